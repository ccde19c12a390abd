// A file that is written whole: there is the old one or the new one, never half of one.
#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>

namespace frontpanels {

// Writes beside `pathUtf8`, under its name and ".part", brings that to the disk and then gives the file its
// own name; what a killed program left under that name is written over. Permissions of an old file stay, and
// a link still leads to it. Of programs that save the same file at once each writes its own, one after the
// other. Where saving fails nothing is left of it, a file that was there stays, and the reason is raised as a
// run-time error that names the path.
void saveWhole(const std::string& pathUtf8, std::span<const std::uint8_t> bytes);
void saveWhole(const std::string& pathUtf8, std::string_view text);

}  // namespace frontpanels

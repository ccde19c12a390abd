// A file that is written whole: there is the old one or the new one, never half of one.
#pragma once

#include <cstdint>
#include <filesystem>
#include <span>

namespace frontpanels {

// Writes under another name beside `path` and then gives the file its own. Where that fails nothing is left
// of it, a file that was there stays, and the reason is raised as a run-time error that names `path`.
void saveWhole(const std::filesystem::path& path, std::span<const std::uint8_t> bytes);

}  // namespace frontpanels

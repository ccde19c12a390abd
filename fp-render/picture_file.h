// A picture's file: there is a whole one or none.
#pragma once

#include <cstdint>
#include <filesystem>
#include <span>

namespace frontpanels {

// Writes under another name beside `path` and then gives the file its own. Where that fails nothing is left
// of it, a file that was there stays, and the reason is raised as a run-time error that names `path`.
void saveWhole(const std::filesystem::path& path, std::span<const std::uint8_t> bytes);

}  // namespace frontpanels

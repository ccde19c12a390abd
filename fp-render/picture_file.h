// A picture's file: there is a whole one or none.
#pragma once

#include <filesystem>
#include <functional>

namespace frontpanels {

// Has `write` make the file under another name beside `path` and then gives it its own. Where that fails
// nothing is left of it and the reason is raised as a run-time error that names `path`; a file that was there
// stays.
void saveWhole(const std::filesystem::path& path, const std::function<void(const std::string& aside)>& write);

}  // namespace frontpanels

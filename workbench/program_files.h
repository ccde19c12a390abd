// Where the program finds and keeps its files. Paths are UTF-8.
#pragma once

#include <filesystem>
#include <string>

namespace frontpanels::workbench {

[[nodiscard]] std::string carriedRecording();
// In the user's own folder for settings of programs. Raises a failure when the system names none.
[[nodiscard]] std::string usersSettingsFile();
// The last part of a path.
[[nodiscard]] std::string fileName(const std::string& path);
// As it is found from any folder.
[[nodiscard]] std::string wholePath(const std::string& path);
// FOLDER/NAME, the folder made where it is not there. Raises a failure that names the folder.
[[nodiscard]] std::string fileIn(const std::string& folder, const std::string& name);
// "2024-05-01 13-30-00" by the user's clock: for the names of files.
[[nodiscard]] std::string stampForNames();
// "2024-05-01 13:30:00"
[[nodiscard]] std::string stamp();

}  // namespace frontpanels::workbench

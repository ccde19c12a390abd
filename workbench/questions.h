// What the user is asked for.
#pragma once

#include <windows.h>

#include <optional>
#include <string>

namespace frontpanels::workbench {

// Pairs of a description and its patterns, each ended by a zero character, as the system's dialogs take them.
using FileFilter = const wchar_t*;

// Paths are UTF-8. Nothing when the user has cancelled; raise a failure when the system has.
[[nodiscard]] std::optional<std::string> askForFileToOpen(HWND owner, const wchar_t* title,
                                                          FileFilter filter);
enum class SavedFile { Replaced, Continued };
// A name without an extension gets `extension`; the user is asked before a file is replaced.
[[nodiscard]] std::optional<std::string> askForFileToSave(HWND owner, const wchar_t* title, FileFilter filter,
                                                          const wchar_t* extension,
                                                          const std::string& proposed,
                                                          SavedFile file = SavedFile::Replaced);

}  // namespace frontpanels::workbench

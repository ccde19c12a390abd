// PNG files by the operating system's own imaging component.
#pragma once

#include <string>

#include "activex/panel_window.h"

namespace frontpanels::activex {

// Replaces a file that is there, and leaves it as it was when writing fails. Raises "Path/File access error"
// where no file can be written, ComFailure when the component fails.
void writePng(const std::wstring& path, const MemoryPicture& picture);

}  // namespace frontpanels::activex

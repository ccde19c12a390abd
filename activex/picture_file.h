// PNG by the operating system's own imaging component.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "activex/panel_window.h"

namespace frontpanels::activex {

// The bytes of a PNG file. Raises ComFailure when the component fails.
[[nodiscard]] std::vector<std::uint8_t> encodePng(const MemoryPicture& picture);
// Replaces a file that is there, and leaves it as it was when writing fails. Raises "Path/File access error"
// where no file can be written, ComFailure when the component fails.
void writePng(const std::wstring& path, const MemoryPicture& picture);

}  // namespace frontpanels::activex

// Pictures as PNG.
#pragma once

#include <cstdint>
#include <filesystem>
#include <string>
#include <vector>

#include "platform/raster/pixels.h"

namespace frontpanels {

// Both answer false with a sentence in `error` when they fail, and leave `png` empty or no file behind.
[[nodiscard]] bool encodePng(const PixelView& pixels, std::vector<std::uint8_t>& png, std::string& error);
[[nodiscard]] bool writePng(const std::filesystem::path& path, const PixelView& pixels, std::string& error);

}  // namespace frontpanels

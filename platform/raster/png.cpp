#include "platform/raster/png.h"

#include <png.h>

#include <cstdio>
#include <fstream>
#include <system_error>

namespace frontpanels {
namespace {

std::vector<std::uint8_t> rgbBytes(const PixelView& pixels) {
  std::vector<std::uint8_t> bytes;
  bytes.reserve(std::size_t{3} * static_cast<std::size_t>(pixels.sizePx.width) *
                static_cast<std::size_t>(pixels.sizePx.height));
  for (std::int32_t y = 0; y < pixels.sizePx.height; ++y) {
    for (std::int32_t x = 0; x < pixels.sizePx.width; ++x) {
      const Color color = pixels.at(x, y);
      bytes.insert(bytes.end(), {color.red(), color.green(), color.blue()});
    }
  }
  return bytes;
}

bool fail(std::string& error, const std::string& what) {
  error = what;
  return false;
}

}  // namespace

bool encodePng(const PixelView& pixels, std::vector<std::uint8_t>& png, std::string& error) {
  png.clear();
  if (pixels.sizePx.width <= 0 || pixels.sizePx.height <= 0) return fail(error, "The picture has no pixels.");
  const std::vector<std::uint8_t> bytes = rgbBytes(pixels);
  png_image image{};
  image.version = PNG_IMAGE_VERSION;
  image.width = static_cast<png_uint_32>(pixels.sizePx.width);
  image.height = static_cast<png_uint_32>(pixels.sizePx.height);
  image.format = PNG_FORMAT_RGB;
  // The first size is a bound; the second call says what was used.
  png_alloc_size_t size = PNG_IMAGE_PNG_SIZE_MAX(image);
  png.resize(size);
  if (png_image_write_to_memory(&image, png.data(), &size, 0, bytes.data(), 0, nullptr) == 0) {
    png.clear();
    return fail(error, std::string("The picture could not be compressed: ") + image.message + '.');
  }
  png.resize(size);
  return true;
}

bool writePng(const std::filesystem::path& path, const PixelView& pixels, std::string& error) {
  std::vector<std::uint8_t> png;
  if (!encodePng(pixels, png, error)) return false;
  std::ofstream file(path, std::ios::binary | std::ios::trunc);
  if (!file) return fail(error, "The file \"" + path.string() + "\" cannot be opened for writing.");
  file.write(reinterpret_cast<const char*>(png.data()), static_cast<std::streamsize>(png.size()));
  file.close();
  if (file) return true;
  std::error_code ignored;
  if (std::filesystem::is_regular_file(path, ignored))
    std::filesystem::remove(path, ignored);  // never a device
  return fail(error, "The file \"" + path.string() + "\" could not be written wholly.");
}

}  // namespace frontpanels

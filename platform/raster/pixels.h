// Pixels in memory: 32 bits each, 0x00RRGGBB (blue first in memory), rows from the top.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>

#include "platform/gdi.h"

namespace frontpanels {

[[nodiscard]] constexpr std::uint32_t pixelOf(Color color) noexcept {
  return static_cast<std::uint32_t>(color.red()) << 16 | static_cast<std::uint32_t>(color.green()) << 8 |
         color.blue();
}
[[nodiscard]] constexpr Color colorOf(std::uint32_t pixel) noexcept {
  return rgb(static_cast<std::uint8_t>(pixel >> 16), static_cast<std::uint8_t>(pixel >> 8),
             static_cast<std::uint8_t>(pixel));
}

// Where drawing goes. Owns nothing.
struct PixelRows {
  std::uint32_t* first = nullptr;
  std::ptrdiff_t stride = 0;  // in pixels

  [[nodiscard]] std::uint32_t* at(std::int32_t x, std::int32_t y) const noexcept {
    return first + y * stride + x;
  }
};

// A look at pixels. Valid until their bitmap is drawn on, resized or deleted.
struct PixelView {
  const std::uint32_t* first = nullptr;
  std::ptrdiff_t stride = 0;  // in pixels
  Size sizePx{};

  [[nodiscard]] const std::uint32_t* row(std::int32_t y) const noexcept { return first + y * stride; }
  [[nodiscard]] Color at(std::int32_t x, std::int32_t y) const noexcept { return colorOf(row(y)[x]); }
};

struct Bitmap {
  std::unique_ptr<std::uint32_t[]> storage;
  Size sizePx{};
  std::ptrdiff_t stride = 0;
  int selections = 0;  // by device contexts: at most one

  [[nodiscard]] PixelRows rows() const noexcept { return {storage.get(), stride}; }
  [[nodiscard]] Rect bounds() const noexcept { return {0, 0, sizePx.width, sizePx.height}; }
  // All black; without storage when the size is not positive, too large, or memory is short.
  [[nodiscard]] static Bitmap create(Size sizePx) noexcept;
};

[[nodiscard]] constexpr Rect intersection(const Rect& a, const Rect& b) noexcept {
  return {a.left > b.left ? a.left : b.left, a.top > b.top ? a.top : b.top,
          a.right < b.right ? a.right : b.right, a.bottom < b.bottom ? a.bottom : b.bottom};
}

}  // namespace frontpanels

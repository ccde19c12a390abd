// Plain integer geometry. Rectangles are half-open: left and top belong to them, right and bottom do not.
#pragma once

#include <cstdint>

namespace frontpanels {

struct Point {
  std::int32_t x = 0;
  std::int32_t y = 0;
  friend bool operator==(const Point&, const Point&) = default;
};

struct Size {
  std::int32_t width = 0;
  std::int32_t height = 0;
  friend bool operator==(const Size&, const Size&) = default;
};

struct Rect {
  std::int32_t left = 0;
  std::int32_t top = 0;
  std::int32_t right = 0;
  std::int32_t bottom = 0;

  // The rule of PtInRect.
  [[nodiscard]] constexpr bool contains(Point p) const noexcept {
    return p.x >= left && p.x < right && p.y >= top && p.y < bottom;
  }
  [[nodiscard]] constexpr std::int32_t width() const noexcept { return right - left; }
  [[nodiscard]] constexpr std::int32_t height() const noexcept { return bottom - top; }
  [[nodiscard]] constexpr bool empty() const noexcept { return right <= left || bottom <= top; }
  friend bool operator==(const Rect&, const Rect&) = default;
};

// Whether they have a pixel in common; neither is empty.
[[nodiscard]] constexpr bool overlap(const Rect& a, const Rect& b) noexcept {
  return a.left < b.right && b.left < a.right && a.top < b.bottom && b.top < a.bottom;
}

}  // namespace frontpanels

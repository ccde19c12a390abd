// Value to pixel: where a plot lies and where its values and points fall. Pixels are those of the off-screen
// surface; positions are doubles until they are drawn.
#pragma once

#include <cstdint>

#include "framework/support/numeric.h"
#include "platform/geometry.h"

namespace frontpanels {

// Pixels between a panel's rectangle and its plot.
struct PlotInsets {
  float left = 0;
  float top = 0;
  float right = 0;
  float bottom = 0;
  friend bool operator==(const PlotInsets&, const PlotInsets&) = default;
};

// A rectangle in single precision, as panels are laid out.
struct PlotRect {
  float left = 0;
  float top = 0;
  float width = 0;
  float height = 0;

  [[nodiscard]] PlotRect shrunk(const PlotInsets& by) const noexcept {
    return {left + by.left, top + by.top, width - (by.left + by.right), height - (by.top + by.bottom)};
  }
  // A plot without height still shows its traces, as lines along it.
  [[nodiscard]] bool drawable() const noexcept { return width > 0 && height >= 0; }
  // Rounded half to even. Raises "Overflow".
  [[nodiscard]] Rect toPixels() const {
    return {toInt32(left), toInt32(top), toInt32(left + width), toInt32(top + height)};
  }
  friend bool operator==(const PlotRect&, const PlotRect&) = default;
};

// The levels at the ends of a value axis.
struct ValueRange {
  double minimum = 0;
  double maximum = 0;

  // In single precision: levels closer than it can tell apart make no range.
  [[nodiscard]] float extent() const noexcept { return static_cast<float>(maximum - minimum); }
  friend bool operator==(const ValueRange&, const ValueRange&) = default;
};

// Maps the smallest value of a range to the bottom edge of a plot and the largest to its top edge.
class ValueAxis {
 public:
  ValueAxis(const PlotRect& plot, const ValueRange& range) noexcept
      : pxPerUnit_(static_cast<double>(plot.height) / range.extent()),
        originPx_(static_cast<double>(plot.top) + plot.height +
                  plot.height * range.minimum / range.extent()) {}

  // Maps the smallest value to the left edge and the largest to the right one.
  [[nodiscard]] static ValueAxis across(const PlotRect& plot, const ValueRange& range) noexcept {
    const double pxPerUnit = static_cast<double>(plot.width) / range.extent();
    return {-pxPerUnit, static_cast<double>(plot.left) - range.minimum * pxPerUnit};
  }

  [[nodiscard]] double pixel(double value) const noexcept { return originPx_ - value * pxPerUnit_; }

 private:
  ValueAxis(double pxPerUnit, double originPx) noexcept : pxPerUnit_(pxPerUnit), originPx_(originPx) {}

  double pxPerUnit_;
  double originPx_;
};

// Maps a point's index to its place along a plot.
class PointAxis {
 public:
  PointAxis(double originPx, double stepPx) noexcept : originPx_(originPx), stepPx_(stepPx) {}

  [[nodiscard]] double pixel(std::int32_t point) const noexcept { return point * stepPx_ + originPx_; }

 private:
  double originPx_;
  double stepPx_;
};

// Division line `i` of `count` along `lengthPx` from `startPx`. Raises "Overflow".
[[nodiscard]] inline std::int32_t divisionLinePx(float startPx, float lengthPx, std::int32_t i,
                                                 std::int32_t count) {
  return toInt32(static_cast<double>(startPx) + static_cast<double>(lengthPx) * i / count);
}

}  // namespace frontpanels

// The pixels of lines that are wider than one pixel: for each segment a four-cornered body between two round
// caps.
#pragma once

#include <cstdint>
#include <span>
#include <vector>

#include "platform/geometry.h"

namespace frontpanels {

// The pixels left <= x < right of row y.
struct PixelSpan {
  std::int32_t y = 0;
  std::int32_t left = 0;
  std::int32_t right = 0;
};

// Collects the spans of a polyline `widthPx` >= 2 wide within `clip` into `spans`: sorted, none overlapping
// another.
void collectWideLine(std::span<const Point> points, std::int32_t widthPx, const Rect& clip,
                     std::vector<PixelSpan>& spans);

}  // namespace frontpanels

// The pixels of one-pixel lines. A line has its first point and not its last. Of the two pixels that an ideal
// line passes at equal distance it takes the one above (of a flat line) or to the left (of a steep one),
// whatever the direction it is drawn in. Clipping cuts pixels away and moves none.
#pragma once

#include <algorithm>
#include <cstdint>
#include <cstdlib>

#include "platform/raster/pixels.h"

namespace frontpanels {

// A line's visible pixels, from the first: each step goes along `major`, and along `minor` too when the error
// wraps.
struct LineWalk {
  std::uint32_t* pixel = nullptr;
  std::ptrdiff_t major = 0;
  std::ptrdiff_t minor = 0;
  std::int64_t count = 0;
  std::int64_t firstStep = 0;  // steps from the line's first point to its first visible pixel
  std::int64_t error = 0;
  std::int64_t errorStep = 0;
  std::int64_t errorWrap = 0;
};

// An empty walk (count 0) when nothing is visible. The coordinates may be any.
[[nodiscard]] LineWalk clippedWalk(PixelRows rows, const Rect& clip, Point from, Point to) noexcept;

// Calls plot(pixel, step) for each pixel of a walk.
template <class Plot>
void forEachPixel(const LineWalk& walk, Plot plot) {
  std::uint32_t* pixel = walk.pixel;
  std::int64_t error = walk.error;
  for (std::int64_t i = 0; i < walk.count; ++i) {
    plot(*pixel, walk.firstStep + i);
    if (i + 1 == walk.count) break;  // no pointer past the bitmap
    pixel += walk.major;
    error += walk.errorStep;
    if (error >= walk.errorWrap) {
      error -= walk.errorWrap;
      pixel += walk.minor;
    }
  }
}

// A solid line whose two ends lie within the bitmap.
void drawSolidInside(PixelRows rows, Point from, Point to, std::uint32_t color) noexcept;

}  // namespace frontpanels

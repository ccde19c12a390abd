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

// A line seen along its longer axis: n steps along it, m < n across (or m = n). `bias` is 1 where a tie would
// otherwise step down or to the right.
struct SolidLine {
  std::uint32_t* pixel;
  std::ptrdiff_t major;
  std::ptrdiff_t minor;
  std::int32_t n;
  std::int32_t m;
  std::int32_t bias;
};
void drawRuns(const SolidLine& line, std::uint32_t color) noexcept;   // m > 0
void drawSteps(const SolidLine& line, std::uint32_t color) noexcept;  // any m

inline std::uint32_t* drawRun(std::uint32_t* pixel, std::ptrdiff_t step, std::int32_t count,
                              std::uint32_t color) noexcept {
  for (; count > 0; --count, pixel += step) *pixel = color;
  return pixel;
}

// A solid line whose two ends lie within the bitmap. In place, for the sake of traces with thousands of
// segments.
inline void drawSolidInside(PixelRows rows, Point from, Point to, std::uint32_t color) noexcept {
  const std::int32_t width = std::abs(to.x - from.x);
  const std::int32_t height = std::abs(to.y - from.y);
  std::uint32_t* const pixel = rows.at(from.x, from.y);
  const std::ptrdiff_t stepX = to.x < from.x ? -1 : 1;
  const std::ptrdiff_t stepY = to.y < from.y ? -rows.stride : rows.stride;
  if (width == 0) {
    drawRun(pixel, stepY, height, color);
  } else if (width == 1 && height > 1) {  // most segments of a dense trace: two runs
    const std::int32_t firstRun = (height + 1 + (to.x > from.x ? 1 : 0)) / 2;
    std::uint32_t* const next = drawRun(pixel, stepY, firstRun, color) + stepX;
    drawRun(next, stepY, height - firstRun, color);
  } else if (height == 0) {
    std::fill_n(stepX > 0 ? pixel : pixel - width + 1, width, color);
  } else if (width >= height) {
    const auto draw = width >= 4 * height ? drawRuns : drawSteps;
    draw({pixel, stepX, stepY, width, height, to.y > from.y ? 1 : 0}, color);
  } else {
    const auto draw = height >= 4 * width ? drawRuns : drawSteps;
    draw({pixel, stepY, stepX, height, width, to.x > from.x ? 1 : 0}, color);
  }
}

}  // namespace frontpanels

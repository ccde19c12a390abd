#include "platform/raster/line.h"

namespace frontpanels {
namespace {

// Products of two differences of 32-bit coordinates need 65 bits.
__extension__ using Wide = __int128;

Wide floorDiv(Wide a, Wide b) { return a >= 0 ? a / b : -((-a + b - 1) / b); }
Wide ceilDiv(Wide a, Wide b) { return -floorDiv(-a, b); }

// A line seen along its longer axis: n steps along it, m across. The pixel of step i lies
// floor((2 m i + n - bias) / 2 n) across; the bias keeps a tie from stepping down or to the right.
struct Slope {
  Wide n = 0;
  Wide m = 0;
  Wide bias = 0;

  [[nodiscard]] Wide across(Wide i) const { return (2 * m * i + n - bias) / (2 * n); }
  // The first step that lies at least `j` across.
  [[nodiscard]] Wide firstStepAt(Wide j) const { return ceilDiv(2 * n * j - n + bias, 2 * m); }
};

struct Steps {
  Wide first;
  Wide end;
};

// The steps whose coordinate start + direction * step lies in [low, high).
Steps stepsWithin(Wide start, int direction, Wide low, Wide high) {
  return direction > 0 ? Steps{low - start, high - start} : Steps{start - high + 1, start - low + 1};
}

}  // namespace

LineWalk clippedWalk(PixelRows rows, const Rect& clip, Point from, Point to) noexcept {
  const Wide dx = Wide{to.x} - from.x;
  const Wide dy = Wide{to.y} - from.y;
  const int stepX = dx < 0 ? -1 : 1;
  const int stepY = dy < 0 ? -1 : 1;
  const bool flat = dx * stepX >= dy * stepY;
  const Slope slope = flat ? Slope{dx * stepX, dy * stepY, stepY > 0 ? 1 : 0}
                           : Slope{dy * stepY, dx * stepX, stepX > 0 ? 1 : 0};
  if (slope.n == 0 || clip.empty()) return {};

  const Steps alongX = stepsWithin(from.x, stepX, clip.left, clip.right);
  const Steps alongY = stepsWithin(from.y, stepY, clip.top, clip.bottom);
  const Steps& major = flat ? alongX : alongY;
  const Steps& minor = flat ? alongY : alongX;
  Wide first = std::max<Wide>(major.first, 0);
  Wide end = std::min(major.end, slope.n);
  if (slope.m > 0) {
    first = std::max(first, slope.firstStepAt(minor.first));
    end = std::min(end, slope.firstStepAt(minor.end));
  } else if (minor.first > 0 || minor.end <= 0) {
    return {};
  }
  if (first >= end) return {};

  const Wide across = slope.across(first);
  const auto x = static_cast<std::int32_t>(from.x + stepX * (flat ? first : across));
  const auto y = static_cast<std::int32_t>(from.y + stepY * (flat ? across : first));
  const std::ptrdiff_t pixelX = stepX;
  const std::ptrdiff_t pixelY = stepY * rows.stride;
  return {
      .pixel = rows.at(x, y),
      .major = flat ? pixelX : pixelY,
      .minor = flat ? pixelY : pixelX,
      .count = static_cast<std::int64_t>(end - first),
      .firstStep = static_cast<std::int64_t>(first),
      .error = static_cast<std::int64_t>(2 * slope.m * first + slope.n - slope.bias - 2 * slope.n * across),
      .errorStep = static_cast<std::int64_t>(2 * slope.m),
      .errorWrap = static_cast<std::int64_t>(2 * slope.n)};
}

namespace {

inline std::uint32_t* drawRun(std::uint32_t* pixel, std::ptrdiff_t step, std::int32_t count,
                              std::uint32_t color) noexcept {
  for (; count > 0; --count, pixel += step) *pixel = color;
  return pixel;
}

// A line of m steps across is m + 1 runs along its longer axis; only their lengths need arithmetic, not each
// pixel.
void drawRuns(std::uint32_t* pixel, std::ptrdiff_t major, std::ptrdiff_t minor, std::int32_t n,
              std::int32_t m, std::int32_t bias, std::uint32_t color) noexcept {
  if (m == 1) {  // most segments of a dense trace
    const std::int32_t firstRun = (n + bias + 1) / 2;
    pixel = drawRun(pixel, major, firstRun, color) + minor;
    drawRun(pixel, major, n - firstRun, color);
    return;
  }
  const std::int32_t quotient = n / m;
  const std::int32_t remainder = n % m;
  // The first run ends at step ceil((n + bias) / 2 m); `slack` is by how much that was rounded up, times 2 m.
  std::int32_t run = (quotient + 1) / 2 + (quotient % 2 == 0 && remainder + bias > 0 ? 1 : 0);
  std::int32_t slack = run * 2 * m - (n + bias);
  std::int32_t left = n;
  for (std::int32_t k = 0; k < m; ++k) {
    pixel = drawRun(pixel, major, run, color) + minor;
    left -= run;
    const bool longer = 2 * remainder > slack;
    run = quotient + (longer ? 1 : 0);
    slack += (longer ? 2 * m : 0) - 2 * remainder;
  }
  drawRun(pixel, major, left, color);
}

// Near a diagonal the runs are so short that stepping is quicker.
void drawSteps(std::uint32_t* pixel, std::ptrdiff_t major, std::ptrdiff_t minor, std::int32_t n,
               std::int32_t m, std::int32_t bias, std::uint32_t color) noexcept {
  std::int32_t error = n - bias;
  for (std::int32_t i = 0; i < n; ++i) {
    *pixel = color;
    pixel += major;
    error += 2 * m;
    const bool wrap = error >= 2 * n;
    error -= wrap ? 2 * n : 0;
    pixel += wrap ? minor : 0;
  }
}

}  // namespace

void drawSolidInside(PixelRows rows, Point from, Point to, std::uint32_t color) noexcept {
  const std::int32_t dx = to.x - from.x;
  const std::int32_t dy = to.y - from.y;
  const std::int32_t width = std::abs(dx);
  const std::int32_t height = std::abs(dy);
  std::uint32_t* const pixel = rows.at(from.x, from.y);
  const std::ptrdiff_t stepX = dx < 0 ? -1 : 1;
  const std::ptrdiff_t stepY = dy < 0 ? -rows.stride : rows.stride;
  if (dx == 0) {
    drawRun(pixel, stepY, height, color);
  } else if (dy == 0) {
    std::fill_n(dx > 0 ? pixel : pixel + dx + 1, width, color);
  } else if (width >= height) {
    const auto draw = width >= 4 * height ? drawRuns : drawSteps;
    draw(pixel, stepX, stepY, width, height, dy > 0 ? 1 : 0, color);
  } else {
    const auto draw = height >= 4 * width ? drawRuns : drawSteps;
    draw(pixel, stepY, stepX, height, width, dx > 0 ? 1 : 0, color);
  }
}

}  // namespace frontpanels

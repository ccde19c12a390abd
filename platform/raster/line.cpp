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

// A line of m steps across is m + 1 runs along its longer axis; only their lengths need arithmetic, not each
// pixel.
void drawRuns(const SolidLine& line, std::uint32_t color) noexcept {
  const std::int32_t n = line.n;
  const std::int32_t m = line.m;
  const std::int32_t quotient = n / m;
  const std::int32_t remainder = n % m;
  // The first run ends at step ceil((n + bias) / 2 m); `slack` is by how much that was rounded up, times 2 m.
  std::int32_t run = (quotient + 1) / 2 + (quotient % 2 == 0 && remainder + line.bias > 0 ? 1 : 0);
  std::int32_t slack = run * 2 * m - (n + line.bias);
  std::int32_t left = n;
  std::uint32_t* pixel = line.pixel;
  for (std::int32_t k = 0; k < m; ++k) {
    pixel = drawRun(pixel, line.major, run, color) + line.minor;
    left -= run;
    const bool longer = 2 * remainder > slack;
    run = quotient + (longer ? 1 : 0);
    slack += (longer ? 2 * m : 0) - 2 * remainder;
  }
  drawRun(pixel, line.major, left, color);
}

// Near a diagonal the runs are so short that stepping is quicker.
void drawSteps(const SolidLine& line, std::uint32_t color) noexcept {
  std::uint32_t* pixel = line.pixel;
  std::int32_t error = line.n - line.bias;
  for (std::int32_t i = 0; i < line.n; ++i) {
    *pixel = color;
    pixel += line.major;
    error += 2 * line.m;
    if (error >= 2 * line.n) {
      error -= 2 * line.n;
      pixel += line.minor;
    }
  }
}

}  // namespace frontpanels

#include "platform/raster/wide_line.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>

namespace frontpanels {
namespace {

__extension__ using Wide = __int128;

struct Corner {
  Wide x = 0;
  Wide y = 0;
};
using Body = std::array<Corner, 4>;

Wide ceilDiv(Wide a, Wide b) { return a > 0 ? (a + b - 1) / b : -(-a / b); }

void add(std::vector<PixelSpan>& spans, const Rect& clip, Wide y, Wide left, Wide right) {
  left = std::max<Wide>(left, clip.left);
  right = std::min<Wide>(right, clip.right);
  if (y < clip.top || y >= clip.bottom || left >= right) return;
  spans.push_back(
      {static_cast<std::int32_t>(y), static_cast<std::int32_t>(left), static_cast<std::int32_t>(right)});
}

// The body is as many whole pixels wide, across and down, as the ideal one rounded up; an odd pixel goes to
// the right side (of a level line: below).
Body bodyOf(Point from, Point to, std::int32_t widthPx) {
  const double dx = static_cast<double>(to.x) - from.x;
  const double dy = static_cast<double>(to.y) - from.y;
  const double length = std::hypot(dx, dy);
  const auto across = static_cast<std::int64_t>(std::ceil(widthPx * std::abs(dy) / length - 1e-9));
  const auto down = static_cast<std::int64_t>(std::ceil(widthPx * std::abs(dx) / length - 1e-9));
  const bool falls = dx * dy > 0;  // from the upper left to the lower right
  const std::int64_t rightX = (across + 1) / 2;
  const std::int64_t rightY = falls ? -(down + 1) / 2 : (down + 1) / 2;
  const std::int64_t leftX = -(across / 2);
  const std::int64_t leftY = falls ? down / 2 : -(down / 2);
  return {{{Wide{from.x} + rightX, Wide{from.y} + rightY},
           {Wide{to.x} + rightX, Wide{to.y} + rightY},
           {Wide{to.x} + leftX, Wide{to.y} + leftY},
           {Wide{from.x} + leftX, Wide{from.y} + leftY}}};
}

// A pixel belongs to the body when its top left corner does, left edge in, right edge out.
void addBody(const Body& body, const Rect& clip, std::vector<PixelSpan>& spans) {
  const auto byY = [](const Corner& a, const Corner& b) { return a.y < b.y; };
  const auto [top, bottom] = std::minmax_element(body.begin(), body.end(), byY);
  const Wide lastY = std::min<Wide>(bottom->y, clip.bottom);
  for (Wide y = std::max<Wide>(top->y, clip.top); y < lastY; ++y) {
    std::array<Wide, 4> crossings{};
    std::size_t count = 0;
    for (std::size_t i = 0; i < body.size(); ++i) {
      const auto [upper, lower] = std::minmax(body[i], body[(i + 1) % body.size()], byY);
      if (y < upper.y || y >= lower.y) continue;
      crossings[count++] = upper.x + ceilDiv((y - upper.y) * (lower.x - upper.x), lower.y - upper.y);
    }
    if (count == 2)
      add(spans, clip, y, std::min(crossings[0], crossings[1]), std::max(crossings[0], crossings[1]));
  }
}

void addCap(Point center, std::int32_t widthPx, const Rect& clip, std::vector<PixelSpan>& spans) {
  // A disc a tenth of a pixel smaller than half the width; distances are doubled, so that pixel centres are
  // whole.
  const auto inside = [widthPx](std::int64_t x2, std::int64_t y2) {
    const std::int64_t radius5 = std::int64_t{5} * widthPx - 1;
    return 25 * (x2 * x2 + y2 * y2) <= radius5 * radius5;
  };
  const Wide left = Wide{center.x} - widthPx / 2;
  const Wide top = Wide{center.y} - widthPx / 2;
  for (std::int64_t row = 0; row < widthPx; ++row) {
    std::int64_t gap = 0;
    while (gap < widthPx && !inside(2 * gap + 1 - widthPx, 2 * row + 1 - widthPx)) ++gap;
    add(spans, clip, top + row, left + gap, left + widthPx - gap);
  }
}

void mergeOverlapping(std::vector<PixelSpan>& spans) {
  std::sort(spans.begin(), spans.end(),
            [](const PixelSpan& a, const PixelSpan& b) { return a.y != b.y ? a.y < b.y : a.left < b.left; });
  std::size_t kept = 0;
  for (const PixelSpan& span : spans) {
    if (kept > 0 && spans[kept - 1].y == span.y && span.left <= spans[kept - 1].right) {
      spans[kept - 1].right = std::max(spans[kept - 1].right, span.right);
    } else {
      spans[kept++] = span;
    }
  }
  spans.resize(kept);
}

}  // namespace

void collectWideLine(std::span<const Point> points, std::int32_t widthPx, const Rect& clip,
                     std::vector<PixelSpan>& spans) {
  spans.clear();
  for (std::size_t i = 0; i < points.size(); ++i) {
    if (i > 0 && points[i] != points[i - 1]) addBody(bodyOf(points[i - 1], points[i], widthPx), clip, spans);
    addCap(points[i], widthPx, clip, spans);
  }
  mergeOverlapping(spans);
}

}  // namespace frontpanels

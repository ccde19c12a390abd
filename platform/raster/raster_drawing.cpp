// The drawing of RasterGdi.
#include <algorithm>
#include <cstring>
#include <new>

#include "platform/raster/line.h"
#include "platform/raster/raster_gdi.h"

namespace frontpanels {
namespace {

constexpr std::uint32_t kColorBits = 0xFFFFFF;

// Lengths of dash, gap, dash, ... in pixels along a line's longer axis; the pattern repeats.
std::span<const std::int32_t> dashes(PenStyle style) {
  static constexpr std::int32_t kDash[] = {18, 6};
  static constexpr std::int32_t kDot[] = {3, 3};
  static constexpr std::int32_t kDashDot[] = {9, 6, 3, 6};
  static constexpr std::int32_t kDashDotDot[] = {9, 3, 3, 3, 3, 3};
  switch (style) {
    case PenStyle::Dash:
      return kDash;
    case PenStyle::Dot:
      return kDot;
    case PenStyle::DashDot:
      return kDashDot;
    case PenStyle::DashDotDot:
      return kDashDotDot;
    default:
      return {};
  }
}

bool inGap(std::span<const std::int32_t> pattern, std::int64_t position) {
  std::int64_t length = 0;
  for (const std::int32_t part : pattern) length += part;
  if (length == 0) return false;
  position %= length;
  bool gap = false;
  for (const std::int32_t part : pattern) {
    if (position < part) return gap;
    position -= part;
    gap = !gap;
  }
  return gap;
}

// Whether a hatch inks the pixel; the pattern of 8 by 8 pixels starts at the bitmap's corner.
bool hatched(HatchStyle style, std::int32_t x, std::int32_t y) {
  const std::int32_t column = x & 7;
  const std::int32_t row = y & 7;
  switch (style) {
    case HatchStyle::Horizontal:
      return row == 3;
    case HatchStyle::Vertical:
      return column == 4;
    case HatchStyle::ForwardDiagonal:
      return column == row;
    case HatchStyle::BackwardDiagonal:
      return column == 7 - row;
    case HatchStyle::Cross:
      return row == 3 || column == 4;
    case HatchStyle::DiagonalCross:
      return column == row || column == 7 - row;
  }
  return false;
}

struct Ink {
  std::uint32_t pixel;
  bool notXor;
  void operator()(std::uint32_t& target) const { target = notXor ? ~(target ^ pixel) & kColorBits : pixel; }
};

void fillSolid(PixelRows rows, const Rect& area, std::uint32_t pixel) {
  if (area.empty()) return;
  if (area.width() == rows.stride) {
    std::fill_n(rows.at(0, area.top), rows.stride * area.height(), pixel);
    return;
  }
  for (std::int32_t y = area.top; y < area.bottom; ++y)
    std::fill_n(rows.at(area.left, y), area.width(), pixel);
}

// A reversed rectangle covers the pixels from one past its smaller side to its larger one, both included.
Rect filledArea(Rect rect) {
  const auto order = [](std::int32_t& low, std::int32_t& high) {
    if (low <= high) return;
    const std::int32_t first = high + 1;
    high = low < INT32_MAX ? low + 1 : low;
    low = first;
  };
  order(rect.left, rect.right);
  order(rect.top, rect.bottom);
  return rect;
}

// Room for the edge's inset at the ends of the coordinate range.
bool edgeIsDrawable(const Rect& rect) {
  const auto roomy = [](std::int32_t v) { return v > INT32_MIN + 2 && v < INT32_MAX - 2; };
  return roomy(rect.left) && roomy(rect.top) && roomy(rect.right) && roomy(rect.bottom);
}

bool within(const Rect& clip, Point p) {
  // One comparison a side pair: what lies before the low side wraps round to a large number.
  const auto between = [](std::int32_t v, std::int32_t low, std::int32_t high) {
    return static_cast<std::uint32_t>(v) - static_cast<std::uint32_t>(low) <
           static_cast<std::uint32_t>(high) - static_cast<std::uint32_t>(low);
  };
  return between(p.x, clip.left, clip.right) && between(p.y, clip.top, clip.bottom);
}

void drawSolid(PixelRows rows, const Rect& clip, std::span<const Point> points, std::uint32_t pixel) {
  if (clip.empty()) return;
  Point from = points.front();
  bool fromInside = within(clip, from);
  for (const Point to : points.subspan(1)) {
    const bool toInside = within(clip, to);
    if (fromInside && toInside) {
      drawSolidInside(rows, from, to, pixel);
    } else {
      forEachPixel(clippedWalk(rows, clip, from, to),
                   [pixel](std::uint32_t& target, std::int64_t) { target = pixel; });
    }
    from = to;
    fromInside = toInside;
  }
}

std::int64_t longerAxis(Point from, Point to) {
  return std::max(std::abs(std::int64_t{to.x} - from.x), std::abs(std::int64_t{to.y} - from.y));
}

std::uint32_t blended(std::uint32_t below, std::uint32_t ink, std::uint32_t coverage) {
  const auto mix = [&](int shift) {
    const std::uint32_t a = below >> shift & 0xFF;
    const std::uint32_t b = ink >> shift & 0xFF;
    return (a * (255 - coverage) + b * coverage + 127) / 255 << shift;
  };
  return mix(16) | mix(8) | mix(0);
}

void drawGlyph(PixelRows rows, const Rect& clip, const Glyph& glyph, std::int64_t left, std::int64_t top,
               std::uint32_t ink) {
  const std::int64_t firstX = std::max<std::int64_t>(clip.left - left, 0);
  const std::int64_t endX = std::min<std::int64_t>(clip.right - left, glyph.sizePx.width);
  const std::int64_t firstY = std::max<std::int64_t>(clip.top - top, 0);
  const std::int64_t endY = std::min<std::int64_t>(clip.bottom - top, glyph.sizePx.height);
  for (std::int64_t y = firstY; y < endY; ++y) {
    const std::uint8_t* coverage = glyph.row(static_cast<std::int32_t>(y));
    for (std::int64_t x = firstX; x < endX; ++x) {
      if (coverage[x] == 0) continue;
      std::uint32_t& target =
          *rows.at(static_cast<std::int32_t>(left + x), static_cast<std::int32_t>(top + y));
      target = coverage[x] == 255 ? ink : blended(target, ink, coverage[x]);
    }
  }
}

std::int64_t advanceOf(Font& font, std::string_view text) {
  std::int64_t width = 0;
  while (!text.empty()) width += font.glyph(nextCodePoint(text)).advancePx;
  return width;
}

// The one place where drawing that may need memory turns its lack into a failed call.
template <class Body>
bool drawn(Body&& body) {
  try {
    body();
    return true;
  } catch (const std::bad_alloc&) {
    return false;
  }
}

}  // namespace

bool RasterGdi::fillRect(DcHandle dc, Rect rect, BrushHandle brush) {
  const Dc* state = dcs_.find(dc);
  const Brush* paint = brushes_.find(brush);
  if (state == nullptr || paint == nullptr) return false;
  const Rect area = intersection(filledArea(rect), state->clip);
  if (paint->null || area.empty()) return true;
  if (!paint->hatch) {
    fillSolid(state->rows, area, paint->pixel);
    return true;
  }
  const bool opaque = state->mode == BackgroundMode::Opaque;
  const std::uint32_t gap = pixelOf(state->bkColor);
  for (std::int32_t y = area.top; y < area.bottom; ++y) {
    for (std::int32_t x = area.left; x < area.right; ++x) {
      if (hatched(*paint->hatch, x, y)) {
        *state->rows.at(x, y) = paint->pixel;
      } else if (opaque) {
        *state->rows.at(x, y) = gap;
      }
    }
  }
  return true;
}

bool RasterGdi::moveTo(DcHandle dc, Point to) {
  Dc* state = dcs_.find(dc);
  if (state == nullptr) return false;
  state->current = to;
  return true;
}

bool RasterGdi::lineTo(DcHandle dc, Point to) {
  Dc* state = dcs_.find(dc);
  if (state == nullptr) return false;
  const Point ends[] = {state->current, to};
  if (!drawn([&] { drawPolyline(*state, ends); })) return false;
  state->current = to;
  return true;
}

bool RasterGdi::polyline(DcHandle dc, std::span<const Point> points) {
  const Dc* state = dcs_.find(dc);
  if (state == nullptr || points.size() < 2) return false;
  return drawn([&] { drawPolyline(*state, points); });
}

void RasterGdi::drawPolyline(const Dc& dc, std::span<const Point> points) {
  const Pen& pen = dc.penNow;
  if (pen.null) return;
  if (pen.widthPx > 1) return drawWide(dc, points);
  const Ink ink{pen.pixel, dc.rop == DrawMode::NotXorPen};
  const std::span<const std::int32_t> pattern = dashes(pen.style);
  if (pattern.empty() && !ink.notXor) return drawSolid(dc.rows, dc.clip, points, pen.pixel);

  const Ink gapInk{pixelOf(dc.bkColor), ink.notXor};
  const bool opaque = dc.mode == BackgroundMode::Opaque;
  std::int64_t position = 0;  // along the pattern, which runs on from segment to segment
  for (std::size_t i = 1; i < points.size(); ++i) {
    forEachPixel(clippedWalk(dc.rows, dc.clip, points[i - 1], points[i]),
                 [&](std::uint32_t& target, std::int64_t step) {
                   if (pattern.empty() || !inGap(pattern, position + step)) {
                     ink(target);
                   } else if (opaque) {
                     gapInk(target);
                   }
                 });
    position += longerAxis(points[i - 1], points[i]);
  }
}

void RasterGdi::drawWide(const Dc& dc, std::span<const Point> points) {
  const Ink ink{dc.penNow.pixel, dc.rop == DrawMode::NotXorPen};
  collectWideLine(points, dc.penNow.widthPx, dc.clip, wideSpans_);
  for (const PixelSpan& span : wideSpans_) {
    std::for_each(dc.rows.at(span.left, span.y), dc.rows.at(span.right, span.y), ink);
  }
}

bool RasterGdi::drawEdge(DcHandle dc, Rect rect, std::uint32_t edge, std::uint32_t sides) {
  struct Ring {
    std::uint32_t flag;
    SystemColor leftTop;
    SystemColor rightBottom;
    std::int32_t inset;
  };
  static constexpr Ring kRings[] = {
      {1, SystemColor::Light3d, SystemColor::DarkShadow3d, 0},          // raised outer
      {2, SystemColor::ButtonShadow, SystemColor::ButtonHighlight, 0},  // sunken outer
      {4, SystemColor::ButtonHighlight, SystemColor::ButtonShadow, 1},  // raised inner
      {8, SystemColor::DarkShadow3d, SystemColor::Light3d, 1},          // sunken inner
  };
  const Dc* state = dcs_.find(dc);
  if (state == nullptr || sides != kAllSides || edge > 15 || !edgeIsDrawable(rect)) return false;
  for (const Ring& ring : kRings) {
    if ((edge & ring.flag) == 0) continue;
    const Rect r{rect.left + ring.inset, rect.top + ring.inset, rect.right - ring.inset,
                 rect.bottom - ring.inset};
    const auto line = [&](Point from, Point to, SystemColor color) {
      const Point ends[] = {from, to};
      drawSolid(state->rows, state->clip, ends, sysPixel(color));
    };
    // Lines, not fills: they show what a rectangle thinner than its edge looks like.
    line({r.left, r.top}, {r.right, r.top}, ring.leftTop);
    line({r.left, r.top}, {r.left, r.bottom}, ring.leftTop);
    line({r.left, r.bottom - 1}, {r.right, r.bottom - 1}, ring.rightBottom);
    line({r.right - 1, r.top}, {r.right - 1, r.bottom}, ring.rightBottom);
  }
  return true;
}

Font* RasterGdi::fontOf(const Dc& dc) {
  FontObject* object = fonts_.find(dc.font);
  // The stock font is loaded when it is first used: a program that writes no text needs no fonts.
  if (object->font == nullptr) object->font = fontCache_.find({"Arial", 14, 700, false});
  return object->font;
}

bool RasterGdi::textOut(DcHandle dc, Point topLeft, std::string_view text) {
  const Dc* state = dcs_.find(dc);
  if (state == nullptr) return false;
  return drawn([&] {
    Font* font = fontOf(*state);
    if (font == nullptr) throw std::bad_alloc();
    drawGlyphs(*state, *font, topLeft, text);
  });
}

void RasterGdi::drawGlyphs(const Dc& dc, Font& font, Point topLeft, std::string_view text) {
  if (dc.mode == BackgroundMode::Opaque && !text.empty()) {
    const auto clamped = [](std::int64_t v) {
      return static_cast<std::int32_t>(std::min<std::int64_t>(v, INT32_MAX));
    };
    const Rect cell{topLeft.x, topLeft.y, clamped(topLeft.x + advanceOf(font, text)),
                    clamped(std::int64_t{topLeft.y} + font.heightPx())};
    fillSolid(dc.rows, intersection(cell, dc.clip), pixelOf(dc.bkColor));
  }
  const std::int64_t baseline = std::int64_t{topLeft.y} + font.ascentPx();
  std::int64_t x = topLeft.x;
  while (!text.empty() && x < dc.clip.right) {
    const Glyph& glyph = font.glyph(nextCodePoint(text));
    drawGlyph(dc.rows, dc.clip, glyph, x + glyph.leftPx, baseline - glyph.topPx, pixelOf(dc.textColor));
    x += glyph.advancePx;
  }
}

Size RasterGdi::textExtent(DcHandle dc, std::string_view text) {
  const Dc* state = dcs_.find(dc);
  if (state == nullptr || text.empty()) return {};
  Size extent;
  drawn([&] {
    Font* font = fontOf(*state);
    if (font == nullptr) return;
    const std::int64_t width = std::min<std::int64_t>(advanceOf(*font, text), INT32_MAX);
    extent = {static_cast<std::int32_t>(width), font->heightPx()};
  });
  return extent;
}

bool RasterGdi::bitBlt(DcHandle to, Rect destination, DcHandle from, Point source, RasterOp operation) {
  const Dc* target = dcs_.find(to);
  const Dc* origin = dcs_.find(from);
  if (target == nullptr || origin == nullptr || operation != RasterOp::SourceCopy) return false;
  const std::int64_t shiftX = std::int64_t{source.x} - destination.left;
  const std::int64_t shiftY = std::int64_t{source.y} - destination.top;
  // Pixels that the source does not have leave what is there.
  const Rect visible = intersection(destination, target->clip);
  const std::int64_t left = std::max<std::int64_t>(visible.left, -shiftX);
  const std::int64_t top = std::max<std::int64_t>(visible.top, -shiftY);
  const std::int64_t right = std::min<std::int64_t>(visible.right, origin->bounds.right - shiftX);
  const std::int64_t bottom = std::min<std::int64_t>(visible.bottom, origin->bounds.bottom - shiftY);
  if (left >= right || top >= bottom) return true;

  const auto copyRow = [&](std::int64_t y) {
    std::memmove(
        target->rows.at(static_cast<std::int32_t>(left), static_cast<std::int32_t>(y)),
        origin->rows.at(static_cast<std::int32_t>(left + shiftX), static_cast<std::int32_t>(y + shiftY)),
        static_cast<std::size_t>(right - left) * sizeof(std::uint32_t));
  };
  const bool wholeRows = right - left == target->rows.stride && target->rows.stride == origin->rows.stride;
  if (wholeRows) {  // then they lie one behind the other
    std::memmove(target->rows.at(0, static_cast<std::int32_t>(top)),
                 origin->rows.at(0, static_cast<std::int32_t>(top + shiftY)),
                 static_cast<std::size_t>((bottom - top) * target->rows.stride) * sizeof(std::uint32_t));
    return true;
  }
  // Within one bitmap, rows are copied in the order that reads each before it is overwritten.
  if (shiftY >= 0) {
    for (std::int64_t y = top; y < bottom; ++y) copyRow(y);
  } else {
    for (std::int64_t y = bottom - 1; y >= top; --y) copyRow(y);
  }
  return true;
}

}  // namespace frontpanels

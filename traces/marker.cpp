#include "traces/marker.h"

#include <algorithm>

#include "framework/support/numeric.h"
#include "platform/gdi_scope.h"
#include "traces/plot_colors.h"

namespace frontpanels {
namespace {

constexpr Color kActiveColor = rgb(50, 50, 50);
constexpr double kActivePenWidthPx = 1.5;  // a whole number of pixels, halves to even: 2
constexpr std::int32_t kIdGapPx = 2;

struct Triangle {
  Point apex;
  Point baseLeft;
  Point baseRight;
};

// `heightPx` runs from the apex to the base: below it for a positive height, above it for a negative one.
Triangle triangle(std::int32_t x, double apexY, std::int16_t widthPx, double heightPx) {
  const double half = static_cast<double>(widthPx) / 2.0;
  const std::int32_t baseY = toInt32(apexY + heightPx);
  return {{x, toInt32(apexY)}, {toInt32(x - half), baseY}, {toInt32(x + half), baseY}};
}

// Closes on its apex: the last point of a line is left out, and the first line has drawn it.
void draw(Gdi& gdi, DcHandle dc, const Triangle& shape) {
  gdi.moveTo(dc, shape.apex);
  gdi.lineTo(dc, shape.baseLeft);
  gdi.lineTo(dc, shape.baseRight);
  gdi.lineTo(dc, shape.apex);
}

}  // namespace

void clsMarker::draw(Gdi& gdi, DcHandle dc) const {
  const auto drawShape = [&] {
    const double y = positionY;
    const double y2 = positionY2;
    if (multiMarker || stripChartMarker) {
      frontpanels::draw(gdi, dc, triangle(positionX, y2, width, height));
      gdi.moveTo(dc, {positionX, toInt32(y2 + height)});
      gdi.lineTo(dc, {positionX, toInt32(y - height)});
      frontpanels::draw(gdi, dc, triangle(positionX, y, width, -static_cast<double>(height)));
    } else if (DELTA) {
      frontpanels::draw(gdi, dc, triangle(positionX, y - height, width, height));
    } else {
      frontpanels::draw(gdi, dc, triangle(positionX, y, width, -static_cast<double>(height)));
    }
  };
  if (!active) return drawShape();
  const SelectedPen pen(gdi, dc, PenStyle::Solid, toInt32(kActivePenWidthPx),
                        PlotColors(gdi).selected(kActiveColor));
  drawShape();
}

// Centred above all that draw() has drawn, so that it never lies on its own glyph: either end of a two-ended
// marker may be the higher one.
void clsMarker::drawId(Gdi& gdi, DcHandle dc) const {
  const Size text = gdi.textExtent(dc, id);
  double glyphTop = static_cast<double>(positionY) - height;
  if (multiMarker || stripChartMarker) glyphTop = std::min<double>(glyphTop, positionY2);
  gdi.textOut(dc, {toInt32(positionX - text.width / 2.0), toInt32(glyphTop - kIdGapPx - text.height)}, id);
}

Rect clsMarker::boundsPx() const {
  const bool twoEnded = multiMarker || stripChartMarker;
  const double half = static_cast<double>(width) / 2.0;
  const double far = twoEnded ? positionY2 : positionY;
  const double upper = std::min<double>(static_cast<double>(positionY) - height, far);
  const double lower = std::max<double>(positionY, twoEnded ? far + height : far);
  return {toInt32(positionX - half), toInt32(upper), toInt32(positionX + half + 1), toInt32(lower + 1)};
}

std::string deltaMarkerId(const std::string& id) { return id + "d"; }

}  // namespace frontpanels

#include "painters/plot_painter.h"

#include <cmath>

#include "entry/number_format.h"
#include "framework/support/guard.h"
#include "framework/support/numeric.h"
#include "painters/auto_scale.h"
#include "platform/runtime_error.h"
#include "traces/plot_colors.h"

namespace frontpanels {
namespace {

// Dark enough to stand out (3 to 1) against the usual button faces.
constexpr Color kDefaultGridColor = rgb(112, 112, 112);
constexpr Color kFirstTraceColor = rgb(50, 156, 50);
constexpr std::string_view kDefaultAxisFormat = "0.##";

std::int32_t nextPainterId() {
  static std::int32_t last = 0;
  return ++last;
}

void requireFinite(double value) {
  if (!std::isfinite(value)) raiseInvalidProcedureCall();
}

}  // namespace

PlotPainter::PlotPainter(Gdi& gdi)
    : gdi_(gdi),
      id_(nextPainterId()),
      gridPen_{PenStyle::Solid, kDefaultGridColor},
      activeTraceColor_(kFirstTraceColor) {
  guard("class_Initialize() ...", [this] { yAxisFormatter_.formatString(kDefaultAxisFormat); });
}

PlotPainter::~PlotPainter() {
  if (clip_) gdi_.deleteObject(clip_);
}

void PlotPainter::requireDivisions(std::int32_t divisions) {
  if (divisions > kMaxDivisions) raiseInvalidProcedureCall();
}

// --- Value axis

ValueRange PlotPainter::axis() const {
  const double top = top_.value_or(0);
  return {top - axisLength_, top};
}

void PlotPainter::measureAxis() noexcept {
  if (numberOfVerticalDivisions_ > 0) axisLength_ = perDivision_ * numberOfVerticalDivisions_;
}

void PlotPainter::gridScaleTop(double level) {
  guard(named("::gridScaleTop() ..."), [&] {
    requireFinite(level);
    top_ = level;
  });
}

void PlotPainter::verticalResolution(double perDivision) {
  guard(named("::verticalResolution() ..."), [&] {
    requireFinite(perDivision);
    if (perDivision <= 0) raiseInvalidProcedureCall();
    perDivision_ = perDivision;
    measureAxis();
  });
}

void PlotPainter::numberOfVerticalDivisions(std::int32_t divisions) {
  guard(named("::numberOfVerticalDivisions() ..."), [&] {
    requireDivisions(divisions);
    numberOfVerticalDivisions_ = divisions;
    measureAxis();
    forgetYAxisLabels();
  });
}

bool PlotPainter::fitAxis(const ValueRange& data) {
  if (numberOfVerticalDivisions_ <= 0 || axisFits(axis(), data)) return false;
  const FittedAxis fitted = axisFor(data, numberOfVerticalDivisions_);
  top_ = fitted.top;
  perDivision_ = fitted.perDivision;
  measureAxis();
  range_ = axis();
  updateYAxisLabels();
  return true;
}

clsNumericEntry& PlotPainter::yAxisFormatter() {
  forgetYAxisLabels();  // the caller may change how levels are written
  return yAxisFormatter_;
}

void PlotPainter::autoFormatY(bool on) {
  autoFormatY_ = on;
  forgetYAxisLabels();
}

void PlotPainter::updateYAxisLabels() {
  guard("updateYAxisLabels() ...", [this] {
    const std::int32_t divisions = shownDivisions();
    std::vector<std::string>& texts = labels_.yAxisTexts();
    texts.resize(divisions > 0 ? static_cast<std::size_t>(divisions) + 1 : 0);
    const double step = divisions > 0 ? (range_.maximum - range_.minimum) / divisions : 0;
    const std::string_view format = autoFormatY_
                                        ? formatForStep(step / yAxisFormatter_.shownScale(range_.maximum))
                                        : std::string_view(yAxisFormatter_.formatString());
    labelledRange_ = range_;
    for (std::size_t i = 0; i < texts.size(); ++i) {
      texts[i].clear();
      yAxisFormatter_.append(texts[i], range_.maximum - static_cast<double>(i) * step, format,
                             !yAxisFormatter_.suppressSuffix());
    }
  });
}

GraphItem PlotPainter::chartItem(std::string name, std::string value) const {
  if (!topLabel().empty()) name = topLabel();
  if (!spokenName().empty()) name = spokenName();
  return {GraphItemKind::Chart, std::move(name), std::move(value), panel_.toPixels(), false, true};
}

// --- Painting

PlotRect PlotPainter::surfaceRect() const {
  if (surface_ == nullptr) raiseObjectVariableNotSet();
  return {surface_->ViewScaleLeft(), surface_->ViewScaleTop(), surface_->ViewScaleWidth(),
          surface_->ViewScaleHeight()};
}

DcHandle PlotPainter::surfaceDc() const {
  if (surface_ == nullptr) raiseObjectVariableNotSet();
  return surface_->ViewHDC();
}

void PlotPainter::createClippingRegion(float areaLeft, float areaTop, float areaRight, float areaBottom,
                                       DcHandle dc) {
  guard("createClippingRegion() ...", [&] {
    destroyClippingRegion(dc);
    clip_ =
        gdi_.createRectRgn({toInt32(areaLeft), toInt32(areaTop), toInt32(areaRight), toInt32(areaBottom)});
    if (clip_) gdi_.selectClipRgn(dc, clip_);
  });
}

void PlotPainter::destroyClippingRegion(DcHandle dc) {
  guard("destroyClippingRegion() ...", [&] {
    if (!clip_) return;
    gdi_.selectClipRgn(dc, {});
    gdi_.deleteObject(std::exchange(clip_, {}));
  });
}

void PlotPainter::drawGridOver(DcHandle dc, const PlotRect& plot, const GridDivisions& divisions) {
  guard(named("::DrawGrid()..."), [&] {
    if (gridDrawStyle_) {
      if (surface_ == nullptr) raiseObjectVariableNotSet();
      surface_->ViewDrawStyle(*gridDrawStyle_);
    }
    layOutGrid(plot, divisions, gridLines_);
    const PlotColors colors(gdi_);
    drawGrid(gdi_, dc, gridLines_, {colors.gridStyle(gridPen_.style), colors.grid(gridPen_.color)});
  });
}

void PlotPainter::drawLabels(DcHandle dc, const LabelFonts& fonts) {
  if (labelledRange_ != range_) updateYAxisLabels();
  labels_.draw(gdi_, dc, fonts, panel_.toPixels(), plotRect().toPixels());
}

void PlotPainter::clearArea(DcHandle dc) {
  guard("clearArea() ...", [&] { fillWithBackground(dc, panel_); });
}

void PlotPainter::fillWithBackground(DcHandle dc, const PlotRect& area) {
  const BrushHandle background = PlotColors(gdi_).backgroundBrush();
  if (background) gdi_.fillRect(dc, area.toPixels(), background);
}

// --- Markers

void PlotPainter::activeMarker(MarkerPointer marker) {
  if (activeMarker_ != nullptr) activeMarker_->active = false;
  activeMarker_ = std::move(marker);
  if (activeMarker_ != nullptr) activeMarker_->active = true;
}

}  // namespace frontpanels

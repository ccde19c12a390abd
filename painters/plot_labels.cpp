#include "painters/plot_labels.h"

#include <algorithm>

#include "painters/axis.h"
#include "platform/gdi_scope.h"
#include "traces/plot_colors.h"

namespace frontpanels {
namespace {

enum class Across : std::uint8_t { BeforePlot, PlotLeft, PlotCenter, PlotRight };
enum class Row : std::uint8_t { Line, Top, XAxis, BelowXAxis };

struct PlaceRule {
  Across across;
  Row row;
};

constexpr std::array<PlaceRule, kLabelPlaces> kRules{{
    {Across::BeforePlot, Row::Line},        // YAxis
    {Across::PlotLeft, Row::XAxis},         // Left
    {Across::PlotRight, Row::XAxis},        // Right
    {Across::PlotCenter, Row::XAxis},       // XAxis
    {Across::BeforePlot, Row::Top},         // YUnit
    {Across::PlotLeft, Row::Top},           // Top
    {Across::PlotCenter, Row::Top},         // TopCenter
    {Across::PlotLeft, Row::BelowXAxis},    // Bottom
    {Across::PlotCenter, Row::BelowXAxis},  // BottomCenter
    {Across::PlotRight, Row::Top},          // Readout
}};

constexpr std::int32_t kGapBeforePlotPx = 4;
constexpr std::int32_t kGapUnderPlotPx = 3;
constexpr std::int32_t kGapAtPanelTopPx = 2;
constexpr std::int32_t kGapBetweenRowsPx = 1;
constexpr std::int32_t kGapBetweenLevelsPx = 6;

// The places of the value and x axes, written in the axis font; the others are written in the corner font.
constexpr std::array kAxisPlaces{LabelPlace::Left, LabelPlace::Right, LabelPlace::XAxis, LabelPlace::YUnit};
constexpr std::array kCornerPlaces{LabelPlace::Top, LabelPlace::TopCenter, LabelPlace::Bottom,
                                   LabelPlace::BottomCenter};

bool inAxisFont(LabelPlace place) { return place <= LabelPlace::YUnit; }

std::int32_t leftOf(const LabelFrame& frame, Across across, std::int32_t widthPx) {
  switch (across) {
    case Across::BeforePlot:
      return frame.plot.left - kGapBeforePlotPx - widthPx;
    case Across::PlotLeft:
      return frame.plot.left;
    case Across::PlotCenter:
      return frame.plot.left + (frame.plot.width() - widthPx) / 2;
    case Across::PlotRight:
      break;
  }
  return frame.plot.right - widthPx;
}

std::int32_t topOf(const LabelFrame& frame, Row row, std::int32_t heightPx, std::int32_t linePx) {
  const std::int32_t below = frame.rowBeforeHeightPx == 0 ? 0 : frame.rowBeforeHeightPx + kGapBetweenRowsPx;
  const std::int32_t xAxisRow = frame.plot.bottom + kGapUnderPlotPx + below;
  switch (row) {
    case Row::Line:
      return linePx - heightPx / 2;
    case Row::Top:
      return frame.panel.top + kGapAtPanelTopPx;
    case Row::XAxis:
      return xAxisRow;
    case Row::BelowXAxis:
      break;
  }
  return frame.xAxisRowHeightPx == 0 ? xAxisRow : xAxisRow + frame.xAxisRowHeightPx + kGapBetweenRowsPx;
}

bool inside(const Rect& inner, const Rect& outer) {
  return inner.left >= outer.left && inner.top >= outer.top && inner.right <= outer.right &&
         inner.bottom <= outer.bottom;
}

}  // namespace

Rect labelCell(const LabelFrame& frame, LabelPlace place, Size extentPx, std::int32_t linePx) {
  const PlaceRule& rule = kRules[static_cast<std::size_t>(place)];
  const std::int32_t left = leftOf(frame, rule.across, extentPx.width);
  const std::int32_t top = topOf(frame, rule.row, extentPx.height, linePx);
  return {left, top, left + extentPx.width, top + extentPx.height};
}

std::int32_t linesPerLabel(std::int32_t plotHeightPx, std::int32_t divisions, std::int32_t heightPx) {
  if (plotHeightPx <= 0 || divisions <= 0) return 1;
  const std::int64_t needed = static_cast<std::int64_t>(heightPx) * divisions;
  return static_cast<std::int32_t>(std::max<std::int64_t>(1, (needed + plotHeightPx - 1) / plotHeightPx));
}

void PlotLabels::text(LabelPlace place, std::string_view text) {
  std::string& stored = texts_[static_cast<std::size_t>(place)];
  if (stored == text) return;
  stored = text;
  stale_ = true;
}

void PlotLabels::valueAxisUnderPlot(bool under) {
  stale_ = stale_ || under != valueAxisUnderPlot_;
  valueAxisUnderPlot_ = under;
}

void PlotLabels::keepRowUnderPlot(std::int32_t heightPx) {
  stale_ = stale_ || heightPx != keptRowHeightPx_;
  keptRowHeightPx_ = heightPx;
}

void PlotLabels::draw(Gdi& gdi, DcHandle dc, const LabelFonts& fonts, const Rect& panel, const Rect& plot) {
  if (stale_ || inputs_ != Inputs{panel, plot, fonts.axis, fonts.corner}) {
    layOut(gdi, dc, fonts, panel, plot);
  }
  const TextStyleScope style(gdi, dc, PlotColors(gdi).text(), BackgroundMode::Transparent);
  const auto firstCorner = std::find_if(placed_.begin(), placed_.end(),
                                        [](const Placed& label) { return !inAxisFont(label.place); });
  const auto write = [&](auto first, auto last, FontHandle font) {
    const SelectedFont selected(gdi, dc, font);
    std::for_each(first, last, [&](const Placed& label) {
      gdi.textOut(dc, {label.cell.left, label.cell.top}, label.text);
    });
  };
  write(placed_.begin(), firstCorner, fonts.axis);
  write(firstCorner, placed_.end(), fonts.corner);
}

std::optional<Rect> PlotLabels::roomFor(LabelPlace place, Size extentPx, std::int32_t linePx) const {
  if (extentPx == Size{}) return std::nullopt;
  const Rect cell = labelCell(frame_, place, extentPx, linePx);
  return isFree(cell) ? std::optional(cell) : std::nullopt;
}

bool PlotLabels::isFree(const Rect& cell) const {
  return inside(cell, frame_.panel) && std::none_of(placed_.begin(), placed_.end(), [&](const Placed& label) {
           return overlap(label.cell, cell);
         });
}

void PlotLabels::layOut(Gdi& gdi, DcHandle dc, const LabelFonts& fonts, const Rect& panel, const Rect& plot) {
  placed_.clear();
  inputs_ = {panel, plot, fonts.axis, fonts.corner};
  frame_ = {panel, plot, 0, keptRowHeightPx_};
  stale_ = false;
  {
    const SelectedFont selected(gdi, dc, fonts.axis);
    valueAxisUnderPlot_ ? layOutYAxisUnderPlot(gdi, dc) : layOutYAxis(gdi, dc);
    layOutXAxisRow(gdi, dc);
    for (const LabelPlace place : kAxisPlaces) {
      if (place != LabelPlace::YUnit || !valueAxisUnderPlot_) placeText(gdi, dc, place);
    }
  }
  const SelectedFont selected(gdi, dc, fonts.corner);
  for (const LabelPlace place : kCornerPlaces) placeText(gdi, dc, place);
}

void PlotLabels::layOutYAxis(Gdi& gdi, DcHandle dc) {
  if (yAxisTexts_.size() < 2) return;
  const auto divisions = static_cast<std::int32_t>(yAxisTexts_.size() - 1);
  const Rect& plot = frame_.plot;
  const std::int32_t lines =
      linesPerLabel(plot.height(), divisions, measure(gdi, dc, yAxisTexts_.front()).height);
  for (std::int32_t i = 0; i <= divisions; i += lines) {
    const std::string& text = yAxisTexts_[static_cast<std::size_t>(i)];
    const std::int32_t line =
        divisionLinePx(static_cast<float>(plot.top), static_cast<float>(plot.height()), i, divisions);
    place(LabelPlace::YAxis, text, measure(gdi, dc, text), line);
  }
}

// A label at an end of the axis is moved into the panel where it would not fit centred.
void PlotLabels::layOutYAxisUnderPlot(Gdi& gdi, DcHandle dc) {
  if (yAxisTexts_.size() < 2) return;
  const auto divisions = static_cast<std::int32_t>(yAxisTexts_.size() - 1);
  const std::string& unit = text(LabelPlace::YUnit);
  topLevel_.assign(yAxisTexts_.front()).append(unit.empty() ? "" : " ").append(unit);
  Size widest{};
  for (const std::string& text : yAxisTexts_) {
    const Size extent = measure(gdi, dc, text);
    widest = {std::max(widest.width, extent.width), std::max(widest.height, extent.height)};
  }
  const Rect& plot = frame_.plot;
  const std::int32_t lines = linesPerLabel(plot.width(), divisions, widest.width + kGapBetweenLevelsPx);
  for (std::int32_t i = 0; i <= divisions; i += lines) {
    const std::string& text = i == 0 ? topLevel_ : yAxisTexts_[static_cast<std::size_t>(i)];
    const std::int32_t line = divisionLinePx(static_cast<float>(plot.left), static_cast<float>(plot.width()),
                                             divisions - i, divisions);
    placeUnderPlot(text, measure(gdi, dc, text), line);
  }
  frame_.rowBeforeHeightPx = widest.height;
}

void PlotLabels::placeUnderPlot(std::string_view text, Size extentPx, std::int32_t linePx) {
  const std::int32_t lastLeft = frame_.panel.right - extentPx.width;
  const std::int32_t left = std::max(frame_.panel.left, std::min(linePx - extentPx.width / 2, lastLeft));
  const std::int32_t top = frame_.plot.bottom + kGapUnderPlotPx;
  const Rect cell{left, top, left + extentPx.width, top + extentPx.height};
  if (extentPx != Size{} && isFree(cell)) placed_.push_back({cell, text, LabelPlace::YAxis});
}

void PlotLabels::layOutXAxisRow(Gdi& gdi, DcHandle dc) {
  for (const LabelPlace place : {LabelPlace::Left, LabelPlace::Right, LabelPlace::XAxis}) {
    if (text(place).empty()) continue;
    frame_.xAxisRowHeightPx = std::max(frame_.xAxisRowHeightPx, measure(gdi, dc, text(place)).height);
  }
}

void PlotLabels::placeText(Gdi& gdi, DcHandle dc, LabelPlace place) {
  if (!text(place).empty()) this->place(place, text(place), measure(gdi, dc, text(place)));
}

void PlotLabels::place(LabelPlace place, std::string_view text, Size extentPx, std::int32_t linePx) {
  if (const auto cell = roomFor(place, extentPx, linePx)) placed_.push_back({*cell, text, place});
}

// A text that could not be measured is left out now and tried again with the next drawing.
Size PlotLabels::measure(Gdi& gdi, DcHandle dc, std::string_view text) {
  const Size extent = gdi.textExtent(dc, text);
  if (extent == Size{} && !text.empty()) stale_ = true;
  return extent;
}

}  // namespace frontpanels

// What the painters share: a panel on the off-screen surface with a plot in it, the plot's value axis, grid
// and labels, the clip round the panel, and the markers that the trace manager works with.
//
// Every routine reports its own failure and returns, leaving what it had. Pixels are those of the off-screen
// surface, rectangles are half-open.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "entry/numeric_entry.h"
#include "painters/axis.h"
#include "painters/grid.h"
#include "painters/plot_labels.h"
#include "painters/property.h"
#include "platform/gdi.h"
#include "traces/trace_object.h"

namespace frontpanels {

class PlotPainter : public TraceObject {
 public:
  static constexpr std::int32_t kMaxDivisions = 1000;

  // `gdi` must outlive the painter.
  explicit PlotPainter(Gdi& gdi);
  ~PlotPainter() override;
  PlotPainter(const PlotPainter&) = delete;
  PlotPainter& operator=(const PlotPainter&) = delete;

  // --- What it is
  [[nodiscard]] std::int16_t resultType() const override { return resultType_; }
  void resultType(std::int16_t type) override { resultType_ = type; }
  // A number of its own for each painter, until it is given another.
  [[nodiscard]] std::int32_t id() const override { return id_; }
  void id(std::int32_t id) { id_ = id; }
  [[nodiscard]] bool traceIsVisible() const override { return traceIsVisible_; }
  void traceIsVisible(bool visible) { traceIsVisible_ = visible; }

  [[nodiscard]] bool dataChanged() const override { return dataChanged_; }
  void dataChanged(bool changed) { dataChanged_ = changed; }

  // --- Value axis. With auto scale off it runs from gridScaleTop, the level at its top, down by
  // `verticalResolution` a division; a top that was never set is null and counts as 0. verticalResolution and
  // dB per division are one value. Levels that are not finite and divisions that are not above 0 are refused.
  [[nodiscard]] std::optional<double> gridScaleTop() const override { return top_; }
  void gridScaleTop(double level) override;
  [[nodiscard]] double verticalResolution() const override { return perDivision_; }
  void verticalResolution(double perDivision) override;
  [[nodiscard]] double getDbPerDivision() const { return perDivision_; }
  void setDbPerDivision(double perDivision) { verticalResolution(perDivision); }
  [[nodiscard]] std::int32_t numberOfVerticalDivisions() const { return numberOfVerticalDivisions_; }
  void numberOfVerticalDivisions(std::int32_t divisions);  // up to 1000; no line for 0 or less
  [[nodiscard]] bool getAutoScale() const override { return autoScale_; }
  void setAutoScale(bool on) override { autoScale_ = on; }
  [[nodiscard]] std::int16_t yAxisStyle() const override { return yAxisStyle_; }
  void yAxisStyle(std::int16_t style) override { yAxisStyle_ = style; }
  [[nodiscard]] clsNumericEntry& yAxisFormatter();
  [[nodiscard]] const clsNumericEntry& yAxisFormatter() const { return yAxisFormatter_; }
  // Whether the value axis has the decimals that its divisions call for, whatever the formatter's.
  [[nodiscard]] bool autoFormatY() const { return autoFormatY_; }
  void autoFormatY(bool on);
  void updateYAxisLabels();

  // --- Labels: see LabelPlace for where they go.
  [[nodiscard]] const std::string& leftLabel() const { return labels_.text(LabelPlace::Left); }
  void leftLabel(std::string_view text) { labels_.text(LabelPlace::Left, text); }
  [[nodiscard]] const std::string& rightLabel() const { return labels_.text(LabelPlace::Right); }
  void rightLabel(std::string_view text) { labels_.text(LabelPlace::Right, text); }
  [[nodiscard]] const std::string& xAxisLabel() const { return labels_.text(LabelPlace::XAxis); }
  void xAxisLabel(std::string_view text) { labels_.text(LabelPlace::XAxis, text); }
  [[nodiscard]] const std::string& yAxisLabel() const { return labels_.text(LabelPlace::YUnit); }
  void yAxisLabel(std::string_view text) { labels_.text(LabelPlace::YUnit, text); }
  [[nodiscard]] const std::string& topLabel() const { return labels_.text(LabelPlace::Top); }
  void topLabel(std::string_view text) { labels_.text(LabelPlace::Top, text); }
  [[nodiscard]] const std::string& topCenterLabel() const { return labels_.text(LabelPlace::TopCenter); }
  void topCenterLabel(std::string_view text) { labels_.text(LabelPlace::TopCenter, text); }
  [[nodiscard]] const std::string& bottomLabel() const { return labels_.text(LabelPlace::Bottom); }
  void bottomLabel(std::string_view text) { labels_.text(LabelPlace::Bottom, text); }
  [[nodiscard]] const std::string& bottomCenterLabel() const {
    return labels_.text(LabelPlace::BottomCenter);
  }
  void bottomCenterLabel(std::string_view text) { labels_.text(LabelPlace::BottomCenter, text); }
  // Of the value axis, the topmost level's first.
  [[nodiscard]] const std::vector<std::string>& yAxisLabels() const {
    return std::as_const(labels_).yAxisTexts();
  }

  // What it is called where it is read aloud; the top label while this is empty.
  Property<std::string> spokenName;

  // --- Plot insets: pixels between the panel's rectangle and the plot. gridScaleTop is the level at the top
  // of the axis, so the top inset has a name of its own.
  [[nodiscard]] float gridScaleLeft() const { return insets_.left; }
  void gridScaleLeft(float px) { insets_.left = px; }
  [[nodiscard]] float gridScaleRight() const { return insets_.right; }
  void gridScaleRight(float px) { insets_.right = px; }
  [[nodiscard]] float gridScaleBottom() const { return insets_.bottom; }
  void gridScaleBottom(float px) { insets_.bottom = px; }
  [[nodiscard]] float gridInsetTop() const { return insets_.top; }
  void gridInsetTop(float px) { insets_.top = px; }

  // --- Grid
  [[nodiscard]] Color getGridDrawColor() const { return gridPen_.color; }
  void setGridDrawColor(Color color) { gridPen_.color = color; }
  [[nodiscard]] PenStyle getGridLineDrawingStyle() const { return gridPen_.style; }
  void setGridLineDrawingStyle(PenStyle style) { gridPen_.style = style; }
  // Written to the surface's ViewDrawStyle before the grid is drawn, once it has been set.
  [[nodiscard]] std::optional<PenStyle> getGridDrawStyle() const { return gridDrawStyle_; }
  void setGridDrawStyle(PenStyle style) { gridDrawStyle_ = style; }

  // --- Place and clip
  [[nodiscard]] DrawingSurface* drawingArea() const { return surface_; }
  void drawingArea(DrawingSurface* surface) override { surface_ = surface; }
  [[nodiscard]] float scaleLeft() const override { return panel_.left; }
  void scaleLeft(float px) override { panel_.left = px; }
  [[nodiscard]] float scaleTop() const override { return panel_.top; }
  void scaleTop(float px) override { panel_.top = px; }
  [[nodiscard]] float scaleWidth() const override { return panel_.width; }
  void scaleWidth(float px) override { panel_.width = px; }
  [[nodiscard]] float scaleHeight() const override { return panel_.height; }
  void scaleHeight(float px) override { panel_.height = px; }
  void createClippingRegion(float areaLeft, float areaTop, float areaRight, float areaBottom,
                            DcHandle dc) override;
  void destroyClippingRegion(DcHandle dc) override;
  // Fills the panel with the background.
  void clearArea(DcHandle dc);
  // As last painted.
  [[nodiscard]] Color activeTraceColor() const override { return activeTraceColor_; }
  void activeTraceColor(Color color) { activeTraceColor_ = color; }

  // --- Markers
  [[nodiscard]] MarkerPointer activeMarker() const override { return activeMarker_; }
  void activeMarker(MarkerPointer marker) override;  // the one before stops being active
  [[nodiscard]] MarkerPointer mouseActiveMarker() const override { return mouseActiveMarker_; }
  void mouseActiveMarker(MarkerPointer marker) override { mouseActiveMarker_ = std::move(marker); }
  [[nodiscard]] std::int16_t markerCount() const override { return markerCount_; }
  void markerCount(std::int16_t count) override { markerCount_ = count; }

 protected:
  // "clsSomePainter::routine() ...": the message of a guard in this painter's name.
  [[nodiscard]] auto named(std::string_view routine) const {
    return [this, routine] { return std::string(typeName()).append(routine); };
  }
  // Raises "Invalid procedure call or argument" for more than the most there may be.
  static void requireDivisions(std::int32_t divisions);

  [[nodiscard]] Gdi& gdi() const noexcept { return gdi_; }
  // Raises "Object variable or With block variable not set" when there is no surface.
  [[nodiscard]] PlotRect surfaceRect() const;
  [[nodiscard]] DcHandle surfaceDc() const;
  // The levels between which the settings put the axis.
  [[nodiscard]] ValueRange axis() const;
  // Puts the axis where auto scale wants it for the data. Answers whether it has moved.
  bool fitAxis(const ValueRange& data);
  // The levels and divisions that are painted and labelled.
  [[nodiscard]] const ValueRange& range() const noexcept { return range_; }
  void range(const ValueRange& range) noexcept { range_ = range; }
  // Divisions of the painted axis.
  [[nodiscard]] virtual std::int32_t shownDivisions() const { return numberOfVerticalDivisions_; }
  // The value axis's labels are out of date.
  void forgetYAxisLabels() noexcept { labelledRange_.reset(); }
  // The painter itself, with all its panel.
  [[nodiscard]] GraphItem chartItem(std::string name, std::string value) const;
  void fillWithBackground(DcHandle dc, const PlotRect& area);
  void drawGridOver(DcHandle dc, const PlotRect& plot, const GridDivisions& divisions);
  void drawLabels(DcHandle dc, const LabelFonts& fonts);

  [[nodiscard]] const PlotRect& panelRect() const noexcept { return panel_; }
  [[nodiscard]] PlotRect plotRect() const noexcept { return panel_.shrunk(insets_); }
  [[nodiscard]] PlotLabels& labels() noexcept { return labels_; }
  // The clip round the panel, null outside a paint.
  [[nodiscard]] RegionHandle panelClip() const noexcept { return clip_; }
  [[nodiscard]] const PlotInsets& insets() const noexcept { return insets_; }

 private:
  void measureAxis() noexcept;

  Gdi& gdi_;
  DrawingSurface* surface_ = nullptr;
  std::int16_t resultType_ = 0;
  std::int32_t id_;
  bool traceIsVisible_ = true;
  bool dataChanged_ = false;

  std::optional<double> top_;
  double perDivision_ = 10;
  double axisLength_ = 100;
  std::int32_t numberOfVerticalDivisions_ = 10;
  bool autoScale_ = false;
  bool autoFormatY_ = false;
  std::int16_t yAxisStyle_ = 0;
  clsNumericEntry yAxisFormatter_;
  ValueRange range_{-100, 0};
  std::optional<ValueRange> labelledRange_;  // empty when the value axis's labels must be written again

  PlotLabels labels_;
  PlotRect panel_;
  PlotInsets insets_{48, 24, 12, 20};
  GridPen gridPen_;
  std::optional<PenStyle> gridDrawStyle_;
  std::vector<GridLine> gridLines_;  // storage of drawGridOver
  RegionHandle clip_{};
  Color activeTraceColor_;

  MarkerPointer activeMarker_;
  MarkerPointer mouseActiveMarker_;
  std::int16_t markerCount_ = 0;
};

}  // namespace frontpanels

// A trace object whose points a test names, and which tells in one shared list what was asked of it.
#pragma once

#include <cmath>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "framework/support/numeric.h"
#include "platform/runtime_error.h"
#include "platform/variant.h"
#include "traces/trace_layout.h"
#include "traces/trace_object.h"

namespace frontpanels::testing {

class FakeTraceObject : public TraceObject {
 public:
  explicit FakeTraceObject(std::string className, std::vector<std::string>* log = nullptr)
      : className_(std::move(className)), log_(log), collections_(2) {}

  // Pixel points of each sub-trace; a new one has a single sub-trace without points.
  std::vector<std::vector<Point>> subTraces{{}};
  bool visible = true;
  bool changed = true;
  bool failsToPaint = false;
  Color color = rgb(1, 2, 3);
  PanelArea panel;
  LabelFonts labelFonts;
  PanelArea clipped;
  std::int16_t count = 0;
  std::int16_t selected = 0;

  std::string_view typeName() const override { return className_; }
  std::int16_t resultType() const override { return resultType_; }
  void resultType(std::int16_t type) override { resultType_ = type; }
  std::int32_t id() const override { return resultType_; }
  bool traceIsVisible() const override { return visible; }
  void drawingArea(DrawingSurface*) override { log("drawingArea"); }
  bool dataChanged() const override { return changed; }
  void processData() override { log("processData"); }
  float scaleLeft() const override { return panel.left; }
  void scaleLeft(float px) override { panel.left = px; }
  float scaleTop() const override { return panel.top; }
  void scaleTop(float px) override { panel.top = px; }
  float scaleWidth() const override { return panel.width; }
  void scaleWidth(float px) override { panel.width = px; }
  float scaleHeight() const override { return panel.height; }
  void scaleHeight(float px) override { panel.height = px; }
  void createClippingRegion(float left, float top, float right, float bottom, DcHandle) override {
    clipped = {left, top, right - left, bottom - top};
    log("clip");
  }
  void Paint(DcHandle) override {
    log("Paint");
    if (failsToPaint) raiseOverflow();
  }
  void drawMarkers(DcHandle) override { log("drawMarkers"); }
  void destroyClippingRegion(DcHandle) override { log("unclip"); }
  void Label(DcHandle, const LabelFonts& fonts) override {
    labelFonts = fonts;
    log("Label");
  }
  void updateMarkerDisplay(DcHandle, const LabelFonts&) override { log("updateMarkerDisplay"); }
  Color activeTraceColor() const override { return color; }
  std::int16_t xAxisStyle() const override { return 1; }
  std::int16_t yAxisStyle() const override { return 0; }
  double verticalResolution() const override { return 10; }
  std::optional<double> gridScaleTop() const override { return std::nullopt; }
  bool getAutoScale() const override { return false; }
  void xAxisStyle(std::int16_t style) override { log("xAxisStyle " + std::to_string(style)); }
  void yAxisStyle(std::int16_t style) override { log("yAxisStyle " + std::to_string(style)); }
  void verticalResolution(double value) override { log("verticalResolution " + numberToText(value)); }
  void gridScaleTop(double level) override { log("gridScaleTop " + numberToText(level)); }
  void setAutoScale(bool on) override { log(on ? "setAutoScale on" : "setAutoScale off"); }
  std::int16_t addATrace(std::int16_t, std::int16_t, double, std::int32_t,
                         std::optional<std::int16_t>) override {
    return -1;
  }
  std::int16_t findATraceByPN(std::int16_t) const override { return -1; }
  std::int16_t pnOffset(std::int16_t) const override { return 0; }
  std::int16_t numberOfTraces() const override { return static_cast<std::int16_t>(subTraces.size()); }
  std::int16_t selectedTraceIndex() const override { return selected; }
  void selectedTraceIndex(std::int16_t index) override { selected = index; }
  std::int32_t traceSize() const override { return static_cast<std::int32_t>(subTraces[0].size()) - 1; }
  bool multiMarker() const override { return false; }
  MarkerCollection& markerCollection() override { return traceMarkerCollections(selected); }
  MarkerCollection& traceMarkerCollections(std::int16_t index) override {
    return collections_.at(static_cast<std::size_t>(index));
  }
  MarkerPointer activeMarker() const override { return active_; }
  void activeMarker(MarkerPointer marker) override {
    if (active_ && active_ != marker) active_->active = false;
    active_ = std::move(marker);
  }
  MarkerPointer mouseActiveMarker() const override { return mouseActive_; }
  void mouseActiveMarker(MarkerPointer marker) override { mouseActive_ = std::move(marker); }
  std::int16_t markerCount() const override { return count; }
  void markerCount(std::int16_t value) override { count = value; }
  // The nearest point by summed distance, the lower index at a tie.
  void findNearestPoint(float x, float y, clsMarker& marker,
                        std::optional<std::int16_t> traceIndex) override {
    lastSought = {toInt32(x), toInt32(y)};
    double best = 10000;
    const std::vector<Point>& points = subTraces[static_cast<std::size_t>(traceIndex.value_or(selected))];
    for (std::size_t i = 0; i < points.size(); ++i) {
      const double distance =
          std::abs(points[i].x - static_cast<double>(x)) + std::abs(points[i].y - static_cast<double>(y));
      if (distance >= best) continue;
      best = distance;
      marker.positionX = points[i].x;
      marker.positionY = points[i].y;
      marker.point = static_cast<std::int32_t>(i);
    }
  }
  void addMarkerToTrace(MarkerPointer marker, std::int16_t traceId) override {
    traceMarkerCollections(traceId).add(marker, marker->id);
  }
  void markerToMax() override { log("markerToMax"); }
  void markerToMin() override { log("markerToMin"); }
  void KeyPress(std::int16_t key) override { log("KeyPress " + std::to_string(key)); }

  Point lastSought;

 private:
  void log(const std::string& what) {
    if (log_ != nullptr) log_->push_back(std::to_string(resultType_) + " " + what);
  }

  std::string className_;
  std::vector<std::string>* log_;
  std::vector<MarkerCollection> collections_;
  std::int16_t resultType_ = 0;
  MarkerPointer active_;
  MarkerPointer mouseActive_;
};

}  // namespace frontpanels::testing

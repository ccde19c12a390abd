// The trace-object contract: the members that the trace manager calls on whatever holds and draws the data of
// one result type. Rectangles are in pixels of the off-screen surface, single precision.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string_view>

#include "framework/support/collection.h"
#include "framework/support/drawing_surface.h"
#include "traces/graph_items.h"
#include "traces/marker.h"

namespace frontpanels {

using MarkerPointer = std::shared_ptr<clsMarker>;
using MarkerCollection = Collection<MarkerPointer>;

// The fonts of one panel's labels and the largest cell of a label's digit, in pixels.
struct LabelFonts {
  FontHandle axis{};
  FontHandle corner{};
  float cellWidthPx = 0;
  float cellHeightPx = 0;
};

class TraceObject {
 public:
  virtual ~TraceObject() = default;

  // The class name, which the trace manager compares as text.
  [[nodiscard]] virtual std::string_view typeName() const = 0;
  [[nodiscard]] virtual std::int16_t resultType() const = 0;
  virtual void resultType(std::int16_t type) = 0;
  [[nodiscard]] virtual std::int32_t id() const = 0;
  [[nodiscard]] virtual bool traceIsVisible() const = 0;

  // Painting, in the order in which the trace manager calls it. `dc` is the off-screen surface.
  virtual void drawingArea(DrawingSurface* surface) = 0;
  [[nodiscard]] virtual bool dataChanged() const = 0;
  virtual void processData() = 0;
  [[nodiscard]] virtual float scaleLeft() const = 0;
  virtual void scaleLeft(float px) = 0;
  [[nodiscard]] virtual float scaleTop() const = 0;
  virtual void scaleTop(float px) = 0;
  [[nodiscard]] virtual float scaleWidth() const = 0;
  virtual void scaleWidth(float px) = 0;
  [[nodiscard]] virtual float scaleHeight() const = 0;
  virtual void scaleHeight(float px) = 0;
  virtual void createClippingRegion(float areaLeft, float areaTop, float areaRight, float areaBottom,
                                    DcHandle dc) = 0;
  virtual void Paint(DcHandle dc) = 0;
  virtual void drawMarkers(DcHandle dc) = 0;
  virtual void destroyClippingRegion(DcHandle dc) = 0;  // raises nothing
  virtual void Label(DcHandle dc, const LabelFonts& fonts) = 0;
  virtual void updateMarkerDisplay(DcHandle dc, const LabelFonts& fonts) = 0;
  [[nodiscard]] virtual Color activeTraceColor() const = 0;

  // Axis settings that a host sends by code; both kinds of painter have them.
  [[nodiscard]] virtual std::int16_t xAxisStyle() const = 0;
  virtual void xAxisStyle(std::int16_t style) = 0;
  [[nodiscard]] virtual std::int16_t yAxisStyle() const = 0;
  virtual void yAxisStyle(std::int16_t style) = 0;
  // dB (or units of the value axis) per division, and the level at the top of the axis, null until it is set.
  [[nodiscard]] virtual double verticalResolution() const = 0;
  virtual void verticalResolution(double perDivision) = 0;
  [[nodiscard]] virtual std::optional<double> gridScaleTop() const = 0;
  virtual void gridScaleTop(double level) = 0;
  [[nodiscard]] virtual bool getAutoScale() const = 0;
  virtual void setAutoScale(bool on) = 0;

  // Sub-traces, each of a PN offset. Adding answers the index of the one that took the PN, -1 when none did;
  // so does looking one up.
  virtual std::int16_t addATrace(std::int16_t mode, std::int16_t pn, double value, std::int32_t size,
                                 std::optional<std::int16_t> traceId) = 0;
  [[nodiscard]] virtual std::int16_t findATraceByPN(std::int16_t pn) const = 0;
  [[nodiscard]] virtual std::int16_t pnOffset(std::int16_t index) const = 0;
  // The selected one receives marker and key operations.
  [[nodiscard]] virtual std::int16_t numberOfTraces() const = 0;
  [[nodiscard]] virtual std::int16_t selectedTraceIndex() const = 0;
  virtual void selectedTraceIndex(std::int16_t index) = 0;
  // Highest point index of the selected sub-trace.
  [[nodiscard]] virtual std::int32_t traceSize() const = 0;
  // Whether one marker spans all sub-traces.
  [[nodiscard]] virtual bool multiMarker() const = 0;

  // Markers. The first item of a collection is the most recently chosen marker. A trace object without
  // sub-traces answers an empty collection.
  [[nodiscard]] virtual MarkerCollection& markerCollection() = 0;
  // Raises "Subscript out of range" for a sub-trace that does not exist.
  [[nodiscard]] virtual MarkerCollection& traceMarkerCollections(std::int16_t traceIndex) = 0;
  [[nodiscard]] virtual MarkerPointer activeMarker() const = 0;
  virtual void activeMarker(MarkerPointer marker) = 0;  // the one before stops being `active`
  [[nodiscard]] virtual MarkerPointer mouseActiveMarker() const = 0;
  virtual void mouseActiveMarker(MarkerPointer marker) = 0;
  [[nodiscard]] virtual std::int16_t markerCount() const = 0;
  virtual void markerCount(std::int16_t count) = 0;
  // Puts the marker on the point nearest to a pixel; without an index on the selected sub-trace.
  virtual void findNearestPoint(float x, float y, clsMarker& marker,
                                std::optional<std::int16_t> traceIndex = std::nullopt) = 0;
  virtual void addMarkerToTrace(MarkerPointer marker, std::int16_t traceId) = 0;
  virtual void markerToMax() = 0;
  virtual void markerToMin() = 0;
  virtual void KeyPress(std::int16_t key) = 0;

  // In words, as last painted: adds itself and then what it shows. `itemCount` is how many that are. What has
  // no words adds nothing.
  virtual void describe(GraphItems& /*items*/) {}
  [[nodiscard]] virtual std::size_t itemCount() const { return 0; }
};

}  // namespace frontpanels

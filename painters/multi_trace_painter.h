// clsMultiTracePainter: the x-y graph of one result type. It holds up to `maxTraces` traces, turns their
// values into pixel points, draws them with grid, labels and markers, and keeps the markers of each trace.
//
// Every routine reports its own failure and returns, leaving what it had; what a caller may see raised is
// said where it is so. Pixels are those of the off-screen surface, rectangles are half-open.
#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "entry/numeric_entry.h"
#include "painters/marker_readout.h"
#include "painters/marker_steps.h"
#include "painters/plot_painter.h"
#include "painters/trace_store.h"
#include "platform/gdi.h"
#include "traces/trace_object.h"

namespace frontpanels {

class clsMultiTracePainter : public PlotPainter {
 public:
  static constexpr std::string_view kTypeName = "clsMultiTracePainter";

  // `gdi` must outlive the painter.
  explicit clsMultiTracePainter(Gdi& gdi);

  [[nodiscard]] std::string_view typeName() const override { return kTypeName; }

  // --- Adding and removing traces; the values of a trace follow by trace().
  // Refills the slots of the trace id, else the slot of the PN, else appends a trace or, when there are
  // `maxTraces`, takes over the least recently used. PN 106, 107 and 111 are looked up as 106 in mode 0 and
  // 107 in mode 1, PN 25 and 214 as 25 and 214. Answers the slot's index, -1 when nothing was stored.
  std::int16_t addATrace(std::int16_t mode, std::int16_t pn, double value, std::int32_t size,
                         std::optional<std::int16_t> traceId = std::nullopt) override;
  // Each answers the slot's index, -1 after a failure.
  std::int16_t addNewTraceAtEnd(std::int16_t pn, double value, std::int32_t size,
                                std::optional<std::int16_t> traceId = std::nullopt);
  std::int16_t addNewTraceAtIndex(std::int16_t index, std::int16_t pn, double value, std::int32_t size,
                                  std::optional<std::int16_t> traceId = std::nullopt);
  std::int16_t addNewTraceAtExistingPN(std::int16_t pn, double value, std::int32_t size,
                                       std::optional<std::int16_t> traceId = std::nullopt);
  // The index of the last trace that has the PN, -1 when none has.
  [[nodiscard]] std::int16_t findATrace(std::int16_t pn) const;
  [[nodiscard]] std::int16_t findATraceByPN(std::int16_t pn) const override { return findATrace(pn); }
  // The index of the trace that owns the marker, -1 when none does.
  [[nodiscard]] std::int16_t findTraceByMarker(const MarkerPointer& marker) const;
  void removeATrace(std::int16_t traceId);
  // Forgets the values of every trace, so that none is drawn; traces and markers stay.
  void clearTrace();

  // --- Values of a trace: an array, null or empty; of the selected trace (the first when there is none yet)
  // or of the one with the index. New values set `dataChanged`. Arrays of singles and doubles are the fast
  // ones, and storage is used again for values of the same kind.
  void trace(const Variant& values);
  void trace(std::span<const float> values);
  void trace(std::int16_t index, const Variant& values);
  [[nodiscard]] const Variant& trace() const { return selectedSlot().data; }
  // Highest point index. A trace never reads past its values: the points that exist are drawn, at most 3001.
  [[nodiscard]] std::int32_t traceSize() const override { return selectedSlot().size; }
  void traceSize(std::int32_t size);
  // What addATrace was given.
  [[nodiscard]] double traceValue(std::int16_t index) const;
  [[nodiscard]] std::int16_t pnOffset(std::int16_t index) const override;
  void pnOffset(std::int16_t index, std::int16_t pn);
  // The id by which a trace is named, whatever its index. Raises "Subscript out of range".
  [[nodiscard]] std::int16_t traceId(std::int16_t index) const { return traces_.slot(index).traceId; }
  [[nodiscard]] TraceOrientation traceOrientation(std::int16_t index) const;
  void traceOrientation(std::int16_t index, TraceOrientation orientation);
  // Trace ids, the least recently used first; the same ids may be given another order.
  [[nodiscard]] const std::vector<std::int16_t>& leastRecentlyUsed() const { return traces_.usageOrder(); }
  void leastRecentlyUsed(std::vector<std::int16_t> order);
  // Points of the last paint, for whoever lays something over the graph. Raises "Subscript out of range".
  [[nodiscard]] const TracePoints& points(std::int16_t index) const { return traces_.slot(index).points; }

  [[nodiscard]] std::int16_t numberOfTraces() const override { return traces_.count(); }
  void numberOfTraces(std::int16_t count);
  [[nodiscard]] std::int16_t selectedTraceIndex() const override { return selectedTraceIndex_; }
  void selectedTraceIndex(std::int16_t index) override;
  // Another name of selectedTraceIndex.
  [[nodiscard]] std::int16_t activeTrace() const { return selectedTraceIndex_; }
  void activeTrace(std::int16_t index) { selectedTraceIndex(index); }
  [[nodiscard]] bool multiMarker() const override { return multiMarker_; }
  void multiMarker(bool multi) { multiMarker_ = multi; }

  // Added to every value once by processData when `useOffset` is set.
  Property<Variant> offset;
  Property<bool> useOffset;

  // Largest value of the selected trace and its point; 0 when it has none. What is written holds until the
  // trace's values or size change.
  [[nodiscard]] double activeTraceMaximumValue();
  void activeTraceMaximumValue(double value);
  [[nodiscard]] double activeTraceMaximumIndex();
  void activeTraceMaximumIndex(double index);

  // --- Value axis
  // The axis runs from the smallest to the largest value of the traces instead.
  Property<bool> calcMinMax;
  // Fits the axis to the traces when they no longer fill it well. Runs by itself in each paint while auto
  // scale is on.
  void DoAutoScale();

  // --- X axis. Start and stop are in Hz (or whatever the traces run over): those of the first and the last
  // point. Setting the span keeps the centre. `numberOfMeasurements` is the number of points, which gives the
  // drawing step.
  [[nodiscard]] double xStart() const { return xStart_; }
  void xStart(double start);
  [[nodiscard]] double xStop() const { return xStop_; }
  void xStop(double stop);
  [[nodiscard]] double span() const { return xStop_ - xStart_; }
  void span(double span);
  Property<std::int32_t> numberOfMeasurements;
  // What lies between two points, for markers and labels. 0: the points share the span. Otherwise the labels
  // go by the points: the last but one lies on the plot's right edge.
  Property<double> xPerPoint;
  [[nodiscard]] std::int32_t numberOfHorizontalDivisions() const { return numberOfHorizontalDivisions_; }
  void numberOfHorizontalDivisions(std::int32_t divisions);  // as for the value axis
  // 0 no labels; 1 start, stop and width of a division; 2 centre and width of a division; 3 centre. Another
  // style keeps the labels as they are.
  [[nodiscard]] std::int16_t xAxisStyle() const override { return xAxisStyle_; }
  void xAxisStyle(std::int16_t style) override;
  [[nodiscard]] clsNumericEntry& xAxisFormatter();
  void updateXAxisLabels();

  // Number formats of marker read-outs. With autoFormatX a read-out's x is no finer than the points lie
  // apart, whatever the format.
  Property<std::string> xMarkerFormatString{"0.######"};
  Property<std::string> yMarkerFormatString{"0.##"};
  Property<bool> autoFormatX;

  // --- Grid
  // In multi-band mode the grid has a line at each boundary of `numberOfBands` bands of equal width.
  Property<bool> multiBand;
  Property<std::int16_t> numberOfBands;

  // --- Painting, in the order in which the trace manager calls it
  void processData() override;
  void Paint(DcHandle dc) override;
  // Directly on the surface of drawingArea, over its whole scale.
  void Paint();
  void drawMarkers(DcHandle dc) override;
  void Label(DcHandle dc, const LabelFonts& fonts) override;
  // Refreshes the stored values of all markers and writes what the active marker reads into the top row.
  // Where there is not room for all of it, the delta is left out, then the x value, then the rest.
  void updateMarkerDisplay(DcHandle dc, const LabelFonts& fonts) override;
  // What every marker reads, trace by trace.
  [[nodiscard]] std::vector<MarkerReading> markerReadings();

  // --- Markers
  [[nodiscard]] MarkerCollection& markerCollection() override {
    return traces_.slot(selectedTraceIndex_).markers;
  }
  void markerCollection(MarkerCollection markers) { markerCollection() = std::move(markers); }
  [[nodiscard]] MarkerCollection& traceMarkerCollection() { return markerCollection(); }
  void traceMarkerCollection(MarkerCollection markers) { markerCollection(std::move(markers)); }
  // Reported, and raises "Subscript out of range", for a trace that does not exist.
  [[nodiscard]] MarkerCollection& traceMarkerCollections(std::int16_t traceIndex) override;
  void traceMarkerCollections(std::int16_t traceIndex, MarkerCollection markers);
  void findNearestPoint(float x, float y, clsMarker& marker,
                        std::optional<std::int16_t> traceIndex = std::nullopt) override;
  // Null when no trace has a marker with the id.
  [[nodiscard]] MarkerPointer findMarker(std::string_view markerId);
  // The other marker of a pair of normal and delta marker; null when the marker has none.
  [[nodiscard]] MarkerPointer partnerOf(const clsMarker& marker);
  void addMarkerToTrace(MarkerPointer marker, std::int16_t traceId) override;
  // Removes the active marker, with its delta marker; the most recently chosen one left becomes active.
  void deleteActiveMarker();
  // Puts the active marker where its point is.
  void updateActiveMarker();
  void updateMarkerValueX();
  // After the x axis has moved: puts every marker back on the point of its stored x value.
  void ResetMarkers();
  void markerToMax() override;
  void markerToMin() override;
  // Along the values of its trace. Nothing without an active marker.
  void activeMarkerToEnd(TraceEnd end);
  void moveActiveMarkerATenth(Towards side);
  void activeMarkerToPeak(PeakOrder order);
  // 39 (right arrow) moves the active marker one point right, every other key one point left. The range is
  // not checked here.
  void KeyPress(std::int16_t key) override;

  // --- In words: the painter, then each trace with its markers in the order of their numbers. A marker reads
  // what the read-out would show of it.
  void describe(GraphItems& items) override;
  [[nodiscard]] std::size_t itemCount() const override;

  // --- Kept and given back: the interface that both painters share
  Property<std::int16_t> maxTraces{5};
  Property<std::int16_t> maxPNs{40};
  Property<std::int16_t> otherIs;
  Property<double> threshold;
  Property<bool> sortFlag;
  Property<std::int16_t> traceType;
  Property<std::int16_t> barSortByMode;
  Property<std::int16_t> barSortOrder;
  Property<double> bandSpan;
  Property<double> bandStartChannel;
  Property<double> bandStopChannel;
  [[nodiscard]] bool getDrawBorders() const { return drawBorders_(); }
  void setDrawBorders(bool draw) { drawBorders_(draw); }
  [[nodiscard]] std::int16_t getBarLabeling() const { return barLabeling_(); }
  void setBarLabeling(std::int16_t labeling) { barLabeling_(labeling); }
  [[nodiscard]] std::int16_t getNumBkts() const { return numBkts_(); }
  void setNumBkts(std::int16_t buckets) { numBkts_(buckets); }
  [[nodiscard]] double getIncrement() const { return increment_(); }
  void setIncrement(double increment) { increment_(increment); }

 private:
  [[nodiscard]] const TraceSlot& selectedSlot() const { return traces_.slot(selectedTraceIndex_); }
  std::int16_t refillTraceId(std::int16_t traceId, const TraceFill& fill);
  void forgetWhatIsGone() noexcept;  // after traces were removed: their markers, a selection past the last
  [[nodiscard]] TraceSlot& slotForValues();
  void storeValues(TraceSlot& slot, const Variant& values);
  void valuesChanged(TraceSlot& slot);

  [[nodiscard]] std::optional<ValueRange> dataRange();
  void computeMinMax(TraceSlot& slot);
  [[nodiscard]] const MinMax& currentMinMax(TraceSlot& slot);
  [[nodiscard]] double rightEdgeX() const;
  void writeXLabel(LabelPlace place, double value);
  void writeDivisionLabel(LabelPlace place);

  static Color traceColor(std::size_t index);
  void paintPanel(DcHandle dc, const PlotRect& panel);
  void drawTraces(DcHandle dc, const PlotRect& plot);
  void placePoints(TraceSlot& slot, const PlotRect& plot, const ValueAxis& y);
  void drawTrace(DcHandle dc, const TracePoints& points, GridPen look);
  void forgetPoints() noexcept;
  void chooseRange();

  enum class Readout : std::uint8_t { WithDelta, Full, LevelOnly };
  void markerToExtreme(double MinMax::*index);
  template <class Step>
  void stepActiveMarker(Step step);
  void drawMarkersOf(DcHandle dc, std::size_t trace);
  // False where the marker has no point to stand on: a gap, or beyond the trace.
  bool placeMarker(std::size_t trace, clsMarker& marker);
  [[nodiscard]] double pointSpacing() const;  // in x units; 0 below two points
  [[nodiscard]] static std::int32_t shownPoint(const TraceSlot& slot, const clsMarker& marker) noexcept;
  void refreshValueX(const TraceSlot& slot, clsMarker& marker) const;
  void refreshValues(const TraceSlot& slot, clsMarker& marker) const;
  void writeReadout(DcHandle dc);
  [[nodiscard]] ReadoutFormat readoutFormat() const;
  void composeReadout(Readout readout);

  [[nodiscard]] GraphItem traceItem(std::int16_t trace);
  [[nodiscard]] GraphItem markerItem(std::int16_t trace, clsMarker& marker);
  [[nodiscard]] std::size_t markersOfAll() const noexcept;

  TraceStore traces_;
  std::int16_t selectedTraceIndex_ = 0;
  bool multiMarker_ = false;
  std::vector<double> converted_;  // scratch for arrays of other types

  double xStart_ = 0;
  double xStop_ = 0;
  double xStepPx_ = 0;
  std::int32_t numberOfHorizontalDivisions_ = 10;
  std::int16_t xAxisStyle_ = 1;
  clsNumericEntry xAxisFormatter_;
  bool xLabelsStale_ = false;

  std::string text_;     // scratch of label writing
  std::string readout_;  // scratch of updateMarkerDisplay
  Property<bool> drawBorders_;
  Property<std::int16_t> barLabeling_;
  Property<std::int16_t> numBkts_;
  Property<double> increment_;
};

}  // namespace frontpanels

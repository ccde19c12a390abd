// Markers of the multi-trace painter.
#include <algorithm>
#include <cmath>
#include <cstdlib>

#include "framework/support/guard.h"
#include "framework/support/numeric.h"
#include "painters/marker_readout.h"
#include "painters/multi_trace_painter.h"
#include "platform/gdi_scope.h"
#include "platform/runtime_error.h"
#include "traces/plot_colors.h"

namespace frontpanels {
namespace {

constexpr std::int16_t kRightArrow = 39;
constexpr std::int16_t kFarthestPx = 10000;

// The sum of the two absolute differences, as 16-bit numbers. Raises "Overflow".
std::int16_t distance(const Point& point, float x, float y) {
  return addInt16(toInt16(std::fabs(point.x - static_cast<double>(x))),
                  toInt16(std::fabs(point.y - static_cast<double>(y))));
}

void removeMarker(MarkerCollection& markers, const clsMarker* removed) {
  std::size_t index = 0;
  for (const MarkerPointer& marker : markers) {
    ++index;
    if (marker.get() == removed) {
      markers.remove(index);
      return;
    }
  }
}

MarkerPointer findById(const MarkerCollection& markers, std::string_view id) {
  for (const MarkerPointer& marker : markers) {
    if (marker->id == id) return marker;
  }
  return nullptr;
}

}  // namespace

MarkerCollection& clsMultiTracePainter::traceMarkerCollections(std::int16_t traceIndex) {
  MarkerCollection* markers = nullptr;
  guard("traceMarkerCollections[Property Get]() ...", [&] { markers = &traces_.slot(traceIndex).markers; });
  if (markers == nullptr) raiseSubscriptOutOfRange();
  return *markers;
}

void clsMultiTracePainter::traceMarkerCollections(std::int16_t traceIndex, MarkerCollection markers) {
  guard("traceMarkerCollections[Property Let]() ...",
        [&] { traces_.slot(traceIndex).markers = std::move(markers); });
}

void clsMultiTracePainter::findNearestPoint(float x, float y, clsMarker& marker,
                                            std::optional<std::int16_t> traceIndex) {
  guard("findNearestPoint() ...", [&] {
    const TraceSlot& slot = traces_.slot(traceIndex.value_or(selectedTraceIndex_));
    if (slot.size == 0) return;
    std::int16_t best = kFarthestPx;
    std::int32_t nearest = -1;  // the marker moves once every distance is known: one may overflow
    for (const TracePoints::Stretch& stretch : slot.points.stretches()) {
      std::int32_t index = stretch.first;
      for (const Point& point : slot.points.points(stretch)) {
        const std::int16_t away = distance(point, x, y);
        if (away < best) {
          best = away;
          nearest = index;
        }
        ++index;
      }
    }
    if (nearest == -1) return;
    const Point& at = *slot.points.find(nearest);
    marker.positionX = at.x;
    marker.positionY = at.y;
    marker.point = nearest;
  });
}

MarkerPointer clsMultiTracePainter::findMarker(std::string_view markerId) {
  return guarded("findMarker() failed ...", MarkerPointer(), [&]() -> MarkerPointer {
    for (const TraceSlot& slot : traces_.allSlots()) {
      if (MarkerPointer found = findById(slot.markers, markerId)) return found;
    }
    return nullptr;
  });
}

void clsMultiTracePainter::addMarkerToTrace(MarkerPointer marker, std::int16_t traceId) {
  guard("addMarkerToTrace() failed", [&] {
    if (marker == nullptr) raiseObjectVariableNotSet();
    const std::int16_t index = traces_.findTraceId(traceId);
    traces_.slot(index).markers.add(marker, marker->id);  // raises for -1
    marker->traceId = index;
  });
}

void clsMultiTracePainter::deleteActiveMarker() {
  guard("deleteActiveMarker()...", [this] {
    if (activeMarker() == nullptr) return;
    const MarkerPointer deleted = activeMarker();
    const std::int16_t owner = traces_.findMarker(deleted.get());
    activeMarker(nullptr);
    mouseActiveMarker(nullptr);
    if (owner == -1) return;
    MarkerCollection& markers = traces_.slot(owner).markers;
    removeMarker(markers, deleted.get());
    if (const MarkerPointer partner = findById(markers, deleted->deltaPartner)) {
      partner->deltaPartner.clear();
      if (partner->DELTA) removeMarker(markers, partner.get());  // it has nothing to differ from any more
    }
    if (!markers.empty()) activeMarker(markers.item(std::size_t{1}));
  });
}

void clsMultiTracePainter::KeyPress(std::int16_t key) {
  guard("clsMultiTracePainter::KeyPress()", [&] {
    if (activeMarker() == nullptr) return;
    activeMarker()->point = toInt32(activeMarker()->point + (key == kRightArrow ? 1.0 : -1.0));
  });
}

void clsMultiTracePainter::markerToMax() { markerToExtreme(&MinMax::maximumIndex); }
void clsMultiTracePainter::markerToMin() { markerToExtreme(&MinMax::minimumIndex); }

void clsMultiTracePainter::markerToExtreme(double MinMax::*index) {
  guard("computeMinMax()", [&] {
    const MinMax& found = currentMinMax(traces_.slot(selectedTraceIndex_));
    if (activeMarker() != nullptr && found.found) activeMarker()->point = toInt32(found.*index);
  });
}

// Keys are rare: the values are copied rather than looked at in each type that they may have.
template <class Step>
void clsMultiTracePainter::stepActiveMarker(Step step) {
  guard("stepActiveMarker() ...", [&] {
    if (activeMarker() == nullptr) return;
    const std::int16_t trace = traces_.findMarker(activeMarker().get());
    if (trace == -1) return;
    const TraceSlot& slot = traces_.slot(trace);
    std::vector<double> values(slot.data.isArray() ? slot.valueCount() : 0);
    for (std::size_t i = 0; i < values.size(); ++i) values[i] = slot.valueAt(i);
    activeMarker()->point = step(values, shownPoint(slot, *activeMarker()));
  });
}

void clsMultiTracePainter::activeMarkerToEnd(TraceEnd end) {
  stepActiveMarker([end](const auto& values, std::int32_t from) { return endPoint(values, from, end); });
}

void clsMultiTracePainter::moveActiveMarkerATenth(Towards side) {
  stepActiveMarker(
      [side](const auto& values, std::int32_t from) { return pointATenthOn(values, from, side); });
}

void clsMultiTracePainter::activeMarkerToPeak(PeakOrder order) {
  stepActiveMarker([order](const auto& values, std::int32_t from) { return nextPeak(values, from, order); });
}

// --- Where markers are and what they read

void clsMultiTracePainter::drawMarkers(DcHandle dc) {
  guard("drawMarkers() ...", [&] {
    const TextStyleScope style(gdi(), dc, PlotColors(gdi()).text(), BackgroundMode::Transparent);
    for (std::size_t t = 0; t < traces_.traces().size(); ++t) drawMarkersOf(dc, t);
  });
}

void clsMultiTracePainter::drawMarkersOf(DcHandle dc, std::size_t trace) {
  const TraceSlot& slot = traces_.traces()[trace];
  if (slot.markers.empty()) return;
  const SelectedPen pen(gdi(), dc, PenStyle::Solid, 1, PlotColors(gdi()).line(traceColor(trace)));
  for (const MarkerPointer& marker : slot.markers) {
    if (!placeMarker(trace, *marker)) continue;
    marker->draw(gdi(), dc);
    marker->drawId(gdi(), dc);
  }
}

bool clsMultiTracePainter::placeMarker(std::size_t trace, clsMarker& marker) {
  const auto traces = traces_.traces();
  const std::int32_t point = shownPoint(traces[trace], marker);
  const Point* const at = traces[trace].points.find(point);
  if (at == nullptr) return false;
  marker.positionX = at->x;
  marker.positionY = at->y;
  // A marker with two ends spans to the neighbouring trace, where that has the point.
  const std::size_t other = trace + 1 < traces.size() ? trace + 1 : trace == 0 ? 0 : trace - 1;
  const Point* const second = traces[other].points.find(point);
  marker.positionY2 = second == nullptr ? at->y : second->y;
  return true;
}

double clsMultiTracePainter::pointSpacing() const {
  if (xPerPoint() != 0) return xPerPoint();
  return numberOfMeasurements() > 1 ? (xStop_ - xStart_) / (numberOfMeasurements() - 1.0) : 0;
}

// A trace's size may count points behind the last one that was drawn: live traces count one too many, and
// recordings end in a gap. A marker that has been moved there stays on the last one and reads it.
std::int32_t clsMultiTracePainter::shownPoint(const TraceSlot& slot, const clsMarker& marker) noexcept {
  const std::int32_t last = slot.points.last();
  return last >= 0 && marker.point > last && marker.point <= slot.size ? last : marker.point;
}

void clsMultiTracePainter::refreshValueX(const TraceSlot& slot, clsMarker& marker) const {
  marker.valueX = xStart_ + shownPoint(slot, marker) * pointSpacing();
}

// A marker beyond the trace keeps the level that it read last.
void clsMultiTracePainter::refreshValues(const TraceSlot& slot, clsMarker& marker) const {
  refreshValueX(slot, marker);
  const std::int32_t point = shownPoint(slot, marker);
  if (point >= 0 && static_cast<std::size_t>(point) < slot.valueCount()) {
    marker.valueY = slot.valueAt(static_cast<std::size_t>(point));
  }
}

void clsMultiTracePainter::updateActiveMarker() {
  guard("updateActiveMarker() ...", [this] {
    if (activeMarker() == nullptr) return;
    const std::int16_t trace = traces_.findMarker(activeMarker().get());
    if (trace == -1 || trace >= traces_.count()) return;
    placeMarker(static_cast<std::size_t>(trace), *activeMarker());
    refreshValues(traces_.slot(trace), *activeMarker());
  });
}

void clsMultiTracePainter::updateMarkerValueX() {
  guard("updateMarkerValueX() ...", [this] {
    if (activeMarker() == nullptr) return;
    const std::int16_t trace = traces_.findMarker(activeMarker().get());
    if (trace != -1) refreshValueX(traces_.slot(trace), *activeMarker());
  });
}

void clsMultiTracePainter::ResetMarkers() {
  guard("ResetMarkers() failed...divide-by-zero error", [this] {
    const double spacing = pointSpacing();
    if (spacing == 0) raiseDivisionByZero();
    for (TraceSlot& slot : traces_.traces()) {
      const double last = std::max(0.0, static_cast<double>(slot.valueCount()) - 1);
      for (const MarkerPointer& marker : slot.markers) {
        marker->point = toInt32(std::clamp((marker->valueX - xStart_) / spacing, 0.0, last));
      }
    }
  });
}

void clsMultiTracePainter::updateMarkerDisplay(DcHandle dc, const LabelFonts& fonts) {
  guard("updateMarkerDisplay() ...", [&] {
    for (const TraceSlot& slot : traces_.traces()) {
      for (const MarkerPointer& marker : slot.markers) refreshValues(slot, *marker);
    }
    if (activeMarker() == nullptr) return;
    const SelectedFont font(gdi(), dc, fonts.corner);
    const TextStyleScope style(gdi(), dc, PlotColors(gdi()).text(), BackgroundMode::Transparent);
    writeReadout(dc);
  });
}

// From the fullest text to the shortest: the first one that there is room for.
void clsMultiTracePainter::writeReadout(DcHandle dc) {
  for (const Readout readout : {Readout::WithDelta, Readout::Full, Readout::LevelOnly}) {
    composeReadout(readout);
    const auto cell = labels().roomFor(LabelPlace::Readout, gdi().textExtent(dc, readout_));
    if (cell) {
      gdi().textOut(dc, {cell->left, cell->top}, readout_);
      return;
    }
  }
}

ReadoutFormat clsMultiTracePainter::readoutFormat() const {
  return {xAxisFormatter_, yAxisFormatter(),
          autoFormatX() ? std::string_view() : std::string_view(xMarkerFormatString()), yMarkerFormatString(),
          std::fabs(pointSpacing())};
}

std::vector<MarkerReading> clsMultiTracePainter::markerReadings() {
  std::vector<MarkerReading> readings;
  for (std::int16_t trace = 0; trace < traces_.count(); ++trace) {
    const TraceSlot& slot = traces_.slot(trace);
    for (const MarkerPointer& marker : slot.markers) {
      refreshValues(slot, *marker);
      readings.push_back(markerReading(*marker, readoutFormat()));
    }
  }
  return readings;
}

void clsMultiTracePainter::composeReadout(Readout readout) {
  const clsMarker& marker = *activeMarker();
  const ReadoutFormat format = readoutFormat();
  readout_.clear();
  const MarkerPointer partner = partnerOf(marker);
  if (readout == Readout::LevelOnly) {
    appendLevelReadout(readout_, marker, format);
  } else if (marker.DELTA && partner != nullptr) {
    appendDeltaReadout(readout_, marker, *partner, format);
  } else {
    appendReadout(readout_, marker, format);
    if (readout == Readout::WithDelta && partner != nullptr) {
      readout_ += "   ";
      appendDeltaReadout(readout_, *partner, marker, format);
    }
  }
}

MarkerPointer clsMultiTracePainter::partnerOf(const clsMarker& marker) {
  if (marker.deltaPartner.empty()) return nullptr;
  const std::int16_t trace = traces_.findMarker(&marker);
  return trace == -1 ? nullptr : findById(traces_.slot(trace).markers, marker.deltaPartner);
}

}  // namespace frontpanels

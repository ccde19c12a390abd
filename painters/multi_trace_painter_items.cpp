// The multi-trace painter in words.
#include <algorithm>
#include <charconv>

#include "framework/support/guard.h"
#include "framework/support/numeric.h"
#include "painters/marker_readout.h"
#include "painters/multi_trace_painter.h"

namespace frontpanels {
namespace {

// The number that the marker's id, or that of its partner, begins with.
int numberOf(const clsMarker& marker) {
  int number = 0;
  std::from_chars(marker.id.data(), marker.id.data() + marker.id.size(), number);
  return number;
}

// The collection has the latest choice first; who goes from marker to marker wants an order that stays.
std::vector<MarkerPointer> byNumber(const MarkerCollection& markers) {
  std::vector<MarkerPointer> sorted;
  for (const MarkerPointer& marker : markers) sorted.push_back(marker);
  std::stable_sort(sorted.begin(), sorted.end(), [](const MarkerPointer& a, const MarkerPointer& b) {
    return std::pair(numberOf(*a), a->DELTA) < std::pair(numberOf(*b), b->DELTA);
  });
  return sorted;
}

std::string joined(const MarkerReading& reading) { return reading.x + ", " + reading.y; }

}  // namespace

std::size_t clsMultiTracePainter::markersOfAll() const noexcept {
  std::size_t count = 0;
  for (const TraceSlot& slot : traces_.traces()) count += slot.markers.count();
  return count;
}

std::size_t clsMultiTracePainter::itemCount() const {
  return 1 + static_cast<std::size_t>(traces_.count()) + markersOfAll();
}

void clsMultiTracePainter::describe(GraphItems& items) {
  guard("describe() ...", [&] {
    const auto traces = static_cast<std::size_t>(traces_.count());
    items.add(chartItem("Traces", countOf(traces, "trace") + ", " + countOf(markersOfAll(), "marker")));
    for (std::int16_t trace = 0; trace < traces_.count(); ++trace) {
      items.add(traceItem(trace));
      for (const MarkerPointer& marker : byNumber(traces_.slot(trace).markers))
        items.add(markerItem(trace, *marker));
    }
  });
}

GraphItem clsMultiTracePainter::traceItem(std::int16_t trace) {
  TraceSlot& slot = traces_.slot(trace);
  GraphItem item{GraphItemKind::Trace,
                 "Trace " + std::to_string(trace + 1),
                 countOf(slot.valueCount(), "point"),
                 plotRect().drawable() ? plotRect().toPixels() : Rect{},
                 trace == selectedTraceIndex_,
                 slot.points.last() >= 0};
  if (const MinMax& found = currentMinMax(slot); found.found) {
    clsMarker largest;
    largest.valueX = xStart_ + found.maximumIndex * pointSpacing();
    largest.valueY = found.maximum;
    const MarkerReading reading = markerReading(largest, readoutFormat());
    (((item.value += ", largest ") += reading.y) += " at ") += reading.x;
  }
  return item;
}

GraphItem clsMultiTracePainter::markerItem(std::int16_t trace, clsMarker& marker) {
  const TraceSlot& slot = traces_.slot(trace);
  refreshValues(slot, marker);
  GraphItem item{GraphItemKind::Marker,
                 (marker.DELTA ? "Delta marker " : "Marker ") + std::to_string(numberOf(marker)),
                 {},
                 {},
                 &marker == activeMarker().get(),
                 placeMarker(static_cast<std::size_t>(trace), marker)};
  if (traces_.count() > 1) item.name += ", trace " + std::to_string(trace + 1);
  const MarkerPointer partner = marker.DELTA ? partnerOf(marker) : nullptr;
  if (partner != nullptr) refreshValues(slot, *partner);
  item.value = joined(partner != nullptr ? deltaReading(marker, *partner, readoutFormat())
                                         : markerReading(marker, readoutFormat()));
  // The clip round the panel cuts off a marker whose level lies beyond the axis.
  item.visible = item.visible && panelRect().toPixels().contains({marker.positionX, marker.positionY});
  if (item.visible) item.placePx = marker.boundsPx();
  return item;
}

}  // namespace frontpanels

// State of the multi-trace painter: its traces, its axes and its labels' texts.
#include "painters/multi_trace_painter.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <utility>

#include "entry/number_format.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "painters/auto_scale.h"
#include "painters/trace_values.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

constexpr std::string_view kDefaultAxisFormat = "0.##";

// PNs that are looked up under another one, by the mode of the call.
struct AliasRow {
  std::int16_t pn;
  std::array<std::int16_t, 2> lookedUp;  // in mode 0 and mode 1
};
constexpr std::array kAliases{AliasRow{106, {106, 107}}, AliasRow{107, {106, 107}}, AliasRow{111, {106, 107}},
                              AliasRow{25, {25, 214}}, AliasRow{214, {25, 214}}};

// Nothing for a PN with aliases in a mode that has none.
std::optional<std::int16_t> lookedUpPn(std::int16_t mode, std::int16_t pn) {
  const auto* const row =
      std::find_if(kAliases.begin(), kAliases.end(), [pn](const AliasRow& alias) { return alias.pn == pn; });
  if (row == kAliases.end()) return pn;
  if (mode != 0 && mode != 1) return std::nullopt;
  return row->lookedUp[static_cast<std::size_t>(mode)];
}

}  // namespace

clsMultiTracePainter::clsMultiTracePainter(Gdi& gdi) : PlotPainter(gdi) {
  guard("class_Initialize() ...", [this] { xAxisFormatter_.formatString(kDefaultAxisFormat); });
}

// --- Adding and removing traces

std::int16_t clsMultiTracePainter::addATrace(std::int16_t mode, std::int16_t pn, double value,
                                             std::int32_t size, std::optional<std::int16_t> traceId) {
  return guarded("addATrace() ...", std::int16_t{-1}, [&]() -> std::int16_t {
    if (traceId && traces_.findTraceId(*traceId) != -1) return refillTraceId(*traceId, {pn, value, size});
    // The trace is kept under the PN that the next call will look up.
    const auto key = lookedUpPn(mode, pn);
    if (!key) return -1;
    const std::int16_t found = traces_.findPn(*key);
    if (found != -1) return addNewTraceAtIndex(found, *key, value, size, traceId);
    if (traces_.count() >= maxTraces()) return addNewTraceAtExistingPN(*key, value, size, traceId);
    return addNewTraceAtEnd(*key, value, size, traceId);
  });
}

std::int16_t clsMultiTracePainter::refillTraceId(std::int16_t traceId, const TraceFill& fill) {
  std::int16_t last = -1;
  for (std::int16_t i = 0; i < traces_.count(); ++i) {
    if (traces_.slot(i).traceId == traceId) last = traces_.refill(i, fill, std::nullopt);
  }
  if (traces_.count() == 1) selectedTraceIndex_ = last;
  return last;
}

std::int16_t clsMultiTracePainter::addNewTraceAtEnd(std::int16_t pn, double value, std::int32_t size,
                                                    std::optional<std::int16_t> traceId) {
  return guarded("addNewTraceAtEnd()...", std::int16_t{-1}, [&] {
    return traces_.append({pn, value, size}, traceId);
  });
}

std::int16_t clsMultiTracePainter::addNewTraceAtIndex(std::int16_t index, std::int16_t pn, double value,
                                                      std::int32_t size,
                                                      std::optional<std::int16_t> traceId) {
  return guarded("addNewTraceAtIndex()...", std::int16_t{-1}, [&] {
    return traces_.refill(index, {pn, value, size}, traceId);
  });
}

std::int16_t clsMultiTracePainter::addNewTraceAtExistingPN(std::int16_t pn, double value, std::int32_t size,
                                                           std::optional<std::int16_t> traceId) {
  return guarded("addNewTraceAtExistingPN()...", std::int16_t{-1}, [&] {
    return traces_.replaceLeastRecentlyUsed({pn, value, size}, traceId);
  });
}

std::int16_t clsMultiTracePainter::findATrace(std::int16_t pn) const {
  return guarded("findATrace() ...", std::int16_t{-1}, [&] { return traces_.findPn(pn); });
}

std::int16_t clsMultiTracePainter::findTraceByMarker(const MarkerPointer& marker) const {
  return guarded("findTraceByMarker() failed ...", std::int16_t{-1}, [&] {
    if (marker == nullptr) raiseObjectVariableNotSet();
    return traces_.findMarker(marker.get());
  });
}

void clsMultiTracePainter::removeATrace(std::int16_t traceId) {
  guard("removeATrace()...", [&] {
    const std::int16_t index = traces_.findTraceId(traceId);
    if (index == -1) {
      errorHandler().Assert("removeATrace() ... can't find trace");
      return;
    }
    traces_.remove(index);
    if (selectedTraceIndex_ > index) --selectedTraceIndex_;
    forgetWhatIsGone();
  });
}

void clsMultiTracePainter::clearTrace() {
  guard("clearTrace() ...", [this] {
    for (TraceSlot& slot : traces_.traces()) {
      slot.data = Variant::null();
      slot.points.clear();
      valuesChanged(slot);
    }
  });
}

void clsMultiTracePainter::forgetWhatIsGone() noexcept {
  const auto gone = [this](const MarkerPointer& marker) {
    return marker != nullptr && traces_.findMarker(marker.get()) == -1;
  };
  if (gone(activeMarker())) activeMarker(nullptr);
  if (gone(mouseActiveMarker())) mouseActiveMarker(nullptr);
  const int last = std::max(0, traces_.count() - 1);
  selectedTraceIndex_ = static_cast<std::int16_t>(std::min<int>(selectedTraceIndex_, last));
}

// --- Values of a trace

TraceSlot& clsMultiTracePainter::slotForValues() {
  if (traces_.count() == 0) traces_.append({}, std::nullopt);
  return traces_.slot(selectedTraceIndex_);
}

void clsMultiTracePainter::valuesChanged(TraceSlot& slot) {
  slot.minMaxCurrent = false;
  slot.offsetPending = true;
  dataChanged(true);
}

void clsMultiTracePainter::storeValues(TraceSlot& slot, const Variant& values) {
  if (!values.isArray() && !values.isNull() && !values.isEmpty()) raiseTypeMismatch();
  slot.data = values;
  valuesChanged(slot);
}

void clsMultiTracePainter::trace(const Variant& values) {
  guard("clsMultiTracePainter::trace() ...", [&] { storeValues(slotForValues(), values); });
}

void clsMultiTracePainter::trace(std::int16_t index, const Variant& values) {
  guard("clsMultiTracePainter::trace() ...", [&] { storeValues(traces_.slot(index), values); });
}

void clsMultiTracePainter::trace(std::span<const float> values) {
  guard("clsMultiTracePainter::trace() ...", [&] {
    TraceSlot& slot = slotForValues();
    if (auto* const singles = std::get_if<Variant::Singles>(&slot.data.value())) {
      singles->assign(values.begin(), values.end());
    } else {
      slot.data = Variant(Variant::Singles(values.begin(), values.end()));
    }
    valuesChanged(slot);
  });
}

void clsMultiTracePainter::traceSize(std::int32_t size) {
  guard("clsMultiTracePainter::traceSize() ...", [&] {
    TraceSlot& slot = slotForValues();
    slot.minMaxCurrent &= slot.size == size;
    slot.size = size;
  });
}

double clsMultiTracePainter::traceValue(std::int16_t index) const {
  return guarded("clsMultiTracePainter::traceValue() ...", 0.0, [&] { return traces_.slot(index).value; });
}

std::int16_t clsMultiTracePainter::pnOffset(std::int16_t index) const {
  return guarded("clsMultiTracePainter::pnOffset() ...", std::int16_t{0},
                 [&] { return traces_.slot(index).pnOffset; });
}

void clsMultiTracePainter::pnOffset(std::int16_t index, std::int16_t pn) {
  guard("clsMultiTracePainter::pnOffset() ...", [&] { traces_.slot(index).pnOffset = pn; });
}

TraceOrientation clsMultiTracePainter::traceOrientation(std::int16_t index) const {
  return guarded("clsMultiTracePainter::traceOrientation() ...", TraceOrientation::FromLeft,
                 [&] { return traces_.slot(index).orientation; });
}

void clsMultiTracePainter::traceOrientation(std::int16_t index, TraceOrientation orientation) {
  guard("clsMultiTracePainter::traceOrientation() ...",
        [&] { traces_.slot(index).orientation = orientation; });
}

void clsMultiTracePainter::leastRecentlyUsed(std::vector<std::int16_t> order) {
  guard("clsMultiTracePainter::leastRecentlyUsed() ...", [&] { traces_.usageOrder(std::move(order)); });
}

void clsMultiTracePainter::numberOfTraces(std::int16_t count) {
  guard("clsMultiTracePainter::numberOfTraces() ...", [&] {
    traces_.count(count);
    forgetWhatIsGone();
  });
}

void clsMultiTracePainter::selectedTraceIndex(std::int16_t index) {
  guard("clsMultiTracePainter::selectedTraceIndex() ...", [&] {
    (void)traces_.slot(index);
    selectedTraceIndex_ = index;
  });
}

double clsMultiTracePainter::activeTraceMaximumValue() {
  return currentMinMax(traces_.slot(selectedTraceIndex_)).maximum;
}

void clsMultiTracePainter::activeTraceMaximumValue(double value) {
  TraceSlot& slot = traces_.slot(selectedTraceIndex_);
  (void)currentMinMax(slot);
  slot.minMax.maximum = value;
}

double clsMultiTracePainter::activeTraceMaximumIndex() {
  return currentMinMax(traces_.slot(selectedTraceIndex_)).maximumIndex;
}

void clsMultiTracePainter::activeTraceMaximumIndex(double index) {
  TraceSlot& slot = traces_.slot(selectedTraceIndex_);
  (void)currentMinMax(slot);
  slot.minMax.maximumIndex = index;
}

// New values arrive by trace(); the offset is added to them once, however often the panel asks before it
// paints.
void clsMultiTracePainter::processData() {
  guard("processData() ...", [this] {
    if (traces_.slot(0).data.isNull() || !dataChanged() || !useOffset()) return;
    const double amount = offset().toDouble();
    for (TraceSlot& slot : traces_.traces()) {
      if (std::exchange(slot.offsetPending, false)) addToValues(slot, amount);
    }
  });
}

// --- Value axis

void clsMultiTracePainter::DoAutoScale() {
  guard("clsMultiTracePainter::DoAutoScale()...", [this] {
    if (const auto data = dataRange()) fitAxis(*data);
  });
}

std::optional<ValueRange> clsMultiTracePainter::dataRange() {
  std::optional<ValueRange> range;
  for (TraceSlot& slot : traces_.traces()) {
    const MinMax& found = currentMinMax(slot);
    if (!found.found) continue;
    range = {std::min(found.minimum, range ? range->minimum : found.minimum),
             std::max(found.maximum, range ? range->maximum : found.maximum)};
  }
  return range;
}

const MinMax& clsMultiTracePainter::currentMinMax(TraceSlot& slot) {
  if (!slot.minMaxCurrent) computeMinMax(slot);
  return slot.minMax;
}

void clsMultiTracePainter::computeMinMax(TraceSlot& slot) {
  slot.minMax = {};
  slot.minMaxCurrent = guard("computeMinMax()", [&] {
    withValues(slot, converted_,
               "clsMultiTracePainter::computeMinMax() ... unhandled array type.  Using Variant (SLOW!)",
               [&](auto values) { slot.minMax = minMaxOf(values); });
  });
}

// --- X axis

void clsMultiTracePainter::xStart(double start) {
  if (std::exchange(xStart_, start) != start) updateXAxisLabels();
}

void clsMultiTracePainter::xStop(double stop) {
  if (std::exchange(xStop_, stop) != stop) updateXAxisLabels();
}

void clsMultiTracePainter::span(double span) {
  if (span == xStop_ - xStart_) return;
  const double center = (xStart_ + xStop_) / 2;
  xStart_ = center - span / 2;
  xStop_ = center + span / 2;
  updateXAxisLabels();
}

void clsMultiTracePainter::numberOfHorizontalDivisions(std::int32_t divisions) {
  guard("clsMultiTracePainter::numberOfHorizontalDivisions() ...", [&] {
    requireDivisions(divisions);
    if (std::exchange(numberOfHorizontalDivisions_, divisions) != divisions) updateXAxisLabels();
  });
}

void clsMultiTracePainter::xAxisStyle(std::int16_t style) {
  xAxisStyle_ = style;
  updateXAxisLabels();
}

clsNumericEntry& clsMultiTracePainter::xAxisFormatter() {
  xLabelsStale_ = true;  // the caller may change how x values are written
  return xAxisFormatter_;
}

void clsMultiTracePainter::updateXAxisLabels() {
  xLabelsStale_ = false;
  guard("updateXAxisLabels() ...", [this] {
    switch (xAxisStyle_) {
      case 0:
        leftLabel("");
        rightLabel("");
        xAxisLabel("");
        break;
      case 1:
        writeXLabel(LabelPlace::Left, xStart_);
        writeXLabel(LabelPlace::Right, rightEdgeX());
        writeDivisionLabel(LabelPlace::XAxis);
        break;
      case 2:
      case 3:
        leftLabel("");
        writeXLabel(LabelPlace::XAxis, (xStart_ + rightEdgeX()) / 2);
        xAxisStyle_ == 2 ? writeDivisionLabel(LabelPlace::Right) : rightLabel("");
        break;
      default:
        break;
    }
  });
}

double clsMultiTracePainter::rightEdgeX() const {
  if (xPerPoint() == 0 || numberOfMeasurements() <= 2) return xStop_;
  return xStart_ + (numberOfMeasurements() - 2.0) * xPerPoint();
}

void clsMultiTracePainter::writeXLabel(LabelPlace place, double value) {
  xAxisFormatter_.formatter(value, text_);
  labels().text(place, text_);
}

// Without divisions there is no width of one to tell.
void clsMultiTracePainter::writeDivisionLabel(LabelPlace place) {
  text_.clear();
  if (numberOfHorizontalDivisions_ > 0) {
    xAxisFormatter_.appendDifference(text_, (rightEdgeX() - xStart_) / numberOfHorizontalDivisions_,
                                     xAxisFormatter_.formatString(), !xAxisFormatter_.suppressSuffix());
    text_ += "/div";
  }
  labels().text(place, text_);
}

}  // namespace frontpanels

// State of the bar chart painter: its block, its bars and its settings.
#include "painters/bar_chart_painter.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <utility>

#include "framework/support/guard.h"
#include "framework/support/numeric.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

constexpr std::string_view kDefaultKeyFormat = "0.##";
constexpr std::int16_t kSortModes = 5;
constexpr std::int16_t kFillStyles = 8;
constexpr std::int16_t kLabelings = 3;
constexpr std::int16_t kSuffixes = 4;

void requireBetween(std::int32_t value, std::int32_t smallest, std::int32_t largest) {
  if (value < smallest || value > largest) raiseInvalidProcedureCall();
}

}  // namespace

clsBarChartPainter::clsBarChartPainter(Gdi& gdi) : PlotPainter(gdi) {
  guard("class_Initialize() ...", [this] {
    xAxisFormatter_.formatString(kDefaultKeyFormat);
    bars_.reserve(static_cast<std::size_t>(maxPNs_));
  });
}

// --- The block of values

void clsBarChartPainter::numberOfMeasurements(std::int32_t count) {
  guard("clsBarChartPainter::numberOfMeasurements()...", [&] {
    requireBetween(count, 0, std::numeric_limits<std::int32_t>::max());
    numberOfMeasurements_ = count;
  });
}

void clsBarChartPainter::elementsPerValue(std::int32_t count) {
  guard("clsBarChartPainter::elementsPerValue()...", [&] {
    requireBetween(count, 2, std::numeric_limits<std::int32_t>::max());
    fill(elementsPerValue_, count);
  });
}

void clsBarChartPainter::trace(const Variant& values) {
  guard("clsBarChartPainter::trace()...", [&] {
    if (!values.isArray() && !values.isNull() && !values.isEmpty()) raiseTypeMismatch();
    block_ = values;
    dataChanged(true);
  });
}

void clsBarChartPainter::trace(std::span<const float> values) {
  guard("clsBarChartPainter::trace()...", [&] {
    if (auto* const singles = std::get_if<Variant::Singles>(&block_.value())) {
      singles->assign(values.begin(), values.end());
    } else {
      block_ = Variant(Variant::Singles(values.begin(), values.end()));
    }
    dataChanged(true);
  });
}

void clsBarChartPainter::maxPNs(std::int16_t count) {
  guard("clsBarChartPainter::maxPNs()...", [&] {
    requireBetween(count, 1, std::numeric_limits<std::int16_t>::max());
    maxPNs_ = count;
    barsToPaint_ = std::min(barsToPaint_, maxPNs_);
  });
}

void clsBarChartPainter::setBarsToPaint(std::int16_t count) {
  barsToPaint_ = count == kAllBars ? kAllBars : std::clamp(count, std::int16_t{1}, maxPNs_);
}

// --- What bars hold

template <class T>
void clsBarChartPainter::fill(T& setting, const T& value) {
  if (setting == value) return;
  setting = value;
  barsStale_ = true;
}

void clsBarChartPainter::offset(const Variant& amount) {
  guard("clsBarChartPainter::offset()...", [&] {
    if (!amount.isNumeric()) raiseTypeMismatch();
    fill(offset_, amount);
  });
}

void clsBarChartPainter::useOffset(bool use) { fill(useOffset_, use); }
void clsBarChartPainter::otherIs(std::int16_t type) { fill(otherIs_, type); }
void clsBarChartPainter::kindFlag(std::int16_t kind) { fill(kindFlag_, kind); }
void clsBarChartPainter::extraValueMode(std::int16_t mode) { fill(extraValueMode_, mode); }
void clsBarChartPainter::extraValueSource(std::int16_t source) { fill(extraValueSource_, source); }
void clsBarChartPainter::hasCellNameLookupId2(bool has) { fill(hasCellNameLookupId2_, has); }

void clsBarChartPainter::defaultExtraValue(const Variant& value) {
  guard("clsBarChartPainter::defaultExtraValue()...", [&] { fill(defaultExtraValue_, value); });
}

// --- Order

template <class T>
void clsBarChartPainter::order(T& setting, const T& value) {
  if (setting == value) return;
  setting = value;
  SortBars();
}

void clsBarChartPainter::barSortByMode(std::int16_t mode) {
  guard("clsBarChartPainter::barSortByMode()...", [&] {
    requireBetween(mode, 0, kSortModes - 1);
    order(barSortByMode_, mode);
  });
}

void clsBarChartPainter::barSortOrder(std::int16_t order) { this->order(barSortOrder_, order); }
void clsBarChartPainter::sortBySetOrder(bool bySets) { order(sortBySetOrder_, bySets); }

void clsBarChartPainter::setOrderList(BarSets sets) {
  guard("clsBarChartPainter::setOrderList()...", [&] {
    numberOfSets_ = toInt16(static_cast<double>(sets.size()));
    setOrderList_ = std::move(sets);
    SortBars();
  });
}

void clsBarChartPainter::numberOfSets(std::int16_t count) {
  guard("clsBarChartPainter::numberOfSets()...", [&] {
    requireBetween(count, 0, std::numeric_limits<std::int16_t>::max());
    order(numberOfSets_, count);
  });
}

// --- Settings of what is shown

void clsBarChartPainter::setIncrement(double increment) {
  guard("clsBarChartPainter::setIncrement()...", [&] {
    if (!std::isfinite(increment) || increment < 0) raiseInvalidProcedureCall();
    increment_ = increment;
  });
}

void clsBarChartPainter::setBarLabeling(std::int16_t labeling) {
  guard("clsBarChartPainter::setBarLabeling()...", [&] {
    requireBetween(labeling, 0, kLabelings - 1);
    barLabeling_ = labeling;
  });
}

void clsBarChartPainter::setBarLabel(std::string_view text) {
  guard("clsBarChartPainter::setBarLabel()...", [&] { barLabel_ = text; });
}

void clsBarChartPainter::valueIs(std::int16_t which) { valueIs_ = which; }

void clsBarChartPainter::suffixIs(std::int16_t suffix) {
  guard("clsBarChartPainter::suffixIs()...", [&] {
    requireBetween(suffix, 0, kSuffixes - 1);
    suffixIs_ = suffix;
  });
}

void clsBarChartPainter::units(std::string_view text) {
  guard("clsBarChartPainter::units()...", [&] { units_ = text; });
}

void clsBarChartPainter::ShowCellName(bool show) { showCellName_ = show; }

void clsBarChartPainter::CellNameInfo(std::shared_ptr<const CellNames> names) {
  cellNames_ = std::move(names);
}

clsNumericEntry& clsBarChartPainter::xAxisFormatter() { return xAxisFormatter_; }

void clsBarChartPainter::BarChartStyle(std::int16_t style) {
  guard("clsBarChartPainter::BarChartStyle()...", [&] {
    requireBetween(style, 0, 1);
    style_ = style;
  });
}

void clsBarChartPainter::setFillStyle(std::int16_t style) {
  guard("clsBarChartPainter::setFillStyle()...", [&] {
    requireBetween(style, 0, kFillStyles - 1);
    fillStyle_ = style;
  });
}

// --- The bars

void clsBarChartPainter::processData() {}
void clsBarChartPainter::SortBars() {}
void clsBarChartPainter::DoAutoScale() {}
void clsBarChartPainter::Paint(DcHandle /*dc*/) {}
void clsBarChartPainter::Paint() {}
void clsBarChartPainter::Label(DcHandle /*dc*/, const LabelFonts& /*fonts*/) {}

void clsBarChartPainter::ClearBars() {
  fullRedraw_ = fullRedraw_ || !bars_.empty();
  bars_.clear();
}

float clsBarChartPainter::barValue(std::int32_t position) const {
  return guarded("clsBarChartPainter::barValue()...", 0.0F, [&] { return barAt(position).value; });
}

float clsBarChartPainter::barOffset(std::int32_t position) const {
  return guarded("clsBarChartPainter::barOffset()...", 0.0F, [&] { return barAt(position).key; });
}

float clsBarChartPainter::barOther(std::int32_t position) const {
  return guarded("clsBarChartPainter::barOther()...", 0.0F, [&] { return barAt(position).other; });
}

const Bar& clsBarChartPainter::barAt(std::int32_t position) const {
  if (position < 1 || position > barArraySize()) raiseSubscriptOutOfRange();
  return bars()[static_cast<std::size_t>(position) - 1];
}

std::int32_t clsBarChartPainter::findBar(std::int16_t barId) const {
  return guarded("clsBarChartPainter::findBar()...", std::int32_t{0}, [&] {
    const std::span<const Bar> all = bars();
    const auto found =
        std::find_if(all.begin(), all.end(), [&](const Bar& bar) { return bar.barId == barId; });
    if (found == all.end()) raiseSubscriptOutOfRange();
    return static_cast<std::int32_t>(found - all.begin()) + 1;
  });
}

// --- Sub-traces and markers

std::int16_t clsBarChartPainter::addATrace(std::int16_t /*mode*/, std::int16_t pn, double /*value*/,
                                           std::int32_t /*size*/, std::optional<std::int16_t> /*traceId*/) {
  return guarded("addATrace() ...", std::int16_t{-1}, [&] {
    const std::int16_t found = findATraceByPN(pn);
    if (found != -1) return found;
    const std::int16_t index = toInt16(static_cast<double>(tracePns_.size()));
    tracePns_.push_back(pn);
    return index;
  });
}

std::int16_t clsBarChartPainter::findATraceByPN(std::int16_t pn) const {
  const auto found = std::find(tracePns_.begin(), tracePns_.end(), pn);
  return found == tracePns_.end() ? std::int16_t{-1} : static_cast<std::int16_t>(found - tracePns_.begin());
}

std::int16_t clsBarChartPainter::pnOffset(std::int16_t index) const {
  return guarded("clsBarChartPainter::pnOffset()...", std::int16_t{0}, [&] {
    requireBetween(index, 0, numberOfTraces() - 1);
    return tracePns_[static_cast<std::size_t>(index)];
  });
}

std::int16_t clsBarChartPainter::numberOfTraces() const {
  return static_cast<std::int16_t>(tracePns_.size());
}

MarkerCollection& clsBarChartPainter::traceMarkerCollections(std::int16_t traceIndex) {
  if (traceIndex < 0 || traceIndex >= std::max<std::int16_t>(1, numberOfTraces())) raiseSubscriptOutOfRange();
  return markers_;
}

void clsBarChartPainter::addMarkerToTrace(MarkerPointer marker, std::int16_t /*traceId*/) {
  guard("addMarkerToTrace() failed", [&] {
    if (marker == nullptr) raiseObjectVariableNotSet();
    markers_.add(marker, marker->id);
  });
}

}  // namespace frontpanels

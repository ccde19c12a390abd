// State of the bar chart painter: its block, its bars and its settings.
#include "painters/bar_chart_painter.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <utility>

#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "framework/support/numeric.h"
#include "painters/min_max.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

constexpr std::string_view kDefaultKeyFormat = "0.##";
constexpr std::int16_t kAscending = 1;
constexpr std::int16_t kFillStyles = 8;
constexpr std::int16_t kLabelings = 3;
constexpr std::int16_t kSuffixes = 4;

void requireBetween(std::int32_t value, std::int32_t smallest, std::int32_t largest) {
  if (value < smallest || value > largest) raiseInvalidProcedureCall();
}

std::int32_t lastItem(std::span<const HeldBar> bars) {
  std::int32_t last = 0;
  for (const HeldBar& bar : bars) last = std::max(last, bar.item);
  return last;
}

}  // namespace

clsBarChartPainter::clsBarChartPainter(Gdi& gdi) : PlotPainter(gdi) {
  guard("class_Initialize() ...", [this] {
    xAxisFormatter_.formatString(kDefaultKeyFormat);
    bars_.resize(static_cast<std::size_t>(maxPNs_));
    bars_.resize(0);
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
    fillBy(rules_.elementsPerValue, count);
  });
}

void clsBarChartPainter::trace(const Variant& values) {
  guard("clsBarChartPainter::trace()...", [&] {
    if (!values.isArray() && !values.isNull() && !values.isEmpty()) raiseTypeMismatch();
    block_ = values;
    blockHeld_ = false;
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
    blockHeld_ = false;
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
void clsBarChartPainter::fillBy(T& setting, const T& value) {
  if (setting == value) return;
  setting = value;
  barsStale_ = true;
}

void clsBarChartPainter::offset(const Variant& amount) {
  guard("clsBarChartPainter::offset()...", [&] {
    if (!amount.isNumeric()) raiseTypeMismatch();
    fillBy(rules_.offset, amount);
  });
}

void clsBarChartPainter::useOffset(bool use) { fillBy(rules_.useOffset, use); }
void clsBarChartPainter::otherIs(std::int16_t type) { fillBy(rules_.otherIs, type); }
void clsBarChartPainter::kindFlag(std::int16_t kind) { fillBy(rules_.kindFlag, kind); }
void clsBarChartPainter::extraValueMode(std::int16_t mode) { fillBy(rules_.extraValueMode, mode); }
void clsBarChartPainter::extraValueSource(std::int16_t source) { fillBy(rules_.extraValueSource, source); }
void clsBarChartPainter::hasCellNameLookupId2(bool has) { fillBy(rules_.hasCellNameLookupId2, has); }

void clsBarChartPainter::defaultExtraValue(const Variant& value) {
  guard("clsBarChartPainter::defaultExtraValue()...", [&] { fillBy(rules_.defaultExtraValue, value); });
}

// --- Order

template <class T>
void clsBarChartPainter::sortBy(T& setting, const T& value) {
  if (setting == value) return;
  setting = value;
  SortBars();
}

void clsBarChartPainter::barSortByMode(std::int16_t mode) {
  guard("clsBarChartPainter::barSortByMode()...", [&] {
    requireBetween(mode, static_cast<std::int16_t>(BarSort::Arrival),
                   static_cast<std::int16_t>(BarSort::Other));
    sortBy(barSortByMode_, mode);
  });
}

void clsBarChartPainter::barSortOrder(std::int16_t order) { sortBy(barSortOrder_, order); }
void clsBarChartPainter::sortBySetOrder(bool bySets) { sortBy(sortBySetOrder_, bySets); }

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
    sortBy(numberOfSets_, count);
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
    yAxisLabel(valueUnit());
  });
}

void clsBarChartPainter::units(std::string_view text) {
  guard("clsBarChartPainter::units()...", [&] {
    units_ = text;
    yAxisLabel(valueUnit());
  });
}

void clsBarChartPainter::numberOfHorizontalDivisions(std::int32_t divisions) {
  guard("clsBarChartPainter::numberOfHorizontalDivisions()...", [&] {
    requireDivisions(divisions);
    numberOfHorizontalDivisions_ = divisions;
  });
}

void clsBarChartPainter::ShowCellName(bool show) { showCellName_ = show; }

void clsBarChartPainter::CellNameInfo(std::shared_ptr<const CellNames> names) {
  cellNames_ = std::move(names);
}

clsNumericEntry& clsBarChartPainter::xAxisFormatter() { return xAxisFormatter_; }

void clsBarChartPainter::BarChartStyle(std::int16_t style) {
  guard("clsBarChartPainter::BarChartStyle()...", [&] {
    requireBetween(style, 0, 1);
    direction_ = static_cast<BarDirection>(style);
  });
}

void clsBarChartPainter::setFillStyle(std::int16_t style) {
  guard("clsBarChartPainter::setFillStyle()...", [&] {
    requireBetween(style, 0, kFillStyles - 1);
    fillStyle_ = style;
  });
}

// --- The bars

// Whatever comes of it, a block is taken up once: the trace manager asks before each paint.
void clsBarChartPainter::processData() {
  guard("clsBarChartPainter::processData()...", [this] {
    if (!dataChanged()) return;
    dataChanged(false);
    if (block_.isNull() || (numberOfMeasurements_ == 0 && numberOfTraces() > 0)) return;
    requireItems(block_, numberOfMeasurements_, rules_.elementsPerValue);
    fillFromBlock(static_cast<std::size_t>(std::min<std::int32_t>(numberOfMeasurements_, maxPNs_)),
                  [](std::size_t i) { return static_cast<std::int32_t>(i); });
    matcher_.match(bars_.bars(), filled_.bars());
    takeFilled();
  });
}

template <class ItemOf>
void clsBarChartPainter::fillFromBlock(std::size_t count, ItemOf itemOf) {
  if (!knownOther(rules_.otherIs)) {
    errorHandler().Assert("clsBarChartPainter::processData()  unknown type for other" + block_.typeName());
  }
  filled_.resize(count);
  for (std::size_t i = 0; i < count; ++i) fillBar(filled_.bars()[i], block_, itemOf(i), rules_);
}

void clsBarChartPainter::takeFilled() {
  fullRedraw_ = fullRedraw_ || filled_.bars().size() < bars_.bars().size();
  std::swap(bars_, filled_);
  blockHeld_ = true;
  barsStale_ = false;
  SortBars();
}

// No update: who is who, and for how long, stays.
void clsBarChartPainter::refreshStaleBars() {
  if (!std::exchange(barsStale_, false) || !blockHeld_) return;
  guard("clsBarChartPainter::processData()...", [this] {
    const std::span<const HeldBar> held = bars();
    if (!held.empty()) requireItems(block_, lastItem(held) + 1, rules_.elementsPerValue);
    fillFromBlock(held.size(), [held](std::size_t i) { return held[i].item; });
    const std::span<HeldBar> filled = filled_.bars();
    for (std::size_t i = 0; i < held.size(); ++i) {
      filled[i].barId = held[i].barId;
      filled[i].updates = held[i].updates;
    }
    takeFilled();
  });
}

void clsBarChartPainter::ClearBars() {
  fullRedraw_ = fullRedraw_ || !bars().empty();
  bars_.resize(0);
}

void clsBarChartPainter::SortBars() {
  guard("clsBarChartPainter::SortBars()...", [this] {
    sortFlag_ = barSortByMode_ != static_cast<std::int16_t>(BarSort::Arrival);
    order_.sort(bars_.bars(), static_cast<BarSort>(barSortByMode_), barSortOrder_ == kAscending);
    if (sortBySetOrder_) SortBarsBySet();
  });
}

void clsBarChartPainter::SortBarsBySet() {
  guard("clsBarChartPainter::SortBarsBySet()... ", [this] {
    if (static_cast<std::size_t>(numberOfSets_) > setOrderList_.size()) raiseSubscriptOutOfRange();
    order_.groupBySets(bars_.bars(), std::span(setOrderList_).first(static_cast<std::size_t>(numberOfSets_)));
  });
}

std::size_t clsBarChartPainter::countToPaint() const {
  const std::size_t all = bars().size();
  return barsToPaint_ == kAllBars ? all : std::min(all, static_cast<std::size_t>(barsToPaint_));
}

void clsBarChartPainter::DoAutoScale() {
  guard("clsBarChartPainter::DoAutoScale()...", [this] {
    MinMax values;
    for (const HeldBar& bar : barsToPaint()) values.consider(static_cast<double>(bar.value), 0);
    if (values.found) fitAxis({values.minimum, values.maximum});
  });
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
    const std::span<const HeldBar> all = bars();
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

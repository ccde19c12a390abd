#include "entry/entry_ranges.h"

#include <algorithm>
#include <cmath>

#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

template <class Ranges, class Wanted>
std::optional<std::int32_t> firstOf(const Ranges& ranges, Wanted wanted) noexcept {
  const auto found = std::ranges::find_if(ranges, wanted);
  if (found == ranges.end()) return std::nullopt;
  return static_cast<std::int32_t>(found - ranges.begin());
}

// Empty reads as 0 elsewhere; as a limit it is missing.
bool isNumber(const Variant& value) {
  return !value.isEmpty() && value.isNumeric() && std::isfinite(value.toDouble());
}

}  // namespace

double EntryLimits::clamped(double value) const {
  if (minimum > maximum) raiseInvalidProcedureCall();
  return std::clamp(value, minimum, maximum);
}

std::optional<std::int32_t> EntryRanges::firstHolding(double value) const noexcept {
  return firstOf(ranges_,
                 [value](const EntryRange& range) { return range.defined && range.limits.hold(value); });
}

std::optional<std::int32_t> EntryRanges::firstDefined() const noexcept {
  return firstOf(ranges_, [](const EntryRange& range) { return range.defined; });
}

EntryRanges::Limits EntryRanges::limits() const noexcept {
  Limits limits;
  for (std::size_t i = 0; i < ranges_.size(); ++i)
    if (ranges_[i].defined) limits[i] = ranges_[i].limits;
  return limits;
}

void EntryRanges::limits(const Limits& limits) noexcept {
  for (std::size_t i = 0; i < ranges_.size(); ++i) {
    ranges_[i].defined = limits[i].has_value();
    ranges_[i].limits = limits[i].value_or(EntryLimits{});
  }
}

std::string_view readLimits(const HostRecordSet& records, EntryRanges::Limits& limits) {
  for (std::size_t record = 0; record < records.count(); ++record) {
    const Variant minimum = records.field(record, kMinimumField);
    const Variant maximum = records.field(record, kMaximumField);
    const Variant order = records.field(record, kOrderField);
    if (!isNumber(minimum) || !isNumber(maximum) || !isNumber(order))
      return "::Limits() ... non-numeric range argument";
    const std::int32_t index = order.toInt32();
    if (index < 0 || index >= EntryRanges::kCount) return "::Limits() ... order of no range";
    const EntryLimits read{minimum.toDouble(), maximum.toDouble()};
    if (read.minimum > read.maximum) return "::Limits() ... minimum above maximum";
    limits[static_cast<std::size_t>(index)] = read;
  }
  return {};
}

}  // namespace frontpanels

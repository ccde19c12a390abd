#include "entry/channel_info.h"

#include <algorithm>
#include <string>

#include "entry/host_data_version.h"
#include "entry/numeric_entry.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "framework/support/numeric.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

auto named(std::string_view routine, std::string_view rest = "") {
  return [=] { return std::string(clsChannelInfo::kTypeName).append(routine).append(rest); };
}

Variant field(const HostRecordSet* records, std::string_view name) {
  if (records == nullptr) raiseObjectVariableNotSet();
  return records->field(0, name);
}

std::int16_t orderOf(const HostRecordSet* records) {
  if (records == nullptr || hostDataVersion() < kHostDataWithOrders) return 0;
  return field(records, kOrderField).toInt16();
}

// Appends what `record` makes of the number, if the text is one.
template <class Record, class MakeRecord>
void append(std::string_view routine, std::string_view value, std::vector<Record>& table, MakeRecord record) {
  guard(named(routine), [&] {
    if (double number = 0; textToNumber(value, number)) table.push_back(record(number));
  });
}

// The range of an entry that an order stands for; none for one of another channelization.
std::optional<std::size_t> rangeOf(std::int16_t order, const ChannelLookup& lookup) {
  if (order < lookup.lowestOrder || order > lookup.highestOrder) return std::nullopt;
  const std::int32_t range = order - lookup.lowestOrder;
  if (range >= EntryRanges::kCount) raiseSubscriptOutOfRange();
  return static_cast<std::size_t>(range);
}

}  // namespace

void clsChannelInfo::reinitialize() noexcept {
  zeros_.clear();
  spacings_.clear();
  discontinuities_.clear();
  lookups_.clear();
}

// --- The tables

void clsChannelInfo::setChannelZero(std::string_view value, const HostRecordSet* records) noexcept {
  append("::setChannelZero()", value, zeros_, [&](double frequency) {
    return ChannelZero{orderOf(records), frequency};
  });
}

void clsChannelInfo::setChannelSpacing(std::string_view value, const HostRecordSet* records) noexcept {
  append("::setChannelSpacing()", value, spacings_, [&](double spacing) {
    return ChannelSpacing{orderOf(records), spacing};
  });
}

void clsChannelInfo::setChannelDiscontinuity(std::string_view value, const HostRecordSet* records) noexcept {
  append("::setChannelDiscontinuity()", value, discontinuities_, [&](double channel) {
    return OrderedDiscontinuity{
        orderOf(records),
        {channel, field(records, kMinimumField).toDouble(), field(records, kMaximumField).toDouble()}};
  });
}

void clsChannelInfo::setChannelLookup(std::string_view value, const HostRecordSet* records) noexcept {
  append("::setChannelLookup()", value, lookups_, [&](double id) {
    return ChannelLookup{toInt16(id), field(records, kMinimumField).toInt16(),
                         field(records, kMaximumField).toInt16()};
  });
}

// --- Their application

bool clsChannelInfo::selectChannelization(std::int16_t id, clsNumericEntry& entry) const noexcept {
  constexpr std::string_view kRoutine = "::selectChannelization()";
  return guarded(named(kRoutine), false, [&] {
    const ChannelLookup* const chosen = lookup(kRoutine, id);
    if (chosen == nullptr) return false;
    const RangePlans plans = plansOf(*chosen);
    entry.ChannelDiscontinuity(0);
    for (std::int32_t range = 0; const RangePlan& plan : plans) {
      if (plan.zero) entry.FormatOffsetForRange(range, *plan.zero);
      if (plan.spacing) entry.FormatScaleForRange(range, *plan.spacing);
      for (const auto& [channel, minimum, maximum] : plan.discontinuities)
        entry.AddChannelDiscontinuity(channel, minimum, maximum, range);
      ++range;
    }
    entry.channelUnits(true);
    entry.reformat();
    return true;
  });
}

void clsChannelInfo::selectChannelSpacing(std::int16_t id, clsNumericEntry& entry) const noexcept {
  constexpr std::string_view kRoutine = "::selectChannelSpacing()";
  guard(named(kRoutine), [&] {
    const ChannelLookup* const chosen = lookup(kRoutine, id);
    if (chosen == nullptr) return;
    const RangePlans plans = spacingsOf(*chosen);
    for (std::int32_t range = 0; const RangePlan& plan : plans) {
      if (plan.spacing) entry.FormatScaleForRange(range, *plan.spacing);
      ++range;
    }
    entry.channelUnits(true);
    entry.reformat();
  });
}

const ChannelLookup* clsChannelInfo::lookup(std::string_view routine, std::int16_t id) const {
  const auto found = std::find_if(lookups_.rbegin(), lookups_.rend(),
                                  [id](const ChannelLookup& record) { return record.id == id; });
  if (found != lookups_.rend()) return &*found;
  errorHandler().Assert(named(routine, " ... could not find channelization lookup")());
  return nullptr;
}

clsChannelInfo::RangePlans clsChannelInfo::spacingsOf(const ChannelLookup& lookup) const {
  RangePlans plans;
  for (auto record = spacings_.rbegin(); record != spacings_.rend(); ++record) {
    const auto range = rangeOf(record->order, lookup);
    if (!range) continue;
    if (record->spacing == 0) raiseDivisionByZero();
    plans[*range].spacing = record->spacing;
  }
  return plans;
}

clsChannelInfo::RangePlans clsChannelInfo::plansOf(const ChannelLookup& lookup) const {
  RangePlans plans = spacingsOf(lookup);
  for (auto record = zeros_.rbegin(); record != zeros_.rend(); ++record)
    if (const auto range = rangeOf(record->order, lookup)) plans[*range].zero = record->frequency;
  for (const OrderedDiscontinuity& record : discontinuities_)
    if (const auto range = rangeOf(record.order, lookup)) {
      requireSeparate(record.block, plans[*range].discontinuities);
      plans[*range].discontinuities.push_back(record.block);
    }
  return plans;
}

}  // namespace frontpanels

// Frequencies shown as channel numbers.
#include <algorithm>
#include <array>
#include <cmath>

#include "entry/entry_text.h"
#include "entry/host_data_version.h"
#include "entry/number_format.h"
#include "entry/numeric_entry.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

// The bands that host records name, of both directions in turn.
constexpr std::array kHostOrders = {0, 2, 4, 1, 3, 5};

// The range that a record belongs to; null without such a band.
const int* hostOrder(const HostRecordSet& records) {
  const Variant order = records.field(0, kOrderField);
  if (order.isEmpty() || !order.isNumeric()) return nullptr;
  const auto* const found = std::ranges::find(kHostOrders, order.toDouble());
  return found == kHostOrders.end() ? nullptr : found;
}

bool namesOrders(const HostRecordSet* records) {
  return records != nullptr && hostDataVersion() >= kHostDataWithOrders;
}

auto named(std::string_view routine) {
  return [routine] { return std::string(clsNumericEntry::kTypeName).append(routine); };
}

}  // namespace

// --- What the host says

void clsNumericEntry::ChannelZero(double value, const HostRecordSet* records) noexcept {
  setChannelField({"::ChannelZero() failed. ", "ChannelZero() bad value for PARM_CHANNEL_ZERO::FIELD_ORDER",
                   &EntryRange::displayOffset},
                  value, records, formatOffset_);
}

void clsNumericEntry::ChannelSpacing(double value, const HostRecordSet* records) noexcept {
  setChannelField(
      {"::ChannelSpacing() failed. ", "ChannelSpacing() bad value for PARM_CHANNEL_SPACING::FIELD_ORDER",
       &EntryRange::displayScale},
      value, records, formatScale_);
}

void clsNumericEntry::setChannelField(const ChannelField& field, double value, const HostRecordSet* records,
                                      double& inForce) noexcept {
  guard(named(field.failure), [&] {
    if (!std::isfinite(value)) raiseOverflow();
    if (field.member == &EntryRange::displayScale && value == 0) raiseDivisionByZero();
    std::int32_t index = 0;
    if (namesOrders(records)) {
      const int* const order = hostOrder(*records);
      if (order == nullptr) {
        // The names run together in this message.
        errorHandler().Assert(named(field.badOrder)());
        return;
      }
      index = *order;
    } else {
      inForce = value;
    }
    EntryRange* const range = ranges_.find(index);
    if (range == nullptr) raiseSubscriptOutOfRange();
    range->*field.member = value;
    channelUnits(true);
  });
}

void clsNumericEntry::AddChannelDiscontinuity(double channel, double minimum, double maximum,
                                              std::optional<std::int32_t> range) noexcept {
  guard(named("::AddChannelDiscontinuity()"), [&] {
    addDiscontinuity({{channel, minimum, maximum}, range});
  });
}

void clsNumericEntry::ChannelDiscontinuity(double value, const HostRecordSet* records) noexcept {
  guard(named("::ChannelDiscontinuity()"), [&] {
    if (records == nullptr && value == 0) {
      discontinuities_.clear();
      UpdateDiscontinuities();
      return;
    }
    if (records == nullptr) raiseObjectVariableNotSet();
    std::int32_t range = 0;
    if (namesOrders(records)) {
      const int* const order = hostOrder(*records);
      if (order == nullptr) raiseSubscriptOutOfRange();
      range = *order;
    }
    const Variant channel = records->field(0, kDefaultField);
    addDiscontinuity(
        {{channel.isEmpty() ? value : channel.toDouble(), records->field(0, kMinimumField).toDouble(),
          records->field(0, kMaximumField).toDouble()},
         range});
  });
}

void clsNumericEntry::addDiscontinuity(const RangedDiscontinuity& added) {
  if (added.range && ranges_.find(*added.range) == nullptr) raiseSubscriptOutOfRange();
  for (std::int32_t index = 0; index < EntryRanges::kCount; ++index)
    if (added.countsFor(index)) requireSeparate(added.block, channelPlan(index).discontinuities);
  discontinuities_.push_back(added);
  UpdateDiscontinuities();
}

void clsNumericEntry::UpdateDiscontinuities() noexcept {
  guard(named("::UpdateDiscontinuities()"), [&] {
    decltype(rangeDiscontinuities_) perRange;
    bool placed = true;
    for (const RangedDiscontinuity& discontinuity : discontinuities_) {
      bool defined = false;
      for (std::int32_t index = 0; index < EntryRanges::kCount; ++index) {
        if (!discontinuity.countsFor(index)) continue;
        perRange[static_cast<std::size_t>(index)].push_back(discontinuity.block);
        defined = defined || hasLimits(index);
      }
      placed = placed && defined;
    }
    rangeDiscontinuities_.swap(perRange);
    redisplay_ = true;
    if (!placed)
      errorHandler().Assert(named("::UpdateDiscontinuities() ... no range defined for step/discontinuity")());
  });
}

bool clsNumericEntry::hasLimits(std::int32_t index) const noexcept {
  return ranges_.find(index)->defined || (index == range_ && limits_ != EntryLimits{});
}

// --- What is shown

void clsNumericEntry::channelUnits(bool channels) noexcept {
  channelUnits_ = channels;
  redisplay_ = true;
}

void clsNumericEntry::channelChoose(bool channels) noexcept {
  channelChoose_ = channels;
  reformat();
}

bool clsNumericEntry::validNumeric() const noexcept {
  if (text() == lastText_) return validNumeric_;
  return guarded("clsNumericEntry::validNumeric() failed. ", false, [&] { return accepts(text()); });
}

bool clsNumericEntry::accepts(std::string_view text) const {
  return (preserveBlankEntry_ && isBlankText(text)) || parsed(text).has_value();
}

clsNumericEntry::Display clsNumericEntry::display() const noexcept {
  if (channelChoose()) {
    const EntryRange& range = *ranges_.find(range_);
    return {range.displayOffset, range.displayScale};
  }
  if (channelUnits_) return {};
  return {formatOffset_, formatScale_};
}

const SuffixTable& clsNumericEntry::shownSuffixes() const noexcept {
  static const SuffixTable kNone;
  return channelChoose() ? kNone : suffixes_;
}

double clsNumericEntry::shownNumber(double value) const {
  if (channelChoose()) return channelAt(value, channelPlan(range_));
  const auto [offset, scale] = display();
  if (scale == 0) raiseDivisionByZero();
  return (value - offset) / scale;
}

ChannelPlan clsNumericEntry::channelPlan(std::int32_t index) const noexcept {
  const EntryRange& range = *ranges_.find(index);
  return {range.displayOffset, range.displayScale, rangeDiscontinuities_[static_cast<std::size_t>(index)]};
}

std::optional<double> clsNumericEntry::frequencyOfChannel(double channel) const noexcept {
  std::optional<double> frequency = frequencyOf(channel, channelPlan(range_), limits_);
  for (std::int32_t index = 0; !frequency && autoChoose_ && index < EntryRanges::kCount; ++index)
    if (const EntryRange& range = *ranges_.find(index); range.defined)
      frequency = frequencyOf(channel, channelPlan(index), range.limits);
  return frequency;
}

double clsNumericEntry::nearestChannel(double value) const {
  const ChannelPlan plan = channelPlan(range_);
  return frequencyAtPosition(nearestMultiple(channelPosition(value, plan), 1), plan);
}

double clsNumericEntry::nextChannel(double value, StepDirection direction) const {
  const ChannelPlan plan = channelPlan(range_);
  const double position = channelPosition(value, plan);
  const double one = direction == StepDirection::Up ? 1 : -1;
  return frequencyAtPosition(normalizeAsStep_ ? nextMultiple(position, direction, 1) : position + one, plan);
}

}  // namespace frontpanels

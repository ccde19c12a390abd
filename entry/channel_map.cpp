#include "entry/channel_map.h"

#include <algorithm>
#include <cmath>

#include "entry/number_format.h"
#include "platform/runtime_error.h"
#include "platform/whole_number.h"

namespace frontpanels {
namespace {

constexpr double kHalf = 0.5;

double lengthOf(const ChannelDiscontinuity& block) noexcept { return block.maximum - block.minimum; }

// Whether `number` lies in as many channels as the block has, `first` the first of them.
bool inBlock(double number, double first, const ChannelDiscontinuity& block) noexcept {
  return number >= first - kHalf && number < first + lengthOf(block) + kHalf;
}

// Of two runs of channels.
bool overlap(double first, double length, double otherFirst, double otherLength) noexcept {
  return first < otherFirst + otherLength + 1 && otherFirst < first + length + 1;
}

const ChannelDiscontinuity* blockCovering(double position, const ChannelPlan& plan) noexcept {
  for (const ChannelDiscontinuity& block : plan.discontinuities)
    if (inBlock(position, block.channel, block)) return &block;
  return nullptr;
}

}  // namespace

void requireSeparate(const ChannelDiscontinuity& added, std::span<const ChannelDiscontinuity> others) {
  if (!std::isfinite(added.channel) || !std::isfinite(added.minimum) || !std::isfinite(added.maximum))
    raiseOverflow();
  if (added.minimum > added.maximum) raiseInvalidProcedureCall();
  for (const ChannelDiscontinuity& other : others) {
    if (other == added) continue;
    if (overlap(added.channel, lengthOf(added), other.channel, lengthOf(other)) ||
        overlap(added.minimum, lengthOf(added), other.minimum, lengthOf(other)))
      raiseInvalidProcedureCall();
  }
}

double channelPosition(double frequency, const ChannelPlan& plan) {
  if (plan.spacing == 0) raiseDivisionByZero();
  const double position = (frequency - plan.zero) / plan.spacing;
  const double whole = roundHalfEven(position);
  const double untold =
      1e-14 * std::max(std::fabs(frequency), std::fabs(plan.zero)) / std::fabs(plan.spacing);
  return std::fabs(position - whole) <= untold && untold < kHalf ? whole : position;
}

double frequencyAtPosition(double position, const ChannelPlan& plan) noexcept {
  return toSignificantDigits(plan.zero + position * plan.spacing);
}

double channelAt(double frequency, const ChannelPlan& plan) {
  const double position = channelPosition(frequency, plan);
  const ChannelDiscontinuity* const block = blockCovering(position, plan);
  return block == nullptr ? position : block->minimum + (position - block->channel);
}

std::optional<double> frequencyOf(double channel, const ChannelPlan& plan,
                                  const EntryLimits& limits) noexcept {
  if (plan.spacing == 0) return std::nullopt;
  // A spacing below 0 counts downwards.
  const auto ends =
      std::minmax({(limits.minimum - plan.zero) / plan.spacing, (limits.maximum - plan.zero) / plan.spacing});
  const auto at = [&](double position) -> std::optional<double> {
    if (!(position >= ends.first - kHalf && position <= ends.second + kHalf)) return std::nullopt;
    const double frequency = frequencyAtPosition(position, plan);
    return std::isfinite(frequency) ? std::optional(frequency) : std::nullopt;
  };
  for (const ChannelDiscontinuity& block : plan.discontinuities)
    if (inBlock(channel, block.minimum, block))
      if (const auto frequency = at(block.channel + (channel - block.minimum))) return frequency;
  if (blockCovering(channel, plan) == nullptr)
    if (const auto frequency = at(channel)) return frequency;
  // Rounded to what is shown, the last of a block may read as its very end, which is no longer in it.
  for (const ChannelDiscontinuity& block : plan.discontinuities)
    if (channel == block.maximum + kHalf)
      if (const auto frequency = at(block.channel + lengthOf(block) + kHalf)) return frequency;
  return std::nullopt;
}

}  // namespace frontpanels

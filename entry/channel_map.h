// Channel numbers and the frequencies that they stand for.
//
// By itself channel n lies at zero + n * spacing. A discontinuity puts a block of other numbers there: the
// channels `minimum` to `maximum`, one spacing apart, `minimum` where channel `channel` would lie by itself.
// The numbers that the block covers are then no channels, and those behind it go on as if it were not there.
//
// What lies between two channels belongs to the nearer one, half-way to the upper one, so that every
// frequency has a number: half a channel above the last of a block the numbers by themselves begin again.
#pragma once

#include <optional>
#include <span>

#include "entry/entry_ranges.h"

namespace frontpanels {

struct ChannelDiscontinuity {
  double channel = 0;
  double minimum = 0;
  double maximum = 0;
  friend bool operator==(const ChannelDiscontinuity&, const ChannelDiscontinuity&) = default;
};

// Raises "Overflow" for what is no finite number, "Invalid procedure call or argument" for a block whose
// minimum is above its maximum, that covers a part of what another covers, or that has a part of another's
// numbers. One that equals another may stand beside it.
void requireSeparate(const ChannelDiscontinuity& added, std::span<const ChannelDiscontinuity> others);

struct ChannelPlan {
  double zero = 0;
  double spacing = 1;
  std::span<const ChannelDiscontinuity> discontinuities;
};

// Raises "Division by zero" for a spacing of 0.
[[nodiscard]] double channelAt(double frequency, const ChannelPlan& plan);
// The frequency of a channel, where the plan has one of this number that is not more than half a spacing
// outside the limits. A number that a block has within the limits is the block's.
[[nodiscard]] std::optional<double> frequencyOf(double channel, const ChannelPlan& plan,
                                                const EntryLimits& limits) noexcept;

// Where a frequency lies, counted in spacings from zero, and back. Frequencies are kept to 15 digits: what is
// off a whole channel by less than they can tell is on it. Raises "Division by zero" for a spacing of 0.
[[nodiscard]] double channelPosition(double frequency, const ChannelPlan& plan);
[[nodiscard]] double frequencyAtPosition(double position, const ChannelPlan& plan) noexcept;

}  // namespace frontpanels

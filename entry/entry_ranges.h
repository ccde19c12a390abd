// The limits of a numeric entry and the ranges that it chooses them from.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <optional>
#include <string_view>

#include "entry/host_record.h"

namespace frontpanels {

// Both limits belong to what they hold.
struct EntryLimits {
  double minimum = std::numeric_limits<double>::lowest();
  double maximum = std::numeric_limits<double>::max();
  friend bool operator==(const EntryLimits&, const EntryLimits&) = default;

  [[nodiscard]] bool hold(double value) const noexcept { return minimum <= value && value <= maximum; }
  // The value, or the limit that it lies beyond. Raises "Invalid procedure call or argument" for limits that
  // hold nothing.
  [[nodiscard]] double clamped(double value) const;
};

// Limits and how values within them are shown: (value - displayOffset) / displayScale.
struct EntryRange {
  bool defined = false;
  EntryLimits limits;
  double displayOffset = 0;
  double displayScale = 1;
  friend bool operator==(const EntryRange&, const EntryRange&) = default;
};

class EntryRanges {
 public:
  static constexpr std::int32_t kCount = 7;
  using Limits = std::array<std::optional<EntryLimits>, kCount>;

  // Null for an index outside 0 to 6.
  [[nodiscard]] EntryRange* find(std::int32_t index) noexcept {
    return index < 0 || index >= kCount ? nullptr : &ranges_[static_cast<std::size_t>(index)];
  }
  [[nodiscard]] const EntryRange* find(std::int32_t index) const noexcept {
    return index < 0 || index >= kCount ? nullptr : &ranges_[static_cast<std::size_t>(index)];
  }
  // The first defined range that holds the value.
  [[nodiscard]] std::optional<std::int32_t> firstHolding(double value) const noexcept;
  [[nodiscard]] std::optional<std::int32_t> firstDefined() const noexcept;

  // Whose limits are given is defined, any other range is not; how values are shown stays.
  [[nodiscard]] Limits limits() const noexcept;
  void limits(const Limits& limits) noexcept;

 private:
  std::array<EntryRange, kCount> ranges_;
};

// Reads the records of a host parameter into the limits that they give to the ranges named by their order.
// Answers what is wrong with them, empty when nothing is; `limits` then hold what they say. Raises what
// HostRecordSet raises.
[[nodiscard]] std::string_view readLimits(const HostRecordSet& records, EntryRanges::Limits& limits);

}  // namespace frontpanels

// How a numeric entry steps from value to value and which values it snaps to.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>

#include "entry/suffix_table.h"

namespace frontpanels {

enum class StepDirection : std::uint8_t { Down, Up };

// The mantissas of one decade, in any order and from any decade; entries that are not above 0 count for
// nothing. The next decade is `base` times as large.
struct StepSequence {
  static constexpr std::size_t kCapacity = 10;

  std::array<double, kCapacity> entries{};
  std::size_t length = 0;
  double base = 10;

  [[nodiscard]] bool defined() const noexcept { return length > 0; }
};

// The value of the sequence that is nearest on a logarithmic scale, at a tie the smaller one. Negative values
// go by their magnitude, 0 stays. Raises "Invalid procedure call or argument" for a sequence without a usable
// entry.
[[nodiscard]] double nearestInSequence(double value, const StepSequence& sequence);
// The next value of the sequence, or the one before. 0 lies in no decade: from there the first mantissa times
// `unit` is next. Raises the same, and "Overflow" where no double is left.
[[nodiscard]] double nextInSequence(double value, StepDirection direction, const StepSequence& sequence,
                                    double unit);

// By how much a shown number moves when nothing but its unit says so: by one of the unit that holds it. Going
// up, a record has its lower limit and not its upper one, going down the other way round; at a limit that
// ends one record and begins no other, the nearest record beyond it counts. A number that no record holds
// moves by the unit it is shown in, without units by 1.
[[nodiscard]] double suffixStep(double shown, StepDirection direction, const SuffixTable& suffixes) noexcept;

// The nearest multiple of a step, halves to the even one; the next one, and from between two the nearer
// beyond.
[[nodiscard]] double nearestMultiple(double value, double step) noexcept;
[[nodiscard]] double nextMultiple(double value, StepDirection direction, double step) noexcept;

}  // namespace frontpanels

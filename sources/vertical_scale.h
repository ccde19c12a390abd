// A vertical axis that fits the levels of a whole recording, so that its pictures compare.
#pragma once

#include <limits>
#include <optional>
#include <span>

namespace frontpanels {

// The smallest and the largest of the levels seen; empty until one was.
struct LevelRange {
  float lowestDb = std::numeric_limits<float>::infinity();
  float highestDb = -std::numeric_limits<float>::infinity();

  [[nodiscard]] bool isEmpty() const noexcept { return lowestDb > highestDb; }
  void add(std::span<const float> levelsDb) noexcept;  // gaps are passed over
};

inline constexpr int kVerticalDivisions = 10;

struct VerticalScale {
  double topDb = 0;
  double dbPerDivision = 10;
  friend bool operator==(const VerticalScale&, const VerticalScale&) = default;
};

// The smallest of 1, 2, 5, 10, 20, 50, ... dB a division, and the lowest top that is a whole number of
// divisions and above all levels, so that ten divisions hold them all. What to show nothing on is ten
// divisions of 10 dB below 0.
[[nodiscard]] VerticalScale verticalScaleFor(const LevelRange& range) noexcept;
// What is given stays, the other is the smallest, or the lowest, with which the lower end holds all levels.
// `dbPerDivision` is above 0.
[[nodiscard]] VerticalScale verticalScaleFor(const LevelRange& range, std::optional<double> topDb,
                                             std::optional<double> dbPerDivision) noexcept;

}  // namespace frontpanels

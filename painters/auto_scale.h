// Choosing a value axis for the data at hand.
#pragma once

#include <cstdint>

#include "painters/axis.h"

namespace frontpanels {

// Whether the data still fit the axis: the largest value lies between a thousandth and a fifth of the range
// below the top, the smallest as far above the bottom. The axis stays still while they do.
[[nodiscard]] bool axisFits(const ValueRange& axis, const ValueRange& data) noexcept;

struct FittedAxis {
  double top = 0;
  double perDivision = 0;
  friend bool operator==(const FittedAxis&, const FittedAxis&) = default;
};

// The axis of `divisions` (at least 1) steps of the 1-2-5 sequence of which the data fill 85 per cent, its
// top on a whole tenth of its length.
[[nodiscard]] FittedAxis axisFor(const ValueRange& data, std::int32_t divisions);

}  // namespace frontpanels

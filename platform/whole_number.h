// Whole-number conversions of the defined arithmetic: halves go to the even neighbour, a value outside the
// target width (a not-a-number included) raises "Overflow".
#pragma once

#include <cmath>
#include <cstdint>

#include "platform/runtime_error.h"

namespace frontpanels {

// Relies on the default floating-point environment (round to nearest, ties to even), which nothing here
// changes.
[[nodiscard]] inline double roundHalfEven(double value) noexcept { return std::nearbyint(value); }

// Whether the rounded value has a 32-bit representation: -2147483648.5 rounds to the even -2147483648 and
// fits, 2147483647.5 rounds up and does not.
[[nodiscard]] inline bool fitsInt32(double value) noexcept {
  return value >= -2147483648.5 && value < 2147483647.5;
}

// lrint is one instruction; where a long has 32 bits the check before it keeps the value inside them.
[[nodiscard]] inline std::int32_t toInt32(double value) {
  if (!fitsInt32(value)) raiseOverflow();
  return static_cast<std::int32_t>(std::lrint(value));
}

[[nodiscard]] inline std::int16_t toInt16(double value) {
  if (!(value >= -32768.5 && value < 32767.5)) raiseOverflow();
  return static_cast<std::int16_t>(std::lrint(value));
}

}  // namespace frontpanels

// The defined arithmetic of whole numbers: rounding and overflow of platform/whole_number.h, and sums.
#pragma once

#include <cstdint>

#include "platform/whole_number.h"

namespace frontpanels {

// 16-bit sum, as counters and marker numbers are kept.
[[nodiscard]] inline std::int16_t addInt16(std::int16_t a, std::int16_t b) {
  return toInt16(static_cast<double>(a) + static_cast<double>(b));
}

}  // namespace frontpanels

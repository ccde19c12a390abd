// The short code of CDMA pilots, and what a matched filter for a part of it makes of the whole.
#pragma once

#include <complex>
#include <cstdint>
#include <span>

#include "framework/support/enumerated_tables.h"

namespace frontpanels {

inline constexpr std::int32_t kPnOffsets = 512;
inline constexpr std::int32_t kChipsPerOffset = 64;
inline constexpr std::int32_t kShortCodeChips = kPnOffsets * kChipsPerOffset;
inline constexpr double kChipRateHz = 1.2288e6;

// Chips of a code format that make one PN offset, and the last one of its code.
[[nodiscard]] constexpr std::int32_t chipsOfOffset(std::int32_t codeFormat) noexcept {
  return codeFormat == kTripleRateCodeFormat ? 3 * kChipsPerOffset : kChipsPerOffset;
}
[[nodiscard]] constexpr double lastChip(std::int32_t codeFormat) noexcept {
  return codeFormat == kTripleRateCodeFormat ? 3.0 * (kShortCodeChips - 1) : kShortCodeChips - 1;
}

// One period, a chip a value, 0 or 1: the chips +1 and -1. It begins behind the only run of fifteen zeros.
enum class CodeBranch : std::uint8_t { InPhase, Quadrature };
[[nodiscard]] std::span<const std::uint8_t> shortCode(CodeBranch branch);

// The filter's chips: the first of the code. What is no pilot comes out of it by so much weaker.
inline constexpr std::int32_t kCorrelatedChips = 2048;

// What the filter gives of a pilot of power 1, by the chips that have gone by since the pilot's code began, 0
// to 32767; 1 at 0.
[[nodiscard]] std::span<const std::complex<float>> codeCorrelation();

}  // namespace frontpanels

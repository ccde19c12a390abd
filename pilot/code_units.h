// CDMA code positions. A PN offset counts 64 chips of the IS-95B code, or 192 chips of the triple-rate code;
// every other format counts the same chips as IS-95B.
#pragma once

#include <cstdint>

namespace frontpanels {

inline constexpr std::int32_t kPilotOffsets = 512;     // PN offsets of the short code: 0 to 511
inline constexpr std::int32_t kLastIs95BChip = 32767;  // of the short code's 512 x 64
inline constexpr std::int32_t kIs95BChipsPerPn = 64;
inline constexpr std::int32_t kTripleRateChipsPerPn = 192;

// From chips of a code format to IS-95B chips and back, to the nearest whole number, halves to even.
// Reported, and 0, where that has no 32 bits.
[[nodiscard]] std::int32_t CurrentToIS95BChips(std::int16_t codeFormat, std::int32_t chips) noexcept;
[[nodiscard]] std::int32_t IS95BToCurrentChips(std::int16_t codeFormat, std::int32_t is95BChips) noexcept;

// Chips of a format that make one PN offset.
[[nodiscard]] std::int32_t chipsPerPn(std::int16_t codeFormat) noexcept;

}  // namespace frontpanels

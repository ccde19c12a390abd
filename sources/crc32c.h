// The check over blocks of a capture: CRC-32C (Castagnoli), which finds every burst of damage up to 32 bits.
#pragma once

#include <cstdint>
#include <span>

namespace frontpanels {

// Of `bytes`, behind those that `before` is the check of.
[[nodiscard]] std::uint32_t crc32c(std::span<const char> bytes, std::uint32_t before = 0) noexcept;

}  // namespace frontpanels

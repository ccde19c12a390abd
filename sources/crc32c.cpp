#include "sources/crc32c.h"

#include <array>
#include <cstddef>

namespace frontpanels {
namespace {

constexpr std::uint32_t kReversedPolynomial = 0x82f63b78;
// Bytes taken in at once: a table for the distance of each from the last of them.
constexpr std::size_t kSlices = 8;

using Table = std::array<std::uint32_t, 256>;

constexpr std::array<Table, kSlices> makeTables() {
  std::array<Table, kSlices> tables{};
  for (std::uint32_t byte = 0; byte < 256; ++byte) {
    std::uint32_t value = byte;
    for (int bit = 0; bit < 8; ++bit) value = (value >> 1) ^ ((value & 1) != 0 ? kReversedPolynomial : 0);
    tables[0][byte] = value;
  }
  for (std::size_t slice = 1; slice < kSlices; ++slice)
    for (std::size_t byte = 0; byte < 256; ++byte) {
      const std::uint32_t nearer = tables[slice - 1][byte];
      tables[slice][byte] = (nearer >> 8) ^ tables[0][nearer & 0xff];
    }
  return tables;
}

constexpr std::array<Table, kSlices> kTables = makeTables();

}  // namespace

std::uint32_t crc32c(std::span<const char> bytes, std::uint32_t before) noexcept {
  std::uint32_t value = ~before;
  const auto byteAt = [&bytes](std::size_t at) {
    return std::uint32_t{static_cast<unsigned char>(bytes[at])};
  };
  for (; bytes.size() >= kSlices; bytes = bytes.subspan(kSlices)) {
    value ^= byteAt(0) | byteAt(1) << 8 | byteAt(2) << 16 | byteAt(3) << 24;
    value = kTables[7][value & 0xff] ^ kTables[6][value >> 8 & 0xff] ^ kTables[5][value >> 16 & 0xff] ^
            kTables[4][value >> 24] ^ kTables[3][byteAt(4)] ^ kTables[2][byteAt(5)] ^ kTables[1][byteAt(6)] ^
            kTables[0][byteAt(7)];
  }
  for (std::size_t at = 0; at < bytes.size(); ++at)
    value = (value >> 8) ^ kTables[0][(value ^ byteAt(at)) & 0xff];
  return ~value;
}

}  // namespace frontpanels

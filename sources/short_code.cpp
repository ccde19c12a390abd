#include "sources/short_code.h"

#include <array>
#include <bit>
#include <cstddef>
#include <vector>

namespace frontpanels {
namespace {

constexpr std::size_t kRegisterLength = 15;
constexpr std::size_t kChips = kShortCodeChips;
constexpr std::size_t kWordBits = 64;
constexpr std::size_t kWords = kCorrelatedChips / kWordBits;

using Code = std::array<std::uint8_t, kChips>;

// A chip is the sum of those so many before it. In-phase x^15+x^13+x^9+x^8+x^7+x^5+1, quadrature
// x^15+x^12+x^11+x^10+x^6+x^5+x^4+x^3+1: of a power p the chip 15 - p before.
constexpr std::size_t kInPhaseTaps[] = {15, 10, 8, 7, 6, 2};
constexpr std::size_t kQuadratureTaps[] = {15, 12, 11, 10, 9, 5, 4, 3};

// The register's only run of fourteen zeros ends it and gets one more.
Code generate(std::span<const std::size_t> taps) {
  std::array<std::uint8_t, kRegisterLength + kChips - 1> chips{};
  chips[0] = 1;
  for (std::size_t chip = kRegisterLength; chip < chips.size(); ++chip)
    for (const std::size_t tap : taps) chips[chip] = chips[chip] ^ chips[chip - tap];
  Code code{};
  for (std::size_t chip = 0; chip + 1 < kChips; ++chip) code[chip] = chips[kRegisterLength + chip];
  return code;
}

// Chips packed so that any run of 64 can be taken out.
class PackedCode {
 public:
  explicit PackedCode(std::span<const std::uint8_t> code)
      : words_((kChips + kCorrelatedChips) / kWordBits + 1) {
    for (std::size_t chip = 0; chip < kChips + kCorrelatedChips; ++chip)
      words_[chip / kWordBits] |= static_cast<std::uint64_t>(code[chip % kChips]) << (chip % kWordBits);
  }
  [[nodiscard]] std::uint64_t from(std::size_t chip) const noexcept {
    const std::size_t shift = chip % kWordBits;
    const std::uint64_t low = words_[chip / kWordBits] >> shift;
    return shift == 0 ? low : low | words_[chip / kWordBits + 1] << (kWordBits - shift);
  }

 private:
  std::vector<std::uint64_t> words_;
};

// Of chips +1 and -1: those that agree less those that do not.
std::int32_t product(const PackedCode& filter, const PackedCode& received, std::size_t chip) {
  int different = 0;
  for (std::size_t word = 0; word < kWords; ++word)
    different += std::popcount(filter.from(word * kWordBits) ^ received.from(chip + word * kWordBits));
  return kCorrelatedChips - 2 * different;
}

std::vector<std::complex<float>> correlate() {
  const PackedCode i(shortCode(CodeBranch::InPhase));
  const PackedCode q(shortCode(CodeBranch::Quadrature));
  constexpr float kScale = 1.0F / (2 * kCorrelatedChips);
  std::vector<std::complex<float>> result(kChips);
  for (std::size_t lag = 0; lag < kChips; ++lag) {
    const std::int32_t real = product(i, i, lag) + product(q, q, lag);
    const std::int32_t imaginary = product(i, q, lag) - product(q, i, lag);
    result[lag] = {static_cast<float>(real) * kScale, static_cast<float>(imaginary) * kScale};
  }
  return result;
}

}  // namespace

std::span<const std::uint8_t> shortCode(CodeBranch branch) {
  static const Code inPhase = generate(kInPhaseTaps);
  static const Code quadrature = generate(kQuadratureTaps);
  return branch == CodeBranch::InPhase ? inPhase : quadrature;
}

std::span<const std::complex<float>> codeCorrelation() {
  static const std::vector<std::complex<float>> correlation = correlate();
  return correlation;
}

}  // namespace frontpanels

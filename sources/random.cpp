#include "sources/random.h"

#include <cmath>

#include "sources/portable_math.h"

namespace frontpanels {
namespace {

constexpr std::uint64_t kGolden = 0x9e3779b97f4a7c15U;
constexpr double kUniformStep = 1.0 / 9007199254740992.0;  // 2^-53
constexpr std::int32_t kDrawnOneByOne = 8;

// The finalizer of SplitMix64.
std::uint64_t mixed(std::uint64_t value) noexcept {
  value = (value ^ (value >> 30U)) * 0xbf58476d1ce4e5b9U;
  value = (value ^ (value >> 27U)) * 0x94d049bb133111ebU;
  return value ^ (value >> 31U);
}

}  // namespace

Random::Random(std::uint64_t seed, std::uint64_t purpose, std::uint64_t index, std::uint64_t index2) noexcept
    : state_(mixed(mixed(mixed(mixed(seed + kGolden) + purpose) + index) + index2)) {}

std::uint64_t Random::bits() noexcept {
  state_ += kGolden;
  return mixed(state_);
}

double Random::uniform() noexcept { return (static_cast<double>(bits() >> 11U) + 0.5) * kUniformStep; }

double Random::exponential() noexcept { return -portableLog(uniform()); }

double Random::normal() noexcept {
  const double length = std::sqrt(2 * exponential());
  return length * portableTurn(uniform()).real();
}

// Of many, by rejection (Marsaglia and Tsang).
double Random::gamma(std::int32_t count) noexcept {
  if (count <= kDrawnOneByOne) {
    double product = 1;
    for (std::int32_t i = 0; i < count; ++i) product *= uniform();
    return count <= 0 ? 0 : -portableLog(product);
  }
  const double d = count - 1.0 / 3;
  const double c = 1 / std::sqrt(9 * d);
  for (;;) {
    const double x = normal();
    const double root = 1 + c * x;
    if (root <= 0) continue;
    const double v = root * root * root;
    if (portableLog(uniform()) < x * x / 2 + d - d * v + d * portableLog(v)) return d * v;
  }
}

}  // namespace frontpanels

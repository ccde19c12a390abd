#include "sources/code_profile.h"

#include <algorithm>
#include <array>
#include <cmath>

#include "sources/portable_math.h"
#include "sources/random.h"

namespace frontpanels {
namespace {

constexpr std::uint64_t kNoisePurpose = 20;
constexpr std::size_t kBlock = kChipsPerOffset;
constexpr std::size_t kDirections = 1024;
// Weaker rays have no side lobes to be seen, and far weaker ones are not there at all.
constexpr float kWithSideLobes = 0.01F;
constexpr float kNearByOnly = 1e-6F;

double wrapped(double chips) { return chips - kShortCodeChips * std::floor(chips / kShortCodeChips); }

}  // namespace

CodeProfile::CodeProfile(std::uint64_t seed)
    : seed_(seed), correlation_(codeCorrelation()), noises_(kShortCodeChips), levels_(kShortCodeChips) {
  for (std::size_t i = 0; i < kDirections; ++i)
    units_.emplace_back(portableTurn(static_cast<double>(i) / static_cast<double>(kDirections)));
}

void CodeProfile::begin(std::uint64_t frame, std::span<const CodeRay> rays, double noise) {
  frame_ = frame;
  rays_ = rays;
  noise_ = static_cast<float>(noise);
  filled_.reset();
}

bool CodeProfile::reaches(const CodeRay& ray, double fromChips, double toChips) const {
  const float power = std::norm(ray.amplitude);
  if (power >= kWithSideLobes) return true;
  return power >= kNearByOnly && wrapped(ray.chips - fromChips + 1) <= toChips - fromChips + 2;
}

// At chips one behind the other. A ray is as wide as a chip: between whole chips the correlation is straight.
// Real numbers, as the product of complex ones looks for infinities.
void CodeProfile::addSignal(const CodeRay& ray, double firstChips,
                            std::span<std::complex<float>> sums) const {
  const double away = wrapped(firstChips - ray.chips);
  const double whole = std::floor(away);
  const auto part = static_cast<float>(away - whole);
  const float real = ray.amplitude.real();
  const float imaginary = ray.amplitude.imag();
  std::size_t lag = static_cast<std::size_t>(whole) % kShortCodeChips;
  std::complex<float> from = correlation_[lag];
  for (std::complex<float>& sum : sums) {
    lag = (lag + 1) % kShortCodeChips;
    const std::complex<float> to = correlation_[lag];
    const float x = from.real() + part * (to.real() - from.real());
    const float y = from.imag() + part * (to.imag() - from.imag());
    sum += std::complex<float>(real * x - imaginary * y, real * y + imaginary * x);
    from = to;
  }
}

// The passes add up to one that has all of the signal and to others that have none of it.
float CodeProfile::level(std::complex<float> signal, const Noise& noise) const {
  const float real = signal.real() + std::sqrt(noise_ / kPasses) * noise.amplitude.real();
  const float imaginary = signal.imag() + std::sqrt(noise_ / kPasses) * noise.amplitude.imag();
  return std::min(real * real + imaginary * imaginary + noise_ / kPasses * noise.power, 1.0F);
}

void CodeProfile::fill(std::size_t block) {
  Random random(seed_, kNoisePurpose, frame_, block);
  const std::size_t first = block * kBlock;
  std::array<std::complex<float>, kBlock> sums{};
  for (const CodeRay& ray : rays_)
    if (reaches(ray, static_cast<double>(first), static_cast<double>(first + kBlock)))
      addSignal(ray, static_cast<double>(first), sums);
  for (std::size_t i = 0; i < kBlock; ++i) {
    const auto length = static_cast<float>(std::sqrt(random.exponential()));
    const std::complex<float> direction = units_[random.bits() % kDirections];
    Noise& noise = noises_[first + i];
    noise.amplitude = {length * direction.real(), length * direction.imag()};
    noise.power = static_cast<float>(random.gamma(kPasses - 1));
    levels_[first + i] = level(sums[i], noise);
  }
  filled_.set(block);
}

const CodeProfile::Noise& CodeProfile::noiseAt(std::size_t chip) {
  const std::size_t index = chip % kShortCodeChips;
  if (!filled_.test(index / kBlock)) fill(index / kBlock);
  return noises_[index];
}

// Noise is as strong between the chips.
float CodeProfile::level(double chips) {
  const double at = wrapped(chips);
  const auto chip = static_cast<std::size_t>(at);
  const auto part = static_cast<float>(at - std::floor(at));
  const Noise& from = noiseAt(chip);
  const Noise& to = noiseAt(chip + 1);
  const float rest = 1 - part;
  const float length = std::sqrt(rest * rest + part * part);
  const Noise between{{(from.amplitude.real() * rest + to.amplitude.real() * part) / length,
                       (from.amplitude.imag() * rest + to.amplitude.imag() * part) / length},
                      from.power * rest + to.power * part};
  std::complex<float> sum;
  for (const CodeRay& ray : rays_)
    if (reaches(ray, at, at)) addSignal(ray, at, {&sum, 1});
  return level(sum, between);
}

CodeProfile::Peak CodeProfile::peak(double fromChips, double toChips) {
  Peak peak{fromChips, 0};
  const auto take = [&peak](double chips, float level) {
    if (level > peak.level) peak = {chips, level};
  };
  const auto end = static_cast<std::size_t>(std::clamp(std::ceil(toChips), 0.0, double{kShortCodeChips}));
  for (auto chip = static_cast<std::size_t>(std::max(std::ceil(fromChips), 0.0)); chip < end; ++chip) {
    if (!filled_.test(chip / kBlock)) fill(chip / kBlock);
    take(static_cast<double>(chip), levels_[chip]);
  }
  for (const CodeRay& ray : rays_)
    if (ray.chips >= fromChips && ray.chips < toChips && std::norm(ray.amplitude) >= kNearByOnly)
      take(ray.chips, level(ray.chips));
  return peak;
}

}  // namespace frontpanels

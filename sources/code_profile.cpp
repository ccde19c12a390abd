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
    : seed_(seed), correlation_(codeCorrelation()), noise_(kShortCodeChips), levels_(kShortCodeChips) {
  for (std::size_t i = 0; i < kDirections; ++i)
    units_.emplace_back(portableTurn(static_cast<double>(i) / static_cast<double>(kDirections)));
}

void CodeProfile::begin(std::uint64_t frame, std::span<const CodeRay> rays, double noise) {
  frame_ = frame;
  rays_ = rays;
  noiseAmplitude_ = static_cast<float>(std::sqrt(noise));
  filled_.reset();
}

// A ray of a chip's width: between whole chips the correlation is straight.
std::complex<float> CodeProfile::signal(const CodeRay& ray, double chips) const {
  const double away = wrapped(chips - ray.chips);
  const double whole = std::floor(away);
  const auto part = static_cast<float>(away - whole);
  const std::size_t lag = static_cast<std::size_t>(whole) % kShortCodeChips;
  const std::complex<float> from = correlation_[lag];
  const std::complex<float> to = correlation_[(lag + 1) % kShortCodeChips];
  return ray.amplitude * (from * (1 - part) + to * part);
}

bool CodeProfile::reaches(const CodeRay& ray, double fromChips, double toChips) const {
  const float power = std::norm(ray.amplitude);
  if (power >= kWithSideLobes) return true;
  return power >= kNearByOnly && wrapped(ray.chips - fromChips + 1) <= toChips - fromChips + 2;
}

void CodeProfile::fill(std::size_t block) {
  Random random(seed_, kNoisePurpose, frame_, block);
  const std::size_t first = block * kBlock;
  std::array<std::complex<float>, kBlock> sums{};
  for (const CodeRay& ray : rays_) {
    if (!reaches(ray, static_cast<double>(first), static_cast<double>(first + kBlock))) continue;
    for (std::size_t i = 0; i < kBlock; ++i) sums[i] += signal(ray, static_cast<double>(first + i));
  }
  for (std::size_t i = 0; i < kBlock; ++i) {
    const auto length = static_cast<float>(std::sqrt(random.exponential()));
    noise_[first + i] = noiseAmplitude_ * length * units_[random.bits() % kDirections];
    levels_[first + i] = std::norm(sums[i] + noise_[first + i]);
  }
  filled_.set(block);
}

std::complex<float> CodeProfile::noiseAt(std::int32_t chip) {
  const std::size_t index = static_cast<std::size_t>(chip) % kShortCodeChips;
  if (!filled_.test(index / kBlock)) fill(index / kBlock);
  return noise_[index];
}

// Noise is as strong between the chips.
float CodeProfile::level(double chips) {
  const double at = wrapped(chips);
  const auto chip = static_cast<std::int32_t>(at);
  const auto part = static_cast<float>(at - chip);
  const std::complex<float> from = noiseAt(chip);
  const std::complex<float> to = noiseAt(chip + 1);
  std::complex<float> sum =
      (from * (1 - part) + to * part) / std::sqrt((1 - part) * (1 - part) + part * part);
  for (const CodeRay& ray : rays_)
    if (reaches(ray, at, at)) sum += signal(ray, at);
  return std::min(std::norm(sum), 1.0F);
}

CodeProfile::Peak CodeProfile::peak(double fromChips, double toChips) {
  Peak peak{fromChips, 0};
  const auto take = [&peak](double chips, float level) {
    if (level > peak.level) peak = {chips, level};
  };
  const auto end = static_cast<std::size_t>(std::clamp(std::ceil(toChips), 0.0, double{kShortCodeChips}));
  for (auto chip = static_cast<std::size_t>(std::max(std::ceil(fromChips), 0.0)); chip < end; ++chip) {
    if (!filled_.test(chip / kBlock)) fill(chip / kBlock);
    take(static_cast<double>(chip), std::min(levels_[chip], 1.0F));
  }
  for (const CodeRay& ray : rays_)
    if (ray.chips >= fromChips && ray.chips < toChips && std::norm(ray.amplitude) >= kNearByOnly)
      take(ray.chips, level(ray.chips));
  return peak;
}

}  // namespace frontpanels

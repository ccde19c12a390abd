#include "sources/noisy_power.h"

#include <algorithm>
#include <cmath>

#include "sources/portable_math.h"

namespace frontpanels {
namespace {

constexpr std::int32_t kLooksOneByOne = 8;
constexpr std::int32_t kMostHeldLooks = 64;
constexpr double kEulerGamma = 0.577215664901532861;
constexpr double kVarianceOfLog = 1.644934066848226436;  // of an exponential variable: pi squared / 6

// The power of a steady amplitude and one of normal real and imaginary parts, their mean power 1.
double oneLook(Random& random, double steady) noexcept {
  const double noise = random.exponential();
  const double phase = portableTurn(random.uniform()).real();
  return steady + noise + 2 * std::sqrt(steady * noise) * phase;
}

// The looks add up to one at all of the steady power and to noise that has nothing of it.
double meanOfLooks(Random& random, double steady, std::int32_t looks) noexcept {
  const double first = oneLook(random, steady * looks);
  return (first + random.gamma(looks - 1)) / looks;
}

// ln(x) + E1(x), by the approximations 5.1.53 and 5.1.56 of Abramowitz and Stegun: the mean of the logarithm
// of a look (J. I. Marcum). What it has at 0 is the -2.5 dB of averaged noise.
double meanOfLog(double steady) noexcept {
  if (steady <= 1) {
    constexpr double kSeries[] = {-kEulerGamma, 0.99999193, -0.24991055, 0.05519968, -0.00976004, 0.00107857};
    double sum = 0;
    for (int power = 5; power >= 0; --power) sum = sum * steady + kSeries[power];
    return sum;
  }
  const double above = steady * steady + 2.334733 * steady + 0.250621;
  const double below = steady * steady + 3.330657 * steady + 1.681534;
  return portableLog(steady) + portableExp(-steady) / steady * above / below;
}

// Of few looks themselves; of many the mean is normal, its variance between those of noise alone and of a
// carrier far above it.
double meanOfLogs(Random& random, double steady, std::int32_t looks) noexcept {
  if (looks > kLooksOneByOne) {
    const double variance = kVarianceOfLog / (1 + steady * kVarianceOfLog / 2);
    return portableExp(meanOfLog(steady) + random.normal() * std::sqrt(variance / looks));
  }
  double sum = 0;
  for (std::int32_t look = 0; look < looks; ++look) sum += portableLog(oneLook(random, steady));
  return portableExp(sum / looks);
}

// Of noise alone by the distribution of the largest one.
double largest(Random& random, double steady, std::int32_t looks) noexcept {
  if (steady == 0) return -portableLog(1 - portableExp(-random.exponential() / looks));
  double result = 0;
  for (std::int32_t look = 0; look < std::min(looks, kMostHeldLooks); ++look)
    result = std::max(result, oneLook(random, steady));
  return result;
}

double smallest(Random& random, double steady, std::int32_t looks) noexcept {
  if (steady == 0) return random.exponential() / looks;
  double result = oneLook(random, steady);
  for (std::int32_t look = 1; look < std::min(looks, kMostHeldLooks); ++look)
    result = std::min(result, oneLook(random, steady));
  return result;
}

}  // namespace

double measuredPower(Random& random, double steady, double noise, Averaging averaging,
                     std::int32_t looks) noexcept {
  const double share = steady / noise;
  switch (averaging) {
    case Averaging::Power:
      return noise * meanOfLooks(random, share, looks);
    case Averaging::LogPower:
      return noise * meanOfLogs(random, share, looks);
    case Averaging::Largest:
      return noise * largest(random, share, looks);
    case Averaging::Smallest:
      break;
  }
  return noise * smallest(random, share, looks);
}

}  // namespace frontpanels

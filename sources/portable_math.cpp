#include "sources/portable_math.h"

#include <array>
#include <cmath>
#include <cstddef>

namespace frontpanels {
namespace {

constexpr double kPi = 3.14159265358979324;
constexpr double kSqrtHalf = 0.707106781186547524;
// ln(2) in two parts: the upper one has so few digits that a whole number of them is exact.
constexpr double kLn2High = 0.693147180369123816;
constexpr double kLn2Low = 1.90821492927058770e-10;
constexpr double kLeastExponent = -700;
constexpr double kLeastRatio = 1e-30;

// Coefficients of series, by the power of their variable: divisions would take most of the time.
constexpr std::size_t kTerms = 15;
constexpr std::array<double, kTerms> kOddReciprocals = [] {
  std::array<double, kTerms> values{};
  for (std::size_t i = 0; i < kTerms; ++i) values[i] = 1.0 / static_cast<double>(2 * i + 1);
  return values;
}();
constexpr std::array<double, 2 * kTerms> kFactorialReciprocals = [] {
  std::array<double, 2 * kTerms> values{};
  double factorial = 1;
  for (std::size_t i = 0; i < values.size(); ++i) {
    values[i] = 1 / factorial;
    factorial *= static_cast<double>(i + 1);
  }
  return values;
}();

}  // namespace

// ln(m * 2^k) = k ln 2 + 2 artanh((m - 1) / (m + 1)), m within a factor of sqrt(2) of 1.
double portableLog(double value) noexcept {
  constexpr std::size_t kUsed = 11;
  int exponent = 0;
  double mantissa = std::frexp(value, &exponent);
  if (mantissa < kSqrtHalf) {
    mantissa *= 2;
    --exponent;
  }
  const double s = (mantissa - 1) / (mantissa + 1);
  const double square = s * s;
  double sum = 0;
  for (std::size_t term = kUsed; term-- > 0;) sum = sum * square + kOddReciprocals[term];
  return exponent * kLn2High + (exponent * kLn2Low + 2 * s * sum);
}

double portableExp(double value) noexcept {
  if (!(value > kLeastExponent)) return 0;
  const double twos = std::nearbyint(value / (kLn2High + kLn2Low));
  const double rest = (value - twos * kLn2High) - twos * kLn2Low;
  constexpr std::size_t kUsed = 14;
  double sum = 0;
  for (std::size_t term = kUsed; term-- > 0;) sum = sum * rest + kFactorialReciprocals[term];
  return std::ldexp(sum, static_cast<int>(twos));
}

std::complex<double> portableTurn(double turns) noexcept {
  const double quarters = std::nearbyint(turns * 4);
  const double x = (turns * 4 - quarters) * (kPi / 2);
  const double square = x * x;
  constexpr std::size_t kUsed = 9;
  double cosine = 0;
  double sine = 0;
  for (std::size_t term = kUsed; term-- > 0;) {
    cosine = kFactorialReciprocals[2 * term] - square * cosine;
    sine = kFactorialReciprocals[2 * term + 1] - square * sine;
  }
  sine *= x;
  const double quarter = quarters - 4 * std::floor(quarters / 4);
  if (quarter == 0) return {cosine, sine};
  if (quarter == 1) return {-sine, cosine};
  if (quarter == 2) return {-cosine, -sine};
  return {sine, -cosine};
}

double toDecibels(double ratio) noexcept {
  return portableLog(ratio > kLeastRatio ? ratio : kLeastRatio) / kNepersPerDecibel;
}

double fromDecibels(double decibels) noexcept { return portableExp(decibels * kNepersPerDecibel); }

}  // namespace frontpanels

#include "sources/portable_math.h"

#include <cmath>
#include <iterator>

namespace frontpanels {
namespace {

constexpr double kPi = 3.14159265358979324;
constexpr double kSqrtHalf = 0.707106781186547524;
// ln(2) in two parts: the upper one has so few digits that a whole number of them is exact.
constexpr double kLn2High = 0.693147180369123816;
constexpr double kLn2Low = 1.90821492927058770e-10;
constexpr double kLeastExponent = -700;
constexpr double kLeastRatio = 1e-30;

// The Taylor series of exp, cos and sin, by the power of their variable.
constexpr int kExpTerms = 14;
constexpr int kTurnTerms = 9;

}  // namespace

// ln(m * 2^k) = k ln 2 + 2 artanh((m - 1) / (m + 1)), m within a factor of sqrt(2) of 1.
double portableLog(double value) noexcept {
  constexpr int kTerms = 11;
  int exponent = 0;
  double mantissa = std::frexp(value, &exponent);
  if (mantissa < kSqrtHalf) {
    mantissa *= 2;
    --exponent;
  }
  const double s = (mantissa - 1) / (mantissa + 1);
  const double square = s * s;
  double sum = 0;
  for (int term = kTerms - 1; term >= 0; --term) sum = sum * square + 1.0 / (2 * term + 1);
  return exponent * kLn2High + (exponent * kLn2Low + 2 * s * sum);
}

double portableExp(double value) noexcept {
  if (!(value > kLeastExponent)) return 0;
  const double twos = std::nearbyint(value / (kLn2High + kLn2Low));
  const double rest = (value - twos * kLn2High) - twos * kLn2Low;
  double sum = 1;
  for (int term = kExpTerms; term >= 1; --term) sum = 1 + sum * rest / term;
  return std::ldexp(sum, static_cast<int>(twos));
}

std::complex<double> portableTurn(double turns) noexcept {
  const double quarters = std::nearbyint(turns * 4);
  const double x = (turns * 4 - quarters) * (kPi / 2);
  const double square = x * x;
  double cosine = 1;
  double sine = 1;
  for (int term = kTurnTerms; term >= 1; --term) {
    cosine = 1 - cosine * square / ((2 * term - 1) * (2 * term));
    sine = 1 - sine * square / ((2 * term) * (2 * term + 1));
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

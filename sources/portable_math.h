// Logarithm, exponential and cosine in operations that every machine rounds alike: the libraries of two
// systems differ in the last bit of theirs. Good to a few parts in 1e15.
#pragma once

#include <complex>

namespace frontpanels {

// Of a finite value above 0.
[[nodiscard]] double portableLog(double value) noexcept;
// 0 below what a double can hold; of up to 700.
[[nodiscard]] double portableExp(double value) noexcept;
// Cosine and sine of an angle in turns.
[[nodiscard]] std::complex<double> portableTurn(double turns) noexcept;

inline constexpr double kNepersPerDecibel = 0.23025850929940457;  // ln(10) / 10

// Of powers: -300 dB for what is less, nothing included.
[[nodiscard]] double toDecibels(double ratio) noexcept;
[[nodiscard]] double fromDecibels(double decibels) noexcept;

}  // namespace frontpanels

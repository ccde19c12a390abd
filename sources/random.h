// Random numbers that are a function of what they are for: a seed, a purpose and up to two indices. Nothing
// has to be drawn in order, so any moment of a simulation can be had at once.
#pragma once

#include <complex>
#include <cstdint>

namespace frontpanels {

class Random {
 public:
  Random(std::uint64_t seed, std::uint64_t purpose, std::uint64_t index = 0,
         std::uint64_t index2 = 0) noexcept;

  [[nodiscard]] std::uint64_t bits() noexcept;
  [[nodiscard]] double uniform() noexcept;      // between 0 and 1, neither included
  [[nodiscard]] double exponential() noexcept;  // of mean 1
  [[nodiscard]] double normal() noexcept;       // of mean 0, variance 1
  // The sum of `count` exponential ones; 0 of none.
  [[nodiscard]] double gamma(std::int32_t count) noexcept;

 private:
  std::uint64_t state_;
};

}  // namespace frontpanels

// The largest and smallest value of a trace and where they are.
#pragma once

#include <cmath>
#include <cstdint>
#include <span>

namespace frontpanels {

// Indices are doubles, as hosts read them; the first of equal values counts. Values that are not finite are
// passed over: where there is no other, `found` stays false.
struct MinMax {
  double maximum = 0;
  double minimum = 0;
  double maximumIndex = 0;
  double minimumIndex = 0;
  bool found = false;
  friend bool operator==(const MinMax&, const MinMax&) = default;

  void consider(double value, std::int32_t index) noexcept {
    if (!std::isfinite(value)) return;
    if (!found || value > maximum) {
      maximum = value;
      maximumIndex = index;
    }
    if (!found || value < minimum) {
      minimum = value;
      minimumIndex = index;
    }
    found = true;
  }
};

template <class T>
[[nodiscard]] MinMax minMaxOf(std::span<const T> values) noexcept {
  MinMax result;
  for (std::size_t i = 0; i < values.size(); ++i) {
    result.consider(static_cast<double>(values[i]), static_cast<std::int32_t>(i));
  }
  return result;
}

}  // namespace frontpanels

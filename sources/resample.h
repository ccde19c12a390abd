// Brings a sweep to the points that the spectrum panel shows.
#pragma once

#include <array>
#include <cstddef>
#include <span>

#include "sources/sweep.h"

namespace frontpanels {

// As many values as the panel takes at once.
inline constexpr std::size_t kDisplayValues = 513;
// Of n values the panel spreads n - 1 over the graph's width and puts the last beyond its right edge. The
// last value is therefore always a gap, and the sweep has the others.
inline constexpr std::size_t kDisplayCells = kDisplayValues - 1;

struct DisplaySweep {
  double centerHz = 0;  // of the range from the first bin at the left edge to the last bin at the right edge
  double spanHz = 0;
  std::array<float, kDisplayValues> values{};  // dB; gaps are not-a-number
  std::size_t count = 0;  // of `values`, the closing gap included; 0 for a sweep without bins

  [[nodiscard]] std::span<const float> shown() const noexcept { return {values.data(), count}; }
};

// Up to 512 bins are shown one for one. More are shared out among 512 cells, half-open stretches of bins, and
// the largest level of a cell stands for it: a narrow carrier never vanishes, and it appears less than one
// cell's width from its frequency. A cell is a gap where all of its bins are. Allocates nothing.
void resample(const Sweep& sweep, DisplaySweep& display) noexcept;

}  // namespace frontpanels

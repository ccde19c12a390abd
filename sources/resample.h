// Brings a sweep, or a part of its frequencies, to the points that the spectrum panel shows.
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

// From `centerHz - spanHz / 2` at the graph's left edge to `centerHz + spanHz / 2` at its right edge.
struct FrequencyRange {
  double centerHz = 0;
  double spanHz = 0;

  friend bool operator==(const FrequencyRange&, const FrequencyRange&) = default;
};

// From the first bin to the last; a bin alone has one bin's width. Nothing for a sweep without bins.
[[nodiscard]] FrequencyRange rangeOf(const Sweep& sweep) noexcept;

struct DisplaySweep {
  FrequencyRange range;
  std::array<float, kDisplayValues> values{};  // dB; gaps are not-a-number
  std::size_t count = 0;  // of `values`, the closing gap included; 0 for a sweep without bins

  [[nodiscard]] std::span<const float> shown() const noexcept { return {values.data(), count}; }
};

// Cells lie evenly from edge to edge, no further apart than the bins and at most 512 of them. The largest
// level of the bins nearest to a cell stands for it: a narrow carrier never vanishes, and it appears no
// further than half a cell from its frequency. A cell between two bins shows the nearer one; a cell is a gap
// where all of its bins are, and outside the sweep. The range's span is above 0. Allocates nothing.
void resample(const Sweep& sweep, const FrequencyRange& range, DisplaySweep& display) noexcept;
// The whole sweep: up to 512 bins are shown one for one.
void resample(const Sweep& sweep, DisplaySweep& display) noexcept;

}  // namespace frontpanels

#include "sources/resample.h"

#include <algorithm>
#include <cstdint>

namespace frontpanels {
namespace {

float largest(std::span<const float> levels) noexcept {
  float result = kGap;
  for (const float level : levels) result = largerLevel(result, level);
  return result;
}

}  // namespace

void resample(const Sweep& sweep, DisplaySweep& display) noexcept {
  const std::span<const float> levels(sweep.levelsDb);
  const std::uint64_t bins = levels.size();
  const std::uint64_t cells = std::min<std::uint64_t>(bins, kDisplayCells);
  for (std::uint64_t cell = 0; cell < cells; ++cell) {
    const std::uint64_t first = cell * bins / cells;
    const std::uint64_t end = (cell + 1) * bins / cells;
    display.values[cell] = largest(levels.subspan(first, end - first));
  }
  display.count = cells;
  if (bins == 0) return;
  // One bin alone is drawn as a level line one bin wide.
  if (bins == 1) display.values[display.count++] = display.values[0];
  display.values[display.count++] = kGap;
  display.spanHz = sweep.stepHz * static_cast<double>(std::max<std::uint64_t>(bins - 1, 1));
  display.centerHz = sweep.startHz + display.spanHz / 2;
}

}  // namespace frontpanels

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
  const std::size_t bins = levels.size();
  const std::size_t cells = std::min(bins, kDisplayCells);
  // In 64 bits: cell times bins outgrows a 32-bit std::size_t.
  const auto firstBin = [bins, cells](std::size_t cell) {
    return static_cast<std::size_t>(std::uint64_t{cell} * bins / cells);
  };
  for (std::size_t cell = 0; cell < cells; ++cell) {
    const std::size_t first = firstBin(cell);
    const std::size_t end = firstBin(cell + 1);
    display.values[cell] = largest(levels.subspan(first, end - first));
  }
  display.count = cells;
  if (bins == 0) return;
  // One bin alone is drawn as a level line one bin wide.
  if (bins == 1) display.values[display.count++] = display.values[0];
  display.values[display.count++] = kGap;
  display.spanHz = sweep.stepHz * static_cast<double>(std::max<std::size_t>(bins - 1, 1));
  display.centerHz = sweep.startHz + display.spanHz / 2;
}

}  // namespace frontpanels

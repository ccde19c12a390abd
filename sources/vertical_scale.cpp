#include "sources/vertical_scale.h"

#include <algorithm>
#include <cmath>

namespace frontpanels {

void LevelRange::add(std::span<const float> levelsDb) noexcept {
  for (const float level : levelsDb) {
    if (std::isnan(level)) continue;
    lowestDb = std::min(lowestDb, level);
    highestDb = std::max(highestDb, level);
  }
}

VerticalScale verticalScaleFor(const LevelRange& range) noexcept {
  if (range.isEmpty()) return {};
  for (double decade = 1;; decade *= 10) {
    for (const double unit : {1.0, 2.0, 5.0}) {
      const double step = unit * decade;
      const double top = (std::floor(static_cast<double>(range.highestDb) / step) + 1) * step;
      if (top - kVerticalDivisions * step <= static_cast<double>(range.lowestDb)) return {top, step};
    }
  }
}

}  // namespace frontpanels

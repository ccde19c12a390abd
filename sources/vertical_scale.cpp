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
  return verticalScaleFor(range, std::nullopt, std::nullopt);
}

VerticalScale verticalScaleFor(const LevelRange& range, std::optional<double> topDb,
                               std::optional<double> dbPerDivision) noexcept {
  constexpr VerticalScale kUsual;
  if (range.isEmpty()) return {topDb.value_or(kUsual.topDb), dbPerDivision.value_or(kUsual.dbPerDivision)};
  const auto topFor = [&](double step) {
    return topDb.value_or((std::floor(static_cast<double>(range.highestDb) / step) + 1) * step);
  };
  if (dbPerDivision) return {topFor(*dbPerDivision), *dbPerDivision};
  for (double decade = 1;; decade *= 10) {
    for (const double unit : {1.0, 2.0, 5.0}) {
      const double step = unit * decade;
      const double top = topFor(step);
      if (top - kVerticalDivisions * step <= static_cast<double>(range.lowestDb)) return {top, step};
    }
  }
}

}  // namespace frontpanels

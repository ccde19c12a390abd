#include "sources/resample.h"

#include <algorithm>
#include <cmath>

namespace frontpanels {
namespace {

// What a range of a whole number of bins may be off by, in bins, after it was brought through decimal
// fractions.
constexpr double kSlackBins = 1e-6;

float largest(std::span<const float> levels) noexcept {
  float result = kGap;
  for (const float level : levels) result = largerLevel(result, level);
  return result;
}

// Places are counted in bins from the first one; what lies outside is cut off.
class Cells {
 public:
  Cells(const Sweep& sweep, const FrequencyRange& range) noexcept
      : levels_(sweep.levelsDb),
        firstBin_((range.centerHz - range.spanHz / 2 - sweep.startHz) / sweep.stepHz),
        spanBins_(range.spanHz / sweep.stepHz),
        count_(static_cast<std::size_t>(
            std::clamp(std::ceil(spanBins_ - kSlackBins) + 1, 2.0, static_cast<double>(kDisplayCells)))),
        pitchBins_(spanBins_ / static_cast<double>(count_ - 1)) {}

  [[nodiscard]] std::size_t count() const noexcept { return count_; }
  [[nodiscard]] float level(std::size_t cell) const noexcept {
    const double from = std::ceil(border(cell));
    const double to = std::ceil(border(cell + 1));
    if (from < to) return between(from, to);
    const double nearest = std::floor(firstBin_ + static_cast<double>(cell) * pitchBins_ + 0.5);
    return between(nearest, nearest + 1);
  }

 private:
  // Halfway to the cell before. Neighbours share it to the last bit, so that no bin falls between them. The
  // outermost reach half a bin over the edge, as a bin has its width.
  [[nodiscard]] double border(std::size_t cell) const noexcept {
    const double place = firstBin_ + (static_cast<double>(cell) - 0.5) * pitchBins_;
    return std::clamp(place, firstBin_ - 0.5, firstBin_ + spanBins_ + 0.5);
  }
  [[nodiscard]] float between(double from, double to) const noexcept {
    // Unlike std::clamp these take in a place that is no number: steps too small for the range make one.
    const auto bin = [this](double place) {
      return static_cast<std::size_t>(std::fmin(std::fmax(place, 0.0), static_cast<double>(levels_.size())));
    };
    return largest(levels_.subspan(bin(from), bin(to) - bin(from)));
  }

  std::span<const float> levels_;
  double firstBin_;
  double spanBins_;
  std::size_t count_;
  double pitchBins_;
};

}  // namespace

FrequencyRange rangeOf(const Sweep& sweep) noexcept {
  if (sweep.levelsDb.empty()) return {};
  const double spanHz =
      sweep.stepHz * static_cast<double>(std::max<std::size_t>(sweep.levelsDb.size() - 1, 1));
  return {sweep.startHz + spanHz / 2, spanHz};
}

void resample(const Sweep& sweep, const FrequencyRange& range, DisplaySweep& display) noexcept {
  display.range = range;
  display.count = 0;
  if (sweep.levelsDb.empty()) return;
  const Cells cells(sweep, range);
  for (; display.count < cells.count(); ++display.count)
    display.values[display.count] = cells.level(display.count);
  display.values[display.count++] = kGap;
}

void resample(const Sweep& sweep, DisplaySweep& display) noexcept {
  resample(sweep, rangeOf(sweep), display);
  // One bin alone is drawn as a level line one bin wide.
  if (sweep.levelsDb.size() == 1) display.values[1] = display.values[0];
}

}  // namespace frontpanels

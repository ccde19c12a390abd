// One sweep of a receiver: a level for each bin of a frequency range.
#pragma once

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>
#include <string>
#include <vector>

namespace frontpanels {

// A level that was not received. It breaks the drawn line and is never a peak.
inline constexpr float kGap = std::numeric_limits<float>::quiet_NaN();

// The larger of two levels; a gap only when both are.
[[nodiscard]] inline float largerLevel(float a, float b) noexcept { return b > a || std::isnan(a) ? b : a; }

struct Sweep {
  std::uint64_t number = 0;     // counted from 1 within its recording
  std::string time;             // date and time of its first row, as the recording words them
  double startHz = 0;           // of the first bin
  double stepHz = 0;            // from bin to bin
  std::vector<float> levelsDb;  // relative dB, they may be positive; gaps are not-a-number
  std::uint64_t rows = 0;       // of the recording that it was put together from

  [[nodiscard]] bool hasLevels() const {
    return std::any_of(levelsDb.begin(), levelsDb.end(), [](float level) { return !std::isnan(level); });
  }
};

}  // namespace frontpanels

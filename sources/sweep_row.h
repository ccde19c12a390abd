// A row of a sweep recording. rtl_power and hackrf_sweep write the same columns: date, time, low Hz, high Hz,
// step Hz, samples, then a level in dB for each bin.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace frontpanels {

struct SweepRow {
  std::string time;  // date and time, one blank between them
  double lowHz = 0;  // of the first bin
  double highHz = 0;
  double stepHz = 0;  // the printed step, or the unrounded one where low, high and the count give it away
  double samples = 0;
  std::vector<float> levelsDb;  // one a bin, missing ones as gaps

  // What the range says, against what the row holds.
  std::size_t writtenValues = 0;  // trailing separators not counted
  std::size_t rangeBins = 0;      // (high - low) / step; 0 when that is no usable count
  // The last value has fewer decimals than the first: at the end of a file it may be the beginning of a
  // number.
  bool lastValueShorter = false;
};

// The finest sweep of either receiver has some three million bins; nothing larger is put together.
inline constexpr std::size_t kMaxSweepBins = std::size_t{1} << 22;

// Reads a row into `row`, whose capacity is reused. False, with the reason in `problem`, when it cannot be
// read; `row` is then unspecified.
//
// The values decide how many bins the row has, except that one value more than the range has bins is the last
// bin written twice, which rtl_power does. A missing value (nan, inf, what old Microsoft libraries print for
// them, or nothing) is a gap.
[[nodiscard]] bool parseSweepRow(std::string_view text, SweepRow& row, std::string& problem);

}  // namespace frontpanels

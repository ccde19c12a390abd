#include "sources/resample.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <string>

namespace frontpanels {
namespace {

// Bins from 100 MHz on, 1 MHz apart, all at -50 dB.
Sweep sweepOf(std::size_t bins) {
  Sweep sweep;
  sweep.startHz = 100e6;
  sweep.stepHz = 1e6;
  sweep.levelsDb.assign(bins, -50.0F);
  return sweep;
}

DisplaySweep shown(const Sweep& sweep) {
  DisplaySweep display;
  display.count = 5;
  resample(sweep, display);
  return display;
}

// Centre and span in kHz, then a level or a gap for each value.
std::string text(const DisplaySweep& display) {
  std::string result = std::to_string(std::lround(display.centerHz / 1e3)) + " " +
                       std::to_string(std::lround(display.spanHz / 1e3)) + ":";
  for (const float level : display.shown())
    result += std::isnan(level) ? " gap" : " " + std::to_string(std::lround(level));
  return result;
}

TEST(Resample, ShowsAFewBinsAsTheyAreWithAClosingGap) {
  Sweep sweep = sweepOf(3);
  sweep.levelsDb = {-24.0F, kGap, 14.0F};
  EXPECT_EQ(text(shown(sweep)), "101000 2000: -24 gap 14 gap");    // from the first bin to the last, 102 MHz
  EXPECT_EQ(text(shown(sweepOf(1))), "100500 1000: -50 -50 gap");  // a line one bin wide
  EXPECT_EQ(shown(sweepOf(0)).count, 0U);
}

TEST(Resample, BringsAnyNumberOfBinsToThePanelsValues) {
  const struct {
    std::size_t bins;
    std::size_t values;
  } rows[] = {{2, 3}, {511, 512}, {512, 513}, {513, 513}, {920, 513}, {4'000'000, 513}};
  for (const auto& row : rows) {
    const DisplaySweep display = shown(sweepOf(row.bins));
    EXPECT_EQ(display.count, row.values) << row.bins;
    EXPECT_EQ(std::count(display.values.begin(), display.values.begin() + row.values - 1, -50.0F),
              static_cast<std::ptrdiff_t>(row.values - 1));
    EXPECT_TRUE(std::isnan(display.shown().back()));
  }
}

// Cell i of 512 has the bins from i * n / 512 up to, not including, (i + 1) * n / 512.
TEST(Resample, PutsThePeakOfABinIntoTheCellThatHasTheBin) {
  const struct {
    std::size_t bins, peak, cell;
  } rows[] = {{513, 0, 0},  {513, 510, 510}, {513, 511, 511}, {513, 512, 511},  {920, 1, 1},
              {920, 0, 0},  {920, 459, 255}, {920, 460, 256}, {920, 919, 511},  {1024, 1, 0},
              {1024, 2, 1}, {6000, 11, 1},   {6000, 10, 0},   {6000, 5999, 511}};
  for (const auto& row : rows) {
    Sweep sweep = sweepOf(row.bins);
    sweep.levelsDb[row.peak] = 7.0F;
    const DisplaySweep display = shown(sweep);
    EXPECT_EQ(std::count(display.values.begin(), display.values.end(), 7.0F), 1);
    EXPECT_EQ(display.values[row.cell], 7.0F) << row.peak << " of " << row.bins;
  }
  EXPECT_TRUE(text(shown(sweepOf(920))).starts_with("559500 919000:"));  // 100 to 1019 MHz, edge to edge
}

TEST(Resample, LeavesAGapOnlyWhereAWholeCellIsMissing) {
  Sweep sweep = sweepOf(1024);  // two bins a cell
  for (const std::size_t bin : {20U, 31U, 40U, 41U}) sweep.levelsDb[bin] = kGap;
  const DisplaySweep display = shown(sweep);
  EXPECT_EQ(display.values[10], -50.0F);
  EXPECT_EQ(display.values[15], -50.0F);
  EXPECT_TRUE(std::isnan(display.values[20]));
  EXPECT_EQ(display.values[21], -50.0F);
}

}  // namespace
}  // namespace frontpanels

#include "sources/resample.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <numeric>

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

TEST(Resample, ShowsAFewBinsAsTheyAreWithAClosingGap) {
  Sweep sweep = sweepOf(3);
  sweep.levelsDb = {-24.0F, kGap, 14.0F};
  DisplaySweep display;
  resample(sweep, display);
  ASSERT_EQ(display.count, 4U);
  EXPECT_EQ(display.values[0], -24.0F);
  EXPECT_TRUE(std::isnan(display.values[1]));
  EXPECT_EQ(display.values[2], 14.0F);
  EXPECT_TRUE(std::isnan(display.values[3]));
  EXPECT_EQ(display.centerHz, 101e6);  // from the first bin, 100 MHz, to the last, 102 MHz
  EXPECT_EQ(display.spanHz, 2e6);
}

TEST(Resample, ShowsOneBinAsALineOneBinWide) {
  DisplaySweep display;
  resample(sweepOf(1), display);
  ASSERT_EQ(display.count, 3U);
  EXPECT_EQ(display.values[0], -50.0F);
  EXPECT_EQ(display.values[1], -50.0F);
  EXPECT_TRUE(std::isnan(display.values[2]));
  EXPECT_EQ(display.centerHz, 100.5e6);
  EXPECT_EQ(display.spanHz, 1e6);
}

TEST(Resample, HasNothingToShowWithoutBins) {
  DisplaySweep display;
  display.count = 5;
  resample(sweepOf(0), display);
  EXPECT_EQ(display.count, 0U);
}

TEST(Resample, BringsAnyNumberOfBinsToThePanelsValues) {
  const struct {
    std::size_t bins;
    std::size_t values;
  } kCases[] = {{2, 3}, {511, 512}, {512, 513}, {513, 513}, {920, 513}, {4'000'000, 513}};
  DisplaySweep display;
  for (const auto& testCase : kCases) {
    resample(sweepOf(testCase.bins), display);
    EXPECT_EQ(display.count, testCase.values) << testCase.bins;
    EXPECT_EQ(std::count(display.values.begin(), display.values.begin() + testCase.values - 1, -50.0F),
              static_cast<std::ptrdiff_t>(testCase.values - 1));
    EXPECT_TRUE(std::isnan(display.shown().back()));
  }
}

// Cell i of 512 has the bins from i * n / 512 up to, not including, (i + 1) * n / 512.
TEST(Resample, PutsThePeakOfABinIntoTheCellThatHasTheBin) {
  const struct {
    std::size_t bins;
    std::size_t peak;
    std::size_t cell;
  } kCases[] = {{513, 0, 0},  {513, 510, 510}, {513, 511, 511}, {513, 512, 511},  {920, 1, 1},
                {920, 0, 0},  {920, 459, 255}, {920, 460, 256}, {920, 919, 511},  {1024, 1, 0},
                {1024, 2, 1}, {6000, 11, 1},   {6000, 10, 0},   {6000, 5999, 511}};
  DisplaySweep display;
  for (const auto& testCase : kCases) {
    Sweep sweep = sweepOf(testCase.bins);
    sweep.levelsDb[testCase.peak] = 7.0F;
    resample(sweep, display);
    EXPECT_EQ(std::count(display.values.begin(), display.values.end(), 7.0F), 1);
    EXPECT_EQ(display.values[testCase.cell], 7.0F) << testCase.peak << " of " << testCase.bins;
  }
}

// The panel shows cell i of 512 at centre - span / 2 + i * span / 511.
TEST(Resample, ShowsEveryBinLessThanACellFromItsFrequency) {
  Sweep sweep = sweepOf(920);
  std::iota(sweep.levelsDb.begin(), sweep.levelsDb.end(), 0.0F);  // a cell's level is its last bin's number
  DisplaySweep display;
  resample(sweep, display);
  double worstBins = 0;
  for (std::size_t cell = 0; cell < 512; ++cell) {
    const double shownHz =
        display.centerHz - display.spanHz / 2 + static_cast<double>(cell) * display.spanHz / 511;
    const double firstBin = cell == 0 ? 0 : static_cast<double>(display.values[cell - 1]) + 1;
    const double lastBin = static_cast<double>(display.values[cell]);
    const double shownBin = (shownHz - 100e6) / 1e6;
    worstBins = std::max({worstBins, std::abs(shownBin - firstBin), std::abs(shownBin - lastBin)});
  }
  EXPECT_LT(worstBins, 920.0 / 512);
  EXPECT_EQ(display.centerHz, 559.5e6);  // (100 + 1019) / 2
  EXPECT_EQ(display.spanHz, 919e6);
}

TEST(Resample, LeavesAGapOnlyWhereAWholeCellIsMissing) {
  Sweep sweep = sweepOf(1024);  // two bins a cell
  sweep.levelsDb[20] = kGap;
  sweep.levelsDb[31] = kGap;
  sweep.levelsDb[40] = sweep.levelsDb[41] = kGap;
  DisplaySweep display;
  resample(sweep, display);
  EXPECT_EQ(display.values[10], -50.0F);
  EXPECT_EQ(display.values[15], -50.0F);
  EXPECT_TRUE(std::isnan(display.values[20]));
  EXPECT_EQ(display.values[21], -50.0F);
}

}  // namespace
}  // namespace frontpanels

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
  std::string result = std::to_string(std::lround(display.range.centerHz / 1e3)) + " " +
                       std::to_string(std::lround(display.range.spanHz / 1e3)) + ":";
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

// Cell i of 512 stands at bin i * (n - 1) / 511 and has the bins that are nearest to it.
TEST(Resample, PutsThePeakOfABinIntoTheCellThatHasTheBin) {
  const struct {
    std::size_t bins, peak, cell;
  } rows[] = {{513, 0, 0},  {513, 510, 509}, {513, 511, 510}, {513, 512, 511},  {920, 1, 1},
              {920, 0, 0},  {920, 459, 255}, {920, 460, 256}, {920, 919, 511},  {1024, 1, 0},
              {1024, 2, 1}, {6000, 6, 1},    {6000, 5, 0},    {6000, 5999, 511}};
  for (const auto& row : rows) {
    Sweep sweep = sweepOf(row.bins);
    sweep.levelsDb[row.peak] = 7.0F;
    const DisplaySweep display = shown(sweep);
    EXPECT_EQ(std::count(display.values.begin(), display.values.end(), 7.0F), 1);
    EXPECT_EQ(display.values[row.cell], 7.0F) << row.peak << " of " << row.bins;
  }
  EXPECT_TRUE(text(shown(sweepOf(920))).starts_with("559500 919000:"));  // 100 to 1019 MHz, edge to edge
}

// Bins of 0, -1, ... -9 dB from 100 MHz on, 1 MHz apart.
TEST(Resample, ShowsThePartOfASweepThatLiesInARange) {
  Sweep sweep = sweepOf(0);
  for (int bin = 0; bin < 10; ++bin) sweep.levelsDb.push_back(static_cast<float>(-bin));
  const struct {
    double centerMHz, spanMHz;
    const char* shown;
  } rows[] = {
      {103, 4, "103000 4000: -1 -2 -3 -4 -5 gap"},
      {104.5, 9, "104500 9000: 0 -1 -2 -3 -4 -5 -6 -7 -8 -9 gap"},
      {100, 4, "100000 4000: gap gap 0 -1 -2 gap"},
      {110, 4, "110000 4000: -8 -9 gap gap gap gap"},
      {200, 2, "200000 2000: gap gap gap gap"},
      {103.3, 2, "103300 2000: -2 -3 -4 gap"},     // 102.3 and so on: the nearest bin
      {103, 2.5, "103000 2500: -2 -3 -3 -4 gap"},  // at 101.75, 102.58, 103.42 and 104.25
      {103.2, 0.1, "103200 100: -3 -3 gap"},       // within one bin
      {104.5, 9.0000001, "104500 9000: 0 -1 -2 -3 -4 -5 -6 -7 -8 -9 gap"},
  };
  for (const auto& row : rows) {
    DisplaySweep display;
    resample(sweep, {row.centerMHz * 1e6, row.spanMHz * 1e6}, display);
    EXPECT_EQ(text(display), row.shown);
  }
}

// 3001 bins, 1000 to 4000, for 512 cells, each 3000 / 511 = 5.87 bins from the next. A bin counts as far as
// half of it reaches over the edge.
TEST(Resample, KeepsEachPeakOfTheRangeAndNoneFromOutside) {
  constexpr std::ptrdiff_t kNowhere = kDisplayValues;
  const struct {
    double centerMHz;
    std::size_t peak;
    std::ptrdiff_t cell;
  } rows[] = {{2600, 999, kNowhere},     {2600, 1000, 0},        {2600, 1002, 0},
              {2600, 1003, 1},           {2600, 2500, 256},      {2600, 3997, 510},
              {2600, 4000, 511},         {2600, 4001, kNowhere}, {2600.45, 1000, 0},
              {2600.55, 1000, kNowhere}, {2600.55, 4001, 511},   {2600.45, 4001, kNowhere}};
  for (const auto& row : rows) {
    Sweep sweep = sweepOf(6000);
    sweep.levelsDb[row.peak] = 7.0F;
    DisplaySweep display;
    resample(sweep, {row.centerMHz * 1e6, 3000e6}, display);
    const auto peak = std::find(display.values.begin(), display.values.end(), 7.0F);
    EXPECT_EQ(peak - display.values.begin(), row.cell) << row.centerMHz << " " << row.peak;
  }
}

TEST(Resample, ShowsNothingOfARangeThatStepsCannotBeCountedIn) {
  Sweep sweep = sweepOf(3);
  sweep.stepHz = 1e-300;
  DisplaySweep display;
  resample(sweep, {1e9, 6e9}, display);
  EXPECT_TRUE(
      std::all_of(display.values.begin(), display.values.end(), [](float v) { return std::isnan(v); }));
  resample(sweep, display);
  EXPECT_EQ(text(display), "100000 0: -50 -50 -50 gap");
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

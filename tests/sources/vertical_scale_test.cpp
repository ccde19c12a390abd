#include "sources/vertical_scale.h"

#include <gtest/gtest.h>

#include <limits>
#include <vector>

namespace frontpanels {
namespace {

TEST(VerticalScale, HoldsAllLevelsOnTheFinestOfOneTwoFive) {
  const struct {
    std::vector<float> levelsDb;
    VerticalScale scale;
  } kCases[] = {
      {{-65.0F, -12.0F}, {-10, 10}},                                // by 5s from -10 only down to -60
      {{-60.0F, -12.0F}, {-10, 5}},                                 // the lowest may lie on the bottom line
      {{-60.5F, -12.0F}, {-10, 10}}, {{-24.38F, 19.13F}, {20, 5}},  // 20 to -30
      {{-58.0F, -50.0F}, {-49, 1}},                                 // the highest lies below the top line
      {{-50.0F}, {-49, 1}},          {{-300.0F, 0.0F}, {50, 50}},  {{}, {0, 10}},
  };
  for (const auto& testCase : kCases) {
    LevelRange range;
    range.add(testCase.levelsDb);
    EXPECT_EQ(verticalScaleFor(range), testCase.scale) << testCase.scale.topDb;
  }
}

TEST(VerticalScale, PassesOverGapsAndHoldsTheLargestSingle) {
  LevelRange range;
  const std::vector<float> gap = {std::numeric_limits<float>::quiet_NaN()};
  range.add(gap);
  EXPECT_TRUE(range.isEmpty());
  const std::vector<float> extremes = {-3e38F, gap[0], 3e38F};
  range.add(extremes);
  EXPECT_NEAR(verticalScaleFor(range).dbPerDivision, 1e38, 1e24);  // a product of tens
}

}  // namespace
}  // namespace frontpanels

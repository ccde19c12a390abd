#include "spectrum/frequency_plan.h"

#include <gtest/gtest.h>

#include <cmath>

namespace frontpanels {
namespace {

TEST(FrequencyPlanTest, StartAndStopFollowCentreAndSpanWithinTheLimits) {
  FrequencyPlan plan;
  plan.setCenter(881.52e6);
  EXPECT_EQ(plan.startHz(), 876.52e6);
  EXPECT_EQ(plan.stopHz(), 886.52e6);
  plan.setSpan(2e6);
  EXPECT_EQ(plan.startHz(), 880.52e6);
  EXPECT_EQ(plan.stopHz(), 882.52e6);
  plan.setCenter(5.9e9);
  plan.setSpan(1e9);  // stop would be 6.4 GHz
  EXPECT_EQ(plan.centerHz(), 5.5e9);
  EXPECT_EQ(plan.stopHz(), 6e9);
  plan.setCenter(0.2e9);
  plan.setSpan(1e9);  // start would be -0.3 GHz
  EXPECT_EQ(plan.centerHz(), 0.5e9);
  EXPECT_EQ(plan.startHz(), 0.0);
}

TEST(FrequencyPlanTest, ValuesOutsideAreHeldAtTheLimitAndNotANumberChangesNothing) {
  FrequencyPlan plan;
  plan.setSpan(9e9);
  EXPECT_EQ(plan.spanHz(), 6e9);
  EXPECT_EQ(plan.centerHz(), 3e9);
  const FrequencyPlan before = plan;
  plan.setCenter(std::nan(""));
  plan.setSpan(INFINITY);
  EXPECT_EQ(plan, before);
}

TEST(FrequencyPlanTest, AxisFormatFollowsTheSpanWithItsGaps) {
  struct Row {
    double spanHz;
    const char* format;
  };
  const Row rows[] = {
      {-1, "0.##"},           {0, "0.##############"}, {4, "0.##############"}, {4.5, "0.##"},
      {5, "0.#############"}, {49, "0.############"},  {50, "0.###########"},   {499, "0.##########"},
      {999, "0.#########"},   {4999, "0.########"},    {5000, "0.##"},          {7500, "0.##"},
      {9999, "0.##"},         {10000, "0.#######"},    {99999, "0.######"},     {100000, "0.#####"},
      {999999, "0.####"},     {1000000, "0.###"},      {4999999, "0.###"},      {5000000, "0.##"},
  };
  for (const Row& row : rows) EXPECT_EQ(axisFormatForSpan(row.spanHz), row.format) << row.spanHz;
}

}  // namespace
}  // namespace frontpanels

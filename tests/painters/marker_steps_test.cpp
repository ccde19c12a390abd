#include "painters/marker_steps.h"

#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

namespace frontpanels::testing {
namespace {

const double kGap = std::nan("");

// Points that a marker visits from `from` on, until it stays.
template <class Step>
std::string way(const std::vector<double>& values, std::int32_t from, Step step) {
  std::string text;
  for (std::int32_t next = step(values, from); next != from; next = step(values, from)) {
    text += (text.empty() ? "" : " ") + std::to_string(next);
    from = next;
  }
  return text;
}
std::string lower(const std::vector<double>& values, std::int32_t from) {
  return way(values, from, [](auto& v, auto at) { return nextPeak(v, at, PeakOrder::Lower); });
}
std::string higher(const std::vector<double>& values, std::int32_t from) {
  return way(values, from, [](auto& v, auto at) { return nextPeak(v, at, PeakOrder::Higher); });
}

TEST(MarkerSteps, PeaksComeByLevelAndStandSixDecibelsAboveTheValleyTowardsAHigherOne) {
  //                                  0    1    2    3    4    5    6    7    8
  const std::vector<double> levels = {-90, -40, -80, -60, -80, -30, -90, -50, -99};
  EXPECT_EQ(lower(levels, 5), "1 7 3");
  EXPECT_EQ(higher(levels, 3), "7 1 5");
  EXPECT_EQ(lower(levels, 2), "");  // -80: no peak is lower
  EXPECT_EQ(lower(levels, 6), "");
  EXPECT_EQ(higher(levels, 8), "3 7 1 5");
  EXPECT_EQ(lower(levels, 99), "5 1 7 3");  // beyond the trace: from the highest on

  EXPECT_EQ(lower({-30, -46, -40}, 0), "2");            // exactly 6 above the valley
  EXPECT_EQ(lower({-30, -45.9, -40}, 0), "");           // not quite
  EXPECT_EQ(lower({-20, -50, -40, -42, -30}, 0), "4");  // -40 is on the slope of -30
  EXPECT_EQ(lower({-40, -50, -40, -43, -40}, 0), "2");  // of equal ones the left one; 3 dB part no peaks
  EXPECT_EQ(lower({-70, -30, -30, -30, -70}, 0), "");
  EXPECT_EQ(higher({-70, -30, -30, -30, -70}, 4), "1");
  EXPECT_EQ(lower({-30, kGap, -60, kGap, -40, kGap}, 1), "0 4");
  EXPECT_EQ(lower({kGap, kGap}, 0), "");
  EXPECT_EQ(higher({}, 0), "");
}

TEST(MarkerSteps, EndsAndTenthsKeepToValues) {
  const auto tenths = [](const std::vector<double>& values, std::int32_t from, Towards side) {
    return way(values, from, [side](auto& v, auto at) { return pointATenthOn(v, at, side); });
  };
  const std::vector<double> sweep(25, -50.0);  // a tenth of 25 points is 2
  EXPECT_EQ(tenths(sweep, 19, Towards::Right), "21 23 24");
  EXPECT_EQ(tenths(sweep, 3, Towards::Left), "1 0");
  EXPECT_EQ(tenths(sweep, 25, Towards::Left).substr(0, 5), "22 20");  // counted from the last point
  EXPECT_EQ(tenths({-1, -2, -3}, 0, Towards::Right), "1 2");          // at least one
  const std::vector<double> gaps = {kGap, -1, kGap, kGap, -2, kGap};
  EXPECT_EQ(tenths(gaps, 1, Towards::Right), "4");
  EXPECT_EQ(tenths(gaps, 4, Towards::Left), "1");
  EXPECT_EQ(tenths({kGap}, 0, Towards::Right), "");
  EXPECT_EQ(endPoint(sweep, 7, TraceEnd::First), 0);
  EXPECT_EQ(endPoint(sweep, 7, TraceEnd::Last), 24);
  EXPECT_EQ(endPoint(gaps, 4, TraceEnd::First), 1);
  EXPECT_EQ(endPoint(gaps, 1, TraceEnd::Last), 4);
  EXPECT_EQ(endPoint({}, 3, TraceEnd::Last), 3);
}

}  // namespace
}  // namespace frontpanels::testing

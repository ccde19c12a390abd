#include "painters/auto_scale.h"

#include <gtest/gtest.h>

namespace frontpanels {
namespace {

TEST(AutoScaleTest, AnAxisIsKeptWhileTheDataEndWithinItsOuterFifths) {
  const struct {
    ValueRange data;
    bool fits;
  } rows[] = {// Axis -100..0: the largest from -20 to -0.1, the smallest from -99.9 to -80.
              {{-99.9, -0.1}, true},  {{-80, -20}, true},     {{-90, -10}, true},     {{-90, -0.09}, false},
              {{-90, -20.01}, false}, {{-79.99, -10}, false}, {{-99.91, -10}, false}, {{-150, 50}, false}};
  for (const auto& row : rows) EXPECT_EQ(axisFits({-100, 0}, row.data), row.fits) << row.data.minimum;
}

TEST(AutoScaleTest, AnAxisIsChosenOnThe125SequenceWithItsTopOnATenth) {
  // 51 / 0.85 = 60, 6 a division: 10 and a span of 100; (-30 - 81 + 100) / 2 = -5.5, in tenths of 10 -0.55.
  EXPECT_EQ(axisFor({-81, -30}, 10), (FittedAxis{-10, 10}));
  // 17 / 0.85 = 20 in 10 divisions of 2; (3 - 14 + 20) / 2 = 4.5 is 2.25 tenths.
  EXPECT_EQ(axisFor({-14, 3}, 10), (FittedAxis{4, 2}));
  // A flat line: the smallest step, 0.0001, and a top half a span above.
  EXPECT_NEAR(axisFor({-50, -50}, 10).top, -49.9995, 0.0002);
  EXPECT_EQ(axisFor({-50, -50}, 10).perDivision, 0.0001);
  // Tenths that a 32-bit number cannot count: the top stays where the data are centred.
  EXPECT_EQ(axisFor({1e9, 1e9}, 10).top, 1e9 + 0.0005);
}

}  // namespace
}  // namespace frontpanels

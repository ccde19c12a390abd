#include "framework/support/numeric.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "tests/support/raised.h"

namespace frontpanels {
namespace {

constexpr double kNan = std::numeric_limits<double>::quiet_NaN();
constexpr double kInfinity = std::numeric_limits<double>::infinity();

TEST(WholeNumber, HalvesGoToTheEvenNeighbour) {
  const struct {
    double value;
    std::int32_t whole;
  } rows[] = {{0.5, 0},   {1.5, 2},  {2.5, 2},    {-0.5, 0},  {-1.5, -2},
              {-2.5, -2}, {0.49, 0}, {-0.51, -1}, {95.5, 96}, {104.5, 104}};
  for (const auto& row : rows) {
    EXPECT_EQ(toInt32(row.value), row.whole) << row.value;
    EXPECT_EQ(toInt16(row.value), row.whole) << row.value;
    EXPECT_EQ(roundHalfEven(row.value), row.whole) << row.value;
  }
}

TEST(WholeNumber, OverflowsOutsideItsBitsInsteadOfWrapping) {
  EXPECT_EQ(toInt32(2147483647.25), 2147483647);
  EXPECT_EQ(toInt32(-2147483648.5), -2147483647 - 1);  // the half goes to the even border
  EXPECT_EQ(toInt16(32767.25), 32767);
  EXPECT_EQ(toInt16(-32768.5), -32768);
  for (const double value :
       {2147483647.5, -2147483648.75, 4294967296.0, 1e300, kInfinity, -kInfinity, kNan}) {
    EXPECT_FALSE(fitsInt32(value)) << value;
    EXPECT_EQ(testing::raised([&] { return toInt32(value); }), "Overflow") << value;
  }
  for (const double value : {32767.5, -32768.75, 65536.0, 4294967296.0, kInfinity, -kInfinity, kNan})
    EXPECT_EQ(testing::raised([&] { return toInt16(value); }), "Overflow") << value;
  EXPECT_EQ(addInt16(32766, 1), 32767);
  EXPECT_EQ(addInt16(-32767, -1), -32768);
  EXPECT_EQ(testing::raised([] { return addInt16(32767, 1); }), "Overflow");
}

}  // namespace
}  // namespace frontpanels

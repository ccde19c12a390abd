#include "framework/support/numeric.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

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

TEST(WholeNumber, TheBordersOf32Bits) {
  EXPECT_EQ(toInt32(2147483647.25), 2147483647);
  EXPECT_EQ(toInt32(-2147483648.5), -2147483647 - 1);  // the half goes to the even border
  for (const double value :
       {2147483647.5, -2147483648.75, 4294967296.0, 1e300, kInfinity, -kInfinity, kNan}) {
    EXPECT_FALSE(fitsInt32(value)) << value;
    EXPECT_THROW(static_cast<void>(toInt32(value)), RuntimeError) << value;
  }
}

TEST(WholeNumber, TheBordersOf16Bits) {
  EXPECT_EQ(toInt16(32767.25), 32767);
  EXPECT_EQ(toInt16(-32768.5), -32768);
  for (const double value : {32767.5, -32768.75, 65536.0, 4294967296.0, kInfinity, -kInfinity, kNan})
    EXPECT_THROW(static_cast<void>(toInt16(value)), RuntimeError) << value;
}

TEST(WholeNumber, SumsOf16BitsOverflowInsteadOfWrapping) {
  EXPECT_EQ(addInt16(32766, 1), 32767);
  EXPECT_EQ(addInt16(-32767, -1), -32768);
  try {
    static_cast<void>(addInt16(32767, 1));
    FAIL() << "no overflow";
  } catch (const RuntimeError& error) {
    EXPECT_EQ(error, RuntimeError(6, "Overflow"));
  }
}

}  // namespace
}  // namespace frontpanels

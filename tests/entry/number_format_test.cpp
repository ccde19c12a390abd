#include "entry/number_format.h"

#include <gtest/gtest.h>

#include <limits>
#include <string>

#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

// Each number by the format, a blank behind it.
std::string texts(const char* format, std::initializer_list<double> numbers) {
  std::string text;
  for (const double number : numbers) {
    appendNumber(text, number, format);
    text += ' ';
  }
  return text;
}

TEST(NumberFormatTest, RoundsHalvesAwayFromZeroOnTheDecimalText) {
  EXPECT_EQ(texts("0.##", {12, 12.5, -43.219}), "12 12.5 -43.22 ");
  // A half-even rounding would give 0.12; the double 1.005 is a little below, but its 15 digits are 1.005.
  EXPECT_EQ(texts("0.##", {0.125, -0.125, 1.005}), "0.13 -0.13 1.01 ");
  EXPECT_EQ(texts("0", {2.5, 0.5, 0.49}), "3 1 0 ");
  EXPECT_EQ(texts("0.#", {0.05, 0.04}), "0.1 0 ");
  // The carry makes a digit, passes a nine, stops at a zero.
  EXPECT_EQ(texts("0.##", {9.996, 999.995, 1.096, 1.059}), "10 1000 1.1 1.06 ");
  EXPECT_EQ(texts("0.##", {0.0004, -0.0004, 1e20}), "0 0 100000000000000000000 ");  // zero has no sign
  EXPECT_EQ(texts("0.00", {0, 1.5}) + texts("0.0#", {1.5}), "0.00 1.50 1.5 ");
  EXPECT_EQ(texts("#.##", {0.25}) + texts("000", {7}), ".25 007 ");
  // 15 significant digits.
  EXPECT_EQ(texts("0.##################", {97.5000001, 2.0 / 3, 1e-9}),
            "97.5000001 0.666666666666667 0.000000001 ");
}

TEST(NumberFormatTest, AFormatThatIsNoneIsRefusedAndTheTextStays) {
  for (const char* format : {"0.0.0", "abc", "0,0", "0.##%"}) {
    std::string text = "kept";
    EXPECT_THROW(appendNumber(text, 1, format), RuntimeError) << format;
    EXPECT_EQ(text, "kept");
  }
}

TEST(NumberFormatTest, DecimalsFollowAStep) {
  const auto formats = [](double step) {
    return std::string(formatForStep(step)) + " " + std::string(formatNoFinerThan(step));
  };
  for (const double whole : {20.0, 10.0, 0.0, -1.0, std::numeric_limits<double>::quiet_NaN()})
    EXPECT_EQ(formats(whole), "0 0") << whole;
  EXPECT_EQ(formats(2.5), "0.# 0");
  EXPECT_EQ(formats(0.5), "0.## 0.#");
  EXPECT_EQ(formats(0.02), "0.### 0.##");
  EXPECT_EQ(formats(1e-300), "0.############### 0.###############");
}

}  // namespace
}  // namespace frontpanels

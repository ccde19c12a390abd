#include "entry/number_format.h"

#include <gtest/gtest.h>

#include <limits>
#include <vector>

#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

struct FormatCase {
  double number;
  const char* format;
  const char* text;
};

TEST(NumberFormatTest, RoundsHalvesAwayFromZeroOnTheDecimalText) {
  const std::vector<FormatCase> cases = {
      {12, "0.##", "12"},
      {12.5, "0.##", "12.5"},
      {-43.219, "0.##", "-43.22"},
      {0.125, "0.##", "0.13"},  // a half-even rounding would give 0.12
      {-0.125, "0.##", "-0.13"},
      {1.005, "0.##", "1.01"},  // the double is a little below: its 15 digits are 1.005
      {2.5, "0", "3"},
      {0.5, "0", "1"},
      {0.49, "0", "0"},
      {0.05, "0.#", "0.1"},
      {0.04, "0.#", "0"},
      {9.996, "0.##", "10"},   // the carry makes a digit
      {1.096, "0.##", "1.1"},  // the carry passes a nine and stops at a zero
      {1.059, "0.##", "1.06"},
      {999.995, "0.##", "1000"},
      {0.0004, "0.##", "0"},
      {-0.0004, "0.##", "0"},  // zero has no sign
      {0, "0.00", "0.00"},
      {1.5, "0.00", "1.50"},
      {1.5, "0.0#", "1.5"},
      {0.25, "#.##", ".25"},
      {7, "000", "007"},
      {1e20, "0.##", "100000000000000000000"},
      {97.5000001, "0.##############", "97.5000001"},
      {2.0 / 3, "0.##################", "0.666666666666667"},  // 15 significant digits
      {1e-9, "0.##########", "0.000000001"},
  };
  for (const FormatCase& c : cases) {
    std::string text;
    appendNumber(text, c.number, c.format);
    EXPECT_EQ(text, c.text) << c.number << " by " << c.format;
  }
}

TEST(NumberFormatTest, AFormatThatIsNoneIsRefusedAndTheTextStays) {
  for (const char* format : {"0.0.0", "abc", "0,0", "0.##%"}) {
    std::string text = "kept";
    EXPECT_THROW(appendNumber(text, 1, format), RuntimeError) << format;
    EXPECT_EQ(text, "kept");
  }
}

TEST(NumberFormatTest, DecimalsFollowAStep) {
  struct StepCase {
    double step;
    const char* forStep;
    const char* noFiner;
  };
  const std::vector<StepCase> cases = {
      {20, "0", "0"},
      {10, "0", "0"},
      {2.5, "0.#", "0"},
      {0.5, "0.##", "0.#"},
      {0.02, "0.###", "0.##"},
      {0, "0", "0"},
      {-1, "0", "0"},
      {std::numeric_limits<double>::quiet_NaN(), "0", "0"},
      {1e-300, "0.###############", "0.###############"},
  };
  for (const StepCase& c : cases) {
    EXPECT_EQ(formatForStep(c.step), c.forStep) << c.step;
    EXPECT_EQ(formatNoFinerThan(c.step), c.noFiner) << c.step;
  }
}

}  // namespace
}  // namespace frontpanels

#include "sources/sweep_row.h"

#include <gtest/gtest.h>

#include <cmath>

#include "sources/sweep.h"

namespace frontpanels {
namespace {

// The levels of a row in hundredths, or the reason why it cannot be read.
std::string read(const std::string& text, SweepRow& row) {
  std::string problem;
  if (!parseSweepRow(text, row, problem)) return problem;
  std::string levels;
  for (const float level : row.levelsDb) {
    levels += levels.empty() ? "" : " ";
    levels += std::isnan(level) ? "gap" : std::to_string(std::lround(level * 100));
  }
  return levels;
}
std::string read(const std::string& text) {
  SweepRow row;
  return read(text, row);
}

TEST(SweepRow, ReadsTheColumnsOfBothReceivers) {
  SweepRow row;
  EXPECT_EQ(read("2020-06-26, 14:57:57.123456, 5000000, 10000000, 1000000.00, 20, -1.5, -2, 3, 4, 5", row),
            "-150 -200 300 400 500");
  EXPECT_EQ(row.time, "2020-06-26 14:57:57.123456");
  EXPECT_EQ(row.lowHz, 5e6);
  EXPECT_EQ(row.highHz, 10e6);
  EXPECT_EQ(row.stepHz, 1e6);
  EXPECT_EQ(row.samples, 20);
}

TEST(SweepRow, ReadsWhatReceiversWriteForValues) {
  const std::string head = "2020-01-01,00:00:00,100,300,100,1,";  // two bins
  // Blanks, a point, an exponent, empty values at the end; the last bin twice, or one value more than the
  // range has bins.
  for (const char* values : {"-1,-2", "  -1 ,\t-2.0  ", "-.1e1,-2E0", "-1,-2,", "-1,-2,-2, , ,", "-1,-2,-7"})
    EXPECT_EQ(read(head + values), "-100 -200") << values;
  for (const char* values : {"nan,-nan", "inf,-inf", "-1.#J,1.#INF", "-1.#IND,1.#QNAN"})
    EXPECT_EQ(read(head + values), "gap gap") << values;
  EXPECT_EQ(read(head + "1e39,-1e300"), "gap gap");  // beyond a single
  EXPECT_EQ(read(head + "-1"), "-100");
  EXPECT_EQ(read(head + ",+2"), "gap 200");
  EXPECT_EQ(read(head + "-1,,-3,-4"), "-100 gap -300 -400");  // the count wins over the range
}

TEST(SweepRow, SaysWhyARowCannotBeRead) {
  const std::string kNoTime = "does not begin with a date and a time: ";
  const struct {
    std::string row;
    std::string problem;
  } kCases[] = {
      {"time,low,high", kNoTime + "\"time,low,high\""},
      {"2020-01-01 00:00:00,1,2,1,1,-1", kNoTime + "\"2020-01-01 00:00:00,1,2,1,1,-1\""},
      {"2020-01-01,00:00:0x,1,2,1,1,-1", kNoTime + "\"2020-01-01,00:00:0x,1,2,1,1,-1\""},
      {std::string(50, 'x'), kNoTime + "\"" + std::string(40, 'x') + "...\""},
      {std::string("\x7f"
                   "ELF\0\1",
                   6),
       "holds bytes that are not text"},
      {"2020-01-01,00:00:00", "ends before its low frequency"},
      {"2020-01-01,00:00:00,100,200,1", "ends before its number of samples"},
      {"2020-01-01,00:00:00,100,200,100,1", "has no values"},
      {"2020-01-01,00:00:00,100,200,100,1, , ,", "has no values"},
      {"2020-01-01,00:00:00,-5,200,100,1,-1", "its low frequency is \"-5\""},
      {"2020-01-01,00:00:00,nan,200,100,1,-1", "its low frequency is \"nan\""},
      {"2020-01-01,00:00:00,1,1e99,100,1,-1", "its high frequency is \"1e99\""},
      {"2020-01-01,00:00:00,100,200,0,1,-1", "its step is 0"},
      {"2020-01-01,00:00:00,100,200,50,1,-1,abc", "its value 2 is \"abc\""},
      {"2020-01-01,00:00:00,100,200,50,1,-1,-", "its value 2 is \"-\""},
      {"2020-01-01,00:00:00,100,200,50,1,-1,2 3", "its value 2 is \"2 3\""},
  };
  for (const auto& testCase : kCases) EXPECT_EQ(read(testCase.row), testCase.problem);
}

TEST(SweepRow, TakesTheUnroundedStepWhereThePrintedOneAgrees) {
  const auto stepHz = [](const std::string& range) {
    SweepRow row;
    EXPECT_EQ(read("2020-01-01,00:00:00," + range + ",3,1,2,3", row), "100 200 300");
    return row.stepHz;
  };
  EXPECT_EQ(stepHz("0,1000000,333333.33"), 1000000.0 / 3);
  EXPECT_EQ(stepHz("0,1000000,333333.40"), 333333.40);  // 0.07 away: not a matter of rounding
  EXPECT_EQ(stepHz("0,9000000000000,1"), 1.0);          // the range lies
}

TEST(SweepRow, RefusesMoreValuesThanASweepMayHave) {
  std::string text = "2020-01-01,00:00:00,0,100,1,1";
  text.append(kMaxSweepBins, ',');
  EXPECT_TRUE(read(text + "1").starts_with("gap gap "));
  EXPECT_EQ(read(text + ",1"), "has more than 4194304 values");
}

}  // namespace
}  // namespace frontpanels

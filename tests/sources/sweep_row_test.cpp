#include "sources/sweep_row.h"

#include <gtest/gtest.h>

#include <cmath>

#include "sources/sweep.h"

namespace frontpanels {
namespace {

std::string levelsText(const SweepRow& row) {
  std::string text;
  for (const float level : row.levelsDb) {
    text += text.empty() ? "" : " ";
    text += std::isnan(level) ? "gap" : std::to_string(std::lround(level * 100));
  }
  return text;
}

TEST(SweepRow, ReadsTheColumnsOfBothReceivers) {
  SweepRow row;
  std::string problem;
  ASSERT_TRUE(parseSweepRow(
      "2020-06-26, 14:57:57.123456, 5000000, 10000000, 1000000.00, 20, -1.5, -2, 3, 4, 5", row, problem));
  EXPECT_EQ(row.time, "2020-06-26 14:57:57.123456");
  EXPECT_EQ(row.lowHz, 5e6);
  EXPECT_EQ(row.highHz, 10e6);
  EXPECT_EQ(row.stepHz, 1e6);
  EXPECT_EQ(row.samples, 20);
  EXPECT_EQ(levelsText(row), "-150 -200 300 400 500");
}

TEST(SweepRow, ReadsWhatReceiversWriteForValues) {
  const std::string head = "2020-01-01,00:00:00,100,300,100,1,";  // two bins
  const struct {
    const char* values;
    const char* levels;
  } kCases[] = {
      {"-1.25,2", "-125 200"},
      {"  -1.25 ,\t+2  ", "-125 200"},
      {"1e1,-2.5E0", "1000 -250"},
      {"-1,-2,-2", "-100 -200"},               // the last bin twice
      {"-1,-2,-7", "-100 -200"},               // one value more than the range has bins
      {"-1,-2,-3,-4", "-100 -200 -300 -400"},  // the count wins over the range
      {"-1", "-100"},
      {"-1,-2,", "-100 -200"},
      {"-1,-2,-2, , ,", "-100 -200"},
      {"-1,,-3,-4", "-100 gap -300 -400"},
      {",-2", "gap -200"},
      {"nan,-nan", "gap gap"},
      {"inf,-inf", "gap gap"},
      {"-1.#J,1.#INF", "gap gap"},
      {"-1.#IND,1.#QNAN", "gap gap"},
      {"1e39,-1e300", "gap gap"},  // beyond a single
  };
  for (const auto& testCase : kCases) {
    SweepRow row;
    std::string problem;
    EXPECT_TRUE(parseSweepRow(head + testCase.values, row, problem)) << testCase.values << ": " << problem;
    EXPECT_EQ(levelsText(row), testCase.levels) << testCase.values;
  }
}

TEST(SweepRow, SaysWhyARowCannotBeRead) {
  const struct {
    std::string row;
    const char* problem;
  } kCases[] = {
      {"time,low,high", "does not begin with a date and a time: \"time,low,high\""},
      {"2020-01-01 00:00:00,1,2,1,1,-1",
       "does not begin with a date and a time: \"2020-01-01 00:00:00,1,2,1,1,-1\""},
      {"2020-01-01,00:00:0x,1,2,1,1,-1",
       "does not begin with a date and a time: \"2020-01-01,00:00:0x,1,2,1,1,-1\""},
      {std::string(50, 'x'),
       "does not begin with a date and a time: \"xxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxx...\""},
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
  for (const auto& testCase : kCases) {
    SweepRow row;
    std::string problem;
    EXPECT_FALSE(parseSweepRow(testCase.row, row, problem)) << testCase.row;
    EXPECT_EQ(problem, testCase.problem);
  }
}

TEST(SweepRow, TakesTheUnroundedStepWhereThePrintedOneAgrees) {
  const struct {
    const char* row;
    double stepHz;
  } kCases[] = {
      {"2020-01-01,00:00:00,0,1000000,333333.33,3,1,2,3", 1000000.0 / 3},
      {"2020-01-01,00:00:00,0,1000000,333333.40,3,1,2,3", 333333.40},  // 0.07 away: not a matter of rounding
      {"2020-01-01,00:00:00,0,9000000000000,1,3,1,2,3", 1.0},          // the range lies
  };
  for (const auto& testCase : kCases) {
    SweepRow row;
    std::string problem;
    ASSERT_TRUE(parseSweepRow(testCase.row, row, problem)) << problem;
    EXPECT_EQ(row.stepHz, testCase.stepHz) << testCase.row;
  }
}

TEST(SweepRow, RefusesMoreValuesThanASweepMayHave) {
  std::string text = "2020-01-01,00:00:00,0,100,1,1";
  text.append(kMaxSweepBins, ',');
  SweepRow row;
  std::string problem;
  EXPECT_TRUE(parseSweepRow(text + "1", row, problem));
  EXPECT_FALSE(parseSweepRow(text + ",1", row, problem));
  EXPECT_EQ(problem, "has more than 4194304 values");
}

}  // namespace
}  // namespace frontpanels

#include "framework/support/utility.h"

#include <gtest/gtest.h>

#include <limits>
#include <map>

#include "tests/support/fake_surface.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels::testing {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();

class UtilityTest : public ReportingTest {};

TEST_F(UtilityTest, Log10IsTheQuotientOfNaturalLogarithmsAndReportsWhatHasNone) {
  EXPECT_DOUBLE_EQ(Log10(0.01), -2);
  EXPECT_DOUBLE_EQ(Log10(2), 0.30102999566398120);
  EXPECT_EQ(Log10(1), 0);
  EXPECT_EQ(said(), "");
  for (const double none : {0.0, -2.5, kInfinity}) EXPECT_EQ(Log10(none), 0);
  EXPECT_EQ(said(),
            "Log10(0) ... \rInvalid procedure call or argument\n"
            "Log10(-2.5) ... \rInvalid procedure call or argument\nLog10(1.#INF) ... \rOverflow");
}

TEST_F(UtilityTest, OneTwoFiveRoundsAwayFromZeroAndAnswersTheSmallestStepWhenItsArithmeticFails) {
  const struct {
    double x;
    double step;
  } rows[] = {{1, 1},       {1.0001, 2},   {2, 2},         {2.0001, 5},      {3, 5},         {5, 5},
              {5.0001, 10}, {7, 10},       {9.99, 10},     {10, 10},         {10.001, 20},   {150, 200},
              {1000, 1000}, {1001, 2000},  {0.3, 0.5},     {0.2, 0.2},       {0.001, 0.001}, {0.0011, 0.002},
              {-3, -5},     {-0.07, -0.1}, {6e307, 1e308}, {1e-300, 1e-300}, {0, 0.0001},    {-0.0, 0.0001}};
  for (const auto& row : rows) EXPECT_DOUBLE_EQ(OneTwoFive(row.x), row.step) << row.x;
  EXPECT_EQ(said(), "");
  // 2E+308 is no double, nor is 1E-324.
  for (const double none : {1.7e308, -kInfinity, 5e-324}) EXPECT_EQ(OneTwoFive(none), 0.0001);
  EXPECT_EQ(said(),
            "OneTwoFive(1.7E+308) ... \rOverflow\nOneTwoFive(-1.#INF) ... \rOverflow\n"
            "OneTwoFive(4.94065645841247E-324) ... \rOverflow");
}

TEST_F(UtilityTest, BooleanValueReadsNumbersAndTheTwoWordsAndReportsAnythingElseAsFalse) {
  for (const char* text : {"-1", "1", "1e-3", "  true  ", "TrUe"}) EXPECT_TRUE(BooleanValue(text)) << text;
  for (const char* text : {"0", " 0.0 ", " False"}) EXPECT_FALSE(BooleanValue(text)) << text;
  EXPECT_EQ(said(), "");
  for (const char* text : {"yes", "", " truer "}) EXPECT_FALSE(BooleanValue(text)) << text;
  EXPECT_EQ(said(),
            "BooleanValue(yes) ... unrecognized input\r\nBooleanValue() ... unrecognized input\r\n"
            "BooleanValue( truer ) ... unrecognized input\r");
}

class RegionalSeparatorsTest : public ReportingTest {
 protected:
  struct CountingLocale : Locale {
    std::map<LocaleItem, std::string> values;
    mutable std::vector<std::pair<LocaleItem, std::int32_t>> asked;
    std::string info(LocaleItem item, std::int32_t maxChars) const override {
      return asked.emplace_back(item, maxChars), values.at(item);
    }
  } locale;
  RegionalSeparators separators{locale};
};

TEST_F(RegionalSeparatorsTest, ReadsTheFirstCharacterOfEachOnceAndKeepsIt) {
  locale.values = {{LocaleItem::DecimalSeparator, ",x"}, {LocaleItem::ListSeparator, "; "}};
  EXPECT_TRUE(locale.asked.empty());
  EXPECT_EQ(separators.decimalSeparator(), ",");
  EXPECT_EQ(separators.decimalSeparator(), ",");
  EXPECT_EQ(separators.listSeparator(), ";");
  // Of a buffer of 100 characters 99 are offered.
  EXPECT_EQ(locale.asked, (std::vector<std::pair<LocaleItem, std::int32_t>>{
                              {LocaleItem::DecimalSeparator, 99}, {LocaleItem::ListSeparator, 99}}));
}

TEST_F(RegionalSeparatorsTest, TakesAWholeCharacterAndTheUsualOneWhereTheSystemNamesNone) {
  locale.values = {{LocaleItem::DecimalSeparator, "\u066B"}, {LocaleItem::ListSeparator, ""}};
  EXPECT_EQ(separators.listSeparator(), ",");
  EXPECT_EQ(separators.RegionalValue(Variant(2.5)), "2\u066B5");
}

TEST_F(RegionalSeparatorsTest, RegionalValueRewritesNumbersAndLeavesOtherTextAlone) {
  locale.values = {{LocaleItem::DecimalSeparator, ","}};
  const struct {
    Variant value;
    const char* text;
  } rows[] = {{-82.5, "-82,5"},       {1.5F, "1,5"},        {"-0.25", "-0,25"}, {" 1.5e3 ", " 1,5e3 "},
              {std::int16_t{7}, "7"}, {"12", "12"},         {".5", ",5"},       {"a.b", "a.b"},
              {"1.2.3", "1.2.3"},     {"3.5 dB", "3.5 dB"}, {true, "True"},     {Variant(), ""}};
  for (const auto& row : rows) EXPECT_EQ(separators.RegionalValue(row.value), row.text);
  EXPECT_EQ(said(), "");
  EXPECT_EQ(separators.RegionalValue(Variant::null()), "");
  EXPECT_EQ(said(), "RegionalValue() ... \rInvalid use of Null");
}

TEST_F(RegionalSeparatorsTest, RegionalValueLeavesThePointWhereItIsTheUsersOwn) {
  const FixedLocale unchanging;
  RegionalSeparators usual(unchanging);
  EXPECT_EQ(usual.RegionalValue(Variant("1.5")), "1.5");
  EXPECT_EQ(usual.listSeparator(), ",");
  EXPECT_EQ(FixedLocale("12345").info(LocaleItem::DecimalSeparator, 4), "123");
}

struct FakeItemDataList : ItemDataList {
  std::vector<std::int32_t> data;

  std::int32_t listCount() const override { return static_cast<std::int32_t>(data.size()); }
  std::int32_t itemData(std::int32_t index) const override {
    return data.at(static_cast<std::size_t>(index));
  }
};

TEST(ItemDataLookUp, AnswersTheFirstMatchOrMinusOneUpToTheLastIndexOfSixteenBits) {
  FakeItemDataList list;
  EXPECT_EQ(indexOfItemData(list, 0), -1);
  list.data = {30, -7, 200000, -7};
  EXPECT_EQ(indexOfItemData(list, -7), 1);
  EXPECT_EQ(indexOfItemData(list, 200000), 2);
  EXPECT_EQ(indexOfItemData(list, 8), -1);
  list.data.assign(40000, 0);
  list.data[32767] = 1;
  list.data[32768] = 2;
  EXPECT_EQ(indexOfItemData(list, 1), 32767);
  EXPECT_EQ(indexOfItemData(list, 2), -1);
}

TEST_F(UtilityTest, AlwaysOnTopSetsTheStateAndReportsARefusal) {
  FakeWindowing windowing;
  AlwaysOnTop(windowing, WindowHandle{5}, true);
  EXPECT_EQ(said(), "");
  windowing.topmostWorks = false;
  AlwaysOnTop(windowing, WindowHandle{5}, false);
  EXPECT_EQ(said(), "AlwaysOnTop() ... SetWindowPos() failed\r");
  EXPECT_EQ(windowing.topmostCalls,
            (std::vector<std::pair<WindowHandle, bool>>{{WindowHandle{5}, true}, {WindowHandle{5}, false}}));
}

}  // namespace
}  // namespace frontpanels::testing

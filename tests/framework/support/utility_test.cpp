#include "framework/support/utility.h"

#include <gtest/gtest.h>

#include <limits>
#include <map>

#include "tests/support/fake_surface.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels::testing {
namespace {

using Messages = std::vector<std::string>;
constexpr double kInfinity = std::numeric_limits<double>::infinity();

class UtilityTest : public ReportingTest {};

TEST_F(UtilityTest, Log10IsTheQuotientOfNaturalLogarithms) {
  EXPECT_DOUBLE_EQ(Log10(0.01), -2);
  EXPECT_DOUBLE_EQ(Log10(2), 0.30102999566398120);
  EXPECT_EQ(Log10(1), 0);
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(UtilityTest, Log10ReportsWhatHasNoLogarithm) {
  EXPECT_EQ(Log10(0), 0);
  EXPECT_EQ(Log10(-2.5), 0);
  EXPECT_EQ(Log10(kInfinity), 0);
  EXPECT_EQ(messages(), (Messages{"Log10(0) ... \rInvalid procedure call or argument",
                                  "Log10(-2.5) ... \rInvalid procedure call or argument",
                                  "Log10(1.#INF) ... \rOverflow"}));
}

TEST_F(UtilityTest, OneTwoFiveRoundsAwayFromZero) {
  const struct {
    double x;
    double step;
  } rows[] = {{1, 1},       {1.0001, 2},   {2, 2},         {2.0001, 5},      {3, 5},         {5, 5},
              {5.0001, 10}, {7, 10},       {9.99, 10},     {10, 10},         {10.001, 20},   {150, 200},
              {1000, 1000}, {1001, 2000},  {0.3, 0.5},     {0.2, 0.2},       {0.001, 0.001}, {0.0011, 0.002},
              {-3, -5},     {-0.07, -0.1}, {6e307, 1e308}, {1e-300, 1e-300}, {0, 0.0001},    {-0.0, 0.0001}};
  for (const auto& row : rows) EXPECT_DOUBLE_EQ(OneTwoFive(row.x), row.step) << row.x;
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(UtilityTest, OneTwoFiveAnswersTheSmallestStepWhenItsArithmeticFails) {
  EXPECT_EQ(OneTwoFive(1.7e308), 0.0001);  // 2E+308 is no double
  EXPECT_EQ(OneTwoFive(-kInfinity), 0.0001);
  EXPECT_EQ(OneTwoFive(5e-324), 0.0001);  // 1E-324 is no double
  EXPECT_EQ(messages(), (Messages{"OneTwoFive(1.7E+308) ... \rOverflow", "OneTwoFive(-1.#INF) ... \rOverflow",
                                  "OneTwoFive(4.94065645841247E-324) ... \rOverflow"}));
}

TEST_F(UtilityTest, BooleanValueReadsNumbersAndTheTwoWords) {
  const struct {
    const char* text;
    bool value;
  } rows[] = {{"0", false},   {"-1", true},       {"1", true},    {" 0.0 ", false},
              {"1e-3", true}, {"  true  ", true}, {"TrUe", true}, {" False", false}};
  for (const auto& row : rows) EXPECT_EQ(BooleanValue(row.text), row.value) << row.text;
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(UtilityTest, BooleanValueReportsAnythingElseAsFalse) {
  EXPECT_FALSE(BooleanValue("yes"));
  EXPECT_FALSE(BooleanValue(""));
  EXPECT_FALSE(BooleanValue(" truer "));
  EXPECT_EQ(messages(),
            (Messages{"BooleanValue(yes) ... unrecognized input\r", "BooleanValue() ... unrecognized input\r",
                      "BooleanValue( truer ) ... unrecognized input\r"}));
}

class CountingLocale : public Locale {
 public:
  std::map<LocaleItem, std::string> values;
  mutable std::vector<std::pair<LocaleItem, std::int32_t>> asked;

  std::string info(LocaleItem item, std::int32_t maxChars) const override {
    asked.emplace_back(item, maxChars);
    return values.at(item);
  }
};

class RegionalSeparatorsTest : public ReportingTest {
 protected:
  CountingLocale locale;
  RegionalSeparators separators{locale};
};

TEST_F(RegionalSeparatorsTest, ReadsTheFirstCharacterOfEachOnceAndKeepsIt) {
  locale.values = {{LocaleItem::DecimalSeparator, ",x"}, {LocaleItem::ListSeparator, "; "}};
  EXPECT_TRUE(locale.asked.empty());
  EXPECT_EQ(separators.decimalSeparator(), ",");
  locale.values[LocaleItem::DecimalSeparator] = "!";
  EXPECT_EQ(separators.decimalSeparator(), ",");
  EXPECT_EQ(separators.listSeparator(), ";");
  // Of a buffer of 100 characters 99 are offered.
  using Asked = std::vector<std::pair<LocaleItem, std::int32_t>>;
  EXPECT_EQ(locale.asked, (Asked{{LocaleItem::DecimalSeparator, 99}, {LocaleItem::ListSeparator, 99}}));
}

TEST_F(RegionalSeparatorsTest, TakesAWholeCharacterAndTheUsualOneWhereTheSystemNamesNone) {
  locale.values = {{LocaleItem::DecimalSeparator, "\u066B"}, {LocaleItem::ListSeparator, ""}};
  EXPECT_EQ(separators.decimalSeparator(), "\u066B");
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
  EXPECT_EQ(messages(), Messages{});
  EXPECT_EQ(separators.RegionalValue(Variant::null()), "");
  EXPECT_EQ(messages(), Messages{"RegionalValue() ... \rInvalid use of Null"});
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

class ItemDataLookUp : public ReportingTest {
 protected:
  FakeItemDataList list;
};

TEST_F(ItemDataLookUp, AnswersTheFirstMatchOrMinusOne) {
  EXPECT_EQ(indexOfItemData(list, 0), -1);
  list.data = {30, -7, 200000, -7};
  EXPECT_EQ(indexOfItemData(list, -7), 1);
  EXPECT_EQ(indexOfItemData(list, 200000), 2);
  EXPECT_EQ(indexOfItemData(list, 8), -1);
}

TEST_F(ItemDataLookUp, ReachesTheLastIndexOfSixteenBitsAndNoFurther) {
  list.data.assign(40000, 0);
  list.data[32767] = 1;
  list.data[32768] = 2;
  EXPECT_EQ(indexOfItemData(list, 1), 32767);
  EXPECT_EQ(indexOfItemData(list, 2), -1);
}

TEST_F(UtilityTest, AlwaysOnTopSetsTheStateAndReportsARefusal) {
  FakeWindowing windowing;
  AlwaysOnTop(windowing, WindowHandle{5}, true);
  EXPECT_EQ(messages(), Messages{});
  windowing.topmostWorks = false;
  AlwaysOnTop(windowing, WindowHandle{5}, false);
  EXPECT_EQ(messages(), Messages{"AlwaysOnTop() ... SetWindowPos() failed\r"});
  using Calls = std::vector<std::pair<WindowHandle, bool>>;
  EXPECT_EQ(windowing.topmostCalls, (Calls{{WindowHandle{5}, true}, {WindowHandle{5}, false}}));
}

}  // namespace
}  // namespace frontpanels::testing

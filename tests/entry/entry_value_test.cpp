#include <cmath>
#include <limits>

#include "tests/entry/entry_field.h"

namespace frontpanels {
namespace {

class EntryValueTest : public testing::EntryFieldTest {};

void limit(clsNumericEntry& entry, double minimum, double maximum) {
  entry.MINIMUM(minimum);
  entry.MAXIMUM(maximum);
}

TEST_F(EntryValueTest, AValueIsSnappedMovedIntoTheLimitsAndRounded) {
  struct ValueCase {
    const char* rule;
    std::function<void(clsNumericEntry&)> settings;
    std::vector<std::pair<double, double>> values;  // set, got
  };
  const std::vector<ValueCase> cases = {
      {"limits", [](auto& e) { limit(e, -5, 10); }, {{-5.5, -5}, {-5, -5}, {3.25, 3.25}, {10, 10}, {11, 10}}},
      {"halves to the even multiple",
       [](auto& e) { e.resolution(0.5); },
       {{1.25, 1}, {1.75, 2}, {-1.25, -1}, {1.3, 1.5}}},
      {"after the limits", [](auto& e) { limit(e, 0, 1.3), e.resolution(0.5); }, {{9, 1.5}, {1.2, 1}}},
      {"step", [](auto& e) { e.step(0.1); }, {{0.34, 0.3}, {-0.36, -0.4}, {3e9 + 0.04, 3e9}}},
      {"nearest mantissa on a logarithmic scale, the lower at a tie, by magnitude",
       [](auto& e) {
         e.sequence({1, 2, 5});
       },
       {{1.41, 1},
        {1.42, 2},
        {3.1, 2},
        {3.2, 5},
        {7.1, 10},
        {0.007, 0.005},
        {-140, -100},
        {0, 0},
        {5e9, 5e9}}},
      {"tie",
       [](auto& e) {
         e.sequence({1, 4});
       },
       {{2, 1}, {20.1, 40}, {-200, -100}}},
      {"mantissas of any decade in any order, useless ones aside",
       [](auto& e) {
         e.sequence({50, 0.1, 0, Variant(), -7, 2, "two"});
       },
       {{6, 5}, {70, 50}, {72, 100}, {190, 200}}},
      {"then the step",
       [](auto& e) {
         e.sequence({1, 2.5}), e.step(2);
       },
       {{2.4, 2}, {30, 24}}},
      {"powers", [](auto& e) { e.power(2); }, {{700, 512}, {800, 1024}, {0.3, 0.25}}},
      {"a sequence goes before powers",
       [](auto& e) {
         e.power("2"), e.sequence({1, 5});
       },
       {{700, 500}}},
      {"no powers below 2", [](auto& e) { e.power(2), e.power(1.9); }, {{700, 700}}},
      {"arbitrary values are limited and rounded alone",
       [](auto& e) { e.Arbitrary(true), e.sequence({1}), e.step(10), e.resolution(0.5), limit(e, 0, 50); },
       {{3.3, 3.5}, {70, 50}}},
      {"taken back", [](auto& e) { e.sequence({1}), e.sequence({}), e.step(5), e.step({}); }, {{3, 3}}},
  };
  for (const ValueCase& c : cases) {
    for (const auto& [set, got] : c.values) {
      clsNumericEntry fresh;
      fresh.valueNoUpdate(0.125);
      c.settings(fresh);
      fresh.value(set);
      EXPECT_DOUBLE_EQ(fresh.value(), got) << c.rule << ", set to " << set;
    }
  }
  EXPECT_EQ(said(), "");
}

TEST_F(EntryValueTest, OutsideItsLimitsAValueMayChooseTheFirstRangeThatHoldsIt) {
  entry.frequencySuffix();
  for (const auto& [index, minimum] : {std::pair{6, 100}, {2, 200}, {4, 250}}) {
    entry.MinimumForRange(index, minimum);
    entry.MaximumForRange(index, minimum + 100);
    entry.FormatOffsetForRange(index, minimum);
    entry.FormatScaleForRange(index, 0.01);
  }
  limit(entry, 0, 90);
  entry.value(260);
  EXPECT_EQ(state(), "90 Hz = 90");  // not unless told to

  const auto range = [this] {
    return std::to_string(entry.range()) + ": " + numberToText(entry.MINIMUM()) + ".." +
           numberToText(entry.MAXIMUM()) + " " + state();
  };
  entry.autoChoose(true);
  entry.value(260);
  EXPECT_EQ(range(), "2: 200..300 6 kHz = 260");
  entry.value(300);
  EXPECT_EQ(range(), "2: 200..300 10 kHz = 300");  // both ends belong to a range
  entry.value(301);
  EXPECT_EQ(range(), "4: 250..350 5.1 kHz = 301");
  entry.value(999);
  EXPECT_EQ(range(), "4: 250..350 10 kHz = 350");  // none: the limits stay
  enter("1 kHz");
  EXPECT_EQ(range(), "4: 250..350 1 kHz = 260");  // offset and scale undone
  entry.autoChoose(false);
  entry.valueNoUpdate(120);
  EXPECT_EQ(range(), "4: 250..350 0 Hz = 250");
  entry.valueNoUpdateAutoChoose(120);
  EXPECT_EQ(range(), "6: 100..200 2 kHz = 120");
  entry.range(2);
  EXPECT_EQ(range(), "2: 200..300 -0.008 MHz = 120");  // the value waits for the next setting
  EXPECT_EQ(said(), "");

  entry.range(7);
  entry.range(-1);
  entry.range(0);
  EXPECT_EQ(said(),
            "clsNumericEntry::range() ... illegal value\r\nclsNumericEntry::range() ... illegal value\r\n"
            "clsNumericEntry::range() ... selected range is not valid\r");
  EXPECT_EQ(entry.range(), 2);
}

TEST_F(EntryValueTest, NewsIsWhatHasChangedTheValueLast) {
  limit(entry, 0, 100);
  entry.value(5);
  EXPECT_TRUE(entry.newValue() && entry.newValue());  // reading does not clear it
  entry.value(5);
  EXPECT_FALSE(entry.newValue());
  entry.valueNoUpdate(100);
  EXPECT_FALSE(entry.newValue());
  EXPECT_EQ(entry.previousValue(), 5);
  entry.value(200);  // moved to where it was
  EXPECT_FALSE(entry.newValue());
  entry.text("7");
  EXPECT_TRUE(entry.newValue());
  entry.Click();
  EXPECT_FALSE(entry.newValue());

  limit(entry, 10, 20);
  entry.value(7);  // the same, but no longer within the limits
  EXPECT_EQ(state(), "10 = 10");
  entry.formatString("0.0");
  EXPECT_EQ(state(), "10 = 10");
  entry.value(10);  // the same, but out of date on the screen
  EXPECT_EQ(state(), "10.0 = 10");
  type("11");
  entry.valueNoUpdate(10);
  EXPECT_EQ(state(), "10.0 = 10");
}

TEST_F(EntryValueTest, WhatCannotBeIsReportedAndChangesNothing) {
  entry.frequencySuffix();
  entry.value(900e3);
  struct BadCase {
    std::function<void(clsNumericEntry&)> call;
    std::string message;
  };
  const double inf = std::numeric_limits<double>::infinity();
  const std::string number = "Non-numeric value passed to clsNumericEntry::";
  const std::string argument = "Invalid procedure call or argument";
  const std::vector<BadCase> cases = {
      {[&](auto& e) { e.value(inf); }, "clsNumericEntry::value() failed. \rOverflow"},
      {[](auto& e) { e.valueNoUpdate(std::nan("")); }, "clsNumericEntry::value() failed. \rOverflow"},
      {[](auto& e) { e.resolution(1e-4), e.value(9e5 + 1), e.resolution({}); },  // not in 32 bits
       "clsNumericEntry::value() failed. \rOverflow"},
      {[](auto& e) { e.step(1e-320), e.value(2), e.step({}); },
       "clsNumericEntry::value() failed. \rOverflow"},
      {[](auto& e) { limit(e, 2, 1), e.value(5), limit(e, 0, 1e9); },
       "clsNumericEntry::value() failed. \r" + argument},
      {[](auto& e) { e.sequence({-1}), e.value(5), e.sequence({}); },
       "clsNumericEntry::chooseSequence() failed. \r" + argument},
      {[](auto& e) {
         e.sequence({1, 2, 3, 4, 5, 6, 7, 8, 9, 9, 9});
       },
       "clsNumericEntry::sequence() failed. \rSubscript out of range"},
      {[](auto& e) { e.power("two"); }, number + "power\r"},
      {[](auto& e) { e.resolution("fine"); }, number + "resolution\r"},
      {[](auto& e) { e.resolution(std::nan("")); }, number + "resolution\r"},
      {[](auto& e) { e.step("wide"); }, number + "step\r"},
      {[](auto& e) { e.resolution(0); }, "clsNumericEntry::resolution() failed. \r" + argument},
      {[](auto& e) { e.step(-1); }, "clsNumericEntry::step() failed. \r" + argument},
      {[&](auto& e) { e.MINIMUM(-inf); }, "clsNumericEntry::MINIMUM() failed. \rOverflow"},
      {[&](auto& e) { e.MAXIMUM(inf); }, "clsNumericEntry::MAXIMUM() failed. \rOverflow"},
      {[&](auto& e) { e.MaximumForRange(1, inf); }, "clsNumericEntry::MaximumForRange() failed. \rOverflow"},
      {[](auto& e) { e.MinimumForRange(7, 1); }, "clsNumericEntry::MinimumForRange()...invalid index\r"},
      {[](auto& e) { static_cast<void>(e.MinimumForRange(-1)); },
       "clsNumericEntry::MinimumForRange()...invalid index\r"},
      {[](auto& e) { e.MaximumForRange(7, 1); }, "clsNumericEntry::MaximumForRange()...invalid index\r"},
      {[](auto& e) { static_cast<void>(e.MaximumForRange(7)); },
       "clsNumericEntry::MaximumForRange()...invalid index\r"},
      {[](auto& e) { e.FormatOffsetForRange(-1, 1); },
       "clsNumericEntry::FormatOffsetForRange()...invalid index\r"},
      {[](auto& e) { static_cast<void>(e.FormatOffsetForRange(7)); },
       "clsNumericEntry::FormatOffsetForRange()...invalid index\r"},
      {[](auto& e) { e.FormatScaleForRange(7, 1); },
       "clsNumericEntry::FormatScaleForRange()...invalid index\r"},
      {[](auto& e) { static_cast<void>(e.FormatScaleForRange(7)); },
       "clsNumericEntry::FormatScaleForRange()...invalid index\r"},
      {[](auto& e) { e.text("5 parsecs"); }, "clsNumericEntry::LetText() failed. \rType mismatch"},
      {[](auto& e) { e.text(""); }, "clsNumericEntry::LetText() failed. \rType mismatch"},
  };
  limit(entry, 0, 1e9);
  for (const BadCase& c : cases) {
    c.call(entry);
    EXPECT_EQ(said(), c.message);
    EXPECT_EQ(state(), "900 kHz = 900000") << c.message;
    EXPECT_FALSE(entry.newValue()) << c.message;
    EXPECT_EQ(numberToText(entry.MINIMUM()) + ".." + numberToText(entry.MAXIMUM()), "0..1000000000");
  }
}

}  // namespace
}  // namespace frontpanels

#include <cmath>

#include "tests/entry/entry_field.h"
#include "tests/support/listed_records.h"

namespace frontpanels {
namespace {

using testing::ListedRecords;
using testing::sequence;
using Entry = clsNumericEntry;

class EntryValueTest : public testing::EntryFieldTest {
 protected:
  void limit(double minimum, double maximum) {
    entry.MINIMUM(minimum);
    entry.MAXIMUM(maximum);
  }
};

TEST_F(EntryValueTest, AValueIsSnappedMovedIntoTheLimitsAndRounded) {
  const std::vector<std::pair<std::function<void(Entry&)>, testing::Rows>> cases = {
      {[](Entry& e) { e.MINIMUM(-5), e.MAXIMUM(10); },
       {"-5.5 -> -5", "-5 -> -5", "3.25 -> 3.25", "11 -> 10"}},
      {[](Entry& e) { e.resolution(0.5); }, {"1.25 -> 1", "1.75 -> 2", "-1.25 -> -1", "1.3 -> 1.5"}},
      {[](Entry& e) { e.MAXIMUM(1.3), e.resolution(0.5); }, {"9 -> 1.5", "1.2 -> 1"}},  // after the limits
      {[](Entry& e) { e.step(0.1); }, {"0.34 -> 0.3", "-0.36 -> -0.4", "3000000000.04 -> 3000000000"}},
      {[](Entry& e) { e.step(5), e.step({}), e.sequence({1}), e.sequence({}); }, {"3 -> 3"}},
      // The nearest mantissa on a logarithmic scale (1 and 2 meet at 1.414), at a tie the lower one.
      {sequence(1, 2, 5),
       {"1.41 -> 1", "1.42 -> 2", "3.2 -> 5", "7.1 -> 10", "0.007 -> 0.005", "-140 -> -100", "0 -> 0",
        "5e9 -> 5000000000"}},
      {sequence(1, 4), {"2 -> 1", "20.1 -> 40", "-200 -> -100"}},
      {sequence(50, 0.1, 0, Variant(), -7, 2, "x"), {"6 -> 5", "70 -> 50", "72 -> 100"}},
      {[](Entry& e) { sequence(5, 3)(e), sequence(Variant(), 2)(e); }, {"3 -> 2", "4 -> 5"}},  // 5 has stayed
      {[](Entry& e) { e.step(2), sequence(1, 2.5)(e); }, {"2.4 -> 2", "30 -> 24"}},
      {[](Entry& e) { e.power(2); }, {"700 -> 512", "800 -> 1024", "0.3 -> 0.25"}},
      {[](Entry& e) { e.power("2"), sequence(1, 5)(e); }, {"700 -> 500"}},
      {[](Entry& e) { e.power(1e300); }, {"1e308 -> 1E+300"}},  // no double lies above
      {[](Entry& e) { e.power(2), e.power(1.9); }, {"700 -> 700"}},
      {[](Entry& e) { e.Arbitrary(true), e.sequence({1}), e.step(10), e.resolution(0.5); }, {"3.3 -> 3.5"}},
  };
  for (const auto& [settings, rows] : cases) {
    const auto set = [&settings = settings](const std::string& value) {
      Entry fresh;
      fresh.valueNoUpdate(0.125);
      settings(fresh);
      fresh.value(Variant(value).toDouble());
      return numberToText(fresh.value());
    };
    EXPECT_EQ(testing::found(rows, set), rows);
  }
  entry.step(0.1);
  entry.value(0.3);
  EXPECT_EQ(entry.value(), 0.3);  // and not three times the double of 0.1
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
  limit(0, 90);
  play({{[&] { entry.value(260); }, "90 Hz = 90 in 0: 0..90"},  // not unless told to
        {[&] { entry.autoChoose(true), entry.value(260); }, "6 kHz = 260 in 2: 200..300"},
        {[&] { entry.value(300); }, "10 kHz = 300 in 2: 200..300"},  // both ends belong to a range
        {[&] { entry.value(301); }, "5.1 kHz = 301 in 4: 250..350"},
        {[&] { entry.value(999); }, "10 kHz = 350 in 4: 250..350"},          // no range: clamped
        {[&] { key("1 kHz", 13); }, "1 kHz = 260 told 260 in 4: 250..350"},  // offset and scale undone
        {[&] { entry.autoChoose(false), entry.valueNoUpdate(120); }, "0 Hz = 250 in 4: 250..350"},
        {[&] { entry.valueNoUpdateAutoChoose(120); }, "2 kHz = 120 in 6: 100..200"},
        {[&] { entry.range(2); }, "-0.008 MHz = 120 in 2: 200..300"}},  // the value waits for the next one
       true);
}

TEST_F(EntryValueTest, NewsIsWhatHasChangedTheValueLast) {
  const auto news = [this](double value) {
    entry.value(value);
    return entry.newValue() && entry.newValue();  // reading does not clear it
  };
  limit(0, 100);
  EXPECT_TRUE(news(5));
  EXPECT_FALSE(news(5));
  entry.valueNoUpdate(100);
  EXPECT_FALSE(entry.newValue());
  EXPECT_EQ(entry.previousValue(), 5);
  EXPECT_FALSE(news(200));  // moved to where it was
  entry.text("7");
  EXPECT_TRUE(entry.newValue());
  limit(10, 20);
  play({{[&] { entry.value(7); }, "10 = 10"},  // the same, but no longer within the limits
        {[&] { entry.formatString("0.0"); }, "10 = 10"},
        {[&] { entry.value(10); }, "10.0 = 10"},  // the same, but out of date on the screen
        {[&] { box.userText("11"), entry.valueNoUpdate(10); }, "10.0 = 10"}});
}

TEST_F(EntryValueTest, WhatCannotBeIsReportedAndChangesNothing) {
  const std::vector<std::pair<std::function<void(Entry&)>, std::string>> cases = {
      {[](Entry& e) { e.value(HUGE_VAL); }, "::value() failed. \rOverflow"},
      {[](Entry& e) { e.valueNoUpdate(std::nan("")); }, "::value() failed. \rOverflow"},
      {[](Entry& e) { e.resolution(1e-4), e.value(8e5), e.resolution({}); }, "::value() failed. \rOverflow"},
      {[](Entry& e) { e.step(1e-320), e.value(2), e.step({}); }, "::value() failed. \rOverflow"},
      {[](Entry& e) { e.MAXIMUM(-1), e.value(5), e.MAXIMUM(1e9); },
       "::value() failed. \rInvalid procedure call or argument"},
      {[](Entry& e) { e.sequence({-1}), e.value(5), e.sequence({}); },
       "::chooseSequence() failed. \rInvalid procedure call or argument"},
      {sequence(1, 2, 3, 4, 5, 6, 7, 8, 9, 9, 9), "::sequence() failed. \rSubscript out of range"},
      {[](Entry& e) { e.power("two"); }, "Non-numeric value passed to clsNumericEntry::power\r"},
      {[](Entry& e) { e.resolution("x"); }, "Non-numeric value passed to clsNumericEntry::resolution\r"},
      {[](Entry& e) { e.step(std::nan("")); }, "Non-numeric value passed to clsNumericEntry::step\r"},
      {[](Entry& e) { e.resolution(0); }, "::resolution() failed. \rInvalid procedure call or argument"},
      {[](Entry& e) { e.MINIMUM(-HUGE_VAL); }, "::MINIMUM() failed. \rOverflow"},
      {[](Entry& e) { e.MAXIMUM(HUGE_VAL); }, "::MAXIMUM() failed. \rOverflow"},
      {[](Entry& e) { e.MaximumForRange(1, HUGE_VAL); }, "::MaximumForRange() failed. \rOverflow"},
      {[](Entry& e) { e.MinimumForRange(7, 1); }, "::MinimumForRange()...invalid index\r"},
      {[](Entry& e) { e.MaximumForRange(-1, 1); }, "::MaximumForRange()...invalid index\r"},
      {[](Entry& e) { e.FormatOffsetForRange(7, 1); }, "::FormatOffsetForRange()...invalid index\r"},
      {[](Entry& e) { e.FormatScaleForRange(7, 1); }, "::FormatScaleForRange()...invalid index\r"},
      {[](Entry& e) { (void)e.MinimumForRange(-1); }, "::MinimumForRange()...invalid index\r"},
      {[](Entry& e) { (void)e.MaximumForRange(7); }, "::MaximumForRange()...invalid index\r"},
      {[](Entry& e) { (void)e.FormatOffsetForRange(7); }, "::FormatOffsetForRange()...invalid index\r"},
      {[](Entry& e) { (void)e.FormatScaleForRange(7); }, "::FormatScaleForRange()...invalid index\r"},
      {[](Entry& e) { e.range(7); }, "::range() ... illegal value\r"},
      {[](Entry& e) { e.range(-1); }, "::range() ... illegal value\r"},
      {[](Entry& e) { e.range(1); }, "::range() ... selected range is not valid\r"},
      {[](Entry& e) { e.text(""); }, "::LetText() failed. \rType mismatch"},
  };
  limit(0, 1e9);
  entry.valueNoUpdate(900e3);
  for (const auto& [call, message] : cases) {
    call(entry);
    EXPECT_EQ(said(), (message[0] == ':' ? "clsNumericEntry" : "") + message);
    EXPECT_EQ(limits() + " " + state(), "0: 0..1000000000 900000 = 900000") << message;
    EXPECT_FALSE(entry.newValue()) << message;
  }
}

TEST_F(EntryValueTest, LimitsComeFromTheHostOrFromAnotherEntry) {
  using Record = ListedRecords::Record;
  const auto record = [](const Variant& order, const Variant& minimum, const Variant& maximum) {
    return Record{{"[Order]", order}, {"[Minimum]", minimum}, {"[Maximum]", maximum}};
  };
  const auto give = [this](std::vector<Record> records) {
    return [this, records] { entry.Limits(ListedRecords(records)); };
  };
  entry.FormatScaleForRange(2, 0.5);
  entry.valueNoUpdate(1);
  play({{give({record(2, 10, "20"), record(0, 5, 6)}), "1 = 1 in 0: 5..6"},
        {give({record(3, 30, 40), record(2, 10, 20)}), "1 = 1 in 2: 10..20"},  // the chosen one has gone
        {[&] { entry.reformat(), entry.formatScale(0.25); }, "2 = 1 in 2: 10..20"},
        {give({record(2, 11, 21)}), "2 = 1 in 2: 11..21"},
        {give({}), "2 = 1 in 2: 11..21"},
        {give({record(2, 11, 11)}), "2 = 1 in 2: 11..11"},
        {[&] { entry.reformat(); }, "4 = 1 in 2: 11..11"}},
       true);

  const char* const notNumeric = "::Limits() ... non-numeric range argument\r";
  const std::vector<std::pair<Record, std::string>> bad = {
      {record(1, "low", 2), notNumeric},
      {record(1, 1, Variant()), notNumeric},
      {record("first", 1, 2), notNumeric},
      {record(1, std::nan(""), 2), notNumeric},
      {record(7, 1, 2), "::Limits() ... order of no range\r"},
      {record(-1, 1, 2), "::Limits() ... order of no range\r"},
      {record(1, 2, 1), "::Limits() ... minimum above maximum\r"},
      {{{"[Minimum]", 1}, {"[Maximum]", 1}}, "::Limits() failed. \rInvalid procedure call or argument"}};
  for (const auto& [wrong, message] : bad) {
    give({record(0, 1, 2), wrong})();
    EXPECT_EQ(said() + limits(), "clsNumericEntry" + message + "2: 11..11");
  }

  EntryField stop;
  stop.entry.FormatOffsetForRange(2, 3);
  stop.entry.CopyLimits(entry);
  entry.step(3);
  entry.suffix("units", 0, 1);
  entry.Clear();
  EXPECT_EQ(limits(), "0: -1.79769313486232E+308..1.79769313486232E+308");
  EXPECT_TRUE(entry.step().isEmpty() && entry.suffixes().count() == 0);
  EXPECT_EQ(stop.limits(), "2: 11..11");
  EXPECT_EQ(stop.entry.formatOffset() + stop.entry.formatScale(), 3 + 1);  // how it shows values is its own
}

}  // namespace
}  // namespace frontpanels

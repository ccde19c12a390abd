#include "entry/entry_steps.h"

#include <cmath>
#include <random>

#include "tests/entry/entry_field.h"

namespace frontpanels {
namespace {

class EntryStepsTest : public testing::EntryFieldTest {};

TEST_F(EntryStepsTest, ClicksGoThroughDecadesUnitsAndSteps) {
  struct ClickCase {
    std::function<void(clsNumericEntry&)> settings;
    double from;
    int clicks;
    const char* texts;
  };
  const std::vector<ClickCase> cases = {
      // A sequence: the next mantissa, the next decade beyond the last one.
      {[](auto& e) {
         e.sequence({1, 2, 5});
       },
       2, 4, "5, 10, 20, 50"},
      {[](auto& e) {
         e.sequence({1, 2, 5});
       },
       20, -6, "10, 5, 2, 1, 0.5, 0.2"},
      {[](auto& e) {
         e.sequence({1, 2, 5});
       },
       -2, 3, "-1, -0.5, -0.2"},
      {[](auto& e) {
         e.sequence({1, 2, 5});
       },
       -2, -3, "-5, -10, -20"},
      {[](auto& e) {
         e.sequence({1, 3, 10}), e.step(1);
       },
       1, 3, "3, 10, 30"},  // before the step
      {[](auto& e) {
         e.sequence({1.2, 4.7}), e.formatString("0.####");
       },
       0.0047, 2, "0.012, 0.047"},
      {[](auto& e) {
         e.Arbitrary(true), e.sequence({1, 2, 5});
       },
       3, 1, "5"},
      {[](auto& e) {
         e.Arbitrary(true), e.sequence({1, 2, 5});
       },
       3, -1, "2"},
      {[](auto& e) {
         e.sequence({2, 5}), e.timeSuffix();
       },
       0, 2, "2 ns, 5 ns"},  // nothing is next to 0
      {[](auto& e) {
         e.sequence({2, 5});
       },
       0, -2, "-2, -5"},
      {[](auto& e) { e.power(2); }, 8, 3, "16, 32, 64"},
      {[](auto& e) { e.power(2); }, 1, -2, "0.5, 0.25"},
      // Neither sequence nor step: one of the unit, of the next one at a limit going up, of the one before
      // going down.
      {[](auto& e) { e.frequencySuffix(); }, 998, 4, "999 Hz, 1 kHz, 2 kHz, 3 kHz"},
      {[](auto& e) { e.frequencySuffix(); }, 998e3, 3, "999 kHz, 1 MHz, 2 MHz"},
      {[](auto& e) { e.frequencySuffix(); }, 2e6, -3, "1 MHz, 999 kHz, 998 kHz"},
      {[](auto& e) { e.frequencySuffix(); }, 2e3, -3, "1 kHz, 999 Hz, 998 Hz"},
      {[](auto& e) { e.frequencySuffix(); }, 1, -2, "0 Hz, -0.000001 MHz"},
      // The gap from 1 to 10 GHz: at its lower end the next unit is GHz, within it the one that is shown.
      {[](auto& e) { e.frequencySuffix(); }, 999e6, 3, "1000 MHz, 2000 MHz, 2001 MHz"},
      {[](auto& e) { e.frequencySuffix(); }, 9.999e9, 3, "10 GHz, 11 GHz, 12 GHz"},
      {[](auto& e) { e.frequencySuffix(); }, 11e9, -3, "10 GHz, 9999 MHz, 9998 MHz"},
      {[](auto& e) { e.frequencySuffix(); }, 1.001e9, -3, "1000 MHz, 999 MHz, 998 MHz"},
      {[](auto& e) { e.suffix("x", 0, 10, 3); }, 30, 2, "11 x, 12 x"},  // nothing beyond the last limit
      {[](auto& e) { e.timeSuffix(); }, 998e-6, 4, "999 us, 1 ms, 2 ms, 3 ms"},
      {[](auto& e) { e.timeSuffix(); }, 2e-3, -3, "1 ms, 999 us, 998 us"},
      {[](auto& e) { e.dBmSuffix(); }, -1.5, 3, "-0.5 dBm, 0.5 dBm, 1.5 dBm"},
      {[](auto&) {}, 7, -2, "6, 5"},
      // By what is shown: channel 7 is the seventh 30 kHz above 870 MHz.
      {[](auto& e) { e.formatOffset(870e6), e.formatScale(30e3); }, 870.21e6, 2, "8, 9"},
      // A step.
      {[](auto& e) { e.step(0.1), e.frequencySuffix(); }, 0.1, 3, "0.2 Hz, 0.3 Hz, 0.4 Hz"},
      {[](auto& e) { e.step(5), e.Arbitrary(true); }, 12, 2, "17, 22"},
      {[](auto& e) { e.step(5), e.Arbitrary(true), e.NormalizeAsStep(true); }, 12, 3, "15, 20, 25"},
      {[](auto& e) { e.step(5), e.Arbitrary(true), e.NormalizeAsStep(true); }, 12, -3, "10, 5, 0"},
      {[](auto& e) { e.step(0.1), e.Arbitrary(true), e.NormalizeAsStep(true); }, 0.3, 2, "0.4, 0.5"},
      {[](auto& e) { e.step(4), e.MAXIMUM(10), e.resolution(4); }, 4, 3, "8, 8, 8"},
  };
  for (const ClickCase& c : cases) {
    testing::EntryField field;
    c.settings(field.entry);
    field.entry.valueNoUpdate(c.from);
    EXPECT_EQ(field.clicks(c.clicks), c.texts) << "from " << c.from;
  }
  EXPECT_EQ(said(), "");
}

TEST_F(EntryStepsTest, AClickStartsFromTheTypedTextAndGivesTheBoxTheFocus) {
  entry.frequencySuffix();
  entry.formatString("0.#");
  entry.valueNoUpdate(1234567);
  EXPECT_EQ(clicks(1), "2.2 MHz");
  EXPECT_EQ(entry.value(), 2234567);  // not from the 1.2 MHz that the text says
  EXPECT_TRUE(box.hasFocus() && box.allSelected());
  EXPECT_EQ(told, " 2234567");

  box.userText("5 k");
  EXPECT_EQ(clicks(-1), "4 kHz");
  EXPECT_EQ(told, " 2234567 4000");  // once, for the click

  entry.MAXIMUM(4000);
  box.userText("9");
  EXPECT_EQ(clicks(1), "4 kHz");
  EXPECT_EQ(told, " 2234567 4000");

  for (const char* text : {"five", ""}) {
    box.userText(text);
    spin.press(true);
    spin.press(false);
    EXPECT_EQ(said(), "clsNumericEntry::upClick() failed. \r\nclsNumericEntry::downClick() failed. \r");
    EXPECT_EQ(state(), std::string(text) + " = 4000");
  }
  entry.sequence({0});
  entry.reformat();
  spin.press(true);
  EXPECT_EQ(said(), "clsNumericEntry::upClick() failed. \rInvalid procedure call or argument");
  EXPECT_EQ(told, " 2234567 4000");

  clsNumericEntry alone;  // without a box there is no text to fail on
  bindEntry(alone, nullptr, &spin, {});
  alone.formatScale(0);
  spin.press(true);
  EXPECT_EQ(said(), "clsNumericEntry::upClick() failed. \rDivision by zero");
  alone.step(2);
  alone.formatScale(1);
  spin.press(true);
  EXPECT_EQ(alone.text(), "2");
}

// Whatever is typed or clicked, the text shown reads as the value shown, and what is refused changes nothing.
TEST_F(EntryStepsTest, AnyTextThatIsShownReadsBackAsTheValue) {
  using Set = void (clsNumericEntry::*)();
  using C = clsNumericEntry;
  const std::vector<Set> sets = {&C::noSuffix,   &C::frequencySuffix, &C::timeSuffix, &C::longTimeSuffix,
                                 &C::voltSuffix, &C::meterSuffix,     &C::byteSuffix, &C::dBmSuffix};
  std::mt19937 random(4711);
  const auto upTo = [&random](int count) {
    return static_cast<int>(random() % static_cast<unsigned>(count));
  };
  for (int round = 0; round < 3000; ++round) {
    testing::EntryField field;
    clsNumericEntry& e = field.entry;
    (e.*sets[static_cast<std::size_t>(upTo(8))])();
    e.MinimumForRange(upTo(7), -1e3);
    e.MaximumForRange(upTo(7), 1e11);
    e.FormatScaleForRange(upTo(7), 30e3);
    e.FormatOffsetForRange(upTo(7), upTo(1000));
    e.autoChoose(upTo(2) == 0);
    e.MINIMUM(-upTo(1000));
    e.MAXIMUM(1 + upTo(1000));
    e.suppressSuffix(upTo(4) == 0);
    e.decimalSeparator(upTo(2) == 0 ? "," : "");
    const double unit = std::pow(10, upTo(24) - 12);
    e.value((upTo(2000) - 200) * unit);
    for (int clicks = upTo(4); clicks > 0; --clicks) field.spin.press(upTo(2) == 0);
    const double value = e.value();
    const std::string text = field.box.Text();
    // The 15 digits of a text tell values apart as far as the offset leaves them room.
    const double room = 1e-14 * (std::fabs(value) + std::fabs(e.formatOffset()));
    EXPECT_NEAR(e.textToNumeric().value_or(HUGE_VAL), value, room) << text;
    field.leave(text + " ");
    EXPECT_NEAR(e.value(), value, room) << text;
    field.leave(text + "?");
    EXPECT_EQ(field.beeps, 1) << text;
    EXPECT_NEAR(e.value(), value, room) << text;
  }
  EXPECT_EQ(said(), "");
}

}  // namespace
}  // namespace frontpanels

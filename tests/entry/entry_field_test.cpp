#include "tests/entry/entry_field.h"

#include <algorithm>
#include <cmath>
#include <random>

#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

using Entry = clsNumericEntry;
using testing::sequence;

class EntryEventsTest : public testing::EntryFieldTest {
 protected:
  void setUp(const char* format = "") {
    entry.frequencySuffix();
    entry.formatString(format);
    entry.MINIMUM(0);
    entry.MAXIMUM(1e12);
    entry.valueNoUpdate(900e3);
  }
};

TEST_F(EntryEventsTest, ClicksGoThroughDecadesUnitsAndSteps) {
  // A value, the direction, and the text after each of as many clicks.
  const std::vector<std::pair<std::function<void(Entry&)>, testing::Rows>> cases = {
      // A sequence: the next mantissa, the next decade beyond the last one. Nothing is next to 0.
      {sequence(1, 2, 5),
       {"20 up -> 50, 100, 200", "20 down -> 10, 5, 2, 1, 0.5", "-2 up -> -1, -0.5",
        "-2 down -> -5, -10, -20", "3 up -> 5", "3 down -> 2", "0 down -> -1, -2"}},
      {[](Entry& e) { e.timeSuffix(), sequence(2, 5)(e); }, {"0 up -> 2 ns, 5 ns"}},
      {[](Entry& e) { e.step(1), sequence(1, 3, 10)(e); }, {"1 up -> 3, 10, 30"}},  // before the step
      {sequence(1.06, 4.7), {"0.0047 up -> 0.0106, 0.047", "10.6 up -> 47, 106"}},  // 1.06 * 10 is a bit more
      {[](Entry& e) { e.power(2); }, {"1 down -> 0.5, 0.25", "8 up -> 16, 32"}},
      // Neither sequence nor step: one of the unit, of the next one at a limit going up, of the one before
      // going down. In the gap from 1 to 10 GHz it is the unit that is shown, at its lower end GHz.
      {[](Entry& e) { e.frequencySuffix(); },
       {"998 up -> 999 Hz, 1 kHz, 2 kHz", "998e3 up -> 999 kHz, 1 MHz, 2 MHz",
        "2e6 down -> 1 MHz, 999 kHz, 998 kHz", "1 down -> 0 Hz, -0.000001 MHz",
        "999e6 up -> 1000 MHz, 2000 MHz, 2001 MHz", "9.999e9 up -> 10 GHz, 11 GHz",
        "11e9 down -> 10 GHz, 9999 MHz, 9998 MHz", "1.001e9 down -> 1000 MHz, 999 MHz"}},
      {[](Entry& e) { e.timeSuffix(); }, {"998e-6 up -> 999 us, 1 ms, 2 ms", "2e-3 down -> 1 ms, 999 us"}},
      {[](Entry& e) { e.suffix("x", 0, 10, 3); }, {"30 up -> 11 x, 12 x"}},  // nothing beyond the last limit
      // By what is shown: channel 7 is the seventh 30 kHz above 870 MHz.
      {[](Entry& e) { e.formatOffset(870e6), e.formatScale(30e3); }, {"870.21e6 up -> 8, 9"}},
      {[](Entry& e) { e.step(0.1), e.dBSuffix(); }, {"0.1 up -> 0.2 dB, 0.3 dB, 0.4 dB"}},
      {[](Entry& e) { e.step(5), e.Arbitrary(true); }, {"12 up -> 17, 22"}},
      {[](Entry& e) { e.step(5), e.Arbitrary(true), e.NormalizeAsStep(true); },
       {"12 up -> 15, 20", "12 down -> 10, 5"}},
      {[](Entry& e) { e.step(0.1), e.Arbitrary(true), e.NormalizeAsStep(true); }, {"0.3 up -> 0.4, 0.5"}},
      {[](Entry& e) { e.step(4), e.MAXIMUM(10), e.resolution(4); }, {"4 up -> 8, 8, 8"}},
  };
  for (const auto& [settings, rows] : cases)
    for (const std::string& row : rows) {
      testing::EntryField field;
      field.entry.valueNoUpdate(Variant(row.substr(0, row.find(' '))).toDouble());
      settings(field.entry);
      const auto count = std::ranges::count(row, ',') + 1;
      const std::string texts = field.clicks(static_cast<int>(count), row.find(" up ") != row.npos);
      EXPECT_EQ(row.substr(row.find("->") + 3), texts) << row;
    }
  EXPECT_EQ(said(), "");
}

TEST_F(EntryEventsTest, AClickStartsFromTheTypedTextAndGivesTheBoxTheFocus) {
  setUp("0.#");
  entry.valueNoUpdate(1234567);
  play({{[&] { spin.press(true); }, "2.2 MHz = 2234567 told 2234567"},  // not from the 1.2 MHz of the text
        {[&] { box.userText("5 k"), spin.press(false); }, "4 kHz = 4000 told 4000"},  // once, for the click
        {[&] { entry.MAXIMUM(4000), box.userText("9"), spin.press(true); }, "4 kHz = 4000"}});
  EXPECT_TRUE(box.hasFocus() && box.allSelected());
  EXPECT_EQ(said(), "");
  play({{[&] { box.userText("five"), spin.press(true); }, "five = 4000"},
        {[&] { box.userText(""), spin.press(false); }, " = 4000"}});
  clsNumericEntry alone;  // without a box there is no text to fail on
  bindEntry(alone, nullptr, &spin, {});
  alone.formatScale(0);
  spin.press(true);
  alone.sequence({0});
  spin.press(true);
  EXPECT_EQ(said(),
            "clsNumericEntry::upClick() failed. \r\nclsNumericEntry::downClick() failed. \r\n"
            "clsNumericEntry::upClick() failed. \rDivision by zero\n"
            "clsNumericEntry::upClick() failed. \rInvalid procedure call or argument");
  alone.sequence({3});
  alone.formatScale(1);
  spin.press(true);
  EXPECT_EQ(alone.text(), "3");
}

TEST_F(EntryEventsTest, KeysTakeATextOverOrStep) {
  // A text, and at its end the key that is pressed.
  const testing::Rows keys = {"800\r -> 800 kHz = 800000 told 800000",
                              "1.6ghz\r -> 1600 MHz = 1600000000 told 1600000000",
                              "900 KHZ\r -> 900 kHz = 900000",  // the same value, written as it should be
                              "2e12\r -> 1000 GHz = 1000000000000 told 1000000000000",
                              "1,000\r -> 1,000 = 900000 beep",  // stays to be corrected
                              "\r ->  = 900000 beep",
                              "700k -> 700 kHz = 700000 told 700000",
                              "5 M -> 5 MHz = 5000000 told 5000000",
                              "12h -> 12 Hz = 12 told 12",
                              "0.9m -> 900 kHz = 900000",
                              "12..g -> 12.. = 900000 beep",
                              "800& -> 801 kHz = 801000 told 801000",
                              "800( -> 799 kHz = 799000 told 799000",
                              "8005 -> 8005 = 900000 going on",
                              "800z -> 800z = 900000 going on",
                              "800\b -> 80 = 900000 going on"};
  setUp();
  const auto press = [this](const std::string& typed) {
    entry.valueNoUpdate(900e3);
    key(typed.substr(0, typed.size() - 1), typed.back());
    return state() + (box.allSelected() ? "" : " going on");
  };
  EXPECT_EQ(testing::found(keys, press), keys);
  const testing::Rows units = {"700 kHz -> 700 kHz", "5 mhZ -> 5 MHz", "12hz -> 12 Hz",
                               "3kHz4 -> 4",         "3kz -> z",       "3kHzz -> z"};
  const auto spell = [this](const std::string& typed) {
    box.selectAll();
    for (const char letter : typed) box.userKey(letter);
    return std::string(box.Text());
  };
  EXPECT_EQ(testing::found(units, spell), units);
  entry.valueNoUpdate(900e3);
  entry.reformat();
  static_cast<void>(state());
  play(
      {{[&] { box.KeyDown(38, 0); }, "901 kHz = 901000 told 901000"},
       {[&] { box.KeyDown(38, 1), box.KeyDown(39, 0); }, "901 kHz = 901000"},  // with shift it is another key
       {[&] { box.KeyDown(40, 0); }, "900 kHz = 900000 told 900000"}});
  EXPECT_EQ(said(), "");
}

TEST_F(EntryEventsTest, LeavingTheFieldTakesAChangedTextOverOrBringsTheLastGoodOneBack) {
  setUp("0.#");
  entry.valueNoUpdate(1234567);
  play({{[&] { leave("1.2 MHz"); }, "1.2 MHz = 1234567"},  // as it was written: the exact value stays
        {[&] { key("1.2 MHz", 13); }, "1.2 MHz = 1234567"},
        {[&] { leave("1.2"); }, "1.2 MHz = 1200000 told 1200000"},
        {[&] { leave("3,5 MHz"); }, "1.2 MHz = 1200000 beep"},
        {[&] { leave(" "); }, "1.2 MHz = 1200000 beep"},
        {[&] { entry.decimalSeparator(","), leave("3,5 MHz"); }, "3,5 MHz = 3500000 told 3500000"},
        {[&] { entry.preserveBlankEntry(true), leave(" "); }, " = 3500000 told 3500000"},
        {[&] { leave(" "); }, " = 3500000"},
        {[&] { entry.valueNoUpdate(3.5e6); }, "3,5 MHz = 3500000"},
        {[&] { leave("3,5 M"); }, "3,5 MHz = 3500000"},
        {[&] { entry.text(""), entry.valueNoUpdate(1000); }, "1 kHz = 1000"},
        {[&] { entry.preserveBlankEntry(false), entry.blank(), leave(""); }, " = 1000"},  // nobody changed it
        {[&] { entry.valueNoUpdate(1000); }, "1 kHz = 1000"}});
  EXPECT_EQ(said(), "");
  play({{[&] { entry.resolution(1e-9), leave("3"); }, "1 kHz = 1000 beep"}});
  box.focusChanged(true);
  EXPECT_TRUE(box.allSelected());
}

TEST_F(EntryEventsTest, EveryEventSaysWhetherItHasChangedTheValue) {
  using E = Entry;
  constexpr void (E::*kIdle[])() = {&E::GotFocus, &E::LostFocus, &E::change,    &E::Click,     &E::DblClick,
                                    &E::DragDrop, &E::DragOver,  &E::LinkClose, &E::LinkError, &E::LinkNotify,
                                    &E::LinkOpen, &E::MouseDown, &E::MouseMove, &E::MouseUp};
  const auto isNews = [this](auto event) {
    entry.value(entry.value() + 1);
    EXPECT_TRUE(entry.newValue());
    event();
    return entry.newValue();
  };
  for (const auto event : kIdle) EXPECT_FALSE(isNews([&] { (entry.*event)(); }));
  std::int16_t character = '5';
  EXPECT_FALSE(isNews([&] { entry.KeyUp(38, 0); }));
  EXPECT_FALSE(isNews([&] { entry.KeyDown(65, 0); }));
  EXPECT_FALSE(isNews([&] { entry.KeyPress(character); }));
  EXPECT_EQ(character, '5');
  box.Change = [this] { entry.change(); };  // raised while the text is written
  EXPECT_TRUE(isNews([&] { entry.upClick(); }));
}

TEST_F(EntryEventsTest, WhatFailsOutsideIsReportedInTheRoutinesName) {
  struct Failing : ControlPeer {
    void changed(ControlChange what) override {
      if (what == ControlChange::Selection || what == ControlChange::Font) raiseOutOfMemory();
    }
    void takeFocus() override {}
    void beep() override { raiseOutOfMemory(); }
  } failing;
  setUp();
  box.peer(&failing);
  box.focusChanged(true);
  key("6", 13);
  leave("six");
  entry.downClick();
  entry.Bold(true);
  box.Change = [] { raiseOutOfMemory(); };
  entry.value(7);
  entry.formatScale(0);
  entry.value(8);
  EXPECT_EQ(said(),
            "clsNumericEntry::GotFocus() failed. \rOut of memory\n"
            "clsNumericEntry::KeyPress() failed. \rOut of memory\n"
            "clsNumericEntry::LostFocus() failed. \rOut of memory\n"
            "clsNumericEntry::downClick() failed. \rOut of memory\n"
            "clsNumericEntry::Bold() failed. \rOut of memory\n"
            "clsNumericEntry::reformat() failed. \rOut of memory\n"
            "clsNumericEntry::formatter() failed. \rDivision by zero\n"
            "clsNumericEntry::reformat() failed. \rOut of memory");
  EXPECT_EQ(state(), " = 8 told 6000");  // what had changed was told all the same
}

TEST_F(EntryEventsTest, TheFieldIsEnabledWhilePanelAndLinkAllowIt) {
  const auto expect = [this](const char* expected) {
    EXPECT_TRUE(box.Enabled() == spin.Enabled() && spin.Enabled() == label.Enabled());
    EXPECT_EQ(box.Text() + (entry.Enabled() ? " on" : " off"), expected);
  };
  setUp();
  entry.linkEnable(false), entry.Enabled(true), expect("900 kHz off");
  entry.clearIfDisabled(true), expect(" off");
  entry.valueNoUpdate(1e6), expect(" off");
  entry.controlEnable(false), entry.linkEnable(true), expect(" off");
  entry.Enabled(true), expect("1 MHz on");
  entry.Enabled(false), entry.clearIfDisabled(false), expect("1 MHz off");

  TextBox other("StartTextBox");
  entry.Bold(true);
  entry.textBox(&other);
  EXPECT_TRUE(box.Bold() && other.Bold() && !other.Italic() && !other.Enabled());
  EXPECT_EQ(other.Text(), "1 MHz");
  entry.Italic(true);
  EXPECT_TRUE(other.Italic() && !box.Italic() && !label.Bold());
  entry.Visible(false);
  EXPECT_FALSE(entry.Visible() || other.Visible() || spin.Visible() || label.Visible());
  entry.textBox(nullptr);
  EXPECT_EQ(said(), "");
  entry.Enabled(true);
  entry.Visible(true);
  EXPECT_EQ(said(),
            "clsNumericEntry::Enable() ... TextBox not defined\r\n"
            "clsNumericEntry::Visible() ... TextBox object not defined\r");
  EXPECT_FALSE(entry.Enabled() || entry.Visible() || spin.Visible() || spin.Enabled());
}

TEST_F(EntryEventsTest, AnyTextThatIsShownReadsBackAsTheValue) {
  using C = Entry;
  constexpr void (C::*kSets[])() = {&C::noSuffix,   &C::frequencySuffix, &C::timeSuffix, &C::longTimeSuffix,
                                    &C::voltSuffix, &C::meterSuffix,     &C::byteSuffix, &C::dBmSuffix};
  std::mt19937 random(4711);
  const auto upTo = [&random](int count) {
    return static_cast<int>(random() % static_cast<unsigned>(count));
  };
  for (int round = 0; round < 3000; ++round) {
    testing::EntryField field;
    Entry& e = field.entry;
    (e.*kSets[upTo(8)])();
    e.MinimumForRange(upTo(7), -1e3);
    e.MaximumForRange(upTo(7), 1e11);
    e.FormatScaleForRange(upTo(7), 30e3);
    e.FormatOffsetForRange(upTo(7), upTo(1000));
    e.autoChoose(upTo(2) == 0);
    e.MINIMUM(-upTo(1000));
    e.MAXIMUM(1 + upTo(1000));
    e.suppressSuffix(upTo(4) == 0);
    e.decimalSeparator(upTo(2) == 0 ? "," : "");
    e.value((upTo(2000) - 200) * std::pow(10, upTo(24) - 12));
    field.clicks(upTo(4), upTo(2) == 0);
    const double value = e.value();
    const std::string text = field.box.Text();
    // The 15 digits of a text tell values apart as far as the offset leaves them room.
    const double room = 1e-14 * (std::fabs(value) + std::fabs(e.formatOffset()));
    EXPECT_NEAR(e.textToNumeric().value_or(HUGE_VAL), value, room) << text;
    field.leave(text + " ");
    field.state();
    field.leave(text + "?");
    EXPECT_EQ(field.state(), field.box.Text() + " = " + numberToText(e.value()) + " beep");
    EXPECT_NEAR(e.value(), value, room) << text;
  }
  EXPECT_EQ(said(), "");
}

}  // namespace
}  // namespace frontpanels

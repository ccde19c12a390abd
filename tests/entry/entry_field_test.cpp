#include <cmath>

#include "tests/entry/entry_field.h"

namespace frontpanels {
namespace {

using testing::ListedRecords;

class EntryFieldEventsTest : public testing::EntryFieldTest {
 protected:
  EntryFieldEventsTest() {
    entry.frequencySuffix();
    entry.MINIMUM(0);
    entry.MAXIMUM(1e12);
    entry.valueNoUpdate(900e3);
  }
};

TEST_F(EntryFieldEventsTest, KeysTakeATextOverOrStep) {
  struct KeyCase {
    std::string text;
    char key;
    const char* state;
    bool consumed;
    const char* told;
    int beeps;
  };
  const std::vector<KeyCase> cases = {
      {"800", 13, "800 kHz = 800000", true, " 800000", 0},
      {"1.6ghz", 13, "1600 MHz = 1600000000", true, " 1600000000", 0},
      {"900 KHZ", 13, "900 kHz = 900000", true, "", 0},  // the same value, written as it should be
      {"900 kHz", 13, "900 kHz = 900000", true, "", 0},
      {"2e12", 13, "1000 GHz = 1000000000000", true, " 1000000000000", 0},
      {"1,000", 13, "1,000 = 900000", true, "", 1},  // stays to be corrected
      {"", 13, " = 900000", true, "", 1},
      {"700", 'k', "700 kHz = 700000", true, " 700000", 0},
      {"5 ", 'M', "5 MHz = 5000000", true, " 5000000", 0},
      {"12", 'h', "12 Hz = 12", true, " 12", 0},
      {"0.9", 'm', "900 kHz = 900000", true, "", 0},
      {"900 ", 'k', "900 kHz = 900000", true, "", 0},
      {"12..", 'g', "12.. = 900000", true, "", 1},
      {"900 kHz", 'k', "900 kHz = 900000", true, "", 1},
      {"800", '&', "801 kHz = 801000", true, " 801000", 0},
      {"800", '(', "799 kHz = 799000", true, " 799000", 0},
      {"800", '5', "8005 = 900000", false, "", 0},
      {"800", 'z', "800z = 900000", false, "", 0},
      {"800", 8, "80 = 900000", false, "", 0},
  };
  for (const KeyCase& c : cases) {
    entry.valueNoUpdate(900e3);
    entry.reformat();
    told.clear();
    beeps = 0;
    key(c.text, c.key);
    EXPECT_EQ(state(), c.state) << c.text << c.key;
    EXPECT_EQ(box.allSelected(), c.consumed) << c.text << c.key;
    EXPECT_EQ(told, c.told) << c.text << c.key;
    EXPECT_EQ(beeps, c.beeps) << c.text << c.key;
    EXPECT_TRUE(box.hasFocus());
  }
  EXPECT_EQ(said(), "");

  entry.reformat();
  box.KeyDown(38, 0);
  EXPECT_EQ(state(), "901 kHz = 901000");
  box.KeyDown(38, 1);  // with shift it is not the arrow alone
  box.KeyDown(39, 0);
  box.KeyDown(40, 0);
  EXPECT_EQ(state(), "900 kHz = 900000");
}

TEST_F(EntryFieldEventsTest, LeavingTheFieldTakesAChangedTextOverOrBringsTheLastGoodOneBack) {
  entry.formatString("0.#");
  entry.value(1234567);
  told.clear();
  box.focusChanged(true);
  EXPECT_TRUE(box.allSelected());
  leave("1.2 MHz");  // as it was written: the exact value stays
  EXPECT_EQ(state() + told, "1.2 MHz = 1234567");
  leave("1.2");
  EXPECT_EQ(state() + told, "1.2 MHz = 1200000 1200000");
  leave("3,5 MHz");
  EXPECT_EQ(state() + told, "1.2 MHz = 1200000 1200000");
  EXPECT_EQ(beeps, 1);
  entry.resolution(1e-4);
  leave("2");  // a value that cannot be: its rounding leaves 32 bits
  EXPECT_EQ(said(), "clsNumericEntry::value() failed. \rOverflow");
  EXPECT_EQ(state() + told, "1.2 MHz = 1200000 1200000");

  entry.resolution({});
  entry.decimalSeparator(",");
  leave("3,5 MHz");
  EXPECT_EQ(state(), "3,5 MHz = 3500000");
  EXPECT_EQ(entry.text(), "3,5 MHz");
}

TEST_F(EntryFieldEventsTest, ABlankFieldIsRefusedUnlessItMayStayBlank) {
  leave(" ");
  EXPECT_EQ(state(), "900 kHz = 900000");
  EXPECT_EQ(beeps, 1);

  entry.preserveBlankEntry(true);
  leave(" ");
  EXPECT_EQ(state() + told, " = 900000");
  entry.valueNoUpdate(900e3);
  entry.reformat();
  EXPECT_EQ(state(), " = 900000");
  leave("900");
  EXPECT_EQ(state() + told, "900 kHz = 900000");
  entry.text("");
  entry.valueNoUpdate(1000);
  EXPECT_EQ(state(), "1 kHz = 1000");

  entry.preserveBlankEntry(false);
  entry.blank();
  EXPECT_EQ(state(), " = 1000");
  leave("");
  EXPECT_EQ(beeps, 1);  // nobody has changed it
  entry.valueNoUpdate(1000);
  EXPECT_EQ(state(), "1 kHz = 1000");
  EXPECT_EQ(said(), "");
}

TEST_F(EntryFieldEventsTest, EveryEventSaysWhetherItHasChangedTheValue) {
  using Event = void (clsNumericEntry::*)();
  using C = clsNumericEntry;
  for (const Event event :
       std::vector<Event>{&C::GotFocus, &C::LostFocus, &C::change, &C::Click, &C::DblClick, &C::DragDrop,
                          &C::DragOver, &C::LinkClose, &C::LinkError, &C::LinkNotify, &C::LinkOpen,
                          &C::MouseDown, &C::MouseMove, &C::MouseUp}) {
    entry.value(entry.value() + 1);
    EXPECT_TRUE(entry.newValue());
    (entry.*event)();
    EXPECT_FALSE(entry.newValue());
  }
  std::int16_t character = '5';
  entry.value(1), entry.KeyUp(65, 0);
  EXPECT_FALSE(entry.newValue());
  entry.value(2), entry.KeyDown(65, 0);
  EXPECT_FALSE(entry.newValue());
  entry.value(3), entry.KeyPress(character);
  EXPECT_FALSE(entry.newValue());
  EXPECT_EQ(character, '5');

  box.Change = [this] { entry.change(); };  // raised while the text is written
  box.focusChanged(false);
  entry.upClick();
  EXPECT_TRUE(entry.newValue());
}

TEST_F(EntryFieldEventsTest, WhatFailsOutsideIsReportedInTheRoutinesName) {
  const auto fail = [] { raiseOutOfMemory(); };
  box.Change = fail;
  entry.value(5);
  EXPECT_EQ(said(), "clsNumericEntry::reformat() failed. \rOut of memory");
  EXPECT_EQ(state(), "5 Hz = 5");
  box.Change = nullptr;

  struct Failing : ControlPeer {
    void changed(ControlChange what) override {
      if (what == ControlChange::Selection) raiseOutOfMemory();
    }
    void takeFocus() override {}
    void beep() override { raiseOutOfMemory(); }
  } failing;
  box.peer(&failing);
  entry.GotFocus();
  box.focusChanged(true);
  enter("6");
  EXPECT_TRUE(entry.newValue());  // the value has changed all the same
  leave("six");
  entry.downClick();
  EXPECT_EQ(said(),
            "clsNumericEntry::GotFocus() failed. \rOut of memory\n"
            "clsNumericEntry::GotFocus() failed. \rOut of memory\n"
            "clsNumericEntry::KeyPress() failed. \rOut of memory\n"
            "clsNumericEntry::LostFocus() failed. \rOut of memory\n"
            "clsNumericEntry::downClick() failed. \rOut of memory");
  EXPECT_EQ(state(), "5 Hz = 5");
  entry.formatScale(0);
  entry.value(7);
  EXPECT_EQ(said(), "clsNumericEntry::formatter() failed. \rDivision by zero");
  EXPECT_EQ(state(), " = 7");
}

TEST_F(EntryFieldEventsTest, TheFieldIsEnabledWhilePanelAndLinkAllowIt) {
  const auto enabled = [this] {
    EXPECT_EQ(box.Enabled(), entry.Enabled());
    EXPECT_EQ(spin.Enabled(), entry.Enabled());
    EXPECT_EQ(label.Enabled(), entry.Enabled());
    return box.Text() + (entry.Enabled() ? " on" : " off");
  };
  EXPECT_EQ(enabled(), "900 kHz on");
  entry.linkEnable(false);
  EXPECT_EQ(enabled(), "900 kHz off");
  entry.Enabled(true);
  EXPECT_EQ(enabled(), "900 kHz off");
  entry.clearIfDisabled(true);
  EXPECT_EQ(enabled(), " off");
  entry.valueNoUpdate(1e6);
  EXPECT_EQ(enabled(), " off");
  entry.controlEnable(false);
  entry.linkEnable(true);
  EXPECT_EQ(enabled(), " off");
  entry.Enabled(true);
  EXPECT_EQ(enabled(), "1 MHz on");
  entry.Enabled(false);
  entry.clearIfDisabled(false);
  EXPECT_EQ(enabled(), "1 MHz off");
  EXPECT_TRUE(entry.linkEnable() && !entry.controlEnable() && !entry.clearIfDisabled());

  TextBox other("StartTextBox");
  entry.Bold(true);
  entry.textBox(&other);
  EXPECT_TRUE(box.Bold() && other.Bold() && !other.Italic() && !other.Enabled());
  entry.Italic(true);
  EXPECT_TRUE(other.Italic() && entry.Bold() && entry.Italic() && !box.Italic() && !label.Bold());
  EXPECT_EQ(other.Text(), "1 MHz");
  entry.Visible(false);
  EXPECT_FALSE(entry.Visible() || other.Visible() || spin.Visible() || label.Visible());
  EXPECT_EQ(entry.spinButton(), &spin);
  EXPECT_EQ(entry.Label(), &label);

  entry.textBox(nullptr);
  EXPECT_EQ(said(), "");
  entry.Enabled(true);
  entry.Visible(true);
  EXPECT_EQ(said(),
            "clsNumericEntry::Enable() ... TextBox not defined\r\n"
            "clsNumericEntry::Visible() ... TextBox object not defined\r");
  EXPECT_FALSE(entry.Enabled() || entry.Visible() || spin.Visible() || spin.Enabled());
}

TEST_F(EntryFieldEventsTest, LimitsComeFromTheHostOrFromAnotherEntry) {
  const auto limits = [](const clsNumericEntry& e) {
    return std::to_string(e.range()) + ": " + numberToText(e.MINIMUM()) + ".." + numberToText(e.MAXIMUM());
  };
  using Record = ListedRecords::Record;
  const auto record = [](Variant order, Variant minimum, Variant maximum) {
    return Record{{"[Order]", order}, {"[Minimum]", minimum}, {"[Maximum]", maximum}};
  };
  entry.FormatScaleForRange(2, 1e3);
  entry.Limits(ListedRecords({record(2, 10, "20"), record(0, 5, 6)}));
  EXPECT_EQ(limits(entry), "0: 5..6");
  EXPECT_EQ(entry.MaximumForRange(2), 20);
  EXPECT_EQ(entry.value(), 900e3);  // waits for the next setting
  entry.Limits(ListedRecords({record(3, 30, 40), record(2, 10, 20)}));
  EXPECT_EQ(limits(entry), "2: 10..20");  // the chosen one has gone
  EXPECT_EQ(entry.formatScale(), 1e3);
  entry.formatScale(7);
  entry.Limits(ListedRecords({record(2, 11, 21)}));
  EXPECT_EQ(limits(entry), "2: 11..21");
  EXPECT_EQ(entry.formatScale(), 7);
  entry.Limits(ListedRecords({}));
  EXPECT_EQ(said(), "");

  const std::string notNumeric = "clsNumericEntry::Limits() ... non-numeric range argument\r";
  const std::vector<std::pair<Record, std::string>> bad = {
      {record(1, "low", 2), notNumeric},
      {record(1, 1, Variant()), notNumeric},
      {record("first", 1, 2), notNumeric},
      {record(1, std::nan(""), 2), notNumeric},
      {record(7, 1, 2), "clsNumericEntry::Limits() ... order of no range\r"},
      {record(-1, 1, 2), "clsNumericEntry::Limits() ... order of no range\r"},
      {record(1, 2, 1), "clsNumericEntry::Limits() ... minimum above maximum\r"},
      {Record{{"[Order]", 1}, {"[Minimum]", 1}},
       "clsNumericEntry::Limits() failed. \rInvalid procedure call or argument"},
  };
  for (const auto& [wrong, message] : bad) {
    entry.Limits(ListedRecords({record(0, 1, 2), wrong}));
    EXPECT_EQ(said(), message);
    EXPECT_EQ(limits(entry), "2: 11..21");
  }

  clsNumericEntry stop;
  stop.FormatOffsetForRange(2, 3);
  stop.CopyLimits(entry);
  EXPECT_EQ(limits(stop), "2: 11..21");
  EXPECT_EQ(stop.formatOffset(), 3);
  EXPECT_EQ(stop.formatScale(), 1);  // how it shows values is its own
  entry.Limits(ListedRecords({record(2, 12, 22)}));
  EXPECT_EQ(limits(stop), "2: 11..21");

  entry.step(3);
  entry.Clear();
  EXPECT_EQ(limits(entry), "0: -1.79769313486232E+308..1.79769313486232E+308");
  EXPECT_EQ(entry.suffixes().count(), 0U);
  EXPECT_TRUE(entry.step().isEmpty());
  entry.timeSuffix();
  entry.value(900e3);
  EXPECT_EQ(state(), "900000 s = 900000");
}

}  // namespace
}  // namespace frontpanels

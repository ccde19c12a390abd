// A numeric entry in a field, as a user meets it: a text box, a spin button and a label, with a window behind
// the box that keeps what it is told.
#pragma once

#include <functional>
#include <string>
#include <vector>

#include "entry/entry_binding.h"
#include "tests/support/listed_records.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels::testing {

class EntryField : public ControlPeer {
 public:
  EntryField() {
    bindEntry(entry, &box, &spin, [this] { told += " " + numberToText(entry.value()); });
    entry.Label(&label);
    box.peer(this);
  }
  ~EntryField() override { box.peer(nullptr); }

  // The user enters the field, puts a text in it and presses Enter, or goes elsewhere, or types one key more.
  void type(std::string text) {
    box.focusChanged(true);
    box.userText(std::move(text));
  }
  void enter(std::string text) {
    type(std::move(text));
    box.userKey(13);
  }
  void leave(std::string text) {
    type(std::move(text));
    box.focusChanged(false);
  }
  void key(std::string text, char character) {
    type(std::move(text));
    box.userKey(character);
  }

  // Text and value.
  [[nodiscard]] std::string state() const { return box.Text() + " = " + numberToText(entry.value()); }
  // So many clicks up, or down where the count is negative: the text after each.
  [[nodiscard]] std::string clicks(int count) {
    std::string texts;
    for (int i = 0; i < std::abs(count); ++i) {
      spin.press(count > 0);
      texts += (i == 0 ? "" : ", ") + box.Text();
    }
    return texts;
  }

  TextBox box{"SpanTextBox"};
  SpinButton spin{"SpanSpinButton"};
  frontpanels::Label label{"SpanLabel"};
  clsNumericEntry entry;
  std::string told;  // the values that the panel has heard of
  int beeps = 0;

 private:
  void changed(ControlChange) override {}
  void takeFocus() override { box.focusChanged(true); }
  void beep() override { ++beeps; }
};

class EntryFieldTest : public ReportingTest, public EntryField {};

}  // namespace frontpanels::testing

// A numeric entry in a field, as a user meets it: text box, spin button and label, with a window behind the
// box that keeps what it is told.
#pragma once

#include <string>
#include <vector>

#include "entry/entry_binding.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels::testing {

// Rows of a table, "before -> after", and the same rows with what is found in place of what they say.
using Rows = std::vector<std::string>;
template <class After>
Rows found(Rows rows, After after) {
  for (std::string& row : rows)
    row.replace(row.find(" -> ") + 4, row.npos, after(row.substr(0, row.find(" -> "))));
  return rows;
}

// A setting of an entry, for a table of such.
inline constexpr auto sequence = [](auto... mantissas) {
  return [=](clsNumericEntry& entry) { entry.sequence({mantissas...}); };
};

class EntryField : public ControlPeer {
 public:
  EntryField() {
    bindEntry(entry, &box, &spin, [this] { heard += " told " + numberToText(entry.value()); });
    entry.Label(&label);
    box.peer(this);
  }
  ~EntryField() override { box.peer(nullptr); }

  // The user enters the field, puts a text in it, and presses a key or goes elsewhere.
  void key(std::string text, std::int16_t character) {
    box.focusChanged(true);
    box.userText(std::move(text));
    box.userKey(character);
  }
  void leave(std::string text) {
    box.focusChanged(true);
    box.userText(std::move(text));
    box.focusChanged(false);
  }

  // Text and value, and what the panel was told and the user heard since it was asked last.
  std::string state() { return box.Text() + " = " + numberToText(entry.value()) + std::exchange(heard, {}); }
  // The chosen range and the limits in force.
  [[nodiscard]] std::string limits() const {
    return std::to_string(entry.range()) + ": " + numberToText(entry.MINIMUM()) + ".." +
           numberToText(entry.MAXIMUM());
  }
  // So many clicks: the text after each.
  std::string clicks(int count, bool up) {
    std::string texts;
    for (; count > 0; --count) {
      spin.press(up);
      texts += (texts.empty() ? "" : ", ") + box.Text();
    }
    return texts;
  }

  TextBox box{"SpanTextBox"};
  SpinButton spin{"SpanSpinButton"};
  frontpanels::Label label{"SpanLabel"};
  clsNumericEntry entry;

 private:
  void changed(ControlChange) override {}
  void takeFocus() override { box.focusChanged(true); }
  void beep() override { heard += " beep"; }

  std::string heard;
};

class EntryFieldTest : public ReportingTest, public EntryField {
 protected:
  // What is done, one after the other, and the state after each.
  using Story = std::vector<std::pair<std::function<void()>, const char*>>;
  void play(const Story& story, bool withLimits = false) {
    for (const auto& [action, expected] : story) {
      action();
      EXPECT_EQ(state() + (withLimits ? " in " + limits() : ""), expected);
    }
  }
};

}  // namespace frontpanels::testing

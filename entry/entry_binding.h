// A numeric entry connected to its text box and spin button.
#pragma once

#include <functional>
#include <string>
#include <string_view>
#include <utility>

#include "entry/numeric_entry.h"
#include "platform/control_set.h"

namespace frontpanels {

// Binds the controls to the entry and forwards their events; each may be null. `changed` is called after
// every event that has changed the value. All of them must outlive the events.
inline void bindEntry(clsNumericEntry& entry, TextBox* box, SpinButton* spin, std::function<void()> changed) {
  const auto tell = [&entry, changed = std::move(changed)] {
    if (entry.newValue() && changed) changed();
  };
  entry.spinButton(spin);
  if (spin != nullptr) {
    spin->buddy(box);
    spin->SpinUp = [&entry, tell] { entry.upClick(), tell(); };
    spin->SpinDown = [&entry, tell] { entry.downClick(), tell(); };
  }
  entry.textBox(box);
  if (box == nullptr) return;
  box->GotFocus = [&entry, tell] { entry.GotFocus(), tell(); };
  box->LostFocus = [&entry, tell] { entry.LostFocus(), tell(); };
  box->KeyPress = [&entry, tell](std::int16_t& character) { entry.KeyPress(character), tell(); };
  box->KeyDown = [&entry, tell](std::int16_t keyCode, std::int16_t shift) {
    entry.KeyDown(keyCode, shift), tell();
  };
}

// The same for the controls that a designer table names after the field: its stem with "TextBox",
// "SpinButton" and, where there is one, "Label".
inline void bindEntry(clsNumericEntry& entry, const ControlSet& controls, std::string_view stem,
                      std::function<void()> changed) {
  const std::string name(stem);
  if (Control* const label = controls.find(name + "Label")) entry.Label(label);
  bindEntry(entry, &controls.textBox(name + "TextBox"), &controls.spinButton(name + "SpinButton"),
            std::move(changed));
}

}  // namespace frontpanels

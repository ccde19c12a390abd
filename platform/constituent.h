// One control of a panel as scripts and aids for the disabled see it: what it shows, and what a user could do
// to it. A member that a kind of control has not raises error 438; an action on a control that no user could
// reach does nothing.
#pragma once

#include <cstdint>
#include <string>

#include "platform/controls.h"
#include "platform/variant.h"

namespace frontpanels {

class Constituent {
 public:
  // The control must outlive this.
  explicit Constituent(Control& control) noexcept : control_(control) {}

  // Text boxes, combo and list boxes. Setting it types a text into a box and chooses an item of a list: its
  // first with that text, else "Invalid procedure call or argument".
  [[nodiscard]] std::string Text() const;
  void Text(const std::string& text) const;
  // Check boxes (0 or 1) and option buttons (true or false). Any number but 0 is 1; an option's choice is
  // given up by choosing another, so that false raises "Invalid procedure call or argument" on the chosen
  // one.
  [[nodiscard]] Variant Value() const;
  void Value(const Variant& value) const;
  // What holds for the user, so also false in a frame that is disabled or hidden.
  [[nodiscard]] bool Enabled() const noexcept { return control_.reallyEnabled(); }
  [[nodiscard]] bool Visible() const noexcept { return control_.reallyVisible(); }
  // Combo and list boxes; -1 is no item.
  [[nodiscard]] std::int32_t ListIndex() const;
  void ListIndex(std::int32_t index) const;
  [[nodiscard]] std::int32_t ListCount() const;
  [[nodiscard]] std::string List(std::int32_t index) const;
  [[nodiscard]] std::int32_t ItemData(std::int32_t index) const;
  // As shown, without the mark of the access key.
  [[nodiscard]] std::string Caption() const;

  // Both move the keyboard focus first, as the mouse does: the field that is left commits its text.
  void Click() const;
  void KeyPress(std::int16_t character) const;
  void SpinUp() const;
  void SpinDown() const;

 private:
  Control& control_;
};

}  // namespace frontpanels

// What the fields of a panel are called where they are read aloud: by what stands at them on the panel, so
// that who hears and who sees speak of the same.
#pragma once

#include <string>

#include "platform/control_set.h"

namespace frontpanels {

// The name of the row, if it has one; else the field's own caption, that of the label before it in tab order,
// or that of its frame. Buttons and options say which frame they are in, as do fields that would otherwise
// share a name with another. A spin button has its text box's name. Never empty.
[[nodiscard]] std::string spokenName(const ControlSet& set, const Control& control);

// The keys that lead to it, "Alt+C"; empty for none.
[[nodiscard]] std::string spokenShortcut(const ControlSet& set, const Control& control);

}  // namespace frontpanels

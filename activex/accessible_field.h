// A field's window as it is read aloud: what the system says of a window of its class, under the name that
// the panel has for the field.
#pragma once

#include <string>

#include "activex/accessible_base.h"

namespace frontpanels::activex {

// The name and the keys of a field when it was asked for.
struct FieldWords {
  std::string name;
  std::string shortcut;  // empty for none
};

// Answers WM_GETOBJECT for the client of a field's window; 0, which leaves the answer to the system, when
// that has nothing to say of the window itself. Raises std::bad_alloc.
[[nodiscard]] LRESULT accessibleField(HWND window, WPARAM flags, FieldWords words);

}  // namespace frontpanels::activex

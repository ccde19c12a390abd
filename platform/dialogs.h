// What interrupts the user.
#pragma once

#include <string_view>

namespace frontpanels {

class Dialogs {
 public:
  virtual ~Dialogs() = default;

  // A modal box with only an OK button and the default title. May raise nothing and lose nothing: where no
  // box can be shown, the text goes to wherever the program keeps its messages.
  virtual void messageBox(std::string_view text) noexcept = 0;
};

}  // namespace frontpanels

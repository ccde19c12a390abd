// Boxes of the library: messages and files. They belong to a panel that the user has in front of him; while
// there is none, a box would stop a script or an unattended host where nobody can answer it: a message is
// kept and not shown, a question for a file answers none.
#pragma once

#include "platform/win32/win32_dialogs.h"

namespace frontpanels::activex {

// A panel in a window, as the owner of boxes.
class BoxOwner {
 public:
  // While a box is open the other windows of the host wait.
  virtual void enableHost(bool enable) noexcept = 0;

 protected:
  BoxOwner() = default;
  BoxOwner(const BoxOwner&) = default;
  BoxOwner& operator=(const BoxOwner&) = default;
  ~BoxOwner() = default;
};

void addBoxOwner(BoxOwner& owner);
void removeBoxOwner(BoxOwner& owner) noexcept;

class MessageBoxes final : public Dialogs {
 public:
  void messageBox(std::string_view text) noexcept override;

 private:
  Win32Dialogs dialogs_;
};

class FileBoxes final : public FileDialogs {
 public:
  [[nodiscard]] std::optional<std::string> openFile(std::string_view filter) override;
  [[nodiscard]] bool cancelPressed() noexcept override { return dialogs_.cancelPressed(); }

 private:
  Win32FileDialogs dialogs_;
};

}  // namespace frontpanels::activex

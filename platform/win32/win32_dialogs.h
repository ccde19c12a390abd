// Boxes of the real window system.
#pragma once

#include "platform/dialogs.h"

namespace frontpanels {

class Win32Dialogs final : public Dialogs {
 public:
  // Belongs to the active window of the calling thread; without one it stands before all windows of the
  // thread.
  void messageBox(std::string_view text) noexcept override;
};

class Win32FileDialogs final : public FileDialogs {
 public:
  // Belongs to the active window of the calling thread. The process keeps its current folder.
  [[nodiscard]] std::optional<std::string> openFile(std::string_view filter) override;
  // Runs no window procedure. Behind another key that waits, Escape counts only while it is held down, in a
  // window of the calling thread.
  [[nodiscard]] bool cancelPressed() noexcept override;
};

}  // namespace frontpanels

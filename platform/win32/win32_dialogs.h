// Message boxes of the real window system.
#pragma once

#include "platform/dialogs.h"

namespace frontpanels {

class Win32Dialogs final : public Dialogs {
 public:
  // Belongs to the active window of the calling thread; without one it stands before all windows of the
  // thread.
  void messageBox(std::string_view text) noexcept override;
};

}  // namespace frontpanels

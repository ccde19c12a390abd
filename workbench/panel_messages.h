// The messages of the panels: kept and shown in the status bar instead of boxes, which would stop the play.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "workbench/automation.h"

namespace frontpanels::workbench {

class PanelMessages {
 public:
  PanelMessages();

  // The latest message that came since the last call.
  [[nodiscard]] std::optional<std::string> takeLatest();

 private:
  Automation diagnostics_;
};

}  // namespace frontpanels::workbench

// The messages of the panels: kept and listed instead of boxes, which would stop the play.
#pragma once

#include <string>
#include <vector>

#include "workbench/automation.h"

namespace frontpanels::workbench {

class PanelMessages {
 public:
  PanelMessages();

  // Those that came since the last call, in their order.
  [[nodiscard]] std::vector<std::string> takeAll();

 private:
  Automation diagnostics_;
};

}  // namespace frontpanels::workbench

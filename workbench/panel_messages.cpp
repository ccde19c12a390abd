#include "workbench/panel_messages.h"

namespace frontpanels::workbench {

PanelMessages::PanelMessages() : diagnostics_(Automation::create("FrontPanels.Diagnostics")) {
  diagnostics_.put("ShowMessages", false);
}

std::vector<std::string> PanelMessages::takeAll() {
  const std::int32_t count = diagnostics_.number("Count");
  std::vector<std::string> messages;
  for (std::int32_t i = 0; i < count; ++i) messages.push_back(diagnostics_.text("Message", {i}));
  // Cleared, so that a day of sweeps with a message each does not pile up.
  if (count > 0) diagnostics_.call("Clear", {});
  return messages;
}

}  // namespace frontpanels::workbench

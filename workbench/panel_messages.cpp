#include "workbench/panel_messages.h"

namespace frontpanels::workbench {

PanelMessages::PanelMessages() : diagnostics_(Automation::create("FrontPanels.Diagnostics")) {
  diagnostics_.put("ShowMessages", false);
}

std::optional<std::string> PanelMessages::takeLatest() {
  const std::int32_t count = diagnostics_.number("Count");
  if (count == 0) return std::nullopt;
  std::string latest = diagnostics_.text("Message", {count - 1});
  // Cleared, so that a day of sweeps with a message each does not pile up.
  diagnostics_.call("Clear", {});
  return latest;
}

}  // namespace frontpanels::workbench

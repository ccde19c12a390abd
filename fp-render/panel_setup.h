// How a panel was set up in the workbench, out of its settings file.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "hosting/setting_names.h"
#include "hosting/stored_setting.h"

namespace frontpanels {

// Of the section "[spectrum]" or "[pilots]", or that of a set-up, in the order in which they go to the panel.
// The file is only read. Raises a run-time error that names it: when it cannot be read, is damaged or has no
// such section.
[[nodiscard]] std::vector<StoredSetting> readPanelSetup(const std::string& pathUtf8, PanelKind panel,
                                                        std::optional<std::uint64_t> setUp);

}  // namespace frontpanels

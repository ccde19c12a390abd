// Where an unattended run leaves its words: the standard error of whoever started it, if there is one.
#pragma once

#include <string_view>

namespace frontpanels::workbench {

void writeError(std::string_view line) noexcept;

}  // namespace frontpanels::workbench

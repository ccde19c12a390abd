// The standard error of whoever started the program, if there is one.
#pragma once

#include <string_view>

namespace frontpanels::workbench {

void writeError(std::string_view line) noexcept;

}  // namespace frontpanels::workbench

// The program's text is UTF-8; the system's is UTF-16.
#pragma once

#include <string>
#include <string_view>

namespace frontpanels::workbench {

[[nodiscard]] std::wstring wide(std::string_view utf8);
[[nodiscard]] std::string narrow(std::wstring_view utf16);

}  // namespace frontpanels::workbench

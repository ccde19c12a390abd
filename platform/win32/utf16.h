// Text of the Windows interfaces. What is not well-formed turns into replacement characters; nothing is
// refused.
#pragma once

#include <string>
#include <string_view>

namespace frontpanels {

[[nodiscard]] std::wstring toUtf16(std::string_view utf8);
[[nodiscard]] std::string toUtf8(std::wstring_view utf16);

}  // namespace frontpanels

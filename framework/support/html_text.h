// Texts as they may stand in a page or in a quoted attribute.
#pragma once

#include <string>
#include <string_view>

namespace frontpanels {

// Any bytes come out as valid UTF-8 without markup: what is malformed and what no page may hold (control
// characters but tab and line ends) is U+FFFD.
[[nodiscard]] std::string htmlEscaped(std::string_view text);

}  // namespace frontpanels

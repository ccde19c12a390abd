// The reports of several panels as one page that needs no other file.
#pragma once

#include <span>
#include <string>
#include <string_view>

namespace frontpanels {

struct ReportPart {
  std::string title;  // any text; without one the part has no heading of its own
  std::string html;   // a panel's fragment, taken as it is
};

// UTF-8; `title` and `stamp` (when and where) may be any texts. Pictures come inside the fragments as "data:"
// addresses; nothing else is loaded, and no script runs.
[[nodiscard]] std::string reportPage(std::string_view title, std::string_view stamp,
                                     std::span<const ReportPart> parts);

}  // namespace frontpanels

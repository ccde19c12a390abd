// Texts as they stand in a file of lines: what would not survive there is written as "%" and two hexadecimal
// digits.
#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace frontpanels {

// UTF-8 without control characters and without blanks at either end, whatever `text` holds. "%", "#" (it
// begins a comment) and each character of `more` are written by their digits, too.
[[nodiscard]] std::string escapedForLine(std::string_view text, std::string_view more = {});
// Nothing when a "%" is not followed by two digits.
[[nodiscard]] std::optional<std::string> unescapedFromLine(std::string_view text);

// Without blanks and tabs at its ends.
[[nodiscard]] std::string_view trimmedLine(std::string_view text) noexcept;

}  // namespace frontpanels

// Whether bytes are UTF-8, one character at a time.
#pragma once

#include <cstddef>
#include <string_view>

namespace frontpanels {

// The bytes of the character at the front of `text`: 1 to 4. 0 where it is malformed (a byte of no character,
// cut off, longer than need be, half of a surrogate pair, beyond U+10FFFF) and for an empty text.
[[nodiscard]] std::size_t utf8CharacterBytes(std::string_view text) noexcept;

}  // namespace frontpanels

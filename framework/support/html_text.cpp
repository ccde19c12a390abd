#include "framework/support/html_text.h"

#include <algorithm>

#include "framework/support/utf8.h"

namespace frontpanels {
namespace {

constexpr std::string_view kReplacement = "\xEF\xBF\xBD";

// U+0080 to U+009F are control characters, too.
bool isControl(std::string_view character) noexcept {
  const auto byte = static_cast<unsigned char>(character.front());
  if (character.size() == 1)
    return (byte < 0x20 && byte != '\t' && byte != '\n' && byte != '\r') || byte == 0x7F;
  return byte == 0xC2 && static_cast<unsigned char>(character[1]) < 0xA0;
}

std::string_view written(std::string_view character) noexcept {
  switch (character.front()) {
    case '&':
      return "&amp;";
    case '<':
      return "&lt;";
    case '>':
      return "&gt;";
    case '"':
      return "&quot;";
    default:
      return isControl(character) ? kReplacement : character;
  }
}

}  // namespace

std::string htmlEscaped(std::string_view text) {
  std::string html;
  while (!text.empty()) {
    const std::size_t bytes = utf8CharacterBytes(text);
    html += bytes == 0 ? kReplacement : written(text.substr(0, bytes));
    text.remove_prefix(std::max<std::size_t>(bytes, 1));
  }
  return html;
}

}  // namespace frontpanels

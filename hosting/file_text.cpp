#include "hosting/file_text.h"

#include <algorithm>
#include <charconv>

#include "framework/support/utf8.h"

namespace frontpanels {
namespace {

constexpr std::string_view kAlways = "%#\x7f";
constexpr std::string_view kHexDigits = "0123456789ABCDEF";

void appendDigits(std::string& text, char c) {
  const auto byte = static_cast<unsigned char>(c);
  text += '%';
  text += kHexDigits[byte >> 4U];
  text += kHexDigits[byte & 15U];
}

}  // namespace

std::string escapedForLine(std::string_view text, std::string_view more) {
  std::string line;
  for (std::size_t at = 0; at < text.size();) {
    const std::string_view rest = text.substr(at);
    const char c = rest.front();
    const std::size_t bytes = utf8CharacterBytes(rest);
    const bool atEnd = c == ' ' && (at == 0 || rest.size() == 1);
    const bool control = static_cast<unsigned char>(c) < ' ';
    if (bytes == 0 || control || atEnd || kAlways.find(c) != kAlways.npos || more.find(c) != more.npos)
      appendDigits(line, c);
    else
      line += rest.substr(0, bytes);
    at += std::max<std::size_t>(bytes, 1);
  }
  return line;
}

std::optional<std::string> unescapedFromLine(std::string_view text) {
  std::string result;
  while (!text.empty()) {
    if (text.front() != '%') {
      result += text.front();
      text.remove_prefix(1);
      continue;
    }
    unsigned char byte = 0;
    const std::string_view digits = text.substr(1, 2);
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), byte, 16);
    if (error != std::errc{} || digits.size() != 2 || end != digits.data() + digits.size())
      return std::nullopt;
    result += static_cast<char>(byte);
    text.remove_prefix(3);
  }
  return result;
}

std::string_view trimmedLine(std::string_view text) noexcept {
  constexpr std::string_view kBlanks = " \t";
  const std::size_t first = text.find_first_not_of(kBlanks);
  if (first == std::string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

}  // namespace frontpanels

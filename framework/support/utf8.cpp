#include "framework/support/utf8.h"

#include <algorithm>

namespace frontpanels {
namespace {

// What leads a character, and between what its second byte lies; all further ones lie between 80 and BF.
struct LeadRow {
  unsigned char first;
  unsigned char last;
  std::size_t bytes;
  unsigned char secondFrom;
  unsigned char secondTo;
};
constexpr LeadRow kLeads[] = {
    {0x00, 0x7F, 1, 0, 0},       {0xC2, 0xDF, 2, 0x80, 0xBF}, {0xE0, 0xE0, 3, 0xA0, 0xBF},
    {0xE1, 0xEC, 3, 0x80, 0xBF}, {0xED, 0xED, 3, 0x80, 0x9F}, {0xEE, 0xEF, 3, 0x80, 0xBF},
    {0xF0, 0xF0, 4, 0x90, 0xBF}, {0xF1, 0xF3, 4, 0x80, 0xBF}, {0xF4, 0xF4, 4, 0x80, 0x8F},
};

bool liesBetween(char c, unsigned char from, unsigned char to) noexcept {
  const auto byte = static_cast<unsigned char>(c);
  return byte >= from && byte <= to;
}

}  // namespace

std::size_t utf8CharacterBytes(std::string_view text) noexcept {
  if (text.empty()) return 0;
  for (const LeadRow& row : kLeads) {
    if (!liesBetween(text.front(), row.first, row.last)) continue;
    if (row.bytes == 1) return 1;
    if (text.size() < row.bytes || !liesBetween(text[1], row.secondFrom, row.secondTo)) return 0;
    const std::string_view further = text.substr(2, row.bytes - 2);
    const bool whole =
        std::all_of(further.begin(), further.end(), [](char c) { return liesBetween(c, 0x80, 0xBF); });
    return whole ? row.bytes : 0;
  }
  return 0;
}

}  // namespace frontpanels

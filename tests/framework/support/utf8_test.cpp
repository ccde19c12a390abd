#include "framework/support/utf8.h"

#include <gtest/gtest.h>

#include <string>

namespace frontpanels {
namespace {

TEST(Utf8Test, KnowsCharactersFromBytesThatAreNone) {
  const struct {
    std::string bytes;
    std::size_t length;
  } rows[] = {{"", 0},
              {"ab", 1},
              {"\x7F", 1},
              {"\x80", 0},
              {"\xC1\xBF", 0},  // two bytes for what one holds
              {"\xC2\x80", 2},
              {"\xC3", 0},
              {"\xC3\x28", 0},
              {"\xE0\x9F\xBF", 0},  // three for what two hold
              {"\xE0\xA0\x80", 3},
              {"\xED\x9F\xBF", 3},
              {"\xED\xA0\x80", 0},  // half of a surrogate pair
              {"\xEF\xBF\xBF", 3},
              {"\xE2\x82", 0},
              {"\xE2\x82\x41", 0},
              {"\xF0\x8F\xBF\xBF", 0},  // four for what three hold
              {"\xF0\x90\x80\x80", 4},
              {"\xF4\x8F\xBF\xBF", 4},  // the last character
              {"\xF4\x90\x80\x80", 0},
              {"\xF5\x80\x80\x80", 0}};
  for (const auto& row : rows) EXPECT_EQ(utf8CharacterBytes(row.bytes), row.length) << row.bytes;
}

}  // namespace
}  // namespace frontpanels

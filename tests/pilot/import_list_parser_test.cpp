#include "pilot/import_list_parser.h"

#include <gtest/gtest.h>

#include <vector>

#include "platform/runtime_error.h"
#include "tests/support/memory_text_files.h"
#include "tests/support/raised.h"

namespace frontpanels {
namespace {

using Lines = std::vector<std::string>;

// Each entry's arguments up to the last one that is not empty, joined by "|"; then why the reading ended.
Lines entriesOf(const std::string& content, const std::string& separator) {
  testing::MemoryTextFiles files;
  files.contents["list.txt"] = content;
  const FixedLocale locale(".", separator);
  RegionalSeparators separators(locale);
  ImportListParser parser(files, separators);
  parser.FileOpen("list.txt");
  Lines entries;
  bool more = true;
  while (more) {
    const std::string error = testing::raised([&] { return more = parser.ParseEntry(); });
    if (!error.empty()) return entries.push_back(error), entries;
    std::string entry;
    for (std::int32_t i = 0; more && i < 9; ++i) entry += (i == 0 ? "" : "|") + parser.GetArg(i);
    if (more) entries.push_back(entry.substr(0, entry.find_last_not_of('|') + 1));
  }
  entries.emplace_back(".");
  return entries;
}

TEST(ImportListParserTest, SplitsALineAtTheUsersSeparator) {
  const struct {
    std::string content;
    std::string separator;
    Lines entries;
  } cases[] = {
      {"12;Town Hall\n", ";", {"12|Town Hall", "."}},
      {"12;Town Hall\n", ",", {"12;Town Hall", "."}},
      {"12;Town Hall\n", "\xC3\xA9;", {"12;Town Hall", "."}},  // its first character alone
      {"a\xC3\xA9"
       "b",
       "\xC3\xA9;",
       {"a|b", "."}},
      {"a,,b", ",", {"a||b", "."}},
      {" a b  , c\n  , d", ",", {"a b|c", "|d", "."}},
      {"a\tb,\tc", "\t", {"a|b,|c", "."}},
      {"1\r\n2\r\n3", ",", {"1", "2", "3", "."}},
      {"1,Town Hall\n2\n", ",", {"1|Town Hall", "2", "."}},  // nothing is left of the line before
      {"1\n\n2\n", ",", {"1", "."}},
      {"\n12\n", ",", {"."}},
      {"", ",", {"."}},
      {"\xEF\xBB\xBF"
       "12,a\n\xEF\xBB\xBF"
       "13\n",
       ",",
       {"12|a",
        "\xEF\xBB\xBF"
        "13",
        "."}},
      {"\xEF\xBB\xBF\n1\n", ",", {"."}},
      {"1,2,3,4,5,6,7,8,9,\n", ",", {"1|2|3|4|5|6|7|8|9", "."}},
      {"1,2,3,4,5,6,7,8,9,10\n", ",", {"Subscript out of range"}},
      {std::string("7\n1\0"
                   "2\n",
                   6),
       ",",
       {"7", "Invalid file format"}},
      {std::string(65536, 'x') + "\n", ",", {std::string(65536, 'x'), "."}},
      {std::string(65537, 'x') + "\n", ",", {"Invalid file format"}},
  };
  for (const auto& [content, separator, entries] : cases)
    EXPECT_EQ(entriesOf(content, separator), entries) << content.substr(0, 40) << " by " << separator;
}

TEST(ImportListParserTest, ALineOfOneBlankOrSeparatorIsAnEntryWithNothingInIt) {
  EXPECT_EQ(entriesOf(" \n,\n", ","), (Lines{"", "", "."}));
}

TEST(ImportListParserTest, RaisesWhatGoesWrong) {
  testing::MemoryTextFiles files;
  files.contents = {{"a", "1,one\n2\n"}};
  const FixedLocale locale;
  RegionalSeparators separators(locale);
  ImportListParser parser(files, separators);
  const auto parse = [&] { return parser.ParseEntry(); };
  const auto open = [&](const char* path) { return parser.FileOpen(path), true; };
  EXPECT_EQ(testing::raised(parse), "Object variable or With block variable not set");
  EXPECT_EQ(testing::raised([&] { return open("b"); }), "File not found");
  open("a");
  EXPECT_TRUE(parse());
  EXPECT_EQ(testing::raised([&] { return open("b"); }), "File not found");
  EXPECT_EQ(parser.GetArg(1), "one");
  EXPECT_TRUE(parse());  // of the file that was open
  for (const std::int32_t index : {-1, 9})
    EXPECT_EQ(testing::raised([&] { return parser.GetArg(index); }), "Subscript out of range") << index;
  files.failAtLine = 1;
  open("a");
  EXPECT_EQ(testing::raised(parse), "Device I/O error");
}

}  // namespace
}  // namespace frontpanels

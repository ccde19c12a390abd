#include "hosting/settings_file.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <memory>

#include "tests/support/raised.h"

namespace frontpanels {
namespace {

using namespace std::string_literals;

const std::string kHead =
    "# Front Panels settings, format 1\n"
    "# Written when the program ends: change it while the program does not run. A value may be followed by "
    "a\n"
    "# comment; % and two hexadecimal digits stand for a byte (%25 is a percent sign, %23 a number sign). "
    "Below\n"
    "# [spectrum] and [pilots] a number is the code of a setting of the panel. The last line must stay.\n";
const std::string kEnd = "\n# checksum 00000000, end of the settings\n";

// What stands between the head and the last line.
std::string body(const SettingsFile& file) {
  const std::string text = file.text();
  return text.substr(kHead.size(), text.size() - kHead.size() - kEnd.size());
}

std::string problemOf(const std::string& text) {
  return testing::raised([&] { return SettingsFile::parse(text); });
}

SettingsFile small() {
  SettingsFile file;
  file.section("window").set("recording", "C:\\Drives\\100% #1.csv");
  file.section("window").set("maximised", true);
  SettingsSection& panel = file.section("spectrum set-up 3");
  panel.set("left", std::int32_t{-5});
  panel.settings({{13, 0, 881.5e6}, {714, 0, std::int16_t{2}}, {230, -1, 0.1F}, {2, 0, true}});
  return file;
}

TEST(SettingsFileTest, IsATextThatPeopleCanRead) {
  EXPECT_EQ(small().text(), kHead +
                                "\n[window]\n"
                                "recording = C:\\Drives\\100%25 %231.csv\n"
                                "maximised = true\n"
                                "\n[spectrum set-up 3]\n"
                                "left = -5\n"
                                "13 = 881500000  # Center frequency (Hz)\n"
                                "714 = integer 2  # X axis style\n"
                                "230,-1 = single 0.1\n"
                                "2 = true\n"
                                "\n# checksum 5d24c56f, end of the settings\n");
}

TEST(SettingsFileTest, GivesBackWhatItHolds) {
  const SettingsFile back = SettingsFile::parse(small().text());
  EXPECT_EQ(back, small());
  EXPECT_FALSE(back.changedByHand());
  EXPECT_EQ(SettingsFile::parse(SettingsFile().text()), SettingsFile());
}

TEST(SettingsFileTest, AnyNameAndAnyTextSurvive) {
  const std::string texts[] = {"",
                               " leading and trailing ",
                               "two\nlines\r\n",
                               "a = b # no comment",
                               "[section]",
                               "] \"quoted\" %41",
                               "Scanner/Io\x1bScanner/Trace",
                               "Gr\u00F6\u00DFe \U0001F4E1",
                               "\xFF\xC3 no UTF-8, half a surrogate \xED\xA0\x80",
                               "\t\x7F\x01",
                               "zero\0inside"s,
                               "13",
                               "-1,2",
                               "# checksum 00000000, end of the settings"};
  SettingsFile file;
  for (const std::string& text : texts) {
    SettingsSection& section = file.section("section " + text);
    section.set("name " + text, text);
    section.set("text", text);
    section.set(text + "!", "by that name");
    section.settings({{314, 0, text}, {-1, 0, 1.0}});
  }
  EXPECT_EQ(SettingsFile::parse(file.text()), file);
}

TEST(SettingsFileTest, GivesEveryTypeOfASettingBackExactly) {
  constexpr double kInfinity = std::numeric_limits<double>::infinity();
  const struct {
    Variant value;
    std::string text;
  } rows[] = {{Variant(), "empty"},
              {Variant::null(), "null"},
              {false, "false"},
              {std::uint8_t{255}, "byte 255"},
              {std::int16_t{-32768}, "integer -32768"},
              {std::int32_t{-2147483647}, "long -2147483647"},
              {std::int64_t{9223372036854775807}, "longlong 9223372036854775807"},
              {0.1F, "single 0.1"},
              {-kInfinity, "-inf"},
              {5e-324, "5e-324"},
              {0.1 + 0.2, "0.30000000000000004"},
              {-0.0, "-0"},
              {DateValue{45292.5}, "date 45292.5"},
              {ErrorValue{-2147352572}, "error -2147352572"},
              {"\"a\" # b\n", "\"\"a\" %23 b%0A\""},
              {"", "\"\""},
              {"5", "\"5\""},
              {Variant::Bytes{1, 2}, "byte() 1 2"},
              {Variant::Int16s{}, "integer()"},
              {Variant::Int32s{-1}, "long() -1"},
              {Variant::Singles{0.1F, 2}, "single() 0.1 2"},
              {Variant::Doubles{0.1, 1e300}, "double() 0.1 1e+300"}};
  for (const auto& row : rows) {
    SettingsFile file;
    file.section("window").settings({{7, 0, row.value}});
    EXPECT_EQ(body(file), "\n[window]\n7 = " + row.text + "\n");
    const SettingsFile back = SettingsFile::parse(file.text());
    EXPECT_EQ(back.find("window")->settings()[0].value, row.value) << row.text;
  }
}

TEST(SettingsFileTest, ASettingThatIsNoNumberStaysNone) {
  SettingsFile file;
  file.section("window").settings({{7, 0, std::nan("")}});
  EXPECT_TRUE(std::isnan(SettingsFile::parse(file.text()).find("window")->settings()[0].value.toDouble()));
}

TEST(SettingsFileTest, KeepsNothingOfAListWithAnObjectInIt) {
  SettingsFile file = small();
  SettingsSection& section = *file.find("spectrum set-up 3");
  for (const Variant& value : {Variant(ObjectReference()), Variant(Variant::Variants{1.0})})
    EXPECT_EQ(testing::raised([&] {
                return section.settings({{13, 0, 1.0}, {14, 0, value}}), 0;
              }),
              "Type mismatch");
  EXPECT_EQ(file, small());
}

TEST(SettingsFileTest, NamesAreUniqueAndKeepTheirPlaces) {
  SettingsFile file;
  SettingsSection& first = file.section("a");
  file.section("b");
  first.set("x", 0.1);
  first.set("y", std::int32_t{2});
  first.set("x", "other");
  EXPECT_EQ(&file.section("a"), &first);
  EXPECT_EQ(body(file), "\n[a]\nx = other\ny = 2\n\n[b]\n");
  EXPECT_TRUE(first.erase("x") && file.erase("b"));
  EXPECT_FALSE(first.erase("x") || file.erase("b"));
  EXPECT_EQ(body(file), "\n[a]\ny = 2\n");
  EXPECT_EQ(testing::raised([&] { return first.set("", "x"), 0; }), "Invalid procedure call or argument");
  EXPECT_EQ(testing::raised([&] { return file.section("").name(); }), "Invalid procedure call or argument");
}

TEST(SettingsFileTest, AValueThatDoesNotReadAsWhatIsAskedForIsNone) {
  SettingsSection section("s");
  section.set("flag", true);
  section.set("count", std::int32_t{-2147483647 - 1});
  section.set("level", -80.1);
  section.set("text", "12 dB");
  EXPECT_EQ(section.get<bool>("flag"), true);
  EXPECT_EQ(section.get<std::int32_t>("count"), -2147483647 - 1);
  EXPECT_EQ(section.get<double>("level"), -80.1);
  EXPECT_EQ(section.get<std::string>("text"), "12 dB");
  EXPECT_FALSE(section.get<bool>("count") || section.get<std::int32_t>("level") ||
               section.get<double>("text") || section.get<double>("flag") ||
               section.get<std::string>("other"));
}

TEST(SettingsFileTest, TakesWhatWasChangedByHand) {
  const SettingsFile file = SettingsFile::parse(
      "\xEF\xBB\xBF# Front Panels settings, format 1\r\n"
      "  [ spectrum ]  # the first panel\r\n"
      "\t13=900e6\r\n"
      "230, 4 = integer 7\r\n"
      " name\t=  a b  # c\r\n\r\n"
      "# checksum 12345678, end of the settings\r\n \r\n");
  EXPECT_TRUE(file.changedByHand());
  EXPECT_EQ(body(file),
            "\n[spectrum]\nname = a b\n13 = 900000000  # Center frequency (Hz)\n230,4 = integer 7\n");
}

TEST(SettingsFileTest, SaysInWhichLineAndWhyATextIsDamaged) {
  const struct {
    std::string lines;
    std::string problem;
  } rows[] = {
      {"x = 1", "line 2: a value before the first section"},
      {"[a", "line 2: no ] behind the name of the section"},
      {"[]", "line 2: a section without a name"},
      {"[a]\n[b]\n[a]", "line 4: the section [a] comes twice"},
      {"[a]\nword", "line 3: no = between name and value"},
      {"[a]\n= 1", "line 3: no name before the ="},
      {"[a]\nx = 1\n%78 = 2", "line 4: \"x\" comes twice in this section"},
      {"[a]\nx = 50 %", "line 3: % without two hexadecimal digits"},
      {"[a]\nx = %4", "line 3: % without two hexadecimal digits"},
      {"[a]\nx = %+4", "line 3: % without two hexadecimal digits"},
      {"[a]\n40000 = 1", "line 3: \"40000\" is no code of a setting"},
      {"[a]\n13, = 1", "line 3: \"13,\" is no code of a setting"},
      {"[a]\n13,x = 1", "line 3: \"13,x\" is no code of a setting"},
      {"[a]\n13 = fast", "line 3: \"fast\" is no value of a setting"},
      {"[a]\n13 = integer 32768", "line 3: \"integer 32768\" is no value of a setting"},
      {"[a]\n13 = byte", "line 3: \"byte\" is no value of a setting"},
      {"[a]\n13 = byte() 1 x", "line 3: \"byte() 1 x\" is no value of a setting"},
      {"[a]\n13 = date() 1", "line 3: \"date() 1\" is no value of a setting"},
      {"[a]\n13 = \"", "line 3: \"\"\" is no value of a setting"},
      {"[a]\n13 =", "line 3: \"\" is no value of a setting"},
      {"[a]\nx = \xE4", "line 3: this is no UTF-8"},
      {"[a]\nx = "s + '\0', "line 3: a control character (0)"},
      {"# checksum 000000000, end of the settings\nx", "line 3: a value before the first section"},
      {"# checksum 00000000, end of the settings\n[a]", "line 3: something follows the end of the settings"}};
  for (const auto& row : rows)
    EXPECT_EQ(problemOf("# Front Panels settings, format 1\n" + row.lines + kEnd), row.problem);
  EXPECT_EQ(problemOf(""), "the file is empty");
  EXPECT_EQ(problemOf("a,b\n"), "line 1: these are no settings of Front Panels");
  EXPECT_EQ(problemOf("# Front Panels settings, format x\n"),
            "line 1: these are no settings of Front Panels");
  EXPECT_EQ(problemOf("# Front Panels settings, format 2\n"),
            "line 1: settings of format 2, and this program reads format 1");
}

TEST(SettingsFileTest, IsDamagedWhereverItIsCut) {
  const std::string whole = small().text();
  for (std::size_t length = 0; length + 1 < whole.size(); ++length)
    EXPECT_NE(problemOf(whole.substr(0, length)), "") << length;
  EXPECT_EQ(problemOf(whole.substr(0, whole.size() - 1)), "");  // the last line's end alone
  EXPECT_EQ(problemOf(kHead + "[a]\n"), "line 5: the end of the settings is missing: the file was cut");
}

}  // namespace
}  // namespace frontpanels

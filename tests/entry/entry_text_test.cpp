#include "entry/entry_text.h"

#include <string>

#include "tests/entry/entry_field.h"

namespace frontpanels {
namespace {

class EntryTextTest : public testing::ReportingTest {
 protected:
  // What texts read as while a unit of this scale is shown.
  void expect(double shownScale, std::string_view separator, const testing::Rows& rows) {
    const auto read = [&](const std::string& text) {
      const auto value = parseEntryText(text, entry.suffixes(), shownScale, separator);
      return value ? numberToText(*value) : "refused";
    };
    EXPECT_EQ(testing::found(rows, read), rows);
  }

  clsNumericEntry entry;
};

TEST_F(EntryTextTest, ReadsANumberAndItsUnitAndNothingElse) {
  const std::string many(65536, '0');
  expect(1, ".", {"0.1 -> 0.1", "5k -> refused", "1.7976931348623157e308 -> 1.79769313486232E+308"});
  entry.frequencySuffix();
  expect(
      1e3, ".",  // kHz are shown
      {"98.1 -> 98100", "\t +900  -> 900000", "900k -> 900000", "900 kHz -> 900000", "1.6ghz -> 1600000000",
       "5m -> 5000000", "-.5e-1 MH -> -50000", "5.E+2h -> 500", many + "7 -> 7000", "1e-400 -> 0"});
  expect(1, ",", {"1,5 -> 1.5", "1.5 -> 1.5", "1.234,5 -> refused"});
  expect(1, "\u066B", {"1\u066B5k -> 1500", "1\u066C5k -> refused"});
  expect(1, ".",
         {many + "k0 -> refused", " -> refused", "  -> refused", "1,234.5 -> refused", "1.5.2 -> refused",
          "12 345 -> refused", "- 5 -> refused", "5e -> refused", "5 kHzz -> refused", "kHz -> refused",
          ". -> refused", "0x10 -> refused", "nan -> refused", "-inf -> refused", "1e400 -> refused",
          "1e305 M -> refused", std::string("5\0k", 3) + " -> refused"});
  EXPECT_EQ(parseEntryText("2.01k", entry.suffixes(), 1, "."), 2010);  // 2.01 * 1000 is a bit less
}

TEST_F(EntryTextTest, ANameIsAUnitWhenItCanMeanOneOnly) {
  entry.suffix("mW", 0, 1, 1e-3);
  entry.suffix("MW", 1e6, 1e30, 1e6);
  entry.suffix("W", 1, 1e6, 1);
  entry.suffix("Wh", 1e30, 2e30, 3600);
  entry.suffix("Wh", 2e30, 3e30, 3600);
  entry.suffix("nothing", 3e30, 4e30, 0.0);
  expect(1, ".",
         {"1mW -> 0.001", "1MW -> 1000000", "1W -> 1", "1w -> 1", "1wH -> 3600", "1m -> refused",
          "1Mw -> refused", "1Whs -> refused", "1nothing -> refused"});
}

}  // namespace
}  // namespace frontpanels

#include "entry/entry_text.h"

#include <cmath>
#include <string>
#include <vector>

#include "entry/numeric_entry.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels {
namespace {

class EntryTextTest : public testing::ReportingTest {};

using AddSet = void (clsNumericEntry::*)();
using C = clsNumericEntry;
const double kRefused = std::nan("");

TEST_F(EntryTextTest, ReadsANumberAndItsUnitAndNothingElse) {
  struct TextCase {
    AddSet set;
    double shownScale;
    const char* separator;
    std::string text;
    double value;
  };
  const std::vector<TextCase> cases = {
      {&C::frequencySuffix, 1e6, ".", "98.1", 98.1e6},  // in the unit that is shown
      {&C::frequencySuffix, 1e3, ".", "\t +900 ", 900e3},
      {&C::frequencySuffix, 1e6, ".", "900k", 900e3},
      {&C::frequencySuffix, 1e6, ".", "900 kHz", 900e3},
      {&C::frequencySuffix, 1e3, ".", "1.6ghz", 1.6e9},
      {&C::frequencySuffix, 1e3, ".", "5m", 5e6},
      {&C::frequencySuffix, 1e6, ".", "0.57 K", 570},  // not 569.9999...
      {&C::frequencySuffix, 1, ".", "-.5e-1 MH", -5e4},
      {&C::frequencySuffix, 1, ".", "5.E+2", 500},
      {&C::frequencySuffix, 1, ",", "1,5", 1.5},
      {&C::frequencySuffix, 1, ",", "1.5", 1.5},
      {&C::frequencySuffix, 1, "\u066B", "1\u066B5k", 1500},
      {&C::frequencySuffix, 1, ".", std::string(65536, '0') + "7", 7},
      {&C::frequencySuffix, 1, ".", "1e-400", 0},
      {&C::timeSuffix, 1, ".", "3m", 3e-3},
      {&C::timeSuffix, 1, ".", "4.9 us", 4.9e-6},
      {&C::meterSuffix, 1, ".", "3 M", 3},  // a whole name, though "km" and "cm" hold an "m" as well
      {&C::noSuffix, 1, ".", "0.1", 0.1},
      {&C::noSuffix, 1, ".", "1.7976931348623157e308", 1.7976931348623157e308},
      {&C::frequencySuffix, 1, ",", "1.234,5", kRefused},
      {&C::frequencySuffix, 1, ".", "1,234.5", kRefused},
      {&C::frequencySuffix, 1, ".", "1.5.2", kRefused},
      {&C::frequencySuffix, 1, ".", "12 345", kRefused},
      {&C::frequencySuffix, 1, ".", "- 5", kRefused},
      {&C::frequencySuffix, 1, ".", "5e", kRefused},
      {&C::frequencySuffix, 1, ".", "5 kHzz", kRefused},
      {&C::frequencySuffix, 1, ".", "kHz", kRefused},
      {&C::frequencySuffix, 1, ".", "", kRefused},
      {&C::frequencySuffix, 1, ".", " ", kRefused},
      {&C::frequencySuffix, 1, ".", ".", kRefused},
      {&C::frequencySuffix, 1, ".", "0x10", kRefused},
      {&C::frequencySuffix, 1, ".", "nan", kRefused},
      {&C::frequencySuffix, 1, ".", "-inf", kRefused},
      {&C::frequencySuffix, 1, ".", "1e400", kRefused},
      {&C::frequencySuffix, 1, ".", "1e305 M", kRefused},
      {&C::frequencySuffix, 1, ".", std::string(65536, 'k'), kRefused},
      {&C::frequencySuffix, 1, ".", std::string("5\0k", 3), kRefused},
      {&C::noSuffix, 1, ".", "5k", kRefused},
  };
  for (const TextCase& c : cases) {
    clsNumericEntry entry;
    (entry.*c.set)();
    const double value =
        parseEntryText(c.text, entry.suffixes(), c.shownScale, c.separator).value_or(kRefused);
    EXPECT_TRUE(value == c.value || std::isnan(c.value + value))
        << c.text.substr(0, 20) << " reads " << value;
  }
}

TEST_F(EntryTextTest, ANameIsAUnitWhenItCanMeanOneOnly) {
  clsNumericEntry entry;
  entry.suffix("mW", 0, 1, 1e-3);
  entry.suffix("MW", 1e6, 1e30, 1e6);
  entry.suffix("W", 1, 1e6, 1);
  entry.suffix("Wh", 1e30, 2e30, 3600);
  entry.suffix("Wh", 2e30, 3e30, 3600);
  const std::vector<std::pair<std::string, double>> cases = {
      {"mW", 1e-3}, {"MW", 1e6}, {"W", 1}, {"w", 1}, {"wH", 3600}, {"m", 0}, {"Mw", 0}, {"Whs", 0}};
  for (const auto& [name, scale] : cases) {
    const SuffixRecord* const unit = suffixNamed(entry.suffixes(), name);
    EXPECT_EQ(unit == nullptr ? 0 : unit->scale, scale) << name;
  }
  entry.suffix("nothing", 3e30, 4e30, 0.0);
  EXPECT_FALSE(parseEntryText("1 nothing", entry.suffixes(), 1, "."));
}

}  // namespace
}  // namespace frontpanels

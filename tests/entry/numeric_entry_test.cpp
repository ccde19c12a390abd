#include "entry/numeric_entry.h"

#include <vector>

#include "tests/support/reporting_fixture.h"

namespace frontpanels {
namespace {

using Entry = clsNumericEntry;

class NumericEntryTest : public testing::ReportingTest {
 protected:
  Entry entry;
};

TEST_F(NumericEntryTest, ShowsValuesInTheUnitWhoseLimitsHoldThem) {
  const struct {
    void (Entry::*set)();
    std::vector<double> values;
    const char* texts;
  } rows[] = {// Limits meet at 1000: the lower one belongs to the record. No record holds 2.4 GHz nor what is
              // negative:
              // the first one's unit.
              {&Entry::frequencySuffix,
               {0, 999, 1000, 900000, 1e6, 98.1e6},
               "0 Hz|999 Hz|1 kHz|900 kHz|1 MHz|98.1 MHz|"},
              {&Entry::frequencySuffix, {2.4e9, 1e10, -500000}, "2400 MHz|10 GHz|-0.5 MHz|"},
              {&Entry::timeSuffix, {5e-8, 2e-6, 0.25, 90}, "50 ns|2 us|250 ms|90 s|"},
              {&Entry::longTimeSuffix, {1e-4, 1}, "0.1 ms|1 s|"},
              {&Entry::meterSuffix, {0.5, 1, 1500}, "50 cm|1 m|1.5 km|"},
              {&Entry::byteSuffix, {999, 1000, 5e9}, "999 Bytes|1 kBytes|5000 MBytes|"},
              {&Entry::voltSuffix, {2e-9, 3e-6, 0.25, 12}, "2 nV|3 uV|250 mV|12 V|"},
              {&Entry::dBmSuffix, {-43.2}, "-43.2 dBm|"},
              {&Entry::dBSuffix, {3}, "3 dB|"},
              {&Entry::percentSuffix, {40}, "40 %|"},
              {&Entry::chipSuffix, {64}, "64 chips|"},
              {&Entry::degreeSuffix, {90}, "90 deg|"},
              {&Entry::offsetSuffix, {12}, "12 PN|"},
              {&Entry::meterPerSecSuffix, {3}, "3 m/s|"},
              {&Entry::milePerHourSuffix, {60}, "60 MPH|"},
              {&Entry::kmPerHourSuffix, {100}, "100 KPH|"},
              {&Entry::feetSuffix, {6}, "6 ft|"},
              {&Entry::noSuffix, {12.25}, "12.25|"}};
  for (const auto& row : rows) {
    Entry shown;
    shown.formatString("0.##");
    (shown.*row.set)();
    std::string texts;
    for (const double value : row.values) texts += shown.formatter(value) + "|";
    EXPECT_EQ(texts, row.texts);
  }
}

TEST_F(NumericEntryTest, SubtractsTheDisplayOffsetDividesByTheScaleAndCanLeaveTheUnitOut) {
  entry.formatString("0.00");
  entry.formatOffset(10);
  entry.formatScale(4);
  entry.dBSuffix();
  EXPECT_EQ(entry.formatter(16), "1.50 dB");
  entry.suppressSuffix(true);
  EXPECT_EQ(entry.formatter(16), "1.50");
  entry.formatString("");  // the general form
  EXPECT_EQ(entry.formatter(11), "0.25");
  entry.formatScale(0);
  EXPECT_EQ(entry.formatter(1), "");
  EXPECT_EQ(said(), "clsNumericEntry::formatter() failed. \rDivision by zero");
}

TEST_F(NumericEntryTest, TakesTheScaleGivenOrTheLowerLimit) {
  entry.suffix("a", 0, 1);
  entry.suffix("b", 1000, 2000);
  entry.suffix("c", 2000, 3000, 7.0);
  entry.suffix("d", 3000, 4000, Variant("12"));
  EXPECT_EQ(said(), "");
  entry.suffix("e", 5000, 6000, Variant("many"));
  EXPECT_EQ(said(), "Warning...a non-numeric value has been passed to clsNumericEntry::suffix()\r");
  EXPECT_EQ(std::vector<SuffixRecord>(entry.suffixes().begin(), entry.suffixes().end()),
            (std::vector<SuffixRecord>{{0, 1, 1, "a"},
                                       {1000, 2000, 1000, "b"},
                                       {2000, 3000, 7, "c"},
                                       {3000, 4000, 12, "d"},
                                       {5000, 6000, 5000, "e"}}));
}

TEST_F(NumericEntryTest, OfOverlappingSuffixesTheLastAddedCountsAndAnEleventhIsRefused) {
  entry.suffix("first", 0, 100, 1);
  entry.suffix("last", 50, 100, 10);
  EXPECT_EQ(entry.formatter(49), "49 first");
  EXPECT_EQ(entry.formatter(50), "5 last");
  entry.timeSuffix();
  for (int i = 7; i <= 10; ++i) entry.suffix("more", 0, 1);
  EXPECT_EQ(said(), "");
  entry.suffix("one more", 0, 1);
  EXPECT_EQ(entry.suffixes().count(), 10U);
  EXPECT_EQ(said(), "clsNumericEntry::suffix() ... too many suffixes\r");
}

}  // namespace
}  // namespace frontpanels

#include "entry/numeric_entry.h"

#include <vector>

#include "tests/support/reporting_fixture.h"

namespace frontpanels {
namespace {

class NumericEntryTest : public testing::ReportingTest {
 protected:
  clsNumericEntry entry;
};

using AddSet = void (clsNumericEntry::*)();

TEST_F(NumericEntryTest, ShowsValuesInTheUnitWhoseLimitsHoldThem) {
  struct UnitCase {
    AddSet set;
    double value;
    const char* text;
  };
  const std::vector<UnitCase> cases = {
      {&clsNumericEntry::frequencySuffix, 0, "0 Hz"},
      {&clsNumericEntry::frequencySuffix, 999, "999 Hz"},
      {&clsNumericEntry::frequencySuffix, 1000, "1 kHz"},  // limits meet: the lower one belongs to the record
      {&clsNumericEntry::frequencySuffix, 900000, "900 kHz"},
      {&clsNumericEntry::frequencySuffix, 1e6, "1 MHz"},
      {&clsNumericEntry::frequencySuffix, 98.1e6, "98.1 MHz"},
      {&clsNumericEntry::frequencySuffix, 2.4e9, "2400 MHz"},  // below 10 GHz no record: the first one's unit
      {&clsNumericEntry::frequencySuffix, 1e10, "10 GHz"},
      {&clsNumericEntry::frequencySuffix, -500000, "-0.5 MHz"},
      {&clsNumericEntry::timeSuffix, 5e-8, "50 ns"},
      {&clsNumericEntry::timeSuffix, 2e-6, "2 us"},
      {&clsNumericEntry::timeSuffix, 0.25, "250 ms"},
      {&clsNumericEntry::timeSuffix, 90, "90 s"},
      {&clsNumericEntry::longTimeSuffix, 1e-4, "0.1 ms"},
      {&clsNumericEntry::longTimeSuffix, 1, "1 s"},
      {&clsNumericEntry::meterSuffix, 0.5, "50 cm"},
      {&clsNumericEntry::meterSuffix, 1, "1 m"},
      {&clsNumericEntry::meterSuffix, 1500, "1.5 km"},
      {&clsNumericEntry::byteSuffix, 999, "999 Bytes"},
      {&clsNumericEntry::byteSuffix, 1000, "1 kBytes"},
      {&clsNumericEntry::byteSuffix, 5e9, "5000 MBytes"},
      {&clsNumericEntry::voltSuffix, 2e-9, "2 nV"},
      {&clsNumericEntry::voltSuffix, 3e-6, "3 uV"},
      {&clsNumericEntry::voltSuffix, 0.25, "250 mV"},
      {&clsNumericEntry::voltSuffix, 12, "12 V"},
      {&clsNumericEntry::dBmSuffix, -43.2, "-43.2 dBm"},
      {&clsNumericEntry::dBSuffix, 3, "3 dB"},
      {&clsNumericEntry::percentSuffix, 40, "40 %"},
      {&clsNumericEntry::chipSuffix, 64, "64 chips"},
      {&clsNumericEntry::degreeSuffix, 90, "90 deg"},
      {&clsNumericEntry::meterPerSecSuffix, 3, "3 m/s"},
      {&clsNumericEntry::milePerHourSuffix, 60, "60 MPH"},
      {&clsNumericEntry::kmPerHourSuffix, 100, "100 KPH"},
      {&clsNumericEntry::feetSuffix, 6, "6 ft"},
      {&clsNumericEntry::noSuffix, 12.25, "12.25"},
  };
  for (const UnitCase& c : cases) {
    clsNumericEntry shown;
    shown.formatString("0.##");
    (shown.*c.set)();
    EXPECT_EQ(shown.formatter(c.value), c.text);
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
}

TEST_F(NumericEntryTest, AFailureIsReportedAndTheTextIsEmpty) {
  entry.formatScale(0);

  EXPECT_EQ(entry.formatter(1), "");

  EXPECT_EQ(messages(), std::vector<std::string>{"clsNumericEntry::formatter() failed. \rDivision by zero"});
}

TEST_F(NumericEntryTest, TakesTheScaleGivenOrTheLowerLimit) {
  entry.suffix("a", 0, 1);
  entry.suffix("b", 1000, 2000);
  entry.suffix("c", 2000, 3000, 7.0);
  entry.suffix("d", 3000, 4000, Variant("12"));
  EXPECT_EQ(messages().size(), 0U);
  entry.suffix("e", 5000, 6000, Variant("many"));

  EXPECT_EQ(std::vector<SuffixRecord>(entry.suffixes().begin(), entry.suffixes().end()),
            (std::vector<SuffixRecord>{{0, 1, 1, "a"},
                                       {1000, 2000, 1000, "b"},
                                       {2000, 3000, 7, "c"},
                                       {3000, 4000, 12, "d"},
                                       {5000, 6000, 5000, "e"}}));
  EXPECT_EQ(messages(), std::vector<std::string>{
                            "Warning...a non-numeric value has been passed to clsNumericEntry::suffix()\r"});
}

TEST_F(NumericEntryTest, RefusesAnEleventhSuffix) {
  entry.frequencySuffix();
  entry.timeSuffix();
  entry.longTimeSuffix();
  EXPECT_EQ(messages().size(), 0U);

  entry.suffix("one more", 0, 1);

  EXPECT_EQ(entry.suffixes().count(), 10U);
  EXPECT_EQ(messages(), std::vector<std::string>{"clsNumericEntry::suffix() ... too many suffixes\r"});
}

TEST_F(NumericEntryTest, OfOverlappingSuffixesTheLastAddedCounts) {
  entry.suffix("first", 0, 100, 1);
  entry.suffix("last", 50, 100, 10);

  EXPECT_EQ(entry.formatter(49), "49 first");
  EXPECT_EQ(entry.formatter(50), "5 last");
}

}  // namespace
}  // namespace frontpanels

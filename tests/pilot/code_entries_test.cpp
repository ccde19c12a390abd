#include "pilot/code_entries.h"

#include "pilot/code_units.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels {
namespace {

using CodeEntriesTest = testing::ReportingTest;

std::string chips(const CodeEntries& code) {
  std::string text;
  for (const clsNumericEntry* const entry : {&code.start, &code.stop, &code.center, &code.span})
    text += (text.empty() ? "" : " ") + numberToText(entry->value());
  return text;
}

TEST_F(CodeEntriesTest, TheTripleRateCodeHas192ChipsForEach64OfTheOthers) {
  struct Row {
    std::int16_t format;
    std::int32_t current;
    std::int32_t is95B;
  };
  // 1 / 192 * 64 = 0.33, 2 / 192 * 64 = 0.67; 98301 is the last IS-95B chip of 32767
  constexpr Row kToIs95B[] = {{2, 192, 64},   {2, 1, 0},   {2, 2, 1},   {2, 98301, 32767},
                              {2, -192, -64}, {0, 37, 37}, {1, 37, 37}, {3, 37, 37}};
  for (const Row& row : kToIs95B)
    EXPECT_EQ(CurrentToIS95BChips(row.format, row.current), row.is95B) << row.format << " " << row.current;
  constexpr Row kFromIs95B[] = {{2, 192, 64}, {2, 3, 1}, {2, 98301, 32767}, {0, 37, 37}, {1, 37, 37}};
  for (const Row& row : kFromIs95B)
    EXPECT_EQ(IS95BToCurrentChips(row.format, row.is95B), row.current) << row.format << " " << row.is95B;
  EXPECT_EQ(IS95BToCurrentChips(2, 0x7FFFFFFF), 0);
  EXPECT_EQ(said(), "Tarvex::IS95BToCurrentChips()\rOverflow");
}

// start, stop, centre, span in chips; each row goes on from the one before
TEST_F(CodeEntriesTest, TheWindowFollowsEachEntryInWholeChipsAndWrapsNowhere) {
  struct Row {
    const char* what;
    void (*change)(CodeEntries& code);
    const char* expected;
  };
  const Row rows[] = {
      // 32767 / 2 = 16383.5, shown rounded to the even chip
      {"load", [](CodeEntries&) {}, "0 32767 16384 32767"},
      {"host's start keeps the span, cut", [](CodeEntries& c) { c.startFromHost(1000); },
       "1000 32767 16884 31767"},
      {"host's span keeps the start", [](CodeEntries& c) { c.spanFromHost(640); }, "1000 1640 1320 640"},
      {"span beyond the end", [](CodeEntries& c) { c.spanFromHost(40000); }, "1000 32767 16884 31767"},
      {"negative", [](CodeEntries& c) { c.spanFromHost(100), c.startFromHost(-5); }, "0 100 50 100"},
      {"half a chip to even", [](CodeEntries& c) { c.startFromHost(2.5), c.spanFromHost(5.5); }, "2 8 5 6"},
      {"host's centre", [](CodeEntries& c) { c.centerFromHost(2000); }, "1997 2003 2000 6"},
      {"centre at the lower end", [](CodeEntries& c) { c.centerFromHost(1); }, "0 6 3 6"},
      {"centre at the upper end", [](CodeEntries& c) { c.centerFromHost(32767); }, "32761 32767 32764 6"},
      {"typed centre stands", [](CodeEntries& c) { c.spanFromHost(5), c.center.value(101), c.fitCenter(); },
       "98 103 101 5"},
      {"typed span round the centre", [](CodeEntries& c) { c.span.value(11), c.fitSpan(); }, "96 107 101 11"},
      {"typed span at the lower end", [](CodeEntries& c) { c.span.value(300), c.fitSpan(); },
       "0 300 150 300"},
      {"typed start keeps the stop", [](CodeEntries& c) { c.start.value(100), c.joinEdges(true); },
       "100 300 200 200"},
      {"typed stop keeps the start", [](CodeEntries& c) { c.stop.value(401), c.joinEdges(false); },
       "100 401 250 301"},
      {"start above the stop", [](CodeEntries& c) { c.start.value(500), c.joinEdges(true); },
       "500 500 500 0"},
      {"stop below the start", [](CodeEntries& c) { c.stop.value(400), c.joinEdges(false); },
       "400 400 400 0"},
      {"changed in vain", [](CodeEntries& c) { c.stop.value(900), c.placeEdges(); }, "400 400 400 0"},
  };
  CodeEntries code;
  for (const Row& row : rows) {
    row.change(code);
    EXPECT_EQ(chips(code), row.expected) << row.what;
  }
  EXPECT_EQ(said(), "");
}

TEST_F(CodeEntriesTest, AnotherFormatCountsTheSamePlacesInItsOwnChips) {
  CodeEntries code;
  code.startFromHost(64 * 12);
  code.spanFromHost(64 * 8 + 1);
  EXPECT_EQ(code.start.text(), "12");
  EXPECT_EQ(code.span.text(), "8.0156");  // 513 / 64 = 8.015625
  code.format(2);
  EXPECT_EQ(chips(code), "2304 3843 3074 1539");  // (2304 + 3843) / 2 = 3073.5, to the even chip
  EXPECT_EQ(code.start.text(), "12");
  EXPECT_EQ(code.span.text(), "8.0156");
  EXPECT_EQ(code.stop.MAXIMUM(), 98301);
  code.units(CodeUnits::Chips);
  EXPECT_EQ(code.start.text(), "2304");
  code.start.upClick();
  EXPECT_EQ(code.start.value(), 2305);
  code.units(CodeUnits::Pn);
  code.start.upClick();
  EXPECT_EQ(code.start.value(), 2305 + 192);
  code.format(0);
  EXPECT_EQ(chips(code), "768 1281 1024 513");  // what was held, not what was typed in vain
  EXPECT_EQ(code.startPn(), 12);
}

}  // namespace
}  // namespace frontpanels

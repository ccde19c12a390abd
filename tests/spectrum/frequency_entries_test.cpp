#include "spectrum/frequency_entries.h"

#include <cmath>

#include "tests/support/listed_records.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels {
namespace {

using testing::ListedRecords;

class FrequencyEntriesTest : public testing::ReportingTest {
 protected:
  [[nodiscard]] static std::string inMHz(const FrequencyEntries& f) {
    std::string text;
    for (const clsNumericEntry* const entry : {&f.center, &f.span, &f.start, &f.stop})
      text += (text.empty() ? "" : " ") + numberToText(entry->value() / 1e6);
    return text;
  }
  [[nodiscard]] static ListedRecords bands() {
    return ListedRecords({{{"[Order]", 0}, {"[Minimum]", 869.04e6}, {"[Maximum]", 893.97e6}},
                          {{"[Order]", 1}, {"[Minimum]", 824.04e6}, {"[Maximum]", 848.97e6}}});
  }
  static void typed(clsNumericEntry& entry, double value) { entry.value(value); }
};

// centre, span, start, stop
TEST_F(FrequencyEntriesTest, EntriesFollowEachOtherWithinTheLimitsAndTheStartRoundsToItsStep) {
  struct Row {
    const char* what;
    void (*change)(FrequencyEntries& f);
    const char* expected;
  };
  // Each row goes on from the one before. The limits are 0 and 6000 MHz.
  const Row rows[] = {
      {"load", [](FrequencyEntries&) {}, "1000 10 995 1005"},
      {"centre", [](FrequencyEntries& f) { f.setCenter(881.52e6); }, "881.52 10 876.52 886.52"},
      {"start rounds only from now on", [](FrequencyEntries& f) { f.setSpan(10e6); },
       "881.52 10 876.52 886.52"},
      {"to 10^7 * 0.1", [](FrequencyEntries& f) { f.setCenter(881.53e6); }, "881.53 10 877 886.53"},
      // log10(30e6) = 7.477, log10(40e6) = 7.602
      {"decade below", [](FrequencyEntries& f) { f.setSpan(30e6); }, "881.53 30 867 896.53"},
      {"decade above", [](FrequencyEntries& f) { f.setSpan(40e6); }, "881.53 40 862 901.53"},
      {"rounded to 10 MHz", [](FrequencyEntries& f) { f.setCenter(881e6); }, "881 40 860 901"},
      {"stop above the maximum", [](FrequencyEntries& f) { f.setCenter(5999e6), f.setSpan(20e6); },
       "5990 20 5980 6000"},
      {"start below the minimum", [](FrequencyEntries& f) { f.setCenter(1e6), f.setSpan(20e6); },
       "10 20 0 20"},
      {"wider than everything", [](FrequencyEntries& f) { f.setSpan(1e12); }, "3000 6000 0 6000"},
      {"not a number", [](FrequencyEntries& f) { f.setSpan(-1.0), f.setSpan(std::nan("")); },
       "3000 0 3000 3000"},
      {"start above stop",
       [](FrequencyEntries& f) { f.setSpan(10e6), typed(f.start, 4000e6), f.joinEdges(true); },
       "4000 0 4000 4000"},
      {"stop below start",
       [](FrequencyEntries& f) { f.setSpan(10e6), typed(f.stop, 3000e6), f.joinEdges(false); },
       "3000 0 3000 3000"},
      {"small spans", [](FrequencyEntries& f) { f.setSpan(1), f.setCenter(4e9), f.setCenter(3e9); },
       "3000 0.000001 2999.9999995 3000.0000005"},
      {"the other edge is what it is, not what it reads",
       [](FrequencyEntries& f) {
         f.setSpan(10e6), f.setCenter(1000.3e6), typed(f.stop, 1006.3e6), f.joinEdges(false);
       },
       "1000.8 11 995 1006.3"},
      {"together", [](FrequencyEntries& f) { f.setSpan(0), f.setCenter(3000e6), f.setSpan(0); },
       "3000 0 3000 3000"},
      {"edges apart", [](FrequencyEntries& f) { typed(f.stop, 3001e6), f.joinEdges(false); },
       "3000.5 1 3000 3001"},
      {"typed centre at the edge",
       [](FrequencyEntries& f) { f.setSpan(100e6), typed(f.center, 5999e6), f.fitCenter(); },
       "5950 100 5900 6000"},
  };
  FrequencyEntries f;
  for (const Row& row : rows) {
    row.change(f);
    EXPECT_EQ(inMHz(f), row.expected) << row.what;
  }
  EXPECT_EQ(said(), "clsNumericEntry::value() failed. \rOverflow");
}

TEST_F(FrequencyEntriesTest, ABandIsARangeOfTheCentreAndChangesByOffsetOrByChannel) {
  FrequencyEntries f;
  f.setBand(1);  // no band has limits
  EXPECT_TRUE(f.downlink());
  f.limits(bands());
  f.setSpan(2e6);
  f.setCenter(836.52e6);
  EXPECT_EQ(f.center.range() * 100 + f.start.range() * 10 + f.stop.range(), 111);
  f.setBand(0);  // 12.48 MHz above the lower limit
  EXPECT_EQ(inMHz(f).substr(0, 8), "881.52 2");
  EXPECT_TRUE(f.downlink());

  clsChannelInfo channels;
  const ListedRecords orders({{{"[Order]", 0}, {"[Minimum]", 0}, {"[Maximum]", 1}}});
  const ListedRecords uplink({{{"[Order]", 1}}});
  channels.setChannelLookup("3", &orders);
  channels.setChannelZero("870000000", &orders);
  channels.setChannelSpacing("30000", &orders);
  channels.setChannelZero("825000000", &uplink);
  channels.setChannelSpacing("30000", &uplink);
  EXPECT_FALSE(f.showChannels(channels, 4));
  EXPECT_EQ(said(), "clsChannelInfo::selectChannelization() ... could not find channelization lookup\r");
  clsChannelInfo narrow;  // all channels in one place
  narrow.setChannelLookup("3", &orders);
  narrow.setChannelZero("870000000", &orders);
  narrow.setChannelSpacing("0", &orders);
  EXPECT_FALSE(f.showChannels(narrow, 3));
  EXPECT_EQ(said(), "clsChannelInfo::selectChannelization()\rDivision by zero");
  EXPECT_EQ(f.center.formatter(f.center.value()), "881.52 MHz");
  EXPECT_TRUE(f.showChannels(channels, 3));
  f.setCenter(881.52e6);  // (881.52 - 870) / 0.03
  EXPECT_EQ(f.center.formatter(f.center.value()), "384");
  f.setBand(1);
  EXPECT_EQ(inMHz(f), "836.52 2 835.52 837.52");  // the start keeps to channels, not to 100 kHz
  f.showFrequencies();
  EXPECT_EQ(f.center.formatter(f.center.value()), "836.52 MHz");
  f.setCenter(836.54e6);
  EXPECT_EQ(inMHz(f), "836.54 2 835.5 837.54");  // and now to 100 kHz again
}

TEST_F(FrequencyEntriesTest, AxisFormatFollowsTheSpanWithItsGaps) {
  struct Row {
    double spanHz;
    const char* format;
  };
  const Row rows[] = {
      {-1, "0.##"},           {0, "0.##############"}, {4, "0.##############"}, {4.5, "0.##"},
      {5, "0.#############"}, {49, "0.############"},  {50, "0.###########"},   {499, "0.##########"},
      {999, "0.#########"},   {4999, "0.########"},    {5000, "0.##"},          {7500, "0.##"},
      {9999, "0.##"},         {10000, "0.#######"},    {99999, "0.######"},     {100000, "0.#####"},
      {999999, "0.####"},     {1000000, "0.###"},      {4999999, "0.###"},      {5000000, "0.##"},
  };
  for (const Row& row : rows) EXPECT_EQ(axisFormatForSpan(row.spanHz), row.format) << row.spanHz;
}

}  // namespace
}  // namespace frontpanels

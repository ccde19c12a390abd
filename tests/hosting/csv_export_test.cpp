#include "hosting/csv_export.h"

#include <gtest/gtest.h>

#include <limits>
#include <locale>

#include "sources/sweep.h"

namespace frontpanels {
namespace {

// With "|" for each line end: every line ends in CR LF.
std::string lines(const std::string& csv) {
  std::string text;
  std::size_t from = 0;
  for (std::size_t end = 0; (end = csv.find("\r\n", from)) != std::string::npos; from = end + 2)
    text += csv.substr(from, end - from) + "|";
  return text + csv.substr(from);
}

DisplaySweep sweepOf(double centerHz, double spanHz, std::initializer_list<float> values) {
  DisplaySweep sweep;
  sweep.range = {centerHz, spanHz};
  for (const float value : values) sweep.values[sweep.count++] = value;
  return sweep;
}

TEST(CsvExportTest, ASweepIsALineAPointFromEdgeToEdge) {
  // 100 to 101 MHz in four points; the closing gap beyond the right edge is none of them.
  EXPECT_EQ(lines(sweepCsv({{{"Source", "fm_band.csv"}, {"Sweep", "7"}}},
                           sweepOf(100.5e6, 1e6, {-80.1F, kGap, 3, -0.5F, kGap}))),
            "# Source: fm_band.csv|# Sweep: 7|Frequency (Hz),Level (dB)|"
            "100000000,-80.1|100333333.33333333,|100666666.66666667,3|101000000,-0.5|");
}

TEST(CsvExportTest, ASweepWithoutPointsHasItsTitlesOnly) {
  EXPECT_EQ(lines(sweepCsv({}, sweepOf(0, 0, {}))), "Frequency (Hz),Level (dB)|");
}

TEST(CsvExportTest, NumbersHaveAPointInEveryLocale) {
  struct Comma : std::numpunct<char> {
    char do_decimal_point() const override { return ','; }
  };
  const std::locale before = std::locale::global(std::locale(std::locale(), new Comma));
  const std::string csv = lines(sweepCsv({}, sweepOf(0.25, 0.5, {-80.5F, 1e-7F, kGap})));
  std::locale::global(before);
  EXPECT_EQ(csv, "Frequency (Hz),Level (dB)|0,-80.5|0.5,1e-07|");
}

TEST(CsvExportTest, ALineOfTheHeadStaysOneAndBeginsNoFormula) {
  const std::pair<std::string, std::string> rows[] = {
      {"=1+1", "# Note: =1+1|"},  // behind "# " in the first cell: no formula
      {"a,=1;+2\t@x, -3", "# Note: a,'=1;'+2\t'@x, '-3|"},
      {"a, b;c d-e", "# Note: a, b;c d-e|"},
      {"say \"x\"", "# Note: say 'x'|"},
      {"two\r\nlines\x1b", "# Note: two  lines |"},
      {"Gr\u00F6\u00DFe", "# Note: Gr\u00F6\u00DFe|"}};
  for (const auto& [value, line] : rows)
    EXPECT_EQ(lines(sweepCsv({{{"Note", value}}}, {})), line + "Frequency (Hz),Level (dB)|");
  EXPECT_EQ(lines(sweepCsv({{{"a,=b\n", "c"}}}, {})), "# a,'=b : c|Frequency (Hz),Level (dB)|");
}

TEST(CsvExportTest, SettingsGoByTheNameThatTheyHaveOnThePanel) {
  const StoredSetting settings[] = {{13, 0, 881.5e6}, {500, 0, 32.0}, {6000, 0, "text"}, {14, 0, 4e6}};
  ExportHeader header{{{"Source", "a"}}};
  addSettings(header, PanelKind::Spectrum, settings);
  addSettings(header, PanelKind::Pilots, settings);
  const std::vector<std::pair<std::string, std::string>> expected = {{"Source", "a"},
                                                                     {"Center frequency (Hz)", "881500000"},
                                                                     {"Averaging (32 off)", "32"},
                                                                     {"Setting 6000", "\"text\""},
                                                                     {"Span (Hz)", "4000000"},
                                                                     {"Carrier frequency (Hz)", "881500000"},
                                                                     {"Code format", "32"},
                                                                     {"Setting 6000", "\"text\""},
                                                                     {"Setting 14", "4000000"}};
  EXPECT_EQ(header.entries, expected);
}

TEST(CsvExportTest, PilotsAreATableASetThatIsThere) {
  PilotFrame frame;
  frame.allPilots = PilotLevels{-70.5F, {-20, kGap, -3.25F}};
  frame.zoomedPilots = PilotLevels{-71, {-9}};
  frame.topN = PilotBars{-70, {{12, -5.5F, 3.25F, -4, 1.5F, 1.5F}, {511, -20, 0, -20, 0, 0}}};
  frame.userList = PilotBars{-60, {}};
  frame.carrier = CarrierState{-12.5, 2, 1};
  // Ec is Ec/Io plus Io.
  EXPECT_EQ(lines(pilotsCsv({{{"Source", "drive"}}}, frame)),
            "# Source: drive|"
            "|# Set: All pilots|# Io (dBm): -70.5|PN offset,Ec/Io (dB),Ec (dBm)|"
            "0,-20,-90.5|1,,|2,-3.25,-73.75|"
            "|# Set: Zoomed pilots|# Io (dBm): -71|Point,Ec/Io (dB),Ec (dBm)|0,-9,-80|"
            "|# Set: Top N|# Io (dBm): -70|"
            "PN offset,Peak Ec/Io (dB),Delay (chips),Aggregate Ec/Io (dB),Delay spread (chips),"
            "Aggregate minus peak (dB),Peak Ec (dBm),Aggregate Ec (dBm)|"
            "12,-5.5,3.25,-4,1.5,1.5,-75.5,-74|511,-20,0,-20,0,0,-90,-90|"
            "|# Set: User list|# Io (dBm): -60|"
            "PN offset,Peak Ec/Io (dB),Delay (chips),Aggregate Ec/Io (dB),Delay spread (chips),"
            "Aggregate minus peak (dB),Peak Ec (dBm),Aggregate Ec (dBm)|"
            "|# Set: Carrier|Frequency error (Hz),State,1PPS|-12.5,locked,1|");
}

TEST(CsvExportTest, WhatWasNotMeasuredIsNotThere) {
  EXPECT_EQ(pilotsCsv({}, {}), "");
  PilotFrame frame;
  frame.carrier = CarrierState{std::numeric_limits<double>::infinity(), 3, 0};
  EXPECT_EQ(lines(pilotsCsv({}, frame)), "# Set: Carrier|Frequency error (Hz),State,1PPS|,3,0|");
}

}  // namespace
}  // namespace frontpanels

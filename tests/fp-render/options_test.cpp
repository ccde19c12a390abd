#include "fp-render/options.h"

#include <gtest/gtest.h>

#include <functional>
#include <vector>

namespace frontpanels {
namespace {

using Arguments = std::vector<const char*>;

TEST(RenderOptions, AreReadInAnyOrder) {
  const Arguments kOrders[] = {{"a.csv", "-o", "out", "--sweep", "12"},
                               {"--sweep=12", "a.csv", "-o", "out"},
                               {"-o", "out", "--sweep", "12", "--", "a.csv"}};
  for (const auto& arguments : kOrders) {
    RenderOptions options;
    std::string problem;
    EXPECT_TRUE(parseOptions(arguments, options, problem)) << problem;
    EXPECT_EQ(options.recording, "a.csv");
    EXPECT_EQ(options.directory, "out");
    EXPECT_EQ(options.range, (FrameRange{12, 12}));
  }
}

TEST(RenderOptions, TakeValuesAsTheyAreWritten) {
  const struct {
    Arguments arguments;
    std::function<bool(const RenderOptions&)> holds;
  } kCases[] = {
      {{"--sweeps", "5-9"},
       [](const auto& o) {
         return o.range == FrameRange{5, 9};
       }},
      {{"--sweeps", "5-"},
       [](const auto& o) {
         return o.range == FrameRange{5, std::nullopt};
       }},
      {{"--sweeps", "-9"},
       [](const auto& o) {
         return o.range == FrameRange{1, 9};
       }},
      {{"--sweeps", "7"},
       [](const auto& o) {
         return o.range == FrameRange{7, 7};
       }},
      {{"--size", "200x150"},
       [](const auto& o) {
         return o.sizePx == Size{200, 150};
       }},
      {{"--size", "7680x4320"},
       [](const auto& o) {
         return o.sizePx == Size{7680, 4320};
       }},
      {{"--scale", "144"}, [](const auto& o) { return o.dpi == 144; }},
      {{"--panel", "pilots"}, [](const auto& o) { return o.panel == PanelKind::Pilots; }},
      {{"--sets", "top,all"},
       [](const auto& o) {
         return o.sets == ShownSets{true, false, true, false};
       }},
      {{"--center", "98100000"}, [](const auto& o) { return o.centerHz == 98.1e6; }},
      {{"--center", "98.1M"}, [](const auto& o) { return o.centerHz == 98.1e6; }},
      {{"--center", "1.5 ghz"}, [](const auto& o) { return o.centerHz == 1.5e9; }},
      {{"--center", "0"}, [](const auto& o) { return o.centerHz == 0.0; }},
      {{"--span", "200k"}, [](const auto& o) { return o.spanHz == 200e3; }},
      {{"--top", "-20 dBm"}, [](const auto& o) { return o.topDb == -20.0; }},
      {{"--per-division", "2.5dB"}, [](const auto& o) { return o.dbPerDivision == 2.5; }},
      {{"--caption", ""}, [](const auto& o) { return o.caption == ""; }},
      {{"--marker", "12 PN", "--delta", "168", "--marker", "98M"},
       [](const auto& o) {
         return o.markers == std::vector<MarkerPlace>{{"12 PN", "168"}, {"98M", std::nullopt}};
       }},
      {{"--set", "716=5", "--set", "230,-1=12", "--set", "314=a=b"},
       [](const auto& o) {
         return o.settings == std::vector<StoredSetting>{{716, 0, 5.0}, {230, -1, 12.0}, {314, 0, "a=b"}};
       }},
      {{"--settings", "f", "--set-up", "3"}, [](const auto& o) { return o.setUp == 3U; }},
  };
  for (const auto& testCase : kCases) {
    Arguments arguments = testCase.arguments;
    arguments.push_back("a.csv");
    RenderOptions options;
    std::string problem;
    EXPECT_TRUE(parseOptions(arguments, options, problem)) << problem;
    EXPECT_TRUE(testCase.holds(options)) << testCase.arguments[0] << " " << testCase.arguments[1];
  }
}

TEST(RenderOptions, ThatMakeNoSenseAreRefusedWithTheReason) {
  const std::string sizes = " needs a size like 800x600, from 200x150 to 7680x4320, not ";
  const std::string ranges = " needs a range like 5-9, 5- or -9 that begins at 1 or later, not ";
  const struct {
    Arguments arguments;
    std::string problem;
  } kCases[] = {
      {{}, "no recording named"},
      {{"a.csv", "b.csv"}, "more than one recording"},
      {{""}, "the recording's name is empty"},
      {{"a.csv", "-x"}, "unknown option -x"},
      {{"a.csv", "--sweep-s=1"}, "unknown option --sweep-s"},
      {{"a.csv", "--peak=1"}, "--peak takes no value"},
      {{"a.csv", "-o"}, "-o needs a value"},
      {{"a.csv", "-o", ""}, "-o needs a folder, not \"\""},
      {{"a.csv", "--sweep", "0"}, "--sweep needs a number from 1 on, not \"0\""},
      {{"a.csv", "--sweep", "3x"}, "--sweep needs a number from 1 on, not \"3x\""},
      {{"a.csv", "--sweep", "18446744073709551616"},
       "--sweep needs a number from 1 on, not \"18446744073709551616\""},
      {{"a.csv", "--sweeps", "9-5"}, "--sweeps" + ranges + "\"9-5\""},
      {{"a.csv", "--sweeps", "0-5"}, "--sweeps" + ranges + "\"0-5\""},
      {{"a.csv", "--sweeps", "-"}, "--sweeps" + ranges + "\"-\""},
      {{"a.csv", "--sweeps", "1-2-3"}, "--sweeps" + ranges + "\"1-2-3\""},
      {{"a.csv", "--every", "0"}, "--every needs a number from 1 on, not \"0\""},
      {{"a.csv", "--size", "199x150"}, "--size" + sizes + "\"199x150\""},
      {{"a.csv", "--size", "200x149"}, "--size" + sizes + "\"200x149\""},
      {{"a.csv", "--size", "7681x4320"}, "--size" + sizes + "\"7681x4320\""},
      {{"a.csv", "--size", "800"}, "--size" + sizes + "\"800\""},
      {{"a.csv", "--scale", "100"}, "--scale needs 96, 144 or 192, not \"100\""},
      {{"a.csv", "--panel", "pilot"}, "--panel needs spectrum or pilots, not \"pilot\""},
      {{"a.csv", "--sets", "all,"}, "--sets needs a list of all, zoomed, top and list, not \"all,\""},
      {{"a.csv", "--name", "../x"}, "--name needs a name that is no path, not \"../x\""},
      {{"a.csv", "--center", "-1"}, "--center needs a frequency like 98.1M, not \"-1\""},
      {{"a.csv", "--center", "98,1M"}, "--center needs a frequency like 98.1M, not \"98,1M\""},
      {{"a.csv", "--span", "0"}, "--span needs a frequency above 0 like 2M, not \"0\""},
      {{"a.csv", "--top", "-20 Hz"}, "--top needs a number of dB, not \"-20 Hz\""},
      {{"a.csv", "--per-division", "0"}, "--per-division needs a number of dB above 0, not \"0\""},
      {{"a.csv", "--marker", "x"}, "--marker needs a frequency or a PN offset, not \"x\""},
      {{"a.csv", "--delta", "1"},
       "--delta needs a frequency or a PN offset, and a --marker before it, not \"1\""},
      {{"a.csv", "--set", "716"}, "--set needs CODE=VALUE or CODE,INDEX=VALUE, not \"716\""},
      {{"a.csv", "--set", "0=1"}, "--set needs CODE=VALUE or CODE,INDEX=VALUE, not \"0=1\""},
      {{"a.csv", "--set", "230,=1"}, "--set needs CODE=VALUE or CODE,INDEX=VALUE, not \"230,=1\""},
      {{"a.csv", "--set-up", "1"}, "--set-up goes with --settings"},
      {{"a.csv", "--frames", "2"}, "--frames goes with --simulate"},
      {{"a.csv", "--simulate", "2"}, "--simulate stands in place of a recording"},
      {{"--simulate", "-2"}, "--simulate needs a number, not \"-2\""},
      {{"--simulate", "2", "--sweeps", "5-"},
       "a simulated drive has no end: --sweeps needs one, or --frames"},
  };
  for (const auto& testCase : kCases) {
    RenderOptions options;
    std::string problem;
    EXPECT_FALSE(parseOptions(testCase.arguments, options, problem)) << testCase.problem;
    EXPECT_EQ(problem, testCase.problem);
  }
}

TEST(RenderOptions, ArePanelsOwnWhereTheyMeanNothingToTheOther) {
  RenderOptions spectrum;
  spectrum.centerHz = 1;
  EXPECT_EQ(problemWith(spectrum, PanelKind::Spectrum), "");
  EXPECT_EQ(problemWith(spectrum, PanelKind::Pilots), "--center is for a spectrum");
  RenderOptions pilots;
  pilots.sets = ShownSets{};
  EXPECT_EQ(problemWith(pilots, PanelKind::Pilots), "");
  EXPECT_EQ(problemWith(pilots, PanelKind::Spectrum), "--sets is for pilots");
  RenderOptions marked;
  marked.markers = {{"511", "98.1M"}};
  EXPECT_EQ(problemWith(marked, PanelKind::Spectrum), "");
  EXPECT_EQ(problemWith(marked, PanelKind::Pilots), "--delta needs a PN offset from 0 to 511, not \"98.1M\"");
  marked.markers = {{"512", std::nullopt}};
  EXPECT_EQ(problemWith(marked, PanelKind::Pilots), "--marker needs a PN offset from 0 to 511, not \"512\"");
}

}  // namespace
}  // namespace frontpanels

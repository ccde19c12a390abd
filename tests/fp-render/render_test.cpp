#include "fp-render/render.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <numeric>
#include <set>
#include <sstream>
#include <vector>

#include "hosting/settings_file.h"
#include "sources/capture_writer.h"
#include "sources/frame_source.h"
#include "tests/support/memory_text_files.h"

namespace frontpanels {
namespace {

namespace fs = std::filesystem;

constexpr const char* kTwoSweeps =
    "2020-01-01,00:00:10,100000000,103000000,1000000.00,1,-60,-20,-50,-50\n"
    "2020-01-01,00:00:11,100000000,103000000,1000000.00,1,-61,-21,-51,-51\n";
constexpr const char* kAllMissing = "2020-01-01,00:00:10,100000000,102000000,1000000.00,1,nan,nan\n";

class RenderTest : public ::testing::Test {
 protected:
  RenderTest() {
    fs::remove_all(folder);
    fs::create_directories(folder);
  }
  ~RenderTest() override { fs::remove_all(folder); }

  int run(std::vector<const char*> arguments) {
    output.str("");
    errors.str("");
    return render(arguments, files, output, errors);
  }
  int draw(const std::string& content, std::vector<const char*> more = {}) {
    files.contents["van/a.csv"] = content;
    std::vector<const char*> arguments = {"van/a.csv", "-o", out.c_str()};
    arguments.insert(arguments.end(), more.begin(), more.end());
    return run(arguments);
  }
  // The names of the pictures, a blank behind each.
  std::string pictures() const {
    std::set<std::string> names;
    for (const auto& entry : fs::directory_iterator(out))
      names.insert(entry.path().filename().string() + " ");
    return std::accumulate(names.begin(), names.end(), std::string());
  }
  std::string bytes(const char* name) const {
    std::ifstream file(fs::path(out) / name, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
  }

  fs::path folder =
      fs::temp_directory_path() /
      ("fp-render-" + std::string(::testing::UnitTest::GetInstance()->current_test_info()->name()));
  std::string out = (folder / "out").string();
  testing::MemoryTextFiles files;
  std::ostringstream output;
  std::ostringstream errors;
};

TEST_F(RenderTest, DrawsAPictureASweepIntoAFolderThatItMakes) {
  EXPECT_EQ(draw(kTwoSweeps), 0);
  EXPECT_EQ(pictures(), "a-sweep-0001.png a-sweep-0002.png ");
  EXPECT_TRUE(bytes("a-sweep-0001.png").starts_with("\x89PNG\r\n\x1a\n"));
  const std::string second = bytes("a-sweep-0002.png");
  EXPECT_NE(bytes("a-sweep-0001.png"), second);
  EXPECT_EQ(output.str(), out + "/a-sweep-0001.png  2020-01-01 00:00:10  100 to 103 MHz, 3 bins\n" + out +
                              "/a-sweep-0002.png  2020-01-01 00:00:11  100 to 103 MHz, 3 bins\n"
                              "2 pictures of a recording of rtl_power\n");
  EXPECT_EQ(errors.str(), "");

  fs::remove_all(out);  // a chosen sweep is drawn as it is among all
  EXPECT_EQ(draw(kTwoSweeps, {"--sweep", "2"}), 0);
  EXPECT_EQ(pictures(), "a-sweep-0002.png ");
  EXPECT_EQ(bytes("a-sweep-0002.png"), second);
}

TEST_F(RenderTest, DrawsTheSweepsOfARangeAndOfThoseEveryNth) {
  std::string seven;
  for (const char second : {'1', '2', '3', '4', '5', '6', '7'})
    seven += std::string("2020-01-01,00:00:0") + second + ",100000000,102000000,1000000.00,1,-60,-20\n";
  const struct {
    std::vector<const char*> options;
    const char* numbers;
  } kCases[] = {{{"--sweeps", "3-5"}, "345"}, {{"--sweeps", "6-"}, "67"},
                {{"--sweeps", "-2"}, "12"},   {{"--sweeps", "7-99"}, "7"},
                {{"--every", "3"}, "147"},    {{"--sweeps", "2-6", "--every", "2"}, "246"},
                {{"--sweep", "4"}, "4"}};
  for (const auto& testCase : kCases) {
    EXPECT_EQ(draw(seven, testCase.options), 0);
    std::string expected;
    for (const char number : std::string(testCase.numbers))
      expected += std::string("a-sweep-000") + number + ".png ";
    EXPECT_EQ(pictures(), expected);
    fs::remove_all(out);
  }
}

TEST_F(RenderTest, LeavesPicturesThatAreThereUnlessItMayOverwriteThem) {
  EXPECT_EQ(draw(kTwoSweeps, {"--sweep", "2"}), 0);
  const std::string first = bytes("a-sweep-0002.png");
  EXPECT_EQ(draw(kTwoSweeps, {"--top", "0"}), 3);
  EXPECT_EQ(errors.str(),
            "fp-render: " + out + "/a-sweep-0002.png: is there already; --overwrite replaces it\n");
  EXPECT_EQ(bytes("a-sweep-0002.png"), first);
  EXPECT_EQ(draw(kTwoSweeps, {"--top", "0", "--overwrite"}), 0);
  EXPECT_NE(bytes("a-sweep-0002.png"), first);
  EXPECT_EQ(draw(kTwoSweeps, {"--name", "other", "--sweep", "1"}), 0);
  EXPECT_EQ(pictures(), "a-sweep-0001.png a-sweep-0002.png other-sweep-0001.png ");
}

TEST_F(RenderTest, SetsThePanelUpAsASettingsFileAndTheCommandLineSayTheLatterLast) {
  SettingsFile settings;
  settings.section("spectrum").settings({{716, 0, 20.0}, {717, 0, 10.0}});
  settings.section("spectrum set-up 3").settings({{716, 0, 7.0}, {9999, 0, 1.0}});
  const std::string path = (folder / "settings").string();
  saveSettings(path, settings);
  EXPECT_EQ(draw(kTwoSweeps, {"--sweep", "1", "--settings", path.c_str()}), 0);
  const std::string set = bytes("a-sweep-0001.png");
  const auto again = [&](std::vector<const char*> options, int exitCode) {
    options.insert(options.end(), {"--sweep", "1", "--overwrite"});
    EXPECT_EQ(draw(kTwoSweeps, options), exitCode) << errors.str();
    return bytes("a-sweep-0001.png");
  };
  EXPECT_EQ(again({"--set", "716=20", "--set", "717=10"}, 0), set);
  EXPECT_EQ(again({"--top", "10", "--per-division", "20"}, 0), set);
  EXPECT_NE(again({"--settings", path.c_str(), "--set", "716=10"}, 0), set);
  again({"--settings", path.c_str(), "--set-up", "3"}, 3);
  EXPECT_EQ(errors.str(),
            "fp-render: the panel reports: SpectrumView::vfpSet() ... unhandled parameterType = 9999 \n" +
                path + ": the panel cannot use 1 for code 9999\n");
  again({"--settings", path.c_str(), "--set-up", "4"}, 1);
  EXPECT_EQ(errors.str(), "fp-render: " + path + ": has no section [spectrum set-up 4]\n");
  std::ofstream(path) << "what is this";
  again({"--settings", path.c_str()}, 1);
  EXPECT_TRUE(errors.str().starts_with("fp-render: " + path + ": "));
  EXPECT_EQ(std::distance(fs::directory_iterator(folder), {}), 2) << "the file stays where it is";
}

TEST_F(RenderTest, KeepsTheGoodRowsNamesTheBadOnesAndDrawsNothingForASweepWithoutLevels) {
  EXPECT_EQ(draw(std::string(kAllMissing) + "what is this\n" + kTwoSweeps + kAllMissing), 3);
  EXPECT_EQ(pictures(), "a-sweep-0002.png a-sweep-0003.png ");
  EXPECT_EQ(errors.str(),
            "van/a.csv: 1 row could not be read, 1 row out of order\n"
            "  line 2: does not begin with a date and a time: \"what is this\"\n"
            "  line 5: its sweep is older than the one before\n"
            "van/a.csv: sweep 1: every level is missing, no picture\n"
            "van/a.csv: sweep 4: every level is missing, no picture\n");
}

TEST_F(RenderTest, AnswersOneAndSaysWhyWhenNothingCanBeDrawn) {
  EXPECT_EQ(run({"absent.csv"}), 1);
  EXPECT_EQ(errors.str(), "fp-render: absent.csv: File not found\n");
  EXPECT_EQ(draw(""), 1);
  EXPECT_EQ(errors.str(), "fp-render: van/a.csv: the file is empty\n");
  EXPECT_EQ(draw(kAllMissing), 1);
  EXPECT_EQ(errors.str(), "van/a.csv: every level is missing, there is nothing to draw\n");
  const struct {
    std::vector<const char*> options;
    const char* problem;
  } kCases[] = {
      {{"--sweep", "3"}, "van/a.csv: has 2 sweeps, no sweep 3\n"},
      {{"--panel", "pilots"}, "van/a.csv: holds no pilots\n"},
      {{"--center", "200M", "--span", "1M"},
       "van/a.csv: every level from 199.5 MHz to 200.5 MHz is missing, there is nothing to draw\n"},
  };
  for (const auto& testCase : kCases) {
    EXPECT_EQ(draw(kTwoSweeps, testCase.options), 1);
    EXPECT_EQ(errors.str(), testCase.problem);
  }
  EXPECT_FALSE(fs::exists(out));
}

TEST_F(RenderTest, LeavesNoHalfPictureWhereItCannotWrite) {
  fs::create_directories(out + "/a-sweep-0001.png/in the way");
  EXPECT_EQ(draw(kTwoSweeps, {"--overwrite"}), 1);
  EXPECT_EQ(pictures(), "a-sweep-0001.png ");
  EXPECT_EQ(errors.str(), "fp-render: " + out + "/a-sweep-0001.png: cannot be written: Is a directory\n");
  fs::remove_all(out);
  std::ofstream(out) << "a file, not a folder";
  EXPECT_EQ(draw(kTwoSweeps), 1);
  EXPECT_EQ(errors.str(), "fp-render: " + out + ": cannot be created: Not a directory\n");
}

// Frame 1 with a sweep alone, 2 and 3 with pilots as well, 4 with pilots that were not heard.
TEST_F(RenderTest, DrawsBothPanelsOfACaptureEachItsOwnFrames) {
  const std::string path = (folder / "drive").string();
  CaptureWriter capture(path);
  for (const int number : {1, 2, 3, 4}) {
    Frame frame;
    frame.time = "12:00:0" + std::to_string(number);
    if (number < 4) frame.sweep = Sweep{0, frame.time, 100e6, 1e6, {-60, -20, -50}};
    if (number > 1) frame.pilots.emplace();
    if (number == 2) frame.pilots->topN = PilotBars{-70, {{12, -5}, {168, -9}}};
    if (number == 3) frame.pilots->allPilots = PilotLevels{-70, std::vector<float>(512, -20.0F)};
    capture.append(frame);
  }
  const auto drawn = [&](std::vector<const char*> options) {
    options.insert(options.begin(), {path.c_str(), "-o", out.c_str()});
    return render(options, systemTextFiles(), output, errors);
  };
  EXPECT_EQ(drawn({}), 0);
  EXPECT_EQ(pictures(), "drive-sweep-0001.png drive-sweep-0002.png drive-sweep-0003.png ");
  output.str("");
  EXPECT_EQ(drawn({"--panel", "pilots"}), 3);
  EXPECT_EQ(output.str(), out + "/drive-pilots-0002.png  12:00:02  top 2\n" + out +
                              "/drive-pilots-0003.png  12:00:03  all 512\n2 pictures of a recording of " +
                              openRecording(systemTextFiles(), path)->formatName() + "\n");
  EXPECT_EQ(errors.str(), path + ": frame 4: every level is missing, no picture\n");
  errors.str("");
  EXPECT_EQ(drawn({"--panel", "pilots", "--sweep", "1"}), 1);
  EXPECT_EQ(errors.str(), path + ": none of these frames has anything for this panel\n");
  fs::resize_file(path, fs::file_size(path) - 1);
  fs::remove_all(out);
  EXPECT_EQ(drawn({"--panel", "pilots", "--sets", "all,list", "--sweeps", "-3"}), 3) << "frame 4 is cut off";
  EXPECT_EQ(pictures(), "drive-pilots-0003.png ");
}

TEST_F(RenderTest, DrawsASimulatedDriveTheSameForTheSameSeed) {
  const auto drive = [&](std::vector<const char*> options) {
    options.insert(options.end(), {"-o", out.c_str(), "--overwrite"});
    EXPECT_EQ(run(options), 0) << errors.str();
  };
  drive({"--simulate", "7"});
  EXPECT_EQ(pictures(), "simulation-7-sweep-0001.png ");
  EXPECT_TRUE(output.str().ends_with("1 picture of Simulated drive, seed 7\n"));
  drive({"--simulate", "7", "--sweep", "2", "--center", "1950M", "--span", "20M"});
  EXPECT_NE(output.str().find("  1940 to 1960"), std::string::npos) << "the receiver is tuned";
  const std::string second = bytes("simulation-7-sweep-0002.png");
  drive({"--simulate", "7", "--sweeps", "1-2", "--center", "1950M", "--span", "20M"});
  EXPECT_EQ(bytes("simulation-7-sweep-0002.png"), second);
  drive({"--simulate", "7", "--panel", "pilots", "--frames", "3", "--every", "2"});
  EXPECT_EQ(pictures(),
            "simulation-7-pilots-0001.png simulation-7-pilots-0003.png simulation-7-sweep-0001.png "
            "simulation-7-sweep-0002.png ");
  drive({"--simulate", "7", "--panel", "pilots", "--sweep", "3", "--set", "230,0=12"});
  EXPECT_NE(output.str().find("list 1"), std::string::npos);
}

TEST_F(RenderTest, SaysWhatMarkersReadAndWhichOnesAreLeftOut) {
  EXPECT_EQ(draw(kTwoSweeps, {"--sweep", "2", "--marker", "101M", "--marker", "99M"}), 3);
  EXPECT_EQ(output.str(), out + "/a-sweep-0002.png  2020-01-01 00:00:11  100 to 103 MHz, 3 bins\n" +
                              "  Marker 1: 101 MHz, -21 dBm\n1 picture of a recording of rtl_power\n");
  EXPECT_EQ(errors.str(),
            "van/a.csv: sweep 2: the marker at 99 MHz lies outside of the graph and is left out\n");
}

TEST_F(RenderTest, ReportsResultsThatNobodyReceives) {
  output.setstate(std::ios::badbit);
  files.contents["a.csv"] = kTwoSweeps;
  EXPECT_EQ(render(std::vector<const char*>{"a.csv", "-o", out.c_str()}, files, output, errors), 3);
  EXPECT_EQ(errors.str(), "fp-render: standard output: cannot be written\n");
}

TEST_F(RenderTest, AnswersTwoForWhatThePanelCannotUse) {
  EXPECT_EQ(draw(kTwoSweeps, {"--set", "740=x"}), 2);
  EXPECT_EQ(errors.str(),
            "fp-render: the panel reports: clsBaseVFP::vfpSet() ...  Type mismatch\n"
            "fp-render: the panel cannot use \"x\" for code 740\n"
            "\"fp-render --help\" explains the command line\n");
  EXPECT_EQ(draw(kTwoSweeps, {"--sets", "all"}), 2);
  EXPECT_EQ(errors.str(),
            "fp-render: --sets is for pilots\n\"fp-render --help\" explains the command line\n");
  EXPECT_FALSE(fs::exists(out));
}

TEST_F(RenderTest, ExplainsItself) {
  EXPECT_EQ(run({"--version"}), 0);
  EXPECT_EQ(output.str(), "fp-render " FRONTPANELS_VERSION "\n");
  EXPECT_EQ(run({"--help"}), 0);
  EXPECT_TRUE(output.str().starts_with("usage: fp-render RECORDING [OPTION]...\n"));
  EXPECT_EQ(run({"--sweep", "none", "a.csv"}), 2);
  EXPECT_EQ(errors.str(),
            "fp-render: --sweep needs a number from 1 on, not \"none\"\n"
            "\"fp-render --help\" explains the command line\n");
}

}  // namespace
}  // namespace frontpanels

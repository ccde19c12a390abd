// What every recording does that `openRecording` opens.
#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <filesystem>

#include "sources/capture_format.h"
#include "sources/crc32c.h"
#include "sources/watched_files.h"
#include "tests/sources/capture_fixture.h"

namespace frontpanels {
namespace {

using testing::FrameText;
using testing::textOfAll;

class RecordingTest : public testing::CaptureFixture {
 protected:
  static constexpr const char* kSweeps =
      "heading\n"
      "2020-01-01,00:00:10,100,120,10.00,1,-1,-2\n"
      "2020-01-01,00:00:10,120,140,10.00,1,-3,-4\n"
      "\n"
      "2020-01-01,00:00:20,100,120,10.00,1,-5,-6\n"
      "what\n"
      "2020-01-01,00:00:30,100,120,10.00,1,-7,-8\n"
      "2020-01-01,00:00:29,100,120,10.00,1,-9,-10\n"
      "2020-01-01,00:00:50,100,120,10.00,1,-11.5,-1";
  static constexpr const char* kSweepsReport =
      "a: 2 rows could not be read, 1 row out of order, cut short\n"
      "  line 1: does not begin with a date and a time: \"heading\"\n"
      "  line 6: does not begin with a date and a time: \"what\"\n"
      "  line 8: its sweep is older than the one before\n"
      "  line 9: the file ends within this row; its last value is left out";

  // Every frame alone, from the last to the first, beside all of them in a row.
  static void expectEachFrameIsFound(TextFiles& files, const std::string& path, std::size_t maxBookmarks) {
    const auto source = openRecording(files, path, {}, maxBookmarks);
    const std::string report = source->problemReport();
    const std::string all = textOfAll(*source);
    std::string found;
    Frame frame;
    for (std::uint64_t number = source->frameCount().value(); number > 0; --number) {
      source->seek(number);
      ASSERT_TRUE(source->next(frame)) << path << number;
      found.insert(0, FrameText::of(frame) + "\n");
    }
    EXPECT_EQ(found, all) << path << " with " << maxBookmarks << " bookmarks";
    EXPECT_EQ(source->problemReport(), report) << path;
    source->seek(source->frameCount().value() + 1);
    EXPECT_FALSE(source->next(frame));
  }
};

TEST_F(RecordingTest, FindsEachFrameWithHoweverFewBookmarks) {
  std::string capture = threeFrames();
  for (int i = 0; i < 5; ++i) capture += capture.substr(16);  // 96 frames
  capture[100] ^= 1;
  files.contents["sweeps"] = kSweeps;
  files.contents["capture"] = capture;
  for (const std::size_t maxBookmarks : {2U, 3U, 7U, 4096U}) {
    expectEachFrameIsFound(files, "sweeps", maxBookmarks);
    expectEachFrameIsFound(files, "capture", maxBookmarks);
    expectEachFrameIsFound(systemTextFiles(), FRONTPANELS_SOURCE_DIR "/recordings/fm_band.csv", maxBookmarks);
  }
  EXPECT_EQ(openRecording(files, "capture", {}, 2)->frameCount(), 95U);
}

TEST_F(RecordingTest, OfARealReceiverFindsEachFrame) {
  const std::string folder = FRONTPANELS_TEST_DATA "/";
  if (!std::filesystem::exists(folder)) GTEST_SKIP() << "no " << folder;
  for (const char* const name : {"04_rtl_power_1bin_hops_7sweeps.csv", "05_rtl_power_no_spaces_no_eol.csv",
                                 "06_hackrf_sweep_0_6GHz_1MHz.txt"})
    expectEachFrameIsFound(systemTextFiles(), folder + name, 2);
}

TEST_F(RecordingTest, CountsWhatIsWrongOnceHoweverOftenItIsRead) {
  const auto source = open(kSweeps);
  EXPECT_EQ(source->problemReport(), kSweepsReport);
  for (int i = 0; i < 3; ++i) {
    source->seek(1);
    textOfAll(*source);
  }
  EXPECT_EQ(source->problemReport(), kSweepsReport);
  EXPECT_EQ(source->frameCount(), 5U);
  EXPECT_TRUE(source->hasSweeps());
  EXPECT_FALSE(source->hasPilots());
}

TEST_F(RecordingTest, TellsHowFarItIsWithinOneHugeFrameTooAndCanBeEnded) {
  const std::size_t bins = 1'000'000;
  std::string row = "2020-01-01,00:00:10,0,10000000,10.00,1";
  for (std::size_t i = 0; i < bins; ++i) row += ",-1";
  files.contents["sweeps"] = row + "\n";
  CaptureWriter(path()).append(testing::sweepFrame("", std::vector<float>(bins)));
  files.contents["capture"] = bytes();
  for (const std::string name : {"sweeps", "capture"}) {
    std::vector<int> heard;
    const auto hear = [&](int percent) { return heard.push_back(percent), true; };
    EXPECT_NE(openRecording(files, name, hear), nullptr);
    EXPECT_GE(heard.size(), files.contents[name].size() / 65536);
    EXPECT_TRUE(std::is_sorted(heard.begin(), heard.end()));
    EXPECT_EQ(heard.back(), 100);
    heard.clear();
    const auto endAtHalf = [&](int percent) { return heard.push_back(percent), percent < 50; };
    EXPECT_EQ(openRecording(files, name, endAtHalf), nullptr);
    EXPECT_LE(heard.back(), 53);  // a piece of 64 KiB is 3 % of 3 MB at most
  }
}

TEST_F(RecordingTest, TellsNoLessWhenAPartIsReadAgain) {
  files.contents["a"] = std::string(100, 'x');
  std::vector<int> heard;
  WatchedFiles watched(files, [&](int percent) { return heard.push_back(percent), true; });
  const auto reader = watched.openBytes("a");
  std::array<char, 60> bytes{};
  EXPECT_EQ(reader->read(bytes), 60U);
  reader->goTo(0);
  EXPECT_EQ(reader->read({bytes.data(), 10}), 10U);
  EXPECT_EQ(heard, (std::vector<int>{60, 60}));
}

TEST_F(RecordingTest, ThatHasChangedPlaysWhatItHoldsAndSaysSo) {
  const std::string capture = threeFrames();
  const auto source = open(capture);
  Frame frame;
  const struct {
    const char* what;
    std::string content;
    std::string played;
  } kCases[] = {{"as it was", capture, kFirst + second() + third()},
                {"longer", capture + capture.substr(16), kFirst + second() + third()},
                {"cut", capture.substr(0, capture.size() - 1), kFirst + second()},
                {"moved by half a marker", capture.substr(0, 16) + "x\xb7" + capture.substr(16),
                 kFirst + second() + third()},
                {"another kind", kSweeps, ""}};
  for (const auto& testCase : kCases) {
    const auto changing = open(capture);
    files.contents["a"] = testCase.content;
    changing->seek(1);
    EXPECT_EQ(textOfAll(*changing), testCase.played) << testCase.what;
    const bool isSame = testCase.content.starts_with(capture);
    EXPECT_EQ(changing->problemReport(), isSame ? "" : "a: the file has changed since it was opened")
        << testCase.what;
  }
  files.contents.clear();
  EXPECT_EQ(testing::raised([&] { return source->seek(2), 0; }), "a: File not found");
  EXPECT_FALSE(source->next(frame));
}

TEST_F(RecordingTest, OfTwoFormatsPlaysBothAndSaysSo) {
  const std::string hackrf = "2020-01-01, 00:00:20.5, 10000000, 15000000, 2500000.00, 8, -5, -6\n";
  const auto sweeps = open("2020-01-01,00:00:10,100,120,10.00,1,-1,-2\n" + hackrf);
  EXPECT_EQ(sweeps->frameCount(), 2U);
  EXPECT_EQ(sweeps->problemReport(), "a: of two formats\n  line 2: from here on also hackrf_sweep");
  const auto capture = open(threeFrames() + hackrf);
  EXPECT_EQ(capture->frameCount(), 3U);
  const std::string place = std::to_string(threeFrames().size());
  EXPECT_EQ(capture->problemReport(), "a: damaged in 1 place\n  byte " + place + ": " +
                                          std::to_string(hackrf.size()) + " bytes are no block");
  EXPECT_EQ(open(hackrf + threeFrames())->frameCount(), 1U);
}

TEST_F(RecordingTest, ThatCannotBeReadFurtherKeepsWhatWasBefore) {
  files.failAtByte = 100'000;
  CaptureWriter writer(path());
  for (int i = 0; i < 3; ++i) writer.append(testing::sweepFrame("x", std::vector<float>(10'000)));
  const auto source = open(bytes());
  EXPECT_EQ(source->frameCount(), 1U);  // 40 kB each, read in pieces of 64 KiB
  EXPECT_EQ(source->problemReport(),
            "a: cut short after frame 1\n"
            "  byte 40073: the file cannot be read further: Device I/O error");
}

// Little-endian numbers, then their check.
std::string checked(std::string bytes, std::initializer_list<std::uint32_t> numbers) {
  const auto append = [&bytes](std::uint32_t number) {
    for (int shift = 0; shift < 32; shift += 8) bytes += static_cast<char>(number >> shift);
  };
  for (const std::uint32_t number : numbers) append(number);
  append(crc32c(bytes));
  return bytes;
}

TEST_F(RecordingTest, OfALaterVersionIsRefusedAndABlockThatIsTooLongIsNone) {
  const std::string magic =
      "\x93"
      "FPCAP\r\n";
  EXPECT_EQ(testing::raised([&] { return open(checked(magic, {2}) + "what is to come"); }),
            "a: a capture of version 2; this program reads version 1");
  const std::string tooLong = checked(
      "\xb7"
      "BLK",
      {1, (32U << 20) + 1, 0});
  EXPECT_EQ(open(checked(magic, {1}) + tooLong)->problemReport(),
            "a: damaged in 1 place\n  byte 16: 20 bytes are no block");
  const std::string unknown = checked(
      "\xb7"
      "BLK",
      {7, 0, crc32c(std::string("\7\0\0\0", 4))});
  EXPECT_EQ(open(checked(magic, {1}) + unknown)->problemReport(),
            "a: damaged in 1 place\n  byte 16: a block of an unknown kind");
}

}  // namespace
}  // namespace frontpanels

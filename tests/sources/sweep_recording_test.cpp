#include "sources/sweep_recording.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

#include "tests/support/memory_text_files.h"
#include "tests/support/raised.h"

namespace frontpanels {
namespace {

using testing::MemoryTextFiles;

// One row of rtl_power with a bin of 10 Hz for each value.
std::string row(int second, int lowHz, const std::string& values, const char* end = "\n") {
  const std::string low = std::to_string(lowHz);
  const auto bins = std::count(values.begin(), values.end(), ',') + 1;
  const std::string high = std::to_string(lowHz + 10 * bins);
  const std::string time = "2020-01-01,00:00:" + std::to_string(10 + second);
  return time + "," + low + "," + high + ",10.00,1," + values + end;
}

std::string text(const Sweep& sweep) {
  std::string result = std::to_string(std::lround(sweep.startHz)) + ":";
  for (const float level : sweep.levelsDb) {
    result += std::isnan(level) ? " gap" : " " + std::to_string(std::lround(level));
  }
  return result;
}

class SweepRecordingTest : public ::testing::Test {
 protected:
  std::unique_ptr<SweepRecording> open(std::string content) {
    files.contents["a.csv"] = std::move(content);
    return SweepRecording::open(files, "a.csv");
  }
  // All sweeps, "|" between them: start, then a level or a gap for each bin.
  std::string sweeps(std::string content) {
    recording = open(std::move(content));
    std::string all;
    for (Sweep sweep; recording->next(sweep);) all += (all.empty() ? "" : " | ") + text(sweep);
    return all;
  }
  std::string refusal(std::string content) {
    return testing::raised([&] { return open(std::move(content)); });
  }

  MemoryTextFiles files;
  std::unique_ptr<SweepRecording> recording;
};

TEST_F(SweepRecordingTest, PutsTheRowsOfASweepTogether) {
  const struct {
    const char* what;
    std::string content;
    const char* sweeps;
  } kCases[] = {
      {"two sweeps", row(0, 100, "1,2") + row(0, 120, "3,4") + row(5, 100, "5,6") + row(5, 120, "7,8"),
       "100: 1 2 3 4 | 100: 5 6 7 8"},
      {"a time that changes within the sweep",
       row(0, 100, "1") + row(1, 110, "2") + row(2, 100, "3") + row(2, 110, "4"), "100: 1 2 | 100: 3 4"},
      {"a time that does not change", row(0, 100, "1") + row(0, 110, "2") + row(0, 100, "3"),
       "100: 1 2 | 100: 3"},
      {"one row a sweep", row(0, 100, "1,2") + row(0, 100, "3,4"), "100: 1 2 | 100: 3 4"},
      {"a missing hop", row(0, 100, "1") + row(0, 130, "4") + row(1, 100, "5"), "100: 1 gap gap 4 | 100: 5"},
      {"a missing first hop", row(0, 100, "1") + row(0, 110, "2") + row(1, 110, "3") + row(1, 120, "4"),
       "100: 1 2 | 110: 3 4"},
      {"a beginning in the middle of a sweep", row(0, 120, "3") + row(1, 100, "1") + row(1, 110, "2"),
       "120: 3 | 100: 1 2"},
      {"rows in any order", row(0, 120, "3") + row(0, 100, "1") + row(0, 110, "2"), "100: 1 2 3"},
      {"another step", row(0, 100, "1") + "2020-01-01,00:00:10,110,130,20.00,1,2\n", "100: 1 | 110: 2"},
      {"overlapping rows", row(0, 100, "1,9,nan") + row(0, 110, "3,4"), "100: 1 9 4"},
      {"a row off the grid by less than half a bin", row(0, 100, "1") + row(0, 114, "2"), "100: 1 2"},
      {"a row off the grid by more", row(0, 100, "1") + row(0, 116, "2"), "100: 1 gap 2"},
      {"a sweep broken off, continued by one with other hops",
       row(0, 100, "1") + row(0, 120, "2") + row(1, 110, "3") + row(1, 130, "4"),
       "100: 1 gap 2 | 110: 3 gap 4"},
      {"a row twice", row(0, 100, "1") + row(0, 110, "2") + row(0, 110, "3") + row(0, 120, "4"),
       "100: 1 2 4"},
      {"CRLF and blank lines", row(0, 100, "1", "\r\n") + " \r\n\n" + row(0, 110, "2", "\r\n"), "100: 1 2"},
      {"no last end of line", row(0, 100, "1.5,2.5", ""), "100: 2 3"},
      {"a byte order mark", "\xef\xbb\xbf" + row(0, 100, "1"), "100: 1"},
      {"a heading", "date,time,low\n" + row(0, 100, "1"), "100: 1"},
      {"every value missing", row(0, 100, "nan,-nan") + row(0, 120, "-inf"), "100: gap gap gap"},
  };
  for (const auto& testCase : kCases) EXPECT_EQ(sweeps(testCase.content), testCase.sweeps) << testCase.what;
}

TEST_F(SweepRecordingTest, PutsTheInterleavedRowsOfHackrfSweepInOrder) {
  const auto hackrf = [](int second, int lowMHz, const char* values) {
    return "2020-01-01, 00:00:1" + std::to_string(second) + ", " + std::to_string(lowMHz) + "000000, " +
           std::to_string(lowMHz + 5) + "000000, 2500000.00, 8, " + values + "\n";
  };
  EXPECT_EQ(sweeps(hackrf(0, 10, "1, 2") + hackrf(0, 20, "5, 6") + hackrf(1, 15, "3, 4") +
                   hackrf(1, 25, "7, 8") + hackrf(1, 10, "9, 9")),
            "10000000: 1 2 3 4 5 6 7 8 | 10000000: 9 9");
  EXPECT_EQ(recording->format(), SweepFormat::HackrfSweep);
  EXPECT_EQ(recording->problemReport(), "");
  EXPECT_EQ(open(row(0, 100, "1"))->format(), SweepFormat::RtlPower);
}

TEST_F(SweepRecordingTest, TellsASweepsNumberTimeAndRowsAndBeginsAnewAfterRewind) {
  recording = open("heading\n" + row(0, 100, "1,2") + row(1, 120, "3") + row(2, 100, "4"));
  Sweep sweep;
  const auto next = [&] {
    if (!recording->next(sweep)) return std::string("none");
    return std::to_string(sweep.number) + " " + sweep.time + " " + std::to_string(sweep.rows);
  };
  EXPECT_EQ(next(), "1 2020-01-01 00:00:10 2");
  EXPECT_EQ(sweep.stepHz, 10);
  EXPECT_EQ(next(), "2 2020-01-01 00:00:12 1");
  EXPECT_EQ(next(), "none");
  EXPECT_EQ(recording->positionBytes(), recording->sizeBytes());
  recording->rewind();
  EXPECT_EQ(next(), "1 2020-01-01 00:00:10 2");
  EXPECT_EQ(text(sweep), "100: 1 2 3");
  EXPECT_EQ(recording->unreadableRows(), 1U);
}

TEST_F(SweepRecordingTest, CountsWhatItCannotReadAndNamesTheFirstLines) {
  EXPECT_EQ(sweeps(row(0, 100, "1") + "x\n" + row(0, 110, "?") + "x\nx\nx\n" + row(0, 120, "3") + "x\n"),
            "100: 1 gap 3");
  EXPECT_EQ(recording->unreadableRows(), 6U);
  EXPECT_EQ(recording->problemReport(),
            "a.csv: 6 rows could not be read\n"
            "  line 2: does not begin with a date and a time: \"x\"\n"
            "  line 3: its value 1 is \"?\"\n"
            "  line 4: does not begin with a date and a time: \"x\"\n"
            "  line 5: does not begin with a date and a time: \"x\"\n"
            "  line 6: does not begin with a date and a time: \"x\"\n"
            "  ...");
}

TEST_F(SweepRecordingTest, NamesWhatIsOutOfOrder) {
  EXPECT_EQ(sweeps(row(5, 110, "2") + row(5, 100, "1") + row(3, 100, "3") + row(3, 110, "4")),
            "100: 1 2 | 100: 3 4");
  EXPECT_EQ(recording->problemReport(),
            "a.csv: 2 rows out of order\n"
            "  line 2: out of order: its frequency is below that of the row before\n"
            "  line 3: its sweep is older than the one before");
}

TEST_F(SweepRecordingTest, RefusesWhatIsNoRecordingAndSaysWhy) {
  EXPECT_EQ(refusal(""), "a.csv: the file is empty");
  EXPECT_EQ(refusal("\n\n"), "a.csv: the file is empty");
  EXPECT_EQ(refusal(std::string("\x89PNG\r\n\x1a\n\0\0", 10)),
            "a.csv: not a recording of rtl_power or hackrf_sweep\n"
            "  line 1: does not begin with a date and a time: \"?PNG\"\n"
            "  line 2: holds bytes that are not text\n"
            "  line 3: holds bytes that are not text");
  EXPECT_EQ(refusal(std::string("\xff\xfe"
                                "2\0000\0",
                                6)),
            "a.csv: UTF-16 text; save it as UTF-8 or plain text");
  EXPECT_EQ(testing::raised([&] { return SweepRecording::open(files, "absent.csv"); }),
            "absent.csv: File not found");
}

TEST_F(SweepRecordingTest, ReadsNoFalseLevelFromAFileCutAnywhere) {
  const std::string whole =
      "2020-01-01,00:00:10,100,120,10.00,1,-65.79,-60.25,-60.25\n"
      "2020-01-01,00:00:10,120,140,10.00,1,-9.75,-58.25,-58.25\n";
  const std::string levels = "100: -66 -60 -10 -58 ";
  for (std::size_t size = 0; size <= whole.size(); ++size) {
    const std::string read =
        (refusal(whole.substr(0, size)) == "opened" ? sweeps(whole.substr(0, size)) : "100:") + " gap";
    const std::string known = read.substr(0, read.find(" gap") + 1);
    EXPECT_TRUE(levels.starts_with(known)) << size << ": " << read;
  }
}

TEST_F(SweepRecordingTest, DoubtsTheLastValueOfACutRow) {
  const std::string head = "2020-01-01,00:00:10,100,120,10.00,1,";
  EXPECT_EQ(sweeps(head + "-65.79,-60.25\n" + head + "-65.79,-6"), "100: -66 -60 | 100: -66 gap");
  EXPECT_EQ(recording->problemReport(),
            "a.csv: cut short\n"
            "  line 2: the file ends within this row; its last value is left out");
  EXPECT_EQ(sweeps(head + "-65.79,-60.25\n" + head + "-6"), "100: -66 -60 | 100: gap");
  EXPECT_EQ(sweeps(head + "-65.79,-60.25\n" + head + "-65.79,-6\n"), "100: -66 -60 | 100: -66 -6");
  EXPECT_EQ(sweeps(head + "-65.79,-60.25,-60.25\n" + head + "-65.79,-60.25"), "100: -66 -60 | 100: -66 gap");
}

TEST_F(SweepRecordingTest, KeepsWhatItReadBeforeTheFileFailed) {
  files.failAtLine = 3;
  EXPECT_EQ(sweeps(row(0, 100, "1") + row(0, 110, "2") + row(0, 120, "3")), "100: 1 2");
  EXPECT_EQ(recording->problems(),
            (std::vector<RowProblem>{{3, "the file cannot be read further: Device I/O error"}}));

  files.failAtLine = 0;
  recording->rewind();
  Sweep sweep;
  ASSERT_TRUE(recording->next(sweep));
  EXPECT_EQ(text(sweep), "100: 1 2 3");
}

TEST_F(SweepRecordingTest, BoundsASweepWhateverItsRowsClaim) {
  // 4194304 bins of 10 Hz from 100 Hz on end at 41943140 Hz.
  Sweep widest;
  ASSERT_TRUE(open(row(0, 100, "1") + row(0, 41943130, "3"))->next(widest));
  EXPECT_EQ(widest.levelsDb.size(), 4194304U);
  EXPECT_EQ(sweeps(row(0, 100, "1") + row(0, 110, "2") + row(0, 41943131, "3") + row(0, 120, "4")),
            "100: 1 2 4");
  EXPECT_EQ(recording->problems(),
            (std::vector<RowProblem>{{3, "too far from the other rows for one sweep"}}));
  EXPECT_EQ(sweeps(row(0, 0, "1") + row(0, 2000000000, "2") + row(0, 2000000010, "3")), "2000000000: 2 3");
  EXPECT_EQ(recording->problems(),
            (std::vector<RowProblem>{{1, "too far from the other rows for one sweep"}}));
  EXPECT_EQ(sweeps("2020-01-01,00:00:10,0,9000000000000,0.01,1,5\n" + row(0, 100, "1")), "0: 5 | 100: 1");
}

TEST_F(SweepRecordingTest, PassesOverALineThatIsTooLong) {
  std::string content = row(0, 100, "1") + row(0, 110, "2");
  content.insert(content.size() - 1, SweepRecording::kMaxLineBytes, ' ');
  EXPECT_EQ(sweeps(content + row(0, 120, "3")), "100: 1 gap 3");
  EXPECT_EQ(recording->problems(), (std::vector<RowProblem>{{2, "longer than 33554432 bytes"}}));
}

}  // namespace
}  // namespace frontpanels

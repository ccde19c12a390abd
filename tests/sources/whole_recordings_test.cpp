// Whole recordings: of real receivers, where they are at hand, and the project's own. The numbers were taken
// from the files by other means.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <filesystem>
#include <numeric>

#include "platform/runtime_error.h"
#include "sources/sweep_recording.h"

namespace frontpanels {
namespace {

class WholeRecording : public ::testing::Test {
 protected:
  std::vector<Sweep> read(const std::string& name, const std::string& folder = FRONTPANELS_TEST_DATA) {
    recording = SweepRecording::open(systemTextFiles(), folder + "/" + name);
    std::vector<Sweep> sweeps;
    for (Sweep sweep; recording->next(sweep);) sweeps.push_back(sweep);
    EXPECT_EQ(recording->problemReport(), "");
    return sweeps;
  }

  std::unique_ptr<SweepRecording> recording;
};

class RealRecording : public WholeRecording {
 protected:
  void SetUp() override {
    if (!std::filesystem::exists(FRONTPANELS_TEST_DATA)) GTEST_SKIP() << "no " << FRONTPANELS_TEST_DATA;
  }
};

std::ptrdiff_t peakBin(const Sweep& sweep) {
  return std::max_element(sweep.levelsDb.begin(), sweep.levelsDb.end()) - sweep.levelsDb.begin();
}

// First bin and step in Hz, bins, rows; time, strongest bin and the sum of all levels in hundredths.
std::string shape(const Sweep& sweep) {
  return std::to_string(std::lround(sweep.startHz)) + " + " + std::to_string(std::lround(sweep.stepHz)) +
         ", " + std::to_string(sweep.levelsDb.size()) + " bins, " + std::to_string(sweep.rows) + " rows";
}
std::string content(const Sweep& sweep) {
  const double sum = std::accumulate(sweep.levelsDb.begin(), sweep.levelsDb.end(), 0.0);
  return sweep.time + ", " + std::to_string(peakBin(sweep)) + ", " + std::to_string(std::lround(sum * 100));
}

TEST_F(RealRecording, OfRtlPowerWithOneBinAHopHasSevenSweeps) {
  std::vector<std::string> contents;
  for (const Sweep& sweep : read("04_rtl_power_1bin_hops_7sweeps.csv")) {
    EXPECT_EQ(shape(sweep), "80000000 + 1000000, 920 bins, 920 rows");
    contents.push_back(content(sweep));
  }
  EXPECT_EQ(contents, (std::vector<std::string>{
                          "2026-02-15 12:29:54, 726, -1888953", "2026-02-15 12:30:31, 858, -1885338",
                          "2026-02-15 12:31:08, 706, -1877808", "2026-02-15 12:31:44, 726, -1899210",
                          "2026-02-15 12:32:21, 723, -1897053", "2026-02-15 12:32:58, 724, -1882600",
                          "2026-02-15 12:33:34, 866, -1876062"}));
  EXPECT_EQ(recording->format(), SweepFormat::RtlPower);
}

TEST_F(RealRecording, OfThreeRowsHasOneSweepWithALastBin) {
  const std::vector<Sweep> sweeps = read("05_rtl_power_no_spaces_no_eol.csv");
  ASSERT_EQ(sweeps.size(), 1U);
  EXPECT_EQ(sweeps[0].startHz, 24e6);
  EXPECT_EQ(sweeps[0].levelsDb, (std::vector<float>{-24.14F, -24.15F, 14.07F}));
}

TEST_F(RealRecording, OfHackrfSweepIsOneSweepInOrderOfFrequency) {
  const std::vector<Sweep> sweeps = read("06_hackrf_sweep_0_6GHz_1MHz.txt");
  ASSERT_EQ(sweeps.size(), 1U);
  EXPECT_EQ(shape(sweeps[0]), "0 + 1000000, 6000 bins, 1200 rows");
  EXPECT_EQ(content(sweeps[0]), "2020-06-26 14:57:57, 0, -39258495");
  const std::vector<float>& levels = sweeps[0].levelsDb;
  EXPECT_EQ(levels[0], -8.30F);
  EXPECT_EQ(levels[5], -55.66F);   // the file's third row
  EXPECT_EQ(levels[10], -55.28F);  // the second
  EXPECT_EQ(levels[19], -26.80F);  // the fourth
  EXPECT_EQ(levels[5999], -61.89F);
  EXPECT_EQ(recording->format(), SweepFormat::HackrfSweep);
}

TEST_F(RealRecording, OfAnotherKindIsRefused) {
  EXPECT_THROW(read("14_umts_drive_psc_ecno.txt"), RuntimeError);
}

TEST_F(WholeRecording, ThatTheProjectCarriesShowsTheFmBandTwelveTimes) {
  const std::vector<Sweep> sweeps = read("fm_band.csv", FRONTPANELS_SOURCE_DIR "/recordings");
  ASSERT_EQ(sweeps.size(), 12U);
  for (const Sweep& sweep : sweeps) {
    EXPECT_EQ(sweep.startHz, 88e6);
    EXPECT_EQ(sweep.stepHz, 19531.25);
    EXPECT_EQ(sweep.levelsDb.size(), 1024U);
    // The strongest station is at 94.7 MHz: (94.7 - 88) MHz / 19531.25 Hz = bin 343, give or take the
    // programme.
    EXPECT_NEAR(static_cast<double>(peakBin(sweep)), 343, 5);
  }
}

}  // namespace
}  // namespace frontpanels

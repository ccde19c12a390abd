// Whole recordings: of real receivers, where they are at hand, and the project's own. The numbers were taken
// from the files by other means.
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <numeric>

#include "platform/runtime_error.h"
#include "sources/sweep_recording.h"

namespace frontpanels {
namespace {

class WholeRecording : public ::testing::Test {
 protected:
  std::vector<Sweep> read(const std::string& name, const std::string& folder) {
    recording = SweepRecording::open(systemTextFiles(), folder + "/" + name);
    std::vector<Sweep> sweeps;
    for (Sweep sweep; recording->next(sweep);) sweeps.push_back(sweep);
    return sweeps;
  }

  std::unique_ptr<SweepRecording> recording;
};

class RealRecording : public WholeRecording {
 protected:
  void SetUp() override {
    if (!std::filesystem::exists(FRONTPANELS_TEST_DATA)) GTEST_SKIP() << "no " << FRONTPANELS_TEST_DATA;
  }
  std::vector<Sweep> read(const std::string& name) {
    return WholeRecording::read(name, FRONTPANELS_TEST_DATA);
  }
};

std::ptrdiff_t peakBin(const Sweep& sweep) {
  return std::max_element(sweep.levelsDb.begin(), sweep.levelsDb.end()) - sweep.levelsDb.begin();
}

double sum(const Sweep& sweep) { return std::accumulate(sweep.levelsDb.begin(), sweep.levelsDb.end(), 0.0); }

TEST_F(RealRecording, OfRtlPowerWithOneBinAHopHasSevenSweeps) {
  const std::vector<Sweep> sweeps = read("04_rtl_power_1bin_hops_7sweeps.csv");
  const struct {
    const char* time;
    std::ptrdiff_t peakBin;  // from 80 MHz on, 1 MHz each
    float peakDb;
    double sumDb;
  } kExpected[] = {
      {"2026-02-15 12:29:54", 726, 15.04F, -18889.53}, {"2026-02-15 12:30:31", 858, 17.40F, -18853.38},
      {"2026-02-15 12:31:08", 706, 19.13F, -18778.08}, {"2026-02-15 12:31:44", 726, 15.05F, -18992.10},
      {"2026-02-15 12:32:21", 723, 14.85F, -18970.53}, {"2026-02-15 12:32:58", 724, 14.18F, -18826.00},
      {"2026-02-15 12:33:34", 866, 17.08F, -18760.62},
  };
  ASSERT_EQ(sweeps.size(), std::size(kExpected));
  for (std::size_t i = 0; i < sweeps.size(); ++i) {
    EXPECT_EQ(sweeps[i].time, kExpected[i].time);
    EXPECT_EQ(sweeps[i].startHz, 80e6);
    EXPECT_EQ(sweeps[i].stepHz, 1e6);
    EXPECT_EQ(sweeps[i].rows, 920U);
    EXPECT_EQ(sweeps[i].levelsDb.size(), 920U);
    EXPECT_EQ(peakBin(sweeps[i]), kExpected[i].peakBin);
    EXPECT_EQ(sweeps[i].levelsDb[kExpected[i].peakBin], kExpected[i].peakDb);
    EXPECT_NEAR(sum(sweeps[i]), kExpected[i].sumDb, 0.001);
  }
  EXPECT_EQ(recording->format(), SweepFormat::RtlPower);
  EXPECT_EQ(recording->problemReport(), "");
}

TEST_F(RealRecording, OfThreeRowsHasOneSweepWithALastBin) {
  const std::vector<Sweep> sweeps = read("05_rtl_power_no_spaces_no_eol.csv");
  ASSERT_EQ(sweeps.size(), 1U);
  EXPECT_EQ(sweeps[0].startHz, 24e6);
  EXPECT_EQ(sweeps[0].levelsDb, (std::vector<float>{-24.14F, -24.15F, 14.07F}));
  EXPECT_EQ(recording->problemReport(), "");
}

TEST_F(RealRecording, OfHackrfSweepIsOneSweepInOrderOfFrequency) {
  const std::vector<Sweep> sweeps = read("06_hackrf_sweep_0_6GHz_1MHz.txt");
  ASSERT_EQ(sweeps.size(), 1U);
  const Sweep& sweep = sweeps[0];
  EXPECT_EQ(sweep.time, "2020-06-26 14:57:57");
  EXPECT_EQ(sweep.startHz, 0);
  EXPECT_EQ(sweep.stepHz, 1e6);
  EXPECT_EQ(sweep.rows, 1200U);
  ASSERT_EQ(sweep.levelsDb.size(), 6000U);
  EXPECT_EQ(sweep.levelsDb[0], -8.30F);
  EXPECT_EQ(sweep.levelsDb[5], -55.66F);   // the file's third row
  EXPECT_EQ(sweep.levelsDb[10], -55.28F);  // the second
  EXPECT_EQ(sweep.levelsDb[19], -26.80F);  // the fourth
  EXPECT_EQ(sweep.levelsDb[2450], -56.45F);
  EXPECT_EQ(sweep.levelsDb[5999], -61.89F);
  EXPECT_NEAR(sum(sweep), -392584.95, 0.001);
  EXPECT_EQ(recording->format(), SweepFormat::HackrfSweep);
  EXPECT_EQ(recording->problemReport(), "");
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
  EXPECT_EQ(recording->problemReport(), "");
}

}  // namespace
}  // namespace frontpanels

#include "sources/drive_simulator.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstring>
#include <limits>
#include <set>

#include "entry/channel_map.h"
#include "sources/channel_plans.h"
#include "sources/portable_math.h"

namespace frontpanels {
namespace {

class DriveSimulatorTest : public ::testing::Test {
 protected:
  DriveSimulatorTest() { tunePilots(false); }
  // Every set, or none of them.
  void tunePilots(bool on, PilotTuning tuning = {}) {
    tuning.allPilots = tuning.zoomedPilots = tuning.topN = tuning.userList = on;
    drive.tune(tuning);
  }
  const Frame& frame(std::uint64_t number) {
    drive.seek(number);
    EXPECT_TRUE(drive.next(frame_));
    return frame_;
  }
  const std::vector<float>& levels(std::uint64_t number) { return frame(number).sweep->levelsDb; }
  float highest(std::uint64_t number) {
    return *std::max_element(levels(number).begin(), levels(number).end());
  }

  static SpectrumTuning around(double centerHz, double spanHz, double rbwHz) {
    SpectrumTuning tuning;
    tuning.centerHz = centerHz;
    tuning.spanHz = spanHz;
    tuning.rbwHz = rbwHz;
    return tuning;
  }
  // Every number that a frame has, so that frames compare.
  static std::vector<float> numbers(const Frame& frame) {
    std::vector<float> all = frame.sweep->levelsDb;
    for (const auto* trace : {&*frame.pilots->allPilots, &*frame.pilots->zoomedPilots}) {
      all.push_back(trace->ioDbm);
      all.insert(all.end(), trace->ecIoDb.begin(), trace->ecIoDb.end());
    }
    for (const auto* bars : {&*frame.pilots->topN, &*frame.pilots->userList})
      for (const PilotRecord& pilot : bars->pilots)
        for (const float value : {pilot.pnOffset, pilot.peakEcIoDb, pilot.delayChips, pilot.aggregateEcIoDb,
                                  pilot.delaySpreadChips, pilot.aggregateMinusPeakDb})
          all.push_back(value);
    all.push_back(static_cast<float>(frame.pilots->carrier->frequencyErrorHz));
    return all;
  }
  // Mean power and the spread of the levels, dB, over ten frames.
  std::pair<double, double> meanAndSpread() {
    double power = 0;
    double sum = 0;
    double squares = 0;
    for (std::uint64_t number = 1; number <= 10; ++number)
      for (const float level : levels(number)) {
        const auto dB = static_cast<double>(level);
        power += std::pow(10, dB / 10) / 5120;
        sum += dB / 5120;
        squares += dB * dB / 5120;
      }
    return {10 * std::log10(power), std::sqrt(squares - sum * sum)};
  }

  DriveSimulator drive{7};

 private:
  Frame frame_;
};

// kT is -173.98 dBm a Hz, the filter 0.27 dB wider than its RBW, the noise figure 10 dB. One look is
// exponential: 5.57 dB; n looks have the root of n less, 4.34 dB to begin with; the largest of 16 is on the
// average 1 + 1/2 + ... + 1/16 as large.
TEST_F(DriveSimulatorTest, HasANoiseFloorOfItsBandwidthAndAveraging) {
  const struct {
    double rbwHz;
    bool narrow;
    std::int16_t type;
    std::int32_t count;
    bool log;
    double meanDbm;
    double spreadDb;
  } rows[] = {
      {10e3, false, 32, 100, true, -123.70, 5.57}, {1e6, false, 32, 1, false, -103.70, 5.57},
      {1e6, true, 32, 1, false, -118.93, 5.57},    {10e3, false, 0, 100, false, -123.70, 0.43},
      {10e3, false, 0, 100, true, -126.17, 0.557}, {10e3, false, 0, 4, true, -125.41, 2.78},
      {10e3, false, 1, 50, false, -123.70, 0.436}, {10e3, false, 2, 16, false, -118.41, 1.52},
      {10e3, false, 3, 16, false, -135.74, 5.57},
  };
  for (const auto& row : rows) {
    SpectrumTuning tuning = around(3005e6, 2e6, row.rbwHz);  // where nobody transmits
    tuning.narrowIf = row.narrow;
    tuning.averageType = row.type;
    tuning.averageCount = row.count;
    tuning.averageLogPower = row.log;
    drive.tune(tuning);
    const auto [meanDbm, spreadDb] = meanAndSpread();
    EXPECT_NEAR(meanDbm, row.meanDbm, 0.2) << row.rbwHz << " " << row.type << " " << row.count;
    EXPECT_NEAR(spreadDb, row.spreadDb, 0.04 * row.spreadDb + 0.01) << row.rbwHz << " " << row.type;
  }
}

// A harmonic of the receiver's 10 MHz. 4 cells of 100 Hz, half of one less as the filter passes by, are 350
// Hz off: 3.01 dB times the square of 350 Hz over half the bandwidth.
TEST_F(DriveSimulatorTest, ShowsACarrierAtItsFrequencyAndAsWideAsTheFilter) {
  const struct {
    double centerHz;
    double rbwHz;
    std::ptrdiff_t cell;
    double fourCellsOffDb;
  } rows[] = {{3000.001e6, 300, 40, 16.4}, {3000.001e6, 600, 40, 4.1}, {2999.998e6, 600, 70, 4.1}};
  for (const auto& row : rows) {
    SpectrumTuning tuning = around(row.centerHz, 10e3, row.rbwHz);
    tuning.points = 101;
    tuning.averageType = 0;
    tuning.averageCount = 1000;
    drive.tune(tuning);
    const std::vector<float>& shown = levels(1);
    ASSERT_EQ(shown.size(), 101U);
    const auto peak = std::max_element(shown.begin(), shown.end());
    EXPECT_EQ(peak - shown.begin(), row.cell);
    EXPECT_NEAR(*peak - *(peak + 4), row.fourCellsOffDb, 0.5);
    EXPECT_NEAR(*peak - *(peak - 4), row.fourCellsOffDb, 0.5);
  }
}

// The floor's highest is at -114 dBm. A minute and a half of each, every 1.5 s.
TEST_F(DriveSimulatorTest, HasWhatStaysAndWhatComesAndGoes) {
  const struct {
    double centerHz;
    double spanHz;
    double rbwHz;
    int fewest;
    int most;
  } rows[] = {{154.25e6, 30e3, 3e3, 5, 55},   // private radio
              {837.75e6, 1e6, 10e3, 5, 55},   // cellular uplink
              {882.75e6, 1e6, 10e3, 60, 60},  // cellular downlink
              {1932.5e6, 1e6, 10e3, 60, 60},  // PCS downlink
              {5.905e9, 1e6, 10e3, 0, 0}};
  for (const auto& row : rows) {
    drive.tune(around(row.centerHz, row.spanHz, row.rbwHz));
    int seen = 0;
    for (std::uint64_t number = 1; number <= 900; number += 15) seen += highest(number) > -107 ? 1 : 0;
    EXPECT_GE(seen, row.fewest) << row.centerHz;
    EXPECT_LE(seen, row.most) << row.centerHz;
  }
}

// From 2600 m to 3020 m at 14 m/s: frames 1859 to 2158.
TEST_F(DriveSimulatorTest, LosesItsReferenceInTheTunnelAndFindsItAgain) {
  const struct {
    std::uint64_t number;
    std::int32_t state;
    double onePps;
    double errorHz;
    double toleranceHz;
  } rows[] = {{3, 0, 1, 0, 950},    {300, 2, 1, 0, 6},     {1857, 2, 1, 0, 6}, {1860, 2, 0, 1, 6},
              {2157, 1, 0, 268, 6}, {2160, 1, 1, 248, 20}, {2400, 2, 1, 0, 6}};
  for (const auto& row : rows) {
    const CarrierState carrier = *frame(row.number).pilots->carrier;
    EXPECT_EQ(carrier.frequencyState, row.state) << row.number;
    EXPECT_EQ(carrier.onePps, row.onePps) << row.number;
    EXPECT_NEAR(carrier.frequencyErrorHz, row.errorHz, row.toleranceHz) << row.number;
  }
  tunePilots(true);
  const float inside = frame(2150).pilots->topN->ioDbm;
  EXPECT_GT(frame(2160).pilots->topN->ioDbm, inside + 10);
}

TEST_F(DriveSimulatorTest, MeasuresPilotsThatFitTogether) {
  std::set<float> known;
  for (const SiteName& site : drive.siteNames()) known.insert(static_cast<float>(site.pnOffset));
  EXPECT_EQ(known.size(), 36U);
  PilotTuning tuning;
  tuning.userPns = {340, 3, 172, 340};
  tunePilots(true, tuning);
  std::size_t found = 0;
  for (std::uint64_t number = 1; number <= 401; number += 20) {
    const PilotFrame& pilots = *frame(number).pilots;
    ASSERT_EQ(pilots.allPilots->ecIoDb.size(), 512U);
    found += pilots.topN->pilots.size();
    float before = 0;
    for (const PilotRecord& pilot : pilots.topN->pilots) {
      EXPECT_EQ(known.count(pilot.pnOffset), 1U) << pilot.pnOffset;
      EXPECT_EQ(pilots.allPilots->ecIoDb[static_cast<std::size_t>(pilot.pnOffset)], pilot.peakEcIoDb);
      EXPECT_LE(pilot.peakEcIoDb, before);
      EXPECT_LE(pilot.aggregateEcIoDb, 0);
      EXPECT_GE(pilot.aggregateMinusPeakDb, 0);
      EXPECT_NEAR(pilot.aggregateEcIoDb - pilot.peakEcIoDb, pilot.aggregateMinusPeakDb, 1e-5);
      EXPECT_EQ(pilot.delaySpreadChips > 0, pilot.aggregateMinusPeakDb > 0);
      before = pilot.peakEcIoDb;
    }
    std::vector<float> listed;
    for (const PilotRecord& pilot : pilots.userList->pilots) listed.push_back(pilot.pnOffset);
    EXPECT_EQ(listed, (std::vector<float>{340, 3, 172, 340}));
  }
  EXPECT_GT(found, 40U);
}

// 1 / 2048 of what is no pilot is -33.1 dB less 1; of 64 chips the largest of four passes' means 2.4 times
// that.
TEST_F(DriveSimulatorTest, ShowsTheFloorOfTheCodeWhereThereIsNoPilot) {
  tunePilots(true);
  double sum = 0;
  const std::vector<float>& levels = frame(500).pilots->allPilots->ecIoDb;
  for (std::size_t pn = 401; pn < 512; ++pn) sum += static_cast<double>(levels[pn]) / 111;
  EXPECT_NEAR(sum, -29.4, 0.6);
}

// The strongest path stands where its record says, in each code format, at the resolution of the window.
TEST_F(DriveSimulatorTest, ShowsPathsInTheWindowOfTheCode) {
  tunePilots(true);
  const PilotRecord strongest = frame(200).pilots->topN->pilots.at(0);
  const struct {
    std::int32_t format;
    double chips;  // of the format, in a chip
    double spanChips;
    double toleranceDb;
  } rows[] = {{0, 1, 30, 0.3}, {1, 1, 63, 0.5}, {2, 3, 60, 0.3}};
  for (const auto& row : rows) {
    PilotTuning tuning;
    tuning.codeFormat = row.format;
    tuning.codeStart = static_cast<double>(strongest.pnOffset) * 64 * row.chips;
    tuning.codeSpan = row.spanChips;
    drive.tune(tuning);
    const std::vector<float>& levels = frame(200).pilots->zoomedPilots->ecIoDb;
    ASSERT_EQ(levels.size(), 512U);
    const auto peak = std::max_element(levels.begin(), levels.end());
    const double chips = static_cast<double>(peak - levels.begin()) * row.spanChips / 511 / row.chips;
    EXPECT_NEAR(chips, static_cast<double>(strongest.delayChips), 0.15) << row.format;
    EXPECT_NEAR(*peak, strongest.peakEcIoDb, row.toleranceDb) << row.format;
  }
}

TEST_F(DriveSimulatorTest, HearsPilotsOnTheirCarriersOnly) {
  const struct {
    double carrierHz;
    bool pilots;
  } rows[] = {{878.49e6, true}, {1932.5e6, true}, {881.55e6, false},
              {890e6, false},   {0, false},       {6e9, false}};
  for (const auto& row : rows) {
    PilotTuning tuning;
    tuning.carrierHz = row.carrierHz;
    tunePilots(true, tuning);
    EXPECT_EQ(frame(300).pilots->topN->pilots.empty(), !row.pilots) << row.carrierHz;
    EXPECT_EQ(frame(300).pilots->carrier->frequencyState, row.pilots ? 2 : 0) << row.carrierHz;
  }
}

TEST_F(DriveSimulatorTest, GivesTheSameFrameWhetherPlayedOrSought) {
  PilotTuning tuning;
  tuning.userPns = {4};
  tunePilots(true, tuning);
  DriveSimulator other(8);
  other.tune(tuning);
  DriveSimulator played(7);
  played.tune(tuning);
  Frame last;
  for (int i = 0; i < 12; ++i) EXPECT_TRUE(played.next(last));
  EXPECT_EQ(frame(36001).time, "2024-05-14 10:00:00.000");
  EXPECT_EQ(numbers(frame(12)), numbers(last));
  EXPECT_EQ(frame(12).time, "2024-05-14 09:00:01.100");
  EXPECT_NE(numbers(frame(13)), numbers(last));
  other.seek(12);
  Frame others;
  EXPECT_TRUE(other.next(others));
  EXPECT_NE(numbers(others), numbers(last));
  EXPECT_EQ(drive.name(), "Simulated drive, seed 7");
  EXPECT_EQ(drive.formatName(), std::string("simulator"));
  EXPECT_FALSE(drive.frameCount());
}

// Nothing in it depends on the machine's library: the same in every build.
TEST_F(DriveSimulatorTest, GivesTheSameBitsOnEveryMachine) {
  tunePilots(true);
  std::uint64_t digest = 14695981039346656037U;
  for (const float number : numbers(frame(777))) {
    std::uint32_t bits = 0;
    std::memcpy(&bits, &number, sizeof bits);
    digest = (digest ^ bits) * 1099511628211U;
  }
  EXPECT_EQ(digest, 16493507096619620453U);
}

TEST_F(DriveSimulatorTest, TakesAnyTuningThereIs) {
  constexpr double kNotANumber = std::numeric_limits<double>::quiet_NaN();
  const double values[] = {kNotANumber, HUGE_VAL, -1, 0, 1e12};
  for (const double value : values) {
    SpectrumTuning spectrum{value, value, value, value, 0, true, 99, -1, false};
    spectrum.points = value > 1 ? 100000 : 0;
    drive.tune(spectrum);
    drive.tune(PilotTuning{value, value, 77, value, value, true, true, true, true, {-1, 512, 511}, value});
    const Frame& shown = frame(5);
    EXPECT_EQ(shown.sweep->levelsDb.size(), value > 1 ? 512U : 2U);
    EXPECT_EQ(shown.pilots->userList->pilots.size(), 1U);
    for (const float level : shown.sweep->levelsDb) EXPECT_TRUE(std::isfinite(level)) << value;
  }
}

TEST(PortableMath, AgreesWithTheLibrary) {
  for (double x = 1e-30; x < 1e30; x *= 7.3) EXPECT_NEAR(portableLog(x), std::log(x), 1e-13) << x;
  for (double x = -600; x < 600; x += 1.37) EXPECT_NEAR(portableExp(x) / std::exp(x), 1, 1e-13) << x;
  for (double x = -3; x < 3; x += 0.0171) {
    EXPECT_NEAR(portableTurn(x).real(), std::cos(x * 6.283185307179586), 1e-13) << x;
    EXPECT_NEAR(portableTurn(x).imag(), std::sin(x * 6.283185307179586), 1e-13) << x;
  }
  EXPECT_EQ(portableExp(-1e9), 0);
  EXPECT_NEAR(toDecibels(0), -300, 1e-9);
}

TEST(ChannelPlans, PutChannelsWhereTheirNetworksHaveThem) {
  const struct {
    std::int32_t plan;
    std::size_t band;
    double channel;
    double frequencyHz;
  } rows[] = {{0, 0, 384, 881.52e6},  {0, 1, 384, 836.52e6},   {0, 0, 991, 869.04e6}, {0, 1, 1023, 825e6},
              {1, 0, 25, 1931.25e6},  {1, 1, 1175, 1908.75e6}, {2, 0, 975, 925.2e6},  {2, 0, 124, 959.8e6},
              {2, 1, 975, 880.2e6},   {3, 0, 512, 1805.2e6},   {3, 1, 885, 1784.8e6}, {4, 0, 50, 2112.5e6},
              {4, 1, 1175, 1978.75e6}};
  for (const auto& row : rows) {
    const ChannelBand& band = channelization(row.plan)->bands[row.band];
    std::vector<ChannelDiscontinuity> blocks;
    for (const ChannelBlock& block : band.blocks)
      blocks.push_back({block.channel, block.lowest, block.highest});
    const ChannelPlan plan{band.zeroHz, band.spacingHz, blocks};
    EXPECT_NEAR(frequencyOf(row.channel, plan, {band.lowestHz, band.highestHz}).value_or(0), row.frequencyHz,
                1)
        << row.plan << " " << row.channel;
  }
  std::set<std::int16_t> orders;
  for (const Channelization& plan : channelizations())
    for (const ChannelBand& band : plan.bands) {
      EXPECT_TRUE(orders.insert(band.order).second);
      EXPECT_EQ(band.uplink, &band != &plan.bands.front());
    }
  EXPECT_EQ(channelization(5), nullptr);
}

}  // namespace
}  // namespace frontpanels

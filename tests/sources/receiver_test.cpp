#include "sources/receiver.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>

namespace frontpanels {
namespace {

constexpr double kNotANumber = std::numeric_limits<double>::quiet_NaN();
constexpr double kInfinity = std::numeric_limits<double>::infinity();

// "13=881520000 14=4000000"
std::string text(const std::vector<ReceiverSetting>& settings) {
  std::string result;
  for (const ReceiverSetting& setting : settings)
    result += (result.empty() ? "" : " ") + std::to_string(setting.code) + "=" +
              std::to_string(std::llround(setting.value));
  return result;
}

class ReceiverTest : public ::testing::Test {
 protected:
  // A sweep from a frequency on, 1 MHz from bin to bin, of 0, -1, -2, ... dB.
  static Sweep sweepFrom(double startMHz, int bins) {
    Sweep sweep;
    sweep.startHz = startMHz * 1e6;
    sweep.stepHz = 1e6;
    for (int bin = 0; bin < bins; ++bin) sweep.levelsDb.push_back(static_cast<float>(-bin));
    return sweep;
  }
  // Centre and span in MHz and the first level.
  std::string receive(const Sweep& sweep) {
    const DisplaySweep& shown = receiver.receive(sweep);
    const float first = shown.count == 0 ? 1.0F : shown.values[0];
    return std::to_string(std::lround(shown.range.centerHz / 1e6)) + " " +
           std::to_string(std::lround(shown.range.spanHz / 1e6)) + " " +
           (std::isnan(first) ? "gap" : std::to_string(std::lround(first)));
  }

  Receiver receiver;
};

TEST_F(ReceiverTest, RefusesWhatNoReceiverCanTakeAndStaysAsItWas) {
  EXPECT_EQ(receive(sweepFrom(100, 11)), "105 10 0");
  const struct {
    std::int16_t code;
    double value;
  } rows[] = {{13, kNotANumber}, {13, kInfinity}, {13, -1},        {13, 6.1e9},       {14, 0},
              {14, -1e6},        {14, 6.1e9},     {14, kInfinity}, {16, 0},           {16, kNotANumber},
              {17, 2},           {17, 0.5},       {43, -0.1},      {94, 0},           {333, 1.5},
              {333, 40000},      {500, 0.5},      {502, -1},       {502, 2.5},        {750, -1},
              {803, -1},         {804, 2},        {3900, 3},       {12, 1},           {0, 1},
              {-13, 1},          {3901, 1},       {43, kInfinity}, {803, kNotANumber}};
  for (const auto& row : rows)
    EXPECT_FALSE(receiver.request(row.code, row.value)) << row.code << " " << row.value;
  EXPECT_EQ(text(receiver.takeAnswers()), "13=105000000 14=10000000");  // what holds instead
  EXPECT_EQ(text(receiver.settings()), "13=105000000 14=10000000");
  EXPECT_EQ(receive(sweepFrom(200, 11)), "205 10 0");
}

TEST_F(ReceiverTest, AnswersEachRequestOnceWithTheValueThatItHasThen) {
  const ReceiverSetting rows[] = {{16, 30e3}, {17, 1},  {43, 0},  {94, 100}, {333, 3}, {500, 32},
                                  {502, 10},  {750, 0}, {803, 5}, {804, 0},  {3900, 1}};
  for (const auto& row : rows) EXPECT_TRUE(receiver.request(row.code, row.value)) << row.code;
  EXPECT_TRUE(receiver.request(16, 10e3));
  EXPECT_EQ(text(receiver.takeAnswers()),
            "16=10000 17=1 43=0 94=100 333=3 500=32 502=10 750=0 803=5 804=0 3900=1");
  EXPECT_EQ(text(receiver.takeAnswers()), "");
  EXPECT_TRUE(receiver.request(502, 0));
  EXPECT_EQ(text(receiver.takeAnswers()), "502=0");
  EXPECT_EQ(text(receiver.settings()),
            "16=10000 17=1 43=0 94=100 333=3 500=32 502=0 750=0 803=5 804=0 3900=1");
}

TEST_F(ReceiverTest, ShowsWholeSweepsUntilItIsTunedAndThenTheRangeWhateverIsSwept) {
  EXPECT_EQ(receive(sweepFrom(100, 11)), "105 10 0");
  EXPECT_EQ(receive(sweepFrom(300, 21)), "310 20 0");
  EXPECT_TRUE(receiver.request(13, 320e6));
  EXPECT_EQ(text(receiver.takeAnswers()), "13=320000000");
  EXPECT_EQ(receive(sweepFrom(300, 21)), "320 20 -10");  // from 310 MHz on; the span is the one shown last
  EXPECT_EQ(receive(sweepFrom(309, 5)), "320 20 -1");
  EXPECT_EQ(receive(sweepFrom(100, 11)), "320 20 gap");
  EXPECT_TRUE(receiver.request(14, 4e6) && receiver.request(16, 1e3));
  EXPECT_EQ(receive(sweepFrom(300, 21)), "320 4 -18");
  receiver.showWholeSweeps();
  EXPECT_EQ(receive(sweepFrom(100, 11)), "105 10 0");
  EXPECT_EQ(text(receiver.settings()), "13=105000000 14=10000000 16=1000");
}

TEST_F(ReceiverTest, TakesWhatWasNotRequestedFromTheFirstSweep) {
  EXPECT_TRUE(receiver.request(14, 4e6));
  EXPECT_EQ(receive({}), "0 0 1");
  EXPECT_EQ(receive(sweepFrom(100, 11)), "105 4 -3");
  EXPECT_EQ(receive(sweepFrom(300, 21)), "105 4 gap");
}

// As panels do it: from 0 to 6 GHz, and the centre gives way.
TEST_F(ReceiverTest, MovesARequestedRangeBackInsideItsLimits) {
  const Sweep wide = sweepFrom(0, 7001);
  EXPECT_EQ(receive(wide), "3500 7000 0");
  EXPECT_EQ(text(receiver.takeAnswers()), "");
  EXPECT_EQ(text(receiver.settings()), "13=3500000000 14=7000000000");
  EXPECT_EQ(receive(sweepFrom(100, 11)), "105 10 0");
  EXPECT_TRUE(receiver.request(14, 300e6));
  EXPECT_EQ(text(receiver.takeAnswers()), "14=300000000");
  EXPECT_EQ(receive(sweepFrom(0, 11)), "150 300 0");
  EXPECT_TRUE(receiver.request(13, 5.9e9));
  EXPECT_EQ(text(receiver.takeAnswers()), "13=5850000000");
  EXPECT_TRUE(receiver.request(13, 2e6) && receiver.request(14, 4e6));  // not moved by the span before
  EXPECT_EQ(text(receiver.takeAnswers()), "13=2000000 14=4000000");
  EXPECT_TRUE(receiver.request(14, 6e9));
  EXPECT_EQ(receive(sweepFrom(0, 11)), "3000 6000 0");
}

TEST_F(ReceiverTest, ShowsABinAloneAsALineOneBinWide) {
  EXPECT_EQ(receive(sweepFrom(100, 1)), "101 1 0");  // 100.5 rounded
  EXPECT_EQ(receiver.receive(sweepFrom(100, 1)).values[1], 0.0F);
}

}  // namespace
}  // namespace frontpanels

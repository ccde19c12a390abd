#include "sources/pilot_receiver.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>

namespace frontpanels {
namespace {

constexpr double kNotANumber = std::numeric_limits<double>::quiet_NaN();

// "803=100 804=50.5"
std::string text(const std::vector<ReceiverSetting>& settings) {
  std::string result;
  for (const ReceiverSetting& setting : settings) {
    std::string value = std::to_string(setting.value);
    value.erase(value.find_last_not_of('0') + 1);
    if (value.back() == '.') value.pop_back();
    result += (result.empty() ? "" : " ") + std::to_string(setting.code) + "=" + value;
  }
  return result;
}

TEST(PilotReceiver, RefusesWhatThePanelWouldNotLetThroughAndStaysAsItWas) {
  PilotReceiver receiver;
  ASSERT_TRUE(receiver.request(13, 0, 881.52e6) && receiver.request(230, 0, 12));
  ASSERT_EQ(text(receiver.takeAnswers()), "13=881520000");
  const struct {
    std::int16_t code;
    std::int16_t index;
    double value;
  } rows[] = {{13, 0, -1},   {13, 0, 6.1e9},        {13, 0, kNotANumber}, {333, 0, 5},  {333, 0, 0.5},
              {500, 0, 3},   {502, 0, 32768},       {502, 0, 10.25},      {803, 0, -1}, {803, 0, 32768},
              {803, 0, 0.5}, {804, 0, -1},          {804, 0, 98301},      {750, 0, 2},  {751, 0, 0.5},
              {780, 0, 0},   {780, 0, 512},         {780, 0, 1.5},        {14, 0, 1},   {0, 0, 0},
              {230, 0, 512}, {230, 0, -1},          {230, 0, 1.5},        {230, 2, 5},  {230, -2, 12},
              {230, -1, 13}, {230, 0, kNotANumber}, {230, -32768, 12}};
  for (const auto& row : rows)
    EXPECT_FALSE(receiver.request(row.code, row.index, row.value)) << row.code << " " << row.value;
  EXPECT_EQ(text(receiver.takeAnswers()), "13=881520000");  // what holds instead
  EXPECT_EQ(text(receiver.settings()), "13=881520000");
  EXPECT_EQ(receiver.userPns().size(), 1U);
  EXPECT_FALSE(receiver.display(10, true));
}

TEST(PilotReceiver, KeepsTheWindowAsThePanelDoes) {
  PilotReceiver receiver;
  const struct {
    std::int16_t code;
    double value;
    const char* answer;
    const char* settings;
  } rows[] = {
      {803, 1000, "803=1000", "803=1000 804=31767"},  // the span is cut at the end of the code
      {804, 128, "804=128", "803=1000 804=128"},
      {502, 500, "502=500", "803=436 804=128"},
      {502, 32767, "502=32703", "803=32639 804=128"},  // gives way
      {502, 10, "502=64", "803=0 804=128"},
      {804, 5, "804=5", "803=0 804=5"},
      {502, 10, "502=10", "803=8 804=5"},  // 7.5: to the even one; the centre as it was requested
      {502, 32764.5, "502=32764", "803=32762 804=5"},
      {500, 2, "500=2", "500=2 803=98286 804=15"},  // three times as many chips
      {803, 98301, "803=98301", "500=2 803=98301 804=0"},
      {500, 1, "500=1", "500=1 803=32767 804=0"},
      {803, 40000, "803=32767", "500=1 803=32767 804=0"},  // refused
  };
  for (const auto& row : rows) {
    EXPECT_EQ(receiver.request(row.code, 0, row.value), row.value != 40000);
    EXPECT_EQ(text(receiver.takeAnswers()), row.answer) << row.code << " " << row.value;
    EXPECT_EQ(text(receiver.settings()), row.settings) << row.code << " " << row.value;
  }
}

TEST(PilotReceiver, EditsTheListByIndexAndNeverEchoesIt) {
  PilotReceiver receiver;
  const struct {
    std::int16_t index;
    double pn;
  } edits[] = {{0, 4}, {1, 8}, {0, 511}, {1, 4}, {-3, 4}, {3, 0}};
  for (const auto& edit : edits) EXPECT_TRUE(receiver.request(230, edit.index, edit.pn)) << edit.pn;
  EXPECT_EQ(receiver.tuning({}).userPns, (std::vector<std::int32_t>{511, 4, 8, 0}));
  EXPECT_EQ(text(receiver.takeAnswers()) + text(receiver.settings()), "");
}

TEST(PilotReceiver, LaysWhatWasRequestedOverDefaults) {
  PilotTuning defaults;
  defaults.codeStart = 64;
  defaults.codeSpan = 100;
  defaults.userPns = {4};
  PilotReceiver receiver;
  EXPECT_EQ(receiver.tuning(defaults), defaults);
  EXPECT_TRUE(receiver.request(500, 0, 2) && receiver.request(13, 0, 1.9e9) && receiver.request(780, 0, 4) &&
              receiver.request(750, 0, 0) && receiver.display(18, false) && receiver.display(200, false) &&
              receiver.request(751, 0, -1));
  PilotTuning wanted = defaults;
  wanted.codeFormat = 2;
  wanted.codeStart = 192;
  wanted.codeSpan = 300;
  wanted.carrierHz = 1.9e9;
  wanted.pnIncrement = 4;
  wanted.topN = wanted.zoomedPilots = false;
  EXPECT_EQ(receiver.tuning(defaults), wanted);
  EXPECT_EQ(text(receiver.takeAnswers()), "500=2 13=1900000000 780=4 750=0 751=1");
  EXPECT_TRUE(receiver.request(804, 0, 3));
  EXPECT_EQ(receiver.tuning(defaults).codeStart, 0);
}

TEST(Receiver, LaysWhatWasRequestedOverDefaults) {
  Receiver receiver;
  Sweep sweep;
  sweep.startHz = 1e8;
  sweep.stepHz = 1e6;
  sweep.levelsDb = {0, 0};
  EXPECT_GT(receiver.receive(sweep).count, 0U);
  EXPECT_EQ(receiver.tuning({}), SpectrumTuning{});  // shown, not requested
  const ReceiverSetting requests[] = {{13, 5.999e9}, {14, 4e6}, {16, 1e3}, {17, 1},  {43, 2},
                                      {94, 3001},    {500, 2},  {502, 7},  {3900, 0}};
  for (const auto& row : requests) EXPECT_TRUE(receiver.request(row.code, row.value)) << row.code;
  const SpectrumTuning wanted{5.998e9, 4e6, 1e3, 2, 512, true, 2, 7, false};
  EXPECT_EQ(receiver.tuning({}), wanted);
}

}  // namespace
}  // namespace frontpanels

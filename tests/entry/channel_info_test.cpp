#include "entry/channel_info.h"

#include <cmath>

#include "entry/host_data_version.h"
#include "tests/entry/entry_field.h"
#include "tests/support/listed_records.h"

namespace frontpanels {
namespace {

using testing::ListedRecords;

ListedRecords record(const Variant& order, double minimum = 0, double maximum = 0,
                     const Variant& channel = {}) {
  return ListedRecords(
      {{{"[Order]", order}, {"[Minimum]", minimum}, {"[Maximum]", maximum}, {"[Default]", channel}}});
}

// Channel 1 at 870.03 MHz, 30 kHz apart; below it, down to 869.04 MHz, the channels 991 to 1023.
class ChannelTest : public testing::EntryFieldTest {
 protected:
  ChannelTest() {
    entry.frequencySuffix();
    entry.Limits(ListedRecords({{{"[Order]", 0}, {"[Minimum]", 869.04e6}, {"[Maximum]", 893.98e6}},
                                {{"[Order]", 1}, {"[Minimum]", 1930e6}, {"[Maximum]", 1990e6}}}));
    entry.value(880e6);
  }
  ~ChannelTest() override { hostDataVersion(0.04); }

  void plan(const Variant& order, const char* zero, const char* spacing, double channel, double minimum,
            double maximum) {
    const ListedRecords set = record(order, minimum, maximum);
    info.setChannelZero(zero, &set);
    info.setChannelSpacing(spacing, &set);
    info.setChannelDiscontinuity(numberToText(channel), &set);
  }
  void lookup(const char* id, double lowest, double highest) {
    const ListedRecords set = record({}, lowest, highest);
    info.setChannelLookup(id, &set);
  }
  void selectCellular() {
    plan(4, "870e6", "30000", -32, 991, 1023);
    plan(5, "1930E6", "50000", 500, 1500, 1600);
    lookup("7", 4, 5);
    info.selectChannelization(7, entry);
  }
  [[nodiscard]] std::string shown() const { return box.Text() + " = " + numberToText(entry.value()); }
  // Offset and scale of the first two ranges, and what 869.04 MHz reads.
  [[nodiscard]] std::string plans() const {
    std::string text;
    for (const std::int32_t range : {0, 1})
      text += numberToText(entry.FormatOffsetForRange(range)) + "/" +
              numberToText(entry.FormatScaleForRange(range)) + " ";
    return text + entry.formatter(869.04e6);
  }

  clsChannelInfo info;
};

TEST_F(ChannelTest, EveryFrequencyHasAChannelAndEveryChannelItsFrequency) {
  // The block from position -32 to 0; half-way between channels begins the upper one. Range 1 by its
  // channels.
  const std::vector<std::pair<double, const char*>> cases = {
      {869.04e6, "991"}, {869.055e6, "991.5"},  {869.97e6, "1022"},
      {870e6, "1023"},   {870.009e6, "1023.3"}, {870.015e6, "0.5"},
      {870.03e6, "1"},   {870.0366e6, "1.22"},  {893.98e6, "799.333333333333"},
      {1930e6, "0"},     {1954.95e6, "499"},    {1955e6, "1500"},
      {1960e6, "1600"},  {1960.025e6, "600.5"}};
  selectCellular();
  entry.autoChoose(true);
  for (const auto& [frequency, channel] : cases) {
    entry.value(frequency);
    EXPECT_EQ(box.Text(), channel);
    entry.valueNoUpdate(frequency < 1e9 ? 880.02e6 : 1980e6);
    leave(channel);
    EXPECT_NEAR(entry.value(), frequency, 1e-6) << channel;
  }
}

TEST_F(ChannelTest, ATextThatIsNoChannelIsRefused) {
  selectCellular();
  entry.value(870.03e6);
  for (const char* text :
       {"0", "-5", "800", "900", "990", "1024", "1500", "1 k", "1 MHz", "1e300", "x", ""}) {
    box.focusChanged(true);
    box.userText(text);
    EXPECT_FALSE(entry.validNumeric()) << text;
    box.focusChanged(false);
    EXPECT_EQ(shown(), "1 = 870030000") << text;
    EXPECT_FALSE(entry.validNumeric()) << text;  // until the next event
  }
  entry.GotFocus();
  EXPECT_TRUE(entry.validNumeric());
  leave("799.5");  // its nearer half is within: the limit
  EXPECT_EQ(shown(), "799.333333333333 = 893980000");
  leave("990.6");
  EXPECT_EQ(shown(), "991 = 869040000");
  leave("1023.5");  // as 1023.4999 reads when it is rounded
  EXPECT_EQ(shown(), "0.5 = 870015000");
  leave("1023");
  EXPECT_EQ(clicks(2, true), "1, 2");
  EXPECT_EQ(clicks(3, false), "1, 1023, 1022");
  entry.value(870.04e6);
  EXPECT_EQ(clicks(1, false), "1023.33333333333");
  entry.NormalizeAsStep(true);
  EXPECT_EQ(clicks(1, true), "1");
  entry.step(1e6);  // one channel all the same
  entry.value(870.0701e6);
  EXPECT_EQ(shown(), "2 = 870060000");

  entry.channelChoose(false);
  EXPECT_EQ(shown(), "870.06 MHz = 870060000");
  leave("871");
  entry.ChannelSpacing(30e3);  // the panel's choice stands
  entry.reformat();
  EXPECT_EQ(shown(), "871 MHz = 871000000");
  entry.channelChoose(true);
  EXPECT_EQ(box.Text(), "33.3333333333333");
  entry.validNumeric(false);
  EXPECT_FALSE(entry.validNumeric());
  entry.Clear();
  EXPECT_FALSE(entry.channelChoose() || entry.channelUnits());
}

TEST_F(ChannelTest, AHostRecordNamesItsBandFromVersion004On) {
  const auto five = record(5), six = record(6), half = record(1.5), none = record({}), word = record("x");
  const auto block = record(0, 100, 109, 20);
  entry.ChannelZero(870e6);
  EXPECT_TRUE(entry.channelUnits() && entry.channelChoose());
  entry.ChannelSpacing(25e3 / 3);
  EXPECT_EQ(entry.formatter(870e6 + 7 * 25e3 / 3), "7");
  entry.ChannelSpacing(30e3);
  entry.ChannelZero(5e6, &five);
  entry.ChannelSpacing(5e3, &five);
  EXPECT_EQ(numberToText(entry.FormatOffsetForRange(5)) + numberToText(entry.FormatScaleForRange(5)),
            "50000005000");
  EXPECT_EQ(numberToText(entry.formatOffset()) + numberToText(entry.formatScale()), "87000000030000");
  for (const ListedRecords* bad : {&six, &half, &none, &word}) {
    entry.ChannelZero(1, bad);
    entry.ChannelSpacing(1, bad);
    EXPECT_EQ(said(),
              "clsNumericEntryChannelZero() bad value for PARM_CHANNEL_ZERO::FIELD_ORDER\r\n"
              "clsNumericEntryChannelSpacing() bad value for PARM_CHANNEL_SPACING::FIELD_ORDER\r");
  }
  entry.ChannelDiscontinuity(7, &six);
  entry.ChannelSpacing(0);
  EXPECT_EQ(said(),
            "clsNumericEntry::ChannelDiscontinuity()\rSubscript out of range\n"
            "clsNumericEntry::ChannelSpacing() failed. \rDivision by zero");
  EXPECT_EQ(plans(), "870000000/30000 0/1 -32");
  hostDataVersion(0.03);
  entry.ChannelZero(869.04e6, &six);
  entry.ChannelDiscontinuity(0, &block);
  EXPECT_EQ(plans(), "869040000/30000 0/1 0");
  EXPECT_EQ(entry.formatter(869.64e6), "100");
  entry.ChannelDiscontinuity(0);
  EXPECT_EQ(entry.formatter(869.64e6), "20");
  entry.ChannelDiscontinuity(1);
  EXPECT_EQ(said(),
            "clsNumericEntry::ChannelDiscontinuity()\rObject variable or With block variable not set");
}

TEST_F(ChannelTest, BlocksThatOverlapAreRefusedInAnyOrder) {
  const std::string refused =
      "clsNumericEntry::AddChannelDiscontinuity()\rInvalid procedure call or argument";
  // The same once more, neighbours whatever their order; a channel in common, a number in common; reversed.
  const std::vector<std::pair<ChannelDiscontinuity, bool>> cases = {
      {{10, 110, 119}, true},  {{10, 110, 119}, true},  {{20, 120, 129}, true}, {{0, 100, 109}, true},
      {{29, 200, 209}, false}, {{-9, 200, 209}, false}, {{40, 91, 100}, false}, {{40, 129, 130}, false},
      {{30, 5, 4}, false},     {{30, 5, 5}, true}};
  entry.ChannelSpacing(1e6);
  entry.ChannelZero(870e6);
  for (const auto& [block, taken] : cases) {
    entry.AddChannelDiscontinuity(block.channel, block.minimum, block.maximum);
    EXPECT_EQ(said(), taken ? "" : refused) << block.channel << " " << block.minimum;
  }
  EXPECT_EQ(entry.formatter(869e6) + entry.formatter(889e6) + entry.formatter(900e6), "-11195");
  entry.AddChannelDiscontinuity(50, 1, HUGE_VAL);
  entry.AddChannelDiscontinuity(50, 900, 901, 3);
  EXPECT_EQ(said(),
            "clsNumericEntry::AddChannelDiscontinuity()\rOverflow\n"
            "clsNumericEntry::UpdateDiscontinuities() ... no range defined for step/discontinuity\r");
}

TEST_F(ChannelTest, OfEachTableTheRecordsOfTheChannelizationAreApplied) {
  plan(9, "1", "2", 0, 500, 510);
  plan(4, "870e6", "30000", -32, 991, 1023);
  plan(4, "6", "7", -32, 991, 1023);  // of two for a band the first counts
  lookup("7", 9, 9);
  lookup("7", 4, 5);
  entry.channelChoose(true);
  entry.AddChannelDiscontinuity(-5, 0, 1e9);
  const std::string before = plans();
  info.selectChannelization(8, entry);
  info.selectChannelSpacing(8, entry);
  EXPECT_EQ(said(),
            "clsChannelInfo::selectChannelization() ... could not find channelization lookup\r\n"
            "clsChannelInfo::selectChannelSpacing() ... could not find channelization lookup\r");
  const auto wrong = [&](const char* id, std::int16_t number, double order, const char* problem) {
    lookup(id, order, order + 9);
    info.selectChannelization(number, entry);
    EXPECT_EQ(said(), std::string("clsChannelInfo::selectChannelization()\r") + problem);
    EXPECT_EQ(plans(), before);
  };
  plan(20, "1", "0", 0, 1, 2);
  wrong("1", 1, 20, "Division by zero");
  plan(40, "1", "1", 0, 1, 2);
  plan(40, "1", "1", 1, 5, 6);
  wrong("2", 2, 40, "Invalid procedure call or argument");
  wrong("3", 3, 33, "Subscript out of range");

  info.selectChannelSpacing(7, entry);
  EXPECT_EQ(plans().substr(0, 12), "0/30000 0/1 ");
  info.selectChannelization(7, entry);
  EXPECT_EQ(plans() + said(), "870000000/30000 0/1 991");
}

TEST_F(ChannelTest, WhatIsNoNumberAddsNoRecordAndWhatIsNoneOfItsWidthIsReported) {
  const auto wide = record(70000, 70000, 1), fit = record(70000, 1, 2);
  const auto setAll = [&](const char* text, const HostRecordSet* set) {
    info.setChannelZero(text, set);
    info.setChannelSpacing(text, set);
    info.setChannelDiscontinuity(text, set);
    info.setChannelLookup(text, set);
  };
  const auto records = [&] {
    return info.channelZeros().size() + info.channelSpacings().size() + info.channelDiscontinuities().size() +
           info.channelLookups().size();
  };
  for (const char* text : {"", "x", "1,5", "1e400", "nan"}) setAll(text, &wide);
  EXPECT_EQ(said(), "");
  setAll("1", &wide);
  info.setChannelLookup("1", nullptr);
  EXPECT_EQ(
      said(),
      "clsChannelInfo::setChannelZero()\rOverflow\nclsChannelInfo::setChannelSpacing()\rOverflow\n"
      "clsChannelInfo::setChannelDiscontinuity()\rOverflow\nclsChannelInfo::setChannelLookup()\rOverflow\n"
      "clsChannelInfo::setChannelLookup()\rObject variable or With block variable not set");
  EXPECT_EQ(records(), 0U);

  hostDataVersion(0.03);
  setAll(" 3.5 ", &fit);  // an id is a whole number, halves to even
  EXPECT_EQ(info.channelZeros(), (std::vector<ChannelZero>{{0, 3.5}}));
  EXPECT_EQ(info.channelSpacings(), (std::vector<ChannelSpacing>{{0, 3.5}}));
  EXPECT_EQ(info.channelDiscontinuities(), (std::vector<OrderedDiscontinuity>{{0, {3.5, 1, 2}}}));
  EXPECT_EQ(info.channelLookups(), (std::vector<ChannelLookup>{{4, 1, 2}}));
  info.reinitialize();
  EXPECT_EQ(records(), 0U);
}

}  // namespace
}  // namespace frontpanels

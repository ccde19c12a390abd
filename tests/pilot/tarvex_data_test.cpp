#include <cmath>
#include <limits>

#include "pilot/pilot_sets.h"
#include "platform/result_writer.h"
#include "tests/pilot/pilot_fixture.h"

namespace frontpanels::testing {
namespace {

std::vector<float> levels(std::size_t count, float value = -20) { return std::vector<float>(count, value); }

TEST_F(PilotTest, EachServerListensToItsPathsInTheirOrder) {
  constexpr std::int32_t kPaths[] = {2, 2, 7, 7, 3};
  for (const PilotServerRow& row : pilotServers()) {
    const std::string paths = panel->paths(row.server);
    EXPECT_EQ(std::count(paths.begin(), paths.end(), '\x1b') + 1, kPaths[static_cast<int>(row.server)]);
  }
  EXPECT_EQ(panel->paths(PilotServer::TopN).substr(0, 91),
            "Brantor Scanner/Cdma Pilot Top N Multipath/Io\x1b"
            "Brantor Scanner/Cdma Pilot Top N Multipath/Pn");
  panel->paths(PilotServer::AllPilots,
               "a/Io\x1b"
               "a/Trace");
  publishLevels(kAllPilotsPath + "AllPilotsTrace", levels(4));
  EXPECT_EQ(trace(11), nullptr);
  publishLevels("a/Trace", levels(4));
  EXPECT_NE(trace(11), nullptr);
}

TEST_F(PilotTest, AFrameOfAllPilotsBecomesATraceThatReadsByPnOffset) {
  hub.publish(kAllPilotsPath + "Io", Variant("-71.25"));
  EXPECT_EQ(panel->updateCount(), 0);
  EXPECT_EQ(trace(11), nullptr);
  std::vector<float> frame = levels(512);
  frame[300] = -4;
  publishLevels(kAllPilotsPath + "AllPilotsTrace", frame);
  ASSERT_NE(trace(11), nullptr);
  EXPECT_EQ(trace(11)->numberOfMeasurements(), 512);
  EXPECT_EQ(trace(11)->span(), 512);
  EXPECT_EQ(trace(11)->xStart(), 0);
  EXPECT_EQ(trace(11)->traceSize(), 512);
  EXPECT_EQ(trace(11)->offset(), Variant(-71.25F));
  EXPECT_EQ(panel->updateCount(), 1);
  EXPECT_EQ(text("I0TextBox"), "-71.25 dBm");
  panel->addMarker();
  panel->markerToMax();
  EXPECT_EQ(trace(11)->activeMarker()->point, 300);
  panel->Paint();
  EXPECT_EQ(trace(11)->activeMarker()->valueX, 300);  // points lie one PN offset apart
  EXPECT_EQ(panel->AllPilotsData().size(), 512U);
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(PilotTest, AZoomedTraceBeginsAtTheCodeWindow) {
  set(803, 64 * 100);
  publishLevels(kZoomedPath + "Zoomed Pilots Trace", levels(21));
  ASSERT_NE(trace(17), nullptr);
  EXPECT_EQ(trace(17)->traceType(), 2);
  EXPECT_EQ(trace(17)->xStart(), 100);
  EXPECT_EQ(trace(17)->xStop(), 121);
  EXPECT_EQ(trace(17)->leftLabel(), "100 PN");
  EXPECT_EQ(trace(17)->rightLabel(), "119 PN");  // the last point but one lies on the plot's right edge
  panel->controls()->optionButton("CdmaUnitsChipsOption").Value(true);
  EXPECT_EQ(trace(17)->leftLabel(), "6400 chips");
  EXPECT_EQ(panel->ZoomedPilotsData().size(), 21U);
}

TEST_F(PilotTest, ATraceOfMoreThan513ValuesOrOfTextsIsReportedAndThePictureStays) {
  publishLevels(kAllPilotsPath + "AllPilotsTrace", levels(513));
  publishLevels(kAllPilotsPath + "AllPilotsTrace", levels(514, -1));
  EXPECT_EQ(said(), "Tarvex::DfiAllPilots_DataChanged()\rSubscript out of range");
  hub.publish(kAllPilotsPath + "AllPilotsTrace", Variant::Variants{Variant(-1.0), Variant("loud")});
  EXPECT_EQ(said(), "Tarvex::DfiAllPilots_DataChanged()\rType mismatch");
  hub.publish(kAllPilotsPath + "Io", Variant("none"));
  EXPECT_EQ(said(), "Tarvex::DfiAllPilots_DataChanged()\rType mismatch");
  EXPECT_EQ(panel->AllPilotsData().size(), 513U);
  EXPECT_EQ(panel->AllPilotsData()[0], -20);
  EXPECT_EQ(trace(11)->numberOfMeasurements(), 513);
  EXPECT_EQ(panel->updateCount(), 1);
  publishLevels(kZoomedPath + "Zoomed Pilots Trace", levels(514));
  EXPECT_EQ(said(), "Tarvex::DfiZoomedPilots_DataChanged()\rSubscript out of range");
  EXPECT_EQ(trace(17), nullptr);
  for (const std::size_t few : {0U, 1U, 2U}) publishLevels(kAllPilotsPath + "AllPilotsTrace", levels(few));
  EXPECT_EQ(panel->AllPilotsData().size(), 2U);
  EXPECT_EQ(said(), "");
}

TEST_F(PilotTest, TheLastPathOfAMultipathFrameClosesIt) {
  publishFrame(kTopNPath, {{12, -7}, {30, -3}}, -70, 6);
  EXPECT_EQ(bars(203), nullptr);
  EXPECT_EQ(panel->updateCount(), 0);
  publishFrame(kTopNPath, {{12, -7}, {30, -3}});
  EXPECT_EQ(barsOf(203), "30:-3 12:-7");  // strongest first
  EXPECT_EQ(bars(203)->numberOfMeasurements(), 2);
  EXPECT_EQ(bars(203)->elementsPerValue(), 6);
  EXPECT_EQ(bars(203)->offset(), Variant(-70.0F));
  const std::vector<float> first(panel->TopNData().begin(), panel->TopNData().begin() + 6);
  EXPECT_EQ(first, (std::vector<float>{12, -7, 15, 16, 17, 18}));
  publishFrame(kListPath, {{5, -9}});
  EXPECT_EQ(barsOf(204), "5:-9");
  EXPECT_EQ(panel->UserListData().size(), 6U);
  EXPECT_EQ(panel->updateCount(), 2);
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(PilotTest, AFrameThatIsNotWholeIsReportedAndThePictureStays) {
  const std::string refused = "Tarvex::DfiPilotTopNMultipath_DataChanged()\rSubscript out of range";
  const auto column = [this](const char* name, std::size_t items) {
    publishLevels(kTopNPath + name, levels(items));
  };
  publishFrame(kTopNPath, {{12, -7}});
  struct Row {
    const char* what;
    std::vector<std::pair<const char*, std::size_t>> paths;
    bool reported;
  };
  const Row rows[] = {
      {"one path has fewer items",
       {{"Pn", 2},
        {"Peak EcIo", 2},
        {"Delay", 1},
        {"Aggr EcIo", 2},
        {"Delay Spread", 2},
        {"Aggr Minus Peak EcIo", 2}},
       true},
      {"the last has more",
       {{"Pn", 2},
        {"Peak EcIo", 2},
        {"Delay", 2},
        {"Aggr EcIo", 2},
        {"Delay Spread", 2},
        {"Aggr Minus Peak EcIo", 3}},
       true},
      {"one is missing, which the frame before had",
       {{"Pn", 2}, {"Peak EcIo", 2}, {"Delay", 2}, {"Aggr EcIo", 2}, {"Aggr Minus Peak EcIo", 2}},
       true},
      {"the last comes early",
       {{"Pn", 1},
        {"Peak EcIo", 1},
        {"Aggr Minus Peak EcIo", 1},
        {"Delay", 1},
        {"Aggr EcIo", 1},
        {"Delay Spread", 1}},
       true},
      {"cut by the next one's first",
       {{"Pn", 3}, {"Peak EcIo", 3}, {"Delay", 3}, {"Pn", 1}, {"Delay", 1}},
       false},
      {"a last path alone", {{"Aggr Minus Peak EcIo", 1}}, true},
      {"and again", {{"Aggr Minus Peak EcIo", 1}}, false},
  };
  for (const Row& row : rows) {
    for (const auto& [name, items] : row.paths) column(name, items);
    EXPECT_EQ(said(), row.reported ? refused : "") << row.what;
    EXPECT_EQ(barsOf(203), "12:-7") << row.what;
  }
  hub.publish(kTopNPath + "Pn", Variant::Variants{Variant("x")});
  EXPECT_EQ(said(), "Tarvex::DfiPilotTopNMultipath_DataChanged()\rType mismatch");
  column("Aggr Minus Peak EcIo", 1);  // of the frame that was spoilt
  EXPECT_EQ(said(), "");
  EXPECT_EQ(panel->updateCount(), 1);
  publishFrame(kTopNPath, {{9, -1}});
  EXPECT_EQ(barsOf(203), "9:-1");
}

TEST_F(PilotTest, FramesOfAnySizeAndContentKeepThePanelAlive) {
  const float nan = std::numeric_limits<float>::quiet_NaN();
  publishFrame(kTopNPath, {{-1, -7}, {600, -9}, {3, nan}, {3, -2}, {nan, -5}});
  EXPECT_EQ(bars(203)->barArraySize(), 5);
  panel->Paint();
  for (const std::size_t items : {1U, 40U, 41U, 10000U, 0U}) {
    std::vector<Pilot> pilots;
    for (std::size_t i = 0; i < items; ++i) pilots.push_back({static_cast<float>(i), -5});
    publishFrame(kTopNPath, pilots);
    EXPECT_EQ(bars(203)->barArraySize(), static_cast<std::int16_t>(std::min<std::size_t>(items, 40)))
        << items;
    EXPECT_EQ(panel->TopNData().size(), items * 6);
  }
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(PilotTest, TheFourSetsStandOnTheGraphTogether) {
  publishLevels(kAllPilotsPath + "AllPilotsTrace", levels(512));
  publishLevels(kZoomedPath + "Zoomed Pilots Trace", levels(20));
  publishFrame(kTopNPath, {{12, -7}});
  publishFrame(kListPath, {{5, -9}});
  EXPECT_EQ(panel->base().traceManager().numberOfTraces(), 4);
  EXPECT_EQ(panel->base().traceManager().activeTrace(), bars(204));
  EXPECT_EQ(bars(204)->scaleHeight(), 570 * 0.6F);
  EXPECT_EQ(trace(17)->scaleLeft(), 760 / 3.0F);
  for (const char* const box :
       {"allPilotsCheckBox", "zoomedPilotsCheckBox", "topNPilotsCheckBox", "userListCheckBox"})
    EXPECT_EQ(panel->controls()->checkBox(box).Value(), 1) << box;
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(PilotTest, TheCarrierIsReadOut) {
  hub.publish(kCarrierPath + "Carrier Error", Variant(-12.5));
  hub.publish(kCarrierPath + "Carrier Freq State", Variant("Locked"));
  EXPECT_EQ(control("CarrierErrorLabel").Caption(), "Carrier Freq Error = -12.5");
  EXPECT_EQ(control("CarrierStateLabel").Caption(), "Carrier Freq State = Locked");
  struct Row {
    Variant value;
    const char* shown;
  };
  const Row rows[] = {{Variant(7.9), "1PPS = 7"},
                      {Variant(-0.5), "1PPS = -1"},
                      {Variant("12.9"), "1PPS = 12"},
                      {Variant("lost"), "1PPS = lost"}};
  for (const Row& row : rows) {
    hub.publish(kCarrierPath + "One Pps", row.value);
    EXPECT_EQ(control("onePpsLabel").Caption(), row.shown);
  }
}

TEST_F(PilotTest, WhatTheHostTakesBackIsNoLongerReadOut) {
  publishFrame(kTopNPath, {{12, -7}}, 0);
  EXPECT_EQ(text("I0TextBox"), "0 dBm");
  panel->vfpOp(0, 10, 14);
  EXPECT_EQ(text("I0TextBox"), "");  // of a set that has had none
  hub.publish(kAllPilotsPath + "Io", Variant(-70));
  EXPECT_EQ(text("I0TextBox"), "-70 dBm");
  hub.publish(kAllPilotsPath + "Io", Variant());
  hub.publish(kCarrierPath + "One Pps", Variant(1));
  hub.publish(kCarrierPath + "One Pps", Variant());
  EXPECT_EQ(text("I0TextBox"), "");
  EXPECT_EQ(control("onePpsLabel").Caption(), "");
  EXPECT_EQ(said(), "");
}

TEST_F(PilotTest, ARecordInAResultBufferIsShownLikeAFrame) {
  const auto display = [this](std::int32_t type, const std::vector<float>& values) {
    ResultWriter writer;
    writer.HardwareId(1);
    writer.BeginMeasurement(3);
    writer.BeginSubMeasurement(1);
    writer.BeginRecord(type);
    writer.Float32(-66);
    writer.Float32Array(values);
    writer.EndRecord();
    writer.EndSubMeasurement();
    writer.EndMeasurement();
    const std::vector<std::uint8_t> bytes = writer.Bytes();
    std::int32_t dataPointer = 0;
    auto dataCount = static_cast<std::int32_t>(bytes.size());
    return panel->displayData({}, bytes, dataPointer, dataCount, type, 0);
  };
  set(312, 3);
  EXPECT_EQ(display(14, levels(512)), 0);
  EXPECT_EQ(trace(11)->numberOfMeasurements(), 512);
  EXPECT_EQ(display(201, {12, -7, 1, 2, 3, 4, 30, -3, 5, 6, 7, 8}), 0);
  EXPECT_EQ(barsOf(203), "30:-3 12:-7");
  EXPECT_EQ(messages(), Messages{});
  EXPECT_EQ(display(201, {12, -7, 1, 2, 3}), 0);
  EXPECT_EQ(said(), "Tarvex::resultData()\rSubscript out of range");
  EXPECT_EQ(display(18, levels(514)), 0);
  EXPECT_EQ(said(), "Tarvex::resultData()\rSubscript out of range");
  EXPECT_EQ(barsOf(203), "30:-3 12:-7");
  EXPECT_EQ(trace(17), nullptr);
}

}  // namespace
}  // namespace frontpanels::testing

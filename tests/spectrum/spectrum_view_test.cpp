#include "spectrum/spectrum_view.h"

#include <cmath>
#include <limits>

#include "platform/result_writer.h"
#include "tests/spectrum/spectrum_fixture.h"

namespace frontpanels::testing {
namespace {

TEST_F(SpectrumViewTest, PublishedSweepIsDrawnAndCopiedInOneTransferWhileTheViewIsShown) {
  view.shown = false;
  publish({-30, -50});
  EXPECT_TRUE(gdi.blits().empty());
  view.shown = true;
  publish({-30, -50, -40});
  ASSERT_EQ(traceLines().size(), 1U);
  EXPECT_EQ(traceLines()[0].points.size(), 3U);
  ASSERT_EQ(gdi.blits().size(), 1U);
  EXPECT_EQ(gdi.blits()[0].rect, (Rect{20, 15, 780, 585}));
  EXPECT_EQ(panel->base().traceManager().find(25), panel->base().traceManager().activeTrace());
  EXPECT_TRUE(messages().empty());
}

TEST_F(SpectrumViewTest, ASweepShowsItsOwnPointsOfWhichMoreThan513AreAnErrorThatKeepsThePicture) {
  publish(std::vector<float>(513, -50.0F));
  ASSERT_EQ(traceLines().size(), 1U);
  EXPECT_EQ(traceLines()[0].points.size(), 513U);
  gdi.clear();
  publish({-30, -35, std::numeric_limits<float>::quiet_NaN(), -40, -45, -50});
  publish(std::vector<float>(514, -50.0F));
  EXPECT_EQ(messages(), Messages{"SpectrumView::DfiSpectrum_DataChanged()\rSubscript out of range"});
  gdi.clear();
  panel->Paint();
  ASSERT_EQ(traceLines().size(), 2U);
  EXPECT_EQ(traceLines()[0].points.size(), 2U);
  EXPECT_EQ(traceLines()[1].points.size(), 3U);
}

TEST_F(SpectrumViewTest, ASweepMayHaveNoPointOneOrTwo) {
  for (const std::size_t points : {0U, 1U, 2U, 0U, 3U}) {
    gdi.clear();
    publish(std::vector<float>(points, -50.0F));
    EXPECT_EQ(traceLines().size(), points == 0 ? 0U : 1U) << points;
    EXPECT_EQ(gdi.blits().size(), 1U) << points;
  }
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(SpectrumViewTest, ASweepInAResultBufferIsDrawnLikeOneFromTheHub) {
  const auto display = [this](const std::vector<float>& levels) {
    ResultWriter writer;
    writer.HardwareId(1);
    writer.BeginMeasurement(0x7FFF);
    writer.BeginSubMeasurement(1);
    writer.BeginRecord(25);
    writer.Float32Array(levels);
    writer.EndRecord();
    writer.EndSubMeasurement();
    writer.EndMeasurement();
    const std::vector<std::uint8_t> bytes = writer.Bytes();
    std::int32_t dataPointer = 0;
    auto dataCount = static_cast<std::int32_t>(bytes.size());
    return panel->displayData({}, bytes, dataPointer, dataCount, 25, 0);
  };
  panel->vfpSet(0, 312, 0, 0x7FFF);
  EXPECT_EQ(display({-30, -50, -40, -60}), 0);
  ASSERT_EQ(traceLines().size(), 1U);
  EXPECT_EQ(traceLines()[0].points.size(), 4U);
  EXPECT_EQ(messages(), Messages{});
  gdi.clear();
  EXPECT_EQ(display(std::vector<float>(514, -50.0F)), 0);  // the picture stays, the record is stepped over
  EXPECT_TRUE(traceLines().empty());
  EXPECT_EQ(messages(),
            (Messages{"SpectrumView::resultData()\rSubscript out of range",
                      "SpectrumView::DisplayData() ... no data read for result type Spectrum\r"}));
}

TEST_F(SpectrumViewTest, TheReportIsOneFragmentWithSettingsReadingsAndPicture) {
  panel->vfpSet(0, 314, 0, "A <&> \"B\"");
  panel->vfpSet(0, 13, 0, 98e6);
  panel->vfpSet(0, 14, 0, 2e6);
  publish({-60, -30, -60});
  panel->addMarker();
  panel->markerToMax();
  owner.png = {0x89, 0x50, 0x4E, 0x47};
  EXPECT_EQ(panel->base().reportHtml(),
            "<div class=\"front-panel\">\n<h2>A &lt;&amp;&gt; &quot;B&quot;</h2>\n<table>\n"
            "<tr><th>Center</th><td>98 MHz</td></tr>\n<tr><th>Span</th><td>2 MHz</td></tr>\n"
            "<tr><th>Start</th><td>97 MHz</td></tr>\n<tr><th>Stop</th><td>99 MHz</td></tr>\n"
            "<tr><th>RBW</th><td>100 kHz</td></tr>\n"
            "<tr><th>Reference level</th><td>-20 dBm</td></tr>\n"
            "<tr><th>Scale</th><td>10 dB/div</td></tr>\n</table>\n<table>\n"
            "<tr><th>Marker</th><th>Frequency</th><th>Level</th></tr>\n"
            "<tr><td>1</td><td>98 MHz</td><td>-30 dBm</td></tr>\n</table>\n"
            "<img alt=\"A &lt;&amp;&gt; &quot;B&quot;\" src=\"data:image/png;base64,iVBORw==\">\n</div>\n");
}

TEST_F(SpectrumViewTest, SavesHandOverTheFrequenciesAndLinksSayWhatTheyFind) {
  panel->vfpSet(0, 315, 0, 5);
  panel->vfpSet(0, 13, 0, 98e6);
  owner.take();
  EXPECT_EQ(panel->vfpOp(0, 9, {}), 0);
  EXPECT_EQ(panel->vfpOp(0, 13, 77), 0);
  EXPECT_EQ(panel->vfpOp(0, 13, "x"), -8);
  EXPECT_EQ(owner.take(), (Messages{"saveDisplaySettings 5 0", "saveSetup 77 5 0"}));
  EXPECT_NE(std::find(owner.kept.begin(), owner.kept.end(), PanelSetting{13, 98e6}), owner.kept.end());
  clsBaseVFP& base = panel->base();
  Variant types;
  EXPECT_EQ(base.measurementInfo(types), 0);
  EXPECT_EQ(types, Variant(Variant::Int32s{25}));
  EXPECT_EQ(base.initializeLinkValue(3, 13), Variant(98e6));
  EXPECT_TRUE(base.actionEnabled(1) && base.actionEnabled(9));
  clearMessages();
  EXPECT_TRUE(base.initializeLinkValue(3, 99).isEmpty());
  EXPECT_TRUE(base.initializeLinkValue(1, 13).isEmpty());
  for (const std::int16_t type : {std::int16_t{1}, std::int16_t{2}, std::int16_t{3}, std::int16_t{4}})
    base.frontPanelLink({type, 99, true, true, true});
  base.frontPanelLink({2, 1, true, true, true});
  const std::string name = "SpectrumView::";
  EXPECT_EQ(messages(), (Messages{name + "initializeLinkValue() ... unhandled parameter\r",
                                  name + "initializeLinkValue()...unsupported link type\r",
                                  name + "frontPanelLink() ... unhandled result\r",
                                  name + "frontPanelLink() ... unhandled action\r",
                                  name + "frontPanelLink() ... unhandled parameter\r",
                                  name + "frontPanelLink()...unrecognized link type\r",
                                  "I don't know how to invoke close yet!\r"}));
  panel->vfpSet(0, 322, 0, 1);
  EXPECT_FALSE(base.actionEnabled(1));
}

TEST_F(SpectrumViewTest, OperationTenTakesOnlyTheNumberTen) {
  for (const Variant& wrong : {Variant(9), Variant("ten"), Variant()})
    EXPECT_EQ(panel->vfpOp(0, 10, wrong), -8);
  EXPECT_EQ(panel->base().traceManager().activeTrace(), nullptr);
  EXPECT_EQ(panel->vfpOp(0, 10, "10"), 0);
  EXPECT_NE(panel->base().traceManager().find(25), nullptr);
}

TEST_F(SpectrumViewTest, AxesShowTheFrequencyPlanAndTheLevelsDownFromTheReference) {
  EXPECT_EQ(panel->vfpSet(0, 13, 0, 98e6), 0);
  EXPECT_EQ(panel->vfpSet(0, 14, 0, 20e6), 0);
  publish({-30, -50, -40});
  for (const char* label : {"88 MHz", "108 MHz", "2 MHz/div", "-20", "-120"})
    EXPECT_TRUE(shows(label)) << label;
  gdi.clear();
  EXPECT_EQ(panel->vfpSet(0, 13, 0, 100e6), 0);
  EXPECT_EQ(panel->vfpSet(0, 717, 0, 0), 0);
  EXPECT_EQ(panel->vfpSet(0, 716, 0, 5), 0);
  panel->Paint();
  for (const char* label : {"90 MHz", "0", "-50"}) EXPECT_TRUE(shows(label)) << label;
  for (const char* label : {"88 MHz", "-120"}) EXPECT_FALSE(shows(label)) << label;
  EXPECT_EQ(panel->vfpSet(0, 13, 0, 100.001e6), 0);
  EXPECT_EQ(panel->vfpSet(0, 14, 0, 4e6), 0);  // narrow enough for a third decimal
  panel->Paint();
  EXPECT_TRUE(shows("98.001 MHz"));
  EXPECT_EQ(panel->vfpSet(0, 14, 0, 10e6), 0);
  EXPECT_EQ(panel->vfpSet(0, 13, 0, 5.998e9), 0);  // the stop entry ends at 6 GHz, the sweep does not
  publish({-30, -50, -40});
  for (const char* label : {"5993 MHz", "6003 MHz"}) EXPECT_TRUE(shows(label)) << label;
}

TEST_F(SpectrumViewTest, CodesOfOthersAreAcceptedAndValuesThatAreNoNumberPassedOver) {
  const PanelSettings before = panel->base().settings();
  for (const auto code : std::initializer_list<std::int16_t>{11, 15, 18})
    EXPECT_EQ(panel->vfpSet(0, code, 0, 5), 0) << code;
  for (const Variant& value : {Variant("abc"), Variant::null(), Variant(std::nan(""))}) {
    EXPECT_EQ(panel->vfpSet(0, 13, 0, value), 0);
    EXPECT_EQ(panel->vfpSet(0, 14, 0, value), 0);
  }
  EXPECT_EQ(panel->base().settings(), before);
  EXPECT_TRUE(messages().empty());
  EXPECT_EQ(panel->vfpSet(0, 312, 0, "abc"), -8);  // the base's own
}

TEST_F(SpectrumViewTest, ClosedPanelIgnoresSweepsAndTheHost) {
  EXPECT_EQ(panel->vfpOp(0, 1, {}), 0);
  publish({-30, -50, -40});
  EXPECT_EQ(panel->vfpOp(0, 10, 9), 0);
  EXPECT_EQ(panel->vfpSet(0, 312, 0, "abc"), 0);
  EXPECT_EQ(panel->base().traceManager().activeTrace(), nullptr);
  EXPECT_TRUE(messages().empty());
}

TEST_F(SpectrumViewTest, MarkerGoesToTheLargestValueAndArrowsWalkItAndKeepItInSight) {
  publish({-30, -50, -20, -40});
  panel->addMarker();
  panel->markerToMax();
  const auto point = [this] { return panel->base().traceManager().activeTrace()->activeMarker()->point; };
  EXPECT_EQ(point(), 2);
  panel->KeyDown(37, 0);
  EXPECT_EQ(point(), 1);
  panel->KeyDown(65, 0);
  EXPECT_EQ(point(), 1);
  for (int i = 0; i < 4; ++i) panel->KeyDown(39, 0);
  gdi.clear();
  panel->KeyDown(39, 0);
  EXPECT_EQ(point(), 4);  // one past the last value
  EXPECT_TRUE(shows("1"));
}

TEST_F(SpectrumViewTest, MarkerCommandsWithNothingToMarkOrMoveDoNothing) {
  const auto pressAll = [this] {
    panel->markerToMax();
    panel->markerToMin();
    panel->KeyDown(39, 0);
  };
  panel->addMarker();
  pressAll();
  panel->vfpOp(0, 10, 10);  // a trace object that has no trace yet
  panel->addMarker();
  EXPECT_EQ(panel->base().traceManager().activeTrace()->activeMarker(), nullptr);
  publish({-30, -50, -40});
  pressAll();
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(SpectrumViewTest, ChangedConfigurationNamesWhatItCannotSetUp) {
  class Other : public clsMultiTracePainter {
   public:
    using clsMultiTracePainter::clsMultiTracePainter;
  };
  const std::string failed = "SpectrumView::changedTraceConfiguration() failed ... ";
  clsTraceManager& traces = panel->base().traceManager();
  float count = 0;
  traces.ListTraceTypes(ResultTypeRecord(28), count);
  traces.addTraceObject(std::make_shared<Other>(gdi), 0);
  traces.addTraceObject(std::make_shared<Other>(gdi), 106);
  traces.addTraceObject(std::make_shared<Other>(gdi), 9999);
  EXPECT_EQ(messages(),
            (Messages{failed + "null trace\r", failed + "missing result type\r",
                      failed + "unhandled result type\r", failed + "unrecognized result type\r"}));
}

TEST_F(SpectrumViewTest, EveryGraphicsCallMayFailAndTheNextSweepIsWhole) {
  publish({-30, -50, -40});
  panel->addMarker();
  gdi.clear();
  panel->Form_Resize();
  const std::vector<int> failing = gdi.callsThatMayFail();
  for (const int n : failing) {
    gdi.failNthCall(n);
    panel->Form_Resize();
    gdi.failNothing();
    panel->Form_Resize();
    gdi.clear();
    publish({-30, -50, -40});
    ASSERT_EQ(traceLines().size(), 1U) << "after failing call " << n;
    ASSERT_EQ(gdi.blits().size(), 1U) << "after failing call " << n;
  }
}

}  // namespace
}  // namespace frontpanels::testing

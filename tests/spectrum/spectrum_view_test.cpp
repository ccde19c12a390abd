#include "spectrum/spectrum_view.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <numeric>

#include "framework/panel/base_vfp.h"
#include "painters/multi_trace_painter.h"
#include "spectrum/frequency_plan.h"
#include "tests/support/fake_surface.h"
#include "tests/support/recording_gdi.h"
#include "tests/support/recording_owner.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels::testing {
namespace {

using Messages = std::vector<std::string>;

// A view of 800 x 600 pixels: the graph is 760 x 570 at (20, 15).
class SpectrumViewTest : public ReportingTest {
 protected:
  SpectrumViewTest() {
    view.dc = gdi.viewDc();
    panel = std::make_unique<SpectrumView>(PanelEnvironment{gdi, windowing, view, hub, {15, 15}, ""}, owner,
                                           owner);
    panel->Form_Resize();
    gdi.clear();
  }
  ~SpectrumViewTest() override {
    panel.reset();
    EXPECT_EQ(gdi.liveObjects(), 0);
    EXPECT_EQ(gdi.liveDcs(), 0);
    EXPECT_EQ(gdi.violations(), std::vector<std::string>{});
  }

  void publish(const std::vector<float>& levels) {
    hub.publish(SpectrumView::kSpectrumPath, std::span(levels));
  }
  [[nodiscard]] bool shows(std::string_view text) const {
    const std::vector<Call> all = gdi.texts();
    return std::any_of(all.begin(), all.end(), [text](const Call& call) { return call.text == text; });
  }
  // The trace's poly-lines: in the colour of trace 0.
  [[nodiscard]] std::vector<Call> traceLines() const {
    std::vector<Call> lines = gdi.polylines();
    std::erase_if(lines, [](const Call& line) { return line.pen.color != rgb(50, 156, 50); });
    return lines;
  }

  RecordingGdi gdi;
  FakeWindowing windowing;
  FakeGraphView view;
  DataHub hub;
  RecordingOwner owner;
  std::unique_ptr<SpectrumView> panel;
};

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
  EXPECT_EQ(panel->vfpSet(0, 13, 0, 5.998e9), 0);  // 10 MHz round it would end at 6003 MHz
  publish({-30, -50, -40});
  gdi.clear();
  publish({-30, -50, -40});  // a sweep keeps the axis that the limit cut off
  EXPECT_TRUE(shows("5993 MHz"));
  EXPECT_TRUE(shows("6000 MHz"));
}

TEST_F(SpectrumViewTest, CodesOfOthersAreAcceptedAndValuesThatAreNoNumberPassedOver) {
  const FrequencyPlan before = panel->frequencyPlan();
  for (const auto code : std::initializer_list<std::int16_t>{11, 15, 18})
    EXPECT_EQ(panel->vfpSet(0, code, 0, 5), 0) << code;
  for (const Variant& value : {Variant("abc"), Variant::null(), Variant(std::nan(""))}) {
    EXPECT_EQ(panel->vfpSet(0, 13, 0, value), 0);
    EXPECT_EQ(panel->vfpSet(0, 14, 0, value), 0);
  }
  EXPECT_EQ(panel->frequencyPlan(), before);
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

#include "framework/panel/base_vfp.h"

#include <gtest/gtest.h>

#include "tests/support/fake_panel_control.h"
#include "tests/support/fake_surface.h"
#include "tests/support/fake_trace_object.h"
#include "tests/support/recording_gdi.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels::testing {
namespace {

using Messages = std::vector<std::string>;

class BaseVfpTest : public ReportingTest {
 protected:
  BaseVfpTest() { control.dc = gdi.viewDc(); }

  std::int32_t set(std::int16_t parameterType, const Variant& value) {
    return base.vfpSet(0, parameterType, 0, value);
  }
  std::int32_t op(std::int16_t operation, const Variant& parameter = {}) {
    return base.vfpOp(0, operation, parameter);
  }

  RecordingGdi gdi;
  FakeWindowing windowing;
  FakeGraphView view;
  DataHub hub;
  FakePanelControl control;
  clsBaseVFP base{{gdi, windowing, view, hub, {15, 15}, ""}, control};
};

TEST_F(BaseVfpTest, NumbersAreStoredFromAnythingThatReadsAsOneElseReportedAndUnchanged) {
  struct Row {
    std::int16_t code;
    Variant number;
    const char* name;
  };
  const Row rows[] = {{43, " 0.25 ", "TIME_MEASUREMENT_PERIOD"},
                      {44, std::int16_t{3}, "TIME_DATABASE_PERIOD"},
                      {45, 4.0F, "TIME_DISPLAY_PERIOD"},
                      {312, 2.5, "PARM_MEASUREMENT_ID"},
                      {315, "12", "PARM_RESOURCE_ID"}};
  for (const Row& row : rows) {
    EXPECT_FALSE(base.resourceIdValid());
    EXPECT_EQ(set(row.code, row.number), 0);
    clearMessages();
    EXPECT_EQ(set(row.code, "abc"), -8);
    EXPECT_EQ(messages(), Messages{std::string("clsBaseVFP::vfpSet() ") + row.name + " must be numeric\r"});
  }
  clearMessages();
  EXPECT_EQ(set(312, 1e10), -8);
  EXPECT_EQ(messages(), Messages{"clsBaseVFP::vfpSet() ... \rOverflow"});
  EXPECT_TRUE(base.resourceIdValid());
  EXPECT_EQ(base.resourceId(), 12);
  EXPECT_EQ(base.measurementId(), 2);  // halves to even
  EXPECT_EQ(base.measurementPeriod(), 0.25);
  EXPECT_EQ(base.databasePeriod(), 3.0);
  EXPECT_EQ(base.displayPeriod(), 4.0);
}

TEST_F(BaseVfpTest, UnknownOperationsAnswerMinusOneAndUnhandledParametersAreReportedOnRequest) {
  for (const int operation : {-32768, -1, 0, 2, 8, 16, 20, 22, 16383, 16384, 32767})
    EXPECT_EQ(op(static_cast<std::int16_t>(operation)), -1) << operation;
  EXPECT_EQ(set(9999, 1), 0);
  EXPECT_TRUE(messages().empty());
  base.warnOnUnhandledParameters = true;
  EXPECT_EQ(set(9999, 1), 0);
  EXPECT_EQ(messages(), Messages{"SpectrumView::vfpSet() ... unhandled parameterType = 9999\r"});
}

TEST_F(BaseVfpTest, ShowingHidesNormalisesAndShowsAWindowThatThePanelOwns) {
  EXPECT_EQ(set(314, "Receiver 1"), 0);
  EXPECT_EQ(base.frontPanelCaption(), "Receiver 1");
  EXPECT_EQ(op(12), 0);
  EXPECT_EQ(control.calls, (Messages{"Caption Receiver 1", "ViewVisible off", "ViewState 0", "ViewVisible on",
                                     "refreshControls", "refreshMenuItems", "Caption Receiver 1"}));
  EXPECT_TRUE(base.saved());
  base.windowOwner = false;
  control.calls.clear();
  op(12);
  EXPECT_EQ(control.calls.front(), "refreshControls");
}

TEST_F(BaseVfpTest, ClosingAsksTheHostAndAClosedPanelAnswersZeroAndChangesNothing) {
  set(315, 5);
  base.virtualFrontPanelId = 6;
  base.closeVfp();
  EXPECT_EQ(control.calls.back(), "frontPanelOp 5 6 1");
  EXPECT_TRUE(messages().empty());
  control.hostStatus = 3;
  base.closeVfp();
  EXPECT_EQ(messages(), Messages{"QUILL_VFP_CLOSE failed"});

  control.calls.clear();
  sharedPanelState().dirty = false;
  EXPECT_EQ(op(1), 0);
  EXPECT_TRUE(base.closing());
  EXPECT_TRUE(sharedPanelState().dirty);
  EXPECT_EQ(control.calls, Messages{"ViewVisible off"});
  EXPECT_EQ(op(4711), 0);
  EXPECT_EQ(set(312, "abc"), 0);
  EXPECT_EQ(set(315, 7), 0);
  EXPECT_EQ(base.resourceId(), 5);
  EXPECT_EQ(messages().size(), 1U);
}

TEST_F(BaseVfpTest, AxisCodesReachTheActivePainterAndNeedOne) {
  EXPECT_EQ(set(714, 1), -8);
  EXPECT_EQ(messages(),
            Messages{"clsBaseVFP::vfpSet() ... \rObject variable or With block variable not set"});
  Messages log;
  base.traceManager().addTraceObject(std::make_shared<FakeTraceObject>("clsMultiTracePainter", &log), 25);
  log.clear();
  EXPECT_EQ(set(714, 2), 0);
  EXPECT_EQ(set(716, 0.1F), 0);  // through text: 0.1, not the 0.100000001 of single precision
  EXPECT_EQ(set(717, -20), 0);
  EXPECT_EQ(set(719, 1), 0);
  EXPECT_EQ(set(722, true), 0);
  EXPECT_EQ(log, (Messages{"25 xAxisStyle 2", "25 verticalResolution 0.100000", "25 gridScaleTop -20.000000",
                           "25 yAxisStyle 1", "25 setAutoScale on"}));
  EXPECT_EQ(op(10, "x"), -8);
  EXPECT_EQ(op(10, 25), 0);
  EXPECT_EQ(op(11, 25), 0);
  EXPECT_EQ(base.traceManager().activeTrace(), nullptr);
}

// Twips in, pixels out: 15 twips a pixel. The margin is the larger of 0.025 of the length and four pen
// widths.
TEST_F(BaseVfpTest, TheAreasLieAgainstTheEdgesAndTheGraphInsideMarginsOfWhatTheyLeave) {
  FakeSideArea right(3000, 100);
  FakeSideArea bottom(100, 1500);
  control.right = &right;
  control.bottom = &bottom;
  base.Resize();
  EXPECT_EQ(bottom.place, (FakeSideArea::Place{0, 7500, 12000, 1500}));
  EXPECT_EQ(right.place, (FakeSideArea::Place{9000, 0, 3000, 7500}));
  EXPECT_EQ(control.widthMark, 9000.0F);
  EXPECT_EQ(control.heightMark, 7500.0F);
  EXPECT_TRUE(messages().empty());
  const auto graph = [this] { return base.traceManager().drawingAreaPx(); };
  base.setDrawingArea();
  // Width 9000: margin 225 twips = 15 pixels. Height 7500: margin 187.5 twips = 12.5 pixels.
  EXPECT_EQ(graph(), (PanelArea{15, 12.5, 570, 475}));

  base.rightPanelVisible(false);
  base.bottomPanelVisible(false);
  EXPECT_FALSE(right.visible);
  EXPECT_FALSE(bottom.visible);
  EXPECT_EQ(graph(), (PanelArea{20, 15, 760, 570}));
  control.drawWidth = 10;  // 4 x 10 pixels
  base.setDrawingArea();
  EXPECT_EQ(graph(), (PanelArea{40, 40, 720, 520}));
  EXPECT_EQ(control.calls.back(), "ViewRefresh");

  control.scaleWidth = 3;
  control.scaleHeight = 0;
  control.drawWidth = 0;
  base.setDrawingArea();  // at least 10 twips, less two margins of 0.25
  EXPECT_FLOAT_EQ(graph().width, 9.5F / 15.0F);
  EXPECT_FLOAT_EQ(graph().height, 9.5F / 15.0F);

  control.scaleMode = right.scaleMode = bottom.scaleMode = ScaleMode::Pixels;
  base.Resize();
  EXPECT_EQ(messages(),
            (Messages{"clsBaseVFP::Resize() ... SpectrumView.ScaleMode should be vbTwips\r",
                      "clsBaseVFP::Resize() ... SpectrumView.ControlPanel.ScaleMode should be vbTwips\r",
                      "clsBaseVFP::Resize() ... SpectrumView.DisplayPanel.ScaleMode should be vbTwips\r"}));
}

}  // namespace
}  // namespace frontpanels::testing

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

TEST_F(BaseVfpTest, UnknownOperationsAnswerMinusOne) {
  for (const int operation : {-32768, -1, 0, 2, 8, 16, 20, 22, 16383, 16384, 32767})
    EXPECT_EQ(op(static_cast<std::int16_t>(operation)), -1) << operation;
}

TEST_F(BaseVfpTest, IdentityAndPeriodsAreStoredFromAnythingThatReadsAsANumber) {
  EXPECT_EQ(set(315, "12"), 0);
  EXPECT_TRUE(base.resourceIdValid());
  EXPECT_EQ(base.resourceId(), 12);
  EXPECT_EQ(set(312, 2.5), 0);
  EXPECT_EQ(base.measurementId(), 2);  // halves to even
  EXPECT_EQ(set(43, " 0.25 "), 0);
  EXPECT_EQ(set(44, std::int16_t{3}), 0);
  EXPECT_EQ(set(45, 4.0F), 0);
  EXPECT_EQ(base.measurementPeriod(), 0.25);
  EXPECT_EQ(base.databasePeriod(), 3.0);
  EXPECT_EQ(base.displayPeriod(), 4.0);
}

TEST_F(BaseVfpTest, ValuesThatAreNoNumberAreReportedAndChangeNothing) {
  struct Row {
    std::int16_t code;
    const char* message;
  };
  const Row rows[] = {
      {43, "clsBaseVFP::vfpSet() TIME_MEASUREMENT_PERIOD must be numeric\r"},
      {44, "clsBaseVFP::vfpSet() TIME_DATABASE_PERIOD must be numeric\r"},
      {45, "clsBaseVFP::vfpSet() TIME_DISPLAY_PERIOD must be numeric\r"},
      {312, "clsBaseVFP::vfpSet() PARM_MEASUREMENT_ID must be numeric\r"},
      {315, "clsBaseVFP::vfpSet() PARM_RESOURCE_ID must be numeric\r"},
  };
  set(312, 7);
  for (const Row& row : rows) {
    clearMessages();
    EXPECT_EQ(set(row.code, "abc"), -8);
    EXPECT_EQ(messages(), Messages{row.message});
  }
  EXPECT_EQ(base.measurementId(), 7);
  EXPECT_FALSE(base.resourceIdValid());
  EXPECT_EQ(base.measurementPeriod(), 0.0);

  clearMessages();
  EXPECT_EQ(set(312, 1e10), -8);
  EXPECT_EQ(messages(), Messages{"clsBaseVFP::vfpSet() ... \rOverflow"});
  EXPECT_EQ(base.measurementId(), 7);
}

TEST_F(BaseVfpTest, UnhandledParametersAreReportedOnRequestOnly) {
  EXPECT_EQ(set(9999, 1), 0);
  EXPECT_TRUE(messages().empty());
  base.warnOnUnhandledParameters = true;
  EXPECT_EQ(set(9999, 1), 0);
  EXPECT_EQ(messages(), Messages{"SpectrumView::vfpSet() ... unhandled parameterType = 9999\r"});
}

TEST_F(BaseVfpTest, CaptionReachesTheContainerAtOnce) {
  EXPECT_EQ(set(314, "Receiver 1"), 0);
  EXPECT_EQ(control.captions, std::vector<std::string>{"Receiver 1"});
  EXPECT_EQ(base.frontPanelCaption(), "Receiver 1");
}

TEST_F(BaseVfpTest, ShowingHidesNormalisesAndShowsAWindowThatThePanelOwns) {
  set(314, "Receiver 1");
  control.calls.clear();
  EXPECT_EQ(op(12), 0);
  EXPECT_EQ(control.calls,
            (std::vector<std::string>{"ViewVisible off", "ViewState 0", "ViewVisible on", "refreshControls",
                                      "refreshMenuItems", "Caption Receiver 1"}));
  EXPECT_TRUE(base.saved());
  base.windowOwner = false;
  control.calls.clear();
  op(12);
  EXPECT_EQ(control.calls.front(), "refreshControls");
}

TEST_F(BaseVfpTest, AfterAClosePanelAnswersZeroAndChangesNothing) {
  sharedPanelState().dirty = false;
  EXPECT_EQ(op(1), 0);
  EXPECT_TRUE(base.closing());
  EXPECT_TRUE(sharedPanelState().dirty);
  EXPECT_EQ(control.calls, std::vector<std::string>{"ViewVisible off"});
  EXPECT_EQ(op(4711), 0);
  EXPECT_EQ(set(312, "abc"), 0);
  EXPECT_EQ(set(315, 5), 0);
  EXPECT_EQ(base.resourceId(), 0);
  EXPECT_TRUE(messages().empty());
}

TEST_F(BaseVfpTest, RefusedCloseRequestIsReported) {
  set(315, 5);
  base.virtualFrontPanelId = 6;
  base.closeVfp();
  EXPECT_EQ(control.calls.back(), "frontPanelOp 5 6 1");
  EXPECT_TRUE(messages().empty());
  control.hostStatus = 3;
  base.closeVfp();
  EXPECT_EQ(messages(), Messages{"QUILL_VFP_CLOSE failed"});
}

TEST_F(BaseVfpTest, AxisCodesReachTheActivePainterAndNeedOne) {
  EXPECT_EQ(set(714, 1), -8);
  EXPECT_EQ(messages(),
            Messages{"clsBaseVFP::vfpSet() ... \rObject variable or With block variable not set"});
  std::vector<std::string> log;
  base.traceManager().addTraceObject(std::make_shared<FakeTraceObject>("clsMultiTracePainter", &log), 25);
  log.clear();
  EXPECT_EQ(set(714, 2), 0);
  EXPECT_EQ(set(716, 0.1F), 0);  // through text: 0.1, not the 0.100000001 of single precision
  EXPECT_EQ(set(717, -20), 0);
  EXPECT_EQ(set(719, 1), 0);
  EXPECT_EQ(set(722, true), 0);
  EXPECT_EQ(
      log, (std::vector<std::string>{"25 xAxisStyle 2", "25 verticalResolution 0.100000",
                                     "25 gridScaleTop -20.000000", "25 yAxisStyle 1", "25 setAutoScale on"}));
  EXPECT_EQ(op(10, "x"), -8);
  EXPECT_EQ(op(10, 25), 0);
  EXPECT_EQ(op(11, 25), 0);
  EXPECT_EQ(base.traceManager().activeTrace(), nullptr);
}

// Twips in, pixels out: 15 twips a pixel. The margin is the larger of 0.025 of the length and four pen
// widths.
TEST_F(BaseVfpTest, DrawingAreaIsWhatTheShownAreasLeaveInsideMargins) {
  control.scaleWidth = 12000;
  control.scaleHeight = 9000;
  FakeSideArea right(3000, 9000);
  FakeSideArea bottom(12000, 1500);
  control.right = &right;
  control.bottom = &bottom;
  base.setDrawingArea();
  // Width 9000: margin 225 twips = 15 pixels. Height 7500: margin 187.5 twips = 12.5 pixels.
  EXPECT_EQ(base.traceManager().drawingAreaPx(), (PanelArea{15, 12.5, 570, 475}));

  base.rightPanelVisible(false);
  base.bottomPanelVisible(false);
  EXPECT_FALSE(right.visible);
  EXPECT_FALSE(bottom.visible);
  EXPECT_EQ(base.traceManager().drawingAreaPx(), (PanelArea{20, 15, 760, 570}));

  control.drawWidth = 10;  // 4 x 10 pixels
  base.setDrawingArea();
  EXPECT_EQ(base.traceManager().drawingAreaPx(), (PanelArea{40, 40, 720, 520}));
  EXPECT_EQ(control.calls.back(), "ViewRefresh");
}

TEST_F(BaseVfpTest, TinyViewStillGivesTenTwipsBeforeMargins) {
  control.scaleWidth = 3;
  control.scaleHeight = 0;
  control.drawWidth = 0;
  base.setDrawingArea();
  // 10 twips less two margins of 0.25: 9.5 twips.
  EXPECT_FLOAT_EQ(base.traceManager().drawingAreaPx().width, 9.5F / 15.0F);
  EXPECT_FLOAT_EQ(base.traceManager().drawingAreaPx().height, 9.5F / 15.0F);
}

TEST_F(BaseVfpTest, ResizePlacesTheAreasAgainstTheEdges) {
  control.scaleWidth = 12000;
  control.scaleHeight = 9000;
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
}

TEST_F(BaseVfpTest, ResizeReportsScalesThatAreNotTwips) {
  FakeSideArea right(100, 100);
  FakeSideArea bottom(100, 100);
  control.right = &right;
  control.bottom = &bottom;
  control.scaleMode = right.scaleMode = bottom.scaleMode = ScaleMode::Pixels;
  base.Resize();
  EXPECT_EQ(messages(),
            (Messages{"clsBaseVFP::Resize() ... SpectrumView.ScaleMode should be vbTwips\r",
                      "clsBaseVFP::Resize() ... SpectrumView.ControlPanel.ScaleMode should be vbTwips\r",
                      "clsBaseVFP::Resize() ... SpectrumView.DisplayPanel.ScaleMode should be vbTwips\r"}));
}

}  // namespace
}  // namespace frontpanels::testing

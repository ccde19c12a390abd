#include "framework/panel/base_vfp.h"

#include <gtest/gtest.h>

#include <tuple>

#include "painters/multi_trace_painter.h"
#include "platform/result_writer.h"
#include "tests/support/fake_panel_control.h"
#include "tests/support/fake_surface.h"
#include "tests/support/fake_trace_object.h"
#include "tests/support/recording_gdi.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels::testing {
namespace {

using Messages = std::vector<std::string>;

// A panel of 800 x 600 pixels, 15 twips each: 12000 x 9000 twips.
struct Panel {
  explicit Panel(const PanelEnvironment& environment) : control(environment), base(environment, control) {
    control.form = &base;
  }
  std::int32_t set(std::int16_t parameterType, const Variant& value) {
    return base.vfpSet(0, parameterType, 0, value);
  }
  std::int32_t op(std::int16_t operation, const Variant& parameter = {}) {
    return base.vfpOp(0, operation, parameter);
  }
  std::vector<std::string> calls() { return control.owner().take(); }

  FakePanelControl control;
  clsBaseVFP base;
};

class BaseVfpTest : public ReportingTest {
 protected:
  BaseVfpTest() { view.dc = gdi.viewDc(); }

  std::int32_t set(std::int16_t parameterType, const Variant& value) {
    return panel.set(parameterType, value);
  }
  std::int32_t op(std::int16_t operation, const Variant& parameter = {}) {
    return panel.op(operation, parameter);
  }
  // Settings as a host sends them, each of which is taken.
  struct Code {
    int code;
    Variant value;
  };
  void take(std::initializer_list<Code> codes) {
    for (const auto& [code, value] : codes) EXPECT_EQ(set(static_cast<std::int16_t>(code), value), 0) << code;
  }
  clsMultiTracePainter& addPainter() {
    auto painter = std::make_shared<clsMultiTracePainter>(gdi);
    panel.base.traceManager().addTraceObject(painter, 25);
    return *painter;
  }
  // What the last call reported.
  Messages reported() {
    Messages texts = messages();
    clearMessages();
    return texts;
  }

  RecordingGdi gdi;
  FakeWindowing windowing;
  FakeGraphView view;
  DataHub hub;
  PanelEnvironment environment{gdi, windowing, view, hub, {15, 15}, ""};
  Panel panel{environment};
  clsBaseVFP& base = panel.base;
  FakePanelControl& control = panel.control;
};

TEST_F(BaseVfpTest, NumbersAreStoredFromAnythingThatReadsAsOneElseReportedAndUnchanged) {
  const std::tuple<std::int16_t, Variant, const char*> rows[] = {
      {43, " 0.25 ", "vfpSet() TIME_MEASUREMENT_PERIOD"},
      {44, std::int16_t{3}, "vfpSet() TIME_DATABASE_PERIOD"},
      {45, 4.0F, "vfpSet() TIME_DISPLAY_PERIOD"},
      {312, 2.5, "vfpSet() PARM_MEASUREMENT_ID"},
      {322, 0, "vfpSet() PARM_LOGGING_FLAG"},
      {704, 1, "vfpset() PARM_WINDOW_STATE"},
      {315, "12", "vfpSet() PARM_RESOURCE_ID"}};
  for (const auto& [code, number, name] : rows) {
    EXPECT_FALSE(base.resourceIdValid());
    EXPECT_EQ(set(code, number), 0);
    for (const Variant& wrong : {Variant("abc"), Variant::null(), Variant(DateValue{1})}) {
      EXPECT_EQ(set(code, wrong), -8);
      EXPECT_EQ(reported(), Messages{std::string("clsBaseVFP::") + name + " must be numeric\r"});
    }
  }
  EXPECT_EQ(set(312, 1e10), -8);
  EXPECT_EQ(reported(), Messages{"clsBaseVFP::vfpSet() ... \rOverflow"});
  EXPECT_TRUE(base.resourceIdValid());
  EXPECT_EQ(base.resourceId(), 12);
  EXPECT_EQ(base.measurementId, 2);  // halves to even
  EXPECT_EQ(base.measurementPeriod, 0.25);
  EXPECT_EQ(base.databasePeriod, 3.0);
  EXPECT_EQ(base.displayPeriod, 4.0);
}

TEST_F(BaseVfpTest, UnknownOperationsAnswerMinusOneAndUnhandledParametersAreReportedOnRequest) {
  for (const int operation : {-32768, -1, 0, 2, 8, 16, 20, 22, 16383, 16384, 32767})
    EXPECT_EQ(op(static_cast<std::int16_t>(operation)), -1) << operation;
  EXPECT_EQ(set(9999, 1), 0);
  EXPECT_EQ(reported(), Messages{});
  base.warnOnUnhandledParameters = true;
  EXPECT_EQ(set(-9999, 1), 0);
  EXPECT_EQ(reported(), Messages{"SpectrumView::vfpSet() ... unhandled parameterType = -9999\r"});
}

TEST_F(BaseVfpTest, WindowParametersActOnTheWindowOnlyWhereThePanelOwnsIt) {
  const std::tuple<std::int16_t, Variant, std::int32_t, Messages> rows[] = {
      {700, 150, 0, {"visible off", "viewState 0", "left 150"}},
      {701, "-15.5", 0, {"visible off", "viewState 0", "top -15.5"}},
      {702, 3e3, 0, {"visible off", "viewState 0", "width 3000"}},
      {703, 4e3F, 0, {"visible off", "viewState 0", "height 4000"}},
      {703, "tall", -8, {"visible off", "viewState 0"}},
      {704, 2, 0, {"viewState 2"}},
      {727, " True ", 0, {"visible on"}},
      {727, 0, 0, {"visible off"}},
  };
  for (const auto& [code, value, status, calls] : rows) {
    base.windowOwner = true;
    EXPECT_EQ(set(code, value), status) << code;
    EXPECT_EQ(panel.calls(), calls) << code;
    base.windowOwner = false;
    EXPECT_EQ(set(code, value), 0) << code;
    EXPECT_EQ(panel.calls(), Messages{}) << code;
  }
  EXPECT_EQ(reported(), Messages{"clsBaseVFP::vfpSet() ... \rType mismatch"});
}

TEST_F(BaseVfpTest, ShowingHidesNormalisesAndShowsAWindowThatThePanelOwns) {
  EXPECT_EQ(set(314, "Receiver 1"), 0);
  EXPECT_EQ(op(12), 0);
  EXPECT_EQ(panel.calls(),
            (Messages{"caption Receiver 1", "visible off", "viewState 0", "visible on", "refreshControls",
                      "refreshMenuItems", "caption Receiver 1"}));  // no status word
  EXPECT_TRUE(base.saved());
  EXPECT_EQ(set(726, 7), 0);
  EXPECT_EQ(base.Caption(), "Receiver 1");
  base.windowOwner = false;
  op(12);
  EXPECT_EQ(panel.calls(), (Messages{"refreshControls", "refreshMenuItems", "caption 7"}));
}

// Each row goes on from the one before.
TEST_F(BaseVfpTest, TheCaptionEndsInOneStatusWordByPlaybackLoggingAndSaving) {
  const std::tuple<const char*, std::function<void()>, const char*> rows[] = {
      {"caption", [&] { set(314, "RX "); }, "RX "},
      {"unsaved", [&] { set(810, 0); }, "RX Unsaved"},
      {"saved", [&] { set(810, true); }, "RX LOG OFF"},
      {"confirmed before the flag", [&] { op(14); }, "RX LOG OFF"},
      {"flag", [&] { set(322, 5); }, "RX LOG ON"},
      {"flag off", [&] { set(322, "0"); }, "RX LOG OFF"},
      {"flag alone", [&] { set(322, 1); }, "RX LOG OFF"},  // not confirmed: the caption is left
      {"confirmed", [&] { op(14); }, "RX LOG ON"},
      {"no status", [&] { base.captionStatus = false, set(810, 0); }, "RX LOG ON"},
      {"no status, logging off", [&] { set(322, 0); }, "RX "},
      {"no status, playback", [&] { op(15); }, "RX "},
      {"playback", [&] { base.captionStatus = true, op(15); }, "RX Playback"},
      {"logging in playback", [&] { set(322, 1); }, "RX Playback"},
      {"saved is applied at once", [&] { set(810, "True"); }, "RX LOG OFF"},
      {"a word that is no boolean", [&] { set(810, "yes"); }, "RX LOG OFF"},
  };
  for (const auto& [what, step, caption] : rows) {
    step();
    EXPECT_EQ(base.Caption(), caption) << what;
  }
  EXPECT_EQ(reported(), Messages{"clsBaseVFP::vfpSet() ... \rType mismatch"});
  base.multipleMeasurementVfp = true;
  panel.calls();
  set(314, "One of many");
  EXPECT_EQ(panel.calls(), Messages{"SetCaption One of many"});
}

TEST_F(BaseVfpTest, LoggingAndPlaybackTakeTheMeasurementControlsAway) {
  FakeSideArea bottom(100, 1500);
  Control button(ControlKind::PushButton, "MarkerToCenterButton");
  control.bottom = &bottom;
  control.markerToCenter = &button;
  base.SupportsMarkerToCenter = true;
  base.checkMenuItem(901, true);  // the menu is the host's
  EXPECT_EQ(base.menuItem(901), (MenuItemState{false, true}));
  base.refreshMenuItems();
  EXPECT_TRUE(base.menuItem(901).checked);
  EXPECT_FALSE(base.menuItem(900).checked);  // no such area

  set(322, 1);
  EXPECT_FALSE(bottom.enabled || bottom.visible || base.bottomPanelVisible() || button.Enabled());
  EXPECT_TRUE(bottom.controlsEnabled);
  EXPECT_FALSE(base.menuItem(901).checked);
  panel.calls();
  set(322, 0);
  EXPECT_TRUE(bottom.enabled && base.bottomPanelEnabled());
  EXPECT_FALSE(bottom.visible);  // the user brings it back
  EXPECT_EQ(panel.calls(), (Messages{"evaluateEnablingMarkerToCenter", "caption Unsaved"}));

  base.PopUp_Click(0, 901);
  EXPECT_TRUE(bottom.visible);
  op(15);
  EXPECT_FALSE(bottom.enabled || bottom.visible || bottom.controlsEnabled);
  EXPECT_EQ(panel.calls().back(), "visible on");
  for (const std::int16_t item : {std::int16_t{1}, std::int16_t{21}, std::int16_t{1002}})
    EXPECT_FALSE(base.menuItem(item).enabled) << item;

  Panel network{environment};
  network.control.className = "frmNetworkParameters";
  network.op(15);
  EXPECT_TRUE(network.base.menuItem(21).enabled && network.base.menuItem(1002).enabled);
  EXPECT_FALSE(network.base.menuItem(1).enabled);
}

TEST_F(BaseVfpTest, MenuItemsAskTheHostOrSwitchTheAreas) {
  FakeSideArea right(3000, 100);
  control.right = &right;
  set(315, 5);
  base.virtualFrontPanelId = 6;
  const auto click = [&](std::int32_t item) {
    base.PopUp_Click(3, item);
    return panel.calls();
  };
  EXPECT_EQ(click(1), Messages{"closeVfp"});
  EXPECT_EQ(click(9), Messages{"saveVfp"});
  EXPECT_EQ(click(21), Messages{"frontPanelOp 5 6 21 True"});
  control.owner().status = 4;
  EXPECT_EQ(click(1002), Messages{"frontPanelOp 5 6 21 False"});
  EXPECT_EQ(reported(), Messages{"SpectrumView::PopUp_Click() status = 4"});
  for (const std::int32_t other : {0, 2, 902, 65537, -1}) EXPECT_EQ(click(other), Messages{}) << other;
  click(900);
  EXPECT_FALSE(right.visible || base.rightPanelVisible());
  click(900);
  EXPECT_TRUE(right.visible && base.rightPanelVisible());
  set(322, 1);
  panel.calls();
  EXPECT_EQ(click(1), Messages{});  // not while logging
}

TEST_F(BaseVfpTest, RequestsToTheHostReportRefusals) {
  set(315, 5);
  base.virtualFrontPanelId = 6;
  const std::tuple<std::function<void()>, const char*, const char*> rows[] = {
      {[&] { base.closeVfp(); }, "frontPanelOp 5 6 1", "QUILL_VFP_CLOSE failed"},
      {[&] { base.saveVfp(); }, "frontPanelOp 5 6 9", "QUILL_VFP_SAVE failed"},
      {[&] { op(9); }, "saveDisplaySettings 5 6", "SpectrumView::saveBase() status = -3"},
      {[&] { op(13, "77"); }, "saveSetup 77 5 6", "SpectrumView::saveSetup() status = -3"},
  };
  for (const auto& [ask, call, message] : rows) {
    control.owner().status = 0;
    ask();
    EXPECT_EQ(panel.calls(), Messages{call});
    EXPECT_EQ(reported(), Messages{});
    control.owner().status = -3;
    ask();
    EXPECT_EQ(reported(), Messages{message});
    panel.calls();
  }
  EXPECT_EQ(op(13, "set-up"), -8);
  EXPECT_EQ(reported(),
            Messages{"clsBaseVFP::vfpOp() ... QUILL_VFP_SAVE_SETUP requires a numeric parameter\r"});
  EXPECT_EQ(panel.calls(), Messages{});
  bool cancel = false;
  base.QueryUnload(cancel);
  EXPECT_TRUE(cancel);
  EXPECT_EQ(panel.calls(), Messages{"closeVfp"});
}

TEST_F(BaseVfpTest, AClosedPanelAnswersZeroAndChangesNothing) {
  set(315, 5);
  sharedPanelState().dirty = false;
  panel.calls();
  EXPECT_EQ(op(1), 0);
  EXPECT_TRUE(base.closing());
  EXPECT_TRUE(sharedPanelState().dirty);
  EXPECT_EQ(panel.calls(), Messages{"visible off"});
  EXPECT_EQ(base.commonBaseVfp(), nullptr);

  const std::vector<std::uint8_t> rubbish(3, 0xFF);
  std::int32_t cursor = -1;
  std::int32_t left = 99;
  EXPECT_EQ(op(4711), 0);
  EXPECT_EQ(set(312, "abc"), 0);
  EXPECT_EQ(set(315, 7), 0);
  EXPECT_EQ(base.displayData({}, rubbish, cursor, left, 0, 0), 0);
  EXPECT_EQ(base.displayParameter(312, 4), 0);
  EXPECT_EQ(base.baseVfpOp(0, 16384, 4), 0);
  EXPECT_EQ(base.baseVfpSet(0, 312, 0, 4), 0);
  base.PopUp_Click(0, 1);
  bool cancel = false;
  base.QueryUnload(cancel);
  EXPECT_FALSE(cancel);
  EXPECT_EQ(cursor, -1);
  EXPECT_EQ(base.resourceId(), 5);
  EXPECT_EQ(panel.calls(), Messages{});
  EXPECT_EQ(reported(), Messages{});
}

TEST_F(BaseVfpTest, TheReversePathReachesThePanelAndNamesTheBaseOfOneMeasurementOfMany) {
  control.answer = 3;
  EXPECT_EQ(base.baseVfpOp(8, 16383, 1), 3);
  EXPECT_EQ(base.baseVfpOp(8, 16384, 2), 3);
  EXPECT_EQ(base.baseVfpSet(8, 312, 4, "x"), 3);
  EXPECT_EQ(base.displayParameter(13, 98e6), 3);
  base.multipleMeasurementVfp = true;
  base.baseVfpOp(8, 32767, 3);
  EXPECT_EQ(panel.calls(), (Messages{"vfpOp 8 16383 1", "playbackOp 8 0 2", "vfpSet[4] 8 312 x",
                                     "vfpSet[0] 0 13 98000000", "playbackOp 8 16383 3 base"}));
  EXPECT_EQ(op(21, 0.0), 0);
  EXPECT_EQ(base.displayState(), 0);
  for (const Variant& on : {Variant(-1), Variant("off"), Variant::null()}) {
    op(21, false);
    EXPECT_EQ(op(21, on), 0);
    EXPECT_EQ(base.displayState(), 1);
  }
}

TEST_F(BaseVfpTest, PanelsOfOneWindowShareTheBottomAreaThroughTheCommonBase) {
  FakeSideArea bottom(100, 1500);
  FakeSideArea right(3000, 100);
  control.bottom = &bottom;
  control.right = &right;
  Panel other{environment};
  other.base.commonBaseVfp(&base);
  other.base.bottomPanelVisible(false);  // equal ids: its own
  EXPECT_TRUE(base.bottomPanelVisible());
  other.base.bottomPanelVisible(true);

  other.base.baseVfpID = 1;
  other.base.bottomPanelVisible(false);
  other.base.bottomPanelEnabled(false);
  other.base.rightPanelEnabled(false);
  other.base.rightPanelVisible(false);
  EXPECT_FALSE(base.bottomPanelVisible() || base.bottomPanelEnabled() || base.rightPanelEnabled());
  EXPECT_FALSE(bottom.visible || bottom.enabled || right.enabled);
  EXPECT_FALSE(other.base.bottomPanelVisible() || other.base.rightPanelEnabled());
  EXPECT_TRUE(base.rightPanelVisible() && right.visible);

  other.op(15);
  EXPECT_TRUE(base.playback);
  other.calls();
  EXPECT_EQ(other.op(1), 0);
  EXPECT_EQ(other.calls(), Messages{});  // the window is the common base's
}

TEST_F(BaseVfpTest, ReplacingWhatThePanelLivesOnIsReported) {
  base.popUpMenu(nullptr);
  base.traceManager(nullptr);
  const auto manager = std::make_shared<clsTraceManager>(TraceManagerEnvironment{gdi, windowing, {15, 15}});
  base.traceManager(manager);
  EXPECT_EQ(&base.traceManager(), manager.get());
  EXPECT_EQ(reported(),
            (Messages{"Warning...clsBaseVFP::popUpMenu() is setting v_popUpMenu\r",
                      "clsBaseVFP::traceManager() ... \rObject variable or With block variable not set",
                      "Warning...clsBaseVFP::traceManager() is setting v_traceManager\r"}));
}

TEST_F(BaseVfpTest, AxisCodesReachTheActivePainterAndNeedOne) {
  EXPECT_EQ(set(714, 1), -8);
  EXPECT_EQ(reported(),
            Messages{"clsBaseVFP::vfpSet() ... \rObject variable or With block variable not set"});
  Messages log;
  base.traceManager().addTraceObject(std::make_shared<FakeTraceObject>("clsMultiTracePainter", &log), 25);
  log.clear();
  // 716 goes through text: 0.1, not the 0.100000001 of single precision.
  take({{714, 2}, {716, 0.1F}, {717, -20}, {719, 1}, {722, true}});
  EXPECT_EQ(log, (Messages{"25 xAxisStyle 2", "25 verticalResolution 0.1", "25 gridScaleTop -20",
                           "25 yAxisStyle 1", "25 setAutoScale on"}));
  EXPECT_EQ(set(799, 0), 0);
  EXPECT_FALSE(base.CellNamingEnabled);
  EXPECT_EQ(op(10, "x"), -8);
  EXPECT_EQ(op(10, 25), 0);
  EXPECT_EQ(op(11, 25), 0);
  EXPECT_EQ(base.traceManager().activeTrace(), nullptr);
}

TEST_F(BaseVfpTest, TracesAndMarkersAreMadeByASequenceOfCodes) {
  EXPECT_EQ(set(743, 1), -8);
  EXPECT_EQ(reported(), Messages{"clsBaseVFP::vfpSet() ... marker request without a trace\r"});
  EXPECT_EQ(set(736, 40), 0);  // without a trace there is no next one
  clsMultiTracePainter& painter = addPainter();
  take({{735, 0}, {736, "300"}, {735, 2.5}});
  EXPECT_EQ(painter.findATraceByPN(0), 0);
  EXPECT_EQ(painter.findATraceByPN(300), 1);
  EXPECT_EQ(painter.traceValue(1), 2.5);
  EXPECT_EQ(painter.selectedTraceIndex(), 1);

  EXPECT_EQ(set(744, 3), -8);  // no marker was started
  EXPECT_EQ(set(740, 0), -8);
  EXPECT_EQ(reported(), (Messages{"clsBaseVFP::vfpSet() ... \rObject variable or With block variable not set",
                                  "clsBaseVFP::vfpSet() ... \rInvalid procedure call or argument"}));
  panel.calls();
  take({{740, 4}, {744, 12}, {743, 300}, {742, true}, {740, 4}, {741, "TRUE"}, {744, 15}, {743, 999}});
  ASSERT_EQ(painter.markerCollection().count(), 2U);  // PN 999 is nobody's: the selected trace
  const clsMarker& plain = *painter.markerCollection().item("4");
  const clsMarker& delta = *painter.markerCollection().item("4d");
  EXPECT_EQ(plain.point, 12);
  EXPECT_EQ(plain.deltaPartner, "4d");
  EXPECT_TRUE(plain.active && delta.DELTA);
  EXPECT_EQ(delta.point, 15);
  EXPECT_EQ(delta.traceId, 1);
  EXPECT_EQ(painter.activeMarker().get(), &plain);
  EXPECT_EQ(painter.mouseActiveMarker().get(), &plain);
  EXPECT_EQ(painter.markerCount(), 2);
  EXPECT_EQ(panel.calls(), (Messages{"delta on", "delta off"}));

  EXPECT_EQ(set(743, 300), -8);  // there is a marker of that number
  set(740, 9);
  set(741, 1);
  EXPECT_EQ(set(743, 300), -8);  // nothing to differ from
  EXPECT_EQ(painter.markerCount(), 2);
  EXPECT_EQ(set(737, 26), -8);
  EXPECT_EQ(set(737, 25), 0);
  EXPECT_EQ(reported().size(), 3U);
}

TEST_F(BaseVfpTest, WhatASaveHandsOverRestoresAnotherPanel) {
  take({{43, 0.5}, {44, 60}, {45, 2}, {705, false}, {799, false}});
  addPainter().numberOfTraces(1);
  take({{714, 3}, {719, 1}, {716, 2.5}, {717, -17}, {722, true}, {740, 2}, {744, 30}, {743, 0}});
  take({{740, 1}, {744, 7}, {743, 0}, {742, 1}, {740, 2}, {741, true}, {744, 9}, {743, 0}});
  op(9);
  const PanelSettings kept = control.owner().kept;
  EXPECT_EQ(kept.front(), (PanelSetting{43, 0.5}));
  EXPECT_EQ(kept.back(), (PanelSetting{9000, "own"}));
  EXPECT_EQ(kept.size(), 6U + 5U + 3U + 4U + 4U + 1U);

  Panel fresh{environment};
  const auto painter = std::make_shared<clsMultiTracePainter>(gdi);  // before its first values
  fresh.base.traceManager().addTraceObject(painter, 25);
  for (const PanelSetting& setting : kept) EXPECT_EQ(fresh.set(setting.parameterType, setting.value), 0);
  EXPECT_EQ(fresh.base.settings(), kept);
  EXPECT_EQ(fresh.base.databasePeriod, 60.0);
  EXPECT_EQ(painter->activeMarker()->id, "1");
  EXPECT_EQ(painter->markerCollection().item("2d")->point, 9);
  EXPECT_EQ(reported(), Messages{});
}

TEST_F(BaseVfpTest, WhatConcernsTheControlIsPassedOn) {
  Variant types;
  base.frontPanelLink({1, 25, true, false, true});
  EXPECT_EQ(base.measurementInfo(types), 0);
  EXPECT_EQ(types, Variant(Variant::Int32s{25}));
  EXPECT_EQ(base.frontPanelOp(1, 2, 3, 4), 0);
  EXPECT_EQ(base.frontPanelSet(1, 2, 3, 4, 5.5), 0);
  EXPECT_EQ(panel.calls(),
            (Messages{"frontPanelLink 25", "frontPanelOp 1 2 3 4", "frontPanelSet 1 2 3 4 5.5"}));
  EXPECT_EQ(base.activeControlLink() + base.reportHtml() + base.linkSourceName(), "SPAN<p>source");
  EXPECT_EQ(base.initializeLinkValue(3, 13), Variant(7));
  EXPECT_TRUE(base.actionEnabled(9));
  EXPECT_FALSE(base.actionEnabled(1));
}

// --- Result buffers

class DisplayDataTest : public BaseVfpTest {
 protected:
  // Records of type 25 with one Int32 each, and one of 99 with two.
  static std::vector<std::uint8_t> buffer(std::int32_t measurementId = 2) {
    ResultWriter writer;
    writer.HardwareId(5);
    writer.BeginMeasurement(measurementId);
    writer.BeginSubMeasurement(1);
    for (const std::int32_t value : {10, 11}) {
      writer.BeginRecord(25);
      writer.Int32(value);
      writer.EndRecord();
    }
    writer.BeginRecord(99);
    writer.Int32(12);
    writer.Int32(13);
    writer.EndRecord();
    writer.EndSubMeasurement();
    writer.EndMeasurement();
    return writer.Bytes();
  }
  std::int32_t display(const std::vector<std::uint8_t>& bytes) {
    dataPointer = 0;
    dataCount = static_cast<std::int32_t>(bytes.size());
    return base.displayData({}, bytes, dataPointer, dataCount, 0, 0);
  }

  std::int32_t dataPointer = 0;
  std::int32_t dataCount = 0;
};

TEST_F(DisplayDataTest, EveryRecordReachesThePanelAndUnreadOnesAreSteppedOver) {
  const std::string panelName = "SpectrumView::DisplayData() ... ";
  const std::pair<int, Messages> rows[] = {{2, {}},
                                           {1, {panelName + "partial data read for result type 99\r"}},
                                           {0, {panelName + "no data read for result type 99\r"}}};
  base.measurementId = 2;
  for (const auto& [readsOf99, texts] : rows) {
    Messages values;
    control.readResult = [&values, reads = readsOf99](std::int32_t type, ResultReader& reader) {
      for (int i = 0; i < (type == 25 ? 1 : reads); ++i)
        values.push_back(std::to_string(reader.GetMeasurementInt32()));
    };
    EXPECT_EQ(display(buffer()), 0) << readsOf99;
    EXPECT_EQ(values.size(), 2U + static_cast<std::size_t>(readsOf99));
    EXPECT_EQ(values[1], "11") << readsOf99;
    EXPECT_EQ(dataCount, 0) << readsOf99;
    EXPECT_EQ(dataPointer, static_cast<std::int32_t>(buffer().size())) << readsOf99;
    EXPECT_EQ(reported(), texts) << readsOf99;
  }
  control.readResult = nullptr;
  base.multipleMeasurementVfp = true;
  panel.calls();
  display(buffer());
  EXPECT_EQ(panel.calls().front(), "resultData 25 base");
  EXPECT_EQ(reported().front(), panelName + "no data read for result type Spectrum\r");
}

TEST_F(DisplayDataTest, AnotherReceiversBufferIsRefusedOnceTheResourceIsKnownAnotherMeasurementReported) {
  control.readResult = [](std::int32_t, ResultReader& reader) {
    reader.SkipMeasurementData(reader.PeekMeasurementTypeId() == 12 ? 8 : 4);
  };
  base.measurementId = 2;
  EXPECT_EQ(display(buffer()), 0);
  set(315, 4);
  panel.calls();
  EXPECT_EQ(display(buffer()), -8);
  EXPECT_EQ(panel.calls(), Messages{});
  EXPECT_EQ(reported(), Messages{"clsBaseVFP::displayData() ... wrong resource id\r"});
  set(315, 5);
  EXPECT_EQ(display(buffer(3)), 0);
  EXPECT_EQ(panel.calls().size(), 3U);  // shown all the same
  EXPECT_EQ(reported(), Messages{"clsBaseVFP::displayData() ... wrong measurement id\r"});
}

TEST_F(DisplayDataTest, ABufferThatLiesAboutItselfEndsInAReport) {
  base.measurementId = 2;
  control.readResult = [](std::int32_t, ResultReader& reader) { reader.SkipMeasurementData(4); };
  const Messages outside{"clsBaseVFP::displayData() ... \rSubscript out of range"};
  const std::vector<std::uint8_t> good = buffer();
  for (std::size_t size = 0; size + 20 < good.size(); ++size) {  // the two records of 25 are whole after that
    EXPECT_EQ(display({good.begin(), good.begin() + static_cast<std::ptrdiff_t>(size)}), -8) << size;
    EXPECT_EQ(reported(), outside) << size;
  }
  for (const auto& [cursor, left] : std::vector<std::pair<std::int32_t, std::int32_t>>{
           {-1, 4}, {0, -1}, {0, 999}, {999, 0}, {8, 2147483647}}) {
    dataPointer = cursor;
    dataCount = left;
    EXPECT_EQ(base.displayData({}, good, dataPointer, dataCount, 0, 0), -8);
    EXPECT_EQ(dataPointer, cursor);
    EXPECT_EQ(dataCount, left);
    EXPECT_EQ(reported(), outside);
  }
  constexpr std::size_t kLengthAt = 16;  // four ids before the first record's length
  for (const std::int16_t length : {std::int16_t{-1}, std::int16_t{-32768}, std::int16_t{32767}}) {
    std::vector<std::uint8_t> lying = good;
    lying[kLengthAt] = static_cast<std::uint8_t>(length);
    lying[kLengthAt + 1] = static_cast<std::uint8_t>(length >> 8);
    EXPECT_EQ(display(lying), -8) << length;
    EXPECT_EQ(reported(), outside) << length;
  }
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
  EXPECT_EQ(control.InvisibleWidthMarkX1(), 9000.0F);
  EXPECT_EQ(control.InvisibleHeightMarkY1(), 7500.0F);
  EXPECT_EQ(reported(), Messages{});
  const auto graph = [this] { return base.traceManager().drawingAreaPx(); };
  base.setDrawingArea();
  // Width 9000: margin 225 twips = 15 pixels. Height 7500: margin 187.5 twips = 12.5 pixels.
  EXPECT_EQ(graph(), (PanelArea{15, 12.5, 570, 475}));

  set(706, false);
  set(705, false);
  EXPECT_FALSE(right.visible || bottom.visible);
  EXPECT_EQ(graph(), (PanelArea{20, 15, 760, 570}));
  control.ViewDrawWidth(10);  // 4 x 10 pixels
  base.setDrawingArea();
  EXPECT_EQ(graph(), (PanelArea{40, 40, 720, 520}));
  EXPECT_EQ(panel.calls().back(), "ViewRefresh");

  view.sizePx = {0, 0};
  control.ViewDrawWidth(1);
  base.setDrawingArea();  // at least 10 twips, less two margins of four pixels
  EXPECT_EQ(graph(), (PanelArea{4, 4, 10.0F / 15.0F - 8.0F, 10.0F / 15.0F - 8.0F}));

  clearMessages();
  control.ViewScaleMode(3);
  right.scaleMode = bottom.scaleMode = ScaleMode::Pixels;
  base.Resize();
  const Messages scales(messages().begin(), messages().begin() + 3);
  EXPECT_EQ(scales,
            (Messages{"clsBaseVFP::Resize() ... SpectrumView.ScaleMode should be vbTwips\r",
                      "clsBaseVFP::Resize() ... SpectrumView.ControlPanel.ScaleMode should be vbTwips\r",
                      "clsBaseVFP::Resize() ... SpectrumView.DisplayPanel.ScaleMode should be vbTwips\r"}));
}

}  // namespace
}  // namespace frontpanels::testing

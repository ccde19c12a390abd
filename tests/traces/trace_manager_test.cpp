#include "traces/trace_manager.h"

#include <gtest/gtest.h>

#include "tests/support/fake_surface.h"
#include "tests/support/fake_trace_object.h"
#include "tests/support/recording_gdi.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels::testing {
namespace {

constexpr float kTwipsPerPixel = 15.0F;
using Messages = std::vector<std::string>;
using Log = std::vector<std::string>;
using Configuration = FakeTraceForm::Configuration;

// An area of 400 x 200 pixels at (20, 10) of the view.
class TraceManagerTest : public ReportingTest {
 protected:
  TraceManagerTest() {
    form.dc = gdi.viewDc();
    form.scaleWidth = form.useableWidth = 800 * kTwipsPerPixel;
    form.scaleHeight = form.useableHeight = 600 * kTwipsPerPixel;
    for (FontHandle& font : fonts) font = gdi.createFont({"Arial", ++fontHeight, 400, false});
    manager = std::make_unique<clsTraceManager>(
        TraceManagerEnvironment{gdi, windowing, {kTwipsPerPixel, kTwipsPerPixel}, fonts});
    manager->setForm(&form);
    manager->drawingArea(20 * kTwipsPerPixel, 10 * kTwipsPerPixel, 400 * kTwipsPerPixel,
                         200 * kTwipsPerPixel);
    manager->setShadowDC();
  }

  std::shared_ptr<FakeTraceObject> add(std::int16_t resultType,
                                       const char* className = "clsMultiTracePainter") {
    auto traceObject = std::make_shared<FakeTraceObject>(className, &log);
    manager->addTraceObject(traceObject, resultType);
    return traceObject;
  }
  // Presses, moves and releases are given in pixels of the off-screen surface.
  void press(float x, float y, std::int16_t operation) {
    manager->MouseDown(1, 0, (x + 20) * kTwipsPerPixel, (y + 10) * kTwipsPerPixel, operation);
  }
  void press(float x, float y) {
    manager->MouseDown(1, 0, (x + 20) * kTwipsPerPixel, (y + 10) * kTwipsPerPixel);
  }
  void move(float x, float y) {
    manager->MouseMove(1, 0, (x + 20) * kTwipsPerPixel, (y + 10) * kTwipsPerPixel);
  }
  [[nodiscard]] static std::vector<std::string> ids(FakeTraceObject& traceObject) {
    std::vector<std::string> result;
    for (const MarkerPointer& marker : traceObject.markerCollection()) result.push_back(marker->id);
    return result;
  }

  std::int32_t fontHeight = 10;
  RecordingGdi gdi;
  FakeWindowing windowing;
  FakeTraceForm form;
  LabelFontHandles fonts;
  Log log;
  std::unique_ptr<clsTraceManager> manager;
};

TEST_F(TraceManagerTest, SurfaceIsMadeInOrderAndGivenBackWhenTheManagerGoes) {
  gdi.clear();
  manager->setShadowDC();
  Log order;
  for (const Call& call : gdi.calls())
    if (call.name != "textExtent") order.push_back(call.name);
  // Put back pen, brush, font, bitmap; delete bitmap and context; then make, select and fill anew. The two
  // pairs of selections at the end measure the other label fonts.
  const Log expected = {"selectObject", "selectObject", "selectObject",       "selectObject",
                        "deleteObject", "deleteDC",     "createCompatibleDC", "createCompatibleBitmap"};
  EXPECT_EQ(Log(order.begin(), order.begin() + 8), expected);
  EXPECT_EQ(gdi.bitmapSize(manager->shadowDC()), (Size{400, 200}));
  EXPECT_EQ(gdi.fills().back().rect, (Rect{0, 0, 400, 200}));
  EXPECT_EQ(gdi.fills().back().brush.color, rgb(240, 240, 240));
  EXPECT_EQ(gdi.pen(manager->shadowDC()).color, rgb(0, 0, 0));
  EXPECT_EQ(gdi.font(manager->shadowDC()).emHeightPx, 11);  // the first of the four
  EXPECT_EQ(manager->maxFontWidth(), 8.0F);
  EXPECT_EQ(manager->maxFontHeight(), 12.0F);

  manager.reset();
  EXPECT_EQ(gdi.liveDcs(), 0);
  EXPECT_EQ(gdi.liveObjects(), 4);  // the fonts are the owner's
  EXPECT_TRUE(gdi.violations().empty());
}

TEST_F(TraceManagerTest, HalfPixelSizesOfTheSurfaceRoundToEven) {
  manager->drawingArea(0, 0, 100.5F * kTwipsPerPixel, 101.5F * kTwipsPerPixel);
  manager->setShadowDC();
  EXPECT_EQ(gdi.bitmapSize(manager->shadowDC()), (Size{100, 102}));
}

TEST_F(TraceManagerTest, MissingDeviceContextIsReportedTwiceAndAMissingBitmapNotAtAll) {
  gdi.failNth("createCompatibleDC", 1);
  manager->setShadowDC();
  EXPECT_EQ(messages(), (Messages{"clsTraceManager::setShadowDC CreateCompatibleDC failed\r",
                                  "clsTraceManager::setShadowDC CreateCompatibleBitmap failed\r"}));
  clearMessages();
  gdi.failNth("createCompatibleBitmap", 1);
  manager->setShadowDC();
  EXPECT_TRUE(messages().empty());
  manager->paintTraces(true);  // tries again
  EXPECT_EQ(gdi.bitmapSize(manager->shadowDC()), (Size{400, 200}));
}

TEST_F(TraceManagerTest, EnteringTheSurfaceRoutineTwiceIsReportedAndCarriedOut) {
  class ReenteringForm : public FakeTraceForm {
   public:
    clsTraceManager* manager = nullptr;
    DcHandle ViewHDC() override {
      if (clsTraceManager* const once = std::exchange(manager, nullptr)) once->setShadowDC();
      return dc;
    }
  };
  ReenteringForm reentering;
  reentering.dc = gdi.viewDc();
  reentering.manager = manager.get();
  manager->setForm(&reentering);
  manager->setShadowDC();
  EXPECT_EQ(messages(), Messages{"clsTraceManager::setShadowDC function entered twice without an exit\r"});
  EXPECT_EQ(gdi.liveDcs(), 1);
  manager.reset();
}

TEST_F(TraceManagerTest, FirstTraceTellsTheFormAndBecomesActive) {
  const auto first = add(25);
  EXPECT_EQ(form.configurations, (std::vector<Configuration>{{TraceState::Added, first.get(), 25}}));
  EXPECT_EQ(manager->activeTrace(), first.get());
  EXPECT_EQ(manager->find(25), first.get());
  EXPECT_EQ(manager->find(26), nullptr);
}

TEST_F(TraceManagerTest, SecondObjectOfAResultTypeIsRefusedAndNotCounted) {
  const auto first = add(25);
  add(25);
  EXPECT_EQ(messages(), Messages{"addTraceObject() failed ...\r"
                                 "This key is already associated with an element of this collection"});
  EXPECT_EQ(manager->numberOfTraces(), 1.0F);
  EXPECT_EQ(manager->activeTrace(), first.get());
}

TEST_F(TraceManagerTest, RemovingTheActiveTraceActivatesTheOldestOne) {
  const auto oldest = add(1);
  add(2);
  add(3);
  form.configurations.clear();
  EXPECT_TRUE(manager->removeTraceObject(3));
  EXPECT_EQ(form.configurations, (std::vector<Configuration>{{TraceState::Removed, oldest.get(), 3}}));
  EXPECT_TRUE(manager->removeTraceObject(2));
  EXPECT_TRUE(manager->removeTraceObject(1));
  EXPECT_EQ(form.configurations.back(), (Configuration{TraceState::Removed, nullptr, 1}));
  EXPECT_EQ(manager->numberOfTraces(), 0.0F);

  gdi.clear();
  manager->paintTraces(true);
  EXPECT_EQ(gdi.drawingOrder(), (Log{"fillRect", "bitBlt"}));
}

TEST_F(TraceManagerTest, RemovingAnUnknownTraceTellsTheFormAndReports) {
  const auto only = add(1);
  form.configurations.clear();
  manager->removeTrace(ResultTypeRecord(7));
  EXPECT_EQ(form.configurations, (std::vector<Configuration>{{TraceState::Removed, only.get(), 7}}));
  EXPECT_EQ(messages(), (Messages{"clsTraceManager::removeTraceObject() received unknown result type\r",
                                  "Trace Object not found.clsTraceManager\r"}));
  clearMessages();
  manager->removeTrace(ResultTypeRecord(40000));
  EXPECT_EQ(messages(), Messages{"removeTrace() failed ...\rOverflow"});
}

TEST_F(TraceManagerTest, ListingATypeIgnoresItClearsTheActiveTraceOrRaisesTheCount) {
  add(1);
  add(2);
  form.configurations.clear();
  float count = 0;
  manager->ListTraceTypes(ResultTypeRecord(10), count);
  EXPECT_EQ(count, 0.0F);
  manager->ListTraceTypes(ResultTypeRecord(735), count);
  EXPECT_EQ(count, 2.0F);
  count = 5;
  manager->ListTraceTypes(ResultTypeRecord(4711), count);
  EXPECT_EQ(count, 5.0F);
  EXPECT_NE(manager->activeTrace(), nullptr);
  manager->ListTraceTypes(ResultTypeRecord(28), count);
  EXPECT_EQ(manager->activeTrace(), nullptr);
  EXPECT_EQ(form.configurations, (std::vector<Configuration>{{TraceState::Added, nullptr, 28}}));
}

TEST_F(TraceManagerTest, ResultDataGoesToItsTraceObjectAndIsSkippedWithoutOne) {
  struct Data : ResultData {
    TraceObject* handedTo = nullptr;
    int skipped = 0;
    void handTo(TraceObject& traceObject) override { handedTo = &traceObject; }
    void SkipMeasurementData() override { ++skipped; }
  } data;
  const auto known = add(25);
  manager->getTraceData(25, data);
  EXPECT_EQ(data.handedTo, known.get());
  EXPECT_EQ(data.skipped, 0);
  manager->getTraceData(26, data);
  EXPECT_EQ(data.skipped, 1);
}

TEST_F(TraceManagerTest, OneTraceFillsTheSurfaceAndIsPaintedStepByStep) {
  const auto only = add(25);
  log.clear();
  gdi.clear();
  manager->paintTraces(false);
  EXPECT_EQ(only->panel, (PanelArea{0, 0, 400, 200}));
  EXPECT_EQ(only->clipped, (PanelArea{0, 0, 400, 200}));
  EXPECT_EQ(log, (Log{"25 drawingArea", "25 processData", "25 clip", "25 Paint", "25 drawMarkers",
                      "25 unclip", "25 Label", "25 updateMarkerDisplay"}));
  EXPECT_EQ(gdi.blits(),
            (std::vector<BlitValue>{{gdi.viewDc(), {20, 10, 420, 210}, manager->shadowDC(), {0, 0}}}));
  EXPECT_EQ(form.frameColors, std::vector<Color>{rgb(1, 2, 3)});

  only->changed = false;
  log.clear();
  manager->paintTraces(false);
  EXPECT_EQ(log[1], "25 clip");  // nothing new to process
}

TEST_F(TraceManagerTest, TwoTracesShareTheSurfaceWithTheActiveOneBelow) {
  const auto other = add(1);
  const auto active = add(2);
  other->changed = false;
  log.clear();
  manager->paintTraces(true);
  EXPECT_EQ(active->panel, (PanelArea{0, 80, 400, 120}));
  EXPECT_EQ(other->panel, (PanelArea{0, 0, 400, 80}));
  EXPECT_EQ(log[1], "1 processData");  // changed or not, once there are several
  // The second and fourth font are the active panel's, the first and third the small panels'.
  EXPECT_EQ(active->labelFonts.axis, fonts[1]);
  EXPECT_EQ(active->labelFonts.corner, fonts[3]);
  EXPECT_EQ(other->labelFonts.axis, fonts[0]);
  EXPECT_EQ(other->labelFonts.corner, fonts[2]);
}

TEST_F(TraceManagerTest, ThreeTracesPutTwoHalvesAboveAndSplittersAtTheirRightEdges) {
  const auto left = add(1);
  const auto right = add(2);
  const auto active = add(3);
  gdi.clear();
  manager->paintTraces(true);
  EXPECT_EQ(left->panel, (PanelArea{0, 0, 200, 80}));
  EXPECT_EQ(right->panel, (PanelArea{200, 0, 200, 80}));
  EXPECT_EQ(active->panel, (PanelArea{0, 80, 400, 120}));
  ASSERT_EQ(gdi.edges().size(), 2U);
  EXPECT_EQ(gdi.edges()[0], (EdgeValue{manager->shadowDC(), {200, 0, 202, 80}, kEdgeSunken, kAllSides}));
  EXPECT_EQ(gdi.edges()[1], (EdgeValue{manager->shadowDC(), {400, 0, 402, 80}, kEdgeSunken, kAllSides}));
}

TEST_F(TraceManagerTest, InvisibleTraceIsNotPainted) {
  const auto hidden = add(1);
  hidden->visible = false;
  log.clear();
  manager->paintTraces(true);
  EXPECT_TRUE(log.empty());
}

TEST_F(TraceManagerTest, FailingPainterIsUnclippedAndReported) {
  const auto failing = add(25);
  failing->failsToPaint = true;
  log.clear();
  manager->paintTraces(true);
  EXPECT_EQ(log.back(), "25 unclip");
  EXPECT_EQ(messages(), Messages{"paintTraces() failed ...\rOverflow"});
}

TEST_F(TraceManagerTest, FrameTakesTheColourOfLineTracesAlone) {
  add(1, "clsBarChartMrkrPainter");
  manager->paintTraces(true);
  EXPECT_TRUE(form.frameColors.empty());
  form.name = "frmPhoneVfp";
  manager->paintTraces(true);
  EXPECT_EQ(form.frameColors, std::vector<Color>{rgb(1, 2, 3)});
}

TEST_F(TraceManagerTest, NewMarkersAreNumberedAfterTheHighestAndComeFirst) {
  const auto trace = add(25);
  trace->subTraces = {{{0, 0}, {200, 100}, {240, 110}}};
  manager->addMarker(0);
  // The middle is taken in pixels of the view: (400 / 2 + 20, 200 / 2 + 10).
  EXPECT_EQ(trace->lastSought, (Point{220, 110}));
  EXPECT_EQ(trace->activeMarker()->point, 2);
  press(0, 0, kNewMarker);
  EXPECT_EQ(ids(*trace), (std::vector<std::string>{"2", "1"}));
  EXPECT_EQ(trace->markerCount(), 2);
  EXPECT_EQ(trace->activeMarker()->id, "2");
  EXPECT_TRUE(trace->activeMarker()->active);
  EXPECT_FALSE(trace->markerCollection().item("1")->active);

  trace->markerCollection().item("1")->id = "32767";
  manager->addMarker(0);
  EXPECT_EQ(messages(), Messages{"addMarker() failed ...\rOverflow"});
}

TEST_F(TraceManagerTest, DeltaMarkerNamesItsPartnerAndFollowsThePointerUntilRelease) {
  const auto trace = add(25);
  trace->subTraces = {{{0, 0}, {100, 50}, {300, 150}}};
  press(300, 150, kNewMarker);
  press(100, 50, kNewDeltaMarker);
  const MarkerPointer delta = trace->markerCollection().item("1d");
  EXPECT_TRUE(delta->DELTA);
  EXPECT_EQ(delta->deltaPartner, "1");
  EXPECT_EQ(trace->activeMarker()->deltaPartner, "1d");
  EXPECT_EQ(manager->findHighestId(), 1);  // delta markers do not count
  EXPECT_EQ(form.deltaButtonStates, std::vector<bool>{false});

  move(2, 3);
  EXPECT_EQ(delta->point, 0);
  manager->MouseUp(1, 0, 0, 0);
  move(300, 150);
  EXPECT_EQ(delta->point, 0);
}

TEST_F(TraceManagerTest, UnknownMarkerOperationIsReported) {
  add(25);
  press(5, 5, 3);
  EXPECT_EQ(messages(), Messages{"clsTraceManager::MouseDown() ... unknown marker operation\r"});
}

TEST_F(TraceManagerTest, PressInsideAnotherPanelActivatesItButNotOnItsEdge) {
  const auto upper = add(1);
  const auto lower = add(2);
  manager->paintTraces(true);
  form.configurations.clear();
  press(0, 40);  // on the left edge: inside no panel
  EXPECT_EQ(manager->activeTrace(), lower.get());
  press(1, 40);
  EXPECT_EQ(manager->activeTrace(), upper.get());
  EXPECT_EQ(form.configurations, (std::vector<Configuration>{{TraceState::Added, upper.get(), 1}}));
  EXPECT_EQ(upper->panel, (PanelArea{0, 80, 400, 120}));
}

TEST_F(TraceManagerTest, ArrowsMoveTheActiveMarkerWithinTheTrace) {
  EXPECT_EQ(manager->moveMarkerLeft(), -9);
  EXPECT_EQ(manager->moveMarkerRight(), -9);
  const auto trace = add(25);
  EXPECT_EQ(manager->moveMarkerRight(), -9);  // no marker
  trace->subTraces = {{{0, 0}, {100, 50}}};
  press(0, 0, kNewMarker);
  EXPECT_EQ(manager->moveMarkerLeft(), 0);
  EXPECT_EQ(trace->activeMarker()->point, 0);
  EXPECT_EQ(manager->moveMarkerRight(), 0);
  EXPECT_EQ(trace->activeMarker()->point, 1);
  EXPECT_EQ(manager->moveMarkerRight(), 0);
  EXPECT_EQ(trace->activeMarker()->point, 1);  // the last point
}

TEST_F(TraceManagerTest, MakingAMarkerFirstKeepsTheOthersInOrder) {
  const auto trace = add(25);
  trace->subTraces = {{{0, 0}}};
  for (int marker = 0; marker < 3; ++marker) press(0, 0, kNewMarker);
  manager->makeFirstMarker(trace->markerCollection().item("2"));
  EXPECT_EQ(ids(*trace), (std::vector<std::string>{"2", "3", "1"}));
}

TEST_F(TraceManagerTest, NearestTraceIsTheMarkedOneElseTheFirstOfTheNearest) {
  const auto trace = add(25);
  trace->subTraces = {{{100, 60}}, {{100, 40}}};
  EXPECT_EQ(manager->findNearestTrace(100, 50), 0);  // 10 pixels to each: the lower index
  EXPECT_EQ(manager->findNearestTrace(100, 49), 1);
  EXPECT_EQ(manager->findNearestTrace(9000, 1159), 0);   // 8900 + 1099 = 9999 pixels away
  EXPECT_EQ(manager->findNearestTrace(9000, 1160), -1);  // 10000: never chosen
}

TEST_F(TraceManagerTest, MarkerIsHitAtItsGlyphAndTakenHoldOf) {
  const auto trace = add(25);
  trace->subTraces = {{{100, 50}}, {{300, 50}}};
  press(100, 50, kNewMarker);
  manager->MouseUp(1, 0, 0, 0);
  // 8 pixels wide and 12 high above its point, and 2 pixels of margin.
  EXPECT_NE(manager->findNearestMarker(106, 36, 0), nullptr);
  EXPECT_EQ(manager->findNearestMarker(107, 36, 0), nullptr);
  EXPECT_EQ(manager->findNearestMarker(106, 35, 0), nullptr);
  EXPECT_EQ(manager->findNearestMarker(100, 53, 0), nullptr);
  EXPECT_EQ(manager->findNearestMarker(100, 50, 1), nullptr);
  press(103, 45);
  EXPECT_EQ(trace->mouseActiveMarker(), trace->markerCollection().item("1"));
}

TEST_F(TraceManagerTest, KeysReachLineTracesAlone) {
  add(1, "clsBarChartMrkrPainter");
  manager->KeyPress(39);
  EXPECT_TRUE(log.empty());
  add(2);
  manager->KeyPress(39);
  EXPECT_EQ(log, Log{"2 KeyPress 39"});
}

TEST_F(TraceManagerTest, PressInTheSplitterBandBelongsToTheSplitter) {
  const auto trace = add(1);
  add(2);
  add(3);
  manager->paintTraces(true);
  // The bar's top is at 200 * 0.4 + 10 = 90 pixels of the view; its band begins 20 above.
  form.pointer = MousePointer::SizeNorthSouth;
  manager->MouseDown(1, 0, 100 * kTwipsPerPixel, 70 * kTwipsPerPixel);
  EXPECT_EQ(windowing.captures, std::vector<WindowHandle>{form.window});
  EXPECT_NE(manager->activeTrace(), trace.get());
  manager->MouseDown(1, 0, 100 * kTwipsPerPixel, 69 * kTwipsPerPixel);
  EXPECT_EQ(manager->activeTrace(), trace.get());
}

TEST_F(TraceManagerTest, EveryGraphicsCallMayFailWithoutALeakAndTheNextPaintIsWhole) {
  add(1);
  add(2);
  add(3);
  manager->setShadowDC();
  gdi.clear();
  manager->setShadowDC();
  manager->paintTraces(true);
  const std::vector<int> failing = gdi.callsThatMayFail();
  ASSERT_GT(failing.size(), 20U);
  for (const int n : failing) {
    gdi.failNthCall(n);
    manager->setShadowDC();
    manager->paintTraces(true);
    gdi.failNothing();
    gdi.clear();
    manager->setShadowDC();
    manager->paintTraces(true);
    EXPECT_EQ(gdi.blits().size(), 1U) << "after failing call " << n;
  }
  manager.reset();
  EXPECT_EQ(gdi.liveDcs(), 0);
  EXPECT_EQ(gdi.liveObjects(), 4);
}

TEST(LabelStyleTest, IsBoldUnlessTheCommandLineAsksForNormal) {
  EXPECT_TRUE(boldLabels(""));
  EXPECT_TRUE(boldLabels("host.exe /BoldLabels"));
  EXPECT_FALSE(boldLabels("host.exe /NormalLabels"));
  EXPECT_FALSE(boldLabels("NormalLabels BoldLabels"));
  EXPECT_TRUE(boldLabels("normallabels"));
}

}  // namespace
}  // namespace frontpanels::testing

#include "traces/trace_manager.h"

#include <gtest/gtest.h>

#include <limits>

#include "tests/support/fake_surface.h"
#include "tests/support/fake_trace_object.h"
#include "tests/support/recording_gdi.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels::testing {
namespace {

constexpr float kTwipsPerPixel = 15.0F;

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
  template <class... Operation>
  void press(float x, float y, Operation... operation) {
    manager->MouseDown(1, 0, (x + 20) * kTwipsPerPixel, (y + 10) * kTwipsPerPixel, operation...);
  }
  void move(float x, float y) {
    manager->MouseMove(1, 0, (x + 20) * kTwipsPerPixel, (y + 10) * kTwipsPerPixel);
  }

  // What the trace objects were asked since it was looked at last.
  std::string asked() {
    std::string text;
    for (const std::string& line : std::exchange(log, {})) text += (text.empty() ? "" : ", ") + line;
    return text;
  }
  std::string askedByPaint() {
    log.clear();
    manager->paintTraces(true);
    return asked();
  }
  // What the form was told since: "+" for a trace added, "-" for one removed, and the active trace.
  std::string told() {
    std::string text;
    for (const auto& now : std::exchange(form.configurations, {})) {
      text += (now.state == TraceState::Added ? " +" : " -") + std::to_string(now.resultType);
      text += " active " + (now.activeTrace ? std::to_string(now.activeTrace->resultType()) : "none");
    }
    return text;
  }
  [[nodiscard]] static std::string ids(FakeTraceObject& traceObject) {
    std::string text;
    for (const MarkerPointer& marker : traceObject.markerCollection()) text += marker->id + " ";
    return text;
  }

  std::int32_t fontHeight = 10;
  RecordingGdi gdi;
  FakeWindowing windowing;
  FakeTraceForm form;
  LabelFontHandles fonts;
  std::vector<std::string> log;
  std::unique_ptr<clsTraceManager> manager;
};

TEST_F(TraceManagerTest, SurfaceIsMadeInOrderAndGivenBackWhenTheManagerGoes) {
  manager->drawingArea(0, 0, 100.5F * kTwipsPerPixel, 101.5F * kTwipsPerPixel);  // halves go to even
  gdi.clear();
  manager->setShadowDC();
  std::string order;
  for (std::size_t i = 0; i < 8; ++i) order += gdi.calls()[i].name + " ";
  // Put back pen, brush, font, bitmap; delete bitmap and context; then make anew.
  EXPECT_EQ(order,
            "selectObject selectObject selectObject selectObject deleteObject deleteDC "
            "createCompatibleDC createCompatibleBitmap ");
  EXPECT_EQ(gdi.bitmapArea(manager->shadowDC()), (Rect{0, 0, 100, 102}));
  EXPECT_EQ(gdi.fills().back().rect, (Rect{0, 0, 100, 102}));
  EXPECT_EQ(gdi.fills().back().brush, rgb(15, 15, 15));  // the system's button face
  EXPECT_EQ(gdi.pen(manager->shadowDC()).color, rgb(0, 0, 0));
  EXPECT_EQ(gdi.font(manager->shadowDC()).emHeightPx, 11);  // the first of the four
  EXPECT_EQ(manager->maxFontWidth(), 8.0F);
  EXPECT_EQ(manager->maxFontHeight(), 12.0F);

  manager.reset();
  EXPECT_EQ(gdi.liveDcs(), 0);
  EXPECT_EQ(gdi.liveObjects(), 4);  // the fonts are the owner's
  EXPECT_TRUE(gdi.violations().empty());
}

TEST_F(TraceManagerTest, MissingDeviceContextIsReportedTwiceAndAMissingBitmapNotAtAll) {
  gdi.failAlways("createCompatibleDC");
  manager->setShadowDC();
  EXPECT_EQ(said(),
            "clsTraceManager::setShadowDC CreateCompatibleDC failed\r\n"
            "clsTraceManager::setShadowDC CreateCompatibleBitmap failed\r");
  gdi.failAlways("createCompatibleBitmap");
  manager->setShadowDC();
  EXPECT_EQ(said(), "");
  gdi.failNothing();
  manager->paintTraces(true);  // tries again
  EXPECT_EQ(gdi.bitmapArea(manager->shadowDC()), (Rect{0, 0, 400, 200}));
}

TEST_F(TraceManagerTest, EnteringTheSurfaceRoutineTwiceIsReportedAndCarriedOut) {
  struct ReenteringForm : FakeTraceForm {
    clsTraceManager* manager = nullptr;
    DcHandle ViewHDC() override {
      if (clsTraceManager* const once = std::exchange(manager, nullptr)) once->setShadowDC();
      return dc;
    }
  } reentering;
  reentering.dc = gdi.viewDc();
  reentering.manager = manager.get();
  manager->setForm(&reentering);
  manager->setShadowDC();
  EXPECT_EQ(said(), "clsTraceManager::setShadowDC function entered twice without an exit\r");
  EXPECT_EQ(gdi.liveDcs(), 1);
  manager.reset();
}

TEST_F(TraceManagerTest, TheFormHearsOfTracesAndTheOldestOneFollowsTheActiveOne) {
  const auto oldest = add(1);
  EXPECT_EQ(told(), " +1 active 1");
  EXPECT_EQ(manager->activeTrace(), oldest.get());
  add(1);
  EXPECT_EQ(said(),
            "addTraceObject() failed ...\rThis key is already associated with an element of this collection");
  EXPECT_EQ(manager->numberOfTraces(), 1.0F);
  EXPECT_EQ(manager->find(1), oldest.get());
  EXPECT_EQ(manager->find(2), nullptr);

  add(2);
  add(3);
  told();
  EXPECT_TRUE(manager->removeTraceObject(3));
  manager->removeTrace(ResultTypeRecord(7));  // the form is told of an unknown one too
  EXPECT_TRUE(manager->removeTraceObject(2));
  manager->removeTrace(ResultTypeRecord(40000));
  EXPECT_TRUE(manager->removeTraceObject(1));
  EXPECT_EQ(told(), " -3 active 1 -7 active 1 -2 active 1 -1 active none");
  EXPECT_EQ(said(),
            "clsTraceManager::removeTraceObject() received unknown result type\r\n"
            "Trace Object not found.clsTraceManager\r\nremoveTrace() failed ...\rOverflow");
  EXPECT_EQ(manager->numberOfTraces(), 0.0F);
  gdi.clear();
  manager->paintTraces(true);
  EXPECT_EQ(gdi.drawingOrder(), (std::vector<std::string>{"fillRect", "bitBlt"}));
}

TEST_F(TraceManagerTest, ListingATypeIgnoresItClearsTheActiveTraceOrRaisesTheCount) {
  add(1);
  add(2);
  told();
  const auto listed = [this](std::int32_t type, float count) {
    return manager->ListTraceTypes(ResultTypeRecord(type), count), count;
  };
  EXPECT_EQ(listed(10, 0), 0.0F);
  EXPECT_EQ(listed(735, 0), 2.0F);
  EXPECT_EQ(listed(4711, 5), 5.0F);
  EXPECT_NE(manager->activeTrace(), nullptr);
  listed(28, 0);
  EXPECT_EQ(manager->activeTrace(), nullptr);
  EXPECT_EQ(told(), " +28 active none");
}

TEST_F(TraceManagerTest, ResultDataGoesToItsTraceObjectAndIsSkippedWithoutOne) {
  struct Data : ResultData {
    std::vector<TraceObject*> takers;  // null for skipped
    void handTo(TraceObject& traceObject) override { takers.push_back(&traceObject); }
    void SkipMeasurementData() override { takers.push_back(nullptr); }
  } data;
  const auto known = add(25);
  manager->getTraceData(25, data);
  manager->getTraceData(26, data);
  EXPECT_EQ(data.takers, (std::vector<TraceObject*>{known.get(), nullptr}));
}

TEST_F(TraceManagerTest, OneTraceFillsTheSurfaceAndIsPaintedStepByStepAndUnclippedWhenItFails) {
  const auto only = add(25);
  gdi.clear();
  EXPECT_EQ(askedByPaint(),
            "25 drawingArea, 25 processData, 25 clip, 25 Paint, 25 drawMarkers, 25 unclip, 25 Label, "
            "25 updateMarkerDisplay");
  EXPECT_EQ(only->panel, (PanelArea{0, 0, 400, 200}));
  EXPECT_EQ(only->clipped, (PanelArea{0, 0, 400, 200}));
  ASSERT_EQ(gdi.blits().size(), 1U);
  EXPECT_EQ(gdi.blits()[0].dc, gdi.viewDc());
  EXPECT_EQ(gdi.blits()[0].from, manager->shadowDC());
  EXPECT_EQ(gdi.blits()[0].rect, (Rect{20, 10, 420, 210}));
  EXPECT_EQ(gdi.blits()[0].points[0], (Point{0, 0}));
  EXPECT_EQ(form.frameColors, std::vector<Color>{rgb(1, 2, 3)});

  only->changed = false;  // nothing new to process
  only->failsToPaint = true;
  EXPECT_EQ(askedByPaint(), "25 drawingArea, 25 clip, 25 Paint, 25 unclip");
  EXPECT_EQ(said(), "paintTraces() failed ...\rOverflow");
  only->visible = false;
  EXPECT_EQ(askedByPaint(), "");
}

TEST_F(TraceManagerTest, TracesShareTheSurfaceWithTheActiveOneBelowAndSplittersAtTheirRightEdges) {
  const auto left = add(1);
  const auto right = add(2);
  left->changed = false;
  EXPECT_TRUE(askedByPaint().starts_with("1 drawingArea, 1 processData"));  // once there are several
  EXPECT_EQ(right->panel, (PanelArea{0, 80, 400, 120}));
  EXPECT_EQ(left->panel, (PanelArea{0, 0, 400, 80}));
  // The second and fourth font are the active panel's, the first and third the small panels'.
  EXPECT_EQ(std::pair(right->labelFonts.axis, right->labelFonts.corner), std::pair(fonts[1], fonts[3]));
  EXPECT_EQ(std::pair(left->labelFonts.axis, left->labelFonts.corner), std::pair(fonts[0], fonts[2]));

  const auto active = add(3);
  gdi.clear();
  manager->paintTraces(true);
  EXPECT_EQ(left->panel, (PanelArea{0, 0, 200, 80}));
  EXPECT_EQ(right->panel, (PanelArea{200, 0, 200, 80}));
  EXPECT_EQ(active->panel, (PanelArea{0, 80, 400, 120}));
  const DcHandle shadow = manager->shadowDC();
  EXPECT_EQ(gdi.edges(), (std::vector<EdgeValue>{{shadow, {200, 0, 202, 80}, kEdgeSunken, kAllSides},
                                                 {shadow, {400, 0, 402, 80}, kEdgeSunken, kAllSides}}));
  for (const float count : {-1.0F, 1.5F, std::numeric_limits<float>::quiet_NaN()}) {
    manager->numberOfTraces(count);
    EXPECT_EQ(askedByPaint(), "");  // no such layout
  }
  EXPECT_EQ(said(), "");
}

TEST_F(TraceManagerTest, WithoutItsFormInputIsReportedAndPaintingDoesNothing) {
  const auto trace = add(1);
  add(2);
  add(3);
  manager->paintTraces(true);
  manager->setForm(nullptr);
  EXPECT_EQ(askedByPaint(), "");
  press(1, 20);  // in the first small panel
  move(1, 70);   // over the band of the bar
  EXPECT_EQ(asked(), "");
  EXPECT_NE(manager->activeTrace(), trace.get());
  EXPECT_EQ(said(),
            "MouseDown() failed ...\rObject variable or With block variable not set\n"
            "MouseMove() failed ...\rObject variable or With block variable not set");
}

TEST_F(TraceManagerTest, LineTracesAloneColourTheFrameAndTakeKeys) {
  add(1, "clsBarChartMrkrPainter");
  manager->paintTraces(true);
  EXPECT_TRUE(form.frameColors.empty());
  form.name = "frmPhoneVfp";
  manager->paintTraces(true);
  EXPECT_EQ(form.frameColors, std::vector<Color>{rgb(1, 2, 3)});
  asked();
  manager->KeyPress(39);
  EXPECT_EQ(asked(), "");
  add(2);
  manager->KeyPress(39);
  EXPECT_EQ(asked(), "2 KeyPress 39");
  manager->removeTraceObject(2);
  manager->removeTraceObject(1);
  manager->paintTraces(true);  // no trace, no colour, and no complaint
  EXPECT_EQ(said(), "");
}

TEST_F(TraceManagerTest, NewMarkersAreNumberedAfterTheHighestAndComeFirst) {
  const auto trace = add(25);
  trace->subTraces = {{{0, 0}, {200, 100}, {240, 110}}};
  manager->addMarker(0);
  // The middle is taken in pixels of the view: (400 / 2 + 20, 200 / 2 + 10).
  EXPECT_EQ(trace->lastSought, (Point{220, 110}));
  EXPECT_EQ(trace->activeMarker()->point, 2);
  press(0, 0, kNewMarker);
  press(0, 0, kNewMarker);
  EXPECT_EQ(ids(*trace), "3 2 1 ");
  EXPECT_EQ(trace->markerCount(), 3);
  EXPECT_EQ(trace->activeMarker()->id, "3");
  EXPECT_TRUE(trace->activeMarker()->active);
  EXPECT_FALSE(trace->markerCollection().item("1")->active);
  manager->makeFirstMarker(trace->markerCollection().item("2"));
  EXPECT_EQ(ids(*trace), "2 3 1 ");

  trace->markerCollection().item("1")->id = "32767";
  manager->addMarker(0);
  press(5, 5, std::int16_t{3});
  EXPECT_EQ(said(),
            "addMarker() failed ...\rOverflow\n"
            "clsTraceManager::MouseDown() ... unknown marker operation\r");
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

TEST_F(TraceManagerTest, PressInsideAnotherPanelActivatesItButNotOnItsEdgeNorInTheSplittersBand) {
  const auto upper = add(1);
  add(2);
  manager->paintTraces(true);
  told();
  press(0, 40);  // on the left edge: inside no panel
  EXPECT_EQ(told(), "");
  press(1, 40);
  EXPECT_EQ(told(), " +1 active 1");
  EXPECT_EQ(upper->panel, (PanelArea{0, 80, 400, 120}));

  const auto third = add(3);
  manager->paintTraces(true);
  // The bar's top is at 200 * 0.4 = 80; its band begins 20 above.
  form.pointer = MousePointer::SizeNorthSouth;
  press(80, 60);
  EXPECT_EQ(windowing.captures, std::vector<WindowHandle>{form.window});
  EXPECT_EQ(manager->activeTrace(), third.get());
  press(80, 59);
  EXPECT_NE(manager->activeTrace(), third.get());

  manager->removeTraceObject(3);
  manager->removeTraceObject(2);
  press(80, 60);  // one trace fills the graph: there is nothing to divide
  EXPECT_EQ(windowing.captures.size(), 1U);
}

TEST_F(TraceManagerTest, ArrowsMoveTheActiveMarkerWithinTheTrace) {
  EXPECT_EQ(manager->moveMarkerLeft(), -9);
  const auto trace = add(25);
  EXPECT_EQ(manager->moveMarkerRight(), -9);  // no marker
  trace->subTraces = {{{0, 0}, {100, 50}}};
  press(0, 0, kNewMarker);
  EXPECT_EQ(manager->moveMarkerLeft(), 0);
  EXPECT_EQ(trace->activeMarker()->point, 0);
  EXPECT_EQ(manager->moveMarkerRight(), 0);
  EXPECT_EQ(manager->moveMarkerRight(), 0);
  EXPECT_EQ(trace->activeMarker()->point, 1);  // the last point
}

TEST_F(TraceManagerTest, NearestTraceIsTheFirstOfTheNearestAndAMarkerIsHitAtItsGlyph) {
  const auto trace = add(25);
  trace->subTraces = {{{100, 60}}, {{100, 40}}};
  EXPECT_EQ(manager->findNearestTrace(100, 50), 0);  // 10 pixels to each: the lower index
  EXPECT_EQ(manager->findNearestTrace(100, 49), 1);
  EXPECT_EQ(manager->findNearestTrace(9000, 1159), 0);   // 8900 + 1099 = 9999 pixels away
  EXPECT_EQ(manager->findNearestTrace(9000, 1160), -1);  // 10000: never chosen

  press(100, 60, kNewMarker);
  manager->MouseUp(1, 0, 0, 0);
  // 8 pixels wide and 12 high above its point, and 2 pixels of margin.
  EXPECT_NE(manager->findNearestMarker(106, 46, 0), nullptr);
  EXPECT_EQ(manager->findNearestMarker(107, 46, 0), nullptr);
  EXPECT_EQ(manager->findNearestMarker(106, 45, 0), nullptr);
  EXPECT_EQ(manager->findNearestMarker(100, 63, 0), nullptr);
  EXPECT_EQ(manager->findNearestMarker(100, 60, 1), nullptr);
  trace->subTraces[1] = {{100, 50}};
  EXPECT_EQ(manager->findNearestTrace(100, 50), 0);  // a glyph wins over the trace that runs across it
  EXPECT_EQ(manager->findNearestTrace(100, 45), 1);  // above the glyph and its margin
  press(103, 55);
  EXPECT_EQ(trace->mouseActiveMarker(), trace->markerCollection().item("1"));
}

TEST_F(TraceManagerTest, EveryGraphicsCallMayFailWithoutALeakAndTheNextPaintIsWhole) {
  for (const auto type : std::initializer_list<std::int16_t>{1, 2, 3}) add(type);
  const auto wholePaint = [this] {
    gdi.clear();
    manager->setShadowDC();
    manager->paintTraces(true);
  };
  wholePaint();
  const std::vector<int> failing = gdi.callsThatMayFail();
  ASSERT_GT(failing.size(), 20U);
  for (const int n : failing) {
    gdi.failNthCall(n);
    wholePaint();
    gdi.failNothing();
    wholePaint();
    EXPECT_EQ(gdi.blits().size(), 1U) << "after failing call " << n;
  }
  manager.reset();
  EXPECT_EQ(gdi.liveDcs(), 0);
  EXPECT_EQ(gdi.liveObjects(), 4);
}

TEST(LabelStyleTest, IsBoldUnlessTheCommandLineAsksForNormal) {
  EXPECT_TRUE(boldLabels("host.exe /BoldLabels"));
  EXPECT_FALSE(boldLabels("host.exe /NormalLabels"));
  EXPECT_FALSE(boldLabels("NormalLabels BoldLabels"));
  EXPECT_TRUE(boldLabels("normallabels"));
}

}  // namespace
}  // namespace frontpanels::testing

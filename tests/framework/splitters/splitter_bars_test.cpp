#include <gtest/gtest.h>

#include "framework/splitters/horz_splitter_bar.h"
#include "framework/splitters/vert_splitter_bar.h"
#include "tests/support/fake_surface.h"
#include "tests/support/raised.h"
#include "tests/support/recording_gdi.h"

namespace frontpanels::testing {
namespace {

constexpr MousePointer kDefault = MousePointer::Default;
constexpr MousePointer kNorthSouth = MousePointer::SizeNorthSouth;
constexpr MousePointer kEastWest = MousePointer::SizeEastWest;

// A surface of 400 x 900 at (10, 40), of which 200 x 300 are usable. The horizontal bar goes by what is
// usable and is drawn at 100 to 120; the vertical one goes by the whole and lies from (100, 60) to (102,
// 160).
class SplitterBarsTest : public ::testing::Test {
 protected:
  SplitterBarsTest() {
    surface.dc = gdi.viewDc();
    surface.scaleLeft = 10;
    surface.scaleTop = 40;
    surface.scaleWidth = 400;
    surface.scaleHeight = 900;
    surface.useableWidth = 200;
    surface.useableHeight = 300;
    horz.DrawingSurface(&surface);
    horz.SplitterBarTop(100);
    vert.DrawingSurface(&surface);
    vert.SplitterBarLeft(100);
    vert.SplitterBarTop(60);
    vert.SplitterBarHeight(100);
  }

  // Whether a press takes hold of a copy of the bar.
  template <class Bar>
  bool grabs(Bar bar, float x, float y, MousePointer pointer, std::int16_t button = 1) {
    surface.pointer = pointer;
    bar.MouseDown(button, 0, x, y);
    return bar.MouseCaptured();
  }
  template <class Bar>
  MousePointer hovering(const Bar& bar, float x, float y) {
    Bar(bar).MouseMove(0, 0, x, y);
    return surface.pointer;
  }
  void pressHorz(float y) {
    surface.pointer = kNorthSouth;
    horz.MouseDown(1, 0, 50, y);
  }
  float releaseHorz(float y) { return horz.MouseUp(1, 0, 50, y), horz.SplitterBarTop(); }
  float dragVert(float to) {
    surface.pointer = kEastWest;
    windowing.captured = surface.window;  // by the container, for the press
    vert.MouseDown(1, 0, 101, 100);
    vert.MouseMove(1, 0, 300, 100);
    EXPECT_EQ(surface.pointer, kEastWest);  // far from the bar, and still the sizing pointer
    return vert.MouseUp(1, 0, to, 100), vert.SplitterBarLeft();
  }

  RecordingGdi gdi;
  FakeTraceForm surface;
  FakeWindowing windowing;
  clsHorzSplitterBar horz{gdi, windowing};
  clsVertSplitterBar vert{gdi, windowing, ScreenMetrics{0.5F, 15.0F}};
};

TEST_F(SplitterBarsTest, SizesAndWhatAssigningTheSurfaceResets) {
  horz.SplitterBarHeight(33);
  EXPECT_EQ(horz.BarWidth(), 20);
  horz.DrawingSurface(&surface);
  EXPECT_EQ(horz.SplitterBarHeight(), 20);
  EXPECT_EQ(horz.SplitterBarTop(), 100);

  EXPECT_EQ(vert.BarWidth(), 4);  // 2 in the screen's twips per pixel: 2 / 0.5
  EXPECT_EQ(vert.SplitterBarBottom(), 160);
  vert.SplitterBarBottom(150);  // measures from the surface's top
  EXPECT_EQ(vert.SplitterBarHeight(), 110);
  vert.SplitterBarBottom(30);
  EXPECT_EQ(vert.SplitterBarHeight(), 0);
  EXPECT_EQ(surface.refreshes, 0);
}

TEST_F(SplitterBarsTest, AreGrabbedWithTheLeftButtonUnderTheSizingPointerOnly) {
  horz.SplitterBarHeight(90);  // has no say: the band is 20 units above and below the bar's top
  struct Row {
    float x, y;
    bool grabbed;
  };
  const Row horzRows[] = {{50, 80, true},    {50, 79, false},    {50, 119, true},  {50, 120, false},
                          {10, 100, true},   {9, 100, false},    {209, 100, true}, {210, 100, false},
                          {50, 79.5F, true}, {50, 119.5F, false}};  // halves to even: 80, 120
  for (const auto& row : horzRows)
    EXPECT_EQ(grabs(horz, row.x, row.y, kNorthSouth), row.grabbed) << row.x << ", " << row.y;
  const Row vertRows[] = {{100, 60, true},   {101, 159, true}, {99, 100, false},
                          {102, 100, false}, {100, 59, false}, {100, 160, false}};
  for (const auto& row : vertRows)
    EXPECT_EQ(grabs(vert, row.x, row.y, kEastWest), row.grabbed) << row.x << ", " << row.y;

  windowing.captures.clear();
  EXPECT_FALSE(grabs(horz, 50, 81, kNorthSouth, 2) || grabs(horz, 50, 81, kNorthSouth, 3));
  EXPECT_FALSE(grabs(horz, 50, 81, kEastWest) || grabs(horz, 50, 81, kDefault));
  EXPECT_FALSE(grabs(vert, 100, 60, kEastWest, 2) || grabs(vert, 100, 60, kNorthSouth));
  EXPECT_TRUE(windowing.captures.empty());
}

TEST_F(SplitterBarsTest, HoveringShowsTheSizingPointerOverTheBarWithinItsLimits) {
  const struct {
    float top, y;
    MousePointer pointer;
  } horzRows[] = {{100, 80, kNorthSouth},
                  {100, 79, kDefault},
                  {100, 119, kNorthSouth},
                  {100, 120, kDefault},
                  // The band of 50 begins at 30, the usable area at 40; none lies below 40 + 300 - 20.
                  {50, 39, kDefault},
                  {50, 40, kNorthSouth},
                  {345, 319, kDefault},
                  {345, 320, kNorthSouth}};
  for (const auto& row : horzRows) {
    horz.SplitterBarTop(row.top);
    EXPECT_EQ(hovering(horz, 50, row.y), row.pointer) << row.top << ", " << row.y;
  }
  const struct {
    float left, x;
    MousePointer pointer;
  } vertRows[] = {{100, 99, kDefault}, {100, 100, kEastWest}, {100, 103, kEastWest}, {100, 104, kDefault},
                  {3, 9, kDefault},    {3, 10, kEastWest},    {500, 407, kDefault},  {500, 408, kEastWest}};
  for (const auto& row : vertRows) {
    vert.SplitterBarLeft(row.left);
    EXPECT_EQ(hovering(vert, row.x, 100), row.pointer) << row.left << ", " << row.x;
  }
  clsVertSplitterBar usual(gdi, windowing, ScreenMetrics{15.0F, 15.0F});
  usual.DrawingSurface(&surface);
  usual.SplitterBarHeight(100);
  usual.SplitterBarLeft(100);  // the drawn width, 2 / 15, rounds to no unit at all
  EXPECT_EQ(hovering(usual, 100, 50), kEastWest);
}

TEST_F(SplitterBarsTest, NothingMovesWhileDraggingAndTheHorizontalBarJumpsByTheDistanceOnRelease) {
  pressHorz(90);
  horz.MouseMove(1, 0, 50, 300);  // far from the bar, and still the sizing pointer
  EXPECT_TRUE(surface.pointers.empty());
  EXPECT_EQ(horz.SplitterBarTop(), 100);
  EXPECT_EQ(releaseHorz(146), 156);  // 100 + (146 - 90)
  // (156 - 40) / (300 - 40): the way is the usable height less the top.
  EXPECT_FLOAT_EQ(horz.RelativePosition(), 116.0F / 260.0F);
  EXPECT_FALSE(horz.MouseCaptured());
  EXPECT_EQ(surface.pointer, kDefault);
  EXPECT_EQ(windowing.releases, 1);
  EXPECT_EQ(surface.refreshes, 1);

  pressHorz(156);
  EXPECT_EQ(releaseHorz(-500), 40);  // lands at the edges of the usable area
  EXPECT_EQ(horz.RelativePosition(), 0);
  pressHorz(50);
  EXPECT_EQ(releaseHorz(331), 320);  // 40 + (331 - 50) is 321; 20 above 40 + 300
  pressHorz(320);
  surface.useableHeight = 40;  // nothing between the top and the usable height
  EXPECT_EQ(raised([&] { return releaseHorz(350); }), "Division by zero");
  EXPECT_EQ(horz.SplitterBarTop(), 320);
  EXPECT_FALSE(horz.MouseCaptured());
}

TEST_F(SplitterBarsTest, TheVerticalBarJumpsToTheReleasePositionWithinTheSurface) {
  EXPECT_EQ(dragVert(210), 210);             // not moved by the distance from the press
  EXPECT_EQ(vert.RelativePosition(), 0.5F);  // (210 - 10) / 400
  EXPECT_EQ(surface.pointer, kDefault);
  EXPECT_FALSE(vert.MouseCaptured());
  EXPECT_EQ(windowing.releases, 1);
  EXPECT_EQ(surface.refreshes, 1);
  vert.SplitterBarLeft(100);
  EXPECT_EQ(dragVert(-7), 10);
  EXPECT_EQ(vert.SplitterBarLeftRelative(), 0);
  vert.SplitterBarLeft(100);
  EXPECT_EQ(dragVert(1000), 408);  // 10 + 400 less its own 2
}

TEST_F(SplitterBarsTest, WithoutAPreviousCaptureThereIsNoDragButTheReleaseStillMovesTheBar) {
  windowing.captured = {};
  pressHorz(105);
  EXPECT_FALSE(horz.MouseCaptured());
  EXPECT_EQ(windowing.captures, std::vector{WindowHandle{77}});
  EXPECT_EQ(releaseHorz(135), 130);  // 30 further down than the press
}

TEST_F(SplitterBarsTest, AReleaseUnderAnotherPointerOnlyLetsGo) {
  pressHorz(100);
  surface.pointer = kDefault;
  EXPECT_EQ(releaseHorz(200), 100);
  EXPECT_EQ(windowing.releases, 1);
  EXPECT_FALSE(horz.MouseCaptured());
  windowing.captured = WindowHandle{5};  // another window's capture is left alone
  EXPECT_EQ(releaseHorz(200), 100);
  EXPECT_EQ(windowing.releases, 1);
  EXPECT_EQ(surface.refreshes, 0);
}

TEST_F(SplitterBarsTest, WritingTheRelativePositionMovesAndRefreshesWritingItsOtherNameDoesNot) {
  horz.SplitterBarTopRelative(0.25F);
  vert.SplitterBarLeftRelative(0.75F);
  EXPECT_EQ(horz.RelativePosition(), 0.25F);
  EXPECT_EQ(vert.RelativePosition(), 0.75F);
  EXPECT_EQ(horz.SplitterBarTop(), 100);
  EXPECT_EQ(vert.SplitterBarLeft(), 100);
  EXPECT_EQ(surface.refreshes, 0);
  horz.RelativePosition(0.5F);
  vert.RelativePosition(0.25F);
  EXPECT_EQ(horz.SplitterBarTopRelative(), 0.5F);
  EXPECT_EQ(horz.SplitterBarTop(), 170);   // 40 + (300 - 40) / 2
  EXPECT_EQ(vert.SplitterBarLeft(), 110);  // 10 + 400 / 4
  surface.useableHeight = 240;
  surface.scaleWidth = 200;
  horz.Resize();
  vert.Resize();
  EXPECT_EQ(horz.SplitterBarTop(), 140);  // 40 + (240 - 40) / 2
  EXPECT_EQ(vert.SplitterBarLeft(), 60);
  EXPECT_EQ(surface.refreshes, 4);
}

TEST_F(SplitterBarsTest, AreDrawnRaisedOnTheirSurfaceABumpAndASunkenEdgeWhereTheyAreToldTo) {
  horz.SplitterBarTop(100.5F);
  horz.SplitterBarHeight(90);
  vert.SplitterBarLeft(100.5F);
  const DcHandle memory = gdi.createCompatibleDC({});
  horz.Refresh();
  horz.Paint(memory, 1, 2.5F, 30, 40);
  vert.Refresh();
  vert.Paint(memory);
  // Halves to even: 100.5 and 120.5; 2.5 and 42.5; 100.5, 102.5 and 104.5. The surface gets the vertical
  // bar's drawn width (4), another device context the stored one (2).
  EXPECT_EQ(gdi.edges(), (std::vector<EdgeValue>{{surface.dc, {10, 100, 210, 120}, 5, 15},
                                                 {memory, {1, 2, 31, 42}, 9, 15},
                                                 {surface.dc, {100, 60, 104, 160}, 5, 15},
                                                 {memory, {100, 60, 102, 160}, 10, 15}}));
  EXPECT_EQ(surface.drawModes, (std::vector{DrawMode::NotXorPen, DrawMode::CopyPen}));
}

TEST_F(SplitterBarsTest, WithoutASurfaceEveryUseRaises) {
  EXPECT_EQ(raised([&] { return clsHorzSplitterBar(gdi, windowing).MouseOver(0, 0); }),
            "Object variable or With block variable not set");
}

}  // namespace
}  // namespace frontpanels::testing

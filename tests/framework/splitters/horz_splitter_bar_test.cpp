#include "framework/splitters/horz_splitter_bar.h"

#include <gtest/gtest.h>

#include "platform/runtime_error.h"
#include "tests/support/fake_surface.h"
#include "tests/support/recording_gdi.h"

namespace frontpanels::testing {
namespace {

constexpr std::int16_t kLeft = 1;
constexpr std::int16_t kRight = 2;

// A surface of which (10, 40) to (210, 340) is usable, and a bar drawn at 100 to 120.
class HorzSplitterBarTest : public ::testing::Test {
 protected:
  HorzSplitterBarTest() {
    surface.dc = gdi.viewDc();
    surface.scaleLeft = 10;
    surface.scaleTop = 40;
    surface.scaleWidth = 900;  // the horizontal bar keeps to what is usable of it
    surface.scaleHeight = 900;
    surface.useableWidth = 200;
    surface.useableHeight = 300;
    bar.DrawingSurface(&surface);
    bar.SplitterBarTop(100);
  }

  void press(float y) {
    surface.pointer = MousePointer::SizeNorthSouth;
    bar.MouseDown(kLeft, 0, 50, y);
  }
  void release(float y) { bar.MouseUp(kLeft, 0, 50, y); }

  RecordingGdi gdi;
  FakeTraceForm surface;
  FakeWindowing windowing;
  clsHorzSplitterBar bar{gdi, windowing};
};

TEST_F(HorzSplitterBarTest, AssigningTheSurfaceResetsTheHeightAndNothingElse) {
  bar.SplitterBarHeight(33);
  EXPECT_EQ(bar.BarWidth(), 20);
  bar.DrawingSurface(&surface);
  EXPECT_EQ(bar.SplitterBarHeight(), 20);
  EXPECT_EQ(bar.SplitterBarTop(), 100);
  EXPECT_EQ(surface.refreshes, 0);
}

TEST_F(HorzSplitterBarTest, IsGrabbedByABandTwentyUnitsAboveAndBelowItsTop) {
  bar.SplitterBarHeight(90);  // has no say
  const struct {
    float x;
    float y;
    bool over;
  } rows[] = {{50, 80, true},   {50, 79, false},   {50, 119, true},  {50, 120, false},
              {10, 100, true},  {9, 100, false},   {209, 100, true}, {210, 100, false},
              {50, 79.5, true}, {50, 119.5, false}};  // halves to even: 80, 120
  for (const auto& row : rows) EXPECT_EQ(bar.MouseOver(row.x, row.y), row.over) << row.x << ", " << row.y;
}

TEST_F(HorzSplitterBarTest, APressStartsADragOnlyWithTheLeftButtonOnTheBandUnderTheSizingPointer) {
  const struct {
    std::int16_t button;
    float y;
    MousePointer pointer;
    bool captured;
  } rows[] = {
      {kLeft, 81, MousePointer::SizeNorthSouth, true}, {kRight, 81, MousePointer::SizeNorthSouth, false},
      {3, 81, MousePointer::SizeNorthSouth, false},    {kLeft, 79, MousePointer::SizeNorthSouth, false},
      {kLeft, 81, MousePointer::SizeEastWest, false},  {kLeft, 81, MousePointer::Default, false}};
  for (const auto& row : rows) {
    clsHorzSplitterBar fresh(gdi, windowing);
    fresh.DrawingSurface(&surface);
    fresh.SplitterBarTop(100);
    windowing.captures.clear();
    surface.pointer = row.pointer;
    fresh.MouseDown(row.button, 0, 50, row.y);
    EXPECT_EQ(fresh.MouseCaptured(), row.captured) << row.button << ' ' << row.y;
    EXPECT_EQ(windowing.captures.size(), row.captured ? 1U : 0U);
  }
}

TEST_F(HorzSplitterBarTest, WithoutAPreviousCaptureThereIsNoDragButTheReleaseStillMovesTheBar) {
  windowing.captured = {};
  press(105);
  EXPECT_FALSE(bar.MouseCaptured());
  EXPECT_EQ(windowing.captures, std::vector{WindowHandle{77}});
  release(135);  // 30 further down than the press
  EXPECT_EQ(bar.SplitterBarTop(), 130);
}

TEST_F(HorzSplitterBarTest, NothingMovesWhileDraggingAndTheBarJumpsByTheDistanceOnRelease) {
  press(90);
  bar.MouseMove(kLeft, 0, 50, 300);  // far from the bar, and still the sizing pointer
  EXPECT_TRUE(surface.pointers.empty());
  EXPECT_EQ(bar.SplitterBarTop(), 100);
  release(146);
  EXPECT_EQ(bar.SplitterBarTop(), 156);  // 100 + (146 - 90)
  // (156 - 40) / (300 - 40): the way is the usable height less the top.
  EXPECT_FLOAT_EQ(bar.RelativePosition(), 116.0F / 260.0F);
  EXPECT_FALSE(bar.MouseCaptured());
  EXPECT_EQ(surface.pointer, MousePointer::Default);
  EXPECT_EQ(windowing.releases, 1);
  EXPECT_EQ(surface.refreshes, 1);
}

TEST_F(HorzSplitterBarTest, AReleaseOutsideLandsAtTheEdgesOfTheUsableArea) {
  press(100);
  release(-500);
  EXPECT_EQ(bar.SplitterBarTop(), 40);
  EXPECT_EQ(bar.RelativePosition(), 0);
  press(50);
  release(331);                          // 40 + (331 - 50)
  EXPECT_EQ(bar.SplitterBarTop(), 320);  // 20 above 40 + 300
}

TEST_F(HorzSplitterBarTest, AReleaseUnderAnotherPointerOnlyLetsGo) {
  press(100);
  surface.pointer = MousePointer::Default;
  release(200);
  EXPECT_EQ(windowing.releases, 1);
  EXPECT_FALSE(bar.MouseCaptured());
  windowing.captured = WindowHandle{5};  // another window's capture is left alone
  release(200);
  EXPECT_EQ(windowing.releases, 1);
  EXPECT_EQ(bar.SplitterBarTop(), 100);
  EXPECT_EQ(surface.refreshes, 0);
}

TEST_F(HorzSplitterBarTest, HoveringShowsTheSizingPointerWithinTheUsableAreaOnly) {
  const struct {
    float top;
    float y;
    MousePointer pointer;
  } rows[] = {{100, 80, MousePointer::SizeNorthSouth},  {100, 79, MousePointer::Default},
              {100, 119, MousePointer::SizeNorthSouth}, {100, 120, MousePointer::Default},
              {50, 39, MousePointer::Default},  // its band begins at 30, the usable area at 40
              {50, 40, MousePointer::SizeNorthSouth},   {345, 319, MousePointer::Default},
              {345, 320, MousePointer::SizeNorthSouth}};  // not below 40 + 300 - 20
  for (const auto& row : rows) {
    bar.SplitterBarTop(row.top);
    bar.MouseMove(0, 0, 50, row.y);
    EXPECT_EQ(surface.pointer, row.pointer) << row.top << ", " << row.y;
  }
}

TEST_F(HorzSplitterBarTest, WritingTheRelativePositionMovesAndRefreshesWritingItsOtherNameDoesNot) {
  bar.SplitterBarTopRelative(0.25F);
  EXPECT_EQ(bar.RelativePosition(), 0.25F);
  EXPECT_EQ(bar.SplitterBarTop(), 100);
  EXPECT_EQ(surface.refreshes, 0);
  bar.RelativePosition(0.5F);
  EXPECT_EQ(bar.SplitterBarTopRelative(), 0.5F);
  EXPECT_EQ(bar.SplitterBarTop(), 170);  // 40 + (300 - 40) / 2
  EXPECT_EQ(surface.refreshes, 1);
  surface.useableHeight = 240;
  bar.Resize();
  EXPECT_EQ(bar.SplitterBarTop(), 140);  // 40 + (240 - 40) / 2
  EXPECT_EQ(surface.refreshes, 2);
}

TEST_F(HorzSplitterBarTest, DrawsARaisedEdgeOnItsSurfaceAndABumpWhereItIsToldTo) {
  bar.SplitterBarTop(100.5F);
  bar.SplitterBarHeight(90);
  bar.Refresh();
  const DcHandle memory = gdi.createCompatibleDC({});
  bar.Paint(memory, 1, 2.5F, 30, 40);
  // Halves to even: 100.5 and 120.5; 2.5 and 42.5.
  EXPECT_EQ(gdi.edges(), (std::vector<EdgeValue>{{surface.dc, {10, 100, 210, 120}, 5, 15},
                                                 {memory, {1, 2, 31, 42}, 9, 15}}));
  EXPECT_EQ(surface.drawModes, (std::vector{DrawMode::NotXorPen, DrawMode::CopyPen}));
}

TEST_F(HorzSplitterBarTest, OnACollapsedSurfaceAReleaseRaisesAndKeepsThePlace) {
  press(100);
  surface.useableHeight = 40;  // nothing between the top and the usable height
  EXPECT_THROW(release(150), RuntimeError);
  EXPECT_EQ(bar.SplitterBarTop(), 100);
  EXPECT_FALSE(bar.MouseCaptured());
}

TEST_F(HorzSplitterBarTest, WithoutASurfaceEveryUseRaises) {
  clsHorzSplitterBar loose(gdi, windowing);
  try {
    static_cast<void>(loose.MouseOver(0, 0));
    FAIL() << "nothing was raised";
  } catch (const RuntimeError& error) {
    EXPECT_EQ(error.description(), "Object variable or With block variable not set");
  }
}

}  // namespace
}  // namespace frontpanels::testing

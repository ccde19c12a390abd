#include "framework/splitters/vert_splitter_bar.h"

#include <gtest/gtest.h>

#include "tests/support/fake_surface.h"
#include "tests/support/recording_gdi.h"

namespace frontpanels::testing {
namespace {

constexpr std::int16_t kLeft = 1;
constexpr std::int16_t kRight = 2;

// A surface from (10, 40) to (410, 340) and a bar from (100, 60) to (102, 160).
class VertSplitterBarTest : public ::testing::Test {
 protected:
  VertSplitterBarTest() {
    surface.dc = gdi.viewDc();
    surface.scaleLeft = 10;
    surface.scaleTop = 40;
    surface.scaleWidth = 400;
    surface.scaleHeight = 300;
    surface.useableWidth = 50;  // the vertical bar goes by the whole scale
    surface.useableHeight = 50;
    bar.DrawingSurface(&surface);
    bar.SplitterBarLeft(100);
    bar.SplitterBarTop(60);
    bar.SplitterBarHeight(100);
  }

  void press(float x) {
    surface.pointer = MousePointer::SizeEastWest;
    bar.MouseDown(kLeft, 0, x, 100);
  }
  void release(float x) { bar.MouseUp(kLeft, 0, x, 100); }

  RecordingGdi gdi;
  FakeTraceForm surface;
  FakeWindowing windowing;
  clsVertSplitterBar bar{gdi, windowing, ScreenMetrics{0.5F, 15.0F}};
};

TEST_F(VertSplitterBarTest, ItsWidthReadsInTheScreensTwipsPerPixel) {
  EXPECT_EQ(bar.BarWidth(), 4);  // 2 / 0.5
  clsVertSplitterBar usual(gdi, windowing, ScreenMetrics{15.0F, 15.0F});
  EXPECT_EQ(usual.BarWidth(), 0);
  usual.DrawingSurface(&surface);
  EXPECT_FLOAT_EQ(usual.BarWidth(), 2.0F / 15.0F);
}

TEST_F(VertSplitterBarTest, ItsBottomIsTopPlusHeightAndWritingItMeasuresFromTheSurfacesTop) {
  EXPECT_EQ(bar.SplitterBarBottom(), 160);
  bar.SplitterBarTop(40);
  bar.SplitterBarBottom(150);
  EXPECT_EQ(bar.SplitterBarHeight(), 110);
  EXPECT_EQ(bar.SplitterBarBottom(), 150);
  bar.SplitterBarBottom(30);
  EXPECT_EQ(bar.SplitterBarHeight(), 0);
}

TEST_F(VertSplitterBarTest, APressStartsADragOnlyWithTheLeftButtonOnTheBarUnderTheSizingPointer) {
  const struct {
    std::int16_t button;
    Point at;
    MousePointer pointer;
    bool captured;
  } rows[] = {{kLeft, {100, 60}, MousePointer::SizeEastWest, true},
              {kLeft, {101, 159}, MousePointer::SizeEastWest, true},
              {kLeft, {99, 100}, MousePointer::SizeEastWest, false},
              {kLeft, {102, 100}, MousePointer::SizeEastWest, false},
              {kLeft, {100, 59}, MousePointer::SizeEastWest, false},
              {kLeft, {100, 160}, MousePointer::SizeEastWest, false},
              {kRight, {100, 60}, MousePointer::SizeEastWest, false},
              {kLeft, {100, 60}, MousePointer::SizeNorthSouth, false}};
  for (const auto& row : rows) {
    clsVertSplitterBar fresh = bar;
    surface.pointer = row.pointer;
    fresh.MouseDown(row.button, 0, static_cast<float>(row.at.x), static_cast<float>(row.at.y));
    EXPECT_EQ(fresh.MouseCaptured(), row.captured) << row.at;
  }
}

TEST_F(VertSplitterBarTest, NothingMovesWhileDraggingAndTheBarJumpsToTheReleasePosition) {
  press(101);
  bar.MouseMove(kLeft, 0, 300, 100);
  EXPECT_TRUE(surface.pointers.empty());
  release(210);
  EXPECT_EQ(bar.SplitterBarLeft(), 210);    // not moved by the distance from the press
  EXPECT_EQ(bar.RelativePosition(), 0.5F);  // (210 - 10) / 400
  EXPECT_EQ(surface.pointer, MousePointer::Default);
  EXPECT_FALSE(bar.MouseCaptured());
  EXPECT_EQ(windowing.releases, 1);
  EXPECT_EQ(surface.refreshes, 1);
}

TEST_F(VertSplitterBarTest, AReleaseOutsideLandsInsideTheSurface) {
  press(100);
  release(-7);
  EXPECT_EQ(bar.SplitterBarLeft(), 10);
  EXPECT_EQ(bar.SplitterBarLeftRelative(), 0);
  surface.pointer = MousePointer::SizeEastWest;
  release(1000);
  EXPECT_EQ(bar.SplitterBarLeft(), 408);  // 10 + 400 less its own 2
}

TEST_F(VertSplitterBarTest, HoveringShowsTheSizingPointerOverTheDrawnWidth) {
  const struct {
    float left;
    float x;
    MousePointer pointer;
  } rows[] = {{100, 99, MousePointer::Default},       {100, 100, MousePointer::SizeEastWest},
              {100, 103, MousePointer::SizeEastWest}, {100, 104, MousePointer::Default},
              {3, 9, MousePointer::Default},          {3, 10, MousePointer::SizeEastWest},
              {500, 407, MousePointer::Default},      {500, 408, MousePointer::SizeEastWest}};
  for (const auto& row : rows) {
    bar.SplitterBarLeft(row.left);
    bar.MouseMove(0, 0, row.x, 100);
    EXPECT_EQ(surface.pointer, row.pointer) << row.left << ", " << row.x;
  }
}

TEST_F(VertSplitterBarTest, AtTheUsualScaleThePointerStillFindsTheBar) {
  clsVertSplitterBar usual(gdi, windowing, ScreenMetrics{15.0F, 15.0F});
  usual.DrawingSurface(&surface);
  usual.SplitterBarLeft(100);
  usual.SplitterBarHeight(100);
  usual.MouseMove(0, 0, 100, 50);  // the drawn width, 2 / 15, rounds to no unit at all
  EXPECT_EQ(surface.pointer, MousePointer::SizeEastWest);
}

TEST_F(VertSplitterBarTest, WritingTheRelativePositionMovesAndRefreshesWritingItsOtherNameDoesNot) {
  bar.SplitterBarLeftRelative(0.75F);
  EXPECT_EQ(bar.RelativePosition(), 0.75F);
  EXPECT_EQ(bar.SplitterBarLeft(), 100);
  EXPECT_EQ(surface.refreshes, 0);
  bar.RelativePosition(0.25F);
  EXPECT_EQ(bar.SplitterBarLeft(), 110);  // 10 + 400 / 4
  surface.scaleWidth = 200;
  bar.Resize();
  EXPECT_EQ(bar.SplitterBarLeft(), 60);
  EXPECT_EQ(surface.refreshes, 2);
}

TEST_F(VertSplitterBarTest, DrawsARaisedEdgeOnItsSurfaceAndASunkenOneWhereItIsToldTo) {
  bar.SplitterBarLeft(100.5F);
  bar.Refresh();
  const DcHandle memory = gdi.createCompatibleDC({});
  bar.Paint(memory);
  // The surface gets the drawn width (4), another device context the stored one (2); halves to even.
  EXPECT_EQ(gdi.edges(), (std::vector<EdgeValue>{{surface.dc, {100, 60, 104, 160}, 5, 15},
                                                 {memory, {100, 60, 102, 160}, 10, 15}}));
}

}  // namespace
}  // namespace frontpanels::testing

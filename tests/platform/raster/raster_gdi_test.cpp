// Small pictures ('#' is ink, '.' is what lay there before) and what the comparison with the real interface,
// which proves the pixel rules, does not reach: handles, far co-ordinates, whole rows, texts, screens.
#include "platform/raster/raster_gdi.h"

#include <gtest/gtest.h>

#include <limits>
#include <string>

#include "platform/gdi_scope.h"

namespace frontpanels {
namespace {

constexpr Color kInk = rgb(255, 255, 255);
constexpr Color kBack = rgb(0, 0, 200);
constexpr std::int32_t kFar = std::numeric_limits<std::int32_t>::max();

class RasterGdiTest : public ::testing::Test {
 protected:
  void canvas(Size sizePx) { dc = gdi.createScreen(sizePx); }

  // 'o' is the background colour kBack.
  std::string picture() {
    const PixelView view = gdi.pixels(dc);
    std::string rows;
    for (std::int32_t y = 0; y < view.sizePx.height; ++y) {
      for (std::int32_t x = 0; x < view.sizePx.width; ++x) {
        const Color color = view.at(x, y);
        rows += color == kInk ? '#' : color == kBack ? 'o' : color == Color{} ? '.' : '?';
      }
      rows += '\n';
    }
    return rows;
  }

  void draw(std::initializer_list<Point> points, PenStyle style = PenStyle::Solid, std::int32_t widthPx = 1) {
    const SelectedPen pen(gdi, dc, style, widthPx, kInk);
    EXPECT_TRUE(gdi.polyline(dc, std::span(points.begin(), points.size())));
  }

  void clipTo(Rect rect) {
    const RegionHandle region = gdi.createRectRgn(rect);
    gdi.selectClipRgn(dc, region);
    gdi.deleteObject(region);  // the device context keeps a copy
  }

  RasterGdi gdi;
  DcHandle dc{};
};

TEST_F(RasterGdiTest, ALineLeavesOutItsLastPointAndATieGoesUpOrLeft) {
  canvas({11, 5});
  draw({{0, 0}, {4, 1}});   // 0, 0.25, 0.5 (tie), 0.75
  draw({{10, 1}, {6, 0}});  // the same heights from the other end
  draw({{0, 1}, {1, 5}});   // steep: a tie goes left
  draw({{9, 4}, {3, 4}});
  draw({{2, 2}, {2, 2}});  // a point alone is nothing
  EXPECT_EQ(picture(),
            "###....##..\n"
            "#..#.....##\n"
            "#..........\n"
            "#..........\n"
            ".#..######.\n");
  const Point one{1, 1};
  EXPECT_FALSE(gdi.polyline(dc, std::span(&one, 1)));
}

TEST_F(RasterGdiTest, ClippingCutsPixelsAwayAndMovesNone) {
  canvas({10, 4});
  clipTo({3, 1, 7, 3});
  draw({{0, 0}, {9, 3}});  // unclipped: runs of 2, 3, 3 and 1
  draw({{7, 1}, {6, 1}});  // starts on the right border, which is outside
  draw({{3, 0}, {7, 0}});  // one row above, one below, one column to the left
  draw({{3, 3}, {7, 3}});
  draw({{2, 1}, {2, 3}});
  EXPECT_EQ(picture(),
            "..........\n"
            "...##.....\n"
            ".....##...\n"
            "..........\n");
  canvas({4, 3});
  draw({{-kFar, -kFar}, {kFar, kFar}});  // from far away: the diagonal that it is
  EXPECT_EQ(picture(), "#...\n.#..\n..#.\n");
}

TEST_F(RasterGdiTest, DashesRunOnFromSegmentToSegmentAndGapsAreFilledOnlyWhenOpaque) {
  canvas({26, 2});
  gdi.setBkColor(dc, kBack);
  draw({{0, 0}, {26, 0}}, PenStyle::DashDot);  // 9, gap 6, 3, gap 6
  gdi.setBkMode(dc, BackgroundMode::Transparent);
  draw({{-4, 1}, {4, 1}, {7, 1}, {13, 1}}, PenStyle::Dot);  // 3, gap 3, counted where it is clipped too
  EXPECT_EQ(picture(),
            "#########oooooo###oooooo##\n"
            "..###...###...............\n");
}

// Rows of sixteen pixels lie one behind the other in memory and are filled and copied in one go.
TEST_F(RasterGdiTest, WholeRowsAreFilledAndCopiedWithoutTheirNeighbours) {
  canvas({16, 4});
  const DcHandle memory = gdi.createCompatibleDC(dc);
  gdi.selectObject(memory, gdi.createCompatibleBitmap(dc, {16, 4}));
  gdi.fillRect(memory, {-3, 1, 99, 3}, gdi.stockBrush(StockBrush::White));
  gdi.fillRect(memory, {0, 2, 1, 3}, gdi.stockBrush(StockBrush::Black));
  gdi.bitBlt(dc, {0, 0, 16, 2}, memory, {0, 1}, RasterOp::SourceCopy);
  gdi.bitBlt(dc, {1, 2, 16, 3}, memory, {1, 1}, RasterOp::SourceCopy);
  gdi.fillRect(dc, {1, 3, 16, 4}, gdi.stockBrush(StockBrush::White));
  EXPECT_EQ(picture(),
            "################\n"
            ".###############\n"
            ".###############\n"
            ".###############\n");
}

TEST_F(RasterGdiTest, OpaqueTextFillsTheCellOfWindowsForTheSameFont) {
  canvas({60, 20});
  const FontHandle font = gdi.createFont({"Liberation Sans", 11, 400, false});
  ASSERT_TRUE(font) << "no font is installed";
  gdi.selectObject(dc, font);
  // Ascent 0.905 and descent 0.212 of 11 pixels, rounded: 10 + 2. A digit is 6 pixels wide, the minus sign 4.
  EXPECT_EQ(gdi.textExtent(dc, "-10"), (Size{16, 12}));
  EXPECT_EQ(gdi.textExtent(dc, ""), (Size{0, 0}));
  EXPECT_GT(gdi.textExtent(dc, "\xE2\x82").width, 0);  // malformed UTF-8 is replaced, never read past
  gdi.setTextColor(dc, kInk);
  gdi.setBkColor(dc, kBack);
  EXPECT_TRUE(gdi.textOut(dc, {3, 2}, "-10"));
  const PixelView view = gdi.pixels(dc);
  EXPECT_EQ(view.at(3, 2), kBack);
  EXPECT_EQ(view.at(18, 13), kBack);
  EXPECT_EQ(view.at(19, 2), Color{});
  EXPECT_EQ(view.at(3, 14), Color{});
  EXPECT_NE(picture().find('#'), std::string::npos);
}

TEST_F(RasterGdiTest, TextOutsideTheClipLeavesNoTrace) {
  canvas({20, 20});
  gdi.setTextColor(dc, kInk);
  gdi.setBkMode(dc, BackgroundMode::Transparent);
  clipTo({0, 0, 20, 2});
  gdi.textOut(dc, {-30, 4}, "868.3 MHz");
  gdi.textOut(dc, {kFar - 3, kFar - 3}, "868.3");
  gdi.textOut(dc, {-kFar, -kFar}, "868.3");
  EXPECT_EQ(picture().find('#'), std::string::npos);
}

TEST_F(RasterGdiTest, UnknownHandlesFailAndChangeNothing) {
  canvas({3, 1});
  const Rect all{0, 0, 3, 1};
  const BrushHandle white = gdi.stockBrush(StockBrush::White);
  const BrushHandle gone = gdi.createSolidBrush(kInk);
  EXPECT_TRUE(gdi.deleteObject(gone));
  const BrushHandle reused = gdi.createSolidBrush(kInk);  // in the same slot: the old handle stays dead
  EXPECT_FALSE(gdi.deleteObject(gone) || gdi.deleteObject(white) || gdi.deleteDC(DcHandle{12345}));
  EXPECT_FALSE(gdi.fillRect(dc, all, gone) || gdi.fillRect({}, all, white));
  EXPECT_FALSE(gdi.fillRect(DcHandle{12345}, all, white) || gdi.lineTo({}, {1, 1}));
  EXPECT_FALSE(gdi.selectObject(dc, PenHandle{}) || gdi.selectClipRgn(dc, RegionHandle{77}));
  EXPECT_FALSE(gdi.createCompatibleBitmap(dc, {-1, 5}) || gdi.createCompatibleBitmap(dc, {40000, 40000}));
  EXPECT_TRUE(gdi.deleteObject(reused));
  EXPECT_EQ(picture(), "...\n");
  EXPECT_EQ(gdi.liveObjects(), 0U);
}

TEST_F(RasterGdiTest, WhatIsSelectedCannotBeDeletedAndABitmapLiesInOneDeviceContext) {
  canvas({3, 3});
  const DcHandle a = gdi.createCompatibleDC({});
  const DcHandle b = gdi.createCompatibleDC({});
  const BitmapHandle bitmap = gdi.createCompatibleBitmap({}, {5, 5});
  const BitmapHandle stock = gdi.selectObject(a, bitmap);
  const PenHandle pen = gdi.createPen(PenStyle::Solid, 1, kInk);
  gdi.selectObject(a, pen);
  EXPECT_FALSE(gdi.selectObject(b, bitmap));
  EXPECT_FALSE(gdi.deleteObject(bitmap));
  EXPECT_FALSE(gdi.deleteObject(pen));
  EXPECT_EQ(gdi.selectObject(a, stock), bitmap);
  EXPECT_TRUE(gdi.deleteDC(a));  // lets the pen go
  EXPECT_TRUE(gdi.deleteDC(b));
  EXPECT_TRUE(gdi.deleteObject(pen));
  EXPECT_TRUE(gdi.deleteObject(bitmap));
  EXPECT_EQ(gdi.liveObjects(), 0U);
  EXPECT_EQ(gdi.liveDcs(), 0U);
}

TEST_F(RasterGdiTest, AScreenKeepsItsHandleWhenItIsResizedAndStartsBlack) {
  canvas({2, 1});
  gdi.setSysColor(SystemColor::ButtonFace, kBack);
  gdi.fillRect(dc, {0, 0, 2, 1}, gdi.sysColorBrush(SystemColor::ButtonFace));
  EXPECT_FALSE(gdi.resizeScreen(dc, {0, 3}));
  EXPECT_EQ(picture(), "oo\n");
  EXPECT_TRUE(gdi.resizeScreen(dc, {3, 2}));
  gdi.fillRect(dc, {2, 1, 9, 9}, gdi.stockBrush(StockBrush::White));
  EXPECT_EQ(picture(), "...\n..#\n");
}

}  // namespace
}  // namespace frontpanels

// The pixel rules of the graphics interface, as small pictures: '#' is ink, '.' is what lay there before.
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

TEST_F(RasterGdiTest, ALineLeavesOutItsLastPointInEveryDirection) {
  canvas({7, 5});
  draw({{1, 0}, {5, 0}});
  draw({{5, 2}, {1, 2}});
  draw({{0, 0}, {0, 4}});
  draw({{6, 4}, {6, 0}});
  draw({{3, 4}, {3, 4}});  // a point alone is nothing
  EXPECT_EQ(picture(),
            "#####..\n"
            "#.....#\n"
            "#.#####\n"
            "#.....#\n"
            "......#\n");
}

// The line rises one pixel in four: the middle of the second step is a tie, which goes up whatever the
// direction.
TEST_F(RasterGdiTest, ATieGoesUpOnAFlatLine) {
  canvas({11, 2});
  draw({{0, 0}, {4, 1}});   // 0, 0.25, 0.5 (tie), 0.75
  draw({{10, 1}, {6, 0}});  // the same heights from the other end
  EXPECT_EQ(picture(),
            "###....##..\n"
            "...#.....##\n");
}

TEST_F(RasterGdiTest, ATieGoesLeftOnASteepLine) {
  canvas({5, 5});
  draw({{0, 0}, {1, 4}});
  draw({{4, 4}, {3, 0}});
  EXPECT_EQ(picture(),
            "#....\n"
            "#..#.\n"
            "#..#.\n"
            ".#..#\n"
            "....#\n");
}

// Every three pixels one across: runs of 2, 3, 3 and 1.
TEST_F(RasterGdiTest, AGentleSlopeIsRunsOfTheRightLengths) {
  canvas({10, 4});
  draw({{0, 0}, {9, 3}});
  EXPECT_EQ(picture(),
            "##........\n"
            "..###.....\n"
            ".....###..\n"
            "........#.\n");
}

TEST_F(RasterGdiTest, ClippingCutsPixelsAwayAndMovesNone) {
  canvas({10, 4});
  clipTo({3, 1, 7, 3});
  draw({{0, 0}, {9, 3}});
  EXPECT_EQ(picture(),
            "..........\n"
            "...##.....\n"
            ".....##...\n"
            "..........\n");
}

TEST_F(RasterGdiTest, LinesFromTheBordersOfTheClipStayWithinIt) {
  canvas({6, 5});
  clipTo({1, 1, 5, 4});
  draw({{5, 1}, {2, 1}});  // starts on the right border, which is outside
  draw({{2, 4}, {2, 2}});  // and on the lower one
  draw({{4, 0}, {4, 9}});
  EXPECT_EQ(picture(),
            "......\n"
            "...##.\n"
            "....#.\n"
            "..#.#.\n"
            "......\n");
}

// From four pixels outside: at x = 2 the line is half way between two rows, which still goes up.
TEST_F(RasterGdiTest, ATieOfAClippedLineGoesUpOrLeftToo) {
  canvas({5, 2});
  draw({{-4, -1}, {4, 1}});
  EXPECT_EQ(picture(), "###..\n...#.\n");
  canvas({2, 5});
  draw({{-1, -4}, {1, 4}});
  EXPECT_EQ(picture(), "#.\n#.\n#.\n.#\n..\n");
}

// Ties at the third and the seventh pixel.
TEST_F(RasterGdiTest, ARisingLineWithSeveralTiesTakesEachUp) {
  canvas({9, 3});
  draw({{0, 2}, {8, 0}});
  EXPECT_EQ(picture(),
            "......##.\n"
            "..####...\n"
            "##.......\n");
}

TEST_F(RasterGdiTest, ALineFromFarAwayShowsTheDiagonalThatItIs) {
  canvas({4, 3});
  draw({{-kFar, -kFar}, {kFar, kFar}});
  EXPECT_EQ(picture(),
            "#...\n"
            ".#..\n"
            "..#.\n");
}

TEST_F(RasterGdiTest, LinesThatEndOnTheRightOrLowerBorderTouchIt) {
  canvas({4, 3});
  draw({{1, 1}, {4, 1}});
  draw({{1, 1}, {1, 3}});
  draw({{4, 0}, {0, 0}});
  EXPECT_EQ(picture(),
            ".###\n"
            ".###\n"
            ".#..\n");
}

TEST_F(RasterGdiTest, APolylineOfOnePointIsRefused) {
  canvas({2, 2});
  const Point one{1, 1};
  EXPECT_FALSE(gdi.polyline(dc, std::span(&one, 1)));
}

TEST_F(RasterGdiTest, LineToGoesOnFromWhereTheLastOneEnded) {
  canvas({5, 3});
  const SelectedPen pen(gdi, dc, PenStyle::Solid, 1, kInk);
  gdi.moveTo(dc, {0, 0});
  gdi.lineTo(dc, {3, 0});
  gdi.lineTo(dc, {3, 3});
  EXPECT_EQ(picture(),
            "####.\n"
            "...#.\n"
            "...#.\n");
}

// A body of 2 x 2 squares: a wide line covers the pixel of its point and those to the left and above.
TEST_F(RasterGdiTest, APenOfTwoPixelsReachesUpAndToTheLeftAndHasItsLastPoint) {
  canvas({9, 5});
  draw({{1, 1}, {7, 3}}, PenStyle::Solid, 2);
  EXPECT_EQ(picture(),
            "##.......\n"
            "#####....\n"
            ".#######.\n"
            "....####.\n"
            ".........\n");
}

TEST_F(RasterGdiTest, NotXorDrawnTwiceLeavesWhatWasThere) {
  canvas({6, 4});
  gdi.fillRect(dc, {2, 1, 4, 3}, gdi.stockBrush(StockBrush::White));
  const std::string before = picture();
  gdi.setRop2(dc, DrawMode::NotXorPen);
  const SelectedPen black(gdi, dc, PenStyle::Solid, 1, rgb(0, 0, 0));
  const Point across[] = {{0, 1}, {6, 1}};
  gdi.polyline(dc, across);
  EXPECT_EQ(picture(),  // not (back xor black): what is black turns white, what is white black
            "......\n"
            "##..##\n"
            "..##..\n"
            "......\n");
  gdi.polyline(dc, across);
  EXPECT_EQ(picture(), before);
}

TEST_F(RasterGdiTest, DashesCountPixelsAlongTheLongerAxisAndGapsAreFilledOnlyWhenOpaque) {
  canvas({26, 5});
  gdi.setBkColor(dc, kBack);
  draw({{0, 0}, {26, 0}}, PenStyle::Dash);        // 18, gap 6
  draw({{0, 1}, {26, 1}}, PenStyle::Dot);         // 3, gap 3
  draw({{0, 2}, {26, 2}}, PenStyle::DashDot);     // 9, gap 6, 3, gap 6
  draw({{0, 3}, {26, 3}}, PenStyle::DashDotDot);  // 9, gap 3, 3, gap 3, 3, gap 3
  gdi.setBkMode(dc, BackgroundMode::Transparent);
  draw({{-4, 4}, {4, 4}, {7, 4}, {13, 4}},
       PenStyle::Dot);  // runs on from segment to segment, also where it is clipped
  EXPECT_EQ(picture(),
            "##################oooooo##\n"
            "###ooo###ooo###ooo###ooo##\n"
            "#########oooooo###oooooo##\n"
            "#########ooo###ooo###ooo##\n"
            "..###...###...............\n");
}

TEST_F(RasterGdiTest, AFillIsHalfOpenAndAReversedOneCoversTheOtherEnds) {
  canvas({9, 3});
  gdi.fillRect(dc, {1, 0, 3, 2}, gdi.stockBrush(StockBrush::White));
  gdi.fillRect(dc, {7, 2, 4, 0}, gdi.stockBrush(StockBrush::White));
  gdi.fillRect(dc, {8, 0, 8, 3}, gdi.stockBrush(StockBrush::White));
  gdi.fillRect(dc, {0, 0, 9, 3}, gdi.stockBrush(StockBrush::Null));
  EXPECT_EQ(picture(),
            ".##......\n"
            ".##..###.\n"
            ".....###.\n");
}

TEST_F(RasterGdiTest, HatchesStartAtTheCornerOfTheBitmap) {
  canvas({9, 9});
  const BrushHandle brush = gdi.createHatchBrush(HatchStyle::BackwardDiagonal, kInk);
  gdi.setBkMode(dc, BackgroundMode::Transparent);
  gdi.fillRect(dc, {2, 1, 9, 9}, brush);
  EXPECT_EQ(picture(),
            ".........\n"
            "......#..\n"
            ".....#...\n"
            "....#....\n"
            "...#.....\n"
            "..#......\n"
            ".........\n"
            "........#\n"
            ".......#.\n");
}

// Rings of one pixel, the outer at the rectangle's border, the inner within it; right and bottom over left
// and top.
TEST_F(RasterGdiTest, EdgesAreTwoRingsInTheSystemsColors) {
  struct Case {
    std::uint32_t edge;
    Color outerLeftTop, outerRightBottom, innerLeftTop, innerRightBottom;
  };
  constexpr Color kLight = rgb(227, 227, 227);
  constexpr Color kDark = rgb(105, 105, 105);
  constexpr Color kHighlight = rgb(255, 255, 255);
  constexpr Color kShadow = rgb(160, 160, 160);
  for (const Case& c :
       {Case{kEdgeRaised, kLight, kDark, kHighlight, kShadow}, Case{kEdgeBump, kLight, kDark, kDark, kLight},
        Case{kEdgeSunken, kShadow, kHighlight, kDark, kLight}}) {
    canvas({8, 7});
    ASSERT_TRUE(gdi.drawEdge(dc, {1, 1, 7, 6}, c.edge, kAllSides));
    const PixelView view = gdi.pixels(dc);
    EXPECT_EQ(view.at(1, 1), c.outerLeftTop);
    EXPECT_EQ(view.at(5, 1), c.outerLeftTop);
    EXPECT_EQ(view.at(6, 1), c.outerRightBottom);
    EXPECT_EQ(view.at(1, 5), c.outerRightBottom);
    EXPECT_EQ(view.at(2, 2), c.innerLeftTop);
    EXPECT_EQ(view.at(5, 2), c.innerRightBottom);
    EXPECT_EQ(view.at(2, 4), c.innerRightBottom);
    EXPECT_EQ(view.at(3, 3), Color{});  // nothing within
    EXPECT_EQ(view.at(7, 6), Color{});
  }
}

TEST_F(RasterGdiTest, ABlitIsClippedToBothBitmapsAndToTheRegion) {
  canvas({8, 3});
  const DcHandle memory = gdi.createCompatibleDC(dc);
  const BitmapHandle bitmap = gdi.createCompatibleBitmap(dc, {4, 2});
  gdi.selectObject(memory, bitmap);
  gdi.fillRect(memory, {0, 0, 4, 2}, gdi.stockBrush(StockBrush::White));
  EXPECT_TRUE(gdi.bitBlt(dc, {-1, 0, 2, 3}, memory, {0, 1}, RasterOp::SourceCopy));  // one row is left
  clipTo({5, 0, 7, 3});
  EXPECT_TRUE(gdi.bitBlt(dc, {4, 1, 8, 3}, memory, {0, 0}, RasterOp::SourceCopy));
  EXPECT_EQ(picture(),
            "##......\n"
            ".....##.\n"
            ".....##.\n");
}

TEST_F(RasterGdiTest, ABlitWithinOneBitmapReadsBeforeItWrites) {
  canvas({4, 4});
  draw({{0, 0}, {4, 0}});
  gdi.bitBlt(dc, {0, 1, 4, 4}, dc, {0, 0}, RasterOp::SourceCopy);
  EXPECT_EQ(picture(), "####\n####\n....\n....\n");
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

TEST_F(RasterGdiTest, OpaqueTextFillsTheCellThatTheExtentTells) {
  canvas({60, 20});
  const FontHandle font = gdi.createFont({"Arial", 11, 400, false});
  ASSERT_TRUE(font) << "no font is installed";
  gdi.selectObject(dc, font);
  gdi.setTextColor(dc, kInk);
  gdi.setBkColor(dc, kBack);
  const Size extent = gdi.textExtent(dc, "-100.5");
  EXPECT_TRUE(gdi.textOut(dc, {3, 2}, "-100.5"));
  const PixelView view = gdi.pixels(dc);
  EXPECT_EQ(view.at(3, 2), kBack);
  EXPECT_EQ(view.at(3 + extent.width - 1, 2 + extent.height - 1), kBack);
  EXPECT_EQ(view.at(3 + extent.width, 2), Color{});
  EXPECT_EQ(view.at(3, 2 + extent.height), Color{});
  EXPECT_NE(picture().find('#'), std::string::npos);
}

TEST_F(RasterGdiTest, ALettersCellIsThatOfWindowsForTheSameFont) {
  canvas({4, 4});
  const FontHandle font = gdi.createFont({"Liberation Sans", 11, 400, false});
  ASSERT_TRUE(font);
  gdi.selectObject(dc, font);
  // Ascent 0.905 and descent 0.212 of 11 pixels, rounded: 10 + 2. A digit is 6 pixels wide, the minus sign 4.
  EXPECT_EQ(gdi.textExtent(dc, "-10"), (Size{16, 12}));
  EXPECT_EQ(gdi.textExtent(dc, ""), (Size{0, 0}));
  // Malformed UTF-8 is written as replacement characters, never read past.
  EXPECT_GT(gdi.textExtent(dc, "\xE2\x82").width, 0);
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
  const BrushHandle white = gdi.stockBrush(StockBrush::White);
  const BrushHandle gone = gdi.createSolidBrush(kInk);
  EXPECT_TRUE(gdi.deleteObject(gone));
  EXPECT_FALSE(gdi.deleteObject(gone));
  const BrushHandle reused = gdi.createSolidBrush(kInk);  // in the same slot: the old handle stays dead
  EXPECT_FALSE(gdi.fillRect(dc, {0, 0, 3, 1}, gone));
  EXPECT_FALSE(gdi.fillRect({}, {0, 0, 3, 1}, white));
  EXPECT_FALSE(gdi.fillRect(DcHandle{12345}, {0, 0, 3, 1}, white));
  EXPECT_FALSE(gdi.lineTo({}, {1, 1}));
  EXPECT_FALSE(gdi.deleteObject(white));
  EXPECT_FALSE(gdi.selectObject(dc, PenHandle{}));
  EXPECT_FALSE(gdi.selectClipRgn(dc, RegionHandle{77}));
  EXPECT_FALSE(gdi.createCompatibleBitmap(dc, {-1, 5}));
  EXPECT_FALSE(gdi.createCompatibleBitmap(dc, {40000, 40000}));
  EXPECT_FALSE(gdi.deleteDC(DcHandle{12345}));
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
  gdi.fillRect(dc, {0, 0, 2, 1}, gdi.stockBrush(StockBrush::White));
  EXPECT_FALSE(gdi.resizeScreen(dc, {0, 3}));
  EXPECT_EQ(picture(), "##\n");
  EXPECT_TRUE(gdi.resizeScreen(dc, {3, 2}));
  gdi.fillRect(dc, {2, 1, 9, 9}, gdi.stockBrush(StockBrush::White));
  EXPECT_EQ(picture(), "...\n..#\n");
}

TEST_F(RasterGdiTest, ASystemBrushTakesOnTheColorThatIsSet) {
  canvas({1, 1});
  EXPECT_EQ(gdi.sysColor(SystemColor::ButtonFace), rgb(240, 240, 240));
  gdi.setSysColor(SystemColor::ButtonFace, kBack);
  gdi.fillRect(dc, {0, 0, 1, 1}, gdi.sysColorBrush(SystemColor::ButtonFace));
  EXPECT_EQ(picture(), "o\n");
}

}  // namespace
}  // namespace frontpanels

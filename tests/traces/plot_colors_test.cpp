#include "traces/plot_colors.h"

#include <gtest/gtest.h>

#include "painters/multi_trace_painter.h"
#include "platform/raster/raster_gdi.h"

namespace frontpanels::testing {
namespace {

constexpr Color kBlack = rgb(0, 0, 0);
constexpr Color kWhite = rgb(255, 255, 255);
constexpr Color kGreen = rgb(50, 156, 50);

TEST(PlotColors, ContrastIsThatOfLuminances) {
  EXPECT_DOUBLE_EQ(contrastRatio(kBlack, kWhite), 21);
  EXPECT_DOUBLE_EQ(contrastRatio(kWhite, kBlack), 21);
  EXPECT_DOUBLE_EQ(contrastRatio(kGreen, kGreen), 1);
  EXPECT_NEAR(contrastRatio(rgb(255, 0, 0), kWhite), 3.998, 0.001);
  EXPECT_NEAR(contrastRatio(rgb(118, 118, 118), kWhite), 4.542, 0.001);
}

TEST(PlotColors, AColourGivesWayOnlyAsFarAsItMust) {
  struct Row {
    Color own;
    Color onBlack;
    Color onWhite;
  };
  // Sixteenths of the way to white or black.
  const Row rows[] = {{kGreen, kGreen, kGreen},
                      {rgb(255, 0, 0), rgb(255, 0, 0), rgb(255, 0, 0)},
                      {rgb(0, 0, 255), rgb(63, 63, 255), rgb(0, 0, 255)},
                      {rgb(255, 255, 0), rgb(255, 255, 0), rgb(144, 144, 0)},
                      {kWhite, kWhite, rgb(144, 144, 144)},
                      {rgb(0, 255, 255), rgb(0, 255, 255), rgb(0, 160, 160)},
                      {rgb(255, 0, 255), rgb(255, 0, 255), rgb(255, 0, 255)},
                      {kBlack, rgb(95, 95, 95), kBlack}};
  for (const Row& row : rows) {
    EXPECT_EQ(standingOut(row.own, kBlack), row.onBlack) << std::hex << row.own.bgr;
    EXPECT_EQ(standingOut(row.own, kWhite), row.onWhite) << std::hex << row.own.bgr;
    EXPECT_GE(contrastRatio(row.onBlack, kBlack), 3);
    EXPECT_GE(contrastRatio(row.onWhite, kWhite), 3);
  }
}

// A panel of 60 x 60 pixels that is all plot: points lie 10 apart, trace 0 at y = 15, trace 2 at y = 45, grid
// lines at the edges and at y = 30.
class HighContrastTest : public ::testing::Test {
 protected:
  HighContrastTest() {
    painter.scaleWidth(60);
    painter.scaleHeight(60);
    painter.gridScaleLeft(0);
    painter.gridInsetTop(0);
    painter.gridScaleRight(0);
    painter.gridScaleBottom(0);
    painter.numberOfVerticalDivisions(2);
    painter.numberOfHorizontalDivisions(0);
    painter.verticalResolution(50);
    painter.numberOfMeasurements(8);
    for (const float level : {-25.0F, -90.0F, -75.0F}) {
      const std::int16_t index = painter.addNewTraceAtEnd(static_cast<std::int16_t>(level), 0, 7);
      painter.trace(index, Variant(Variant::Singles(8, level)));
    }
  }
  [[nodiscard]] PixelView painted() {
    gdi.fillRect(dc, {0, 0, 60, 60}, PlotColors(gdi).backgroundBrush());
    painter.Paint(dc);
    return gdi.pixels(dc);
  }
  // How many pixels of a row have the colour.
  static int inRow(const PixelView& picture, std::int32_t y, Color color) {
    int count = 0;
    for (std::int32_t x = 0; x < 60; ++x) count += picture.at(x, y) == color ? 1 : 0;
    return count;
  }

  RasterGdi gdi;
  DcHandle dc = gdi.createScreen({60, 60});
  clsMultiTracePainter painter{gdi};
};

TEST_F(HighContrastTest, WithoutItTheGraphHasItsOwnColoursAndWithItThoseOfTheScheme) {
  PixelView picture = painted();
  EXPECT_EQ(picture.at(3, 20), rgb(240, 240, 240));  // button face
  EXPECT_EQ(inRow(picture, 15, kGreen), 60);
  EXPECT_EQ(inRow(picture, 30, rgb(112, 112, 112)), 60);
  EXPECT_EQ(inRow(picture, 45, rgb(0, 0, 255)), 60);

  gdi.setSysColor(SystemColor::Window, kBlack);
  gdi.setSysColor(SystemColor::WindowText, kWhite);
  gdi.setSysColor(SystemColor::GrayText, rgb(63, 242, 63));
  gdi.setHighContrast(true);
  picture = painted();
  EXPECT_EQ(picture.at(3, 20), kBlack);
  EXPECT_EQ(inRow(picture, 15, kGreen), 60);
  EXPECT_EQ(inRow(picture, 30, rgb(63, 242, 63)), 30);  // three on, three off
  EXPECT_EQ(inRow(picture, 45, rgb(63, 63, 255)), 30);
  EXPECT_EQ(inRow(picture, 45, kBlack), 30);  // between the dots the window shows
  EXPECT_EQ(PlotColors(gdi).text(), kWhite);
  EXPECT_EQ(PlotColors(gdi).textOn(rgb(255, 255, 0), kWhite), kBlack);
  EXPECT_EQ(PlotColors(gdi).selected(rgb(50, 50, 50)), rgb(0, 120, 215));
}

}  // namespace
}  // namespace frontpanels::testing

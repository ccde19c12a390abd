#include "fp-render/headless_panel.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <vector>

#include "framework/support/error_handler.h"
#include "platform/gdi_scope.h"

namespace frontpanels {
namespace {

constexpr Color kTraceColor = rgb(50, 156, 50);
constexpr Point kNowhere{-1, -1};

DisplaySweep sweepFrom(double startHz, double stepHz, std::vector<float> levelsDb) {
  Sweep sweep;
  sweep.startHz = startHz;
  sweep.stepHz = stepHz;
  sweep.levelsDb = std::move(levelsDb);
  DisplaySweep display;
  resample(sweep, display);
  return display;
}

// The first place, row by row, from which all of `ink` has the colour.
Point find(const PixelView& picture, Color color, const std::vector<Point>& ink, Size extentPx) {
  for (std::int32_t y = 0; y + extentPx.height <= picture.sizePx.height; ++y) {
    for (std::int32_t x = 0; x + extentPx.width <= picture.sizePx.width; ++x) {
      const auto lit = [&](Point at) { return picture.at(x + at.x, y + at.y) == color; };
      if (std::all_of(ink.begin(), ink.end(), lit)) return {x, y};
    }
  }
  return kNowhere;
}
Point highestOfTrace(const PixelView& picture) { return find(picture, kTraceColor, {{0, 0}}, {1, 1}); }

// Where the picture has the text in the font of its axes: 9 points are 12 pixels.
Point placeOf(const char* text, const PixelView& picture) {
  RasterGdi gdi;
  const DcHandle dc = gdi.createScreen({200, 40});
  const FontHandle font = gdi.createFont({"Arial", 12, 700});
  const SelectedFont selected(gdi, dc, font);
  const TextStyleScope style(gdi, dc, rgb(255, 255, 255), BackgroundMode::Transparent);
  gdi.textOut(dc, {0, 0}, text);
  const PixelView drawn = gdi.pixels(dc);
  std::vector<Point> ink;
  for (std::int32_t i = 0; i < 200 * 40; ++i) {
    if (drawn.at(i % 200, i / 200) == rgb(255, 255, 255)) ink.push_back({i % 200, i / 200});
  }
  EXPECT_FALSE(ink.empty()) << text;
  return find(picture, gdi.sysColor(SystemColor::ButtonText), ink, gdi.textExtent(dc, text));
}

// Where a peak of -10 dB in one of 1001 bins is drawn: from 100 MHz on, 100 kHz apart, the others at -90 dB.
Point peakOfBin(std::size_t bin) {
  std::vector<float> levelsDb(1001, -90.0F);
  levelsDb[bin] = -10.0F;
  HeadlessPanel panel({0, 10});
  panel.show(sweepFrom(100e6, 1e5, std::move(levelsDb)), "a caption");
  return highestOfTrace(panel.picture());
}

TEST(HeadlessPanel, DrawsEveryBinAtItsFrequencyFromEdgeToEdge) {
  messageLog().clear();
  const Point first = peakOfBin(0);
  const std::int32_t graphWidthPx = peakOfBin(1000).x - first.x;
  EXPECT_GT(graphWidthPx, 600);
  // A cell has two bins; the graph shows 511 steps of cells.
  EXPECT_NEAR(peakOfBin(250).x, first.x + graphWidthPx / 4, 2);
  EXPECT_NEAR(peakOfBin(900).x, first.x + graphWidthPx * 9 / 10, 2);
  EXPECT_EQ(messageLog().count(), 0U);
}

TEST(HeadlessPanel, LabelsTheFrequenciesAndTheScaleThatItIsGivenAndDrawsNothingInAGap) {
  HeadlessPanel panel({-30, 20});  // -30 down to -230 in 10 divisions of 20
  panel.show(sweepFrom(100e6, 1e6, std::vector<float>(101, -50.0F)), "");
  const PixelView picture = panel.picture();
  const Point start = placeOf("100 MHz", picture);
  const Point stop = placeOf("200 MHz", picture);
  EXPECT_LT(kNowhere.x, start.x);
  EXPECT_LT(start.x, placeOf("10 MHz/div", picture).x);
  EXPECT_LT(placeOf("10 MHz/div", picture).x, stop.x);
  EXPECT_LT(0, placeOf("-30", picture).y);
  EXPECT_LT(placeOf("-30", picture).y, placeOf("-230", picture).y);
  EXPECT_EQ(placeOf("150 MHz", picture), kNowhere);
  EXPECT_NE(highestOfTrace(picture), kNowhere);
  panel.show(sweepFrom(100e6, 1e6, std::vector<float>(101, kGap)), "");
  EXPECT_EQ(highestOfTrace(panel.picture()), kNowhere);
}

}  // namespace
}  // namespace frontpanels

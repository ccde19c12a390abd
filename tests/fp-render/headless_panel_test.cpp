#include "fp-render/headless_panel.h"

#include <gtest/gtest.h>

#include <vector>

#include "framework/support/error_handler.h"
#include "platform/raster/png.h"

namespace frontpanels {
namespace {

constexpr Color kTraceColor = rgb(50, 156, 50);

// The highest pixel of the trace; (0, 0) when there is none.
Point highestOfTrace(const PixelView& picture) {
  for (std::int32_t y = 0; y < picture.sizePx.height; ++y) {
    for (std::int32_t x = 0; x < picture.sizePx.width; ++x) {
      if (picture.at(x, y) == kTraceColor) return {x, y};
    }
  }
  return {};
}

// Where a peak of -10 dB in one of 1001 bins is drawn: from 100 MHz on, 100 kHz apart, the others at -90 dB.
Point peakOfBin(std::size_t bin) {
  Sweep sweep;
  sweep.startHz = 100e6;
  sweep.stepHz = 1e5;
  sweep.levelsDb.assign(1001, -90.0F);
  sweep.levelsDb[bin] = -10.0F;
  DisplaySweep display;
  resample(sweep, display);
  HeadlessPanel panel({0, 10});
  panel.show(display, "a caption");
  return highestOfTrace(panel.picture());
}

TEST(HeadlessPanel, DrawsEveryBinAtItsFrequencyFromEdgeToEdge) {
  messageLog().clear();
  const Point first = peakOfBin(0);
  const Point last = peakOfBin(1000);
  const std::int32_t graphWidthPx = last.x - first.x;
  EXPECT_GT(graphWidthPx, 600);
  // A cell has two bins; the graph shows 511 steps of cells.
  EXPECT_NEAR(peakOfBin(250).x, first.x + graphWidthPx / 4, 2);
  EXPECT_NEAR(peakOfBin(500).x, first.x + graphWidthPx / 2, 2);
  EXPECT_NEAR(peakOfBin(900).x, first.x + graphWidthPx * 9 / 10, 2);
  EXPECT_EQ(messageLog().count(), 0U);
}

std::vector<std::uint8_t> pictureOf(double startHz, double stepHz, const VerticalScale& scale) {
  Sweep sweep;
  sweep.startHz = startHz;
  sweep.stepHz = stepHz;
  sweep.levelsDb.assign(100, -50.0F);
  DisplaySweep display;
  resample(sweep, display);
  HeadlessPanel panel(scale);
  panel.show(display, "");
  std::vector<std::uint8_t> png;
  std::string error;
  EXPECT_TRUE(encodePng(panel.picture(), png, error)) << error;
  return png;
}

TEST(HeadlessPanel, LabelsTheFrequenciesAndTheScaleThatItIsGiven) {
  const auto usual = pictureOf(100e6, 1e6, {0, 10});
  EXPECT_EQ(pictureOf(100e6, 1e6, {0, 10}), usual);
  EXPECT_NE(pictureOf(110e6, 1e6, {0, 10}), usual);
  EXPECT_NE(pictureOf(100e6, 2e6, {0, 10}), usual);
  // The same centre, 149.5 MHz: only the span differs.
  EXPECT_NE(pictureOf(124.75e6, 0.5e6, {0, 10}), usual);
  EXPECT_NE(pictureOf(100e6, 1e6, {-30, 10}), usual);
  EXPECT_NE(pictureOf(100e6, 1e6, {0, 20}), usual);
}

TEST(HeadlessPanel, DrawsNothingInAGap) {
  Sweep sweep;
  sweep.startHz = 100e6;
  sweep.stepHz = 1e6;
  sweep.levelsDb.assign(100, kGap);
  DisplaySweep display;
  resample(sweep, display);
  HeadlessPanel panel({0, 10});
  panel.show(display, "");
  EXPECT_EQ(highestOfTrace(panel.picture()), (Point{0, 0}));
}

}  // namespace
}  // namespace frontpanels

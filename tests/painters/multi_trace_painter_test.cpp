// Traces in their slots, and where their points are drawn.
#include "painters/multi_trace_painter.h"

#include <array>
#include <sstream>
#include <tuple>

#include "tests/painters/painter_fixture.h"

namespace frontpanels {
namespace {

using testing::kGap;
using testing::kGreen;
using testing::kRed;
using Singles = Variant::Singles;
using Doubles = Variant::Doubles;
constexpr float kInfinite = std::numeric_limits<float>::infinity();

class MultiTracePainterTest : public testing::PainterTest {
 protected:
  // PN and value of each slot, "*" where a newer trace took it over / trace ids, the least recently used
  // first.
  [[nodiscard]] std::string slots() const {
    std::ostringstream text;
    for (std::int16_t i = 0; i < painter.numberOfTraces(); ++i) {
      const bool replaced = painter.traceOrientation(i) == TraceOrientation::Replaced;
      text << painter.pnOffset(i) << "=" << painter.traceValue(i) << (replaced ? "* " : " ");
    }
    text << "/";
    for (const std::int16_t id : painter.leastRecentlyUsed()) text << " " << id;
    return text.str();
  }
  void divisions(std::int32_t vertical, std::int32_t horizontal) {
    painter.numberOfVerticalDivisions(vertical);
    painter.numberOfHorizontalDivisions(horizontal);
  }
};

TEST_F(MultiTracePainterTest, ATraceIsAppendedUntilThePainterIsFullThenTheLeastRecentlyUsedGoes) {
  for (std::int16_t pn = 1; pn <= 5; ++pn) EXPECT_EQ(painter.addATrace(0, pn, pn * 0.5, 10), pn - 1);
  EXPECT_EQ(painter.addATrace(0, 1, 3, 8), 0);  // is there and refilled in its slot
  EXPECT_EQ(painter.traceSize(), 8);
  EXPECT_EQ(slots(), "1=3 2=1 3=1.5 4=2 5=2.5 / 0 1 2 3 4");
  EXPECT_EQ(painter.addATrace(0, 6, 9.5, 20, std::int16_t{77}), 0);
  EXPECT_EQ(painter.addATrace(0, 7, 0, 20), 1);  // keeps the slot's trace id
  EXPECT_EQ(slots(), "6=9.5* 7=0* 3=1.5 4=2 5=2.5 / 2 3 4 77 1");
}

TEST_F(MultiTracePainterTest, SomePnsGoUnderAnotherByTheMode) {
  // Mode, PN and the PN it is looked up under.
  const std::vector<std::array<std::int16_t, 3>> rows = {
      {0, 106, 106}, {0, 107, 106}, {0, 111, 106}, {1, 106, 107}, {1, 107, 107}, {1, 111, 107},
      {0, 25, 25},   {0, 214, 25},  {1, 25, 214},  {1, 214, 214}, {2, 26, 26},
  };
  for (const auto& [mode, pn, lookedUp] : rows) {
    clsMultiTracePainter fresh(gdi);
    fresh.addNewTraceAtEnd(999, 0, 1);
    fresh.addNewTraceAtEnd(lookedUp, 0, 1);
    EXPECT_EQ(fresh.addATrace(mode, pn, 0, 1), 1) << mode << " " << pn;
  }
  EXPECT_EQ(painter.addATrace(2, 106, 0, 1), -1);
  EXPECT_EQ(painter.addATrace(-1, 214, 0, 1), -1);
  EXPECT_EQ(painter.numberOfTraces(), 0);
}

TEST_F(MultiTracePainterTest, ATraceIdRefillsItsSlots) {
  for (const auto id : std::array<std::int16_t, 3>{40, 50, 40}) painter.addNewTraceAtEnd(2, 0, 5, id);
  painter.addATrace(7, 106, 2.5, 6, std::int16_t{40});  // the alias rule is for look-ups by PN
  EXPECT_EQ(slots(), "106=2.5 2=0 106=2.5 / 40 50 40");
  EXPECT_EQ(painter.findATrace(106), 2);  // the last one that has it
  EXPECT_EQ(painter.findATrace(9), -1);
}

TEST_F(MultiTracePainterTest, RemovingATraceTakesItsMarkersAndItsPlaceInTheUsageOrder) {
  for (std::int16_t pn = 1; pn <= 3; ++pn) painter.addATrace(0, pn, 0, 5);
  const MarkerPointer gone = addMarker("1", 0, 1);
  const MarkerPointer kept = addMarker("2", 0, 2);
  painter.activeMarker(gone);
  painter.selectedTraceIndex(2);

  painter.removeATrace(1);
  EXPECT_EQ(slots(), "1=0 3=0 / 0 2");
  EXPECT_EQ(painter.activeMarker(), nullptr);
  EXPECT_EQ(painter.selectedTraceIndex(), 1);
  EXPECT_EQ(painter.findTraceByMarker(kept), 1);
  EXPECT_EQ(kept->traceId, 1);

  painter.activeMarker(kept);
  painter.removeATrace(1);
  EXPECT_EQ(said(), "removeATrace() ... can't find trace\r");
  painter.numberOfTraces(1);
  EXPECT_EQ(painter.activeMarker(), nullptr);
  EXPECT_EQ(painter.selectedTraceIndex(), 0);
}

TEST_F(MultiTracePainterTest, BadInputIsReportedAndChangesNothing) {
  EXPECT_EQ(painter.addNewTraceAtIndex(0, 1, 1, 1), -1);
  EXPECT_EQ(painter.addNewTraceAtExistingPN(1, 1, 1), -1);
  painter.selectedTraceIndex(3);
  painter.trace(Variant(5.0));
  EXPECT_EQ(painter.numberOfTraces(), 1);  // a place for the values, which were none
  EXPECT_EQ(painter.selectedTraceIndex(), 0);
  EXPECT_TRUE(painter.trace().isNull());
  EXPECT_EQ(said(),
            "addNewTraceAtIndex()...\rSubscript out of range\n"
            "addNewTraceAtExistingPN()...\rSubscript out of range\n"
            "clsMultiTracePainter::selectedTraceIndex() ...\rSubscript out of range\n"
            "clsMultiTracePainter::trace() ...\rType mismatch");

  painter.gridScaleTop(-20);
  painter.gridScaleTop(std::numeric_limits<double>::infinity());
  painter.verticalResolution(0);
  painter.numberOfVerticalDivisions(1001);
  EXPECT_EQ(
      std::tuple(painter.gridScaleTop(), painter.verticalResolution(), painter.numberOfVerticalDivisions()),
      std::tuple(-20, 10, 0));
  EXPECT_EQ(messages().size(), 3U);
}

TEST_F(MultiTracePainterTest, TheOffsetIsAddedOnceToThePointsOfEveryTraceWhenTheFirstHasNewValues) {
  painter.addATrace(0, 1, 0, 1);
  painter.addATrace(0, 2, 0, 2);
  painter.offset(Variant(0.5));
  painter.trace(1, Variant(Variant::Int16s{4, 5, 6}));
  painter.useOffset(true);
  painter.processData();  // trace 0 is null
  painter.trace(0, Variant(Singles{1, 2, 3}));
  painter.useOffset(false);
  painter.processData();
  EXPECT_EQ(painter.trace(), Variant(Singles{1, 2, 3}));

  painter.useOffset(true);
  painter.processData();
  painter.processData();
  EXPECT_EQ(painter.trace(), Variant(Singles{1.5F, 2.5F}));  // size + 1 elements
  painter.selectedTraceIndex(1);
  EXPECT_EQ(painter.trace(), Variant(Doubles{4.5, 5.5, 6.5}));
}

TEST_F(MultiTracePainterTest, PointsFollowTheAxisFromTheLeftEdgeWithinThePlot) {
  // x = 15 + 10 i; y = 24 + 40 - (value + 100) * 0.4
  EXPECT_EQ(painted({0, -100, -50, -25}), "15,24 25,64 35,44 45,34");
  EXPECT_EQ(gdi.polylines()[0].pen, (testing::PenValue{PenStyle::Solid, 1, kGreen}));
  EXPECT_EQ(gdi.polylines()[0].clip, (Rect{15, 24, 95, 65}));
  EXPECT_FALSE(painter.dataChanged());
  EXPECT_EQ(gdi.liveObjects(), 0);
  painter.numberOfMeasurements(2);  // too few for a step: that of the paint before is kept
  EXPECT_EQ(painted({0, -50}), "15,24 25,44");

  painter.numberOfMeasurements(10);
  painter.gridScaleLeft(4.5F);
  painter.gridScaleRight(15.5F);
  // Halves go to even: x = 14.5, 24.5, 34.5; y = 64 - 0.5 and 64 - 1.5
  EXPECT_EQ(painted({-98.75F, -96.25F, 0}), "14,64 24,62 34,24");
}

TEST_F(MultiTracePainterTest, AStripChartGrowsFromTheRightEdge) {
  painter.numberOfMeasurements(12);  // 8 pixels a step
  give({0, 0, -100});
  painter.traceOrientation(0, TraceOrientation::FromRight);
  EXPECT_EQ(painted(), "79,24 87,24 95,64");
  painter.traceOrientation(0, TraceOrientation::Replaced);
  EXPECT_EQ(painted(), "15,24 23,24 31,64");  // from the left
}

TEST_F(MultiTracePainterTest, ATraceReadsNoFurtherThanItsValuesAndGapsBreakTheLine) {
  give({0, -50, -100});
  painter.traceSize(500);
  EXPECT_EQ(painted(), "15,24 25,44 35,64");
  painter.traceSize(1);
  EXPECT_EQ(painted(), "15,24 25,44");
  painter.traceSize(-1);
  EXPECT_EQ(painted(), "");
  // A value alone between gaps is a mark of one pixel.
  EXPECT_EQ(painted({kGap, 0, 0, kInfinite, -50, -kInfinite, -100, -100, kGap}),
            "25,24 35,24 | 55,44 56,44 | 75,64 85,64");
  EXPECT_EQ(said(), "");
}

TEST_F(MultiTracePainterTest, WhatCannotBeDrawnIsReportedAndTheNextPaintTriesAgain) {
  // 0.4 pixels a unit: y = 24 - 0.4 v. 5368709000 gives -2147483576, which fits; 5368709200 gives
  // -2147483656.
  painter.traceSize(1);
  painter.trace(Variant(Doubles{0, 5368709000.0}));
  EXPECT_EQ(painted(), "15,24 25,-2147483576");
  painter.trace(Variant(Doubles{0, 5368709200.0}));
  EXPECT_EQ(painted(), "");
  EXPECT_EQ(gdi.liveObjects(), 0);
  EXPECT_EQ(said(), "clsMultiTracePainter::Paint() ...\rOverflow");

  EXPECT_NE(painted(Singles(3001, -50.0F)), "");
  EXPECT_EQ(gdi.polylines().at(0).points.size(), 3001U);
  EXPECT_EQ(painted(Singles(3002, -50.0F)), "");
  EXPECT_EQ(said(), "clsMultiTracePainter::Paint() ...\rSubscript out of range");

  painter.trace(Variant(Variant::Variants{Variant(std::int16_t{0}), Variant("-50"), Variant(-100.0)}));
  painter.traceSize(2);
  EXPECT_EQ(painted(), "15,24 25,44 35,64");
  EXPECT_EQ(
      said(),
      "clsMultiTracePainter::Paint() ... unrecognized array type.  Will be handled as Variant (SLOW!)\r");
}

TEST_F(MultiTracePainterTest, TheRangeOfTheDataCanTakeThePlaceOfTheAxisAndNeedsAnExtent) {
  painter.calcMinMax(true);
  EXPECT_EQ(painted({-30, -70, -50}), "15,24 25,64 35,44");
  const auto maximum = [&] {
    return std::pair(painter.activeTraceMaximumValue(), painter.activeTraceMaximumIndex());
  };
  EXPECT_EQ(maximum(), std::pair(-30.0, 0.0));
  painter.activeTraceMaximumValue(5);
  painter.activeTraceMaximumIndex(2);
  EXPECT_EQ(maximum(), std::pair(5.0, 2.0));
  give({-30, -20});  // new values are searched anew
  EXPECT_EQ(maximum(), std::pair(-20.0, 1.0));

  EXPECT_EQ(painted({-50, -50}), "");  // the largest value equals the smallest
  painter.calcMinMax(false);
  painter.scaleWidth(20);  // no width left between the insets
  EXPECT_EQ(painted(), "");
  painter.scaleWidth(100);
  painter.scaleHeight(9.5F);  // half a pixel less than the insets
  EXPECT_EQ(painted(), "");
  EXPECT_TRUE(painter.dataChanged());
  painter.scaleHeight(10);  // a flat plot still shows its line
  EXPECT_EQ(painted(), "15,24 25,24");
}

TEST_F(MultiTracePainterTest, EachTraceHasItsColourAndTheSelectedOneGivesItsOwn) {
  for (std::int16_t i = 0; i < 9; ++i) {
    painter.addNewTraceAtEnd(i, 0, 1);
    painter.trace(i, Variant(Singles{0, 0}));
  }
  painter.selectedTraceIndex(1);
  paint();
  const Color expected[] = {
      kGreen,           kRed,         rgb(0, 0, 255), rgb(255, 255, 0), rgb(255, 255, 255), rgb(0, 255, 255),
      rgb(255, 0, 255), rgb(0, 0, 0), kGreen};
  for (std::size_t i = 0; i < 9; ++i) EXPECT_EQ(gdi.polylines().at(i).pen.color, expected[i]) << i;
  EXPECT_EQ(painter.activeTraceColor(), kRed);
}

TEST_F(MultiTracePainterTest, TheAxisRunsDownFromItsTopByDivisions) {
  painter.gridScaleTop(-20);
  painter.setDbPerDivision(8);
  painter.numberOfVerticalDivisions(5);  // -20 .. -60: 1 pixel a unit; grid lines 8 pixels apart
  EXPECT_TRUE(painted({-20, -60, -30}).ends_with(" | 15,56 95,56 | 15,64 95,64 | 15,24 25,64 35,34"));
}

TEST_F(MultiTracePainterTest, AutoScaleFitsAllTracesAndWritesTheAxis) {
  painter.numberOfVerticalDivisions(10);
  painter.setAutoScale(true);
  painter.addATrace(0, 1, 0, 2);
  painter.addATrace(0, 2, 0, 2);
  painter.trace(0, Variant(Singles{-14, -3, kGap}));
  painter.trace(1, Variant(Doubles{-1e30 * 1e300, 3, -2}));
  EXPECT_EQ(painter.gridScaleTop(), std::nullopt);
  paint();
  // 17 / 0.85 = 20, 2 a division; (3 - 14 + 20) / 2 = 4.5 is 2.25 tenths of 20: 4.
  EXPECT_EQ(painter.gridScaleTop(), 4);
  EXPECT_EQ(painter.verticalResolution(), 2);
  EXPECT_EQ(painter.yAxisLabels().size(), 11U);
  EXPECT_EQ(painter.yAxisLabels().back(), "-16");
  EXPECT_EQ(painter.points(0).find(0)->y, 60);  // 24 + 18 * 2 pixels

  // Largest 3.5 of 4..-16 lies within a fifth of the top, smallest -14 of the bottom: the axis stays.
  painter.trace(0, Variant(Singles{-14, 3.5F, kGap}));
  paint();
  EXPECT_EQ(painter.gridScaleTop(), 4);
  EXPECT_EQ(said(), "");
}

TEST_F(MultiTracePainterTest, LabelsFollowTheirStyleAndDivisions) {
  painter.numberOfHorizontalDivisions(10);
  painter.xAxisFormatter().frequencySuffix();
  painter.xStart(88e6);
  painter.xStop(108e6);
  const struct {
    std::int16_t style;
    double spanHz;
    std::int16_t divisions;
    std::string leftCentreRight;
  } rows[] = {{1, 20e6, 10, "88 MHz|2 MHz/div|108 MHz"}, {2, 20e6, 10, "|98 MHz|2 MHz/div"},
              {4, 20e6, 10, "|98 MHz|2 MHz/div"},        {3, 10e6, 10, "|98 MHz|"},
              {1, 10e6, 0, "93 MHz||103 MHz"},           {0, 10e6, 0, "||"}};
  for (const auto& row : rows) {
    painter.xAxisStyle(row.style);
    painter.span(row.spanHz);
    painter.numberOfHorizontalDivisions(row.divisions);
    EXPECT_EQ(painter.leftLabel() + "|" + painter.xAxisLabel() + "|" + painter.rightLabel(),
              row.leftCentreRight);
  }

  painter.numberOfVerticalDivisions(2);
  painter.gridScaleTop(0.005);
  painter.verticalResolution(0.005);
  paint();
  painter.Label(dc, {});
  EXPECT_EQ(painter.yAxisLabels(), (std::vector<std::string>{"0.01", "0", "-0.01"}));  // by "0.##"
  painter.autoFormatY(true);
  painter.Label(dc, {});
  EXPECT_EQ(painter.yAxisLabels(), (std::vector<std::string>{"0.005", "0", "-0.005"}));
}

TEST_F(MultiTracePainterTest, TheGridDrawsBothOuterEdgesAndNeedsTheSurfaceThatItIsToStyle) {
  divisions(3, 2);
  painter.setGridLineDrawingStyle(PenStyle::Dot);
  painter.setGridDrawColor(kRed);
  // y = 24 + 40 i / 3 (37.33, 50.67); x = 15 + 80 j / 2
  EXPECT_EQ(
      painted(),
      "15,24 95,24 | 15,37 95,37 | 15,51 95,51 | 15,64 95,64 | 15,24 15,64 | 55,24 55,64 | 95,24 95,64");
  EXPECT_EQ(gdi.polylines().front().pen, (testing::PenValue{PenStyle::Dot, 1, kRed}));

  divisions(0, 0);
  painter.multiBand(true);
  painter.numberOfBands(4);
  EXPECT_EQ(painted(), "35,24 35,64 | 55,24 55,64 | 75,24 75,64");
  painter.setGridDrawStyle(PenStyle::Dash);
  EXPECT_EQ(painted({0, 0}), "15,24 25,24");
  EXPECT_EQ(said(), "clsMultiTracePainter::DrawGrid()...\rObject variable or With block variable not set");

  testing::FakeTraceForm form;
  painter.drawingArea(&form);
  EXPECT_TRUE(painted().starts_with("35,24 35,64 | "));
  EXPECT_EQ(form.drawStyle, PenStyle::Dash);
}

TEST_F(MultiTracePainterTest, PaintsDirectlyOnTheSurfaceOfItsHost) {
  testing::FakeTraceForm form;
  painter.drawingArea(&form);
  form.dc = dc;
  form.scaleLeft = 100;
  give({0, -100});
  painter.Paint();  // plot (105, 4) of 780 x 590; 97.5 a step
  EXPECT_EQ(drawn(), "105,4 202,594");
}

TEST_F(MultiTracePainterTest, TheClipIsRoundedHalfToEvenAndUndone) {
  painter.createClippingRegion(0.5F, 1.5F, 100.5F, 49.51F, dc);
  EXPECT_EQ(gdi.clip(dc), (Rect{0, 2, 100, 50}));
  give({0, 0});
  paint();
  EXPECT_EQ(gdi.clip(dc), (Rect{0, 2, 100, 50}));  // the plot's clip is gone again
  painter.destroyClippingRegion(dc);
  EXPECT_EQ(gdi.clip(dc), std::nullopt);
  EXPECT_EQ(gdi.liveObjects(), 0);
}

TEST_F(MultiTracePainterTest, WhicheverCallFailsNothingLeaksAndTheNextPaintIsWhole) {
  divisions(2, 2);
  painter.topLabel("top");
  give({0, -50, kGap, -100});
  painter.activeMarker(addMarker("1", 1));
  const LabelFonts fonts{gdi.createFont({"axis"}), gdi.createFont({"corner"})};
  const int before = gdi.liveObjects();
  const auto wholePaint = [&] {
    gdi.clear();
    painter.createClippingRegion(10, 20, 110, 70, dc);
    painter.Paint(dc);
    painter.drawMarkers(dc);
    painter.destroyClippingRegion(dc);
    painter.Label(dc, fonts);
    painter.updateMarkerDisplay(dc, fonts);
    return gdi.drawingOrder();
  };
  wholePaint();
  const std::vector<std::string> whole = wholePaint();
  const std::vector<int> failing = gdi.callsThatMayFail();
  ASSERT_GT(failing.size(), 40U);
  for (const int n : failing) {
    gdi.failNthCall(n);
    wholePaint();
    gdi.failNothing();
    EXPECT_EQ(gdi.liveObjects(), before) << "call " << n;
    EXPECT_EQ(gdi.violations(), std::vector<std::string>{}) << "call " << n;
    EXPECT_EQ(wholePaint(), whole) << "call " << n;
  }
  EXPECT_EQ(said(), "");
}

TEST_F(MultiTracePainterTest, ValuesOfTheSameKindUseTheirStorageAgain) {
  give(Singles(513, -50.0F));
  const void* const before = std::get<Singles>(painter.trace().value()).data();
  painter.trace(std::span<const float>(std::vector<float>(513, -60.0F)));
  painter.trace(Variant(Singles(500, -70.0F)));
  EXPECT_EQ(static_cast<const void*>(std::get<Singles>(painter.trace().value()).data()), before);
  EXPECT_TRUE(painter.dataChanged());
}

}  // namespace
}  // namespace frontpanels

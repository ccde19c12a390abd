// Markers on the traces of a painter.
#include "tests/painters/painter_fixture.h"

namespace frontpanels {
namespace {

using testing::kGap;
using testing::kGreen;
constexpr float kInfinite = std::numeric_limits<float>::infinity();

class PainterMarkersTest : public testing::PainterTest {
 protected:
  // The texts that a step writes, a blank behind each.
  template <class Step>
  std::string written(Step step) {
    gdi.clear();
    step();
    std::string texts;
    for (const testing::Call& text : gdi.texts()) texts += text.text + " ";
    return texts;
  }
  std::string readout() {
    return written([this] { painter.updateMarkerDisplay(dc, {}); });
  }
  // With a text in the top row that ends `px` behind the plot's left edge.
  std::string readoutBeside(std::size_t px) {
    painter.topLabel(std::string(px / 8, 't'));
    painter.Label(dc, {});
    return readout();
  }
  std::string drawnIds() {
    return written([this] { painter.drawMarkers(dc); });
  }
  // A panel with room for a read-out: plot (15, 44) of 580 x 40, frequencies 100 to 109 MHz.
  void widen() {
    painter.scaleWidth(600);
    painter.scaleHeight(70);
    painter.gridInsetTop(24);
    painter.xAxisStyle(0);
    painter.xAxisFormatter().frequencySuffix();
    painter.yAxisFormatter().dBmSuffix();
    painter.xStart(100e6);
    painter.xStop(109e6);
  }
  void show() {
    paint();
    painter.Label(dc, {});
  }
};

TEST_F(PainterMarkersTest, TheNearestPointIsTheOneWithTheSmallestSumOfDifferences) {
  EXPECT_EQ(painted({0, -50, -100, -50}), "15,24 25,44 35,64 45,44");
  clsMarker marker;
  const auto nearest = [&](float x, float y) { return painter.findNearestPoint(x, y, marker), marker.point; };
  EXPECT_EQ(nearest(35, 44), 1);  // 10 from points 1 and 3: the lower index
  EXPECT_EQ(nearest(36, 44), 3);
  EXPECT_EQ(nearest(25, 54), 1);        // 10 against 20
  EXPECT_EQ(nearest(14.4F, 10000), 2);  // over 9936 away, still below 10000
  EXPECT_EQ(nearest(15, 10100), 2);     // nothing within 10000
  EXPECT_EQ(painted({0, -82000}), "15,24 25,32824");
  EXPECT_EQ(nearest(15, 24), 2);  // the way to the second overflows
  EXPECT_EQ(said(), "findNearestPoint() ...\rOverflow");
}

TEST_F(PainterMarkersTest, ExtremesAreFoundInTheDataGapsAside) {
  const MarkerPointer marker = (give({}), addMarker("1", 0));
  painter.activeMarker(marker);
  const auto largest = [&] { return painter.markerToMax(), marker->point; };
  const auto smallest = [&] { return painter.markerToMin(), marker->point; };
  give({kInfinite, -20, -5, -5, -90, -90, kGap, -kInfinite});
  EXPECT_EQ(largest(), 2);  // the first of two
  EXPECT_EQ(smallest(), 4);
  give({-1, -2});  // new values are searched anew
  EXPECT_EQ(smallest(), 1);
  give({kGap, kGap});
  EXPECT_EQ(largest(), 1);
  EXPECT_EQ(said(), "");
  painter.trace(Variant(Variant::Int16s{-9, -3}));
  EXPECT_EQ(smallest(), 0);
  EXPECT_EQ(said(),
            "clsMultiTracePainter::computeMinMax() ... unhandled array type.  Using Variant (SLOW!)\r");
}

TEST_F(PainterMarkersTest, EveryKeyButTheRightArrowMovesLeftEvenBelowZero) {
  give({0, 0});
  painter.KeyPress(39);  // no active marker: nothing
  const MarkerPointer marker = addMarker("1", 0);
  painter.activeMarker(marker);
  EXPECT_TRUE(marker->active);
  const auto pressed = [&](std::int16_t key) { return painter.KeyPress(key), marker->point; };
  EXPECT_EQ(pressed(39), 1);
  EXPECT_EQ(pressed(37), 0);
  EXPECT_EQ(pressed(65), -1);
  marker->point = 2147483647;
  EXPECT_EQ(pressed(39), 2147483647);
  EXPECT_EQ(said(), "clsMultiTracePainter::KeyPress()\rOverflow");
}

TEST_F(PainterMarkersTest, MarkersAreDrawnOnTheirPointsInTheTraceColour) {
  give({0, -50, kGap, -50});
  const MarkerPointer marker = addMarker("1", 1);
  addMarker("2", 2);  // a gap
  addMarker("3", 9);  // no such point
  paint();
  EXPECT_EQ(drawnIds(), "1 ");
  EXPECT_EQ((Point{marker->positionX, marker->positionY}), (Point{25, 44}));
  EXPECT_EQ(gdi.succeeded("createPen").at(0).pen, (testing::PenValue{PenStyle::Solid, 1, kGreen}));
}

TEST_F(PainterMarkersTest, AMarkerOnACountedPointThatIsNotDrawnStaysOnTheLastOneThatIs) {
  widen();
  give({0, -25, -50, kGap});
  painter.traceSize(4);  // the number of points: one more than the highest index
  const MarkerPointer marker = addMarker("1", 4);
  painter.activeMarker(marker);
  for (const std::int32_t point : {3, 4}) {
    marker->point = point;
    show();
    EXPECT_EQ(drawnIds(), "1 ");
    EXPECT_EQ(marker->positionY, 64);  // -50 in the middle of 44..84
    EXPECT_EQ(readout(), "1  102 MHz  -50 dBm ");
    EXPECT_EQ(marker->point, point);
  }
  marker->point = 5;
  show();
  EXPECT_EQ(drawnIds(), "");

  give({-10, kGap, -30});
  marker->point = 1;
  show();
  EXPECT_EQ(readout(), "1  101 MHz  --- ");
}

TEST_F(PainterMarkersTest, TheActiveMarkerReadsItsFrequencyAndLevelShortenedWithoutRoom) {
  widen();
  give({-10, -20.25F, -30, -40, -50, -60, -70, -80, -90, -100});
  painter.activeMarker(addMarker("1", 1));
  show();
  EXPECT_EQ(readout(), "1  101 MHz  -20.25 dBm ");
  // 22 letters of 8 up to the plot's right edge at 595, 2 below the panel's top.
  EXPECT_EQ(gdi.texts().back().points[0], (Point{419, 22}));
  painter.activeMarker()->point = 9;
  EXPECT_EQ(readout(), "1  109 MHz  -100 dBm ");  // the last point is the stop; 20 letters: from 435
  EXPECT_EQ(readoutBeside(424), "1  -100 dBm ");  // 15 + 424 = 439
  EXPECT_EQ(readoutBeside(504), "");              // 15 + 504 = 519, and 595 - 88 = 507
  painter.xStop(100.09e6);                        // points 10 kHz apart
  painter.activeMarker()->point = 3;
  painter.xMarkerFormatString("0.000000");
  EXPECT_EQ(readoutBeside(0), "1  100.030000 MHz  -40 dBm ");
  painter.autoFormatX(true);
  EXPECT_EQ(readout(), "1  100.03 MHz  -40 dBm ");
}

TEST_F(PainterMarkersTest, ADeltaMarkerReadsDifferencesOfStoredValuesAndGoesWithItsMarker) {
  widen();
  give({-10, -20.1F, -20.5F, -40, -50});
  const MarkerPointer other = addMarker("2", 0);
  const MarkerPointer marker = addMarker("1", 2);
  const MarkerPointer delta = addMarker("1d", 1);
  delta->DELTA = true;
  delta->deltaPartner = "1";
  marker->deltaPartner = "1d";
  painter.activeMarker(delta);
  show();
  EXPECT_EQ(readout(), "1d  -1 MHz  +0.4 dB ");  // less than a pixel
  painter.activeMarker(marker);
  EXPECT_EQ(readout(), "1  102 MHz  -20.5 dBm   1d  -1 MHz  +0.4 dB ");

  painter.deleteActiveMarker();
  EXPECT_EQ(painter.markerCollection().count(), 1U);
  EXPECT_EQ(painter.activeMarker(), other);
  EXPECT_FALSE(marker->active);
  EXPECT_TRUE(other->active);
  painter.deleteActiveMarker();
  painter.deleteActiveMarker();
  EXPECT_EQ(painter.activeMarker(), nullptr);
  EXPECT_EQ(said(), "");
}

TEST_F(PainterMarkersTest, MarkersReturnToTheirFrequencyAfterTheAxisMoved) {
  widen();
  give({0, 0, 0, 0, 0, 0, 0, 0, 0, 0});
  const MarkerPointer inside = addMarker("1", 4);  // 104 MHz
  const MarkerPointer outside = addMarker("2", 9);
  paint();
  painter.updateMarkerDisplay(dc, {});
  const auto points = [&](double startHz, double stopHz) {
    painter.xStart(startHz);
    painter.xStop(stopHz);
    painter.ResetMarkers();
    return std::pair(inside->point, outside->point);
  };
  EXPECT_EQ(points(102e6, 106.5e6), std::pair(4, 9));  // 0.5 MHz a point: 104 and, at the end, 106.5 MHz
  EXPECT_EQ(points(103e6, 112e6), std::pair(1, 6));
  painter.span(0);
  painter.ResetMarkers();
  EXPECT_EQ(said(), "ResetMarkers() failed...divide-by-zero error\rDivision by zero");
}

TEST_F(PainterMarkersTest, AMarkerForNoTraceIsReported) {
  give({0, 0});
  addMarker("1", 0, 5);
  addMarker("2", 0);
  addMarker("2", 0);
  EXPECT_EQ(painter.markerCollection().count(), 1U);
  EXPECT_THROW((void)painter.traceMarkerCollections(1), RuntimeError);
  painter.findNearestPoint(0, 0, *painter.findMarker("2"), std::int16_t{3});
  EXPECT_EQ(said(),
            "addMarkerToTrace() failed\rSubscript out of range\n"
            "addMarkerToTrace() failed\rThis key is already associated with an element of this collection\n"
            "traceMarkerCollections[Property Get]() ...\rSubscript out of range\n"
            "findNearestPoint() ...\rSubscript out of range");
}

}  // namespace
}  // namespace frontpanels

#include "traces/marker.h"

#include <gtest/gtest.h>

#include "platform/runtime_error.h"
#include "tests/support/recording_gdi.h"

namespace frontpanels::testing {
namespace {

using Path = std::vector<Point>;

class MarkerTest : public ::testing::Test {
 protected:
  MarkerTest() {
    marker.positionX = 100;
    marker.positionY = 50;
    marker.positionY2 = 20;
    marker.id = "12";
  }

  // The corners of what was drawn; a line that starts elsewhere than the one before ended is set off by its
  // start.
  Path drawn() {
    gdi.clear();
    marker.draw(gdi, gdi.viewDc());
    Path path;
    for (const Call& line : gdi.lines()) {
      if (path.empty() || path.back() != line.points[0]) path.push_back(line.points[0]);
      path.push_back(line.points[1]);
    }
    return path;
  }

  RecordingGdi gdi;
  clsMarker marker;
};

TEST_F(MarkerTest, NormalMarkerStandsOnItsPointAndDeltaMarkerUpsideDown) {
  EXPECT_EQ(drawn(), (Path{{100, 50}, {96, 38}, {104, 38}, {100, 50}}));
  marker.width = 9;  // halves go to the even neighbour: 96.5 and 105.5
  marker.positionX = 101;
  EXPECT_EQ(drawn(), (Path{{101, 50}, {96, 38}, {106, 38}, {101, 50}}));
  marker.DELTA = true;
  EXPECT_EQ(drawn(), (Path{{101, 38}, {96, 50}, {106, 50}, {101, 38}}));
  marker.positionX = 2147483647;  // a corner outside 32 bits
  EXPECT_THROW(marker.draw(gdi, gdi.viewDc()), RuntimeError);
}

TEST_F(MarkerTest, TwoEndedMarkersJoinTheirTrianglesByAStem) {
  const Path twoEnded = {{100, 20}, {96, 32},  {104, 32}, {100, 20}, {100, 32},
                         {100, 38}, {100, 50}, {96, 38},  {104, 38}, {100, 50}};
  marker.multiMarker = true;
  EXPECT_EQ(drawn(), twoEnded);
  marker.multiMarker = false;
  marker.stripChartMarker = true;
  marker.DELTA = true;
  EXPECT_EQ(drawn(), twoEnded);
}

TEST_F(MarkerTest, ActiveMarkerHasAPenOfItsOwnTwoPixelsWide) {
  marker.active = true;
  drawn();
  EXPECT_EQ(gdi.lines()[0].pen, (PenValue{PenStyle::Solid, 2, rgb(50, 50, 50)}));
  EXPECT_EQ(gdi.liveObjects(), 0);
  gdi.failAlways("createPen");
  EXPECT_EQ(drawn().size(), 4U);
  EXPECT_TRUE(gdi.violations().empty());
  gdi.failNothing();
  marker.active = false;
  drawn();
  EXPECT_TRUE(gdi.succeeded("createPen").empty());
}

TEST_F(MarkerTest, IdIsCentredTwoPixelsAboveTheHighestPointOfTheGlyph) {
  const struct {
    bool twoEnded, delta;
    std::int32_t y2;
    Point topLeft;
  } rows[] = {{false, false, 20, {92, 24}},  // two letters of 8 x 12: 16 wide; the glyph begins at 38
              {false, true, 20, {92, 24}},   // a delta marker covers the same height
              {true, false, 20, {92, 6}},    // the second end is the higher one
              {true, true, 45, {92, 24}},    // the second end lies within the first triangle
              {true, false, 80, {92, 24}}};
  for (const auto& row : rows) {
    gdi.clear();
    marker.multiMarker = row.twoEnded;
    marker.DELTA = row.delta;
    marker.positionY2 = row.y2;
    marker.drawId(gdi, gdi.viewDc());
    EXPECT_EQ(gdi.texts().at(0).text, "12");
    EXPECT_EQ(gdi.texts()[0].points[0], row.topLeft) << row.y2;
  }
  EXPECT_EQ(deltaMarkerId("12"), "12d");
}

}  // namespace
}  // namespace frontpanels::testing

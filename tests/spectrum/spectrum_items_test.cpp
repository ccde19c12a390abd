// What SpectrumView says of its graph. The graph is 760 x 570 at (20, 15), the plot (48, 24) of 700 x 525 in
// it, -20 to -120 dBm: 5.25 pixels a dB.
#include <limits>

#include "tests/spectrum/spectrum_fixture.h"
#include "tests/support/listed_items.h"

namespace frontpanels::testing {
namespace {

constexpr float kGap = std::numeric_limits<float>::quiet_NaN();

class SpectrumItemsTest : public SpectrumViewTest {
 protected:
  SpectrumItemsTest() {
    panel->fields().frequency.center.valueNoUpdate(100.5e6);
    panel->fields().frequency.span.valueNoUpdate(3e6);
  }
  [[nodiscard]] clsTraceManager& traces() { return panel->base().traceManager(); }
  [[nodiscard]] std::string said() {
    const GraphItems items = traces().graphItems();
    EXPECT_EQ(traces().graphState().items, items.all().size());
    return listed(items);
  }
};

// Four points from 99 to 102 MHz stand at 48, 398 and 748 of the surface and one beyond it; -30 dBm at 24
// + 52.5, to even 76. A marker's glyph is 9 wide and 13 high, its tip the last row.
TEST_F(SpectrumItemsTest, TraceAndMarkersAreReadAsTheGraphShowsThem) {
  EXPECT_EQ(said(), "");
  publish({-30, -50.25F, -40, -45});
  panel->addMarker();
  EXPECT_EQ(said(),
            "Spectrum: 1 trace, 1 marker (20,15 760x570) selected\n"
            "Trace 1: 4 points, largest -30 dBm at 99 MHz (68,39 700x525) selected\n"
            "Marker 1: 100 MHz, -50.25 dBm (414,186 9x13) selected\n");
  panel->addDeltaMarker();
  traces().moveMarkerLeft();
  panel->addMarker();
  traces().moveMarkerRight();
  EXPECT_EQ(said(),
            "Spectrum: 1 trace, 3 markers (20,15 760x570) selected\n"
            "Trace 1: 4 points, largest -30 dBm at 99 MHz (68,39 700x525) selected\n"
            "Marker 1: 99 MHz, -30 dBm (64,79 9x13)\n"
            "Delta marker 1: +1 MHz, -20.25 dB (414,186 9x13)\n"
            "Marker 2: 101 MHz, -40 dBm (764,132 9x13) selected\n");
  traces().moveMarkerRight();
  EXPECT_EQ(said().substr(said().find("Marker 2")), "Marker 2: 102 MHz, -45 dBm (0,0 0x0) selected unseen\n");
}

TEST_F(SpectrumItemsTest, WhatIsNotSeenHasNoPlace) {
  publish({kGap, -200, -40});
  panel->addMarker();
  traces().activeTrace()->activeMarker()->point = 1;  // below the panel's lower edge
  EXPECT_EQ(said().substr(said().find("Marker")), "Marker 1: 101 MHz, -200 dBm (0,0 0x0) selected unseen\n");
  traces().activeTrace()->activeMarker()->point = 0;
  EXPECT_EQ(said().substr(said().find("Marker")), "Marker 1: 99 MHz, --- (0,0 0x0) selected unseen\n");
  publish({kGap});
  EXPECT_EQ(said().substr(said().find("Trace"), 42), "Trace 1: 1 point (0,0 0x0) selected unseen");
  dynamic_cast<clsMultiTracePainter&>(*traces().activeTrace()).traceIsVisible(false);
  EXPECT_EQ(said().substr(0, 60), "Spectrum: 1 trace, 1 marker (0,0 0x0) selected unseen\nTrace ");
}

TEST_F(SpectrumItemsTest, NewLevelsAreNoNewsButMarkersAre) {
  publish({-30, -50, -40});
  const GraphState before = traces().graphState();
  EXPECT_EQ(before.items, 2U);
  publish({-31, -51, -41});
  EXPECT_EQ(traces().graphState(), before);
  panel->addMarker();
  const GraphState marked = traces().graphState();
  EXPECT_EQ(marked.items, 3U);
  EXPECT_EQ(marked.activeMarker, traces().activeTrace()->activeMarker().get());
  EXPECT_EQ(marked.point, 1);
  traces().moveMarkerRight();
  EXPECT_EQ(traces().graphState().point, 2);
}

TEST_F(SpectrumItemsTest, ThereIsAnEndToWhatIsListed) {
  publish({-30, -50});
  for (int marker = 0; marker < 1100; ++marker)
    traces().activeTrace()->markerCollection().add(std::make_shared<clsMarker>());
  EXPECT_EQ(traces().graphItems().all().size(), 1000U);
  EXPECT_EQ(traces().graphState().items, 1000U);
}

TEST_F(SpectrumItemsTest, TheViewIsToldOfEachNewPicture) {
  publish({-30, -50});
  const int before = view.paintings;
  panel->addMarker();
  EXPECT_EQ(view.paintings, before + 1);
}

}  // namespace
}  // namespace frontpanels::testing

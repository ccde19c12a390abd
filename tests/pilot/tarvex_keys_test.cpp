// The keys of the graph, on the pilot panel with its several displays.
#include "tests/pilot/pilot_fixture.h"

namespace frontpanels::testing {
namespace {

constexpr std::int16_t kUp = 38;
constexpr std::int16_t kDown = 40;
constexpr std::int16_t kPlus = 107;
constexpr std::int16_t kMinus = 109;

TEST_F(PilotTest, KeysChooseTheDisplayAndWorkOnItsMarkersAndScale) {
  const auto active = [this] { return panel->base().traceManager().activeTrace()->resultType(); };
  const auto point = [this] { return panel->base().traceManager().activeTrace()->activeMarker()->point; };
  EXPECT_FALSE(panel->KeyDown(kDown, 0));
  publishLevels(kAllPilotsPath + "AllPilotsTrace", {-20, -5, -30, -10, -30});
  EXPECT_FALSE(panel->KeyDown(kDown, 0));  // one display alone
  publishFrame(kTopNPath, {{12, -7}, {30, -9}});
  publishLevels(kZoomedPath + "Zoomed Pilots Trace", {-20, -12, -30});
  EXPECT_EQ(active(), 17);
  EXPECT_TRUE(panel->KeyDown(kDown, 0));
  EXPECT_EQ(active(), 17);  // the last that was added
  EXPECT_TRUE(panel->KeyDown(kUp, 0));
  EXPECT_EQ(active(), 203);
  for (const std::int16_t key : std::vector<std::int16_t>{'P', 'N', 'D', 'C', 39, 36, 9})
    EXPECT_FALSE(panel->KeyDown(key, 0)) << key;
  EXPECT_TRUE(panel->KeyDown(kPlus, 0) && panel->KeyDown(kPlus, 0) && panel->KeyDown(kMinus, 0));
  EXPECT_EQ(bars(203)->verticalResolution(), 4);  // from 3 dB a division
  EXPECT_EQ(trace(11)->verticalResolution(), 5);
  EXPECT_TRUE(panel->KeyDown(kUp, 0));
  EXPECT_EQ(active(), 11);
  panel->addMarker();
  EXPECT_TRUE(panel->KeyDown('P', 0));
  EXPECT_EQ(point(), 1);
  EXPECT_TRUE(panel->KeyDown('N', 0));
  EXPECT_EQ(point(), 3);
  EXPECT_FALSE(panel->KeyDown('C', 0));  // no button of that kind here
  EXPECT_EQ(said(), "");
}

}  // namespace
}  // namespace frontpanels::testing

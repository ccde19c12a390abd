// What Tarvex says of its graph.
#include "pilot/cell_name_info.h"
#include "tests/pilot/pilot_fixture.h"
#include "tests/support/listed_items.h"

namespace frontpanels::testing {
namespace {

class PilotItemsTest : public PilotTest {
 protected:
  [[nodiscard]] clsTraceManager& traces() { return panel->base().traceManager(); }
  [[nodiscard]] std::string said() {
    const GraphItems items = traces().graphItems();
    EXPECT_EQ(traces().graphState().items, items.all().size());
    return frontpanels::testing::listed(items);
  }
};

// The plot is (48, 24) of 700 x 525 in the graph at (20, 15), 0 to -30 dB in divisions of 3: 17.5 pixels a
// dB, and bars take the middle three quarters of their half of it. A value below the axis leaves a line.
TEST_F(PilotItemsTest, BarsAreReadWithTheirQuantityAndTheNamesThatAreShown) {
  publishFrame(kTopNPath, {{12, -7}, {300, -20.5F}});
  EXPECT_EQ(said(),
            "Top N: 2 bars, largest PN 12, -7.0 dB (20,15 760x570) selected\n"
            "PN 12: -7.0 dB (112,161 262x403)\n"
            "PN 300: -20.5 dB (462,398 262x166)\n");
  const auto names = std::make_shared<clsCellNameInfo>();
  names->SetCellName(12, -1, "Mill Lane");
  panel->CellNameInfo(names);
  bars(203)->ShowCellName(true);
  bars(203)->otherIs(3);
  bars(203)->setBarLabel("Cell");
  publishFrame(kTopNPath, {{12, -300}});  // the other quantity is the value plus Io of -70
  EXPECT_EQ(said().substr(said().find('\n') + 1),
            "Cell 12, Mill Lane: -300.0 dB, -370.0 dBm (156,563 525x1)\n");
}

TEST_F(PilotItemsTest, WithSeveralDisplaysNamesSayWhoseTheyAre) {
  publishLevels(kAllPilotsPath + "AllPilotsTrace", {-10, -20, -5});
  publishFrame(kTopNPath, {{12, -7}});
  const std::string text = said();
  EXPECT_NE(text.find("All Pilots: 1 trace, 0 markers ("), std::string::npos) << text;
  EXPECT_NE(text.find("Trace 1, All Pilots: 3 points, largest -5 dB at 2 PN ("), std::string::npos) << text;
  EXPECT_NE(text.find("PN 12, Top N: -7.0 dB ("), std::string::npos) << text;
}

}  // namespace
}  // namespace frontpanels::testing

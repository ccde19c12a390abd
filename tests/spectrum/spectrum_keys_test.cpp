// The keys of the graph, on the spectrum panel.
#include "tests/spectrum/spectrum_fixture.h"

namespace frontpanels::testing {
namespace {

constexpr std::int16_t kShift = 1;
constexpr std::int16_t kCtrl = 2;
enum Key : std::int16_t {
  kTab = 9,
  kEsc = 27,
  kEnd = 35,
  kHome,
  kLeft,
  kUp,
  kRight,
  kDown,
  kPlus = 107,
  kMinus = 109
};

using Keys = std::vector<std::int16_t>;

class SpectrumKeysTest : public SpectrumViewTest {
 protected:
  SpectrumKeysTest() { publish(kSweep); }

  bool press(std::int16_t key, std::int16_t shift = 0) {
    const bool wanted = panel->base().usesKey(key, shift);
    const bool used = panel->KeyDown(key, shift);
    EXPECT_EQ(used, wanted) << key;
    return used;
  }
  [[nodiscard]] clsMultiTracePainter& painter() {
    return dynamic_cast<clsMultiTracePainter&>(*panel->base().traceManager().activeTrace());
  }
  // Id and point of the active marker, "-" without one.
  [[nodiscard]] std::string active() {
    const MarkerPointer marker = painter().activeMarker();
    return marker == nullptr ? "-" : marker->id + "@" + std::to_string(marker->point);
  }
  // The same after a key, "unused" when it is another's.
  [[nodiscard]] std::string after(std::int16_t key, std::int16_t shift = 0) {
    return press(key, shift) ? active() : "unused";
  }
  [[nodiscard]] Control& button(std::string_view name) { return panel->controls()->control(name); }
  void drag(const char* id, std::int32_t byPx, bool release = false) {
    const MarkerPointer marker = painter().findMarker(id);
    const auto x = [&](std::int32_t px) {
      return static_cast<float>(px + 20) * 15;
    };  // the graph lies at (20, 15)
    const float y = static_cast<float>(marker->positionY + 15) * 15;
    const std::int32_t from = marker->positionX;
    panel->MouseDown(1, 0, x(from), y);
    panel->MouseMove(1, 0, x(from + byPx), y);
    if (release) panel->MouseUp(1, 0, x(from + byPx), y);
  }

  //                                0    1    2    3    4    5    6    7    8    9   10   11
  const std::vector<float> kSweep{-90, -40, -80, -60, -80, -30, -90, -50, -99, -98, -97, -96};
};

TEST_F(SpectrumKeysTest, KeysWalkTheMarkerAndWithoutOneTheyAreTheContainers) {
  for (const std::int16_t key : Keys{kLeft, kRight, kHome, kEnd, kTab, kEsc, kUp, kDown})
    EXPECT_FALSE(press(key)) << key;
  for (const std::int16_t key : Keys{'P', 'N', 'D', 'C', 'A'}) EXPECT_FALSE(press(key)) << key;
  EXPECT_FALSE(press(kRight, kCtrl));
  panel->addMarker();
  EXPECT_EQ(after(kHome), "1@0");
  EXPECT_EQ(after(kLeft), "1@0");
  EXPECT_EQ(after(kRight), "1@1");
  EXPECT_EQ(after(kRight, kCtrl), "1@2");  // a tenth of 12 points
  EXPECT_EQ(after(kLeft, kCtrl), "1@1");
  EXPECT_EQ(after(kEnd), "1@11");
  EXPECT_EQ(after(kRight, kCtrl), "1@11");
  EXPECT_EQ(after('P'), "1@5");
  EXPECT_EQ(after('N'), "1@1");
  EXPECT_EQ(after('N'), "1@7");
  EXPECT_EQ(after('N'), "1@3");
  EXPECT_EQ(after('N'), "1@3");  // the end of the trace stands but 3 dB above the floor
  EXPECT_EQ(after('N', kShift), "1@7");
  EXPECT_EQ(after('P', kCtrl), "unused");
  EXPECT_EQ(after(kTab), "unused");  // there is but one marker
  EXPECT_EQ(after(kEsc), "unused");
  EXPECT_TRUE(messages().empty());
}

TEST_F(SpectrumKeysTest, KeysDoWhatTheirButtonsDoAndObeyWhatTheyObey) {
  panel->addMarker();
  panel->vfpSet(0, 13, 0, 98e6);
  panel->vfpSet(0, 14, 0, 11e6);  // 92.5 to 103.5 MHz: points lie 1 MHz apart
  owner.take();
  EXPECT_EQ(after('P'), "1@5");
  EXPECT_TRUE(press('C'));
  EXPECT_EQ(owner.take(), Messages{"frontPanelSet 0 0 13 0 97500000"});
  EXPECT_TRUE(press(kPlus) && press(187, kShift));  // from 10 dB a division
  EXPECT_EQ(painter().verticalResolution(), 12);
  EXPECT_TRUE(press(kMinus));
  EXPECT_EQ(painter().verticalResolution(), 11);
  EXPECT_EQ(panel->controls()->textBox("VerticalScaleTextBox").Text(), "11");
  panel->vfpSet(0, 322, 0, 1);  // logging holds the receiver where it is
  EXPECT_EQ(after('C'), "unused");
  EXPECT_EQ(after('P'), "1@5");
  panel->base().rightPanelEnabled(false);
  for (const std::int16_t key : Keys{'P', 'N', 'D', 'C', kPlus, kMinus}) EXPECT_FALSE(press(key)) << key;
  EXPECT_EQ(after(kRight), "1@6");
  panel->base().rightPanelEnabled(true);
  panel->vfpOp(0, 1, {});
  EXPECT_FALSE(press(kRight) || press('P'));
  EXPECT_EQ(owner.take(), Messages{"visible off"});
}

TEST_F(SpectrumKeysTest, DeltaComesAndGoesByOneKeyWhicheverOfTheTwoIsActive) {
  panel->addMarker();
  press(kHome);
  EXPECT_EQ(after('D'), "1@0");
  EXPECT_EQ(painter().markerCollection().count(), 2U);
  EXPECT_FALSE(button("MarkerDeltaButton").Enabled());
  EXPECT_EQ(after(kTab), "1d@4");  // put in the middle of the graph, as by the button
  EXPECT_EQ(after(kEnd), "1d@11");
  EXPECT_EQ(after('D'), "1@0");
  EXPECT_EQ(painter().markerCollection().count(), 1U);
  EXPECT_TRUE(button("MarkerDeltaButton").Enabled());
  EXPECT_EQ(after('D'), "1@0");
  EXPECT_EQ(after('D'), "1@0");
  EXPECT_EQ(painter().markerCollection().count(), 1U);
}

TEST_F(SpectrumKeysTest, TabGoesThroughTheMarkersByNumberAndLeavesBehindTheLast) {
  for (const std::int16_t key : Keys{kHome, kEnd, kHome}) panel->addMarker(), press(key);
  press('D');
  EXPECT_EQ(after(kTab), "3d@4");
  EXPECT_EQ(after(kTab), "unused");
  for (const char* next : {"3@0", "2@11", "1@0", "unused"}) EXPECT_EQ(after(kTab, kShift), next);
  EXPECT_EQ(painter().markerCollection().item(std::size_t{1})->id, "1");  // as chosen last
  EXPECT_EQ(after(kTab), "2@11");
  EXPECT_EQ(after(kTab, kCtrl), "unused");
}

TEST_F(SpectrumKeysTest, TheTenthMarkerComesAfterTheNinth) {
  for (int count = 0; count < 10; ++count) panel->addMarker(), press(kHome);
  EXPECT_EQ(after(kTab), "unused");
  for (const char* next : {"9@0", "8@0"}) EXPECT_EQ(after(kTab, kShift), next);
}

TEST_F(SpectrumKeysTest, EscapeTakesADraggedMarkerBackWhileTheButtonIsDown) {
  panel->addMarker();
  press('P');
  drag("1", 150);  // points lie 70 pixels apart: 2 on
  EXPECT_EQ(active(), "1@7");
  EXPECT_EQ(after(kEsc), "1@5");
  EXPECT_EQ(after(kEsc), "unused");
  panel->MouseMove(1, 0, 15, 15);
  EXPECT_EQ(active(), "1@5");  // it is free
  panel->MouseUp(1, 0, 15, 15);
  drag("1", 150, true);
  EXPECT_EQ(after(kEsc), "unused");
  EXPECT_EQ(active(), "1@7");
  drag("1", 150);
  publish({-50, -50});  // a shorter sweep comes in the middle of it
  EXPECT_EQ(after(kEsc), "1@2");
  EXPECT_TRUE(messages().empty());
}

TEST_F(SpectrumKeysTest, UpAndDownChooseAmongTheTracesAndTheirMarkers) {
  EXPECT_FALSE(press(kDown));
  painter().addNewTraceAtEnd(7, 0, 11);
  painter().trace(1, Variant(Variant::Singles(kSweep)));
  panel->addMarker();
  EXPECT_EQ(after(kDown), "-");
  EXPECT_EQ(painter().selectedTraceIndex(), 1);
  EXPECT_EQ(painter().activeTraceColor(), rgb(255, 0, 0));
  EXPECT_FALSE(button("MarkerDeleteButton").Enabled() || button("MarkerToCenterButton").Enabled());
  panel->addMarker();
  EXPECT_EQ(after('P'), "1@5");
  EXPECT_EQ(painter().traceMarkerCollections(1).count(), 1U);
  EXPECT_EQ(after(kDown), "1@5");  // the last one
  press(kUp);
  EXPECT_EQ(painter().selectedTraceIndex(), 0);
  EXPECT_EQ(after(kHome), "1@0");
  EXPECT_EQ(after(kTab), "1@5");  // of the other trace
  EXPECT_EQ(painter().selectedTraceIndex(), 1);
}

}  // namespace
}  // namespace frontpanels::testing

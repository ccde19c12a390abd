#include "framework/panel/fields_picture.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "tests/spectrum/spectrum_fixture.h"
#include "tests/support/recording_gdi.h"

namespace frontpanels::testing {
namespace {

constexpr ControlRow kRows[] = {
    {"Area", ControlKind::Picture, "", "", {1500, 0, 3000, 1500}},
    {"Box", ControlKind::TextBox, "Area", "", {150, 150, 900, 300}, 0},
    {"Spin", ControlKind::SpinButton, "Area", "", {1050, 150, 150, 300}},
    {"Check", ControlKind::CheckBox, "Area", "A&uto && more", {150, 600, 1500, 300}, 1},
    {"Far", ControlKind::Label, "Area", "Far", {2700, 600, 900, 300}},
    {"Gone", ControlKind::Label, "Area", "Gone", {3000, 600, 900, 300}},
    {"Close", ControlKind::PushButton, "", "&Close", {0, 1500, 1500, 450}, 2},
    {"Hidden", ControlKind::PushButton, "", "Hidden", {0, 2100, 1500, 450}, 3, false},
};

class FieldsPictureTest : public ::testing::Test {
 protected:
  FieldsPictureTest() { font = gdi.createFont({"Arial", 11}); }
  ~FieldsPictureTest() override {
    gdi.deleteObject(font);
    EXPECT_EQ(gdi.liveObjects(), 0);
    EXPECT_EQ(gdi.violations(), std::vector<std::string>{});
    EXPECT_EQ(gdi.clip(gdi.viewDc()), std::nullopt);
  }
  void paint(Size viewPx = {400, 300}, std::int32_t dpi = 96) {
    gdi.clear();
    paintFields(gdi, gdi.viewDc(), set, viewPx, dpi, [this](const Control&) { return font; });
  }
  [[nodiscard]] const Call* textOf(std::string_view text) {
    texts = gdi.texts();
    const auto found =
        std::find_if(texts.begin(), texts.end(), [text](const Call& call) { return call.text == text; });
    return found == texts.end() ? nullptr : &*found;
  }
  [[nodiscard]] bool filled(Rect rect, SystemColor color) {
    const std::vector<Call> fills = gdi.fills();
    return std::any_of(fills.begin(), fills.end(), [&](const Call& call) {
      return call.rect == rect && call.brush == gdi.sysColor(color);
    });
  }

  [[nodiscard]] bool edged(Rect rect, std::uint32_t edge) {
    const std::vector<EdgeValue> edges = gdi.edges();
    return std::count(edges.begin(), edges.end(), EdgeValue{gdi.viewDc(), rect, edge, kAllSides}) == 1;
  }

  RecordingGdi gdi;
  ControlSet set{kRows};
  FontHandle font;
  std::vector<Call> texts;
};

// 15 twips a pixel; a field stands where its area and its own place put it.
TEST_F(FieldsPictureTest, FieldsStandWhereTheirWindowsWould) {
  set.textBox("Box").Text("881.52 MHz");
  paint();
  const Rect box{110, 10, 170, 30};
  EXPECT_TRUE(filled({100, 0, 300, 100}, SystemColor::ButtonFace));
  EXPECT_TRUE(filled(box, SystemColor::Window));
  EXPECT_TRUE(edged(box, kEdgeSunken));
  EXPECT_TRUE(edged({0, 100, 100, 130}, kEdgeRaised));
  // The arrows of a spin button share its height.
  EXPECT_TRUE(edged({170, 10, 180, 20}, kEdgeRaised));
  EXPECT_TRUE(edged({170, 20, 180, 30}, kEdgeRaised));
  const Call* const text = textOf("881.52 MHz");
  ASSERT_NE(text, nullptr);
  EXPECT_EQ(text->points[0].x, 113);
  EXPECT_EQ(text->clip, (Rect{113, 13, 167, 27}));
  EXPECT_EQ(text->textColor, gdi.sysColor(SystemColor::WindowText));
  EXPECT_EQ(textOf("Hidden"), nullptr);
  set.textBox("Box").Text("5");
  paint();
  EXPECT_EQ(textOf("5")->points[0].x, 167 - 8);  // a number stands at the right, beside its arrows
}

TEST_F(FieldsPictureTest, CaptionsLoseTheMarkOfTheirKeyAndButtonsHaveThemInTheMiddle) {
  paint();
  EXPECT_NE(textOf("Auto & more"), nullptr);
  const Call* const close = textOf("Close");
  ASSERT_NE(close, nullptr);
  const Size extent = gdi.textExtent(gdi.viewDc(), "Close");
  EXPECT_EQ(close->points[0], (Point{2 + (96 - extent.width) / 2, 102 + (26 - extent.height) / 2}));
}

TEST_F(FieldsPictureTest, AnAreaAndTheViewCutOffWhatReachesOutOfThem) {
  paint();
  ASSERT_NE(textOf("Far"), nullptr);
  EXPECT_EQ(textOf("Far")->clip, (Rect{280, 40, 300, 60}));
  EXPECT_EQ(textOf("Gone"), nullptr);
  paint({290, 100});
  EXPECT_EQ(textOf("Far")->clip, (Rect{280, 40, 290, 60}));
  EXPECT_EQ(textOf("Close"), nullptr);
}

TEST_F(FieldsPictureTest, StatesAreSeen) {
  paint();
  const std::size_t empty = gdi.polylines().size();
  set.checkBox("Check").Value(1);
  set.control("Close").Enabled(false);
  paint();
  EXPECT_EQ(gdi.polylines().size(), empty + 2);  // a tick of two lines
  EXPECT_EQ(textOf("Close")->textColor, gdi.sysColor(SystemColor::GrayText));
  EXPECT_EQ(textOf("Auto & more")->textColor, gdi.sysColor(SystemColor::ButtonText));
}

// --- Another scale

// The box is 13 dots at 96 an inch, its caption 4 behind it.
TEST_F(FieldsPictureTest, MarksGrowWithTheScale) {
  paint({800, 600}, 192);
  EXPECT_TRUE(edged({220, 87, 246, 113}, kEdgeSunken));
  EXPECT_EQ(textOf("Auto & more")->points[0].x, 246 + 8);
}

class RescaledPanelTest : public SpectrumViewTest {};

// Twice as many dots: half the twips a pixel, insets of as many twips.
TEST_F(RescaledPanelTest, AGraphFollowsTheScaleOfItsScreen) {
  publish({-50, -60, -70});
  auto& painter = dynamic_cast<PlotPainter&>(*panel->base().traceManager().activeTrace());
  const float insetBefore = painter.gridScaleLeft();
  gdi.clear();
  panel->rescale({7.5F, 7.5F});
  EXPECT_EQ(panel->ViewScaleWidth(), 800 * 7.5F);
  EXPECT_EQ(painter.gridScaleLeft(), insetBefore * 2);
  // 800 x 600 px with margins of 2.5 %
  EXPECT_EQ(gdi.bitmapArea(panel->base().traceManager().shadowDC()), (Rect{0, 0, 760, 570}));
  ASSERT_FALSE(gdi.texts().empty());
  EXPECT_EQ(gdi.texts().back().font.emHeightPx, 24);  // 9 points are 180 twips
}

}  // namespace
}  // namespace frontpanels::testing

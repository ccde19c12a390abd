#include <memory>

#include "tests/painters/bar_chart_fixture.h"
#include "tests/support/fake_surface.h"

namespace frontpanels {
namespace {

using testing::BarChartTest;
using testing::Call;
using testing::kNoNumber;

constexpr Color kFace = rgb(15, 15, 15);
constexpr Color kInk = rgb(18, 18, 18);
constexpr Color kWhite = rgb(255, 255, 255);
constexpr Color kBlue = rgb(0, 84, 200);
constexpr Color kRed = rgb(196, 0, 0);

// Panel (0, 0) to (260, 144), plot (48, 24) to (248, 124), values from -100 to 0: a pixel a level upwards,
// two across. No grid and no value axis's labels until a test wants them.
class BarPaintTest : public BarChartTest {
 protected:
  BarPaintTest() {
    chart.scaleWidth(260);
    chart.scaleHeight(144);
    chart.numberOfVerticalDivisions(0);
    chart.numberOfHorizontalDivisions(0);
    fonts = {gdi.createFont({"axis"}), gdi.createFont({"corner"}), 8, 12};
  }
  void paint() {
    gdi.clear();
    chart.Paint(dc);
  }
  // Text and place of what Label writes, "5 93,127 | 9 193,127".
  [[nodiscard]] std::string written() {
    chart.Paint(dc);
    gdi.clear();
    chart.Label(dc, fonts);
    std::string all;
    for (const Call& text : gdi.texts()) {
      all += (all.empty() ? "" : " | ") + text.text + " " + std::to_string(text.points[0].x) + "," +
             std::to_string(text.points[0].y);
    }
    return all;
  }
  [[nodiscard]] std::vector<Rect> filled() const {
    std::vector<Rect> rects;
    for (const Call& fill : gdi.fills()) rects.push_back(fill.rect);
    return rects;
  }

  LabelFonts fonts;
};
using Rects = std::vector<Rect>;

TEST_F(BarPaintTest, BarsAreFilledInTheColorsOfTheirIdentities) {
  update({{5, -25}, {9, -50}, {7, kNoNumber}, {8, -120}});
  update({{9, -50}, {5, -25}});
  paint();
  // Slots of 100 pixels: bars of 75, 12 behind the slot's beginning.
  EXPECT_EQ(filled(), (Rects{{0, 0, 260, 144}, {60, 74, 135, 124}, {160, 49, 235, 124}}));
  EXPECT_EQ(gdi.fills()[0].brush, kFace);
  EXPECT_EQ(gdi.fills()[1].brush, kRed);
  EXPECT_EQ(gdi.fills()[2].brush, kBlue);
  EXPECT_EQ(chart.getCurrentBarColor(), kRed);  // of the first one
  chart.BarChartStyle(1);
  paint();
  EXPECT_EQ(filled(), (Rects{{0, 0, 260, 144}, {48, 30, 148, 68}, {48, 80, 198, 118}}));
  EXPECT_EQ(said(), "");
}

TEST_F(BarPaintTest, BarsWithoutAValueKeepTheirPlaceAndOnlyTheFirstArePainted) {
  update({{5, -25}, {9, kNoNumber}, {7, -50}, {8, -150}, {6, 50}});
  chart.setBarsToPaint(4);
  paint();  // slots of 50: bars of 38, 6 behind; the fourth lies below the axis
  EXPECT_EQ(filled(), (Rects{{0, 0, 260, 144}, {54, 49, 92, 124}, {154, 74, 192, 124}}));
  chart.setBarsToPaint(-1);
  paint();  // slots of 40: bars of 30, 5 behind; the fifth is cut at the top
  EXPECT_EQ(filled(), (Rects{{0, 0, 260, 144}, {53, 49, 83, 124}, {133, 74, 163, 124}, {213, 24, 243, 124}}));
}

TEST_F(BarPaintTest, TheThirteenthIdentityHasTheFirstColorAgain) {
  Items items;
  for (int i = 0; i < 13; ++i) items.emplace_back(static_cast<float>(i), -50.0F);
  update(items);
  paint();
  EXPECT_EQ(gdi.fills()[13].brush, kBlue);
  EXPECT_EQ(gdi.fills()[12].brush, rgb(80, 48, 0));
}

TEST_F(BarPaintTest, GridBarsAndThresholdLieOnEachOtherInThisOrder) {
  chart.numberOfVerticalDivisions(2);
  chart.verticalResolution(50);
  chart.numberOfHorizontalDivisions(1);
  chart.threshold(-30.0);
  update({{5, -25}});
  paint();
  EXPECT_EQ(gdi.drawingOrder(),
            (std::vector<std::string>{"fillRect", "polyline", "polyline", "polyline", "polyline", "polyline",
                                      "fillRect", "polyline", "polyline"}));
  const std::vector<Call> lines = gdi.polylines();
  EXPECT_EQ(lines[1].points, (std::vector<Point>{{48, 74}, {248, 74}}));
  EXPECT_EQ(lines[5].points, (std::vector<Point>{{48, 54}, {248, 54}}));
  EXPECT_EQ(lines[5].pen, (testing::PenValue{PenStyle::Solid, 1, kFace}));
  EXPECT_EQ(lines[6].pen, (testing::PenValue{PenStyle::Dash, 1, kInk}));
  chart.BarChartStyle(1);
  paint();
  EXPECT_EQ(gdi.polylines()[6].points, (std::vector<Point>{{188, 24}, {188, 124}}));
  chart.threshold(0.5);  // above the axis
  paint();
  EXPECT_EQ(gdi.polylines().size(), 5U);
}

TEST_F(BarPaintTest, BarsMayBeOutlinedOrHatched) {
  update({{5, -25}});
  chart.setDrawBorders(true);
  paint();
  EXPECT_EQ(gdi.polylines()[0].points,
            (std::vector<Point>{{73, 49}, {222, 49}, {222, 123}, {73, 123}, {73, 49}}));
  chart.setDrawBorders(false);
  chart.setFillStyle(1);
  paint();
  EXPECT_EQ(filled().size(), 1U);
  EXPECT_EQ(gdi.polylines().size(), 1U);
  chart.setFillStyle(7);
  paint();
  EXPECT_EQ(gdi.succeeded("createHatchBrush").size(), 1U);
  EXPECT_EQ(gdi.fills()[1].backgroundMode, BackgroundMode::Transparent);
}

TEST_F(BarPaintTest, AutoScaleFollowsThePaintedBarsWhenTheyLeaveTheAxis) {
  struct ScaleCase {
    float largest;
    float smallest;
    double top;
    double perDivision;
  };
  const std::vector<ScaleCase> cases = {
      {-20, -80, 0, 10},         // a fifth of the range free at either end: kept
      {-0.11F, -99.89F, 0, 10},  // a thousandth: kept
      {-50, -60, -44, 2},        // 10 / 0.85 in ten steps of 2; (-110 + 20) / 2 in tenths of 20: -22.5 to -22
      {-45, -63, -44, 2},        // within its fifths: kept
      // Above the top: 20 / 0.85 in steps of 5; (-106 + 50) / 2 in tenths of 50: -5.6 to -6.
      {-43, -63, -30, 5},
  };
  chart.numberOfVerticalDivisions(10);
  chart.setBarsToPaint(3);
  chart.setAutoScale(true);
  for (const ScaleCase& given : cases) {
    update({{1, given.largest}, {2, kNoNumber}, {3, given.smallest}, {4, 1000}});
    chart.Paint(dc);
    EXPECT_EQ(chart.gridScaleTop().value_or(0), given.top) << given.largest;
    EXPECT_EQ(chart.getDbPerDivision(), given.perDivision) << given.largest;
  }
  EXPECT_EQ(said(), "");
}

TEST_F(BarPaintTest, TheFixedAxisEndsAboveTheFloorAndBeginsAtAnIncrement) {
  chart.numberOfVerticalDivisions(10);
  chart.gridScaleTop(-62);
  chart.Paint(dc);
  chart.Label(dc, fonts);
  EXPECT_EQ(chart.yAxisLabels(),
            (std::vector<std::string>{"-62", "-72", "-82", "-92", "-102", "-112", "-122"}));
  chart.setIncrement(5);
  chart.Paint(dc);
  chart.Label(dc, fonts);
  EXPECT_EQ(chart.yAxisLabels(),
            (std::vector<std::string>{"-60", "-70", "-80", "-90", "-100", "-110", "-120", "-130"}));
}

TEST_F(BarPaintTest, KeysAndQuantitiesAreWrittenAtTheirBars) {
  chart.suffixIs(2);
  chart.valueIs(1);
  update({{5, -25}, {9, -50}});
  EXPECT_EQ(written(), "dBm 20,2 | 5 93,127 | -25.0 dBm 61,36 | 9 193,127 | -50.0 dBm 161,61");
  EXPECT_EQ(chart.bars()[0].label, "5  -25.0 dBm");
  EXPECT_EQ(filled(), (Rects{{61, 36, 133, 48}, {161, 61, 233, 73}}));  // the grid gives way
  chart.BarChartStyle(1);  // without its first row a letter is 11 high
  EXPECT_EQ(written(), "5 36,42 | 9 36,92 | -50.0 dBm 152,92 | -25.0 dBm 122,42");
  EXPECT_EQ(gdi.texts()[2].textColor, kInk);
  EXPECT_EQ(gdi.texts()[3].textColor, kWhite);  // it would leave the panel behind its bar
  EXPECT_EQ(gdi.texts()[3].backgroundMode, BackgroundMode::Transparent);
  chart.setBarLabel("PN");
  chart.setBarLabeling(1);
  EXPECT_EQ(written(), "PN 5 12,42 | PN 9 12,92");
  chart.setBarLabeling(0);
  EXPECT_EQ(written(), "");
  EXPECT_EQ(said(), "");
}

TEST_F(BarPaintTest, TheOtherQuantityHasTheUnitOfItsType) {
  const std::vector<const char*> labels = {"5",           "5  -75.0",     "5  3.5 chips", "5  -75.0 dBm",
                                           "5  -25.0 dB", "5  -70.0 dBm", "5  -20.0 dB",  "5  1.3 chips",
                                           "5  2.0 dB",   "5  3.5",       "5  -20.0",     "5  3.5",
                                           "5  3.5"};
  chart.offset(-50.0);
  for (std::size_t type = 0; type < labels.size(); ++type) {
    chart.otherIs(static_cast<std::int16_t>(type));
    update({5, -25, 3.5F, -20, 1.25F, 2}, 1, 6);
    (void)written();
    EXPECT_EQ(chart.bars()[0].label, labels[type]) << type;
  }
}

TEST_F(BarPaintTest, UnitsAreThoseOfTheSuffixOrTheOnesGiven) {
  chart.valueIs(1);
  update({{5, -25}});
  std::string labels;
  for (std::int16_t suffix = 0; suffix < 4; ++suffix) {
    chart.suffixIs(suffix);
    (void)written();
    labels += chart.bars()[0].label + "|" + chart.yAxisLabel() + "|";
  }
  EXPECT_EQ(labels, "5  -25.0||5  -25.0 dB|dB|5  -25.0 dBm|dBm|5  -25.0 chips|chips|");
  chart.suffixIs(0);
  chart.units("V");
  (void)written();
  EXPECT_EQ(chart.bars()[0].label + chart.yAxisLabel(), "5  -25.0 VV");
}

class NamesByIdentifiers : public CellNames {
 public:
  [[nodiscard]] std::string_view GetCellName(double id1, double id2) const noexcept override {
    return id1 == 5 ? id2 == 3.5 ? "Quay" : id2 == -1 ? "Hill" : "?" : "";
  }
};

TEST_F(BarPaintTest, TheCellsNameStandsAtTheBar) {
  chart.ShowCellName(true);
  update({5, -25, 3.5F, 9, -50, 3.5F}, 2, 3);
  EXPECT_EQ(written(), "5 93,127 | 9 193,127");  // nobody knows a name
  chart.CellNameInfo(std::make_shared<NamesByIdentifiers>());
  EXPECT_EQ(written(), "5 93,127 | Hill 81,36 | 9 193,127");
  chart.hasCellNameLookupId2(true);
  EXPECT_EQ(written(), "5 93,127 | Quay 81,36 | 9 193,127");
}

TEST_F(BarPaintTest, KeysWithoutRoomStandInTheTopRowAsFarAsTheyFit) {
  Items items;
  for (int i = 0; i < 10; ++i)
    items.emplace_back(100.0F + static_cast<float>(i), -10.0F - static_cast<float>(i));
  update(items);
  // Slots of 20 pixels for keys of 24: every second one. 23 letters up to 248.
  EXPECT_EQ(written(),
            "100 45,127 | 102 85,127 | 104 125,127 | 106 165,127 | 108 205,127 | "
            "101, 103, 105, 107, 109 64,2");
  EXPECT_EQ(gdi.texts().back().font.face, "corner");
  chart.topLabel("123");  // to 72
  EXPECT_EQ(written(),
            "123 48,2 | 100 45,127 | 102 85,127 | 104 125,127 | 106 165,127 | 108 205,127 | "
            "101, 103, 105, 107 104,2");
}

TEST_F(BarPaintTest, TheTopRowGivesWayToTextsOfBarsThatReachIt) {
  Items items;
  for (int i = 0; i < 10; ++i) items.emplace_back(100.0F + static_cast<float>(i), 0.0F);
  chart.valueIs(1);
  update(items);
  (void)written();  // every second bar has "0.0" at 11 to 23, the row is at 2 to 14
  EXPECT_EQ(gdi.texts().back().text, "0.0");
}

TEST_F(BarPaintTest, WhatCannotBePaintedIsLeftOutOrReported) {
  update({{5, -25}});
  chart.scaleWidth(60);  // no plot between the insets
  EXPECT_EQ(written(), "");
  EXPECT_EQ(said(), "");
  chart.scaleWidth(1e30F);
  paint();
  chart.Label(dc, fonts);
  EXPECT_EQ(said(),
            "clsBarChartPainter::Paint()...\rOverflow\n"
            "clsBarChartPainter::LabelVerticalBarChart()...\rOverflow");
  chart.BarChartStyle(1);
  chart.Label(dc, fonts);
  EXPECT_EQ(said(), "clsBarChartPainter::LabelHorizontalBarChart()...\rOverflow");
  chart.Paint();
  EXPECT_EQ(said(), "clsBarChartPainter::Paint()...\rObject variable or With block variable not set");
  testing::FakeTraceForm form;
  form.dc = dc;
  form.scaleWidth = 260;
  form.scaleHeight = 144;
  chart.drawingArea(&form);
  gdi.clear();
  chart.Paint();
  EXPECT_EQ(filled(), (Rects{{0, 0, 260, 144}, {48, 36, 198, 111}}));
}

TEST_F(BarPaintTest, AFailingCallLosesNoObject) {
  chart.numberOfVerticalDivisions(10);
  chart.threshold(-30.0);
  chart.setDrawBorders(true);
  chart.valueIs(1);
  update({{5, -25}, {9, -50}});
  const auto frame = [this] {
    gdi.clear();
    chart.createClippingRegion(0, 0, 260, 144, dc);
    chart.Paint(dc);
    chart.destroyClippingRegion(dc);
    chart.Label(dc, fonts);
  };
  frame();
  const int objects = gdi.liveObjects();
  for (const int call : gdi.callsThatMayFail()) {
    gdi.clear();
    gdi.failNthCall(call);
    frame();
    EXPECT_EQ(gdi.liveObjects(), objects) << call;
    EXPECT_TRUE(gdi.violations().empty()) << call << gdi.violations().front();
  }
  EXPECT_EQ(said(), "");
}

}  // namespace
}  // namespace frontpanels

#include "painters/bar_layout.h"

#include <limits>
#include <string>

#include "tests/support/recording_gdi.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels {

std::ostream& operator<<(std::ostream& out, PxSpan span) { return out << span.from << ".." << span.to; }

namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr auto kUp = BarDirection::Vertical;
constexpr auto kAcross = BarDirection::Horizontal;

class BarLayoutTest : public testing::ReportingTest {};

// Plot (50, 20) of 200 x 100 pixels, values from -100 to 0.
constexpr PlotRect kPlot{50, 20, 200, 100};
constexpr ValueRange kLevels{-100, 0};

struct RectCase {
  BarDirection direction;
  std::size_t count;
  std::size_t bar;
  double value;
  Rect expected;
};

class BarRectTest : public BarLayoutTest, public ::testing::WithParamInterface<RectCase> {};

TEST_P(BarRectTest, IsThreeQuartersOfItsSlot) {
  const RectCase& given = GetParam();
  EXPECT_EQ(BarFrame(kPlot, given.direction, kLevels, given.count).bar(given.bar, given.value),
            given.expected);
}

INSTANTIATE_TEST_SUITE_P(
    Bars, BarRectTest,
    ::testing::Values(
        RectCase{kUp, 4, 0, -25, {56, 45, 94, 120}},     // slot 50: 37.5 to the even 38, 6 before
        RectCase{kUp, 4, 3, -25, {206, 45, 244, 120}},   // 50 + 3 x 50 + 6; 20 + 25
        RectCase{kUp, 8, 1, 0, {78, 20, 97, 120}},       // slot 25: 18.75 to 19, 3 before
        RectCase{kUp, 1, 0, -99, {75, 119, 225, 120}},   // 150 wide, 25 before
        RectCase{kUp, 1, 0, 40, {75, 20, 225, 120}},     // cut at the top
        RectCase{kUp, 1, 0, -100, {75, 120, 225, 120}},  // and at the bottom: no length
        RectCase{kUp, 1, 0, -140, {75, 120, 225, 120}}, RectCase{kUp, 1, 0, kNaN, {75, 120, 225, 120}},
        RectCase{kUp, 40, 39, -50, {245, 70, 249, 120}},     // slot 5: 3.75 to 4, 0.5 to the even 0
        RectCase{kUp, 1000, 999, -50, {249, 70, 250, 120}},  // a pixel at least, and within the plot
        RectCase{kUp, 1000, 0, -50, {50, 70, 51, 120}},
        RectCase{kAcross, 4, 0, -25, {50, 23, 200, 42}},     // slot 25; 75 of 100 levels are 150 pixels
        RectCase{kAcross, 4, 3, -99.75, {50, 98, 50, 117}},  // half a pixel to the even 50
        RectCase{kAcross, 4, 3, -99.25, {50, 98, 52, 117}},  // 51.5 to the even 52
        RectCase{kAcross, 40, 1, 10, {50, 22, 250, 24}},     // slot 2.5 to 2, 0.25 to 0; 22.5 to 22
        RectCase{kAcross, 1, 0, kNaN, {50, 32, 50, 107}}));  // slot 100: 75, 12.5 to 12

TEST_F(BarLayoutTest, AnAxisWithoutExtentHasBarsWithoutLength) {
  EXPECT_EQ(BarFrame(kPlot, kUp, {5, 5}, 1).lengthPx(5), 0);
  EXPECT_EQ(BarFrame(kPlot, kUp, {5, 5}, 1).line(5), std::nullopt);
}

TEST_F(BarLayoutTest, ALineCrossesTheBarsWhereItsLevelLiesWithinTheAxis) {
  using Line = std::array<Point, 2>;
  const BarFrame up(kPlot, kUp, kLevels, 4);
  EXPECT_EQ(up.line(-30), (Line{{{50, 50}, {250, 50}}}));
  EXPECT_EQ(up.line(0), (Line{{{50, 20}, {250, 20}}}));
  EXPECT_EQ(up.line(-100), (Line{{{50, 120}, {250, 120}}}));
  EXPECT_EQ(BarFrame(kPlot, kAcross, kLevels, 4).line(-30), (Line{{{190, 20}, {190, 120}}}));
  for (const double outside : {0.01, -100.01, kNaN}) EXPECT_EQ(up.line(outside), std::nullopt);
}

TEST_F(BarLayoutTest, AFixedAxisHasWholeDivisionsAboveItsFloor) {
  struct AxisCase {
    double top;
    double perDivision;
    std::int32_t divisions;
    FixedAxis expected;
  };
  const std::vector<AxisCase> cases = {
      {0, 10, 10, {{-100, 0}, 10}},       {-30, 10, 10, {{-130, -30}, 10}},  // down to the floor itself
      {-31, 10, 10, {{-121, -31}, 9}},                                       // -131 would pass it
      {-128, 10, 10, {{-130, -128}, 1}},                                     // not one whole division: cut
      {-130, 10, 10, {{-230, -130}, 10}},  // an axis from below the floor has none
      {-20, 20, 5, {{-120, -20}, 5}},     {0, 10, 0, {{0, 0}, 0}}};
  for (const AxisCase& given : cases) {
    EXPECT_EQ(fixedAxis(given.top, given.perDivision, given.divisions, -130), given.expected) << given.top;
  }
}

// --- Texts, each letter 8 x 12 pixels, in the panel (0, 0) to (280, 160).

class BarTextTest : public BarLayoutTest {
 protected:
  void layOut(BarDirection direction, std::vector<double> values, std::vector<BarTextSizes> sizes,
              bool mayStandInside = true) {
    const BarFrame frame(kPlot, direction, kLevels, values.size());
    std::vector<std::int32_t> lengths;
    std::vector<std::uint32_t> order;
    for (std::uint32_t i = 0; i < values.size(); ++i) {
      lengths.push_back(frame.lengthPx(values[i]));
      order.push_back(i);
    }
    std::stable_sort(order.begin(), order.end(), [&](auto a, auto b) { return values[a] > values[b]; });
    labels.draw(gdi, gdi.viewDc(), {}, panel, kPlot.toPixels());
    layout.layOut(frame, panel, lengths, sizes, order, labels, mayStandInside);
  }
  // "bar.part left,top", an "i" for one on the bar itself.
  [[nodiscard]] std::string placed() const {
    std::string all;
    for (const auto& text : layout.placed()) {
      all += (all.empty() ? "" : " | ") + std::to_string(text.bar) + "." + std::to_string(text.part) +
             (text.inside ? "i " : " ") + std::to_string(text.cell.left) + "," +
             std::to_string(text.cell.top);
    }
    return all;
  }
  [[nodiscard]] std::vector<std::uint32_t> withoutKey() const {
    return {layout.withoutKey().begin(), layout.withoutKey().end()};
  }

  testing::RecordingGdi gdi;
  PlotLabels labels;
  Rect panel{0, 0, 280, 160};
  BarTextLayout layout;
};

BarTextSizes keyOf(std::int32_t widthPx) { return {{widthPx, 12}, {}}; }

TEST_F(BarTextTest, KeysStandAtTheBase) {
  layOut(kUp, {-50, -60}, {keyOf(24), keyOf(8)});
  EXPECT_EQ(placed(), "0.0 87,123 | 1.0 195,123");  // bars from 62 to 137 and 162 to 237; 3 under the plot
  layOut(kAcross, {-50, -60}, {keyOf(24), keyOf(8)});
  EXPECT_EQ(placed(), "0.0 22,39 | 1.0 38,89");  // up to 4 before the plot; centres 45 and 95
}

TEST_F(BarTextTest, OfKeysThatWouldMeetTheStrongestKeepTheirs) {
  // Slots of 20 pixels, centres 20 apart: keys 16 wide keep the 4 that belong between them, 17 wide do not.
  const std::vector<double> values{-50, -40, -60, -30, -70, -20, -80, -10, -90, -95};
  layOut(kUp, values, std::vector<BarTextSizes>(10, keyOf(16)));
  EXPECT_EQ(withoutKey(), std::vector<std::uint32_t>{});
  layOut(kUp, values, std::vector<BarTextSizes>(10, keyOf(17)));
  EXPECT_EQ(withoutKey(), (std::vector<std::uint32_t>{0, 2, 4, 6, 8}));
  // Across, slots of 10: rows of 10 fit, rows of 11 do not.
  layOut(kAcross, values, std::vector<BarTextSizes>(10, {{16, 10}, {}}));
  EXPECT_EQ(withoutKey(), std::vector<std::uint32_t>{});
  layOut(kAcross, values, std::vector<BarTextSizes>(10, {{16, 11}, {}}));
  EXPECT_EQ(withoutKey(), (std::vector<std::uint32_t>{0, 2, 4, 6, 8}));
}

TEST_F(BarTextTest, NoKeyLeavesThePanelOrCoversALabel) {
  layOut(kAcross, {-50}, {keyOf(46)});
  EXPECT_EQ(placed(), "0.0 0,63");
  layOut(kAcross, {-50}, {keyOf(47)});
  EXPECT_EQ(withoutKey(), std::vector<std::uint32_t>{0});
  labels.text(LabelPlace::XAxis, "x");  // (146, 123) to (154, 135)
  layOut(kUp, {-50}, {keyOf(24)});
  EXPECT_EQ(withoutKey(), std::vector<std::uint32_t>{0});
  labels.keepRowUnderPlot(12);  // moves it a row down
  layOut(kUp, {-50}, {keyOf(24)});
  EXPECT_EQ(placed(), "0.0 138,123");
}

TEST_F(BarTextTest, QuantitiesStandAtTheEndOfTheirBar) {
  const BarTextSizes two{{}, {Size{40, 12}, Size{24, 12}, Size{}}};
  layOut(kUp, {-50}, {two});
  EXPECT_EQ(placed(), "0.1 130,57 | 0.2 138,45");  // the end is at 70: 70 - 1 - 12, and 12 above it
  layOut(kAcross, {-50}, {two});
  EXPECT_EQ(placed(), "0.1 154,63 | 0.2 202,63");  // the end is at 150: 4 behind it, and 8 behind the first
}

TEST_F(BarTextTest, QuantitiesWithoutRoomAtTheEndStandInTheBar) {
  const BarTextSizes two{{}, {Size{40, 12}, Size{24, 12}, Size{}}};
  layOut(kAcross, {0}, {two});                       // the end is at 250: 4 + 40 would reach 294
  EXPECT_EQ(placed(), "0.1i 174,63 | 0.2i 222,63");  // 250 - 4 - 24, and 8 and 40 before it
  layOut(kAcross, {0}, {two}, false);
  EXPECT_EQ(placed(), "");
  layOut(kAcross, {-20}, {two}, false);  // the end is at 210: room for the first alone
  EXPECT_EQ(placed(), "0.1 214,63");
  // Bars of 11 pixels hold letters of 12, which have air over and under them; bars of 9 do not.
  layOut(kAcross, std::vector<double>(8, 0.0), std::vector<BarTextSizes>(8, two));
  EXPECT_EQ(placed(), "");
  layOut(kAcross, std::vector<double>(7, 0.0), std::vector<BarTextSizes>(7, two));
  EXPECT_EQ(layout.placed().size(), 14U);
}

TEST_F(BarTextTest, QuantitiesKeepClearOfOtherBarsAndTexts) {
  const auto of = [](std::int32_t widthPx) { return BarTextSizes{{}, {Size{widthPx, 12}, {}, {}}}; };
  // Bars from 56 to 94, 106 to 144 and so on. The first text may begin with the plot, at 50.
  layOut(kUp, {-50, -20, -50, -90}, {of(56), of(8), of(62), of(8)});
  EXPECT_EQ(placed(), "1.1 121,27 | 0.1 50,57 | 2.1 144,57 | 3.1 221,97");  // to 106, and from 144
  layOut(kUp, {-50, -20, -50, -90}, {of(57), of(8), of(63), of(8)});
  EXPECT_EQ(placed(), "1.1 121,27 | 3.1 221,97");
  // Two texts of 47 over equal bars have 3 between them, which is too little; of 46 they have 4.
  layOut(kUp, {-50, -50, -90, -90}, {of(46), of(46), {}, {}});
  EXPECT_EQ(placed(), "0.1 52,57 | 1.1 102,57");
  layOut(kUp, {-50, -50, -90, -90}, {of(48), of(48), {}, {}}, false);
  EXPECT_EQ(placed(), "0.1 51,57");
  // To 110, over the next bar: that may end a pixel farther, where the text begins, and no more.
  layOut(kUp, {-50, -49, -90, -90}, {of(60), {}, {}, {}}, false);
  EXPECT_EQ(placed(), "0.1 50,57");
  layOut(kUp, {-50, -48, -90, -90}, {of(60), {}, {}, {}}, false);
  EXPECT_EQ(placed(), "");
  // A text that begins 12 below another is clear of it however wide they are.
  layOut(kUp, {-50, -62, -90, -90}, {of(60), of(60), {}, {}}, false);
  EXPECT_EQ(placed(), "0.1 50,57 | 1.1 95,69");
  layOut(kUp, {-50, -61, -90, -90}, {of(60), of(60), {}, {}}, false);
  EXPECT_EQ(placed(), "0.1 50,57");
}

TEST_F(BarTextTest, WhatWouldReachBeyondThePanelIsLeftOut) {
  panel = {0, 0, 0, 0};
  layOut(kUp, {-50}, {BarTextSizes{{8, 12}, {Size{8, 12}, {}, {}}}}, false);
  EXPECT_EQ(placed(), "");
  panel = {60, 30, 90, 60};  // smaller than its plot
  layOut(kUp, {-50, 0, 10}, std::vector<BarTextSizes>(3, {{8, 12}, {Size{8, 12}, {}, {}}}), false);
  EXPECT_EQ(withoutKey().size(), 3U);
}

}  // namespace
}  // namespace frontpanels

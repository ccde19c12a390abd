#include "fp-render/panel_picture.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <vector>

#include "framework/support/error_handler.h"
#include "platform/gdi_scope.h"
#include "tests/support/raised.h"

namespace frontpanels {
namespace {

constexpr Color kTraceColor = rgb(50, 156, 50);
constexpr Point kNowhere{-1, -1};

Frame sweepFrom(double startHz, double stepHz, std::vector<float> levelsDb) {
  Frame frame;
  frame.sweep.emplace();
  frame.sweep->startHz = startHz;
  frame.sweep->stepHz = stepHz;
  frame.sweep->levelsDb = std::move(levelsDb);
  return frame;
}

// 1001 bins from 100 MHz on, 100 kHz apart: -10 dB in one of them, the others at -90 dB.
Frame sweepWithPeak(std::size_t bin) {
  std::vector<float> levelsDb(1001, -90.0F);
  levelsDb[bin] = -10.0F;
  return sweepFrom(100e6, 1e5, std::move(levelsDb));
}

// One frame as if it were the recording, from 0 down to -100 where nothing else is said.
bool draw(PanelPicture& picture, const Frame& frame, const std::vector<StoredSetting>& settings = {},
          const WantedMarkers& markers = {}, const VerticalScale& scale = {0, 10}) {
  messageLog().clear();
  for (const StoredSetting& setting : settings) EXPECT_TRUE(picture.set(setting)) << setting.code;
  picture.survey(frame);
  picture.fitScale(scale.topDb, scale.dbPerDivision);
  picture.markers(markers);
  const bool drawn = picture.show(frame);
  EXPECT_EQ(messageLog().count(), 0U);
  return drawn;
}

// The first place, row by row, from which all of `ink` has the colour.
Point find(const PixelView& picture, Color color, const std::vector<Point>& ink, Size extentPx) {
  for (std::int32_t y = 0; y + extentPx.height <= picture.sizePx.height; ++y) {
    for (std::int32_t x = 0; x + extentPx.width <= picture.sizePx.width; ++x) {
      const auto lit = [&](Point at) { return picture.at(x + at.x, y + at.y) == color; };
      if (std::all_of(ink.begin(), ink.end(), lit)) return {x, y};
    }
  }
  return kNowhere;
}
Point highestOfTrace(const PixelView& picture) { return find(picture, kTraceColor, {{0, 0}}, {1, 1}); }

// Where the picture has the text in the font of its axes: 9 points are 12 pixels.
Point placeOf(const char* text, const PixelView& picture) {
  RasterGdi gdi;
  const DcHandle dc = gdi.createScreen({200, 40});
  const FontHandle font = gdi.createFont({"Arial", 12, 700});
  const SelectedFont selected(gdi, dc, font);
  const TextStyleScope style(gdi, dc, rgb(255, 255, 255), BackgroundMode::Transparent);
  gdi.textOut(dc, {0, 0}, text);
  const PixelView drawn = gdi.pixels(dc);
  std::vector<Point> ink;
  for (std::int32_t i = 0; i < 200 * 40; ++i) {
    if (drawn.at(i % 200, i / 200) == rgb(255, 255, 255)) ink.push_back({i % 200, i / 200});
  }
  EXPECT_FALSE(ink.empty()) << text;
  return find(picture, gdi.sysColor(SystemColor::ButtonText), ink, gdi.textExtent(dc, text));
}

bool hasInk(const PixelView& picture, const Rect& within, Color color) {
  for (std::int32_t y = within.top; y < within.bottom; ++y)
    for (std::int32_t x = within.left; x < within.right; ++x)
      if (picture.at(x, y) == color) return true;
  return false;
}

// A picture of 800 x 600 has its plot from 68 to 768 (margin 20, labels 48; labels 12, margin 20) and from 62
// to 564; a whole graph is 700 x 502 pixels.
constexpr std::int32_t kPlotLeft = 68;
constexpr std::int32_t kPlotWidth = 700;
constexpr std::int32_t kPlotTop = 62;
constexpr std::int32_t kPlotBottom = 564;

class SpectrumPictureTest : public ::testing::Test {
 protected:
  std::unique_ptr<PanelPicture> panel = makeSpectrumPicture({});
  [[nodiscard]] PixelView picture() { return panel->picture("a caption"); }
};

TEST_F(SpectrumPictureTest, DrawsEveryBinAtItsFrequencyFromEdgeToEdge) {
  const struct {
    std::size_t bin;
    std::int32_t x;
  } kCases[] = {{0, kPlotLeft}, {250, kPlotLeft + 175}, {500, kPlotLeft + 350}, {900, kPlotLeft + 630}};
  for (const auto& testCase : kCases) {
    const auto one = makeSpectrumPicture({});
    ASSERT_TRUE(draw(*one, sweepWithPeak(testCase.bin)));
    const Point highest = highestOfTrace(one->picture(""));
    EXPECT_NEAR(highest.x, testCase.x, 1) << testCase.bin;
    EXPECT_NEAR(highest.y, kPlotTop + 50, 1);  // -10 dB: one division of ten
  }
}

TEST_F(SpectrumPictureTest, LabelsTheFrequenciesAndTheScaleThatItIsGivenAndDrawsNothingInAGap) {
  // -30 down to -230 in 10 divisions of 20
  ASSERT_TRUE(draw(*panel, sweepFrom(100e6, 1e6, std::vector<float>(101, -50.0F)), {}, {}, {-30, 20}));
  const PixelView view = picture();
  const Point start = placeOf("100 MHz", view);
  const Point stop = placeOf("200 MHz", view);
  EXPECT_LT(kNowhere.x, start.x);
  EXPECT_LT(start.x, placeOf("10 MHz/div", view).x);
  EXPECT_LT(placeOf("10 MHz/div", view).x, stop.x);
  EXPECT_LT(0, placeOf("-30", view).y);
  EXPECT_LT(placeOf("-30", view).y, placeOf("-230", view).y);
  EXPECT_EQ(placeOf("150 MHz", view), kNowhere);
  EXPECT_FALSE(panel->show(sweepFrom(100e6, 1e6, std::vector<float>(101, kGap))));
  std::vector<float> half(101, -50.0F);
  std::fill(half.begin() + 50, half.end(), kGap);
  ASSERT_TRUE(panel->show(sweepFrom(100e6, 1e6, half)));
  const PixelView gap = picture();
  EXPECT_TRUE(hasInk(gap, {kPlotLeft, kPlotTop, kPlotLeft + 340, kPlotBottom}, kTraceColor));
  EXPECT_FALSE(hasInk(gap, {kPlotLeft + 350, kPlotTop, 768, kPlotBottom}, kTraceColor));
}

TEST_F(SpectrumPictureTest, ShowsTheRangeThatASettingAsksForAtOneCellABin) {
  // 100 to 140 MHz: 110 MHz is a quarter of the way.
  ASSERT_TRUE(draw(*panel, sweepWithPeak(100), {{13, 0, 120e6}, {14, 0, 40e6}}, {{{110e6, {}}}, false}));
  EXPECT_EQ(highestOfTrace(picture()).x, kPlotLeft + kPlotWidth / 4);
  EXPECT_EQ(panel->markerReadings(), std::vector<std::string>{"Marker 1: 110 MHz, -10 dBm"});
  EXPECT_FALSE(panel->show(sweepFrom(300e6, 1e5, std::vector<float>(100, -50.0F))));
  EXPECT_EQ(panel->missingLevels(), "every level from 100 MHz to 140 MHz is missing");
}

TEST_F(SpectrumPictureTest, ShowsReceiversBeyondTheLimitsOfThePanelsFields) {
  ASSERT_TRUE(draw(*panel, sweepFrom(7e9, 1e6, std::vector<float>(101, -50.0F))));
  EXPECT_NE(placeOf("7000 MHz", picture()), kNowhere);
}

TEST_F(SpectrumPictureTest, PutsMarkersWhereTheyWereWantedAndOneOnThePeakOfEachSweep) {
  const WantedMarkers wanted{{{150e6, 200.09e6}, {200.1e6, {}}}, true};
  ASSERT_TRUE(draw(*panel, sweepWithPeak(900), {}, wanted));
  EXPECT_EQ(panel->markersLeftOut(), std::vector<std::string>{"200.1 MHz"});
  // 512 cells lie 100 / 511 MHz apart: the nearest are those at 150.098, 200 and 190.02 MHz. The last one
  // reaches half of that over the edge.
  EXPECT_EQ(panel->markerReadings(),
            (std::vector<std::string>{"Marker 1: 150.1 MHz, -90 dBm", "Delta marker 1: +49.9 MHz, +0 dB",
                                      "Marker 3: 190 MHz, -10 dBm"}));
  const Color ink = rgb(0, 0, 0);
  const Rect above{kPlotLeft + 624, kPlotTop + 22, kPlotLeft + 636, kPlotTop + 38};
  EXPECT_TRUE(hasInk(picture(), above, ink)) << "its number";
  ASSERT_TRUE(panel->show(sweepWithPeak(250)));
  EXPECT_EQ(panel->markerReadings().back(), "Marker 3: 125 MHz, -10 dBm");
  EXPECT_FALSE(hasInk(picture(), above, ink));
}

TEST_F(SpectrumPictureTest, KeepsTheMarkersAndTheScaleThatASettingBringsWithIt) {
  const std::vector<StoredSetting> settings = {{716, 0, 7.0},  {717, 0, -3.0}, {740, 0, 4.0},
                                               {744, 0, 50.0}, {743, 0, 0.0},  {742, 0, true}};
  for (const StoredSetting& setting : settings) EXPECT_TRUE(panel->set(setting));
  const Frame sweep = sweepFrom(100e6, 1e6, std::vector<float>(101, -50.0F));
  panel->survey(sweep);
  panel->fitScale({}, {});
  panel->markers({{{120e6, {}}}, false});
  ASSERT_TRUE(panel->show(sweep));
  EXPECT_NE(placeOf("-73", picture()), kNowhere);  // -3 less ten divisions of 7
  EXPECT_EQ(panel->markerReadings(),
            (std::vector<std::string>{"Marker 4: 150 MHz, -50 dBm", "Marker 5: 120 MHz, -50 dBm"}));
  EXPECT_FALSE(panel->set({9999, 0, 1.0}));
}

TEST(PanelPicture, ShowsItsFieldsOrTheGraphAloneWhateverASettingSays) {
  const Frame sweep = sweepFrom(100e6, 1e6, std::vector<float>(101, -50.0F));
  for (const bool fields : {false, true}) {
    const auto panel = makeSpectrumPicture({{1024, 768}, 96, fields, true});
    ASSERT_TRUE(draw(*panel, sweep, {{705, 0, true}}));
    // A frame in the area of the display fields, and nothing of it where the graph has that room.
    const PixelView view = panel->picture("");
    EXPECT_EQ(hasInk(view, {1010, 200, 1024, 201}, RasterGdi().sysColor(SystemColor::ButtonShadow)), fields);
  }
}

TEST(PanelPicture, IsOfTheSizeAndTheScaleThatIsWantedWithOrWithoutACaption) {
  const Frame sweep = sweepFrom(100e6, 1e6, std::vector<float>(101, -50.0F));
  const struct {
    PictureLook look;
    std::int32_t plotTop;
  } kCases[] = {{{{800, 600}, 96, false, true}, kPlotTop},  // 24 + a fortieth of 576 + 24
                {{{800, 600}, 96, false, false}, 39},       // a fortieth of 600 + 24
                {{{400, 300}, 192, false, true}, 102}};     // 48 + a fortieth of 252 + 48
  for (const auto& testCase : kCases) {
    const auto panel = makeSpectrumPicture(testCase.look);
    ASSERT_TRUE(draw(*panel, sweep));
    const PixelView view = panel->picture("");
    EXPECT_EQ(view.sizePx, testCase.look.sizePx);
    std::int32_t y = 0;  // down the right edge of the plot's last division, to the top line of the grid
    const std::int32_t x = view.sizePx.width - view.sizePx.width / 10;
    while (y < 299 && view.at(x, y) == view.at(0, 0)) ++y;
    EXPECT_EQ(y, testCase.plotTop);
  }
}

// --- Pilots

Frame pilotsFrom(std::initializer_list<PilotRecord> top) {
  Frame frame;
  frame.pilots.emplace();
  frame.pilots->topN = PilotBars{-70, top};
  return frame;
}
constexpr ShownSets kTopAlone{false, false, true, false};

// Levels of the bars from left to right as their heights tell them, of an axis from 0 down to -30.
std::vector<int> barsOf(const PixelView& view) {
  const Color paper = view.at(kPlotLeft + 1, kPlotBottom - 3);
  std::vector<int> levels;
  for (std::int32_t x = kPlotLeft + 1; x < kPlotLeft + kPlotWidth; ++x) {
    if (view.at(x, kPlotBottom - 3) == paper || view.at(x - 1, kPlotBottom - 3) != paper) continue;
    std::int32_t y = kPlotBottom - 3;
    while (view.at(x + 2, y) == view.at(x + 2, kPlotBottom - 3)) --y;
    levels.push_back(static_cast<int>(std::lround((kPlotTop - y - 1.0) * 30 / (kPlotBottom - kPlotTop))));
  }
  return levels;
}

TEST(PilotPicture, ShowsBarsInTheOrderThatSettingsAskFor) {
  const Frame frame = pilotsFrom({{300, -9}, {12, -15}, {168, -6}});
  const struct {
    std::vector<StoredSetting> settings;
    std::vector<int> levels;
  } kCases[] = {{{}, {-6, -9, -15}},
                {{{730, 0, 1.0}}, {-15, -9, -6}},
                {{{729, 0, 2.0}, {730, 0, 1.0}}, {-15, -6, -9}}};  // by PN offset
  for (const auto& testCase : kCases) {
    const auto panel = makePilotPicture({}, kTopAlone);
    ASSERT_TRUE(draw(*panel, frame, testCase.settings, {}, {0, 3}));
    EXPECT_EQ(barsOf(panel->picture("")), testCase.levels);
  }
}

TEST(PilotPicture, FitsAScaleOnlyWhereThePanelsOwnDoesNotHoldTheLevels) {
  const struct {
    std::vector<StoredSetting> settings;
    float lowestDb;
    const char* top;
    const char* bottom;
  } kCases[] = {{{}, -30, "-3", "-27"},
                {{}, -31, "-5", "-55"},  // 5 dB a division hold what 2 cannot; -9 is the highest
                {{{728, 0, 1.0}}, -16, "-78", "-88"}};  // with Io, -70 dBm: -79 to -86
  for (const auto& testCase : kCases) {
    const auto panel = makePilotPicture({}, kTopAlone);
    const Frame frame = pilotsFrom({{300, -9}, {12, testCase.lowestDb}});
    for (const StoredSetting& setting : testCase.settings) EXPECT_TRUE(panel->set(setting));
    panel->survey(frame);
    panel->fitScale({}, {});
    ASSERT_TRUE(panel->show(frame));
    const PixelView view = panel->picture("");
    EXPECT_NE(placeOf(testCase.top, view), kNowhere) << testCase.top;
    EXPECT_NE(placeOf(testCase.bottom, view), kNowhere) << testCase.bottom;
  }
}

TEST(PilotPicture, ShowsWhatItsFrameHoldsAndNothingOfTheOneBefore) {
  const auto panel = makePilotPicture({}, {true, false, true, false});
  Frame both = pilotsFrom({{300, -9}});
  both.pilots->allPilots = PilotLevels{-70, std::vector<float>(512, -20.0F)};
  both.pilots->allPilots->ecIoDb[511] = -5;
  ASSERT_TRUE(draw(*panel, both, {}, {{{511, {}}}, true}, {0, 3}));
  EXPECT_EQ(panel->markerReadings(), (std::vector<std::string>{"Marker 1, All Pilots: 511 PN, -5 dB",
                                                               "Marker 2, All Pilots: 511 PN, -5 dB"}));
  EXPECT_NE(highestOfTrace(panel->picture("")), kNowhere);
  const Frame barsAlone = pilotsFrom({{300, -9}});
  ASSERT_TRUE(panel->show(barsAlone));
  EXPECT_EQ(highestOfTrace(panel->picture("")), kNowhere);
  EXPECT_NE(placeOf("511 PN", panel->picture("")), kNowhere) << "the axis stays";
  EXPECT_FALSE(panel->show(pilotsFrom({})));
  EXPECT_FALSE(panel->show(Frame()));
}

// 1024 chips from chip 10240 on are PN 160 to 176: 17 levels lie an offset apart.
TEST(PilotPicture, SpreadsTheZoomedPilotsOverTheWindowOfTheCode) {
  const auto panel = makePilotPicture({}, {false, true, false, false});
  Frame frame;
  frame.pilots.emplace();
  frame.pilots->zoomedPilots = PilotLevels{-70, std::vector<float>(17, -20.0F)};
  frame.pilots->zoomedPilots->ecIoDb[12] = -5;
  ASSERT_TRUE(draw(*panel, frame, {{803, 0, 10240.0}, {804, 0, 1024.0}}, {{{161, {}}}, true}, {0, 3}));
  EXPECT_EQ(panel->markerReadings(),
            (std::vector<std::string>{"Marker 1: 161 PN, -20 dB", "Marker 2: 172 PN, -5 dB"}));
  EXPECT_NE(placeOf("176 PN", panel->picture("")), kNowhere);
  // Highest is the left corner of the peak's marker, 4 pixels beside its point.
  EXPECT_EQ(highestOfTrace(panel->picture("")).x, kPlotLeft + kPlotWidth * 12 / 16 - 4);
}

TEST(PilotPicture, HasNoPlaceForMarkersAmongBars) {
  const auto panel = makePilotPicture({}, kTopAlone);
  EXPECT_EQ(testing::raised([&] {
              panel->markers({{}, true});
              return 0;
            }),
            "there is no trace for markers to stand on");
}

}  // namespace
}  // namespace frontpanels

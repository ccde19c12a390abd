#include "painters/plot_labels.h"

#include <string>
#include <vector>

#include "tests/support/recording_gdi.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels {
namespace {

// Panel (0, 0) to (300, 140), plot (50, 20) to (250, 100). A letter is 8 x 12 pixels.
class PlotLabelsTest : public testing::ReportingTest {
 protected:
  void SetUp() override { fonts = {gdi.createFont({"axis"}), gdi.createFont({"corner"})}; }
  // Font, text and place of each label, in order.
  std::vector<std::string> drawn() {
    gdi.clear();
    labels.draw(gdi, gdi.viewDc(), fonts, panel, plot);
    std::vector<std::string> lines;
    for (const testing::Call& text : gdi.texts()) {
      const Point at = text.points[0];
      lines.push_back(text.font.face + " " + text.text + " " + std::to_string(at.x) + "," +
                      std::to_string(at.y));
    }
    return lines;
  }

  testing::RecordingGdi gdi;
  LabelFonts fonts;
  Rect panel{0, 0, 300, 140};
  Rect plot{50, 20, 250, 100};
  PlotLabels labels;
};
using Lines = std::vector<std::string>;

TEST_F(PlotLabelsTest, EveryLabelHasItsPlace) {
  const std::vector<std::pair<LabelPlace, const char*>> given = {
      {LabelPlace::Left, "l"},    {LabelPlace::Right, "rr"},        {LabelPlace::XAxis, "xxx"},
      {LabelPlace::YUnit, "dBm"}, {LabelPlace::Top, "t"},           {LabelPlace::TopCenter, "tc"},
      {LabelPlace::Bottom, "b"},  {LabelPlace::BottomCenter, "bcd"}};
  for (const auto& [place, text] : given) labels.text(place, text);
  labels.yAxisTexts() = {"0", "-50", "-100"};
  EXPECT_EQ(drawn(), (Lines{"axis 0 38,14",      // 50 - 4 - 8; centred on line 20
                            "axis -50 22,54",    // line 60
                            "axis -100 14,94",   // line 100
                            "axis l 50,103",     // 3 under the plot
                            "axis rr 234,103",   // 250 - 16
                            "axis xxx 138,103",  // 50 + (200 - 24) / 2
                            "axis dBm 22,2",     // 50 - 4 - 24; 2 below the panel's top
                            "corner t 50,2", "corner tc 142,2",
                            "corner b 50,116",  // below the axis row: 103 + 12 + 1
                            "corner bcd 138,116"}));
  EXPECT_EQ(gdi.texts().front().backgroundMode, BackgroundMode::Transparent);
  EXPECT_EQ(gdi.texts().front().textColor, rgb(18, 18, 18));  // the system's button text
}

TEST_F(PlotLabelsTest, LeavesOutWhatWouldOverlapAnEarlierLabelOrLeaveThePanel) {
  labels.yAxisTexts() = {"123456", "-50"};              // 48 wide: 50 - 4 - 48 is left of the panel
  labels.text(LabelPlace::Left, "0123456789");          // 50..130
  labels.text(LabelPlace::Right, "0123456789");         // 170..250
  labels.text(LabelPlace::XAxis, "012345");             // 126..174 overlaps both
  labels.text(LabelPlace::Top, "0123456789012");        // 50..154
  labels.text(LabelPlace::TopCenter, "01");             // 142..158 overlaps by 12
  labels.text(LabelPlace::BottomCenter, "second row");  // 116 + 12 is within 140
  panel.bottom = 127;                                   // and one pixel too low now
  EXPECT_EQ(drawn(), (Lines{"axis -50 22,94", "axis 0123456789 50,103", "axis 0123456789 170,103",
                            "corner 0123456789012 50,2"}));
  labels.text(LabelPlace::XAxis, "01234");  // 130..170 touches both
  EXPECT_EQ(drawn().size(), 5U);
}

TEST_F(PlotLabelsTest, ValueLabelsAreThinnedWhereLinesAreCloserThanText) {
  // 80 pixels of plot, labels 12 high.
  EXPECT_EQ(linesPerLabel(80, 6, 12), 1);   // 13.3 apart
  EXPECT_EQ(linesPerLabel(72, 6, 12), 1);   // 12 apart: they touch
  EXPECT_EQ(linesPerLabel(71, 6, 12), 2);   // 11.8
  EXPECT_EQ(linesPerLabel(80, 20, 12), 3);  // 4 apart
  EXPECT_EQ(linesPerLabel(0, 10, 12), 1);
  labels.yAxisTexts() = {"0", "1", "2", "3", "4", "5", "6", "7", "8"};  // lines 10 apart
  EXPECT_EQ(drawn(), (Lines{"axis 0 38,14", "axis 2 38,34", "axis 4 38,54", "axis 6 38,74", "axis 8 38,94"}));
}

TEST_F(PlotLabelsTest, TheValueAxisMayLieUnderThePlot) {
  labels.valueAxisUnderPlot(true);
  labels.yAxisTexts() = {"0", "-50", "-100"};
  labels.text(LabelPlace::YUnit, "dBm");
  labels.text(LabelPlace::XAxis, "level");
  panel.right = 265;
  EXPECT_EQ(drawn(), (Lines{"axis 0 dBm 225,103",     // 40 wide on line 250, moved into the panel
                            "axis -50 138,103",       // line 150
                            "axis -100 34,103",       // line 50
                            "axis level 130,116"}));  // a row below
  labels.yAxisTexts() = {"0", "1", "2", "3",   "4",   "5",  "6",
                         "7", "8", "9", "-10", "-11", "-12"};  // 16.7 apart
  EXPECT_EQ(drawn().size(), 1U + 7);                           // 24 wide and 6 between them: every second
  labels.valueAxisUnderPlot(false);
  labels.keepRowUnderPlot(20);
  EXPECT_EQ(drawn().back(), "axis dBm 22,2");
  EXPECT_EQ(labels.roomFor(LabelPlace::XAxis, {8, 12}), std::nullopt);  // the label is at 103 + 20 + 1
  EXPECT_TRUE(labels.isFree({130, 103, 170, 123}));
  EXPECT_FALSE(labels.isFree({130, 103, 170, 125}));
}

TEST_F(PlotLabelsTest, TextsAreMeasuredAgainOnlyAfterAChangeOrAFailure) {
  labels.text(LabelPlace::Left, "98 MHz");
  gdi.failAlways("textExtent");
  EXPECT_EQ(drawn(), Lines{});
  gdi.failNothing();
  EXPECT_EQ(drawn(), Lines{"axis 98 MHz 50,103"});
  labels.text(LabelPlace::Left, "98 MHz");
  EXPECT_EQ(drawn(), Lines{"axis 98 MHz 50,103"});
  EXPECT_EQ(gdi.succeeded("textExtent").size(), 0U);

  plot.left = 60;
  labels.text(LabelPlace::Left, "99 MHz!");
  labels.text(LabelPlace::Top, "012345678");  // 60..132
  EXPECT_EQ(drawn()[0], "axis 99 MHz! 60,103");
  EXPECT_EQ(labels.roomFor(LabelPlace::Readout, {118, 12}), (Rect{132, 2, 250, 14}));
  EXPECT_EQ(labels.roomFor(LabelPlace::Readout, {119, 12}), std::nullopt);
}

}  // namespace
}  // namespace frontpanels

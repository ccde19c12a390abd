// The spectrum panel's fields as a user and a host move them.
#include <cmath>

#include "framework/support/enumerated_tables.h"
#include "framework/support/host_codes.h"
#include "spectrum/spectrum_controls.h"
#include "tests/spectrum/spectrum_fixture.h"
#include "tests/support/listed_records.h"

namespace frontpanels::testing {
namespace {

class SpectrumFieldsTest : public SpectrumViewTest {
 protected:
  SpectrumFieldsTest() {
    panel->vfpSet(0, 315, 0, 5);
    panel->base().virtualFrontPanelId = 7;
    panel->base().rightPanelVisible(true);
    panel->base().bottomPanelVisible(true);
    owner.take();
  }

  [[nodiscard]] ControlSet& controls() { return *panel->controls(); }
  [[nodiscard]] std::string text(const char* stem) {
    return controls().textBox(std::string(stem) + "TextBox").Text();
  }
  void type(const std::string& stem, const char* typed) {
    TextBox& box = controls().textBox(stem + "TextBox");
    box.SetFocus();
    for (const char* c = typed; *c != 0; ++c) box.userKey(*c);
    box.userKey(13);
  }
  void click(const char* name) { controls().control(name).userClick(); }
  void set(std::int16_t code, const Variant& value) {
    EXPECT_EQ(panel->vfpSet(0, code, 0, value), 0) << code;
  }
  // The requests since it was asked last, without the panel's ids.
  [[nodiscard]] std::string requests() {
    std::string all;
    for (const std::string& call : owner.take())
      all += (all.empty() ? "" : ", ") + (call.rfind("frontPanel", 0) == 0 ? call.substr(10) : call);
    return all;
  }
  [[nodiscard]] bool enabled(const char* name) { return controls().control(name).reallyEnabled(); }
  [[nodiscard]] bool chosen(const char* name) { return controls().optionButton(name).Value(); }
  // Delete, Delta, To Max, To Center
  [[nodiscard]] std::string markerButtons() {
    std::string all;
    for (const char* const name :
         {"MarkerDeleteButton", "MarkerDeltaButton", "MarkerToMaxButton", "MarkerToCenterButton"})
      all += enabled(name) ? '1' : '0';
    return all;
  }
};

TEST_F(SpectrumFieldsTest, WhatTheUserEntersReachesTheHostOnce) {
  struct Row {
    const char* stem;
    const char* typed;
    const char* requests;
    const char* shown;
  };
  // Each row goes on from the one before; ids 5 and 7, then code, index 0 and value.
  const Row rows[] = {
      {"CenterFrequency", "881.52M", "Set 5 7 13 0 881520000", "881.52 MHz"},
      {"CenterFrequency", "881.52M", "", "881.52 MHz"},
      {"FrequencySpan", "1M", "Set 5 7 14 0 1000000", "1 MHz"},
      {"CenterFrequency", "5999.9M", "Set 5 7 13 0 5999500000", "5999.5 MHz"},
      // The centre gives way to the wider span and the host hears of both.
      {"FrequencySpan", "2M", "Set 5 7 13 0 5999000000, Set 5 7 14 0 2000000", "2 MHz"},
      {"StartFrequency", "5996M", "Set 5 7 13 0 5998000000, Set 5 7 14 0 4000000", "5996 MHz"},
      {"StopFrequency", "5998M", "Set 5 7 13 0 5997000000, Set 5 7 14 0 2000000", "5998 MHz"},
      {"FrequencyRbw", "30k", "Set 5 7 16 0 30000", "30 kHz"},
      {"DisplayLength", "101", "Set 5 7 94 0 101", "101"},
      {"SweepRate", "2", "Set 5 7 43 0 2", "2 s"},
      {"VerticalScale", "5", "", "5"},
      {"VerticalOffset", "-10", "", "-10 dBm"},
  };
  for (const Row& row : rows) {
    type(row.stem, row.typed);
    EXPECT_EQ(requests(), row.requests) << row.stem << ' ' << row.typed;
    EXPECT_EQ(text(row.stem), row.shown) << row.stem << ' ' << row.typed;
  }
  EXPECT_EQ(panel->base().measurementPeriod, 2);
  controls().spinButton("CenterFrequencySpinButton").press(true);  // a tenth of a decade of 2 MHz
  EXPECT_EQ(requests(), "Set 5 7 13 0 5997100000");
  EXPECT_EQ(said(), "");
}

TEST_F(SpectrumFieldsTest, AnEchoInsideTheRequestIsShownAndNotSentBack) {
  owner.settingChanged = [this](std::int16_t code, const Variant& value) {
    // A receiver that tunes in steps of 1 MHz.
    panel->vfpSet(0, code, 0, std::floor(value.toDouble() / 1e6) * 1e6);
  };
  type("CenterFrequency", "881.52M");
  EXPECT_EQ(requests(), "Set 5 7 13 0 881520000");
  EXPECT_EQ(text("CenterFrequency") + ", " + text("StopFrequency"), "881 MHz, 886 MHz");
  type("StopFrequency", "887M");  // start 876: centre 881.5, span 11
  EXPECT_EQ(requests(), "Set 5 7 13 0 881500000, Set 5 7 14 0 11000000");
  EXPECT_EQ(text("CenterFrequency") + ", " + text("FrequencySpan"), "881 MHz, 11 MHz");
}

TEST_F(SpectrumFieldsTest, TheSpanThatTheUserEnteredIsSentWhateverTheHostAnswersToTheCentre) {
  set(14, 1e6);
  set(13, 5999.5e6);
  owner.settingChanged = [this](std::int16_t code, const Variant&) {
    if (code == 13) set(14, 1e6);
  };
  type("FrequencySpan", "2M");
  EXPECT_EQ(requests(), "Set 5 7 13 0 5999000000, Set 5 7 14 0 2000000");
}

TEST_F(SpectrumFieldsTest, WhatTheHostSendsIsShownAndNotSentBack) {
  struct Row {
    std::int16_t code;
    Variant value;
    const char* stem;
    const char* shown;
  };
  const Row entries[] = {
      {13, 881.52e6, "CenterFrequency", "881.52 MHz"},
      {14, "2e6", "FrequencySpan", "2 MHz"},
      {16, 3000, "FrequencyRbw", "3 kHz"},
      {43, 0.2, "SweepRate", "200 ms"},
      {94, 101, "DisplayLength", "101"},
      {502, 50, "AverageCount", "50"},
      {502, 5000, "AverageCount", "1000"},
      {16, "none", "FrequencyRbw", "3 kHz"},
      {803, 5, "SweepRate", "200 ms"},  // kept for its turn
      {804, 0, "SweepRate", "5 m"},
      {43, 3, "SweepRate", "5 m"},
      {804, 2, "SweepRate", "3 s"},
  };
  for (const Row& row : entries) {
    set(row.code, row.value);
    EXPECT_EQ(text(row.stem), row.shown) << row.code;
  }
  const Row options[] = {
      {17, 1, "NarrowbandOption", ""},        {17, 2, "WidebandOption", ""},
      {750, 0, "ChannelOption", ""},          {750, -1, "FrequencyOption", ""},
      {804, 0, "IntervalDistanceOption", ""}, {804, 7, "IntervalTimeOption", ""},
      {3900, 0, "LinPowerOption", ""},        {3900, 1, "LogPwrOption", ""},
  };
  for (const Row& row : options) {
    if (row.code == 750) reporting().silenceAssert = true;  // without channelizations there are no channels
    set(row.code, row.value);
    EXPECT_TRUE(chosen(row.stem)) << row.code << ' ' << row.stem;
  }
  EXPECT_EQ(requests(), "");
}

TEST_F(SpectrumFieldsTest, AveragingOffTakesTheCountAway) {
  EXPECT_FALSE(enabled("AverageCountTextBox"));
  set(500, 2);
  EXPECT_TRUE(enabled("AverageCountTextBox"));
  type("AverageCount", "20");
  set(500, 32);
  EXPECT_FALSE(enabled("AverageCountTextBox"));
  EXPECT_EQ(requests(), "Set 5 7 502 0 20");
  controls().list("AverageTypeCombo").userChoice(1);
  const std::int32_t type = controls().list("AverageTypeCombo").item(1).data;
  EXPECT_EQ(requests(), "Set 5 7 500 0 " + std::to_string(type));
  EXPECT_TRUE(enabled("AverageCountTextBox"));
  controls().list("AverageTypeCombo").userChoice(1);
  EXPECT_EQ(requests(), "");
}

TEST_F(SpectrumFieldsTest, ButtonsAndOptionsAskTheHostAndItsRefusalIsReported) {
  struct Row {
    const char* control;
    const char* request;
    const char* routine;
  };
  const Row rows[] = {
      {"SingleSweepButton", "Op 5 7 2", "SingleSweepButton_Click()"},
      {"ContinuousSweepButton", "Op 5 7 3", "ContinuousSweepButton_Click()"},
      {"StopSweepButton", "Op 5 7 4", "StopSweepButton_Click()"},
      {"UplinkOption", "Set 5 7 13 0 1000000000", "UplinkOption_Click()"},
      {"NarrowbandOption", "Set 5 7 17 0 1", "NarrowbandOption_Click()"},
      {"WidebandOption", "Set 5 7 17 0 0", "WidebandOption_Click()"},
      {"IntervalDistanceOption", "Set 5 7 804 0 0", "IntervalDistanceOption_Click()"},
      {"IntervalTimeOption", "Set 5 7 804 0 1", "IntervalTimeOption_Click()"},
      {"LinPowerOption", "Set 5 7 3900 0 0", "LinPowerOption_Click()"},
      {"LogPwrOption", "Set 5 7 3900 0 1", "LogPwrOption_Click()"},
  };
  owner.status = -3;
  for (const Row& row : rows) {
    click(row.control);
    EXPECT_EQ(requests(), row.request) << row.control;
    EXPECT_EQ(said(), std::string("SpectrumView::") + row.routine + " status = -3") << row.control;
  }
  struct EntryRow {
    const char* stem;
    const char* typed;
    const char* routine;
  };
  const EntryRow entries[] = {
      {"CenterFrequency", "2000M", "newCenterFrequency()"},   {"FrequencySpan", "1M", "newFrequencySpan()"},
      {"StartFrequency", "1999M", "newStartStopFrequency()"}, {"FrequencyRbw", "1k", "newFrequencyRbw()"},
      {"DisplayLength", "9", "newDisplayLength()"},           {"SweepRate", "9", "newSweepRate()"},
  };
  for (const EntryRow& row : entries) {
    type(row.stem, row.typed);
    EXPECT_EQ(said(), std::string("SpectrumView::") + row.routine + " status = -3") << row.stem;
  }
  EXPECT_EQ(requests(),  // the refused centre of the start was not followed by its span
            "Set 5 7 13 0 2000000000, Set 5 7 14 0 1000000, Set 5 7 13 0 1999750000, Set 5 7 16 0 1000, "
            "Set 5 7 94 0 9, Set 5 7 43 0 9");
}

TEST_F(SpectrumFieldsTest, BandOptionsShowTheBandInForceAndItsLimitsHoldASweepThatIsTooWide) {
  click("UplinkOption");  // there are no bands
  EXPECT_TRUE(chosen("DownlinkOption"));
  EXPECT_EQ(requests(), "Set 5 7 13 0 1000000000");
  panel->Limits(13, ListedRecords({{{"[Order]", 0}, {"[Minimum]", 869e6}, {"[Maximum]", 894e6}},
                                   {{"[Order]", 1}, {"[Minimum]", 824e6}, {"[Maximum]", 849e6}}}));
  set(14, 2e6);
  set(13, 880e6);
  owner.status = 4;
  click("UplinkOption");  // 11 MHz above the lower limit
  EXPECT_EQ(requests(), "Set 5 7 13 0 835000000");
  EXPECT_EQ(said(), "SpectrumView::UplinkOption_Click() status = 4");
  owner.status = 0;
  click("DownlinkOption");
  EXPECT_EQ(requests(), "Set 5 7 13 0 880000000");
  type("FrequencySpan", "100M");
  EXPECT_EQ(requests(), "Set 5 7 13 0 894000000, Set 5 7 14 0 100000000");
  EXPECT_EQ(text("StartFrequency") + ", " + text("StopFrequency"), "869 MHz, 894 MHz");
  EXPECT_TRUE(chosen("DownlinkOption"));
}

TEST_F(SpectrumFieldsTest, LimitsThatAreNoneAreRefusedAndTheOthersStay) {
  const auto limits = [this](std::int16_t code, const Variant& minimum, const Variant& maximum) {
    return panel->Limits(code,
                         ListedRecords({{{"[Order]", 0}, {"[Minimum]", minimum}, {"[Maximum]", maximum}}}));
  };
  for (const std::int16_t code : {std::int16_t{13}, std::int16_t{16}, std::int16_t{43}})
    EXPECT_EQ(limits(code, 2, 5), 0) << code;
  for (const std::int16_t code : {std::int16_t{13}, std::int16_t{16}, std::int16_t{43}})
    EXPECT_EQ(limits(code, "x", 5), -8) << code;
  EXPECT_EQ(limits(99, 2, 5), -8);
  type("SweepRate", "100");
  EXPECT_EQ(text("SweepRate"), "5 s");
}

TEST_F(SpectrumFieldsTest, WhatIsEnteredWhileARequestRunsGoesBack) {
  owner.settingChanged = [this](std::int16_t, const Variant&) {
    owner.settingChanged = nullptr;  // a host that lets the user go on inside its event
    type("FrequencySpan", "2M");
    type("StopFrequency", "1003M");
    type("CenterFrequency", "500M");
  };
  type("CenterFrequency", "900M");
  EXPECT_EQ(requests(), "Set 5 7 13 0 900000000");
  EXPECT_EQ(text("CenterFrequency") + ", " + text("FrequencySpan") + ", " + text("StopFrequency"),
            "900 MHz, 10 MHz, 905 MHz");
}

TEST_F(SpectrumFieldsTest, TheVerticalFieldsAndTheTraceFollowEachOther) {
  publish({-30, -50, -40});
  clsMultiTracePainter& painter = dynamic_cast<clsMultiTracePainter&>(*panel->base().traceManager().find(25));
  gdi.clear();
  type("VerticalScale", "5");
  type("VerticalOffset", "-10");
  EXPECT_EQ(painter.getDbPerDivision(), 5);
  EXPECT_EQ(painter.gridScaleTop(), -10);
  EXPECT_EQ(gdi.blits().size(), 2U);
  set(717, 0);
  set(716, 2);
  EXPECT_EQ(text("VerticalScale") + ", " + text("VerticalOffset"), "2, 0 dBm");
  click("AutoScaleBox");
  EXPECT_TRUE(painter.getAutoScale());
  EXPECT_EQ(text("VerticalOffset"), numberToText(*painter.gridScaleTop()) + " dBm");
  publish({-130, -150, -140});
  EXPECT_EQ(text("VerticalScale"), numberToText(painter.verticalResolution()));
  EXPECT_LT(*painter.gridScaleTop(), -100);
  EXPECT_EQ(text("VerticalOffset"), numberToText(*painter.gridScaleTop()) + " dBm");
  set(722, false);
  EXPECT_EQ(controls().checkBox("AutoScaleBox").Value(), 0);
  panel->Limits(716, ListedRecords({{{"[Order]", 0}, {"[Minimum]", -5}, {"[Maximum]", 5}}}));
  type("VerticalScale", "0");
  EXPECT_EQ(said(), "SpectrumView::newVerticalScale() ... illegal value\r");
}

TEST_F(SpectrumFieldsTest, MarkerButtonsWorkOnTheActiveMarkerAndAreEnabledByIt) {
  set(13, 100e6);
  EXPECT_EQ(markerButtons(), "0000");
  click("MarkerAddButton");  // no trace
  publish({-60, -30, -60, -60, -60});
  EXPECT_EQ(markerButtons(), "0000");
  click("MarkerAddButton");
  EXPECT_EQ(markerButtons(), "1111");
  const TraceObject& trace = *panel->base().traceManager().activeTrace();
  click("MarkerToMaxButton");
  EXPECT_EQ(trace.activeMarker()->point, 1);
  click("MarkerDeltaButton");
  EXPECT_EQ(markerButtons(), "1011");
  panel->addDeltaMarker();  // it has one
  EXPECT_EQ(controls().control("MarkerFrame").ForeColor(), rgb(50, 156, 50));
  owner.take();
  click("MarkerToCenterButton");  // the second of five points from 95 to 105 MHz
  EXPECT_EQ(requests(), "Set 5 7 13 0 97500000");
  set(322, 1);
  EXPECT_EQ(markerButtons(), "1010");
  click("MarkerAddButton");
  EXPECT_EQ(markerButtons(), "1110");
  owner.take();
  panel->updateMarkerButtons();
  panel->markerToCenter();
  EXPECT_EQ(markerButtons() + requests(), "1110");
  set(322, 0);
  EXPECT_EQ(markerButtons(), "1111");
  click("MarkerDeleteButton");
  click("MarkerDeleteButton");  // the first one with its delta marker
  EXPECT_EQ(markerButtons(), "0000");
  click("MarkerAddButton");
  panel->vfpOp(0, 11, 25);
  EXPECT_EQ(markerButtons(), "0000");
  EXPECT_EQ(said(), "");
}

TEST_F(SpectrumFieldsTest, AMarkerKeepsItsPointAndWithOtherPointsItsFrequency) {
  publish({-60, -60, -60, -30, -60});
  panel->addMarker();
  panel->markerToMax();
  panel->Paint();
  const TraceObject& trace = *panel->base().traceManager().activeTrace();
  publish({-10, -60, -60, -40, -60});
  EXPECT_EQ(trace.activeMarker()->point, 3);
  EXPECT_EQ(trace.activeMarker()->valueY, -40);
  publish(std::vector<float>(9, -50.0F));  // half as far apart
  EXPECT_EQ(trace.activeMarker()->point, 6);
  publish({-50, -50});
  EXPECT_EQ(trace.activeMarker()->point, 1);
}

TEST_F(SpectrumFieldsTest, ChannelsStandInFieldsAxisAndReadOut) {
  const ListedRecords order({{{"[Order]", 0}, {"[Minimum]", 0}, {"[Maximum]", 0}}});
  panel->channels().setChannelLookup("0", &order);
  panel->channels().setChannelZero("870000000", &order);
  panel->channels().setChannelSpacing("30000", &order);
  panel->Limits(13, ListedRecords({{{"[Order]", 0}, {"[Minimum]", 869e6}, {"[Maximum]", 894e6}}}));
  set(333, 0);
  set(14, 3e6);
  set(13, 881.52e6);
  publish({-60, -60, -30, -60, -60});
  panel->addMarker();
  panel->markerToMax();
  gdi.clear();
  click("ChannelOption");  // repaints by itself
  EXPECT_EQ(requests(), "Set 5 7 750 0 0");
  EXPECT_EQ(text("CenterFrequency"), "384");
  for (const char* const label : {"334", "434", "10/div"}) EXPECT_TRUE(shows(label)) << label;
  EXPECT_TRUE(shows("1  384  -30 dBm"));
  type("CenterFrequency", "400");
  EXPECT_EQ(requests(), "Set 5 7 13 0 882000000");
  gdi.clear();
  click("FrequencyOption");
  EXPECT_EQ(text("CenterFrequency"), "882 MHz");
  EXPECT_TRUE(shows("880.5 MHz"));
  EXPECT_EQ(said(), "");
  click("ChannelOption");
  EXPECT_EQ(text("CenterFrequency"), "400");
  panel->channels().reinitialize();
  panel->ChannelizationCombo_Change();
  EXPECT_EQ(text("CenterFrequency"), "882 MHz");
  EXPECT_EQ(said(), "clsChannelInfo::selectChannelization() ... could not find channelization lookup\r");
  set(13, 881e6);
  set(14, 1e6);
  EXPECT_EQ(said(), "");
}

TEST_F(SpectrumFieldsTest, TheContextMenuShowsWhereThePanelStandsAndActs) {
  const auto menu = [this] {
    std::string all;
    for (const PanelMenuItem& item : panel->contextMenu())
      all += item.caption + (item.checked ? "+" : "") + (item.enabled ? "" : "-") + "|";
    return all;
  };
  EXPECT_EQ(menu(),
            "Display Controls+|Measurement Controls+|Axis: Start / Stop-|Axis: Center / Span-|"
            "Properties|Close|");
  publish({-30, -50, -40});
  for (const auto item : std::initializer_list<std::int16_t>{1, 2, 4}) panel->contextMenuClick(item);
  EXPECT_EQ(menu(),
            "Display Controls|Measurement Controls|Axis: Start / Stop|Axis: Center / Span+|"
            "Properties|Close|");
  EXPECT_TRUE(shows("1000 MHz"));
  owner.take();
  panel->contextMenuClick(5);
  EXPECT_EQ(said(), "I don't know how to invoke the property page yet!\r");
  panel->contextMenuClick(6);
  EXPECT_EQ(requests(), "Op 5 7 1");
  set(322, 1);
  panel->contextMenuClick(6);
  panel->contextMenuClick(99);
  EXPECT_EQ(requests(), "");
  EXPECT_EQ(menu(),
            "Display Controls|Measurement Controls-|Axis: Start / Stop|Axis: Center / Span+|"
            "Properties|Close-|");
}

TEST_F(SpectrumFieldsTest, LinksShowOnTheirFieldsAndNameTheOneInUse) {
  clsBaseVFP& base = panel->base();
  const auto look = [this](const char* name) {
    const Control& control = controls().control(name);
    return std::string(control.Bold() ? "b" : "") + (control.Italic() ? "i" : "") +
           (control.Enabled() ? "e" : "");
  };
  base.frontPanelLink({3, 13, true, false, false});
  base.frontPanelLink({2, 4, false, true, true});
  base.frontPanelLink({3, 17, true, true, false});
  EXPECT_EQ(look("CenterFrequencyTextBox") + look("StopSweepButton") + look("NarrowbandOption"),
            "bieb"
            "i");
  base.frontPanelLink({3, 13, false, false, true});
  EXPECT_EQ(look("CenterFrequencyTextBox"), "e");
  EXPECT_EQ(base.initializeLinkValue(3, 94), Variant(513.0));
  EXPECT_EQ(base.initializeLinkValue(3, 17), Variant(0.0));
  set(43, 0.5);
  set(804, 0);  // the entry holds a distance now
  EXPECT_EQ(base.initializeLinkValue(3, 43), Variant(0.5));
  EXPECT_EQ(base.activeControlLink(), "");
  controls().control("StartFrequencyTextBox").SetFocus();
  EXPECT_EQ(base.activeControlLink(), "STARTFREQUENCYTEXTBOX");
  controls().control("StopFrequencyTextBox").SetFocus();
  EXPECT_EQ(base.activeControlLink(), "");
  EXPECT_EQ(said(), "");
}

TEST_F(SpectrumFieldsTest, WhatIsHandedOverRestoresAnotherPanel) {
  publish({-30, -50, -40});
  const std::pair<std::int16_t, double> sent[] = {{13, 98e6}, {14, 2e6}, {16, 3e3}, {17, 1},
                                                  {43, 4},    {94, 99},  {500, 2},  {502, 33},
                                                  {803, 12},  {804, 0},  {3900, 0}, {716, 5}};
  for (const auto& [code, value] : sent) set(code, value);
  const PanelSettings kept = panel->base().settings();
  SpectrumView other(PanelEnvironment{gdi, windowing, view, hub, {15, 15}, ""}, owner, owner);
  other.vfpOp(0, 10, 10);
  EXPECT_NE(other.base().settings(), kept);
  for (const PanelSetting& setting : kept) other.vfpSet(0, setting.parameterType, 0, setting.value);
  EXPECT_EQ(other.base().settings(), kept);
  EXPECT_EQ(other.controls()->textBox("SweepRateTextBox").Text(), "12 m");
}

TEST_F(SpectrumFieldsTest, EveryControlMayBeUsedInEveryState) {
  const auto useAll = [this] {
    for (const auto& control : controls().controls()) {
      control->userClick();
      if (auto* const spin = dynamic_cast<SpinButton*>(control.get())) spin->press(true), spin->press(false);
      if (dynamic_cast<TextBox*>(control.get()) != nullptr) {
        for (const char key : {'-', '9', 'e', '9', '\r'}) control->userKey(key);
      }
      panel->base().rightPanelVisible(true);
      panel->base().bottomPanelVisible(!panel->base().recordMode && !panel->base().playback);
    }
  };
  useAll();
  publish({-30, -50, -40});
  useAll();
  set(322, 1);
  owner.take();
  useAll();
  for (const std::string& call : owner.take())  // the receiver stays where it is
    EXPECT_EQ(call.find("frontPanelSet 5 7 1"), std::string::npos) << call;
  set(322, 0);
  panel->vfpOp(0, 15, 0);
  useAll();
  click("MeasurementFrameInvisibleButton");
  EXPECT_FALSE(panel->base().bottomPanelVisible());
  clearMessages();
  panel->vfpOp(0, 1, {});
  owner.take();
  useAll();
  EXPECT_EQ(requests(), "");
  EXPECT_EQ(panel->Limits(13, ListedRecords({})), 0);
}

TEST_F(SpectrumFieldsTest, CollapseButtonsHideAndShowTheirAreasAndLieAtTheirEdges) {
  const auto marks = [this] {
    const ControlPlace& right = controls().control("MarkerFrameInvisibleButton").place();
    const ControlPlace& bottom = controls().control("MeasurementFrameInvisibleButton").place();
    return std::vector<float>{right.leftTwips, right.heightTwips, bottom.topTwips, bottom.widthTwips};
  };
  // 12000 x 9000 twips; the areas take 2730 and 1530, a button 90.
  EXPECT_EQ(marks(), (std::vector<float>{9180, 7380, 7380, 9270}));
  click("MarkerFrameInvisibleButton");
  EXPECT_EQ(marks(), (std::vector<float>{11910, 7380, 7380, 12000}));
  click("MeasurementFrameInvisibleButton");
  EXPECT_EQ(marks(), (std::vector<float>{11910, 8910, 8910, 12000}));
  click("MarkerFrameInvisibleButton");
  EXPECT_TRUE(panel->base().rightPanelVisible() && !panel->base().bottomPanelVisible());
}

TEST_F(SpectrumFieldsTest, HostTablesThatDoNotFitTheOptionsAreReported) {
  const EnumeratedTables before = enumeratedTables();
  const EnumeratedValue one[] = {{0, "Only"}};
  enumeratedTables().replace(FREQ_FILTER, one);
  enumeratedTables().add(PARM_AVERAGE_AS_LOG_POWER, {2, "Third"});
  ControlSet set(spectrumControls());
  const SpectrumFields fields(set);
  enumeratedTables() = before;
  const std::string message =
      "SpectrumView::form_Load() ... recieved unexpected number of records on parameter ";
  EXPECT_EQ(said(), message + "FREQ_FILTER\r\n" + message + "PARM_AVERAGE_AS_LOG_POWER\r");
}

}  // namespace
}  // namespace frontpanels::testing

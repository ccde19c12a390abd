#include "tests/pilot/pilot_fixture.h"

namespace frontpanels::testing {
namespace {

TEST_F(PilotTest, OperationsAddAndRemoveTheDisplaysOfTheFourSets) {
  struct Row {
    std::int32_t resultType;
    std::int16_t traceId;
    bool bars;
  };
  constexpr Row kRows[] = {{14, 11, false}, {18, 17, false}, {201, 203, true}, {200, 204, true}};
  for (const Row& row : kRows) {
    EXPECT_EQ(panel->vfpOp(0, 10, row.resultType), 0);
    EXPECT_EQ(panel->vfpOp(0, 10, row.resultType), 0);  // once more changes nothing
    EXPECT_EQ(bars(row.traceId) != nullptr, row.bars) << row.resultType;
    EXPECT_EQ(trace(row.traceId) != nullptr, !row.bars) << row.resultType;
  }
  EXPECT_EQ(trace(11)->span(), 511);
  EXPECT_EQ(trace(17)->traceType(), 2);
  EXPECT_EQ(trace(17)->xAxisStyle(), 1);
  EXPECT_EQ(bars(203)->elementsPerValue(), 5);
  EXPECT_EQ(bars(203)->barSortOrder(), 2);
  EXPECT_EQ(bars(203)->otherIs(), 0);
  EXPECT_EQ(bars(203)->valueIs(), 1);
  EXPECT_EQ(bars(203)->drawingArea(), panel.get());
  EXPECT_TRUE(control("userPNListImportButton").reallyEnabled());
  for (const Row& row : kRows) {
    EXPECT_EQ(panel->vfpOp(0, 11, row.resultType), 0);
    EXPECT_EQ(panel->base().traceManager().find(row.traceId), nullptr);
  }
  EXPECT_FALSE(control("userPNListFrame").Enabled());
  EXPECT_EQ(messages(), Messages{});
  EXPECT_EQ(panel->vfpOp(0, 11, 14), 0);
  EXPECT_EQ(said(), "clsTraceManager::removeTraceObject() received unknown result type\r");
  for (const std::int16_t operation : {std::int16_t{10}, std::int16_t{11}})
    for (const Variant& unusable : {Variant("all"), Variant(25), Variant()})
      EXPECT_EQ(panel->vfpOp(0, operation, unusable), -8) << operation;
  EXPECT_EQ(panel->vfpOp(0, 22, 0), -1);
}

TEST_F(PilotTest, AfterACloseNothingIsShownAndNothingAnswers) {
  EXPECT_EQ(panel->vfpOp(0, 1, {}), 0);
  EXPECT_EQ(panel->vfpOp(0, 10, 14), 0);
  EXPECT_EQ(set(780, 5), 0);
  publishFrame(kTopNPath, {{12, -7}});
  EXPECT_EQ(panel->base().traceManager().numberOfTraces(), 0);
  EXPECT_EQ(text("PNIncrementTextBox"), "1");
}

TEST_F(PilotTest, CodesOfTheBarsChangeTheCurrentChartAndWithoutOneNothing) {
  struct Row {
    std::int16_t code;
    double value;
    double (*held)(const clsBarChartPainter& bars);
  };
  const Row rows[] = {
      {728, 1, [](const clsBarChartPainter& b) { return b.useOffset() ? 1.0 : 0.0; }},
      {729, 2, [](const clsBarChartPainter& b) { return double{b.barSortByMode() * 1.0}; }},
      {730, 1, [](const clsBarChartPainter& b) { return double{b.barSortOrder() * 1.0}; }},
      {731, 7, [](const clsBarChartPainter& b) { return double{b.otherIs() * 1.0}; }},
      {732, -9.5, [](const clsBarChartPainter& b) { return b.threshold().value_or(0); }},
      {775, 1, [](const clsBarChartPainter& b) { return double{b.BarChartStyle() * 1.0}; }},
      {776, 1, [](const clsBarChartPainter& b) { return b.ShowCellName() ? 1.0 : 0.0; }},
  };
  for (const Row& row : rows) EXPECT_EQ(set(row.code, row.value), 0);  // no chart yet
  publishFrame(kListPath, {{5, -9}});
  publishFrame(kTopNPath, {{12, -7}});
  panel->vfpOp(0, 10, 14);  // a trace over PN offset is active, the chart of the strongest stays current
  for (const Row& row : rows) {
    EXPECT_NE(row.held(*bars(203)), row.value) << row.code;
    EXPECT_EQ(set(row.code, Variant("much")), 0);
    EXPECT_NE(row.held(*bars(203)), row.value) << row.code;
    EXPECT_EQ(set(row.code, row.value), 0);
    EXPECT_EQ(row.held(*bars(203)), row.value) << row.code;
    EXPECT_NE(row.held(*bars(204)), row.value) << row.code;
  }
  EXPECT_EQ(panel->controls()->list("SortByComboBox").Text(), "X");
  EXPECT_TRUE(panel->controls()->optionButton("SortAscendingOptionButton").Value());
  EXPECT_EQ(text("ThresholdTextBox"), "-9.5");
  panel->vfpOp(0, 11, 201);
  set(729, 4);
  EXPECT_EQ(bars(204)->barSortByMode(), 4);
  EXPECT_EQ(asked(), Calls{});  // nothing goes back
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(PilotTest, TheChartThatTheHostChoosesIsTheCurrentOne) {
  publishFrame(kListPath, {{5, -9}});
  publishFrame(kTopNPath, {{12, -7}});
  EXPECT_EQ(set(737, 204), 0);
  set(729, 2);
  EXPECT_EQ(bars(204)->barSortByMode(), 2);
  EXPECT_EQ(bars(203)->barSortByMode(), 1);
  set(731, 9);  // a quantity that the list does not offer
  EXPECT_EQ(bars(204)->otherIs(), 9);
  EXPECT_EQ(panel->controls()->list("BarLabelComboBox").ListIndex(), -1);
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(PilotTest, CellNamesStandOnlyWhereNamingIsEnabled) {
  publishFrame(kTopNPath, {{12, -7}});
  set(799, false);
  set(776, 1);
  EXPECT_FALSE(bars(203)->ShowCellName());
  EXPECT_FALSE(control("ShowCellNameCheckBox").Enabled());
  set(799, true);
  EXPECT_TRUE(control("ShowCellNameCheckBox").Enabled());
  set(776, 1);
  EXPECT_TRUE(bars(203)->ShowCellName());
}

TEST_F(PilotTest, CodesOfTheCodeWindowFillItsFieldsAndSayNothingBack) {
  set(500, 2);
  EXPECT_EQ(panel->controls()->list("FormatComboBox").Text(), "CDMA2000 3X");
  set(803, 1920);
  set(804, 384);
  EXPECT_EQ(text("CodeStartTextBox"), "10");
  EXPECT_EQ(text("CodeStopTextBox"), "12");
  EXPECT_EQ(text("CodeCenterTextBox"), "11");
  EXPECT_EQ(text("CodeSpanTextBox"), "2");
  set(502, 3840);
  EXPECT_EQ(text("CodeStartTextBox"), "19");
  set(500, 0);
  EXPECT_EQ(panel->fields().code.start.value(), 19 * 64);
  set(780, 600);
  EXPECT_EQ(text("PNIncrementTextBox"), "511");
  constexpr std::int16_t kCodes[] = {500, 502, 780, 803, 804};
  for (const std::int16_t code : kCodes) EXPECT_EQ(set(code, Variant("many")), 0) << code;
  EXPECT_EQ(panel->fields().code.start.value(), 19 * 64);
  EXPECT_EQ(asked(), Calls{});
  EXPECT_EQ(messages(), Messages{});
  set(500, 9);
  EXPECT_EQ(said(), "clsEnumeratedParameter::value() ... could not find value (9) for ParameterType 231\r");
  EXPECT_EQ(panel->fields().format.value(), 0);
}

TEST_F(PilotTest, ASetThatTheHostSwitchesOffStaysAwayUntilItIsSwitchedOn) {
  publishFrame(kTopNPath, {{12, -7}});
  set(750, Variant("False"));
  EXPECT_EQ(bars(203), nullptr);
  EXPECT_EQ(panel->controls()->checkBox("topNPilotsCheckBox").Value(), 0);
  publishFrame(kTopNPath, {{12, -7}});
  EXPECT_EQ(bars(203), nullptr);
  set(750, 1);
  EXPECT_EQ(bars(203), nullptr);  // comes with its next frame
  publishFrame(kTopNPath, {{12, -7}});
  EXPECT_NE(bars(203), nullptr);
  EXPECT_EQ(set(750, Variant("perhaps")), -8);
  EXPECT_EQ(said(), "Tarvex::vfpSet() ... \rType mismatch");
  EXPECT_NE(bars(203), nullptr);
  EXPECT_EQ(asked(), Calls{});
}

// An index from 0 inserts, -1 deletes the first item, -2 the second. Each row goes on from the one before.
TEST_F(PilotTest, TheHostEditsTheUsersListByPlace) {
  const std::string past =
      "Tarvex::vfpSet() attempt to add an item at an index past the end of the List Box "
      "list/CDMA_CODE_OFFSET, ";
  const std::string invalid = "Tarvex::vfpSet() attempt to delete an invalid index/CDMA_CODE_OFFSET, ";
  const std::string notAdded = "Tarvex::vfpSet()...CDMA_CODE_OFFSET not added at the correct index\r";
  struct Row {
    std::int16_t index;
    Variant value;
    std::string list;
    std::string message;
  };
  const Row rows[] = {
      {0, 12, "12", ""},
      {0, 24.0, "24 12", ""},
      {2, Variant("36"), "24 12 36", ""},
      {4, 48.0, "24 12 36", past + "\r"},
      {32767, 48, "24 12 36", past + "\r"},
      {1, 512, "24 12 36", notAdded},
      {1, -1, "24 12 36", notAdded},
      {1, 7.5, "24 12 36", notAdded},
      {1, Variant("many"), "24 12 36", ""},
      {1, 511, "24 511 12 36", ""},
      {-5, 24.0, "24 511 12 36", invalid + "Double\r"},
      {-32768, 24.0, "24 511 12 36", invalid + "Double\r"},
      {-2, 24, "24 511 12 36",
       "Tarvex::vfpSet()...CDMA_CODE_OFFSET to delete is inconsistent with the index\r"},
      {-2, 511, "24 12 36", ""},
      {-3, 36, "24 12", ""},
      {-1, 24, "12", ""},
  };
  for (const Row& row : rows) {
    EXPECT_EQ(set(230, row.value, row.index), 0) << row.index;
    EXPECT_EQ(listed(), row.list) << row.index;
    EXPECT_EQ(said(), row.message) << row.index;
  }
  publishFrame(kListPath, {{12, -7}});
  panel->Paint();
  EXPECT_FALSE(bars(204)->dataChanged());
  set(230, 12, -1);
  EXPECT_TRUE(bars(204)->dataChanged());
  EXPECT_EQ(asked(), Calls{});
}

TEST_F(PilotTest, TheSettingsRestoreAnotherPanel) {
  publishFrame(kTopNPath, {{12, -7}});
  set(500, 2), set(780, 4), set(803, 1920), set(804, 384), set(13, 881.5e6);
  set(728, 1), set(729, 2), set(730, 1), set(731, 5), set(732, -80), set(775, 1), set(776, 1);
  panel->vfpOp(0, 9, {});
  const PanelSettings kept = owner.kept;
  RecordingOwner other;
  Tarvex restored(PanelEnvironment{gdi, windowing, view, hub, {15, 15}, ""},
                  PilotServices{dialogs, files, separators}, other, other);
  restored.vfpOp(0, 10, 201);
  for (const PanelSetting& setting : kept) restored.vfpSet(0, setting.parameterType, 0, setting.value);
  restored.vfpOp(0, 9, {});
  ASSERT_EQ(kept.size(), other.kept.size());
  for (std::size_t i = 0; i < kept.size(); ++i) {
    EXPECT_EQ(kept[i].parameterType, other.kept[i].parameterType);
    EXPECT_EQ(kept[i].value, other.kept[i].value) << kept[i].parameterType;
  }
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(PilotTest, TheReportListsTheBarsOfEachSet) {
  publishFrame(kTopNPath, {{12, -7}, {30, -3.5F}});
  owner.png = {1, 2, 3};
  const std::string html = panel->base().reportHtml();
  for (const char* const part : {"PN offset", "<td>Top N</td><td>30</td><td>-3.5 dB</td>", "-70 dBm", "AQID"})
    EXPECT_NE(html.find(part), std::string::npos) << part << "\n" << html;
}

TEST_F(PilotTest, LinksShowOnTheFieldsThatHoldTheirParameters) {
  panel->base().frontPanelLink({3, 803, true, false, true});
  EXPECT_TRUE(control("CodeStartTextBox").Bold());
  panel->base().frontPanelLink({3, 500, false, true, false});
  EXPECT_TRUE(control("FormatComboBox").Italic());
  EXPECT_FALSE(control("FormatComboBox").Enabled());
  EXPECT_EQ(said(), "");
  panel->base().frontPanelLink({3, 94, false, false, true});
  EXPECT_EQ(said(), "Tarvex::frontPanelLink() ... unhandled parameter\r");
  Variant types;
  EXPECT_EQ(panel->measurementInfo(types), 0);
  EXPECT_EQ(types, (Variant::Int32s{14, 18, 201, 200}));
}

}  // namespace
}  // namespace frontpanels::testing

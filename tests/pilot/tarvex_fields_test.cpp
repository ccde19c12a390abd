#include "tests/pilot/pilot_fixture.h"

namespace frontpanels::testing {
namespace {

class PilotFieldsTest : public PilotTest {
 protected:
  PilotFieldsTest() {
    panel->base().rightPanelVisible(true);
    panel->base().bottomPanelVisible(true);
    set(315, 7);
    panel->base().virtualFrontPanelId = 4;
    owner.take();
  }
};

TEST_F(PilotFieldsTest, WhatIsEnteredAboutTheMeasurementGoesToTheHost) {
  struct Row {
    const char* box;
    const char* typed;
    Calls requests;
    const char* shown;
  };
  // Each row goes on from the one before; 64 chips are a PN offset.
  const Row rows[] = {
      {"CodeStopTextBox", "100", {"frontPanelSet 7 4 803 0 0", "frontPanelSet 7 4 804 0 6400"}, "100"},
      {"CodeStartTextBox", "20.5", {"frontPanelSet 7 4 803 0 1312", "frontPanelSet 7 4 804 0 5088"}, "20.5"},
      {"CodeCenterTextBox", "50", {"frontPanelSet 7 4 502 0 3200"}, "50"},
      {"CodeSpanTextBox", "10", {"frontPanelSet 7 4 803 0 2880", "frontPanelSet 7 4 804 0 640"}, "10"},
      {"PNIncrementTextBox", "4", {"frontPanelSet 7 4 780 0 4"}, "4"},
      {"carrierFrequencyTextBox", "881.52M", {"frontPanelSet 7 4 13 0 881520000"}, "881.52 MHz"},
      {"CodeSpanTextBox", "", {}, "10"},
      {"TopNTextBox", "5", {}, "5"},
  };
  for (const Row& row : rows) {
    type(row.box, row.typed);
    EXPECT_EQ(asked(), row.requests) << row.box;
    EXPECT_EQ(text(row.box), row.shown) << row.box;
  }
  choose("FormatComboBox", 2);
  choose("ChannelizationCombo", 1);
  EXPECT_EQ(asked(), (Calls{"frontPanelSet 7 4 500 0 2", "frontPanelSet 7 4 333 0 1"}));
  EXPECT_EQ(text("CodeStartTextBox"), "45");
  EXPECT_EQ(panel->fields().code.start.value(), 45 * 192);
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(PilotFieldsTest, ARefusedRequestIsReportedOnce) {
  owner.status = -8;
  type("CodeStartTextBox", "20");
  EXPECT_EQ(said(), "Tarvex::newCodeStartStop() status = -8");
  EXPECT_EQ(asked().size(), 1U);
  click("topNPilotsCheckBox");
  EXPECT_EQ(said(), "Tarvex::topNPilotsCheckBox_Click() status = -8");
  EXPECT_EQ(panel->controls()->checkBox("topNPilotsCheckBox").Value(), 0);
  panel->vfpOp(0, 10, 200);
  click("userPNListAddButton");
  EXPECT_EQ(said(), "Tarvex::userPNListAddButton_Click() status = -8");
  EXPECT_EQ(listed(), "");
  owner.settingChanged = [this](std::int16_t, const Variant&) { set(230, 5, 0); };
  click("userPNListAddButton");  // the host edits the list and refuses
  EXPECT_EQ(said(), "Tarvex::userPNListAddButton_Click() status = -8");
  EXPECT_EQ(listed(), "5 0");
  owner.settingChanged = {};
  choose("FormatComboBox", 2);
  EXPECT_EQ(said(), "Tarvex::newCdmaFormat() status = -8");
  EXPECT_EQ(panel->fields().code.format(), 0);
  EXPECT_EQ(panel->controls()->list("FormatComboBox").Text(), "IS-95B");
}

TEST_F(PilotFieldsTest, AThresholdComesAndGoesWithItsField) {
  publishFrame(kTopNPath, {{12, -7}});
  EXPECT_EQ(text("ThresholdTextBox"), "");
  type("ThresholdTextBox", "0");
  EXPECT_EQ(bars(203)->threshold(), 0);
  panel->controls()->textBox("ThresholdTextBox").userText("");
  control("ThresholdTextBox").userKey(13);
  EXPECT_EQ(bars(203)->threshold(), std::nullopt);
  panel->controls()->spinButton("ThresholdSpinButton").press(true);  // from the last one, by one
  EXPECT_EQ(bars(203)->threshold(), 1);
  publishFrame(kListPath, {{5, -9}});
  EXPECT_EQ(text("ThresholdTextBox"), "");
  type("ThresholdTextBox", "1");
  EXPECT_EQ(bars(204)->threshold(), 1);
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(PilotFieldsTest, AHostThatClosesThePanelInsideARequestIsAskedNothingMore) {
  owner.settingChanged = [this](std::int16_t, const Variant&) { panel->vfpOp(0, 1, {}); };
  type("CodeStopTextBox", "100");
  EXPECT_EQ(asked().size(), 2U);  // the request, and the view that goes
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(PilotFieldsTest, TheHostsAnswerInsideARequestIsTakenAndDoesNotChangeTheNext) {
  owner.settingChanged = [this](std::int16_t code, const Variant&) {
    if (code == 803) set(804, 64), set(803, 128);
  };
  type("CodeStopTextBox", "100");
  EXPECT_EQ(asked(), (Calls{"frontPanelSet 7 4 803 0 0", "frontPanelSet 7 4 804 0 6400"}));
  EXPECT_EQ(text("CodeStartTextBox"), "2");
}

TEST_F(PilotFieldsTest, CheckBoxesAskForTheirSetsAndTakeThemOffTheGraph) {
  for (const char* const box :
       {"allPilotsCheckBox", "zoomedPilotsCheckBox", "topNPilotsCheckBox", "userListCheckBox"})
    click(box);
  EXPECT_EQ(asked(), (Calls{"frontPanelOp 7 4 10 14", "frontPanelOp 7 4 10 18",
                            "frontPanelSet 7 4 750 0 True", "frontPanelSet 7 4 751 0 True"}));
  EXPECT_EQ(panel->base().traceManager().numberOfTraces(), 0);  // each comes with its first frame
  EXPECT_TRUE(control("userPNListAddButton").reallyEnabled());
  publishFrame(kTopNPath, {{12, -7}});
  EXPECT_EQ(asked(), Calls{});
  click("topNPilotsCheckBox");
  click("allPilotsCheckBox");
  EXPECT_EQ(asked(), (Calls{"frontPanelSet 7 4 750 0 False", "frontPanelOp 7 4 11 14"}));
  publishFrame(kTopNPath, {{12, -7}});
  EXPECT_EQ(bars(203), nullptr);
  panel->vfpOp(0, 11, 14);  // the host does as it was asked
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(PilotFieldsTest, FieldsOfTheBarsChangeTheChartThatIsActive) {
  EXPECT_FALSE(control("SortByComboBox").Enabled());
  EXPECT_TRUE(control("MarkerAddButton").Enabled());
  publishFrame(kListPath, {{5, -9}});
  publishFrame(kTopNPath, {{12, -7}, {30, -3}, {8, -5}});
  EXPECT_TRUE(control("SortByComboBox").Enabled());
  EXPECT_FALSE(control("MarkerAddButton").Enabled());
  choose("SortByComboBox", 2);
  EXPECT_EQ(barsOf(203), "30:-3 12:-7 8:-5");
  click("SortAscendingOptionButton");
  EXPECT_EQ(barsOf(203), "8:-5 12:-7 30:-3");
  choose("BarLabelComboBox", 1);
  EXPECT_EQ(bars(203)->otherIs(), 2);
  choose("BarChartStyleComboBox", 1);
  EXPECT_EQ(bars(203)->BarChartStyle(), 1);
  type("ThresholdTextBox", "-6");
  EXPECT_EQ(bars(203)->threshold(), -6);
  click("ShowCellNameCheckBox");
  EXPECT_TRUE(bars(203)->ShowCellName());
  type("TopNTextBox", "2");
  EXPECT_EQ(bars(203)->getBarsToPaint(), 2);
  EXPECT_EQ(bars(204)->getBarsToPaint(), -1);
  EXPECT_EQ(bars(204)->barSortByMode(), 1);
  EXPECT_EQ(asked(), Calls{});
  panel->controls()->list("BarLabelComboBox").ListIndex(-1);
  EXPECT_EQ(said(), "Tarvex::BarLabelComboBox_Click() invalid label value\r");
}

TEST_F(PilotFieldsTest, TheQuantitiesOfMultipathRecordsCanBeChosenWhileTheyAreActive) {
  ItemList& list = panel->controls()->list("BarLabelComboBox");
  EXPECT_EQ(list.ListCount(), 4);
  publishFrame(kTopNPath, {{12, -7}});
  ASSERT_EQ(list.ListCount(), 8);
  EXPECT_EQ(list.item(7).text, "Ag - Peak (dB)");
  choose("BarLabelComboBox", 7);
  EXPECT_EQ(bars(203)->otherIs(), 8);
  panel->vfpOp(0, 10, 14);
  EXPECT_EQ(list.ListCount(), 4);
  panel->MouseDown(1, 0, 6000, 1000);  // the small panel above
  EXPECT_EQ(panel->base().traceManager().activeTrace(), bars(203));
  ASSERT_EQ(list.ListCount(), 8);
  EXPECT_EQ(list.Text(), "Ag - Peak (dB)");
  EXPECT_EQ(said(), "");
  list.RemoveItem(0);
  panel->refreshControls();
  EXPECT_EQ(said(),
            "Tarvex::changedTraceConfiguration() ... unexpected count in barLabelComboBox ... have all "
            "addItems/removeItems been updated?\r");
}

TEST_F(PilotFieldsTest, PowerIsShownWithOrWithoutTheTotalPowerAndTheAxisGoesAlong) {
  publishFrame(kTopNPath, {{12, -7}}, -71.4);
  choose("PowerDisplayComboBox", 1);
  panel->Paint();
  EXPECT_EQ(barsOf(203), "12:-78.4");
  EXPECT_EQ(bars(203)->gridScaleTop(), -72);  // 0 - 71.4, to a whole division of 3 dB
  EXPECT_EQ(bars(203)->yAxisLabel(), "dBm");
  choose("PowerDisplayComboBox", 0);
  panel->Paint();
  EXPECT_EQ(barsOf(203), "12:-7");
  EXPECT_EQ(bars(203)->gridScaleTop(), 0);
  hub.publish(kAllPilotsPath + "Io", Variant(-60));
  publishLevels(kAllPilotsPath + "AllPilotsTrace", {-10, -11, -12, -13});
  choose("PowerDisplayComboBox", 1);
  panel->Paint();
  EXPECT_EQ(trace(11)->trace().element(0), Variant(-70.0F));
  choose("PowerDisplayComboBox", 0);
  panel->Paint();
  EXPECT_EQ(trace(11)->trace().element(0), Variant(-10.0F));
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(PilotFieldsTest, TheVerticalFieldsFollowTheActiveDisplay) {
  publishFrame(kTopNPath, {{12, -7}, {30, -27}});
  EXPECT_EQ(text("VerticalScaleTextBox"), "3");
  type("VerticalScaleTextBox", "4");
  EXPECT_EQ(bars(203)->verticalResolution(), 4);
  type("VerticalOffsetTextBox", "-2");
  EXPECT_EQ(bars(203)->gridScaleTop(), -2);
  click("AutoScaleBox");
  EXPECT_TRUE(bars(203)->getAutoScale());
  // (27 - 7) / 0.85 / 10 = 2.35, to 5 a division: 50; top (-7 - 27 + 50) / 2 = 8, to 10 in steps of 5
  EXPECT_EQ(text("VerticalScaleTextBox"), "5");
  EXPECT_EQ(text("VerticalOffsetTextBox"), "10");
  panel->vfpOp(0, 10, 14);
  EXPECT_EQ(panel->controls()->checkBox("AutoScaleBox").Value(), 0);
  EXPECT_EQ(text("VerticalScaleTextBox"), "5");
  EXPECT_EQ(text("VerticalOffsetTextBox"), "0");
}

TEST_F(PilotFieldsTest, TheUsersListIsEditedAndTheHostIsTold) {
  EXPECT_FALSE(control("userPNListAddButton").reallyEnabled());
  panel->vfpOp(0, 10, 200);
  type("userPNListTextBox", "12");
  click("userPNListAddButton");
  type("userPNListTextBox", "600");  // the last one
  click("userPNListAddButton");
  control("userPNListTextBox").SetFocus();
  control("userPNListTextBox").userKey('x');
  click("userPNListAddButton");  // the text is refused: what is back in the field was not meant
  EXPECT_EQ(listed(), "12 511");
  EXPECT_EQ(asked(), (Calls{"frontPanelSet 7 4 230 0 12", "frontPanelSet 7 4 230 1 511"}));
  EXPECT_FALSE(control("userPNListDeleteButton").Enabled());
  choose("userPNListListBox", 0);
  EXPECT_TRUE(control("userPNListDeleteButton").Enabled());
  click("CdmaUnitsChipsOption");
  EXPECT_EQ(listed(), "768 32704");
  click("userPNListDeleteButton");
  EXPECT_EQ(asked(), Calls{"frontPanelSet 7 4 230 -1 12"});
  EXPECT_EQ(listed(), "32704");
  EXPECT_EQ(panel->controls()->list("userPNListListBox").ListIndex(), 0);  // the selection goes on
  owner.settingChanged = [this](std::int16_t code, const Variant& value) { set(code, value, 1); };  // an echo
  type("userPNListTextBox", "128");
  click("userPNListAddButton");
  EXPECT_EQ(listed(), "32704 128");
  EXPECT_EQ(messages(), Messages{});
}

class PilotImportTest : public PilotFieldsTest {
 protected:
  PilotImportTest() {
    panel->vfpOp(0, 10, 200);
    set(230, 7, 0);
    dialogs.chosen = "pn.txt";
  }
  void import(std::string content) {
    files.contents["pn.txt"] = std::move(content);
    click("userPNListImportButton");
  }
};

TEST_F(PilotImportTest, AFilesPnOffsetsGoToTheListAndToTheHost) {
  set(780, 3);
  import("12;Hill\r\n 24 ;;x\n36\n\n48\n");  // the first empty line ends it
  EXPECT_EQ(dialogs.filter, "Text Files (*.txt)|*.txt");
  EXPECT_EQ(listed(), "7 12 24 36");
  EXPECT_EQ(asked(), (Calls{"frontPanelSet 7 4 230 1 12", "frontPanelSet 7 4 230 2 24",
                            "frontPanelSet 7 4 230 3 36", "frontPanelSet 7 4 780 0 3"}));
  import("");
  EXPECT_EQ(asked(), Calls{"frontPanelSet 7 4 780 0 3"});
  dialogs.chosen.reset();
  import("1");
  EXPECT_EQ(asked(), Calls{});
  EXPECT_EQ(listed(), "7 12 24 36");
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(PilotImportTest, AFileThatCannotBeUsedIsReportedAndChangesNothing) {
  struct Row {
    std::string content;
    const char* failure;
  };
  std::string tooMany;
  for (int i = 0; i < 32768; ++i) tooMany += "1\n";
  const Row rows[] = {
      {"12\nhill\n", "Type mismatch"}, {"12\n512\n", "Type mismatch"},
      {"12\n-1\n", "Type mismatch"},   {"12\n1.5\n", "Type mismatch"},
      {";12\n", "Type mismatch"},      {"1;2;3;4;5;6;7;8;9;10\n", "Subscript out of range"},
      {tooMany, "Overflow"},
  };
  for (const Row& row : rows) {
    import(row.content);
    EXPECT_EQ(said(), std::string("Tarvex::userPNListImportButton()\r") + row.failure);
    EXPECT_EQ(listed(), "7");
    EXPECT_EQ(asked(), Calls{});
  }
  dialogs.chosen = "nowhere.txt";
  click("userPNListImportButton");
  EXPECT_EQ(said(), "Tarvex::userPNListImportButton()\rFile not found");
}

TEST_F(PilotImportTest, TheUserAndTheHostCanEndAnImport) {
  std::string lines;
  for (int i = 0; i < 600; ++i) lines += std::to_string(i % 512) + "\n";
  dialogs.looksToCancel = 1;  // while the file is read
  import(lines);
  EXPECT_EQ(listed(), "7");
  EXPECT_EQ(asked(), Calls{});
  dialogs.looksToCancel = 3;  // 600 lines have been read at two looks; the third comes after 255 entries
  import(lines);
  EXPECT_EQ(panel->controls()->list("userPNListListBox").ListCount(), 1 + 255);
  const Calls calls = asked();
  EXPECT_EQ(calls.back(), "frontPanelSet 7 4 780 0 1");
  dialogs.looksToCancel = -1;
  owner.status = -8;
  import("3\n4\n");
  EXPECT_EQ(panel->controls()->list("userPNListListBox").ListCount(), 1 + 255);
  EXPECT_EQ(said(),
            "Tarvex::userPNListImportButton() status = -8\nTarvex::userPNListImportButton() status = -8");
}

}  // namespace
}  // namespace frontpanels::testing

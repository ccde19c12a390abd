#include "pilot/pilot_controls.h"

namespace frontpanels {
namespace {

// Tab goes through the measurement area from left to right, then down the display area; a label or frame
// comes right before its field, which is where its access key leads. The areas' places are those in a view of
// 12000 x 9000 twips.
using enum ControlKind;

constexpr ControlRow kRows[] = {
    spoken({"controlPanel", Picture, "", "", {0, 0, 12000, 1755}}, "Measurement Controls"),
    spoken({"displayPanel", Picture, "", "", {0, 0, 2730, 9000}}, "Display Controls"),

    {"pilotSetsFrame", Frame, "controlPanel", "Pilots", {60, 45, 1995, 1650}},
    {"allPilotsCheckBox", CheckBox, "pilotSetsFrame", "&All Pilots", {105, 240, 1800, 270}, 0},
    {"zoomedPilotsCheckBox", CheckBox, "pilotSetsFrame", "&Zoomed", {105, 570, 1800, 270}, 1},
    {"topNPilotsCheckBox", CheckBox, "pilotSetsFrame", "&Top N", {105, 900, 960, 270}, 2},
    spoken({"TopNTextBox", TextBox, "pilotSetsFrame", "", {1095, 885, 525, 285}, 3}, "Top N, Count"),
    {"TopNSpinButton", SpinButton, "pilotSetsFrame", "", {1620, 885, 240, 285}},
    {"userListCheckBox", CheckBox, "pilotSetsFrame", "&User List", {105, 1230, 1800, 270}, 4},

    {"CodeFrame", Frame, "controlPanel", "Code", {2100, 45, 4425, 1650}},
    {"FormatLabel", Label, "CodeFrame", "&Format", {105, 270, 675, 225}, 5},
    {"FormatComboBox", ComboBox, "CodeFrame", "", {780, 225, 1545, 315}, 6},
    {"CdmaUnitsPnOption", OptionButton, "CodeFrame", "PN", {2490, 240, 690, 270}, 7},
    {"CdmaUnitsChipsOption", OptionButton, "CodeFrame", "Chips", {3210, 240, 990, 270}, 8},
    {"CodeStartLabel", Label, "CodeFrame", "&Start", {105, 630, 675, 225}, 9},
    {"CodeStartTextBox", TextBox, "CodeFrame", "", {780, 585, 1080, 285}, 10},
    {"CodeStartSpinButton", SpinButton, "CodeFrame", "", {1860, 585, 240, 285}},
    {"CodeStopLabel", Label, "CodeFrame", "Sto&p", {105, 975, 675, 225}, 11},
    {"CodeStopTextBox", TextBox, "CodeFrame", "", {780, 930, 1080, 285}, 12},
    {"CodeStopSpinButton", SpinButton, "CodeFrame", "", {1860, 930, 240, 285}},
    {"CodeCenterLabel", Label, "CodeFrame", "&Center", {2325, 630, 675, 225}, 13},
    {"CodeCenterTextBox", TextBox, "CodeFrame", "", {3000, 585, 1080, 285}, 14},
    {"CodeCenterSpinButton", SpinButton, "CodeFrame", "", {4080, 585, 240, 285}},
    {"CodeSpanLabel", Label, "CodeFrame", "Spa&n", {2325, 975, 675, 225}, 15},
    {"CodeSpanTextBox", TextBox, "CodeFrame", "", {3000, 930, 1080, 285}, 16},
    {"CodeSpanSpinButton", SpinButton, "CodeFrame", "", {4080, 930, 240, 285}},
    {"PNIncrementLabel", Label, "CodeFrame", "PN &Inc.", {105, 1320, 675, 225}, 17},
    {"PNIncrementTextBox", TextBox, "CodeFrame", "", {780, 1275, 1080, 285}, 18},
    {"PNIncrementSpinButton", SpinButton, "CodeFrame", "", {1860, 1275, 240, 285}},

    {"userPNListFrame", Frame, "controlPanel", "User PN List", {6570, 45, 2895, 1650}},
    spoken({"userPNListTextBox", TextBox, "userPNListFrame", "", {105, 270, 1140, 285}, 19},
           "PN, User PN List"),
    {"userPNListSpinButton", SpinButton, "userPNListFrame", "", {1245, 270, 240, 285}},
    {"userPNListAddButton", PushButton, "userPNListFrame", "A&dd", {105, 690, 660, 330}, 20},
    {"userPNListDeleteButton", PushButton, "userPNListFrame", "D&elete", {795, 690, 690, 330}, 21},
    {"userPNListImportButton", PushButton, "userPNListFrame", "I&mport...", {105, 1155, 1380, 330}, 22},
    {"userPNListListBox", ListBox, "userPNListFrame", "", {1605, 225, 1185, 1335}, 23},

    {"CarrierFrame", Frame, "controlPanel", "Carrier", {9510, 45, 2385, 1650}},
    spoken({"carrierFrequencyTextBox", TextBox, "CarrierFrame", "", {105, 225, 1935, 285}, 24},
           "Carrier, Frequency"),
    {"carrierFrequencySpinButton", SpinButton, "CarrierFrame", "", {2040, 225, 240, 285}},
    spoken({"ChannelizationCombo", ComboBox, "CarrierFrame", "", {105, 555, 2175, 315}, 25},
           "Channelization"),
    {"CarrierErrorLabel", Label, "CarrierFrame", "", {105, 930, 2220, 210}},
    {"CarrierStateLabel", Label, "CarrierFrame", "", {105, 1155, 2220, 210}},
    {"onePpsLabel", Label, "CarrierFrame", "", {105, 1380, 2220, 210}},

    {"BarsFrame", Frame, "displayPanel", "Bars", {60, 45, 2610, 2820}},
    {"SortByLabel", Label, "BarsFrame", "Sort &By", {90, 300, 555, 225}, 26},
    {"SortByComboBox", ComboBox, "BarsFrame", "", {645, 255, 1905, 315}, 27},
    {"SortAscendingOptionButton", OptionButton, "BarsFrame", "Ascending", {105, 615, 1155, 270}, 28},
    {"SortDescendingOptionButton", OptionButton, "BarsFrame", "Descending", {1275, 615, 1245, 270}, 29},
    {"BarLabelLabel", Label, "BarsFrame", "Sho&w", {90, 990, 555, 225}, 30},
    {"BarLabelComboBox", ComboBox, "BarsFrame", "", {645, 945, 1905, 315}, 31},
    {"BarChartStyleLabel", Label, "BarsFrame", "St&yle", {90, 1350, 555, 225}, 32},
    {"BarChartStyleComboBox", ComboBox, "BarsFrame", "", {645, 1305, 1905, 315}, 33},
    {"PowerDisplayLabel", Label, "BarsFrame", "P&ower", {90, 1710, 555, 225}, 34},
    {"PowerDisplayComboBox", ComboBox, "BarsFrame", "", {645, 1665, 1905, 315}, 35},
    {"ThresholdLabel", Label, "BarsFrame", "T&hreshold", {105, 2085, 900, 225}, 36},
    {"ThresholdTextBox", TextBox, "BarsFrame", "", {1080, 2040, 1185, 285}, 37},
    {"ThresholdSpinButton", SpinButton, "BarsFrame", "", {2265, 2040, 240, 285}},
    {"ShowCellNameCheckBox", CheckBox, "BarsFrame", "Cell Names", {105, 2430, 2400, 270}, 38},

    {"I0Frame", Frame, "displayPanel", "Io", {60, 2910, 2610, 645}},
    {"I0TextBox", TextBox, "I0Frame", "", {105, 255, 2400, 285}},

    {"VerticalScaleFrame", Frame, "displayPanel", "Vertical Scale", {60, 3600, 2610, 1290}},
    spoken({"VerticalScaleTextBox", TextBox, "VerticalScaleFrame", "", {105, 255, 1050, 285}, 39},
           "Vertical Scale, dB/div"),
    {"VerticalScaleSpinButton", SpinButton, "VerticalScaleFrame", "", {1155, 255, 240, 285}},
    {"VerticalScaleLabel", Label, "VerticalScaleFrame", "dB/div", {1455, 300, 1050, 225}},
    {"VerticalOffsetTextBox", TextBox, "VerticalScaleFrame", "", {105, 600, 1050, 285}, 41},
    {"VerticalOffsetSpinButton", SpinButton, "VerticalScaleFrame", "", {1155, 600, 240, 285}},
    {"VerticalOffsetLabel", Label, "VerticalScaleFrame", "Ref &Level", {1455, 645, 1050, 225}, 40},
    {"AutoScaleBox", CheckBox, "VerticalScaleFrame", "AutoScale", {105, 945, 2400, 270}, 42},

    {"MarkerFrame", Frame, "displayPanel", "Mar&kers", {60, 4935, 2610, 1050}, 43},
    {"MarkerAddButton", PushButton, "MarkerFrame", "Add", {105, 255, 1185, 330}, 44},
    {"MarkerDeleteButton", PushButton, "MarkerFrame", "Delete", {1320, 255, 1185, 330}, 45},
    {"MarkerToMaxButton", PushButton, "MarkerFrame", "To Max", {105, 630, 1185, 330}, 46},
    {"MarkerDeltaButton", PushButton, "MarkerFrame", "Delta", {1320, 630, 1185, 330}, 47},

    {"CloseButton", PushButton, "displayPanel", "Close", {60, 6045, 2610, 345}, 48},
    spoken({"MeasurementFrameInvisibleButton", PushButton, "", "", {0, 7155, 9270, 90}},
           "Show or Hide Measurement Controls"),
    spoken({"MarkerFrameInvisibleButton", PushButton, "", "", {9180, 0, 90, 7245}},
           "Show or Hide Display Controls"),
};

}  // namespace

std::span<const ControlRow> pilotControls() noexcept { return kRows; }

}  // namespace frontpanels

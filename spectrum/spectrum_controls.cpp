#include "spectrum/spectrum_controls.h"

namespace frontpanels {
namespace {

// Tab goes through the measurement area from left to right, then down the display area; a label or frame
// comes right before its field, which is where its access key leads. The areas' places are those in a view of
// 12000 x 9000 twips.
using enum ControlKind;

constexpr ControlRow kRows[] = {
    spoken({"controlPanel", Picture, "", "", {0, 0, 12000, 1530}}, "Measurement Controls"),
    spoken({"displayPanel", Picture, "", "", {0, 0, 2730, 9000}}, "Display Controls"),
    {"CloseButton", PushButton, "displayPanel", "<Close>", {60, 5280, 2610, 345}, 42},
    {"FrequencyFrame", Frame, "controlPanel", "<Frequency>", {60, 45, 5730, 1425}},
    {"CenterFrequencyTextBox", TextBox, "FrequencyFrame", "", {825, 270, 1830, 285}, 1},
    {"CenterFrequencySpinButton", SpinButton, "FrequencyFrame", "", {2655, 270, 240, 285}},
    {"CenterFrequencyLabel", Label, "FrequencyFrame", "<Center>", {105, 315, 720, 225}, 0},
    {"FrequencySpanTextBox", TextBox, "FrequencyFrame", "", {825, 645, 1830, 285}, 3},
    {"FrequencySpanSpinButton", SpinButton, "FrequencyFrame", "", {2655, 645, 240, 285}},
    {"FrequencySpanLabel", Label, "FrequencyFrame", "<Span>", {105, 690, 720, 225}, 2},
    {"FrequencyRbwTextBox", TextBox, "FrequencyFrame", "", {825, 1020, 1830, 285}, 5},
    {"FrequencyRbwSpinButton", SpinButton, "FrequencyFrame", "", {2655, 1020, 240, 285}},
    {"FrequencyRbwLabel", Label, "FrequencyFrame", "<RBW>", {105, 1065, 720, 225}, 4},
    {"StartFrequencyTextBox", TextBox, "FrequencyFrame", "", {3555, 270, 1830, 285}, 7},
    {"StartFrequencySpinButton", SpinButton, "FrequencyFrame", "", {5385, 270, 240, 285}},
    {"StartFrequencyLabel", Label, "FrequencyFrame", "<Start>", {2955, 315, 600, 225}, 6},
    {"StopFrequencyTextBox", TextBox, "FrequencyFrame", "", {3555, 645, 1830, 285}, 9},
    {"StopFrequencySpinButton", SpinButton, "FrequencyFrame", "", {5385, 645, 240, 285}},
    {"StopFrequencyLabel", Label, "FrequencyFrame", "<Stop>", {2955, 690, 600, 225}, 8},
    {"SweepFrame", Frame, "controlPanel", "<Measurement>", {5835, 45, 1380, 1425}},
    {"SingleSweepButton", PushButton, "SweepFrame", "<Single>", {105, 255, 1170, 330}, 10},
    {"ContinuousSweepButton", PushButton, "SweepFrame", "<Cont.>", {105, 630, 1170, 330}, 11},
    {"StopSweepButton", PushButton, "SweepFrame", "<Stop>", {105, 1005, 1170, 330}, 12},
    spoken({"MeasurementFrameInvisibleButton", PushButton, "", "", {0, 7380, 9270, 90}},
           "Show or Hide Measurement Controls"),
    {"TraceFrame", Frame, "displayPanel", "<Trace>", {60, 45, 2610, 1395}},
    {"AverageCountTextBox", TextBox, "TraceFrame", "", {1335, 270, 900, 285}, 24},
    {"AverageCountSpinButton", SpinButton, "TraceFrame", "", {2235, 270, 240, 285}},
    {"AverageCountLabel", Label, "TraceFrame", "<Averages>", {105, 315, 1230, 225}, 23},
    {"AverageTypeCombo", ComboBox, "TraceFrame", "", {1125, 630, 1350, 315}, 26},
    {"AverageTypeLabel", Label, "TraceFrame", "<Averaging>", {105, 690, 1020, 225}, 25},
    {"DisplayLengthTextBox", TextBox, "TraceFrame", "", {1335, 1020, 900, 285}, 28},
    {"DisplayLengthSpinButton", SpinButton, "TraceFrame", "", {2235, 1020, 240, 285}},
    {"DisplayLengthLabel", Label, "TraceFrame", "<Disp. Length>", {105, 1065, 1230, 225}, 27},
    {"PowerAverageModeFrame", Frame, "displayPanel", "<Average Mode>", {60, 1485, 2610, 585}},
    {"LogPwrOption", OptionButton, "PowerAverageModeFrame", "<LogPwr>", {105, 255, 1230, 270}, 29},
    {"LinPowerOption", OptionButton, "PowerAverageModeFrame", "<Pwr>", {1380, 255, 1125, 270}, 30},
    {"UnitsFrame", Frame, "controlPanel", "<Units>", {7260, 45, 1470, 1425}},
    {"FrequencyOption", OptionButton, "UnitsFrame", "<Frequency>", {105, 255, 1320, 270}, 13},
    {"ChannelOption", OptionButton, "UnitsFrame", "<Channel>", {105, 555, 1320, 270}, 14},
    spoken({"ChannelizationCombo", ComboBox, "UnitsFrame", "", {105, 960, 1260, 315}, 15}, "Channelization"),
    {"BandFrame", Frame, "controlPanel", "<Band>", {10365, 45, 1530, 690}},
    {"DownlinkOption", OptionButton, "BandFrame", "<Downlink>", {105, 195, 1380, 225}, 19},
    {"UplinkOption", OptionButton, "BandFrame", "<Uplink>", {105, 420, 1380, 225}, 20},
    {"IntervalFrame", Frame, "controlPanel", "<Meas. Interval>", {8775, 45, 1545, 1425}},
    {"IntervalTimeOption", OptionButton, "IntervalFrame", "<Time>", {105, 255, 1395, 270}, 16},
    {"IntervalDistanceOption", OptionButton, "IntervalFrame", "<Distance>", {105, 555, 1395, 270}, 17},
    {"SweepRateTextBox", TextBox, "IntervalFrame", "", {105, 975, 1095, 285}, 18},
    {"SweepRateSpinButton", SpinButton, "IntervalFrame", "", {1200, 975, 240, 285}},
    {"IFBandwidthFrame", Frame, "controlPanel", "<IF Bandwidth>", {10365, 780, 1530, 690}},
    {"WidebandOption", OptionButton, "IFBandwidthFrame", "<Wideband>", {105, 195, 1380, 225}, 21},
    {"NarrowbandOption", OptionButton, "IFBandwidthFrame", "<Narrwbd>", {105, 420, 1380, 225}, 22},
    {"IfLabelFormatterNC", TextBox, "controlPanel", "", {0, 0, 0, 0}, kNoTabIndex, false},
    {"VerticalScaleFrame", Frame, "displayPanel", "<Vertical Scale>", {60, 2115, 2610, 945}},
    spoken({"VerticalScaleTextBox", TextBox, "VerticalScaleFrame", "", {105, 270, 1050, 285}, 32},
           "Vertical Scale, dB/div"),
    {"VerticalScaleSpinButton", SpinButton, "VerticalScaleFrame", "", {1155, 270, 240, 285}},
    {"VerticalScaleLabel", Label, "VerticalScaleFrame", "db&/div", {1455, 315, 960, 225}, 31},
    {"AutoScaleBox", CheckBox, "VerticalScaleFrame", "A&utoScale", {105, 615, 2400, 270}, 33},
    {"VerticalOffsetFrame", Frame, "displayPanel", "<Vertical offset>", {60, 3105, 2610, 645}},
    {"VerticalOffsetTextBox", TextBox, "VerticalOffsetFrame", "", {105, 270, 1050, 285}, 35},
    {"VerticalOffsetSpinButton", SpinButton, "VerticalOffsetFrame", "", {1155, 270, 240, 285}},
    {"VerticalOffsetLabel", Label, "VerticalOffsetFrame", "Ref &Level", {1455, 315, 960, 225}, 34},
    {"MarkerFrame", Frame, "displayPanel", "Mar&kers", {60, 3795, 2610, 1410}, 36},
    {"MarkerAddButton", PushButton, "MarkerFrame", "Add", {105, 255, 1185, 330}, 37},
    {"MarkerDeleteButton", PushButton, "MarkerFrame", "Delete", {1320, 255, 1185, 330}, 38},
    {"MarkerToMaxButton", PushButton, "MarkerFrame", "To Max", {105, 630, 1185, 330}, 39},
    {"MarkerDeltaButton", PushButton, "MarkerFrame", "Delta", {1320, 630, 1185, 330}, 40},
    {"MarkerToCenterButton", PushButton, "MarkerFrame", "To Center", {105, 1005, 1185, 330}, 41},
    spoken({"MarkerFrameInvisibleButton", PushButton, "", "", {9180, 0, 90, 7470}},
           "Show or Hide Display Controls"),
};

}  // namespace

std::span<const ControlRow> spectrumControls() noexcept { return kRows; }

}  // namespace frontpanels

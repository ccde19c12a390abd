#include "spectrum/spectrum_controls.h"

namespace frontpanels {
namespace {

// A label or frame comes right before its field in tab order, which is where its access key leads. The areas'
// places are those in a view of 12000 x 9000 twips.
using enum ControlKind;

constexpr ControlRow kRows[] = {
    {"controlPanel", Picture, "", "", {0, 0, 12000, 1530}},
    {"displayPanel", Picture, "", "", {0, 0, 2730, 9000}},
    {"CloseButton", PushButton, "displayPanel", "<Close>", {60, 5280, 2610, 345}, 42},
    {"FrequencyFrame", Frame, "controlPanel", "<Frequency>", {60, 45, 4650, 1425}},
    {"CenterFrequencyTextBox", TextBox, "FrequencyFrame", "", {825, 270, 1290, 285}, 1},
    {"CenterFrequencySpinButton", SpinButton, "FrequencyFrame", "", {2115, 270, 240, 285}},
    {"CenterFrequencyLabel", Label, "FrequencyFrame", "<Center>", {105, 315, 720, 225}, 0},
    {"FrequencySpanTextBox", TextBox, "FrequencyFrame", "", {825, 645, 1290, 285}, 3},
    {"FrequencySpanSpinButton", SpinButton, "FrequencyFrame", "", {2115, 645, 240, 285}},
    {"FrequencySpanLabel", Label, "FrequencyFrame", "<Span>", {105, 690, 720, 225}, 2},
    {"FrequencyRbwTextBox", TextBox, "FrequencyFrame", "", {825, 1020, 1290, 285}, 5},
    {"FrequencyRbwSpinButton", SpinButton, "FrequencyFrame", "", {2115, 1020, 240, 285}},
    {"FrequencyRbwLabel", Label, "FrequencyFrame", "<RBW>", {105, 1065, 720, 225}, 4},
    {"StartFrequencyTextBox", TextBox, "FrequencyFrame", "", {3015, 270, 1290, 285}, 7},
    {"StartFrequencySpinButton", SpinButton, "FrequencyFrame", "", {4305, 270, 240, 285}},
    {"StartFrequencyLabel", Label, "FrequencyFrame", "<Start>", {2415, 315, 600, 225}, 6},
    {"StopFrequencyTextBox", TextBox, "FrequencyFrame", "", {3015, 645, 1290, 285}, 9},
    {"StopFrequencySpinButton", SpinButton, "FrequencyFrame", "", {4305, 645, 240, 285}},
    {"StopFrequencyLabel", Label, "FrequencyFrame", "<Stop>", {2415, 690, 600, 225}, 8},
    {"SweepFrame", Frame, "controlPanel", "<Measurement>", {4755, 45, 1410, 1425}},
    {"SingleSweepButton", PushButton, "SweepFrame", "<Single>", {105, 255, 1200, 330}, 10},
    {"ContinuousSweepButton", PushButton, "SweepFrame", "<Cont.>", {105, 630, 1200, 330}, 11},
    {"StopSweepButton", PushButton, "SweepFrame", "<Stop>", {105, 1005, 1200, 330}, 12},
    {"MeasurementFrameInvisibleButton", PushButton, "", "", {0, 7380, 9270, 90}},
    {"TraceFrame", Frame, "displayPanel", "<Trace>", {60, 45, 2610, 1395}},
    {"AverageCountTextBox", TextBox, "TraceFrame", "", {1335, 270, 900, 285}, 14},
    {"AverageCountSpinButton", SpinButton, "TraceFrame", "", {2235, 270, 240, 285}},
    {"AverageCountLabel", Label, "TraceFrame", "<Averages>", {105, 315, 1230, 225}, 13},
    {"AverageTypeCombo", ComboBox, "TraceFrame", "", {1125, 630, 1350, 315}, 16},
    {"AverageTypeLabel", Label, "TraceFrame", "<Averaging>", {105, 690, 1020, 225}, 15},
    {"DisplayLengthTextBox", TextBox, "TraceFrame", "", {1335, 1020, 900, 285}, 18},
    {"DisplayLengthSpinButton", SpinButton, "TraceFrame", "", {2235, 1020, 240, 285}},
    {"DisplayLengthLabel", Label, "TraceFrame", "<Disp. Length>", {105, 1065, 1230, 225}, 17},
    {"PowerAverageModeFrame", Frame, "displayPanel", "<Average Mode>", {60, 1485, 2610, 585}},
    {"LogPwrOption", OptionButton, "PowerAverageModeFrame", "<LogPwr>", {105, 255, 1230, 270}, 19},
    {"LinPowerOption", OptionButton, "PowerAverageModeFrame", "<Pwr>", {1380, 255, 1125, 270}, 20},
    {"UnitsFrame", Frame, "controlPanel", "<Units>", {6210, 45, 1470, 1425}},
    {"FrequencyOption", OptionButton, "UnitsFrame", "<Frequency>", {105, 255, 1320, 270}, 21},
    {"ChannelOption", OptionButton, "UnitsFrame", "<Channel>", {105, 555, 1320, 270}, 22},
    {"ChannelizationCombo", ComboBox, "UnitsFrame", "", {105, 960, 1260, 315}, 23},
    {"BandFrame", Frame, "controlPanel", "<Band>", {7725, 45, 1290, 1425}},
    {"DownlinkOption", OptionButton, "BandFrame", "<Downlink>", {105, 255, 1155, 270}, 24},
    {"UplinkOption", OptionButton, "BandFrame", "<Uplink>", {105, 555, 1155, 270}, 25},
    {"IntervalFrame", Frame, "controlPanel", "<Meas. Interval>", {9060, 45, 1425, 1425}},
    {"IntervalTimeOption", OptionButton, "IntervalFrame", "<Time>", {105, 255, 1275, 270}, 26},
    {"IntervalDistanceOption", OptionButton, "IntervalFrame", "<Distance>", {105, 555, 1275, 270}, 27},
    {"SweepRateTextBox", TextBox, "IntervalFrame", "", {105, 975, 975, 285}, 28},
    {"SweepRateSpinButton", SpinButton, "IntervalFrame", "", {1080, 975, 240, 285}},
    {"IFBandwidthFrame", Frame, "controlPanel", "<IF Bandwidth>", {10530, 45, 1410, 1425}},
    {"WidebandOption", OptionButton, "IFBandwidthFrame", "<Wideband>", {105, 255, 1260, 270}, 29},
    {"NarrowbandOption", OptionButton, "IFBandwidthFrame", "<Narrwbd>", {105, 555, 1260, 270}, 30},
    {"IfLabelFormatterNC", TextBox, "controlPanel", "", {0, 0, 0, 0}, kNoTabIndex, false},
    {"VerticalScaleFrame", Frame, "displayPanel", "<Vertical Scale>", {60, 2115, 2610, 945}},
    {"VerticalScaleTextBox", TextBox, "VerticalScaleFrame", "", {105, 270, 1050, 285}, 32},
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
    {"MarkerFrameInvisibleButton", PushButton, "", "", {9180, 0, 90, 7470}},
};

}  // namespace

std::span<const ControlRow> spectrumControls() noexcept { return kRows; }

}  // namespace frontpanels

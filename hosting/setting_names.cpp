#include "hosting/setting_names.h"

#include <algorithm>
#include <iterator>

#include "framework/support/host_codes.h"

namespace frontpanels {
namespace {

constexpr std::string_view kWords[] = {"spectrum", "pilots"};

// A code names one thing on both panels, a thing of each, or is known to one of them.
struct NameRow {
  std::int16_t code;
  std::string_view spectrum;
  std::string_view pilots;
};

constexpr NameRow onBoth(std::int16_t code, std::string_view name) { return {code, name, name}; }

constexpr NameRow kNames[] = {
    {kCenterFrequencyParameter, "Center frequency (Hz)", "Carrier frequency (Hz)"},
    {kSpanParameter, "Span (Hz)", ""},
    {kRbwParameter, "Resolution bandwidth (Hz)", ""},
    {FREQ_FILTER, "IF bandwidth (1 narrow)", ""},
    {TIME_MEASUREMENT_PERIOD, "Measurement period (s)", "Measurement period"},
    onBoth(TIME_DATABASE_PERIOD, "Database period"),
    onBoth(TIME_DISPLAY_PERIOD, "Display period"),
    {kDisplayLengthParameter, "Points of a sweep", ""},
    {CDMA_CODE_OFFSET, "", "PN offset of the user list"},
    onBoth(PARM_MEASUREMENT_ID, "Measurement id"),
    onBoth(kCaptionParameter, "Caption"),
    onBoth(PARM_RESOURCE_ID, "Resource id"),
    onBoth(PARM_LOGGING_FLAG, "Logging"),
    onBoth(kChannelizationParameter, "Channelization"),
    {kAverageTypeParameter, "Averaging (32 off)", "Code format"},
    {kAverageCountParameter, "Averages", "Code center (chips)"},
    onBoth(kLeftParameter, "Left (twips)"),
    onBoth(kTopParameter, "Top (twips)"),
    onBoth(kWidthParameter, "Width (twips)"),
    onBoth(kHeightParameter, "Height (twips)"),
    onBoth(PARM_WINDOW_STATE, "Window state"),
    onBoth(kBottomPanelParameter, "Bottom area shown"),
    onBoth(kRightPanelParameter, "Right area shown"),
    onBoth(kXAxisStyleParameter, "X axis style"),
    onBoth(kVerticalResolutionParameter, "Vertical scale (units a division)"),
    onBoth(kGridTopParameter, "Level at the top"),
    onBoth(kYAxisStyleParameter, "Y axis style"),
    onBoth(kAutoScaleParameter, "Auto scale"),
    onBoth(kCaptionTextParameter, "Caption"),
    onBoth(kVisibleParameter, "Visible"),
    {kPowerDisplayParameter, "", "Bars show (0 Ec/Io, 1 Ec)"},
    {kSortModeParameter, "", "Bars sorted by"},
    {kSortOrderParameter, "", "Sort order (1 ascending)"},
    {kBarLabelParameter, "", "Shown beside the bars"},
    {kThresholdParameter, "", "Threshold (unit of the bars)"},
    onBoth(kTraceParameter, "Trace added"),
    onBoth(kTraceValueParameter, "PN of the next trace"),
    onBoth(kSelectTraceParameter, "Active trace"),
    onBoth(kNewMarkerParameter, "Marker"),
    onBoth(kMarkerFlagParameter, "Marker is a delta marker"),
    onBoth(kActiveMarkerParameter, "Marker is the active one"),
    onBoth(kAttachMarkerParameter, "Marker on the trace of PN"),
    onBoth(kMarkerValueParameter, "Marker at point"),
    {kUnitsParameter, "Units (0 channels, 1 frequencies)", "Top N shown"},
    {kUserListSetParameter, "", "User list shown"},
    {kBarChartStyleParameter, "", "Bars (0 upright, 1 lying)"},
    {kShowCellNameParameter, "", "Names of the cells shown"},
    {kPnIncrementParameter, "", "PN increment"},
    onBoth(kCellNamingParameter, "Names of cells allowed"),
    {kDistanceIntervalParameter, "Distance between sweeps (m)", "Code start (chips)"},
    {kIntervalKindParameter, "Interval (0 distance, 1 time)", "Code span (chips)"},
    onBoth(kSavedParameter, "Settings saved"),
    {PARM_AVERAGE_AS_LOG_POWER, "Averaging of (0 power, 1 log power)", ""},
};

}  // namespace

std::string_view settingName(PanelKind panel, std::int16_t code) noexcept {
  const auto* const row = std::find_if(std::begin(kNames), std::end(kNames),
                                       [code](const NameRow& one) { return one.code == code; });
  if (row == std::end(kNames)) return {};
  return panel == PanelKind::Spectrum ? row->spectrum : row->pilots;
}

std::string_view panelWord(PanelKind panel) noexcept { return kWords[static_cast<std::size_t>(panel)]; }

std::optional<PanelKind> panelOfWord(std::string_view text) noexcept {
  const std::string_view word = text.substr(0, text.find(' '));
  for (const PanelKind panel : {PanelKind::Spectrum, PanelKind::Pilots})
    if (word == panelWord(panel)) return panel;
  return std::nullopt;
}

}  // namespace frontpanels

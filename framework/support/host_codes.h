// The numbers that travel between host and panel. Names in the host's own spelling where it has one.
#pragma once

#include <cstdint>

namespace frontpanels {

// Operations of `vfpOp`.
inline constexpr std::int16_t QUILL_VFP_CLOSE = 1;
inline constexpr std::int16_t kSingleSweepOperation = 2;  // these three go from the panel to the host
inline constexpr std::int16_t kContinuousSweepOperation = 3;
inline constexpr std::int16_t kStopSweepOperation = 4;
inline constexpr std::int16_t QUILL_VFP_SAVE = 9;
inline constexpr std::int16_t kAddTraceOperation = 10;
inline constexpr std::int16_t kRemoveTraceOperation = 11;
inline constexpr std::int16_t kShowOperation = 12;
inline constexpr std::int16_t QUILL_VFP_SAVE_SETUP = 13;
inline constexpr std::int16_t kLoggingOnOperation = 14;
inline constexpr std::int16_t kPlaybackOperation = 15;
inline constexpr std::int16_t kDisplayStateOperation = 21;
// On the way from the base into a panel, an operation from here on is a playback operation, counted from 0.
inline constexpr std::int16_t kFirstPlaybackOperation = 16384;

// Items of the pop-up menu. The two that ask for a display state have numbers of their own.
inline constexpr std::int16_t kCloseItem = 1;
inline constexpr std::int16_t kSaveItem = 9;
inline constexpr std::int16_t kDisplayStateOnItem = 21;
inline constexpr std::int16_t kDisplayStateOffItem = 1002;
inline constexpr std::int16_t kRightPanelItem = 900;
inline constexpr std::int16_t kBottomPanelItem = 901;

// Parameter types of `vfpSet`.
inline constexpr std::int16_t kCenterFrequencyParameter = 13;
inline constexpr std::int16_t kSpanParameter = 14;
inline constexpr std::int16_t kRbwParameter = 16;
inline constexpr std::int16_t FREQ_FILTER = 17;  // the IF bandwidth, 1 narrow
inline constexpr std::int16_t TIME_MEASUREMENT_PERIOD = 43;
inline constexpr std::int16_t TIME_DATABASE_PERIOD = 44;
inline constexpr std::int16_t TIME_DISPLAY_PERIOD = 45;
inline constexpr std::int16_t kDisplayLengthParameter = 94;
inline constexpr std::int16_t PARM_MEASUREMENT_ID = 312;
inline constexpr std::int16_t kCaptionParameter = 314;
inline constexpr std::int16_t PARM_RESOURCE_ID = 315;
inline constexpr std::int16_t PARM_LOGGING_FLAG = 322;
inline constexpr std::int16_t kChannelizationParameter = 333;
inline constexpr std::int16_t kAverageTypeParameter = 500;
inline constexpr std::int16_t kAverageCountParameter = 502;
inline constexpr std::int16_t kLeftParameter = 700;
inline constexpr std::int16_t kTopParameter = 701;
inline constexpr std::int16_t kWidthParameter = 702;
inline constexpr std::int16_t kHeightParameter = 703;
inline constexpr std::int16_t PARM_WINDOW_STATE = 704;
inline constexpr std::int16_t kBottomPanelParameter = 705;
inline constexpr std::int16_t kRightPanelParameter = 706;
inline constexpr std::int16_t kXAxisStyleParameter = 714;
inline constexpr std::int16_t kVerticalResolutionParameter = 716;
inline constexpr std::int16_t kGridTopParameter = 717;
inline constexpr std::int16_t kYAxisStyleParameter = 719;
inline constexpr std::int16_t kAutoScaleParameter = 722;
inline constexpr std::int16_t kCaptionTextParameter = 726;
inline constexpr std::int16_t kVisibleParameter = 727;
inline constexpr std::int16_t kTraceParameter = 735;
inline constexpr std::int16_t kTraceValueParameter = 736;
inline constexpr std::int16_t kSelectTraceParameter = 737;
inline constexpr std::int16_t kNewMarkerParameter = 740;
inline constexpr std::int16_t kMarkerFlagParameter = 741;
inline constexpr std::int16_t kActiveMarkerParameter = 742;
inline constexpr std::int16_t kAttachMarkerParameter = 743;
inline constexpr std::int16_t kMarkerValueParameter = 744;
inline constexpr std::int16_t kUnitsParameter = 750;  // 0 channels, else frequencies
inline constexpr std::int16_t kCellNamingParameter = 799;
inline constexpr std::int16_t kDistanceIntervalParameter = 803;
inline constexpr std::int16_t kIntervalKindParameter = 804;  // 0 distance, else time
inline constexpr std::int16_t kSavedParameter = 810;
inline constexpr std::int16_t PARM_AVERAGE_AS_LOG_POWER = 3900;  // 0 power, else log power

// Those of the pilot panel: some numbers mean one thing there and another on the spectrum panel.
inline constexpr std::int16_t CDMA_CODE_OFFSET = 230;
inline constexpr std::int16_t kCodeFormatParameter = 500;
inline constexpr std::int16_t kCodeCenterParameter = 502;
inline constexpr std::int16_t kPowerDisplayParameter = 728;
inline constexpr std::int16_t kSortModeParameter = 729;
inline constexpr std::int16_t kSortOrderParameter = 730;
inline constexpr std::int16_t kBarLabelParameter = 731;
inline constexpr std::int16_t kThresholdParameter = 732;
inline constexpr std::int16_t kTopNSetParameter = 750;
inline constexpr std::int16_t kUserListSetParameter = 751;
inline constexpr std::int16_t kBarChartStyleParameter = 775;
inline constexpr std::int16_t kShowCellNameParameter = 776;
inline constexpr std::int16_t kPnIncrementParameter = 780;
inline constexpr std::int16_t kCodeStartParameter = 803;
inline constexpr std::int16_t kCodeSpanParameter = 804;

// Answers of the entry points.
inline constexpr std::int32_t kStatusDone = 0;
inline constexpr std::int32_t kStatusUnknownOperation = -1;
inline constexpr std::int32_t kStatusUnusableParameter = -8;

}  // namespace frontpanels

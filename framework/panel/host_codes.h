// The numbers that travel between host and panel. Names in the host's own spelling where it has one.
#pragma once

#include <cstdint>

namespace frontpanels {

// Operations of `vfpOp`.
inline constexpr std::int16_t QUILL_VFP_CLOSE = 1;
inline constexpr std::int16_t kAddTraceOperation = 10;
inline constexpr std::int16_t kRemoveTraceOperation = 11;
inline constexpr std::int16_t kShowOperation = 12;

// Parameter types of `vfpSet`.
inline constexpr std::int16_t kCenterFrequencyParameter = 13;
inline constexpr std::int16_t kSpanParameter = 14;
inline constexpr std::int16_t TIME_MEASUREMENT_PERIOD = 43;
inline constexpr std::int16_t TIME_DATABASE_PERIOD = 44;
inline constexpr std::int16_t TIME_DISPLAY_PERIOD = 45;
inline constexpr std::int16_t PARM_MEASUREMENT_ID = 312;
inline constexpr std::int16_t kCaptionParameter = 314;
inline constexpr std::int16_t PARM_RESOURCE_ID = 315;
inline constexpr std::int16_t kXAxisStyleParameter = 714;
inline constexpr std::int16_t kVerticalResolutionParameter = 716;
inline constexpr std::int16_t kGridTopParameter = 717;
inline constexpr std::int16_t kYAxisStyleParameter = 719;
inline constexpr std::int16_t kAutoScaleParameter = 722;

// Answers of the entry points.
inline constexpr std::int32_t kStatusDone = 0;
inline constexpr std::int32_t kStatusUnknownOperation = -1;
inline constexpr std::int32_t kStatusUnusableParameter = -8;

}  // namespace frontpanels

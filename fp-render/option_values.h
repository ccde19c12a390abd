// What the values of fp-render's options mean. Each function answers nothing for a text that it cannot take.
#pragma once

#include <array>
#include <cstdint>
#include <limits>
#include <optional>
#include <string_view>

#include "hosting/setting_names.h"
#include "hosting/stored_setting.h"
#include "pilot/pilot_sets.h"
#include "platform/geometry.h"

namespace frontpanels {

// By PilotSet.
using ShownSets = std::array<bool, kPilotSets>;

// Frames by number, the ends included.
struct FrameRange {
  std::uint64_t first = 1;
  std::optional<std::uint64_t> last;  // to the end when absent
  friend bool operator==(const FrameRange&, const FrameRange&) = default;
};

inline constexpr Size kSmallestPicturePx = {200, 150};
inline constexpr Size kLargestPicturePx = {7680, 4320};

// A whole number, digits alone.
[[nodiscard]] std::optional<std::uint64_t> countOf(
    std::string_view text, std::uint64_t least = 1,
    std::uint64_t most = std::numeric_limits<std::uint64_t>::max());
[[nodiscard]] std::optional<Size> pictureSizeOf(std::string_view text);       // "800x600"
[[nodiscard]] std::optional<FrameRange> frameRangeOf(std::string_view text);  // "5", "5-9", "5-", "-9"
[[nodiscard]] std::optional<PanelKind> panelKindOf(std::string_view text);    // "spectrum" or "pilots"
[[nodiscard]] std::optional<ShownSets> pilotSetsOf(std::string_view text);    // "all,top"
// A setting as a host sends it: "716=5", "230,-1=12". What reads as a number is one.
[[nodiscard]] std::optional<StoredSetting> settingOf(std::string_view text);

// Numbers as the fields of the panels take them, with a unit or the beginning of one. Without a unit they are
// hertz, PN offsets, decibels.
[[nodiscard]] std::optional<double> frequencyHzOf(std::string_view text);  // not below 0
[[nodiscard]] std::optional<double> pnOffsetOf(std::string_view text);     // 0 to 511
[[nodiscard]] std::optional<double> levelDbOf(std::string_view text);

}  // namespace frontpanels

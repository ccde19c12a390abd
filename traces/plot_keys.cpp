#include "traces/plot_keys.h"

#include <algorithm>
#include <iterator>

namespace frontpanels {
namespace {

constexpr std::int16_t kPlain = 0;
constexpr std::int16_t kShift = 1;
constexpr std::int16_t kCtrl = 2;
constexpr std::int16_t kAny = -1;  // whatever is held, unless a row above says otherwise

constexpr std::int16_t kTab = 9;
constexpr std::int16_t kEscape = 27;
constexpr std::int16_t kEnd = 35;
constexpr std::int16_t kHome = 36;
constexpr std::int16_t kLeft = 37;
constexpr std::int16_t kUp = 38;
constexpr std::int16_t kRight = 39;
constexpr std::int16_t kDown = 40;
constexpr std::int16_t kPadPlus = 107;
constexpr std::int16_t kPadMinus = 109;
constexpr std::int16_t kPlus = 187;  // on some keyboards it takes Shift to make it a plus
constexpr std::int16_t kMinus = 189;

struct KeyRow {
  std::int16_t keyCode;
  std::int16_t shift;
  PlotCommand command;
};

using enum PlotCommand;

constexpr KeyRow kKeys[] = {
    {kLeft, kCtrl, MarkerTenthLeft},  {kRight, kCtrl, MarkerTenthRight},   {kLeft, kAny, MarkerLeft},
    {kRight, kAny, MarkerRight},      {kHome, kPlain, MarkerToFirstPoint}, {kEnd, kPlain, MarkerToLastPoint},
    {'P', kPlain, MarkerToMax},       {'N', kPlain, MarkerToLowerPeak},    {'N', kShift, MarkerToHigherPeak},
    {'D', kPlain, SwitchDelta},       {'C', kPlain, MarkerToCenter},       {kTab, kPlain, NextMarker},
    {kTab, kShift, PreviousMarker},   {kDown, kPlain, NextTrace},          {kUp, kPlain, PreviousTrace},
    {kPadPlus, kPlain, WidenScale},   {kPlus, kPlain, WidenScale},         {kPlus, kShift, WidenScale},
    {kPadMinus, kPlain, NarrowScale}, {kMinus, kPlain, NarrowScale},       {kEscape, kPlain, TakeMarkerBack},
};

}  // namespace

std::optional<PlotCommand> plotCommandOf(std::int16_t keyCode, std::int16_t shift) noexcept {
  const auto* const row = std::find_if(std::begin(kKeys), std::end(kKeys), [&](const KeyRow& key) {
    return key.keyCode == keyCode && (key.shift == kAny || key.shift == shift);
  });
  if (row == std::end(kKeys)) return std::nullopt;
  return row->command;
}

}  // namespace frontpanels

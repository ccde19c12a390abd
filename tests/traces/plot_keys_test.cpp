#include "traces/plot_keys.h"

#include <gtest/gtest.h>

namespace frontpanels::testing {
namespace {

using enum PlotCommand;

TEST(PlotKeys, EachKeyAsksForItsCommandWithWhatIsHeldAndALetterWithCtrlOrAltForNone) {
  struct Row {
    std::int16_t keyCode;
    std::int16_t shift;  // 1 Shift, 2 Ctrl, 4 Alt
    std::optional<PlotCommand> command;
  };
  const Row rows[] = {{37, 0, MarkerLeft},        {37, 1, MarkerLeft},         {37, 2, MarkerTenthLeft},
                      {39, 0, MarkerRight},       {39, 2, MarkerTenthRight},   {36, 0, MarkerToFirstPoint},
                      {35, 0, MarkerToLastPoint}, {36, 2, std::nullopt},       {'P', 0, MarkerToMax},
                      {'P', 2, std::nullopt},     {'N', 0, MarkerToLowerPeak}, {'N', 1, MarkerToHigherPeak},
                      {'N', 4, std::nullopt},     {'D', 0, SwitchDelta},       {'C', 0, MarkerToCenter},
                      {'C', 2, std::nullopt},     {'C', 4, std::nullopt},      {9, 0, NextMarker},
                      {9, 1, PreviousMarker},     {9, 2, std::nullopt},        {40, 0, NextTrace},
                      {38, 0, PreviousTrace},     {107, 0, WidenScale},        {187, 1, WidenScale},
                      {109, 0, NarrowScale},      {189, 0, NarrowScale},       {27, 0, TakeMarkerBack},
                      {'A', 0, std::nullopt},     {13, 0, std::nullopt},       {0, 0, std::nullopt}};
  for (const Row& row : rows)
    EXPECT_EQ(plotCommandOf(row.keyCode, row.shift), row.command) << row.keyCode << " with " << row.shift;
}

}  // namespace
}  // namespace frontpanels::testing

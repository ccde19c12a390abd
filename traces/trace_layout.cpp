#include "traces/trace_layout.h"

namespace frontpanels {
namespace {

constexpr double kActiveShare = 60.0 / 100.0;
constexpr double kSmallShare = 40.0 / 100.0;

float shareOf(float height, double share) noexcept {
  return static_cast<float>(static_cast<double>(height) * share);
}

}  // namespace

float smallRowHeight(float height) noexcept { return shareOf(height, kSmallShare); }

PanelArea activePanelArea(float numberOfTraces, float width, float height) noexcept {
  if (numberOfTraces == 1.0F) return {0, 0, width, height};
  return {0, smallRowHeight(height), width, shareOf(height, kActiveShare)};
}

PanelArea smallPanelArea(std::int16_t position, float numberOfTraces, float width, float height) noexcept {
  const float panelWidth = width / (numberOfTraces - 1.0F);
  return {static_cast<float>(position) * panelWidth, 0, panelWidth, smallRowHeight(height)};
}

}  // namespace frontpanels

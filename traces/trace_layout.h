// Where the panels of a display area go. Pixels of the off-screen surface, single precision throughout.
#pragma once

#include <cstdint>

namespace frontpanels {

struct PanelArea {
  float left = 0;
  float top = 0;
  float width = 0;
  float height = 0;
  friend bool operator==(const PanelArea&, const PanelArea&) = default;

  // Edges do not belong to the panel.
  [[nodiscard]] bool contains(float x, float y) const noexcept {
    return x > left && x < left + width && y > top && y < top + height;
  }
};

// Height of the row of small panels above the active one.
[[nodiscard]] float smallRowHeight(float height) noexcept;

// One trace object fills the surface; with more, the active one takes the lower 60 %.
[[nodiscard]] PanelArea activePanelArea(float numberOfTraces, float width, float height) noexcept;

// The `position`-th (from 0) of the panels that share the upper 40 % side by side.
[[nodiscard]] PanelArea smallPanelArea(std::int16_t position, float numberOfTraces, float width,
                                       float height) noexcept;

}  // namespace frontpanels

// What a panel's window tells the panel, and the control round it.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "framework/panel/pop_up_menu.h"
#include "platform/geometry.h"
#include "platform/windowing.h"
#include "traces/graph_items.h"

namespace frontpanels::activex {

// A press, move or release. Button 1 is left, 2 right, 4 middle; shift has 1 for Shift, 2 for Ctrl, 4 for
// Alt; twips.
struct MouseEvent {
  std::int16_t button = 0;
  std::int16_t shift = 0;
  float xTwips = 0;
  float yTwips = 0;
};

class PanelEvents {
 public:
  virtual ~PanelEvents() = default;

  virtual void paint() = 0;
  // What paint covers, in pixels of the view; the rest is background.
  [[nodiscard]] virtual Rect paintedAreaPx() = 0;
  // The off-screen surface whose picture lies there.
  [[nodiscard]] virtual DcHandle surface() = 0;
  // The part of the view that the areas with the fields leave to the graph, from its left upper corner on.
  [[nodiscard]] virtual Size graphSizePx() = 0;
  virtual void resized() = 0;
  // The view is on a screen of another scale; its size may be another as well.
  virtual void rescaled(ScreenMetrics metrics) = 0;
  virtual void mouseDown(const MouseEvent& event) = 0;
  virtual void mouseMove(const MouseEvent& event) = 0;
  virtual void mouseUp(const MouseEvent& event) = 0;
  // Whether the graph has a use for the key, and the key itself with the same answer.
  [[nodiscard]] virtual bool usesKey(std::int16_t keyCode, std::int16_t shift) = 0;
  virtual bool keyDown(std::int16_t keyCode, std::int16_t shift) = 0;
  // The graph's own menu, empty for none.
  [[nodiscard]] virtual std::vector<PanelMenuItem> contextMenu() = 0;
  virtual void contextMenuClick(std::int16_t id) = 0;
  // What the user did has had its effect.
  virtual void settled() = 0;
  // What the graph shows, in words, with places in pixels of the view; and what is told of it as it happens.
  [[nodiscard]] virtual GraphItems graphItems() = 0;
  [[nodiscard]] virtual GraphState graphState() = 0;
  // What the panel is called: its caption, else what its class is.
  [[nodiscard]] virtual std::string title() = 0;
};

}  // namespace frontpanels::activex

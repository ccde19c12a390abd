// The items of a graph as lines of text: "Marker 1: 98.1 MHz, -43.2 dBm (64,79 9x13) selected".
#pragma once

#include <string>

#include "traces/graph_items.h"

namespace frontpanels::testing {

[[nodiscard]] inline std::string listed(const GraphItems& items) {
  std::string text;
  for (const GraphItem& item : items.all()) {
    const Rect& at = item.placePx;
    text += item.name + ": " + item.value + " (" + std::to_string(at.left) + "," + std::to_string(at.top) +
            " " + std::to_string(at.width()) + "x" + std::to_string(at.height()) + ")";
    text += item.selected ? " selected" : "";
    text += item.visible ? "\n" : " unseen\n";
  }
  return text;
}

}  // namespace frontpanels::testing

// MarkerCommands: what the marker buttons of a panel do. Each works on the active trace where that is a
// clsMultiTracePainter. Without a trace there is nothing to mark, without a marker nothing to move: no
// report.
#pragma once

#include <string>
#include <string_view>

#include "painters/multi_trace_painter.h"
#include "platform/control_set.h"
#include "traces/trace_manager.h"

namespace frontpanels {

class MarkerCommands {
 public:
  // Both must outlive the commands; `typeName`, a literal, is the panel that reports name.
  MarkerCommands(clsTraceManager& traces, ControlSet& controls, std::string_view typeName) noexcept
      : traces_(traces), controls_(controls), typeName_(typeName) {}

  // A marker on the selected trace.
  void addMarker();
  // A marker has one delta marker, and that has none.
  void addDeltaMarker();
  // The active marker, with its delta marker.
  void deleteMarker();
  void markerToMax() { move(&clsTraceManager::markerToMax); }
  void markerToMin() { move(&clsTraceManager::markerToMin); }
  // Enables the buttons that need a marker, as far as the panel has them, exactly when the active trace has
  // one: MarkerDeleteButton, MarkerDeltaButton, MarkerToMaxButton, and MarkerToCenterButton, which the panel
  // may then still take away.
  void updateMarkerButtons();

  // The active trace, null when it is none that has these markers.
  [[nodiscard]] clsMultiTracePainter* activePainter() const;

 private:
  [[nodiscard]] std::string named(const char* routine) const;
  [[nodiscard]] MarkerPointer activeMarker() const;
  void move(void (clsTraceManager::*toExtreme)());

  clsTraceManager& traces_;
  ControlSet& controls_;
  std::string_view typeName_;
};

}  // namespace frontpanels

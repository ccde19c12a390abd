// MarkerCommands: what the marker buttons of a panel do, and the keys of its graph. Each works on the active
// trace where that is a clsMultiTracePainter. Without a trace there is nothing to mark, without a marker
// nothing to move: no report.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "painters/multi_trace_painter.h"
#include "platform/control_set.h"
#include "traces/plot_keys.h"
#include "traces/trace_manager.h"

namespace frontpanels {

class MarkerCommands final : public PlotCommands {
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

  // Keys, as far as they are no button's. What moves a marker needs an active one, what a button does as well
  // needs that button enabled. Markers follow each other trace by trace, by their numbers, each with its
  // delta marker behind it; traces as they were added, those of one display after those of another.
  bool canRun(PlotCommand command) override;
  void run(PlotCommand command) override;

  // The active trace, null when it is none that has these markers.
  [[nodiscard]] clsMultiTracePainter* activePainter() const;

 private:
  struct KeyRow;
  static const KeyRow kKeys[];
  [[nodiscard]] static const KeyRow* findKey(PlotCommand command) noexcept;
  struct Place {
    std::int16_t trace = 0;
    MarkerPointer marker;
  };

  [[nodiscard]] bool hasMarker() const;
  [[nodiscard]] bool hasActiveMarker() const { return activeMarker() != nullptr; }
  [[nodiscard]] bool hasSeveralTraces() const;
  [[nodiscard]] bool mayFindPeaks() const { return hasActiveMarker() && enabled("MarkerToMaxButton"); }
  [[nodiscard]] bool maySwitchDelta() const;
  [[nodiscard]] bool enabled(const char* button) const;
  [[nodiscard]] std::vector<Place> markersInOrder() const;
  [[nodiscard]] Place neighbour(bool behind) const;
  template <class Step>
  void step(Step step);
  void switchDelta();
  void chooseNeighbour(bool behind);
  void chooseTrace(bool behind);

  [[nodiscard]] std::string named(const char* routine) const;
  [[nodiscard]] MarkerPointer activeMarker() const;
  void move(void (clsTraceManager::*toExtreme)());

  clsTraceManager& traces_;
  ControlSet& controls_;
  std::string_view typeName_;
};

}  // namespace frontpanels

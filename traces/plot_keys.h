// What the keyboard asks of a graph that has the focus. Which keys are the graph's is written here alone.
#pragma once

#include <cstdint>
#include <optional>

namespace frontpanels {

enum class PlotCommand : std::uint8_t {
  MarkerLeft,
  MarkerRight,
  MarkerTenthLeft,
  MarkerTenthRight,
  MarkerToFirstPoint,
  MarkerToLastPoint,
  MarkerToMax,
  MarkerToLowerPeak,
  MarkerToHigherPeak,
  SwitchDelta,
  MarkerToCenter,
  NextMarker,
  PreviousMarker,
  NextTrace,
  PreviousTrace,
  WidenScale,
  NarrowScale,
  TakeMarkerBack
};

// Key codes are those of key messages; `shift` has 1 for Shift, 2 for Ctrl, 4 for Alt. Nothing for a key that
// is not the graph's.
[[nodiscard]] std::optional<PlotCommand> plotCommandOf(std::int16_t keyCode, std::int16_t shift) noexcept;

// Whoever runs commands. One that cannot run now does nothing, and its key is free for others.
class PlotCommands {
 public:
  virtual ~PlotCommands() = default;

  [[nodiscard]] virtual bool canRun(PlotCommand command) = 0;
  virtual void run(PlotCommand command) = 0;
};

}  // namespace frontpanels

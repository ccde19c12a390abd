// The owning panel as the trace manager sees it.
#pragma once

#include <cstdint>
#include <string>

#include "framework/support/drawing_surface.h"

namespace frontpanels {

class TraceObject;

// What changedTraceConfiguration tells the panel.
enum class TraceState : std::int16_t { Added = 1, Removed = 2 };

class TraceForm : public DrawingSurface {
 public:
  // The panel's class name, where behaviour depends on it.
  [[nodiscard]] virtual std::string typeName() = 0;
  [[nodiscard]] virtual std::int16_t winState() = 0;
  // `activeTrace` is null when no trace is left, or when a listed result type cleared it.
  virtual void changedTraceConfiguration(TraceState state, TraceObject* activeTrace,
                                         std::int16_t resultType) = 0;
  virtual void setMarkerFrameColor(Color color) = 0;
  virtual void deltaMarkerButtonEnabled(bool enable) = 0;
  // The graph has been composed anew and is on the screen.
  virtual void tracesPainted() {}
};

}  // namespace frontpanels

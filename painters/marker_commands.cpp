#include "painters/marker_commands.h"

#include "framework/support/guard.h"

namespace frontpanels {
namespace {

constexpr const char* kNeedAMarker[] = {"MarkerDeleteButton", "MarkerDeltaButton", "MarkerToMaxButton",
                                        "MarkerToCenterButton"};

}  // namespace

std::string MarkerCommands::named(const char* routine) const {
  return std::string(typeName_).append("::").append(routine);
}

clsMultiTracePainter* MarkerCommands::activePainter() const {
  return dynamic_cast<clsMultiTracePainter*>(traces_.activeTrace());
}

MarkerPointer MarkerCommands::activeMarker() const {
  const clsMultiTracePainter* const painter = activePainter();
  return painter == nullptr ? nullptr : painter->activeMarker();
}

void MarkerCommands::addMarker() {
  guard([this] { return named("addMarker() ... "); },
        [this] {
          const clsMultiTracePainter* const painter = activePainter();
          if (painter == nullptr || painter->numberOfTraces() == 0) return;
          traces_.addMarker(painter->traceId(painter->selectedTraceIndex()));
          updateMarkerButtons();
        });
}

void MarkerCommands::addDeltaMarker() {
  guard([this] { return named("addDeltaMarker() ... "); },
        [this] {
          const MarkerPointer marker = activeMarker();
          if (marker != nullptr && marker->deltaPartner.empty()) traces_.addDeltaMarker();
        });
}

void MarkerCommands::deleteMarker() {
  guard([this] { return named("MarkerDeleteButton_Click() ... "); },
        [this] {
          if (activeMarker() == nullptr) return;
          activePainter()->deleteActiveMarker();
          updateMarkerButtons();
          traces_.paintTraces(true);
        });
}

void MarkerCommands::move(void (clsTraceManager::*toExtreme)()) {
  if (activeMarker() != nullptr) (traces_.*toExtreme)();
}

void MarkerCommands::updateMarkerButtons() {
  guard([this] { return named("updateMarkerButtons() . . ."); },
        [this] {
          TraceObject* const active = traces_.activeTrace();
          const bool any = active != nullptr && !active->markerCollection().empty();
          for (const char* const name : kNeedAMarker)
            if (Control* const button = controls_.find(name)) button->Enabled(any);
        });
}

}  // namespace frontpanels

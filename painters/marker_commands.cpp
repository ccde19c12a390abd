#include "painters/marker_commands.h"

#include <algorithm>
#include <iterator>
#include <tuple>

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

// --- Keys

struct MarkerCommands::KeyRow {
  PlotCommand command;
  bool (*possible)(const MarkerCommands& commands);
  void (*run)(MarkerCommands& commands);
};

using Commands = MarkerCommands;
using enum PlotCommand;

const MarkerCommands::KeyRow MarkerCommands::kKeys[] = {
    {MarkerLeft, [](const Commands& on) { return on.hasMarker(); },
     [](Commands& on) { on.traces_.moveMarkerLeft(); }},
    {MarkerRight, [](const Commands& on) { return on.hasMarker(); },
     [](Commands& on) { on.traces_.moveMarkerRight(); }},
    {MarkerTenthLeft, [](const Commands& on) { return on.hasActiveMarker(); },
     [](Commands& on) { on.step([](auto& painter) { painter.moveActiveMarkerATenth(Towards::Left); }); }},
    {MarkerTenthRight, [](const Commands& on) { return on.hasActiveMarker(); },
     [](Commands& on) { on.step([](auto& painter) { painter.moveActiveMarkerATenth(Towards::Right); }); }},
    {MarkerToFirstPoint, [](const Commands& on) { return on.hasActiveMarker(); },
     [](Commands& on) { on.step([](auto& painter) { painter.activeMarkerToEnd(TraceEnd::First); }); }},
    {MarkerToLastPoint, [](const Commands& on) { return on.hasActiveMarker(); },
     [](Commands& on) { on.step([](auto& painter) { painter.activeMarkerToEnd(TraceEnd::Last); }); }},
    {MarkerToLowerPeak, [](const Commands& on) { return on.mayFindPeaks(); },
     [](Commands& on) { on.step([](auto& painter) { painter.activeMarkerToPeak(PeakOrder::Lower); }); }},
    {MarkerToHigherPeak, [](const Commands& on) { return on.mayFindPeaks(); },
     [](Commands& on) { on.step([](auto& painter) { painter.activeMarkerToPeak(PeakOrder::Higher); }); }},
    {SwitchDelta, [](const Commands& on) { return on.maySwitchDelta(); },
     [](Commands& on) { on.switchDelta(); }},
    {NextMarker, [](const Commands& on) { return on.neighbour(true).marker != nullptr; },
     [](Commands& on) { on.chooseNeighbour(true); }},
    {PreviousMarker, [](const Commands& on) { return on.neighbour(false).marker != nullptr; },
     [](Commands& on) { on.chooseNeighbour(false); }},
    {NextTrace, [](const Commands& on) { return on.hasSeveralTraces(); },
     [](Commands& on) { on.chooseTrace(true); }},
    {PreviousTrace, [](const Commands& on) { return on.hasSeveralTraces(); },
     [](Commands& on) { on.chooseTrace(false); }},
    {TakeMarkerBack, [](const Commands& on) { return on.traces_.holdsMarker(); },
     [](Commands& on) { on.traces_.takeMarkerBack(); }},
};

const MarkerCommands::KeyRow* MarkerCommands::findKey(PlotCommand command) noexcept {
  const auto* const row = std::find_if(std::begin(kKeys), std::end(kKeys),
                                       [command](const KeyRow& key) { return key.command == command; });
  return row == std::end(kKeys) ? nullptr : row;
}

bool MarkerCommands::canRun(PlotCommand command) {
  const KeyRow* const row = findKey(command);
  return row != nullptr && row->possible(*this);
}

void MarkerCommands::run(PlotCommand command) {
  guard([this] { return named("run() ... "); },
        [&] {
          if (canRun(command)) findKey(command)->run(*this);
        });
}

bool MarkerCommands::hasMarker() const {
  TraceObject* const active = traces_.activeTrace();
  return active != nullptr && !active->markerCollection().empty();
}

bool MarkerCommands::hasSeveralTraces() const {
  const TraceObject* const active = traces_.activeTrace();
  return active != nullptr && (active->numberOfTraces() > 1 || traces_.Traces().count() > 1);
}

bool MarkerCommands::enabled(const char* button) const {
  const Control* const control = controls_.find(button);
  return control != nullptr && control->reallyEnabled();
}

bool MarkerCommands::maySwitchDelta() const {
  const MarkerPointer marker = activeMarker();
  if (marker == nullptr) return false;
  return enabled(marker->deltaPartner.empty() ? "MarkerDeltaButton" : "MarkerDeleteButton");
}

template <class Step>
void MarkerCommands::step(Step step) {
  step(*activePainter());
  traces_.paintTraces(true);
}

// Off, the delta marker goes and the one that it was measured from is the active one.
void MarkerCommands::switchDelta() {
  const MarkerPointer marker = activeMarker();
  if (marker->deltaPartner.empty()) return addDeltaMarker();
  clsMultiTracePainter& painter = *activePainter();
  const MarkerPointer partner = painter.partnerOf(*marker);
  if (!marker->DELTA) painter.activeMarker(partner);
  painter.deleteActiveMarker();
  if (const MarkerPointer left = marker->DELTA ? partner : marker) painter.activeMarker(left);
  updateMarkerButtons();
  traces_.paintTraces(true);
}

std::vector<MarkerCommands::Place> MarkerCommands::markersInOrder() const {
  std::vector<Place> places;
  clsMultiTracePainter* const painter = activePainter();
  for (std::int16_t trace = 0; painter != nullptr && trace < painter->numberOfTraces(); ++trace)
    for (const MarkerPointer& marker : painter->traceMarkerCollections(trace))
      places.push_back({trace, marker});
  // The collections are in the order in which markers were chosen. Of two numbers the longer is the larger.
  const auto order = [](const Place& place) {
    const clsMarker& marker = *place.marker;
    const std::string& number = marker.DELTA ? marker.deltaPartner : marker.id;
    return std::tuple(place.trace, number.size(), std::string_view(number), marker.DELTA);
  };
  std::sort(places.begin(), places.end(),
            [&order](const Place& one, const Place& other) { return order(one) < order(other); });
  return places;
}

MarkerCommands::Place MarkerCommands::neighbour(bool behind) const {
  const std::vector<Place> places = markersInOrder();
  if (places.size() < 2) return {};
  const MarkerPointer active = activeMarker();
  if (active == nullptr) return behind ? places.front() : places.back();
  const auto found = std::find_if(places.begin(), places.end(),
                                  [&active](const Place& place) { return place.marker == active; });
  if (found == places.end() || (behind ? found + 1 == places.end() : found == places.begin())) return {};
  return *(behind ? found + 1 : found - 1);
}

void MarkerCommands::chooseNeighbour(bool behind) {
  const Place place = neighbour(behind);
  clsMultiTracePainter& painter = *activePainter();
  painter.selectedTraceIndex(place.trace);
  painter.activeMarker(place.marker);
  traces_.makeFirstMarker(place.marker);
  updateMarkerButtons();
  traces_.paintTraces(true);
}

// The active marker is one of the selected trace, or none.
void MarkerCommands::chooseTrace(bool behind) {
  TraceObject& active = *traces_.activeTrace();
  const std::int32_t next = active.selectedTraceIndex() + (behind ? 1 : -1);
  if (next < 0 || next >= active.numberOfTraces()) {
    traces_.activateNeighbour(behind);
  } else {
    active.selectedTraceIndex(static_cast<std::int16_t>(next));
    const MarkerCollection& markers = active.markerCollection();
    active.activeMarker(markers.empty() ? nullptr : markers.item(std::size_t{1}));
  }
  updateMarkerButtons();
  traces_.paintTraces(true);
}

}  // namespace frontpanels

#include "activex/tarvex_control.h"

#include <algorithm>
#include <array>
#include <iterator>
#include <string>

#include "activex/cell_name_object.h"
#include "platform/runtime_error.h"

namespace frontpanels::activex {
namespace {

constexpr ControlClass kClass{&CLSID_Tarvex, &IID_ITarvex, &DIID__ITarvexEvents, L"Front Panels Tarvex"};

// The paths that are kept with the form, in the order of PilotServer.
struct PathsRow {
  const wchar_t* name;
  DISPID id;
};
constexpr std::array<PathsRow, kPilotServers> kPaths{{{L"DfiAllPilots", 106},
                                                      {L"DfiZoomedPilots", 107},
                                                      {L"DfiPilotTopNMultipath", 108},
                                                      {L"DfiPilotListMultipath", 109},
                                                      {L"DfiCarrier", 110}}};

constexpr std::size_t kAreas = std::size(kStoredAreas);
using Stored = std::array<StoredProperty, kAreas + kPilotServers>;

Stored stored() {
  Stored properties;
  std::copy(std::begin(kStoredAreas), std::end(kStoredAreas), properties.begin());
  for (std::size_t i = 0; i < kPilotServers; ++i)
    properties[kAreas + i] = {kPaths[i].name, pilotServers()[i].paths};
  return properties;
}

PilotServer serverOf(std::size_t property) { return static_cast<PilotServer>(property - kAreas); }

}  // namespace

TarvexControl::TarvexControl(IUnknown* outer)
    : FrontPanelControl(outer, kClass,
                        PilotServices{services().fileDialogs, systemTextFiles(), services().separators}) {}

// --- Data

HRESULT TarvexControl::giveSingles(VARIANT* array, std::span<const float> (Tarvex::*data)() const) {
  return give(array, [&] {
    const std::span<const float> values = (panel().*data)();
    return toAutomation(Variant::Singles(values.begin(), values.end()));
  });
}

HRESULT TarvexControl::get_AllPilotsData(VARIANT* levels) {
  return giveSingles(levels, &Tarvex::AllPilotsData);
}
HRESULT TarvexControl::get_ZoomedPilotsData(VARIANT* levels) {
  return giveSingles(levels, &Tarvex::ZoomedPilotsData);
}
HRESULT TarvexControl::get_TopNData(VARIANT* records) { return giveSingles(records, &Tarvex::TopNData); }
HRESULT TarvexControl::get_UserListData(VARIANT* records) {
  return giveSingles(records, &Tarvex::UserListData);
}

HRESULT TarvexControl::get_UpdateCount(short* updates) {
  return give(updates, [&] { return panel().updateCount(); });
}

// --- Names

HRESULT TarvexControl::get_CellNameInfo(IDispatch** cells) {
  return give(cells, [&] {
    if (cells_) cells_->AddRef();
    return cells_.get();
  });
}

HRESULT TarvexControl::put_CellNameInfo(IDispatch* cells) { return putref_CellNameInfo(cells); }

HRESULT TarvexControl::putref_CellNameInfo(IDispatch* cells) {
  return perform([&] {
    const auto names = cellNamesOf(cells);
    if (cells != nullptr && names == nullptr) raiseTypeMismatch();
    panel().CellNameInfo(names);
    cells_ = ComPointer<IDispatch>(cells);
  });
}

// --- Paths

HRESULT TarvexControl::givePaths(BSTR* paths, PilotServer server) {
  return give(paths, [&] { return toBstr(panel().paths(server)); });
}

HRESULT TarvexControl::takePaths(BSTR paths, PilotServer server) {
  return perform([&] {
    panel().paths(server, fromBstr(paths));
    propertyChanged(kPaths[static_cast<std::size_t>(server)].id);
  });
}

HRESULT TarvexControl::get_DfiAllPilots(BSTR* paths) { return givePaths(paths, PilotServer::AllPilots); }
HRESULT TarvexControl::put_DfiAllPilots(BSTR paths) { return takePaths(paths, PilotServer::AllPilots); }
HRESULT TarvexControl::get_DfiZoomedPilots(BSTR* paths) {
  return givePaths(paths, PilotServer::ZoomedPilots);
}
HRESULT TarvexControl::put_DfiZoomedPilots(BSTR paths) { return takePaths(paths, PilotServer::ZoomedPilots); }
HRESULT TarvexControl::get_DfiPilotTopNMultipath(BSTR* paths) { return givePaths(paths, PilotServer::TopN); }
HRESULT TarvexControl::put_DfiPilotTopNMultipath(BSTR paths) { return takePaths(paths, PilotServer::TopN); }
HRESULT TarvexControl::get_DfiPilotListMultipath(BSTR* paths) {
  return givePaths(paths, PilotServer::UserList);
}
HRESULT TarvexControl::put_DfiPilotListMultipath(BSTR paths) {
  return takePaths(paths, PilotServer::UserList);
}
HRESULT TarvexControl::get_DfiCarrier(BSTR* paths) { return givePaths(paths, PilotServer::Carrier); }
HRESULT TarvexControl::put_DfiCarrier(BSTR paths) { return takePaths(paths, PilotServer::Carrier); }

// --- What is kept with the form

std::span<const StoredProperty> TarvexControl::storedProperties() const {
  static const Stored properties = stored();
  return properties;
}

Variant TarvexControl::storedValue(std::size_t property) const {
  if (property < kAreas) return FrontPanelControl::storedValue(property);
  return panel().paths(serverOf(property));
}

void TarvexControl::storedValue(std::size_t property, const Variant& value) {
  if (property < kAreas) return FrontPanelControl::storedValue(property, value);
  panel().paths(serverOf(property), value.toText());
}

}  // namespace frontpanels::activex

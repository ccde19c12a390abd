#include "activex/connections_part.h"

#include <oleauto.h>
#include <olectl.h>

#include <algorithm>

#include "activex/barrier.h"
#include "activex/enumerators.h"

namespace frontpanels::activex {

// --- The connection point

bool EventConnectionPoint::connected(DWORD cookie) const noexcept {
  return std::any_of(connections_.begin(), connections_.end(),
                     [cookie](const Connection& connection) { return connection.cookie == cookie; });
}

HRESULT EventConnectionPoint::QueryInterface(REFIID id, void** object) {
  if (object == nullptr) return E_POINTER;
  *object = id == IID_IUnknown || id == IID_IConnectionPoint ? static_cast<IConnectionPoint*>(this) : nullptr;
  if (*object == nullptr) return E_NOINTERFACE;
  AddRef();
  return S_OK;
}

HRESULT EventConnectionPoint::GetConnectionInterface(IID* id) {
  if (id == nullptr) return E_POINTER;
  *id = *core_.controlClass().eventInterface;
  return S_OK;
}

HRESULT EventConnectionPoint::GetConnectionPointContainer(IConnectionPointContainer** container) {
  if (container == nullptr) return E_POINTER;
  return core_.outer()->QueryInterface(IID_IConnectionPointContainer, reinterpret_cast<void**>(container));
}

// A sink answers for the event interface, or for plain dispatch only.
HRESULT EventConnectionPoint::Advise(IUnknown* sink, DWORD* cookie) {
  if (sink == nullptr || cookie == nullptr) return E_POINTER;
  *cookie = 0;
  ComPointer<IDispatch> events;
  if (FAILED(sink->QueryInterface(*core_.controlClass().eventInterface,
                                  reinterpret_cast<void**>(events.receive()))) &&
      FAILED(sink->QueryInterface(IID_IDispatch, reinterpret_cast<void**>(events.receive()))))
    return CONNECT_E_CANNOTCONNECT;
  return barrier([&] {
    connections_.push_back({lastCookie_ + 1, std::move(events)});
    *cookie = ++lastCookie_;
  });
}

HRESULT EventConnectionPoint::Unadvise(DWORD cookie) {
  const auto found =
      std::find_if(connections_.begin(), connections_.end(),
                   [cookie](const Connection& connection) { return connection.cookie == cookie; });
  if (found == connections_.end()) return CONNECT_E_NOCONNECTION;
  const Connection removed = std::move(*found);  // let go of only when the list is whole again
  connections_.erase(found);
  return S_OK;
}

HRESULT EventConnectionPoint::EnumConnections(IEnumConnections** connections) {
  if (connections == nullptr) return E_POINTER;
  *connections = nullptr;
  return barrier([&] {
    std::vector<ConnectionItem> items;
    for (const Connection& connection : connections_)
      items.push_back({ComPointer<IUnknown>(connection.sink.get()), connection.cookie});
    *connections = new ConnectionEnumerator(std::move(items));
  });
}

void EventConnectionPoint::disconnectAll() noexcept {
  const std::vector<Connection> dropped = std::move(connections_);  // their ends may call back
  connections_.clear();
}

// --- The container of connection points

LONG ConnectionsPart::raiseForStatus(DISPID event, std::span<const VARIANT> arguments) {
  LONG answer = 0;
  if (!core().raisesEvents()) return answer;
  const ComPointer<IUnknown> alive(core().outer());
  // A copy: sinks come and go inside an event.
  const std::vector<EventConnectionPoint::Connection> told = events_.connections();
  for (const EventConnectionPoint::Connection& connection : told) {
    if (!events_.connected(connection.cookie)) continue;
    LONG cell = answer;
    std::vector<VARIANT> reversed(1);
    V_VT(&reversed[0]) = VT_BYREF | VT_I4;
    V_I4REF(&reversed[0]) = &cell;
    reversed.insert(reversed.end(), arguments.rbegin(), arguments.rend());
    DISPPARAMS parameters{reversed.data(), nullptr, static_cast<UINT>(reversed.size()), 0};
    VARIANT result;
    VariantInit(&result);
    const HRESULT handled = connection.sink->Invoke(event, IID_NULL, LOCALE_USER_DEFAULT, DISPATCH_METHOD,
                                                    &parameters, &result, nullptr, nullptr);
    VariantClear(&result);
    if (SUCCEEDED(handled)) answer = cell;
  }
  return answer;
}

HRESULT ConnectionsPart::EnumConnectionPoints(IEnumConnectionPoints** points) {
  if (points == nullptr) return E_POINTER;
  *points = nullptr;
  return barrier([&] {
    std::vector<ComPointer<IConnectionPoint>> items;
    items.emplace_back(&events_);
    *points = new ConnectionPointEnumerator(std::move(items));
  });
}

HRESULT ConnectionsPart::FindConnectionPoint(REFIID id, IConnectionPoint** point) {
  if (point == nullptr) return E_POINTER;
  *point = nullptr;
  if (id != *core().controlClass().eventInterface) return CONNECT_E_NOCONNECTION;
  *point = &events_;
  events_.AddRef();
  return S_OK;
}

}  // namespace frontpanels::activex

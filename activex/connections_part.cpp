#include "activex/connections_part.h"

#include <oleauto.h>
#include <olectl.h>

#include <algorithm>

#include "activex/barrier.h"
#include "activex/enumerators.h"

namespace frontpanels::activex {

// --- The connection point

bool ControlConnectionPoint::connected(DWORD cookie) const noexcept {
  return std::any_of(connections_.begin(), connections_.end(),
                     [cookie](const Connection& connection) { return connection.cookie == cookie; });
}

HRESULT ControlConnectionPoint::QueryInterface(REFIID id, void** object) {
  if (object == nullptr) return E_POINTER;
  *object = id == IID_IUnknown || id == IID_IConnectionPoint ? static_cast<IConnectionPoint*>(this) : nullptr;
  if (*object == nullptr) return E_NOINTERFACE;
  AddRef();
  return S_OK;
}

HRESULT ControlConnectionPoint::GetConnectionInterface(IID* id) {
  if (id == nullptr) return E_POINTER;
  *id = id_;
  return S_OK;
}

HRESULT ControlConnectionPoint::GetConnectionPointContainer(IConnectionPointContainer** container) {
  if (container == nullptr) return E_POINTER;
  return core_.outer()->QueryInterface(IID_IConnectionPointContainer, reinterpret_cast<void**>(container));
}

// A sink of events answers for their interface, or for plain dispatch only.
HRESULT ControlConnectionPoint::Advise(IUnknown* sink, DWORD* cookie) {
  if (sink == nullptr || cookie == nullptr) return E_POINTER;
  *cookie = 0;
  ComPointer<IUnknown> joined;
  const auto place = reinterpret_cast<void**>(joined.receive());
  const bool events = id_ == *core_.controlClass().eventInterface;
  if (FAILED(sink->QueryInterface(id_, place)) &&
      (!events || FAILED(sink->QueryInterface(IID_IDispatch, place))))
    return CONNECT_E_CANNOTCONNECT;
  return barrier([&] {
    connections_.push_back({lastCookie_ + 1, std::move(joined)});
    *cookie = ++lastCookie_;
  });
}

HRESULT ControlConnectionPoint::Unadvise(DWORD cookie) {
  const auto found =
      std::find_if(connections_.begin(), connections_.end(),
                   [cookie](const Connection& connection) { return connection.cookie == cookie; });
  if (found == connections_.end()) return CONNECT_E_NOCONNECTION;
  const Connection removed = std::move(*found);  // let go of only when the list is whole again
  connections_.erase(found);
  return S_OK;
}

HRESULT ControlConnectionPoint::EnumConnections(IEnumConnections** connections) {
  if (connections == nullptr) return E_POINTER;
  *connections = nullptr;
  return barrier([&] {
    std::vector<ConnectionItem> items;
    for (const Connection& connection : connections_)
      items.push_back({ComPointer<IUnknown>(connection.sink.get()), connection.cookie});
    *connections = new ConnectionEnumerator(std::move(items));
  });
}

void ControlConnectionPoint::disconnectAll() noexcept {
  const std::vector<Connection> dropped = std::move(connections_);  // their ends may call back
  connections_.clear();
}

// --- The container of connection points

LONG ConnectionsPart::raiseForStatus(DISPID event, std::span<const VARIANT> arguments) {
  LONG answer = 0;
  if (!core().raisesEvents()) return answer;
  const ComPointer<IUnknown> alive(core().outer());
  // A copy: sinks come and go inside an event.
  const std::vector<ControlConnectionPoint::Connection> told = events_.connections();
  for (const ControlConnectionPoint::Connection& connection : told) {
    if (!events_.connected(connection.cookie)) continue;
    LONG cell = answer;
    std::vector<VARIANT> reversed(1);
    V_VT(&reversed[0]) = VT_BYREF | VT_I4;
    V_I4REF(&reversed[0]) = &cell;
    reversed.insert(reversed.end(), arguments.rbegin(), arguments.rend());
    DISPPARAMS parameters{reversed.data(), nullptr, static_cast<UINT>(reversed.size()), 0};
    VARIANT result;
    VariantInit(&result);
    const HRESULT handled = static_cast<IDispatch*>(connection.sink.get())
                                ->Invoke(event, IID_NULL, LOCALE_USER_DEFAULT, DISPATCH_METHOD, &parameters,
                                         &result, nullptr, nullptr);
    VariantClear(&result);
    if (SUCCEEDED(handled)) answer = cell;
  }
  return answer;
}

void ConnectionsPart::notifyChanged(DISPID property) {
  const ComPointer<IUnknown> alive(core().outer());
  const std::vector<ControlConnectionPoint::Connection> told = changes_.connections();
  for (const ControlConnectionPoint::Connection& connection : told)
    if (changes_.connected(connection.cookie))
      static_cast<IPropertyNotifySink*>(connection.sink.get())->OnChanged(property);
}

void ConnectionsPart::disconnectAll() noexcept {
  events_.disconnectAll();
  changes_.disconnectAll();
}

HRESULT ConnectionsPart::EnumConnectionPoints(IEnumConnectionPoints** points) {
  if (points == nullptr) return E_POINTER;
  *points = nullptr;
  return barrier([&] {
    std::vector<ComPointer<IConnectionPoint>> items;
    items.emplace_back(&events_);
    items.emplace_back(&changes_);
    *points = new ConnectionPointEnumerator(std::move(items));
  });
}

HRESULT ConnectionsPart::FindConnectionPoint(REFIID id, IConnectionPoint** point) {
  if (point == nullptr) return E_POINTER;
  *point = nullptr;
  for (ControlConnectionPoint* const candidate : {&events_, &changes_})
    if (candidate->id() == id) *point = ComPointer<IConnectionPoint>(candidate).detach();
  return *point != nullptr ? S_OK : CONNECT_E_NOCONNECTION;
}

}  // namespace frontpanels::activex

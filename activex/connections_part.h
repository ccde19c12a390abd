// IConnectionPointContainer and the connection points: the control's events, and changes of its properties.
// Events are raised at once: a host answers some of them through an argument.
#pragma once

#include <ocidl.h>

#include <optional>
#include <span>
#include <vector>

#include "activex/control_core.h"

namespace frontpanels::activex {

// An object of its own, which shares the life of the control.
class ControlConnectionPoint final : public IConnectionPoint {
 public:
  ControlConnectionPoint(ControlCore& core, const IID& id) noexcept : core_(core), id_(id) {}
  virtual ~ControlConnectionPoint() = default;
  [[nodiscard]] const IID& id() const noexcept { return id_; }

  struct Connection {
    DWORD cookie = 0;           // never used twice
    ComPointer<IUnknown> sink;  // the outgoing interface itself, or IDispatch in its place
  };
  [[nodiscard]] const std::vector<Connection>& connections() const noexcept { return connections_; }
  [[nodiscard]] bool connected(DWORD cookie) const noexcept;
  void disconnectAll() noexcept;

  HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override;
  ULONG STDMETHODCALLTYPE AddRef() override { return core_.outer()->AddRef(); }
  ULONG STDMETHODCALLTYPE Release() override { return core_.outer()->Release(); }
  HRESULT STDMETHODCALLTYPE GetConnectionInterface(IID* id) override;
  HRESULT STDMETHODCALLTYPE GetConnectionPointContainer(IConnectionPointContainer** container) override;
  HRESULT STDMETHODCALLTYPE Advise(IUnknown* sink, DWORD* cookie) override;
  HRESULT STDMETHODCALLTYPE Unadvise(DWORD cookie) override;
  HRESULT STDMETHODCALLTYPE EnumConnections(IEnumConnections** connections) override;

 private:
  ControlCore& core_;
  const IID& id_;
  std::vector<Connection> connections_;
  DWORD lastCookie_ = 0;
};

class ConnectionsPart final : public ControlPart<IConnectionPointContainer> {
 public:
  explicit ConnectionsPart(ControlCore& core) noexcept
      : ControlPart(core),
        events_(core, *core.controlClass().eventInterface),
        changes_(core, IID_IPropertyNotifySink) {}

  // Raises an event whose last argument is a status that the host answers in. Each sink sees the answer so
  // far, the last that handles the event decides; 0 when nobody does or while the control raises none.
  // `arguments` are in the order of the declaration, without the status.
  [[nodiscard]] LONG raiseForStatus(DISPID event, std::span<const VARIANT> arguments);
  void notifyChanged(DISPID property);
  void disconnectAll() noexcept;

  HRESULT STDMETHODCALLTYPE EnumConnectionPoints(IEnumConnectionPoints** points) override;
  HRESULT STDMETHODCALLTYPE FindConnectionPoint(REFIID id, IConnectionPoint** point) override;

 private:
  ControlConnectionPoint events_;
  ControlConnectionPoint changes_;
};

}  // namespace frontpanels::activex

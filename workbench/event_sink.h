// The sink for a panel's default source interface: its requests to the host, answered in the by-reference
// status.
#pragma once

#include <ocidl.h>

#include <map>
#include <string>

#include "workbench/com_object.h"
#include "workbench/panel_place.h"

namespace frontpanels::workbench {

class EventSink final : public ComObject<IDispatch> {
 public:
  // `events` describes the source interface `id`; the members are told apart by their names in it.
  EventSink(PanelRequests& requests, const IID& id, ITypeInfo& events);
  void detach() noexcept { requests_ = nullptr; }

  HRESULT STDMETHODCALLTYPE GetTypeInfoCount(UINT* count) override;
  HRESULT STDMETHODCALLTYPE GetTypeInfo(UINT, LCID, ITypeInfo** info) override;
  HRESULT STDMETHODCALLTYPE GetIDsOfNames(REFIID, LPOLESTR*, UINT, LCID, DISPID*) override {
    return DISP_E_UNKNOWNNAME;
  }
  // DISP_E_MEMBERNOTFOUND for an event that nobody handles: the panel then goes by its default.
  HRESULT STDMETHODCALLTYPE Invoke(DISPID member, REFIID, LCID, WORD flags, DISPPARAMS* parameters,
                                   VARIANT* result, EXCEPINFO*, UINT*) override;

 private:
  struct Handler;
  static const Handler kHandlers[];

  ~EventSink() override = default;
  [[nodiscard]] void* findInterface(REFIID id) noexcept override;
  [[nodiscard]] std::int32_t frontPanelOp(VARIANT* arguments);
  [[nodiscard]] std::int32_t frontPanelSet(VARIANT* arguments);
  [[nodiscard]] std::int32_t saveDisplaySettings(VARIANT* arguments);
  [[nodiscard]] std::int32_t saveSetup(VARIANT* arguments);

  PanelRequests* requests_;
  IID id_;
  std::map<DISPID, const Handler*> handlers_;
};

// Connected while it lives: finds the default source interface of a control, joins it with a sink of its own,
// and leaves it again. A control without one raises a failure.
class EventConnection {
 public:
  EventConnection(IUnknown& control, PanelRequests& requests);
  EventConnection(const EventConnection&) = delete;
  EventConnection& operator=(const EventConnection&) = delete;
  ~EventConnection();

 private:
  ComPointer<EventSink> sink_;
  ComPointer<IConnectionPoint> point_;
  DWORD cookie_ = 0;
};

}  // namespace frontpanels::workbench

#include "workbench/event_sink.h"

#include <windows.h>

#include <olectl.h>

#include <cmath>
#include <limits>

#include "workbench/automation.h"
#include "workbench/failure.h"

namespace frontpanels::workbench {
namespace {

DISPID memberOf(ITypeInfo& events, const wchar_t* name) {
  std::wstring copy = name;
  LPOLESTR pointer = copy.data();
  MEMBERID id = DISPID_UNKNOWN;
  check(events.GetIDsOfNames(&pointer, 1, &id), "Looking up an event of the panel");
  return id;
}

std::int32_t numberOf(VARIANT& argument) {
  VARIANT number;
  VariantInit(&number);
  check(VariantChangeType(&number, &argument, 0, VT_I4), "Reading an argument of an event");
  return number.lVal;
}

std::int16_t shortOf(VARIANT& argument) { return static_cast<std::int16_t>(numberOf(argument)); }

// Nothing at all would be converted to 0.
double realOf(VARIANT& argument) {
  VARIANT number;
  VariantInit(&number);
  const bool isNumber = argument.vt != VT_EMPTY && SUCCEEDED(VariantChangeType(&number, &argument, 0, VT_R8));
  return isNumber ? number.dblVal : std::numeric_limits<double>::quiet_NaN();
}

// Writes in the type that the panel handed over.
HRESULT writeStatus(VARIANT& place, std::int32_t status) {
  switch (place.vt) {
    case VT_BYREF | VT_I4:
      *place.plVal = status;
      return S_OK;
    case VT_BYREF | VT_I2:
      *place.piVal = static_cast<SHORT>(status);
      return S_OK;
    case VT_BYREF | VT_VARIANT:
      VariantClear(place.pvarVal);
      place.pvarVal->vt = VT_I4;
      place.pvarVal->lVal = status;
      return S_OK;
    default:
      return DISP_E_TYPEMISMATCH;
  }
}

// The implemented interface that a class marks as its default source.
ComPointer<ITypeInfo> defaultSource(ITypeInfo& classInfo) {
  TYPEATTR* attributes = nullptr;
  check(classInfo.GetTypeAttr(&attributes), "Reading the panel's class");
  const UINT count = attributes->cImplTypes;
  classInfo.ReleaseTypeAttr(attributes);
  for (UINT i = 0; i < count; ++i) {
    constexpr int kWanted = IMPLTYPEFLAG_FDEFAULT | IMPLTYPEFLAG_FSOURCE;
    int flags = 0;
    HREFTYPE reference = 0;
    ComPointer<ITypeInfo> source;
    if (SUCCEEDED(classInfo.GetImplTypeFlags(i, &flags)) && (flags & kWanted) == kWanted &&
        SUCCEEDED(classInfo.GetRefTypeOfImplType(i, &reference)) &&
        SUCCEEDED(classInfo.GetRefTypeInfo(reference, source.receive())))
      return source;
  }
  throw HostFailure("The panel has no default source of events");
}

}  // namespace

// The arguments of an event come in reverse order, the status first.
struct EventSink::Handler {
  const wchar_t* event;
  UINT arguments;
  std::int32_t (EventSink::*answer)(VARIANT* arguments);
};

const EventSink::Handler EventSink::kHandlers[] = {
    {L"frontPanelOp", 5, &EventSink::frontPanelOp},
    {L"frontPanelSet", 6, &EventSink::frontPanelSet},
    {L"saveDisplaySettings", 4, &EventSink::saveDisplaySettings},
    {L"saveSetup", 4, &EventSink::saveSetup},
};

EventSink::EventSink(PanelRequests& requests, const IID& id, ITypeInfo& events)
    : requests_(&requests), id_(id) {
  for (const Handler& handler : kHandlers) handlers_.emplace(memberOf(events, handler.event), &handler);
}

void* EventSink::findInterface(REFIID id) noexcept {
  return id == IID_IUnknown || id == IID_IDispatch || id == id_ ? static_cast<IDispatch*>(this) : nullptr;
}

HRESULT EventSink::GetTypeInfoCount(UINT* count) {
  if (count == nullptr) return E_POINTER;
  *count = 0;
  return S_OK;
}

HRESULT EventSink::GetTypeInfo(UINT, LCID, ITypeInfo** info) {
  if (info != nullptr) *info = nullptr;
  return E_NOTIMPL;
}

HRESULT EventSink::Invoke(DISPID member, REFIID, LCID, WORD, DISPPARAMS* parameters, VARIANT*, EXCEPINFO*,
                          UINT*) {
  return comBarrier([&]() -> HRESULT {
    const ComPointer<EventSink> alive(this);
    const auto found = handlers_.find(member);
    if (requests_ == nullptr || found == handlers_.end()) return DISP_E_MEMBERNOTFOUND;
    const Handler& handler = *found->second;
    if (parameters == nullptr || parameters->cArgs != handler.arguments) return DISP_E_BADPARAMCOUNT;
    return writeStatus(parameters->rgvarg[0], (this->*handler.answer)(parameters->rgvarg));
  });
}

std::int32_t EventSink::frontPanelOp(VARIANT* arguments) {
  enum { kStatus, kArgument, kOperation, kPanelId, kHardwareId };
  const double argument = realOf(arguments[kArgument]);
  return requests_->frontPanelOp({numberOf(arguments[kHardwareId]), numberOf(arguments[kPanelId])},
                                 shortOf(arguments[kOperation]),
                                 std::isnan(argument) ? -1 : numberOf(arguments[kArgument]));
}

std::int32_t EventSink::frontPanelSet(VARIANT* arguments) {
  enum { kStatus, kValue, kIndex, kParameterType, kPanelId, kHardwareId };
  return requests_->frontPanelSet({numberOf(arguments[kHardwareId]), numberOf(arguments[kPanelId])},
                                  shortOf(arguments[kParameterType]), shortOf(arguments[kIndex]),
                                  realOf(arguments[kValue]));
}

std::int32_t EventSink::saveDisplaySettings(VARIANT* arguments) {
  enum { kStatus, kList, kPanelId, kHardwareId };
  return requests_->saveDisplaySettings({numberOf(arguments[kHardwareId]), numberOf(arguments[kPanelId])},
                                        arguments[kList]);
}

std::int32_t EventSink::saveSetup(VARIANT* arguments) {
  enum { kStatus, kPanelId, kResourceId, kSetUpId };
  return requests_->saveSetup(numberOf(arguments[kSetUpId]),
                              {numberOf(arguments[kResourceId]), numberOf(arguments[kPanelId])});
}

EventConnection::EventConnection(IUnknown& control, PanelRequests& requests) {
  const ComPointer<IUnknown> object(&control);
  const auto provider = object.query<IProvideClassInfo2>();
  const auto container = object.query<IConnectionPointContainer>();
  if (!provider || !container) throw HostFailure("The panel raises no events");
  IID id{};
  check(provider->GetGUID(GUIDKIND_DEFAULT_SOURCE_DISP_IID, &id), "Asking for the panel's events");
  ComPointer<ITypeInfo> classInfo;
  check(provider->GetClassInfo(classInfo.receive()), "Asking for the panel's class");
  check(container->FindConnectionPoint(id, point_.receive()), "Finding the panel's events");
  sink_ = makeComObject<EventSink>(requests, id, *defaultSource(*classInfo.get()).get());
  check(point_->Advise(static_cast<IDispatch*>(sink_.get()), &cookie_), "Joining the panel's events");
}

EventConnection::~EventConnection() {
  sink_->detach();
  point_->Unadvise(cookie_);
}

}  // namespace frontpanels::workbench

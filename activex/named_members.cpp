#include "activex/named_members.h"

#include <oleauto.h>

#include <algorithm>
#include <cwchar>
#include <vector>

#include "activex/barrier.h"
#include "activex/variants.h"
#include "platform/win32/com_pointer.h"

namespace frontpanels::activex {
namespace {

// What the barrier said of a failure, as the caller of an Invoke expects it.
HRESULT asException(HRESULT failure, EXCEPINFO* exception) noexcept {
  ComPointer<IErrorInfo> info;
  if (exception == nullptr || GetErrorInfo(0, info.receive()) != S_OK) return failure;
  *exception = {};
  info->GetDescription(&exception->bstrDescription);
  info->GetSource(&exception->bstrSource);
  exception->scode = failure;
  return DISP_E_EXCEPTION;
}

}  // namespace

HRESULT NamedDispatch::QueryInterface(REFIID id, void** object) {
  if (object == nullptr) return E_POINTER;
  *object = nullptr;
  if (id != IID_IUnknown && id != IID_IDispatch) return E_NOINTERFACE;
  AddRef();
  *object = static_cast<IDispatch*>(this);
  return S_OK;
}

HRESULT NamedDispatch::GetTypeInfoCount(UINT* count) {
  if (count == nullptr) return E_POINTER;
  *count = 0;
  return S_OK;
}

HRESULT NamedDispatch::GetTypeInfo(UINT /*index*/, LCID /*locale*/, ITypeInfo** info) {
  if (info == nullptr) return E_POINTER;
  *info = nullptr;
  return DISP_E_BADINDEX;
}

HRESULT NamedDispatch::GetIDsOfNames(REFIID reserved, LPOLESTR* names, UINT count, LCID /*locale*/,
                                     DISPID* ids) {
  if (reserved != IID_NULL) return DISP_E_UNKNOWNINTERFACE;
  if (names == nullptr || ids == nullptr || count == 0) return E_INVALIDARG;
  std::fill(ids, ids + count, DISPID_UNKNOWN);  // no argument has a name
  for (DISPID member = 1; nameOf(member) != nullptr; ++member)
    if (_wcsicmp(nameOf(member), names[0]) == 0) ids[0] = member;
  return count == 1 && ids[0] != DISPID_UNKNOWN ? S_OK : DISP_E_UNKNOWNNAME;
}

// The host may let go of the object inside the member that it calls.
HRESULT NamedDispatch::Invoke(DISPID member, REFIID reserved, LCID /*locale*/, WORD flags,
                              DISPPARAMS* parameters, VARIANT* result, EXCEPINFO* exception,
                              UINT* /*badArgument*/) {
  if (reserved != IID_NULL) return DISP_E_UNKNOWNINTERFACE;
  if (parameters == nullptr) return E_POINTER;
  const bool writes = (flags & (DISPATCH_PROPERTYPUT | DISPATCH_PROPERTYPUTREF)) != 0;
  if (nameOf(member) == nullptr || (writes && !writable(member))) return DISP_E_MEMBERNOTFOUND;
  if (parameters->cArgs != (writes ? 1U : argumentCount(member))) return DISP_E_BADPARAMCOUNT;
  const ComPointer<IDispatch> alive(this);
  SetErrorInfo(0, nullptr);  // what an earlier failure left must not stand for this call's
  const HRESULT done = barrier(IID_IDispatch, [&] {
    std::vector<Variant> arguments;  // the last comes first
    for (UINT i = parameters->cArgs; i > 0; --i)
      arguments.push_back(fromAutomation(parameters->rgvarg[i - 1]));
    if (writes) return put(member, arguments[0]);
    const Variant value = get(member, arguments);
    if (result != nullptr) *result = toAutomation(value);
  });
  return SUCCEEDED(done) ? done : asException(done, exception);
}

}  // namespace frontpanels::activex

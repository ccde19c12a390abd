// IDispatch by the type library: names, optional and named arguments and conversions as Automation has them,
// and by-reference variables of script hosts unwrapped for parameters of a plain type.
#pragma once

#include <oaidl.h>

#include "activex/barrier.h"
#include "platform/win32/com_pointer.h"

namespace frontpanels::activex {

// The description of an interface or class in the library's own type library. Raises ComFailure.
[[nodiscard]] ComPointer<ITypeInfo> typeInfoOf(const GUID& id);
// Type library of this very file. Raises ComFailure.
[[nodiscard]] ComPointer<ITypeLib> ownTypeLibrary();

// Calls a member through the type description. A member that is not there is answered quietly.
HRESULT invokeByTypeInfo(ITypeInfo& info, void* object, DISPID member, WORD flags, DISPPARAMS* parameters,
                         VARIANT* result, EXCEPINFO* exception, UINT* badArgument);

// The four methods for a dual interface. `Base` brings the interface and the base methods.
template <class Base, class Dual>
class Dispatching : public Base {
 public:
  using Base::Base;

  HRESULT STDMETHODCALLTYPE GetTypeInfoCount(UINT* count) override {
    if (count == nullptr) return E_POINTER;
    *count = 1;
    return S_OK;
  }
  HRESULT STDMETHODCALLTYPE GetTypeInfo(UINT index, LCID, ITypeInfo** info) override {
    if (info == nullptr) return E_POINTER;
    *info = nullptr;
    if (index != 0) return DISP_E_BADINDEX;
    return barrier([&] {
      *info = typeInfo().get();
      (*info)->AddRef();
    });
  }
  HRESULT STDMETHODCALLTYPE GetIDsOfNames(REFIID reserved, LPOLESTR* names, UINT count, LCID,
                                          DISPID* ids) override {
    if (reserved != IID_NULL) return DISP_E_UNKNOWNINTERFACE;
    return barrier([&] { return typeInfo()->GetIDsOfNames(names, count, ids); });
  }
  HRESULT STDMETHODCALLTYPE Invoke(DISPID member, REFIID reserved, LCID, WORD flags, DISPPARAMS* parameters,
                                   VARIANT* result, EXCEPINFO* exception, UINT* badArgument) override {
    if (reserved != IID_NULL) return DISP_E_UNKNOWNINTERFACE;
    // The host may let go of the object inside the member that it calls.
    const ComPointer<IUnknown> alive(this->outer());
    return barrier([&] {
      return invokeByTypeInfo(*typeInfo().get(), static_cast<Dual*>(this), member, flags, parameters, result,
                              exception, badArgument);
    });
  }

 private:
  [[nodiscard]] const ComPointer<ITypeInfo>& typeInfo() {
    if (!typeInfo_) typeInfo_ = typeInfoOf(__uuidof(Dual));
    return typeInfo_;
  }

  ComPointer<ITypeInfo> typeInfo_;
};

}  // namespace frontpanels::activex

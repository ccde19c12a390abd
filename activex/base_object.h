// A panel's base as an object for late binding: the state that its panels share with their host, each
// property by its name. It is not described in the type library; its identity is its own, its life the
// control's.
#pragma once

#include <oaidl.h>

#include "framework/panel/base_vfp.h"

namespace frontpanels::activex {

class BaseObject : public IDispatch {
 public:
  BaseObject() = default;
  virtual ~BaseObject() = default;
  BaseObject(const BaseObject&) = delete;
  BaseObject& operator=(const BaseObject&) = delete;

  HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override;
  HRESULT STDMETHODCALLTYPE GetTypeInfoCount(UINT* count) override;
  HRESULT STDMETHODCALLTYPE GetTypeInfo(UINT index, LCID locale, ITypeInfo** info) override;
  HRESULT STDMETHODCALLTYPE GetIDsOfNames(REFIID reserved, LPOLESTR* names, UINT count, LCID locale,
                                          DISPID* ids) override;
  HRESULT STDMETHODCALLTYPE Invoke(DISPID member, REFIID reserved, LCID locale, WORD flags,
                                   DISPPARAMS* parameters, VARIANT* result, EXCEPINFO* exception,
                                   UINT* badArgument) override;

 private:
  [[nodiscard]] virtual clsBaseVFP& base() = 0;
};

}  // namespace frontpanels::activex

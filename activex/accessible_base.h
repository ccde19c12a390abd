// What the library's accessible objects share: their count, the module's lock, late binding by the system's
// own description of the interface, and the members that none of them has.
#pragma once

#include <windows.h>

#include <oleacc.h>

#include <atomic>

#include "activex/barrier.h"
#include "activex/module.h"
#include "platform/win32/com_pointer.h"

namespace frontpanels::activex {

// Clients keep such objects for as long as they like: each of them may outlive what it speaks of.
class AccessibleBase : public IAccessible, public IEnumVARIANT, public IOleWindow {
 public:
  AccessibleBase() = default;
  AccessibleBase(const AccessibleBase&) = delete;
  AccessibleBase& operator=(const AccessibleBase&) = delete;

  // IUnknown
  HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override;
  ULONG STDMETHODCALLTYPE AddRef() override { return ++references_; }
  ULONG STDMETHODCALLTYPE Release() override {
    const ULONG left = --references_;
    if (left == 0) delete this;
    return left;
  }
  // IDispatch
  HRESULT STDMETHODCALLTYPE GetTypeInfoCount(UINT* count) override;
  HRESULT STDMETHODCALLTYPE GetTypeInfo(UINT index, LCID locale, ITypeInfo** info) override;
  HRESULT STDMETHODCALLTYPE GetIDsOfNames(REFIID reserved, LPOLESTR* names, UINT count, LCID locale,
                                          DISPID* ids) override;
  HRESULT STDMETHODCALLTYPE Invoke(DISPID member, REFIID reserved, LCID locale, WORD flags,
                                   DISPPARAMS* parameters, VARIANT* result, EXCEPINFO* exception,
                                   UINT* badArgument) override;
  // IAccessible: nothing is renamed or set from outside, and there are no help files.
  HRESULT STDMETHODCALLTYPE get_accHelp(VARIANT, BSTR* help) override;
  HRESULT STDMETHODCALLTYPE get_accHelpTopic(BSTR* file, VARIANT, LONG* topic) override;
  HRESULT STDMETHODCALLTYPE put_accName(VARIANT, BSTR) override { return DISP_E_MEMBERNOTFOUND; }
  HRESULT STDMETHODCALLTYPE put_accValue(VARIANT, BSTR) override { return DISP_E_MEMBERNOTFOUND; }
  // IOleWindow
  HRESULT STDMETHODCALLTYPE ContextSensitiveHelp(BOOL) override { return E_NOTIMPL; }

 protected:
  virtual ~AccessibleBase() = default;
  // Whether the object can list its children.
  [[nodiscard]] virtual bool enumerates() const noexcept { return true; }

 private:
  ModuleLock lock_;
  std::atomic<ULONG> references_ = 1;
};

// The child that a client names; -1 for what is no number. The object itself is CHILDID_SELF.
[[nodiscard]] inline LONG childOf(const VARIANT& child) noexcept {
  return V_VT(&child) == VT_I4 && V_I4(&child) >= 0 ? V_I4(&child) : -1;
}

// The identity of the interface is taken from its declaration everywhere: in the import library its name is
// that of a jump.

// The answer to WM_GETOBJECT; the caller keeps its own reference.
[[nodiscard]] inline LRESULT handedOut(AccessibleBase& object, WPARAM flags) {
  return LresultFromObject(__uuidof(IAccessible), flags, static_cast<IAccessible*>(&object));
}
[[nodiscard]] inline bool asksForClient(LPARAM object) noexcept {
  return static_cast<DWORD>(object) == static_cast<DWORD>(OBJID_CLIENT);
}

}  // namespace frontpanels::activex

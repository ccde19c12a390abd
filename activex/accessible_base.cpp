#include "activex/accessible_base.h"

#include "activex/dispatch.h"

namespace frontpanels::activex {
namespace {

// LIBID_Accessibility; import libraries do not agree on whether they have it.
constexpr GUID kAccessibility{0x1ea4dbf0, 0x3c3b, 0x11cf, {0x81, 0x0c, 0x00, 0xaa, 0x00, 0x38, 0x9b, 0x71}};
constexpr WORD kMajorVersion = 1;
constexpr WORD kMinorVersion = 1;

// Raises ComFailure(E_NOTIMPL) where the system has no description of the interface.
ComPointer<ITypeInfo> description() {
  ComPointer<ITypeLib> library;
  ComPointer<ITypeInfo> info;
  if (FAILED(
          LoadRegTypeLib(kAccessibility, kMajorVersion, kMinorVersion, LOCALE_NEUTRAL, library.receive())) ||
      FAILED(library->GetTypeInfoOfGuid(__uuidof(IAccessible), info.receive())))
    throw ComFailure(E_NOTIMPL);
  return info;
}

}  // namespace

HRESULT AccessibleBase::QueryInterface(REFIID id, void** object) {
  if (object == nullptr) return E_POINTER;
  *object = nullptr;
  if (id == IID_IUnknown || id == IID_IDispatch || id == __uuidof(IAccessible))
    *object = static_cast<IAccessible*>(this);
  else if (id == IID_IEnumVARIANT && enumerates())
    *object = static_cast<IEnumVARIANT*>(this);
  else if (id == IID_IOleWindow)
    *object = static_cast<IOleWindow*>(this);
  if (*object == nullptr) return E_NOINTERFACE;
  AddRef();
  return S_OK;
}

HRESULT AccessibleBase::GetTypeInfoCount(UINT* count) {
  if (count == nullptr) return E_POINTER;
  *count = barrier([] { description(); }) == S_OK ? 1 : 0;
  return S_OK;
}

HRESULT AccessibleBase::GetTypeInfo(UINT index, LCID, ITypeInfo** info) {
  if (info == nullptr) return E_POINTER;
  *info = nullptr;
  if (index != 0) return DISP_E_BADINDEX;
  return barrier([&] { *info = description().detach(); });
}

HRESULT AccessibleBase::GetIDsOfNames(REFIID reserved, LPOLESTR* names, UINT count, LCID, DISPID* ids) {
  if (reserved != IID_NULL) return DISP_E_UNKNOWNINTERFACE;
  return barrier([&] { return description()->GetIDsOfNames(names, count, ids); });
}

HRESULT AccessibleBase::Invoke(DISPID member, REFIID reserved, LCID, WORD flags, DISPPARAMS* parameters,
                               VARIANT* result, EXCEPINFO* exception, UINT* badArgument) {
  if (reserved != IID_NULL) return DISP_E_UNKNOWNINTERFACE;
  return barrier([&] {
    return invokeByTypeInfo(*description().get(), static_cast<IAccessible*>(this), member, flags, parameters,
                            result, exception, badArgument);
  });
}

HRESULT AccessibleBase::get_accHelp(VARIANT, BSTR* help) {
  if (help == nullptr) return E_POINTER;
  *help = nullptr;
  return DISP_E_MEMBERNOTFOUND;
}

HRESULT AccessibleBase::get_accHelpTopic(BSTR* file, VARIANT, LONG* topic) {
  if (file == nullptr || topic == nullptr) return E_POINTER;
  *file = nullptr;
  *topic = 0;
  return DISP_E_MEMBERNOTFOUND;
}

}  // namespace frontpanels::activex

#include "activex/class_info_part.h"

#include "activex/barrier.h"
#include "activex/dispatch.h"

namespace frontpanels::activex {

HRESULT ClassInfoPart::GetClassInfo(ITypeInfo** info) {
  if (info == nullptr) return E_POINTER;
  *info = nullptr;
  return barrier([&] { *info = typeInfoOf(*core().controlClass().id).detach(); });
}

HRESULT ClassInfoPart::GetGUID(DWORD kind, GUID* id) {
  if (id == nullptr) return E_POINTER;
  *id = GUID_NULL;
  if (kind != GUIDKIND_DEFAULT_SOURCE_DISP_IID) return E_INVALIDARG;
  *id = *core().controlClass().eventInterface;
  return S_OK;
}

HRESULT ClassInfoPart::InterfaceSupportsErrorInfo(REFIID id) {
  return id == *core().controlClass().defaultInterface ? S_OK : S_FALSE;
}

}  // namespace frontpanels::activex

#include "activex/class_factory.h"

#include "activex/barrier.h"

namespace frontpanels::activex {

HRESULT ClassFactory::QueryInterface(REFIID id, void** object) {
  if (object == nullptr) return E_POINTER;
  *object = id == IID_IUnknown || id == IID_IClassFactory ? static_cast<IClassFactory*>(this) : nullptr;
  if (*object == nullptr) return E_NOINTERFACE;
  AddRef();
  return S_OK;
}

ULONG ClassFactory::Release() {
  const ULONG left = --references_;
  if (left == 0) delete this;
  return left;
}

HRESULT ClassFactory::CreateInstance(IUnknown* outer, REFIID id, void** object) {
  if (object == nullptr) return E_POINTER;
  *object = nullptr;
  if (outer != nullptr && id != IID_IUnknown) return CLASS_E_NOAGGREGATION;
  return barrier([&]() -> HRESULT {
    IUnknown* const inner = row_.create(outer)->inner();
    const HRESULT found = inner->QueryInterface(id, object);
    inner->Release();
    return found;
  });
}

HRESULT ClassFactory::LockServer(WINBOOL lock) {
  lock ? lockModule() : unlockModule();
  return S_OK;
}

}  // namespace frontpanels::activex

#include "activex/aggregable.h"

namespace frontpanels::activex {

HRESULT Aggregable::Inner::QueryInterface(REFIID id, void** object) {
  if (object == nullptr) return E_POINTER;
  *object = nullptr;
  if (id == IID_IUnknown) {
    *object = this;
    AddRef();
    return S_OK;
  }
  void* const found = owner_.findInterface(id);
  if (found == nullptr) return E_NOINTERFACE;
  *object = found;
  // Through the outer object: that is whose reference the caller will give back.
  owner_.outer()->AddRef();
  return S_OK;
}

ULONG Aggregable::Inner::Release() {
  const ULONG left = --references_;
  if (left == 0) {
    references_ = 1;  // whatever the destruction hands out and takes back does not end it a second time
    owner_.lastRelease();
    delete &owner_;
  }
  return left;
}

}  // namespace frontpanels::activex

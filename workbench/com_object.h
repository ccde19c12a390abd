// Base of the container's own objects: a reference count, and one answer to the question for an interface.
#pragma once

#include <unknwn.h>

#include <atomic>

#include "platform/win32/com_pointer.h"

namespace frontpanels::workbench {

// Interfaces have no virtual destructor: objects end by their last Release.
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wnon-virtual-dtor"

template <class... Interfaces>
class ComObject : public Interfaces... {
 public:
  ComObject() = default;
  ComObject(const ComObject&) = delete;
  ComObject& operator=(const ComObject&) = delete;

  HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override {
    if (object == nullptr) return E_POINTER;
    *object = findInterface(id);
    if (*object == nullptr) return E_NOINTERFACE;
    AddRef();
    return S_OK;
  }
  ULONG STDMETHODCALLTYPE AddRef() override { return ++references_; }
  ULONG STDMETHODCALLTYPE Release() override {
    const ULONG left = --references_;
    if (left == 0) delete this;
    return left;
  }

 protected:
  virtual ~ComObject() = default;
  // The pointer that answers for an interface, without a reference; null for one that the object lacks.
  [[nodiscard]] virtual void* findInterface(REFIID id) noexcept = 0;

 private:
  std::atomic<ULONG> references_ = 0;
};

#pragma GCC diagnostic pop

template <class Object, class... Arguments>
[[nodiscard]] ComPointer<Object> makeComObject(Arguments&&... arguments) {
  return ComPointer<Object>(new Object(std::forward<Arguments>(arguments)...));
}

}  // namespace frontpanels::workbench

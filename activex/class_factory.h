// IClassFactory for each row of the class table.
#pragma once

#include <unknwn.h>

#include <atomic>

#include "activex/classes.h"
#include "activex/module.h"

namespace frontpanels::activex {

class ClassFactory final : public IClassFactory {
 public:
  explicit ClassFactory(const ClassRow& row) noexcept : row_(row) {}
  virtual ~ClassFactory() = default;

  HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override;
  ULONG STDMETHODCALLTYPE AddRef() override { return ++references_; }
  ULONG STDMETHODCALLTYPE Release() override;
  // An outer object may only ask for IUnknown: it keeps the inner one.
  HRESULT STDMETHODCALLTYPE CreateInstance(IUnknown* outer, REFIID id, void** object) override;
  HRESULT STDMETHODCALLTYPE LockServer(WINBOOL lock) override;

 private:
  ModuleLock lock_;
  const ClassRow& row_;
  std::atomic<ULONG> references_ = 1;
};

}  // namespace frontpanels::activex

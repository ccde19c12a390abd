// FrontPanels.Diagnostics: the messages of the library, and whether they interrupt anybody.
#pragma once

#include "activex/aggregable.h"
#include "activex/dispatch.h"
#include "frontpanels_h.h"

namespace frontpanels::activex {

class DiagnosticsObject final
    : public Dispatching<Delegating<IDiagnostics, ISupportErrorInfo>, IDiagnostics> {
 public:
  using Dispatching::Dispatching;

  HRESULT STDMETHODCALLTYPE get_SilenceAssert(VARIANT_BOOL* silent) override;
  HRESULT STDMETHODCALLTYPE put_SilenceAssert(VARIANT_BOOL silent) override;
  HRESULT STDMETHODCALLTYPE get_ShowMessages(VARIANT_BOOL* show) override;
  HRESULT STDMETHODCALLTYPE put_ShowMessages(VARIANT_BOOL show) override;
  HRESULT STDMETHODCALLTYPE get_Count(LONG* count) override;
  HRESULT STDMETHODCALLTYPE Message(LONG index, BSTR* text) override;
  HRESULT STDMETHODCALLTYPE Clear() override;
  HRESULT STDMETHODCALLTYPE InterfaceSupportsErrorInfo(REFIID id) override {
    return id == IID_IDiagnostics ? S_OK : S_FALSE;
  }

 private:
  [[nodiscard]] void* findInterface(REFIID id) noexcept override;
};

}  // namespace frontpanels::activex

// FrontPanels.DataHub: how a host feeds the panels' data servers.
#pragma once

#include "activex/aggregable.h"
#include "activex/dispatch.h"
#include "frontpanels_h.h"

namespace frontpanels::activex {

class DataHubObject final : public Dispatching<Delegating<IDataHub, ISupportErrorInfo>, IDataHub> {
 public:
  using Dispatching::Dispatching;

  HRESULT STDMETHODCALLTYPE Publish(BSTR path, VARIANT values) override;
  HRESULT STDMETHODCALLTYPE ItemCount(BSTR path, LONG* count) override;
  HRESULT STDMETHODCALLTYPE Value(BSTR path, LONG index, VARIANT* value) override;
  HRESULT STDMETHODCALLTYPE InterfaceSupportsErrorInfo(REFIID id) override {
    return id == IID_IDataHub ? S_OK : S_FALSE;
  }

 private:
  [[nodiscard]] void* findInterface(REFIID id) noexcept override;
};

}  // namespace frontpanels::activex

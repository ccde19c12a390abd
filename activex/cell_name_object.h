// FrontPanels.clsCellNameInfo: how a host names the cells of its charts.
#pragma once

#include <memory>

#include "activex/aggregable.h"
#include "activex/dispatch.h"
#include "frontpanels_h.h"
#include "pilot/cell_name_info.h"

namespace frontpanels::activex {

// Within the library only: the names themselves, for a control that a host hands the object to. The
// identifier stands for this library's own layout of the names; it changes when that does.
struct CellNameSource : IUnknown {
  [[nodiscard]] virtual std::shared_ptr<frontpanels::clsCellNameInfo> cellNames() const noexcept = 0;
};

class CellNameObject final
    : public Dispatching<Delegating<IclsCellNameInfo, ISupportErrorInfo, CellNameSource>, IclsCellNameInfo> {
 public:
  explicit CellNameObject(IUnknown* outer);

  HRESULT STDMETHODCALLTYPE Initialize() override;
  HRESULT STDMETHODCALLTYPE SetCellName(double id1, double id2, BSTR content) override;
  HRESULT STDMETHODCALLTYPE GetCellName(double id1, double id2, BSTR* content) override;
  HRESULT STDMETHODCALLTYPE get_maxCellNameLength(short* characters) override;
  HRESULT STDMETHODCALLTYPE put_maxCellNameLength(short characters) override;
  HRESULT STDMETHODCALLTYPE InterfaceSupportsErrorInfo(REFIID id) override {
    return id == IID_IclsCellNameInfo ? S_OK : S_FALSE;
  }
  [[nodiscard]] std::shared_ptr<frontpanels::clsCellNameInfo> cellNames() const noexcept override {
    return names_;
  }

 private:
  [[nodiscard]] void* findInterface(REFIID id) noexcept override;

  std::shared_ptr<frontpanels::clsCellNameInfo> names_;  // also of the controls that show them
};

// The names behind an object of this library; null for any other object and for none.
[[nodiscard]] std::shared_ptr<frontpanels::clsCellNameInfo> cellNamesOf(IUnknown* object) noexcept;

}  // namespace frontpanels::activex

__CRT_UUID_DECL(frontpanels::activex::CellNameSource, 0x83344b71, 0x9aa9, 0x4b37, 0xa6, 0xd0, 0xdd, 0xb1,
                0x87, 0xb5, 0xaa, 0xd8)

#include "activex/cell_name_object.h"

#include "activex/variants.h"

namespace frontpanels::activex {

CellNameObject::CellNameObject(IUnknown* outer)
    : Dispatching(outer), names_(std::make_shared<frontpanels::clsCellNameInfo>()) {}

HRESULT CellNameObject::Initialize() {
  names_->Initialize();
  return S_OK;
}

// What the names refuse is reported, and no error of the call: a host goes on naming its other cells.
HRESULT CellNameObject::SetCellName(double id1, double id2, BSTR content) {
  return barrier(IID_IclsCellNameInfo, [&] { names_->SetCellName(id1, id2, fromBstr(content)); });
}

HRESULT CellNameObject::GetCellName(double id1, double id2, BSTR* content) {
  if (content == nullptr) return E_POINTER;
  *content = nullptr;
  return barrier(IID_IclsCellNameInfo, [&] { *content = toBstr(names_->GetCellName(id1, id2)); });
}

HRESULT CellNameObject::get_maxCellNameLength(short* characters) {
  if (characters == nullptr) return E_POINTER;
  *characters = names_->maxCellNameLength();
  return S_OK;
}

HRESULT CellNameObject::put_maxCellNameLength(short characters) {
  names_->maxCellNameLength(characters);
  return S_OK;
}

void* CellNameObject::findInterface(REFIID id) noexcept {
  if (id == IID_IclsCellNameInfo || id == IID_IDispatch) return static_cast<IclsCellNameInfo*>(this);
  if (id == IID_ISupportErrorInfo) return static_cast<ISupportErrorInfo*>(this);
  if (id == __uuidof(CellNameSource)) return static_cast<CellNameSource*>(this);
  return nullptr;
}

std::shared_ptr<frontpanels::clsCellNameInfo> cellNamesOf(IUnknown* object) noexcept {
  const auto source = ComPointer<IUnknown>(object).query<CellNameSource>();
  return source ? source->cellNames() : nullptr;
}

}  // namespace frontpanels::activex

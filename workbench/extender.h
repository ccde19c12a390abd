// The extender: the properties that a panel has from its container. Places are in twips, as forms count them.
#pragma once

#include <string>

#include "workbench/com_object.h"
#include "workbench/control_owner.h"

namespace frontpanels::workbench {

class Extender final : public ComObject<IDispatch> {
 public:
  Extender(ControlOwner& owner, std::wstring name) : owner_(&owner), name_(std::move(name)) {}
  void detach() noexcept { owner_ = nullptr; }

  HRESULT STDMETHODCALLTYPE GetTypeInfoCount(UINT* count) override;
  HRESULT STDMETHODCALLTYPE GetTypeInfo(UINT index, LCID locale, ITypeInfo** info) override;
  HRESULT STDMETHODCALLTYPE GetIDsOfNames(REFIID, LPOLESTR* names, UINT count, LCID, DISPID* ids) override;
  HRESULT STDMETHODCALLTYPE Invoke(DISPID member, REFIID, LCID, WORD flags, DISPPARAMS* parameters,
                                   VARIANT* result, EXCEPINFO*, UINT*) override;

 private:
  struct Property;
  static const Property kProperties[];

  ~Extender() override = default;
  [[nodiscard]] void* findInterface(REFIID id) noexcept override;
  [[nodiscard]] LONG edgeTwips(LONG RECT::*edge);
  [[nodiscard]] LONG extentTwips(LONG RECT::*low, LONG RECT::*high);

  ControlOwner* owner_;
  std::wstring name_;
  std::wstring caption_;
};

}  // namespace frontpanels::workbench

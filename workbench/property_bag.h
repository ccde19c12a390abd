// A property bag: what a panel keeps with its form, by name.
#pragma once

#include <oaidl.h>
#include <ocidl.h>

#include <string>
#include <utility>
#include <vector>

#include "platform/variant.h"
#include "workbench/com_object.h"

namespace frontpanels::workbench {

using Properties = std::vector<std::pair<std::string, Variant>>;

class PropertyBag final : public ComObject<IPropertyBag> {
 public:
  explicit PropertyBag(Properties properties) : properties_(std::move(properties)) {}
  [[nodiscard]] const Properties& properties() const noexcept { return properties_; }

  // E_INVALIDARG for a name that is not there: the panel then keeps what it has.
  HRESULT STDMETHODCALLTYPE Read(LPCOLESTR name, VARIANT* value, IErrorLog* errors) override;
  HRESULT STDMETHODCALLTYPE Write(LPCOLESTR name, VARIANT* value) override;

 private:
  ~PropertyBag() override = default;
  [[nodiscard]] void* findInterface(REFIID id) noexcept override;

  Properties properties_;
};

}  // namespace frontpanels::workbench

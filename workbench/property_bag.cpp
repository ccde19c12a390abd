#include "workbench/property_bag.h"

#include <algorithm>

#include "platform/win32/utf16.h"
#include "workbench/automation.h"
#include "workbench/failure.h"

namespace frontpanels::workbench {
namespace {

auto find(Properties& properties, const std::string& name) {
  return std::find_if(properties.begin(), properties.end(),
                      [&name](const auto& property) { return property.first == name; });
}

}  // namespace

void* PropertyBag::findInterface(REFIID id) noexcept {
  return id == IID_IUnknown || id == IID_IPropertyBag ? static_cast<IPropertyBag*>(this) : nullptr;
}

HRESULT PropertyBag::Read(LPCOLESTR name, VARIANT* value, IErrorLog*) {
  return comBarrier([&]() -> HRESULT {
    if (name == nullptr || value == nullptr) return E_POINTER;
    const auto found = find(properties_, toUtf8(name));
    if (found == properties_.end()) return E_INVALIDARG;
    // The type that is wanted comes in with the empty value.
    const VARTYPE wanted = value->vt;
    Value stored = Value::of(found->second);
    if (wanted == VT_EMPTY) return VariantCopy(value, stored.inPlace());
    return VariantChangeType(value, stored.inPlace(), 0, wanted);
  });
}

HRESULT PropertyBag::Write(LPCOLESTR name, VARIANT* value) {
  return comBarrier([&]() -> HRESULT {
    if (name == nullptr || value == nullptr) return E_POINTER;
    const std::string key = toUtf8(name);
    Variant kept = variantOf(*value);
    if (const auto found = find(properties_, key); found != properties_.end()) {
      found->second = std::move(kept);
    } else {
      properties_.emplace_back(key, std::move(kept));
    }
    return S_OK;
  });
}

}  // namespace frontpanels::workbench

#include "activex/data_hub_object.h"

#include "activex/late_notices.h"
#include "activex/services.h"
#include "activex/variants.h"

namespace frontpanels::activex {

HRESULT DataHubObject::Publish(BSTR path, VARIANT values) {
  return barrier(IID_IDataHub, [&] {
    const std::string name = fromBstr(path);
    DataHub& hub = services().hub;
    const LateNotices notices;
    // A sweep of singles goes through without an array of its own.
    if (!withSingles(values, [&](std::span<const float> singles) { hub.publish(name, singles); }))
      hub.publish(name, fromAutomation(values));
  });
}

HRESULT DataHubObject::ItemCount(BSTR path, LONG* count) {
  if (count == nullptr) return E_POINTER;
  *count = 0;
  return barrier(IID_IDataHub, [&] { *count = services().hub.itemCount(fromBstr(path)); });
}

HRESULT DataHubObject::Value(BSTR path, LONG index, VARIANT* value) {
  if (value == nullptr) return E_POINTER;
  VariantInit(value);
  return barrier(IID_IDataHub, [&] {
    *value = toAutomation(services().hub.value(fromBstr(path), static_cast<std::int32_t>(index)));
  });
}

void* DataHubObject::findInterface(REFIID id) noexcept {
  if (id == IID_IDataHub || id == IID_IDispatch) return static_cast<IDataHub*>(this);
  if (id == IID_ISupportErrorInfo) return static_cast<ISupportErrorInfo*>(this);
  return nullptr;
}

}  // namespace frontpanels::activex

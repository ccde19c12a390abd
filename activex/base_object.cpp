#include "activex/base_object.h"

#include <oleauto.h>

#include <algorithm>
#include <cwchar>
#include <iterator>
#include <type_traits>
#include <utility>

#include "activex/barrier.h"
#include "activex/variants.h"

namespace frontpanels::activex {
namespace {

struct PropertyRow {
  const wchar_t* name;
  Variant (*read)(clsBaseVFP& base);
  void (*write)(clsBaseVFP& base, const Variant& value);  // null for one that only reads
};

// A value of the property's own type.
template <class T>
T as(const Variant& value) {
  if constexpr (std::is_same_v<T, bool>)
    return value.toBoolean();
  else if constexpr (std::is_same_v<T, std::int16_t>)
    return value.toInt16();
  else if constexpr (std::is_same_v<T, std::int32_t>)
    return value.toInt32();
  else if constexpr (std::is_same_v<T, float>)
    return value.toSingle();
  else if constexpr (std::is_same_v<T, double>)
    return value.toDouble();
  else
    return value.toText();
}

template <auto Member>
constexpr PropertyRow field(const wchar_t* name) {
  using T = std::remove_reference_t<decltype(std::declval<clsBaseVFP&>().*Member)>;
  return {name, [](clsBaseVFP& base) { return Variant(base.*Member); },
          [](clsBaseVFP& base, const Variant& value) { base.*Member = as<T>(value); }};
}

// Getter and setter of one name.
template <class T, T (clsBaseVFP::*Get)() const noexcept, void (clsBaseVFP::*Set)(T)>
constexpr PropertyRow property(const wchar_t* name) {
  return {name, [](clsBaseVFP& base) { return Variant((base.*Get)()); },
          [](clsBaseVFP& base, const Variant& value) { (base.*Set)(as<T>(value)); }};
}

const PropertyRow kProperties[] = {
    {L"closing", [](clsBaseVFP& base) { return Variant(base.closing()); }, nullptr},
    {L"resourceId", [](clsBaseVFP& base) { return Variant(base.resourceId()); },
     [](clsBaseVFP& base, const Variant& value) { base.resourceId(value.toInt32()); }},
    {L"resourceIdValid", [](clsBaseVFP& base) { return Variant(base.resourceIdValid()); },
     [](clsBaseVFP& base, const Variant& value) { base.resourceIdValid(value.toBoolean()); }},
    field<&clsBaseVFP::measurementId>(L"measurementId"),
    field<&clsBaseVFP::virtualFrontPanelId>(L"virtualFrontPanelId"),
    {L"frontPanelCaption", [](clsBaseVFP& base) { return Variant(base.frontPanelCaption()); },
     [](clsBaseVFP& base, const Variant& value) { base.frontPanelCaption(value.toText()); }},
    property<bool, &clsBaseVFP::rightPanelVisible, &clsBaseVFP::rightPanelVisible>(L"rightPanelVisible"),
    property<bool, &clsBaseVFP::bottomPanelVisible, &clsBaseVFP::bottomPanelVisible>(L"bottomPanelVisible"),
    property<bool, &clsBaseVFP::rightPanelEnabled, &clsBaseVFP::rightPanelEnabled>(L"rightPanelEnabled"),
    property<bool, &clsBaseVFP::bottomPanelEnabled, &clsBaseVFP::bottomPanelEnabled>(L"bottomPanelEnabled"),
    {L"displayState", [](clsBaseVFP& base) { return Variant(base.displayState()); }, nullptr},
    field<&clsBaseVFP::warnOnUnhandledParameters>(L"warnOnUnhandledParameters"),
    field<&clsBaseVFP::databasePeriod>(L"databasePeriod"),
    field<&clsBaseVFP::displayPeriod>(L"displayPeriod"),
    field<&clsBaseVFP::measurementPeriod>(L"measurementPeriod"),
    field<&clsBaseVFP::AttachToExistingForm>(L"AttachToExistingForm"),
    field<&clsBaseVFP::SupportsMarkerToCenter>(L"SupportsMarkerToCenter"),
    property<bool, &clsBaseVFP::saved, &clsBaseVFP::saved>(L"saved"),
    field<&clsBaseVFP::recordMode>(L"recordMode"),
    {L"loggingConfirmed", [](clsBaseVFP& base) { return Variant(base.loggingConfirmed()); }, nullptr},
    field<&clsBaseVFP::playback>(L"playback"),
    field<&clsBaseVFP::multipleMeasurementVfp>(L"multipleMeasurementVfp"),
    field<&clsBaseVFP::baseVfpID>(L"baseVfpID"),
    {L"Caption", [](clsBaseVFP& base) { return Variant(base.Caption()); },
     [](clsBaseVFP& base, const Variant& value) { base.Caption(value.toText()); }},
    field<&clsBaseVFP::captionStatus>(L"captionStatus"),
    field<&clsBaseVFP::windowOwner>(L"windowOwner"),
    field<&clsBaseVFP::CellNamingEnabled>(L"CellNamingEnabled"),
    field<&clsBaseVFP::resourceType>(L"resourceType"),
    field<&clsBaseVFP::frontPanelType>(L"frontPanelType"),
    field<&clsBaseVFP::winState>(L"winState"),
    field<&clsBaseVFP::hSplitter>(L"hSplitter"),
    field<&clsBaseVFP::vSplitter>(L"vSplitter"),
};

// Numbers of the properties are their places in the table, from 1.
const PropertyRow* findRow(DISPID member) noexcept {
  const auto count = static_cast<DISPID>(std::size(kProperties));
  return member >= 1 && member <= count ? &kProperties[member - 1] : nullptr;
}

DISPID idOf(const wchar_t* name) noexcept {
  DISPID id = 1;
  for (const PropertyRow& row : kProperties) {
    if (_wcsicmp(row.name, name) == 0) return id;
    ++id;
  }
  return DISPID_UNKNOWN;
}

}  // namespace

HRESULT BaseObject::QueryInterface(REFIID id, void** object) {
  if (object == nullptr) return E_POINTER;
  *object = nullptr;
  if (id != IID_IUnknown && id != IID_IDispatch) return E_NOINTERFACE;
  AddRef();
  *object = static_cast<IDispatch*>(this);
  return S_OK;
}

HRESULT BaseObject::GetTypeInfoCount(UINT* count) {
  if (count == nullptr) return E_POINTER;
  *count = 0;
  return S_OK;
}

HRESULT BaseObject::GetTypeInfo(UINT /*index*/, LCID /*locale*/, ITypeInfo** info) {
  if (info == nullptr) return E_POINTER;
  *info = nullptr;
  return DISP_E_BADINDEX;
}

HRESULT BaseObject::GetIDsOfNames(REFIID reserved, LPOLESTR* names, UINT count, LCID /*locale*/,
                                  DISPID* ids) {
  if (reserved != IID_NULL) return DISP_E_UNKNOWNINTERFACE;
  if (names == nullptr || ids == nullptr || count == 0) return E_INVALIDARG;
  std::fill(ids, ids + count, DISPID_UNKNOWN);  // properties have no named arguments
  ids[0] = idOf(names[0]);
  return count == 1 && ids[0] != DISPID_UNKNOWN ? S_OK : DISP_E_UNKNOWNNAME;
}

HRESULT BaseObject::Invoke(DISPID member, REFIID reserved, LCID /*locale*/, WORD flags,
                           DISPPARAMS* parameters, VARIANT* result, EXCEPINFO* /*exception*/,
                           UINT* badArgument) {
  if (reserved != IID_NULL) return DISP_E_UNKNOWNINTERFACE;
  if (parameters == nullptr) return E_POINTER;
  const PropertyRow* const row = findRow(member);
  const bool writes = (flags & (DISPATCH_PROPERTYPUT | DISPATCH_PROPERTYPUTREF)) != 0;
  if (row == nullptr || (writes && row->write == nullptr)) return DISP_E_MEMBERNOTFOUND;
  if (parameters->cArgs != (writes ? 1U : 0U)) return DISP_E_BADPARAMCOUNT;
  AddRef();
  const HRESULT done = barrier([&] {
    if (writes) return row->write(base(), fromAutomation(parameters->rgvarg[0]));
    const Variant value = row->read(base());
    if (result != nullptr) *result = toAutomation(value);
  });
  Release();
  if (FAILED(done) && badArgument != nullptr) *badArgument = 0;
  return done;
}

}  // namespace frontpanels::activex

#include "activex/base_object.h"

#include <type_traits>
#include <utility>

namespace frontpanels::activex {
namespace {

using Row = NamedMember<clsBaseVFP>;
using NoArguments = std::span<const Variant>;

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
constexpr Row field(const wchar_t* name) {
  using T = std::remove_reference_t<decltype(std::declval<clsBaseVFP&>().*Member)>;
  return {name, [](clsBaseVFP& base, NoArguments) { return Variant(base.*Member); },
          [](clsBaseVFP& base, const Variant& value) { base.*Member = as<T>(value); }};
}

// Getter and setter of one name.
template <class T, T (clsBaseVFP::*Get)() const noexcept, void (clsBaseVFP::*Set)(T)>
constexpr Row property(const wchar_t* name) {
  return {name, [](clsBaseVFP& base, NoArguments) { return Variant((base.*Get)()); },
          [](clsBaseVFP& base, const Variant& value) { (base.*Set)(as<T>(value)); }};
}

const Row kProperties[] = {
    {L"closing", [](clsBaseVFP& base, NoArguments) { return Variant(base.closing()); }, nullptr},
    {L"resourceId", [](clsBaseVFP& base, NoArguments) { return Variant(base.resourceId()); },
     [](clsBaseVFP& base, const Variant& value) { base.resourceId(value.toInt32()); }},
    {L"resourceIdValid", [](clsBaseVFP& base, NoArguments) { return Variant(base.resourceIdValid()); },
     [](clsBaseVFP& base, const Variant& value) { base.resourceIdValid(value.toBoolean()); }},
    field<&clsBaseVFP::measurementId>(L"measurementId"),
    field<&clsBaseVFP::virtualFrontPanelId>(L"virtualFrontPanelId"),
    {L"frontPanelCaption", [](clsBaseVFP& base, NoArguments) { return Variant(base.frontPanelCaption()); },
     [](clsBaseVFP& base, const Variant& value) { base.frontPanelCaption(value.toText()); }},
    property<bool, &clsBaseVFP::rightPanelVisible, &clsBaseVFP::rightPanelVisible>(L"rightPanelVisible"),
    property<bool, &clsBaseVFP::bottomPanelVisible, &clsBaseVFP::bottomPanelVisible>(L"bottomPanelVisible"),
    property<bool, &clsBaseVFP::rightPanelEnabled, &clsBaseVFP::rightPanelEnabled>(L"rightPanelEnabled"),
    property<bool, &clsBaseVFP::bottomPanelEnabled, &clsBaseVFP::bottomPanelEnabled>(L"bottomPanelEnabled"),
    {L"displayState", [](clsBaseVFP& base, NoArguments) { return Variant(base.displayState()); }, nullptr},
    field<&clsBaseVFP::warnOnUnhandledParameters>(L"warnOnUnhandledParameters"),
    field<&clsBaseVFP::databasePeriod>(L"databasePeriod"),
    field<&clsBaseVFP::displayPeriod>(L"displayPeriod"),
    field<&clsBaseVFP::measurementPeriod>(L"measurementPeriod"),
    field<&clsBaseVFP::AttachToExistingForm>(L"AttachToExistingForm"),
    field<&clsBaseVFP::SupportsMarkerToCenter>(L"SupportsMarkerToCenter"),
    property<bool, &clsBaseVFP::saved, &clsBaseVFP::saved>(L"saved"),
    field<&clsBaseVFP::recordMode>(L"recordMode"),
    {L"loggingConfirmed", [](clsBaseVFP& base, NoArguments) { return Variant(base.loggingConfirmed()); },
     nullptr},
    field<&clsBaseVFP::playback>(L"playback"),
    field<&clsBaseVFP::multipleMeasurementVfp>(L"multipleMeasurementVfp"),
    field<&clsBaseVFP::baseVfpID>(L"baseVfpID"),
    {L"Caption", [](clsBaseVFP& base, NoArguments) { return Variant(base.Caption()); },
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

}  // namespace

BaseObject::BaseObject() : NamedObject(kProperties) {}

}  // namespace frontpanels::activex

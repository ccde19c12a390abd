#include "activex/constituent_object.h"

namespace frontpanels::activex {
namespace {

using Self = const Constituent;
using Arguments = std::span<const Variant>;

const NamedMember<Self> kMembers[] = {
    {L"Text", [](Self& self, Arguments) { return Variant(self.Text()); },
     [](Self& self, const Variant& value) { self.Text(value.toText()); }},
    {L"Value", [](Self& self, Arguments) { return self.Value(); },
     [](Self& self, const Variant& value) { self.Value(value); }},
    {L"Enabled", [](Self& self, Arguments) { return Variant(self.Enabled()); }, nullptr},
    {L"Visible", [](Self& self, Arguments) { return Variant(self.Visible()); }, nullptr},
    {L"Caption", [](Self& self, Arguments) { return Variant(self.Caption()); }, nullptr},
    {L"ListIndex", [](Self& self, Arguments) { return Variant(self.ListIndex()); },
     [](Self& self, const Variant& value) { self.ListIndex(value.toInt32()); }},
    {L"ListCount", [](Self& self, Arguments) { return Variant(self.ListCount()); }, nullptr},
    {L"List", [](Self& self, Arguments given) { return Variant(self.List(given[0].toInt32())); }, nullptr, 1},
    {L"ItemData", [](Self& self, Arguments given) { return Variant(self.ItemData(given[0].toInt32())); },
     nullptr, 1},
    {L"Click", [](Self& self, Arguments) { return self.Click(), Variant(); }, nullptr},
    {L"KeyPress", [](Self& self, Arguments given) { return self.KeyPress(given[0].toInt16()), Variant(); },
     nullptr, 1},
    {L"SpinUp", [](Self& self, Arguments) { return self.SpinUp(), Variant(); }, nullptr},
    {L"SpinDown", [](Self& self, Arguments) { return self.SpinDown(), Variant(); }, nullptr},
};

}  // namespace

ConstituentObject::ConstituentObject(IUnknown* panel, Control& control)
    : NamedObject(kMembers), panel_(panel), constituent_(control) {}

}  // namespace frontpanels::activex

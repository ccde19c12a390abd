#include "platform/constituent.h"

#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

template <class T>
T& as(Control& control) {
  auto* const wanted = dynamic_cast<T*>(&control);
  if (wanted == nullptr) raiseMemberNotSupported();
  return *wanted;
}

void choose(ItemList& list, const std::string& text) {
  for (std::int32_t index = 0; index < list.ListCount(); ++index)
    if (list.item(index).text == text) return list.userChoice(index);
  raiseInvalidProcedureCall();
}

std::string withoutMark(const std::string& caption) {
  std::string shown;
  for (std::size_t at = 0; at < caption.size(); ++at) {
    if (caption[at] == '&' && ++at == caption.size()) break;
    shown += caption[at];
  }
  return shown;
}

}  // namespace

std::string Constituent::Text() const {
  if (const auto* const list = dynamic_cast<const ItemList*>(&control_)) return list->Text();
  return as<TextBox>(control_).Text();
}

void Constituent::Text(const std::string& text) const {
  auto* const list = dynamic_cast<ItemList*>(&control_);
  TextBox* const box = list == nullptr ? &as<TextBox>(control_) : nullptr;
  if (!control_.usable()) return;
  if (list != nullptr)
    choose(*list, text);
  else
    box->Text(text);
}

Variant Constituent::Value() const {
  if (const auto* const box = dynamic_cast<const CheckBox*>(&control_)) return box->Value();
  return as<OptionButton>(control_).Value();
}

void Constituent::Value(const Variant& value) const {
  if (auto* const box = dynamic_cast<CheckBox*>(&control_)) {
    const std::int16_t wanted = value.toBoolean() ? 1 : 0;
    if (wanted != box->Value()) box->userClick();
    return;
  }
  auto& option = as<OptionButton>(control_);
  if (value.toBoolean())
    option.userClick();
  else if (option.Value() && option.usable())
    raiseInvalidProcedureCall();
}

std::int32_t Constituent::ListIndex() const { return as<ItemList>(control_).ListIndex(); }

void Constituent::ListIndex(std::int32_t index) const {
  auto& list = as<ItemList>(control_);
  if (list.usable()) list.userChoice(index);
}

std::int32_t Constituent::ListCount() const { return as<ItemList>(control_).ListCount(); }

std::string Constituent::List(std::int32_t index) const { return as<ItemList>(control_).item(index).text; }

std::int32_t Constituent::ItemData(std::int32_t index) const {
  return as<ItemList>(control_).item(index).data;
}

std::string Constituent::Caption() const {
  if (!facetsOf(control_.kind()).hasCaption) raiseMemberNotSupported();
  return withoutMark(control_.Caption());
}

void Constituent::Click() const {
  if (!facetsOf(control_.kind()).takesFocus) raiseMemberNotSupported();
  control_.SetFocus();
  control_.userClick();
}

void Constituent::KeyPress(std::int16_t character) const {
  if (!facetsOf(control_.kind()).takesFocus) raiseMemberNotSupported();
  control_.SetFocus();
  control_.userKey(character);
}

void Constituent::SpinUp() const { as<SpinButton>(control_).press(true); }

void Constituent::SpinDown() const { as<SpinButton>(control_).press(false); }

}  // namespace frontpanels

#include "platform/controls.h"

#include <algorithm>
#include <iterator>

#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

constexpr std::int16_t kBackspace = 8;
constexpr std::int16_t kEnter = 13;
constexpr std::int16_t kBlank = 32;
constexpr std::int16_t kShift = 1;

// In the order of ControlKind.
constexpr ControlFacets kFacets[] = {
    {.takesFocus = false, .hasCaption = true, .contains = true},    // Frame
    {.takesFocus = false, .hasCaption = true, .contains = false},   // Label
    {.takesFocus = true, .hasCaption = false, .contains = false},   // TextBox
    {.takesFocus = false, .hasCaption = false, .contains = false},  // SpinButton
    {.takesFocus = true, .hasCaption = false, .contains = false},   // ComboBox
    {.takesFocus = true, .hasCaption = false, .contains = false},   // ListBox
    {.takesFocus = true, .hasCaption = true, .contains = false},    // CheckBox
    {.takesFocus = true, .hasCaption = true, .contains = false},    // OptionButton
    {.takesFocus = true, .hasCaption = true, .contains = false},    // PushButton
    {.takesFocus = false, .hasCaption = false, .contains = true},   // Picture
};

struct Key {
  std::int16_t code;
  std::int16_t shift;
};

// The key that types a character. Signs lie elsewhere on each keyboard, so theirs has no number.
Key keyOf(std::int16_t character) {
  if (character >= 'a' && character <= 'z') return {static_cast<std::int16_t>(character - 'a' + 'A'), 0};
  if (character >= 'A' && character <= 'Z') return {character, kShift};
  const bool own = (character >= '0' && character <= '9') || (character > 0 && character <= kBlank);
  return {own ? character : std::int16_t{0}, 0};
}

void appendUtf8(std::string& text, std::uint16_t unit) {
  constexpr std::uint16_t kFirstSurrogate = 0xD800;
  constexpr std::uint16_t kLastSurrogate = 0xDFFF;
  if (unit >= kFirstSurrogate && unit <= kLastSurrogate) raiseInvalidProcedureCall();
  const auto tail = [unit](unsigned shift) { return static_cast<char>(0x80U | ((unit >> shift) & 0x3FU)); };
  if (unit < 0x80U) {
    text += static_cast<char>(unit);
  } else if (unit < 0x800U) {
    text += static_cast<char>(0xC0U | (unit >> 6U));
    text += tail(0);
  } else {
    text += static_cast<char>(0xE0U | (unit >> 12U));
    text += tail(6);
    text += tail(0);
  }
}

void removeLastCharacter(std::string& text) {
  const auto isContinuation = [](char c) { return (static_cast<unsigned char>(c) & 0xC0U) == 0x80U; };
  while (!text.empty() && isContinuation(text.back())) text.pop_back();
  if (!text.empty()) text.pop_back();
}

}  // namespace

ControlFacets facetsOf(ControlKind kind) noexcept { return kFacets[static_cast<std::size_t>(kind)]; }

// --- All kinds

bool Control::reallyVisible() const noexcept {
  return visible_ && (parent_ == nullptr || parent_->reallyVisible());
}

bool Control::reallyEnabled() const noexcept {
  return enabled_ && (parent_ == nullptr || parent_->reallyEnabled());
}

void Control::SetFocus() {
  if (!facetsOf(kind_).takesFocus || !usable()) return;
  if (peer_ != nullptr)
    peer_->takeFocus();
  else if (scope_ != nullptr)
    scope_->moveFocus(*this);
  else
    focusChanged(true);
}

void Control::setUsability(bool& field, bool value, ControlChange change) {
  // Asked for before: a window that is disabled loses the focus by itself.
  Control* const focused = scope_ == nullptr ? nullptr : scope_->focused();
  set(field, value, change);
  if (focused != nullptr && !focused->usable()) scope_->leave(*focused);
}

void Control::userClick() {
  if (usable()) raise(Click);
}

void Control::userKey(std::int16_t code) {
  if (!usable()) return;
  const Key key = keyOf(code);
  if (KeyDown) KeyDown(key.code, key.shift);
  std::int16_t character = code;
  if (KeyPress) KeyPress(character);
  if (character != 0) applyKey(character);
}

// --- Text boxes

void TextBox::Text(std::string text) {
  if (text == text_) return;
  text_ = std::move(text);
  allSelected_ = false;
  tell(ControlChange::Text);
  raise(Change);
}

void TextBox::userText(std::string text) {
  if (text == text_) return;
  text_ = std::move(text);
  allSelected_ = false;
  raise(Change);
}

void TextBox::applyKey(std::int16_t character) {
  std::string text = allSelected_ ? std::string() : Text();
  if (character == kBackspace)
    removeLastCharacter(text);
  else if (character < 0 || character >= kBlank)
    appendUtf8(text, static_cast<std::uint16_t>(character));
  else
    return;
  Text(std::move(text));
}

// --- Buttons

void CheckBox::Value(std::int16_t value) {
  if (value != 0 && value != 1) raiseInvalidProcedureCall();
  if (value == value_) return;
  value_ = value;
  tell(ControlChange::Value);
  raise(Click);
}

void CheckBox::userClick() {
  if (usable()) Value(value_ == 0 ? 1 : 0);
}

void CheckBox::applyKey(std::int16_t character) {
  if (character == kBlank) userClick();
}

void OptionButton::Value(bool chosen) {
  if (chosen == chosen_) return;
  if (chosen && group_ != nullptr)
    for (OptionButton* const other : *group_)
      if (other != this) other->show(false);
  show(chosen);
  if (chosen) raise(Click);
}

void OptionButton::show(bool chosen) { set(chosen_, chosen, ControlChange::Value); }

void OptionButton::userClick() {
  if (usable()) Value(true);
}

void OptionButton::applyKey(std::int16_t character) {
  if (character == kBlank) userClick();
}

void PushButton::applyKey(std::int16_t character) {
  if (character == kBlank || character == kEnter) userClick();
}

// --- Lists

const ItemList::Item& ItemList::item(std::int32_t index) const {
  if (index < 0 || index >= ListCount()) raiseSubscriptOutOfRange();
  return items_[static_cast<std::size_t>(index)];
}

void ItemList::AddItem(std::string text, std::int32_t data) { AddItem(std::move(text), data, ListCount()); }

void ItemList::AddItem(std::string text, std::int32_t data, std::int32_t index) {
  if (index < 0 || index > ListCount()) raiseSubscriptOutOfRange();
  items_.insert(items_.begin() + index, Item{std::move(text), data});
  if (index <= listIndex_) ++listIndex_;
  if (peer() != nullptr) peer()->itemAdded(index);
}

void ItemList::RemoveItem(std::int32_t index) {
  static_cast<void>(item(index));
  items_.erase(items_.begin() + index);
  if (index == listIndex_)
    listIndex_ = -1;
  else if (index < listIndex_)
    --listIndex_;
  if (peer() != nullptr) peer()->itemRemoved(index);
}

void ItemList::Clear() {
  items_.clear();
  listIndex_ = -1;
  tell(ControlChange::Items);
}

void ItemList::ListIndex(std::int32_t index) {
  if (index != -1) static_cast<void>(item(index));
  if (index == listIndex_) return;
  listIndex_ = index;
  tell(ControlChange::ListIndex);
  raise(Click);
}

void ItemList::userChoice(std::int32_t index) {
  static_cast<void>(item(index));
  listIndex_ = index;
  tell(ControlChange::ListIndex);
  raise(Click);
}

void ItemList::userClick() {
  if (usable() && listIndex_ >= 0) userChoice(listIndex_);
}

}  // namespace frontpanels

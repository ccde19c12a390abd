// clsEnumeratedParameter: a drop-down list bound to one enumerated host parameter. The items carry the type's
// values as item data; the selected item and the value follow each other.
#pragma once

#include <cstdint>
#include <string_view>

#include "entry/host_record.h"
#include "platform/controls.h"

namespace frontpanels {

class clsEnumeratedParameter {
 public:
  static constexpr std::string_view kTypeName = "clsEnumeratedParameter";

  // The bound list, which must outlive the binding; another kind of list than a drop-down one is reported
  // and bound all the same. The list's click is the owner's to forward.
  [[nodiscard]] ItemList* ComboBox() const noexcept { return list_; }
  void ComboBox(ItemList* list) noexcept;
  [[nodiscard]] Control* Label() const noexcept { return label_; }
  void Label(Control* label) noexcept { label_ = label; }

  // Of the list; false without one. Set on list and label.
  [[nodiscard]] bool Enabled() const noexcept { return list_ != nullptr && list_->Enabled(); }
  void Enabled(bool enabled) noexcept;
  [[nodiscard]] bool Visible() const noexcept { return list_ != nullptr && list_->Visible(); }
  void Visible(bool visible) noexcept;

  // 0 is none. A new type fills the list anew.
  [[nodiscard]] std::int32_t parameterType() const noexcept { return parameterType_; }
  void parameterType(std::int32_t type) noexcept;
  // While set, a new type empties the list, which then holds what Add and Limits put there.
  [[nodiscard]] bool subset() const noexcept { return subset_; }
  void subset(bool subset) noexcept { subset_ = subset; }
  // A value that no item carries is stored and reported, and the selection stays.
  [[nodiscard]] std::int16_t value() const noexcept { return value_; }
  void value(std::int16_t value) noexcept;
  // Whether the latest click changed the value.
  [[nodiscard]] bool newValue() const noexcept { return newValue_; }

  void Add(std::int16_t value) noexcept;
  void Remove(std::int16_t value) noexcept;
  // Selects the value's item again, where there is one.
  void Update() noexcept;
  // Adds every value between the limits of each record; nothing at all where a limit has no 16-bit value.
  void Limits(const HostRecordSet& records) noexcept;

  // What the list tells. Only a click has an effect.
  void Click() noexcept;
  void change() noexcept {}
  void DblClick() noexcept {}
  void DragDrop() noexcept {}
  void DragOver() noexcept {}
  void DropDown() noexcept {}
  void GotFocus() noexcept {}
  void KeyDown(std::int16_t /*keyCode*/, std::int16_t /*shift*/) noexcept {}
  void KeyPress(std::int16_t& /*character*/) noexcept {}
  void KeyUp(std::int16_t /*keyCode*/, std::int16_t /*shift*/) noexcept {}
  void LostFocus() noexcept {}

 private:
  // Raises "Object variable or With block variable not set" while no list is bound.
  [[nodiscard]] ItemList& list() const;
  // The last item that carries the value, -1 when none does.
  [[nodiscard]] std::int32_t itemOf(std::int16_t value) const;
  void addItem(std::int16_t value) const;
  void fill() const;
  void select() const;

  ItemList* list_ = nullptr;
  Control* label_ = nullptr;
  std::int32_t parameterType_ = 0;
  std::int16_t value_ = 0;
  bool newValue_ = false;
  bool subset_ = false;
};

}  // namespace frontpanels

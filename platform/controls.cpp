#include "platform/controls.h"

#include "platform/runtime_error.h"

namespace frontpanels {

const ItemList::Item& ItemList::item(std::int32_t index) const {
  if (index < 0 || index >= ListCount()) raiseSubscriptOutOfRange();
  return items_[static_cast<std::size_t>(index)];
}

void ItemList::AddItem(std::string text, std::int32_t data) { AddItem(std::move(text), data, ListCount()); }

void ItemList::AddItem(std::string text, std::int32_t data, std::int32_t index) {
  if (index < 0 || index > ListCount()) raiseSubscriptOutOfRange();
  items_.insert(items_.begin() + index, Item{std::move(text), data});
  if (index <= listIndex_) ++listIndex_;
  tell(ControlChange::Items);
}

void ItemList::RemoveItem(std::int32_t index) {
  static_cast<void>(item(index));
  items_.erase(items_.begin() + index);
  if (index == listIndex_)
    listIndex_ = -1;
  else if (index < listIndex_)
    --listIndex_;
  tell(ControlChange::Items);
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

}  // namespace frontpanels

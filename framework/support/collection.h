// An ordered collection, counted from 1, whose items may carry a text key. Item 1 is the oldest unless an
// item was added before it.
#pragma once

#include <algorithm>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "platform/runtime_error.h"

namespace frontpanels {

template <class T>
class Collection {
 public:
  [[nodiscard]] std::size_t count() const noexcept { return entries_.size(); }
  [[nodiscard]] bool empty() const noexcept { return entries_.empty(); }
  [[nodiscard]] bool contains(std::string_view key) const noexcept {
    return position(key) != entries_.size();
  }

  // An empty key means none. Raises error 457 when the key is taken.
  void add(T item, std::string key = {}) { insert(entries_.size(), std::move(item), std::move(key)); }
  // Raises "Subscript out of range" when there is no item `index`.
  void addBefore(T item, std::string key, std::size_t index) {
    insert(checked(index), std::move(item), std::move(key));
  }

  // Raises "Subscript out of range".
  [[nodiscard]] T& item(std::size_t index) { return entries_[checked(index)].item; }
  [[nodiscard]] const T& item(std::size_t index) const { return entries_[checked(index)].item; }
  // Raises "Invalid procedure call or argument" when no item has the key.
  [[nodiscard]] T& item(std::string_view key) { return entries_[checked(key)].item; }
  [[nodiscard]] const T& item(std::string_view key) const { return entries_[checked(key)].item; }

  void remove(std::size_t index) { erase(checked(index)); }
  void remove(std::string_view key) { erase(checked(key)); }
  void clear() noexcept { entries_.clear(); }

  // Items in order.
  [[nodiscard]] auto begin() { return ItemIterator{entries_.begin()}; }
  [[nodiscard]] auto end() { return ItemIterator{entries_.end()}; }
  [[nodiscard]] auto begin() const { return ItemIterator{entries_.begin()}; }
  [[nodiscard]] auto end() const { return ItemIterator{entries_.end()}; }

 private:
  struct Entry {
    T item;
    std::string key;
  };
  template <class Base>
  struct ItemIterator {
    Base base;
    auto& operator*() const { return base->item; }
    ItemIterator& operator++() {
      ++base;
      return *this;
    }
    bool operator==(const ItemIterator&) const = default;
  };
  template <class Base>
  ItemIterator(Base) -> ItemIterator<Base>;

  [[nodiscard]] std::size_t position(std::string_view key) const noexcept {
    const auto found = std::find_if(entries_.begin(), entries_.end(), [key](const Entry& entry) {
      return !entry.key.empty() && entry.key == key;
    });
    return static_cast<std::size_t>(found - entries_.begin());
  }
  [[nodiscard]] std::size_t checked(std::size_t index) const {
    if (index < 1 || index > entries_.size()) raiseSubscriptOutOfRange();
    return index - 1;
  }
  [[nodiscard]] std::size_t checked(std::string_view key) const {
    const std::size_t at = position(key);
    if (at == entries_.size()) raiseInvalidProcedureCall();
    return at;
  }
  void insert(std::size_t at, T item, std::string key) {
    if (!key.empty() && contains(key)) raiseDuplicateKey();
    entries_.insert(entries_.begin() + static_cast<std::ptrdiff_t>(at),
                    Entry{std::move(item), std::move(key)});
  }
  void erase(std::size_t at) { entries_.erase(entries_.begin() + static_cast<std::ptrdiff_t>(at)); }

  std::vector<Entry> entries_;
};

}  // namespace frontpanels

// Objects in slots that are reused: once a pool has grown to what a program needs at a time, adding and
// removing allocate nothing. A handle carries its slot's generation, so one that was removed is recognised.
#pragma once

#include <cstddef>
#include <cstdint>
#include <new>
#include <utility>
#include <vector>

namespace frontpanels {

template <class T, class H>
class Pool {
 public:
  // Null when the pool is full or memory is short.
  [[nodiscard]] H add(T&& value) noexcept {
    if (free_ == kNone && !grow()) return {};
    Slot& slot = slots_[free_];
    const std::size_t index = std::exchange(free_, slot.nextFree);
    slot.value = std::move(value);
    slot.live = true;
    ++live_;
    return H{slot.generation << kIndexBits | (index + 1)};
  }

  // Null for a handle that this pool did not give out or that was removed. Valid until the next add.
  [[nodiscard]] T* find(H handle) noexcept {
    const std::size_t index = (handle.value & kIndexMask) - 1;  // wraps round for a null handle
    if (index >= slots_.size()) return nullptr;
    Slot& slot = slots_[index];
    return slot.live && slot.generation == handle.value >> kIndexBits ? &slot.value : nullptr;
  }

  bool remove(H handle) noexcept {
    if (find(handle) == nullptr) return false;
    const std::size_t index = (handle.value & kIndexMask) - 1;
    Slot& slot = slots_[index];
    slot.value = T{};
    slot.live = false;
    slot.generation = (slot.generation + 1) & (kIndexMask >> 8);
    slot.nextFree = std::exchange(free_, index);
    --live_;
    return true;
  }

  [[nodiscard]] std::size_t live() const noexcept { return live_; }

 private:
  static constexpr unsigned kIndexBits = 20;
  static constexpr std::uintptr_t kIndexMask = (std::uintptr_t{1} << kIndexBits) - 1;
  static constexpr std::size_t kNone = ~std::size_t{0};

  struct Slot {
    T value{};
    std::uintptr_t generation = 1;
    std::size_t nextFree = kNone;
    bool live = false;
  };

  bool grow() noexcept {
    if (slots_.size() >= kIndexMask) return false;
    try {
      slots_.emplace_back();
    } catch (const std::bad_alloc&) {
      return false;
    }
    free_ = slots_.size() - 1;
    return true;
  }

  std::vector<Slot> slots_;
  std::size_t free_ = kNone;
  std::size_t live_ = 0;
};

}  // namespace frontpanels

// An owning pointer to an interface.
#pragma once

#include <unknwn.h>

#include <utility>

namespace frontpanels {

template <class Interface>
class ComPointer {
 public:
  ComPointer() = default;
  // Shares the reference: the caller keeps his own.
  explicit ComPointer(Interface* shared) noexcept : pointer_(shared) {
    if (pointer_ != nullptr) pointer_->AddRef();
  }
  // Takes over the caller's reference.
  [[nodiscard]] static ComPointer adopt(Interface* owned) noexcept {
    ComPointer pointer;
    pointer.pointer_ = owned;
    return pointer;
  }
  ComPointer(const ComPointer& other) noexcept : ComPointer(other.pointer_) {}
  ComPointer(ComPointer&& other) noexcept : pointer_(std::exchange(other.pointer_, nullptr)) {}
  ComPointer& operator=(ComPointer other) noexcept {
    std::swap(pointer_, other.pointer_);
    return *this;
  }
  ~ComPointer() { reset(); }

  // The member is empty before the object goes: its last release may call back into the owner.
  void reset() noexcept {
    if (Interface* const released = std::exchange(pointer_, nullptr)) released->Release();
  }
  // Gives the reference to the caller.
  [[nodiscard]] Interface* detach() noexcept { return std::exchange(pointer_, nullptr); }
  [[nodiscard]] Interface* get() const noexcept { return pointer_; }
  Interface* operator->() const noexcept { return pointer_; }
  explicit operator bool() const noexcept { return pointer_ != nullptr; }

  // For functions that hand an interface out through an argument.
  [[nodiscard]] Interface** receive() noexcept {
    reset();
    return &pointer_;
  }

  // Empty when the object does not have the interface.
  template <class Other>
  [[nodiscard]] ComPointer<Other> query() const noexcept {
    ComPointer<Other> other;
    if (pointer_ != nullptr)
      pointer_->QueryInterface(__uuidof(Other), reinterpret_cast<void**>(other.receive()));
    return other;
  }

 private:
  Interface* pointer_ = nullptr;
};

}  // namespace frontpanels

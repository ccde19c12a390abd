// A stored value that is read by name() and written by name(value).
#pragma once

#include <utility>

namespace frontpanels {

template <class T>
class Property {
 public:
  Property() = default;
  explicit Property(T value) : value_(std::move(value)) {}

  [[nodiscard]] const T& operator()() const noexcept { return value_; }
  void operator()(T value) { value_ = std::move(value); }

 private:
  T value_{};
};

}  // namespace frontpanels

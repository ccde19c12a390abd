// A value that a variable has, a flag that is up, for as long as a block runs, nested blocks included.
#pragma once

#include <utility>

namespace frontpanels {

template <class T>
class ValueScope {
 public:
  ValueScope(T& variable, T value) noexcept : variable_(variable), before_(std::exchange(variable, value)) {}
  ~ValueScope() { variable_ = before_; }
  ValueScope(const ValueScope&) = delete;
  ValueScope& operator=(const ValueScope&) = delete;

 private:
  T& variable_;
  T before_;
};

class FlagScope {
 public:
  explicit FlagScope(bool& flag) noexcept : up_(flag, true) {}

 private:
  ValueScope<bool> up_;
};

}  // namespace frontpanels

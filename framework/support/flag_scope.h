// A flag that is up for as long as a block runs, nested blocks included.
#pragma once

#include <utility>

namespace frontpanels {

class FlagScope {
 public:
  explicit FlagScope(bool& flag) noexcept : flag_(flag), before_(std::exchange(flag, true)) {}
  ~FlagScope() { flag_ = before_; }
  FlagScope(const FlagScope&) = delete;
  FlagScope& operator=(const FlagScope&) = delete;

 private:
  bool& flag_;
  bool before_;
};

}  // namespace frontpanels

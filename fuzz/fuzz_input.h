// The fuzzer's bytes taken apart from the front, and what a target says when its subject breaks a promise.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <span>

namespace frontpanels::fuzz {

class FuzzInput {
 public:
  explicit FuzzInput(std::span<const std::uint8_t> bytes) : bytes_(bytes) {}

  [[nodiscard]] bool empty() const noexcept { return bytes_.empty(); }

  // A number as its bytes stand, with zeros for bytes that are not there: every input means something.
  template <class T>
  [[nodiscard]] T number() noexcept {
    const std::span<const std::uint8_t> taken = bytes(sizeof(T));
    T value{};
    if (!taken.empty()) std::memcpy(&value, taken.data(), taken.size());
    return value;
  }
  // So many bytes, or as many as there are.
  std::span<const std::uint8_t> bytes(std::size_t count) noexcept {
    const std::span<const std::uint8_t> taken = bytes_.first(std::min(count, bytes_.size()));
    bytes_ = bytes_.subspan(taken.size());
    return taken;
  }
  std::span<const std::uint8_t> rest() noexcept { return bytes(bytes_.size()); }

 private:
  std::span<const std::uint8_t> bytes_;
};

// Ends the program, which makes the fuzzer keep the input.
inline void require(bool kept, const char* promise) {
  if (kept) return;
  std::fprintf(stderr, "broken promise: %s\n", promise);
  std::abort();
}

}  // namespace frontpanels::fuzz

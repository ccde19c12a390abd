// Numbers as they stand in files: the shortest text that reads as the same number, without an exponent where
// people need none, "." as separator whatever the locale.
#pragma once

#include <array>
#include <charconv>
#include <cmath>
#include <optional>
#include <string>
#include <string_view>
#include <system_error>
#include <type_traits>

namespace frontpanels {

template <class T>
[[nodiscard]] std::string exactText(T number) {
  static_assert(std::is_arithmetic_v<T> && !std::is_same_v<T, bool>);
  std::array<char, 40> text{};
  char* const end = text.data() + text.size();
  if constexpr (std::is_floating_point_v<T>) {
    const T size = std::fabs(number);
    if (size == 0 || (size >= T(1e-5) && size < T(1e15)))
      return {text.data(), std::to_chars(text.data(), end, number, std::chars_format::fixed).ptr};
  }
  return {text.data(), std::to_chars(text.data(), end, number).ptr};
}

// Nothing unless the whole text is a number that fits.
template <class T>
[[nodiscard]] std::optional<T> exactNumber(std::string_view text) {
  static_assert(std::is_arithmetic_v<T> && !std::is_same_v<T, bool>);
  T number{};
  const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
  if (error != std::errc{} || end != text.data() + text.size()) return std::nullopt;
  return number;
}

}  // namespace frontpanels

// Routines that every part of the system shares. Each reports its own failure and answers its fallback.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "platform/locale.h"
#include "platform/variant.h"
#include "platform/windowing.h"

namespace frontpanels {

// Base-10 logarithm; 0 after a reported failure, as for a number that is not positive.
[[nodiscard]] double Log10(double x) noexcept;

// `x` rounded away from zero to the next value of the 1-2-5 sequence; 0.0001 for 0 and after a reported
// failure.
[[nodiscard]] double OneTwoFive(double x) noexcept;

// Text that reads as a number is true unless it is 0; "true" and "false" in any case; anything else is
// reported and false.
[[nodiscard]] bool BooleanValue(std::string_view text) noexcept;

// The user's separators, each read from the system on its first use and kept: one instance serves a library's
// life.
class RegionalSeparators {
 public:
  // The locale must outlive this.
  explicit RegionalSeparators(const Locale& locale) : locale_(locale) {}

  // One character (UTF-8); "." and "," where the system names none.
  [[nodiscard]] const std::string& decimalSeparator();
  [[nodiscard]] const std::string& listSeparator();

  // The value's text with the user's decimal separator in place of "." where the value is a number or text
  // that reads as one; any other text as it is. Empty after a reported failure.
  [[nodiscard]] std::string RegionalValue(const Variant& value) noexcept;

 private:
  [[nodiscard]] const std::string& cached(std::string& separator, LocaleItem item,
                                          std::string_view fallback) const;

  const Locale& locale_;
  std::string decimal_;
  std::string list_;
};

// A list or combo box as far as a look-up needs it.
class ItemDataList {
 public:
  virtual ~ItemDataList() = default;

  [[nodiscard]] virtual std::int32_t listCount() const = 0;
  // `index` from 0 to the count less one.
  [[nodiscard]] virtual std::int32_t itemData(std::int32_t index) const = 0;
};

// Index of the first entry whose item data equals `value`, -1 when none does. Indices have 16 bits: entries
// behind index 32767 are not looked at.
[[nodiscard]] std::int16_t indexOfItemData(const ItemDataList& list, std::int32_t value) noexcept;

// Sets or clears a window's topmost state.
void AlwaysOnTop(Windowing& windowing, WindowHandle window, bool onTop) noexcept;

}  // namespace frontpanels

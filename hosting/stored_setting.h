// One setting of a panel as a host keeps it, and its value as a text of one line that gives type and value
// back exactly:
//   881500000     a Double: what most settings are        byte 7, integer -3, long 5, longlong 5, single 0.1
//   "a caption"   text                                    date 45292.5 (days), error -2147352572
//   true, false, empty, null                              integer() 1 2 3, and so on: arrays of numbers
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "platform/variant.h"

namespace frontpanels {

// As `vfpSet` takes it.
struct StoredSetting {
  std::int16_t code = 0;
  std::int16_t index = 0;
  Variant value;
  friend bool operator==(const StoredSetting&, const StoredSetting&) = default;
};

// Raises "Type mismatch" for what no text holds: an object, an array of variants. Text stands between quotes
// as it is, whatever it holds.
[[nodiscard]] std::string settingValueText(const Variant& value);
// Nothing for a text that is no value.
[[nodiscard]] std::optional<Variant> parseSettingValue(std::string_view text);

}  // namespace frontpanels

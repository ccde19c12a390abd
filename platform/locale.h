// The user's regional settings, as the operating system words them.
#pragma once

#include <cstdint>
#include <string>

namespace frontpanels {

enum class LocaleItem : std::int32_t { ListSeparator = 12, DecimalSeparator = 14 };

class Locale {
 public:
  virtual ~Locale() = default;

  // The value of an item for the current user, at most `maxChars` - 1 characters; empty when it is not known.
  [[nodiscard]] virtual std::string info(LocaleItem item, std::int32_t maxChars) const = 0;
};

}  // namespace frontpanels

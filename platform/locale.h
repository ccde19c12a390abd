// The user's regional settings, as the operating system words them.
#pragma once

#include <cstdint>
#include <string>
#include <utility>

namespace frontpanels {

enum class LocaleItem : std::int32_t { ListSeparator = 12, DecimalSeparator = 14 };

class Locale {
 public:
  virtual ~Locale() = default;

  // The value of an item for the current user, at most `maxChars` - 1 characters; empty when it is not known.
  [[nodiscard]] virtual std::string info(LocaleItem item, std::int32_t maxChars) const = 0;
};

// Settings that never change: for programs whose output must not depend on who runs them.
class FixedLocale final : public Locale {
 public:
  explicit FixedLocale(std::string decimalSeparator = ".", std::string listSeparator = ",")
      : decimal_(std::move(decimalSeparator)), list_(std::move(listSeparator)) {}

  [[nodiscard]] std::string info(LocaleItem item, std::int32_t maxChars) const override {
    const std::string& value = item == LocaleItem::DecimalSeparator ? decimal_ : list_;
    return maxChars < 1 ? std::string() : value.substr(0, static_cast<std::size_t>(maxChars) - 1);
  }

 private:
  std::string decimal_;
  std::string list_;
};

}  // namespace frontpanels

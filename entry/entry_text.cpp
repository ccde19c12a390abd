#include "entry/entry_text.h"

#include <algorithm>
#include <cmath>
#include <string>

#include "entry/number_format.h"
#include "platform/variant.h"

namespace frontpanels {
namespace {

constexpr std::string_view kBlanks = " \t\n\v\f\r";

constexpr bool isDigit(char c) noexcept { return c >= '0' && c <= '9'; }
constexpr char upperCased(char c) noexcept {
  return c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c;
}

std::string_view trimmed(std::string_view text) noexcept {
  text.remove_prefix(std::min(text.find_first_not_of(kBlanks), text.size()));
  return text.substr(0, text.find_last_not_of(kBlanks) + 1);
}

// The first of the records that match; null when they differ in scale.
template <class Matches>
const SuffixRecord* onlyOne(const SuffixTable& suffixes, Matches matches) noexcept {
  const SuffixRecord* found = nullptr;
  for (const SuffixRecord& record : suffixes) {
    if (!matches(record.name)) continue;
    if (found != nullptr && found->scale != record.scale) return nullptr;
    if (found == nullptr) found = &record;
  }
  return found;
}

// The number at the front of a text, moved out of it character by character.
class NumberTaker {
 public:
  explicit NumberTaker(std::string_view& rest) : rest_(rest) {}

  std::string take(std::string_view decimalSeparator) {
    takeSign();
    takeDigits();
    if (const std::size_t bytes = separatorBytes(decimalSeparator); bytes > 0) {
      rest_.remove_prefix(bytes);
      number_ += '.';
      takeDigits();
    }
    if (exponentFollows()) {
      takeOne();
      takeSign();
      takeDigits();
    }
    return std::move(number_);
  }

 private:
  void takeOne() {
    number_ += rest_.front();
    rest_.remove_prefix(1);
  }
  void takeSign() {
    if (rest_.starts_with('-') || rest_.starts_with('+')) takeOne();
  }
  void takeDigits() {
    while (!rest_.empty() && isDigit(rest_.front())) takeOne();
  }
  [[nodiscard]] std::size_t separatorBytes(std::string_view decimalSeparator) const {
    return rest_.starts_with(decimalSeparator) ? decimalSeparator.size() : rest_.starts_with('.') ? 1 : 0;
  }
  // A letter without digits behind it is the beginning of a unit.
  [[nodiscard]] bool exponentFollows() const {
    if (rest_.empty() || upperCased(rest_.front()) != 'E') return false;
    std::size_t digits = 1;
    if (rest_.size() > digits && (rest_[digits] == '-' || rest_[digits] == '+')) ++digits;
    return rest_.size() > digits && isDigit(rest_[digits]);
  }

  std::string_view& rest_;
  std::string number_;
};

}  // namespace

bool isBlankText(std::string_view text) noexcept { return trimmed(text).empty(); }

const SuffixRecord* suffixNamed(const SuffixTable& suffixes, std::string_view name) noexcept {
  const SuffixRecord* found = onlyOne(suffixes, [name](std::string_view other) { return other == name; });
  if (found == nullptr)
    found = onlyOne(suffixes, [name](std::string_view other) {
      return other.size() == name.size() && beginsWith(other, name);
    });
  if (found == nullptr)
    found = onlyOne(suffixes, [name](std::string_view other) { return beginsWith(other, name); });
  return found;
}

bool beginsWith(std::string_view name, std::string_view typed) noexcept {
  return typed.size() <= name.size() &&
         std::equal(typed.begin(), typed.end(), name.begin(),
                    [](char a, char b) { return upperCased(a) == upperCased(b); });
}

const SuffixRecord* suffixBegunBy(const SuffixTable& suffixes, std::int16_t character) noexcept {
  if (character <= 0 || character > '~') return nullptr;
  const auto letter = static_cast<char>(character);
  const auto* const found = std::find_if(
      suffixes.begin(), suffixes.end(),
      [letter](const SuffixRecord& record) { return beginsWith(record.name, std::string_view(&letter, 1)); });
  return found == suffixes.end() ? nullptr : found;
}

std::optional<double> parseEntryText(std::string_view text, const SuffixTable& suffixes, double shownScale,
                                     std::string_view decimalSeparator) {
  std::string_view rest = trimmed(text);
  double number = 0;
  if (!textToNumber(NumberTaker(rest).take(decimalSeparator), number)) return std::nullopt;
  double scale = shownScale;
  if (const std::string_view name = trimmed(rest); !name.empty()) {
    const SuffixRecord* const unit = suffixNamed(suffixes, name);
    if (unit == nullptr) return std::nullopt;
    scale = unit->scale;
  }
  // "2.01 k" is 2010 and no bit less.
  const double value = scale == 1 ? number : toSignificantDigits(number * scale);
  if (scale == 0 || !std::isfinite(value)) return std::nullopt;
  return value;
}

}  // namespace frontpanels

#include "platform/variant.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <string_view>

#include "platform/runtime_error.h"
#include "platform/whole_number.h"

namespace frontpanels {
namespace {

template <class... Handlers>
struct Overloaded : Handlers... {
  using Handlers::operator()...;
};
template <class... Handlers>
Overloaded(Handlers...) -> Overloaded<Handlers...>;

template <class T>
inline constexpr bool kIsVector = false;
template <class T>
inline constexpr bool kIsVector<std::vector<T>> = true;

constexpr bool isBlank(char c) noexcept { return c == ' ' || (c >= '\t' && c <= '\r'); }
constexpr bool isDigit(char c) noexcept { return c >= '0' && c <= '9'; }

std::string_view trimmed(std::string_view text) noexcept {
  while (!text.empty() && isBlank(text.front())) text.remove_prefix(1);
  while (!text.empty() && isBlank(text.back())) text.remove_suffix(1);
  return text;
}

bool equalsIgnoringCase(std::string_view text, std::string_view lowerCase) noexcept {
  return std::equal(text.begin(), text.end(), lowerCase.begin(), lowerCase.end(),
                    [](char a, char b) { return (a >= 'A' && a <= 'Z' ? a + ('a' - 'A') : a) == b; });
}

// An unsigned decimal number, taken apart.
struct Digits {
  std::string_view whole;
  std::string_view fraction;
  std::string_view exponent;  // with its sign; empty when there is none
  bool valid = false;
};

std::string_view takeDigits(std::string_view& rest) noexcept {
  const auto end = std::find_if_not(rest.begin(), rest.end(), isDigit);
  const std::string_view digits = rest.substr(0, static_cast<std::size_t>(end - rest.begin()));
  rest.remove_prefix(digits.size());
  return digits;
}

Digits takeApart(std::string_view rest) noexcept {
  Digits digits;
  digits.whole = takeDigits(rest);
  if (rest.starts_with('.')) {
    rest.remove_prefix(1);
    digits.fraction = takeDigits(rest);
  }
  if (digits.whole.empty() && digits.fraction.empty()) return digits;
  if (rest.starts_with('e') || rest.starts_with('E')) {
    rest.remove_prefix(1);
    digits.exponent = rest;
    if (rest.starts_with('+') || rest.starts_with('-')) rest.remove_prefix(1);
    if (takeDigits(rest).empty()) return digits;
  }
  digits.valid = rest.empty();
  return digits;
}

// Of a number that no double holds: whether it is too small rather than too large.
bool underflows(const Digits& digits) noexcept {
  const std::size_t leading = digits.whole.find_first_not_of('0');
  const std::size_t leadingFraction = digits.fraction.find_first_not_of('0');
  const double point = leading != std::string_view::npos ? static_cast<double>(digits.whole.size() - leading)
                                                         : -static_cast<double>(leadingFraction);
  double exponent = 0;
  std::string_view text = digits.exponent;
  const bool negative = text.starts_with('-');
  if (!text.empty() && !isDigit(text.front())) text.remove_prefix(1);
  for (const char c : text) exponent = exponent * 10 + (c - '0');
  return point + (negative ? -exponent : exponent) < 0;
}

// Puts the digits of a scientific text "d.ddde+xx" into the general form with `places` significant digits.
std::string generalForm(std::string_view scientific, int places) {
  std::string text(scientific.starts_with('-') ? "-" : "");
  if (!text.empty()) scientific.remove_prefix(1);
  const std::size_t e = scientific.find('e');
  std::string digits(1, scientific.front());
  if (e > 1) digits += scientific.substr(2, e - 2);
  digits.resize(std::max<std::size_t>(digits.find_last_not_of('0') + 1, 1));
  const bool small = scientific[e + 1] == '-';
  int exponent = 0;
  std::from_chars(scientific.data() + e + 2, scientific.data() + scientific.size(), exponent);
  if (small) exponent = -exponent;

  const int count = static_cast<int>(digits.size());
  if (exponent >= places || count - 1 - exponent > places) {
    text += digits.front();
    if (count > 1) text.append(1, '.').append(digits, 1);
    text.append(small ? "E-" : "E+").append(std::abs(exponent) < 10 ? "0" : "");
    return text += std::to_string(std::abs(exponent));
  }
  if (exponent < 0) return text.append("0.").append(static_cast<std::size_t>(-exponent - 1), '0') += digits;
  if (count <= exponent + 1)
    return text.append(digits).append(static_cast<std::size_t>(exponent + 1 - count), '0');
  const auto point = static_cast<std::size_t>(exponent + 1);
  return text.append(digits, 0, point).append(1, '.').append(digits, point);
}

template <class Float>
std::string toGeneralForm(Float number, int places) {
  if (std::isnan(number)) return "1.#QNAN";
  if (std::isinf(number)) return number < 0 ? "-1.#INF" : "1.#INF";
  if (number == 0) return "0";  // a negative zero too
  std::array<char, 40> text{};
  const auto end = std::to_chars(text.data(), text.data() + text.size(), number,
                                 std::chars_format::scientific, places - 1);
  return generalForm({text.data(), static_cast<std::size_t>(end.ptr - text.data())}, places);
}

double parsed(const std::string& text) {
  double number = 0;
  if (!textToNumber(text, number)) raiseTypeMismatch();
  return number;
}

std::string dateText(double days) {
  // The calendar of four-digit years: 1 January 100 to 31 December 9999.
  if (!(days > -657435 && days < 2958466)) raiseOverflow();
  // The fraction counts forward from midnight, before the first day as well: -1.25 is 29 December, 06:00.
  double day = std::trunc(days);
  double seconds = roundHalfEven(std::fabs(days - day) * 86400);
  if (seconds >= 86400) {
    seconds = 0;
    day += 1;
  }
  constexpr auto kFirstDay = std::chrono::sys_days(std::chrono::year(1899) / 12 / 30);
  const std::chrono::year_month_day date(kFirstDay + std::chrono::days(static_cast<int>(day)));
  const auto time = static_cast<unsigned>(seconds);
  std::array<char, 80> text{};
  int length = std::snprintf(text.data(), text.size(), "%04d-%02u-%02u", static_cast<int>(date.year()),
                             static_cast<unsigned>(date.month()), static_cast<unsigned>(date.day()));
  if (time != 0) {
    const auto used = static_cast<std::size_t>(length);
    length += std::snprintf(text.data() + used, text.size() - used, " %02u:%02u:%02u", time / 3600,
                            time / 60 % 60, time % 60);
  }
  return {text.data(), static_cast<std::size_t>(length)};
}

}  // namespace

bool Variant::isArray() const noexcept {
  return std::visit([]<class T>(const T&) { return kIsVector<T>; }, value_);
}

bool Variant::isNumeric() const noexcept {
  return std::visit(Overloaded{[](const Empty&) { return true; },
                               [](const std::string& text) {
                                 double number = 0;
                                 return textToNumber(text, number);
                               },
                               []<class T>(const T&) { return std::is_arithmetic_v<T>; }},
                    value_);
}

std::string Variant::typeName() const {
  if (const auto* object = std::get_if<ObjectReference>(&value_)) return *object ? "Object" : "Nothing";
  constexpr std::array<const char*, std::variant_size_v<Value>> kNames{
      "Empty",     "Null",   "Boolean",  "Byte",     "Integer",  "Long",   "LongLong",
      "Single",    "Double", "Date",     "Error",    "String",   "Object", "Byte()",
      "Integer()", "Long()", "Single()", "Double()", "Variant()"};
  return kNames[value_.index()];
}

double Variant::toDouble() const {
  return std::visit(
      Overloaded{[](const Empty&) { return 0.0; }, [](const Null&) -> double { raiseInvalidUseOfNull(); },
                 [](bool value) { return value ? -1.0 : 0.0; },
                 [](const DateValue& date) { return date.days; },
                 [](const std::string& text) { return parsed(text); },
                 []<class T>(const T& value) -> double {
                   if constexpr (std::is_arithmetic_v<T>)
                     return static_cast<double>(value);
                   else
                     raiseTypeMismatch();
                 }},
      value_);
}

float Variant::toSingle() const {
  if (const auto* single = std::get_if<float>(&value_)) return *single;
  const double number = toDouble();
  // Half a step above the largest single is the first number that would round to infinity.
  constexpr double kTooLarge = 0x1.ffffffp127;
  if (std::isfinite(number) && std::fabs(number) >= kTooLarge) raiseOverflow();
  return static_cast<float>(number);
}

std::int32_t Variant::toInt32() const { return frontpanels::toInt32(toDouble()); }
std::int16_t Variant::toInt16() const { return frontpanels::toInt16(toDouble()); }

bool Variant::toBoolean() const {
  if (const auto* text = std::get_if<std::string>(&value_)) {
    const std::string_view word = trimmed(*text);
    if (equalsIgnoringCase(word, "true")) return true;
    if (equalsIgnoringCase(word, "false")) return false;
  }
  return toDouble() != 0;
}

std::string Variant::toText() const {
  return std::visit(Overloaded{[](const Empty&) { return std::string(); },
                               [](const Null&) -> std::string { raiseInvalidUseOfNull(); },
                               [](bool value) { return std::string(value ? "True" : "False"); },
                               [](float value) { return numberToText(value); },
                               [](double value) { return numberToText(value); },
                               [](const DateValue& date) { return dateText(date.days); },
                               [](const std::string& text) { return text; },
                               []<class T>(const T& value) -> std::string {
                                 if constexpr (std::is_integral_v<T>)
                                   return std::to_string(value);
                                 else
                                   raiseTypeMismatch();
                               }},
                    value_);
}

std::size_t Variant::elementCount() const {
  return std::visit(
      []<class T>(const T& value) -> std::size_t {
        if constexpr (kIsVector<T>)
          return value.size();
        else
          raiseTypeMismatch();
      },
      value_);
}

Variant Variant::element(std::size_t index) const {
  return std::visit(
      [index]<class T>(const T& value) -> Variant {
        if constexpr (kIsVector<T>) {
          if (index >= value.size()) raiseSubscriptOutOfRange();
          return value[index];
        } else {
          raiseTypeMismatch();
        }
      },
      value_);
}

bool textToNumber(std::string_view text, double& number) noexcept {
  text = trimmed(text);
  const bool negative = text.starts_with('-');
  if (negative || text.starts_with('+')) text.remove_prefix(1);
  // Looked through first: from_chars would take words for infinity as well, and stop at what follows a
  // number.
  const Digits digits = takeApart(text);
  if (!digits.valid) return false;
  double value = 0;
  const auto result = std::from_chars(text.data(), text.data() + text.size(), value);
  if (result.ec == std::errc::result_out_of_range) {
    if (!underflows(digits)) return false;
    value = 0;
  }
  number = negative ? -value : value;
  return true;
}

std::string numberToText(double number) { return toGeneralForm(number, 15); }
std::string numberToText(float number) { return toGeneralForm(number, 7); }

}  // namespace frontpanels

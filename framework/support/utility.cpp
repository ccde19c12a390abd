#include "framework/support/utility.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

constexpr double kSmallestStep = 0.0001;
constexpr std::int32_t kLocaleBufferChars = 100;

std::string upperCased(std::string_view text) {
  std::string upper(text);
  std::transform(upper.begin(), upper.end(), upper.begin(),
                 [](char c) { return c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c; });
  return upper;
}

std::string_view trimmed(std::string_view text) {
  const std::size_t first = text.find_first_not_of(' ');
  if (first == std::string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(' ') - first + 1);
}

// Read from its text: the nearest double on every platform, which pow is not for large exponents.
double powerOfTen(int exponent) {
  double power = HUGE_VAL;
  static_cast<void>(textToNumber("1e" + std::to_string(exponent), power));
  return power;
}

int stepOf(double mantissa) {
  if (mantissa <= 1) return 1;
  if (mantissa <= 2) return 2;
  if (mantissa <= 5) return 5;
  return mantissa < 10 ? 10 : 20;
}

double nextStep(double x) {
  if (x == 0) return kSmallestStep;
  if (!std::isfinite(x)) raiseOverflow();
  const double magnitude = std::fabs(x);
  int exponent = static_cast<int>(std::trunc(Log10(magnitude)));
  double mantissa = magnitude / powerOfTen(exponent);
  if (mantissa < 1) {
    mantissa *= 10;
    --exponent;
  } else if (mantissa >= 10) {
    mantissa *= 0.1;
    ++exponent;
  }
  const double step = stepOf(mantissa) * powerOfTen(exponent);
  if (!std::isfinite(step) || step == 0) raiseOverflow();
  return std::copysign(step, x);
}

// How many bytes the UTF-8 character at the front of a text has.
std::size_t leadingCharacterBytes(std::string_view text) {
  const auto isContinuation = [](char c) { return (static_cast<unsigned char>(c) & 0xC0U) == 0x80U; };
  std::size_t bytes = std::min<std::size_t>(text.size(), 1);
  while (bytes < text.size() && isContinuation(text[bytes])) ++bytes;
  return bytes;
}

}  // namespace

double Log10(double x) noexcept {
  return guarded([x] { return "Log10(" + numberToText(x) + ") ... "; }, 0.0,
                 [x] {
                   if (!(x > 0)) raiseInvalidProcedureCall();
                   if (std::isinf(x)) raiseOverflow();
                   return std::log(x) / std::log(10.0);
                 });
}

double OneTwoFive(double x) noexcept {
  return guarded([x] { return "OneTwoFive(" + numberToText(x) + ") ... "; }, kSmallestStep,
                 [x] { return nextStep(x); });
}

bool BooleanValue(std::string_view text) noexcept {
  const auto message = [text] { return "BooleanValue(" + std::string(text) + ") ... "; };
  return guarded(message, false, [&] {
    double number = 0;
    if (textToNumber(text, number)) return number != 0;
    const std::string word = upperCased(trimmed(text));
    if (word == "TRUE") return true;
    if (word != "FALSE") errorHandler().Assert(message() + "unrecognized input");
    return false;
  });
}

const std::string& RegionalSeparators::decimalSeparator() {
  return cached(decimal_, LocaleItem::DecimalSeparator, ".");
}
const std::string& RegionalSeparators::listSeparator() {
  return cached(list_, LocaleItem::ListSeparator, ",");
}

const std::string& RegionalSeparators::cached(std::string& separator, LocaleItem item,
                                              std::string_view fallback) const {
  if (!separator.empty()) return separator;
  // One less than the buffer holds is passed as its size.
  const std::string value = locale_.info(item, kLocaleBufferChars - 1);
  separator = value.empty() ? std::string(fallback) : value.substr(0, leadingCharacterBytes(value));
  return separator;
}

std::string RegionalSeparators::RegionalValue(const Variant& value) noexcept {
  return guarded("RegionalValue() ... ", std::string(), [&] {
    std::string text = value.toText();
    const std::size_t point = value.isNumeric() ? text.find('.') : std::string::npos;
    if (point != std::string::npos) text.replace(point, 1, decimalSeparator());
    return text;
  });
}

std::int16_t indexOfItemData(const ItemDataList& list, std::int32_t value) noexcept {
  return guarded("indexOfItemData() ... ", std::int16_t{-1}, [&] {
    const std::int32_t count =
        std::min<std::int32_t>(list.listCount(), std::numeric_limits<std::int16_t>::max() + 1);
    for (std::int32_t index = 0; index < count; ++index)
      if (list.itemData(index) == value) return static_cast<std::int16_t>(index);
    return std::int16_t{-1};
  });
}

void AlwaysOnTop(Windowing& windowing, WindowHandle window, bool onTop) noexcept {
  guard("AlwaysOnTop() ... ", [&] {
    if (!windowing.setTopmost(window, onTop))
      errorHandler().Assert("AlwaysOnTop() ... SetWindowPos() failed");
  });
}

}  // namespace frontpanels

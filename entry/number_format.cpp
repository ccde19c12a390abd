#include "entry/number_format.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>

#include "platform/runtime_error.h"
#include "platform/variant.h"

namespace frontpanels {
namespace {

constexpr int kSignificantDigits = 15;

struct NumberFormat {
  int integerDigits = 0;   // written at least
  int fractionDigits = 0;  // written at least
  int decimals = 0;        // written at most
};

NumberFormat parse(std::string_view format) {
  NumberFormat parsed;
  bool behindPoint = false;
  for (const char c : format) {
    if (c == '.' && !behindPoint) {
      behindPoint = true;
    } else if (c == '0' || c == '#') {
      if (behindPoint) ++parsed.decimals;
      if (c == '0') behindPoint ? parsed.fractionDigits = parsed.decimals : ++parsed.integerDigits;
    } else {
      raiseInvalidProcedureCall();
    }
  }
  return parsed;
}

// The significant digits of a number and where its point lies: 0.digits times ten to the power of `point`.
struct Decimal {
  std::array<char, kSignificantDigits> digits{};
  int point = 0;

  [[nodiscard]] char digit(int index) const {
    return index >= 0 && index < kSignificantDigits ? digits[static_cast<std::size_t>(index)] : '0';
  }
  [[nodiscard]] bool zero() const {
    return std::all_of(digits.begin(), digits.end(), [](char d) { return d == '0'; });
  }
};

Decimal toDecimal(double magnitude) {
  std::array<char, 32> text{};  // d.dddddddddddddde+xxx
  const auto end = std::to_chars(text.data(), text.data() + text.size(), magnitude,
                                 std::chars_format::scientific, kSignificantDigits - 1)
                       .ptr;
  Decimal decimal;
  decimal.digits[0] = text[0];
  std::copy_n(text.begin() + 2, kSignificantDigits - 1, decimal.digits.begin() + 1);
  const char* exponent = text.data() + kSignificantDigits + 2;
  if (*exponent == '+') ++exponent;
  std::from_chars(exponent, end, decimal.point);
  ++decimal.point;
  return decimal;
}

void roundHalfAway(Decimal& decimal, int decimals) {
  const int kept = decimal.point + decimals;
  if (kept >= kSignificantDigits) return;
  const bool up = decimal.digit(kept) >= '5';
  const auto keptEnd = decimal.digits.begin() + std::max(kept, 0);
  std::fill(keptEnd, decimal.digits.end(), '0');
  if (!up) return;
  for (auto at = keptEnd; at != decimal.digits.begin();) {
    if (*--at != '9') {
      ++*at;
      return;
    }
    *at = '0';
  }
  decimal.digits[0] = '1';  // the carry left the digits: what is left behind it is zeros
  ++decimal.point;
}

void appendDigits(std::string& text, const Decimal& decimal, const NumberFormat& format) {
  for (int place = std::max(decimal.point, format.integerDigits); place > 0; --place) {
    text += decimal.digit(decimal.point - place);
  }
  int written = format.decimals;
  while (written > format.fractionDigits && decimal.digit(decimal.point + written - 1) == '0') --written;
  if (written == 0) return;
  text += '.';
  for (int place = 0; place < written; ++place) text += decimal.digit(decimal.point + place);
}

constexpr std::string_view kDecimals = "0.###############";

std::string_view formatWithDecimals(double decimals) {
  if (!(decimals >= 1)) return kDecimals.substr(0, 1);
  return kDecimals.substr(0, 2 + static_cast<std::size_t>(std::min(decimals, 15.0)));
}

}  // namespace

void appendNumber(std::string& text, double number, std::string_view format) {
  const NumberFormat parsed = parse(format);
  if (!std::isfinite(number)) {
    text += numberToText(number);
    return;
  }
  Decimal decimal = toDecimal(std::fabs(number));
  roundHalfAway(decimal, parsed.decimals);
  if (decimal.zero()) decimal.point = 0;
  if (number < 0 && !decimal.zero()) text += '-';
  appendDigits(text, decimal, parsed);
}

double toSignificantDigits(double number) noexcept {
  std::array<char, 32> text{};
  const char* const end = std::to_chars(text.data(), text.data() + text.size(), number,
                                        std::chars_format::scientific, kSignificantDigits - 1)
                              .ptr;
  double rounded = number;  // stays where no double is that large, or the number is none
  std::from_chars(text.data(), end, rounded);
  return rounded;
}

std::string_view formatForStep(double step) noexcept {
  return formatWithDecimals(step > 0 ? 1 - std::floor(std::log10(step)) : 0);
}

std::string_view formatNoFinerThan(double step) noexcept {
  return formatWithDecimals(step > 0 ? -std::floor(std::log10(step)) : 0);
}

}  // namespace frontpanels

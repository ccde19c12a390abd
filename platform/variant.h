// A tagged value as it travels between host and panel: empty, null, a boolean, a number of a stated width,
// text, an object reference, an error code or an array of one element type.
#pragma once

#include <concepts>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <type_traits>
#include <utility>
#include <variant>
#include <vector>

namespace frontpanels {

class Variant;

// Days since 30 December 1899, the time as the fraction.
struct DateValue {
  double days = 0;
  friend bool operator==(const DateValue&, const DateValue&) = default;
};

struct ErrorValue {
  std::int32_t code = 0;
  friend bool operator==(const ErrorValue&, const ErrorValue&) = default;
};

// An object of the host: compared by identity, never looked into by the core.
using ObjectReference = std::shared_ptr<void>;

class Variant {
 public:
  struct Empty {
    friend bool operator==(const Empty&, const Empty&) = default;
  };
  struct Null {
    friend bool operator==(const Null&, const Null&) = default;
  };
  using Bytes = std::vector<std::uint8_t>;
  using Int16s = std::vector<std::int16_t>;
  using Int32s = std::vector<std::int32_t>;
  using Singles = std::vector<float>;
  using Doubles = std::vector<double>;
  using Variants = std::vector<Variant>;
  using Value = std::variant<Empty, Null, bool, std::uint8_t, std::int16_t, std::int32_t, std::int64_t, float,
                             double, DateValue, ErrorValue, std::string, ObjectReference, Bytes, Int16s,
                             Int32s, Singles, Doubles, Variants>;

  Variant() = default;
  // NOLINTBEGIN(google-explicit-constructor): a value is a variant, and every call with one says so
  Variant(Value value) : value_(std::move(value)) {}
  Variant(const char* text) : value_(std::string(text)) {}  // without it a literal would become a bool
  template <class T>
  requires(!std::same_as<std::remove_cvref_t<T>, Variant>) &&
      std::constructible_from<Value, std::in_place_type_t<std::remove_cvref_t<T>>, T> Variant(T&& value)
      : value_(std::in_place_type<std::remove_cvref_t<T>>, std::forward<T>(value)) {}
  // NOLINTEND(google-explicit-constructor)

  [[nodiscard]] static Variant null() { return Variant(Value(Null{})); }

  [[nodiscard]] const Value& value() const noexcept { return value_; }
  // For writers that keep an array's capacity: assigning the same alternative reuses it.
  [[nodiscard]] Value& value() noexcept { return value_; }

  [[nodiscard]] bool isEmpty() const noexcept { return std::holds_alternative<Empty>(value_); }
  [[nodiscard]] bool isNull() const noexcept { return std::holds_alternative<Null>(value_); }
  [[nodiscard]] bool isArray() const noexcept;
  // True for a number, a boolean, empty (it reads as 0) and text that reads as a number.
  [[nodiscard]] bool isNumeric() const noexcept;
  // Name of the type as the run-time words it: "Empty", "Null", "Integer", "Single()", ...
  [[nodiscard]] std::string typeName() const;

  // Conversions by the run-time's rules: whole numbers round half to even and raise "Overflow" outside their
  // width, true reads as -1, empty as 0 or no text, text is parsed, null raises "Invalid use of Null", what
  // has no value (an array, an object, an error code) raises "Type mismatch".
  [[nodiscard]] double toDouble() const;
  // Not-a-number and infinities stay what they are: they mark gaps in a trace.
  [[nodiscard]] float toSingle() const;
  [[nodiscard]] std::int32_t toInt32() const;
  [[nodiscard]] std::int16_t toInt16() const;
  // Any number but 0 is true; of texts also "True" and "False" in any case.
  [[nodiscard]] bool toBoolean() const;
  // Numbers in the general form, "True"/"False", dates as "2024-05-01 13:30:00" (the date alone at midnight).
  [[nodiscard]] std::string toText() const;

  // Elements of an array; raises "Type mismatch" when it is none, "Subscript out of range" past its end.
  [[nodiscard]] std::size_t elementCount() const;
  [[nodiscard]] Variant element(std::size_t index) const;

  friend bool operator==(const Variant&, const Variant&) = default;

 private:
  Value value_;
};

// The number that a text reads as, if it does: blanks around, a sign, digits with "." and an exponent ("E" or
// "e"). Neither the user's locale nor the C locale has a say. A value too large for a double is no number;
// one too small reads as 0.
[[nodiscard]] bool textToNumber(std::string_view text, double& number) noexcept;

// A number in the general form: at most 15 significant digits (7 for a single), "." as separator, no zeros at
// the end; with an exponent of two digits or more where the digits would not fit in as many places ("0.1",
// "-3", "1E+20", "1.5E-16").
[[nodiscard]] std::string numberToText(double number);
[[nodiscard]] std::string numberToText(float number);

}  // namespace frontpanels

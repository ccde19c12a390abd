// The library-wide tables of enumerated host parameters: one type, an ordered list of values with their
// labels. A host that knows more values than the library adds them.
#pragma once

#include <cstdint>
#include <map>
#include <span>
#include <string>
#include <vector>

namespace frontpanels {

// A type is the code of its parameter (host_codes.h), except for these two: code formats are sent under 500,
// which as a type means the averaging, and result types under no code at all.
inline constexpr std::int32_t kCodeFormatEnumeration = 231;
inline constexpr std::int32_t kResultTypeEnumeration = 310;

// Values with a meaning of their own.
inline constexpr std::int16_t kAveragingOff = 32;
inline constexpr std::int16_t kNarrowbandFilter = 1;
// The code format whose unit is a third of an IS-95B chip.
inline constexpr std::int16_t kTripleRateCodeFormat = 2;

struct EnumeratedValue {
  std::int16_t value = 0;
  std::string label;
  friend bool operator==(const EnumeratedValue&, const EnumeratedValue&) = default;
};

class EnumeratedTables {
 public:
  // Holds what the library knows by itself.
  EnumeratedTables();

  // A type's values in order; none for a type that is not known. Good until the type is next written.
  [[nodiscard]] std::span<const EnumeratedValue> values(std::int32_t parameterType) const;
  // The label of a value, or the value in decimal where it has none.
  [[nodiscard]] std::string label(std::int32_t parameterType, std::int16_t value) const;

  // Appends a value, or gives a listed one another label.
  void add(std::int32_t parameterType, const EnumeratedValue& value);
  // Puts a list in place of a type's values. Of a value that comes twice the place is the first, the label
  // the last.
  void replace(std::int32_t parameterType, std::span<const EnumeratedValue> values);

 private:
  std::map<std::int32_t, std::vector<EnumeratedValue>> tables_;
};

// The instance that every part of the library reads.
[[nodiscard]] EnumeratedTables& enumeratedTables();

[[nodiscard]] inline std::span<const EnumeratedValue> enumeratedValues(std::int32_t parameterType) {
  return enumeratedTables().values(parameterType);
}
[[nodiscard]] inline std::string enumeratedLabel(std::int32_t parameterType, std::int16_t value) {
  return enumeratedTables().label(parameterType, value);
}

}  // namespace frontpanels

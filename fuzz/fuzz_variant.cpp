#include "fuzz/fuzz_variant.h"

#include <iterator>
#include <memory>
#include <string>

namespace frontpanels::fuzz {
namespace {

template <class T>
Variant number(FuzzInput& input) {
  return input.number<T>();
}

template <class T>
Variant array(FuzzInput& input) {
  std::vector<T> values(input.number<std::uint8_t>());
  for (T& value : values) value = input.number<T>();
  return values;
}

Variant text(FuzzInput& input) {
  const auto bytes = input.bytes(input.number<std::uint8_t>());
  return std::string(bytes.begin(), bytes.end());
}

// Of numbers and texts only: an array within an array says nothing new.
Variant mixedArray(FuzzInput& input) {
  Variant::Variants values(input.number<std::uint8_t>() % 8U);
  for (Variant& value : values)
    value = (input.number<std::uint8_t>() & 1) != 0 ? text(input) : number<double>(input);
  return values;
}

// make_seeds writes the places of these rows.
constexpr Variant (*kMakers[])(FuzzInput&) = {
    [](FuzzInput&) { return Variant(); },
    [](FuzzInput&) { return Variant::null(); },
    [](FuzzInput& input) { return Variant((input.number<std::uint8_t>() & 1) != 0); },
    number<std::uint8_t>,
    number<std::int16_t>,
    number<std::int32_t>,
    number<std::int64_t>,
    number<float>,
    number<double>,
    text,
    [](FuzzInput& input) { return Variant(DateValue{input.number<double>()}); },
    [](FuzzInput& input) { return Variant(ErrorValue{input.number<std::int32_t>()}); },
    [](FuzzInput&) { return Variant(ObjectReference()); },
    [](FuzzInput&) { return Variant(ObjectReference(std::make_shared<int>(1))); },
    array<std::uint8_t>,
    array<std::int16_t>,
    array<std::int32_t>,
    array<float>,
    array<double>,
    mixedArray,
};

}  // namespace

Variant takeVariant(FuzzInput& input) {
  return kMakers[input.number<std::uint8_t>() % std::size(kMakers)](input);
}

}  // namespace frontpanels::fuzz

// What a container keeps of a control, written and read: in a stream, or property by property in a bag.
#pragma once

#include <ocidl.h>

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "platform/variant.h"

namespace frontpanels::activex {

// A property that the container stores with its form: a boolean or a text (UTF-8), as its default value is.
struct StoredProperty {
  const wchar_t* name;
  std::variant<bool, std::string_view> defaultValue;
};
[[nodiscard]] Variant defaultOf(const StoredProperty& property);

// A value a property, in the order of their table and of their kinds.
using StoredValues = std::vector<Variant>;

struct StoredState {
  SIZEL extentHimetric{};
  StoredValues values;
};
// The stream is left behind the state. Properties that it does not have yet, having been written before there
// were any, get their defaults; those that are not known any more are passed over. Raises ComFailure for a
// stream that is cut, damaged or another's.
[[nodiscard]] StoredState readStored(IStream& stream, std::span<const StoredProperty> properties);
[[nodiscard]] std::string storedBytes(const StoredState& state);

// What is missing gets its default, and so does, with a note in the log, what does not convert.
[[nodiscard]] StoredValues readStored(IPropertyBag& bag, IErrorLog* log,
                                      std::span<const StoredProperty> properties);
// Without `all` what differs from its default. Raises ComFailure.
void writeStored(IPropertyBag& bag, std::span<const StoredProperty> properties, const StoredValues& values,
                 bool all);

}  // namespace frontpanels::activex

// Values between Automation's variants and the panels' own.
#pragma once

#include <oaidl.h>

#include <functional>
#include <span>
#include <string>
#include <string_view>

#include "platform/variant.h"

namespace frontpanels::activex {

// References are followed; a missing argument reads as empty. Arrays of one dimension keep the widths that
// the panels know; other element types arrive as arrays of variants. Raises "Type mismatch" for what has no
// counterpart and "Out of memory".
[[nodiscard]] Variant fromAutomation(const VARIANT& value);
// A view of an array of singles where it lies. False, without a call, for any other value.
bool withSingles(const VARIANT& value, const std::function<void(std::span<const float>)>& body);
// A new value that the caller clears. Raises "Out of memory".
[[nodiscard]] VARIANT toAutomation(const Variant& value);

// A null string is an empty one.
[[nodiscard]] std::string fromBstr(BSTR text);
[[nodiscard]] BSTR toBstr(std::string_view utf8);

}  // namespace frontpanels::activex

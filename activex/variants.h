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
// The bytes of a buffer: an array of bytes where it lies, or an array of numbers that each fit a byte, as
// scripts make them. Raises "Type mismatch" for what is no array, "Overflow" for a number that is no byte.
LONG withBytes(const VARIANT& value, const std::function<LONG(std::span<const std::uint8_t>)>& body);
// What a host handed to an entry point. A value without a counterpart (an array of two dimensions, a record)
// becomes an error value: the entry point then says that it cannot use it.
[[nodiscard]] Variant hostValue(const VARIANT& value);
// Puts a value into a caller's variable, which may be a reference to another. Raises ComFailure.
void replaceVariable(VARIANT& variable, const Variant& value);
// A new value that the caller clears. Raises "Out of memory".
[[nodiscard]] VARIANT toAutomation(const Variant& value);

// A null string is an empty one.
[[nodiscard]] std::string fromBstr(BSTR text);
[[nodiscard]] BSTR toBstr(std::string_view utf8);

}  // namespace frontpanels::activex

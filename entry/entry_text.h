// What a user types into a numeric entry, read: a number and perhaps the unit that it is meant in.
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

#include "entry/suffix_table.h"

namespace frontpanels {

// Blanks alone, or nothing.
[[nodiscard]] bool isBlankText(std::string_view text) noexcept;

// The unit that a typed name stands for: in any letter case, whole or by a beginning that only one scale
// has. A whole name goes before one that begins with it ("m" before "ms"), and one in the same letter case
// before others. Null where none or more than one is meant.
[[nodiscard]] const SuffixRecord* suffixNamed(const SuffixTable& suffixes, std::string_view name) noexcept;

// Whether a name begins with what was typed, in either case of its letters.
[[nodiscard]] bool beginsWith(std::string_view name, std::string_view typed) noexcept;
// The first unit that a typed character is the first letter of, in either case; null when there is none.
[[nodiscard]] const SuffixRecord* suffixBegunBy(const SuffixTable& suffixes, std::int16_t character) noexcept;

// The number in base units that a text means, if it means one: blanks around, a sign, digits with the user's
// decimal separator or ".", an exponent, and a unit behind it. Without a unit it counts in units of
// `shownScale`. Anything else is none: group separators, words for infinity, a unit alone, what no double
// holds.
[[nodiscard]] std::optional<double> parseEntryText(std::string_view text, const SuffixTable& suffixes,
                                                   double shownScale, std::string_view decimalSeparator);

}  // namespace frontpanels

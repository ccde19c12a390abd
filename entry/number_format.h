// Numbers written by a format of the "0.##" kind.
#pragma once

#include <string>
#include <string_view>

namespace frontpanels {

// Appends `number` to `text`, rounded to the decimals that the format has places for. A "0" is a digit that
// is always written, a "#" one that is left out where it would be a leading or trailing zero; the point is
// written only with a digit behind it ("12", not "12."). Halves round away from zero, on the decimal text of
// the number's 15 significant digits, so 1.005 gives 1.01 by "0.##". Zero never carries a sign. Raises
// "Invalid procedure call or argument" for a format with anything but "0", "#" and one point; `text` is then
// as it was.
void appendNumber(std::string& text, double number, std::string_view format);

// The number that its 15 significant digits read as: what a sum or a product of decimal numbers would be
// without the error of binary ones.
[[nodiscard]] double toSignificantDigits(double number) noexcept;

// The format with as many optional decimals as tell apart numbers that are `step` apart, to one digit more
// than the step's first: "0" for 10, "0.#" for 2.5, "0.###" for 0.02. "0" when the step is no positive
// number.
[[nodiscard]] std::string_view formatForStep(double step) noexcept;
// The same to the step's first digit and no finer: "0" for 2.5, "0.##" for 0.02.
[[nodiscard]] std::string_view formatNoFinerThan(double step) noexcept;

}  // namespace frontpanels

// fp-render from its command line to its exit code.
#pragma once

#include <ostream>
#include <span>

#include "platform/textfile.h"

namespace frontpanels {

inline constexpr int kDrawn = 0;
inline constexpr int kNothingDrawn = 1;
inline constexpr int kWrongUsage = 2;
inline constexpr int kDrawnWithProblems = 3;  // some pictures, and something that was wrong on the way

// `arguments` are those after the program's name. Raises nothing: what goes wrong is said on `errors`.
[[nodiscard]] int render(std::span<const char* const> arguments, TextFiles& files, std::ostream& output,
                         std::ostream& errors) noexcept;

}  // namespace frontpanels

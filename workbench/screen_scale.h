// Pixels of the screen in the units of the container's interfaces.
#pragma once

#include <windows.h>

#include <algorithm>
#include <cmath>

namespace frontpanels::workbench {

// Dots an inch; 96 where no screen tells.
[[nodiscard]] int screenDpi() noexcept;

[[nodiscard]] inline LONG twipsFromPixels(LONG pixels) noexcept {
  constexpr int kTwipsAnInch = 1440;
  return MulDiv(pixels, kTwipsAnInch, screenDpi());
}

[[nodiscard]] inline LONG pixelsFromTwips(double twips) noexcept {
  constexpr double kTwipsAnInch = 1440;
  constexpr double kFarthest = 32767;  // as far as windows are placed
  const double pixels = twips * screenDpi() / kTwipsAnInch;
  return std::lround(std::clamp(pixels, -kFarthest, kFarthest));
}

// Hundredths of a millimetre.
[[nodiscard]] inline LONG himetricFromPixels(LONG pixels) noexcept {
  constexpr int kHimetricAnInch = 2540;
  return MulDiv(pixels, kHimetricAnInch, screenDpi());
}

// A length drawn for 96 dots an inch.
[[nodiscard]] inline int scaled(int pixels) noexcept { return MulDiv(pixels, screenDpi(), 96); }

}  // namespace frontpanels::workbench

// Window services of the real window system.
#pragma once

#include <windows.h>

#include "platform/windowing.h"

namespace frontpanels {

class Win32Windowing final : public Windowing {
 public:
  WindowHandle setCapture(WindowHandle window) override;
  [[nodiscard]] WindowHandle getCapture() override;
  void releaseCapture() override;
  bool setTopmost(WindowHandle window, bool topmost) override;
};

// Asks the screen for its scale; the usual one where it does not answer.
[[nodiscard]] ScreenMetrics readScreenMetrics();
// That of the screen which a window is on, as far as its program tells one screen from another.
[[nodiscard]] ScreenMetrics metricsOf(HWND window);
[[nodiscard]] int dotsPerInch(const ScreenMetrics& metrics) noexcept;
// Whether the user has asked for a scheme of few colours that stand out against each other.
[[nodiscard]] bool isHighContrast() noexcept;

}  // namespace frontpanels

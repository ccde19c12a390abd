#include "platform/win32/win32_windowing.h"

#include <windows.h>

namespace frontpanels {
namespace {

constexpr float kTwipsPerInch = 1440.0F;

HWND native(WindowHandle window) { return reinterpret_cast<HWND>(window.value); }
WindowHandle wrapped(HWND window) { return {reinterpret_cast<std::uintptr_t>(window)}; }

}  // namespace

WindowHandle Win32Windowing::setCapture(WindowHandle window) { return wrapped(SetCapture(native(window))); }
WindowHandle Win32Windowing::getCapture() { return wrapped(GetCapture()); }
void Win32Windowing::releaseCapture() { ReleaseCapture(); }

bool Win32Windowing::setTopmost(WindowHandle window, bool topmost) {
  // Place, size and activation stay as they are.
  constexpr UINT kOrderOnly = SWP_NOMOVE | SWP_NOSIZE | SWP_NOACTIVATE;
  return SetWindowPos(native(window), topmost ? HWND_TOPMOST : HWND_NOTOPMOST, 0, 0, 0, 0, kOrderOnly) != 0;
}

ScreenMetrics readScreenMetrics() {
  ScreenMetrics metrics;
  const HDC screen = GetDC(nullptr);
  if (screen == nullptr) return metrics;
  const int dotsPerInchX = GetDeviceCaps(screen, LOGPIXELSX);
  const int dotsPerInchY = GetDeviceCaps(screen, LOGPIXELSY);
  ReleaseDC(nullptr, screen);
  // A screen without a driver answers 0, by which nothing can be divided.
  if (dotsPerInchX > 0) metrics.twipsPerPixelX = kTwipsPerInch / static_cast<float>(dotsPerInchX);
  if (dotsPerInchY > 0) metrics.twipsPerPixelY = kTwipsPerInch / static_cast<float>(dotsPerInchY);
  return metrics;
}

// Windows before 10 have one scale for all screens.
ScreenMetrics metricsOf(HWND window) {
  using Ask = UINT(WINAPI*)(HWND);
  static const auto kAsk = reinterpret_cast<Ask>(
      reinterpret_cast<void*>(GetProcAddress(GetModuleHandleW(L"user32.dll"), "GetDpiForWindow")));
  const UINT dpi = kAsk == nullptr ? 0 : kAsk(window);
  if (dpi == 0) return readScreenMetrics();
  const float twipsPerPixel = kTwipsPerInch / static_cast<float>(dpi);
  return {twipsPerPixel, twipsPerPixel};
}

bool isHighContrast() noexcept {
  HIGHCONTRASTW mode{sizeof mode, 0, nullptr};
  return SystemParametersInfoW(SPI_GETHIGHCONTRAST, sizeof mode, &mode, 0) != 0 &&
         (mode.dwFlags & HCF_HIGHCONTRASTON) != 0;
}

int dotsPerInch(const ScreenMetrics& metrics) noexcept {
  return static_cast<int>(kTwipsPerInch / metrics.twipsPerPixelX + 0.5F);
}

}  // namespace frontpanels

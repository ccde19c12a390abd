#include "workbench/screen_scale.h"

namespace frontpanels::workbench {

int screenDpi() noexcept {
  static const int kDpi = [] {
    const HDC screen = GetDC(nullptr);
    const int dpi = GetDeviceCaps(screen, LOGPIXELSX);
    ReleaseDC(nullptr, screen);
    return dpi > 0 ? dpi : 96;
  }();
  return kDpi;
}

}  // namespace frontpanels::workbench

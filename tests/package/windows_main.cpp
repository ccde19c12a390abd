// A stranger's program for Windows: the drawing seam on the system's graphics interface, a panel behind the
// seams.
#include "framework/panel/headless.h"
#include "framework/support/host_codes.h"
#include "platform/win32/win32_gdi.h"
#include "spectrum/spectrum_view.h"

using namespace frontpanels;

int main() {
  constexpr Size kPicturePx{800, 600};
  Win32Gdi gdi;
  HeadlessView view(gdi.createCompatibleDC({}), kPicturePx);
  HeadlessWindowing windowing;
  HeadlessOwner owner;
  DataHub hub;
  SpectrumView panel({gdi, windowing, view, hub, ScreenMetrics{}, ""}, owner, owner);
  panel.Form_Resize();
  return panel.vfpOp(1, kShowOperation, Variant());
}

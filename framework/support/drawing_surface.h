// A panel's surface as splitter bars, base and painters see it: the `View...` members, the pointer shape, a
// refresh. The scale is the surface's own: whoever owns a bar or painter decides between pixels and twips.
#pragma once

#include <cstdint>

#include "platform/gdi.h"
#include "platform/windowing.h"

namespace frontpanels {

// Values of ViewScaleMode.
enum class ScaleMode : std::int16_t { Twips = 1, Pixels = 3 };

class DrawingSurface {
 public:
  virtual ~DrawingSurface() = default;

  [[nodiscard]] virtual float ViewScaleLeft() = 0;
  [[nodiscard]] virtual float ViewScaleTop() = 0;
  [[nodiscard]] virtual float ViewScaleWidth() = 0;
  [[nodiscard]] virtual float ViewScaleHeight() = 0;
  // What is left of the scale after the parts that the panel keeps for itself.
  [[nodiscard]] virtual float ViewUseableScaleWidth() = 0;
  [[nodiscard]] virtual float ViewUseableScaleHeight() = 0;
  [[nodiscard]] virtual WindowHandle ViewHWnd() = 0;
  // The device context of the visible graph area.
  [[nodiscard]] virtual DcHandle ViewHDC() = 0;
  [[nodiscard]] virtual MousePointer ViewMousePointer() = 0;
  virtual void ViewMousePointer(MousePointer pointer) = 0;
  [[nodiscard]] virtual DrawMode ViewDrawMode() = 0;
  virtual void ViewDrawMode(DrawMode mode) = 0;
  [[nodiscard]] virtual PenStyle ViewDrawStyle() = 0;
  virtual void ViewDrawStyle(PenStyle style) = 0;
  // Repaints the surface; the owner redraws what lies on it.
  virtual void Refresh() = 0;
};

}  // namespace frontpanels

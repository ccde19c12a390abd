// Window services behind a panel: mouse capture, topmost state, the screen's scale, and the picture box that
// a panel's graph is drawn on.
#pragma once

#include <cstdint>

#include "platform/geometry.h"
#include "platform/handle.h"

namespace frontpanels {

// The screen's scale, read once at the edge. 1440 twips make an inch, so 15 a pixel at 96 dots an inch.
struct ScreenMetrics {
  float twipsPerPixelX = 15.0F;
  float twipsPerPixelY = 15.0F;
};

class Windowing {
 public:
  virtual ~Windowing() = default;

  // Answers the window that held the capture before, null when none did.
  virtual WindowHandle setCapture(WindowHandle window) = 0;
  [[nodiscard]] virtual WindowHandle getCapture() = 0;
  virtual void releaseCapture() = 0;
  // False when the window system refused.
  virtual bool setTopmost(WindowHandle window, bool topmost) = 0;
};

// The values of a mouse pointer property.
enum class MousePointer : std::int16_t { Default = 0, SizeNorthSouth = 7, SizeEastWest = 9 };

// The picture box that a panel draws its graph on.
class GraphView {
 public:
  virtual ~GraphView() = default;

  // The device context of what the user sees. Stays the same while the view exists.
  [[nodiscard]] virtual DcHandle hdc() = 0;
  // Null while the view has no window (a panel that was created but not sited).
  [[nodiscard]] virtual WindowHandle hwnd() = 0;
  [[nodiscard]] virtual Size clientSizePx() = 0;
  [[nodiscard]] virtual MousePointer mousePointer() = 0;
  virtual void mousePointer(MousePointer pointer) = 0;
  [[nodiscard]] virtual bool visible() = 0;
  virtual void visible(bool visible) = 0;
  // Asks for a paint of the whole view; it may come later, from the window system.
  virtual void refresh() = 0;
  // The graph has been composed anew and copied here.
  virtual void painted() {}
};

}  // namespace frontpanels

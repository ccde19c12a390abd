// A panel's surface measured in pixels. The panel itself reports twips; the splitter bars between its traces
// are drawn in device coordinates and their 20 units are meant as pixels, so the trace manager hands them
// this view.
#pragma once

#include "framework/support/drawing_surface.h"

namespace frontpanels {

class PixelSurface : public DrawingSurface {
 public:
  PixelSurface(DrawingSurface& surface, ScreenMetrics metrics) : surface_(surface), metrics_(metrics) {}

  float ViewScaleLeft() override { return surface_.ViewScaleLeft() / metrics_.twipsPerPixelX; }
  float ViewScaleTop() override { return surface_.ViewScaleTop() / metrics_.twipsPerPixelY; }
  float ViewScaleWidth() override { return surface_.ViewScaleWidth() / metrics_.twipsPerPixelX; }
  float ViewScaleHeight() override { return surface_.ViewScaleHeight() / metrics_.twipsPerPixelY; }
  float ViewUseableScaleWidth() override {
    return surface_.ViewUseableScaleWidth() / metrics_.twipsPerPixelX;
  }
  float ViewUseableScaleHeight() override {
    return surface_.ViewUseableScaleHeight() / metrics_.twipsPerPixelY;
  }
  WindowHandle ViewHWnd() override { return surface_.ViewHWnd(); }
  DcHandle ViewHDC() override { return surface_.ViewHDC(); }
  MousePointer ViewMousePointer() override { return surface_.ViewMousePointer(); }
  void ViewMousePointer(MousePointer pointer) override { surface_.ViewMousePointer(pointer); }
  DrawMode ViewDrawMode() override { return surface_.ViewDrawMode(); }
  void ViewDrawMode(DrawMode mode) override { surface_.ViewDrawMode(mode); }
  PenStyle ViewDrawStyle() override { return surface_.ViewDrawStyle(); }
  void ViewDrawStyle(PenStyle style) override { surface_.ViewDrawStyle(style); }
  void Refresh() override { surface_.Refresh(); }

 private:
  DrawingSurface& surface_;
  ScreenMetrics metrics_;
};

}  // namespace frontpanels

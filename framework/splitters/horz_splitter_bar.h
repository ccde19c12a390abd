// The horizontal bar between the active trace and the row of small ones. It works in the units of its
// surface, is dragged by a band twice as tall as itself, and moves by the distance of the drag when the
// button is released.
#pragma once

#include <cstdint>

#include "framework/splitters/splitter_drag.h"
#include "framework/support/drawing_surface.h"
#include "platform/gdi.h"
#include "platform/windowing.h"

namespace frontpanels {

class clsHorzSplitterBar {
 public:
  clsHorzSplitterBar(Gdi& gdi, Windowing& windowing);

  // The surface must outlive the bar. Assigning it sets the bar's height back to 20.
  void DrawingSurface(frontpanels::DrawingSurface* surface);

  [[nodiscard]] float BarWidth() const noexcept { return kThickness; }
  [[nodiscard]] float SplitterBarTop() const noexcept { return top_; }
  void SplitterBarTop(float top) noexcept { top_ = top; }
  // Kept for the owner; hit band, limits and drawing use the constant 20.
  [[nodiscard]] float SplitterBarHeight() const noexcept { return height_; }
  void SplitterBarHeight(float height) noexcept { height_ = height; }
  // The bar's place as a fraction of the usable height. The first name moves the bar and refreshes the
  // surface when it is written, the second one stores only.
  [[nodiscard]] float RelativePosition() const noexcept { return relative_; }
  void RelativePosition(float fraction);
  [[nodiscard]] float SplitterBarTopRelative() const noexcept { return relative_; }
  void SplitterBarTopRelative(float fraction) noexcept { relative_ = fraction; }

  [[nodiscard]] bool MouseOver(float x, float y) const;
  [[nodiscard]] bool MouseCaptured() const noexcept { return drag_.captured(); }
  void MouseDown(std::int16_t button, std::int16_t shift, float x, float y);
  void MouseMove(std::int16_t button, std::int16_t shift, float x, float y);
  void MouseUp(std::int16_t button, std::int16_t shift, float x, float y);

  void Resize();
  // Draws the bar on the surface's device context.
  void Refresh();
  // Draws a bump into any device context, with the surface's draw mode at not-xor meanwhile.
  void Paint(DcHandle dc, float left, float top, float width, float height);

 private:
  static constexpr float kThickness = 20.0F;

  [[nodiscard]] float highest() const;
  [[nodiscard]] float lowest() const;
  void moveTo(float top);

  Gdi& gdi_;
  SplitterDrag drag_;
  float top_ = 0;
  float height_ = 0;
  float relative_ = 0;
  float pressY_ = 0;
};

}  // namespace frontpanels

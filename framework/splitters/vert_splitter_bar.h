// A vertical bar between two neighbouring small traces. It works in the units of its surface and jumps to
// where the button is released.
#pragma once

#include <cstdint>

#include "framework/splitters/splitter_drag.h"
#include "framework/support/drawing_surface.h"
#include "platform/gdi.h"
#include "platform/windowing.h"

namespace frontpanels {

class clsVertSplitterBar {
 public:
  clsVertSplitterBar(Gdi& gdi, Windowing& windowing, ScreenMetrics metrics);

  // The surface must outlive the bar. Assigning it sets the bar's width back to 2.
  void DrawingSurface(frontpanels::DrawingSurface* surface);

  void rescale(ScreenMetrics metrics) noexcept { metrics_ = metrics; }

  // The stored width over the screen's horizontal twips per pixel.
  [[nodiscard]] float BarWidth() const noexcept { return width_ / metrics_.twipsPerPixelX; }
  [[nodiscard]] float SplitterBarLeft() const noexcept { return left_; }
  void SplitterBarLeft(float left) noexcept { left_ = left; }
  [[nodiscard]] float SplitterBarTop() const noexcept { return top_; }
  void SplitterBarTop(float top) noexcept { top_ = top; }
  [[nodiscard]] float SplitterBarHeight() const noexcept { return height_; }
  void SplitterBarHeight(float height) noexcept { height_ = height; }
  [[nodiscard]] float SplitterBarBottom() const noexcept { return top_ + height_; }
  // Sets the height that reaches from the surface's top to `bottom`; none when that lies above it.
  void SplitterBarBottom(float bottom);
  // The bar's place as a fraction of the surface's width. The first name moves the bar and refreshes the
  // surface when it is written, the second one stores only.
  [[nodiscard]] float RelativePosition() const noexcept { return relative_; }
  void RelativePosition(float fraction);
  [[nodiscard]] float SplitterBarLeftRelative() const noexcept { return relative_; }
  void SplitterBarLeftRelative(float fraction) noexcept { relative_ = fraction; }

  [[nodiscard]] bool MouseOver(float x, float y) const;
  [[nodiscard]] bool MouseCaptured() const noexcept { return drag_.captured(); }
  void MouseDown(std::int16_t button, std::int16_t shift, float x, float y);
  void MouseMove(std::int16_t button, std::int16_t shift, float x, float y);
  void MouseUp(std::int16_t button, std::int16_t shift, float x, float y);

  void Resize();
  // Draws the bar on the surface's device context.
  void Refresh();
  // Draws the bar, sunken, into any device context.
  void Paint(DcHandle dc);

 private:
  [[nodiscard]] float leftmost() const;
  [[nodiscard]] float rightmost() const;
  void moveTo(float left);

  Gdi& gdi_;
  ScreenMetrics metrics_;
  SplitterDrag drag_;
  float left_ = 0;
  float width_ = 0;
  float top_ = 0;
  float height_ = 0;
  float relative_ = 0;
};

}  // namespace frontpanels

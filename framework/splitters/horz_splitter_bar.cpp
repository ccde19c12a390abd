#include "framework/splitters/horz_splitter_bar.h"

#include <algorithm>

namespace frontpanels {
clsHorzSplitterBar::clsHorzSplitterBar(Gdi& gdi, Windowing& windowing)
    : gdi_(gdi), drag_(windowing, MousePointer::SizeNorthSouth) {}

void clsHorzSplitterBar::DrawingSurface(frontpanels::DrawingSurface* surface) {
  drag_.surface(surface);
  height_ = kThickness;
}

void clsHorzSplitterBar::RelativePosition(float fraction) {
  relative_ = fraction;
  Resize();
}

float clsHorzSplitterBar::highest() const { return drag_.surface().ViewScaleTop(); }
float clsHorzSplitterBar::lowest() const {
  return highest() + drag_.surface().ViewUseableScaleHeight() - kThickness;
}

// The band reaches 20 units above the bar as well as below its top: twice as tall as what is drawn, and easy
// to grab.
bool clsHorzSplitterBar::MouseOver(float x, float y) const {
  const float left = drag_.surface().ViewScaleLeft();
  const float right = left + drag_.surface().ViewUseableScaleWidth();
  return containsRounded(roundedRect(left, top_ - kThickness, right, top_ + kThickness), x, y);
}

void clsHorzSplitterBar::MouseDown(std::int16_t button, std::int16_t /*shift*/, float x, float y) {
  if (button != kLeftMouseButton || !MouseOver(x, y) || !drag_.pointerIsSizing()) return;
  drag_.begin();
  pressY_ = y;
}

void clsHorzSplitterBar::MouseMove(std::int16_t /*button*/, std::int16_t /*shift*/, float x, float y) {
  if (drag_.inProgress()) return;  // the bar jumps on release
  const float left = drag_.surface().ViewScaleLeft();
  const float right = left + drag_.surface().ViewUseableScaleWidth();
  const float hoverTop = std::min(std::max(top_ - kThickness, highest()), lowest());
  drag_.showPointer(containsRounded(roundedRect(left, hoverTop, right, top_ + kThickness), x, y));
}

void clsHorzSplitterBar::MouseUp(std::int16_t /*button*/, std::int16_t /*shift*/, float /*x*/, float y) {
  if (!drag_.pointerIsSizing()) return drag_.cancel();
  drag_.finish();
  moveTo(top_ + (y - pressY_));
  drag_.surface().Refresh();
}

void clsHorzSplitterBar::moveTo(float top) {
  if (top < highest()) top = highest();
  if (top > lowest()) top = lowest();
  relative_ = fractionOf(top - highest(), drag_.surface().ViewUseableScaleHeight() - highest());
  top_ = top;
}

void clsHorzSplitterBar::Resize() {
  top_ = highest() + (drag_.surface().ViewUseableScaleHeight() - highest()) * relative_;
  drag_.surface().Refresh();
}

void clsHorzSplitterBar::Refresh() {
  const float left = drag_.surface().ViewScaleLeft();
  const float right = left + drag_.surface().ViewUseableScaleWidth();
  gdi_.drawEdge(drag_.surface().ViewHDC(), roundedRect(left, top_, right, top_ + kThickness), kEdgeRaised,
                kAllSides);
}

void clsHorzSplitterBar::Paint(DcHandle dc, float left, float top, float width, float height) {
  const Rect rect = roundedRect(left, top, left + width, top + height);
  frontpanels::DrawingSurface& surface = drag_.surface();
  const DrawMode previous = surface.ViewDrawMode();
  surface.ViewDrawMode(DrawMode::NotXorPen);
  gdi_.drawEdge(dc, rect, kEdgeBump, kAllSides);
  surface.ViewDrawMode(previous);
}

}  // namespace frontpanels

#include "framework/splitters/vert_splitter_bar.h"

#include <algorithm>

namespace frontpanels {
namespace {

constexpr float kWidth = 2.0F;

}  // namespace

clsVertSplitterBar::clsVertSplitterBar(Gdi& gdi, Windowing& windowing, ScreenMetrics metrics)
    : gdi_(gdi), metrics_(metrics), drag_(windowing, MousePointer::SizeEastWest) {}

void clsVertSplitterBar::DrawingSurface(frontpanels::DrawingSurface* surface) {
  drag_.surface(surface);
  width_ = kWidth;
}

void clsVertSplitterBar::SplitterBarBottom(float bottom) {
  height_ = std::max(bottom - drag_.surface().ViewScaleTop(), 0.0F);
}

void clsVertSplitterBar::RelativePosition(float fraction) {
  relative_ = fraction;
  Resize();
}

// The whole scale, not the usable one as with the horizontal bar.
float clsVertSplitterBar::leftmost() const { return drag_.surface().ViewScaleLeft(); }
float clsVertSplitterBar::rightmost() const { return leftmost() + drag_.surface().ViewScaleWidth() - width_; }

bool clsVertSplitterBar::MouseOver(float x, float y) const {
  return containsRounded(roundedRect(left_, top_, left_ + width_, top_ + height_), x, y);
}

void clsVertSplitterBar::MouseDown(std::int16_t button, std::int16_t /*shift*/, float x, float y) {
  if (button == kLeftMouseButton && MouseOver(x, y) && drag_.pointerIsSizing()) drag_.begin();
}

void clsVertSplitterBar::MouseMove(std::int16_t /*button*/, std::int16_t /*shift*/, float x, float y) {
  if (drag_.inProgress()) return;
  const float hoverLeft = std::min(std::max(left_, leftmost()), rightmost());
  // At least a unit wide: the drawn width is a fraction of one, and the pointer could never be over it.
  const float hoverWidth = std::max(BarWidth(), 1.0F);
  drag_.showPointer(
      containsRounded(roundedRect(hoverLeft, top_, hoverLeft + hoverWidth, top_ + height_), x, y));
}

void clsVertSplitterBar::MouseUp(std::int16_t /*button*/, std::int16_t /*shift*/, float x, float /*y*/) {
  if (!drag_.pointerIsSizing()) return drag_.cancel();
  drag_.finish();
  moveTo(x);
  drag_.surface().Refresh();
}

void clsVertSplitterBar::moveTo(float left) {
  if (left < leftmost()) left = leftmost();
  if (left > rightmost()) left = rightmost();
  relative_ = fractionOf(left - leftmost(), drag_.surface().ViewScaleWidth());
  left_ = left;
}

void clsVertSplitterBar::Resize() {
  left_ = leftmost() + drag_.surface().ViewScaleWidth() * relative_;
  drag_.surface().Refresh();
}

void clsVertSplitterBar::Refresh() {
  gdi_.drawEdge(drag_.surface().ViewHDC(), roundedRect(left_, top_, left_ + BarWidth(), top_ + height_),
                kEdgeRaised, kAllSides);
}

void clsVertSplitterBar::Paint(DcHandle dc) {
  gdi_.drawEdge(dc, roundedRect(left_, top_, left_ + width_, top_ + height_), kEdgeSunken, kAllSides);
}

}  // namespace frontpanels

#include "framework/splitters/splitter_drag.h"

#include "framework/support/numeric.h"

namespace frontpanels {

DrawingSurface& SplitterDrag::surface() const {
  if (surface_ == nullptr) raiseObjectVariableNotSet();
  return *surface_;
}

bool SplitterDrag::pointerIsSizing() const { return surface().ViewMousePointer() == sizingPointer_; }

void SplitterDrag::begin() { captured_ = static_cast<bool>(windowing_.setCapture(surface().ViewHWnd())); }

bool SplitterDrag::inProgress() const {
  return captured_ && pointerIsSizing() && windowing_.getCapture() == surface().ViewHWnd();
}

void SplitterDrag::showPointer(bool overBar) {
  surface().ViewMousePointer(overBar ? sizingPointer_ : MousePointer::Default);
}

void SplitterDrag::finish() {
  windowing_.releaseCapture();
  surface().ViewMousePointer(MousePointer::Default);
  captured_ = false;
}

void SplitterDrag::cancel() {
  if (windowing_.getCapture() == surface().ViewHWnd()) windowing_.releaseCapture();
  captured_ = false;
}

Rect roundedRect(float left, float top, float right, float bottom) {
  return {toInt32(left), toInt32(top), toInt32(right), toInt32(bottom)};
}

float fractionOf(float distance, float way) {
  if (way == 0) raiseDivisionByZero();
  return distance / way;
}

bool containsRounded(const Rect& rect, float x, float y) { return rect.contains({toInt32(x), toInt32(y)}); }

}  // namespace frontpanels

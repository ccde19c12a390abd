// What both splitter bars share: the hold on the mouse while a bar is dragged and the pointer that says so.
#pragma once

#include <cstdint>

#include "framework/support/drawing_surface.h"
#include "platform/gdi.h"
#include "platform/windowing.h"

namespace frontpanels {

inline constexpr std::int16_t kLeftMouseButton = 1;

class SplitterDrag {
 public:
  SplitterDrag(Windowing& windowing, MousePointer sizingPointer)
      : windowing_(windowing), sizingPointer_(sizingPointer) {}

  void surface(DrawingSurface* surface) noexcept { surface_ = surface; }
  // Raises "Object variable or With block variable not set" before a surface was given.
  [[nodiscard]] DrawingSurface& surface() const;

  [[nodiscard]] bool captured() const noexcept { return captured_; }
  [[nodiscard]] bool pointerIsSizing() const;
  // Takes the capture. The drag is on only when some window held the capture before: during a press the
  // container does, so without one this is no press that reached the panel in the ordinary way.
  void begin();
  [[nodiscard]] bool inProgress() const;
  // The pointer over the bar, or the default one beside it.
  void showPointer(bool overBar);
  // Ends a drag by a release on the bar: capture, pointer and state go back.
  void finish();
  // Ends whatever there was after a release elsewhere.
  void cancel();

 private:
  Windowing& windowing_;
  MousePointer sizingPointer_;
  DrawingSurface* surface_ = nullptr;
  bool captured_ = false;
};

// A rectangle of surface units with every edge rounded half to even. Raises "Overflow".
[[nodiscard]] Rect roundedRect(float left, float top, float right, float bottom);
// A bar's place as a fraction of the way it can go. Raises "Division by zero" where there is no way at all,
// so that a bar on a collapsed surface keeps its last good place.
[[nodiscard]] float fractionOf(float distance, float way);
// Whether a point, rounded the same way, lies in it.
[[nodiscard]] bool containsRounded(const Rect& rect, float x, float y);

}  // namespace frontpanels

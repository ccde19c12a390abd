// Scopes for drawing: what is selected or set for a block is put back at its end, on every way out.
// A creation that failed leaves the device context as it was; the block then draws with what is selected.
#pragma once

#include "platform/gdi.h"

namespace frontpanels {

// Selects a handle that someone else owns.
template <class H>
class SelectedObject {
 public:
  SelectedObject(Gdi& gdi, DcHandle dc, H object) : gdi_(gdi), dc_(dc) {
    if (object) previous_ = gdi_.selectObject(dc_, object);
  }
  ~SelectedObject() {
    if (previous_) gdi_.selectObject(dc_, previous_);
  }
  SelectedObject(const SelectedObject&) = delete;
  SelectedObject& operator=(const SelectedObject&) = delete;

 private:
  Gdi& gdi_;
  DcHandle dc_;
  H previous_{};
};

using SelectedFont = SelectedObject<FontHandle>;

// Creates a pen, selects it, selects it out again and deletes it.
class SelectedPen {
 public:
  SelectedPen(Gdi& gdi, DcHandle dc, PenStyle style, std::int32_t widthPx, Color color)
      : gdi_(gdi), dc_(dc), pen_(gdi.createPen(style, widthPx, color)) {
    if (pen_) previous_ = gdi_.selectObject(dc_, pen_);
  }
  ~SelectedPen() {
    // A pen that stayed selected could not be deleted: where the previous one is refused, a stock pen takes
    // its place.
    if (previous_ && !gdi_.selectObject(dc_, previous_))
      gdi_.selectObject(dc_, gdi_.stockPen(StockPen::Black));
    if (pen_) gdi_.deleteObject(pen_);
  }
  SelectedPen(const SelectedPen&) = delete;
  SelectedPen& operator=(const SelectedPen&) = delete;

 private:
  Gdi& gdi_;
  DcHandle dc_;
  PenHandle pen_;
  PenHandle previous_{};
};

class TextStyleScope {
 public:
  TextStyleScope(Gdi& gdi, DcHandle dc, Color color, BackgroundMode mode)
      : gdi_(gdi), dc_(dc), color_(gdi.setTextColor(dc, color)), mode_(gdi.setBkMode(dc, mode)) {}
  ~TextStyleScope() {
    gdi_.setBkMode(dc_, mode_);
    gdi_.setTextColor(dc_, color_);
  }
  TextStyleScope(const TextStyleScope&) = delete;
  TextStyleScope& operator=(const TextStyleScope&) = delete;

 private:
  Gdi& gdi_;
  DcHandle dc_;
  Color color_;
  BackgroundMode mode_;
};

}  // namespace frontpanels

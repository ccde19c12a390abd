// The memory device context that a graph is composed in, with its bitmap and what was selected before.
#pragma once

#include "platform/gdi.h"

namespace frontpanels {

class OffScreenSurface {
 public:
  explicit OffScreenSurface(Gdi& gdi) : gdi_(gdi) {}
  ~OffScreenSurface() { release(); }
  OffScreenSurface(const OffScreenSurface&) = delete;
  OffScreenSurface& operator=(const OffScreenSurface&) = delete;

  [[nodiscard]] DcHandle dc() const noexcept { return dc_; }
  // Both parts were made: drawing leaves a trace.
  [[nodiscard]] bool complete() const noexcept { return dc_ && bitmap_; }

  // Puts back what was selected (pen, brush, font, bitmap), then deletes the bitmap and the context.
  void release() noexcept {
    if (dc_) {
      if (previousPen_) gdi_.selectObject(dc_, previousPen_);
      if (previousBrush_) gdi_.selectObject(dc_, previousBrush_);
      if (previousFont_) gdi_.selectObject(dc_, previousFont_);
      if (previousBitmap_) gdi_.selectObject(dc_, previousBitmap_);
    }
    if (bitmap_ && gdi_.deleteObject(bitmap_)) bitmap_ = {};
    if (dc_) gdi_.deleteDC(dc_);
    // A bitmap that could not be selected out is free now that its context is gone.
    if (bitmap_) gdi_.deleteObject(bitmap_);
    dc_ = {};
    bitmap_ = {};
    previousPen_ = {};
    previousBrush_ = {};
    previousFont_ = {};
    previousBitmap_ = {};
  }

  // The two steps of making it; each answers whether its own object was made.
  bool createDC(DcHandle compatibleWith) {
    dc_ = gdi_.createCompatibleDC(compatibleWith);
    return static_cast<bool>(dc_);
  }
  void createBitmap(DcHandle compatibleWith, Size sizePx) {
    bitmap_ = gdi_.createCompatibleBitmap(compatibleWith, sizePx);
  }

  // Selects the bitmap, the black pen, the face brush and a font, keeping what they replace.
  void selectOwn(FontHandle font) {
    if (bitmap_) previousBitmap_ = gdi_.selectObject(dc_, bitmap_);
    previousPen_ = gdi_.selectObject(dc_, gdi_.stockPen(StockPen::Black));
    previousBrush_ = gdi_.selectObject(dc_, gdi_.sysColorBrush(SystemColor::ButtonFace));
    if (font) previousFont_ = gdi_.selectObject(dc_, font);
  }

 private:
  Gdi& gdi_;
  DcHandle dc_{};
  BitmapHandle bitmap_{};
  BitmapHandle previousBitmap_{};
  PenHandle previousPen_{};
  BrushHandle previousBrush_{};
  FontHandle previousFont_{};
};

}  // namespace frontpanels

// The graphics interface of a panel that can also be drawn into a picture of another size: a metafile, a
// printer's page, a form's design surface. While a picture is open, what the panel draws goes there as lines,
// areas and texts, at the picture's own resolution, and the panel's surfaces stay as they are; what it
// measures and selects is still theirs, so that the panel notices nothing.
#pragma once

#include <windows.h>

#include <vector>

#include "platform/win32/win32_gdi.h"

namespace frontpanels {

// Where a picture is drawn to, and what it is a picture of.
struct PictureTarget {
  HDC dc = nullptr;
  RECTL bounds{};         // logical coordinates of the context; either axis may run backwards
  Size viewPx;            // what the bounds show
  DcHandle view;          // the panel's own context
  DcHandle surface;       // the graph's off-screen surface
  Point surfaceOriginPx;  // its place in the view
};

class PictureGdi final : public Win32Gdi {
 public:
  // Calls of the panel go to the picture for as long as it lives, to the one opened last. The target's state
  // is put back at the end.
  class Picture {
   public:
    Picture(PictureGdi& gdi, const PictureTarget& target);
    ~Picture();
    Picture(const Picture&) = delete;
    Picture& operator=(const Picture&) = delete;

   private:
    friend class PictureGdi;

    struct State {
      LOGPEN pen{};
      LOGFONTW font{};
      COLORREF text = 0;
      COLORREF background = 0;
      int mode = 0;
      int operation = 0;
    };

    // Of the panel that is pictured: another one may be painting meanwhile.
    [[nodiscard]] bool shows(DcHandle dc) const { return dc == target_.view || dc == target_.surface; }
    // An axis of `viewPx` pixels that is drawn `length` units long. Traces reach far beyond it.
    struct Axis {
      LONG first;
      LONG length;
      std::int32_t viewPx;
      double farthest;

      [[nodiscard]] LONG edgeOf(std::int32_t px) const;
      [[nodiscard]] LONG middleOf(std::int32_t px) const;  // where a line runs
      [[nodiscard]] LONG within(double coordinate) const;
    };

    [[nodiscard]] Axis across() const;
    [[nodiscard]] Axis down() const;
    [[nodiscard]] POINT at(DcHandle dc, Point point) const;
    [[nodiscard]] RECT at(DcHandle dc, Rect rect) const;
    // Lengths that are as long both ways: of pens and edges.
    [[nodiscard]] int length(int px) const;
    void takeOver(DcHandle dc);
    void select(HGDIOBJ made);
    void takePen(const LOGPEN& pen);
    void takeFont(const LOGFONTW& font);
    void clip(DcHandle dc, RegionHandle region);
    void edge(DcHandle dc, Rect rect, std::uint32_t edge);
    bool polyline(DcHandle dc, std::span<const Point> points);
    bool textOut(DcHandle dc, Point topLeft, std::string_view text);

    PictureGdi& gdi_;
    Picture* outer_;  // open when this one was opened
    PictureTarget target_;
    int saved_;
    bool clipped_ = false;
    bool known_ = false;  // whether the context has the state
    State state_;
    double farthest_;            // coordinate that the context can hold
    std::vector<HGDIOBJ> made_;  // pens and fonts; a saved state may have any of them
    std::vector<POINT> points_;
  };

  bool selectClipRgn(DcHandle dc, RegionHandle region) override;
  bool fillRect(DcHandle dc, Rect rect, BrushHandle brush) override;
  bool moveTo(DcHandle dc, Point to) override;
  bool lineTo(DcHandle dc, Point to) override;
  bool polyline(DcHandle dc, std::span<const Point> points) override;
  bool drawEdge(DcHandle dc, Rect rect, std::uint32_t edge, std::uint32_t sides) override;
  bool textOut(DcHandle dc, Point topLeft, std::string_view text) override;
  bool bitBlt(DcHandle to, Rect destination, DcHandle from, Point source, RasterOp operation) override;

 private:
  // The open picture that a call goes to; null for none.
  [[nodiscard]] Picture* pictureOf(DcHandle dc) const noexcept {
    return picture_ != nullptr && picture_->shows(dc) ? picture_ : nullptr;
  }

  Picture* picture_ = nullptr;
};

}  // namespace frontpanels

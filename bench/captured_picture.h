// A picture as the bare list of its graphics calls: captured once from whoever draws it, then drawn again
// with no framework round it. Its traces take new values each time.
#pragma once

#include <cstdint>
#include <map>
#include <span>
#include <string>
#include <variant>
#include <vector>

#include "platform/gdi.h"

namespace frontpanels::bench {

// How a trace's values become pixels: what the shortest loop that draws the same picture has to know.
struct PlotMapping {
  double leftPx = 0;
  double stepPx = 0;
  double originPx = 0;
  double pxPerUnit = 0;
};

// Forwards every call and keeps those that a picture is made of; asking for a text's size is not one of them.
// A polyline of more than two points counts as a trace. Allocates only while it captures, so that what is
// measured through it is the panel's own.
class CapturingGdi : public Gdi {
 public:
  explicit CapturingGdi(Gdi& gdi) : gdi_(gdi) {}

  void start() {
    calls_.clear();
    created_.clear();
    createdBrushes_.clear();
    traces_ = 0;
    capturing_ = true;
  }
  void stop() { capturing_ = false; }
  // Draws the captured picture through the graphics interface behind this one; trace i of it with values i.
  void draw(std::span<const std::span<const float>> traces, const PlotMapping& mapping);

  DcHandle createCompatibleDC(DcHandle dc) override { return gdi_.createCompatibleDC(dc); }
  bool deleteDC(DcHandle dc) override { return gdi_.deleteDC(dc); }
  BitmapHandle createCompatibleBitmap(DcHandle dc, Size size) override {
    return gdi_.createCompatibleBitmap(dc, size);
  }
  PenHandle createPen(PenStyle style, std::int32_t widthPx, Color color) override;
  BrushHandle createSolidBrush(Color color) override;
  BrushHandle createHatchBrush(HatchStyle style, Color color) override {
    return gdi_.createHatchBrush(style, color);
  }
  FontHandle createFont(const FontSpec& font) override { return gdi_.createFont(font); }
  RegionHandle createRectRgn(Rect rect) override;
  bool deleteObject(BitmapHandle bitmap) override { return gdi_.deleteObject(bitmap); }
  bool deleteObject(PenHandle pen) override;
  bool deleteObject(BrushHandle brush) override;
  bool deleteObject(FontHandle font) override { return gdi_.deleteObject(font); }
  bool deleteObject(RegionHandle region) override;
  PenHandle stockPen(StockPen pen) override { return gdi_.stockPen(pen); }
  BrushHandle stockBrush(StockBrush brush) override { return gdi_.stockBrush(brush); }
  Color sysColor(SystemColor color) override { return gdi_.sysColor(color); }
  BrushHandle sysColorBrush(SystemColor color) override { return gdi_.sysColorBrush(color); }
  BitmapHandle selectObject(DcHandle dc, BitmapHandle bitmap) override {
    return gdi_.selectObject(dc, bitmap);
  }
  PenHandle selectObject(DcHandle dc, PenHandle pen) override;
  BrushHandle selectObject(DcHandle dc, BrushHandle brush) override { return gdi_.selectObject(dc, brush); }
  FontHandle selectObject(DcHandle dc, FontHandle font) override;
  bool selectClipRgn(DcHandle dc, RegionHandle region) override;
  Color setTextColor(DcHandle dc, Color color) override;
  Color setBkColor(DcHandle dc, Color color) override { return gdi_.setBkColor(dc, color); }
  BackgroundMode setBkMode(DcHandle dc, BackgroundMode mode) override;
  DrawMode setRop2(DcHandle dc, DrawMode mode) override { return gdi_.setRop2(dc, mode); }
  bool fillRect(DcHandle dc, Rect rect, BrushHandle brush) override;
  bool moveTo(DcHandle dc, Point to) override;
  bool lineTo(DcHandle dc, Point to) override;
  bool polyline(DcHandle dc, std::span<const Point> points) override;
  bool drawEdge(DcHandle dc, Rect rect, std::uint32_t edge, std::uint32_t sides) override {
    return gdi_.drawEdge(dc, rect, edge, sides);
  }
  bool textOut(DcHandle dc, Point topLeft, std::string_view text) override;
  Size textExtent(DcHandle dc, std::string_view text) override { return gdi_.textExtent(dc, text); }
  bool bitBlt(DcHandle to, Rect destination, DcHandle from, Point source, RasterOp operation) override;

 private:
  // An object that the picture itself makes is named by its slot, every other one by its handle.
  struct CreatePen {
    std::size_t slot;
    PenStyle style;
    std::int32_t widthPx;
    Color color;
  };
  struct DeletePen {
    std::size_t slot;
  };
  struct CreateBrush {
    std::size_t slot;
    Color color;
  };
  struct DeleteBrush {
    std::size_t slot;
  };
  struct FillWithCreated {
    DcHandle dc;
    Rect rect;
    std::size_t slot;
  };
  struct SelectCreatedPen {
    DcHandle dc;
    std::size_t slot;
  };
  struct SelectPen {
    DcHandle dc;
    PenHandle pen;
  };
  struct SelectFont {
    DcHandle dc;
    FontHandle font;
  };
  struct Clip {
    DcHandle dc;
    Rect rect;
  };
  struct Unclip {
    DcHandle dc;
  };
  struct TextColor {
    DcHandle dc;
    Color color;
  };
  struct TextMode {
    DcHandle dc;
    BackgroundMode mode;
  };
  struct Fill {
    DcHandle dc;
    Rect rect;
    BrushHandle brush;
  };
  struct MoveTo {
    DcHandle dc;
    Point to;
  };
  struct LineTo {
    DcHandle dc;
    Point to;
  };
  struct Line {
    DcHandle dc;
    std::vector<Point> points;
  };
  struct Trace {
    DcHandle dc;
    std::size_t index;
  };
  struct Text {
    DcHandle dc;
    Point topLeft;
    std::string text;
  };
  struct Blit {
    DcHandle to;
    Rect destination;
    DcHandle from;
    Point source;
    RasterOp operation;
  };
  using Call = std::variant<CreatePen, DeletePen, SelectCreatedPen, SelectPen, SelectFont, Clip, Unclip,
                            TextColor, TextMode, CreateBrush, DeleteBrush, FillWithCreated, Fill, MoveTo,
                            LineTo, Line, Trace, Text, Blit>;
  struct Player;

  template <class C>
  void keep(C call) {
    if (capturing_) calls_.emplace_back(std::move(call));
  }

  Gdi& gdi_;
  bool capturing_ = false;
  std::vector<Call> calls_;
  std::map<std::uintptr_t, std::size_t> created_;  // pens alive while capturing: handle to slot
  std::map<std::uintptr_t, std::size_t> createdBrushes_;
  std::map<std::uintptr_t, Rect> regions_;
  std::size_t pens_ = 0;
  std::size_t brushes_ = 0;
  std::size_t traces_ = 0;
  std::vector<PenHandle> drawnPens_;
  std::vector<BrushHandle> drawnBrushes_;
  std::vector<Point> points_;
};

}  // namespace frontpanels::bench

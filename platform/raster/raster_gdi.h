// The drawing seam in memory, with the pixel rules of the graphics interface: see docs/decisions.md.
// Handles are slots in pools: in steady state, making and deleting objects allocates nothing.
#pragma once

#include <array>
#include <map>
#include <optional>
#include <vector>

#include "platform/gdi.h"
#include "platform/raster/font_cache.h"
#include "platform/raster/pixels.h"
#include "platform/raster/pool.h"
#include "platform/raster/wide_line.h"

namespace frontpanels {

class RasterGdi final : public Gdi {
 public:
  RasterGdi();

  // A device context with pixels of its own that stands for a visible view. Null when the size is not
  // positive.
  [[nodiscard]] DcHandle createScreen(Size sizePx);
  // Gives a screen new, black pixels.
  bool resizeScreen(DcHandle screen, Size sizePx);
  // What was drawn; empty for an unknown device context.
  [[nodiscard]] PixelView pixels(DcHandle dc);
  // Windows' defaults until they are set. The colour's brush takes it on.
  void setSysColor(SystemColor color, Color value);
  // Off until it is set.
  void setHighContrast(bool on) { highContrast_ = on; }

  // Objects that were created and not yet deleted; screens and stock objects are not counted.
  [[nodiscard]] std::size_t liveObjects() const;
  [[nodiscard]] std::size_t liveDcs() const;

  [[nodiscard]] DcHandle createCompatibleDC(DcHandle dc) override;
  bool deleteDC(DcHandle dc) override;
  [[nodiscard]] BitmapHandle createCompatibleBitmap(DcHandle dc, Size sizePx) override;
  [[nodiscard]] PenHandle createPen(PenStyle style, std::int32_t widthPx, Color color) override;
  [[nodiscard]] BrushHandle createSolidBrush(Color color) override;
  [[nodiscard]] BrushHandle createHatchBrush(HatchStyle style, Color color) override;
  [[nodiscard]] FontHandle createFont(const FontSpec& font) override;
  [[nodiscard]] RegionHandle createRectRgn(Rect rect) override;
  bool deleteObject(BitmapHandle bitmap) override;
  bool deleteObject(PenHandle pen) override;
  bool deleteObject(BrushHandle brush) override;
  bool deleteObject(FontHandle font) override;
  bool deleteObject(RegionHandle region) override;
  [[nodiscard]] PenHandle stockPen(StockPen pen) override;
  [[nodiscard]] BrushHandle stockBrush(StockBrush brush) override;
  [[nodiscard]] Color sysColor(SystemColor color) override;
  [[nodiscard]] BrushHandle sysColorBrush(SystemColor color) override;
  [[nodiscard]] bool highContrast() override { return highContrast_; }
  BitmapHandle selectObject(DcHandle dc, BitmapHandle bitmap) override;
  PenHandle selectObject(DcHandle dc, PenHandle pen) override;
  BrushHandle selectObject(DcHandle dc, BrushHandle brush) override;
  FontHandle selectObject(DcHandle dc, FontHandle font) override;
  bool selectClipRgn(DcHandle dc, RegionHandle region) override;
  Color setTextColor(DcHandle dc, Color color) override;
  Color setBkColor(DcHandle dc, Color color) override;
  BackgroundMode setBkMode(DcHandle dc, BackgroundMode mode) override;
  DrawMode setRop2(DcHandle dc, DrawMode mode) override;
  bool fillRect(DcHandle dc, Rect rect, BrushHandle brush) override;
  bool moveTo(DcHandle dc, Point to) override;
  bool lineTo(DcHandle dc, Point to) override;
  bool polyline(DcHandle dc, std::span<const Point> points) override;
  bool drawEdge(DcHandle dc, Rect rect, std::uint32_t edge, std::uint32_t sides) override;
  bool textOut(DcHandle dc, Point topLeft, std::string_view text) override;
  [[nodiscard]] Size textExtent(DcHandle dc, std::string_view text) override;
  bool bitBlt(DcHandle to, Rect destination, DcHandle from, Point source, RasterOp operation) override;

 private:
  struct Pen {
    PenStyle style = PenStyle::Solid;
    std::int32_t widthPx = 1;
    std::uint32_t pixel = 0;
    bool null = false;
    bool stock = false;
    int selections = 0;
  };
  struct Brush {
    std::uint32_t pixel = 0;
    std::optional<HatchStyle> hatch{};
    bool null = false;
    bool stock = false;
    int selections = 0;
  };
  struct FontObject {
    Font* font = nullptr;
    bool stock = false;
    int selections = 0;
  };
  struct Dc {
    BitmapHandle bitmap{};
    PenHandle pen{};
    BrushHandle brush{};
    FontHandle font{};
    PixelRows rows{};  // of the selected bitmap, as are the bounds
    Rect bounds{};
    std::optional<Rect> region{};
    Rect clip{};   // bounds and region together
    Pen penNow{};  // a copy: a selected pen cannot change
    Color textColor{};
    Color bkColor = rgb(255, 255, 255);
    BackgroundMode mode = BackgroundMode::Opaque;
    DrawMode rop = DrawMode::CopyPen;
    Point current{};
    bool screen = false;
  };

  [[nodiscard]] DcHandle newDc(BitmapHandle bitmap, bool screen);
  static void attach(Dc& dc, const Bitmap& bitmap);
  static void updateClip(Dc& dc);
  template <class T, class H>
  bool destroy(Pool<T, H>& pool, H handle);
  template <class T, class H>
  H exchangeSelected(Pool<T, H>& pool, DcHandle dc, H Dc::*slot, H handle);
  [[nodiscard]] Font* fontOf(const Dc& dc);

  void drawPolyline(const Dc& dc, std::span<const Point> points);
  void drawWide(const Dc& dc, std::span<const Point> points);
  void drawGlyphs(const Dc& dc, Font& font, Point topLeft, std::string_view text);
  [[nodiscard]] std::uint32_t sysPixel(SystemColor color) { return pixelOf(sysColor(color)); }

  Pool<Bitmap, BitmapHandle> bitmaps_;
  Pool<Pen, PenHandle> pens_;
  Pool<Brush, BrushHandle> brushes_;
  Pool<FontObject, FontHandle> fonts_;
  Pool<Rect, RegionHandle> regions_;
  Pool<Dc, DcHandle> dcs_;
  FontCache fontCache_;
  std::map<SystemColor, Color> systemColors_;
  std::map<SystemColor, BrushHandle> systemBrushes_;
  std::map<StockPen, PenHandle> stockPens_;
  std::map<StockBrush, BrushHandle> stockBrushes_;
  FontHandle stockFont_{};
  BitmapHandle stockBitmap_{};
  std::size_t stockObjects_ = 0;
  std::size_t screens_ = 0;
  std::vector<PixelSpan> wideSpans_;  // reused
  bool highContrast_ = false;
};

}  // namespace frontpanels

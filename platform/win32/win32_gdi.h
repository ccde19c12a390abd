// The drawing seam on the real graphics interface: one call forwarded a method.
#pragma once

#include <optional>

#include "platform/gdi.h"

namespace frontpanels {

class Win32Gdi : public Gdi {
 public:
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
  // Asked of the system once, and again after it has said that colours or settings have changed.
  [[nodiscard]] bool highContrast() override;
  void settingsChanged() noexcept { highContrast_.reset(); }
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
  std::optional<bool> highContrast_;
};

}  // namespace frontpanels

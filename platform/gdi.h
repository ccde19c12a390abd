// The drawing seam: the graphics-interface functions that the panels draw with, one method each.
// Coordinates are device pixels; rectangles are half-open; a polyline or a line leaves out its last point.
// A function that fails answers a null handle or false and changes nothing; none of them throws.
#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>

#include "platform/geometry.h"
#include "platform/handle.h"

namespace frontpanels {

// A Windows colour value: 0x00BBGGRR.
struct Color {
  std::uint32_t bgr = 0;

  [[nodiscard]] constexpr std::uint8_t red() const noexcept { return static_cast<std::uint8_t>(bgr); }
  [[nodiscard]] constexpr std::uint8_t green() const noexcept { return static_cast<std::uint8_t>(bgr >> 8); }
  [[nodiscard]] constexpr std::uint8_t blue() const noexcept { return static_cast<std::uint8_t>(bgr >> 16); }
  friend constexpr bool operator==(const Color&, const Color&) = default;
};

[[nodiscard]] constexpr Color rgb(std::uint8_t red, std::uint8_t green, std::uint8_t blue) noexcept {
  return Color{static_cast<std::uint32_t>(red) | static_cast<std::uint32_t>(green) << 8 |
               static_cast<std::uint32_t>(blue) << 16};
}

// The numbers are those of the graphics interface, so that its backend forwards them as they are.
enum class PenStyle : std::int32_t { Solid = 0, Dash = 1, Dot = 2, DashDot = 3, DashDotDot = 4 };
enum class HatchStyle : std::int32_t {
  Horizontal = 0,
  Vertical = 1,
  ForwardDiagonal = 2,
  BackwardDiagonal = 3,
  Cross = 4,
  DiagonalCross = 5
};
enum class StockPen : std::int32_t { White = 6, Black = 7, Null = 8 };
enum class StockBrush : std::int32_t {
  White = 0,
  LightGray = 1,
  Gray = 2,
  DarkGray = 3,
  Black = 4,
  Null = 5
};
enum class BackgroundMode : std::int32_t { Transparent = 1, Opaque = 2 };
enum class DrawMode : std::int32_t { NotXorPen = 10, CopyPen = 13 };
enum class RasterOp : std::uint32_t { SourceCopy = 0x00CC0020 };
enum class SystemColor : std::int32_t {
  Window = 5,
  WindowText = 8,
  Highlight = 13,
  ButtonFace = 15,
  ButtonShadow = 16,
  GrayText = 17,
  ButtonText = 18,
  ButtonHighlight = 20,
  DarkShadow3d = 21,
  Light3d = 22
};

// Edge styles and sides of drawEdge.
inline constexpr std::uint32_t kEdgeRaised = 5;   // raised outer and inner
inline constexpr std::uint32_t kEdgeBump = 9;     // raised outer, sunken inner
inline constexpr std::uint32_t kEdgeSunken = 10;  // sunken outer and inner
inline constexpr std::uint32_t kAllSides = 15;

struct FontSpec {
  std::string face;
  std::int32_t emHeightPx = 11;  // height of the character, without internal leading
  std::int32_t weight = 400;
  bool italic = false;
  friend bool operator==(const FontSpec&, const FontSpec&) = default;
};

class Gdi {
 public:
  virtual ~Gdi() = default;

  // Device contexts. A null `dc` stands for the screen.
  [[nodiscard]] virtual DcHandle createCompatibleDC(DcHandle dc) = 0;
  virtual bool deleteDC(DcHandle dc) = 0;
  [[nodiscard]] virtual BitmapHandle createCompatibleBitmap(DcHandle dc, Size sizePx) = 0;

  // Objects. Whoever creates one deletes it, after selecting it out; stock and system objects are never
  // deleted.
  [[nodiscard]] virtual PenHandle createPen(PenStyle style, std::int32_t widthPx, Color color) = 0;
  [[nodiscard]] virtual BrushHandle createSolidBrush(Color color) = 0;
  [[nodiscard]] virtual BrushHandle createHatchBrush(HatchStyle style, Color color) = 0;
  [[nodiscard]] virtual FontHandle createFont(const FontSpec& font) = 0;
  [[nodiscard]] virtual RegionHandle createRectRgn(Rect rect) = 0;
  virtual bool deleteObject(BitmapHandle bitmap) = 0;
  virtual bool deleteObject(PenHandle pen) = 0;
  virtual bool deleteObject(BrushHandle brush) = 0;
  virtual bool deleteObject(FontHandle font) = 0;
  virtual bool deleteObject(RegionHandle region) = 0;
  [[nodiscard]] virtual PenHandle stockPen(StockPen pen) = 0;
  [[nodiscard]] virtual BrushHandle stockBrush(StockBrush brush) = 0;
  [[nodiscard]] virtual Color sysColor(SystemColor color) = 0;
  [[nodiscard]] virtual BrushHandle sysColorBrush(SystemColor color) = 0;
  // Whether the user has asked the system for a scheme of few colours that stand out against each other.
  [[nodiscard]] virtual bool highContrast() { return false; }

  // Selecting answers the object that was selected before, null on failure.
  virtual BitmapHandle selectObject(DcHandle dc, BitmapHandle bitmap) = 0;
  virtual PenHandle selectObject(DcHandle dc, PenHandle pen) = 0;
  virtual BrushHandle selectObject(DcHandle dc, BrushHandle brush) = 0;
  virtual FontHandle selectObject(DcHandle dc, FontHandle font) = 0;
  // The device context keeps a copy of the region; a null region removes the clip.
  virtual bool selectClipRgn(DcHandle dc, RegionHandle region) = 0;

  // State of a device context; each answers what was set before.
  virtual Color setTextColor(DcHandle dc, Color color) = 0;
  virtual Color setBkColor(DcHandle dc, Color color) = 0;
  virtual BackgroundMode setBkMode(DcHandle dc, BackgroundMode mode) = 0;
  virtual DrawMode setRop2(DcHandle dc, DrawMode mode) = 0;

  // Drawing.
  virtual bool fillRect(DcHandle dc, Rect rect, BrushHandle brush) = 0;
  virtual bool moveTo(DcHandle dc, Point to) = 0;
  virtual bool lineTo(DcHandle dc, Point to) = 0;
  virtual bool polyline(DcHandle dc, std::span<const Point> points) = 0;
  virtual bool drawEdge(DcHandle dc, Rect rect, std::uint32_t edge, std::uint32_t sides) = 0;
  // `topLeft` is the top left corner of the text's cell; the text is UTF-8.
  virtual bool textOut(DcHandle dc, Point topLeft, std::string_view text) = 0;
  [[nodiscard]] virtual Size textExtent(DcHandle dc, std::string_view text) = 0;
  virtual bool bitBlt(DcHandle to, Rect destination, DcHandle from, Point source, RasterOp operation) = 0;
};

}  // namespace frontpanels

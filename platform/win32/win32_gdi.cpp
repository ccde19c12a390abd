#include "platform/win32/win32_gdi.h"

#include <windows.h>

#include <array>
#include <cstddef>
#include <limits>
#include <vector>

#include "platform/win32/win32_windowing.h"

namespace frontpanels {
namespace {

// The seam's points and rectangles are handed over as they are.
static_assert(sizeof(Point) == sizeof(POINT) && offsetof(Point, y) == offsetof(POINT, y));
static_assert(sizeof(Rect) == sizeof(RECT) && offsetof(Rect, bottom) == offsetof(RECT, bottom));

HDC native(DcHandle dc) { return reinterpret_cast<HDC>(dc.value); }
template <class Tag>
HGDIOBJ object(Handle<Tag> handle) {
  return reinterpret_cast<HGDIOBJ>(handle.value);
}
template <class H, class Native>
H wrapped(Native handle) {
  return H{reinterpret_cast<std::uintptr_t>(handle)};
}
RECT native(Rect rect) { return {rect.left, rect.top, rect.right, rect.bottom}; }

template <class Tag>
Handle<Tag> selected(DcHandle dc, Handle<Tag> handle) {
  return wrapped<Handle<Tag>>(SelectObject(native(dc), object(handle)));
}

// UTF-16 text of a UTF-8 one; labels fit in place, so that drawing them allocates nothing.
class WideText {
 public:
  explicit WideText(std::string_view utf8) {
    // A UTF-8 text never has more UTF-16 units than bytes.
    if (utf8.size() > static_cast<std::size_t>(std::numeric_limits<int>::max())) return;
    if (utf8.size() > inPlace_.size()) {
      long_.resize(utf8.size());
      units_ = long_.data();
    }
    const int bytes = static_cast<int>(utf8.size());
    length_ = MultiByteToWideChar(CP_UTF8, 0, utf8.data(), bytes, units_, bytes);
  }
  WideText(const WideText&) = delete;
  WideText& operator=(const WideText&) = delete;
  [[nodiscard]] const wchar_t* data() const { return units_; }
  [[nodiscard]] int length() const { return length_; }

 private:
  std::array<wchar_t, 128> inPlace_;
  std::vector<wchar_t> long_;
  wchar_t* units_ = inPlace_.data();
  int length_ = 0;
};

}  // namespace

DcHandle Win32Gdi::createCompatibleDC(DcHandle dc) {
  return wrapped<DcHandle>(CreateCompatibleDC(native(dc)));
}
bool Win32Gdi::deleteDC(DcHandle dc) { return DeleteDC(native(dc)) != 0; }

BitmapHandle Win32Gdi::createCompatibleBitmap(DcHandle dc, Size sizePx) {
  if (dc) return wrapped<BitmapHandle>(CreateCompatibleBitmap(native(dc), sizePx.width, sizePx.height));
  const HDC screen = GetDC(nullptr);
  const HBITMAP bitmap = CreateCompatibleBitmap(screen, sizePx.width, sizePx.height);
  ReleaseDC(nullptr, screen);
  return wrapped<BitmapHandle>(bitmap);
}

PenHandle Win32Gdi::createPen(PenStyle style, std::int32_t widthPx, Color color) {
  return wrapped<PenHandle>(CreatePen(static_cast<int>(style), widthPx, color.bgr));
}
BrushHandle Win32Gdi::createSolidBrush(Color color) {
  return wrapped<BrushHandle>(CreateSolidBrush(color.bgr));
}
BrushHandle Win32Gdi::createHatchBrush(HatchStyle style, Color color) {
  return wrapped<BrushHandle>(CreateHatchBrush(static_cast<int>(style), color.bgr));
}
FontHandle Win32Gdi::createFont(const FontSpec& font) {
  LOGFONTW wanted{};
  wanted.lfHeight = -font.emHeightPx;  // negative: the height of the character, not of its cell
  wanted.lfWeight = font.weight;
  wanted.lfItalic = font.italic ? TRUE : FALSE;
  wanted.lfCharSet = DEFAULT_CHARSET;
  const WideText face(font.face);
  for (int i = 0; i < face.length() && i < LF_FACESIZE - 1; ++i) wanted.lfFaceName[i] = face.data()[i];
  return wrapped<FontHandle>(CreateFontIndirectW(&wanted));
}
RegionHandle Win32Gdi::createRectRgn(Rect rect) {
  return wrapped<RegionHandle>(CreateRectRgn(rect.left, rect.top, rect.right, rect.bottom));
}
bool Win32Gdi::deleteObject(BitmapHandle bitmap) { return DeleteObject(object(bitmap)) != 0; }
bool Win32Gdi::deleteObject(PenHandle pen) { return DeleteObject(object(pen)) != 0; }
bool Win32Gdi::deleteObject(BrushHandle brush) { return DeleteObject(object(brush)) != 0; }
bool Win32Gdi::deleteObject(FontHandle font) { return DeleteObject(object(font)) != 0; }
bool Win32Gdi::deleteObject(RegionHandle region) { return DeleteObject(object(region)) != 0; }

PenHandle Win32Gdi::stockPen(StockPen pen) {
  return wrapped<PenHandle>(GetStockObject(static_cast<int>(pen)));
}
BrushHandle Win32Gdi::stockBrush(StockBrush brush) {
  return wrapped<BrushHandle>(GetStockObject(static_cast<int>(brush)));
}
Color Win32Gdi::sysColor(SystemColor color) {
  return Color{static_cast<std::uint32_t>(GetSysColor(static_cast<int>(color)))};
}
bool Win32Gdi::highContrast() {
  if (!highContrast_) highContrast_ = isHighContrast();
  return *highContrast_;
}
BrushHandle Win32Gdi::sysColorBrush(SystemColor color) {
  return wrapped<BrushHandle>(GetSysColorBrush(static_cast<int>(color)));
}

BitmapHandle Win32Gdi::selectObject(DcHandle dc, BitmapHandle bitmap) { return selected(dc, bitmap); }
PenHandle Win32Gdi::selectObject(DcHandle dc, PenHandle pen) { return selected(dc, pen); }
BrushHandle Win32Gdi::selectObject(DcHandle dc, BrushHandle brush) { return selected(dc, brush); }
FontHandle Win32Gdi::selectObject(DcHandle dc, FontHandle font) { return selected(dc, font); }
bool Win32Gdi::selectClipRgn(DcHandle dc, RegionHandle region) {
  return SelectClipRgn(native(dc), reinterpret_cast<HRGN>(region.value)) != ERROR;
}

Color Win32Gdi::setTextColor(DcHandle dc, Color color) { return Color{SetTextColor(native(dc), color.bgr)}; }
Color Win32Gdi::setBkColor(DcHandle dc, Color color) { return Color{SetBkColor(native(dc), color.bgr)}; }
BackgroundMode Win32Gdi::setBkMode(DcHandle dc, BackgroundMode mode) {
  return static_cast<BackgroundMode>(SetBkMode(native(dc), static_cast<int>(mode)));
}
DrawMode Win32Gdi::setRop2(DcHandle dc, DrawMode mode) {
  return static_cast<DrawMode>(SetROP2(native(dc), static_cast<int>(mode)));
}

bool Win32Gdi::fillRect(DcHandle dc, Rect rect, BrushHandle brush) {
  const RECT area = native(rect);
  return FillRect(native(dc), &area, reinterpret_cast<HBRUSH>(brush.value)) != 0;
}
bool Win32Gdi::moveTo(DcHandle dc, Point to) { return MoveToEx(native(dc), to.x, to.y, nullptr) != 0; }
bool Win32Gdi::lineTo(DcHandle dc, Point to) { return LineTo(native(dc), to.x, to.y) != 0; }
bool Win32Gdi::polyline(DcHandle dc, std::span<const Point> points) {
  if (points.size() > static_cast<std::size_t>(std::numeric_limits<int>::max())) return false;
  return Polyline(native(dc), reinterpret_cast<const POINT*>(points.data()),
                  static_cast<int>(points.size())) != 0;
}
bool Win32Gdi::drawEdge(DcHandle dc, Rect rect, std::uint32_t edge, std::uint32_t sides) {
  RECT area = native(rect);
  return DrawEdge(native(dc), &area, edge, sides) != 0;
}
bool Win32Gdi::textOut(DcHandle dc, Point topLeft, std::string_view text) {
  const WideText wide(text);
  return TextOutW(native(dc), topLeft.x, topLeft.y, wide.data(), wide.length()) != 0;
}
Size Win32Gdi::textExtent(DcHandle dc, std::string_view text) {
  const WideText wide(text);
  SIZE extent{};
  if (GetTextExtentPoint32W(native(dc), wide.data(), wide.length(), &extent) == 0) return {};
  return {extent.cx, extent.cy};
}
bool Win32Gdi::bitBlt(DcHandle to, Rect destination, DcHandle from, Point source, RasterOp operation) {
  return BitBlt(native(to), destination.left, destination.top, destination.width(), destination.height(),
                native(from), source.x, source.y, static_cast<DWORD>(operation)) != 0;
}

}  // namespace frontpanels

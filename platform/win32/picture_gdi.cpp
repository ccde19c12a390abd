#include "platform/win32/picture_gdi.h"

#include <cmath>
#include <cstdint>
#include <new>
#include <string>
#include <string_view>

#include "platform/win32/utf16.h"

namespace frontpanels {
namespace {

HDC native(DcHandle dc) { return reinterpret_cast<HDC>(dc.value); }
HBRUSH native(BrushHandle brush) { return reinterpret_cast<HBRUSH>(brush.value); }

// The edge of a pixel on an axis of `viewPx` pixels that is drawn `length` units long.
LONG edgeAt(LONG first, LONG length, std::int32_t px, std::int32_t viewPx) {
  return first + static_cast<LONG>(std::floor(0.5 + static_cast<double>(px) * length / viewPx));
}

// The middle of a pixel: lines run there. At the view's own scale it is the pixel itself.
LONG middleAt(LONG first, LONG length, std::int32_t px, std::int32_t viewPx) {
  return first + static_cast<LONG>(std::floor((px + 0.5) * length / viewPx));
}

// What an object of a context is made of; all of it zero where the context does not say.
template <class Description>
Description describe(HDC dc, UINT kind) {
  Description description{};
  GetObjectW(GetCurrentObject(dc, kind), sizeof description, &description);
  return description;
}

// What needs memory of its own fails as everything else on this seam does.
template <class Body>
bool drawn(Body body) noexcept {
  try {
    return body();
  } catch (const std::bad_alloc&) {
    return false;
  }
}

bool alike(const LOGPEN& a, const LOGPEN& b) {
  return a.lopnStyle == b.lopnStyle && a.lopnWidth.x == b.lopnWidth.x && a.lopnColor == b.lopnColor;
}

bool alike(const LOGFONTW& a, const LOGFONTW& b) {
  return a.lfHeight == b.lfHeight && a.lfWeight == b.lfWeight && a.lfItalic == b.lfItalic &&
         std::wstring_view(a.lfFaceName) == b.lfFaceName;
}

}  // namespace

PictureGdi::Picture::Picture(PictureGdi& gdi, const PictureTarget& target)
    : gdi_(gdi), outer_(gdi.picture_), target_(target), saved_(SaveDC(target.dc)) {
  SetTextAlign(target_.dc, TA_LEFT | TA_TOP | TA_NOUPDATECP);
  const RECTL& bounds = target_.bounds;
  IntersectClipRect(target_.dc, static_cast<int>(bounds.left), static_cast<int>(bounds.top),
                    static_cast<int>(bounds.right), static_cast<int>(bounds.bottom));
  gdi_.picture_ = this;
}

PictureGdi::Picture::~Picture() {
  gdi_.picture_ = outer_;
  if (clipped_) RestoreDC(target_.dc, -1);
  if (saved_ != 0) RestoreDC(target_.dc, -1);
  if (pen_ != nullptr) DeleteObject(pen_);
  if (font_ != nullptr) DeleteObject(font_);
}

POINT PictureGdi::Picture::at(DcHandle dc, Point point) const {
  const Point origin = dc == target_.surface ? target_.surfaceOriginPx : Point{};
  const RECTL& bounds = target_.bounds;
  return {middleAt(bounds.left, bounds.right - bounds.left, point.x + origin.x, target_.viewPx.width),
          middleAt(bounds.top, bounds.bottom - bounds.top, point.y + origin.y, target_.viewPx.height)};
}

RECT PictureGdi::Picture::at(DcHandle dc, Rect rect) const {
  const Point origin = dc == target_.surface ? target_.surfaceOriginPx : Point{};
  const RECTL& bounds = target_.bounds;
  const LONG width = bounds.right - bounds.left;
  const LONG height = bounds.bottom - bounds.top;
  return {edgeAt(bounds.left, width, rect.left + origin.x, target_.viewPx.width),
          edgeAt(bounds.top, height, rect.top + origin.y, target_.viewPx.height),
          edgeAt(bounds.left, width, rect.right + origin.x, target_.viewPx.width),
          edgeAt(bounds.top, height, rect.bottom + origin.y, target_.viewPx.height)};
}

int PictureGdi::Picture::length(int px) const {
  const RECTL& bounds = target_.bounds;
  return std::abs(MulDiv(px, static_cast<int>(bounds.bottom - bounds.top), target_.viewPx.height));
}

// What the panel has selected and set in its own context holds in the picture's.
void PictureGdi::Picture::takeOver(DcHandle dc) {
  const HDC own = native(dc);
  State now{describe<LOGPEN>(own, OBJ_PEN),
            describe<LOGFONTW>(own, OBJ_FONT),
            GetTextColor(own),
            GetBkColor(own),
            GetBkMode(own),
            GetROP2(own)};
  if (!known_ || !alike(now.pen, state_.pen)) takePen(now.pen);
  if (!known_ || !alike(now.font, state_.font)) takeFont(now.font);
  if (!known_ || now.text != state_.text) SetTextColor(target_.dc, now.text);
  if (!known_ || now.background != state_.background) SetBkColor(target_.dc, now.background);
  if (!known_ || now.mode != state_.mode) SetBkMode(target_.dc, now.mode);
  if (!known_ || now.operation != state_.operation) SetROP2(target_.dc, now.operation);
  state_ = now;
  known_ = true;
}

// A plain pen that is wider than one unit has no dashes; a 16-bit metafile knows no others.
void PictureGdi::Picture::takePen(const LOGPEN& pen) {
  const int width = length(pen.lopnWidth.x > 1 ? static_cast<int>(pen.lopnWidth.x) : 1);
  const bool dashed = pen.lopnStyle != PS_SOLID && pen.lopnStyle != PS_NULL;
  HPEN made = nullptr;
  if (dashed && width > 1 && GetObjectType(target_.dc) != OBJ_METADC) {
    const LOGBRUSH brush{BS_SOLID, pen.lopnColor, 0};
    made = ExtCreatePen(PS_GEOMETRIC | PS_ENDCAP_FLAT | pen.lopnStyle, static_cast<DWORD>(width), &brush, 0,
                        nullptr);
  } else {
    made = CreatePen(static_cast<int>(pen.lopnStyle), dashed ? 1 : width, pen.lopnColor);
  }
  if (made == nullptr) return;
  SelectObject(target_.dc, made);
  if (pen_ != nullptr) DeleteObject(pen_);
  pen_ = made;
}

void PictureGdi::Picture::takeFont(const LOGFONTW& font) {
  LOGFONTW wanted = font;
  const int height = length(static_cast<int>(std::abs(font.lfHeight)));
  wanted.lfHeight = font.lfHeight < 0 ? -height : height;
  const HFONT made = CreateFontIndirectW(&wanted);
  if (made == nullptr) return;
  SelectObject(target_.dc, made);
  if (font_ != nullptr) DeleteObject(font_);
  font_ = made;
}

// Within a saved state: a picture's own clip is never widened, and a metafile records it where it is replayed
// at any size. What was selected goes with the state.
void PictureGdi::Picture::clip(DcHandle dc, RegionHandle region) {
  if (clipped_) RestoreDC(target_.dc, -1);
  clipped_ = false;
  known_ = false;
  RECT box{};
  if (!region || GetRgnBox(reinterpret_cast<HRGN>(region.value), &box) == ERROR) return;
  clipped_ = SaveDC(target_.dc) != 0;
  const RECT shown = at(dc, Rect{box.left, box.top, box.right, box.bottom});
  IntersectClipRect(target_.dc, shown.left, shown.top, shown.right, shown.bottom);
}

// One ring of two colours, as wide as a line: those of the system are pixels, whatever the scale.
void PictureGdi::Picture::edge(DcHandle dc, Rect rect, std::uint32_t edge) {
  const bool sunken = edge == kEdgeSunken;
  const HBRUSH upper = GetSysColorBrush(sunken ? COLOR_3DSHADOW : COLOR_3DHIGHLIGHT);
  const HBRUSH lower = GetSysColorBrush(sunken ? COLOR_3DHIGHLIGHT : COLOR_3DSHADOW);
  const struct {
    Rect px;
    HBRUSH brush;
  } strips[] = {{{rect.left, rect.top, rect.right, rect.top + 1}, upper},
                {{rect.left, rect.top, rect.left + 1, rect.bottom}, upper},
                {{rect.left, rect.bottom - 1, rect.right, rect.bottom}, lower},
                {{rect.right - 1, rect.top, rect.right, rect.bottom}, lower}};
  for (const auto& strip : strips) {
    const RECT area = at(dc, strip.px);
    FillRect(target_.dc, &area, strip.brush);
  }
}

bool PictureGdi::Picture::polyline(DcHandle dc, std::span<const Point> points) {
  points_.clear();
  for (const Point& point : points) points_.push_back(at(dc, point));
  return Polyline(target_.dc, points_.data(), static_cast<int>(points_.size())) != 0;
}

// Each character stands where it does on the screen, whatever widths the picture's device has for it.
bool PictureGdi::Picture::textOut(DcHandle dc, Point topLeft, std::string_view text) {
  const std::wstring wide = toUtf16(text);
  const int count = static_cast<int>(wide.size());
  std::vector<INT> advances(wide.size());
  SIZE whole{};
  if (GetTextExtentExPointW(native(dc), wide.data(), count, 0, nullptr, advances.data(), &whole) == 0)
    return false;
  const RECT cell = at(dc, Rect{topLeft.x, topLeft.y, topLeft.x + whole.cx, topLeft.y + whole.cy});
  LONG from = cell.left;
  for (INT& advance : advances) {
    const LONG to = at(dc, Rect{0, 0, topLeft.x + advance, 0}).right;
    advance = static_cast<INT>(std::abs(to - from));
    from = to;
  }
  return ExtTextOutW(target_.dc, cell.left, cell.top, 0, nullptr, wide.data(), static_cast<UINT>(count),
                     advances.data()) != 0;
}

// --- The seam

bool PictureGdi::selectClipRgn(DcHandle dc, RegionHandle region) {
  if (picture_ != nullptr) picture_->clip(dc, region);
  return Win32Gdi::selectClipRgn(dc, region);
}

bool PictureGdi::fillRect(DcHandle dc, Rect rect, BrushHandle brush) {
  if (picture_ == nullptr) return Win32Gdi::fillRect(dc, rect, brush);
  picture_->takeOver(dc);  // a hatched brush leaves gaps in the background's colour
  const RECT area = picture_->at(dc, rect);
  return FillRect(picture_->target_.dc, &area, native(brush)) != 0;
}

bool PictureGdi::moveTo(DcHandle dc, Point to) {
  if (picture_ == nullptr) return Win32Gdi::moveTo(dc, to);
  const POINT at = picture_->at(dc, to);
  return MoveToEx(picture_->target_.dc, at.x, at.y, nullptr) != 0;
}

bool PictureGdi::lineTo(DcHandle dc, Point to) {
  if (picture_ == nullptr) return Win32Gdi::lineTo(dc, to);
  picture_->takeOver(dc);
  const POINT at = picture_->at(dc, to);
  return LineTo(picture_->target_.dc, at.x, at.y) != 0;
}

bool PictureGdi::polyline(DcHandle dc, std::span<const Point> points) {
  if (picture_ == nullptr) return Win32Gdi::polyline(dc, points);
  picture_->takeOver(dc);
  return drawn([&] { return picture_->polyline(dc, points); });
}

bool PictureGdi::drawEdge(DcHandle dc, Rect rect, std::uint32_t edge, std::uint32_t sides) {
  if (picture_ == nullptr) return Win32Gdi::drawEdge(dc, rect, edge, sides);
  picture_->edge(dc, rect, edge);
  return true;
}

bool PictureGdi::textOut(DcHandle dc, Point topLeft, std::string_view text) {
  if (picture_ == nullptr) return Win32Gdi::textOut(dc, topLeft, text);
  picture_->takeOver(dc);
  return drawn([&] { return picture_->textOut(dc, topLeft, text); });
}

// The surface is nowhere but in the picture already.
bool PictureGdi::bitBlt(DcHandle to, Rect destination, DcHandle from, Point source, RasterOp operation) {
  if (picture_ == nullptr) return Win32Gdi::bitBlt(to, destination, from, source, operation);
  return true;
}

}  // namespace frontpanels

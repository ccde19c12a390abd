#include "platform/win32/picture_gdi.h"

#include <algorithm>
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

// 16-bit metafiles have 16 bits; of others' 32 the systems before the current ones used 27.
double farthestOf(HDC dc) { return GetObjectType(dc) == OBJ_METADC ? 32767.0 : 134217727.0; }

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
    : gdi_(gdi),
      outer_(gdi.picture_),
      target_(target),
      saved_(SaveDC(target.dc)),
      farthest_(farthestOf(target.dc)) {
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
  for (HGDIOBJ const object : made_) DeleteObject(object);
}

LONG PictureGdi::Picture::Axis::edgeOf(std::int32_t px) const {
  return within(std::floor(first + 0.5 + static_cast<double>(px) * length / viewPx));
}

// At the view's own scale it is the pixel itself.
LONG PictureGdi::Picture::Axis::middleOf(std::int32_t px) const {
  return within(std::floor(first + (px + 0.5) * length / viewPx));
}

LONG PictureGdi::Picture::Axis::within(double coordinate) const {
  return static_cast<LONG>(std::clamp(coordinate, -farthest, farthest));
}

PictureGdi::Picture::Axis PictureGdi::Picture::across() const {
  return {target_.bounds.left, target_.bounds.right - target_.bounds.left, target_.viewPx.width, farthest_};
}

PictureGdi::Picture::Axis PictureGdi::Picture::down() const {
  return {target_.bounds.top, target_.bounds.bottom - target_.bounds.top, target_.viewPx.height, farthest_};
}

POINT PictureGdi::Picture::at(DcHandle dc, Point point) const {
  const Point origin = dc == target_.surface ? target_.surfaceOriginPx : Point{};
  return {across().middleOf(point.x + origin.x), down().middleOf(point.y + origin.y)};
}

RECT PictureGdi::Picture::at(DcHandle dc, Rect rect) const {
  const Point origin = dc == target_.surface ? target_.surfaceOriginPx : Point{};
  return {across().edgeOf(rect.left + origin.x), down().edgeOf(rect.top + origin.y),
          across().edgeOf(rect.right + origin.x), down().edgeOf(rect.bottom + origin.y)};
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
  select(made);
}

void PictureGdi::Picture::takeFont(const LOGFONTW& font) {
  LOGFONTW wanted = font;
  // A height of 0 would stand for the usual one.
  const int height = std::max(length(static_cast<int>(std::abs(font.lfHeight))), 1);
  wanted.lfHeight = font.lfHeight < 0 ? -height : height;
  select(CreateFontIndirectW(&wanted));
}

// Without room to remember it the object before stays.
void PictureGdi::Picture::select(HGDIOBJ made) {
  if (made == nullptr) return;
  if (!drawn([&] { return made_.push_back(made), true; })) {
    DeleteObject(made);
    return;
  }
  SelectObject(target_.dc, made);
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
  if (Picture* const picture = pictureOf(dc)) picture->clip(dc, region);
  return Win32Gdi::selectClipRgn(dc, region);
}

bool PictureGdi::fillRect(DcHandle dc, Rect rect, BrushHandle brush) {
  Picture* const picture = pictureOf(dc);
  if (picture == nullptr) return Win32Gdi::fillRect(dc, rect, brush);
  picture->takeOver(dc);  // a hatched brush leaves gaps in the background's colour
  const RECT area = picture->at(dc, rect);
  return FillRect(picture->target_.dc, &area, native(brush)) != 0;
}

bool PictureGdi::moveTo(DcHandle dc, Point to) {
  Picture* const picture = pictureOf(dc);
  if (picture == nullptr) return Win32Gdi::moveTo(dc, to);
  const POINT at = picture->at(dc, to);
  return MoveToEx(picture->target_.dc, at.x, at.y, nullptr) != 0;
}

bool PictureGdi::lineTo(DcHandle dc, Point to) {
  Picture* const picture = pictureOf(dc);
  if (picture == nullptr) return Win32Gdi::lineTo(dc, to);
  picture->takeOver(dc);
  const POINT at = picture->at(dc, to);
  return LineTo(picture->target_.dc, at.x, at.y) != 0;
}

bool PictureGdi::polyline(DcHandle dc, std::span<const Point> points) {
  Picture* const picture = pictureOf(dc);
  if (picture == nullptr) return Win32Gdi::polyline(dc, points);
  picture->takeOver(dc);
  return drawn([&] { return picture->polyline(dc, points); });
}

bool PictureGdi::drawEdge(DcHandle dc, Rect rect, std::uint32_t edge, std::uint32_t sides) {
  Picture* const picture = pictureOf(dc);
  if (picture == nullptr) return Win32Gdi::drawEdge(dc, rect, edge, sides);
  picture->edge(dc, rect, edge);
  return true;
}

bool PictureGdi::textOut(DcHandle dc, Point topLeft, std::string_view text) {
  Picture* const picture = pictureOf(dc);
  if (picture == nullptr) return Win32Gdi::textOut(dc, topLeft, text);
  picture->takeOver(dc);
  return drawn([&] { return picture->textOut(dc, topLeft, text); });
}

// The surface is nowhere but in the picture already.
bool PictureGdi::bitBlt(DcHandle to, Rect destination, DcHandle from, Point source, RasterOp operation) {
  if (pictureOf(to) == nullptr) return Win32Gdi::bitBlt(to, destination, from, source, operation);
  return true;
}

}  // namespace frontpanels

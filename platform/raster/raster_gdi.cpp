// Objects and the state of device contexts; the drawing is in raster_drawing.cpp.
#include "platform/raster/raster_gdi.h"

#include <algorithm>
#include <new>
#include <utility>

namespace frontpanels {
namespace {

constexpr std::int32_t kMaxSidePx = 32767;
constexpr std::int32_t kMaxPenWidthPx = 1024;
constexpr Color kInvalidColor{0xFFFFFFFF};

constexpr std::pair<SystemColor, Color> kDefaultSystemColors[] = {
    {SystemColor::Window, rgb(255, 255, 255)},       {SystemColor::WindowText, rgb(0, 0, 0)},
    {SystemColor::Highlight, rgb(0, 120, 215)},      {SystemColor::ButtonFace, rgb(240, 240, 240)},
    {SystemColor::ButtonShadow, rgb(160, 160, 160)}, {SystemColor::GrayText, rgb(109, 109, 109)},
    {SystemColor::ButtonText, rgb(0, 0, 0)},         {SystemColor::ButtonHighlight, rgb(255, 255, 255)},
    {SystemColor::DarkShadow3d, rgb(105, 105, 105)}, {SystemColor::Light3d, rgb(227, 227, 227)},
};

constexpr std::pair<StockBrush, Color> kStockBrushes[] = {
    {StockBrush::White, rgb(255, 255, 255)}, {StockBrush::LightGray, rgb(192, 192, 192)},
    {StockBrush::Gray, rgb(128, 128, 128)},  {StockBrush::DarkGray, rgb(64, 64, 64)},
    {StockBrush::Black, rgb(0, 0, 0)},       {StockBrush::Null, rgb(0, 0, 0)},
};

constexpr std::pair<StockPen, Color> kStockPens[] = {
    {StockPen::White, rgb(255, 255, 255)}, {StockPen::Black, rgb(0, 0, 0)}, {StockPen::Null, rgb(0, 0, 0)}};

// Where 1024-pixel steps between rows would put a column's pixels into the same few lines of the processor's
// cache.
std::ptrdiff_t strideOf(std::int32_t width) {
  const std::ptrdiff_t stride = (width + 15) / 16 * 16;
  return stride % 256 == 0 ? stride + 16 : stride;
}

template <class Key, class Value>
Value valueOr(const std::map<Key, Value>& map, Key key, Value fallback) {
  const auto found = map.find(key);
  return found == map.end() ? fallback : found->second;
}

}  // namespace

Bitmap Bitmap::create(Size sizePx) noexcept {
  Bitmap bitmap;
  if (sizePx.width < 1 || sizePx.height < 1 || sizePx.width > kMaxSidePx || sizePx.height > kMaxSidePx)
    return bitmap;
  bitmap.stride = strideOf(sizePx.width);
  bitmap.storage.reset(new (std::nothrow)
                           std::uint32_t[static_cast<std::size_t>(bitmap.stride) * sizePx.height]());
  bitmap.sizePx = sizePx;
  return bitmap;
}

RasterGdi::RasterGdi() {
  for (const auto& [pen, color] : kStockPens) {
    stockPens_[pen] = pens_.add({.pixel = pixelOf(color), .null = pen == StockPen::Null, .stock = true});
  }
  for (const auto& [brush, color] : kStockBrushes) {
    stockBrushes_[brush] =
        brushes_.add({.pixel = pixelOf(color), .null = brush == StockBrush::Null, .stock = true});
  }
  for (const auto& [name, color] : kDefaultSystemColors) {
    systemColors_[name] = color;
    systemBrushes_[name] = brushes_.add({.pixel = pixelOf(color), .stock = true});
  }
  stockFont_ = fonts_.add({.stock = true});
  stockBitmap_ = bitmaps_.add(Bitmap::create({1, 1}));
  stockObjects_ = pens_.live() + brushes_.live() + fonts_.live() + bitmaps_.live();
}

DcHandle RasterGdi::createScreen(Size sizePx) {
  const BitmapHandle bitmap = createCompatibleBitmap({}, sizePx);
  if (!bitmap) return {};
  const DcHandle screen = newDc(bitmap, true);
  if (screen) {
    ++screens_;
  } else {
    bitmaps_.remove(bitmap);
  }
  return screen;
}

bool RasterGdi::resizeScreen(DcHandle screen, Size sizePx) {
  Dc* dc = dcs_.find(screen);
  if (dc == nullptr || !dc->screen) return false;
  Bitmap fresh = Bitmap::create(sizePx);
  if (fresh.storage == nullptr) return false;
  fresh.selections = 1;
  Bitmap& bitmap = *bitmaps_.find(dc->bitmap);
  bitmap = std::move(fresh);
  attach(*dc, bitmap);
  return true;
}

PixelView RasterGdi::pixels(DcHandle dc) {
  const Dc* state = dcs_.find(dc);
  if (state == nullptr) return {};
  return {state->rows.first, state->rows.stride, {state->bounds.width(), state->bounds.height()}};
}

void RasterGdi::setSysColor(SystemColor color, Color value) {
  const auto found = systemBrushes_.find(color);
  if (found == systemBrushes_.end()) return;
  systemColors_[color] = value;
  brushes_.find(found->second)->pixel = pixelOf(value);
}

std::size_t RasterGdi::liveObjects() const {
  return pens_.live() + brushes_.live() + fonts_.live() + bitmaps_.live() + regions_.live() - stockObjects_ -
         screens_;
}
std::size_t RasterGdi::liveDcs() const { return dcs_.live() - screens_; }

DcHandle RasterGdi::newDc(BitmapHandle bitmap, bool screen) {
  const DcHandle handle = dcs_.add({.bitmap = bitmap,
                                    .pen = stockPens_[StockPen::Black],
                                    .brush = stockBrushes_[StockBrush::White],
                                    .font = stockFont_,
                                    .screen = screen});
  Dc* dc = dcs_.find(handle);
  if (dc == nullptr) return {};
  dc->penNow = *pens_.find(dc->pen);
  Bitmap* pixels = bitmaps_.find(bitmap);
  ++pixels->selections;
  attach(*dc, *pixels);
  return handle;
}

void RasterGdi::attach(Dc& dc, const Bitmap& bitmap) {
  dc.rows = bitmap.rows();
  dc.bounds = bitmap.bounds();
  updateClip(dc);
}

void RasterGdi::updateClip(Dc& dc) { dc.clip = dc.region ? intersection(dc.bounds, *dc.region) : dc.bounds; }

DcHandle RasterGdi::createCompatibleDC(DcHandle dc) {
  if (dc && dcs_.find(dc) == nullptr) return {};
  return newDc(stockBitmap_, false);
}

bool RasterGdi::deleteDC(DcHandle dc) {
  Dc* state = dcs_.find(dc);
  if (state == nullptr) return false;
  --bitmaps_.find(state->bitmap)->selections;
  if (Pen* pen = pens_.find(state->pen); !pen->stock) --pen->selections;
  if (Brush* brush = brushes_.find(state->brush); !brush->stock) --brush->selections;
  if (FontObject* font = fonts_.find(state->font); !font->stock) --font->selections;
  if (state->screen) {
    bitmaps_.remove(state->bitmap);
    --screens_;
  }
  return dcs_.remove(dc);
}

BitmapHandle RasterGdi::createCompatibleBitmap(DcHandle dc, Size sizePx) {
  if (dc && dcs_.find(dc) == nullptr) return {};
  // A side of nothing gives one pixel, as the graphics interface has it.
  if (sizePx.width == 0 || sizePx.height == 0) sizePx = {1, 1};
  Bitmap bitmap = Bitmap::create(sizePx);
  if (bitmap.storage == nullptr) return {};
  return bitmaps_.add(std::move(bitmap));
}

PenHandle RasterGdi::createPen(PenStyle style, std::int32_t widthPx, Color color) {
  // Width 0 means one pixel, a negative width its size; only one-pixel pens have dashes.
  const std::int64_t width = std::clamp<std::int64_t>(std::abs(std::int64_t{widthPx}), 1, kMaxPenWidthPx);
  return pens_.add({.style = width > 1 ? PenStyle::Solid : style,
                    .widthPx = static_cast<std::int32_t>(width),
                    .pixel = pixelOf(color)});
}
BrushHandle RasterGdi::createSolidBrush(Color color) { return brushes_.add({.pixel = pixelOf(color)}); }
BrushHandle RasterGdi::createHatchBrush(HatchStyle style, Color color) {
  if (style < HatchStyle::Horizontal || style > HatchStyle::DiagonalCross) return {};
  return brushes_.add({.pixel = pixelOf(color), .hatch = style});
}
FontHandle RasterGdi::createFont(const FontSpec& font) {
  Font* loaded = fontCache_.find(font);
  return loaded == nullptr ? FontHandle{} : fonts_.add({.font = loaded});
}
RegionHandle RasterGdi::createRectRgn(Rect rect) {
  return regions_.add({std::min(rect.left, rect.right), std::min(rect.top, rect.bottom),
                       std::max(rect.left, rect.right), std::max(rect.top, rect.bottom)});
}

template <class T, class H>
bool RasterGdi::destroy(Pool<T, H>& pool, H handle) {
  const T* object = pool.find(handle);
  return object != nullptr && !object->stock && object->selections == 0 && pool.remove(handle);
}

bool RasterGdi::deleteObject(BitmapHandle bitmap) {
  const Bitmap* object = bitmaps_.find(bitmap);
  return object != nullptr && bitmap != stockBitmap_ && object->selections == 0 && bitmaps_.remove(bitmap);
}
bool RasterGdi::deleteObject(PenHandle pen) { return destroy(pens_, pen); }
bool RasterGdi::deleteObject(BrushHandle brush) { return destroy(brushes_, brush); }
bool RasterGdi::deleteObject(FontHandle font) { return destroy(fonts_, font); }
bool RasterGdi::deleteObject(RegionHandle region) { return regions_.remove(region); }

PenHandle RasterGdi::stockPen(StockPen pen) { return valueOr(stockPens_, pen, {}); }
BrushHandle RasterGdi::stockBrush(StockBrush brush) { return valueOr(stockBrushes_, brush, {}); }
Color RasterGdi::sysColor(SystemColor color) { return valueOr(systemColors_, color, {}); }
BrushHandle RasterGdi::sysColorBrush(SystemColor color) { return valueOr(systemBrushes_, color, {}); }

BitmapHandle RasterGdi::selectObject(DcHandle dc, BitmapHandle bitmap) {
  Dc* state = dcs_.find(dc);
  Bitmap* fresh = bitmaps_.find(bitmap);
  if (state == nullptr || fresh == nullptr || state->screen) return {};
  const BitmapHandle previous = state->bitmap;
  if (bitmap == previous) return previous;
  // A bitmap lies in one device context at a time; only the stock one may lie in many.
  if (fresh->selections > 0 && bitmap != stockBitmap_) return {};
  --bitmaps_.find(previous)->selections;
  ++fresh->selections;
  state->bitmap = bitmap;
  attach(*state, *fresh);
  return previous;
}

template <class T, class H>
H RasterGdi::exchangeSelected(Pool<T, H>& pool, DcHandle dc, H Dc::*slot, H handle) {
  Dc* state = dcs_.find(dc);
  T* fresh = pool.find(handle);
  if (state == nullptr || fresh == nullptr) return {};
  const H previous = std::exchange(state->*slot, handle);
  if (T* old = pool.find(previous); !old->stock) --old->selections;
  if (!fresh->stock) ++fresh->selections;
  return previous;
}

PenHandle RasterGdi::selectObject(DcHandle dc, PenHandle pen) {
  const PenHandle previous = exchangeSelected(pens_, dc, &Dc::pen, pen);
  if (previous) dcs_.find(dc)->penNow = *pens_.find(pen);
  return previous;
}
BrushHandle RasterGdi::selectObject(DcHandle dc, BrushHandle brush) {
  return exchangeSelected(brushes_, dc, &Dc::brush, brush);
}
FontHandle RasterGdi::selectObject(DcHandle dc, FontHandle font) {
  return exchangeSelected(fonts_, dc, &Dc::font, font);
}

bool RasterGdi::selectClipRgn(DcHandle dc, RegionHandle region) {
  Dc* state = dcs_.find(dc);
  const Rect* rect = regions_.find(region);
  if (state == nullptr || (region && rect == nullptr)) return false;
  state->region = rect == nullptr ? std::nullopt : std::optional(*rect);
  updateClip(*state);
  return true;
}

Color RasterGdi::setTextColor(DcHandle dc, Color color) {
  Dc* state = dcs_.find(dc);
  return state == nullptr ? kInvalidColor : std::exchange(state->textColor, color);
}
Color RasterGdi::setBkColor(DcHandle dc, Color color) {
  Dc* state = dcs_.find(dc);
  return state == nullptr ? kInvalidColor : std::exchange(state->bkColor, color);
}
BackgroundMode RasterGdi::setBkMode(DcHandle dc, BackgroundMode mode) {
  Dc* state = dcs_.find(dc);
  return state == nullptr ? BackgroundMode{} : std::exchange(state->mode, mode);
}
DrawMode RasterGdi::setRop2(DcHandle dc, DrawMode mode) {
  Dc* state = dcs_.find(dc);
  return state == nullptr ? DrawMode{} : std::exchange(state->rop, mode);
}

}  // namespace frontpanels

#include "tests/support/recording_gdi.h"

#include <algorithm>
#include <array>
#include <utility>

namespace frontpanels {

std::ostream& operator<<(std::ostream& out, Point p) { return out << '(' << p.x << ", " << p.y << ')'; }
std::ostream& operator<<(std::ostream& out, Size s) { return out << s.width << " x " << s.height; }
std::ostream& operator<<(std::ostream& out, const Rect& r) {
  return out << '[' << r.left << ", " << r.top << ", " << r.right << ", " << r.bottom << ')';
}
std::ostream& operator<<(std::ostream& out, Color c) {
  return out << "rgb(" << int{c.red()} << ", " << int{c.green()} << ", " << int{c.blue()} << ')';
}
std::ostream& operator<<(std::ostream& out, const FontSpec& font) {
  return out << '\'' << font.face << "' " << font.emHeightPx << " px, weight " << font.weight
             << (font.italic ? ", italic" : "");
}

namespace testing {
namespace {

constexpr std::int32_t kLetterWidthPx = 8;
constexpr std::int32_t kLetterHeightPx = 12;
constexpr std::uintptr_t kStockPenBase = 100;
constexpr std::uintptr_t kStockBrushBase = 200;
constexpr std::uintptr_t kSystemBrushBase = 300;

constexpr std::array<std::pair<SystemColor, Color>, 10> kSystemColors{{
    {SystemColor::Window, rgb(255, 255, 255)},
    {SystemColor::WindowText, rgb(0, 0, 0)},
    {SystemColor::Highlight, rgb(0, 120, 215)},
    {SystemColor::ButtonFace, rgb(240, 240, 240)},
    {SystemColor::ButtonShadow, rgb(160, 160, 160)},
    {SystemColor::GrayText, rgb(109, 109, 109)},
    {SystemColor::ButtonText, rgb(0, 0, 0)},
    {SystemColor::ButtonHighlight, rgb(255, 255, 255)},
    {SystemColor::DarkShadow3d, rgb(105, 105, 105)},
    {SystemColor::Light3d, rgb(227, 227, 227)},
}};

constexpr std::array<std::pair<StockBrush, BrushValue>, 6> kStockBrushes{{
    {StockBrush::White, {rgb(255, 255, 255)}},
    {StockBrush::LightGray, {rgb(192, 192, 192)}},
    {StockBrush::Gray, {rgb(128, 128, 128)}},
    {StockBrush::DarkGray, {rgb(64, 64, 64)}},
    {StockBrush::Black, {rgb(0, 0, 0)}},
    {StockBrush::Null, {{}, std::nullopt, true}},
}};

std::int32_t codePoints(std::string_view utf8) {
  return static_cast<std::int32_t>(std::count_if(
      utf8.begin(), utf8.end(), [](char c) { return (static_cast<unsigned char>(c) & 0xC0) != 0x80; }));
}

template <class Value, class Make>
std::vector<Value> collect(const std::vector<Call>& calls, std::string_view name, Make make) {
  std::vector<Value> values;
  for (const Call& call : calls) {
    if (call.name == name && !call.failed) values.push_back(make(call));
  }
  return values;
}

void print(std::ostream& out, const std::vector<Point>& points) {
  for (std::size_t i = 0; i < points.size(); ++i) out << (i == 0 ? "" : " ") << points[i];
}

void print(std::ostream& out, const std::optional<Rect>& clip) {
  if (clip) out << " clipped to " << *clip;
}

}  // namespace

std::ostream& operator<<(std::ostream& out, const PenValue& pen) {
  if (pen.null) return out << "null pen";
  return out << "pen style " << static_cast<int>(pen.style) << " width " << pen.widthPx << ' ' << pen.color;
}

std::ostream& operator<<(std::ostream& out, const BrushValue& brush) {
  if (brush.null) return out << "null brush";
  out << "brush " << brush.color;
  if (brush.hatch) out << " hatch " << static_cast<int>(*brush.hatch);
  return out;
}

std::ostream& operator<<(std::ostream& out, const Call& call) {
  out << call.name << " dc " << call.dc;
  if (call.object != 0) out << " object #" << call.object;
  if (!call.points.empty()) print(out << ' ', call.points);
  if (call.rect != Rect{}) out << ' ' << call.rect;
  if (!call.text.empty()) out << " \"" << call.text << '"';
  return out << (call.failed ? " FAILED" : "");
}

std::ostream& operator<<(std::ostream& out, const PolylineValue& value) {
  print(out << "polyline dc " << value.dc << ' ', value.points);
  print(out << " with " << value.pen, value.clip);
  return out;
}
std::ostream& operator<<(std::ostream& out, const LineValue& value) {
  return out << "line " << value.from << " to " << value.to << " with " << value.pen;
}
std::ostream& operator<<(std::ostream& out, const TextValue& value) {
  return out << "text \"" << value.text << "\" at " << value.topLeft << ' ' << value.color
             << (value.mode == BackgroundMode::Opaque ? " opaque " : " transparent ") << value.font;
}
std::ostream& operator<<(std::ostream& out, const FillValue& value) {
  return out << "fill dc " << value.dc << ' ' << value.rect << " with " << value.brush;
}
std::ostream& operator<<(std::ostream& out, const EdgeValue& value) {
  return out << "edge dc " << value.dc << ' ' << value.rect << " edge " << value.edge << " sides "
             << value.sides;
}
std::ostream& operator<<(std::ostream& out, const BlitValue& value) {
  return out << "blit " << value.from << ' ' << value.source << " to " << value.to << ' '
             << value.destination;
}

RecordingGdi::RecordingGdi() {
  const auto stockPen = [this](StockPen pen, PenValue value) {
    stock_[kStockPenBase + static_cast<std::uintptr_t>(pen)] = {.kind = Kind::Pen, .pen = value};
  };
  stockPen(StockPen::White, {PenStyle::Solid, 1, rgb(255, 255, 255)});
  stockPen(StockPen::Black, {PenStyle::Solid, 1, rgb(0, 0, 0)});
  stockPen(StockPen::Null, {PenStyle::Solid, 1, {}, true});
  for (const auto& [brush, value] : kStockBrushes) {
    stock_[kStockBrushBase + static_cast<std::uintptr_t>(brush)] = {.kind = Kind::Brush, .brush = value};
  }
  for (const auto& [color, value] : kSystemColors) {
    stock_[kSystemBrushBase + static_cast<std::uintptr_t>(color)] = {.kind = Kind::Brush, .brush = {value}};
  }
  stockFont_ = addStock({.kind = Kind::Font, .font = {"System", 16, 700, false}});
  stockBitmap_ = addStock({.kind = Kind::Bitmap, .rect = {0, 0, 1, 1}});
  viewDc_ = createCompatibleDC({});
  clear();
}

std::vector<PolylineValue> RecordingGdi::polylines() const {
  return collect<PolylineValue>(calls_, "polyline", [](const Call& c) {
    return PolylineValue{c.dc, c.points, c.pen, c.clip};
  });
}
std::vector<LineValue> RecordingGdi::lines() const {
  return collect<LineValue>(calls_, "lineTo", [](const Call& c) {
    return LineValue{c.points[0], c.points[1], c.pen};
  });
}
std::vector<TextValue> RecordingGdi::texts() const {
  return collect<TextValue>(calls_, "textOut", [](const Call& c) {
    return TextValue{c.points[0], c.text, c.textColor, c.backgroundMode, c.font};
  });
}
std::vector<FillValue> RecordingGdi::fills() const {
  return collect<FillValue>(calls_, "fillRect", [](const Call& c) {
    return FillValue{c.dc, c.rect, c.brush};
  });
}
std::vector<EdgeValue> RecordingGdi::edges() const {
  return collect<EdgeValue>(calls_, "drawEdge", [](const Call& c) {
    return EdgeValue{c.dc, c.rect, c.edge, c.sides};
  });
}
std::vector<BlitValue> RecordingGdi::blits() const {
  return collect<BlitValue>(calls_, "bitBlt", [](const Call& c) {
    return BlitValue{c.dc, c.rect, c.from, c.points[0]};
  });
}

std::vector<std::string> RecordingGdi::drawingOrder() const {
  static const std::set<std::string, std::less<>> drawing{"fillRect", "lineTo",  "polyline",
                                                          "drawEdge", "textOut", "bitBlt"};
  std::vector<std::string> names;
  for (const Call& call : calls_) {
    if (drawing.contains(call.name) && !call.failed) names.push_back(call.name);
  }
  return names;
}

std::vector<Call> RecordingGdi::callsOf(std::string_view name) const {
  std::vector<Call> matching;
  std::copy_if(calls_.begin(), calls_.end(), std::back_inserter(matching),
               [name](const Call& call) { return call.name == name; });
  return matching;
}

void RecordingGdi::clear() {
  calls_.clear();
  violations_.clear();
}

int RecordingGdi::liveDcs() const { return static_cast<int>(dcs_.size()) - 1; }

PenValue RecordingGdi::pen(DcHandle dc) const {
  const Dc* state = findDc(dc);
  const Object* object = state == nullptr ? nullptr : find(state->pen, Kind::Pen);
  return object == nullptr ? PenValue{} : object->pen;
}
BrushValue RecordingGdi::brush(DcHandle dc) const {
  const Dc* state = findDc(dc);
  const Object* object = state == nullptr ? nullptr : find(state->brush, Kind::Brush);
  return object == nullptr ? BrushValue{} : object->brush;
}
FontSpec RecordingGdi::font(DcHandle dc) const {
  const Dc* state = findDc(dc);
  const Object* object = state == nullptr ? nullptr : find(state->font, Kind::Font);
  return object == nullptr ? FontSpec{} : object->font;
}
std::optional<Rect> RecordingGdi::clip(DcHandle dc) const {
  const Dc* state = findDc(dc);
  return state == nullptr ? std::nullopt : state->clip;
}
Size RecordingGdi::bitmapSize(DcHandle dc) const {
  const Dc* state = findDc(dc);
  const Object* object = state == nullptr ? nullptr : find(state->bitmap, Kind::Bitmap);
  return object == nullptr ? Size{} : Size{object->rect.right, object->rect.bottom};
}

void RecordingGdi::failNth(std::string_view name, int n) { failAt_[std::string(name)] = n; }
void RecordingGdi::failAlways(std::string_view name) { failAlways_.emplace(name); }
void RecordingGdi::failNthCall(int n) { failAnyAt_ = n; }
std::vector<int> RecordingGdi::callsThatMayFail() const {
  std::vector<int> places;
  for (std::size_t i = 0; i < calls_.size(); ++i)
    if (!calls_[i].name.starts_with("delete")) places.push_back(static_cast<int>(i) + 1);
  return places;
}

void RecordingGdi::failNothing() {
  failAt_.clear();
  failAlways_.clear();
  failAnyAt_ = 0;
}

DcHandle RecordingGdi::createCompatibleDC(DcHandle dc) {
  if (!begin("createCompatibleDC", dc)) return {};
  if (dc && findDc(dc) == nullptr)
    return violate("createCompatibleDC of an unknown device context"), DcHandle{};
  const DcHandle created{nextHandle_++};
  dcs_[created.value] = {.bitmap = stockBitmap_,
                         .pen = kStockPenBase + static_cast<std::uintptr_t>(StockPen::Black),
                         .brush = kStockBrushBase + static_cast<std::uintptr_t>(StockBrush::White),
                         .font = stockFont_};
  calls_.back().object = created.value;
  return created;
}

bool RecordingGdi::deleteDC(DcHandle dc) {
  if (!begin("deleteDC", dc)) return false;
  const auto found = dcs_.find(dc.value);
  if (found == dcs_.end() || dc == viewDc_) return violate("deleteDC of what is no memory device context");
  const Dc gone = found->second;
  dcs_.erase(found);
  for (const Slot slot : {&Dc::bitmap, &Dc::pen, &Dc::brush, &Dc::font}) {
    if (objects_.contains(gone.*slot) && !gone.selectFailed) {
      violate("deleteDC while a created object was selected");
    }
    buryIfUnselected(gone.*slot, slot);
  }
  return true;
}

BitmapHandle RecordingGdi::createCompatibleBitmap(DcHandle dc, Size sizePx) {
  // The graphics interface answers a 1 x 1 bitmap for a size of 0 and fails for a negative one.
  const bool degenerate = sizePx.width == 0 || sizePx.height == 0;
  const Rect area{0, 0, degenerate ? 1 : sizePx.width, degenerate ? 1 : sizePx.height};
  if (area.empty()) return begin("createCompatibleBitmap", dc), BitmapHandle{};
  return {createObject("createCompatibleBitmap", dc, {.kind = Kind::Bitmap, .rect = area})};
}

PenHandle RecordingGdi::createPen(PenStyle style, std::int32_t widthPx, Color color) {
  return {createObject("createPen", {}, {.kind = Kind::Pen, .pen = {style, widthPx, color}})};
}
BrushHandle RecordingGdi::createSolidBrush(Color color) {
  return {createObject("createSolidBrush", {}, {.kind = Kind::Brush, .brush = {color}})};
}
BrushHandle RecordingGdi::createHatchBrush(HatchStyle style, Color color) {
  return {createObject("createHatchBrush", {}, {.kind = Kind::Brush, .brush = {color, style}})};
}
FontHandle RecordingGdi::createFont(const FontSpec& font) {
  return {createObject("createFont", {}, {.kind = Kind::Font, .font = font})};
}
RegionHandle RecordingGdi::createRectRgn(Rect rect) {
  return {createObject("createRectRgn", {}, {.kind = Kind::Region, .rect = rect})};
}

PenHandle RecordingGdi::stockPen(StockPen pen) {
  if (!begin("stockPen", {})) return {};
  return {kStockPenBase + static_cast<std::uintptr_t>(pen)};
}
BrushHandle RecordingGdi::stockBrush(StockBrush brush) {
  if (!begin("stockBrush", {})) return {};
  return {kStockBrushBase + static_cast<std::uintptr_t>(brush)};
}
Color RecordingGdi::sysColor(SystemColor color) {
  if (!begin("sysColor", {})) return {};
  const auto* found = std::find_if(kSystemColors.begin(), kSystemColors.end(),
                                   [color](const auto& entry) { return entry.first == color; });
  return found == kSystemColors.end() ? Color{} : found->second;
}
BrushHandle RecordingGdi::sysColorBrush(SystemColor color) {
  if (!begin("sysColorBrush", {})) return {};
  return {kSystemBrushBase + static_cast<std::uintptr_t>(color)};
}

BitmapHandle RecordingGdi::selectObject(DcHandle dc, BitmapHandle bitmap) {
  return {select(dc, bitmap.value, &Dc::bitmap, Kind::Bitmap)};
}
PenHandle RecordingGdi::selectObject(DcHandle dc, PenHandle pen) {
  return {select(dc, pen.value, &Dc::pen, Kind::Pen)};
}
BrushHandle RecordingGdi::selectObject(DcHandle dc, BrushHandle brush) {
  return {select(dc, brush.value, &Dc::brush, Kind::Brush)};
}
FontHandle RecordingGdi::selectObject(DcHandle dc, FontHandle font) {
  return {select(dc, font.value, &Dc::font, Kind::Font)};
}

bool RecordingGdi::selectClipRgn(DcHandle dc, RegionHandle region) {
  if (!beginDrawing("selectClipRgn", dc)) return false;
  calls_.back().object = region.value;
  const Object* object = find(region.value, Kind::Region);
  if (region && object == nullptr) return violate("selectClipRgn of an unknown region");
  dcs_[dc.value].clip = object == nullptr ? std::nullopt : std::optional(object->rect);
  if (object != nullptr) calls_.back().rect = object->rect;
  return true;
}

// What the graphics interface answers for a device context that it does not know: CLR_INVALID, or zero.
Color RecordingGdi::setTextColor(DcHandle dc, Color color) {
  return exchange("setTextColor", dc, &Dc::textColor, color, Color{0xFFFFFFFF});
}
Color RecordingGdi::setBkColor(DcHandle dc, Color color) {
  return exchange("setBkColor", dc, &Dc::bkColor, color, Color{0xFFFFFFFF});
}
BackgroundMode RecordingGdi::setBkMode(DcHandle dc, BackgroundMode mode) {
  return exchange("setBkMode", dc, &Dc::mode, mode, BackgroundMode{});
}
DrawMode RecordingGdi::setRop2(DcHandle dc, DrawMode mode) {
  return exchange("setRop2", dc, &Dc::rop, mode, DrawMode{});
}

bool RecordingGdi::fillRect(DcHandle dc, Rect rect, BrushHandle brush) {
  if (!beginDrawing("fillRect", dc)) return false;
  const Object* object = find(brush.value, Kind::Brush);
  if (object == nullptr) return violate("fillRect with an unknown brush");
  calls_.back().rect = rect;
  calls_.back().brush = object->brush;
  return true;
}

bool RecordingGdi::moveTo(DcHandle dc, Point to) {
  if (!beginDrawing("moveTo", dc)) return false;
  calls_.back().points = {to};
  dcs_[dc.value].current = to;
  return true;
}

bool RecordingGdi::lineTo(DcHandle dc, Point to) {
  if (!beginDrawing("lineTo", dc)) return false;
  calls_.back().points = {dcs_[dc.value].current, to};
  dcs_[dc.value].current = to;
  return true;
}

bool RecordingGdi::polyline(DcHandle dc, std::span<const Point> points) {
  if (!beginDrawing("polyline", dc)) return false;
  calls_.back().points.assign(points.begin(), points.end());
  calls_.back().failed = points.size() < 2;  // the graphics interface refuses a single point
  return !calls_.back().failed;
}

bool RecordingGdi::drawEdge(DcHandle dc, Rect rect, std::uint32_t edge, std::uint32_t sides) {
  if (!beginDrawing("drawEdge", dc)) return false;
  calls_.back().rect = rect;
  calls_.back().edge = edge;
  calls_.back().sides = sides;
  return true;
}

bool RecordingGdi::textOut(DcHandle dc, Point topLeft, std::string_view text) {
  if (!beginDrawing("textOut", dc)) return false;
  calls_.back().points = {topLeft};
  calls_.back().text = text;
  return true;
}

Size RecordingGdi::textExtent(DcHandle dc, std::string_view text) {
  if (!beginDrawing("textExtent", dc)) return {};
  calls_.back().text = text;
  return {codePoints(text) * kLetterWidthPx, text.empty() ? 0 : kLetterHeightPx};
}

bool RecordingGdi::bitBlt(DcHandle to, Rect destination, DcHandle from, Point source, RasterOp) {
  if (!beginDrawing("bitBlt", to)) return false;
  calls_.back().rect = destination;
  calls_.back().from = from;
  calls_.back().points = {source};
  return findDc(from) != nullptr || violate("bitBlt from an unknown device context");
}

Call& RecordingGdi::record(std::string_view name, DcHandle dc) {
  Call& call = calls_.emplace_back();
  call.name = name;
  call.dc = dc;
  const Dc* state = findDc(dc);
  if (state == nullptr) return call;
  call.pen = pen(dc);
  call.brush = brush(dc);
  call.font = font(dc);
  call.textColor = state->textColor;
  call.backgroundMode = state->mode;
  call.drawMode = state->rop;
  call.clip = state->clip;
  return call;
}

bool RecordingGdi::begin(std::string_view name, DcHandle dc) {
  Call& call = record(name, dc);
  call.failed = shouldFail(name);
  return !call.failed;
}

bool RecordingGdi::beginDrawing(std::string_view name, DcHandle dc) {
  if (!begin(name, dc)) return false;
  return findDc(dc) != nullptr || violate(std::string(name) + " on an unknown device context");
}

bool RecordingGdi::shouldFail(std::string_view name) {
  bool fail = failAlways_.contains(name);
  if (failAnyAt_ > 0 && --failAnyAt_ == 0) fail = true;
  const auto counted = failAt_.find(name);
  if (counted != failAt_.end() && --counted->second == 0) {
    failAt_.erase(counted);
    fail = true;
  }
  return fail;
}

bool RecordingGdi::violate(const std::string& what) {
  violations_.push_back(what);
  calls_.back().failed = true;
  return false;
}

const RecordingGdi::Object* RecordingGdi::find(std::uintptr_t handle, Kind kind) const {
  for (const auto* table : {&objects_, &stock_}) {
    const auto found = table->find(handle);
    if (found != table->end() && found->second.kind == kind) return &found->second;
  }
  return nullptr;
}

const RecordingGdi::Dc* RecordingGdi::findDc(DcHandle dc) const {
  const auto found = dcs_.find(dc.value);
  return found == dcs_.end() ? nullptr : &found->second;
}

bool RecordingGdi::selectedSomewhere(std::uintptr_t handle, Slot slot, bool* blameless) const {
  const auto holder =
      std::find_if(dcs_.begin(), dcs_.end(), [&](const auto& dc) { return dc.second.*slot == handle; });
  if (holder == dcs_.end()) return false;
  if (blameless != nullptr) *blameless = holder->second.selectFailed;
  return true;
}

std::uintptr_t RecordingGdi::add(Object object) {
  const std::uintptr_t handle = nextHandle_++;
  objects_.emplace(handle, std::move(object));
  return handle;
}

std::uintptr_t RecordingGdi::addStock(Object object) {
  const std::uintptr_t handle = nextHandle_++;
  stock_.emplace(handle, std::move(object));
  return handle;
}

std::uintptr_t RecordingGdi::createObject(std::string_view name, DcHandle dc, Object object) {
  if (!begin(name, dc)) return 0;
  if (dc && findDc(dc) == nullptr) return violate(std::string(name) + " for an unknown device context"), 0;
  Call& call = calls_.back();
  if (object.kind == Kind::Pen) call.pen = object.pen;
  if (object.kind == Kind::Brush) call.brush = object.brush;
  if (object.kind == Kind::Font) call.font = object.font;
  call.rect = object.rect;
  call.object = add(std::move(object));
  return call.object;
}

// The graphics interface lets a deleted pen, brush or font live until it is selected out.
void RecordingGdi::buryIfUnselected(std::uintptr_t handle, Slot slot) {
  const auto found = objects_.find(handle);
  if (found == objects_.end() || !found->second.deletedWhileSelected) return;
  if (!selectedSomewhere(handle, slot, nullptr)) objects_.erase(found);
}

std::uintptr_t RecordingGdi::select(DcHandle dc, std::uintptr_t handle, Slot slot, Kind kind) {
  if (!begin("selectObject", dc)) {
    if (findDc(dc) != nullptr) dcs_[dc.value].selectFailed = true;
    return 0;
  }
  calls_.back().object = handle;
  if (findDc(dc) == nullptr) return violate("selectObject into an unknown device context"), 0;
  if (find(handle, kind) == nullptr) return violate("selectObject of an unknown object"), 0;
  Dc& state = dcs_[dc.value];
  const bool alreadyHere = state.*slot == handle;
  if (kind == Kind::Bitmap && !alreadyHere && objects_.contains(handle) &&
      selectedSomewhere(handle, slot, nullptr)) {
    return violate("selectObject of a bitmap that another device context holds"), 0;
  }
  const std::uintptr_t previous = std::exchange(state.*slot, handle);
  buryIfUnselected(previous, slot);
  return previous;
}

bool RecordingGdi::destroy(std::uintptr_t handle, Slot slot, const char* kind) {
  if (!begin("deleteObject", {})) return false;
  calls_.back().object = handle;
  const auto found = objects_.find(handle);
  if (found == objects_.end() || found->second.deletedWhileSelected) {
    return violate(std::string("deleteObject of a ") + kind + " that is unknown or not one's own");
  }
  bool blameless = false;
  if (slot == nullptr || !selectedSomewhere(handle, slot, &blameless)) return objects_.erase(handle), true;
  if (!blameless) violate(std::string("deleteObject of a ") + kind + " that is selected");
  if (slot == &Dc::bitmap) return false;
  found->second.deletedWhileSelected = true;
  return true;
}

template <class T>
T RecordingGdi::exchange(std::string_view name, DcHandle dc, T Dc::*field, T value, T failure) {
  if (!beginDrawing(name, dc)) return failure;
  return std::exchange(dcs_[dc.value].*field, value);
}

}  // namespace testing
}  // namespace frontpanels

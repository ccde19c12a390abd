#include "tests/support/recording_gdi.h"

#include <algorithm>
#include <iterator>
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

namespace testing {
namespace {

Color systemColor(SystemColor color) {
  const auto n = static_cast<std::uint8_t>(color);
  return rgb(n, n, n);
}

}  // namespace

std::ostream& operator<<(std::ostream& out, const PenValue& pen) {
  return out << "pen style " << static_cast<int>(pen.style) << " width " << pen.widthPx << ' ' << pen.color;
}
std::ostream& operator<<(std::ostream& out, const EdgeValue& value) {
  return out << "edge dc " << value.dc.value << ' ' << value.rect << ' ' << value.edge << ' ' << value.sides;
}

RecordingGdi::RecordingGdi() {
  fresh_.selected = {stock("bitmap", 0, {.kind = Bitmap, .rect = {0, 0, 1, 1}}),
                     stockPen(StockPen::Black).value, stockBrush(StockBrush::White).value,
                     stock("font", 0, {.kind = Font, .font = {"System", 16, 700, false}})};
  viewDc_ = createCompatibleDC({});
  clear();
}

std::vector<EdgeValue> RecordingGdi::edges() const {
  std::vector<EdgeValue> values;
  for (const Call& c : succeeded("drawEdge")) values.push_back({c.dc, c.rect, c.edge, c.sides});
  return values;
}

std::vector<Call> RecordingGdi::succeeded(std::string_view name) const {
  std::vector<Call> matching;
  std::copy_if(calls_.begin(), calls_.end(), std::back_inserter(matching),
               [name](const Call& call) { return call.name == name && !call.failed; });
  return matching;
}

std::vector<std::string> RecordingGdi::drawingOrder() const {
  static constexpr std::array<std::string_view, 6> drawing{"fillRect", "lineTo",  "polyline",
                                                           "drawEdge", "textOut", "bitBlt"};
  std::vector<std::string> names;
  for (const Call& call : calls_) {
    if (!call.failed && std::find(drawing.begin(), drawing.end(), call.name) != drawing.end())
      names.push_back(call.name);
  }
  return names;
}

void RecordingGdi::clear() {
  calls_.clear();
  violations_.clear();
}

int RecordingGdi::liveObjects() const {
  return static_cast<int>(std::count_if(objects_.begin(), objects_.end(),
                                        [](const auto& object) { return !object.second.stock; }));
}

std::vector<int> RecordingGdi::callsThatMayFail() const {
  std::vector<int> places;
  for (std::size_t i = 0; i < calls_.size(); ++i)
    if (!calls_[i].name.starts_with("delete")) places.push_back(static_cast<int>(i) + 1);
  return places;
}

DcHandle RecordingGdi::createCompatibleDC(DcHandle dc) {
  if (begin("createCompatibleDC", dc) == nullptr) return {};
  if (dc && !dcs_.contains(dc.value)) return violate("createCompatibleDC of an unknown one"), DcHandle{};
  dcs_[nextHandle_] = fresh_;
  return {nextHandle_++};
}

bool RecordingGdi::deleteDC(DcHandle dc) {
  if (begin("deleteDC", dc) == nullptr) return false;
  if (!dcs_.contains(dc.value) || dc == viewDc_) return violate("deleteDC of what is no memory one");
  const Dc gone = dcs_[dc.value];
  dcs_.erase(dc.value);
  for (const Kind kind : {Bitmap, Pen, Brush, Font}) {
    if (!objects_[gone.selected[kind]].stock && !gone.selectFailed)
      violate("deleteDC while a created object was selected");
    buryIfUnselected(gone.selected[kind], kind);
  }
  return true;
}

BitmapHandle RecordingGdi::createCompatibleBitmap(DcHandle dc, Size sizePx) {
  // The graphics interface answers a 1 x 1 bitmap for a size of 0 and fails for a negative one.
  const bool degenerate = sizePx.width == 0 || sizePx.height == 0;
  const Rect area{0, 0, degenerate ? 1 : sizePx.width, degenerate ? 1 : sizePx.height};
  if (area.empty()) return begin("createCompatibleBitmap", dc), BitmapHandle{};
  return {create("createCompatibleBitmap", {.kind = Bitmap, .rect = area})};
}

PenHandle RecordingGdi::createPen(PenStyle style, std::int32_t widthPx, Color color) {
  return {create("createPen", {.kind = Pen, .pen = {style, widthPx, color}})};
}
BrushHandle RecordingGdi::createSolidBrush(Color color) {
  return {create("createSolidBrush", {.kind = Brush, .brush = color})};
}
BrushHandle RecordingGdi::createHatchBrush(HatchStyle, Color color) {
  return {create("createHatchBrush", {.kind = Brush, .brush = color})};
}
FontHandle RecordingGdi::createFont(const FontSpec& font) {
  return {create("createFont", {.kind = Font, .font = font})};
}
RegionHandle RecordingGdi::createRectRgn(Rect rect) {
  return {create("createRectRgn", {.kind = Region, .rect = rect})};
}

PenHandle RecordingGdi::stockPen(StockPen pen) {
  const Color color = pen == StockPen::White ? rgb(255, 255, 255) : Color{};
  return {stock("stockPen", static_cast<std::uintptr_t>(pen), {.kind = Pen, .pen = {.color = color}})};
}
BrushHandle RecordingGdi::stockBrush(StockBrush brush) {
  const Color color = brush == StockBrush::White ? rgb(255, 255, 255) : Color{};
  return {stock("stockBrush", static_cast<std::uintptr_t>(brush), {.kind = Brush, .brush = color})};
}
Color RecordingGdi::sysColor(SystemColor color) {
  return begin("sysColor", {}) == nullptr ? Color{} : systemColor(color);
}
BrushHandle RecordingGdi::sysColorBrush(SystemColor color) {
  const auto index = 50 + static_cast<std::uintptr_t>(color);  // beyond the stock brushes
  return {stock("sysColorBrush", index, {.kind = Brush, .brush = systemColor(color)})};
}

bool RecordingGdi::selectClipRgn(DcHandle dc, RegionHandle region) {
  if (beginDrawing("selectClipRgn", dc) == nullptr) return false;
  const Object* object = find(region.value, Region);
  if (region && object == nullptr) return violate("selectClipRgn of an unknown region");
  dcs_[dc.value].clip = object == nullptr ? std::nullopt : std::optional(object->rect);
  return true;
}

Color RecordingGdi::setTextColor(DcHandle dc, Color color) {
  return exchange("setTextColor", dc, &Dc::textColor, color);
}
Color RecordingGdi::setBkColor(DcHandle dc, Color color) {
  return exchange("setBkColor", dc, &Dc::bkColor, color);
}
BackgroundMode RecordingGdi::setBkMode(DcHandle dc, BackgroundMode mode) {
  return exchange("setBkMode", dc, &Dc::mode, mode);
}
DrawMode RecordingGdi::setRop2(DcHandle dc, DrawMode mode) { return exchange("setRop2", dc, &Dc::rop, mode); }

bool RecordingGdi::fillRect(DcHandle dc, Rect rect, BrushHandle brush) {
  Call* const call = beginDrawing("fillRect", dc);
  if (call == nullptr) return false;
  const Object* object = find(brush.value, Brush);
  if (object == nullptr) return violate("fillRect with an unknown brush");
  call->rect = rect;
  call->brush = object->brush;
  return true;
}

bool RecordingGdi::moveTo(DcHandle dc, Point to) {
  if (beginDrawing("moveTo", dc) == nullptr) return false;
  dcs_[dc.value].current = to;
  return true;
}

bool RecordingGdi::lineTo(DcHandle dc, Point to) {
  Call* const call = beginDrawing("lineTo", dc);
  if (call != nullptr) call->points = {std::exchange(dcs_[dc.value].current, to), to};
  return call != nullptr;
}

bool RecordingGdi::polyline(DcHandle dc, std::span<const Point> points) {
  Call* const call = beginDrawing("polyline", dc);
  if (call == nullptr) return false;
  call->points.assign(points.begin(), points.end());
  call->failed = points.size() < 2;  // the graphics interface refuses a single point
  return !call->failed;
}

bool RecordingGdi::drawEdge(DcHandle dc, Rect rect, std::uint32_t edge, std::uint32_t sides) {
  Call* const call = beginDrawing("drawEdge", dc);
  if (call == nullptr) return false;
  call->rect = rect;
  call->edge = edge;
  call->sides = sides;
  return true;
}

bool RecordingGdi::textOut(DcHandle dc, Point topLeft, std::string_view text) {
  Call* const call = beginDrawing("textOut", dc);
  if (call == nullptr) return false;
  call->points = {topLeft};
  call->text = text;
  return true;
}

Size RecordingGdi::textExtent(DcHandle dc, std::string_view text) {
  if (beginDrawing("textExtent", dc) == nullptr || text.empty()) return {};
  const auto letters = std::count_if(text.begin(), text.end(),
                                     [](char c) { return (static_cast<unsigned char>(c) & 0xC0) != 0x80; });
  return {static_cast<std::int32_t>(letters) * 8, 12};
}

bool RecordingGdi::bitBlt(DcHandle to, Rect destination, DcHandle from, Point source, RasterOp) {
  Call* const call = beginDrawing("bitBlt", to);
  if (call == nullptr) return false;
  call->rect = destination;
  call->from = from;
  call->points = {source};
  return dcs_.contains(from.value) || violate("bitBlt from an unknown device context");
}

// The call with the state it is made under; null when it is to fail.
Call* RecordingGdi::begin(std::string_view name, DcHandle dc) {
  Call& call = calls_.emplace_back();
  call.name = name;
  call.dc = dc;
  if (const auto state = dcs_.find(dc.value); state != dcs_.end()) {
    call.pen = pen(dc);
    call.font = font(dc);
    call.textColor = state->second.textColor;
    call.backgroundMode = state->second.mode;
    call.clip = state->second.clip;
  }
  call.failed = (failAt_ > 0 && --failAt_ == 0) || failing_ == name;
  return call.failed ? nullptr : &call;
}

Call* RecordingGdi::beginDrawing(std::string_view name, DcHandle dc) {
  Call* const call = begin(name, dc);
  if (call == nullptr || dcs_.contains(dc.value)) return call;
  return violate(std::string(name) + " on an unknown device context"), nullptr;
}

bool RecordingGdi::violate(const std::string& what) {
  violations_.push_back(what);
  calls_.back().failed = true;
  return false;
}

const RecordingGdi::Object* RecordingGdi::find(std::uintptr_t handle, Kind kind) const {
  const auto found = objects_.find(handle);
  return found != objects_.end() && found->second.kind == kind ? &found->second : nullptr;
}

const RecordingGdi::Object& RecordingGdi::selected(DcHandle dc, Kind kind) const {
  return objects_.at(dcs_.at(dc.value).selected[kind]);
}

const RecordingGdi::Dc* RecordingGdi::holder(std::uintptr_t handle, Kind kind) const {
  if (kind == Region) return nullptr;
  const auto found = std::find_if(dcs_.begin(), dcs_.end(),
                                  [&](const auto& dc) { return dc.second.selected[kind] == handle; });
  return found == dcs_.end() ? nullptr : &found->second;
}

std::uintptr_t RecordingGdi::create(std::string_view name, Object object) {
  Call* const call = begin(name, {});
  if (call == nullptr) return 0;
  call->pen = object.pen;
  objects_.emplace(nextHandle_, std::move(object));
  return nextHandle_++;
}

std::uintptr_t RecordingGdi::stock(std::string_view name, std::uintptr_t index, Object object) {
  if (begin(name, {}) == nullptr) return 0;
  const std::uintptr_t handle = 100 + 100 * std::uintptr_t{object.kind} + index;
  object.stock = true;
  objects_.emplace(handle, std::move(object));
  return handle;
}

std::uintptr_t RecordingGdi::select(DcHandle dc, std::uintptr_t handle, Kind kind) {
  const bool works = begin("selectObject", dc) != nullptr;
  const auto state = dcs_.find(dc.value);
  if (!works) return state != dcs_.end() && (state->second.selectFailed = true), 0;
  if (state == dcs_.end()) return violate("selectObject into an unknown device context"), 0;
  const Object* const object = find(handle, kind);
  if (object == nullptr) return violate("selectObject of an unknown object"), 0;
  const Dc* const held = holder(handle, kind);
  if (kind == Bitmap && !object->stock && held != nullptr && held != &state->second)
    return violate("selectObject of a bitmap that another device context holds"), 0;
  const std::uintptr_t previous = std::exchange(state->second.selected[kind], handle);
  buryIfUnselected(previous, kind);
  return previous;
}

// The graphics interface lets a deleted pen, brush or font live until it is selected out.
void RecordingGdi::buryIfUnselected(std::uintptr_t handle, Kind kind) {
  if (objects_[handle].deletedWhileSelected && holder(handle, kind) == nullptr) objects_.erase(handle);
}

bool RecordingGdi::destroy(std::uintptr_t handle, Kind kind) {
  if (begin("deleteObject", {}) == nullptr) return false;
  const auto found = objects_.find(handle);
  if (found == objects_.end() || found->second.stock || found->second.deletedWhileSelected)
    return violate("deleteObject of what is unknown or not one's own");
  const Dc* const held = holder(handle, kind);
  if (held == nullptr) return objects_.erase(handle), true;
  if (!held->selectFailed) violate("deleteObject of what is selected");
  found->second.deletedWhileSelected = kind != Bitmap;
  return kind != Bitmap;
}

template <class T>
T RecordingGdi::exchange(std::string_view name, DcHandle dc, T Dc::*field, T value) {
  if (beginDrawing(name, dc) == nullptr) return {};
  return std::exchange(dcs_[dc.value].*field, value);
}

}  // namespace testing
}  // namespace frontpanels

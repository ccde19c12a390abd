// A Gdi that draws nothing and keeps every call as a value, with what was in force when it was made. Any call
// can be told to fail; misuse (deleting what is selected, drawing with an unknown handle) is kept as a
// violation. Every letter (UTF-8 code point) is 8 pixels wide and 12 high.
#pragma once

#include <cstdint>
#include <map>
#include <optional>
#include <ostream>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "platform/gdi.h"

namespace frontpanels {

// Printing for test messages.
std::ostream& operator<<(std::ostream& out, Point p);
std::ostream& operator<<(std::ostream& out, Size s);
std::ostream& operator<<(std::ostream& out, const Rect& r);
std::ostream& operator<<(std::ostream& out, Color c);
std::ostream& operator<<(std::ostream& out, const FontSpec& font);
template <class Tag>
std::ostream& operator<<(std::ostream& out, Handle<Tag> handle) {
  return out << '#' << handle.value;
}

namespace testing {

struct PenValue {
  PenStyle style = PenStyle::Solid;
  std::int32_t widthPx = 1;
  Color color{};
  bool null = false;  // the stock pen that draws nothing
  friend bool operator==(const PenValue&, const PenValue&) = default;
};

struct BrushValue {
  Color color{};
  std::optional<HatchStyle> hatch{};
  bool null = false;
  friend bool operator==(const BrushValue&, const BrushValue&) = default;
};

// One call. Fields that a call does not have keep their defaults; the state is the one the call was made
// under.
struct Call {
  std::string name;  // as in gdi.h: "createPen", "polyline", ...
  DcHandle dc{};
  bool failed = false;
  std::uintptr_t object = 0;  // the handle that was created, selected or deleted
  PenValue pen{};
  BrushValue brush{};
  FontSpec font{};
  Color textColor{};
  BackgroundMode backgroundMode = BackgroundMode::Opaque;
  DrawMode drawMode = DrawMode::CopyPen;
  std::optional<Rect> clip{};
  std::vector<Point> points{};
  Rect rect{};
  std::string text{};
  std::uint32_t edge = 0;
  std::uint32_t sides = 0;
  DcHandle from{};
  friend bool operator==(const Call&, const Call&) = default;
};

struct PolylineValue {
  DcHandle dc{};
  std::vector<Point> points{};
  PenValue pen{};
  std::optional<Rect> clip{};
  friend bool operator==(const PolylineValue&, const PolylineValue&) = default;
};

struct LineValue {
  Point from{};
  Point to{};
  PenValue pen{};
  friend bool operator==(const LineValue&, const LineValue&) = default;
};

struct TextValue {
  Point topLeft{};
  std::string text{};
  Color color{};
  BackgroundMode mode = BackgroundMode::Opaque;
  FontSpec font{};
  friend bool operator==(const TextValue&, const TextValue&) = default;
};

struct FillValue {
  DcHandle dc{};
  Rect rect{};
  BrushValue brush{};
  friend bool operator==(const FillValue&, const FillValue&) = default;
};

struct EdgeValue {
  DcHandle dc{};
  Rect rect{};
  std::uint32_t edge = 0;
  std::uint32_t sides = 0;
  friend bool operator==(const EdgeValue&, const EdgeValue&) = default;
};

struct BlitValue {
  DcHandle to{};
  Rect destination{};
  DcHandle from{};
  Point source{};
  friend bool operator==(const BlitValue&, const BlitValue&) = default;
};

std::ostream& operator<<(std::ostream& out, const PenValue& pen);
std::ostream& operator<<(std::ostream& out, const BrushValue& brush);
std::ostream& operator<<(std::ostream& out, const Call& call);
std::ostream& operator<<(std::ostream& out, const PolylineValue& value);
std::ostream& operator<<(std::ostream& out, const LineValue& value);
std::ostream& operator<<(std::ostream& out, const TextValue& value);
std::ostream& operator<<(std::ostream& out, const FillValue& value);
std::ostream& operator<<(std::ostream& out, const EdgeValue& value);
std::ostream& operator<<(std::ostream& out, const BlitValue& value);

class RecordingGdi final : public Gdi {
 public:
  RecordingGdi();

  // The device context of the visible view: there from the start, counted by none of the counters.
  [[nodiscard]] DcHandle viewDc() const { return viewDc_; }

  // What was drawn, in order; calls that failed are left out.
  [[nodiscard]] std::vector<PolylineValue> polylines() const;
  [[nodiscard]] std::vector<LineValue> lines() const;  // each lineTo with the point where it began
  [[nodiscard]] std::vector<TextValue> texts() const;
  [[nodiscard]] std::vector<FillValue> fills() const;
  [[nodiscard]] std::vector<EdgeValue> edges() const;
  [[nodiscard]] std::vector<BlitValue> blits() const;
  // Every call, and the names of those that draw ("fillRect", "polyline", ...), in order.
  [[nodiscard]] const std::vector<Call>& calls() const { return calls_; }
  [[nodiscard]] std::vector<std::string> drawingOrder() const;
  [[nodiscard]] std::vector<Call> callsOf(std::string_view name) const;
  // Forgets the calls and violations; objects, state and pending failures stay.
  void clear();

  // Objects and device contexts that were created and not yet deleted.
  [[nodiscard]] int liveObjects() const { return static_cast<int>(objects_.size()); }
  [[nodiscard]] int liveDcs() const;
  // Misuse, in words. Deleting what an injected failure of selectObject left selected is none.
  [[nodiscard]] const std::vector<std::string>& violations() const { return violations_; }

  // The pen, brush, font and clip in force.
  [[nodiscard]] PenValue pen(DcHandle dc) const;
  [[nodiscard]] BrushValue brush(DcHandle dc) const;
  [[nodiscard]] FontSpec font(DcHandle dc) const;
  [[nodiscard]] std::optional<Rect> clip(DcHandle dc) const;
  [[nodiscard]] Size bitmapSize(DcHandle dc) const;

  // Failures, counted from now; 1 is the next call. A failing call changes nothing.
  void failNth(std::string_view name, int n);
  void failAlways(std::string_view name);
  void failNthCall(int n);
  void failNothing();
  // The recorded calls by their place, from 1, that failNthCall can make fail without losing an object: all
  // but the deletions, whose failure is a leak whatever the caller does.
  [[nodiscard]] std::vector<int> callsThatMayFail() const;

  [[nodiscard]] DcHandle createCompatibleDC(DcHandle dc) override;
  bool deleteDC(DcHandle dc) override;
  [[nodiscard]] BitmapHandle createCompatibleBitmap(DcHandle dc, Size sizePx) override;
  [[nodiscard]] PenHandle createPen(PenStyle style, std::int32_t widthPx, Color color) override;
  [[nodiscard]] BrushHandle createSolidBrush(Color color) override;
  [[nodiscard]] BrushHandle createHatchBrush(HatchStyle style, Color color) override;
  [[nodiscard]] FontHandle createFont(const FontSpec& font) override;
  [[nodiscard]] RegionHandle createRectRgn(Rect rect) override;
  bool deleteObject(BitmapHandle bitmap) override { return destroy(bitmap.value, &Dc::bitmap, "bitmap"); }
  bool deleteObject(PenHandle pen) override { return destroy(pen.value, &Dc::pen, "pen"); }
  bool deleteObject(BrushHandle brush) override { return destroy(brush.value, &Dc::brush, "brush"); }
  bool deleteObject(FontHandle font) override { return destroy(font.value, &Dc::font, "font"); }
  bool deleteObject(RegionHandle region) override { return destroy(region.value, nullptr, "region"); }
  [[nodiscard]] PenHandle stockPen(StockPen pen) override;
  [[nodiscard]] BrushHandle stockBrush(StockBrush brush) override;
  // Button face (240, 240, 240), shadow (160, 160, 160), text black, highlight white, and so on.
  [[nodiscard]] Color sysColor(SystemColor color) override;
  [[nodiscard]] BrushHandle sysColorBrush(SystemColor color) override;
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
  enum class Kind { Bitmap, Pen, Brush, Font, Region };
  struct Object {
    Kind kind = Kind::Pen;
    PenValue pen{};
    BrushValue brush{};
    FontSpec font{};
    Rect rect{};  // of a region; of a bitmap (0, 0, width, height)
    bool deletedWhileSelected = false;
  };
  struct Dc {
    std::uintptr_t bitmap = 0;
    std::uintptr_t pen = 0;
    std::uintptr_t brush = 0;
    std::uintptr_t font = 0;
    std::optional<Rect> clip{};
    Color textColor{};
    Color bkColor = rgb(255, 255, 255);
    BackgroundMode mode = BackgroundMode::Opaque;
    DrawMode rop = DrawMode::CopyPen;
    Point current{};
    bool selectFailed = false;  // by injection
  };
  using Slot = std::uintptr_t Dc::*;

  Call& record(std::string_view name, DcHandle dc);
  bool begin(std::string_view name, DcHandle dc);
  bool beginDrawing(std::string_view name, DcHandle dc);
  bool shouldFail(std::string_view name);
  bool violate(const std::string& what);
  [[nodiscard]] const Object* find(std::uintptr_t handle, Kind kind) const;
  [[nodiscard]] const Dc* findDc(DcHandle dc) const;
  [[nodiscard]] bool selectedSomewhere(std::uintptr_t handle, Slot slot, bool* blameless) const;
  std::uintptr_t add(Object object);
  std::uintptr_t addStock(Object object);
  std::uintptr_t createObject(std::string_view name, DcHandle dc, Object object);
  void buryIfUnselected(std::uintptr_t handle, Slot slot);
  std::uintptr_t select(DcHandle dc, std::uintptr_t handle, Slot slot, Kind kind);
  bool destroy(std::uintptr_t handle, Slot slot, const char* kind);
  template <class T>
  T exchange(std::string_view name, DcHandle dc, T Dc::*field, T value, T failure);

  std::uintptr_t nextHandle_ = 1000;
  std::map<std::uintptr_t, Object> stock_;
  std::map<std::uintptr_t, Object> objects_;
  std::map<std::uintptr_t, Dc> dcs_;
  DcHandle viewDc_{};
  std::uintptr_t stockFont_ = 0;
  std::uintptr_t stockBitmap_ = 0;
  std::vector<Call> calls_;
  std::vector<std::string> violations_;
  std::map<std::string, int, std::less<>> failAt_;  // calls left until the failing one
  std::set<std::string, std::less<>> failAlways_;
  int failAnyAt_ = 0;
};

}  // namespace testing
}  // namespace frontpanels

// A Gdi that draws nothing and keeps every call as a value, with what was in force when it was made. Any call
// can be told to fail; misuse (deleting what is selected, drawing with an unknown handle) is kept as a
// violation. Every letter (UTF-8 code point) is 8 pixels wide and 12 high; system colour n is rgb(n, n, n).
#pragma once

#include <array>
#include <cstdint>
#include <map>
#include <optional>
#include <ostream>
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

namespace testing {

struct PenValue {
  PenStyle style = PenStyle::Solid;
  std::int32_t widthPx = 1;
  Color color{};
  friend bool operator==(const PenValue&, const PenValue&) = default;
};

// One call. Fields that a call does not have keep their defaults; the state is the one the call was made
// under.
struct Call {
  std::string name;  // as in gdi.h: "createPen", "polyline", ...
  DcHandle dc{};
  bool failed = false;
  PenValue pen{};
  Color brush{};
  FontSpec font{};
  Color textColor{};
  BackgroundMode backgroundMode = BackgroundMode::Opaque;
  std::optional<Rect> clip{};
  std::vector<Point> points{};  // of a line both ends; of a text its top left; of a blit its source
  Rect rect{};
  std::string text{};
  std::uint32_t edge = 0;
  std::uint32_t sides = 0;
  DcHandle from{};
};

struct EdgeValue {
  DcHandle dc{};
  Rect rect{};
  std::uint32_t edge = 0;
  std::uint32_t sides = 0;
  friend bool operator==(const EdgeValue&, const EdgeValue&) = default;
};

std::ostream& operator<<(std::ostream& out, const PenValue& pen);
std::ostream& operator<<(std::ostream& out, const EdgeValue& value);

class RecordingGdi final : public Gdi {
 public:
  RecordingGdi();

  // The device context of the visible view: there from the start, counted by none of the counters.
  [[nodiscard]] DcHandle viewDc() const { return viewDc_; }

  // What was drawn, in order; calls that failed are left out.
  [[nodiscard]] std::vector<Call> polylines() const { return succeeded("polyline"); }
  [[nodiscard]] std::vector<Call> lines() const { return succeeded("lineTo"); }
  [[nodiscard]] std::vector<Call> texts() const { return succeeded("textOut"); }
  [[nodiscard]] std::vector<Call> fills() const { return succeeded("fillRect"); }
  [[nodiscard]] std::vector<Call> blits() const { return succeeded("bitBlt"); }
  [[nodiscard]] std::vector<EdgeValue> edges() const;
  [[nodiscard]] std::vector<Call> succeeded(std::string_view name) const;
  // The names of the calls that drew ("fillRect", "polyline", ...), in order.
  [[nodiscard]] std::vector<std::string> drawingOrder() const;
  // Every call, failed or not.
  [[nodiscard]] const std::vector<Call>& calls() const { return calls_; }
  // Forgets the calls and violations; objects, state and pending failures stay.
  void clear();

  // Objects and device contexts that were created and not yet deleted.
  [[nodiscard]] int liveObjects() const;
  [[nodiscard]] int liveDcs() const { return static_cast<int>(dcs_.size()) - 1; }
  // Misuse, in words. Deleting what an injected failure of selectObject left selected is none.
  [[nodiscard]] const std::vector<std::string>& violations() const { return violations_; }

  // What is in force.
  [[nodiscard]] PenValue pen(DcHandle dc) const { return selected(dc, Pen).pen; }
  [[nodiscard]] FontSpec font(DcHandle dc) const { return selected(dc, Font).font; }
  [[nodiscard]] Rect bitmapArea(DcHandle dc) const { return selected(dc, Bitmap).rect; }
  [[nodiscard]] std::optional<Rect> clip(DcHandle dc) const { return dcs_.at(dc.value).clip; }

  // Failures: of every call of a name; of the nth call from now, 1 being the next. A failing call changes
  // nothing.
  void failAlways(std::string_view name) { failing_ = name; }
  void failNthCall(int n) { failAt_ = n; }
  void failNothing() { failing_.clear(), failAt_ = 0; }
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
  bool deleteObject(BitmapHandle bitmap) override { return destroy(bitmap.value, Bitmap); }
  bool deleteObject(PenHandle pen) override { return destroy(pen.value, Pen); }
  bool deleteObject(BrushHandle brush) override { return destroy(brush.value, Brush); }
  bool deleteObject(FontHandle font) override { return destroy(font.value, Font); }
  bool deleteObject(RegionHandle region) override { return destroy(region.value, Region); }
  [[nodiscard]] PenHandle stockPen(StockPen pen) override;
  [[nodiscard]] BrushHandle stockBrush(StockBrush brush) override;
  [[nodiscard]] Color sysColor(SystemColor color) override;
  [[nodiscard]] BrushHandle sysColorBrush(SystemColor color) override;
  BitmapHandle selectObject(DcHandle dc, BitmapHandle bitmap) override {
    return {select(dc, bitmap.value, Bitmap)};
  }
  PenHandle selectObject(DcHandle dc, PenHandle pen) override { return {select(dc, pen.value, Pen)}; }
  BrushHandle selectObject(DcHandle dc, BrushHandle brush) override {
    return {select(dc, brush.value, Brush)};
  }
  FontHandle selectObject(DcHandle dc, FontHandle font) override { return {select(dc, font.value, Font)}; }
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
  enum Kind : std::uintptr_t { Bitmap, Pen, Brush, Font, Region };
  struct Object {
    Kind kind = Pen;
    PenValue pen{};
    Color brush{};
    FontSpec font{};
    Rect rect{};  // of a region; of a bitmap (0, 0, width, height)
    bool stock = false;
    bool deletedWhileSelected = false;
  };
  struct Dc {
    std::array<std::uintptr_t, 4> selected{};  // by kind; a region is copied, not selected
    std::optional<Rect> clip{};
    Color textColor{};
    Color bkColor = rgb(255, 255, 255);
    BackgroundMode mode = BackgroundMode::Opaque;
    DrawMode rop = DrawMode::CopyPen;
    Point current{};
    bool selectFailed = false;  // by injection
  };

  Call* begin(std::string_view name, DcHandle dc);
  Call* beginDrawing(std::string_view name, DcHandle dc);
  bool violate(const std::string& what);
  [[nodiscard]] const Object* find(std::uintptr_t handle, Kind kind) const;
  [[nodiscard]] const Object& selected(DcHandle dc, Kind kind) const;
  [[nodiscard]] const Dc* holder(std::uintptr_t handle, Kind kind) const;
  std::uintptr_t create(std::string_view name, Object object);
  std::uintptr_t stock(std::string_view name, std::uintptr_t index, Object object);
  std::uintptr_t select(DcHandle dc, std::uintptr_t handle, Kind kind);
  void buryIfUnselected(std::uintptr_t handle, Kind kind);
  bool destroy(std::uintptr_t handle, Kind kind);
  template <class T>
  T exchange(std::string_view name, DcHandle dc, T Dc::*field, T value);

  std::uintptr_t nextHandle_ = 1000;
  std::map<std::uintptr_t, Object> objects_;
  std::map<std::uintptr_t, Dc> dcs_;
  Dc fresh_;
  DcHandle viewDc_{};
  std::vector<Call> calls_;
  std::vector<std::string> violations_;
  std::string failing_;
  int failAt_ = 0;
};

}  // namespace testing
}  // namespace frontpanels

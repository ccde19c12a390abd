#include "tests/wine/gdi_scenes.h"

#include <array>

#include "platform/gdi_scope.h"

namespace frontpanels::testing {
namespace {

constexpr Color kWhite = rgb(255, 255, 255);
constexpr Color kGreen = rgb(0, 200, 40);
constexpr Color kBlue = rgb(10, 20, 230);
constexpr Rect kAll{0, 0, kSceneSizePx.width, kSceneSizePx.height};

// The same numbers on every machine.
class Dice {
 public:
  explicit Dice(std::uint32_t seed) : state_(seed * 2654435761U + 12345U) {}
  std::int32_t roll(std::int32_t low, std::int32_t high) {
    state_ = state_ * 1664525U + 1013904223U;
    return low + static_cast<std::int32_t>((state_ >> 8) % static_cast<std::uint32_t>(high - low + 1));
  }
  Point inside() { return {roll(0, kSceneSizePx.width - 1), roll(0, kSceneSizePx.height - 1)}; }
  Point around(std::int32_t reach) {
    return {roll(-reach, kSceneSizePx.width + reach), roll(-reach, kSceneSizePx.height + reach)};
  }
  Color color() { return Color{static_cast<std::uint32_t>(roll(0, 0xFFFFFF))}; }
  Rect rect(std::int32_t reach) {
    const Point a = around(reach);
    const Point b = around(reach);
    return {a.x, a.y, b.x, b.y};
  }

 private:
  std::uint32_t state_;
};

void fill(Gdi& gdi, DcHandle dc, Rect rect, Color color) {
  const BrushHandle brush = gdi.createSolidBrush(color);
  gdi.fillRect(dc, rect, brush);
  gdi.deleteObject(brush);
}

void line(Gdi& gdi, DcHandle dc, Point from, Point to) {
  gdi.moveTo(dc, from);
  gdi.lineTo(dc, to);
}

void clipTo(Gdi& gdi, DcHandle dc, Rect rect) {
  const RegionHandle region = gdi.createRectRgn(rect);
  gdi.selectClipRgn(dc, region);
  gdi.deleteObject(region);
}

void fills(Gdi& gdi, DcHandle dc, std::uint32_t seed) {
  Dice dice(seed);
  for (int i = 0; i < 20; ++i) fill(gdi, dc, dice.rect(30), dice.color());
}

void stockAndSystemFills(Gdi& gdi, DcHandle dc, std::uint32_t) {
  std::int32_t x = 0;
  for (const StockBrush brush : {StockBrush::White, StockBrush::LightGray, StockBrush::Gray,
                                 StockBrush::DarkGray, StockBrush::Black, StockBrush::Null}) {
    gdi.fillRect(dc, {x, 0, x + 20, 60}, gdi.stockBrush(brush));
    x += 20;
  }
  x = 0;
  for (const SystemColor color : kSceneSystemColors) {
    gdi.fillRect(dc, {x, 60, x + 20, 120}, gdi.sysColorBrush(color));
    x += 20;
  }
}

void hatches(Gdi& gdi, DcHandle dc, std::uint32_t seed) {
  Dice dice(seed);
  gdi.setBkColor(dc, kGreen);
  for (std::int32_t style = 0; style < 6; ++style) {
    const BrushHandle brush = gdi.createHatchBrush(static_cast<HatchStyle>(style), kWhite);
    gdi.setBkMode(dc, style % 2 == 0 ? BackgroundMode::Opaque : BackgroundMode::Transparent);
    gdi.fillRect(dc, {style * 26 + dice.roll(0, 5), dice.roll(0, 9), style * 26 + 24, 110}, brush);
    gdi.deleteObject(brush);
  }
}

void edges(Gdi& gdi, DcHandle dc, std::uint32_t) {
  std::int32_t y = 2;
  for (const std::uint32_t edge : {kEdgeRaised, kEdgeBump, kEdgeSunken}) {
    gdi.drawEdge(dc, {2, y, 60, y + 20}, edge, kAllSides);
    std::int32_t x = 64;
    for (std::int32_t size = 0; size < 7; ++size) {
      gdi.drawEdge(dc, {x, y, x + size, y + size}, edge, kAllSides);
      gdi.drawEdge(dc, {x, y + 14, x + size, y + 20}, edge, kAllSides);
      x += size + 4;
    }
    gdi.drawEdge(dc, {130, y + 20, 122, y + 12}, edge, kAllSides);
    gdi.drawEdge(dc, {150, y, 200, y + 20}, edge, kAllSides);
    y += 30;
  }
}

// A star of lines of every slope, drawn outwards and inwards; lines of one and of no pixel.
void star(Gdi& gdi, DcHandle dc, std::uint32_t) {
  const SelectedPen pen(gdi, dc, PenStyle::Solid, 1, kWhite);
  for (std::int32_t i = -24; i <= 24; ++i) {
    line(gdi, dc, {40, 50}, {40 + i, 26});
    line(gdi, dc, {40, 50}, {64, 50 + i});
    line(gdi, dc, {40 + i, 74}, {40, 50});
    line(gdi, dc, {16, 50 + i}, {40, 50});
  }
  for (std::int32_t i = 0; i < 12; ++i) line(gdi, dc, {80, 4 + 9 * i}, {80 + 6 * i, 4 + 9 * i + i});
  for (std::int32_t i = -1; i <= 1; ++i) line(gdi, dc, {104 + 4 * i, 100}, {104 + 5 * i, 100});
}

struct Strokes {
  const char* name;
  std::array<std::int32_t, 3> reachesPx;  // how far outside the picture they may begin and end, in turn
  std::array<std::int32_t, 3> widthsPx{1, 1, 1};
  bool dashed = false;
  bool clipped = false;
  DrawMode mode = DrawMode::CopyPen;
};

constexpr Strokes kStrokes[] = {{"lines", {0, 0, 0}},
                                {"lines from outside", {40, 2000, 40000}},
                                {"clipped lines", {8, 20, 40}, {1, 1, 1}, false, true},
                                {"dashes", {0, 30, 30}, {1, 1, 2}, true},
                                {"wide lines", {0, 30, 40}, {2, 3, 4}},
                                {"not-xor", {0, 20, 20}, {3, 1, 1}, false, false, DrawMode::NotXorPen}};

void strokes(Gdi& gdi, DcHandle dc, const Strokes& kind, std::uint32_t seed) {
  Dice dice(seed);
  fill(gdi, dc, {20, 10, 140, 100}, kBlue);
  gdi.setBkColor(dc, kGreen);
  gdi.setRop2(dc, kind.mode);
  for (std::uint32_t i = 0; i < 30; ++i) {
    if (kind.clipped && i % 6 == 0) clipTo(gdi, dc, dice.rect(20));
    gdi.setBkMode(dc, i % 2 == 0 ? BackgroundMode::Opaque : BackgroundMode::Transparent);
    const auto style = static_cast<PenStyle>(kind.dashed ? 1 + i % 4 : 0);
    const SelectedPen pen(gdi, dc, style, kind.widthsPx[i % 3], dice.color());
    const std::int32_t reach = kind.reachesPx[(i + seed) % 3];
    const std::array<Point, 4> points{dice.around(reach), dice.inside(), dice.around(reach),
                                      dice.around(reach)};
    if (i % 4 < 2) {
      gdi.polyline(dc, points);
    } else {
      line(gdi, dc, points[0], points[1]);
      gdi.lineTo(dc, points[2]);
    }
  }
  gdi.selectClipRgn(dc, {});
  fill(gdi, dc, {70, 50, 90, 60}, kGreen);  // not affected by the mode
  gdi.drawEdge(dc, {30, 70, 60, 90}, kEdgeRaised, kAllSides);
}

// A trace as a panel draws it: x advances slowly, y jumps.
void traces(Gdi& gdi, DcHandle dc, std::uint32_t seed) {
  Dice dice(seed);
  for (const std::int32_t count : {20, 100, 160, 500}) {
    const SelectedPen pen(gdi, dc, PenStyle::Solid, 1, dice.color());
    std::array<Point, 500> points;
    for (std::int32_t i = 0; i < count; ++i) {
      points[static_cast<std::size_t>(i)] = {i * kSceneSizePx.width / count, dice.roll(0, 40) + count / 8};
    }
    gdi.polyline(dc, std::span(points).first(static_cast<std::size_t>(count)));
  }
}

// Triangles and cross bars as markers have them, thin and wide.
void markers(Gdi& gdi, DcHandle dc, std::uint32_t) {
  for (std::int32_t i = 0; i < 12; ++i) {
    const SelectedPen pen(gdi, dc, PenStyle::Solid, 1 + i % 2,
                          rgb(50, 50, static_cast<std::uint8_t>(50 + 15 * i)));
    const Point tip{10 + i * 12, 20 + i * 7};
    line(gdi, dc, tip, {tip.x - 4, tip.y - 12});
    gdi.lineTo(dc, {tip.x + 4, tip.y - 12});
    gdi.lineTo(dc, tip);
    line(gdi, dc, {tip.x, tip.y + 1}, {tip.x, tip.y + 9});
  }
}

void blits(Gdi& gdi, DcHandle dc, std::uint32_t seed) {
  Dice dice(seed);
  const DcHandle memory = gdi.createCompatibleDC(dc);
  const BitmapHandle bitmap = gdi.createCompatibleBitmap(dc, {70, 50});
  const BitmapHandle before = gdi.selectObject(memory, bitmap);
  for (int i = 0; i < 15; ++i) fill(gdi, memory, dice.rect(0), dice.color());
  for (int i = 0; i < 8; ++i) {
    if (i == 4) clipTo(gdi, dc, {30, 20, 130, 90});
    const Point to = dice.around(20);
    gdi.bitBlt(dc, {to.x, to.y, to.x + dice.roll(1, 60), to.y + dice.roll(1, 60)}, memory,
               {dice.roll(-10, 60), dice.roll(-10, 40)}, RasterOp::SourceCopy);
  }
  gdi.selectClipRgn(dc, {});
  gdi.bitBlt(dc, {33, 22, 120, 90}, dc, {30, 20}, RasterOp::SourceCopy);
  gdi.bitBlt(dc, {10, 12, 90, 100}, dc, {14, 20}, RasterOp::SourceCopy);
  gdi.selectObject(memory, before);
  gdi.deleteObject(bitmap);
  gdi.deleteDC(memory);
}

void writeIn(Gdi& gdi, DcHandle dc, const FontSpec& spec, Point at, std::string_view text) {
  const FontHandle font = gdi.createFont(spec);
  {
    const SelectedFont selected(gdi, dc, font);
    const Size extent = gdi.textExtent(dc, text);
    gdi.textOut(dc, {at.x - extent.width / 2, at.y}, text);  // centred, so that the extent shows
  }
  gdi.deleteObject(font);
}

void labels(Gdi& gdi, DcHandle dc, std::uint32_t seed) {
  const TextStyleScope style(gdi, dc, kWhite,
                             seed % 2 == 0 ? BackgroundMode::Transparent : BackgroundMode::Opaque);
  gdi.setBkColor(dc, kGreen);
  static const std::array<std::string_view, 6> texts{"-100.0",       "868.30 MHz", "Ref 10 dBm",
                                                     "\xC2\xB5s 1d", "1",          "gjpqy"};
  const auto em = static_cast<std::int32_t>(9 + seed / 2);
  writeIn(gdi, dc, {"Arial", em, 400, false}, {80, 40}, texts[seed % texts.size()]);
}

}  // namespace

std::vector<Scene> gdiScenes(std::uint32_t rounds) {
  std::vector<Scene> scenes{{"stock and system fills", stockAndSystemFills},
                            {"edges", edges},
                            {"star", star},
                            {"markers", markers}};
  for (std::uint32_t seed = 0; seed < rounds; ++seed) {
    for (const Scene& scene :
         {Scene{"fills", fills}, Scene{"hatches", hatches}, Scene{"traces", traces}, Scene{"blits", blits}})
      scenes.push_back({scene.name, scene.draw, seed});
    for (const Strokes& kind : kStrokes) {
      scenes.push_back(
          {kind.name, [&kind](Gdi& gdi, DcHandle dc, std::uint32_t s) { strokes(gdi, dc, kind, s); }, seed});
    }
  }
  for (std::uint32_t seed = 0; seed < 16; ++seed) scenes.push_back({"label", labels, seed, true});
  for (Scene& scene : scenes) scene.name.append(" ").append(std::to_string(scene.seed));
  return scenes;
}

}  // namespace frontpanels::testing

// One frame of a spectrum display drawn through RasterGdi, beside a loop written for this picture alone that
// puts the same pixels straight into memory. Both run in turn on the same frames; the medians are compared.
#include <benchmark/benchmark.h>

#include <algorithm>
#include <array>
#include <chrono>
#include <cstdint>
#include <cstring>
#include <string>
#include <string_view>
#include <vector>

#include "bench/allocation_count.h"
#include "platform/gdi_scope.h"
#include "platform/raster/raster_gdi.h"

namespace frontpanels::bench {
namespace {

constexpr Size kSizePx{800, 600};
constexpr Rect kPlot{60, 20, 780, 560};
constexpr Color kFace = rgb(240, 240, 240);
constexpr Color kGrid = rgb(160, 160, 160);
constexpr Color kInk = rgb(0, 0, 0);
constexpr std::array<Color, 5> kTraceColors{rgb(0, 0, 255), rgb(200, 0, 0), rgb(0, 128, 0), rgb(128, 0, 128),
                                            rgb(0, 128, 128)};
constexpr int kFrames = 16;  // of different values, drawn in turn
constexpr int kMarkers = 4;

using Trace = std::vector<Point>;

// Noise with a few carriers on it. The last points lie to the right of the plot and are clipped.
std::vector<std::vector<Trace>> makeFrames(int traces, int points) {
  std::uint32_t state = 2463534242U;
  const auto noise = [&state](int range) {
    state = state * 1664525U + 1013904223U;
    return static_cast<std::int32_t>((state >> 10) % static_cast<std::uint32_t>(range));
  };
  std::vector<std::vector<Trace>> frames(kFrames, std::vector<Trace>(static_cast<std::size_t>(traces)));
  for (auto& frame : frames) {
    std::int32_t floorPx = kPlot.bottom - 60;
    for (Trace& trace : frame) {
      for (int i = 0; i < points; ++i) {
        const int fromCarrier = std::abs(i % (points / 4) - points / 8) * 512 / points;
        const std::int32_t carrier = fromCarrier < 6 ? 160 - 25 * fromCarrier : 0;
        trace.push_back({kPlot.left + i * kPlot.width() / (points - 2), floorPx - carrier - noise(40)});
      }
      floorPx -= 60;
    }
  }
  return frames;
}

struct Label {
  Point at;
  std::string_view text;
};
constexpr std::array<Label, 14> kLabels{{{{8, 14}, "0.0"},
                                         {{8, 68}, "-10.0"},
                                         {{8, 122}, "-20.0"},
                                         {{8, 176}, "-30.0"},
                                         {{8, 230}, "-40.0"},
                                         {{8, 284}, "-50.0"},
                                         {{8, 338}, "-60.0"},
                                         {{8, 392}, "-70.0"},
                                         {{8, 446}, "-80.0"},
                                         {{8, 500}, "-90.0"},
                                         {{8, 554}, "-100.0"},
                                         {{60, 570}, "868.00 MHz"},
                                         {{390, 570}, "869.00 MHz"},
                                         {{710, 570}, "870.00 MHz"}}};
constexpr std::array<std::string_view, kMarkers> kIds{"1", "2", "3", "3d"};

Point markerAt(const Trace& trace, int marker) {
  return trace[trace.size() / 8 + static_cast<std::size_t>(marker) * trace.size() / 5];
}

// A triangle that stands on its point.
std::array<Point, 4> markerShape(Point tip) {
  return {{tip, {tip.x - 4, tip.y - 12}, {tip.x + 4, tip.y - 12}, tip}};
}

// ---- through the drawing seam

class SeamPicture {
 public:
  SeamPicture() : screen_(gdi_.createScreen(kSizePx)), memory_(gdi_.createCompatibleDC(screen_)) {
    gdi_.selectObject(memory_, gdi_.createCompatibleBitmap(screen_, kSizePx));
    gdi_.selectObject(memory_, gdi_.createFont({"Arial", 11, 400, false}));
    gdi_.setSysColor(SystemColor::ButtonFace, kFace);
  }

  void draw(const std::vector<Trace>& traces) {
    gdi_.fillRect(memory_, {0, 0, kSizePx.width, kSizePx.height},
                  gdi_.sysColorBrush(SystemColor::ButtonFace));
    const RegionHandle region = gdi_.createRectRgn(kPlot);
    gdi_.selectClipRgn(memory_, region);
    drawGrid();
    for (std::size_t t = 0; t < traces.size(); ++t) {
      const SelectedPen pen(gdi_, memory_, PenStyle::Solid, 1, kTraceColors[t]);
      gdi_.polyline(memory_, traces[t]);
    }
    drawMarkers(traces.front());
    gdi_.selectClipRgn(memory_, {});
    gdi_.deleteObject(region);
    const TextStyleScope style(gdi_, memory_, kInk, BackgroundMode::Transparent);
    for (const Label& label : kLabels) gdi_.textOut(memory_, label.at, label.text);
    gdi_.bitBlt(screen_, {0, 0, kSizePx.width, kSizePx.height}, memory_, {0, 0}, RasterOp::SourceCopy);
  }

  [[nodiscard]] PixelView pixels() { return gdi_.pixels(screen_); }

 private:
  void drawGrid() {
    const SelectedPen pen(gdi_, memory_, PenStyle::Solid, 1, kGrid);
    for (std::int32_t i = 0; i <= 10; ++i) {
      const std::int32_t x = kPlot.left + i * (kPlot.width() - 1) / 10;
      const std::int32_t y = kPlot.top + i * (kPlot.height() - 1) / 10;
      gdi_.moveTo(memory_, {x, kPlot.top});
      gdi_.lineTo(memory_, {x, kPlot.bottom});
      gdi_.moveTo(memory_, {kPlot.left, y});
      gdi_.lineTo(memory_, {kPlot.right, y});
    }
  }

  void drawMarkers(const Trace& trace) {
    const TextStyleScope style(gdi_, memory_, kInk, BackgroundMode::Transparent);
    for (int i = 0; i < kMarkers; ++i) {
      const Point tip = markerAt(trace, i);
      gdi_.polyline(memory_, markerShape(tip));
      gdi_.textOut(memory_, {tip.x + 6, tip.y - 16}, kIds[static_cast<std::size_t>(i)]);
    }
  }

  RasterGdi gdi_;
  DcHandle screen_;
  DcHandle memory_;
};

// ---- by hand

class HandPicture {
 public:
  HandPicture() : surface_(kPixels), screen_(kPixels) {
    for (const Label& label : kLabels) labels_.push_back(inkOf(label.text));
    for (const std::string_view id : kIds) ids_.push_back(inkOf(id));
  }

  void draw(const std::vector<Trace>& traces) {
    std::fill(surface_.begin(), surface_.end(), pixelOf(kFace));
    for (std::int32_t i = 0; i <= 10; ++i) {
      const std::int32_t x = kPlot.left + i * (kPlot.width() - 1) / 10;
      const std::int32_t y = kPlot.top + i * (kPlot.height() - 1) / 10;
      for (std::int32_t row = kPlot.top; row < kPlot.bottom; ++row) *at({x, row}) = pixelOf(kGrid);
      std::fill_n(at({kPlot.left, y}), kPlot.width(), pixelOf(kGrid));
    }
    for (std::size_t t = 0; t < traces.size(); ++t) {
      for (std::size_t i = 1; i < traces[t].size(); ++i) {
        line(traces[t][i - 1], traces[t][i], pixelOf(kTraceColors[t]));
      }
    }
    for (int i = 0; i < kMarkers; ++i) {
      const Point tip = markerAt(traces.front(), i);
      const std::array<Point, 4> shape = markerShape(tip);
      for (std::size_t k = 1; k < shape.size(); ++k) line(shape[k - 1], shape[k], pixelOf(kInk));
      write(ids_[static_cast<std::size_t>(i)], {tip.x + 6, tip.y - 16});
    }
    for (std::size_t i = 0; i < kLabels.size(); ++i) write(labels_[i], kLabels[i].at);
    std::memcpy(screen_.data(), surface_.data(), surface_.size() * sizeof(std::uint32_t));
  }

  [[nodiscard]] PixelView pixels() const { return {screen_.data(), kSizePx.width, kSizePx}; }

 private:
  static constexpr std::size_t kPixels = static_cast<std::size_t>(kSizePx.width) * kSizePx.height;

  // The places of a text's ink, written once with the same font.
  static std::vector<Point> inkOf(std::string_view text) {
    RasterGdi gdi;
    const DcHandle dc = gdi.createScreen({200, 40});
    gdi.selectObject(dc, gdi.createFont({"Arial", 11, 400, false}));
    gdi.setBkMode(dc, BackgroundMode::Transparent);
    gdi.setTextColor(dc, rgb(255, 255, 255));
    gdi.textOut(dc, {0, 0}, text);
    std::vector<Point> ink;
    for (std::int32_t y = 0; y < 40; ++y) {
      for (std::int32_t x = 0; x < 200; ++x) {
        if (gdi.pixels(dc).row(y)[x] != 0) ink.push_back({x, y});
      }
    }
    return ink;
  }

  std::uint32_t* at(Point p) { return surface_.data() + p.y * kSizePx.width + p.x; }

  void write(const std::vector<Point>& ink, Point topLeft) {
    for (const Point p : ink) *at({topLeft.x + p.x, topLeft.y + p.y}) = pixelOf(kInk);
  }

  // Midpoint lines without the last point; only at the plot's right edge is each pixel looked at.
  void line(Point from, Point to, std::uint32_t color) {
    const std::int32_t dx = std::abs(to.x - from.x);
    const std::int32_t dy = std::abs(to.y - from.y);
    const std::int32_t stepX = to.x < from.x ? -1 : 1;
    const std::int32_t stepY = to.y < from.y ? -kSizePx.width : kSizePx.width;
    std::uint32_t* pixel = at(from);
    if (from.x >= kPlot.right || to.x >= kPlot.right) {
      lineAtEdge(from, to, color);
    } else if (dx >= dy) {
      std::int32_t error = dx - (to.y > from.y ? 1 : 0);
      for (std::int32_t i = 0; i < dx; ++i) {
        *pixel = color;
        pixel += stepX;
        if ((error += 2 * dy) >= 2 * dx) error -= 2 * dx, pixel += stepY;
      }
    } else {
      std::int32_t error = dy - (to.x > from.x ? 1 : 0);
      for (std::int32_t i = 0; i < dy; ++i) {
        *pixel = color;
        pixel += stepY;
        if ((error += 2 * dx) >= 2 * dy) error -= 2 * dy, pixel += stepX;
      }
    }
  }

  void lineAtEdge(Point from, Point to, std::uint32_t color) {
    const std::int32_t dx = to.x - from.x;  // never negative in a trace
    const std::int32_t dy = std::abs(to.y - from.y);
    const std::int32_t down = to.y < from.y ? -1 : 1;
    const std::int32_t longer = std::max(dx, dy);
    for (std::int32_t i = 0; i < longer; ++i) {
      const bool flat = dx >= dy;
      const std::int32_t bias = (flat ? to.y > from.y : to.x > from.x) ? 1 : 0;
      const std::int32_t across = (2 * std::min(dx, dy) * i + longer - bias) / (2 * longer);
      const Point p{from.x + (flat ? i : across), from.y + down * (flat ? across : i)};
      if (p.x < kPlot.right) *at(p) = color;
    }
  }

  std::vector<std::uint32_t> surface_;
  std::vector<std::uint32_t> screen_;
  std::vector<std::vector<Point>> labels_;
  std::vector<std::vector<Point>> ids_;
};

bool samePixels(const PixelView& a, const PixelView& b) {
  for (std::int32_t y = 0; y < kSizePx.height; ++y) {
    if (!std::equal(a.row(y), a.row(y) + kSizePx.width, b.row(y))) return false;
  }
  return true;
}

double median(std::vector<double>& values) {
  std::nth_element(values.begin(), values.begin() + static_cast<std::ptrdiff_t>(values.size() / 2),
                   values.end());
  return values[values.size() / 2];
}

template <class Body>
double microseconds(Body&& body) {
  const auto begin = std::chrono::steady_clock::now();
  body();
  return std::chrono::duration<double, std::micro>(std::chrono::steady_clock::now() - begin).count();
}

void frame(benchmark::State& state) {
  const auto frames = makeFrames(static_cast<int>(state.range(0)), static_cast<int>(state.range(1)));
  SeamPicture seam;
  HandPicture hand;
  for (const auto& traces : frames) {
    seam.draw(traces);
    hand.draw(traces);
    if (!samePixels(seam.pixels(), hand.pixels())) return state.SkipWithError("the two pictures differ");
  }
  std::vector<double> seamUs;
  std::vector<double> handUs;
  seamUs.reserve(1U << 20);
  handUs.reserve(1U << 20);
  std::uint64_t allocations = 0;
  std::size_t next = 0;
  for (auto _ : state) {
    const auto& traces = frames[next++ % kFrames];
    const std::uint64_t before = allocationCount();
    seamUs.push_back(microseconds([&] { seam.draw(traces); }));
    allocations += allocationCount() - before;
    handUs.push_back(microseconds([&] { hand.draw(traces); }));
    state.SetIterationTime(seamUs.back() / 1e6);
  }
  const double seamMedian = median(seamUs);
  const double handMedian = median(handUs);
  state.counters["raster_us"] = seamMedian;
  state.counters["by_hand_us"] = handMedian;
  state.counters["ratio"] = seamMedian / handMedian;
  state.counters["allocations_per_frame"] =
      static_cast<double>(allocations) / static_cast<double>(state.iterations());
}

BENCHMARK(frame)
    ->ArgNames({"traces", "points"})
    ->Args({1, 513})
    ->Args({5, 513})
    ->Args({5, 3001})
    ->UseManualTime()
    ->Unit(benchmark::kMicrosecond)
    ->MinTime(1.0);

}  // namespace
}  // namespace frontpanels::bench

BENCHMARK_MAIN();

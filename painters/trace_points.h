// The pixel points of one trace, in stretches that are drawn with one line each.
#pragma once

#include <cmath>
#include <cstdint>
#include <span>
#include <vector>

#include "painters/axis.h"
#include "platform/geometry.h"

namespace frontpanels {

class TracePoints {
 public:
  // Point indices run from 0 to 3000.
  static constexpr std::size_t kMaxPoints = 3001;

  // Points without a gap between them.
  struct Stretch {
    std::int32_t first = 0;
    std::int32_t count = 0;
    friend bool operator==(const Stretch&, const Stretch&) = default;
  };

  // Places every value; one that is not finite leaves a gap. Positions are rounded half to even.
  // Raises "Overflow" for a finite value whose position does not fit 32 bits and "Subscript out of range"
  // past the last index; there are no points then. Storage is used again.
  template <class T>
  void place(std::span<const T> values, const PointAxis& x, const ValueAxis& y) {
    begin(values.size());
    if (!placeAll(values, x, y)) placeWithGaps(values, x, y);
  }
  void clear() noexcept {
    points_.clear();
    stretches_.clear();
  }

  [[nodiscard]] std::span<const Stretch> stretches() const noexcept { return stretches_; }
  [[nodiscard]] std::span<const Point> points(const Stretch& stretch) const noexcept {
    return std::span(points_).subspan(static_cast<std::size_t>(stretch.first),
                                      static_cast<std::size_t>(stretch.count));
  }
  // Null where the trace has no such point or a gap.
  [[nodiscard]] const Point* find(std::int32_t index) const noexcept;
  // Index of the last point there is; -1 without any.
  [[nodiscard]] std::int32_t last() const noexcept {
    return stretches_.empty() ? -1 : stretches_.back().first + stretches_.back().count - 1;
  }

 private:
  void begin(std::size_t count);

  static constexpr double kSurelyFitsPx = 2147483647;  // beyond it the careful pass decides

  // One pass without a branch a point: a value that is not finite has no position that fits, so whether all
  // of them do answers both questions at once.
  template <class T>
  bool placeAll(std::span<const T> values, const PointAxis& x, const ValueAxis& y) {
    if (values.empty()) return true;
    const auto count = static_cast<std::int32_t>(values.size());
    bool fits = fitsInt32(x.pixel(0)) && fitsInt32(x.pixel(count - 1));
    Point* const points = points_.data();
    for (std::int32_t i = 0; i < count; ++i) {
      const double yPx = y.pixel(static_cast<double>(values[static_cast<std::size_t>(i)]));
      fits &= std::fabs(yPx) < kSurelyFitsPx;
      points[i] = {static_cast<std::int32_t>(std::lrint(x.pixel(i))),
                   static_cast<std::int32_t>(std::lrint(yPx))};
    }
    if (fits) stretches_.push_back({0, count});
    return fits;
  }

  template <class T>
  void placeWithGaps(std::span<const T> values, const PointAxis& x, const ValueAxis& y) {
    stretches_.clear();
    bool open = false;
    for (std::size_t i = 0; i < values.size(); ++i) {
      const auto value = static_cast<double>(values[i]);
      const auto index = static_cast<std::int32_t>(i);
      if (!std::isfinite(value)) {
        open = false;
        continue;
      }
      place(index, {x.pixel(index), y.pixel(value)}, open);
      open = true;
    }
  }
  struct Position {
    double xPx;
    double yPx;
  };
  void place(std::int32_t index, Position at, bool continued);

  std::vector<Point> points_;
  std::vector<Stretch> stretches_;
};

}  // namespace frontpanels

// Where the bars of a chart, and what is written at them, go. Pixels; rectangles are half-open.
//
// Both directions share one arithmetic: bars follow each other `along` the plot (from the left, or from the
// top) and grow `out` of its base (the bottom edge, or the left one).
#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <span>
#include <vector>

#include "painters/axis.h"
#include "painters/plot_labels.h"

namespace frontpanels {

enum class BarDirection : std::int16_t { Vertical = 0, Horizontal = 1 };

struct PxSpan {
  std::int32_t from = 0;
  std::int32_t to = 0;
  [[nodiscard]] std::int32_t length() const noexcept { return to - from; }
  friend bool operator==(const PxSpan&, const PxSpan&) = default;
};

// The axis of a chart whose scale is fixed: `divisions` of `perDivision` from the top down, but only the
// whole ones above the floor, unless the axis begins at or below it.
struct FixedAxis {
  ValueRange range;
  std::int32_t divisions = 0;
  friend bool operator==(const FixedAxis&, const FixedAxis&) = default;
};
[[nodiscard]] FixedAxis fixedAxis(double top, double perDivision, std::int32_t divisions, double floor);

// `count` bars share the plot evenly: a bar takes three quarters of its slot, at least a pixel, in its
// middle.
class BarFrame {
 public:
  // Raises "Overflow" for a plot beyond 32-bit coordinates. A range without extent has bars without length.
  BarFrame(const PlotRect& plot, BarDirection direction, const ValueRange& range, std::size_t count);

  [[nodiscard]] BarDirection direction() const noexcept { return direction_; }
  [[nodiscard]] const Rect& plot() const noexcept { return plot_; }
  [[nodiscard]] PxSpan along(std::size_t bar) const;
  [[nodiscard]] std::int32_t slotPx() const noexcept { return static_cast<std::int32_t>(slotPx_); }
  // How far a bar grows: cut at both ends of the axis, 0 for what is no number.
  [[nodiscard]] std::int32_t lengthPx(double value) const;
  [[nodiscard]] Rect bar(std::size_t bar, double value) const {
    return rect(along(bar), {0, lengthPx(value)});
  }
  // The two ends of the line across the bars at a level that lies within the axis.
  [[nodiscard]] std::optional<std::array<Point, 2>> line(double level) const;
  [[nodiscard]] Rect rect(PxSpan along, PxSpan out) const noexcept;

 private:
  BarDirection direction_;
  ValueRange range_;
  ValueAxis axis_;
  Rect plot_;
  double startPx_;
  double slotPx_;
  std::int32_t barPx_;
  std::int32_t leadPx_;  // from a slot's beginning to its bar, in whole pixels so that gaps look alike
};

// What is written at one bar, as sizes: its key and its quantities, the most important one first. An extent
// of 0 x 0 is none.
struct BarTextSizes {
  static constexpr std::size_t kQuantities = 3;
  Size key;
  std::array<Size, kQuantities> quantities;
};

// Places texts so that none overlaps another, a bar of someone else's or a label round the plot, or leaves
// the panel. Where there is not room for all, stronger bars go first. Linear in the bars.
class BarTextLayout {
 public:
  struct Placed {
    Rect cell;
    std::uint32_t bar = 0;
    std::uint32_t part = 0;  // 0 the key, then the quantities
    bool inside = false;     // on the bar itself
    friend bool operator==(const Placed&, const Placed&) = default;
  };

  // `lengthsPx`, `sizes` and `strongestFirst` are of the same bars. Keys go to the base. Quantities go to the
  // end of the bar; into it, if `mayStandInside`, where they would not fit there; the last ones are left out
  // where all would fit neither way.
  void layOut(const BarFrame& frame, const Rect& panel, std::span<const std::int32_t> lengthsPx,
              std::span<const BarTextSizes> sizes, std::span<const std::uint32_t> strongestFirst,
              const PlotLabels& around, bool mayStandInside);

  [[nodiscard]] std::span<const Placed> placed() const noexcept { return placed_; }
  // Whether a text at a bar lies on some of the cell.
  [[nodiscard]] bool covers(const Rect& cell) const noexcept;
  // Bars whose key found no room, the strongest first.
  [[nodiscard]] std::span<const std::uint32_t> withoutKey() const noexcept { return withoutKey_; }

 private:
  struct Surroundings {
    const BarFrame& frame;
    const PlotLabels& around;
  };
  struct Block;

  void begin(const BarFrame& frame, const Rect& panel, std::span<const std::int32_t> lengthsPx);
  [[nodiscard]] bool placeKey(const Surroundings& in, std::uint32_t bar, Size size);
  void placeQuantities(const Surroundings& in, std::uint32_t bar, std::int32_t lengthPx,
                       const BarTextSizes& sizes, bool mayStandInside);
  bool placeOutside(const Surroundings& in, const Block& block);
  bool placeInside(const Surroundings& in, const Block& block);
  [[nodiscard]] bool inReach(PxSpan along) const noexcept;

  std::vector<Placed> placed_;
  std::vector<std::uint32_t> withoutKey_;
  // By pixel along the panel, from `firstPx_`.
  std::int32_t firstPx_ = 0;
  std::vector<std::uint8_t> keyTaken_;
  std::vector<std::int32_t> barEndPx_;
  std::vector<std::int32_t> textStartPx_;  // of what has been placed outside
};

}  // namespace frontpanels

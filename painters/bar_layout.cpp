#include "painters/bar_layout.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "framework/support/numeric.h"

namespace frontpanels {
namespace {

constexpr double kBarShareOfSlot = 0.75;
constexpr std::int32_t kFarthestPx = 32767;  // along a panel; nothing is written beyond
constexpr std::int32_t kNothingPlacedPx = std::numeric_limits<std::int32_t>::max();

// Distances in pixels, by direction.
struct Gaps {
  std::int32_t keyFromBase;
  std::int32_t textFromEnd;
  std::int32_t betweenParts;
  std::int32_t betweenBars;  // of the texts of two of them
  std::int32_t overBar;  // by which a cell may be larger than the bar it stands in: letters have air there
};
constexpr std::array<Gaps, 2> kGaps{{{3, 1, 0, 4, 0}, {4, 4, 8, 0, 2}}};

const Gaps& gapsOf(const BarFrame& frame) { return kGaps[static_cast<std::size_t>(frame.direction())]; }

std::int32_t alongOf(const BarFrame& frame, Size size) {
  return frame.direction() == BarDirection::Vertical ? size.width : size.height;
}

std::int32_t outOf(const BarFrame& frame, Size size) {
  return frame.direction() == BarDirection::Vertical ? size.height : size.width;
}

PxSpan centred(PxSpan bar, std::int32_t sizePx) {
  const std::int32_t from = (bar.from + bar.to - sizePx) / 2;
  return {from, from + sizePx};
}

// Centred, but not before the plot of vertical bars: the value axis has its labels there.
PxSpan overBar(const BarFrame& frame, PxSpan bar, Size size) {
  const PxSpan along = centred(bar, alongOf(frame, size));
  if (frame.direction() == BarDirection::Horizontal) return along;
  const std::int32_t from = std::max(along.from, frame.plot().left);
  return {from, from + along.length()};
}

}  // namespace

FixedAxis fixedAxis(double top, double perDivision, std::int32_t divisions, double floor) {
  if (divisions <= 0 || top <= floor) return {{top - perDivision * divisions, top}, divisions};
  const double whole = std::floor((top - floor) / perDivision);
  const std::int32_t shown = whole >= divisions ? divisions : std::max(1, static_cast<std::int32_t>(whole));
  return {{std::max(top - perDivision * shown, floor), top}, shown};
}

BarFrame::BarFrame(const PlotRect& plot, BarDirection direction, const ValueRange& range, std::size_t count)
    : direction_(direction),
      range_(range),
      axis_(direction == BarDirection::Vertical ? ValueAxis(plot, range) : ValueAxis::across(plot, range)),
      plot_(plot.toPixels()),
      startPx_(static_cast<double>(direction == BarDirection::Vertical ? plot.left : plot.top)),
      slotPx_(static_cast<double>(direction == BarDirection::Vertical ? plot.width : plot.height) /
              static_cast<double>(std::max<std::size_t>(count, 1))),
      barPx_(std::max(1, toInt32(slotPx_ * kBarShareOfSlot))),
      leadPx_(toInt32((slotPx_ - barPx_) / 2)) {}

PxSpan BarFrame::along(std::size_t bar) const {
  const PxSpan plot = direction_ == BarDirection::Vertical ? PxSpan{plot_.left, plot_.right}
                                                           : PxSpan{plot_.top, plot_.bottom};
  const std::int32_t from = toInt32(startPx_ + slotPx_ * static_cast<double>(bar)) + leadPx_;
  const std::int32_t kept = std::max(plot.from, std::min(from, plot.to - barPx_));
  return {kept, kept + barPx_};
}

std::int32_t BarFrame::lengthPx(double value) const {
  if (!std::isfinite(value) || !(range_.extent() > 0)) return 0;
  const std::int32_t end = toInt32(axis_.pixel(std::clamp(value, range_.minimum, range_.maximum)));
  return direction_ == BarDirection::Vertical ? plot_.bottom - end : end - plot_.left;
}

std::optional<std::array<Point, 2>> BarFrame::line(double level) const {
  if (!(range_.extent() > 0) || !(level >= range_.minimum && level <= range_.maximum)) return std::nullopt;
  const std::int32_t at = toInt32(axis_.pixel(level));
  if (direction_ == BarDirection::Vertical) return {{{{plot_.left, at}, {plot_.right, at}}}};
  return {{{{at, plot_.top}, {at, plot_.bottom}}}};
}

Rect BarFrame::rect(PxSpan along, PxSpan out) const noexcept {
  if (direction_ == BarDirection::Vertical) {
    return {along.from, plot_.bottom - out.to, along.to, plot_.bottom - out.from};
  }
  return {plot_.left + out.from, along.from, plot_.left + out.to, along.to};
}

// The quantities of one bar that are tried together.
struct BarTextLayout::Block {
  std::uint32_t bar;
  std::int32_t barLengthPx;
  std::span<const Size> sizes;
};

void BarTextLayout::layOut(const BarFrame& frame, const Rect& panel, std::span<const std::int32_t> lengthsPx,
                           std::span<const BarTextSizes> sizes, std::span<const std::uint32_t> strongestFirst,
                           const PlotLabels& around, bool mayStandInside) {
  begin(frame, panel, lengthsPx);
  const Surroundings in{frame, around};
  for (const std::uint32_t bar : strongestFirst) {
    if (sizes[bar].key != Size{} && !placeKey(in, bar, sizes[bar].key)) withoutKey_.push_back(bar);
    placeQuantities(in, bar, lengthsPx[bar], sizes[bar], mayStandInside);
  }
}

bool BarTextLayout::covers(const Rect& cell) const noexcept {
  return std::any_of(placed_.begin(), placed_.end(),
                     [&](const Placed& text) { return overlap(text.cell, cell); });
}

void BarTextLayout::begin(const BarFrame& frame, const Rect& panel, std::span<const std::int32_t> lengthsPx) {
  placed_.clear();
  withoutKey_.clear();
  const bool vertical = frame.direction() == BarDirection::Vertical;
  firstPx_ = vertical ? panel.left : panel.top;
  const std::int64_t extent = static_cast<std::int64_t>(vertical ? panel.right : panel.bottom) - firstPx_;
  const auto pixels = static_cast<std::size_t>(std::clamp<std::int64_t>(extent, 0, kFarthestPx));
  keyTaken_.assign(pixels, 0);
  barEndPx_.assign(pixels, 0);
  textStartPx_.assign(pixels, kNothingPlacedPx);
  for (std::size_t i = 0; i < lengthsPx.size(); ++i) {
    const PxSpan bar = frame.along(i);
    if (!inReach(bar)) continue;
    for (std::int32_t px = bar.from; px < bar.to; ++px) {
      std::int32_t& end = barEndPx_[static_cast<std::size_t>(px - firstPx_)];
      end = std::max(end, lengthsPx[i]);
    }
  }
}

bool BarTextLayout::inReach(PxSpan along) const noexcept {
  return along.from >= firstPx_ &&
         along.to - static_cast<std::int64_t>(firstPx_) <= static_cast<std::int64_t>(keyTaken_.size());
}

bool BarTextLayout::placeKey(const Surroundings& in, std::uint32_t bar, Size size) {
  const Gaps& gaps = gapsOf(in.frame);
  const PxSpan along = centred(in.frame.along(bar), alongOf(in.frame, size));
  if (!inReach(along)) return false;
  const Rect cell = in.frame.rect(along, {-gaps.keyFromBase - outOf(in.frame, size), -gaps.keyFromBase});
  const auto first = keyTaken_.begin() + (along.from - firstPx_);
  if (std::find(first, first + along.length(), 1) != first + along.length()) return false;
  if (!in.around.isFree(cell)) return false;
  const auto before = std::min<std::ptrdiff_t>(gaps.betweenBars, first - keyTaken_.begin());
  const auto last = first + along.length();
  const auto behind = std::min<std::ptrdiff_t>(gaps.betweenBars, keyTaken_.end() - last);
  std::fill(first - before, last + behind, std::uint8_t{1});
  placed_.push_back({cell, bar, 0, false});
  return true;
}

void BarTextLayout::placeQuantities(const Surroundings& in, std::uint32_t bar, std::int32_t lengthPx,
                                    const BarTextSizes& sizes, bool mayStandInside) {
  std::size_t count = 0;
  while (count < BarTextSizes::kQuantities && sizes.quantities[count] != Size{}) ++count;
  for (; count > 0; --count) {
    const Block block{bar, lengthPx, std::span(sizes.quantities).first(count)};
    if (placeOutside(in, block) || (mayStandInside && placeInside(in, block))) return;
  }
}

// Bars come by falling length, so a text that was placed before begins no nearer to the base than this one.
bool BarTextLayout::placeOutside(const Surroundings& in, const Block& block) {
  const Gaps& gaps = gapsOf(in.frame);
  const PxSpan bar = in.frame.along(block.bar);
  std::array<PxSpan, BarTextSizes::kQuantities> spans;
  std::array<PxSpan, BarTextSizes::kQuantities> reaches;
  const std::size_t before = placed_.size();
  std::int32_t out = block.barLengthPx + gaps.textFromEnd;
  for (std::size_t part = 0; part < block.sizes.size(); ++part) {
    const Size size = block.sizes[part];
    const PxSpan along = spans[part] = overBar(in.frame, bar, size);
    const PxSpan reach = reaches[part] = {out, out + outOf(in.frame, size)};
    const Rect cell = in.frame.rect(along, reach);
    bool free = inReach(along) && in.around.isFree(cell);
    for (std::int32_t px = along.from; free && px < along.to; ++px) {
      const auto at = static_cast<std::size_t>(px - firstPx_);
      free = barEndPx_[at] <= reach.from && textStartPx_[at] >= reach.to;
    }
    if (!free) {
      placed_.resize(before);
      return false;
    }
    placed_.push_back({cell, block.bar, static_cast<std::uint32_t>(part + 1), false});
    out = reach.to + gaps.betweenParts;
  }
  for (std::size_t part = 0; part < block.sizes.size(); ++part) {
    const std::int32_t from = std::max(0, spans[part].from - gaps.betweenBars - firstPx_);
    const std::int32_t to = std::min(static_cast<std::int32_t>(textStartPx_.size()),
                                     spans[part].to + gaps.betweenBars - firstPx_);
    for (std::int32_t px = from; px < to; ++px) {
      std::int32_t& start = textStartPx_[static_cast<std::size_t>(px)];
      start = std::min(start, reaches[part].from);
    }
  }
  return true;
}

bool BarTextLayout::placeInside(const Surroundings& in, const Block& block) {
  const Gaps& gaps = gapsOf(in.frame);
  const PxSpan bar = in.frame.along(block.bar);
  std::int32_t total = gaps.betweenParts * (static_cast<std::int32_t>(block.sizes.size()) - 1);
  for (const Size size : block.sizes) {
    const std::int32_t along = alongOf(in.frame, size);
    if (along > bar.length() + gaps.overBar || along > in.frame.slotPx()) return false;
    total += outOf(in.frame, size);
  }
  if (total + 2 * gaps.textFromEnd > block.barLengthPx) return false;
  std::int32_t out = block.barLengthPx - gaps.textFromEnd - total;
  for (std::size_t part = 0; part < block.sizes.size(); ++part) {
    const Size size = block.sizes[part];
    const PxSpan reach{out, out + outOf(in.frame, size)};
    const Rect cell = in.frame.rect(centred(bar, alongOf(in.frame, size)), reach);
    placed_.push_back({cell, block.bar, static_cast<std::uint32_t>(part + 1), true});
    out = reach.to + gaps.betweenParts;
  }
  return true;
}

}  // namespace frontpanels

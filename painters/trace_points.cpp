#include "painters/trace_points.h"

#include <algorithm>

#include "platform/runtime_error.h"

namespace frontpanels {

void TracePoints::begin(std::size_t count) {
  clear();
  if (count > kMaxPoints) raiseSubscriptOutOfRange();
  points_.resize(count);
}

void TracePoints::place(std::int32_t index, Position at, bool continued) {
  if (!fitsInt32(at.xPx) || !fitsInt32(at.yPx)) {
    clear();
    raiseOverflow();
  }
  points_[static_cast<std::size_t>(index)] = {toInt32(at.xPx), toInt32(at.yPx)};
  if (continued) {
    ++stretches_.back().count;
  } else {
    stretches_.push_back({index, 1});
  }
}

const Point* TracePoints::find(std::int32_t index) const noexcept {
  const auto behind =
      std::upper_bound(stretches_.begin(), stretches_.end(), index,
                       [](std::int32_t i, const Stretch& stretch) { return i < stretch.first; });
  if (behind == stretches_.begin()) return nullptr;
  const Stretch& stretch = *(behind - 1);
  return index - stretch.first < stretch.count ? &points_[static_cast<std::size_t>(index)] : nullptr;
}

}  // namespace frontpanels

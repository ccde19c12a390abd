#include "painters/marker_steps.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <optional>

namespace frontpanels {
namespace {

constexpr std::int32_t kTenths = 10;

double at(std::span<const double> values, std::int32_t point) {
  return values[static_cast<std::size_t>(point)];
}

std::int32_t countOf(std::span<const double> values) { return static_cast<std::int32_t>(values.size()); }

// First and last point that have a value.
struct Reach {
  std::int32_t first;
  std::int32_t last;
};
std::optional<Reach> reachOf(std::span<const double> values) {
  Reach reach{0, countOf(values) - 1};
  while (reach.first <= reach.last && !std::isfinite(at(values, reach.first))) ++reach.first;
  while (reach.last > reach.first && !std::isfinite(at(values, reach.last))) --reach.last;
  if (reach.first > reach.last) return std::nullopt;
  return reach;
}

// Of equal values the left one counts as the higher: they are one peak unless a valley parts them.
bool standsOut(std::span<const double> values, std::int32_t point, std::int32_t direction) {
  const double level = at(values, point);
  double valley = level;
  for (std::int32_t i = point + direction; i >= 0 && i < countOf(values); i += direction) {
    const double other = at(values, i);
    if (!std::isfinite(other)) continue;
    if (direction < 0 ? other >= level : other > level) return level - valley >= kPeakExcursionDb;
    valley = std::min(valley, other);
  }
  return true;  // nothing is higher on this side
}

bool isPeak(std::span<const double> values, std::int32_t point) {
  return std::isfinite(at(values, point)) && standsOut(values, point, -1) && standsOut(values, point, +1);
}

// A place in the order of the peaks.
struct Rank {
  double level;
  std::int32_t point;
};
bool precedes(const Rank& one, const Rank& other) {
  return one.level > other.level || (one.level == other.level && one.point < other.point);
}

// A marker in a gap has no level: every peak is lower.
Rank rankOf(std::span<const double> values, std::int32_t from) {
  const double level = from >= 0 && from < countOf(values) ? at(values, from) : std::nan("");
  return {std::isfinite(level) ? level : std::numeric_limits<double>::infinity(), from};
}

}  // namespace

std::int32_t endPoint(std::span<const double> values, std::int32_t from, TraceEnd end) {
  const auto reach = reachOf(values);
  if (!reach) return from;
  return end == TraceEnd::First ? reach->first : reach->last;
}

std::int32_t pointATenthOn(std::span<const double> values, std::int32_t from, Towards side) {
  const auto reach = reachOf(values);
  if (!reach) return from;
  const auto direction = static_cast<std::int32_t>(side);
  const std::int32_t step = std::max(1, countOf(values) / kTenths);
  const std::int32_t start = std::clamp(from, reach->first, reach->last);
  std::int32_t point = std::clamp(start + direction * step, reach->first, reach->last);
  while (!std::isfinite(at(values, point))) point += direction;
  return point;
}

std::int32_t nextPeak(std::span<const double> values, std::int32_t from, PeakOrder order) {
  const Rank marker = rankOf(values, from);
  const auto comesAfter = [order](const Rank& one, const Rank& other) {
    return order == PeakOrder::Lower ? precedes(other, one) : precedes(one, other);
  };
  std::optional<Rank> next;
  for (std::int32_t point = 0; point < countOf(values); ++point) {
    if (!isPeak(values, point)) continue;
    const Rank peak{at(values, point), point};
    if (comesAfter(peak, marker) && (!next || comesAfter(*next, peak))) next = peak;
  }
  return next ? next->point : from;
}

}  // namespace frontpanels

#include "painters/bar_order.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numeric>
#include <utility>

namespace frontpanels {
namespace {

float strength(const HeldBar& bar) noexcept {
  return std::isnan(bar.value) ? -std::numeric_limits<float>::infinity() : bar.value;
}

bool shownLonger(const HeldBar& a, const HeldBar& b) noexcept {
  return a.updates != b.updates ? a.updates > b.updates : strength(a) > strength(b);
}

// Whether `a` belongs before `b` when bars descend.
bool precedes(const HeldBar& a, const HeldBar& b, BarSort by) noexcept {
  switch (by) {
    case BarSort::Arrival:
      return a.item > b.item;
    case BarSort::Value:
      return a.value > b.value;
    case BarSort::Key:
      return a.key > b.key;
    case BarSort::History:
      return shownLonger(a, b);
    case BarSort::Other:
      break;
  }
  return a.other > b.other;
}

void countUp(std::vector<std::uint32_t>& order, std::size_t count) {
  order.resize(count);
  std::iota(order.begin(), order.end(), 0U);
}

// Where no key is missing this is any stable sort. A bar moves only past bars that it precedes, so one whose
// key is no number stays a border that none crosses.
template <class Precedes>
void insertionSort(std::vector<std::uint32_t>& order, Precedes precedes) {
  for (std::size_t i = 1; i < order.size(); ++i) {
    const std::uint32_t moved = order[i];
    std::size_t to = i;
    for (; to > 0 && precedes(moved, order[to - 1]); --to) order[to] = order[to - 1];
    order[to] = moved;
  }
}

}  // namespace

void BarOrder::sort(std::span<HeldBar> bars, BarSort by, bool ascending) {
  countUp(order_, bars.size());
  const bool turned = ascending || by == BarSort::Arrival;  // arrival has one direction
  insertionSort(order_, [&](std::uint32_t a, std::uint32_t b) {
    return turned ? precedes(bars[b], bars[a], by) : precedes(bars[a], bars[b], by);
  });
  arrange(bars);
}

void BarOrder::groupBySets(std::span<HeldBar> bars, std::span<const std::vector<float>> sets) {
  setOf_.resize(bars.size());
  nextOfSet_.assign(sets.size() + 2, 0);
  for (std::size_t i = 0; i < bars.size(); ++i) {
    const auto found = std::find_if(sets.begin(), sets.end(), [&](const std::vector<float>& set) {
      return std::find(set.begin(), set.end(), bars[i].key) != set.end();
    });
    setOf_[i] = static_cast<std::uint32_t>(found - sets.begin());
    ++nextOfSet_[setOf_[i] + 1];
  }
  std::partial_sum(nextOfSet_.begin(), nextOfSet_.end(), nextOfSet_.begin());
  order_.resize(bars.size());
  for (std::uint32_t i = 0; i < bars.size(); ++i) order_[nextOfSet_[setOf_[i]]++] = i;
  arrange(bars);
}

std::span<const std::uint32_t> BarOrder::strongestFirst(std::span<const HeldBar> bars) {
  countUp(order_, bars.size());
  std::sort(order_.begin(), order_.end(), [bars](std::uint32_t a, std::uint32_t b) {
    const float x = strength(bars[a]);
    const float y = strength(bars[b]);
    return x != y ? x > y : a < b;
  });
  return order_;
}

// Puts at each place the bar that `order_` names, along the cycles of the permutation.
void BarOrder::arrange(std::span<HeldBar> bars) noexcept {
  for (std::uint32_t i = 0; i < order_.size(); ++i) {
    std::uint32_t at = i;
    while (order_[at] != i) {
      const std::uint32_t from = order_[at];
      std::swap(bars[at], bars[from]);
      order_[at] = at;
      at = from;
    }
    order_[at] = at;
  }
}

}  // namespace frontpanels

#include "painters/trace_store.h"

#include <algorithm>
#include <utility>

#include "framework/support/numeric.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

void fillSlot(TraceSlot& slot, const TraceFill& fill) {
  slot.pnOffset = fill.pnOffset;
  slot.value = fill.value;
  slot.size = fill.size;
  slot.minMaxCurrent = false;
}

}  // namespace

std::size_t TraceSlot::valueCount() const {
  if (size < 0 || !data.isArray()) return 0;
  return std::min(data.elementCount(), static_cast<std::size_t>(size) + 1);
}

void TraceStore::count(std::int16_t count) {
  if (count < 0) raiseSubscriptOutOfRange();
  while (count_ < count) append({}, std::nullopt);
  while (count_ > count) remove(static_cast<std::int16_t>(count_ - 1));
}

TraceSlot& TraceStore::slot(std::int16_t index) {
  if (index < 0 || static_cast<std::size_t>(index) >= slots_.size()) raiseSubscriptOutOfRange();
  return slots_[static_cast<std::size_t>(index)];
}

const TraceSlot& TraceStore::slot(std::int16_t index) const {
  return const_cast<TraceStore*>(this)->slot(index);
}

std::int16_t TraceStore::findPn(std::int16_t pnOffset) const noexcept {
  std::int16_t found = -1;
  for (std::int16_t i = 0; i < count_; ++i) {
    if (slots_[static_cast<std::size_t>(i)].pnOffset == pnOffset) found = i;
  }
  return found;
}

std::int16_t TraceStore::findTraceId(std::int16_t traceId) const noexcept {
  for (std::int16_t i = 0; i < count_; ++i) {
    if (slots_[static_cast<std::size_t>(i)].traceId == traceId) return i;
  }
  return -1;
}

std::int16_t TraceStore::findMarker(const clsMarker* marker) const noexcept {
  for (std::size_t i = 0; i < slots_.size(); ++i) {
    for (const MarkerPointer& candidate : slots_[i].markers) {
      if (candidate.get() == marker) return static_cast<std::int16_t>(i);
    }
  }
  return -1;
}

std::int16_t TraceStore::append(const TraceFill& fill, std::optional<std::int16_t> traceId) {
  const std::int16_t grown = addInt16(count_, 1);
  const std::int16_t index = count_;
  const std::int16_t id = traceId.value_or(freeTraceId());
  usageOrder_.reserve(usageOrder_.size() + 1);
  if (slots_.size() < static_cast<std::size_t>(grown)) slots_.emplace_back();
  usageOrder_.push_back(id);
  count_ = grown;
  slot(index).traceId = id;
  fillSlot(slot(index), fill);
  return index;
}

std::int16_t TraceStore::refill(std::int16_t index, const TraceFill& fill,
                                std::optional<std::int16_t> traceId) {
  if (index >= count_) raiseSubscriptOutOfRange();
  TraceSlot& refilled = slot(index);
  fillSlot(refilled, fill);
  if (traceId) rename(refilled, *traceId);
  return index;
}

std::int16_t TraceStore::replaceLeastRecentlyUsed(const TraceFill& fill,
                                                  std::optional<std::int16_t> traceId) {
  if (usageOrder_.empty()) raiseSubscriptOutOfRange();
  const std::int16_t index = findTraceId(usageOrder_.front());
  TraceSlot& replaced = slot(index);
  fillSlot(replaced, fill);
  replaced.traceId = traceId.value_or(replaced.traceId);
  replaced.orientation = TraceOrientation::Replaced;
  std::rotate(usageOrder_.begin(), usageOrder_.begin() + 1, usageOrder_.end());
  usageOrder_.back() = replaced.traceId;
  return index;
}

void TraceStore::remove(std::int16_t index) {
  if (index >= count_) raiseSubscriptOutOfRange();
  const TraceSlot& removed = slot(index);
  usageOrder_.erase(std::find(usageOrder_.begin(), usageOrder_.end(), removed.traceId));
  slots_.erase(slots_.begin() + index);
  if (slots_.empty()) slots_.emplace_back();
  --count_;
  for (std::size_t i = static_cast<std::size_t>(index); i < slots_.size(); ++i) {
    for (const MarkerPointer& marker : slots_[i].markers) marker->traceId = static_cast<std::int16_t>(i);
  }
}

void TraceStore::usageOrder(std::vector<std::int16_t> order) {
  if (!std::is_permutation(order.begin(), order.end(), usageOrder_.begin(), usageOrder_.end())) {
    raiseInvalidProcedureCall();
  }
  usageOrder_ = std::move(order);
}

std::int16_t TraceStore::freeTraceId() const noexcept {
  std::int16_t id = 0;
  while (findTraceId(id) != -1) ++id;
  return id;
}

void TraceStore::rename(TraceSlot& slot, std::int16_t traceId) {
  *std::find(usageOrder_.begin(), usageOrder_.end(), slot.traceId) = traceId;
  slot.traceId = traceId;
}

}  // namespace frontpanels

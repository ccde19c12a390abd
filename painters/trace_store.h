// The traces of one painter: a slot each, with what was delivered and what has been worked out from it.
#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <vector>

#include "painters/min_max.h"
#include "painters/trace_points.h"
#include "platform/variant.h"
#include "traces/trace_object.h"

namespace frontpanels {

// Which way a trace's points run over the plot.
enum class TraceOrientation : std::int16_t {
  FromLeft = 0,   // the first point at the left edge
  FromRight = 1,  // the last point at the right edge: a strip chart
  Replaced = 2,   // of a slot that a newer trace has taken over; runs from the left
};

struct TraceSlot {
  Variant data = Variant::null();  // null, empty or an array
  std::int32_t size = 0;           // highest point index
  std::int16_t pnOffset = 0;
  double value = 0;
  std::int16_t traceId = 0;
  TraceOrientation orientation = TraceOrientation::FromLeft;
  MarkerCollection markers;

  bool offsetPending = false;  // the values have come since the offset was last added
  TracePoints points;          // of the last paint
  MinMax minMax;
  bool minMaxCurrent = false;

  // Points 0 to `size` of which there is a value.
  [[nodiscard]] std::size_t valueCount() const;
  // Raises "Subscript out of range", "Type mismatch" or "Invalid use of Null".
  [[nodiscard]] double valueAt(std::size_t point) const { return data.element(point).toDouble(); }
};

// What a trace is filled with; its values follow.
struct TraceFill {
  std::int16_t pnOffset = 0;
  double value = 0;
  std::int32_t size = 0;
};

class TraceStore {
 public:
  [[nodiscard]] std::int16_t count() const noexcept { return count_; }
  // New slots are empty, surplus ones go with their markers. Raises "Subscript out of range" below 0.
  void count(std::int16_t count);

  // The traces there are.
  [[nodiscard]] std::span<TraceSlot> traces() noexcept {
    return std::span(slots_).first(static_cast<std::size_t>(count_));
  }
  [[nodiscard]] std::span<const TraceSlot> traces() const noexcept {
    return std::span(slots_).first(static_cast<std::size_t>(count_));
  }
  // Every slot: the first is there before any trace is, for its markers.
  [[nodiscard]] std::span<TraceSlot> allSlots() noexcept { return slots_; }
  // Raises "Subscript out of range".
  [[nodiscard]] TraceSlot& slot(std::int16_t index);
  [[nodiscard]] const TraceSlot& slot(std::int16_t index) const;

  // -1 when there is none. With duplicates the highest index has the PN and the lowest the trace id.
  [[nodiscard]] std::int16_t findPn(std::int16_t pnOffset) const noexcept;
  [[nodiscard]] std::int16_t findTraceId(std::int16_t traceId) const noexcept;
  [[nodiscard]] std::int16_t findMarker(const clsMarker* marker) const noexcept;

  // Each answers the slot's index. Without a trace id a new trace takes the lowest one that is free and a
  // slot keeps its own. A refilled slot keeps its values until new ones come.
  std::int16_t append(const TraceFill& fill, std::optional<std::int16_t> traceId);
  std::int16_t refill(std::int16_t index, const TraceFill& fill, std::optional<std::int16_t> traceId);
  // Takes over the slot of the least recently used trace id, which becomes the most recently used.
  std::int16_t replaceLeastRecentlyUsed(const TraceFill& fill, std::optional<std::int16_t> traceId);
  void remove(std::int16_t index);

  // Trace ids, the least recently used first.
  [[nodiscard]] const std::vector<std::int16_t>& usageOrder() const noexcept { return usageOrder_; }
  // Raises "Invalid procedure call or argument" for anything but the same ids in another order.
  void usageOrder(std::vector<std::int16_t> order);

 private:
  [[nodiscard]] std::int16_t freeTraceId() const noexcept;
  void rename(TraceSlot& slot, std::int16_t traceId);

  std::vector<TraceSlot> slots_ = std::vector<TraceSlot>(1);
  std::int16_t count_ = 0;
  std::vector<std::int16_t> usageOrder_;
};

}  // namespace frontpanels

// What a graph shows, in words, for those who cannot see it: every trace object, its traces with their
// markers, or its bars, each with its place. Made only when somebody asks.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <utility>
#include <vector>

#include "platform/geometry.h"

namespace frontpanels {

class TraceObject;
class clsMarker;

enum class GraphItemKind : std::uint8_t { Chart, Trace, Marker, Bar };

struct GraphItem {
  GraphItemKind kind{};
  std::string name;   // "Marker 1"
  std::string value;  // "98.1 MHz, -43.2 dBm"
  Rect placePx{};     // of the off-screen surface; empty for what is not seen
  bool selected = false;
  bool visible = true;
  friend bool operator==(const GraphItem&, const GraphItem&) = default;
};

// In reading order. There is an end to what anyone would listen to, whatever a host sends.
class GraphItems {
 public:
  static constexpr std::size_t kMost = 1000;

  void add(GraphItem item) {
    if (items_.size() < kMost) items_.push_back(std::move(item));
  }
  [[nodiscard]] std::vector<GraphItem>& all() noexcept { return items_; }
  [[nodiscard]] const std::vector<GraphItem>& all() const noexcept { return items_; }

 private:
  std::vector<GraphItem> items_;
};

// What changes only when something happens that a user is to hear of, and not with new values alone. The
// pointers are there to be compared.
struct GraphState {
  std::size_t items = 0;
  const TraceObject* activeTrace = nullptr;
  const clsMarker* activeMarker = nullptr;
  std::int32_t point = 0;  // of the active marker
  friend bool operator==(const GraphState&, const GraphState&) = default;
};

// "1 marker", "2 markers"
[[nodiscard]] inline std::string countOf(std::size_t count, const char* thing) {
  return std::to_string(count) + " " + thing + (count == 1 ? "" : "s");
}

}  // namespace frontpanels

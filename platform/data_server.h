// Data servers: a panel subscribes to paths and is told when one of them changes. Everything happens on the
// user-interface thread, at once, inside the publisher's call.
#pragma once

#include <cstdint>
#include <exception>
#include <functional>
#include <map>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "platform/variant.h"

namespace frontpanels {

class DataServer;

// One per process: the host publishes, every server subscribed to the path raises its event.
// The hub must outlive its servers.
class DataHub {
 public:
  DataHub() = default;
  ~DataHub() = default;
  DataHub(const DataHub&) = delete;
  DataHub& operator=(const DataHub&) = delete;

  // A scalar or an array; an empty value takes back what was published. A server that comes inside an event
  // hears the next one, one that goes hears nothing more, and no other misses or repeats an event for it. A
  // publication inside an event of the same path is delivered after the current one, whose values stay until
  // then. What a handler throws reaches the publisher when all servers have heard.
  void publish(std::string_view path, Variant values);
  // The same for a stretch of singles, without an allocation once the path has held as many.
  void publish(std::string_view path, std::span<const float> values);

  // 0 for a path that was never published; 1 for a scalar.
  [[nodiscard]] std::int32_t itemCount(std::string_view path) const;
  // Raises "Subscript out of range".
  [[nodiscard]] Variant value(std::string_view path, std::int32_t index) const;

 private:
  friend class DataServer;
  using DataChanged = std::function<void(std::int32_t index)>;

  struct Subscription {
    const DataServer* server = nullptr;  // null for one that went inside the event
    std::int32_t index = 0;              // of the path among the server's own
    // Shared, so that a server may destroy itself inside its own event.
    std::shared_ptr<const DataChanged> dataChanged;
  };
  struct Path {
    Variant values;
    std::vector<Subscription> subscriptions;
    std::vector<Variant> waiting;  // published inside the event that is being raised
    bool raising = false;
  };
  class Raising;

  Path& pathOf(std::string_view path);
  static void deliver(Path& path);
  static void raise(Path& path, std::exception_ptr& failure);
  static void unsubscribe(Path& path, const DataServer& server) noexcept;
  [[nodiscard]] static std::int32_t itemCount(const Path& path);
  [[nodiscard]] static Variant item(const Path& path, std::int32_t index);

  std::map<std::string, Path, std::less<>> paths_;
};

class DataServer {
 public:
  using DataChanged = DataHub::DataChanged;

  DataServer(DataHub& hub, DataChanged dataChanged);
  ~DataServer();
  DataServer(const DataServer&) = delete;
  DataServer& operator=(const DataServer&) = delete;

  static constexpr char kPathSeparator = '\x1b';
  // The paths, separated by the escape character; their order gives the indices of DataChanged, from 0.
  // Replaces what was subscribed before; an empty text subscribes to nothing.
  void subscribe(std::string_view paths);

  // Raises "Subscript out of range" for an unknown path index.
  [[nodiscard]] std::int32_t itemCount(std::int32_t index) const;
  // Raises "Subscript out of range" for an unknown path index or item.
  [[nodiscard]] Variant value(std::int32_t index, std::int32_t item) const;
  [[nodiscard]] float singleValue(std::int32_t index, std::int32_t item) const;
  // All values of a path in one call when they are singles; empty otherwise. Valid until the path is
  // published again.
  [[nodiscard]] std::span<const float> singles(std::int32_t index) const;

 private:
  void unsubscribe() noexcept;
  [[nodiscard]] const DataHub::Path& path(std::int32_t index) const;

  DataHub& hub_;
  std::shared_ptr<const DataChanged> dataChanged_;
  std::vector<DataHub::Path*> paths_;  // nodes of the hub's map: they stay while the hub lives
};

}  // namespace frontpanels

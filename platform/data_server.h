// Data servers: a panel subscribes to paths and is told when one of them changes. Everything happens on the
// user-interface thread, at once, inside the publisher's call.
#pragma once

#include <cstdint>
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
  // A scalar or an array. A server that comes or goes inside an event neither misses nor repeats an event of
  // another; a publication inside an event of the same path is delivered after the current one.
  void publish(std::string_view path, Variant values);
  // The same for a stretch of singles, without an allocation once the path has held as many.
  void publish(std::string_view path, std::span<const float> values);

  // 0 for a path that was never published; 1 for a scalar.
  [[nodiscard]] std::int32_t itemCount(std::string_view path) const;
  // Raises "Subscript out of range".
  [[nodiscard]] Variant value(std::string_view path, std::int32_t index) const;

 private:
  friend class DataServer;
  struct Path {
    Variant values;
    std::vector<DataServer*> subscribers;
    bool publishing = false;
  };

  Path& subscribe(std::string_view path, DataServer& server);
  void unsubscribe(DataServer& server) noexcept;
  void raise(const std::string& path);

  std::map<std::string, Path, std::less<>> paths_;
};

class DataServer {
 public:
  using DataChanged = std::function<void(std::int32_t index)>;

  DataServer(DataHub& hub, DataChanged dataChanged);
  ~DataServer();
  DataServer(const DataServer&) = delete;
  DataServer& operator=(const DataServer&) = delete;

  static constexpr char kPathSeparator = '\x1b';
  // The paths, separated by the escape character; their order gives the indices of DataChanged, from 0.
  // Replaces what was subscribed before.
  void subscribe(std::string_view paths);

  [[nodiscard]] std::int32_t itemCount(std::int32_t index) const;
  // Raises "Subscript out of range" for an unknown path index or item.
  [[nodiscard]] Variant value(std::int32_t index, std::int32_t item) const;
  [[nodiscard]] float singleValue(std::int32_t index, std::int32_t item) const;
  // All values of a path in one call when they are singles; empty otherwise. Valid until the path is
  // published again.
  [[nodiscard]] std::span<const float> singles(std::int32_t index) const;

 private:
  friend class DataHub;
  struct Subscription;

  DataHub& hub_;
  DataChanged dataChanged_;
  std::vector<const std::string*> paths_;  // keys of the hub's map: stable while the hub lives
};

}  // namespace frontpanels

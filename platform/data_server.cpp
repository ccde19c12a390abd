#include "platform/data_server.h"

#include <algorithm>
#include <utility>

#include "platform/runtime_error.h"

namespace frontpanels {

// While a path's event is raised, its subscriptions only grow; what went meanwhile is swept out at the end.
class DataHub::Raising {
 public:
  explicit Raising(Path& path) : path_(path) { path_.raising = true; }
  ~Raising() {
    path_.raising = false;
    path_.waiting.clear();
    std::erase_if(path_.subscriptions, [](const Subscription& one) { return one.server == nullptr; });
  }
  Raising(const Raising&) = delete;
  Raising& operator=(const Raising&) = delete;

 private:
  Path& path_;
};

void DataHub::publish(std::string_view path, Variant values) {
  Path& known = pathOf(path);
  if (known.raising) {
    known.waiting.push_back(std::move(values));
    return;
  }
  known.values = std::move(values);
  deliver(known);
}

void DataHub::publish(std::string_view path, std::span<const float> values) {
  Path& known = pathOf(path);
  auto* singles = std::get_if<Variant::Singles>(&known.values.value());
  if (known.raising || singles == nullptr)
    return publish(path, Variant(Variant::Singles(values.begin(), values.end())));
  singles->assign(values.begin(), values.end());
  deliver(known);
}

std::int32_t DataHub::itemCount(std::string_view path) const {
  const auto found = paths_.find(path);
  return found == paths_.end() ? 0 : itemCount(found->second);
}

Variant DataHub::value(std::string_view path, std::int32_t index) const {
  const auto found = paths_.find(path);
  if (found == paths_.end()) raiseSubscriptOutOfRange();
  return item(found->second, index);
}

DataHub::Path& DataHub::pathOf(std::string_view path) {
  const auto found = paths_.find(path);
  return found != paths_.end() ? found->second : paths_[std::string(path)];
}

void DataHub::deliver(Path& path) {
  std::exception_ptr failure;
  {
    const Raising raising(path);
    raise(path, failure);
    for (std::size_t next = 0; next < path.waiting.size(); ++next) {
      path.values = std::move(path.waiting[next]);
      raise(path, failure);
    }
  }
  if (failure) std::rethrow_exception(failure);
}

void DataHub::raise(Path& path, std::exception_ptr& failure) {
  const std::size_t count = path.subscriptions.size();
  for (std::size_t i = 0; i < count; ++i) {
    const Subscription one = path.subscriptions[i];  // a copy: the handler may change the list
    if (one.server == nullptr) continue;
    try {
      (*one.dataChanged)(one.index);
    } catch (...) {
      if (!failure) failure = std::current_exception();
    }
  }
}

void DataHub::unsubscribe(Path& path, const DataServer& server) noexcept {
  for (Subscription& one : path.subscriptions)
    if (one.server == &server) one = {};
  if (!path.raising)
    std::erase_if(path.subscriptions, [](const Subscription& one) { return one.server == nullptr; });
}

std::int32_t DataHub::itemCount(const Path& path) {
  if (path.values.isEmpty()) return 0;
  return path.values.isArray() ? static_cast<std::int32_t>(path.values.elementCount()) : 1;
}

Variant DataHub::item(const Path& path, std::int32_t index) {
  if (index < 0 || index >= itemCount(path)) raiseSubscriptOutOfRange();
  return path.values.isArray() ? path.values.element(static_cast<std::size_t>(index)) : path.values;
}

DataServer::DataServer(DataHub& hub, DataChanged dataChanged)
    : hub_(hub), dataChanged_(std::make_shared<const DataChanged>(std::move(dataChanged))) {}

DataServer::~DataServer() { unsubscribe(); }

void DataServer::subscribe(std::string_view paths) {
  unsubscribe();
  while (!paths.empty()) {
    const std::size_t end = std::min(paths.find(kPathSeparator), paths.size());
    DataHub::Path& path = hub_.pathOf(paths.substr(0, end));
    const auto index = static_cast<std::int32_t>(paths_.size());
    paths_.push_back(&path);
    path.subscriptions.push_back({this, index, dataChanged_});
    paths.remove_prefix(std::min(end + 1, paths.size()));
  }
}

void DataServer::unsubscribe() noexcept {
  for (DataHub::Path* path : paths_) DataHub::unsubscribe(*path, *this);
  paths_.clear();
}

std::int32_t DataServer::itemCount(std::int32_t index) const { return DataHub::itemCount(path(index)); }

Variant DataServer::value(std::int32_t index, std::int32_t item) const {
  return DataHub::item(path(index), item);
}

float DataServer::singleValue(std::int32_t index, std::int32_t item) const {
  const std::span<const float> all = singles(index);
  if (item >= 0 && static_cast<std::size_t>(item) < all.size()) return all[static_cast<std::size_t>(item)];
  return value(index, item).toSingle();
}

std::span<const float> DataServer::singles(std::int32_t index) const {
  const auto* values = std::get_if<Variant::Singles>(&path(index).values.value());
  return values == nullptr ? std::span<const float>() : std::span<const float>(*values);
}

const DataHub::Path& DataServer::path(std::int32_t index) const {
  if (index < 0 || static_cast<std::size_t>(index) >= paths_.size()) raiseSubscriptOutOfRange();
  return *paths_[static_cast<std::size_t>(index)];
}

}  // namespace frontpanels

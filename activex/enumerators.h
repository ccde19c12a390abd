// Enumerators over a fixed list of items: one template for the lists that containers walk.
#pragma once

#include <ocidl.h>

#include <algorithm>
#include <atomic>
#include <utility>
#include <vector>

#include "activex/barrier.h"
#include "activex/module.h"
#include "platform/win32/com_pointer.h"

namespace frontpanels::activex {

// `Traits` gives the item as kept and how one is handed out with a reference of the caller's own.
template <class Interface, class Traits>
class Enumerator final : public Interface {
 public:
  using Item = typename Traits::Item;
  using Handed = typename Traits::Handed;

  explicit Enumerator(std::vector<Item> items, std::size_t next = 0)
      : items_(std::move(items)), next_(next) {}
  virtual ~Enumerator() = default;

  HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override {
    if (object == nullptr) return E_POINTER;
    *object = id == IID_IUnknown || id == __uuidof(Interface) ? this : nullptr;
    if (*object == nullptr) return E_NOINTERFACE;
    AddRef();
    return S_OK;
  }
  ULONG STDMETHODCALLTYPE AddRef() override { return ++references_; }
  ULONG STDMETHODCALLTYPE Release() override {
    const ULONG left = --references_;
    if (left == 0) delete this;
    return left;
  }
  HRESULT STDMETHODCALLTYPE Next(ULONG count, Handed* items, ULONG* fetched) override {
    if (items == nullptr || (fetched == nullptr && count != 1)) return E_POINTER;
    ULONG given = 0;
    for (; given < count && next_ < items_.size(); ++given) items[given] = Traits::hand(items_[next_++]);
    if (fetched != nullptr) *fetched = given;
    return given == count ? S_OK : S_FALSE;
  }
  HRESULT STDMETHODCALLTYPE Skip(ULONG count) override {
    const std::size_t left = items_.size() - next_;
    next_ += std::min<std::size_t>(count, left);
    return count <= left ? S_OK : S_FALSE;
  }
  HRESULT STDMETHODCALLTYPE Reset() override {
    next_ = 0;
    return S_OK;
  }
  HRESULT STDMETHODCALLTYPE Clone(Interface** copy) override {
    if (copy == nullptr) return E_POINTER;
    *copy = nullptr;
    return barrier([&] { *copy = new Enumerator(items_, next_); });
  }

 private:
  ModuleLock lock_;
  std::atomic<ULONG> references_ = 1;
  std::vector<Item> items_;
  std::size_t next_;
};

struct ConnectionPointTraits {
  using Item = ComPointer<IConnectionPoint>;
  using Handed = IConnectionPoint*;
  static Handed hand(const Item& item) { return ComPointer<IConnectionPoint>(item).detach(); }
};
using ConnectionPointEnumerator = Enumerator<IEnumConnectionPoints, ConnectionPointTraits>;

struct ConnectionItem {
  ComPointer<IUnknown> sink;
  DWORD cookie = 0;
};
struct ConnectionTraits {
  using Item = ConnectionItem;
  using Handed = CONNECTDATA;
  static Handed hand(const Item& item) { return {ComPointer<IUnknown>(item.sink).detach(), item.cookie}; }
};
using ConnectionEnumerator = Enumerator<IEnumConnections, ConnectionTraits>;

}  // namespace frontpanels::activex

// Base of the library's objects: a reference count behind an inner identity, so that a host's form may make
// the object part of one of its own (aggregation), and the module's lock while the object lives.
#pragma once

#include <unknwn.h>

#include <atomic>

#include "activex/module.h"

namespace frontpanels::activex {

class Aggregable {
 public:
  // A null outer object means that this one stands for itself.
  explicit Aggregable(IUnknown* outer) noexcept : inner_(*this), outer_(outer != nullptr ? outer : &inner_) {}
  virtual ~Aggregable() = default;
  Aggregable(const Aggregable&) = delete;
  Aggregable& operator=(const Aggregable&) = delete;

  // The object's own count and identity, whoever stands outside.
  [[nodiscard]] IUnknown* inner() noexcept { return &inner_; }
  // Whose identity the object shows.
  [[nodiscard]] IUnknown* outer() const noexcept { return outer_; }

 protected:
  // The pointer that answers for an interface, without a reference; null for one that the object lacks.
  [[nodiscard]] virtual void* findInterface(REFIID id) noexcept = 0;
  // Called once, before the destruction begins: the object is still whole and may call out.
  virtual void lastRelease() noexcept {}

 private:
  class Inner final : public IUnknown {
   public:
    explicit Inner(Aggregable& owner) noexcept : owner_(owner) {}
    HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override;
    ULONG STDMETHODCALLTYPE AddRef() override { return ++references_; }
    ULONG STDMETHODCALLTYPE Release() override;

   private:
    Aggregable& owner_;
    std::atomic<ULONG> references_ = 1;
  };

  ModuleLock lock_;
  Inner inner_;
  IUnknown* outer_;
};

// The three base methods of an object with several interfaces: they all ask whoever shows its identity.
template <class... Interfaces>
class Delegating : public Aggregable, public Interfaces... {
 public:
  using Aggregable::Aggregable;
  HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override {
    return outer()->QueryInterface(id, object);
  }
  ULONG STDMETHODCALLTYPE AddRef() override { return outer()->AddRef(); }
  ULONG STDMETHODCALLTYPE Release() override { return outer()->Release(); }
};

}  // namespace frontpanels::activex

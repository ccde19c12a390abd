// Objects for late binding that one table describes: each member by its name, in any letter case. They are
// not in the type library; what they offer is found by name alone.
#pragma once

#include <oaidl.h>

#include <span>

#include "platform/variant.h"

namespace frontpanels::activex {

// A member of objects of type `Self`: a property that reads and writes, or a method.
template <class Self>
struct NamedMember {
  const wchar_t* name;
  Variant (*get)(Self& self, std::span<const Variant> arguments);  // a method is one whose value is empty
  void (*put)(Self& self, const Variant& value);                   // null for what only reads
  UINT argumentCount = 0;                                          // of `get`
};

// The parts of IDispatch that do not depend on what is called.
class NamedDispatch : public IDispatch {
 public:
  NamedDispatch() = default;
  virtual ~NamedDispatch() = default;
  NamedDispatch(const NamedDispatch&) = delete;
  NamedDispatch& operator=(const NamedDispatch&) = delete;

  HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override;
  HRESULT STDMETHODCALLTYPE GetTypeInfoCount(UINT* count) override;
  HRESULT STDMETHODCALLTYPE GetTypeInfo(UINT index, LCID locale, ITypeInfo** info) override;
  HRESULT STDMETHODCALLTYPE GetIDsOfNames(REFIID reserved, LPOLESTR* names, UINT count, LCID locale,
                                          DISPID* ids) override;
  HRESULT STDMETHODCALLTYPE Invoke(DISPID member, REFIID reserved, LCID locale, WORD flags,
                                   DISPPARAMS* parameters, VARIANT* result, EXCEPINFO* exception,
                                   UINT* badArgument) override;

 protected:
  // Members are numbered from 1; null beyond the last.
  [[nodiscard]] virtual const wchar_t* nameOf(DISPID member) const noexcept = 0;
  [[nodiscard]] virtual bool writable(DISPID member) const noexcept = 0;
  [[nodiscard]] virtual UINT argumentCount(DISPID member) const noexcept = 0;
  virtual Variant get(DISPID member, std::span<const Variant> arguments) = 0;
  virtual void put(DISPID member, const Variant& value) = 0;
};

template <class Self>
class NamedObject : public NamedDispatch {
 public:
  explicit NamedObject(std::span<const NamedMember<Self>> members) noexcept : members_(members) {}

 protected:
  [[nodiscard]] virtual Self& self() = 0;

  const wchar_t* nameOf(DISPID member) const noexcept override {
    const auto count = static_cast<DISPID>(members_.size());
    return member >= 1 && member <= count ? row(member).name : nullptr;
  }
  bool writable(DISPID member) const noexcept override { return row(member).put != nullptr; }
  UINT argumentCount(DISPID member) const noexcept override { return row(member).argumentCount; }
  Variant get(DISPID member, std::span<const Variant> arguments) override {
    return row(member).get(self(), arguments);
  }
  void put(DISPID member, const Variant& value) override { row(member).put(self(), value); }

 private:
  [[nodiscard]] const NamedMember<Self>& row(DISPID member) const noexcept {
    return members_[static_cast<std::size_t>(member - 1)];
  }

  std::span<const NamedMember<Self>> members_;
};

}  // namespace frontpanels::activex

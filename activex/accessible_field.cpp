#include "activex/accessible_field.h"

#include <utility>

#include "activex/variants.h"

namespace frontpanels::activex {
namespace {

class AccessibleField final : public AccessibleBase {
 public:
  AccessibleField(HWND window, ComPointer<IAccessible> standard, FieldWords words)
      : window_(window),
        standard_(std::move(standard)),
        children_(standard_.query<IEnumVARIANT>()),
        words_(std::move(words)) {}

  // IAccessible
  HRESULT STDMETHODCALLTYPE get_accName(VARIANT child, BSTR* name) override {
    if (childOf(child) != CHILDID_SELF) return standard_->get_accName(child, name);
    return give(name, words_.name);
  }
  HRESULT STDMETHODCALLTYPE get_accKeyboardShortcut(VARIANT child, BSTR* keys) override {
    if (childOf(child) != CHILDID_SELF || words_.shortcut.empty())
      return standard_->get_accKeyboardShortcut(child, keys);
    return give(keys, words_.shortcut);
  }
  HRESULT STDMETHODCALLTYPE get_accParent(IDispatch** parent) override {
    return standard_->get_accParent(parent);
  }
  HRESULT STDMETHODCALLTYPE get_accChildCount(LONG* count) override {
    return standard_->get_accChildCount(count);
  }
  HRESULT STDMETHODCALLTYPE get_accChild(VARIANT child, IDispatch** object) override {
    return standard_->get_accChild(child, object);
  }
  HRESULT STDMETHODCALLTYPE get_accValue(VARIANT child, BSTR* value) override {
    return standard_->get_accValue(child, value);
  }
  HRESULT STDMETHODCALLTYPE get_accDescription(VARIANT child, BSTR* text) override {
    return standard_->get_accDescription(child, text);
  }
  HRESULT STDMETHODCALLTYPE get_accRole(VARIANT child, VARIANT* role) override {
    return standard_->get_accRole(child, role);
  }
  HRESULT STDMETHODCALLTYPE get_accState(VARIANT child, VARIANT* state) override {
    return standard_->get_accState(child, state);
  }
  HRESULT STDMETHODCALLTYPE get_accFocus(VARIANT* child) override { return standard_->get_accFocus(child); }
  HRESULT STDMETHODCALLTYPE get_accSelection(VARIANT* children) override {
    return standard_->get_accSelection(children);
  }
  HRESULT STDMETHODCALLTYPE get_accDefaultAction(VARIANT child, BSTR* action) override {
    return standard_->get_accDefaultAction(child, action);
  }
  HRESULT STDMETHODCALLTYPE accSelect(LONG flags, VARIANT child) override {
    return standard_->accSelect(flags, child);
  }
  HRESULT STDMETHODCALLTYPE accLocation(LONG* left, LONG* top, LONG* width, LONG* height,
                                        VARIANT child) override {
    return standard_->accLocation(left, top, width, height, child);
  }
  HRESULT STDMETHODCALLTYPE accNavigate(LONG direction, VARIANT start, VARIANT* end) override {
    return standard_->accNavigate(direction, start, end);
  }
  HRESULT STDMETHODCALLTYPE accHitTest(LONG x, LONG y, VARIANT* child) override {
    return standard_->accHitTest(x, y, child);
  }
  HRESULT STDMETHODCALLTYPE accDoDefaultAction(VARIANT child) override {
    return standard_->accDoDefaultAction(child);
  }
  // IEnumVARIANT
  HRESULT STDMETHODCALLTYPE Next(ULONG count, VARIANT* items, ULONG* fetched) override {
    return children_->Next(count, items, fetched);
  }
  HRESULT STDMETHODCALLTYPE Skip(ULONG count) override { return children_->Skip(count); }
  HRESULT STDMETHODCALLTYPE Reset() override { return children_->Reset(); }
  HRESULT STDMETHODCALLTYPE Clone(IEnumVARIANT** copy) override { return children_->Clone(copy); }
  // IOleWindow
  HRESULT STDMETHODCALLTYPE GetWindow(HWND* window) override {
    if (window == nullptr) return E_POINTER;
    *window = window_;
    return S_OK;
  }

 private:
  bool enumerates() const noexcept override { return static_cast<bool>(children_); }

  HRESULT give(BSTR* text, const std::string& words) {
    if (text == nullptr) return E_POINTER;
    *text = nullptr;
    if (IsWindow(window_) == FALSE) return CO_E_OBJNOTCONNECTED;
    return barrier([&] { *text = toBstr(words); });
  }

  HWND window_;
  ComPointer<IAccessible> standard_;
  ComPointer<IEnumVARIANT> children_;
  const FieldWords words_;
};

}  // namespace

LRESULT accessibleField(HWND window, WPARAM flags, FieldWords words) {
  ComPointer<IAccessible> standard;
  if (FAILED(CreateStdAccessibleObject(window, OBJID_CLIENT, __uuidof(IAccessible),
                                       reinterpret_cast<void**>(standard.receive()))))
    return 0;
  const auto field =
      ComPointer<AccessibleField>::adopt(new AccessibleField(window, std::move(standard), std::move(words)));
  return handedOut(*field.get(), flags);
}

}  // namespace frontpanels::activex

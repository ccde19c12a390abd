// The graph as it is read aloud. Its children are what it shows, as simple elements that count from 1 in
// reading order, and behind them the windows that stand in it: the areas with the fields. It may outlive the
// panel; every member then answers CO_E_OBJNOTCONNECTED.
#pragma once

#include <string>
#include <vector>

#include "activex/accessible_base.h"
#include "traces/graph_items.h"

namespace frontpanels::activex {

// The panel as such an object asks it. None of its windows is made or destroyed by an answer.
class GraphTeller {
 public:
  virtual ~GraphTeller() = default;

  [[nodiscard]] virtual HWND window() = 0;
  [[nodiscard]] virtual std::string title() = 0;
  // Places are pixels of the window. Valid until the next paint.
  [[nodiscard]] virtual const std::vector<GraphItem>& items() = 0;
  // Keeps the control alive while it answers.
  virtual void hold() noexcept = 0;
  virtual void letGo() noexcept = 0;
};

// The number of the innermost item that is selected, by which screen readers follow; CHILDID_SELF for none.
[[nodiscard]] LONG followedItem(const std::vector<GraphItem>& items) noexcept;

class AccessibleGraph final : public AccessibleBase {
 public:
  explicit AccessibleGraph(GraphTeller& teller) : teller_(&teller) {}
  // The window has gone.
  void disconnect() noexcept { teller_ = nullptr; }

  // IAccessible
  HRESULT STDMETHODCALLTYPE get_accParent(IDispatch** parent) override;
  HRESULT STDMETHODCALLTYPE get_accChildCount(LONG* count) override;
  HRESULT STDMETHODCALLTYPE get_accChild(VARIANT child, IDispatch** object) override;
  HRESULT STDMETHODCALLTYPE get_accName(VARIANT child, BSTR* name) override;
  HRESULT STDMETHODCALLTYPE get_accValue(VARIANT child, BSTR* value) override;
  HRESULT STDMETHODCALLTYPE get_accDescription(VARIANT child, BSTR* text) override;
  HRESULT STDMETHODCALLTYPE get_accRole(VARIANT child, VARIANT* role) override;
  HRESULT STDMETHODCALLTYPE get_accState(VARIANT child, VARIANT* state) override;
  HRESULT STDMETHODCALLTYPE get_accKeyboardShortcut(VARIANT child, BSTR* keys) override;
  HRESULT STDMETHODCALLTYPE get_accFocus(VARIANT* child) override;
  HRESULT STDMETHODCALLTYPE get_accSelection(VARIANT* children) override;
  HRESULT STDMETHODCALLTYPE get_accDefaultAction(VARIANT child, BSTR* action) override;
  // The graph can take the focus; markers are chosen with the graph's own keys.
  HRESULT STDMETHODCALLTYPE accSelect(LONG flags, VARIANT child) override;
  // In pixels of the screen; all 0 for what is not seen.
  HRESULT STDMETHODCALLTYPE accLocation(LONG* left, LONG* top, LONG* width, LONG* height,
                                        VARIANT child) override;
  HRESULT STDMETHODCALLTYPE accNavigate(LONG direction, VARIANT start, VARIANT* end) override;
  HRESULT STDMETHODCALLTYPE accHitTest(LONG x, LONG y, VARIANT* child) override;
  HRESULT STDMETHODCALLTYPE accDoDefaultAction(VARIANT child) override;
  // IEnumVARIANT
  HRESULT STDMETHODCALLTYPE Next(ULONG count, VARIANT* items, ULONG* fetched) override;
  HRESULT STDMETHODCALLTYPE Skip(ULONG count) override;
  HRESULT STDMETHODCALLTYPE Reset() override;
  HRESULT STDMETHODCALLTYPE Clone(IEnumVARIANT** copy) override;
  // IOleWindow
  HRESULT STDMETHODCALLTYPE GetWindow(HWND* window) override;

 private:
  // Who answers for a child: the graph itself, an item, or a window.
  struct Child {
    const GraphItem* item = nullptr;
    HWND window = nullptr;
    [[nodiscard]] bool self() const noexcept { return item == nullptr && window == nullptr; }
  };

  // Runs `body(teller)` while there is a panel to ask, and keeps that alive.
  template <class Body>
  HRESULT ask(Body body);
  // Raises E_INVALIDARG for a number that no child has.
  [[nodiscard]] static Child find(GraphTeller& teller, const VARIANT& child);
  // A text of a child: the graph's own, an item's, or what its window answers.
  template <class Own, class Foreign>
  HRESULT giveText(const VARIANT& child, BSTR* text, Own own, Foreign foreign);

  GraphTeller* teller_;
  LONG next_ = 0;  // of the enumeration, in children
};

}  // namespace frontpanels::activex

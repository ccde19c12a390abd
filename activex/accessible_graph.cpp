#include "activex/accessible_graph.h"

#include <algorithm>
#include <optional>
#include <utility>

#include "activex/enumerators.h"
#include "activex/variants.h"

namespace frontpanels::activex {
namespace {

// In the order of GraphItemKind. Of items that lie on each other the one of the highest rank is meant.
struct KindFacets {
  LONG role;
  LONG state;
  int rank;
};
constexpr KindFacets kKinds[] = {
    {ROLE_SYSTEM_CHART, STATE_SYSTEM_READONLY | STATE_SYSTEM_SELECTABLE, 0},
    {ROLE_SYSTEM_GRAPHIC, STATE_SYSTEM_READONLY | STATE_SYSTEM_SELECTABLE, 1},
    {ROLE_SYSTEM_INDICATOR, STATE_SYSTEM_SELECTABLE, 3},
    {ROLE_SYSTEM_GRAPHIC, STATE_SYSTEM_READONLY, 2},
};
const KindFacets& facetsOf(const GraphItem& item) { return kKinds[static_cast<std::size_t>(item.kind)]; }

class Held {
 public:
  explicit Held(GraphTeller& teller) noexcept : teller_(teller) { teller_.hold(); }
  ~Held() { teller_.letGo(); }
  Held(const Held&) = delete;
  Held& operator=(const Held&) = delete;

 private:
  GraphTeller& teller_;
};

std::vector<HWND> windowsIn(HWND parent) {
  std::vector<HWND> windows;
  for (HWND child = GetWindow(parent, GW_CHILD); child != nullptr; child = GetWindow(child, GW_HWNDNEXT))
    windows.push_back(child);
  return windows;
}

ComPointer<IAccessible> accessibleOf(HWND window) {
  ComPointer<IAccessible> object;
  check(AccessibleObjectFromWindow(window, static_cast<DWORD>(OBJID_WINDOW), __uuidof(IAccessible),
                                   reinterpret_cast<void**>(object.receive())));
  return object;
}

// What the system says of a window that has no words of its own.
ComPointer<IAccessible> standardOf(HWND window) {
  ComPointer<IAccessible> object;
  check(CreateStdAccessibleObject(window, OBJID_CLIENT, __uuidof(IAccessible),
                                  reinterpret_cast<void**>(object.receive())));
  return object;
}

VARIANT self() {
  VARIANT child;
  V_VT(&child) = VT_I4;
  V_I4(&child) = CHILDID_SELF;
  return child;
}

VARIANT numbered(LONG number) {
  VARIANT child = self();
  V_I4(&child) = number;
  return child;
}

VARIANT windowChild(HWND window) {
  VARIANT child;
  V_VT(&child) = VT_DISPATCH;
  V_DISPATCH(&child) = accessibleOf(window).detach();
  return child;
}

LONG countOfChildren(GraphTeller& teller) {
  return static_cast<LONG>(teller.items().size() + windowsIn(teller.window()).size());
}

VARIANT childAt(GraphTeller& teller, LONG number) {
  const auto items = static_cast<LONG>(teller.items().size());
  if (number <= items) return numbered(number);
  return windowChild(windowsIn(teller.window()).at(static_cast<std::size_t>(number - items - 1)));
}

// The window directly in the graph that a window lies in; null for the graph itself and for others.
HWND childRound(HWND graph, HWND window) {
  while (window != nullptr && GetParent(window) != graph) window = GetParent(window);
  return window;
}

// In a line: "Spectrum: 1 trace, 2 markers".
std::string summary(const std::vector<GraphItem>& items) {
  std::string text;
  for (const GraphItem& item : items)
    if (item.kind == GraphItemKind::Chart)
      text.append(text.empty() ? "" : "; ").append(item.name).append(": ").append(item.value);
  return text.empty() ? "nothing" : text;
}

LONG stateOf(HWND window) {
  const bool focused = GetFocus() == window;
  return STATE_SYSTEM_FOCUSABLE | (focused ? STATE_SYSTEM_FOCUSED : 0) |
         (IsWindowVisible(window) != FALSE ? 0 : STATE_SYSTEM_INVISIBLE) |
         (IsWindowEnabled(window) != FALSE ? 0 : STATE_SYSTEM_UNAVAILABLE);
}

// Enumerations apart from the object's own.
struct ChildTraits {
  struct Item {
    ComPointer<IAccessible> graph;
    LONG number = 0;
  };
  using Handed = VARIANT;
  // A window's number is given as its object. A child that has gone meanwhile keeps its number.
  static Handed hand(const Item& item) {
    VARIANT child = numbered(item.number);
    IDispatch* object = nullptr;
    if (item.graph->get_accChild(child, &object) == S_OK && object != nullptr) {
      V_VT(&child) = VT_DISPATCH;
      V_DISPATCH(&child) = object;
    }
    return child;
  }
};
using Children = Enumerator<IEnumVARIANT, ChildTraits>;

std::vector<ChildTraits::Item> childrenOf(AccessibleGraph& graph, const std::vector<LONG>& numbers) {
  std::vector<ChildTraits::Item> items;
  for (const LONG number : numbers) items.push_back({ComPointer<IAccessible>(&graph), number});
  return items;
}

std::vector<LONG> selectedNumbers(const std::vector<GraphItem>& items) {
  std::vector<LONG> numbers;
  for (std::size_t i = 0; i < items.size(); ++i)
    if (items[i].selected) numbers.push_back(static_cast<LONG>(i) + 1);
  return numbers;
}

}  // namespace

LONG followedItem(const std::vector<GraphItem>& items) noexcept {
  LONG followed = CHILDID_SELF;
  int rank = -1;
  for (std::size_t i = 0; i < items.size(); ++i) {
    if (!items[i].selected || facetsOf(items[i]).rank <= rank) continue;
    followed = static_cast<LONG>(i) + 1;
    rank = facetsOf(items[i]).rank;
  }
  return followed;
}

template <class Body>
HRESULT AccessibleGraph::ask(Body body) {
  GraphTeller* const teller = teller_;
  if (teller == nullptr || teller->window() == nullptr) return CO_E_OBJNOTCONNECTED;
  const ComPointer<IAccessible> alive(this);
  const Held held(*teller);
  return barrier([&]() -> HRESULT { return body(*teller); });
}

AccessibleGraph::Child AccessibleGraph::find(GraphTeller& teller, const VARIANT& child) {
  const LONG number = childOf(child);
  const std::vector<GraphItem>& items = teller.items();
  const auto count = static_cast<LONG>(items.size());
  if (number == CHILDID_SELF) return {};
  if (number > 0 && number <= count) return {&items[static_cast<std::size_t>(number) - 1], nullptr};
  const std::vector<HWND> windows = windowsIn(teller.window());
  const auto index = static_cast<std::size_t>(number - count - 1);
  if (number < 0 || index >= windows.size()) throw ComFailure(E_INVALIDARG);
  return {nullptr, windows[index]};
}

template <class Own, class Foreign>
HRESULT AccessibleGraph::giveText(const VARIANT& child, BSTR* text, Own own, Foreign foreign) {
  if (text == nullptr) return E_POINTER;
  *text = nullptr;
  return ask([&](GraphTeller& teller) -> HRESULT {
    const Child found = find(teller, child);
    if (found.window != nullptr) return (accessibleOf(found.window).get()->*foreign)(self(), text);
    const std::optional<std::string> words = own(teller, found.item);
    if (!words) return DISP_E_MEMBERNOTFOUND;
    *text = toBstr(*words);
    return S_OK;
  });
}

// --- Words

HRESULT AccessibleGraph::get_accName(VARIANT child, BSTR* name) {
  const auto own = [](GraphTeller& teller, const GraphItem* item) -> std::optional<std::string> {
    return item == nullptr ? teller.title() : item->name;
  };
  return giveText(child, name, own, &IAccessible::get_accName);
}

HRESULT AccessibleGraph::get_accValue(VARIANT child, BSTR* value) {
  const auto own = [](GraphTeller& teller, const GraphItem* item) -> std::optional<std::string> {
    return item == nullptr ? summary(teller.items()) : item->value;
  };
  return giveText(child, value, own, &IAccessible::get_accValue);
}

HRESULT AccessibleGraph::get_accDescription(VARIANT child, BSTR* text) {
  const auto own = [](GraphTeller& teller, const GraphItem* item) -> std::optional<std::string> {
    if (item != nullptr) return std::nullopt;
    return summary(teller.items());
  };
  return giveText(child, text, own, &IAccessible::get_accDescription);
}

HRESULT AccessibleGraph::get_accKeyboardShortcut(VARIANT child, BSTR* keys) {
  const auto none = [](GraphTeller&, const GraphItem*) { return std::optional<std::string>(); };
  return giveText(child, keys, none, &IAccessible::get_accKeyboardShortcut);
}

HRESULT AccessibleGraph::get_accDefaultAction(VARIANT child, BSTR* action) {
  const auto none = [](GraphTeller&, const GraphItem*) { return std::optional<std::string>(); };
  return giveText(child, action, none, &IAccessible::get_accDefaultAction);
}

HRESULT AccessibleGraph::get_accRole(VARIANT child, VARIANT* role) {
  if (role == nullptr) return E_POINTER;
  VariantInit(role);
  return ask([&](GraphTeller& teller) -> HRESULT {
    const Child found = find(teller, child);
    if (found.window != nullptr) return accessibleOf(found.window)->get_accRole(self(), role);
    *role = numbered(found.self() ? ROLE_SYSTEM_CHART : facetsOf(*found.item).role);
    return S_OK;
  });
}

HRESULT AccessibleGraph::get_accState(VARIANT child, VARIANT* state) {
  if (state == nullptr) return E_POINTER;
  VariantInit(state);
  return ask([&](GraphTeller& teller) -> HRESULT {
    const Child found = find(teller, child);
    if (found.window != nullptr) return accessibleOf(found.window)->get_accState(self(), state);
    LONG flags = stateOf(teller.window());
    if (!found.self()) {
      const GraphItem& item = *found.item;
      const bool followed = followedItem(teller.items()) == childOf(child);
      flags = (flags & STATE_SYSTEM_INVISIBLE) | facetsOf(item).state |
              (item.selected ? STATE_SYSTEM_SELECTED : 0) | (item.visible ? 0 : STATE_SYSTEM_INVISIBLE) |
              (followed ? flags & (STATE_SYSTEM_FOCUSED | STATE_SYSTEM_FOCUSABLE) : 0);
    }
    *state = numbered(flags);
    return S_OK;
  });
}

// --- Children

HRESULT AccessibleGraph::get_accParent(IDispatch** parent) {
  if (parent == nullptr) return E_POINTER;
  *parent = nullptr;
  return ask([&](GraphTeller& teller) { return standardOf(teller.window())->get_accParent(parent); });
}

HRESULT AccessibleGraph::get_accChildCount(LONG* count) {
  if (count == nullptr) return E_POINTER;
  *count = 0;
  return ask([&](GraphTeller& teller) { return *count = countOfChildren(teller), S_OK; });
}

HRESULT AccessibleGraph::get_accChild(VARIANT child, IDispatch** object) {
  if (object == nullptr) return E_POINTER;
  *object = nullptr;
  return ask([&](GraphTeller& teller) -> HRESULT {
    const Child found = find(teller, child);
    if (found.self()) return AddRef(), *object = static_cast<IAccessible*>(this), S_OK;
    if (found.item != nullptr) return S_FALSE;  // the graph answers for it
    return *object = accessibleOf(found.window).detach(), S_OK;
  });
}

HRESULT AccessibleGraph::Next(ULONG count, VARIANT* items, ULONG* fetched) {
  if (items == nullptr || (fetched == nullptr && count != 1)) return E_POINTER;
  ULONG given = 0;
  const HRESULT done = ask([&](GraphTeller& teller) {
    const LONG children = countOfChildren(teller);
    for (; given < count && next_ < children; ++given) items[given] = childAt(teller, ++next_);
    return given == count ? S_OK : S_FALSE;
  });
  if (fetched != nullptr) *fetched = given;
  return done;
}

HRESULT AccessibleGraph::Skip(ULONG count) {
  return ask([&](GraphTeller& teller) {
    const LONG left = std::max<LONG>(countOfChildren(teller) - next_, 0);
    const bool enough = count <= static_cast<ULONG>(left);
    next_ += enough ? static_cast<LONG>(count) : left;
    return enough ? S_OK : S_FALSE;
  });
}

HRESULT AccessibleGraph::Reset() {
  next_ = 0;
  return S_OK;
}

HRESULT AccessibleGraph::Clone(IEnumVARIANT** copy) {
  if (copy == nullptr) return E_POINTER;
  *copy = nullptr;
  return ask([&](GraphTeller& teller) {
    std::vector<LONG> numbers(static_cast<std::size_t>(countOfChildren(teller)));
    for (std::size_t i = 0; i < numbers.size(); ++i) numbers[i] = static_cast<LONG>(i) + 1;
    const auto next = std::min(static_cast<std::size_t>(next_), numbers.size());
    *copy = new Children(childrenOf(*this, numbers), next);
    return S_OK;
  });
}

HRESULT AccessibleGraph::get_accFocus(VARIANT* child) {
  if (child == nullptr) return E_POINTER;
  VariantInit(child);
  return ask([&](GraphTeller& teller) -> HRESULT {
    const HWND focus = GetFocus();
    if (focus == teller.window()) return *child = numbered(followedItem(teller.items())), S_OK;
    const HWND round = childRound(teller.window(), focus);
    if (round == nullptr) return S_FALSE;
    return *child = windowChild(round), S_OK;
  });
}

HRESULT AccessibleGraph::get_accSelection(VARIANT* children) {
  if (children == nullptr) return E_POINTER;
  VariantInit(children);
  return ask([&](GraphTeller& teller) -> HRESULT {
    const std::vector<LONG> numbers = selectedNumbers(teller.items());
    if (numbers.empty()) return S_FALSE;
    if (numbers.size() == 1) return *children = numbered(numbers.front()), S_OK;
    V_UNKNOWN(children) = new Children(childrenOf(*this, numbers));
    V_VT(children) = VT_UNKNOWN;
    return S_OK;
  });
}

// --- Place and way

HRESULT AccessibleGraph::accSelect(LONG flags, VARIANT child) {
  return ask([&](GraphTeller& teller) -> HRESULT {
    const Child found = find(teller, child);
    if (found.window != nullptr) return accessibleOf(found.window)->accSelect(flags, self());
    if (!found.self() || flags != SELFLAG_TAKEFOCUS) return DISP_E_MEMBERNOTFOUND;
    SetFocus(teller.window());
    return S_OK;
  });
}

HRESULT AccessibleGraph::accLocation(LONG* left, LONG* top, LONG* width, LONG* height, VARIANT child) {
  if (left == nullptr || top == nullptr || width == nullptr || height == nullptr) return E_POINTER;
  *left = *top = *width = *height = 0;
  return ask([&](GraphTeller& teller) -> HRESULT {
    const Child found = find(teller, child);
    if (found.window != nullptr)
      return accessibleOf(found.window)->accLocation(left, top, width, height, self());
    RECT place{};
    if (found.self()) GetClientRect(teller.window(), &place);
    if (!found.self()) {
      const Rect& px = found.item->placePx;
      if (px.empty()) return S_OK;
      place = {px.left, px.top, px.right, px.bottom};
    }
    MapWindowPoints(teller.window(), nullptr, reinterpret_cast<POINT*>(&place), 2);
    *left = place.left;
    *top = place.top;
    *width = place.right - place.left;
    *height = place.bottom - place.top;
    return S_OK;
  });
}

// Only in reading order: what lies right of a marker may be anything.
HRESULT AccessibleGraph::accNavigate(LONG direction, VARIANT start, VARIANT* end) {
  if (end == nullptr) return E_POINTER;
  VariantInit(end);
  return ask([&](GraphTeller& teller) -> HRESULT {
    const Child from = find(teller, start);
    const LONG children = countOfChildren(teller);
    LONG to = 0;
    if (direction == NAVDIR_FIRSTCHILD || direction == NAVDIR_LASTCHILD) {
      if (!from.self()) return S_FALSE;
      to = direction == NAVDIR_FIRSTCHILD ? 1 : children;
    } else if (from.self()) {
      return standardOf(teller.window())->accNavigate(direction, start, end);
    } else if (direction == NAVDIR_NEXT || direction == NAVDIR_PREVIOUS) {
      to = childOf(start) + (direction == NAVDIR_NEXT ? 1 : -1);
    }
    if (to < 1 || to > children) return S_FALSE;
    return *end = childAt(teller, to), S_OK;
  });
}

HRESULT AccessibleGraph::accHitTest(LONG x, LONG y, VARIANT* child) {
  if (child == nullptr) return E_POINTER;
  VariantInit(child);
  return ask([&](GraphTeller& teller) -> HRESULT {
    POINT at{x, y};
    ScreenToClient(teller.window(), &at);
    RECT client{};
    GetClientRect(teller.window(), &client);
    if (PtInRect(&client, at) == FALSE) return S_FALSE;
    const HWND hit = ChildWindowFromPointEx(teller.window(), at, CWP_SKIPINVISIBLE);
    if (hit != nullptr && hit != teller.window()) return *child = windowChild(hit), S_OK;
    LONG found = CHILDID_SELF;
    int rank = -1;
    const std::vector<GraphItem>& items = teller.items();
    for (std::size_t i = 0; i < items.size(); ++i) {
      if (!items[i].placePx.contains({at.x, at.y}) || facetsOf(items[i]).rank <= rank) continue;
      found = static_cast<LONG>(i) + 1;
      rank = facetsOf(items[i]).rank;
    }
    return *child = numbered(found), S_OK;
  });
}

HRESULT AccessibleGraph::accDoDefaultAction(VARIANT child) {
  return ask([&](GraphTeller& teller) -> HRESULT {
    const Child found = find(teller, child);
    return found.window != nullptr ? accessibleOf(found.window)->accDoDefaultAction(self())
                                   : DISP_E_MEMBERNOTFOUND;
  });
}

HRESULT AccessibleGraph::GetWindow(HWND* window) {
  if (window == nullptr) return E_POINTER;
  *window = nullptr;
  return ask([&](GraphTeller& teller) { return *window = teller.window(), S_OK; });
}

}  // namespace frontpanels::activex

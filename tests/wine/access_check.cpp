// The registered panels as a screen reader meets them: every field by its name, the graph item by item, the
// events that it follows them by, and the access keys that a container asks for. Prints a line a check, at
// the end "N passed, N failed".
#include <windows.h>

#include <objbase.h>
#include <oleacc.h>
#include <olectl.h>

#include <algorithm>
#include <functional>
#include <set>
#include <string>
#include <vector>

#include "platform/win32/utf16.h"
#include "tests/wine/com_client.h"
#include "tests/wine/full_container.h"
#include "tests/wine/panel_user.h"

namespace frontpanels::testing {
namespace {

constexpr const wchar_t* kFieldClasses[] = {L"EDIT", L"COMBOBOX", L"LISTBOX", L"BUTTON", L"msctls_updown32"};

ComPointer<IAccessible> accessibleOf(HWND window) {
  ComPointer<IAccessible> object;
  AccessibleObjectFromWindow(window, static_cast<DWORD>(OBJID_CLIENT), __uuidof(IAccessible),
                             reinterpret_cast<void**>(object.receive()));
  return object;
}

using TextMember = HRESULT (STDMETHODCALLTYPE IAccessible::*)(VARIANT, BSTR*);
std::wstring textOf(IAccessible& object, TextMember member, int child = CHILDID_SELF) {
  Value text;
  if ((object.*member)(Value(child).variant(), &V_BSTR(text.get())) == S_OK) V_VT(text.get()) = VT_BSTR;
  return V_VT(text.get()) == VT_BSTR ? text.text() : L"";
}
std::wstring nameOf(IAccessible& object, int child = CHILDID_SELF) {
  return textOf(object, &IAccessible::get_accName, child);
}
std::wstring valueOf(IAccessible& object, int child = CHILDID_SELF) {
  return textOf(object, &IAccessible::get_accValue, child);
}
int countOf(IAccessible& object) {
  LONG count = -1;
  object.get_accChildCount(&count);
  return static_cast<int>(count);
}
int stateOf(IAccessible& object, int child) {
  Value state;
  object.get_accState(Value(child).variant(), state.get());
  return state.number();
}
// The number of the item with a name; 0 for none.
int itemCalled(IAccessible& graph, const std::wstring& name) {
  for (int child = countOf(graph); child > 0; --child)
    if (nameOf(graph, child) == name) return child;
  return 0;
}

// What is told of one window, and which of its items.
class Ear {
 public:
  explicit Ear(HWND window) {
    about_ = window;
    heard.clear();
    hook_ = SetWinEventHook(EVENT_OBJECT_REORDER, EVENT_OBJECT_VALUECHANGE, nullptr, hear,
                            GetCurrentProcessId(), GetCurrentThreadId(), WINEVENT_OUTOFCONTEXT);
  }
  ~Ear() { UnhookWinEvent(hook_); }
  Ear(const Ear&) = delete;
  Ear& operator=(const Ear&) = delete;

  static std::vector<std::pair<DWORD, LONG>> heard;
  static bool of(DWORD event, LONG child) {
    pumpMessages();
    return std::find(heard.begin(), heard.end(), std::pair(event, child)) != heard.end();
  }
  static bool nothing() { return pumpMessages(), heard.empty(); }

 private:
  static void CALLBACK hear(HWINEVENTHOOK, DWORD event, HWND window, LONG object, LONG child, DWORD, DWORD) {
    if (window == about_ && object == OBJID_CLIENT) heard.emplace_back(event, child);
  }
  static HWND about_;
  HWINEVENTHOOK hook_;
};
std::vector<std::pair<DWORD, LONG>> Ear::heard;
HWND Ear::about_ = nullptr;

// --- Fields

void fieldsHaveNames(const Sited& panel) {
  std::set<std::wstring> names;
  std::wstring nameless;
  std::wstring shared;
  for (const wchar_t* const className : kFieldClasses)
    for (const HWND window : windowsOf(panel.window(), className)) {
      const auto object = accessibleOf(window);
      const std::wstring name = object ? nameOf(*object.get()) : L"";
      if (name.empty()) nameless += className + std::wstring(L" ");
      const bool frame = (GetWindowLongW(window, GWL_STYLE) & BS_TYPEMASK) == BS_GROUPBOX;
      const bool button = isOf(window, L"BUTTON");
      const bool spin = isOf(window, L"msctls_updown32");
      if (spin && names.count(name) == 0) shared += L"(a spin button) " + name + L" ";
      if (!spin && !(button && frame) && !names.insert(name).second) shared += name + L"; ";
    }
  expect(nameless.empty(), "every field has a name " + toUtf8(nameless));
  expect(shared.empty() && names.size() > 30,
         "of its own, and its text box's if it is a spin button " + toUtf8(shared));
  const bool spectrum = panelKind().name == std::wstring(L"SpectrumView");
  for (const wchar_t* const name : {L"Add, Markers", L"Ref Level", L"Show or Hide Display Controls",
                                    spectrum ? L"Stop, Measurement" : L"Add, User PN List"})
    expect(names.count(name) == 1, "a field is called " + toUtf8(name));
}

void fieldsAreTheSystemsBesides(const Sited& panel) {
  const HWND box =
      boxBeside(panel.window(), panelKind().name == std::wstring(L"Tarvex") ? L"&Start" : L"<Start>");
  const auto object = accessibleOf(box);
  expect(object && nameOf(*object.get()) == L"Start" && valueOf(*object.get()) == testing::textOf(box) &&
             !testing::textOf(box).empty(),
         "a box is called by its label and reads its text");
  if (!object) return;
  Value role;
  object->get_accRole(Value(CHILDID_SELF).variant(), role.get());
  expect(role.number() == ROLE_SYSTEM_TEXT, "it is a text box to the system");
  const std::wstring keys = textOf(*object.get(), &IAccessible::get_accKeyboardShortcut);
  expect(panelKind().name == std::wstring(L"SpectrumView") || keys == L"Alt+S", "and says its access key");
}

// --- The graph

bool enumerates(IAccessible& graph) {
  const auto children = ComPointer<IAccessible>(&graph).query<IEnumVARIANT>();
  if (!children || children->Reset() != S_OK) return false;
  int items = 0;
  int windows = 0;
  ULONG fetched = 0;
  for (Value child; children->Next(1, child.get(), &fetched) == S_OK; child = Value()) {
    if (V_VT(&child.variant()) == VT_DISPATCH) {
      ++windows;
    } else if (V_VT(&child.variant()) == VT_I4 && V_I4(&child.variant()) == ++items && windows == 0) {
      IDispatch* own = nullptr;
      if (graph.get_accChild(child.variant(), &own) != S_FALSE || own != nullptr) return false;
      if (nameOf(graph, items).empty() || valueOf(graph, items).empty()) return false;
    } else {
      return false;
    }
  }
  return items > 0 && windows == 4 && items + windows == countOf(graph);
}

void graphIsRead(const Sited& panel, IAccessible& graph) {
  const std::wstring chart = panelKind().name == std::wstring(L"Tarvex") ? L"All Pilots" : L"Spectrum";
  expect(nameOf(graph, 1) == chart && valueOf(graph, 1) == L"1 trace, 0 markers" &&
             valueOf(graph) == chart + L": 1 trace, 0 markers",
         "the graph says what it shows: " + toUtf8(valueOf(graph)));
  expect(nameOf(graph, 2) == L"Trace 1" && valueOf(graph, 2).starts_with(L"513 points, largest -"),
         "and so does the trace: " + toUtf8(valueOf(graph, 2)));
  expect(enumerates(graph), "its children are items first, then the areas' windows");
  Value role;
  graph.get_accRole(Value(CHILDID_SELF).variant(), role.get());
  ComPointer<IDispatch> parent;
  graph.get_accParent(parent.receive());
  expect(role.number() == ROLE_SYSTEM_CHART && parent && countOf(graph) == 6, "it is a chart in a window");
  Value name;
  expect(graph.get_accChild(Value(6).variant(), parent.receive()) == S_OK && parent.query<IAccessible>() &&
             graph.get_accName(Value(7).variant(), &V_BSTR(name.get())) == E_INVALIDARG &&
             graph.get_accName(Value(L"1").variant(), &V_BSTR(name.get())) == E_INVALIDARG,
         "a number that no child has is refused");
  // SpectrumView is told of a trace by the number that it keeps it under.
  call(*panel.members.get(), L"vfpOp", {0, 11, panelKind().resultType == 10 ? 25 : panelKind().resultType});
  expect(countOf(graph) == 4 && valueOf(graph) == L"nothing", "a trace that was removed is read no more");
  call(*panel.members.get(), L"vfpOp", {0, 10, panelKind().resultType});
}

// --- Markers

void markersAreFollowed(const Sited& panel, IAccessible& graph) {
  const Ear ear(panel.window());
  publish(carrier());
  panel.call(L"addMarker");
  const int marker = itemCalled(graph, L"Marker 1");
  expect(
      marker == 3 && Ear::of(EVENT_OBJECT_REORDER, CHILDID_SELF) && Ear::of(EVENT_OBJECT_SELECTION, marker),
      "a new marker is told of and selected");
  const std::wstring before = valueOf(graph, marker);
  Ear::heard.clear();
  SetFocus(panel.window());
  SendMessageW(panel.window(), WM_KEYDOWN, VK_RIGHT, 0);
  expect(Ear::of(EVENT_OBJECT_VALUECHANGE, marker) && valueOf(graph, marker) != before,
         "a key moves it, and its value follows: " + toUtf8(before + L" -> " + valueOf(graph, marker)));
  constexpr int kFollowed = STATE_SYSTEM_SELECTED | STATE_SYSTEM_FOCUSED;
  Value focus;
  graph.get_accFocus(focus.get());
  expect((stateOf(graph, marker) & kFollowed) == kFollowed && focus.number() == marker &&
             (stateOf(graph, marker) & STATE_SYSTEM_INVISIBLE) == 0,
         "it is selected and has the focus");
  Ear::heard.clear();
  publish(std::vector<float>(513, panelKind().floorDb));
  expect(Ear::nothing(), "a sweep is no event");
}

void placesAreOfTheScreen(const Sited& panel, IAccessible& graph) {
  const int marker = itemCalled(graph, L"Marker 1");
  LONG place[4]{};
  graph.accLocation(&place[0], &place[1], &place[2], &place[3], Value(marker).variant());
  RECT window{};
  GetWindowRect(panel.window(), &window);
  expect(place[2] == 9 && place[3] == 13 && place[0] > window.left && place[1] > window.top,
         "a marker has its place");
  const auto hit = [&](LONG x, LONG y) {
    Value child;
    graph.accHitTest(x, y, child.get());
    return child;
  };
  expect(
      hit(place[0] + 4, place[1] + 12).number() == marker && hit(place[0] + 40, place[1] - 20).number() == 2,
      "and is found there, and the trace beside it");
  const Value area = hit(window.right - 5, window.top + 20);
  const Value outside = hit(window.left - 5, window.top);
  expect(V_VT(&area.variant()) == VT_DISPATCH && V_VT(&outside.variant()) == VT_EMPTY,
         "over an area it is the area, and outside nothing");
  const auto next = [&graph](LONG way, int from) {
    Value end;
    graph.accNavigate(way, Value(from).variant(), end.get());
    return end.number();
  };
  expect(next(NAVDIR_FIRSTCHILD, 0) == 1 && next(NAVDIR_NEXT, 1) == 2 && next(NAVDIR_PREVIOUS, marker) == 2 &&
             next(NAVDIR_PREVIOUS, 1) == -12345,
         "the way leads from item to item");
}

void captionIsTheName(const Sited& panel, IAccessible& graph) {
  const Ear ear(panel.window());
  expect(!nameOf(graph).empty(),
         "without a caption the graph is called by its class: " + toUtf8(nameOf(graph)));
  put(*panel.members.get(), L"Caption", L"Rooftop");
  expect(nameOf(graph) == L"Rooftop" && Ear::of(EVENT_OBJECT_NAMECHANGE, CHILDID_SELF),
         "a new caption is told of");
  Ear::heard.clear();
  put(*panel.members.get(), L"Caption", L"Rooftop");
  expect(Ear::nothing(), "once");
}

// --- Access keys

std::vector<ACCEL> keysOf(const Sited& panel) {
  CONTROLINFO info{};
  info.cb = sizeof info;
  panel.object.query<IOleControl>()->GetControlInfo(&info);
  std::vector<ACCEL> keys(info.cAccel);
  if (info.hAccel != nullptr)
    keys.resize(static_cast<std::size_t>(CopyAcceleratorTableW(info.hAccel, keys.data(), info.cAccel)));
  return keys;
}
bool has(const std::vector<ACCEL>& keys, BYTE how, WORD key) {
  return std::any_of(keys.begin(), keys.end(),
                     [&](const ACCEL& entry) { return (entry.fVirt & 0x7F) == how && entry.key == key; });
}

void keysReachThePanel(const Sited& panel) {
  const bool spectrum = panelKind().name == std::wstring(L"SpectrumView");
  const std::vector<ACCEL> keys = keysOf(panel);
  expect(has(keys, FALT, 'l') && has(keys, FALT, 'L') && has(keys, FALT | FVIRTKEY, 'L') &&
             !has(keys, FALT, 'x'),
         "the container is given the keys of the captions");
  expect(!spectrum || keys.size() == 10, "three forms of each letter and one of the slash");
  const HWND elsewhere = GetParent(panel.window());
  SetFocus(elsewhere);
  MSG message{elsewhere, WM_SYSCHAR, 'l', 0x20000001, 0, {}};
  const auto control = panel.object.query<IOleControl>();
  control->OnMnemonic(&message);
  const auto focused = accessibleOf(GetFocus());
  expect(focused && nameOf(*focused.get()) == L"Ref Level" && panel.container.count("OnUIActivate") > 0,
         "a key leads into the field of its label");
  SetFocus(elsewhere);
  message.wParam = 'x';
  control->OnMnemonic(&message);
  expect(GetFocus() == elsewhere && control->OnMnemonic(nullptr) == E_POINTER, "another key does nothing");
  const int told = panel.container.count("OnControlInfoChanged");
  put(*panel.members.get(), L"DisplayPanelVisible", false);
  expect(panel.container.count("OnControlInfoChanged") > told && !has(keysOf(panel), FALT, 'l'),
         "keys of fields that are hidden go, and the container hears of it");
  put(*panel.members.get(), L"DisplayPanelVisible", true);
  expect(has(keysOf(panel), FALT, 'l'), "and come again");
}

// What is asked of the panel's window, which passes it on to the form and so to all windows in that.
WPARAM cuesAsked = 0;
WNDPROC panelProcedure = nullptr;
LRESULT CALLBACK watchPanel(HWND window, UINT message, WPARAM wide, LPARAM extra) {
  if (message == WM_CHANGEUISTATE) cuesAsked = wide;
  return CallWindowProcW(panelProcedure, window, message, wide, extra);
}

void cuesShow(const Sited& panel) {
  const HWND graph = panel.window();
  const HWND box = windowsOf(panel.window(), L"EDIT").front();
  panelProcedure = reinterpret_cast<WNDPROC>(
      SetWindowLongPtrW(graph, GWLP_WNDPROC, reinterpret_cast<LONG_PTR>(watchPanel)));
  const auto asks = [](HWND window, WPARAM key) {
    cuesAsked = 0;
    SendMessageW(window, WM_SYSKEYDOWN, key, 0x20000001);
    return cuesAsked == MAKEWPARAM(UIS_CLEAR, UISF_HIDEACCEL | UISF_HIDEFOCUS);
  };
  expect(asks(graph, VK_MENU) && asks(box, VK_MENU) && asks(box, VK_F10) && !asks(box, 'Q'),
         "Alt and F10 bring the underlines of the keys, from graph and field");
  SetWindowLongPtrW(graph, GWLP_WNDPROC, reinterpret_cast<LONG_PTR>(panelProcedure));
}

// --- The end

void objectsOutliveThePanel(HWND desk) {
  ComPointer<IAccessible> graph;
  ComPointer<IAccessible> field;
  {
    Sited panel(desk, OLEIVERB_INPLACEACTIVATE);
    graph = accessibleOf(panel.window());
    field = accessibleOf(windowsOf(panel.window(), L"EDIT").front());
    panel.close();
  }
  Value text;
  LONG count = 5;
  const VARIANT self = Value(CHILDID_SELF).variant();
  expect(graph && graph->get_accName(self, &V_BSTR(text.get())) == CO_E_OBJNOTCONNECTED &&
             graph->get_accChildCount(&count) == CO_E_OBJNOTCONNECTED && count == 0,
         "what a reader keeps of a closed graph says that it has gone");
  expect(field && field->get_accName(self, &V_BSTR(text.get())) == CO_E_OBJNOTCONNECTED, "and so of a field");
}

void check(HWND desk) {
  chapter("read aloud");
  objectsOutliveThePanel(desk);
  Sited panel(desk);
  panel.container.place = {0, 0, inPixels(12000), inPixels(9000)};
  panel.verb(OLEIVERB_INPLACEACTIVATE);
  pumpMessages();
  fieldsHaveNames(panel);
  fieldsAreTheSystemsBesides(panel);
  const auto graph = accessibleOf(panel.window());
  expect(static_cast<bool>(graph), "the graph can be read");
  if (!graph) return;
  publish(carrier());
  captionIsTheName(panel, *graph.get());
  graphIsRead(panel, *graph.get());
  markersAreFollowed(panel, *graph.get());
  placesAreOfTheScreen(panel, *graph.get());
  keysReachThePanel(panel);
  cuesShow(panel);
}

}  // namespace

int check() {
  return runChecks({1000, 800}, [](const Desk& desk) { onEachPanel([&] { check(desk.window); }); });
}

}  // namespace frontpanels::testing

int main() { return frontpanels::testing::check(); }

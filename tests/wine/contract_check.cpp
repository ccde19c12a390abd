// What containers of many kinds rely on, one chapter a duty. Knows the control by its registration alone.
// Prints a line a check, at the end "N passed, N failed". With "atl DLL" as arguments the control stands in
// the window of a container that somebody else wrote.
#include <windows.h>

#include <objbase.h>
#include <ocidl.h>
#include <olectl.h>

#include <algorithm>
#include <cfloat>
#include <functional>
#include <limits>
#include <map>
#include <string>
#include <vector>

#include "tests/wine/com_client.h"
#include "tests/wine/full_container.h"
#include "tests/wine/panel_user.h"

namespace frontpanels::testing {
namespace {

constexpr int kHardwareId = 7;

using Texts = std::vector<std::string>;

std::wstring takeMessages(const Desk& desk) {
  std::wstring all;
  const int messages = call(desk.diagnostics, L"Count").number();
  for (int i = 0; i < messages; ++i) all += call(desk.diagnostics, L"Message", {i}).text() + L"|";
  call(desk.diagnostics, L"Clear");
  return all;
}

// --- Requests

void answersOfTheHost(const Desk& desk) {
  Hosted hosted;
  hosted.call(L"vfpSet", {0, 315, 0, kHardwareId});
  hosted.call(L"closeVfp");
  expect(takeMessages(desk).empty(), "without a sink the answer is 0");

  const auto point = pointOf(*hosted.members.get(), eventsOf(*hosted.members.get()));
  EventSink first;
  EventSink second;
  DWORD firstCookie = 0;
  DWORD secondCookie = 0;
  point->Advise(&first, &firstCookie);
  point->Advise(&second, &secondCookie);
  first.status = 5;
  hosted.call(L"closeVfp");
  expect(first.received == Lines{L"1 7 0 1  0"}, "resource, panel and operation arrive");
  expect(second.received == Lines{L"1 7 0 1  5"}, "the next sink sees the answer so far");
  expect(takeMessages(desk).empty(), "the last sink decides");

  second.answer = DISP_E_MEMBERNOTFOUND;
  hosted.call(L"closeVfp");
  expect(takeMessages(desk) == L"QUILL_VFP_CLOSE failed|",
         "a sink without a handler leaves the answer alone");

  second.answer = S_OK;
  second.received.clear();
  first.during = [&] { point->Unadvise(secondCookie); };
  hosted.call(L"closeVfp");
  expect(second.received.empty() && takeMessages(desk) == L"QUILL_VFP_CLOSE failed|",
         "a sink that has left in the meantime hears nothing");
  first.during = [] {};

  const auto control = hosted.members.query<IOleControl>();
  control->FreezeEvents(TRUE);
  control->FreezeEvents(TRUE);
  control->FreezeEvents(FALSE);
  first.received.clear();
  hosted.call(L"closeVfp");
  expect(first.received.empty(), "frozen twice and thawed once is still frozen");
  control->FreezeEvents(FALSE);
  hosted.call(L"closeVfp");
  expect(!first.received.empty(), "thawed twice is not");
  point->Unadvise(firstCookie);
  DWORD again = 0;
  point->Advise(&first, &again);
  expect(
      again != firstCookie && again != secondCookie && point->Unadvise(firstCookie) == CONNECT_E_NOCONNECTION,
      "a cookie is never used twice");
  point->Unadvise(again);
  expect(first.references == 1 && second.references == 1, "no reference to a sink is left");
}

void settingsForKeeping(const Desk& desk) {
  EventSink sink;
  Hosted hosted;
  IDispatch& panel = *hosted.members.get();
  put(panel, L"virtualFrontPanelId", 6);
  call(panel, L"vfpSet", {0, 315, 0, kHardwareId});
  hosted.advise(sink);
  LONG kept = 0;
  sink.during = [&] {
    const Value list = call(panel, L"Settings");
    if (V_VT(&list.variant()) == (VT_ARRAY | VT_VARIANT))
      SafeArrayGetUBound(V_ARRAY(&list.variant()), 1, &kept);
  };
  sink.status = 2;
  call(desk.diagnostics, L"Clear");
  expect(call(panel, L"vfpOp", {0, 9}).number() == 0 && call(panel, L"vfpOp", {0, 13, 77}).number() == 0,
         "both saves answer 0");
  expect(sink.received == Lines{L"3 7 6 ? 0", L"4 77 7 6 0"},
         "a list is handed over, and the id of a set-up");
  expect(kept > 10, "whose settings can be read inside the event");
  const std::wstring name = panelKind().name;
  expect(takeMessages(desk) == name + L"::saveBase() status = 2|" + name + L"::saveSetup() status = 2|",
         "a host that refuses is reported");
  call(panel, L"PopUp_Click", {0, 1002});
  expect(sink.received.back() == L"1 7 6 21 0 0", "the menu's request carries its argument");
  call(desk.diagnostics, L"Clear");
}

constexpr VARTYPE kAutomationTypes[] = {
    VT_EMPTY, VT_NULL,    VT_I2,      VT_I4, VT_R4,  VT_R8,  VT_CY,  VT_DATE, VT_BSTR, VT_DISPATCH, VT_ERROR,
    VT_BOOL,  VT_UNKNOWN, VT_DECIMAL, VT_I1, VT_UI1, VT_UI2, VT_UI4, VT_I8,   VT_UI8,  VT_INT,      VT_UINT};

// A value of every type that a host can make, and a reference to it.
std::vector<VARIANT> everyType(std::vector<Value>& owned) {
  static LONGLONG cell[4] = {};
  std::vector<VARIANT> values;
  for (const VARTYPE type : kAutomationTypes) {
    VARIANT value{};
    V_VT(&value) = type;
    if (type != VT_BSTR && type != VT_DECIMAL) V_I8(&value) = 0;
    values.push_back(value);
    VARIANT reference{};
    V_VT(&reference) = static_cast<VARTYPE>(VT_BYREF | type);
    V_BYREF(&reference) = cell;
    if (type <= VT_NULL) continue;  // neither is referred to, nor an array's element
    values.push_back(reference);
    VARIANT array{};
    V_VT(&array) = static_cast<VARTYPE>(VT_ARRAY | type);
    for (const UINT dimensions : {1U, 2U}) {
      SAFEARRAYBOUND bounds[2] = {{2, 0}, {2, 0}};
      V_ARRAY(&array) = SafeArrayCreate(type, dimensions, bounds);
      if (V_ARRAY(&array) == nullptr) continue;
      Value keeper;
      *keeper.get() = array;
      owned.push_back(std::move(keeper));
      values.push_back(array);
    }
    V_ARRAY(&array) = nullptr;
    values.push_back(array);
  }
  return values;
}

bool isStatus(const Value& answer) {
  const int status = answer.number();
  return V_VT(&answer.variant()) == VT_I4 && (status == 0 || status == -1 || status == -8);
}

void anyValueAtAll(const Desk& desk) {
  Hosted hosted;
  IDispatch& panel = *hosted.members.get();
  std::vector<Value> owned;
  const Value zero(0);
  const std::vector<VARIANT> values = everyType(owned);
  int strange = 0;
  for (const VARIANT& value : values) {
    for (const int code : {9,   10,  13,  15,  21,  43,  230, 312, 314, 315, 322, 500, 700,
                           704, 706, 716, 727, 731, 732, 740, 751, 775, 803, 804, 810}) {
      const Value number(code);
      strange +=
          !isStatus(callRaw(panel, L"vfpSet", {zero.variant(), number.variant(), zero.variant(), value}));
      strange += !isStatus(callRaw(panel, L"vfpOp", {zero.variant(), number.variant(), value}));
      strange += !isStatus(callRaw(panel, L"displayParameter", {number.variant(), value}));
    }
    LONG cursor = 0;
    LONG left = 2;
    VARIANT byCursor{};
    V_VT(&byCursor) = VT_BYREF | VT_I4;
    V_I4REF(&byCursor) = &cursor;
    VARIANT byLeft = byCursor;
    V_I4REF(&byLeft) = &left;
    strange += !isStatus(
        callRaw(panel, L"displayData", {value, value, byCursor, byLeft, zero.variant(), zero.variant()}));
  }
  expect(strange == 0, "every entry point answers a status to " + std::to_string(values.size()) + " values" +
                           (strange == 0 ? "" : ", but not " + std::to_string(strange) + " times"));
  call(desk.diagnostics, L"Clear");
}

void closedInItsOwnRequest(const Desk& desk) {
  EventSink sink;
  Sited hosted(desk.window, OLEIVERB_UIACTIVATE);
  hosted.advise(sink);
  sink.during = [&] { hosted.close(); };
  IDispatch* const members = hosted.members.get();
  call(*members, L"closeVfp");
  expect(hosted.container.count("OnInPlaceDeactivate") == 1, "it is deactivated once");
  expect(hosted.container.references == 1 && sink.references == 1, "and holds nothing any more");
  takeMessages(desk);  // what closing in the middle of a request reports is not looked at
}

// --- Messages

void CALLBACK answerTheBox(HWND, UINT, UINT_PTR timer, DWORD) {
  const HWND box = FindWindowW(L"#32770", nullptr);
  if (box == nullptr) return;
  KillTimer(nullptr, timer);
  PostMessageW(box, WM_COMMAND, IDOK, 0);
}

// A box that nobody answers would hold this up until its time is over.
void showsBoxesToUsersOnly(const Desk& desk) {
  const auto wrong = [](Hosted& hosted) { return hosted.call(L"vfpSet", {0, 312, 0, L"abc"}).number(); };
  const std::wstring text = L"clsBaseVFP::vfpSet() PARM_MEASUREMENT_ID must be numeric\r|";
  put(desk.diagnostics, L"ShowMessages", true);
  {
    Hosted script;
    expect(wrong(script) == -8 && takeMessages(desk) == text, "without a window a message is kept only");
  }
  Sited hosted(desk.window, OLEIVERB_INPLACEACTIVATE);
  FullContainer& container = hosted.container;
  SetTimer(nullptr, 0, 10, answerTheBox);
  expect(wrong(hosted) == -8 && takeMessages(desk) == text, "with one a box shows it");
  expect(container.count("EnableModeless(off)") == 1 && container.count("EnableModeless") == 1,
         "and the host waits for its end");
  put(desk.diagnostics, L"ShowMessages", false);
}

// --- The container's place

void tellsItsPlace(const Desk& desk) {
  FullContainer container(desk.window);
  PlaceProperties place;
  container.extender = &place;
  Hosted hosted;
  hosted.object->SetClientSite(&container);
  hosted.call(L"vfpSet", {0, 314, 0, L"Receiver 1"});
  hosted.call(L"vfpSet", {0, 702, 0, 4500});
  hosted.call(L"vfpOp", {0, 12});
  const Lines expected = {L"Caption=Receiver 1", L"Visible=False", L"ViewState=0",  L"Width=4500",
                          L"Visible=False",      L"ViewState=0",   L"Visible=True", L"Caption=Receiver 1"};
  expect(place.told == expected, "caption, size, visibility and state reach the container's place");
  container.extender = hosted.members.get();
  expect(hosted.call(L"vfpOp", {0, 12}).number() == 0,
         "a container that answers the control itself is not asked in circles");
  container.extender = nullptr;
  expect(hosted.call(L"vfpOp", {0, 12}).number() == 0, "a container without a place will do");
  hosted.close();
  expect(container.references == 1 && place.references == 1, "no reference is left");
}

void staysQuietInADesigner(const Desk& desk) {
  FullContainer container(desk.window);
  container.userMode = false;
  EventSink sink;
  Hosted hosted;
  hosted.object->SetClientSite(&container);
  hosted.advise(sink);
  hosted.call(L"closeVfp");
  expect(sink.received.empty(), "raises nothing");
  hosted.verb(OLEIVERB_INPLACEACTIVATE);
  SendMessageW(hosted.window(), WM_LBUTTONDOWN, MK_LBUTTON, MAKELPARAM(50, 50));
  expect(GetCapture() == nullptr && GetFocus() != hosted.window(), "takes neither mouse nor focus");
  container.userMode = true;
  hosted.members.query<IOleControl>()->OnAmbientPropertyChange(DISPID_UNKNOWN);
  hosted.call(L"closeVfp");
  expect(!sink.received.empty(), "until the container runs");
}

// --- Activation

void activatesStepByStep(const Desk& desk) {
  Sited hosted(desk.window);
  FullContainer& container = hosted.container;
  SetFocus(desk.window);
  expect(hosted.verb(OLEIVERB_INPLACEACTIVATE) == S_OK, "in place");
  expect(container.told == Texts{"OnInPlaceActivate", "ShowObject"}, "takes neither focus nor frame");
  const RECT rect = placeIn(desk.window, hosted.window());
  expect(EqualRect(&rect, &container.place) != 0, "stands where the container said");
  container.told.clear();
  expect(hosted.verb(0xFFFC) == S_OK, "a verb passed as 16 bits is understood");  // OLEIVERB_UIACTIVATE
  expect(container.told == Texts{"OnUIActivate", "OnFocus", "SetActiveObject", "SetBorderSpace(none)"},
         "with the user's attention it has focus and frame, once each");
  expect(GetFocus() == hosted.window(), "the focus is its window's");
  expect(hosted.verb(-99) == E_NOTIMPL, "an unknown verb of the system's is refused");
  expect(hosted.verb(99) == OLEOBJ_S_INVALIDVERB, "an unknown verb of its own activates it");

  const HWND view = hosted.window();
  hosted.verb(OLEIVERB_HIDE);
  expect(hosted.window() == view && (GetWindowLongW(view, GWL_STYLE) & WS_VISIBLE) == 0,
         "hidden it keeps its window");
  hosted.verb(OLEIVERB_SHOW);
  expect((GetWindowLongW(view, GWL_STYLE) & WS_VISIBLE) != 0, "and shows it again");

  SIZEL stale{1000, 1000};
  hosted.object->SetExtent(DVASPECT_CONTENT, &stale);
  hosted.inPlace->SetObjectRects(&container.place, &container.place);
  hosted.verb(OLEIVERB_UIACTIVATE);
  container.told.clear();
  hosted.inPlace->InPlaceDeactivate();
  const Texts left = {"SetActiveObject(none)", "OnUIDeactivate", "OnFocus(off)", "OnInPlaceDeactivate"};
  expect(container.told == left, "leaves the frame first and the place last");
  hosted.inPlace->InPlaceDeactivate();
  expect(container.count("OnInPlaceDeactivate") == 1, "once");
  expect(hosted.call(L"ViewScaleWidth").number() == 400 * 15, "keeps its size without a window");
  expect(container.count("OnPosRectChange") == 0, "never asks for another place by itself");
}

void losesItsWindow(const Desk&) {
  const HWND parent = CreateWindowExW(0, L"STATIC", L"", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 0, 0, 500, 400,
                                      nullptr, nullptr, nullptr, nullptr);
  Sited hosted(parent, OLEIVERB_INPLACEACTIVATE);
  const FullContainer& container = hosted.container;
  publish(carrier());
  DestroyWindow(parent);
  publish(carrier());
  expect(hosted.window() == nullptr, "goes with its parent's");
  hosted.close();
  expect(container.count("OnInPlaceDeactivate") == 1 && container.references == 1, "closes all the same");

  Sited released(GetDesktopWindow(), OLEIVERB_INPLACEACTIVATE);
  const HWND view = released.window();
  released.release();  // without a close
  expect(!IsWindow(view), "goes with the last reference");
  expect(released.container.count("OnInPlaceDeactivate") == 1 && released.container.references == 1,
         "and the container hears of it");
}

// A container that lets go while it is asked for the place of the new window.
class Wavering final : public FullContainer {
 public:
  using FullContainer::FullContainer;
  std::function<void()> during;
  HRESULT STDMETHODCALLTYPE GetWindowContext(IOleInPlaceFrame** frame, IOleInPlaceUIWindow** document,
                                             LPRECT area, LPRECT clip, LPOLEINPLACEFRAMEINFO info) override {
    if (during) during();
    return FullContainer::GetWindowContext(frame, document, area, clip, info);
  }
};

void leavesNoHalfState(const Desk& desk) {
  Wavering wavering(desk.window);
  Hosted hosted;
  hosted.object->SetClientSite(&wavering);
  wavering.during = [&] { hosted.inPlace->InPlaceDeactivate(); };
  expect(FAILED(hosted.verb(OLEIVERB_UIACTIVATE)) && hosted.window() == nullptr &&
             wavering.count("OnInPlaceDeactivate") == 1 && wavering.count("OnUIActivate") == 0,
         "an activation that the container takes back in the middle fails");
  wavering.during = nullptr;
  expect(hosted.verb(OLEIVERB_UIACTIVATE) == S_OK && IsWindow(hosted.window()) &&
             wavering.count("OnUIActivate") == 1,
         "and the next one does not");
  hosted.close();
  expect(wavering.references == 1, "no reference to the container is left");

  FullContainer dead(reinterpret_cast<HWND>(static_cast<LONG_PTR>(0x7FF0)));
  Hosted homeless;
  homeless.object->SetClientSite(&dead);
  expect(FAILED(homeless.verb(OLEIVERB_INPLACEACTIVATE)), "a window that is none takes no panel");
  homeless.object->SetClientSite(nullptr);
  expect(dead.references == 1 && dead.count("OnInPlaceDeactivate") == 1, "nor does the panel keep its frame");

  const HWND form = CreateWindowExW(0, L"STATIC", L"", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 0, 0, 500, 400,
                                    nullptr, nullptr, nullptr, nullptr);
  Wavering again(form);
  Hosted lost;
  lost.object->SetClientSite(&again);
  lost.verb(OLEIVERB_UIACTIVATE);
  DestroyWindow(form);
  again.stand(desk.window);
  expect(lost.verb(OLEIVERB_UIACTIVATE) == S_OK && IsWindow(lost.window()) &&
             again.count("OnInPlaceActivate") == 2 && again.count("OnInPlaceDeactivate") == 1 &&
             again.count("OnUIActivate") == 2,
         "a panel whose form has gone stands on the next one, whole");
}

void changesItsSite(const Desk& desk) {
  FullContainer first(desk.window);
  FullContainer second(desk.window);
  Hosted hosted;
  hosted.object->SetClientSite(&first);
  hosted.verb(OLEIVERB_INPLACEACTIVATE);
  hosted.object->SetClientSite(&second);
  expect(first.count("OnInPlaceDeactivate") == 1 && first.references == 1,
         "leaves the one before it takes another");
  expect(hosted.verb(OLEIVERB_INPLACEACTIVATE) == S_OK && second.count("OnInPlaceActivate") == 1,
         "is active there");
}

// --- Keys and mouse

void sharesTheKeys(const Desk& desk) {
  Sited hosted(desk.window, OLEIVERB_UIACTIVATE);
  FullContainer& container = hosted.container;
  put(*hosted.members.get(), L"DisplayPanelVisible", false);
  put(*hosted.members.get(), L"MeasurementPanelVisible", false);
  const auto active = hosted.object.query<IOleInPlaceActiveObject>();
  MSG left{hosted.window(), WM_KEYDOWN, VK_LEFT, 0, 0, {}};
  expect(active->TranslateAccelerator(&left) == S_OK && container.count("TranslateAccelerator") == 1,
         "an arrow is the container's while there is no marker");
  publish(carrier());
  hosted.call(L"addMarker");
  MSG letter{hosted.window(), WM_CHAR, 'p', 0, 0, {}};
  const auto code = [&](const MSG& message) {
    return SendMessageW(hosted.window(), WM_GETDLGCODE, message.wParam, reinterpret_cast<LPARAM>(&message));
  };
  expect(active->TranslateAccelerator(&left) == S_OK && container.count("TranslateAccelerator") == 1,
         "and the panel's, unasked, when there is one");
  MSG percent{hosted.window(), WM_CHAR, '%', 0, 0, {}};  // its number is that of the left arrow
  expect((code(left) & DLGC_WANTMESSAGE) != 0 && (code(letter) & DLGC_WANTMESSAGE) != 0 &&
             (code(percent) & DLGC_WANTMESSAGE) == 0,
         "a dialog hears the same, of a letter that is a key too");
  MSG tab{hosted.window(), WM_KEYDOWN, VK_TAB, 0, 0, {}};
  expect(active->TranslateAccelerator(&tab) == S_OK && container.count("TranslateAccelerator") == 2,
         "Tab is the container's where no field is in sight");
}

void capturesTheMouse(const Desk& desk) {
  Sited hosted(desk.window, OLEIVERB_INPLACEACTIVATE);
  const HWND view = hosted.window();
  const LRESULT answer = SendMessageW(view, WM_MOUSEACTIVATE, reinterpret_cast<WPARAM>(desk.window),
                                      MAKELPARAM(HTCLIENT, WM_LBUTTONDOWN));
  expect(answer == MA_ACTIVATE && hosted.container.count("OnUIActivate") == 1,
         "a click makes it the active object");
  SendMessageW(view, WM_LBUTTONDOWN, MK_LBUTTON, MAKELPARAM(50, 50));
  expect(GetCapture() == view, "a press takes the capture");
  SendMessageW(view, WM_MBUTTONDOWN, MK_LBUTTON | MK_MBUTTON, MAKELPARAM(50, 50));
  SendMessageW(view, WM_LBUTTONUP, MK_MBUTTON, MAKELPARAM(-500, 50));
  expect(GetCapture() == view, "which lasts while a button is down");
  SendMessageW(view, WM_MBUTTONUP, 0, MAKELPARAM(50, 50));
  expect(GetCapture() == nullptr, "and ends with the last one");
}

// --- Pictures

void paintsAllOfItself(const Desk& desk) {
  Sited hosted(desk.window, OLEIVERB_INPLACEACTIVATE);
  const int contextBefore = hosted.call(L"ViewHDC").number();
  publish(carrier());
  pumpMessages();  // the form paints its background first
  const HWND view = hosted.window();
  const HDC dc = GetDC(view);
  RECT all{};
  GetClientRect(view, &all);
  FillRect(dc, &all, static_cast<HBRUSH>(GetStockObject(BLACK_BRUSH)));
  InvalidateRect(view, nullptr, TRUE);
  pumpMessages();
  expect(GetPixel(dc, 0, 0) == GetSysColor(COLOR_BTNFACE) &&
             GetPixel(dc, all.right - 1, all.bottom - 1) == GetSysColor(COLOR_BTNFACE),
         "the margins are painted, too");
  expect(pixelsOf(dc, all, kTraceColor) > 200, "with the trace");
  expect(hosted.call(L"ViewScaleWidth").number() == 400 * 15, "its scale is twips: 15 a pixel");
  expect(hosted.call(L"ViewHDC").number() == contextBefore, "its device context stays the same");
  ReleaseDC(view, dc);
}

// --- Storage

using Bag = std::map<std::wstring, std::wstring>;

void keepsPropertiesInABag(const Desk&) {
  ChangeSink changes;
  Hosted hosted;
  const auto persist = hosted.object.query<IPersistPropertyBag>();
  TextBag bag;
  persist->Save(&bag, TRUE, FALSE);
  expect(bag.texts.empty(), "what is as usual is not written");
  persist->Save(&bag, TRUE, TRUE);
  expect(bag.texts[L"DisplayPanelVisible"] == L"True" && bag.texts[L"MeasurementPanelVisible"] == L"True" &&
             bag.texts.size() == (panelKind().text == nullptr ? 2U : 7U),
         "unless all is asked for");
  DWORD cookie = 0;
  pointOf(*hosted.members.get(), IID_IPropertyNotifySink)->Advise(&changes, &cookie);
  put(*hosted.members.get(), L"DisplayPanelVisible", false);
  expect(changes.changed == std::vector<DISPID>{26}, "a change is told");
  expect(hosted.object.query<IPersistStreamInit>()->IsDirty() == S_OK, "and makes the control dirty");
  bag.texts.clear();
  persist->Save(&bag, TRUE, FALSE);
  expect(bag.texts == Bag{{L"DisplayPanelVisible", L"False"}}, "the change alone is written");

  Hosted other;
  const auto loading = other.object.query<IPersistPropertyBag>();
  loading->Load(&bag, nullptr);
  expect(other.call(L"DisplayPanelVisible").number() == 0 &&
             other.call(L"MeasurementPanelVisible").number() == -1,
         "and comes back from a text");
  ErrorLog log;
  bag.texts = {{L"DisplayPanelVisible", L"perhaps"}, {L"MeasurementPanelVisible", L"0"}};
  expect(loading->Load(&bag, &log) == S_OK && log.names == Lines{L"DisplayPanelVisible"},
         "a bad value is logged");
  expect(other.call(L"DisplayPanelVisible").number() == -1, "and the usual one kept");
}

void keepsStateInAStorage(const Desk&) {
  Hosted hosted;
  ComPointer<IStorage> storage;
  StgCreateDocfile(nullptr, STGM_CREATE | STGM_READWRITE | STGM_SHARE_EXCLUSIVE | STGM_DELETEONRELEASE, 0,
                   storage.receive());
  const auto persist = hosted.object.query<IPersistStorage>();
  persist->InitNew(storage.get());
  SIZEL extent{7001, 5003};
  hosted.object->SetExtent(DVASPECT_CONTENT, &extent);
  expect(persist->Save(storage.get(), TRUE) == S_OK && persist->IsDirty() == S_OK, "saved is dirty still");
  expect(persist->SaveCompleted(nullptr) == S_OK && persist->IsDirty() == S_FALSE, "until it is for good");
  persist->Save(storage.get(), TRUE);
  extent = {7001, 5004};
  hosted.object->SetExtent(DVASPECT_CONTENT, &extent);
  persist->SaveCompleted(nullptr);
  expect(persist->IsDirty() == S_OK, "what has changed since is not in it");
  Hosted other;
  expect(other.object.query<IPersistStorage>()->Load(storage.get()) == S_OK, "loads");
  SIZEL back{};
  other.object->GetExtent(DVASPECT_CONTENT, &back);
  expect(back.cx == 7001 && back.cy == 5003, "with the extent to the unit");
}

constexpr const wchar_t* kOtherPaths = L"mine/error\x1bmine/Gr\u00F6\u00DFe";

void keepsTexts(const Desk& desk) {
  const wchar_t* const name = panelKind().text;
  if (name == nullptr) return;
  Hosted hosted;
  const std::wstring usual = hosted.call(name).text();
  put(*hosted.members.get(), name, kOtherPaths);
  expect(hosted.object.query<IPersistStreamInit>()->IsDirty() == S_OK,
         "another text makes the control dirty");
  const auto comesBack = [&](const char* how, const std::function<HRESULT(Hosted&)>& load) {
    Hosted other;
    expect(other.call(name).text() == usual && load(other) == S_OK && other.call(name).text() == kOtherPaths,
           std::string("comes back ") + how);
  };
  ComPointer<IStream> stream;
  CreateStreamOnHGlobal(nullptr, TRUE, stream.receive());
  hosted.object.query<IPersistStreamInit>()->Save(stream.get(), FALSE);
  const auto begin = [&stream] { stream->Seek({}, STREAM_SEEK_SET, nullptr); };
  comesBack("from a stream", [&](Hosted& other) {
    return begin(), other.object.query<IPersistStreamInit>()->Load(stream.get());
  });
  TextBag bag;
  hosted.object.query<IPersistPropertyBag>()->Save(&bag, FALSE, FALSE);
  expect(bag.texts == Bag{{name, kOtherPaths}}, "stands in the bag alone");
  comesBack("from a bag",
            [&](Hosted& other) { return other.object.query<IPersistPropertyBag>()->Load(&bag, nullptr); });
  ComPointer<IStorage> storage;
  StgCreateDocfile(nullptr, STGM_CREATE | STGM_READWRITE | STGM_SHARE_EXCLUSIVE | STGM_DELETEONRELEASE, 0,
                   storage.receive());
  hosted.object.query<IPersistStorage>()->Save(storage.get(), FALSE);
  comesBack("from a storage",
            [&](Hosted& other) { return other.object.query<IPersistStorage>()->Load(storage.get()); });

  Hosted other;
  ULARGE_INTEGER end{};
  stream->Seek({}, STREAM_SEEK_END, &end);
  int taken = 0;
  for (ULONGLONG length = end.QuadPart; length-- > 0;) {
    stream->SetSize({.QuadPart = length});
    begin();
    taken += SUCCEEDED(other.object.query<IPersistStreamInit>()->Load(stream.get()));
  }
  expect(taken == 0 && other.call(name).text() == usual,
         "a stream cut anywhere is refused and changes nothing");
  call(desk.diagnostics, L"Clear");
}

// --- Calls by name

void callsByName(const Desk&) {
  Hosted hosted;
  IDispatch& members = *hosted.members.get();
  DISPPARAMS none{};
  Value result;
  const auto invoke = [&](DISPID id, REFIID reserved, WORD flags, DISPPARAMS& parameters) {
    return members.Invoke(id, reserved, LOCALE_USER_DEFAULT, flags, &parameters, result.get(), nullptr,
                          nullptr);
  };
  expect(invoke(DISPID_READYSTATE, IID_NULL, DISPATCH_PROPERTYGET, none) == DISP_E_MEMBERNOTFOUND,
         "what a page probes for is answered quietly");
  expect(invoke(15, IID_IUnknown, DISPATCH_PROPERTYGET, none) == DISP_E_UNKNOWNINTERFACE,
         "the reserved interface must be none");
  Value caption(L"Both ways");
  DISPID put = DISPID_PROPERTYPUT;
  DISPPARAMS parameters{caption.get(), &put, 1, 1};
  expect(
      invoke(DISPID_CAPTION, IID_NULL, DISPATCH_PROPERTYPUT | DISPATCH_PROPERTYPUTREF, parameters) == S_OK &&
          call(members, L"Caption").text() == L"Both ways",
      "a property takes both kinds of put at once");
  // As script hosts pass variables: by reference to a variant of whatever type.
  Value variables[] = {Value(true), Value(314.0), Value(L"0"), Value(L"Variable")};
  std::vector<VARIANT> references(4);
  for (int i = 0; i < 4; ++i) {
    V_VT(&references[i]) = VT_BYREF | VT_VARIANT;
    V_VARIANTREF(&references[i]) = variables[i].get();
  }
  expect(callRaw(members, L"vfpSet", references).number() == 0 &&
             call(members, L"Caption").text() == L"Variable",
         "variables of any type convert");
}

using ClassObject = HRESULT(WINAPI*)(REFCLSID, REFIID, void**);
struct Elsewhere {
  ClassObject function;
  HRESULT answer;
};

DWORD WINAPI askElsewhere(void* argument) {
  auto& elsewhere = *static_cast<Elsewhere*>(argument);
  ComPointer<IClassFactory> factory;
  elsewhere.answer = elsewhere.function(classOf(L"FrontPanels.DataHub"), IID_IClassFactory,
                                        reinterpret_cast<void**>(factory.receive()));
  return 0;
}

void countsEveryHolder() {
  chapter("library");
  ComPointer<IEnumConnectionPoints> points;
  {
    Hosted hosted;
    hosted.object.query<IConnectionPointContainer>()->EnumConnectionPoints(points.receive());
  }
  const HMODULE library = GetModuleHandleW(L"frontpanels.ocx");
  const auto canUnload = reinterpret_cast<HRESULT(WINAPI*)()>(
      reinterpret_cast<void*>(GetProcAddress(library, "DllCanUnloadNow")));
  const auto classObject =
      reinterpret_cast<ClassObject>(reinterpret_cast<void*>(GetProcAddress(library, "DllGetClassObject")));
  expect(canUnload() == S_FALSE, "an enumerator keeps it loaded");
  Elsewhere elsewhere{classObject, S_OK};
  const HANDLE thread = CreateThread(nullptr, 0, askElsewhere, &elsewhere, 0, nullptr);
  WaitForSingleObject(thread, INFINITE);
  CloseHandle(thread);
  expect(elsewhere.answer == RPC_E_WRONG_THREAD, "a second thread is turned away while it is in use");
  IConnectionPoint* fetched[3] = {};
  ULONG number = 0;
  expect(points->Next(3, fetched, &number) == S_FALSE && number == 2,
         "the control has two connection points");
  for (IConnectionPoint* const point : fetched)
    if (point != nullptr) point->Release();
  points.reset();
  expect(canUnload() == S_OK, "when the last holder goes it may go, too");
  ComPointer<IUnknown> nothing;
  expect(classObject(IID_IUnknown, IID_IUnknown, reinterpret_cast<void**>(nothing.receive())) ==
             CLASS_E_CLASSNOTAVAILABLE,
         "it makes no class that is not its own");
}

// Hosts exist in which a division by zero is an exception of the processor.
void worksWithoutMaskedExceptions(const Desk& desk) {
  Sited hosted(desk.window, OLEIVERB_INPLACEACTIVATE);
  std::vector<float> gaps = carrier();
  gaps[100] = std::numeric_limits<float>::quiet_NaN();
  gaps[101] = std::numeric_limits<float>::infinity();
  const unsigned unmasked = _MCW_EM & ~static_cast<unsigned>(_EM_INVALID | _EM_ZERODIVIDE | _EM_OVERFLOW);
  const unsigned before = _controlfp(0, 0);
  _controlfp(unmasked, _MCW_EM);
  publish(gaps);
  hosted.call(L"vfpSet", {0, 14, 0, 0.0});
  UpdateWindow(hosted.window());
  const unsigned after = _controlfp(0, 0);
  _controlfp(before, _MCW_EM);
  expect((after & _MCW_EM) == unmasked, "gaps are drawn, and the host's settings put back");
}

constexpr struct {
  const char* name;
  void (*check)(const Desk& desk);
} kChapters[] = {{"requests", answersOfTheHost},
                 {"settings for keeping", settingsForKeeping},
                 {"any value at all", anyValueAtAll},
                 {"closed in its own request", closedInItsOwnRequest},
                 {"messages", showsBoxesToUsersOnly},
                 {"place", tellsItsPlace},
                 {"designer", staysQuietInADesigner},
                 {"activation", activatesStepByStep},
                 {"lost window", losesItsWindow},
                 {"half states", leavesNoHalfState},
                 {"sites", changesItsSite},
                 {"keys", sharesTheKeys},
                 {"mouse", capturesTheMouse},
                 {"window", paintsAllOfItself},
                 {"property bag", keepsPropertiesInABag},
                 {"storage", keepsStateInAStorage},
                 {"texts", keepsTexts},
                 {"calls by name", callsByName},
                 {"floating point", worksWithoutMaskedExceptions}};

// --- A container of somebody else's

using ControlOf = HRESULT(WINAPI*)(HWND, IUnknown**);

ControlOf foreignContainer(const wchar_t* libraryName) {
  const HMODULE library = LoadLibraryW(libraryName);
  const auto initialise =
      reinterpret_cast<BOOL(WINAPI*)()>(reinterpret_cast<void*>(GetProcAddress(library, "AtlAxWinInit")));
  expect(library != nullptr && initialise != nullptr && initialise() != FALSE,
         "a foreign container is there");
  return reinterpret_cast<ControlOf>(reinterpret_cast<void*>(GetProcAddress(library, "AtlAxGetControl")));
}

void standsInAForeignContainer(ControlOf controlOf) {
  chapter("foreign container");
  const HWND frame = CreateWindowExW(0, L"STATIC", L"", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 0, 0, 700, 600,
                                     nullptr, nullptr, nullptr, nullptr);
  const HWND host = CreateWindowExW(0, L"AtlAxWin", panelClass().c_str(), WS_CHILD | WS_VISIBLE, 20, 20, 600,
                                    400, frame, nullptr, nullptr, nullptr);
  ComPointer<IUnknown> control;
  expect(host != nullptr && controlOf(host, control.receive()) == S_OK, "creates the control by its name");
  const auto members = control.query<IDispatch>();
  const auto inPlace = control.query<IOleInPlaceObject>();
  if (!members) return;
  expect(call(*members.get(), L"vfpOp", {0, 10, panelKind().resultType}).number() == 0, "passes calls on");
  publish(carrier());
  pumpMessages();
  HWND view = nullptr;
  inPlace->GetWindow(&view);
  RECT client{};
  GetClientRect(view, &client);
  expect(GetParent(view) == host && client.right == 600 && client.bottom == 400,
         "gives it all of its window");
  const HDC dc = GetDC(view);
  expect(pixelsOf(dc, client, kTraceColor) > 200, "shows the sweep");
  MoveWindow(host, 20, 20, 500, 300, TRUE);
  pumpMessages();
  GetClientRect(view, &client);
  expect(client.right == 500 && client.bottom == 300 && pixelsOf(dc, client, kTraceColor) > 150,
         "also in another size");
  ReleaseDC(view, dc);
  control = {};
  DestroyWindow(frame);
  expect(!IsWindow(view), "closes it with its window");
}

}  // namespace

int check(int count, wchar_t** arguments) {
  const auto checks = [=](const Desk& desk) {
    if (count == 3 && std::wstring(arguments[1]) == L"atl") {
      const ControlOf controlOf = foreignContainer(arguments[2]);
      return onEachPanel([controlOf] { standsInAForeignContainer(controlOf); });
    }
    onEachPanel([&] {
      for (const auto& [name, check] : kChapters) {
        chapter(name);
        check(desk);
      }
    });
    chapter("all chapters");
  };
  return runChecks({800, 600}, checks, countsEveryHolder);
}

}  // namespace frontpanels::testing

int wmain(int count, wchar_t** arguments) { return frontpanels::testing::check(count, arguments); }

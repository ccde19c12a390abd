#include "activex/in_place_part.h"

#include <algorithm>
#include <iterator>
#include <utility>

#include "activex/barrier.h"

namespace frontpanels::activex {
namespace {

constexpr wchar_t kObjectName[] = L"Front Panels";

// Keys that move the caret of a field. Those of the graph never come this far.
constexpr WPARAM kArrowKeys[] = {VK_LEFT, VK_RIGHT, VK_UP, VK_DOWN, VK_HOME, VK_END};

bool isArrow(WPARAM key) {
  return std::find(std::begin(kArrowKeys), std::end(kArrowKeys), key) != std::end(kArrowKeys);
}

DWORD modifierState() {
  const auto down = [](int key) { return GetKeyState(key) < 0; };
  return (down(VK_SHIFT) ? 1U : 0U) | (down(VK_CONTROL) ? 2U : 0U) | (down(VK_MENU) ? 4U : 0U);
}

// Enter in a field is the field's, whatever a default button of the container would make of it.
HRESULT dispatch(const MSG& message) {
  TranslateMessage(&message);
  DispatchMessageW(&message);
  return S_OK;
}

}  // namespace

void InPlacePart::activate(HWND parent, const RECT* place) {
  if (!active_) enterSite(parent, place);
  core().window().visible(true);
}

// In each answer the container may end what has only begun.
void InPlacePart::enterSite(HWND parent, const RECT* place) {
  deactivate();  // of a window that went with its container's
  const auto site = core().site().query<IOleInPlaceSite>();
  if (!site || site->CanInPlaceActivate() != S_OK) throw ComFailure(E_FAIL);
  check(site->OnInPlaceActivate());
  inPlaceSite_ = site;
  HWND container = parent;
  if (FAILED(site->GetWindow(&container)) || container == nullptr) container = parent;
  RECT area{};
  RECT clip{};
  OLEINPLACEFRAMEINFO info{};
  info.cb = sizeof info;
  const bool told =
      SUCCEEDED(site->GetWindowContext(frame_.receive(), document_.receive(), &area, &clip, &info));
  if (!told && place != nullptr) area = *place;
  try {
    if (inPlaceSite_) core().window().create(container, area);
    if (inPlaceSite_) addBoxOwner(*this);
  } catch (...) {
    deactivate();
    throw;
  }
  if (!inPlaceSite_) {
    core().window().destroy();
    throw ComFailure(E_FAIL);
  }
  active_ = true;
  takePlace(area, told ? &clip : nullptr);
  if (const ComPointer<IOleClientSite> client = core().site()) client->ShowObject();
}

void InPlacePart::takePlace(const RECT& place, const RECT* clip) {
  core().placePx(place);
  core().window().place(place, clip);
  core().adoptSize({place.right - place.left, place.bottom - place.top});
}

void InPlacePart::requestPlace(const RECT& place) {
  if (const ComPointer<IOleInPlaceSite> site = inPlaceSite_) site->OnPosRectChange(&place);
}

void InPlacePart::activateUi() {
  if (!active_ || uiActive_) return;
  uiActive_ = true;
  const ComPointer<IUnknown> alive(core().outer());
  const ComPointer<IOleInPlaceSite> site = inPlaceSite_;  // may close in its answer
  site->OnUIActivate();
  // In each answer the container may change its mind.
  if (active_ && core().inUse() && !core().window().hasFocus()) SetFocus(core().window().window());
  if (active_) nameActiveObject(this);
}

void InPlacePart::nameActiveObject(IOleInPlaceActiveObject* object) {
  const ComPointer<IOleInPlaceFrame> frame = frame_;
  const ComPointer<IOleInPlaceUIWindow> document = document_;
  const wchar_t* const name = object != nullptr ? kObjectName : nullptr;
  if (frame) frame->SetActiveObject(object, name);
  if (document) document->SetActiveObject(object, name);
  if (object == nullptr) return;
  // The control brings no tool bars: whatever room the containers offer for them is theirs.
  if (frame) frame->SetBorderSpace(nullptr);
  if (document) document->SetBorderSpace(nullptr);
}

void InPlacePart::hide() {
  deactivateUi();
  core().window().visible(false);
}

// The state is cleared before the container hears of it: it may call back with anything.
void InPlacePart::deactivateUi() {
  if (!std::exchange(uiActive_, false)) return;
  const ComPointer<IOleInPlaceSite> site = inPlaceSite_;
  nameActiveObject(nullptr);
  if (site) site->OnUIDeactivate(FALSE);
}

void InPlacePart::deactivate() {
  if (!inPlaceSite_) return;
  const ComPointer<IUnknown> alive(core().outer());
  deactivateUi();
  active_ = false;
  removeBoxOwner(*this);
  core().window().destroy();
  const ComPointer<IOleInPlaceSite> site = std::exchange(inPlaceSite_, {});
  const ComPointer<IOleInPlaceFrame> frame = std::exchange(frame_, {});
  const ComPointer<IOleInPlaceUIWindow> document = std::exchange(document_, {});
  if (site) site->OnInPlaceDeactivate();
  core().viewChanged();  // whatever the window has shown meanwhile
}

void InPlacePart::windowLost() noexcept {
  active_ = false;
  uiActive_ = false;
  removeBoxOwner(*this);
}

void InPlacePart::enableHost(bool enable) noexcept {
  if (const ComPointer<IOleInPlaceFrame> frame = frame_) frame->EnableModeless(enable);
}

HRESULT InPlacePart::GetWindow(HWND* window) {
  if (window == nullptr) return E_POINTER;
  *window = core().window().window();
  return *window != nullptr ? S_OK : E_FAIL;
}

HRESULT InPlacePart::InPlaceDeactivate() {
  return entry([&] { deactivate(); });
}

HRESULT InPlacePart::UIDeactivate() {
  return entry([&] { deactivateUi(); });
}

HRESULT InPlacePart::SetObjectRects(LPCRECT place, LPCRECT clip) {
  if (place == nullptr) return E_POINTER;
  return entry([&] { takePlace(*place, clip); });
}

HRESULT InPlacePart::TranslateAccelerator(LPMSG message) {
  if (message == nullptr) return E_POINTER;
  return entry([&]() -> HRESULT {
    if (core().window().translateKey(*message)) return S_OK;
    const bool pressed = message->message == WM_KEYDOWN;
    if ((pressed || message->message == WM_CHAR) && core().window().hasFocus()) {
      const LRESULT wanted =
          SendMessageW(message->hwnd, WM_GETDLGCODE, message->wParam, reinterpret_cast<LPARAM>(message));
      if (pressed && (wanted & DLGC_WANTMESSAGE) != 0) return dispatch(*message);
      const bool own = pressed ? (wanted & DLGC_WANTARROWS) != 0 && isArrow(message->wParam)
                               : (wanted & DLGC_WANTCHARS) != 0;
      if (own) return S_FALSE;
    }
    const auto site = core().site().query<IOleControlSite>();
    return site && site->TranslateAccelerator(message, modifierState()) == S_OK ? S_OK : S_FALSE;
  });
}

}  // namespace frontpanels::activex

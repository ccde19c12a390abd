#include "activex/panel_window.h"

#include <windowsx.h>

#include <algorithm>
#include <cwchar>
#include <iterator>
#include <new>
#include <utility>

#include "activex/accessible_field.h"
#include "activex/barrier.h"
#include "activex/context_menu.h"
#include "activex/module.h"
#include "activex/printed_window.h"
#include "activex/services.h"
#include "framework/panel/fields_picture.h"
#include "framework/support/flag_scope.h"
#include "platform/control_names.h"
#include "platform/win32/field_fonts.h"
#include "platform/win32/win32_windowing.h"

namespace frontpanels::activex {
namespace {

struct ButtonRow {
  UINT down;
  UINT doubleClick;
  UINT up;
  std::int16_t button;
};
constexpr ButtonRow kButtons[] = {
    {WM_LBUTTONDOWN, WM_LBUTTONDBLCLK, WM_LBUTTONUP, 1},
    {WM_RBUTTONDOWN, WM_RBUTTONDBLCLK, WM_RBUTTONUP, 2},
    {WM_MBUTTONDOWN, WM_MBUTTONDBLCLK, WM_MBUTTONUP, 4},
};

// Named by the headers of later systems only.
constexpr UINT kDpiChangedAfterParent = 0x02E3;

std::int16_t shiftState() {
  const auto down = [](int key) { return GetKeyState(key) < 0; };
  return static_cast<std::int16_t>((down(VK_SHIFT) ? 1 : 0) | (down(VK_CONTROL) ? 2 : 0) |
                                   (down(VK_MENU) ? 4 : 0));
}

std::int16_t buttonsHeld(WPARAM keys) {
  return static_cast<std::int16_t>(((keys & MK_LBUTTON) != 0 ? 1 : 0) | ((keys & MK_RBUTTON) != 0 ? 2 : 0) |
                                   ((keys & MK_MBUTTON) != 0 ? 4 : 0));
}

// The class outlives a module that is unloaded and would then point into nothing: a name of its own for each
// address that the module is loaded at keeps a later copy from finding the old one.
const wchar_t* windowClass(WNDPROC procedure) {
  static wchar_t name[64];
  static const bool registered = [procedure] {
    std::swprintf(name, std::size(name), L"FrontPanels.Graph.%p", reinterpret_cast<void*>(procedure));
    WNDCLASSEXW description{};
    description.cbSize = sizeof description;
    // A context of its own: the view's handle stays the same while the window lives.
    description.style = CS_OWNDC | CS_DBLCLKS;
    description.lpfnWndProc = procedure;
    description.hInstance = moduleHandle();
    description.lpszClassName = name;
    return RegisterClassExW(&description) != 0 || GetLastError() == ERROR_CLASS_ALREADY_EXISTS;
  }();
  if (!registered) throw ComFailure(E_FAIL);
  return name;
}

// The control stays alive while its window handles a message: a host may release it inside its own event.
class HeldControl {
 public:
  explicit HeldControl(WindowOwner& owner) noexcept : owner_(owner) { owner_.holdControl(); }
  ~HeldControl() { owner_.releaseControl(); }
  HeldControl(const HeldControl&) = delete;
  HeldControl& operator=(const HeldControl&) = delete;

 private:
  WindowOwner& owner_;
};

}  // namespace

// --- Pictures in memory

void MemoryPicture::create(Size sizePx) {
  release();
  BITMAPINFO info{};
  info.bmiHeader.biSize = sizeof info.bmiHeader;
  info.bmiHeader.biWidth = sizePx.width;
  info.bmiHeader.biHeight = -sizePx.height;
  info.bmiHeader.biPlanes = 1;
  info.bmiHeader.biBitCount = 32;
  dc_ = CreateCompatibleDC(nullptr);
  void* bits = nullptr;
  if (dc_ != nullptr) bitmap_ = CreateDIBSection(dc_, &info, DIB_RGB_COLORS, &bits, nullptr, 0);
  if (bitmap_ == nullptr) {
    release();
    throw std::bad_alloc();
  }
  previous_ = SelectObject(dc_, bitmap_);
  pixels_ = static_cast<std::uint32_t*>(bits);
  sizePx_ = sizePx;
  const RECT all{0, 0, sizePx.width, sizePx.height};
  FillRect(dc_, &all, GetSysColorBrush(COLOR_BTNFACE));
}

void MemoryPicture::release() noexcept {
  if (previous_ != nullptr) SelectObject(dc_, previous_);
  if (bitmap_ != nullptr) DeleteObject(bitmap_);
  if (dc_ != nullptr) DeleteDC(dc_);
  dc_ = nullptr;
  bitmap_ = nullptr;
  previous_ = nullptr;
  pixels_ = nullptr;
  sizePx_ = {};
}

// --- The window

PanelWindow::PanelWindow(WindowOwner& owner, ScreenMetrics metrics, Size initialSizePx)
    : owner_(owner), voice_(*this, owner), metrics_(metrics), memorySizePx_(initialSizePx) {}

PanelWindow::~PanelWindow() { destroy(); }

void PanelWindow::fields(ControlSet* fields) {
  fields_.reset();
  controls_ = fields;
  FieldsOwner& owner = *this;
  if (fields != nullptr) fields_.emplace(*fields, owner);
}

void PanelWindow::font(HFONT font) {
  font_ = font;
  if (window_ != nullptr && fields_) fields_->rescale(font_, dotsPerInch(metrics_));
}

void PanelWindow::followScale() {
  const ScreenMetrics now = metricsOf(window_);
  if (dotsPerInch(now) == dotsPerInch(metrics_)) return;
  metrics_ = now;
  if (events_ != nullptr) events_->rescaled(metrics_);
  if (window_ != nullptr && fields_) fields_->rescale(font_, dotsPerInch(metrics_));
}

void PanelWindow::create(HWND parent, const RECT& place) {
  const wchar_t* const className = windowClass(windowProcedure);
  window_ = CreateWindowExW(
      0, className, caption_.c_str(), WS_CHILD | WS_CLIPSIBLINGS | WS_CLIPCHILDREN | WS_TABSTOP, place.left,
      place.top, place.right - place.left, place.bottom - place.top, parent, nullptr, moduleHandle(), this);
  if (window_ == nullptr) throw ComFailure(HRESULT_FROM_WIN32(GetLastError()));
  windowDC_ = GetDC(window_);
  memory_.release();
  followScale();
  if (fields_) {
    try {
      fields_->create(window_, font_, dotsPerInch(metrics_));
    } catch (...) {
      destroy();
      throw;
    }
  }
  if (events_ != nullptr) events_->resized();
}

void PanelWindow::caption(const std::wstring& text) {
  caption_ = text;
  if (window_ != nullptr) SetWindowTextW(window_, caption_.c_str());
}

void PanelWindow::destroy() noexcept {
  if (window_ != nullptr) DestroyWindow(window_);
}

void PanelWindow::place(const RECT& rect, const RECT* clip) {
  if (window_ == nullptr) return;
  SetWindowPos(window_, nullptr, rect.left, rect.top, rect.right - rect.left, rect.bottom - rect.top,
               SWP_NOZORDER | SWP_NOACTIVATE);
  RECT shown = rect;
  // Some pages hand over an empty clip for "no clip"; one beside the place leaves nothing to be seen.
  if (clip != nullptr && !IsRectEmpty(clip)) IntersectRect(&shown, clip, &rect);
  if (EqualRect(&shown, &rect)) {
    SetWindowRgn(window_, nullptr, TRUE);
    return;
  }
  OffsetRect(&shown, -rect.left, -rect.top);
  SetWindowRgn(window_, CreateRectRgnIndirect(&shown), TRUE);  // the window owns the region now
}

void PanelWindow::resizeMemory(Size sizePx) {
  if (sizePx.width <= 0 || sizePx.height <= 0 || sizePx == memorySizePx_) return;
  memorySizePx_ = sizePx;
  if (window_ == nullptr && events_ != nullptr) events_->resized();
}

void PanelWindow::draw(PictureGdi& gdi, HDC dc, const RECTL& bounds) {
  if (events_ == nullptr) return;
  const DcHandle view = hdc();
  const Size size = clientSizePx();
  const Rect graph = events_->paintedAreaPx();
  const PictureGdi::Picture picture(gdi,
                                    {dc, bounds, size, view, events_->surface(), {graph.left, graph.top}});
  gdi.fillRect(view, {0, 0, size.width, size.height}, gdi.sysColorBrush(SystemColor::ButtonFace));
  {
    const FlagScope drawing(drawing_);
    events_->paint();
  }
  if (controls_ == nullptr) return;
  const FieldFonts fonts(font_, dotsPerInch(metrics_));
  paintFields(gdi, view, *controls_, size, dotsPerInch(metrics_), [&fonts](const Control& control) {
    return FontHandle{reinterpret_cast<std::uintptr_t>(fonts.of(control))};
  });
}

void PanelWindow::renderGraph(MemoryPicture& picture) {
  picture.create(events_ == nullptr ? clientSizePx() : events_->graphSizePx());
  if (events_ == nullptr) return;
  const HDC before = std::exchange(rendering_, picture.dc());
  const FlagScope drawing(drawing_);
  const HRESULT painted = barrier([&] { events_->paint(); });
  rendering_ = before;
  check(painted);
}

DcHandle PanelWindow::hdc() {
  HDC current = rendering_ != nullptr ? rendering_ : windowDC_;
  if (current == nullptr) {
    if (memory_.sizePx() != memorySizePx_) memory_.create(memorySizePx_);
    current = memory_.dc();
  }
  return {reinterpret_cast<std::uintptr_t>(current)};
}

Size PanelWindow::clientSizePx() {
  if (window_ == nullptr) return memorySizePx_;
  RECT client{};
  GetClientRect(window_, &client);
  return {std::max<std::int32_t>(client.right, 1), std::max<std::int32_t>(client.bottom, 1)};
}

void PanelWindow::mousePointer(MousePointer pointer) {
  if (pointer == pointer_) return;
  pointer_ = pointer;
  if (window_ != nullptr) showPointer();
}

void PanelWindow::showPointer() const {
  const wchar_t* const shape = pointer_ == MousePointer::SizeNorthSouth ? IDC_SIZENS
                               : pointer_ == MousePointer::SizeEastWest ? IDC_SIZEWE
                                                                        : IDC_ARROW;
  SetCursor(LoadCursorW(nullptr, shape));
}

void PanelWindow::visible(bool visible) {
  visible_ = visible;
  if (window_ != nullptr) ShowWindow(window_, visible ? SW_SHOWNA : SW_HIDE);
}

void PanelWindow::refresh() {
  if (window_ != nullptr) InvalidateRect(window_, nullptr, FALSE);
}

void PanelWindow::painted() {
  voice_.painted();
  if (window_ == nullptr && !drawing_) owner_.viewChanged();
}

// --- Messages

LRESULT CALLBACK PanelWindow::windowProcedure(HWND window, UINT message, WPARAM wParam,
                                              LPARAM lParam) noexcept {
  if (message == WM_NCCREATE) {
    const auto* const creation = reinterpret_cast<const CREATESTRUCTW*>(lParam);
    SetWindowLongPtrW(window, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(creation->lpCreateParams));
    static_cast<PanelWindow*>(creation->lpCreateParams)->window_ = window;
  }
  auto* const self = reinterpret_cast<PanelWindow*>(GetWindowLongPtrW(window, GWLP_USERDATA));
  if (self == nullptr) return DefWindowProcW(window, message, wParam, lParam);
  const HeldControl held(self->owner_);
  LRESULT result = 0;
  barrier([&] { result = self->handle(message, wParam, lParam); });
  if (self->events_ != nullptr) barrier([&] { self->events_->settled(); });
  if (message == WM_NCDESTROY) {
    SetWindowLongPtrW(window, GWLP_USERDATA, 0);
    self->window_ = nullptr;
    self->windowDC_ = nullptr;
    self->focused_ = false;
    self->voice_.windowGone();
    if (self->fields_) self->fields_->destroy();
    self->owner_.windowDestroyed();
  }
  return result;
}

LRESULT PanelWindow::handle(UINT message, WPARAM wParam, LPARAM lParam) {
  LRESULT result = 0;
  if (fields_ && fields_->parentMessage(message, wParam, lParam, result)) return result;
  switch (message) {
    case WM_PAINT:
      return paint(), 0;
    case WM_ERASEBKGND:
      return 1;  // all of the view is painted at once; erasing it before would flicker
    case WM_PRINT:
    case WM_PRINTCLIENT:
      return print(reinterpret_cast<HDC>(wParam)), 0;
    case WM_SIZE:
      if (windowDC_ == nullptr) return 0;
      followScale();  // a program need not be told of another screen before its size
      if (events_ != nullptr) events_->resized();
      return 0;
    case kDpiChangedAfterParent:
      return followScale(), 0;
    case WM_SYSCOLORCHANGE:
    case WM_SETTINGCHANGE:
    case WM_THEMECHANGED:
      services().gdi.settingsChanged();
      if (events_ != nullptr && windowDC_ != nullptr) events_->resized();  // makes the picture anew
      if (window_ == nullptr) return 0;  // a report may have let the host close
      RedrawWindow(window_, nullptr, nullptr, RDW_INVALIDATE | RDW_ALLCHILDREN);
      return DefWindowProcW(window_, message, wParam, lParam);
    case WM_SETFOCUS:
      return takeFocus(), 0;
    case WM_KILLFOCUS:
      return focusMoved(reinterpret_cast<HWND>(wParam)), 0;
    default:
      return handleInput(message, wParam, lParam);
  }
}

LRESULT PanelWindow::handleInput(UINT message, WPARAM wParam, LPARAM lParam) {
  for (const ButtonRow& row : kButtons) {
    if (message == row.down || message == row.doubleClick) return press(row.button, lParam), 0;
    if (message == row.up) {
      release(row.button, wParam, lParam);
      return row.up == WM_RBUTTONUP ? DefWindowProcW(window_, message, wParam, lParam) : 0;
    }
  }
  switch (message) {
    case WM_MOUSEACTIVATE:
      if (owner_.inUse()) owner_.pressed();
      return MA_ACTIVATE;
    case WM_MOUSEMOVE:
      if (events_ != nullptr && owner_.inUse()) events_->mouseMove(mouseEvent(buttonsHeld(wParam), lParam));
      return 0;
    case WM_KEYDOWN:
    case WM_SYSKEYDOWN:
    case WM_SYSCHAR:
      if (untranslatedKey(message, wParam)) return 0;
      break;
    case WM_GETOBJECT:
      if (asksForClient(lParam)) return voice_.answer(wParam);
      break;
    case WM_GETDLGCODE:
      return dialogCode(reinterpret_cast<const MSG*>(lParam));
    case WM_CONTEXTMENU:
      if (reinterpret_cast<HWND>(wParam) == window_ && showMenu(lParam)) return 0;
      break;
    case WM_SETCURSOR:
      if (LOWORD(lParam) != HTCLIENT || pointer_ == MousePointer::Default) break;
      return showPointer(), TRUE;
    default:
      break;
  }
  return DefWindowProcW(window_, message, wParam, lParam);
}

void PanelWindow::paint() {
  PAINTSTRUCT description;
  const HWND painted = window_;
  services().gdi.settingsChanged();  // a child may hear of new colours by having to paint only
  const HDC dc = BeginPaint(painted, &description);
  // Also when the panel fails: a window that is not validated asks to be painted for ever.
  barrier([&] {
    fillMargins(dc);
    if (events_ != nullptr) events_->paint();
  });
  EndPaint(painted, &description);
}

void PanelWindow::paintInto(HDC dc) {
  const HDC before = std::exchange(rendering_, dc);
  barrier([&] {
    fillMargins(dc);
    if (events_ != nullptr) events_->paint();
  });
  rendering_ = before;
}

void PanelWindow::print(HDC dc) {
  paintInto(dc);
  printChildren(window_, dc);
}

void PanelWindow::fillMargins(HDC dc) {
  const Size size = clientSizePx();
  const RECT all{0, 0, size.width, size.height};
  const Rect graph = events_ != nullptr ? events_->paintedAreaPx() : Rect{};
  const int saved = SaveDC(dc);
  ExcludeClipRect(dc, graph.left, graph.top, graph.right, graph.bottom);
  FillRect(dc, &all, GetSysColorBrush(COLOR_BTNFACE));
  RestoreDC(dc, saved);
}

// The capture is taken before the press goes on: a splitter bar takes it in turn and expects to find a window
// that held it.
void PanelWindow::press(std::int16_t button, LPARAM position) {
  if (!owner_.inUse()) return;
  SetFocus(window_);
  if (window_ == nullptr) return;  // a field that lost the focus may have had the panel closed
  SetCapture(window_);
  if (events_ != nullptr) events_->mouseDown(mouseEvent(button, position));
}

// The capture ends with the last button.
void PanelWindow::release(std::int16_t button, WPARAM keys, LPARAM position) {
  if (events_ != nullptr && owner_.inUse()) events_->mouseUp(mouseEvent(button, position));
  if (buttonsHeld(keys) == 0 && window_ != nullptr && GetCapture() == window_) ReleaseCapture();
}

// --- Keys and focus

void PanelWindow::run(const std::function<void()>& body) noexcept {
  const HeldControl held(owner_);
  barrier(body);
  if (events_ != nullptr) barrier([&] { events_->settled(); });
}

bool PanelWindow::translateKey(const MSG& message) {
  if (window_ == nullptr || !owner_.inUse()) return false;
  if (message.hwnd == window_ && message.message == WM_KEYDOWN && events_ != nullptr &&
      events_->keyDown(static_cast<std::int16_t>(message.wParam), shiftState()))
    return true;
  // What the key has led to may have closed the panel.
  if (!fields_ || window_ == nullptr) return false;
  const bool tab = message.message == WM_KEYDOWN && message.wParam == VK_TAB && GetKeyState(VK_SHIFT) >= 0 &&
                   GetKeyState(VK_CONTROL) >= 0;
  if (tab && message.hwnd == window_) return fields_->enter(true);
  return fields_->translateKey(message);
}

bool PanelWindow::untranslatedKey(UINT message, WPARAM key) {
  if (!owner_.inUse()) return false;
  return translateKey(MSG{window_, message, key, 0, 0, {}}) ||
         (fields_ && fields_->untranslatedKey(message, key));
}

// A dialog asks for each key, and for the character that a letter types: that goes where its key goes.
LRESULT PanelWindow::dialogCode(const MSG* message) {
  const LRESULT tab = fields_ ? DLGC_WANTTAB : 0;
  if (message == nullptr) return tab | DLGC_WANTARROWS;
  const WPARAM letter = message->wParam & ~WPARAM{0x20};
  const bool pressed = message->message == WM_KEYDOWN;
  const bool typed = message->message == WM_CHAR && letter >= 'A' && letter <= 'Z';
  if ((!pressed && !typed) || events_ == nullptr || !owner_.inUse()) return tab;
  const auto key = static_cast<std::int16_t>(pressed ? message->wParam : letter);
  return tab | (events_->usesKey(key, shiftState()) ? DLGC_WANTMESSAGE : 0);
}

bool PanelWindow::holds(HWND window) const noexcept {
  return window != nullptr && window_ != nullptr && (window == window_ || IsChild(window_, window));
}

// What a field does when it is left may have sent the focus elsewhere in the meantime.
void PanelWindow::focusMoved(HWND to) {
  const HWND now = GetFocus();
  const bool focused = holds(now != nullptr ? now : to);
  if (std::exchange(focused_, focused) != focused) owner_.focusChanged(focused);
}

// Who comes with Tab from outside wants to go through the fields; who comes with the mouse wants the graph.
void PanelWindow::takeFocus() {
  const bool entered = !focused_;
  focusMoved(window_);
  if (entered && fields_ && GetFocus() == window_ && GetKeyState(VK_TAB) < 0 && owner_.inUse())
    fields_->enter(GetKeyState(VK_SHIFT) >= 0);
}

std::u32string PanelWindow::accessKeys() const {
  return controls_ == nullptr || window_ == nullptr ? std::u32string() : controls_->accessKeys();
}

bool PanelWindow::accessKey(WPARAM key) {
  return window_ != nullptr && translateKey(MSG{window_, WM_SYSCHAR, key, 0, 0, {}});
}

bool PanelWindow::readAloud(const Control& control, HWND window, WPARAM flags, LRESULT& result) {
  if (controls_ == nullptr || control.kind() == ControlKind::Label) return false;
  result =
      accessibleField(window, flags, {spokenName(*controls_, control), spokenShortcut(*controls_, control)});
  return result != 0;
}

// --- Mouse and menu

// Without a position it was a key: the menu then opens in the middle of the graph.
bool PanelWindow::showMenu(LPARAM position) {
  if (events_ == nullptr || !owner_.inUse()) return false;
  const std::vector<PanelMenuItem> items = events_->contextMenu();
  if (items.empty()) return false;
  POINT at{GET_X_LPARAM(position), GET_Y_LPARAM(position)};
  if (position == -1) {
    const Size graph = events_->graphSizePx();
    at = {graph.width / 2, graph.height / 2};
    ClientToScreen(window_, &at);
  }
  const PanelMenuItem* const chosen = chooseFromMenu(window_, at, items);
  // The panel may have gone while the menu was open.
  if (chosen != nullptr && events_ != nullptr && window_ != nullptr) events_->contextMenuClick(chosen->id);
  return true;
}

MouseEvent PanelWindow::mouseEvent(std::int16_t button, LPARAM position) const {
  return {button, shiftState(), static_cast<float>(GET_X_LPARAM(position)) * metrics_.twipsPerPixelX,
          static_cast<float>(GET_Y_LPARAM(position)) * metrics_.twipsPerPixelY};
}

}  // namespace frontpanels::activex

#include "workbench/panel_window.h"

#include <windowsx.h>

#include <utility>

#include "workbench/failure.h"
#include "workbench/screen_scale.h"

namespace frontpanels::workbench {
namespace {

constexpr const wchar_t* kClassName = L"FrontPanelsPanel";
// At 96 dots an inch.
constexpr SIZE kSmallest = {240, 180};

void registerClass(WNDPROC procedure) {
  WNDCLASSEXW windowClass{};
  windowClass.cbSize = sizeof windowClass;
  windowClass.lpfnWndProc = procedure;
  windowClass.hInstance = GetModuleHandleW(nullptr);
  windowClass.hIcon = LoadIconW(nullptr, IDI_APPLICATION);
  windowClass.hCursor = LoadCursorW(nullptr, IDC_ARROW);
  windowClass.hbrBackground = GetSysColorBrush(COLOR_BTNFACE);
  windowClass.lpszClassName = kClassName;
  if (RegisterClassExW(&windowClass) == 0 && GetLastError() != ERROR_CLASS_ALREADY_EXISTS)
    raiseLastError("Registering the panels' window class");
}

}  // namespace

PanelWindow::PanelWindow(PanelFrame& frame, PanelWindowEvents& events, const std::wstring& title)
    : frame_(frame), events_(events), title_(title) {
  registerClass(windowProcedure);
  const HWND window = CreateMDIWindowW(kClassName, title.c_str(), WS_CLIPCHILDREN, CW_USEDEFAULT,
                                       CW_USEDEFAULT, CW_USEDEFAULT, CW_USEDEFAULT, frame.clientWindow(),
                                       GetModuleHandleW(nullptr), reinterpret_cast<LPARAM>(this));
  if (window == nullptr) raiseLastError("Creating the panel's window");
}

PanelWindow::~PanelWindow() {
  control_ = nullptr;
  // A child that is only destroyed leaves the next one without the keys.
  if (window_ != nullptr)
    SendMessageW(frame_.clientWindow(), WM_MDIDESTROY, reinterpret_cast<WPARAM>(window_), 0);
}

PanelWindow* PanelWindow::of(HWND window) noexcept {
  if (window == nullptr ||
      reinterpret_cast<WNDPROC>(GetWindowLongPtrW(window, GWLP_WNDPROC)) != windowProcedure)
    return nullptr;
  return reinterpret_cast<PanelWindow*>(GetWindowLongPtrW(window, GWLP_USERDATA));
}

void PanelWindow::occupy(HostedControl* control) {
  control_ = control;
  if (control_ != nullptr && GetFocus() == window_) control_->focus();
}

// --- PanelPlace

RECT PanelWindow::panelRect() {
  RECT client{};
  GetClientRect(window_, &client);
  return client;
}

void PanelWindow::panelCaption(const std::wstring& text) {
  SetWindowTextW(window_, text.empty() ? title_.c_str() : text.c_str());
}

RECT PanelWindow::bounds() {
  WINDOWPLACEMENT placement{};
  placement.length = sizeof placement;
  GetWindowPlacement(window_, &placement);
  return placement.rcNormalPosition;
}

void PanelWindow::bounds(const RECT& wanted) {
  WINDOWPLACEMENT placement{};
  placement.length = sizeof placement;
  GetWindowPlacement(window_, &placement);
  placement.rcNormalPosition = wanted;
  if (!visible()) placement.showCmd = SW_HIDE;
  SetWindowPlacement(window_, &placement);
}

bool PanelWindow::visible() { return (GetWindowLongPtrW(window_, GWL_STYLE) & WS_VISIBLE) != 0; }

void PanelWindow::visible(bool visible) { ShowWindow(window_, visible ? SW_SHOW : SW_HIDE); }

LONG PanelWindow::viewState() {
  if (IsIconic(window_)) return kViewMinimised;
  return IsZoomed(window_) ? kViewMaximised : kViewNormal;
}

void PanelWindow::viewState(LONG state) {
  if (state == viewState()) return;
  const auto own = reinterpret_cast<WPARAM>(window_);
  switch (state) {
    case kViewNormal:
      SendMessageW(frame_.clientWindow(), WM_MDIRESTORE, own, 0);
      break;
    case kViewMinimised:
      ShowWindow(window_, SW_MINIMIZE);
      break;
    case kViewMaximised:
      SendMessageW(frame_.clientWindow(), WM_MDIMAXIMIZE, own, 0);
      break;
    default:
      throw HostFailure("A panel's window has no state " + std::to_string(state));
  }
}

// --- Messages

LRESULT PanelWindow::windowProcedure(HWND window, UINT message, WPARAM wide, LPARAM extra) noexcept {
  if (message == WM_NCCREATE) {
    const auto* const created = reinterpret_cast<CREATESTRUCTW*>(extra);
    const auto* const child = static_cast<MDICREATESTRUCTW*>(created->lpCreateParams);
    auto* const self = reinterpret_cast<PanelWindow*>(child->lParam);
    self->window_ = window;
    SetWindowLongPtrW(window, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(self));
  }
  auto* const self = reinterpret_cast<PanelWindow*>(GetWindowLongPtrW(window, GWLP_USERDATA));
  if (self == nullptr) return DefMDIChildProcW(window, message, wide, extra);
  try {
    return self->handle(message, wide, extra);
  } catch (...) {
    self->frame_.failed(currentFailure());
    return 0;
  }
}

LRESULT PanelWindow::handle(UINT message, WPARAM wide, LPARAM extra) {
  switch (message) {
    case WM_CLOSE:
      events_.closeAsked();
      return 0;
    case WM_SETFOCUS:
      if (control_ != nullptr) control_->focus();
      return 0;
    case WM_SIZE:
      if (control_ != nullptr && wide != SIZE_MINIMIZED) control_->layOut();
      break;
    case WM_MDIACTIVATE:
      activated(reinterpret_cast<HWND>(extra) == window_);
      break;
    case WM_EXITSIZEMOVE:
      frame_.placedByUser();
      break;
    case WM_CONTEXTMENU:
      askForPopUp(extra);
      return 0;
    case WM_NCRBUTTONUP:
      if (wide != HTCAPTION) break;
      askForPopUp(extra);
      return 0;
    case WM_GETMINMAXINFO:
      DefMDIChildProcW(window_, message, wide, extra);
      reinterpret_cast<MINMAXINFO*>(extra)->ptMinTrackSize = {scaled(kSmallest.cx), scaled(kSmallest.cy)};
      return 0;
    case WM_NCDESTROY:
      SetWindowLongPtrW(window_, GWLP_USERDATA, 0);
      return DefMDIChildProcW(std::exchange(window_, nullptr), message, wide, extra);
    default:
      break;
  }
  return DefMDIChildProcW(window_, message, wide, extra);
}

void PanelWindow::activated(bool active) {
  if (control_ != nullptr) control_->documentActivated(active);
  frame_.panelsChanged();
}

// A key has no place: the menu then opens at the panel's upper left.
void PanelWindow::askForPopUp(LPARAM position) {
  POINT at{GET_X_LPARAM(position), GET_Y_LPARAM(position)};
  if (at.x == -1 && at.y == -1) {
    at = {0, 0};
    ClientToScreen(window_, &at);
  }
  events_.popUpAsked(at);
}

}  // namespace frontpanels::workbench

#include "workbench/main_window.h"

#include <commctrl.h>

#include <algorithm>
#include <array>
#include <utility>

#include "platform/win32/utf16.h"
#include "workbench/failure.h"
#include "workbench/resource_ids.h"
#include "workbench/screen_scale.h"

namespace frontpanels::workbench {
namespace {

constexpr const wchar_t* kClassName = L"FrontPanelsWorkbench";
constexpr const wchar_t* kTitle = L"Front Panels workbench";
constexpr const wchar_t* kHint = L"No panel is open. Panels, Spectrum (Ctrl+1) opens one.";
constexpr UINT_PTR kPlayTimer = 1;
// At 96 dots an inch.
constexpr int kWidth = 960;
constexpr int kHeight = 640;
constexpr int kMinimumWidth = 320;
constexpr int kMinimumHeight = 240;
// Right edges of the status bar's parts but the last, which has the rest.
constexpr std::array<int, 3> kPartEdges = {300, 500, 650};

void registerClass(WNDPROC procedure) {
  WNDCLASSEXW windowClass{};
  windowClass.cbSize = sizeof windowClass;
  windowClass.lpfnWndProc = procedure;
  windowClass.hInstance = GetModuleHandleW(nullptr);
  windowClass.hIcon = LoadIconW(nullptr, IDI_APPLICATION);
  windowClass.hCursor = LoadCursorW(nullptr, IDC_ARROW);
  windowClass.hbrBackground = GetSysColorBrush(COLOR_BTNFACE);
  windowClass.lpszMenuName = MAKEINTRESOURCEW(IDR_MAIN);
  windowClass.lpszClassName = kClassName;
  if (RegisterClassExW(&windowClass) == 0 && GetLastError() != ERROR_CLASS_ALREADY_EXISTS)
    raiseLastError("Registering the window class");
}

}  // namespace

MainWindow::MainWindow(MainWindowEvents& events) : events_(events) {
  const INITCOMMONCONTROLSEX wanted{sizeof wanted, ICC_BAR_CLASSES};
  InitCommonControlsEx(&wanted);
  registerClass(windowProcedure);
  accelerators_ = LoadAcceleratorsW(GetModuleHandleW(nullptr), MAKEINTRESOURCEW(IDR_MAIN));
  const HWND window = CreateWindowExW(0, kClassName, kTitle, WS_OVERLAPPEDWINDOW | WS_CLIPCHILDREN,
                                      CW_USEDEFAULT, CW_USEDEFAULT, scaled(kWidth), scaled(kHeight), nullptr,
                                      nullptr, GetModuleHandleW(nullptr), this);
  if (window == nullptr) raiseLastError("Creating the window");
  createStatusBar();
}

MainWindow::~MainWindow() {
  if (window_ != nullptr) DestroyWindow(window_);
}

void MainWindow::createStatusBar() {
  statusBar_ = CreateWindowExW(0, STATUSCLASSNAMEW, nullptr, WS_CHILD | WS_VISIBLE | SBARS_SIZEGRIP, 0, 0, 0,
                               0, window_, nullptr, GetModuleHandleW(nullptr), nullptr);
  if (statusBar_ == nullptr) raiseLastError("Creating the status bar");
  constexpr int kToTheEdge = -1;
  std::array<int, kPartEdges.size() + 1> edges{};
  std::transform(kPartEdges.begin(), kPartEdges.end(), edges.begin(), scaled);
  edges.back() = kToTheEdge;
  SendMessageW(statusBar_, SB_SETPARTS, edges.size(), reinterpret_cast<LPARAM>(edges.data()));
}

void MainWindow::show(int showCommand) {
  ShowWindow(window_, showCommand);
  UpdateWindow(window_);
}

void MainWindow::occupy(HostedControl* control) {
  control_ = control;
  if (control_ == nullptr) {
    SetWindowTextW(window_, kTitle);
    InvalidateRect(window_, nullptr, TRUE);
  } else if (GetFocus() == window_) {
    control_->focus();
  }
}

void MainWindow::status(StatusPart part, const std::string& text) {
  SendMessageW(statusBar_, SB_SETTEXTW, static_cast<WPARAM>(part),
               reinterpret_cast<LPARAM>(toUtf16(text).c_str()));
}

void MainWindow::startTicking(std::chrono::milliseconds period) {
  if (SetTimer(window_, kPlayTimer, static_cast<UINT>(period.count()), nullptr) == 0)
    raiseLastError("Starting to play");
}

void MainWindow::stopTicking() noexcept { KillTimer(window_, kPlayTimer); }

int MainWindow::runMessageLoop() {
  MSG message{};
  while (GetMessageW(&message, nullptr, 0, 0) > 0) {
    const bool key = message.message >= WM_KEYFIRST && message.message <= WM_KEYLAST;
    // The active control has the first look at a key.
    if (key && control_ != nullptr && control_->translateAccelerator(message)) continue;
    if (key && translateAccelerator(message)) continue;
    TranslateMessage(&message);
    DispatchMessageW(&message);
  }
  return static_cast<int>(message.wParam);
}

// --- PanelPlace

RECT MainWindow::panelRect() {
  RECT client{};
  RECT bar{};
  GetClientRect(window_, &client);
  if (statusBar_ != nullptr) GetWindowRect(statusBar_, &bar);
  client.bottom = std::max(client.top, client.bottom - (bar.bottom - bar.top));
  return client;
}

void MainWindow::panelCaption(const std::wstring& text) {
  SetWindowTextW(window_, text.empty() ? kTitle : (text + L" - " + kTitle).c_str());
}

void MainWindow::statusText(const std::wstring& text) { status(StatusPart::Message, toUtf8(text)); }

bool MainWindow::translateAccelerator(MSG& message) {
  return TranslateAcceleratorW(window_, accelerators_, &message) != 0;
}

// --- Messages

LRESULT MainWindow::windowProcedure(HWND window, UINT message, WPARAM wide, LPARAM extra) noexcept {
  if (message == WM_NCCREATE) {
    auto* const created = static_cast<MainWindow*>(reinterpret_cast<CREATESTRUCTW*>(extra)->lpCreateParams);
    created->window_ = window;
    SetWindowLongPtrW(window, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(created));
  }
  auto* const self = reinterpret_cast<MainWindow*>(GetWindowLongPtrW(window, GWLP_USERDATA));
  if (self == nullptr) return DefWindowProcW(window, message, wide, extra);
  try {
    return self->handle(message, wide, extra);
  } catch (...) {
    self->events_.failed(currentFailure());
    return 0;
  }
}

LRESULT MainWindow::handle(UINT message, WPARAM wide, LPARAM extra) {
  switch (message) {
    case WM_COMMAND:
      events_.command(LOWORD(wide));
      return 0;
    case WM_INITMENUPOPUP:
      events_.menuOpening(reinterpret_cast<HMENU>(wide));
      return 0;
    case WM_TIMER:
      events_.tick();
      return 0;
    case WM_SIZE:
      layOut();
      return 0;
    case WM_PAINT:
      paintHint();
      return 0;
    case WM_SETFOCUS:
      if (control_ != nullptr) control_->focus();
      return 0;
    case WM_ACTIVATE:
      if (control_ != nullptr) control_->frameActivated(LOWORD(wide) != WA_INACTIVE);
      break;
    case WM_GETMINMAXINFO:
      reinterpret_cast<MINMAXINFO*>(extra)->ptMinTrackSize = {scaled(kMinimumWidth), scaled(kMinimumHeight)};
      return 0;
    case WM_CLOSE:
      events_.command(IDM_FILE_EXIT);
      return 0;
    case WM_NCDESTROY:
      SetWindowLongPtrW(window_, GWLP_USERDATA, 0);
      return DefWindowProcW(std::exchange(window_, nullptr), message, wide, extra);
    default:
      break;
  }
  return DefWindowProcW(window_, message, wide, extra);
}

void MainWindow::layOut() {
  // The bar places itself at the lower edge.
  if (statusBar_ != nullptr) SendMessageW(statusBar_, WM_SIZE, 0, 0);
  if (control_ != nullptr && !IsIconic(window_)) control_->layOut();
}

void MainWindow::paintHint() {
  PAINTSTRUCT paint{};
  const HDC dc = BeginPaint(window_, &paint);
  if (control_ == nullptr) {
    RECT rect = panelRect();
    const HGDIOBJ previous = SelectObject(dc, GetStockObject(DEFAULT_GUI_FONT));
    SetBkMode(dc, TRANSPARENT);
    DrawTextW(dc, kHint, -1, &rect, DT_CENTER | DT_VCENTER | DT_SINGLELINE);
    SelectObject(dc, previous);
  }
  EndPaint(window_, &paint);
}

}  // namespace frontpanels::workbench

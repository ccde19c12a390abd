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
constexpr const wchar_t* kHint = L"No panel is open. Panels, Spectrum (Ctrl+1) or Pilots (Ctrl+2) opens one.";
constexpr UINT_PTR kPlayTimer = 1;
// At 96 dots an inch: two panels side by side with all of their fields, where the screen has room for that.
constexpr int kWidth = 1640;
constexpr int kHeight = 860;
constexpr int kMinimumWidth = 320;
constexpr int kMinimumHeight = 240;
// Right edges of the status bar's parts but the last, which has the rest.
constexpr std::array<int, 3> kPartEdges = {300, 520, 700};

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

SIZE firstSize() {
  RECT room{};
  SystemParametersInfoW(SPI_GETWORKAREA, 0, &room, 0);
  return {std::min<LONG>(scaled(kWidth), room.right - room.left),
          std::min<LONG>(scaled(kHeight), room.bottom - room.top)};
}

LONG heightOf(HWND window) {
  RECT rect{};
  GetWindowRect(window, &rect);
  return rect.bottom - rect.top;
}

}  // namespace

MainWindow::MainWindow(MainWindowEvents& events)
    : events_(events),
      window_(createWindow()),
      accelerators_(LoadAcceleratorsW(GetModuleHandleW(nullptr), MAKEINTRESOURCEW(IDR_MAIN))),
      client_(createClient()),
      statusBar_(createStatusBar()),
      timeStrip_(window_),
      messages_(window_) {
  // From here on it hears of messages: all of its parts are there.
  SetWindowLongPtrW(window_, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(this));
  layOut();
  panelsChanged();
}

MainWindow::~MainWindow() {
  if (window_ == nullptr) return;
  SetWindowLongPtrW(window_, GWLP_USERDATA, 0);
  DestroyWindow(window_);
}

HWND MainWindow::createWindow() {
  const INITCOMMONCONTROLSEX wanted{sizeof wanted,
                                    ICC_BAR_CLASSES | ICC_PROGRESS_CLASS | ICC_LISTVIEW_CLASSES};
  InitCommonControlsEx(&wanted);
  registerClass(windowProcedure);
  const SIZE size = firstSize();
  const HWND window =
      CreateWindowExW(0, kClassName, kTitle, WS_OVERLAPPEDWINDOW | WS_CLIPCHILDREN, CW_USEDEFAULT,
                      CW_USEDEFAULT, size.cx, size.cy, nullptr, nullptr, GetModuleHandleW(nullptr), nullptr);
  if (window == nullptr) raiseLastError("Creating the window");
  return window;
}

// The window system keeps the list of the panels' windows at the end of the menu Panels.
HWND MainWindow::createClient() {
  constexpr int kPanelsMenu = 1;
  CLIENTCREATESTRUCT wanted{GetSubMenu(GetMenu(window_), kPanelsMenu), IDM_FIRST_PANEL_WINDOW};
  const HWND client = CreateWindowExW(0, L"MDICLIENT", nullptr, WS_CHILD | WS_CLIPCHILDREN, 0, 0, 0, 0,
                                      window_, reinterpret_cast<HMENU>(static_cast<UINT_PTR>(IDC_CLIENT)),
                                      GetModuleHandleW(nullptr), &wanted);
  if (client == nullptr) raiseLastError("Creating the room for the panels");
  return client;
}

HWND MainWindow::createStatusBar() {
  const HWND bar = CreateWindowExW(0, STATUSCLASSNAMEW, nullptr, WS_CHILD | WS_VISIBLE | SBARS_SIZEGRIP, 0, 0,
                                   0, 0, window_, reinterpret_cast<HMENU>(static_cast<UINT_PTR>(IDC_STATUS)),
                                   GetModuleHandleW(nullptr), nullptr);
  if (bar == nullptr) raiseLastError("Creating the status bar");
  constexpr int kToTheEdge = -1;
  std::array<int, kPartEdges.size() + 1> edges{};
  std::transform(kPartEdges.begin(), kPartEdges.end(), edges.begin(), scaled);
  edges.back() = kToTheEdge;
  SendMessageW(bar, SB_SETPARTS, edges.size(), reinterpret_cast<LPARAM>(edges.data()));
  return bar;
}

void MainWindow::show(int showCommand) {
  ShowWindow(window_, showCommand);
  UpdateWindow(window_);
}

void MainWindow::status(StatusPart part, const std::string& text) {
  SendMessageW(statusBar_, SB_SETTEXTW, static_cast<WPARAM>(part),
               reinterpret_cast<LPARAM>(toUtf16(text).c_str()));
}

void MainWindow::showMessages(bool shown) {
  messages_.show(shown);
  layOut();
  if (!shown) focusPanel();
}

void MainWindow::showPlace(std::uint64_t frame, std::optional<std::uint64_t> frames) {
  const LONG before = timeStrip_.heightPx();
  timeStrip_.showPlace(frame, frames);
  if (timeStrip_.heightPx() != before) layOut();
}

void MainWindow::showProgress(const std::string& what, int percent) {
  const LONG before = timeStrip_.heightPx();
  timeStrip_.showProgress(what, percent);
  if (timeStrip_.heightPx() != before) layOut();
}

void MainWindow::endProgress() {
  const LONG before = timeStrip_.heightPx();
  timeStrip_.endProgress();
  if (timeStrip_.heightPx() != before) layOut();
}

void MainWindow::startTicking(std::chrono::milliseconds period) {
  if (SetTimer(window_, kPlayTimer, static_cast<UINT>(period.count()), nullptr) == 0)
    raiseLastError("Starting to play");
}

void MainWindow::stopTicking() noexcept { KillTimer(window_, kPlayTimer); }

// --- Keys

// Escape leads back from the program's own fields to the panel.
bool MainWindow::leavesOwnField(const MSG& message) {
  if (message.message != WM_KEYDOWN || message.wParam != VK_ESCAPE) return false;
  if (!messages_.hasFocus() && !timeStrip_.hasFocus()) return false;
  focusPanel();
  return true;
}

// The active control has the first look at a key that is meant for it.
bool MainWindow::deliver(MSG& message) {
  const bool key = message.message >= WM_KEYFIRST && message.message <= WM_KEYLAST;
  if (!key) return false;
  PanelWindow* const panel = activePanel();
  const bool inPanel =
      panel != nullptr && (message.hwnd == panel->handle() || IsChild(panel->handle(), message.hwnd));
  if (inPanel && panel->control() != nullptr && panel->control()->translateAccelerator(message)) return true;
  return leavesOwnField(message) || translateAccelerator(message);
}

int MainWindow::runMessageLoop() {
  MSG message{};
  while (const BOOL more = GetMessageW(&message, nullptr, 0, 0)) {
    constexpr BOOL kFailed = -1;
    if (more == kFailed) raiseLastError("Waiting for messages");
    if (deliver(message)) continue;
    TranslateMessage(&message);
    DispatchMessageW(&message);
  }
  return static_cast<int>(message.wParam);
}

bool MainWindow::pumpMessages() {
  MSG message{};
  while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) {
    if (message.message == WM_QUIT) {
      PostQuitMessage(static_cast<int>(message.wParam));
      return false;
    }
    if (message.message == WM_KEYDOWN && message.wParam == VK_ESCAPE) events_.command(IDM_CANCEL);
    if (deliver(message)) continue;
    TranslateMessage(&message);
    DispatchMessageW(&message);
  }
  return true;
}

void MainWindow::statusText(const std::wstring& text) { status(StatusPart::Message, toUtf8(text)); }

bool MainWindow::translateAccelerator(MSG& message) {
  return TranslateMDISysAccel(client_, &message) ||
         TranslateAcceleratorW(window_, accelerators_, &message) != 0;
}

// --- Panels

PanelWindow* MainWindow::activePanel() const {
  return PanelWindow::of(reinterpret_cast<HWND>(SendMessageW(client_, WM_MDIGETACTIVE, 0, 0)));
}

void MainWindow::nextPanel() { SendMessageW(client_, WM_MDINEXT, 0, 0); }

void MainWindow::focusPanel() {
  if (const PanelWindow* const panel = activePanel()) SetFocus(panel->handle());
}

void MainWindow::focusPlace() { timeStrip_.focus(); }

void MainWindow::arrange(Arrangement arrangement) {
  arrangement_ = arrangement;
  placePanels();
}

// In the order in which they were opened.
std::vector<HWND> MainWindow::panelWindows() const {
  std::vector<HWND> windows;
  for (HWND window = GetWindow(client_, GW_CHILD); window != nullptr; window = GetWindow(window, GW_HWNDNEXT))
    if (PanelWindow::of(window) != nullptr) windows.push_back(window);
  std::sort(windows.begin(), windows.end(),
            [](HWND a, HWND b) { return GetWindowLongPtrW(a, GWLP_ID) < GetWindowLongPtrW(b, GWLP_ID); });
  return windows;
}

// Pixels that do not divide evenly go to the later panels.
void MainWindow::placePanels() {
  if (arrangement_ == Arrangement::ByUser || IsIconic(window_)) return;
  std::vector<HWND> windows = panelWindows();
  std::erase_if(windows, [](HWND window) { return IsIconic(window) || !PanelWindow::of(window)->visible(); });
  if (windows.empty() || std::any_of(windows.begin(), windows.end(), IsZoomed)) return;
  RECT room{};
  GetClientRect(client_, &room);
  const auto count = static_cast<LONG>(windows.size());
  const bool stacked = arrangement_ == Arrangement::Stacked;
  const auto share = [count](LONG extent, LONG i) { return extent * i / count; };
  for (LONG i = 0; i < count; ++i) {
    const RECT place = stacked ? RECT{0, share(room.bottom, i), room.right, share(room.bottom, i + 1)}
                               : RECT{share(room.right, i), 0, share(room.right, i + 1), room.bottom};
    MoveWindow(windows[static_cast<std::size_t>(i)], place.left, place.top, place.right - place.left,
               place.bottom - place.top, TRUE);
  }
}

void MainWindow::panelsChanged() {
  const bool any = !panelWindows().empty();
  if (any != IsWindowVisible(client_)) {
    ShowWindow(client_, any ? SW_SHOW : SW_HIDE);
    InvalidateRect(window_, nullptr, TRUE);
  }
  placePanels();
}

// --- Messages

LRESULT MainWindow::windowProcedure(HWND window, UINT message, WPARAM wide, LPARAM extra) noexcept {
  auto* const self = reinterpret_cast<MainWindow*>(GetWindowLongPtrW(window, GWLP_USERDATA));
  if (self == nullptr) return DefFrameProcW(window, nullptr, message, wide, extra);
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
      // The list of windows in the menu and the buttons of a maximised one are the window system's.
      if (LOWORD(wide) >= IDM_FIRST_PANEL_WINDOW) break;
      events_.command(LOWORD(wide));
      return 0;
    case WM_INITMENUPOPUP:
      if (HIWORD(extra) == 0) events_.menuOpening(reinterpret_cast<HMENU>(wide));
      break;
    case WM_TIMER:
      events_.tick();
      return 0;
    case WM_HSCROLL:
      if (const auto frame = timeStrip_.movedTo(extra)) events_.seek(*frame);
      return 0;
    case WM_NOTIFY:
      messages_.notified(*reinterpret_cast<const NMHDR*>(extra));
      return 0;
    case WM_SIZE:
      layOut();
      return 0;
    case WM_PAINT:
      paintHint();
      return 0;
    case WM_SETFOCUS:
      focusPanel();
      return 0;
    case WM_ACTIVATE:
      if (const PanelWindow* const panel = activePanel(); panel != nullptr && panel->control() != nullptr)
        panel->control()->frameActivated(LOWORD(wide) != WA_INACTIVE);
      break;
    case WM_GETMINMAXINFO:
      reinterpret_cast<MINMAXINFO*>(extra)->ptMinTrackSize = {scaled(kMinimumWidth), scaled(kMinimumHeight)};
      return 0;
    case WM_CLOSE:
      events_.command(IDM_FILE_EXIT);
      return 0;
    case WM_ENDSESSION:
      if (wide != 0) events_.command(IDM_FILE_EXIT);
      return 0;
    case WM_NCDESTROY:
      SetWindowLongPtrW(window_, GWLP_USERDATA, 0);
      return DefFrameProcW(std::exchange(window_, nullptr), client_, message, wide, extra);
    default:
      break;
  }
  return DefFrameProcW(window_, client_, message, wide, extra);
}

// From below: the status bar places itself, then the messages, then the strip; the panels have the rest.
void MainWindow::layOut() {
  if (IsIconic(window_)) return;
  SendMessageW(statusBar_, WM_SIZE, 0, 0);
  RECT rest{};
  GetClientRect(window_, &rest);
  rest.bottom -= heightOf(statusBar_);
  const auto takeFromBelow = [&rest](LONG height) {
    RECT taken = rest;
    taken.top = std::max(rest.top, rest.bottom - height);
    rest.bottom = taken.top;
    return taken;
  };
  messages_.layOut(takeFromBelow(messages_.heightPx()));
  timeStrip_.layOut(takeFromBelow(timeStrip_.heightPx()));
  MoveWindow(client_, rest.left, rest.top, rest.right - rest.left, rest.bottom - rest.top, TRUE);
  placePanels();
  if (!IsWindowVisible(client_)) InvalidateRect(window_, nullptr, TRUE);
}

void MainWindow::paintHint() {
  PAINTSTRUCT paint{};
  const HDC dc = BeginPaint(window_, &paint);
  if (!IsWindowVisible(client_)) {
    RECT rect{};
    GetWindowRect(client_, &rect);
    MapWindowPoints(nullptr, window_, reinterpret_cast<POINT*>(&rect), 2);
    const HGDIOBJ previous = SelectObject(dc, GetStockObject(DEFAULT_GUI_FONT));
    SetBkMode(dc, TRANSPARENT);
    SetTextColor(dc, GetSysColor(COLOR_BTNTEXT));
    DrawTextW(dc, kHint, -1, &rect, DT_CENTER | DT_VCENTER | DT_SINGLELINE);
    SelectObject(dc, previous);
  }
  EndPaint(window_, &paint);
}

}  // namespace frontpanels::workbench

#include "workbench/time_strip.h"

#include <commctrl.h>

#include <algorithm>
#include <limits>

#include "platform/win32/utf16.h"
#include "workbench/failure.h"
#include "workbench/resource_ids.h"
#include "workbench/screen_scale.h"

namespace frontpanels::workbench {
namespace {

// At 96 dots an inch.
constexpr int kHeight = 30;
constexpr int kTextWidth = 220;
constexpr int kButtonWidth = 80;
constexpr int kMargin = 4;

HWND makeChild(HWND parent, const wchar_t* windowClass, const wchar_t* text, DWORD style, UINT id) {
  const HWND child =
      CreateWindowExW(0, windowClass, text, WS_CHILD | style, 0, 0, 0, 0, parent,
                      reinterpret_cast<HMENU>(static_cast<UINT_PTR>(id)), GetModuleHandleW(nullptr), nullptr);
  if (child == nullptr) raiseLastError("Creating the strip below the panels");
  SendMessageW(child, WM_SETFONT, reinterpret_cast<WPARAM>(GetStockObject(DEFAULT_GUI_FONT)), FALSE);
  return child;
}

LONG sliderPlace(std::uint64_t frame) {
  constexpr std::uint64_t kFarthest = std::numeric_limits<LONG>::max();
  return static_cast<LONG>(std::min(frame, kFarthest));
}

void setText(HWND window, const std::wstring& text) {
  wchar_t shown[128] = L"";
  GetWindowTextW(window, shown, static_cast<int>(std::size(shown)));
  // Without the look each frame would make it flicker.
  if (text != shown) SetWindowTextW(window, text.c_str());
}

}  // namespace

TimeStrip::TimeStrip(HWND parent)
    : slider_(makeChild(parent, TRACKBAR_CLASSW, L"Place in the recording", WS_TABSTOP | TBS_NOTICKS,
                        IDC_TIME_SLIDER)),
      text_(makeChild(parent, L"STATIC", L"", SS_LEFT | SS_CENTERIMAGE | SS_ENDELLIPSIS, IDC_TIME_TEXT)),
      bar_(makeChild(parent, PROGRESS_CLASSW, L"", 0, IDC_PROGRESS)),
      cancel_(makeChild(parent, L"BUTTON", L"Cancel", WS_TABSTOP | BS_PUSHBUTTON, IDM_CANCEL)) {}

LONG TimeStrip::heightPx() const noexcept { return shown_ == Shown::Nothing ? 0 : scaled(kHeight); }

void TimeStrip::layOut(const RECT& place) {
  const int margin = scaled(kMargin);
  const int top = static_cast<int>(place.top) + margin;
  const int height = std::max(0, static_cast<int>(place.bottom) - margin - top);
  const int left = static_cast<int>(place.left) + margin;
  const int right = static_cast<int>(place.right) - margin;
  const int textRight = left + scaled(kTextWidth);
  const int buttonLeft = right - scaled(kButtonWidth);
  MoveWindow(text_, left, top, textRight - left, height, TRUE);
  MoveWindow(slider_, textRight + margin, top, std::max(0, right - textRight - margin), height, TRUE);
  MoveWindow(bar_, textRight + margin, top, std::max(0, buttonLeft - textRight - 2 * margin), height, TRUE);
  MoveWindow(cancel_, buttonLeft, top, right - buttonLeft, height, TRUE);
}

void TimeStrip::show(Shown what) {
  shown_ = what;
  ShowWindow(text_, what == Shown::Nothing ? SW_HIDE : SW_SHOWNA);
  ShowWindow(slider_, what == Shown::Place ? SW_SHOWNA : SW_HIDE);
  ShowWindow(bar_, what == Shown::Progress ? SW_SHOWNA : SW_HIDE);
  ShowWindow(cancel_, what == Shown::Progress ? SW_SHOWNA : SW_HIDE);
}

void TimeStrip::showPlace(std::uint64_t frame, std::optional<std::uint64_t> frames) {
  frames_ = frames;
  if (shown_ == Shown::Progress) return;
  const bool hasPlace = frames && *frames > 0;
  if (hasPlace != (shown_ == Shown::Place)) show(hasPlace ? Shown::Place : Shown::Nothing);
  if (!hasPlace) return;
  SendMessageW(slider_, TBM_SETRANGEMIN, FALSE, 1);
  SendMessageW(slider_, TBM_SETRANGEMAX, TRUE, sliderPlace(*frames));
  SendMessageW(slider_, TBM_SETPAGESIZE, 0, std::max(1L, sliderPlace(*frames) / 10));
  SendMessageW(slider_, TBM_SETPOS, TRUE, sliderPlace(std::max<std::uint64_t>(frame, 1)));
  setText(text_, L"Frame " + std::to_wstring(frame) + L" of " + std::to_wstring(*frames));
}

void TimeStrip::showProgress(const std::string& what, int percent) {
  if (shown_ != Shown::Progress) show(Shown::Progress);
  setText(text_, toUtf16(what));
  SendMessageW(bar_, PBM_SETPOS, static_cast<WPARAM>(percent), 0);
}

void TimeStrip::endProgress() { show(Shown::Nothing); }

std::optional<std::uint64_t> TimeStrip::movedTo(LPARAM extra) const {
  if (reinterpret_cast<HWND>(extra) != slider_ || shown_ != Shown::Place) return std::nullopt;
  const auto place = static_cast<std::uint64_t>(SendMessageW(slider_, TBM_GETPOS, 0, 0));
  return place;
}

void TimeStrip::focus() const {
  if (shown_ == Shown::Place) SetFocus(slider_);
}

}  // namespace frontpanels::workbench

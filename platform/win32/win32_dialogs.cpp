#include "platform/win32/win32_dialogs.h"

#include <windows.h>

#include <commdlg.h>

#include <algorithm>
#include <string>

#include "platform/runtime_error.h"
#include "platform/win32/utf16.h"

namespace frontpanels {
namespace {

constexpr std::size_t kLongestPath = 32768;

// The system wants a zero behind each half of a pair and one more at the end. A zero within would end the
// list.
std::wstring systemFilter(std::string_view filter) {
  std::wstring pairs = toUtf16(filter);
  const bool whole = std::count(pairs.begin(), pairs.end(), L'|') % 2 == 1;
  if (!pairs.empty() && (!whole || pairs.find(L'\0') != std::wstring::npos)) raiseInvalidProcedureCall();
  std::replace(pairs.begin(), pairs.end(), L'|', L'\0');
  return pairs + L'\0';
}

// Of the messages that wait only, so that no other thread's call is answered in between.
bool takeEscape() noexcept {
  constexpr UINT kWaiting = PM_QS_INPUT | PM_QS_POSTMESSAGE;
  MSG first{};
  if (PeekMessageW(&first, nullptr, WM_KEYDOWN, WM_KEYDOWN, PM_NOREMOVE | kWaiting) == 0) return false;
  return first.wParam == VK_ESCAPE &&
         PeekMessageW(&first, nullptr, WM_KEYDOWN, WM_KEYDOWN, PM_REMOVE | kWaiting) != 0;
}

bool holdsEscape() noexcept {
  const HWND front = GetForegroundWindow();
  return front != nullptr && GetWindowThreadProcessId(front, nullptr) == GetCurrentThreadId() &&
         GetAsyncKeyState(VK_ESCAPE) < 0;
}

}  // namespace

void Win32Dialogs::messageBox(std::string_view text) noexcept {
  try {
    std::wstring shown = toUtf16(text);
    std::replace(shown.begin(), shown.end(), L'\0', L' ');  // a zero would end the message
    const HWND owner = GetActiveWindow();
    MessageBoxW(owner, shown.c_str(), nullptr, owner == nullptr ? MB_OK | MB_TASKMODAL : MB_OK);
  } catch (...) {
    OutputDebugStringW(L"Front Panels: no memory to show a message\n");  // the message log has kept it
  }
}

std::optional<std::string> Win32FileDialogs::openFile(std::string_view filter) {
  const std::wstring pairs = systemFilter(filter);
  std::wstring path(kLongestPath, L'\0');
  OPENFILENAMEW question{};
  question.lStructSize = sizeof question;
  question.hwndOwner = GetActiveWindow();
  question.lpstrFilter = filter.empty() ? nullptr : pairs.c_str();
  question.lpstrFile = path.data();
  question.nMaxFile = static_cast<DWORD>(path.size());
  question.Flags = OFN_EXPLORER | OFN_FILEMUSTEXIST | OFN_PATHMUSTEXIST | OFN_HIDEREADONLY | OFN_NOCHANGEDIR;
  if (GetOpenFileNameW(&question) != 0) return toUtf8(path.c_str());
  if (CommDlgExtendedError() != 0) raiseOutOfMemory();
  return std::nullopt;
}

bool Win32FileDialogs::cancelPressed() noexcept { return takeEscape() || holdsEscape(); }

}  // namespace frontpanels

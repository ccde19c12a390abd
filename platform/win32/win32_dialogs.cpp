#include "platform/win32/win32_dialogs.h"

#include <windows.h>

#include <algorithm>

#include "platform/win32/utf16.h"

namespace frontpanels {

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

}  // namespace frontpanels

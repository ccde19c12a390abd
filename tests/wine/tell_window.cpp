// Plays the user of a window of another program:
//
//   tell_window CLASS WORD...
//
// Waits for a window of that class and puts into its queue, in order, for each word: "key:118" a key pressed
// and let go (a virtual key's number), "command:1101" a menu's command, "click:<Stop>" a click on the button
// of that caption, "choose:History" an item of whatever list has it, "type:<Span>=1M" the text and Enter
// into the box beside that label, "file:NAME" the name into a dialog for files, and its button, "close" its
// closing. After "in:Pilots" fields are looked for in the panel's window whose title begins so. Ends with 1
// when no such window came.
#include <windows.h>

#include <cstdio>
#include <cstring>
#include <cwchar>
#include <string>
#include <utility>
#include <vector>

#include "tests/wine/panel_user.h"

namespace {

using namespace frontpanels::testing;

constexpr ULONGLONG kPatienceMs = 30000;
constexpr DWORD kGlanceMs = 50;

HWND waitForWindow(const char* className) {
  const ULONGLONG started = GetTickCount64();
  while (GetTickCount64() - started < kPatienceMs) {
    const HWND window = FindWindowA(className, nullptr);
    if (window != nullptr && IsWindowVisible(window)) return window;
    Sleep(kGlanceMs);
  }
  return nullptr;
}

// What stands before and behind the first of the sign.
std::pair<std::wstring, std::wstring> halvesOf(const std::wstring& text, wchar_t sign) {
  const std::size_t at = text.find(sign);
  if (at == std::wstring::npos) return {text, {}};
  return {text.substr(0, at), text.substr(at + 1)};
}

bool clickOn(HWND window, const std::wstring& text) {
  const HWND button = buttonWith(window, text);
  if (button == nullptr) return false;
  click(button);
  return true;
}

bool typeBeside(HWND window, const std::wstring& labelAndText) {
  const auto [label, text] = halvesOf(labelAndText, L'=');
  const HWND box = boxBeside(window, label);
  if (box == nullptr) return false;
  typeInto(box, text);
  return true;
}

// The list tells its owner, as it does when a user has chosen.
bool choose(HWND window, const std::wstring& item) {
  for (const HWND list : windowsOf(window, L"ComboBox")) {
    const LRESULT place = SendMessageW(list, CB_FINDSTRINGEXACT, static_cast<WPARAM>(-1),
                                       reinterpret_cast<LPARAM>(item.c_str()));
    if (place == CB_ERR) continue;
    SendMessageW(list, CB_SETCURSEL, static_cast<WPARAM>(place), 0);
    const auto chosen = MAKEWPARAM(GetDlgCtrlID(list), CBN_SELCHANGE);
    return PostMessageW(GetParent(list), WM_COMMAND, chosen, reinterpret_cast<LPARAM>(list));
  }
  return false;
}

bool nameFile(HWND dialog, const std::wstring& name) {
  const std::vector<HWND> boxes = windowsOf(dialog, L"Edit");
  if (boxes.empty()) return false;
  SendMessageW(boxes.front(), WM_SETTEXT, 0, reinterpret_cast<LPARAM>(name.c_str()));
  return PostMessageW(dialog, WM_COMMAND, IDOK, 0);
}

HWND panelOf(HWND window, const std::wstring& title) {
  for (const HWND panel : windowsOf(window, L"FrontPanelsPanel"))
    if (textOf(panel).rfind(title, 0) == 0) return panel;
  return nullptr;
}

// `scope` is where fields are looked for.
bool tell(HWND window, HWND& scope, const std::wstring& word) {
  const auto [what, rest] = halvesOf(word, L':');
  if (what == L"in") return (scope = panelOf(window, rest)) != nullptr;
  if (what == L"click") return clickOn(scope, rest);
  if (what == L"choose") return choose(scope, rest);
  if (what == L"type") return typeBeside(scope, rest);
  if (what == L"file") return nameFile(window, rest);
  if (what == L"close") return PostMessageW(window, WM_CLOSE, 0, 0);
  const auto number = std::wcstoul(rest.c_str(), nullptr, 10);
  if (what == L"command") return PostMessageW(window, WM_COMMAND, number, 0);
  if (what != L"key") return false;
  return PostMessageW(window, WM_KEYDOWN, number, 1) && PostMessageW(window, WM_KEYUP, number, 0xC0000001);
}

}  // namespace

int main(int count, char** words) {
  if (count < 2) return 2;
  const HWND window = waitForWindow(words[1]);
  if (window == nullptr) {
    std::fprintf(stderr, "no window of the class %s\n", words[1]);
    return 1;
  }
  HWND scope = window;
  for (int i = 2; i < count; ++i) {
    if (!tell(window, scope, std::wstring(words[i], words[i] + std::strlen(words[i])))) {
      std::fprintf(stderr, "the window cannot be told %s\n", words[i]);
      return 2;
    }
  }
  return 0;
}

#include "tests/wine/panel_user.h"

#include <algorithm>
namespace frontpanels::testing {
namespace {

// A function and not a lambda, which has no calling convention of its own to be given in 32 bits.
BOOL CALLBACK addToList(HWND window, LPARAM list) {
  reinterpret_cast<std::vector<HWND>*>(list)->push_back(window);
  return TRUE;
}

std::vector<HWND> descendants(HWND panel) {
  std::vector<HWND> all;
  EnumChildWindows(panel, addToList, reinterpret_cast<LPARAM>(&all));
  return all;
}

HWND withText(HWND panel, const wchar_t* className, const std::wstring& text) {
  const std::vector<HWND> all = windowsOf(panel, className);
  const auto found =
      std::find_if(all.begin(), all.end(), [&](HWND window) { return textOf(window) == text; });
  return found == all.end() ? nullptr : *found;
}

RECT placeOf(HWND window) {
  RECT place{};
  GetWindowRect(window, &place);
  return place;
}

void sendKey(WORD key, bool down) {
  INPUT input{};
  input.type = INPUT_KEYBOARD;
  input.ki.wVk = key;
  input.ki.wScan = static_cast<WORD>(MapVirtualKeyW(key, MAPVK_VK_TO_VSC));
  input.ki.dwFlags = down ? 0 : KEYEVENTF_KEYUP;
  SendInput(1, &input, sizeof input);
}

}  // namespace

std::wstring textOf(HWND window) {
  // The text of another program's field is not GetWindowText's to give.
  wchar_t text[1000] = L"";
  SendMessageW(window, WM_GETTEXT, 1000, reinterpret_cast<LPARAM>(text));
  return text;
}

bool isOf(HWND window, const wchar_t* className) {
  wchar_t name[32] = L"";
  GetClassNameW(window, name, 32);
  return lstrcmpiW(name, className) == 0;
}

std::vector<HWND> windowsOf(HWND panel, const wchar_t* className) {
  std::vector<HWND> all = descendants(panel);
  std::erase_if(all, [className](HWND window) { return !isOf(window, className); });
  return all;
}

RECT placeIn(HWND panel, HWND window) {
  RECT place = placeOf(window);
  MapWindowPoints(nullptr, panel, reinterpret_cast<POINT*>(&place), 2);
  return place;
}

LOGFONTW fontOf(HWND window) {
  LOGFONTW font{};
  GetObjectW(reinterpret_cast<HFONT>(SendMessageW(window, WM_GETFONT, 0, 0)), sizeof font, &font);
  return font;
}

int screenDpi() {
  const HDC screen = GetDC(nullptr);
  const int dpi = GetDeviceCaps(screen, LOGPIXELSX);
  ReleaseDC(nullptr, screen);
  return dpi;
}

int inPixels(double twips) { return MulDiv(static_cast<int>(twips), screenDpi(), 1440); }

HWND buttonWith(HWND panel, const std::wstring& caption) { return withText(panel, L"BUTTON", caption); }

HWND boxBeside(HWND panel, const std::wstring& label) {
  const HWND beside = withText(panel, L"STATIC", label);
  if (beside == nullptr) return nullptr;
  const RECT at = placeOf(beside);
  HWND nearest = nullptr;
  for (const HWND window : windowsOf(panel, L"EDIT")) {
    const RECT place = placeOf(window);
    const bool inItsRow = place.top < at.bottom && place.bottom > at.top && place.left >= at.right;
    if (inItsRow && (nearest == nullptr || place.left < placeOf(nearest).left)) nearest = window;
  }
  return nearest;
}

void click(HWND window) {
  const RECT place = placeOf(window);
  const LPARAM middle = MAKELPARAM((place.right - place.left) / 2, (place.bottom - place.top) / 2);
  PostMessageW(window, WM_LBUTTONDOWN, MK_LBUTTON, middle);
  PostMessageW(window, WM_LBUTTONUP, 0, middle);
}

void typeInto(HWND box, const std::wstring& text) {
  click(box);
  PostMessageW(box, EM_SETSEL, 0, -1);
  for (const wchar_t character : text + L'\r') PostMessageW(box, WM_CHAR, character, 1);
}

void press(WORD key, WORD held, const std::function<void()>& pump) {
  if (held != 0) sendKey(held, true);
  sendKey(key, true);
  pump();
  sendKey(key, false);
  if (held != 0) sendKey(held, false);
  pump();
}

}  // namespace frontpanels::testing

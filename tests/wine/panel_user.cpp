#include "tests/wine/panel_user.h"

#include <algorithm>
#include <vector>

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

bool isOf(HWND window, const wchar_t* className) {
  wchar_t name[32] = L"";
  GetClassNameW(window, name, 32);
  return lstrcmpiW(name, className) == 0;
}

HWND withText(HWND panel, const wchar_t* className, const std::wstring& text) {
  const std::vector<HWND> all = descendants(panel);
  const auto found = std::find_if(
      all.begin(), all.end(), [&](HWND window) { return isOf(window, className) && textOf(window) == text; });
  return found == all.end() ? nullptr : *found;
}

RECT placeOf(HWND window) {
  RECT place{};
  GetWindowRect(window, &place);
  return place;
}

}  // namespace

std::wstring textOf(HWND window) {
  // The text of another program's field is not GetWindowText's to give.
  wchar_t text[200] = L"";
  SendMessageW(window, WM_GETTEXT, 200, reinterpret_cast<LPARAM>(text));
  return text;
}

HWND buttonWith(HWND panel, const std::wstring& caption) { return withText(panel, L"BUTTON", caption); }

HWND boxBeside(HWND panel, const std::wstring& label) {
  const HWND beside = withText(panel, L"STATIC", label);
  if (beside == nullptr) return nullptr;
  const RECT at = placeOf(beside);
  HWND nearest = nullptr;
  for (const HWND window : descendants(panel)) {
    const RECT place = placeOf(window);
    const bool inItsRow = place.top < at.bottom && place.bottom > at.top && place.left >= at.right;
    if (isOf(window, L"EDIT") && inItsRow && (nearest == nullptr || place.left < placeOf(nearest).left))
      nearest = window;
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

}  // namespace frontpanels::testing

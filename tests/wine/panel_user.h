// A user in front of a panel, of this program or another: finds fields by what stands on them or before them.
// Twips and dots an inch are those of the screen.
#pragma once

#include <windows.h>

#include <functional>
#include <string>
#include <vector>

namespace frontpanels::testing {

// A button, an option or a frame by its caption; null when there is none.
[[nodiscard]] HWND buttonWith(HWND panel, const std::wstring& caption);
// The box to the right of a label; null when there is none.
[[nodiscard]] HWND boxBeside(HWND panel, const std::wstring& label);
[[nodiscard]] std::wstring textOf(HWND window);
[[nodiscard]] bool isOf(HWND window, const wchar_t* className);
// The windows of a class inside the panel, at any depth.
[[nodiscard]] std::vector<HWND> windowsOf(HWND panel, const wchar_t* className);
[[nodiscard]] RECT placeIn(HWND panel, HWND window);
[[nodiscard]] LOGFONTW fontOf(HWND window);
[[nodiscard]] int screenDpi();
[[nodiscard]] int inPixels(double twips);

// Into the queue of the window's program. Typing goes into the box with all of its text selected and ends
// with Enter.
void click(HWND window);
void typeInto(HWND box, const std::wstring& text);

// Keys of the keyboard, for the window that has the focus. Messages are pumped also while the key is down:
// whoever looks at its state then sees it so.
void press(WORD key, WORD held, const std::function<void()>& pump);

}  // namespace frontpanels::testing

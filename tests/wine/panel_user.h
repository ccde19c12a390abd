// A user in front of a panel, of this program or another: finds fields by what stands on them or before them.
#pragma once

#include <windows.h>

#include <string>

namespace frontpanels::testing {

// A button, an option or a frame by its caption; null when there is none.
[[nodiscard]] HWND buttonWith(HWND panel, const std::wstring& caption);
// The box to the right of a label; null when there is none.
[[nodiscard]] HWND boxBeside(HWND panel, const std::wstring& label);
[[nodiscard]] std::wstring textOf(HWND window);

// Into the queue of the window's program. Typing goes into the box with all of its text selected and ends
// with Enter.
void click(HWND window);
void typeInto(HWND box, const std::wstring& text);

}  // namespace frontpanels::testing

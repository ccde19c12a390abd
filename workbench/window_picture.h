// A picture of a window as it stands on the screen, written as PNG.
#pragma once

#include <windows.h>

#include <string>

namespace frontpanels::workbench {

// Menu and client area: title bar and border are the window manager's and need not be there. What waits to be
// painted is painted first. Raises a failure that names the file.
void saveWindowPicture(HWND window, const std::string& path);
// What a device context shows, from its upper left corner on.
void saveContextPicture(HDC dc, SIZE sizePx, const std::string& path);

}  // namespace frontpanels::workbench

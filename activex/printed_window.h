// Windows as part of a picture.
#pragma once

#include <windows.h>

namespace frontpanels::activex {

// Paints what lies in a window, windows within windows too, into a context whose origin is that of the
// window's client area. The window itself is the caller's to paint. Raises std::bad_alloc.
void printChildren(HWND window, HDC dc);

}  // namespace frontpanels::activex

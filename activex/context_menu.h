// A panel's own menu on the screen.
#pragma once

#include <windows.h>

#include <span>

#include "framework/panel/pop_up_menu.h"

namespace frontpanels::activex {

// Shows the items at a place of the screen until the user has decided. Null when nothing was chosen. Raises
// ComFailure when the window system refuses.
[[nodiscard]] const PanelMenuItem* chooseFromMenu(HWND owner, POINT at, std::span<const PanelMenuItem> items);

}  // namespace frontpanels::activex

#include "activex/context_menu.h"

#include <memory>
#include <type_traits>

#include "activex/barrier.h"
#include "platform/win32/utf16.h"

namespace frontpanels::activex {
namespace {

struct DestroyMenuOf {
  void operator()(HMENU menu) const noexcept { DestroyMenu(menu); }
};
using Menu = std::unique_ptr<std::remove_pointer_t<HMENU>, DestroyMenuOf>;

}  // namespace

// The menu counts from 1, as 0 is its word for no choice.
const PanelMenuItem* chooseFromMenu(HWND owner, POINT at, std::span<const PanelMenuItem> items) {
  const Menu menu(CreatePopupMenu());
  if (!menu) throw ComFailure(E_OUTOFMEMORY);
  UINT_PTR number = 0;
  for (const PanelMenuItem& item : items) {
    const UINT state = (item.checked ? MF_CHECKED : 0U) | (item.enabled ? 0U : MF_GRAYED);
    AppendMenuW(menu.get(), MF_STRING | state, ++number, toUtf16(item.caption).c_str());
  }
  const auto chosen = static_cast<std::size_t>(
      TrackPopupMenu(menu.get(), TPM_RETURNCMD | TPM_NONOTIFY | TPM_RIGHTBUTTON, static_cast<int>(at.x),
                     static_cast<int>(at.y), 0, owner, nullptr));
  return chosen == 0 || chosen > items.size() ? nullptr : &items[chosen - 1];
}

}  // namespace frontpanels::activex

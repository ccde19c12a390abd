// Menus of a panel. The pop-up menu belongs to the host; a panel decides which of its items are checked and
// enabled. The context menu of its graph is the panel's own.
#pragma once

#include <cstdint>
#include <map>
#include <string>

namespace frontpanels {

struct MenuItemState {
  bool checked = false;
  bool enabled = true;
  friend bool operator==(const MenuItemState&, const MenuItemState&) = default;
};

// One item of the context menu, in order.
struct PanelMenuItem {
  std::int16_t id = 0;
  std::string caption;
  bool checked = false;
  bool enabled = true;
  friend bool operator==(const PanelMenuItem&, const PanelMenuItem&) = default;
};

// A menu that wants to hear of each decision as it falls.
class PopUpMenu {
 public:
  virtual ~PopUpMenu() = default;

  virtual void itemChanged(std::int16_t buttonId, const MenuItemState& state) = 0;
};

// The decisions so far, by item; one that nothing was decided about is enabled and not checked.
class MenuItemStates {
 public:
  [[nodiscard]] MenuItemState state(std::int16_t buttonId) const {
    const auto found = states_.find(buttonId);
    return found == states_.end() ? MenuItemState{} : found->second;
  }
  [[nodiscard]] MenuItemState& at(std::int16_t buttonId) { return states_[buttonId]; }

 private:
  std::map<std::int16_t, MenuItemState> states_;
};

}  // namespace frontpanels

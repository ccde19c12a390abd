#include "activex/message_boxes.h"

#include <algorithm>
#include <vector>

namespace frontpanels::activex {
namespace {

std::vector<BoxOwner*>& owners() {
  static std::vector<BoxOwner*> list;
  return list;
}

bool isOwner(const BoxOwner* owner) noexcept {
  return std::find(owners().begin(), owners().end(), owner) != owners().end();
}

}  // namespace

void addBoxOwner(BoxOwner& owner) { owners().push_back(&owner); }

void removeBoxOwner(BoxOwner& owner) noexcept { std::erase(owners(), &owner); }

void MessageBoxes::messageBox(std::string_view text) noexcept {
  if (owners().empty()) return;
  BoxOwner* const owner = owners().back();
  owner->enableHost(false);
  dialogs_.messageBox(text);
  if (isOwner(owner)) owner->enableHost(true);  // the panel may have gone while the box was open
}

}  // namespace frontpanels::activex

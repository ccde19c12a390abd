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

// While it lives the host waits for a box of the panel that came last.
class HostWaits {
 public:
  HostWaits() : owner_(owners().empty() ? nullptr : owners().back()) {
    if (owner_ != nullptr) owner_->enableHost(false);
  }
  ~HostWaits() {
    if (isOwner(owner_)) owner_->enableHost(true);  // the panel may have gone while the box was open
  }
  HostWaits(const HostWaits&) = delete;
  HostWaits& operator=(const HostWaits&) = delete;

  // Whether there is anybody to answer a box.
  [[nodiscard]] bool forUser() const noexcept { return owner_ != nullptr; }

 private:
  BoxOwner* owner_;
};

}  // namespace

void addBoxOwner(BoxOwner& owner) { owners().push_back(&owner); }

void removeBoxOwner(BoxOwner& owner) noexcept { std::erase(owners(), &owner); }

void MessageBoxes::messageBox(std::string_view text) noexcept {
  const HostWaits waits;
  if (waits.forUser()) dialogs_.messageBox(text);
}

std::optional<std::string> FileBoxes::openFile(std::string_view filter) {
  const HostWaits waits;
  return waits.forUser() ? dialogs_.openFile(filter) : std::nullopt;
}

}  // namespace frontpanels::activex

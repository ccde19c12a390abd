#include "activex/services.h"

#include "framework/support/error_handler.h"

namespace frontpanels::activex {

Services& services() {
  static Services shared;
  static const bool connected = [] {
    reporting().dialogs = &shared.dialogs;
    return true;
  }();
  static_cast<void>(connected);
  return shared;
}

}  // namespace frontpanels::activex

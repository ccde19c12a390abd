// What a call raises.
#pragma once

#include <string>

#include "platform/runtime_error.h"

namespace frontpanels::testing {

// The description of the run-time error that `call` raises; empty when it raises none.
template <class Call>
std::string raised(Call&& call) {
  try {
    static_cast<void>(call());
    return {};
  } catch (const RuntimeError& error) {
    return error.description();
  }
}

}  // namespace frontpanels::testing

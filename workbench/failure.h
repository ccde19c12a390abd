// What the program throws when the system or a control refuses, and the barrier that stops it at every place
// where somebody else's code calls in.
#pragma once

#include <windows.h>

#include <stdexcept>
#include <string>
#include <string_view>
#include <utility>

namespace frontpanels::workbench {

class HostFailure : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

// A class of the control library is not there to be created.
class NotRegistered : public HostFailure {
 public:
  explicit NotRegistered(std::string_view progId);
};

// "0x80004005 (Unspecified error)"
[[nodiscard]] std::string describe(HRESULT result);
// Raises a failure that says what was tried; nothing for a success.
void check(HRESULT result, std::string_view attempt);
// The same for functions that leave their reason in GetLastError.
[[noreturn]] void raiseLastError(std::string_view attempt);

// For a catch block: what went wrong, in the user's words.
[[nodiscard]] std::string currentFailure() noexcept;

// For the methods of COM objects: the body's result, or the failure's code.
template <class Body>
HRESULT comBarrier(Body&& body) noexcept {
  try {
    return std::forward<Body>(body)();
  } catch (const std::bad_alloc&) {
    return E_OUTOFMEMORY;
  } catch (...) {
    return E_FAIL;
  }
}

}  // namespace frontpanels::workbench

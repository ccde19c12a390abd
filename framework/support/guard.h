// The error handler that every routine puts round its body: a failure is reported through `Assert` with the
// routine's message and the routine returns. Nothing gets past it.
#pragma once

#include <string>
#include <string_view>
#include <type_traits>
#include <utility>

namespace frontpanels {

// Reports the exception that is being handled. Call from a catch block only.
void reportCurrentException(std::string_view message) noexcept;
// The description by which that exception is reported: the run-time error's own, "Out of memory", or
// "Internal error".
[[nodiscard]] std::string describeCurrentException();

// True when the body ran to its end. `message` is a text or, where it carries a value, a callable that makes
// one.
template <class Message, class Body>
bool guard(const Message& message, Body&& body) noexcept {
  try {
    std::forward<Body>(body)();
    return true;
  } catch (...) {
    if constexpr (std::is_invocable_v<const Message&>) {
      try {
        const std::string text = message();
        reportCurrentException(text);
      } catch (...) {
        reportCurrentException("");
      }
    } else {
      reportCurrentException(message);
    }
    return false;
  }
}

// The body's value, or `fallback` after a reported failure.
template <class Message, class Fallback, class Body>
Fallback guarded(const Message& message, Fallback fallback, Body&& body) noexcept {
  guard(message, [&] { fallback = std::forward<Body>(body)(); });
  return fallback;
}

}  // namespace frontpanels

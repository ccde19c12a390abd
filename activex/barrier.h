// The last barrier before the host: no exception leaves a COM method or a window procedure. What is caught
// becomes an error code with a text that the host can show.
#pragma once

#include <windows.h>

#include <string>
#include <type_traits>
#include <utility>

#include "activex/floating_point.h"
#include "platform/runtime_error.h"

namespace frontpanels::activex {

// A failure with a code of its own.
class ComFailure {
 public:
  explicit ComFailure(HRESULT code) noexcept : code_(code) {}
  [[nodiscard]] HRESULT code() const noexcept { return code_; }

 private:
  HRESULT code_;
};
inline void check(HRESULT result) {
  if (FAILED(result)) throw ComFailure(result);
}

// A build for tests defines it before all else and makes any body fail; otherwise there is nothing of it.
#ifndef FRONTPANELS_FAULT_POINT
#define FRONTPANELS_FAULT_POINT() static_cast<void>(0)
#endif

// For a catch block: the code of the exception that is being handled; its text becomes the thread's error
// information.
[[nodiscard]] HRESULT currentFailure(const IID& source) noexcept;

template <class Body>
HRESULT barrier(const IID& source, Body&& body) noexcept {
  const MaskedFloatingPoint masked;
  try {
    FRONTPANELS_FAULT_POINT();
    if constexpr (std::is_void_v<decltype(body())>) {
      body();
      return S_OK;
    } else {
      return body();
    }
  } catch (...) {
    return currentFailure(source);
  }
}
template <class Body>
HRESULT barrier(Body&& body) noexcept {
  return barrier(IID{}, std::forward<Body>(body));
}

}  // namespace frontpanels::activex

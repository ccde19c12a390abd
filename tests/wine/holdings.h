// What this process holds of the system: to be compared before and after something that must leave nothing.
#pragma once

#include <windows.h>

#include <cstdint>

namespace frontpanels::testing {

struct Holdings {
  int windows = 0;  // of this thread, hidden ones and children too
  int graphicsObjects = 0;
  std::int64_t heapBlocks = 0;  // in use, over all heaps
  std::int64_t heapBytes = 0;

  friend bool operator==(const Holdings&, const Holdings&) = default;
};
[[nodiscard]] Holdings holdings();
[[nodiscard]] Holdings operator-(const Holdings& a, const Holdings& b);

}  // namespace frontpanels::testing

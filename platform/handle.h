// A handle given out by the system: typed, comparable, null when zero. It owns nothing.
#pragma once

#include <cstdint>

namespace frontpanels {

template <class Tag>
struct Handle {
  std::uintptr_t value = 0;

  explicit constexpr operator bool() const noexcept { return value != 0; }
  friend constexpr bool operator==(const Handle&, const Handle&) = default;
};

using WindowHandle = Handle<struct WindowTag>;
using DcHandle = Handle<struct DcTag>;
using BitmapHandle = Handle<struct BitmapTag>;
using PenHandle = Handle<struct PenTag>;
using BrushHandle = Handle<struct BrushTag>;
using FontHandle = Handle<struct FontTag>;
using RegionHandle = Handle<struct RegionTag>;

}  // namespace frontpanels

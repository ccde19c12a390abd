// Result types that the trace manager knows by number. Others exist; a host may invent more.
#pragma once

#include <cstdint>

namespace frontpanels {

// What listing a result of a type does to the traces on show.
enum class ListedAs : std::uint8_t {
  Ignored,       // leaves the traces alone
  ClearsActive,  // the display starts over: the panel is told that there is no active trace
  Counted        // counts as one of the panel's traces
};

[[nodiscard]] ListedAs listedAs(std::int16_t resultType) noexcept;
// Whether the number is one of those above; an unknown one is counted too.
[[nodiscard]] bool isKnownResultType(std::int16_t resultType) noexcept;

}  // namespace frontpanels

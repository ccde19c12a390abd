// How many times this program has asked for heap memory.
#pragma once

#include <cstdint>

namespace frontpanels::bench {

[[nodiscard]] std::uint64_t allocationCount() noexcept;

}  // namespace frontpanels::bench

// What a receiver measures of a power that is partly steady, as of a carrier, and partly noise.
#pragma once

#include <cstdint>

#include "sources/random.h"

namespace frontpanels {

enum class Averaging : std::uint8_t { Power, LogPower, Largest, Smallest };

// Of so many looks at `steady` and noise of the mean power `noise`, which is above 0; in the unit of both.
[[nodiscard]] double measuredPower(Random& random, double steady, double noise, Averaging averaging,
                                   std::int32_t looks) noexcept;

}  // namespace frontpanels

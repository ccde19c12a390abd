// How fast a recording is played, in the order of the menu.
#pragma once

#include <array>
#include <cstddef>

namespace frontpanels::workbench {

inline constexpr std::array<unsigned, 6> kSweepsASecond = {1, 2, 5, 10, 20, 50};
inline constexpr std::size_t kFirstRate = 2;

}  // namespace frontpanels::workbench

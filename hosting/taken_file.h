// Files that another program has at the moment: it saves the same one, or looks through it.
#pragma once

#include <chrono>
#include <system_error>
#include <thread>

namespace frontpanels {

// Whether waiting may help.
[[nodiscard]] bool isTaken(const std::error_code& error) noexcept;

// Repeats a step that answers an error until it goes well or fails for another reason, for two seconds at
// most.
template <class Step>
std::error_code onceFree(const Step& step) {
  using Clock = std::chrono::steady_clock;
  constexpr std::chrono::seconds kPatience(2);
  constexpr std::chrono::milliseconds kBetween(10);
  const Clock::time_point end = Clock::now() + kPatience;
  for (;;) {
    const std::error_code error = step();
    if (!isTaken(error) || Clock::now() >= end) return error;
    std::this_thread::sleep_for(kBetween);
  }
}

}  // namespace frontpanels

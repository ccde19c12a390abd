// The four sets of pilots and the carrier: where their data come from, by what they are known to the host and
// to the trace manager, and the check box that switches them.
#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <span>
#include <string_view>

namespace frontpanels {

enum class PilotSet : std::uint8_t { AllPilots, ZoomedPilots, TopN, UserList };
inline constexpr std::size_t kPilotSets = 4;

struct PilotSetRow {
  PilotSet set;
  std::int16_t resultType;  // by which a host adds and removes the set's display
  std::int16_t traceId;     // under which the trace manager keeps it
  bool bars;                // otherwise a trace of energy over PN offset
  const char* checkBox;
  const char* title;
};
[[nodiscard]] std::span<const PilotSetRow, kPilotSets> pilotSets() noexcept;
[[nodiscard]] const PilotSetRow& pilotSet(PilotSet set) noexcept;
// Null for another number.
[[nodiscard]] const PilotSetRow* pilotSetOfResultType(std::int32_t resultType) noexcept;
[[nodiscard]] const PilotSetRow* pilotSetOfTrace(std::int16_t traceId) noexcept;

// The servers, in the order of PilotSet, the carrier's last.
enum class PilotServer : std::uint8_t { AllPilots, ZoomedPilots, TopN, UserList, Carrier };
inline constexpr std::size_t kPilotServers = 5;

struct PilotServerRow {
  PilotServer server;
  const char* property;  // under which a form keeps the server's paths
  const char* paths;     // as a new panel has them, separated by the escape character
};
[[nodiscard]] std::span<const PilotServerRow, kPilotServers> pilotServers() noexcept;

}  // namespace frontpanels

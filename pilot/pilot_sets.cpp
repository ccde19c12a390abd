#include "pilot/pilot_sets.h"

#include <algorithm>

namespace frontpanels {
namespace {

using enum PilotSet;

constexpr std::array<PilotSetRow, kPilotSets> kSets{{
    {AllPilots, 14, 11, false, "allPilotsCheckBox", "All Pilots"},
    {ZoomedPilots, 18, 17, false, "zoomedPilotsCheckBox", "Zoomed Pilots"},
    {TopN, 201, 203, true, "topNPilotsCheckBox", "Top N"},
    {UserList, 200, 204, true, "userListCheckBox", "User List"},
}};

// A path that is not the first of its server is separated from the one before.
#define FOLLOWED_BY "\x1b"
#define MULTIPATH_PATHS(set)                                                                            \
  set "/Io" FOLLOWED_BY set "/Pn" FOLLOWED_BY set "/Peak EcIo" FOLLOWED_BY set "/Delay" FOLLOWED_BY set \
      "/Aggr EcIo" FOLLOWED_BY set "/Delay Spread" FOLLOWED_BY set "/Aggr Minus Peak EcIo"

constexpr std::array<PilotServerRow, kPilotServers> kServers{{
    {PilotServer::AllPilots, "DfiAllPilots",
     "Brantor Scanner/CDMA All Pilots/Io" FOLLOWED_BY "Brantor Scanner/CDMA All Pilots/AllPilotsTrace"},
    {PilotServer::ZoomedPilots, "DfiZoomedPilots",
     "Brantor Scanner/Cdma Zoomed Pilot/Io" FOLLOWED_BY
     "Brantor Scanner/Cdma Zoomed Pilot/Zoomed Pilots Trace"},
    {PilotServer::TopN, "DfiPilotTopNMultipath",
     MULTIPATH_PATHS("Brantor Scanner/Cdma Pilot Top N Multipath")},
    {PilotServer::UserList, "DfiPilotListMultipath",
     MULTIPATH_PATHS("Brantor Scanner/Cdma Pilot List Multipath Frame")},
    {PilotServer::Carrier, "DfiCarrier",
     "Brantor Scanner/Cdma Carrier Frame/Carrier Error" FOLLOWED_BY
     "Brantor Scanner/Cdma Carrier Frame/Carrier Freq State" FOLLOWED_BY
     "Brantor Scanner/Cdma Carrier Frame/One Pps"},
}};

#undef MULTIPATH_PATHS
#undef FOLLOWED_BY

template <class Predicate>
const PilotSetRow* findSet(Predicate predicate) noexcept {
  const auto* const found = std::find_if(kSets.begin(), kSets.end(), predicate);
  return found == kSets.end() ? nullptr : found;
}

}  // namespace

std::span<const PilotSetRow, kPilotSets> pilotSets() noexcept { return kSets; }

const PilotSetRow& pilotSet(PilotSet set) noexcept { return kSets[static_cast<std::size_t>(set)]; }

const PilotSetRow* pilotSetOfResultType(std::int32_t resultType) noexcept {
  return findSet([resultType](const PilotSetRow& row) { return row.resultType == resultType; });
}

const PilotSetRow* pilotSetOfTrace(std::int16_t traceId) noexcept {
  return findSet([traceId](const PilotSetRow& row) { return row.traceId == traceId; });
}

std::span<const PilotServerRow, kPilotServers> pilotServers() noexcept { return kServers; }

}  // namespace frontpanels

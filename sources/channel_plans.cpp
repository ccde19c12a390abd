#include "sources/channel_plans.h"

#include <algorithm>
#include <iterator>

namespace frontpanels {
namespace {

// Channels below the first one that the band had when it was numbered.
constexpr ChannelBlock kExtendedCellular[] = {{-32, 991, 1023}};
constexpr ChannelBlock kExtendedGsm[] = {{-49, 975, 1023}};

constexpr ChannelBand kCellular[] = {
    {0, "Cellular downlink", false, 870e6, 30e3, 869e6, 894e6, kExtendedCellular},
    {1, "Cellular uplink", true, 825e6, 30e3, 824e6, 849e6, kExtendedCellular},
};
constexpr ChannelBand kPcs[] = {
    {2, "PCS downlink", false, 1930e6, 50e3, 1930e6, 1990e6, {}},
    {3, "PCS uplink", true, 1850e6, 50e3, 1850e6, 1910e6, {}},
};
constexpr ChannelBand kGsm900[] = {
    {4, "GSM 900 downlink", false, 935e6, 200e3, 925e6, 960e6, kExtendedGsm},
    {5, "GSM 900 uplink", true, 890e6, 200e3, 880e6, 915e6, kExtendedGsm},
};
// The first channel has the number 512 and lies 200 kHz above the lower limit.
constexpr ChannelBand kDcs1800[] = {
    {6, "DCS 1800 downlink", false, 1805.2e6 - 512 * 200e3, 200e3, 1805e6, 1880e6, {}},
    {7, "DCS 1800 uplink", true, 1710.2e6 - 512 * 200e3, 200e3, 1710e6, 1785e6, {}},
};
constexpr ChannelBand kImt2000[] = {
    {8, "IMT-2000 downlink", false, 2110e6, 50e3, 2110e6, 2170e6, {}},
    {9, "IMT-2000 uplink", true, 1920e6, 50e3, 1920e6, 1980e6, {}},
};

constexpr Channelization kPlans[] = {
    {0, "Cellular", kCellular}, {1, "PCS", kPcs},          {2, "GSM 900", kGsm900},
    {3, "DCS 1800", kDcs1800},  {4, "IMT-2000", kImt2000},
};

}  // namespace

std::span<const Channelization> channelizations() noexcept { return kPlans; }

const Channelization* channelization(std::int32_t value) noexcept {
  const auto* const found = std::find_if(std::begin(kPlans), std::end(kPlans),
                                         [value](const Channelization& plan) { return plan.value == value; });
  return found == std::end(kPlans) ? nullptr : found;
}

}  // namespace frontpanels

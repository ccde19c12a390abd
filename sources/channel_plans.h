// The channelizations that hosts give to the spectrum panel: channel numbers of mobile networks, band by
// band.
#pragma once

#include <cstdint>
#include <span>

namespace frontpanels {

// Channels `lowest` to `highest`, the first of them where `channel` would lie by itself.
struct ChannelBlock {
  double channel;
  double lowest;
  double highest;
};

// By itself channel n lies at zeroHz + n * spacingHz.
struct ChannelBand {
  std::int16_t order;  // no other band of any channelization has it
  const char* name;
  bool uplink;
  double zeroHz;
  double spacingHz;
  double lowestHz;  // the band's limits
  double highestHz;
  std::span<const ChannelBlock> blocks;
};

// The downlink is first; orders follow each other. Of the limits of a centre frequency a band's order is its
// place here.
struct Channelization {
  std::int16_t value;  // of the parameter that chooses it
  const char* name;
  std::span<const ChannelBand> bands;
};

[[nodiscard]] std::span<const Channelization> channelizations() noexcept;
// Null for another value.
[[nodiscard]] const Channelization* channelization(std::int32_t value) noexcept;

}  // namespace frontpanels

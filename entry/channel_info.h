// clsChannelInfo: the channelizations that the host delivers, and their application to numeric entries.
#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

#include "entry/channel_map.h"
#include "entry/entry_ranges.h"
#include "entry/host_record.h"

namespace frontpanels {

class clsNumericEntry;

// The order of a record says which band it belongs to.
struct ChannelZero {
  std::int16_t order = 0;
  double frequency = 0;
  friend bool operator==(const ChannelZero&, const ChannelZero&) = default;
};

struct ChannelSpacing {
  std::int16_t order = 0;
  double spacing = 0;
  friend bool operator==(const ChannelSpacing&, const ChannelSpacing&) = default;
};

struct OrderedDiscontinuity {
  std::int16_t order = 0;
  ChannelDiscontinuity block;
  friend bool operator==(const OrderedDiscontinuity&, const OrderedDiscontinuity&) = default;
};

// The orders of a channelization, both ends included: the lowest one's band is range 0 of an entry.
struct ChannelLookup {
  std::int16_t id = 0;
  std::int16_t lowestOrder = 0;
  std::int16_t highestOrder = 0;
  friend bool operator==(const ChannelLookup&, const ChannelLookup&) = default;
};

class clsChannelInfo {
 public:
  static constexpr std::string_view kTypeName = "clsChannelInfo";

  // Empties the tables.
  void reinitialize() noexcept;

  // Each appends a record; a text that is no number adds none and is not reported. The first record of the
  // set is read. A host whose data have no orders has order 0 alone.
  void setChannelZero(std::string_view value, const HostRecordSet* records = nullptr) noexcept;
  void setChannelSpacing(std::string_view value, const HostRecordSet* records = nullptr) noexcept;
  void setChannelDiscontinuity(std::string_view value, const HostRecordSet* records) noexcept;
  void setChannelLookup(std::string_view value, const HostRecordSet* records) noexcept;

  // Gives the entry's ranges the channel zeros, spacings and discontinuities of one channelization; of two
  // lookups the one added last counts, of two zeros or spacings of a band the one added first. The entry then
  // has channel units and its text is written anew. An id that no lookup has, and a channelization that no
  // entry can take (a spacing of 0, blocks that overlap, more bands than ranges), are reported, leave the
  // entry as it was and answer false.
  bool selectChannelization(std::int16_t id, clsNumericEntry& entry) const noexcept;
  // The spacings alone, for an entry that holds the distance of two frequencies: it counts from no channel
  // zero and knows no discontinuity.
  void selectChannelSpacing(std::int16_t id, clsNumericEntry& entry) const noexcept;

  [[nodiscard]] const std::vector<ChannelZero>& channelZeros() const noexcept { return zeros_; }
  [[nodiscard]] const std::vector<ChannelSpacing>& channelSpacings() const noexcept { return spacings_; }
  [[nodiscard]] const std::vector<OrderedDiscontinuity>& channelDiscontinuities() const noexcept {
    return discontinuities_;
  }
  [[nodiscard]] const std::vector<ChannelLookup>& channelLookups() const noexcept { return lookups_; }

 private:
  // What a channelization gives to one range.
  struct RangePlan {
    std::optional<double> zero;
    std::optional<double> spacing;
    std::vector<ChannelDiscontinuity> discontinuities;
  };
  using RangePlans = std::array<RangePlan, EntryRanges::kCount>;

  // Null after a report in the routine's name.
  [[nodiscard]] const ChannelLookup* lookup(std::string_view routine, std::int16_t id) const;
  [[nodiscard]] RangePlans spacingsOf(const ChannelLookup& lookup) const;
  [[nodiscard]] RangePlans plansOf(const ChannelLookup& lookup) const;

  std::vector<ChannelZero> zeros_;
  std::vector<ChannelSpacing> spacings_;
  std::vector<OrderedDiscontinuity> discontinuities_;
  std::vector<ChannelLookup> lookups_;
};

}  // namespace frontpanels

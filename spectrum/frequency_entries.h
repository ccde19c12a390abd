// Centre, span, start and stop of a sweep as entries, and how they follow each other. All in hertz. What is
// written here is no news to the entries' owner.
#pragma once

#include <cstdint>
#include <string_view>

#include "entry/channel_info.h"
#include "entry/numeric_entry.h"

namespace frontpanels {

class FrequencyEntries {
 public:
  // 1 GHz in a span of 10 MHz, from 0 to 6 GHz.
  FrequencyEntries();

  clsNumericEntry center;
  clsNumericEntry span;
  clsNumericEntry start;
  clsNumericEntry stop;

  // The ends of the frequency axis. The start entry rounds to its resolution and both edge entries end at
  // their limits, the axis does neither.
  [[nodiscard]] double axisStartHz() const noexcept { return center.value() - span.value() * 0.5; }
  [[nodiscard]] double axisStopHz() const noexcept { return center.value() + span.value() * 0.5; }
  // The range of the centre, which is a band: 0 is the downlink.
  [[nodiscard]] bool downlink() const noexcept { return center.range() == 0; }

  // A centre of the host's or the program's, in whichever band holds it; the edges go along.
  void setCenter(double centerHz) noexcept;
  // After the user has changed the centre: it gives way where the sweep would pass a limit, and the edges go
  // along.
  void fitCenter() noexcept;
  // The edges move apart round the centre, which gives way at the limits; the steps follow the span.
  void setSpan(double spanHz) noexcept;
  // After the user has changed an edge: centre and span become what lies between the edges. A start above the
  // stop drags the other edge along.
  void joinEdges(bool startChanged) noexcept;
  // The edges round the centre, after one of them was changed in vain.
  void placeEdges() noexcept;
  // The centre goes over to a band: to the same channel where channels are shown, else as far from the lower
  // limit as before. Nothing happens where the band has no limits.
  void setBand(std::int32_t range) noexcept;

  // A host's limits of frequencies: of centre and edges alike. False, after a report, for unusable ones.
  bool limits(const HostRecordSet& records) noexcept;
  // Shows channels of the channelization, or frequencies. One that `channels` has not, or that no entry can
  // take, is reported and the answer is false.
  bool showChannels(const clsChannelInfo& channels, std::int16_t channelization) noexcept;
  void showFrequencies() noexcept;

 private:
  // The edges' band is the centre's.
  void followRange() noexcept;
  void followSpan() noexcept;
};

// Number format of the frequency axis for a span.
[[nodiscard]] std::string_view axisFormatForSpan(double spanHz) noexcept;

}  // namespace frontpanels

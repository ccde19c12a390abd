// What the fields of SpectrumView hold: the entries and lists behind the controls of the designer table, with
// the limits and values that hold until a host sends its own.
#pragma once

#include <array>
#include <cstdint>
#include <optional>

#include "entry/channel_info.h"
#include "entry/enumerated_parameter.h"
#include "entry/numeric_entry.h"
#include "platform/control_set.h"
#include "spectrum/frequency_entries.h"

namespace frontpanels {

// What a sweep is started by, and what the sweep-rate entry therefore holds: seconds or metres.
enum class MeasurementInterval : std::uint8_t { Time, Distance };

class SpectrumFields {
 public:
  // Gives the controls of the designer table their meaning; they must outlive the fields. Reports host tables
  // of the IF filter and of the averaging mode that have not the records that the panel's options stand for.
  explicit SpectrumFields(ControlSet& controls);

  ControlSet& controls;
  FrequencyEntries frequency;
  clsNumericEntry frequencyRbw;    // Hz
  clsNumericEntry averageCount;    // sweeps
  clsNumericEntry displayLength;   // points
  clsNumericEntry sweepRate;       // s or m
  clsNumericEntry verticalScale;   // dB a division
  clsNumericEntry verticalOffset;  // dBm at the top of the graph
  clsEnumeratedParameter averageType;
  clsEnumeratedParameter channelization;
  clsChannelInfo channels;

  [[nodiscard]] MeasurementInterval interval() const {
    return controls.optionButton("IntervalTimeOption").Value() ? MeasurementInterval::Time
                                                               : MeasurementInterval::Distance;
  }
  // The sweep-rate entry goes over to seconds or metres and shows the value, which is no news.
  void showInterval(MeasurementInterval interval, double value) noexcept;
  // A host's limits of one kind of interval; they outlast the other kind's turn. False for unusable ones.
  bool intervalLimits(MeasurementInterval kind, const HostRecordSet& records) noexcept;

 private:
  static constexpr std::size_t kIntervalKinds = 2;

  void setUpEntries();
  void setUpLists();

  std::array<std::optional<EntryLimits>, kIntervalKinds> intervalLimits_;
};

}  // namespace frontpanels

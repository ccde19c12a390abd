// The receiver that a recording stands in for: the settings that panels ask it for, and the part of each
// sweep that it is tuned to.
#pragma once

#include <cstdint>
#include <map>
#include <vector>

#include "sources/resample.h"
#include "sources/tuning.h"

namespace frontpanels {

// What the receiver can be tuned to: as far as panels go.
inline constexpr double kLowestTunedHz = 0.0;
inline constexpr double kHighestTunedHz = 6.0e9;

struct ReceiverSetting {
  std::int16_t code = 0;
  double value = 0;

  friend bool operator==(const ReceiverSetting&, const ReceiverSetting&) = default;
};

class Receiver {
 public:
  // A panel's request, by its code. False, and nothing has changed, for a code that the receiver does not
  // have and for a value that it cannot take, not-a-number among them; the panel is then answered with the
  // value that holds.
  [[nodiscard]] bool request(std::int16_t code, double value);
  // What was requested since the last call, each code once, with the value that the receiver has now.
  [[nodiscard]] std::vector<ReceiverSetting> takeAnswers();
  // All that was requested so far: for a panel that is new.
  [[nodiscard]] std::vector<ReceiverSetting> settings() const;
  // The defaults with what was requested in place of theirs, points as many as a panel shows at most.
  [[nodiscard]] SpectrumTuning tuning(const SpectrumTuning& defaults) const;

  // The sweep as panels show it. Before a request of centre or span that is the whole sweep; from then on the
  // range stays, whatever is swept, and what was not requested stays as it was shown last. A range that
  // passes a limit is moved back inside. Valid until the next call.
  [[nodiscard]] const DisplaySweep& receive(const Sweep& sweep);
  // The channelization requested last, at first 0.
  [[nodiscard]] std::int16_t channelization() const;
  // Whether centre or span was requested: the range then stays.
  [[nodiscard]] bool tuned() const noexcept { return tuned_; }
  // Forgets the tuning, from the next sweep on; the other settings stay.
  void showWholeSweeps();

 private:
  void fitRange();

  std::map<std::int16_t, double> values_;  // centre and span among them once there is a range
  std::vector<std::int16_t> unanswered_;
  bool tuned_ = false;
  DisplaySweep display_;
};

}  // namespace frontpanels

// The receiver of the pilot panel: the settings that panels ask it for, and the user's list of PN offsets.
#pragma once

#include <array>
#include <cstdint>
#include <map>
#include <optional>
#include <span>
#include <vector>

#include "sources/receiver.h"
#include "sources/tuning.h"

namespace frontpanels {

class PilotReceiver {
 public:
  // A panel's request, by its code; the index is that of an edit of the user's list. False, and nothing has
  // changed, for a code that the receiver does not have and for a value that the panel's own entries would
  // not let through, not-a-number among them; the panel is then answered with the value that holds.
  [[nodiscard]] bool request(std::int16_t code, std::int16_t index, double value);
  // A panel's operation that switches a set, by the set's result type. False for another number.
  [[nodiscard]] bool display(std::int32_t resultType, bool on);

  // What was requested since the last call, each code once, with the value that the receiver has now. Edits
  // of the list are not among them: an echo would be another edit.
  [[nodiscard]] std::vector<ReceiverSetting> takeAnswers();
  // What a panel that is new has to be sent, in this order; of the window of the code start and span.
  [[nodiscard]] std::vector<ReceiverSetting> settings() const;
  [[nodiscard]] std::span<const std::int32_t> userPns() const noexcept { return userPns_; }

  // The defaults with what was requested in place of theirs. A window that is not requested is expressed in
  // the code format that is.
  [[nodiscard]] PilotTuning tuning(const PilotTuning& defaults) const;

 private:
  // In whole chips of the code format.
  struct Window {
    double start;
    double span;
    double center;  // as it was requested: of an odd span half a chip beside the middle
  };
  enum Set : std::uint8_t { kAllPilots, kZoomedPilots, kTopN, kUserList, kSets };

  void take(std::int16_t code, double value);
  [[nodiscard]] bool takeList(std::int16_t index, double value);
  void format(std::int32_t format);
  void place(double start, double span);
  void placeRound(double center, double span);
  [[nodiscard]] std::optional<double> value(std::int16_t code) const;
  [[nodiscard]] std::int32_t codeFormat() const;

  std::map<std::int16_t, double> values_;  // but for sets, list and window
  std::array<std::optional<bool>, kSets> sets_;
  std::vector<std::int32_t> userPns_;
  bool listEdited_ = false;
  std::optional<Window> window_;
  std::vector<std::int16_t> unanswered_;
};

}  // namespace frontpanels

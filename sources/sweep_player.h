// Plays a recording sweep by sweep: what the keys of a recorder do, without a clock. Whoever has the clock
// calls `step` while `state` is `Playing`.
#pragma once

#include <cstdint>
#include <memory>
#include <string>

#include "sources/sweep_recording.h"

namespace frontpanels {

class SweepPlayer {
 public:
  enum class State { Empty, Paused, Playing, Ended };

  // `files` must outlive the player.
  explicit SweepPlayer(TextFiles& files) : files_(files) {}

  // Loads another recording and stands before its first sweep. Raises as `SweepRecording::open` does; the
  // player then keeps the one that it had.
  void open(const std::string& path);

  // Each does nothing without a recording. Playing on from the end begins anew; that and `restart` raise as
  // `open` does, and the player then stands at the end.
  void play();
  void pause() noexcept;
  void restart();
  // Takes the next sweep; false, and the state `Ended`, when there is none. The state is otherwise unchanged.
  bool step();

  [[nodiscard]] State state() const noexcept { return state_; }
  // The sweep taken last; without bins until there was one.
  [[nodiscard]] const Sweep& sweep() const noexcept { return sweep_; }
  // Counted from 1; 0 before the first sweep.
  [[nodiscard]] std::uint64_t sweepNumber() const noexcept { return sweepNumber_; }
  [[nodiscard]] const std::string& sweepTime() const noexcept { return sweepTime_; }
  // Null while empty.
  [[nodiscard]] const SweepRecording* recording() const noexcept { return recording_.get(); }
  // How far the reading is, 0 to 100.
  [[nodiscard]] int percent() const;

 private:
  void rewind();
  void standBeforeFirst();

  TextFiles& files_;
  std::unique_ptr<SweepRecording> recording_;
  State state_ = State::Empty;
  Sweep sweep_;
  std::uint64_t sweepNumber_ = 0;
  std::string sweepTime_;
};

}  // namespace frontpanels

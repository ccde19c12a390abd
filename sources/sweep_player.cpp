#include "sources/sweep_player.h"

#include <algorithm>

namespace frontpanels {

void SweepPlayer::open(const std::string& path) {
  recording_ = SweepRecording::open(files_, path);
  standBeforeFirst();
  state_ = State::Paused;
}

void SweepPlayer::play() {
  if (state_ == State::Empty) return;
  if (state_ == State::Ended) rewind();
  state_ = State::Playing;
}

void SweepPlayer::pause() noexcept {
  if (state_ == State::Playing) state_ = State::Paused;
}

void SweepPlayer::restart() {
  if (state_ == State::Empty) return;
  const State before = state_;
  rewind();
  state_ = before == State::Playing ? State::Playing : State::Paused;
}

bool SweepPlayer::step() {
  if (state_ == State::Empty || state_ == State::Ended) return false;
  if (!recording_->next(sweep_)) {
    state_ = State::Ended;
    return false;
  }
  sweepNumber_ = sweep_.number;
  sweepTime_ = sweep_.time;
  return true;
}

// A recording whose file is gone cannot be read on either: the player then stands at its end.
void SweepPlayer::rewind() {
  state_ = State::Ended;
  recording_->rewind();
  standBeforeFirst();
}

void SweepPlayer::standBeforeFirst() {
  sweepNumber_ = 0;
  sweepTime_.clear();
}

int SweepPlayer::percent() const {
  if (!recording_) return 0;
  const std::uint64_t size = recording_->sizeBytes();
  if (size == 0) return 100;
  // In double: a hundred times the size of a large file still fits.
  const double share = static_cast<double>(recording_->positionBytes()) / static_cast<double>(size);
  return static_cast<int>(std::clamp(share * 100.0, 0.0, 100.0));
}

}  // namespace frontpanels

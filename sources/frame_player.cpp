#include "sources/frame_player.h"

#include <algorithm>
#include <utility>

namespace frontpanels {

void FramePlayer::open(std::unique_ptr<FrameSource> source) {
  if (!source) return;
  source_ = std::move(source);
  frame_ = {};
  state_ = State::Paused;
}

void FramePlayer::close() {
  source_.reset();
  frame_ = {};
  state_ = State::Empty;
}

void FramePlayer::play() {
  if (state_ == State::Empty) return;
  if (state_ == State::Ended) rewind();
  state_ = State::Playing;
}

void FramePlayer::pause() noexcept {
  if (state_ == State::Playing) state_ = State::Paused;
}

void FramePlayer::restart() {
  if (state_ == State::Empty) return;
  const State before = state_;
  rewind();
  state_ = before == State::Playing ? State::Playing : State::Paused;
}

bool FramePlayer::step() {
  if (state_ == State::Empty || (state_ == State::Ended && !loop_)) return false;
  if (state_ != State::Ended && takeNext()) return true;
  const State after = state_ == State::Playing ? State::Playing : State::Paused;
  state_ = State::Ended;
  if (!loop_) return false;
  source_->seek(1);
  if (!takeNext()) return false;
  state_ = after;
  return true;
}

void FramePlayer::stepBack() {
  if (frameNumber() > 1) seek(frameNumber() - 1);
}

void FramePlayer::seek(std::uint64_t number) {
  if (state_ == State::Empty) return;
  const State before = state_;
  state_ = State::Ended;
  const std::uint64_t last = frameCount().value_or(number);
  source_->seek(std::max<std::uint64_t>(std::min(number, last), 1));
  if (takeNext()) state_ = before == State::Playing ? State::Playing : State::Paused;
}

bool FramePlayer::takeNext() {
  if (!source_->next(coming_)) return false;
  std::swap(frame_, coming_);
  return true;
}

// A recording whose file is gone cannot be read on either: the player then stands at its end.
void FramePlayer::rewind() {
  state_ = State::Ended;
  source_->seek(1);
  frame_.number = 0;
  frame_.time.clear();
}

std::optional<std::uint64_t> FramePlayer::frameCount() const {
  return source_ ? source_->frameCount() : std::nullopt;
}

int FramePlayer::percent() const {
  const std::optional<std::uint64_t> count = frameCount();
  if (!count) return 0;
  if (*count == 0) return 100;
  return static_cast<int>(static_cast<double>(frameNumber()) / static_cast<double>(*count) * 100.0);
}

}  // namespace frontpanels

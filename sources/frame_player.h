// Plays frames one after the other: what the keys of a recorder do, without a clock. Whoever has the clock
// calls `step` while `state` is `Playing`.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>

#include "sources/frame_source.h"

namespace frontpanels {

class FramePlayer {
 public:
  enum class State { Empty, Paused, Playing, Ended };

  // Takes another source and stands before its first frame; without one (null) all stays as it is.
  void open(std::unique_ptr<FrameSource> source);
  void close();

  // Each does nothing without a source. What goes to another place than the next raises as
  // `FrameSource::seek` does: the state is then `Ended`, and the frame stays.
  //
  // Playing on from the end begins anew.
  void play();
  void pause() noexcept;
  void restart();
  // Takes the next frame. At the end it begins anew where there is a loop; otherwise, and where the source
  // has no frame at all, it answers false and the state is `Ended`. The state is otherwise unchanged, but
  // that going on from `Ended` pauses.
  bool step();
  // Shows the frame before; nothing happens at the first.
  void stepBack();
  // Shows a frame, or the nearest that there is. Playing goes on from there.
  void seek(std::uint64_t number);
  void loop(bool on) noexcept { loop_ = on; }
  [[nodiscard]] bool loop() const noexcept { return loop_; }

  [[nodiscard]] State state() const noexcept { return state_; }
  // The one taken last. Before the first it has neither number nor time, whatever else it still holds.
  [[nodiscard]] const Frame& frame() const noexcept { return frame_; }
  // Counted from 1; 0 before the first frame.
  [[nodiscard]] std::uint64_t frameNumber() const noexcept { return frame_.number; }
  // Nothing while empty and for a source without an end.
  [[nodiscard]] std::optional<std::uint64_t> frameCount() const;
  // Null while empty.
  [[nodiscard]] FrameSource* source() noexcept { return source_.get(); }
  [[nodiscard]] const FrameSource* source() const noexcept { return source_.get(); }
  // Of its frames, 0 to 100; 0 without an end.
  [[nodiscard]] int percent() const;

 private:
  bool takeNext();
  void rewind();

  std::unique_ptr<FrameSource> source_;
  State state_ = State::Empty;
  bool loop_ = false;
  Frame frame_;
  Frame coming_;  // so that what is shown stays where nothing comes
};

}  // namespace frontpanels

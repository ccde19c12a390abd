// Where frames come from: a recording or the simulator.
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "platform/textfile.h"
#include "sources/frame.h"

namespace frontpanels {

class FrameSource {
 public:
  virtual ~FrameSource() = default;

  // False at the end; `frame` is then unspecified. What `frame` has room for is used again. Raises nothing
  // for what cannot be read: see `problemReport`.
  virtual bool next(Frame& frame) = 0;
  // `next` then gives frame `number`, counted from 1; beyond the last one it stands at the end. Raises a
  // run-time error that names the file when that is gone; the source then stands at its end.
  virtual void seek(std::uint64_t number) = 0;

  // Nothing for a source without an end.
  [[nodiscard]] virtual std::optional<std::uint64_t> frameCount() const = 0;
  // A file's path, or what the source is.
  [[nodiscard]] virtual const std::string& name() const = 0;
  [[nodiscard]] virtual const char* formatName() const = 0;
  [[nodiscard]] virtual bool hasSweeps() const = 0;
  [[nodiscard]] virtual bool hasPilots() const = 0;
  // For the user: what was wrong with what was read so far, and the first of it by its place, a line each;
  // empty when nothing was.
  [[nodiscard]] virtual std::string problemReport() const = 0;
};

// Hears how far a long work is, 0 to 100, every now and then. False ends the work.
using Progress = std::function<bool(int percent)>;

inline constexpr std::size_t kMaxBookmarks = 4096;

// The format is recognised from the content. The recording is read once, to know its frames and to be able to
// seek; held are one frame and at most `maxBookmarks` places, from 2 on. `progress` hears of every 64 KiB.
// Null when it ended the work. Raises a run-time error whose description names the file: when it cannot be
// opened, is empty, or is no recording. `files` must outlive the source.
[[nodiscard]] std::unique_ptr<FrameSource> openRecording(TextFiles& files, const std::string& path,
                                                         const Progress& progress = {},
                                                         std::size_t maxBookmarks = kMaxBookmarks);

}  // namespace frontpanels

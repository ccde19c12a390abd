// What reads the frames of one format, one after the other: the part of a recording that differs by format.
#pragma once

#include <cstdint>
#include <memory>
#include <string>

#include "platform/textfile.h"
#include "sources/frame.h"

namespace frontpanels {

// Where a frame begins in its file.
struct FramePlace {
  std::uint64_t bytes = 0;
  std::uint64_t linesBefore = 0;  // in text
  friend bool operator==(const FramePlace&, const FramePlace&) = default;
};

class FrameReader {
 public:
  virtual ~FrameReader() = default;

  // False at the end; `frame` is then unspecified, otherwise all of it is set but the numbers. What it has
  // room for is used again. What cannot be read is passed over and noted for the report.
  virtual bool next(Frame& frame) = 0;
  // Of the next frame, or of what lies before it and is passed over.
  [[nodiscard]] virtual FramePlace place() const = 0;
  // Opens the file anew, for it may have changed; `next` then reads from there. Raises a run-time error that
  // names the file.
  virtual void goTo(const FramePlace& place) = 0;

  // When it was opened last.
  [[nodiscard]] virtual std::uint64_t sizeBytes() const = 0;
  [[nodiscard]] virtual const std::string& path() const = 0;
  [[nodiscard]] virtual const char* formatName() const = 0;
  [[nodiscard]] virtual std::string problemReport() const = 0;
};

// The format is recognised from the content. Raises a run-time error that names the file: when it cannot be
// opened, is empty, or is no recording. `files` must outlive the reader.
[[nodiscard]] std::unique_ptr<FrameReader> openFrameReader(TextFiles& files, const std::string& path);

}  // namespace frontpanels

// Text files, read line by line with a bound on what is held at once.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>

namespace frontpanels {

struct TextLine {
  std::string text;          // without its line end (LF or CRLF), cut to the reader's bound
  std::uint64_t number = 0;  // counted from 1
  bool cut = false;          // the line was longer than the bound; the rest of it was passed over
  bool ended = false;        // by LF or CRLF; only the last line of a file may lack its end
};

class TextReader {
 public:
  virtual ~TextReader() = default;

  // False at the end of the file; `line` keeps its capacity from call to call.
  // Raises "Device I/O error" when reading fails on the way.
  virtual bool readLine(TextLine& line) = 0;
  // Bytes consumed so far and in the whole file, for a progress bar.
  [[nodiscard]] virtual std::uint64_t positionBytes() const = 0;
  [[nodiscard]] virtual std::uint64_t sizeBytes() const = 0;
};

class TextFiles {
 public:
  virtual ~TextFiles() = default;

  // `path` is UTF-8. Raises "File not found", "Permission denied" or "Path/File access error".
  [[nodiscard]] virtual std::unique_ptr<TextReader> open(const std::string& path,
                                                         std::size_t maxLineBytes) = 0;
};

// The files of the operating system.
[[nodiscard]] TextFiles& systemTextFiles();

}  // namespace frontpanels

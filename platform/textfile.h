// Files of others, read line by line or in pieces, with a bound on what is held at once.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>
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
  // The next line begins `positionBytes` into the file, with so many lines before it. At or beyond the end
  // there is none.
  virtual void goTo(std::uint64_t positionBytes, std::uint64_t linesBefore) = 0;
  // Bytes consumed so far and in the whole file, for a progress bar.
  [[nodiscard]] virtual std::uint64_t positionBytes() const = 0;
  [[nodiscard]] virtual std::uint64_t sizeBytes() const = 0;
};

class ByteReader {
 public:
  virtual ~ByteReader() = default;

  // How many bytes it has put into `bytes`, from the front; fewer than there is room for only at the end of
  // the file. Raises "Device I/O error".
  [[nodiscard]] virtual std::size_t read(std::span<char> bytes) = 0;
  // At or beyond the end there is nothing to read.
  virtual void goTo(std::uint64_t positionBytes) = 0;
  // When it was opened.
  [[nodiscard]] virtual std::uint64_t sizeBytes() const = 0;
};

class TextFiles {
 public:
  virtual ~TextFiles() = default;

  // `path` is UTF-8. Raises "File not found", "Permission denied" or "Path/File access error".
  [[nodiscard]] virtual std::unique_ptr<TextReader> open(const std::string& path,
                                                         std::size_t maxLineBytes) = 0;
  // The same for what is no text, or not known to be; and nothing but a file, for only that can be gone to
  // and fro in.
  [[nodiscard]] virtual std::unique_ptr<ByteReader> openBytes(const std::string& path) = 0;
};

// Lines of `bytes`, which stands at its begin.
[[nodiscard]] std::unique_ptr<TextReader> linesOf(std::unique_ptr<ByteReader> bytes,
                                                  std::size_t maxLineBytes);

// The files of the operating system.
[[nodiscard]] TextFiles& systemTextFiles();

}  // namespace frontpanels

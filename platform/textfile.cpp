#include "platform/textfile.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <limits>
#include <system_error>
#include <utility>

#include "platform/file_path.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

namespace fs = std::filesystem;

class FileBytes : public ByteReader {
 public:
  FileBytes(std::ifstream file, std::uint64_t sizeBytes) : file_(std::move(file)), sizeBytes_(sizeBytes) {}

  std::size_t read(std::span<char> bytes) override {
    if (file_.eof()) return 0;
    file_.read(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    if (file_.bad() || (file_.fail() && !file_.eof())) raiseDeviceIoError();
    return static_cast<std::size_t>(file_.gcount());
  }
  void goTo(std::uint64_t positionBytes) override {
    file_.clear();
    file_.seekg(static_cast<std::streamoff>(positionBytes));
    if (file_.fail()) raiseDeviceIoError();
  }
  [[nodiscard]] std::uint64_t sizeBytes() const override { return sizeBytes_; }

 private:
  std::ifstream file_;
  std::uint64_t sizeBytes_;
};

// Holds one block of the file and one line cut to its bound, however long the file or its lines are.
class LineReader : public TextReader {
 public:
  LineReader(std::unique_ptr<ByteReader> bytes, std::size_t maxLineBytes)
      : bytes_(std::move(bytes)),
        // One more is kept to see whether the byte at the bound is the CR of a line end.
        keptBytes_(std::min(maxLineBytes, std::numeric_limits<std::size_t>::max() - 1) + 1) {}

  bool readLine(TextLine& line) override {
    if (!fill()) return false;
    line.text.clear();
    line.ended = false;
    std::uint64_t length = 0;
    while (!line.ended && fill()) length += takeFromBlock(line);
    if (line.ended && line.text.ends_with('\r')) {  // in a line that is cut it only shortens what is cut off
      line.text.pop_back();
      --length;
    }
    line.cut = length >= keptBytes_;
    if (line.cut) line.text.resize(keptBytes_ - 1);
    line.number = ++lineNumber_;
    return true;
  }
  void goTo(std::uint64_t positionBytes, std::uint64_t linesBefore) override {
    at_ = filled_ = 0;
    bytes_->goTo(positionBytes);
    positionBytes_ = positionBytes;
    lineNumber_ = linesBefore;
  }
  [[nodiscard]] std::uint64_t positionBytes() const override { return positionBytes_; }
  [[nodiscard]] std::uint64_t sizeBytes() const override { return bytes_->sizeBytes(); }

 private:
  // False at the end of the file.
  bool fill() {
    if (at_ < filled_) return true;
    at_ = filled_ = 0;
    filled_ = bytes_->read(block_);
    return filled_ != 0;
  }

  // Moves bytes up to and with the next line feed; answers how many of them belong to the line.
  std::size_t takeFromBlock(TextLine& line) {
    const char* begin = block_.data() + at_;
    const void* feed = std::memchr(begin, '\n', filled_ - at_);
    line.ended = feed != nullptr;
    const std::size_t length =
        line.ended ? static_cast<std::size_t>(static_cast<const char*>(feed) - begin) : filled_ - at_;
    line.text.append(begin, std::min(length, keptBytes_ - line.text.size()));
    const std::size_t consumed = length + (line.ended ? 1 : 0);
    at_ += consumed;
    positionBytes_ += consumed;
    return length;
  }

  std::unique_ptr<ByteReader> bytes_;
  std::size_t keptBytes_;
  std::array<char, 65536> block_{};
  std::size_t at_ = 0;
  std::size_t filled_ = 0;
  std::uint64_t positionBytes_ = 0;
  std::uint64_t lineNumber_ = 0;
};

[[noreturn]] void raiseFor(const std::error_code& error) {
  if (error == std::errc::permission_denied) raisePermissionDenied();
  if (error == std::errc::no_such_file_or_directory || error == std::errc::not_a_directory)
    raiseFileNotFound();
  raisePathFileAccessError();
}

// A file that can be gone to and fro in, or whatever else can be read.
enum class Wanted { File, Readable };

std::unique_ptr<FileBytes> openFile(const std::string& path, Wanted wanted) {
  const fs::path native = pathFromUtf8(path);
  std::error_code error;
  const fs::file_status status = fs::status(native, error);
  if (status.type() == fs::file_type::not_found) raiseFileNotFound();
  if (error) raiseFor(error);
  if (fs::is_directory(status) || (wanted == Wanted::File && !fs::is_regular_file(status)))
    raisePathFileAccessError();
  errno = 0;
  std::ifstream file(native, std::ios::binary);
  if (!file) raiseFor(std::error_code(errno, std::generic_category()));
  const std::uintmax_t size = fs::file_size(native, error);
  return std::make_unique<FileBytes>(std::move(file), error ? 0 : size);
}

class SystemTextFiles : public TextFiles {
 public:
  [[nodiscard]] std::unique_ptr<TextReader> open(const std::string& path, std::size_t maxLineBytes) override {
    return linesOf(openFile(path, Wanted::Readable), maxLineBytes);
  }
  [[nodiscard]] std::unique_ptr<ByteReader> openBytes(const std::string& path) override {
    return openFile(path, Wanted::File);
  }
};

}  // namespace

std::unique_ptr<TextReader> linesOf(std::unique_ptr<ByteReader> bytes, std::size_t maxLineBytes) {
  return std::make_unique<LineReader>(std::move(bytes), maxLineBytes);
}

TextFiles& systemTextFiles() {
  static SystemTextFiles files;
  return files;
}

}  // namespace frontpanels

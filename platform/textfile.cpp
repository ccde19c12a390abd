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

// Holds one block of the file and one line cut to its bound, however long the file or its lines are.
class FileTextReader : public TextReader {
 public:
  FileTextReader(std::ifstream file, std::uint64_t sizeBytes, std::size_t maxLineBytes)
      : file_(std::move(file)),
        sizeBytes_(sizeBytes),
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
  [[nodiscard]] std::uint64_t positionBytes() const override { return positionBytes_; }
  [[nodiscard]] std::uint64_t sizeBytes() const override { return sizeBytes_; }

 private:
  // False at the end of the file.
  bool fill() {
    if (at_ < filled_) return true;
    if (file_.eof()) return false;
    file_.read(block_.data(), static_cast<std::streamsize>(block_.size()));
    if (file_.bad() || (file_.fail() && !file_.eof())) raiseDeviceIoError();
    at_ = 0;
    filled_ = static_cast<std::size_t>(file_.gcount());
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

  std::ifstream file_;
  std::uint64_t sizeBytes_;
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

class SystemTextFiles : public TextFiles {
 public:
  [[nodiscard]] std::unique_ptr<TextReader> open(const std::string& path, std::size_t maxLineBytes) override {
    const fs::path native = pathFromUtf8(path);
    std::error_code error;
    const fs::file_status status = fs::status(native, error);
    if (status.type() == fs::file_type::not_found) raiseFileNotFound();
    if (error) raiseFor(error);
    if (fs::is_directory(status)) raisePathFileAccessError();
    errno = 0;
    std::ifstream file(native, std::ios::binary);
    if (!file) raiseFor(std::error_code(errno, std::generic_category()));
    const std::uintmax_t size = fs::file_size(native, error);
    return std::make_unique<FileTextReader>(std::move(file), error ? 0 : size, maxLineBytes);
  }
};

}  // namespace

TextFiles& systemTextFiles() {
  static SystemTextFiles files;
  return files;
}

}  // namespace frontpanels

#include "sources/capture_writer.h"

#include <array>
#include <cerrno>
#include <filesystem>
#include <memory>
#include <string_view>
#include <system_error>

#include "platform/file_path.h"
#include "platform/textfile.h"
#include "sources/capture_blocks.h"
#include "sources/capture_format.h"
#include "sources/named_files.h"

namespace frontpanels {
namespace {

namespace fs = std::filesystem;

constexpr int kInvalidProcedureCall = 5;
constexpr int kPathFileAccessError = 75;

// Where the whole blocks of a capture end, from its headers alone; 0 when there is not even a whole header of
// the file.
std::uint64_t endOfWholeBlocks(const std::string& path) {
  std::unique_ptr<ByteReader> bytes = systemTextFiles().openBytes(path);
  std::array<char, kCaptureHeaderBytes> head{};
  const std::size_t size = bytes->read(head);
  const std::vector<char> wanted = captureHeader();
  const std::string_view expected(wanted.data(), wanted.size());
  if (!expected.starts_with(std::string_view(head.data(), size)))
    throw RuntimeError(kInvalidFileFormat, "not a capture that can be continued");
  if (size < head.size()) return 0;
  CaptureBlocks blocks(std::move(bytes), kCaptureHeaderBytes);
  for (CaptureBlock block; blocks.next(block);) {
  }
  return blocks.positionBytes();
}

}  // namespace

CaptureWriter::CaptureWriter(const std::string& pathUtf8)
    : path_(pathUtf8), native_(namingFile(path_, [this] { return pathFromUtf8(path_); })) {
  std::error_code ignored;
  const bool isNew = fs::status(native_, ignored).type() == fs::file_type::not_found;
  if (!isNew) wholeBytes_ = namingFile(path_, [this] { return endOfWholeBlocks(path_); });
  open(isNew ? std::ios::trunc : std::ios::in);
  takeBackWhatIsCut();
  if (wholeBytes_ != 0) return;
  try {
    write(captureHeader());
  } catch (const RuntimeError&) {
    if (isNew) fs::remove(native_, ignored);
    throw;
  }
}

void CaptureWriter::append(const Frame& frame) {
  if (!encodeFrame(frame, block_))
    throw RuntimeError(kInvalidProcedureCall,
                       path_ + ": cannot hold a frame of this length or with frequencies like these");
  write(block_);
  ++frames_;
}

// Without a buffer: a block goes to the system in one piece.
void CaptureWriter::open(std::ios::openmode keep) {
  file_.clear();
  file_.rdbuf()->pubsetbuf(nullptr, 0);
  errno = 0;
  file_.open(native_, std::ios::out | std::ios::binary | keep);
  if (!file_) raiseNotWritten(errno);
}

void CaptureWriter::write(const std::vector<char>& bytes) {
  if (!file_.is_open()) open(std::ios::in);
  std::error_code ignored;
  errno = ENOENT;  // not every system keeps an open file from being removed
  if (fs::exists(native_, ignored)) {
    errno = 0;
    file_.seekp(static_cast<std::streamoff>(wholeBytes_));
    file_.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    file_.flush();
    if (file_) {
      wholeBytes_ += bytes.size();
      return;
    }
  }
  const int reason = errno;
  file_.close();
  takeBackWhatIsCut();
  raiseNotWritten(reason);
}

void CaptureWriter::takeBackWhatIsCut() const noexcept {
  std::error_code error;
  const std::uintmax_t size = fs::file_size(native_, error);
  if (!error && size > wholeBytes_) fs::resize_file(native_, wholeBytes_, error);
}

void CaptureWriter::raiseNotWritten(int reason) const {
  throw RuntimeError(kPathFileAccessError,
                     path_ + ": cannot be written: " + std::generic_category().message(reason));
}

}  // namespace frontpanels

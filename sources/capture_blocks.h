// Walks the blocks of a capture from header to header, over whatever is damaged between them.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>
#include <vector>

#include "platform/textfile.h"
#include "sources/capture_format.h"

namespace frontpanels {

struct CaptureBlock {
  std::uint64_t atBytes = 0;  // of its header, from the file's begin
  BlockHeader header;
};

class CaptureBlocks {
 public:
  // The first block is looked for at `fromBytes`.
  CaptureBlocks(std::unique_ptr<ByteReader> bytes, std::uint64_t fromBytes);

  // The next block that lies whole in the file; false when there is none. Raises "Device I/O error".
  bool next(CaptureBlock& block);
  // The payload of the block found last. False when the file has become shorter meanwhile.
  [[nodiscard]] bool readPayload(std::vector<char>& payload);

  // What `next` has passed over before it found a block or the end, because it is no block.
  [[nodiscard]] std::uint64_t passedOverAtBytes() const noexcept { return passedOverAtBytes_; }
  [[nodiscard]] std::uint64_t passedOverBytes() const noexcept { return passedOverBytes_; }

  // Where the next block is looked for. At the end: where the whole blocks end, as far as what follows is
  // the beginning of one more.
  [[nodiscard]] std::uint64_t positionBytes() const noexcept { return nextAtBytes_; }
  // At the end: whether the file breaks off within a block.
  [[nodiscard]] bool isCut() const noexcept { return isCut_; }

 private:
  [[nodiscard]] bool stopAt(std::uint64_t atBytes, bool isCut) noexcept;
  [[nodiscard]] bool findMarker(std::uint64_t& atBytes);
  void goTo(std::uint64_t atBytes);
  [[nodiscard]] bool fill();
  [[nodiscard]] std::size_t read(std::span<char> bytes);

  std::unique_ptr<ByteReader> bytes_;
  std::uint64_t sizeBytes_;
  std::uint64_t nextAtBytes_;
  std::uint64_t passedOverAtBytes_ = 0;
  std::uint64_t passedOverBytes_ = 0;
  std::uint32_t payloadBytes_ = 0;
  bool isCut_ = false;

  std::array<char, 65536> buffer_{};
  std::uint64_t bufferAtBytes_ = 0;
  std::size_t at_ = 0;  // in the buffer
  std::size_t filled_ = 0;
};

}  // namespace frontpanels

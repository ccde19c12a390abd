#include "sources/capture_blocks.h"

#include <algorithm>
#include <cstring>
#include <utility>

namespace frontpanels {
namespace {

// The marker, or as much of it as there are bytes.
bool beginsLikeABlock(std::span<const char> bytes) {
  const std::string_view text(bytes.data(), std::min(bytes.size(), kBlockMarker.size()));
  return kBlockMarker.starts_with(text);
}

}  // namespace

CaptureBlocks::CaptureBlocks(std::unique_ptr<ByteReader> bytes, std::uint64_t fromBytes)
    : bytes_(std::move(bytes)), sizeBytes_(bytes_->sizeBytes()), nextAtBytes_(fromBytes) {
  bytes_->goTo(fromBytes);
  bufferAtBytes_ = fromBytes;
}

bool CaptureBlocks::next(CaptureBlock& block) {
  passedOverAtBytes_ = nextAtBytes_;
  passedOverBytes_ = 0;
  std::uint64_t at = nextAtBytes_;
  do {
    goTo(at);
    std::array<char, kBlockHeaderBytes> bytes{};
    const std::size_t size = read(bytes);
    if (size == 0) return stopAt(at, false);
    if (size < bytes.size() && beginsLikeABlock({bytes.data(), size})) return stopAt(at, true);
    if (const auto header = parseBlockHeader(bytes)) {
      if (header->payloadBytes > sizeBytes_ - std::min(sizeBytes_, at + kBlockHeaderBytes))
        return stopAt(at, true);
      block = {at, *header};
      payloadBytes_ = header->payloadBytes;
      passedOverBytes_ = at - nextAtBytes_;
      nextAtBytes_ = at + kBlockHeaderBytes + payloadBytes_;
      return true;
    }
    ++at;
  } while (findMarker(at));
  return stopAt(at, false);
}

bool CaptureBlocks::stopAt(std::uint64_t atBytes, bool isCut) noexcept {
  passedOverBytes_ = atBytes - nextAtBytes_;
  nextAtBytes_ = atBytes;
  isCut_ = isCut;
  return false;
}

// From `atBytes` on, which is then the file's end when there is none.
bool CaptureBlocks::findMarker(std::uint64_t& atBytes) {
  goTo(atBytes);
  std::size_t matched = 0;
  while (matched < kBlockMarker.size()) {
    if (at_ == filled_ && !fill()) {
      atBytes = bufferAtBytes_ + at_;
      return false;
    }
    const char byte = buffer_[at_++];
    // No byte comes twice in the marker, so a match that fails can only begin anew with this byte.
    matched = byte == kBlockMarker[matched] ? matched + 1 : (byte == kBlockMarker[0] ? 1 : 0);
  }
  atBytes = bufferAtBytes_ + at_ - kBlockMarker.size();
  return true;
}

bool CaptureBlocks::readPayload(std::vector<char>& payload) {
  payload.resize(payloadBytes_);
  return read(payload) == payload.size();
}

void CaptureBlocks::goTo(std::uint64_t atBytes) {
  if (atBytes >= bufferAtBytes_ && atBytes <= bufferAtBytes_ + filled_) {
    at_ = static_cast<std::size_t>(atBytes - bufferAtBytes_);
    return;
  }
  bytes_->goTo(atBytes);
  bufferAtBytes_ = atBytes;
  at_ = filled_ = 0;
}

// False at the end of the file.
bool CaptureBlocks::fill() {
  bufferAtBytes_ += filled_;
  at_ = filled_ = 0;
  filled_ = bytes_->read(buffer_);
  return filled_ != 0;
}

std::size_t CaptureBlocks::read(std::span<char> bytes) {
  std::size_t done = 0;
  while (done < bytes.size() && (at_ < filled_ || fill())) {
    const std::size_t count = std::min(bytes.size() - done, filled_ - at_);
    std::memcpy(bytes.data() + done, buffer_.data() + at_, count);
    at_ += count;
    done += count;
  }
  return done;
}

}  // namespace frontpanels

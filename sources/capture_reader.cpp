#include "sources/capture_reader.h"

#include <algorithm>
#include <array>
#include <utility>

#include "platform/runtime_error.h"
#include "sources/named_files.h"

namespace frontpanels {

bool CaptureReader::recognises(std::span<const char> head) {
  const std::string_view text(head.data(), std::min(head.size(), kCaptureMagic.size()));
  return !text.empty() && kCaptureMagic.starts_with(text);
}

CaptureReader::CaptureReader(TextFiles& files, std::string path) : files_(files), path_(std::move(path)) {
  std::array<char, kCaptureHeaderBytes> head{};
  const std::size_t size = namingFile(path_, [&] { return files_.openBytes(path_)->read(head); });
  if (size == 0) refuseFile(path_, "the file is empty");
  if (!recognises({head.data(), size})) refuseFile(path_, "not a capture");
  cutShort_ = size < head.size();
  if (!cutShort_) checkHeader(head);
  goTo({kCaptureHeaderBytes, 0});
}

// A damaged header costs nothing: each block has a check of its own.
void CaptureReader::checkHeader(std::span<const char> head) {
  const CaptureHeader header = parseCaptureHeader(head);
  if (!header.intact) {
    noteDamage(0, "the header of the file is damaged");
  } else if (header.version != kCaptureVersion) {
    refuseFile(path_, "a capture of version " + std::to_string(header.version) +
                          "; this program reads version " + std::to_string(kCaptureVersion));
  }
}

void CaptureReader::goTo(const FramePlace& place) {
  auto bytes = namingFile(path_, [this] { return files_.openBytes(path_); });
  sizeBytes_ = bytes->sizeBytes();
  blocks_ = std::make_unique<CaptureBlocks>(std::move(bytes), place.bytes);
  readFailed_ = false;
}

// A file that cannot be read further ends here; what came before is kept.
bool CaptureReader::next(Frame& frame) {
  if (readFailed_) return false;
  const std::uint64_t atBytes = blocks_->positionBytes();
  try {
    return nextFrame(frame);
  } catch (const RuntimeError& error) {
    readFailed_ = true;
    cutShort_ = true;
    keepProblem(atBytes, "the file cannot be read further: " + error.description());
    return false;
  }
}

bool CaptureReader::nextFrame(Frame& frame) {
  while (nextBlock()) {
    if (!blocks_->readPayload(payload_)) {
      cutShort_ = true;
      return false;
    }
    const char* const problem = decode(frame);
    if (problem == nullptr) {
      ++frames_;
      return true;
    }
    noteDamage(block_.atBytes, problem);
  }
  return false;
}

bool CaptureReader::nextBlock() {
  const bool found = blocks_->next(block_);
  if (blocks_->passedOverBytes() != 0)
    noteDamage(blocks_->passedOverAtBytes(),
               std::to_string(blocks_->passedOverBytes()) + " bytes are no block");
  if (!found) cutShort_ = cutShort_ || blocks_->isCut();
  return found;
}

// What is wrong with the block; null when nothing is.
const char* CaptureReader::decode(Frame& frame) const {
  if (blockCheck(block_.header.kind, payload_) != block_.header.check) return "the check of the block fails";
  if (block_.header.kind != kFrameBlock) return "a block of an unknown kind";
  return decodeFrame(payload_, frame) ? nullptr : "the block holds no frame";
}

void CaptureReader::noteDamage(std::uint64_t atBytes, const std::string& text) {
  ++damages_;
  keepProblem(atBytes, text);
}

void CaptureReader::keepProblem(std::uint64_t atBytes, const std::string& text) {
  if (problems_.size() < kKeptProblems)
    problems_.push_back("\n  byte " + std::to_string(atBytes) + ": " + text);
}

std::string CaptureReader::problemReport() const {
  if (damages_ == 0 && !cutShort_) return {};
  std::string report = path_ + ":";
  if (damages_ != 0)
    report += " damaged in " + std::to_string(damages_) + (damages_ == 1 ? " place" : " places");
  if (damages_ != 0 && cutShort_) report += ",";
  if (cutShort_) report += " cut short after frame " + std::to_string(frames_);
  for (const std::string& problem : problems_) report += problem;
  if (damages_ > problems_.size()) report += "\n  ...";
  return report;
}

}  // namespace frontpanels

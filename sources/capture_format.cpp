#include "sources/capture_format.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cmath>
#include <cstring>
#include <string>

#include "sources/crc32c.h"
#include "sources/sweep_row.h"

namespace frontpanels {
namespace {

enum Part : std::uint32_t {
  kSweep = 1,
  kPilots = 2,  // measured, whichever of the following there are
  kAllPilots = 4,
  kZoomedPilots = 8,
  kTopN = 16,
  kUserList = 32,
  kCarrier = 64,
  kAllParts = 127
};

constexpr double kMaxFrequencyHz = 1e13;  // either way

// Whether its bins have frequencies.
bool isPlaced(const Sweep& sweep) {
  const auto isFrequency = [](double hz) { return std::abs(hz) <= kMaxFrequencyHz; };
  return isFrequency(sweep.startHz) && isFrequency(sweep.stepHz) && sweep.levelsDb.size() <= kMaxSweepBins &&
         (sweep.levelsDb.empty() || sweep.stepHz > 0);
}

template <class T>
auto toLittleEndian(T value) {
  auto bytes = std::bit_cast<std::array<char, sizeof(T)>>(value);
  if constexpr (std::endian::native != std::endian::little) std::reverse(bytes.begin(), bytes.end());
  return bytes;
}

class PayloadWriter {
 public:
  explicit PayloadWriter(std::vector<char>& bytes) : bytes_(bytes) {}

  template <class T>
  void number(T value) {
    for (const char byte : toLittleEndian(value)) bytes_.push_back(byte);
  }
  template <class T>
  void count(const T& values) {
    number(static_cast<std::uint32_t>(values.size()));
  }
  void text(std::string_view value) {
    count(value);
    bytes_.insert(bytes_.end(), value.begin(), value.end());
  }
  void singles(const std::vector<float>& values) {
    count(values);
    if constexpr (std::endian::native == std::endian::little) {
      const std::size_t at = bytes_.size();
      bytes_.resize(at + values.size() * sizeof(float));
      if (!values.empty()) std::memcpy(bytes_.data() + at, values.data(), values.size() * sizeof(float));
    } else {
      for (const float value : values) number(value);
    }
  }

 private:
  std::vector<char>& bytes_;
};

// Nothing is asked for that the payload does not hold: after the first wrong field all others are zero or
// empty.
class PayloadReader {
 public:
  explicit PayloadReader(std::span<const char> bytes) : rest_(bytes) {}

  [[nodiscard]] bool isWhole() const { return sound_ && rest_.empty(); }

  template <class T>
  void number(T& value) {
    std::array<char, sizeof(T)> raw{};
    const std::span<const char> taken = take(1, sizeof(T));
    std::copy(taken.begin(), taken.end(), raw.begin());
    if constexpr (std::endian::native != std::endian::little) std::reverse(raw.begin(), raw.end());
    value = std::bit_cast<T>(raw);
  }
  [[nodiscard]] std::uint32_t number() {
    std::uint32_t value = 0;
    number(value);
    return value;
  }
  void text(std::string& value) {
    const std::span<const char> taken = take(number(), 1);
    value.assign(taken.begin(), taken.end());
  }
  void singles(std::vector<float>& values) {
    const std::span<const char> taken = take(number(), sizeof(float));
    values.resize(taken.size() / sizeof(float));
    if (!values.empty()) std::memcpy(values.data(), taken.data(), taken.size());
    if constexpr (std::endian::native != std::endian::little)
      for (float& value : values) value = std::bit_cast<float>(toLittleEndian(value));
  }
  // Whether so many things of so many bytes can follow.
  [[nodiscard]] bool holds(std::uint32_t count, std::size_t bytesEach) {
    sound_ = sound_ && count <= rest_.size() / bytesEach;
    return sound_;
  }

 private:
  std::span<const char> take(std::uint32_t count, std::size_t bytesEach) {
    if (!holds(count, bytesEach)) return {};
    const std::span<const char> taken = rest_.first(count * bytesEach);
    rest_ = rest_.subspan(taken.size());
    return taken;
  }

  std::span<const char> rest_;
  bool sound_ = true;
};

constexpr float PilotRecord::*kPilotFields[] = {
    &PilotRecord::pnOffset,        &PilotRecord::peakEcIoDb,       &PilotRecord::delayChips,
    &PilotRecord::aggregateEcIoDb, &PilotRecord::delaySpreadChips, &PilotRecord::aggregateMinusPeakDb};

void write(PayloadWriter& to, const Sweep& sweep) {
  to.number(sweep.startHz);
  to.number(sweep.stepHz);
  to.number(sweep.rows);
  to.singles(sweep.levelsDb);
}
void write(PayloadWriter& to, const PilotLevels& levels) {
  to.number(levels.ioDbm);
  to.singles(levels.ecIoDb);
}
void write(PayloadWriter& to, const PilotBars& bars) {
  to.number(bars.ioDbm);
  to.count(bars.pilots);
  for (const PilotRecord& pilot : bars.pilots)
    for (const auto field : kPilotFields) to.number(pilot.*field);
}
void write(PayloadWriter& to, const CarrierState& carrier) {
  to.number(carrier.frequencyErrorHz);
  to.number(carrier.frequencyState);
  to.number(carrier.onePps);
}

void read(PayloadReader& from, Sweep& sweep) {
  from.number(sweep.startHz);
  from.number(sweep.stepHz);
  from.number(sweep.rows);
  from.singles(sweep.levelsDb);
}
void read(PayloadReader& from, PilotLevels& levels) {
  from.number(levels.ioDbm);
  from.singles(levels.ecIoDb);
}
void read(PayloadReader& from, PilotBars& bars) {
  from.number(bars.ioDbm);
  const std::uint32_t count = from.number();
  bars.pilots.resize(from.holds(count, std::size(kPilotFields) * sizeof(float)) ? count : 0);
  for (PilotRecord& pilot : bars.pilots)
    for (const auto field : kPilotFields) from.number(pilot.*field);
}
void read(PayloadReader& from, CarrierState& carrier) {
  from.number(carrier.frequencyErrorHz);
  from.number(carrier.frequencyState);
  from.number(carrier.onePps);
}

template <class T>
void readInto(std::optional<T>& target, bool isThere, PayloadReader& from) {
  if (!isThere) return target.reset();
  if (!target) target.emplace();
  read(from, *target);
}

std::uint32_t partsOf(const Frame& frame) {
  std::uint32_t parts = 0;
  const auto flag = [&parts](const auto& part, Part bit) {
    if (part) parts |= bit;
  };
  flag(frame.sweep, kSweep);
  flag(frame.pilots, kPilots);
  if (!frame.pilots) return parts;
  const PilotFrame& pilots = *frame.pilots;
  flag(pilots.allPilots, kAllPilots);
  flag(pilots.zoomedPilots, kZoomedPilots);
  flag(pilots.topN, kTopN);
  flag(pilots.userList, kUserList);
  flag(pilots.carrier, kCarrier);
  return parts;
}

void writePayload(const Frame& frame, PayloadWriter& to) {
  const auto part = [&to](const auto& value) {
    if (value) write(to, *value);
  };
  to.number(partsOf(frame));
  to.text(frame.time);
  part(frame.sweep);
  if (!frame.pilots) return;
  part(frame.pilots->allPilots);
  part(frame.pilots->zoomedPilots);
  part(frame.pilots->topN);
  part(frame.pilots->userList);
  part(frame.pilots->carrier);
}

// An upper bound, worked out before memory is taken.
std::uint64_t payloadBound(const Frame& frame) {
  constexpr std::uint64_t kFixedBytes = 256;
  std::uint64_t bytes = kFixedBytes + frame.time.size();
  if (frame.sweep) bytes += frame.sweep->levelsDb.size() * sizeof(float);
  if (!frame.pilots) return bytes;
  for (const auto& levels : {&frame.pilots->allPilots, &frame.pilots->zoomedPilots})
    if (*levels) bytes += (*levels)->ecIoDb.size() * sizeof(float);
  for (const auto& bars : {&frame.pilots->topN, &frame.pilots->userList})
    if (*bars) bytes += (*bars)->pilots.size() * sizeof(PilotRecord);
  return bytes;
}

std::uint32_t numberAt(std::span<const char> bytes, std::size_t at) {
  return PayloadReader(bytes.subspan(at)).number();
}

constexpr std::size_t kVersionAt = 8;
constexpr std::size_t kHeaderCheckAt = 12;
constexpr std::size_t kKindAt = 4;
constexpr std::size_t kLengthAt = 8;
constexpr std::size_t kBlockCheckAt = 12;
constexpr std::size_t kBlockHeaderCheckAt = 16;

}  // namespace

std::vector<char> captureHeader() {
  std::vector<char> bytes(kCaptureMagic.begin(), kCaptureMagic.end());
  PayloadWriter to(bytes);
  to.number(kCaptureVersion);
  to.number(crc32c(bytes));
  return bytes;
}

CaptureHeader parseCaptureHeader(std::span<const char> bytes) {
  return {numberAt(bytes, kVersionAt),
          numberAt(bytes, kHeaderCheckAt) == crc32c(bytes.first(kHeaderCheckAt))};
}

std::optional<BlockHeader> parseBlockHeader(std::span<const char> bytes) {
  if (!std::string_view(bytes.data(), bytes.size()).starts_with(kBlockMarker)) return std::nullopt;
  if (numberAt(bytes, kBlockHeaderCheckAt) != crc32c(bytes.first(kBlockHeaderCheckAt))) return std::nullopt;
  const BlockHeader header{numberAt(bytes, kKindAt), numberAt(bytes, kLengthAt),
                           numberAt(bytes, kBlockCheckAt)};
  if (header.payloadBytes > kMaxPayloadBytes) return std::nullopt;
  return header;
}

std::uint32_t blockCheck(std::uint32_t kind, std::span<const char> payload) {
  return crc32c(payload, crc32c(toLittleEndian(kind)));
}

bool encodeFrame(const Frame& frame, std::vector<char>& block) {
  if (payloadBound(frame) > kMaxPayloadBytes || (frame.sweep && !isPlaced(*frame.sweep))) return false;
  block.assign(kBlockHeaderBytes, 0);
  PayloadWriter to(block);
  writePayload(frame, to);
  const std::span<const char> payload = std::span<const char>(block).subspan(kBlockHeaderBytes);
  std::vector<char> header(kBlockMarker.begin(), kBlockMarker.end());
  PayloadWriter head(header);
  head.number(kFrameBlock);
  head.number(static_cast<std::uint32_t>(payload.size()));
  head.number(blockCheck(kFrameBlock, payload));
  head.number(crc32c(header));
  std::copy(header.begin(), header.end(), block.begin());
  return true;
}

bool decodeFrame(std::span<const char> payload, Frame& frame) {
  PayloadReader from(payload);
  const std::uint32_t parts = from.number();
  if ((parts & ~std::uint32_t{kAllParts}) != 0) return false;
  if ((parts & kPilots) == 0 && (parts & ~std::uint32_t{kSweep}) != 0) return false;
  const auto there = [parts](Part part) { return (parts & part) != 0; };
  from.text(frame.time);
  readInto(frame.sweep, there(kSweep), from);
  if (there(kPilots)) {
    if (!frame.pilots) frame.pilots.emplace();
    readInto(frame.pilots->allPilots, there(kAllPilots), from);
    readInto(frame.pilots->zoomedPilots, there(kZoomedPilots), from);
    readInto(frame.pilots->topN, there(kTopN), from);
    readInto(frame.pilots->userList, there(kUserList), from);
    readInto(frame.pilots->carrier, there(kCarrier), from);
  } else {
    frame.pilots.reset();
  }
  if (frame.sweep) frame.sweep->time = frame.time;
  return from.isWhole() && (!frame.sweep || isPlaced(*frame.sweep));
}

}  // namespace frontpanels

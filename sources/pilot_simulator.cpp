#include "sources/pilot_simulator.h"

#include <algorithm>
#include <cmath>

#include "sources/drive_simulator.h"
#include "sources/emitters.h"
#include "sources/portable_math.h"
#include "sources/random.h"
#include "sources/receiver.h"
#include "sources/spectrum_simulator.h"

namespace frontpanels {
namespace {

// Purposes of random numbers.
constexpr std::uint64_t kPathPurpose = 30;
constexpr std::uint64_t kErrorPurpose = 31;
constexpr std::uint64_t kErrorNoisePurpose = 32;

constexpr double kSpeedOfLightMPerS = 299792458;
constexpr double kRadiatedDbm = 55;                   // of a sector, with its antenna
constexpr double kPilotShare = 0.2;                   // of what a sector radiates
constexpr double kDelayDecay = 2;                     // chips in which paths lose 4.3 dB
constexpr double kDetected = 5.3 / kCorrelatedChips;  // Ec/Io; noise comes so far once in a million chips

float decibels(double ratio) { return static_cast<float>(toDecibels(ratio)); }

}  // namespace

PilotSimulator::PilotSimulator(std::uint64_t seed, const DriveMap& map)
    : seed_(seed), map_(map), profile_(seed) {
  for (const Emitter& emitter : emitters())
    if (emitter.modulation == Modulation::Cdma && emitter.origin == Origin::Network)
      carriersHz_.push_back(emitter.centerHz);
  for (std::size_t sector = 0; sector < kSectors; ++sector) {
    Random random(seed_, kPathPurpose, sector);
    const std::uint64_t count = 2 + random.bits() % 4;
    double delayChips = 0;
    double sum = 0;
    for (std::uint64_t i = 0; i < count; ++i) {
      Path path;
      path.delayChips = delayChips;
      path.wobbleChips = i == 0 ? 0 : 0.4 * random.uniform();
      path.share = portableExp(-delayChips / kDelayDecay);
      path.phase = random.uniform();
      for (std::size_t wave = 0; wave < kWaves; ++wave) {
        path.angles[wave] = (static_cast<double>(wave) + random.uniform()) / kWaves;
        path.phases[wave] = random.uniform();
      }
      sum += path.share;
      delayChips += 1.2 + 1.2 * random.exponential();
      paths_[sector].push_back(path);
    }
    for (Path& path : paths_[sector]) path.share /= sum;
  }
}

void PilotSimulator::tune(const PilotTuning& tuning, std::uint64_t next) {
  const PilotTuning defaults;
  const double before = tuning_.carrierHz;
  tuning_ = tuning;
  const auto fit = [](double& value, double otherwise, double least, double most) {
    value = std::clamp(std::isfinite(value) ? value : otherwise, least, most);
  };
  fit(tuning_.carrierHz, defaults.carrierHz, kLowestTunedHz, kHighestTunedHz);
  fit(tuning_.pnIncrement, defaults.pnIncrement, 1, kPnOffsets - 1);
  fit(tuning_.codeStart, defaults.codeStart, 0, lastChip(tuning_.codeFormat));
  fit(tuning_.codeSpan, defaults.codeSpan, 0, lastChip(tuning_.codeFormat) - tuning_.codeStart);
  if (tuning_.carrierHz != before) tunedAt_ = next;
}

// --- What arrives

PilotSimulator::Tuned PilotSimulator::nearestCarrier() const {
  Tuned tuned;
  double awayHz = kHighestTunedHz;
  for (const double carrierHz : carriersHz_)
    if (std::fabs(tuning_.carrierHz - carrierHz) < awayHz) {
      awayHz = std::fabs(tuning_.carrierHz - carrierHz);
      tuned.carrierHz = carrierHz;
    }
  tuned.overlap = std::max(0.0, 1 - awayHz / kCdmaWidthHz);
  const double turns = awayHz * kCorrelatedChips / kChipRateHz;  // of the carrier during the correlation
  const double loss = turns == 0 ? 1 : portableTurn(turns / 2).imag() / (turns * 3.14159265358979324);
  tuned.coherence = loss * loss;
  return tuned;
}

void PilotSimulator::receive(std::size_t sector, double drivenM, const Tuned& tuned) {
  constexpr double kWobbleM = 300;
  const double mw =
      tuned.overlap * fromDecibels(kRadiatedDbm + map_.gainDb(sector, drivenM, tuned.carrierHz));
  const double firstChips = map_.distanceM(sector, drivenM) / kSpeedOfLightMPerS * kChipRateHz;
  const double waves = drivenM * tuned.carrierHz / kSpeedOfLightMPerS;
  for (const Path& path : paths_[sector]) {
    std::complex<double> fading;
    for (std::size_t wave = 0; wave < kWaves; ++wave)
      fading += portableTurn(waves * portableTurn(path.angles[wave]).real() + path.phases[wave]);
    fading *= std::sqrt(mw * path.share / kWaves);
    const double wobble = path.wobbleChips * portableTurn(drivenM / kWobbleM + path.phase).imag();
    const double chips =
        map_.names()[sector].pnOffset * kChipsPerOffset + firstChips + path.delayChips + wobble;
    rays_.push_back({chips < kShortCodeChips ? chips : chips - kShortCodeChips, {}});
    ioMw_ += std::norm(fading);
    pilotsMw_ += kPilotShare * std::norm(fading);
    const std::complex<double> pilot = fading * std::sqrt(kPilotShare * tuned.coherence);
    rays_.back().amplitude = std::complex<float>(pilot);
  }
}

void PilotSimulator::receive(double timeS) {
  const Tuned tuned = nearestCarrier();
  ioMw_ = kThermalMwPerHz * fromDecibels(kNoiseFigureDb) * kChipRateHz;
  pilotsMw_ = 0;
  rays_.clear();
  if (tuned.overlap > 0)
    for (std::size_t sector = 0; sector < kSectors; ++sector)
      receive(sector, DriveMap::drivenM(timeS), tuned);
  const auto scale = static_cast<float>(1 / std::sqrt(ioMw_));
  heard_ = false;
  for (CodeRay& ray : rays_) {
    ray.amplitude *= scale;
    heard_ = heard_ || std::norm(ray.amplitude) > static_cast<float>(kDetected);
  }
}

// --- What is measured

void PilotSimulator::measure(std::uint64_t frame, double timeS, PilotFrame& pilots) {
  receive(timeS);
  profile_.begin(frame, rays_, (1 - pilotsMw_ / ioMw_) / kCorrelatedChips);
  peaks_.assign(kPnOffsets, std::nullopt);
  pilots = {};
  if (tuning_.allPilots) pilots.allPilots = allPilots();
  if (tuning_.zoomedPilots) pilots.zoomedPilots = zoomedPilots();
  if (tuning_.topN) pilots.topN = topN();
  if (tuning_.userList) pilots.userList = userList();
  pilots.carrier = carrier(frame, timeS);
}

const CodeProfile::Peak& PilotSimulator::peakOf(std::int32_t pn) {
  std::optional<CodeProfile::Peak>& peak = peaks_[static_cast<std::size_t>(pn)];
  if (!peak) peak = profile_.peak(pn * kChipsPerOffset, (pn + 1) * kChipsPerOffset);
  return *peak;
}

PilotLevels PilotSimulator::allPilots() {
  PilotLevels levels{decibels(ioMw_), {}};
  for (std::int32_t pn = 0; pn < kPnOffsets; ++pn)
    levels.ecIoDb.push_back(decibels(static_cast<double>(peakOf(pn).level)));
  return levels;
}

// A point wider than a path is the largest of what it covers.
PilotLevels PilotSimulator::zoomedPilots() {
  constexpr double kFine = 0.5;  // chips
  PilotLevels levels{decibels(ioMw_), {}};
  const double scale = static_cast<double>(kChipsPerOffset) / chipsOfOffset(tuning_.codeFormat);
  const std::size_t points = tuning_.codeSpan > 0 ? kDisplayCells : 1;
  const double pitch = tuning_.codeSpan * scale / static_cast<double>(std::max<std::size_t>(points - 1, 1));
  for (std::size_t point = 0; point < points; ++point) {
    const double at = tuning_.codeStart * scale + static_cast<double>(point) * pitch;
    float level = profile_.level(at);
    if (pitch > kFine) level = std::max(level, profile_.peak(at - pitch / 2, at + pitch / 2).level);
    levels.ecIoDb.push_back(decibels(static_cast<double>(level)));
  }
  return levels;
}

PilotBars PilotSimulator::topN() {
  const auto increment = static_cast<std::int32_t>(tuning_.pnIncrement);
  std::vector<std::pair<std::int32_t, CodeProfile::Peak>> found;
  for (std::int32_t pn = 0; pn < kPnOffsets; pn += increment)
    if (const CodeProfile::Peak peak = peakOf(pn); static_cast<double>(peak.level) > kDetected)
      found.emplace_back(pn, peak);
  std::stable_sort(found.begin(), found.end(),
                   [](const auto& a, const auto& b) { return a.second.level > b.second.level; });
  if (found.size() > kMostTopN) found.resize(kMostTopN);
  PilotBars bars{decibels(ioMw_), {}};
  for (const auto& [pn, peak] : found) bars.pilots.push_back(record(pn, peak));
  return bars;
}

PilotBars PilotSimulator::userList() {
  PilotBars bars{decibels(ioMw_), {}};
  for (const std::int32_t pn : tuning_.userPns)
    if (pn >= 0 && pn < kPnOffsets) bars.pilots.push_back(record(pn, peakOf(pn)));
  return bars;
}

// Paths count that stand out of the noise and are a chip away from a stronger one.
PilotRecord PilotSimulator::record(std::int32_t pn, const CodeProfile::Peak& peak) {
  std::vector<CodeProfile::Peak> paths;
  for (const CodeRay& ray : rays_)
    if (static_cast<std::int32_t>(ray.chips) / kChipsPerOffset == pn)
      if (const float level = profile_.level(ray.chips); static_cast<double>(level) > kDetected)
        paths.push_back({ray.chips, level});
  std::stable_sort(paths.begin(), paths.end(),
                   [](const auto& a, const auto& b) { return a.level > b.level; });
  std::vector<CodeProfile::Peak> counted{peak};
  for (const CodeProfile::Peak& path : paths)
    if (std::all_of(counted.begin(), counted.end(),
                    [&path](const auto& stronger) { return std::fabs(stronger.chips - path.chips) >= 1; }))
      counted.push_back(path);

  double sum = 0;
  double mean = 0;
  for (const CodeProfile::Peak& path : counted) {
    sum += static_cast<double>(path.level);
    mean += static_cast<double>(path.level) * (path.chips - peak.chips);
  }
  mean /= sum;
  double variance = 0;
  for (const CodeProfile::Peak& path : counted) {
    const double away = path.chips - peak.chips - mean;
    variance += static_cast<double>(path.level) * away * away / sum;
  }
  const double peakDb = toDecibels(static_cast<double>(peak.level));
  const double aggregateDb = toDecibels(std::min(sum, 1.0));
  return {static_cast<float>(pn),
          static_cast<float>(peakDb),
          static_cast<float>(peak.chips - pn * kChipsPerOffset),
          static_cast<float>(aggregateDb),
          static_cast<float>(std::sqrt(variance)),
          static_cast<float>(aggregateDb - peakDb)};
}

// The error after a retune goes in seconds; without its reference the receiver's clock runs away.
CarrierState PilotSimulator::carrier(std::uint64_t frame, double timeS) const {
  constexpr double kInitialHz = 700;
  constexpr double kSettlingS = 1.8;
  constexpr double kSearchS = 0.5;
  constexpr double kLockedHz = 10;
  constexpr double kDriftHzPerS = 9;
  constexpr double kNoiseHz = 1.2;
  constexpr double kSearchNoiseHz = 60;
  const double elapsedS = static_cast<double>(frame - (frame >= tunedAt_ ? tunedAt_ : 1)) * kDriveStepS;
  const auto carrierHz = static_cast<std::uint64_t>(tuning_.carrierHz);
  const double initialHz = kInitialHz * (2 * Random(seed_, kErrorPurpose, carrierHz).uniform() - 1);
  const double noise = Random(seed_, kErrorNoisePurpose, frame).normal();
  const DriveMap::Sky sky = DriveMap::sky(timeS);
  const double driftHz = kDriftHzPerS * sky.hiddenS * portableExp(-sky.sinceVisibleS / kSettlingS);
  const double onePps = sky.hidden ? 0 : 1;
  if (!heard_ || elapsedS < kSearchS) return {initialHz + driftHz + kSearchNoiseHz * noise, 0, onePps};
  const double errorHz = initialHz * portableExp(-(elapsedS - kSearchS) / kSettlingS) + driftHz;
  // The receiver counts tenths of a hertz.
  const double countedHz = std::nearbyint((errorHz + kNoiseHz * noise) * 10) / 10;
  return {countedHz, std::fabs(errorHz) > kLockedHz ? 1 : 2, onePps};
}

}  // namespace frontpanels

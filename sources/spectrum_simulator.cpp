#include "sources/spectrum_simulator.h"

#include <algorithm>
#include <cmath>

#include "sources/portable_math.h"
#include "sources/random.h"
#include "sources/receiver.h"

namespace frontpanels {
namespace {

// Purposes of random numbers.
constexpr std::uint64_t kCellPurpose = 10;
constexpr std::uint64_t kEmitterPurpose = 11;
constexpr std::uint64_t kSlotPurpose = 12;
constexpr std::uint64_t kMobilePurpose = 13;
constexpr std::uint64_t kBurstPurpose = 1000;  // and the emitter's number

constexpr double kSigmasOf3Db = 2.35482004503094938;  // of a Gaussian: 2 sqrt(2 ln 2)
constexpr double kNoiseSigmas = 2.50662827463100050;  // of its noise bandwidth: sqrt(2 pi)
constexpr double kReachSigmas = 7;                    // -106 dB
constexpr double kSliceSigmas = 0.6;                  // of a slice, so that slices make a smooth whole

constexpr double kLeastSpanHz = 1;
constexpr double kLeastRbwHz = 1;
constexpr double kMostRbwHz = 10e6;
constexpr std::int32_t kMostLooks = 1000;
constexpr std::int32_t kBurstsOneByOne = 64;

// Values of the averaging's parameter.
constexpr std::int16_t kLinearAverages = 0;
constexpr std::int16_t kExponentialAverages = 1;
constexpr std::int16_t kMaximumHold = 2;
constexpr std::int16_t kMinimumHold = 3;

double finiteOr(double value, double otherwise) { return std::isfinite(value) ? value : otherwise; }

}  // namespace

SpectrumSimulator::SpectrumSimulator(std::uint64_t seed, const DriveMap& map)
    : seed_(seed), map_(map), emitters_(emitters()) {
  const auto alike = [](const Emitter& a, const Emitter& b) {
    return a.modulation == b.modulation && a.widthHz == b.widthHz;
  };
  for (std::size_t i = 0; i < emitters_.size(); ++i) {
    if (i == 0 || !alike(emitters_[i], emitters_[i - 1]))
      shapes_.push_back(shapeOf(emitters_[i].modulation, emitters_[i].widthHz));
    emitterShapes_.push_back(shapes_.size() - 1);
  }
  tune({});
}

// --- Tuning

void SpectrumSimulator::tune(const SpectrumTuning& tuning) {
  const SpectrumTuning defaults;
  const double spanHz =
      std::clamp(finiteOr(tuning.spanHz, defaults.spanHz), kLeastSpanHz, kHighestTunedHz - kLowestTunedHz);
  const double centerHz = std::clamp(finiteOr(tuning.centerHz, defaults.centerHz),
                                     kLowestTunedHz + spanHz / 2, kHighestTunedHz - spanHz / 2);
  const std::size_t points = std::clamp<std::size_t>(tuning.points, 2, kDisplayCells);
  startHz_ = centerHz - spanHz / 2;
  stepHz_ = spanHz / static_cast<double>(points - 1);
  const double rbwHz = std::clamp(finiteOr(tuning.rbwHz, defaults.rbwHz), kLeastRbwHz, kMostRbwHz);
  filterHz_ = (tuning.narrowIf ? std::min(rbwHz, kNarrowIfHz) : rbwHz) / kSigmasOf3Db;
  steadyMw_.resize(points);
  noiseMw_.resize(points);

  const std::int32_t count = std::clamp(tuning.averageCount, 1, kMostLooks);
  averaging_ = tuning.averageLogPower ? Averaging::LogPower : Averaging::Power;
  looks_ = 1;
  if (tuning.averageType == kLinearAverages) looks_ = count;
  // Of as many sweeps in its time constant; settled.
  if (tuning.averageType == kExponentialAverages) looks_ = 2 * count - 1;
  if (tuning.averageType == kMaximumHold || tuning.averageType == kMinimumHold) {
    looks_ = count;
    averaging_ = tuning.averageType == kMaximumHold ? Averaging::Largest : Averaging::Smallest;
  }
  footprints_.clear();
  for (std::size_t i = 0; i < emitters_.size(); ++i) {
    Footprint footprint{i, 0, {}};
    place(footprint, emitters_[i].centerHz);
    if (!footprint.gains.empty() || moves(emitters_[i])) footprints_.push_back(std::move(footprint));
  }
}

// So far that it is to be seen.
bool SpectrumSimulator::moves(const Emitter& emitter) const noexcept {
  constexpr double kSeen = 0.05;
  return emitter.driftHz > kSeen * filterHz_;
}

// The filter passes by, and the cell keeps the largest of what it shows on its way: what is narrower than a
// cell is seen all the same.
void SpectrumSimulator::place(Footprint& footprint, double centerHz) const {
  const SpectrumShape& shape = shapes_[emitterShapes_[footprint.emitter]];
  const double reachHz =
      -shape.firstHz + stepHz_ / 2 + kReachSigmas * (filterHz_ + kSliceSigmas * shape.sliceHz);
  const auto cells = static_cast<double>(noiseMw_.size());
  const double first = std::max(std::ceil((centerHz - reachHz - startHz_) / stepHz_), 0.0);
  const double last = std::min(std::floor((centerHz + reachHz - startHz_) / stepHz_), cells - 1);
  footprint.gains.clear();
  if (!(first <= last)) return;
  footprint.firstCell = static_cast<std::size_t>(first);
  for (std::size_t cell = footprint.firstCell; cell <= static_cast<std::size_t>(last); ++cell) {
    const double awayHz = std::fabs(startHz_ + static_cast<double>(cell) * stepHz_ - centerHz);
    footprint.gains.push_back(gain(shape, std::max(awayHz - stepHz_ / 2, 0.0)));
  }
}

// Each slice is a Gaussian, and so is what the filter makes of it.
double SpectrumSimulator::gain(const SpectrumShape& shape, double offsetHz) const {
  const double sliceHz = kSliceSigmas * shape.sliceHz;
  const double variance = filterHz_ * filterHz_ + sliceHz * sliceHz;
  const double reachHz = kReachSigmas * std::sqrt(variance);
  double sum = 0;
  for (std::size_t slice = 0; slice < shape.shares.size(); ++slice) {
    const double awayHz = offsetHz - shape.firstHz - static_cast<double>(slice) * shape.sliceHz;
    if (std::fabs(awayHz) < reachHz)
      sum += shape.shares[slice] * portableExp(-awayHz * awayHz / (2 * variance));
  }
  return sum * filterHz_ / std::sqrt(variance);
}

// --- Emitters

bool SpectrumSimulator::isPresent(std::size_t emitter, double timeS) const {
  const Emitter& it = emitters_[emitter];
  if (it.slotS == 0) return true;
  const auto slot =
      static_cast<std::uint64_t>(timeS / it.slotS + Random(seed_, kSlotPurpose, emitter).uniform());
  return Random(seed_, kSlotPurpose, emitter, slot + 1).uniform() < it.share;
}

double SpectrumSimulator::powerMw(std::size_t emitter, double timeS) const {
  constexpr double kSpreadDb = 6;
  constexpr double kFadingDb = 2;
  constexpr double kFadingS = 37;
  constexpr double kMobileDb = 8;
  const Emitter& it = emitters_[emitter];
  const double drivenM = DriveMap::drivenM(timeS);
  Random random(seed_, kEmitterPurpose, emitter);
  const double spreadDb = kSpreadDb * (2 * random.uniform() - 1);
  const double phase = random.uniform();
  switch (it.origin) {
    case Origin::Receiver:
      return fromDecibels(it.dBm + spreadDb);
    case Origin::Land: {
      const double fadingDb = kFadingDb * portableTurn(timeS / kFadingS + phase).imag();
      return fromDecibels(it.dBm + spreadDb + fadingDb - DriveMap::roofDb(drivenM));
    }
    case Origin::Site:
      return fromDecibels(it.dBm + map_.gainDb(emitter % kSectors, drivenM, it.centerHz));
    case Origin::Network: {
      double sum = 0;
      for (std::size_t sector = 0; sector < kSectors; ++sector)
        sum += fromDecibels(it.dBm + map_.gainDb(sector, drivenM, it.centerHz));
      return sum;
    }
    case Origin::Mobile:
      break;
  }
  const auto slot = static_cast<std::uint64_t>(timeS / std::max(it.slotS, 1.0) + phase);
  return fromDecibels(it.dBm + kMobileDb * Random(seed_, kMobilePurpose, emitter, slot).normal());
}

// Each sweep passes a cell at another moment: the emitter transmits then, or it does not.
double SpectrumSimulator::onShare(std::size_t emitter, std::uint64_t frame, std::size_t cell) const {
  const double burst = emitters_[emitter].burst;
  if (burst >= 1) return 1;
  Random random(seed_, kBurstPurpose + emitter, frame, cell);
  const std::int32_t looks = std::min(looks_, kBurstsOneByOne);
  std::int32_t on = 0;
  for (std::int32_t look = 0; look < looks; ++look) on += random.uniform() < burst ? 1 : 0;
  if (averaging_ == Averaging::Largest) return on > 0 ? 1 : 0;
  if (averaging_ == Averaging::Smallest) return on == looks ? 1 : 0;
  return looks_ > looks ? burst : static_cast<double>(on) / looks;
}

void SpectrumSimulator::add(const Footprint& footprint, std::uint64_t frame, double timeS) {
  if (footprint.gains.empty() || !isPresent(footprint.emitter, timeS)) return;
  const double mw = powerMw(footprint.emitter, timeS);
  std::vector<double>& cells =
      emitters_[footprint.emitter].modulation == Modulation::Carrier ? steadyMw_ : noiseMw_;
  for (std::size_t i = 0; i < footprint.gains.size(); ++i) {
    const std::size_t cell = footprint.firstCell + i;
    cells[cell] += mw * footprint.gains[i] * onShare(footprint.emitter, frame, cell);
  }
}

// --- Sweeps

void SpectrumSimulator::measure(std::uint64_t frame, double timeS, Sweep& sweep) {
  constexpr double kDriftS = 23;
  const double floorMw = kThermalMwPerHz * fromDecibels(kNoiseFigureDb) * kNoiseSigmas * filterHz_;
  std::fill(steadyMw_.begin(), steadyMw_.end(), 0.0);
  std::fill(noiseMw_.begin(), noiseMw_.end(), floorMw);
  for (Footprint& footprint : footprints_) {
    const Emitter& emitter = emitters_[footprint.emitter];
    if (moves(emitter)) {
      const double phase = Random(seed_, kEmitterPurpose, footprint.emitter, 1).uniform();
      place(footprint, emitter.centerHz + emitter.driftHz * portableTurn(timeS / kDriftS + phase).imag());
    }
    add(footprint, frame, timeS);
  }
  sweep.startHz = startHz_;
  sweep.stepHz = stepHz_;
  sweep.levelsDb.resize(noiseMw_.size());
  for (std::size_t cell = 0; cell < noiseMw_.size(); ++cell) {
    Random random(seed_, kCellPurpose, frame, cell);
    sweep.levelsDb[cell] = static_cast<float>(
        toDecibels(measuredPower(random, steadyMw_[cell], noiseMw_[cell], averaging_, looks_)));
  }
}

}  // namespace frontpanels

#include "sources/drive_simulator.h"

#include <array>
#include <chrono>
#include <cstdio>

#include "sources/pilot_simulator.h"
#include "sources/spectrum_simulator.h"

namespace frontpanels {
namespace {

constexpr std::uint64_t kStepMs = 100;
static_assert(static_cast<double>(kStepMs) / 1000 == kDriveStepS);

// The first frame's moment. Dates come again after 400 years.
constexpr std::chrono::sys_days kFirstDay = std::chrono::year{2024} / std::chrono::May / 14;
constexpr std::uint64_t kFirstMs = 9U * 3600000;
constexpr std::uint64_t kDayMs = 24U * 3600000;
constexpr std::uint64_t kDaysOf400Years = 146097;

std::string timeText(std::uint64_t number) {
  const std::uint64_t steps = (number - 1) % (kDaysOf400Years * (kDayMs / kStepMs));
  const std::uint64_t ms = kFirstMs + steps * kStepMs;
  const std::chrono::year_month_day day = kFirstDay + std::chrono::days(ms / kDayMs);
  const auto part = [ms](std::uint64_t unitMs, std::uint64_t units) {
    return static_cast<unsigned>(ms / unitMs % units);
  };
  std::array<char, 32> text{};
  std::snprintf(text.data(), text.size(), "%04d-%02u-%02u %02u:%02u:%02u.%03u", static_cast<int>(day.year()),
                static_cast<unsigned>(day.month()), static_cast<unsigned>(day.day()), part(3600000, 24),
                part(60000, 60), part(1000, 60), part(1, 1000));
  return text.data();
}

}  // namespace

class DriveSimulator::Drive {
 public:
  explicit Drive(std::uint64_t seed) : map(seed), spectrum(seed, map), pilots(seed, map) {}

  DriveMap map;
  SpectrumSimulator spectrum;
  PilotSimulator pilots;
};

DriveSimulator::DriveSimulator(std::uint64_t seed)
    : drive_(std::make_unique<Drive>(seed)), name_("Simulated drive, seed " + std::to_string(seed)) {}
DriveSimulator::~DriveSimulator() = default;

void DriveSimulator::tune(const SpectrumTuning& tuning) { drive_->spectrum.tune(tuning); }
void DriveSimulator::tune(const PilotTuning& tuning) { drive_->pilots.tune(tuning, nextNumber_); }
std::span<const SiteName> DriveSimulator::siteNames() const noexcept { return drive_->map.names(); }

bool DriveSimulator::next(Frame& frame) {
  const double timeS = static_cast<double>(nextNumber_ - 1) * kDriveStepS;
  frame.number = nextNumber_;
  frame.time = timeText(nextNumber_);
  if (!frame.sweep) frame.sweep.emplace();
  frame.sweep->number = nextNumber_;
  frame.sweep->time = frame.time;
  frame.sweep->rows = 0;
  drive_->spectrum.measure(nextNumber_, timeS, *frame.sweep);
  if (!frame.pilots) frame.pilots.emplace();
  drive_->pilots.measure(nextNumber_, timeS, *frame.pilots);
  ++nextNumber_;
  return true;
}

void DriveSimulator::seek(std::uint64_t number) { nextNumber_ = number == 0 ? 1 : number; }

}  // namespace frontpanels

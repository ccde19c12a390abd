#include "spectrum/frequency_plan.h"

#include <algorithm>
#include <cmath>

namespace frontpanels {
namespace {

double withinLimits(double frequencyHz) noexcept {
  return std::clamp(frequencyHz, kLowestFrequencyHz, kHighestFrequencyHz);
}

struct FormatBand {
  double lowestHz;
  double highestHz;
  std::string_view format;
};

// Closed at both ends. Spans between two bands, 5000 to 9999 Hz among them, fall through on purpose.
constexpr FormatBand kFormatBands[] = {
    {0, 4, "0.##############"},  {5, 9, "0.#############"},   {10, 49, "0.############"},
    {50, 99, "0.###########"},   {100, 499, "0.##########"},  {500, 999, "0.#########"},
    {1000, 4999, "0.########"},  {10000, 49999, "0.#######"}, {50000, 99999, "0.######"},
    {100000, 499999, "0.#####"}, {500000, 999999, "0.####"},  {1000000, 4999999, "0.###"},
};
constexpr std::string_view kOtherwise = "0.##";

}  // namespace

void FrequencyPlan::setCenter(double centerHz) noexcept {
  if (!std::isfinite(centerHz)) return;
  centerHz_ = withinLimits(centerHz);
  placeEdges();
}

void FrequencyPlan::setSpan(double spanHz) noexcept {
  if (!std::isfinite(spanHz)) return;
  const double span = withinLimits(spanHz);
  if (centerHz_ + span * 0.5 > kHighestFrequencyHz) centerHz_ = kHighestFrequencyHz - span * 0.5;
  if (centerHz_ - span * 0.5 < kLowestFrequencyHz) centerHz_ = kLowestFrequencyHz + span * 0.5;
  spanHz_ = span;
  placeEdges();
}

void FrequencyPlan::placeEdges() noexcept {
  startHz_ = withinLimits(centerHz_ - spanHz_ * 0.5);
  stopHz_ = withinLimits(centerHz_ + spanHz_ * 0.5);
}

std::string_view axisFormatForSpan(double spanHz) noexcept {
  for (const FormatBand& band : kFormatBands)
    if (spanHz >= band.lowestHz && spanHz <= band.highestHz) return band.format;
  return kOtherwise;
}

}  // namespace frontpanels

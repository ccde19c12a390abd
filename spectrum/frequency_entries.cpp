#include "spectrum/frequency_entries.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "framework/support/numeric.h"

namespace frontpanels {
namespace {

constexpr double kHighestFrequencyHz = 6.0e9;
constexpr double kDefaultCenterHz = 1.0e9;
constexpr double kDefaultSpanHz = 10.0e6;
constexpr std::string_view kFrequencyFormat = "0.########";

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

// A tenth of the decade that is nearest to the span.
double stepForSpan(double spanHz) {
  const std::int16_t decade = toInt16(std::log10(spanHz));
  return std::pow(10.0, decade) * 0.1;
}

}  // namespace

FrequencyEntries::FrequencyEntries() {
  for (clsNumericEntry* const entry : {&center, &span, &start, &stop}) {
    entry->frequencySuffix();
    entry->formatString(kFrequencyFormat);
    entry->Arbitrary(true);
    entry->MINIMUM(0);
    entry->MAXIMUM(kHighestFrequencyHz);
  }
  center.autoChoose(true);  // the edges keep to the centre's band
  center.valueNoUpdate(kDefaultCenterHz);
  span.valueNoUpdate(kDefaultSpanHz);
  placeEdges();
  for (clsNumericEntry* const entry : {&center, &start, &stop}) entry->step(stepForSpan(kDefaultSpanHz));
}

void FrequencyEntries::followRange() noexcept {
  for (clsNumericEntry* const edge : {&start, &stop})
    if (edge->range() != center.range()) edge->CopyLimits(center);
}

void FrequencyEntries::placeEdges() noexcept {
  start.valueNoUpdate(axisStartHz());
  stop.valueNoUpdate(axisStopHz());
}

void FrequencyEntries::setCenter(double centerHz) noexcept {
  center.valueNoUpdateAutoChoose(centerHz);
  followRange();
  placeEdges();
}

void FrequencyEntries::fitCenter() noexcept {
  followRange();
  const double half = span.value() * 0.5;
  double centerHz = center.value();
  if (centerHz + half > stop.MAXIMUM()) centerHz = stop.MAXIMUM() - half;
  if (centerHz - half < start.MINIMUM()) centerHz = start.MINIMUM() + half;
  // A sweep wider than the band asks for a centre outside it, which must not choose another band.
  centerHz = std::min(std::max(centerHz, center.MINIMUM()), center.MAXIMUM());
  if (centerHz != center.value()) center.valueNoUpdate(centerHz);
  placeEdges();
}

void FrequencyEntries::setSpan(double spanHz) noexcept {
  span.valueNoUpdate(spanHz);
  fitCenter();
  followSpan();
}

// A span of 0 names no decade: the steps stay.
void FrequencyEntries::followSpan() noexcept {
  if (!(span.value() > 0)) return;
  const double stepHz = stepForSpan(span.value());
  start.step(stepHz);
  // Resolutions are counted in 32 bits.
  const bool rounds = start.MAXIMUM() / stepHz <= std::numeric_limits<std::int32_t>::max();
  start.resolution(rounds ? Variant(stepHz) : Variant());
  stop.step(stepHz);
  center.step(stepHz);
}

void FrequencyEntries::joinEdges(bool startChanged) noexcept {
  // The entry of the other edge may show it rounded.
  double lowHz = startChanged ? start.value() : std::max(axisStartHz(), start.MINIMUM());
  double highHz = startChanged ? std::min(axisStopHz(), stop.MAXIMUM()) : stop.value();
  if (lowHz > highHz) (startChanged ? highHz : lowHz) = startChanged ? lowHz : highHz;
  const double centerHz = (lowHz + highHz) / 2;
  const double spanHz = highHz - lowHz;
  center.valueNoUpdateAutoChoose(centerHz);
  span.valueNoUpdate(spanHz);
  // A limit of centre or span may stand against what the edges ask for.
  if (spanHz == 0 || center.value() != centerHz || span.value() != spanHz) {
    followRange();
    placeEdges();
  }
  followSpan();
}

void FrequencyEntries::setBand(std::int32_t range) noexcept {
  if (range == center.range() || !center.rangeDefined(range)) return;
  if (center.channelChoose()) {
    const std::string channel = center.formatter(center.value());
    center.range(range);
    center.text(channel);
  } else {
    const double offsetHz = center.value() - center.MINIMUM();
    center.range(range);
    center.valueNoUpdate(std::min(center.MINIMUM() + offsetHz, center.MAXIMUM()));
  }
  fitCenter();
}

bool FrequencyEntries::limits(const HostRecordSet& records) noexcept {
  if (!center.Limits(records)) return false;
  start.CopyLimits(center);
  stop.CopyLimits(center);
  return true;
}

bool FrequencyEntries::showChannels(const clsChannelInfo& channels, std::int16_t channelization) noexcept {
  if (!channels.selectChannelization(channelization, center)) return false;
  for (clsNumericEntry* const edge : {&start, &stop})
    if (!channels.selectChannelization(channelization, *edge)) return false;
  channels.selectChannelSpacing(channelization, span);
  for (clsNumericEntry* const entry : {&center, &span, &start, &stop}) entry->channelChoose(true);
  return true;
}

void FrequencyEntries::showFrequencies() noexcept {
  for (clsNumericEntry* const entry : {&center, &span, &start, &stop}) entry->channelChoose(false);
}

std::string_view axisFormatForSpan(double spanHz) noexcept {
  for (const FormatBand& band : kFormatBands)
    if (spanHz >= band.lowestHz && spanHz <= band.highestHz) return band.format;
  return kOtherwise;
}

}  // namespace frontpanels

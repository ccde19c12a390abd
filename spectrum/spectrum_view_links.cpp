// SpectrumView as one of many: links, context menu, report.
#include "framework/panel/report_html.h"
#include "framework/support/host_codes.h"
#include "spectrum/spectrum_view.h"

namespace frontpanels {
namespace {

struct ActionRow {
  std::int16_t operation;
  const char* button;
};
constexpr ActionRow kActions[] = {{kSingleSweepOperation, "SingleSweepButton"},
                                  {kContinuousSweepOperation, "ContinuousSweepButton"},
                                  {kStopSweepOperation, "StopSweepButton"}};

// Parameters that no numeric entry holds, with the controls that do.
struct ChoiceRow {
  std::int16_t parameterType;
  const char* controls[2];
};
constexpr ChoiceRow kChoices[] = {
    {FREQ_FILTER, {"NarrowbandOption", "WidebandOption"}},
    {kChannelizationParameter, {"ChannelizationCombo", nullptr}},
    {kAverageTypeParameter, {"AverageTypeCombo", "AverageTypeLabel"}},
    {kUnitsParameter, {"FrequencyOption", "ChannelOption"}},
    {kIntervalKindParameter, {"IntervalTimeOption", "IntervalDistanceOption"}},
    {PARM_AVERAGE_AS_LOG_POWER, {"LogPwrOption", "LinPowerOption"}},
};

constexpr const char* kLinkedByName[] = {"CenterFrequencyTextBox", "StartFrequencyTextBox",
                                         "SingleSweepButton", "StopSweepButton", "ContinuousSweepButton"};

}  // namespace

// --- Links

clsNumericEntry* SpectrumView::linkedEntry(std::int32_t parameterType) {
  switch (parameterType) {
    case kCenterFrequencyParameter:
      return &fields_.frequency.center;
    case kSpanParameter:
      return &fields_.frequency.span;
    case kRbwParameter:
      return &fields_.frequencyRbw;
    case TIME_MEASUREMENT_PERIOD:
      return fields_.interval() == MeasurementInterval::Time ? &fields_.sweepRate : nullptr;
    case kDistanceIntervalParameter:
      return fields_.interval() == MeasurementInterval::Distance ? &fields_.sweepRate : nullptr;
    case kDisplayLengthParameter:
      return &fields_.displayLength;
    case kAverageCountParameter:
      return &fields_.averageCount;
    case kVerticalResolutionParameter:
      return &fields_.verticalScale;
    case kGridTopParameter:
      return &fields_.verticalOffset;
    default:
      return nullptr;
  }
}

bool SpectrumView::linkAction(const FrontPanelLink& link) {
  for (const ActionRow& row : kActions) {
    if (row.operation != link.genericId) continue;
    showLink(fields_.controls.control(row.button), link);
    return true;
  }
  return false;
}

bool SpectrumView::linkParameter(const FrontPanelLink& link) {
  if (clsNumericEntry* const entry = linkedEntry(link.genericId)) {
    entry->Bold(link.bold);
    entry->Italic(link.italic);
    entry->linkEnable(link.enable);
    return true;
  }
  for (const ChoiceRow& row : kChoices) {
    if (row.parameterType != link.genericId) continue;
    for (const char* const name : row.controls)
      if (name != nullptr) showLink(fields_.controls.control(name), link);
    return true;
  }
  return false;
}

std::optional<double> SpectrumView::linkedValue(std::int32_t parameterType) {
  const clsNumericEntry* const entry = linkedEntry(parameterType);
  return entry == nullptr ? std::nullopt : std::optional<double>(entry->value());
}

std::span<const char* const> SpectrumView::linkedByName() const { return kLinkedByName; }

std::int32_t SpectrumView::measurementInfo(Variant& measurementTypes) {
  measurementTypes = Variant::Int32s{kSpectrumResultType};
  return kStatusDone;
}

bool SpectrumView::actionEnabled(std::int16_t action) {
  for (const ActionRow& row : kActions)
    if (row.operation == action) return fields_.controls.control(row.button).reallyEnabled();
  return FieldPanel::actionEnabled(action);
}

// --- The context menu, "Spectrum VFP Menu"

constexpr std::int16_t kStartStopAxis = 1;
constexpr std::int16_t kCenterSpanAxis = 2;

std::vector<SpectrumView::MenuCommand> SpectrumView::ownMenuCommands() {
  const clsMultiTracePainter* const painter = findPainter();
  const std::int16_t style = painter == nullptr ? std::int16_t{0} : painter->xAxisStyle();
  return {{"Axis: Start / Stop", style == kStartStopAxis, painter != nullptr,
           [this] { menuXAxisStyle(kStartStopAxis); }},
          {"Axis: Center / Span", style == kCenterSpanAxis, painter != nullptr,
           [this] { menuXAxisStyle(kCenterSpanAxis); }}};
}

void SpectrumView::menuXAxisStyle(std::int16_t style) {
  if (clsMultiTracePainter* const painter = findPainter()) painter->xAxisStyle(style);
  updateXAxisLabels();
  refreshTraces();
}

// --- Report

std::string SpectrumView::reportHtml() {
  PanelReport page;
  page.caption = linkSourceName();
  const FrequencyEntries& frequency = fields_.frequency;
  page.settings = {{"Center", frequency.center.text()},
                   {"Span", frequency.span.text()},
                   {"Start", frequency.start.text()},
                   {"Stop", frequency.stop.text()},
                   {"RBW", fields_.frequencyRbw.text()}};
  if (clsMultiTracePainter* const painter = findPainter()) {
    const std::string top = numberToText(painter->gridScaleTop().value_or(0));
    page.settings.push_back({"Reference level", top + " " + painter->yAxisLabel()});
    page.settings.push_back({"Scale", numberToText(painter->verticalResolution()) + " dB/div"});
    for (const MarkerReading& reading : painter->markerReadings())
      page.readings.push_back({reading.id, reading.x, reading.y});
  }
  page.xTitle = "Frequency";
  page.yTitle = "Level";
  page.picturePng = container().picturePng();
  return frontpanels::reportHtml(page);
}

}  // namespace frontpanels

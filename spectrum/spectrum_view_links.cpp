// SpectrumView as one of many: links, context menu, report.
#include <algorithm>
#include <iterator>

#include "framework/panel/report_html.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "framework/support/host_codes.h"
#include "spectrum/spectrum_view.h"

namespace frontpanels {
namespace {

// What a host can link to on a panel.
enum class LinkType : std::int16_t { Result = 1, Action = 2, Parameter = 3 };

void report(std::string_view what) { errorHandler().Assert(std::string("SpectrumView").append(what)); }

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

std::string upperCased(std::string_view name) {
  std::string upper(name);
  for (char& c : upper)
    if (c >= 'a' && c <= 'z') c = static_cast<char>(c - 'a' + 'A');
  return upper;
}

void show(Control& control, const FrontPanelLink& link) {
  control.Bold(link.bold);
  control.Italic(link.italic);
  control.Enabled(link.enable);
}

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

void SpectrumView::frontPanelLink(const FrontPanelLink& link) {
  switch (static_cast<LinkType>(link.linkType)) {
    case LinkType::Result:
      return report("::frontPanelLink() ... unhandled result");
    case LinkType::Action:
      if (link.genericId == QUILL_VFP_CLOSE)
        return errorHandler().Assert("I don't know how to invoke close yet!");
      if (!linkAction(link)) report("::frontPanelLink() ... unhandled action");
      return;
    case LinkType::Parameter:
      if (!linkParameter(link)) report("::frontPanelLink() ... unhandled parameter");
      return;
  }
  report("::frontPanelLink()...unrecognized link type");
}

bool SpectrumView::linkAction(const FrontPanelLink& link) {
  for (const ActionRow& row : kActions) {
    if (row.operation != link.genericId) continue;
    show(fields_.controls.control(row.button), link);
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
      if (name != nullptr) show(fields_.controls.control(name), link);
    return true;
  }
  return false;
}

Variant SpectrumView::initializeLinkValue(std::int16_t linkType, std::int32_t genericId) {
  if (static_cast<LinkType>(linkType) != LinkType::Parameter) {
    report("::initializeLinkValue()...unsupported link type");
    return {};
  }
  if (const clsNumericEntry* const entry = linkedEntry(genericId)) return entry->value();
  PanelSettings own{{TIME_MEASUREMENT_PERIOD, base_.measurementPeriod}};
  appendSettings(own);
  const auto found = std::find_if(own.begin(), own.end(), [genericId](const PanelSetting& setting) {
    return setting.parameterType == genericId;
  });
  if (found != own.end()) return found->value;
  report("::initializeLinkValue() ... unhandled parameter");
  return {};
}

std::string SpectrumView::activeControlLink() {
  const Control* const focused = fields_.controls.focused();
  if (focused == nullptr) return {};
  const bool linked = std::find(std::begin(kLinkedByName), std::end(kLinkedByName), focused->name()) !=
                      std::end(kLinkedByName);
  return linked ? upperCased(focused->name()) : std::string();
}

std::int32_t SpectrumView::measurementInfo(Variant& measurementTypes) {
  measurementTypes = Variant::Int32s{kSpectrumResultType};
  return kStatusDone;
}

// While logging the panel stays open, in playback it cannot be closed.
bool SpectrumView::actionEnabled(std::int16_t action) {
  if (action == QUILL_VFP_CLOSE) return !base_.recordMode && !base_.playback;
  for (const ActionRow& row : kActions)
    if (row.operation == action) return fields_.controls.control(row.button).reallyEnabled();
  return action == QUILL_VFP_SAVE;
}

// --- The context menu, "Spectrum VFP Menu"

enum MenuItem : std::int16_t {
  menuDisplayControls = 1,
  menuMeasurementControls,
  menuStartStop,
  menuCenterSpan,
  menuProperties,
  menuClose
};

constexpr std::int16_t kStartStopAxis = 1;
constexpr std::int16_t kCenterSpanAxis = 2;

std::vector<PanelMenuItem> SpectrumView::contextMenu() {
  if (base_.closing()) return {};
  const clsMultiTracePainter* const painter = findPainter();
  const std::int16_t style = painter == nullptr ? std::int16_t{0} : painter->xAxisStyle();
  return {
      {menuDisplayControls, "Display Controls", base_.rightPanelVisible(), true},
      {menuMeasurementControls, "Measurement Controls", base_.bottomPanelVisible(),
       base_.bottomPanelEnabled()},
      {menuStartStop, "Axis: Start / Stop", style == kStartStopAxis, painter != nullptr},
      {menuCenterSpan, "Axis: Center / Span", style == kCenterSpanAxis, painter != nullptr},
      {menuProperties, "Properties", false, true},
      {menuClose, "Close", false, actionEnabled(QUILL_VFP_CLOSE)},
  };
}

void SpectrumView::contextMenuClick(std::int16_t id) {
  guard("SpectrumView::contextMenuClick()", [&] {
    const std::vector<PanelMenuItem> items = contextMenu();
    const bool usable = std::any_of(items.begin(), items.end(), [id](const PanelMenuItem& item) {
      return item.id == id && item.enabled;
    });
    if (!usable) return;
    switch (static_cast<MenuItem>(id)) {
      case menuDisplayControls:
        return toggleDisplayArea();
      case menuMeasurementControls:
        return toggleMeasurementArea();
      case menuStartStop:
        return menuXAxisStyle(kStartStopAxis);
      case menuCenterSpan:
        return menuXAxisStyle(kCenterSpanAxis);
      case menuProperties:
        return errorHandler().Assert("I don't know how to invoke the property page yet!");
      case menuClose:
        return closeVfp();
    }
  });
}

void SpectrumView::menuXAxisStyle(std::int16_t style) {
  if (clsMultiTracePainter* const painter = findPainter()) painter->xAxisStyle(style);
  updateXAxisLabels();
  refreshTraces();
}

void SpectrumView::closeVfp() {
  guard("SpectrumView::closeVfp() ... ", [this] { base_.closeVfp(); });
}

// --- Report

std::string SpectrumView::linkSourceName() {
  return base_.frontPanelCaption().empty() ? kTypeName : base_.frontPanelCaption();
}

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

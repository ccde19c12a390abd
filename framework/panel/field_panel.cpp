#include "framework/panel/field_panel.h"

#include <algorithm>
#include <iterator>

#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "framework/support/host_codes.h"

namespace frontpanels {
namespace {

// What a host can link to on a panel.
enum class LinkType : std::int16_t { Result = 1, Action = 2, Parameter = 3 };

constexpr const char* kDisplayAreaButton = "MarkerFrameInvisibleButton";
constexpr const char* kMeasurementAreaButton = "MeasurementFrameInvisibleButton";
// How wide a collapse button is, across the edge that it lies along.
constexpr float kCollapseButtonTwips = 90;

// Commands of keys that are those of a button or of one half of a spin button.
struct ButtonKeyRow {
  PlotCommand command;
  const char* control;
  std::function<void()> Control::*click;
  std::function<void()> SpinButton::*spin;
};
constexpr const char* kVerticalScale = "VerticalScaleSpinButton";
constexpr ButtonKeyRow kButtonKeys[] = {
    {PlotCommand::MarkerToMax, "MarkerToMaxButton", &Control::Click, nullptr},
    {PlotCommand::MarkerToCenter, "MarkerToCenterButton", &Control::Click, nullptr},
    {PlotCommand::WidenScale, kVerticalScale, nullptr, &SpinButton::SpinUp},
    {PlotCommand::NarrowScale, kVerticalScale, nullptr, &SpinButton::SpinDown},
};

const ButtonKeyRow* findButtonKey(PlotCommand command) {
  const auto* const row = std::find_if(std::begin(kButtonKeys), std::end(kButtonKeys),
                                       [command](const ButtonKeyRow& key) { return key.command == command; });
  return row == std::end(kButtonKeys) ? nullptr : row;
}

std::string upperCased(std::string_view name) {
  std::string upper(name);
  for (char& c : upper)
    if (c >= 'a' && c <= 'z') c = static_cast<char>(c - 'a' + 'A');
  return upper;
}

}  // namespace

FieldPanel::FieldPanel(const PanelEnvironment& environment, PanelHost& host, PanelContainer& container,
                       const char* typeName, std::span<const ControlRow> rows)
    : HostedPanel(environment, host, container),
      typeName_(typeName),
      controls_(rows),
      displayPanel_(controls_, controls_.picture("displayPanel")),
      controlPanel_(controls_, controls_.picture("controlPanel")),
      base_(environment, *this) {
  controls_.pushButton(kDisplayAreaButton).Click = whileOpen([this] { toggleDisplayArea(); });
  controls_.pushButton(kMeasurementAreaButton).Click = whileOpen([this] { toggleMeasurementArea(); });
}

std::int32_t FieldPanel::playbackOp(std::int32_t /*hardwareId*/, std::int16_t /*operation*/,
                                    const Variant& /*parameter*/, clsBaseVFP* /*base*/) {
  return kStatusUnknownOperation;
}

// --- Window

void FieldPanel::rescale(ScreenMetrics metrics) {
  HostedPanel::rescale(metrics);
  base_.rescale(metrics);
  guard([this] { return named("rescale()"); }, [this] { rescaled(); });
  Form_Resize();
}

// The collapse buttons lie along the areas' inner edges, and at the view's edge where an area is hidden.
void FieldPanel::Form_Resize() {
  base_.Resize();
  guard([this] { return named("Form_Resize()"); },
        [this] {
          const float right = InvisibleWidthMarkX1() - kCollapseButtonTwips;
          const float bottom = InvisibleHeightMarkY1() - kCollapseButtonTwips;
          controls_.control(kDisplayAreaButton).Move({right, 0, kCollapseButtonTwips, bottom});
          controls_.control(kMeasurementAreaButton)
              .Move({0, bottom, InvisibleWidthMarkX1(), kCollapseButtonTwips});
        });
}

void FieldPanel::closeVfp() {
  guard([this] { return named("closeVfp() ... "); }, [this] { base_.closeVfp(); });
}

void FieldPanel::refreshTraces() {
  guard([this] { return named("refreshTraces()"); },
        [this] {
          if (!view().visible()) return;
          base_.traceManager().paintTraces(true);
          tracesRefreshed();
        });
}

// --- Markers

void FieldPanel::setMarkerFrameColor(Color color) {
  if (Control* const frame = controls_.find("MarkerFrame")) frame->ForeColor(color);
}

void FieldPanel::deltaMarkerButtonEnabled(bool enable) {
  if (Control* const button = controls_.find("MarkerDeltaButton")) button->Enabled(enable);
}

bool FieldPanel::mayCenterMarker() {
  const TraceObject* const active = base_.traceManager().activeTrace();
  return active != nullptr && active->activeMarker() != nullptr && !base_.recordMode && !base_.playback;
}

void FieldPanel::evaluateEnablingMarkerToCenter() {
  guard([this] { return named("evaluateEnablingMarkerToCenter()"); },
        [this] {
          if (Control* const button = MarkerToCenterButton()) button->Enabled(mayCenterMarker());
        });
}

// --- Keys

bool FieldPanel::canRun(PlotCommand command) {
  const ButtonKeyRow* const row = findButtonKey(command);
  if (row == nullptr) return plotCommands().canRun(command);
  const Control* const button = controls_.find(row->control);
  return button != nullptr && button->reallyEnabled();
}

void FieldPanel::run(PlotCommand command) {
  guard([this] { return named("run() ... "); },
        [&] {
          if (!canRun(command)) return;
          const ButtonKeyRow* const row = findButtonKey(command);
          if (row == nullptr) {
            plotCommands().run(command);
            return evaluateEnablingMarkerToCenter();  // the active marker may be another one
          }
          const auto& does = row->spin != nullptr ? controls_.spinButton(row->control).*(row->spin)
                                                  : controls_.control(row->control).*(row->click);
          if (does) does();
        });
}

// --- Reports and requests

std::string FieldPanel::named(std::string_view routine) const {
  return std::string(typeName_).append("::").append(routine);
}

void FieldPanel::report(std::string_view what) const { errorHandler().Assert(named(what)); }

bool FieldPanel::accepted(std::string_view routine, std::int32_t status) const {
  if (status == kStatusDone) return true;
  errorHandler().ReportError(named(routine) + " status = " + std::to_string(status));
  return false;
}

bool FieldPanel::request(std::string_view routine, std::int16_t parameterType, std::int16_t index,
                         const Variant& value) {
  if (base_.closing()) return false;
  return accepted(routine,
                  frontPanelSet(base_.resourceId(), base_.virtualFrontPanelId, parameterType, index, value));
}

bool FieldPanel::operate(std::string_view routine, std::int16_t operation, const Variant& argument) {
  return guarded([&] { return named(routine); }, false,
                 [&] {
                   if (base_.closing()) return false;
                   return accepted(routine, frontPanelOp(base_.resourceId(), base_.virtualFrontPanelId,
                                                         operation, argument));
                 });
}

void FieldPanel::select(std::string_view option) {
  OptionButton& button = controls_.optionButton(option);
  if (button.Value()) return;
  const FlagScope inProgress = changeOption();
  button.Value(true);
}

// --- Context menu

std::vector<FieldPanel::MenuCommand> FieldPanel::menuCommands() {
  std::vector<MenuCommand> commands = {
      {"Display Controls", base_.rightPanelVisible(), true, [this] { toggleDisplayArea(); }},
      {"Measurement Controls", base_.bottomPanelVisible(), base_.bottomPanelEnabled(),
       [this] { toggleMeasurementArea(); }}};
  for (MenuCommand& command : ownMenuCommands()) commands.push_back(std::move(command));
  commands.push_back({"Properties", false, true,
                      [] { errorHandler().Assert("I don't know how to invoke the property page yet!"); }});
  commands.push_back({"Close", false, actionEnabled(QUILL_VFP_CLOSE), [this] { closeVfp(); }});
  return commands;
}

std::vector<PanelMenuItem> FieldPanel::contextMenu() {
  std::vector<PanelMenuItem> items;
  if (base_.closing()) return items;
  for (const MenuCommand& command : menuCommands())
    items.push_back(
        {static_cast<std::int16_t>(items.size() + 1), command.caption, command.checked, command.enabled});
  return items;
}

void FieldPanel::contextMenuClick(std::int16_t id) {
  if (base_.closing()) return;
  guard([this] { return named("contextMenuClick()"); },
        [&] {
          const std::vector<MenuCommand> commands = menuCommands();
          const auto at = static_cast<std::size_t>(id) - 1;
          if (id > 0 && at < commands.size() && commands[at].enabled) commands[at].run();
        });
}

// --- Links

void FieldPanel::showLink(Control& control, const FrontPanelLink& link) {
  control.Bold(link.bold);
  control.Italic(link.italic);
  control.Enabled(link.enable);
}

void FieldPanel::frontPanelLink(const FrontPanelLink& link) {
  switch (static_cast<LinkType>(link.linkType)) {
    case LinkType::Result:
      return report("frontPanelLink() ... unhandled result");
    case LinkType::Action:
      if (link.genericId == QUILL_VFP_CLOSE)
        return errorHandler().Assert("I don't know how to invoke close yet!");
      if (!linkAction(link)) report("frontPanelLink() ... unhandled action");
      return;
    case LinkType::Parameter:
      if (!linkParameter(link)) report("frontPanelLink() ... unhandled parameter");
      return;
  }
  report("frontPanelLink()...unrecognized link type");
}

Variant FieldPanel::initializeLinkValue(std::int16_t linkType, std::int32_t genericId) {
  if (static_cast<LinkType>(linkType) != LinkType::Parameter) {
    report("initializeLinkValue()...unsupported link type");
    return {};
  }
  if (const std::optional<double> value = linkedValue(genericId)) return *value;
  PanelSettings own{{TIME_MEASUREMENT_PERIOD, base_.measurementPeriod}};
  appendSettings(own);
  const auto found = std::find_if(own.begin(), own.end(), [genericId](const PanelSetting& setting) {
    return setting.parameterType == genericId;
  });
  if (found != own.end()) return found->value;
  report("initializeLinkValue() ... unhandled parameter");
  return {};
}

std::string FieldPanel::activeControlLink() {
  const Control* const focused = controls_.focused();
  if (focused == nullptr) return {};
  const std::span<const char* const> names = linkedByName();
  const bool linked = std::find(names.begin(), names.end(), focused->name()) != names.end();
  return linked ? upperCased(focused->name()) : std::string();
}

bool FieldPanel::actionEnabled(std::int16_t action) {
  if (action == QUILL_VFP_CLOSE) return !base_.recordMode && !base_.playback;
  return action == QUILL_VFP_SAVE;
}

std::string FieldPanel::linkSourceName() {
  return base_.frontPanelCaption().empty() ? typeName_ : base_.frontPanelCaption();
}

}  // namespace frontpanels

#include "workbench/panel.h"

#include <utility>

#include "framework/support/host_codes.h"
#include "platform/win32/utf16.h"
#include "workbench/failure.h"
#include "workbench/pilot_panel.h"
#include "workbench/screen_scale.h"
#include "workbench/spectrum_panel.h"

namespace frontpanels::workbench {
namespace {

constexpr double kPeriodSeconds = 0.2;

void checkStatus(std::int32_t status, const std::string& meaning) {
  if (status == kStatusDone) return;
  throw HostFailure("The panel refused " + meaning + ": status " + std::to_string(status));
}

struct PopUpRow {
  std::int16_t id;
  const char* caption;
};
constexpr PopUpRow kPopUp[] = {
    {kRightPanelItem, "&Display controls"},
    {kBottomPanelItem, "&Measurement controls"},
    {kDisplayStateOnItem, "Display &on"},
    {kDisplayStateOffItem, "Display o&ff"},
    {kSaveItem, "&Save"},
    {kCloseItem, "&Close"},
};

}  // namespace

Panel::Panel(PanelKind kind, PanelFrame& frame, PanelListener& listener, const StoredPanel* stored)
    : row_(panelKind(kind)), listener_(listener), window_(frame, *this, toUtf16(row_.caption)) {
  control_.emplace(row_.progId, toUtf16(row_.controlName), window_, static_cast<PanelRequests&>(*this),
                   stored == nullptr || stored->properties.empty() ? nullptr : &stored->properties);
  window_.occupy(&*control_);
  panel_.emplace(control_->automation());
  hub_.emplace(Automation::create("FrontPanels.DataHub"));
  introduce();
}

Panel::~Panel() { close(); }

// A panel that refuses to be closed goes all the same.
void Panel::close() noexcept {
  closed_ = true;
  try {
    if (panel_) operate(QUILL_VFP_CLOSE, std::int32_t{0});
  } catch (...) {
  }
  window_.occupy(nullptr);
}

void Panel::introduce() {
  set(PARM_RESOURCE_ID, row_.hardwareId);
  set(PARM_MEASUREMENT_ID, row_.measurementId);
  panel_->put("virtualFrontPanelId", static_cast<std::int32_t>(row_.kind) + 1);
  for (const std::int16_t period : {TIME_MEASUREMENT_PERIOD, TIME_DATABASE_PERIOD, TIME_DISPLAY_PERIOD})
    set(period, kPeriodSeconds);
  giveCaption();
}

// A panel that owns its window is placed by the host's word; hidden meanwhile, it is shown by the last one.
void Panel::showFirst(const StoredPanel* stored) {
  panel_->object("baseInstance").put("windowOwner", true);
  if (stored != nullptr && stored->boundsTwips) {
    const RECT& place = *stored->boundsTwips;
    set(kLeftParameter, static_cast<std::int32_t>(place.left));
    set(kTopParameter, static_cast<std::int32_t>(place.top));
    set(kWidthParameter, static_cast<std::int32_t>(place.right - place.left));
    set(kHeightParameter, static_cast<std::int32_t>(place.bottom - place.top));
  }
  ready_ = true;
  if (stored != nullptr) restore(*stored);
  operate(kShowOperation, std::int32_t{0});
}

void Panel::set(std::int16_t code, const Value& value, std::int16_t index) {
  checkStatus(panel_->number("vfpSet", {row_.hardwareId, code, index, value}),
              "setting " + std::to_string(code));
}

void Panel::operate(std::int16_t operation, const Value& parameter) {
  checkStatus(panel_->number("vfpOp", {row_.hardwareId, operation, parameter}),
              "operation " + std::to_string(operation));
}

void Panel::publish(std::string_view path, const Value& value) { hub_->call("Publish", {path, value}); }

// --- Requests of the panel. It is still inside its own event: it is answered after that.

std::int32_t Panel::frontPanelOp(PanelIds, std::int16_t operation, std::int32_t argument) {
  if (!answers()) return kStatusDone;
  if (operation == kAddTraceOperation || operation == kRemoveTraceOperation) {
    if (!requestDisplay(argument, operation == kAddTraceOperation)) return kStatusUnusableParameter;
    changed_ = true;
    listener_.answerWanted(kind());
    return kStatusDone;
  }
  if (operation == kDisplayStateOperation) {
    operate(kDisplayStateOperation, argument != 0);
    return kStatusDone;
  }
  if (operation == QUILL_VFP_CLOSE) {
    listener_.closeAsked(kind());
    return kStatusDone;
  }
  return listener_.operationAsked(kind(), operation) ? kStatusDone : kStatusUnknownOperation;
}

std::int32_t Panel::frontPanelSet(PanelIds, std::int16_t parameterType, std::int16_t index, double value) {
  if (!answers()) return kStatusDone;
  const bool taken = request(parameterType, index, value);
  changed_ = changed_ || taken;
  listener_.answerWanted(kind());
  return taken ? kStatusDone : kStatusUnusableParameter;
}

std::int32_t Panel::saveDisplaySettings(PanelIds, const VARIANT& list) {
  if (!answers()) return kStatusDone;
  listener_.settingsHanded(kind(), std::nullopt, storedSettings(list));
  return kStatusDone;
}

std::int32_t Panel::saveSetup(std::int32_t setUpId, PanelIds) {
  if (!answers()) return kStatusDone;
  listener_.settingsHanded(kind(), setUpId, settings());
  return kStatusDone;
}

bool Panel::answer() {
  const std::vector<ReceiverSetting> answers = takeAnswers();
  for (const ReceiverSetting& setting : answers) {
    set(setting.code, setting.value);
    told(setting);
  }
  return std::exchange(changed_, false) || !answers.empty();
}

// --- Operations of the host

void Panel::save() { operate(QUILL_VFP_SAVE, std::int32_t{0}); }

void Panel::saveSetUp(std::int32_t setUp) { operate(QUILL_VFP_SAVE_SETUP, setUp); }

void Panel::receive(const Frame& frame) {
  if (!show(frame)) return;
  received_ = true;
  restoreMarkers();
}

// What the panel does not take, of an older version for instance, does not keep it from the rest. The
// receiver learns what holds now, and tells the panel where that is something else. Markers stand on values
// and wait for the first ones.
void Panel::restore(const StoredPanel& stored) {
  markers_.emplace();
  forgetOwn();
  for (const StoredSetting& setting : stored.settings) {
    const bool ofMarker = setting.code >= kNewMarkerParameter && setting.code <= kMarkerValueParameter;
    ofMarker ? markers_->push_back(setting) : restoreOne(setting);
  }
  restoreOwn(stored);
  answer();
  if (received_) restoreMarkers();
}

void Panel::restoreOne(const StoredSetting& setting) {
  static_cast<void>(
      panel_->number("vfpSet", {row_.hardwareId, setting.code, setting.index, Value::of(setting.value)}));
  if (setting.value.isNumeric())
    static_cast<void>(request(setting.code, setting.index, setting.value.toDouble()));
}

// Those that are there make room: the numbers of markers are theirs alone.
void Panel::restoreMarkers() {
  const auto markers = std::exchange(markers_, std::nullopt);
  if (!markers) return;
  for (const StoredSetting& present : settings())
    if (present.code == kNewMarkerParameter) panel_->call("deleteMarker", {});
  for (const StoredSetting& setting : *markers) restoreOne(setting);
}

// Status words follow the caption directly.
void Panel::giveCaption() { set(kCaptionParameter, std::string(row_.caption) + " "); }

// A panel that logs puts its measurement controls away; they come back to where they were.
void Panel::logging(bool on) {
  if (on == logging_) return;
  logging_ = on;
  if (on) measurementShown_ = panel_->flag("MeasurementPanelVisible");
  set(PARM_LOGGING_FLAG, on);
  if (on) operate(kLoggingOnOperation, std::int32_t{0});
  if (on) return;
  panel_->put("MeasurementPanelVisible", measurementShown_);
  giveCaption();  // without a word on logging
}

void Panel::playback() {
  operate(kPlaybackOperation, std::int32_t{0});
  playback_ = true;
}

std::vector<PopUpItem> Panel::popUpItems() {
  panel_->call("refreshMenuItems", {});
  std::vector<PopUpItem> items;
  for (const PopUpRow& row : kPopUp)
    items.push_back({row.id, row.caption, panel_->flag("MenuItemChecked", {row.id}),
                     panel_->flag("MenuItemEnabled", {row.id})});
  return items;
}

void Panel::popUpClick(std::int16_t item) {
  panel_->call("PopUp_Click", {row_.hardwareId, static_cast<std::int32_t>(item)});
}

RECT Panel::boundsTwips() {
  RECT place = window_.bounds();
  for (LONG* const side : {&place.left, &place.top, &place.right, &place.bottom})
    *side = twipsFromPixels(*side);
  return place;
}

std::vector<StoredSetting> Panel::settings() { return storedSettings(panel_->value("Settings").variant()); }

std::vector<StoredSetting> Panel::storedSettings(const VARIANT& list) const {
  const std::vector<Variant> flat = elementsOf(list);
  if (flat.size() % 2 != 0) throw HostFailure("The panel's list of settings ends with a code");
  std::vector<StoredSetting> stored;
  for (std::size_t i = 0; i < flat.size(); i += 2) stored.push_back({flat[i].toInt16(), 0, flat[i + 1]});
  // What logging has put away for a while is not to be kept away.
  for (StoredSetting& setting : stored)
    if (logging_ && setting.code == kBottomPanelParameter) setting.value = measurementShown_;
  appendOwn(stored);
  return stored;
}

std::unique_ptr<Panel> openPanel(PanelKind kind, PanelFrame& frame, PanelListener& listener,
                                 const StoredPanel* stored) {
  switch (kind) {
    case PanelKind::Spectrum:
      return std::make_unique<SpectrumPanel>(frame, listener, stored);
    case PanelKind::Pilots:
      return std::make_unique<PilotPanel>(frame, listener, stored);
  }
  throw HostFailure("There is no such panel");
}

}  // namespace frontpanels::workbench

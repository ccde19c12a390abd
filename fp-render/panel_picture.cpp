#include "fp-render/panel_picture.h"

#include <algorithm>
#include <array>

#include "framework/support/error_handler.h"
#include "framework/support/host_codes.h"
#include "framework/support/numeric.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

constexpr std::int32_t kHardwareId = 1;
constexpr int kIllegalCall = 5;

void require(std::int32_t status) {
  if (status != kStatusDone) raiseInvalidProcedureCall();
}

bool holds(const VerticalScale& scale, const LevelRange& range) {
  return range.isEmpty() ||
         (static_cast<double>(range.highestDb) <= scale.topDb &&
          static_cast<double>(range.lowestDb) >= scale.topDb - kVerticalDivisions * scale.dbPerDivision);
}

VerticalScale scaleOf(const PlotPainter& display) {
  return {display.gridScaleTop().value_or(0), display.verticalResolution()};
}

}  // namespace

PanelPicture::~PanelPicture() = default;

PanelEnvironment PanelPicture::environment() {
  return {surface_.gdi(), windowing_, surface_.view(), hub_, surface_.metrics(), ""};
}

// --- Settings

void PanelPicture::open() {
  panel().base().windowOwner = false;  // a picture is where it is, and to be seen
  panel().base().warnOnUnhandledParameters = true;
  panel().base().captionStatus = false;
  panel().Form_Resize();
  setOwn(kRightPanelParameter, fields_);
  setOwn(kBottomPanelParameter, fields_);
  require(panel().vfpOp(kHardwareId, kShowOperation, Variant(), nullptr));
  for (const PlotPainter* const display : displays()) scales_[display->resultType()] = scaleOf(*display);
}

bool PanelPicture::set(const StoredSetting& setting) {
  const std::uint64_t reports = messageLog().count();
  const std::int32_t status =
      panel().vfpSet(kHardwareId, setting.code, setting.index, setting.value, nullptr);
  if (!fields_ && (setting.code == kRightPanelParameter || setting.code == kBottomPanelParameter))
    setOwn(setting.code, false);
  if (status != kStatusDone || messageLog().count() != reports) return false;
  settings_.push_back(setting);
  return true;
}

bool PanelPicture::isSet(std::int16_t code) const {
  return std::any_of(settings_.begin(), settings_.end(),
                     [code](const StoredSetting& setting) { return setting.code == code; });
}

void PanelPicture::setOwn(std::int16_t code, const Variant& value) {
  require(panel().vfpSet(kHardwareId, code, 0, value, nullptr));
}

// --- Scale

std::vector<PlotPainter*> PanelPicture::displays() {
  std::vector<PlotPainter*> found;
  for (const TracePointer& trace : panel().base().traceManager().Traces())
    if (auto* const display = dynamic_cast<PlotPainter*>(trace.get())) found.push_back(display);
  return found;
}

void PanelPicture::levels(std::int16_t resultType, std::span<const float> levelsDb, float addedDb) {
  LevelRange added;
  added.add(levelsDb);
  if (added.isEmpty()) return;
  levels_[resultType].add(std::array{added.lowestDb + addedDb, added.highestDb + addedDb});
}

bool PanelPicture::hasLevels() const {
  return std::any_of(levels_.begin(), levels_.end(), [](const auto& of) { return !of.second.isEmpty(); });
}

void PanelPicture::fitScale(std::optional<double> topDb, std::optional<double> dbPerDivision) {
  const bool given = topDb || dbPerDivision;
  for (PlotPainter* const display : displays()) {
    const VerticalScale now = scaleOf(*display);
    const bool fromSetting = now != scales_[display->resultType()];
    const LevelRange& range = levels_[display->resultType()];
    if (!given && (fromSetting || display->getAutoScale() || (ownScaleWhereItFits() && holds(now, range))))
      continue;
    const auto wanted = [&](std::optional<double> option, double setting) {
      return option || !fromSetting ? option : std::optional(setting);
    };
    const VerticalScale scale =
        verticalScaleFor(range, wanted(topDb, now.topDb), wanted(dbPerDivision, now.dbPerDivision));
    display->setAutoScale(false);
    display->gridScaleTop(scale.topDb);
    display->verticalResolution(scale.dbPerDivision);
  }
  panel().refreshControls();
}

// --- Markers

void PanelPicture::markers(const WantedMarkers& wanted) {
  if (!wanted.any()) return;
  clsMultiTracePainter* const painter = markedTrace();
  if (painter == nullptr) throw RuntimeError(kIllegalCall, "there is no trace for markers to stand on");
  setOwn(kSelectTraceParameter, painter->resultType());
  activeIsOurs_ = painter->activeMarker() == nullptr;
  std::int32_t number = panel().base().traceManager().findHighestId();
  for (const WantedMarker& marker : wanted.at) {
    addMarker(*painter, ++number, false, marker.place);
    if (marker.delta) addMarker(*painter, number, true, marker.delta);
  }
  if (wanted.peak) addMarker(*painter, ++number, false, std::nullopt);
}

// As a host sends a marker back.
void PanelPicture::addMarker(clsMultiTracePainter& painter, std::int32_t number, bool delta,
                             std::optional<double> place) {
  setOwn(kNewMarkerParameter, number);
  if (delta) setOwn(kMarkerFlagParameter, true);
  setOwn(kMarkerValueParameter, 0);
  setOwn(kAttachMarkerParameter, 0);
  const std::string id = std::to_string(number);
  markers_.push_back({painter.findMarker(delta ? deltaMarkerId(id) : id), place});
  if (!markers_.back().marker) raiseObjectVariableNotSet();
}

void PanelPicture::placeMarkers() {
  leftOut_.clear();
  clsMultiTracePainter* const painter = markedTrace();
  if (painter == nullptr || markers_.empty()) return;
  MarkerCollection& shown = painter->markerCollection();
  bool partnerShown = false;
  for (const Marker& wanted : markers_) {
    const bool delta = wanted.marker->DELTA;
    const bool visible = placeMarker(*painter, wanted) && (!delta || partnerShown);
    if (!delta) partnerShown = visible;
    if (visible && !shown.contains(wanted.marker->id)) shown.add(wanted.marker, wanted.marker->id);
    if (!visible && shown.contains(wanted.marker->id)) shown.remove(wanted.marker->id);
  }
  activateFirstMarker(*painter);
}

// False outside of what is shown: the gap behind the last point is no place for a marker.
bool PanelPicture::placeMarker(clsMultiTracePainter& painter, const Marker& wanted) {
  if (!wanted.place) {
    wanted.marker->point = toInt32(painter.activeTraceMaximumIndex());
    return true;
  }
  const double point = (*wanted.place - painter.xStart()) / painter.xPerPoint();
  const double last = painter.numberOfMeasurements() - 2.0;
  if (!(point >= -0.5 && point <= last + 0.5)) {
    leftOut_.push_back(painter.xAxisFormatter().formatter(*wanted.place));
    return false;
  }
  wanted.marker->point = toInt32(std::clamp(point, 0.0, last));
  return true;
}

void PanelPicture::activateFirstMarker(clsMultiTracePainter& painter) {
  if (!activeIsOurs_) return;
  const auto first = std::find_if(markers_.begin(), markers_.end(), [&](const Marker& wanted) {
    return painter.markerCollection().contains(wanted.marker->id);
  });
  const MarkerPointer active = first == markers_.end() ? nullptr : first->marker;
  painter.activeMarker(active);
  painter.mouseActiveMarker(active);
}

std::vector<std::string> PanelPicture::markerReadings() {
  std::vector<std::string> readings;
  const GraphItems items = panel().base().traceManager().graphItems();
  for (const GraphItem& item : items.all())
    if (item.kind == GraphItemKind::Marker) readings.push_back(item.name + ": " + item.value);
  return readings;
}

// --- Pictures

PixelView PanelPicture::picture(const std::string& caption) {
  surface_.clear();
  if (fields_) panel().refreshControls();
  panel().Paint();
  if (fields_) surface_.drawFields(*panel().controls());
  return surface_.picture(caption);
}

}  // namespace frontpanels

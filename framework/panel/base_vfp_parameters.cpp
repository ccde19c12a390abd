// The common parameters of clsBaseVFP, and the list of them that a panel hands over for keeping.
#include <algorithm>
#include <iterator>

#include "framework/panel/base_vfp.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "framework/support/host_codes.h"
#include "framework/support/numeric.h"
#include "framework/support/utility.h"

namespace frontpanels {
namespace {

constexpr std::int16_t kUsualTraceMode = 0;

std::string markerId(std::int32_t number, bool delta) {
  const std::string id = std::to_string(number);
  return delta ? deltaMarkerId(id) : id;
}

// There is a place for markers before there is a trace.
std::int16_t tracesWithMarkers(const TraceObject& painter) {
  return std::max<std::int16_t>(painter.numberOfTraces(), 1);
}

// The marker of the trace object that has the id, whichever of its traces it is on.
MarkerPointer findMarker(TraceObject& painter, const std::string& id) {
  for (std::int16_t trace = 0; trace < tracesWithMarkers(painter); ++trace)
    for (const MarkerPointer& marker : painter.traceMarkerCollections(trace))
      if (marker->id == id) return marker;
  return nullptr;
}

}  // namespace

// One row a code. A code whose value must be a number names the message for one that is none.
struct clsBaseVFP::ParameterRow {
  enum class When : std::uint8_t { Always, OwnsWindow };
  std::int16_t code = 0;
  const char* mustBeNumeric = nullptr;
  void (*apply)(clsBaseVFP& base, const Variant& value) = nullptr;
  When when = When::Always;
  const char* withoutTrace = nullptr;  // the message for a panel that has no active trace
};

const clsBaseVFP::ParameterRow clsBaseVFP::kParameters[] = {
      {TIME_MEASUREMENT_PERIOD, "clsBaseVFP::vfpSet() TIME_MEASUREMENT_PERIOD must be numeric",
       [](clsBaseVFP& base, const Variant& value) { base.measurementPeriod = value.toDouble(); }},
      {TIME_DATABASE_PERIOD, "clsBaseVFP::vfpSet() TIME_DATABASE_PERIOD must be numeric",
       [](clsBaseVFP& base, const Variant& value) { base.databasePeriod = value.toDouble(); }},
      {TIME_DISPLAY_PERIOD, "clsBaseVFP::vfpSet() TIME_DISPLAY_PERIOD must be numeric",
       [](clsBaseVFP& base, const Variant& value) { base.displayPeriod = value.toDouble(); }},
      {PARM_MEASUREMENT_ID, "clsBaseVFP::vfpSet() PARM_MEASUREMENT_ID must be numeric",
       [](clsBaseVFP& base, const Variant& value) { base.measurementId = value.toInt32(); }},
      {kCaptionParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) {
         base.frontPanelCaption_ = value.toText();
         base.Caption(base.frontPanelCaption_);
       }},
      {PARM_RESOURCE_ID, "clsBaseVFP::vfpSet() PARM_RESOURCE_ID must be numeric",
       [](clsBaseVFP& base, const Variant& value) { base.resourceId(value.toInt32()); }},
      {PARM_LOGGING_FLAG, "clsBaseVFP::vfpSet() PARM_LOGGING_FLAG must be numeric",
       [](clsBaseVFP& base, const Variant& value) {
         base.recordMode = value.toDouble() != 0;
         if (!base.recordMode) base.loggingConfirmed_ = false;
         base.logIndicatorHandler();
       }},
      {kLeftParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) { base.placeWindow(&PanelControl::left, value); },
       ParameterRow::When::OwnsWindow},
      {kTopParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) { base.placeWindow(&PanelControl::top, value); },
       ParameterRow::When::OwnsWindow},
      {kWidthParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) { base.placeWindow(&PanelControl::ViewWidth, value); },
       ParameterRow::When::OwnsWindow},
      {kHeightParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) { base.placeWindow(&PanelControl::ViewHeight, value); },
       ParameterRow::When::OwnsWindow},
      // The lower-case routine name is the one that hosts look for.
      {PARM_WINDOW_STATE, "clsBaseVFP::vfpset() PARM_WINDOW_STATE must be numeric",
       [](clsBaseVFP& base, const Variant& value) { base.child_.ViewState(value.toInt16()); },
       ParameterRow::When::OwnsWindow},
      {kBottomPanelParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) { base.bottomPanelVisible(value.toBoolean()); }},
      {kRightPanelParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) { base.rightPanelVisible(value.toBoolean()); }},
      {kXAxisStyleParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) {
         base.activePainter().xAxisStyle(value.toInt16());
         base.child_.refreshControls();
       }},
      {kVerticalResolutionParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) {
         // Through text: the host's single-precision 0.1 arrives as the 0.1 that it shows.
         base.activePainter().verticalResolution(Variant(value.toText()).toDouble());
         base.child_.refreshControls();
       }},
      {kGridTopParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) {
         base.activePainter().gridScaleTop(value.toDouble());
         base.child_.refreshControls();
       }},
      {kYAxisStyleParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) {
         base.activePainter().yAxisStyle(value.toInt16());
         base.child_.refreshControls();
       }},
      {kAutoScaleParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) {
         base.activePainter().setAutoScale(value.toBoolean());
         base.child_.refreshControls();
       }},
      {kCaptionTextParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) { base.frontPanelCaption_ = value.toText(); }},
      {kVisibleParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) { base.child_.ViewVisible(BooleanValue(value.toText())); },
       ParameterRow::When::OwnsWindow},
      {kTraceParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) { base.addTraceOfPn(value.toDouble()); }},
      {kTraceValueParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) {
         if (base.traceManager_->activeTrace() != nullptr) base.nextTracePn_ = value.toInt16();
       }},
      {kSelectTraceParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) { base.selectTrace(value.toInt16()); }},
      {kNewMarkerParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) { base.startMarker(value.toInt32()); }},
      {kMarkerFlagParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) { base.flagMarker(BooleanValue(value.toText())); }},
      {kActiveMarkerParameter, nullptr, [](clsBaseVFP& base, const Variant&) { base.activateMarker(); }},
      {kAttachMarkerParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) { base.attachMarker(value.toInt16()); }, ParameterRow::When::Always,
       "clsBaseVFP::vfpSet() ... marker request without a trace"},
      {kMarkerValueParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) { base.pendingMarker().point = value.toInt32(); }},
      {kCellNamingParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) {
         base.CellNamingEnabled = value.toBoolean();
         base.child_.refreshControls();
       }},
      {kSavedParameter, nullptr,
       [](clsBaseVFP& base, const Variant& value) { base.saved(value.toBoolean()); }},
};

const clsBaseVFP::ParameterRow* clsBaseVFP::findParameter(std::int16_t code) noexcept {
  const auto* const row =
      std::find_if(std::begin(kParameters), std::end(kParameters),
                   [code](const ParameterRow& candidate) { return candidate.code == code; });
  return row == std::end(kParameters) ? nullptr : row;
}

std::int32_t clsBaseVFP::vfpSet(std::int32_t /*hardwareId*/, std::int16_t parameterType,
                                std::int16_t /*index*/, const Variant& value) {
  if (closing_) return kStatusDone;
  return guarded("clsBaseVFP::vfpSet() ... ", kStatusUnusableParameter, [&] {
    if (const ParameterRow* const row = findParameter(parameterType)) return apply(*row, value);
    reportUnhandled(parameterType);
    return kStatusDone;
  });
}

std::int32_t clsBaseVFP::apply(const ParameterRow& row, const Variant& value) {
  if (row.when == ParameterRow::When::OwnsWindow && !windowOwner) return kStatusDone;
  if (row.mustBeNumeric != nullptr && !value.isNumeric()) {
    errorHandler().Assert(row.mustBeNumeric);
    return kStatusUnusableParameter;
  }
  if (row.withoutTrace != nullptr && traceManager_->activeTrace() == nullptr) {
    errorHandler().Assert(row.withoutTrace);
    return kStatusUnusableParameter;
  }
  row.apply(*this, value);
  return kStatusDone;
}

void clsBaseVFP::reportUnhandled(std::int16_t parameterType) {
  if (!warnOnUnhandledParameters) return;
  errorHandler().Assert(child_.typeName() +
                        "::vfpSet() ... unhandled parameterType = " + std::to_string(parameterType));
}

// A place that is no number is an unusable one, but the window is made ready for one all the same.
void clsBaseVFP::placeWindow(void (PanelControl::*place)(float), const Variant& value) {
  child_.ViewVisible(false);
  child_.ViewState(0);
  if (!value.isNumeric()) raiseTypeMismatch();
  (child_.*place)(value.toSingle());
}

// --- Traces

TraceObject& clsBaseVFP::activePainter() {
  if (traceManager_->activeTrace() == nullptr) raiseObjectVariableNotSet();
  return *traceManager_->activeTrace();
}

void clsBaseVFP::addTraceOfPn(double value) {
  TraceObject& painter = activePainter();
  const std::int16_t index =
      painter.addATrace(kUsualTraceMode, nextTracePn_, value, 0, std::nullopt);  // values follow
  if (index < 0) raiseInvalidProcedureCall();
  painter.selectedTraceIndex(index);
}

void clsBaseVFP::selectTrace(std::int16_t resultType) {
  for (const TracePointer& trace : traceManager_->Traces()) {
    if (trace->resultType() != resultType) continue;
    traceManager_->activeTrace(trace);
    child_.refreshControls();
    return;
  }
  raiseInvalidProcedureCall();
}

// --- Markers

void clsBaseVFP::startMarker(std::int32_t number) {
  if (number < 1) raiseInvalidProcedureCall();
  auto marker = std::make_shared<clsMarker>();
  marker->id = markerId(number, false);
  marker_ = std::move(marker);
  markerNumber_ = number;
}

clsMarker& clsBaseVFP::pendingMarker() {
  if (!marker_) raiseObjectVariableNotSet();
  return *marker_;
}

void clsBaseVFP::flagMarker(bool delta) {
  clsMarker& marker = pendingMarker();
  marker.id = markerId(markerNumber_, delta);
  marker.deltaPartner = delta ? markerId(markerNumber_, false) : std::string();
  marker.DELTA = delta;
}

// A delta marker has nothing to differ from without its partner.
MarkerPointer clsBaseVFP::deltaPartner(TraceObject& painter) {
  MarkerPointer partner = findMarker(painter, marker_->deltaPartner);
  if (!partner) raiseInvalidProcedureCall();
  return partner;
}

void clsBaseVFP::attachMarker(std::int16_t pn) {
  clsMarker& marker = pendingMarker();
  TraceObject& painter = activePainter();
  if (findMarker(painter, marker.id)) raiseDuplicateKey();
  const MarkerPointer partner = marker.DELTA ? deltaPartner(painter) : nullptr;
  const std::int16_t count = addInt16(painter.markerCount(), 1);
  const std::int16_t found = painter.findATraceByPN(pn);
  const std::int16_t trace = found >= 0 ? found : painter.selectedTraceIndex();
  painter.traceMarkerCollections(trace).add(marker_, marker.id);
  marker.traceId = trace;
  if (partner) partner->deltaPartner = marker.id;
  painter.markerCount(count);
  child_.deltaMarkerButtonEnabled(!marker.DELTA);
}

void clsBaseVFP::activateMarker() {
  TraceObject& painter = activePainter();
  pendingMarker().active = true;
  painter.activeMarker(marker_);
  painter.mouseActiveMarker(marker_);
}

// --- What is handed over for keeping

PanelSettings clsBaseVFP::settings() {
  PanelSettings settings;
  appendCommonSettings(settings);
  appendTraceSettings(settings);
  child_.appendSettings(settings);
  return settings;
}

// Who the panel is (its ids and caption) and what state it is in (logging, saved) the host tells it anew.
void clsBaseVFP::appendCommonSettings(PanelSettings& settings) {
  settings.push_back({TIME_MEASUREMENT_PERIOD, measurementPeriod});
  settings.push_back({TIME_DATABASE_PERIOD, databasePeriod});
  settings.push_back({TIME_DISPLAY_PERIOD, displayPeriod});
  settings.push_back({kRightPanelParameter, rightPanelVisible()});
  settings.push_back({kBottomPanelParameter, bottomPanelVisible()});
  settings.push_back({kCellNamingParameter, CellNamingEnabled});
}

// Plain markers before delta markers, which need their partners.
void clsBaseVFP::appendTraceSettings(PanelSettings& settings) {
  TraceObject* const painter = traceManager_->activeTrace();
  if (painter == nullptr) return;
  settings.push_back({kXAxisStyleParameter, painter->xAxisStyle()});
  settings.push_back({kYAxisStyleParameter, painter->yAxisStyle()});
  settings.push_back({kVerticalResolutionParameter, painter->verticalResolution()});
  if (const std::optional<double> top = painter->gridScaleTop())
    settings.push_back({kGridTopParameter, *top});
  settings.push_back({kAutoScaleParameter, painter->getAutoScale()});
  for (const bool delta : {false, true}) {
    for (std::int16_t trace = 0; trace < tracesWithMarkers(*painter); ++trace) {
      for (const MarkerPointer& marker : painter->traceMarkerCollections(trace)) {
        if (marker->DELTA != delta) continue;
        const std::string& number = delta ? marker->deltaPartner : marker->id;
        settings.push_back({kNewMarkerParameter, Variant(number).toInt32()});
        if (delta) settings.push_back({kMarkerFlagParameter, true});
        settings.push_back({kMarkerValueParameter, marker->point});
        settings.push_back({kAttachMarkerParameter, painter->pnOffset(trace)});
        if (marker == painter->activeMarker()) settings.push_back({kActiveMarkerParameter, true});
      }
    }
  }
}

}  // namespace frontpanels

// Tarvex and its displays: traces and charts of the sets, and what the fields show of them.
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "framework/support/host_codes.h"
#include "framework/support/numeric.h"
#include "pilot/code_units.h"
#include "pilot/tarvex.h"
#include "traces/result_types.h"

namespace frontpanels {
namespace {

// Room round a plot for its labels, in twips.
struct InsetsTwips {
  float left;
  float top;
  float right;
  float bottom;
};
constexpr InsetsTwips kInsets{720, 360, 180, 315};

constexpr double kSpanOfAllPilots = 511;
constexpr std::int16_t kZoomedTraceType = 2;
constexpr std::int16_t kStartStopAxis = 1;
constexpr std::int32_t kElementsBeforeFirstFrame = 5;
constexpr std::int16_t kDescending = 2;
constexpr std::int16_t kNoOther = 0;
constexpr std::int16_t kWithValue = 1;
// Of the value axis: suffixIs of the chart.
constexpr std::int16_t kDecibels = 1;
constexpr std::int16_t kDecibelMilliwatts = 2;

constexpr double kTraceDbPerDivision = 5;
constexpr double kBarsDbPerDivision = 3;

const char* unitOf(bool withIo) { return withIo ? "dBm" : "dB"; }

// Other panels' lists of pilots are kept under this number.
constexpr std::int16_t kOtherUserListTrace = 15;

}  // namespace

// --- Adding and removing

TraceObject* Tarvex::displayOf(const PilotSetRow& row) { return base().traceManager().find(row.traceId); }

std::int32_t Tarvex::addDisplay(const Variant& resultType) {
  const PilotSetRow* const row =
      resultType.isNumeric() ? pilotSetOfResultType(resultType.toInt32()) : nullptr;
  if (row == nullptr) return kStatusUnusableParameter;
  state(row->set).switchedOff = false;
  if (displayOf(*row) == nullptr) addDisplay(*row);
  refreshTraces();
  return kStatusDone;
}

std::int32_t Tarvex::removeDisplay(const Variant& resultType) {
  const PilotSetRow* const row =
      resultType.isNumeric() ? pilotSetOfResultType(resultType.toInt32()) : nullptr;
  if (row == nullptr) return kStatusUnusableParameter;
  // The user was quicker.
  if (state(row->set).switchedOff && displayOf(*row) == nullptr) return kStatusDone;
  removeDisplay(*row);
  return kStatusDone;
}

void Tarvex::addDisplay(const PilotSetRow& row) {
  clsTraceManager& traces = base().traceManager();
  if (row.bars) {
    const auto bars = std::make_shared<clsBarChartPainter>(gdi());
    setUp(*bars, row.set);
    traces.addTraceObject(bars, row.traceId);
  } else {
    const auto painter = std::make_shared<clsMultiTracePainter>(gdi());
    setUp(*painter, row.set);
    traces.addTraceObject(painter, row.traceId);
    if (row.set == PilotSet::AllPilots) painter->span(kSpanOfAllPilots);
    placeXAxis(*painter, row.set);
  }
  showSet(row, true);
}

void Tarvex::removeDisplay(const PilotSetRow& row) {
  base().traceManager().removeTraceObject(row.traceId);
  showSet(row, false);
  refreshTraces();
}

void Tarvex::showSet(const PilotSetRow& row, bool on) {
  const FlagScope inProgress = changeOption();
  controls()->checkBox(row.checkBox).Value(on ? 1 : 0);
  if (row.set == PilotSet::UserList) fields_.enableUserPnList(on);
}

void Tarvex::switchSet(PilotSet set, bool on) {
  const PilotSetRow& row = pilotSet(set);
  state(set).switchedOff = !on;
  if (!on && displayOf(row) != nullptr) return removeDisplay(row);
  showSet(row, on);
}

template <class Painter>
Painter* Tarvex::findOrAddDisplay(PilotSet set) {
  if (state(set).switchedOff) return nullptr;
  const PilotSetRow& row = pilotSet(set);
  if (displayOf(row) == nullptr) addDisplay(row);
  return dynamic_cast<Painter*>(displayOf(row));
}
template clsMultiTracePainter* Tarvex::findOrAddDisplay(PilotSet set);
template clsBarChartPainter* Tarvex::findOrAddDisplay(PilotSet set);

void Tarvex::setInsets(PlotPainter& painter) const {
  painter.gridScaleLeft(kInsets.left / metrics().twipsPerPixelX);
  painter.gridInsetTop(kInsets.top / metrics().twipsPerPixelY);
  painter.gridScaleRight(kInsets.right / metrics().twipsPerPixelX);
  painter.gridScaleBottom(kInsets.bottom / metrics().twipsPerPixelY);
}

void Tarvex::rescaled() {
  for (const TracePointer& trace : base().traceManager().Traces())
    if (auto* const painter = dynamic_cast<PlotPainter*>(trace.get())) setInsets(*painter);
}

void Tarvex::setUp(clsMultiTracePainter& painter, PilotSet set) {
  setInsets(painter);
  painter.offset(0);
  if (set == PilotSet::ZoomedPilots) painter.traceType(kZoomedTraceType);
  painter.xAxisStyle(kStartStopAxis);
  painter.xPerPoint(1);
  painter.topLabel(pilotSet(set).title);
  painter.autoFormatX(true);
  painter.autoFormatY(true);
  painter.gridScaleTop(0);
  painter.verticalResolution(kTraceDbPerDivision);
  showPower(painter, false);
}

void Tarvex::setUp(clsBarChartPainter& painter, PilotSet set) {
  setInsets(painter);
  painter.drawingArea(this);
  painter.elementsPerValue(kElementsBeforeFirstFrame);
  painter.barSortOrder(kDescending);
  painter.otherIs(kNoOther);
  painter.valueIs(kWithValue);
  painter.setBarsToPaint(set == PilotSet::TopN ? toInt16(fields_.topN.value())
                                               : clsBarChartPainter::kAllBars);
  painter.topLabel(pilotSet(set).title);
  painter.spokenKey("PN");
  painter.gridScaleTop(0);
  painter.verticalResolution(kBarsDbPerDivision);
  painter.CellNameInfo(base().CellNamingEnabled ? cellNames_ : nullptr);
  showPower(painter, false);
}

// A trace begins at the first PN offset of its set, and its points lie one apart.
void Tarvex::placeXAxis(clsMultiTracePainter& painter, PilotSet set) {
  const double startPn = set == PilotSet::ZoomedPilots ? fields_.code.startPn() : 0;
  const double span = painter.span();
  clsNumericEntry& formatter = painter.xAxisFormatter();
  formatter.Clear();
  const bool pn = fields_.code.units() == CodeUnits::Pn;
  pn ? formatter.offsetSuffix() : formatter.chipSuffix();
  formatter.formatScale(pn ? 1 : 1.0 / chipsPerPn(fields_.code.format()));
  painter.xStart(startPn);
  painter.xStop(startPn + span);
}

void Tarvex::showPower(clsBarChartPainter& bars, bool withIo) {
  bars.useOffset(withIo);
  bars.suffixIs(withIo ? kDecibelMilliwatts : kDecibels);
}

void Tarvex::showPower(clsMultiTracePainter& painter, bool withIo) {
  painter.useOffset(withIo);
  clsNumericEntry& formatter = painter.yAxisFormatter();
  formatter.Clear();
  withIo ? formatter.dBmSuffix() : formatter.dBSuffix();
  formatter.suppressSuffix(true);
  painter.yAxisLabel(unitOf(withIo));
}

// --- The active trace and the current chart

void Tarvex::changedTraceConfiguration(TraceState state, TraceObject* activeTrace, std::int16_t resultType) {
  const auto fail = [this](const char* what) {
    report(std::string("changedTraceConfiguration() failed ... ") + what);
  };
  guard("Tarvex::changedTraceConfiguration() failed ... ", [&] {
    if (state == TraceState::Added) {
      if (resultType == 0) return fail("missing result type");
      if (activeTrace == nullptr) return fail("null trace");
      if (pilotSetOfTrace(resultType) == nullptr)
        return fail(isKnownResultType(resultType) ? "unhandled result type" : "unrecognized result type");
    } else if (state != TraceState::Removed) {
      return fail("unrecognized trace state");
    }
    showActiveTrace();
  });
}

// The chart that was active last; when it goes, another one that is left.
void Tarvex::chooseCurrentBars(const TraceObject* activeTrace) {
  if (dynamic_cast<const clsBarChartPainter*>(activeTrace) != nullptr)
    currentBarTrace_ = activeTrace->resultType();
  if (currentBars() != nullptr) return;
  currentBarTrace_ = kNoTrace;
  for (const PilotSetRow& row : pilotSets())
    if (row.bars && displayOf(row) != nullptr) currentBarTrace_ = row.traceId;
}

clsBarChartPainter* Tarvex::currentBars() {
  if (currentBarTrace_ == kNoTrace) return nullptr;
  return dynamic_cast<clsBarChartPainter*>(base().traceManager().find(currentBarTrace_));
}

clsBarChartPainter* Tarvex::userListBars() {
  clsTraceManager& traces = base().traceManager();
  TraceObject* shown = displayOf(pilotSet(PilotSet::UserList));
  if (shown == nullptr) shown = traces.find(kOtherUserListTrace);
  return dynamic_cast<clsBarChartPainter*>(shown);
}

void Tarvex::showActiveTrace() {
  chooseCurrentBars(base().traceManager().activeTrace());
  const bool bars = dynamic_cast<clsBarChartPainter*>(base().traceManager().activeTrace()) != nullptr;
  {
    const FlagScope inProgress = changeOption();
    if (!fields_.barLabelsForMultipath(bars))
      report(
          "changedTraceConfiguration() ... unexpected count in barLabelComboBox ... have all "
          "addItems/removeItems been updated?");
    fields_.enableBarFields(bars);
  }
  if (bars) controls()->control("MarkerFrame").ForeColor(std::nullopt);  // of the trace that was active
  showBarSettings();
  showVerticalAxis();
  showIo();
  markers_.updateMarkerButtons();
  // Bars have no markers.
  controls()->control("MarkerAddButton").Enabled(!bars);
}

// The fields of the bars show the current chart, as far as they can.
void Tarvex::showBarSettings() {
  const clsBarChartPainter* const bars = currentBars();
  const TraceObject* const active = base().traceManager().activeTrace();
  if (bars == nullptr) return;
  const FlagScope inProgress = changeOption();
  fields_.sortBy.value(bars->barSortByMode());
  select(bars->barSortOrder() == 1 ? "SortAscendingOptionButton" : "SortDescendingOptionButton");
  if (active == bars) showBarLabel(bars->otherIs());
  fields_.barChartStyle.value(bars->BarChartStyle());
  if (bars->threshold())
    fields_.threshold.valueNoUpdate(*bars->threshold());
  else
    fields_.threshold.blank();
  CheckBox& names = controls()->checkBox("ShowCellNameCheckBox");
  names.Value(bars->ShowCellName() ? 1 : 0);
  names.Enabled(active == bars && base().CellNamingEnabled);
}

// Hosts know quantities that the list does not offer.
void Tarvex::showBarLabel(std::int16_t otherIs) {
  ItemList& list = *fields_.barLabel.ComboBox();
  for (std::int32_t i = 0; i < list.ListCount(); ++i)
    if (list.item(i).data == otherIs) return fields_.barLabel.value(otherIs);
  list.ListIndex(-1);
}

void Tarvex::showVerticalAxis() {
  const TraceObject* const active = base().traceManager().activeTrace();
  if (active == nullptr) return;
  const FlagScope inProgress = changeOption();
  controls()->checkBox("AutoScaleBox").Value(active->getAutoScale() ? 1 : 0);
  fields_.powerDisplay.value(withIo(*active) ? 1 : 0);
  fields_.verticalScale.valueNoUpdate(active->verticalResolution());
  if (const std::optional<double> top = active->gridScaleTop()) fields_.verticalOffset.valueNoUpdate(*top);
  shownTop_ = active->gridScaleTop();
  shownPerDivision_ = active->verticalResolution();
}

bool Tarvex::withIo(const TraceObject& display) {
  if (const auto* const bars = dynamic_cast<const clsBarChartPainter*>(&display)) return bars->useOffset();
  const auto* const painter = dynamic_cast<const clsMultiTracePainter*>(&display);
  return painter != nullptr && painter->useOffset();
}

void Tarvex::tracesRefreshed() {
  const TraceObject* const active = base().traceManager().activeTrace();
  if (active == nullptr || !active->getAutoScale()) return;
  if (active->gridScaleTop() != shownTop_ || active->verticalResolution() != shownPerDivision_)
    showVerticalAxis();
}

// Of the active trace's set.
void Tarvex::showIo() {
  const TraceObject* const active = base().traceManager().activeTrace();
  const PilotSetRow* const row = active == nullptr ? nullptr : pilotSetOfTrace(active->resultType());
  if (row != nullptr && state(row->set).ioDbm)
    fields_.io.valueNoUpdate(*state(row->set).ioDbm);
  else
    fields_.io.blank();
}

void Tarvex::refreshControls() {
  if (base().closing()) return;
  guard("Tarvex::refreshControls()...", [this] {
    showActiveTrace();
    CellNameInfo(cellNames_);
  });
}

void Tarvex::CellNameInfo(std::shared_ptr<const CellNames> names) {
  cellNames_ = std::move(names);
  for (const PilotSetRow& row : pilotSets())
    if (auto* const bars = dynamic_cast<clsBarChartPainter*>(displayOf(row)))
      bars->CellNameInfo(base().CellNamingEnabled ? cellNames_ : nullptr);
  refreshTraces();
}

// What is counted in code units is written anew.
void Tarvex::showCodeWindow() {
  for (const PilotSetRow& row : pilotSets())
    if (auto* const painter = dynamic_cast<clsMultiTracePainter*>(displayOf(row)))
      placeXAxis(*painter, row.set);
  refreshTraces();
}

}  // namespace frontpanels

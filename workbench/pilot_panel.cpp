#include "workbench/pilot_panel.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <string_view>

#include "framework/support/host_codes.h"
#include "pilot/code_units.h"

namespace frontpanels::workbench {
namespace {

constexpr double kNoSecondId = -1;  // of a cell: its PN offset alone says which it is
constexpr char kPathSeparator = 27;

// Path `index` of a server, as a new panel is subscribed to it.
std::string_view pathOf(PilotServer server, std::size_t index) {
  std::string_view paths = pilotServers()[static_cast<std::size_t>(server)].paths;
  for (; index > 0; --index) paths.remove_prefix(paths.find(kPathSeparator) + 1);
  return paths.substr(0, paths.find(kPathSeparator));
}

// The paths of a server of bars behind that of the total power, in their order.
constexpr std::array<float PilotRecord::*, 6> kColumns = {
    &PilotRecord::pnOffset,        &PilotRecord::peakEcIoDb,       &PilotRecord::delayChips,
    &PilotRecord::aggregateEcIoDb, &PilotRecord::delaySpreadChips, &PilotRecord::aggregateMinusPeakDb,
};

struct SetRow {
  PilotSet set;
  bool PilotTuning::*on;
};
constexpr SetRow kSets[] = {
    {PilotSet::AllPilots, &PilotTuning::allPilots},
    {PilotSet::ZoomedPilots, &PilotTuning::zoomedPilots},
    {PilotSet::TopN, &PilotTuning::topN},
    {PilotSet::UserList, &PilotTuning::userList},
};

// The panel counts one PN offset a point: of a window that is received finer the largest level of each stands
// for it.
PilotLevels onePointAPn(const PilotLevels& levels, const PilotTuning& tuning) {
  const double windowPn = tuning.codeSpan / chipsPerPn(static_cast<std::int16_t>(tuning.codeFormat));
  const std::size_t received = levels.ecIoDb.size();
  const auto points = static_cast<std::size_t>(std::max(1.0, std::ceil(windowPn)));
  if (points >= received) return levels;
  PilotLevels shown{levels.ioDbm, std::vector<float>(points, kGap)};
  for (std::size_t i = 0; i < received; ++i) {
    float& level = shown.ecIoDb[i * points / received];
    level = largerLevel(level, levels.ecIoDb[i]);
  }
  return shown;
}

// Result types of what a new panel shows: all pilots, and the strongest of them.
const std::vector<std::int32_t> kFirstDisplays = {14, 201};

}  // namespace

PilotPanel::PilotPanel(PanelFrame& frame, PanelListener& listener, const StoredPanel* stored)
    : Panel(PanelKind::Pilots, frame, listener, stored),
      names_(Automation::create("FrontPanels.clsCellNameInfo")) {
  showDisplays(stored != nullptr && stored->displays ? *stored->displays : kFirstDisplays);
  set(kCenterFrequencyParameter, receiver_.tuning(PilotTuning{}).carrierHz);
  showFirst(stored);
}

std::vector<std::int32_t> PilotPanel::displays() const {
  const PilotTuning tuning = receiver_.tuning(PilotTuning{});
  std::vector<std::int32_t> on;
  for (const SetRow& row : kSets)
    if (tuning.*row.on) on.push_back(pilotSet(row.set).resultType);
  return on;
}

// Those that are named, and no others.
void PilotPanel::showDisplays(const std::vector<std::int32_t>& resultTypes) {
  const std::vector<std::int32_t> before = shownOnce_ ? displays() : std::vector<std::int32_t>{};
  const auto isIn = [](const std::vector<std::int32_t>& list, std::int32_t value) {
    return std::find(list.begin(), list.end(), value) != list.end();
  };
  for (const PilotSetRow& row : pilotSets()) {
    const bool on = isIn(resultTypes, row.resultType);
    static_cast<void>(receiver_.display(row.resultType, on));
    if (on == isIn(before, row.resultType)) continue;
    operate(on ? kAddTraceOperation : kRemoveTraceOperation, static_cast<std::int32_t>(row.resultType));
  }
  shownOnce_ = true;
}

void PilotPanel::restoreOwn(const StoredPanel& stored) {
  if (stored.displays) showDisplays(*stored.displays);
  if (stored.cells.empty()) return;
  ownNames_ = stored.cells;
  showNames();
}

// The last first: -1 takes the first one out, -2 the second.
void PilotPanel::forgetOwn() {
  const std::vector<std::int32_t> pns = receiver_.tuning(PilotTuning{}).userPns;
  for (std::size_t i = pns.size(); i-- > 0;) {
    const auto index = static_cast<std::int16_t>(-1 - static_cast<std::int32_t>(i));
    if (request(CDMA_CODE_OFFSET, index, pns[i])) set(CDMA_CODE_OFFSET, static_cast<double>(pns[i]), index);
  }
}

bool PilotPanel::request(std::int16_t code, std::int16_t index, double value) {
  return receiver_.request(code, index, value);
}

bool PilotPanel::requestDisplay(std::int32_t resultType, bool on) {
  return receiver_.display(static_cast<std::int16_t>(resultType), on);
}

// The panel hands over its fields; the user's list is the host's to keep, as it was told of each edit.
void PilotPanel::appendOwn(std::vector<StoredSetting>& settings) const {
  std::int16_t index = 0;
  for (const std::int32_t pn : receiver_.tuning(PilotTuning{}).userPns)
    settings.push_back({CDMA_CODE_OFFSET, index++, static_cast<double>(pn)});
}

// --- Frames: the last path of a server completes its set.

void PilotPanel::publishLevels(PilotServer server, const PilotLevels& levels) {
  publish(pathOf(server, 0), static_cast<double>(levels.ioDbm));
  publish(pathOf(server, 1), std::span<const float>(levels.ecIoDb));
}

void PilotPanel::publishBars(PilotServer server, const PilotBars& bars) {
  publish(pathOf(server, 0), static_cast<double>(bars.ioDbm));
  for (std::size_t i = 0; i < kColumns.size(); ++i) {
    column_.clear();
    for (const PilotRecord& pilot : bars.pilots) column_.push_back(pilot.*kColumns[i]);
    publish(pathOf(server, i + 1), std::span<const float>(column_));
  }
}

void PilotPanel::publishCarrier(const CarrierState& carrier) {
  publish(pathOf(PilotServer::Carrier, 0), carrier.frequencyErrorHz);
  publish(pathOf(PilotServer::Carrier, 1), carrier.frequencyState);
  publish(pathOf(PilotServer::Carrier, 2), carrier.onePps);
}

// A set that is switched off stays so, whatever a recording has of it.
bool PilotPanel::show(const Frame& frame) {
  if (!frame.pilots) return false;
  shown_ = *frame.pilots;
  const PilotTuning tuning = receiver_.tuning(PilotTuning{});
  if (!tuning.allPilots) shown_.allPilots.reset();
  if (!tuning.zoomedPilots) shown_.zoomedPilots.reset();
  if (!tuning.topN) shown_.topN.reset();
  if (!tuning.userList) shown_.userList.reset();
  if (shown_.allPilots) publishLevels(PilotServer::AllPilots, *shown_.allPilots);
  if (shown_.zoomedPilots) {
    shown_.zoomedPilots = onePointAPn(*shown_.zoomedPilots, tuning);
    publishLevels(PilotServer::ZoomedPilots, *shown_.zoomedPilots);
  }
  if (shown_.topN) publishBars(PilotServer::TopN, *shown_.topN);
  if (shown_.userList) publishBars(PilotServer::UserList, *shown_.userList);
  if (shown_.carrier) publishCarrier(*shown_.carrier);
  return true;
}

void PilotPanel::meet(const DriveSimulator* simulator) {
  sourceNames_.clear();
  if (simulator != nullptr)
    for (const SiteName& site : simulator->siteNames()) sourceNames_.push_back({site.pnOffset, site.name});
  showNames();
}

void PilotPanel::tune(DriveSimulator& simulator) const { simulator.tune(receiver_.tuning(PilotTuning{})); }

// --- Cells

void PilotPanel::showNames() {
  names_.call("Initialize", {});
  for (const std::vector<CellName>* const list : {&sourceNames_, &ownNames_})
    for (const CellName& cell : *list)
      names_.call("SetCellName", {static_cast<double>(cell.pnOffset), kNoSecondId, cell.name});
  const bool any = !sourceNames_.empty() || !ownNames_.empty();
  if (any) automation().put("CellNameInfo", Value(names_.dispatch()));
  set(kCellNamingParameter, any);
}

std::size_t PilotPanel::addCells(const std::vector<CellName>& cells) {
  std::size_t taken = 0;
  for (const CellName& cell : cells) {
    const auto index = static_cast<std::int16_t>(receiver_.tuning(PilotTuning{}).userPns.size());
    if (!request(CDMA_CODE_OFFSET, index, cell.pnOffset)) continue;
    set(CDMA_CODE_OFFSET, static_cast<double>(cell.pnOffset), index);
    ++taken;
    if (cell.name.empty()) continue;
    std::erase_if(ownNames_, [&cell](const CellName& own) { return own.pnOffset == cell.pnOffset; });
    ownNames_.push_back(cell);
  }
  showNames();
  return taken;
}

}  // namespace frontpanels::workbench

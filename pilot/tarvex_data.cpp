// Tarvex and its data: servers, frames, result records.
#include <algorithm>
#include <cmath>
#include <limits>

#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "pilot/tarvex.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

constexpr std::int32_t kIoPath = 0;
constexpr std::int32_t kTracePath = 1;
// Of multipath servers: the PN offsets follow the total power.
constexpr std::int32_t kFirstColumnPath = 1;

// "12.9" seconds are 12; what is no number is shown as it came.
std::string wholeText(const Variant& value) {
  double number = 0;
  if (!textToNumber(value.toText(), number) || !std::isfinite(number)) return value.toText();
  return numberToText(std::floor(number));
}

std::string plainText(const Variant& value) { return value.toText(); }

// A path that cannot be read to its end spoils the frame that it belongs to.
class ColumnReading {
 public:
  explicit ColumnReading(MultipathFrame& frame) noexcept : frame_(&frame) {}
  ~ColumnReading() {
    if (frame_ != nullptr) frame_->spoil();
  }
  ColumnReading(const ColumnReading&) = delete;
  ColumnReading& operator=(const ColumnReading&) = delete;
  void done() noexcept { frame_ = nullptr; }

 private:
  MultipathFrame* frame_;
};

// By the index of the carrier's paths.
struct CarrierRow {
  const char* label;
  const char* text;
  std::string (*shown)(const Variant& value);
};
constexpr CarrierRow kCarrier[] = {{"CarrierErrorLabel", "Carrier Freq Error = ", plainText},
                                   {"CarrierStateLabel", "Carrier Freq State = ", plainText},
                                   {"onePpsLabel", "1PPS = ", wholeText}};

}  // namespace

// --- Servers

void Tarvex::subscribe(DataHub& hub) {
  for (const PilotServerRow& row : pilotServers()) {
    servers_.push_back(std::make_unique<DataServer>(
        hub, [this, server = row.server](std::int32_t index) { pathChanged(server, index); }));
    paths(row.server, row.paths);
  }
}

const std::string& Tarvex::paths(PilotServer server) const {
  return paths_[static_cast<std::size_t>(server)];
}

void Tarvex::paths(PilotServer server, std::string paths) {
  servers_[static_cast<std::size_t>(server)]->subscribe(paths);
  paths_[static_cast<std::size_t>(server)] = std::move(paths);
}

void Tarvex::pathChanged(PilotServer server, std::int32_t index) {
  if (base().closing()) return;
  const PilotServerRow& row = pilotServers()[static_cast<std::size_t>(server)];
  guard([&row] { return std::string("Tarvex::") + row.property + "_DataChanged()"; },
        [&] {
          const DataServer& source = *servers_[static_cast<std::size_t>(server)];
          if (server == PilotServer::Carrier) return showCarrier(source, index);
          const auto set = static_cast<PilotSet>(server);
          if (index == kIoPath)
            return takeIo(set, source.itemCount(index) == 0 ? Variant() : source.value(index, 0));
          if (pilotSet(set).bars)
            takeColumn(set, source, index);
          else if (index == kTracePath)
            takeLevels(set, readPath(source, index));
        });
}

void Tarvex::showCarrier(const DataServer& source, std::int32_t index) {
  if (index >= static_cast<std::int32_t>(std::size(kCarrier))) return;
  const CarrierRow& row = kCarrier[index];
  const bool known = source.itemCount(index) > 0;
  controls()->control(row.label).Caption(known ? row.text + row.shown(source.value(index, 0))
                                               : std::string());
}

// An empty value: the host has taken it back.
void Tarvex::takeIo(PilotSet set, const Variant& value) {
  double ioDbm = 0;
  if (!value.isEmpty() && !textToNumber(value.toText(), ioDbm)) raiseTypeMismatch();
  state(set).ioDbm = value.isEmpty() ? std::nullopt : std::optional(Variant(ioDbm).toSingle());
  showIo();
}

std::span<const float> Tarvex::readPath(const DataServer& source, std::int32_t index) {
  const std::int32_t items = source.itemCount(index);
  if (const std::span<const float> singles = source.singles(index);
      singles.size() == static_cast<std::size_t>(items))
    return singles;
  values_.clear();
  for (std::int32_t item = 0; item < items; ++item) values_.push_back(source.singleValue(index, item));
  return values_;
}

// --- Frames

void Tarvex::takeLevels(PilotSet set, std::span<const float> levels) {
  SetState& data = state(set);
  if (levels.size() > data.levels.size()) raiseSubscriptOutOfRange();
  std::copy(levels.begin(), levels.end(), data.levels.begin());
  data.points = levels.size();
  showLevels(set);
}

void Tarvex::takeColumn(PilotSet set, const DataServer& source, std::int32_t index) {
  MultipathFrame& frame = state(set).frame;
  const std::int32_t column = index - kFirstColumnPath;
  if (column >= kValuesPerPilot) return;
  ColumnReading reading(frame);
  const std::span<const float> values = readPath(source, index);
  reading.done();
  if (frame.take(column, values)) showBars(set);
}

void Tarvex::showLevels(PilotSet set) {
  auto* const painter = findOrAddDisplay<clsMultiTracePainter>(set);
  if (painter == nullptr) return;
  const SetState& data = state(set);
  const auto points = static_cast<std::int32_t>(data.points);
  painter->numberOfMeasurements(points);
  painter->dataChanged(true);
  painter->span(points);
  painter->trace(std::span(data.levels).first(data.points));
  painter->traceSize(points);
  painter->offset(data.ioDbm.value_or(0));
  placeXAxis(*painter, set);
  completeUpdate();
}

void Tarvex::showBars(PilotSet set) {
  auto* const painter = findOrAddDisplay<clsBarChartPainter>(set);
  if (painter == nullptr) return;
  const std::span<const float> records = state(set).frame.records();
  painter->numberOfMeasurements(static_cast<std::int32_t>(records.size()) / kValuesPerPilot);
  painter->dataChanged(true);
  painter->trace(records);
  painter->elementsPerValue(kValuesPerPilot);
  painter->offset(state(set).ioDbm.value_or(0));
  completeUpdate();
}

void Tarvex::completeUpdate() {
  if (updateCount_ < std::numeric_limits<std::int16_t>::max()) ++updateCount_;
  refreshTraces();
}

void Tarvex::resultData(std::int32_t resultTypeId, ResultReader& reader, clsBaseVFP* /*base*/) {
  const PilotSetRow* const row = pilotSetOfResultType(resultTypeId);
  if (row == nullptr) return;
  guard("Tarvex::resultData()", [&] {
    const float ioDbm = reader.GetMeasurementFloat32();
    values_ = reader.GetFloat32Array();
    if (row->bars)
      state(row->set).frame.takeRecords(values_);
    else if (values_.size() > kMaxPoints)
      raiseSubscriptOutOfRange();
    state(row->set).ioDbm = ioDbm;
    showIo();
    row->bars ? showBars(row->set) : takeLevels(row->set, values_);
  });
}

// --- What the sets hold

std::span<const float> Tarvex::levelsOf(PilotSet set) const {
  return std::span(state(set).levels).first(state(set).points);
}
std::span<const float> Tarvex::AllPilotsData() const { return levelsOf(PilotSet::AllPilots); }
std::span<const float> Tarvex::ZoomedPilotsData() const { return levelsOf(PilotSet::ZoomedPilots); }
std::span<const float> Tarvex::TopNData() const { return state(PilotSet::TopN).frame.records(); }
std::span<const float> Tarvex::UserListData() const { return state(PilotSet::UserList).frame.records(); }

}  // namespace frontpanels

// The pilot panel without a window.
#include <algorithm>

#include "fp-render/panel_picture.h"
#include "framework/support/host_codes.h"
#include "framework/support/utility.h"
#include "pilot/cell_name_info.h"
#include "pilot/code_units.h"
#include "pilot/tarvex.h"
#include "platform/locale.h"
#include "sources/pilot_receiver.h"

namespace frontpanels {
namespace {

// Nobody is there to choose a file.
class NoFileDialogs final : public FileDialogs {
 public:
  std::optional<std::string> openFile(std::string_view) override { return std::nullopt; }
  bool cancelPressed() noexcept override { return false; }
};

// In the order in which the panel's paths carry them.
constexpr float PilotRecord::*kColumns[] = {
    &PilotRecord::pnOffset,        &PilotRecord::peakEcIoDb,       &PilotRecord::delayChips,
    &PilotRecord::aggregateEcIoDb, &PilotRecord::delaySpreadChips, &PilotRecord::aggregateMinusPeakDb,
};

std::vector<std::string> pathsOf(PilotServer server) {
  const std::string_view all = pilotServers()[static_cast<std::size_t>(server)].paths;
  std::vector<std::string> paths;
  for (std::size_t from = 0; from <= all.size();) {
    const std::size_t to = std::min(all.find(DataServer::kPathSeparator, from), all.size());
    paths.emplace_back(all.substr(from, to - from));
    from = to + 1;
  }
  return paths;
}

// Either of the two, whichever the set is of; both null where the frame lacks the set.
struct SetData {
  const PilotLevels* levels = nullptr;
  const PilotBars* bars = nullptr;
};
SetData dataOf(const PilotFrame& frame, PilotSet set) {
  const auto at = [](const auto& data) { return data ? &*data : nullptr; };
  switch (set) {
    case PilotSet::AllPilots:
      return {at(frame.allPilots), nullptr};
    case PilotSet::ZoomedPilots:
      return {at(frame.zoomedPilots), nullptr};
    case PilotSet::TopN:
      return {nullptr, at(frame.topN)};
    case PilotSet::UserList:
      return {nullptr, at(frame.userList)};
  }
  return {};
}

bool hasLevel(const SetData& data) {
  LevelRange range;
  if (data.levels != nullptr) range.add(data.levels->ecIoDb);
  return !range.isEmpty() || (data.bars != nullptr && !data.bars->pilots.empty());
}

class PilotPicture final : public PanelPicture {
 public:
  PilotPicture(const PictureLook& look, const ShownSets& sets)
      : PanelPicture(look),
        sets_(sets),
        panel_(environment(), {dialogs_, systemTextFiles(), separators_}, owner_, owner_) {
    for (const PilotSetRow& row : pilotSets())
      if (shows(row.set) && panel_.vfpOp(0, kAddTraceOperation, row.resultType) != kStatusDone)
        raiseInvalidProcedureCall();
    for (const PilotServerRow& row : pilotServers())
      paths_[static_cast<std::size_t>(row.server)] = pathsOf(row.server);
    open();
  }

  // Without a carrier of its own the panel goes by the receiver's.
  void tune(DriveSimulator& drive) override {
    PilotReceiver receiver;
    for (const StoredSetting& setting : settings())
      if (setting.value.isNumeric())
        static_cast<void>(receiver.request(setting.code, setting.index, setting.value.toDouble()));
    const PilotTuning tuning = receiver.tuning({});
    drive.tune(tuning);
    setOwn(kCenterFrequencyParameter, tuning.carrierHz);
    const auto names = std::make_shared<clsCellNameInfo>();
    for (const SiteName& site : drive.siteNames()) names->SetCellName(site.pnOffset, 0, site.name);
    panel_.CellNameInfo(names);
  }

  void survey(const Frame& frame) override {
    if (!frame.pilots) return;
    for (const PilotSetRow& row : pilotSets())
      if (shows(row.set)) survey(row, dataOf(*frame.pilots, row.set));
  }

  bool show(const Frame& frame) override {
    if (!frame.pilots) return false;
    bool any = false;
    for (const PilotSetRow& row : pilotSets())
      any = any || (shows(row.set) && hasLevel(dataOf(*frame.pilots, row.set)));
    if (!any) return false;
    for (const PilotSetRow& row : pilotSets())
      if (shows(row.set)) publish(row, dataOf(*frame.pilots, row.set));
    publishCarrier(frame.pilots->carrier);
    placeMarkers();
    return true;
  }

 protected:
  FieldPanel& panel() override { return panel_; }
  bool ownScaleWhereItFits() const override { return true; }
  clsMultiTracePainter* markedTrace() override {
    for (const PilotSet set : {PilotSet::AllPilots, PilotSet::ZoomedPilots})
      if (shows(set))
        return dynamic_cast<clsMultiTracePainter*>(panel_.base().traceManager().find(pilotSet(set).traceId));
    return nullptr;
  }

 private:
  [[nodiscard]] bool shows(PilotSet set) const { return sets_[static_cast<std::size_t>(set)]; }
  [[nodiscard]] const std::vector<std::string>& paths(PilotSet set) const {
    return paths_[static_cast<std::size_t>(set)];
  }

  void survey(const PilotSetRow& row, const SetData& data) {
    if (data.levels != nullptr) {
      std::size_t& points = points_[static_cast<std::size_t>(row.set)];
      points = std::max(points, data.levels->ecIoDb.size());
      levels(row.traceId, data.levels->ecIoDb);
    }
    if (data.bars == nullptr) return;
    column(data.bars, &PilotRecord::peakEcIoDb);
    const auto* const chart =
        dynamic_cast<const clsBarChartPainter*>(panel_.base().traceManager().find(row.traceId));
    levels(row.traceId, column_, chart != nullptr && chart->useOffset() ? data.bars->ioDbm : 0.0F);
  }

  void publish(const PilotSetRow& row, const SetData& data) {
    const bool known = data.levels != nullptr || data.bars != nullptr;
    const float ioDbm = data.levels != nullptr ? data.levels->ioDbm : known ? data.bars->ioDbm : 0.0F;
    hub_.publish(paths(row.set)[0], known ? Variant(ioDbm) : Variant());
    row.bars ? publishBars(row, data.bars) : publishLevels(row, data.levels);
  }

  // The axis stays where the set is missing. Of n values the panel spreads n - 1 over the graph's width: the
  // last one, behind its right edge, is a gap, so that the last pilot can be seen.
  void publishLevels(const PilotSetRow& row, const PilotLevels* levels) {
    column_.clear();
    if (levels != nullptr) column_ = levels->ecIoDb;
    column_.resize(std::min(points_[static_cast<std::size_t>(row.set)] + 1, Tarvex::kMaxPoints), kGap);
    hub_.publish(paths(row.set)[1], std::span<const float>(column_));
    if (row.set == PilotSet::ZoomedPilots) spreadOverWindow();
  }

  // Once a window of the code is set the levels lie evenly in it, from its start to its stop.
  void spreadOverWindow() {
    const bool window =
        isSet(kCodeStartParameter) || isSet(kCodeSpanParameter) || isSet(kCodeCenterParameter);
    auto* const trace = dynamic_cast<clsMultiTracePainter*>(
        panel_.base().traceManager().find(pilotSet(PilotSet::ZoomedPilots).traceId));
    if (!window || trace == nullptr || column_.size() <= 2) return;
    const CodeEntries& code = panel_.fields().code;
    trace->xPerPoint(code.span.value() / chipsPerPn(code.format()) /
                     (static_cast<double>(column_.size()) - 2));
    trace->updateXAxisLabels();
  }

  void publishBars(const PilotSetRow& row, const PilotBars* bars) {
    const std::vector<std::string>& paths = this->paths(row.set);
    for (std::size_t i = 0; i < std::size(kColumns); ++i) {
      column(bars, kColumns[i]);
      hub_.publish(paths[i + 1], std::span<const float>(column_));
    }
  }

  void publishCarrier(const std::optional<CarrierState>& carrier) {
    const std::vector<std::string>& paths = paths_[static_cast<std::size_t>(PilotServer::Carrier)];
    const Variant values[] = {carrier ? Variant(carrier->frequencyErrorHz) : Variant(),
                              carrier ? Variant(carrier->frequencyState) : Variant(),
                              carrier ? Variant(carrier->onePps) : Variant()};
    for (std::size_t i = 0; i < std::size(values); ++i) hub_.publish(paths[i], values[i]);
  }

  void column(const PilotBars* bars, float PilotRecord::*member) {
    column_.clear();
    if (bars == nullptr) return;
    for (const PilotRecord& pilot : bars->pilots) column_.push_back(pilot.*member);
  }

  ShownSets sets_;
  NoFileDialogs dialogs_;
  FixedLocale locale_;
  RegionalSeparators separators_{locale_};
  std::array<std::vector<std::string>, kPilotServers> paths_;
  std::array<std::size_t, kPilotSets> points_{};  // the most of any frame, for sets of levels
  std::vector<float> column_;
  Tarvex panel_;
};

}  // namespace

std::unique_ptr<PanelPicture> makePilotPicture(const PictureLook& look, const ShownSets& sets) {
  return std::make_unique<PilotPicture>(look, sets);
}

}  // namespace frontpanels

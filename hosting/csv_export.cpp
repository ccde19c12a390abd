#include "hosting/csv_export.h"

#include <cmath>
#include <string_view>

#include "hosting/file_text.h"
#include "hosting/number_text.h"

namespace frontpanels {
namespace {

constexpr std::string_view kLineEnd = "\r\n";

// A gap, and whatever else is no finite number, is an empty field.
template <class T>
std::string field(T number) {
  return std::isfinite(number) ? exactText(number) : std::string();
}

template <class... Fields>
void addRow(std::string& csv, const std::string& first, const Fields&... more) {
  csv += first;
  ((csv.append(1, ',').append(more)), ...);
  csv += kLineEnd;
}

// One line without quotes, in which no cell that a spreadsheet may cut out of it begins a formula.
std::string headText(std::string_view text) {
  constexpr std::string_view kSeparators = ",;\t";
  constexpr std::string_view kFormulaBegins = "=+-@";
  std::string result;
  bool cellBegins = false;
  for (char c : text) {
    if (c == '"') c = '\'';
    const bool separates = kSeparators.find(c) != kSeparators.npos;
    if (!separates && static_cast<unsigned char>(c) < ' ') c = ' ';
    if (cellBegins && kFormulaBegins.find(c) != kFormulaBegins.npos) result += '\'';
    cellBegins = separates || (cellBegins && c == ' ');
    result += c;
  }
  return result;
}

void addHeadLine(std::string& csv, std::string_view name, std::string_view value) {
  csv.append("# ").append(headText(std::string(name).append(": ").append(value))).append(kLineEnd);
}

std::string headOf(const ExportHeader& header) {
  std::string csv;
  for (const auto& [name, value] : header.entries) addHeadLine(csv, name, value);
  return csv;
}

void beginTable(std::string& csv, std::string_view set) {
  if (!csv.empty()) csv += kLineEnd;
  addHeadLine(csv, "Set", set);
}

void addLevels(std::string& csv, std::string_view set, const std::string& offsetTitle,
               const PilotLevels& levels) {
  beginTable(csv, set);
  addHeadLine(csv, "Io (dBm)", field(levels.ioDbm));
  addRow(csv, offsetTitle, "Ec/Io (dB)", "Ec (dBm)");
  for (std::size_t i = 0; i < levels.ecIoDb.size(); ++i) {
    const float ecIoDb = levels.ecIoDb[i];
    addRow(csv, exactText(i), field(ecIoDb), field(ecIoDb + levels.ioDbm));
  }
}

void addBars(std::string& csv, std::string_view set, const PilotBars& bars) {
  beginTable(csv, set);
  addHeadLine(csv, "Io (dBm)", field(bars.ioDbm));
  addRow(csv, "PN offset", "Peak Ec/Io (dB)", "Delay (chips)", "Aggregate Ec/Io (dB)", "Delay spread (chips)",
         "Aggregate minus peak (dB)", "Peak Ec (dBm)", "Aggregate Ec (dBm)");
  for (const PilotRecord& pilot : bars.pilots)
    addRow(csv, field(pilot.pnOffset), field(pilot.peakEcIoDb), field(pilot.delayChips),
           field(pilot.aggregateEcIoDb), field(pilot.delaySpreadChips), field(pilot.aggregateMinusPeakDb),
           field(pilot.peakEcIoDb + bars.ioDbm), field(pilot.aggregateEcIoDb + bars.ioDbm));
}

std::string stateWord(std::int32_t state) {
  constexpr const char* kWords[] = {"searching", "settling", "locked"};
  const auto place = static_cast<std::uint32_t>(state);
  return place < std::size(kWords) ? kWords[place] : std::to_string(state);
}

void addCarrier(std::string& csv, const CarrierState& carrier) {
  beginTable(csv, "Carrier");
  addRow(csv, "Frequency error (Hz)", "State", "1PPS");
  addRow(csv, field(carrier.frequencyErrorHz), stateWord(carrier.frequencyState), field(carrier.onePps));
}

}  // namespace

void addSettings(ExportHeader& header, PanelKind panel, std::span<const StoredSetting> settings) {
  for (const StoredSetting& setting : settings) {
    const std::string_view name = settingName(panel, setting.code);
    header.entries.emplace_back(name.empty() ? "Setting " + exactText(setting.code) : std::string(name),
                                settingValueText(setting.value));
  }
}

std::string sweepCsv(const ExportHeader& header, const DisplaySweep& sweep) {
  std::string csv = headOf(header);
  addRow(csv, "Frequency (Hz)", "Level (dB)");
  if (sweep.count < 3) return csv;
  const std::size_t last = sweep.count - 2;  // the value behind it lies beyond the right edge
  const double startHz = sweep.range.centerHz - sweep.range.spanHz / 2;
  for (std::size_t i = 0; i <= last; ++i) {
    const double offsetHz = sweep.range.spanHz * static_cast<double>(i) / static_cast<double>(last);
    addRow(csv, field(startHz + offsetHz), field(sweep.values[i]));
  }
  return csv;
}

std::string pilotsCsv(const ExportHeader& header, const PilotFrame& frame) {
  std::string csv = headOf(header);
  if (frame.allPilots) addLevels(csv, "All pilots", "PN offset", *frame.allPilots);
  if (frame.zoomedPilots) addLevels(csv, "Zoomed pilots", "Point", *frame.zoomedPilots);
  if (frame.topN) addBars(csv, "Top N", *frame.topN);
  if (frame.userList) addBars(csv, "User list", *frame.userList);
  if (frame.carrier) addCarrier(csv, *frame.carrier);
  return csv;
}

}  // namespace frontpanels

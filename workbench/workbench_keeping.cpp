// What is kept from one run to the next, and what is handed out.
#include <windows.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <filesystem>
#include <sstream>

#include "framework/support/host_codes.h"
#include "hosting/number_text.h"
#include "hosting/report_page.h"
#include "hosting/whole_file.h"
#include "pilot/import_list_parser.h"
#include "platform/win32/utf16.h"
#include "platform/win32/win32_locale.h"
#include "workbench/failure.h"
#include "workbench/pilot_panel.h"
#include "workbench/program_files.h"
#include "workbench/questions.h"
#include "workbench/spectrum_panel.h"
#include "workbench/window_picture.h"
#include "workbench/workbench.h"

namespace frontpanels::workbench {
namespace {

constexpr FileFilter kPictures = L"Pictures (*.png)\0*.png\0";
constexpr FileFilter kValues = L"Comma-separated values (*.csv)\0*.csv\0";
constexpr FileFilter kReports = L"Web pages (*.html)\0*.html\0";
constexpr FileFilter kLists = L"Text files (*.txt;*.csv)\0*.txt;*.csv\0All files (*.*)\0*.*\0";

constexpr std::array<const char*, 4> kSides = {"left", "top", "right", "bottom"};
constexpr std::array<LONG RECT::*, 4> kRectSides = {&RECT::left, &RECT::top, &RECT::right, &RECT::bottom};
constexpr std::array<const char*, 3> kArrangements = {"side by side", "stacked", "by user"};
constexpr std::string_view kPropertyPrefix = "property ";
constexpr std::string_view kCellPrefix = "cell ";

void keep(SettingsSection& section, const RECT& place) {
  for (std::size_t i = 0; i < kSides.size(); ++i)
    section.set(kSides[i], static_cast<std::int32_t>(place.*kRectSides[i]));
}

// Nothing when a side is missing or nothing is left between two of them.
std::optional<RECT> keptPlace(const SettingsSection& section) {
  RECT place{};
  for (std::size_t i = 0; i < kSides.size(); ++i) {
    const auto side = section.get<std::int32_t>(kSides[i]);
    if (!side) return std::nullopt;
    place.*kRectSides[i] = *side;
  }
  if (place.right <= place.left || place.bottom <= place.top) return std::nullopt;
  return place;
}

// What does not read as a number ends the list.
std::vector<std::int32_t> numbersOf(const std::string& text) {
  std::istringstream words(text);
  std::vector<std::int32_t> numbers;
  for (std::int32_t number = 0; words >> number;) numbers.push_back(number);
  return numbers;
}

std::string textOf(const std::vector<std::int32_t>& numbers) {
  std::string text;
  for (const std::int32_t number : numbers) text += (text.empty() ? "" : " ") + std::to_string(number);
  return text;
}

std::string setUpName(PanelKind kind, int number) {
  return std::string(panelWord(kind)) + " set-up " + std::to_string(number);
}

}  // namespace

// --- The settings file

void Workbench::loadSettings() {
  settingsPath_ = options_.settingsFile;
  // Unattended runs that name no file leave the user's own alone.
  if (settingsPath_.empty() && !options_.exit) settingsPath_ = usersSettingsFile();
  if (settingsPath_.empty()) return;
  LoadedSettings loaded = frontpanels::loadSettings(settingsPath_);
  settings_ = std::move(loaded.settings);
  settingsMayBeReplaced_ = loaded.mayBeReplaced;
  if (!loaded.problem.empty()) report(loaded.problem);
}

bool Workbench::saveSettings() {
  if (settingsPath_.empty() || !settingsMayBeReplaced_) return false;
  keepWindow();
  keepSource();
  for (const auto& panel : panels_) attempt([&] { keepPanel(*panel); });
  frontpanels::saveSettings(settingsPath_, settings_);
  return true;
}

void Workbench::saveSettingsNow() {
  window_.status(StatusPart::Message,
                 saveSettings() ? "Settings saved" : "Settings are not kept in this run");
}

void Workbench::keepWindow() {
  WINDOWPLACEMENT placement{};
  placement.length = sizeof placement;
  GetWindowPlacement(window_.handle(), &placement);
  SettingsSection& section = settings_.section("window");
  keep(section, placement.rcNormalPosition);
  section.set("maximised",
              placement.showCmd == SW_SHOWMAXIMIZED ||
                  (placement.showCmd == SW_SHOWMINIMIZED && placement.flags == WPF_RESTORETOMAXIMIZED));
  section.set("panels", kArrangements[static_cast<std::size_t>(window_.arrangement())]);
  section.set("messages", window_.messagesShown());
}

// Without a source the one that is remembered stays so: it may come back.
void Workbench::keepSource() {
  SettingsSection& source = settings_.section("source");
  source.set("frames a second", static_cast<std::int32_t>(kSweepsASecond.at(rate_)));
  source.set("loop", player_.loop());
  if (player_.source() == nullptr) return;
  source.erase("recording");
  source.erase("simulated drive");
  if (simulator_ != nullptr) source.set("simulated drive", std::to_string(seed_));
  if (!openedPath_.empty()) source.set("recording", openedPath_);
}

// A place on a screen that is no longer there is brought back by the window system.
void Workbench::placeWindow() {
  if (const SettingsSection* const section = settings_.find("window")) {
    if (const auto place = keptPlace(*section)) {
      WINDOWPLACEMENT placement{};
      placement.length = sizeof placement;
      placement.rcNormalPosition = *place;
      placement.showCmd = SW_HIDE;
      SetWindowPlacement(window_.handle(), &placement);
    }
    showMaximised_ = section->get<bool>("maximised").value_or(false);
    const std::string arrangement = section->get<std::string>("panels").value_or("");
    const auto found = std::find(kArrangements.begin(), kArrangements.end(), arrangement);
    if (found != kArrangements.end())
      window_.arrange(static_cast<Arrangement>(found - kArrangements.begin()));
    if (section->get<bool>("messages").value_or(false)) window_.showMessages(true);
  }
  if (const SettingsSection* const source = settings_.find("source")) {
    const auto rate =
        std::find(kSweepsASecond.begin(), kSweepsASecond.end(),
                  static_cast<unsigned>(source->get<std::int32_t>("frames a second").value_or(0)));
    if (rate != kSweepsASecond.end()) rate_ = static_cast<std::size_t>(rate - kSweepsASecond.begin());
    // Unattended, a loop would never end.
    player_.loop(!options_.exit && source->get<bool>("loop").value_or(false));
  }
}

// --- Panels

void Workbench::keepPanel(Panel& panel) {
  SettingsSection& section = settings_.section(panelWord(panel.kind()));
  section.set("open", true);
  keep(section, panel.boundsTwips());
  for (const auto& [name, value] : panel.properties())
    section.set(std::string(kPropertyPrefix) + name, settingValueText(value));
  section.set("displays", textOf(panel.displays()));
  section.set("tuned", panel.tuned());
  for (const CellName& cell : panel.cells())
    section.set(std::string(kCellPrefix) + std::to_string(cell.pnOffset), cell.name);
  section.settings(panel.settings());
}

std::optional<StoredPanel> Workbench::storedPanel(PanelKind kind) const {
  return storedPanel(std::string(panelWord(kind)));
}

std::optional<StoredPanel> Workbench::storedPanel(const std::string& name) const {
  const SettingsSection* const section = settings_.find(name);
  if (section == nullptr) return std::nullopt;
  StoredPanel stored;
  stored.boundsTwips = keptPlace(*section);
  stored.settings = section->settings();
  if (const auto displays = section->get<std::string>("displays")) stored.displays = numbersOf(*displays);
  for (const auto& [key, text] : section->values()) {
    if (key.starts_with(kPropertyPrefix)) {
      if (const std::optional<Variant> value = parseSettingValue(text))
        stored.properties.emplace_back(key.substr(kPropertyPrefix.size()), *value);
    } else if (key.starts_with(kCellPrefix)) {
      if (const auto pn = exactNumber<std::int32_t>(std::string_view(key).substr(kCellPrefix.size())))
        stored.cells.push_back({*pn, text});
    }
  }
  return stored;
}

// Whether the source is the one that the settings were kept with, and was tuned in.
bool Workbench::sourceIsKept() const {
  const SettingsSection* const source = settings_.find("source");
  const SettingsSection* const spectrum = settings_.find(panelWord(PanelKind::Spectrum));
  if (source == nullptr || spectrum == nullptr || !spectrum->get<bool>("tuned").value_or(false)) return false;
  if (simulator_ != nullptr) return source->get<std::string>("simulated drive") == std::to_string(seed_);
  return !openedPath_.empty() && source->get<std::string>("recording") == openedPath_;
}

void Workbench::settingsHanded(PanelKind kind, std::optional<std::int32_t> setUp,
                               std::vector<StoredSetting> settings) {
  SettingsSection& section =
      settings_.section(setUp ? setUpName(kind, *setUp) : std::string(panelWord(kind)));
  section.settings(std::move(settings));
  if (const Panel* const handing = panel(kind)) section.set("displays", textOf(handing->displays()));
}

void Workbench::restoreSettings() {
  for (const auto& panel : panels_)
    if (const auto stored = storedPanel(panel->kind())) panel->restore(*stored);
  receiveAnew();
  window_.status(StatusPart::Message, "Settings restored");
}

// Set-ups are counted from 1, the rows of the menu from 0.
bool Workbench::hasSetUp(int number) const {
  return std::any_of(kPanelKinds.begin(), kPanelKinds.end(), [&](const PanelKindRow& row) {
    return settings_.find(setUpName(row.kind, number + 1)) != nullptr;
  });
}

void Workbench::saveSetUp(int number) {
  for (const auto& panel : panels_) panel->saveSetUp(number + 1);
  const bool saved = saveSettings();
  window_.status(StatusPart::Message, "Set-up " + std::to_string(number + 1) +
                                          (saved ? " saved" : " is kept until the end of this run"));
}

void Workbench::restoreSetUp(int number) {
  for (const auto& panel : panels_)
    if (const auto kept = storedPanel(setUpName(panel->kind(), number + 1))) panel->restore(*kept);
  receiveAnew();
  takeScreenshots();
  window_.status(StatusPart::Message, "Set-up " + std::to_string(number + 1) + " restored");
}

// A line a cell: its PN offset, then its name, divided by the user's list separator. The file is read whole
// before anything is changed.
void Workbench::importCells() {
  constexpr double kLargestPn = 511;
  const auto path = askForFileToOpen(window_.handle(), L"Import cells", kLists);
  auto* const pilots = static_cast<PilotPanel*>(panel(PanelKind::Pilots));
  if (!path || pilots == nullptr) return;
  Win32Locale locale;
  RegionalSeparators separators(locale);
  ImportListParser parser(files_, separators);
  parser.FileOpen(*path);
  std::vector<CellName> cells;
  while (parser.ParseEntry()) {
    double pn = 0;
    if (!textToNumber(parser.GetArg(0), pn) || pn < 0 || pn > kLargestPn || pn != std::floor(pn))
      throw HostFailure(*path + ": line " + std::to_string(cells.size() + 1) +
                        " has no PN offset from 0 to 511: \"" + parser.GetArg(0) + "\"");
    cells.push_back({static_cast<std::int32_t>(pn), parser.GetArg(1)});
  }
  const std::size_t taken = pilots->addCells(cells);
  receiveAnew();
  window_.status(StatusPart::Message,
                 std::to_string(taken) + " of " + std::to_string(cells.size()) + " cells imported");
}

// --- Exports

// Unasked, no export takes the place of another.
std::optional<std::string> Workbench::exportName(std::string_view stem, const wchar_t* extension,
                                                 const wchar_t* filter) const {
  const std::string name = std::string(stem) + " " + stampForNames();
  const std::string end = "." + toUtf8(extension);
  if (options_.exportFolder.empty())
    return askForFileToSave(window_.handle(), L"Export", filter, extension, name + end);
  std::string path = fileIn(options_.exportFolder, name + end);
  for (int number = 2; std::filesystem::exists(toUtf16(path)); ++number)
    path = fileIn(options_.exportFolder, name + " " + std::to_string(number) + end);
  return path;
}

void Workbench::exported(const std::string& path) {
  window_.status(StatusPart::Message, fileName(path) + " saved");
}

ExportHeader Workbench::exportHeader(Panel& panel) const {
  ExportHeader header;
  header.entries.emplace_back("exported", stamp());
  if (player_.frameNumber() > 0) {
    header.entries.emplace_back("source", player_.source()->name());
    header.entries.emplace_back("frame", std::to_string(player_.frameNumber()));
    header.entries.emplace_back("time", player_.frame().time);
  }
  for (const StoredSetting& setting : panel.settings()) {
    const std::string_view name = settingName(panel.kind(), setting.code);
    if (!name.empty() && !setting.value.isArray()) header.entries.emplace_back(name, setting.value.toText());
  }
  return header;
}

// The panel may be closed while the user is asked for a name.
void Workbench::exportPicture() {
  if (activePanel() == nullptr) return;
  const PanelKind kind = activePanel()->kind();
  const auto path = exportName(panelWord(kind), L"png", kPictures);
  Panel* const exporting = panel(kind);
  if (!path || exporting == nullptr) return;
  exporting->savePicture(*path);
  exported(*path);
}

void Workbench::exportWindow() {
  const auto path = exportName("window", L"png", kPictures);
  if (!path) return;
  saveWindowPicture(window_.handle(), *path);
  exported(*path);
}

void Workbench::exportValues() {
  if (activePanel() == nullptr) return;
  const PanelKind kind = activePanel()->kind();
  const auto path = exportName(panelWord(kind), L"csv", kValues);
  Panel* const exporting = panel(kind);
  if (!path || exporting == nullptr) return;
  const ExportHeader header = exportHeader(*exporting);
  saveWhole(*path, kind == PanelKind::Spectrum
                       ? sweepCsv(header, static_cast<SpectrumPanel*>(exporting)->shown())
                       : pilotsCsv(header, static_cast<PilotPanel*>(exporting)->shown()));
  exported(*path);
}

void Workbench::exportReport() {
  const auto path = exportName("report", L"html", kReports);
  if (!path) return;
  std::vector<ReportPart> parts;
  for (const auto& panel : panels_) parts.push_back({panelKind(panel->kind()).caption, panel->reportHtml()});
  saveWhole(*path, reportPage("Front Panels report", stamp(), parts));
  exported(*path);
}

}  // namespace frontpanels::workbench

#include "workbench/workbench.h"

#include <windows.h>

#include <algorithm>
#include <iterator>
#include <utility>

#include "framework/support/host_codes.h"
#include "frontpanels_version.h"
#include "hosting/number_text.h"
#include "platform/win32/utf16.h"
#include "workbench/console.h"
#include "workbench/failure.h"
#include "workbench/program_files.h"
#include "workbench/resource_ids.h"

namespace frontpanels::workbench {
namespace {

const char* const kHelp =
    "Ctrl+O opens a recording, Ctrl+D a simulated drive.\n"
    "F5 plays, F6 pauses, F7 takes one frame, Shift+F7 goes one back, F8 begins anew, Ctrl+G goes to the "
    "slider, Ctrl+L plays in a loop.\n"
    "F9 records what is played. Ctrl+E exports the picture of a panel, Ctrl+Shift+E its values, Ctrl+W the "
    "picture "
    "of the window, Ctrl+R a report; Ctrl+Shift+D begins another simulated drive.\n\n"
    "Ctrl+1 and Ctrl+2 open and close the panels, Ctrl+F6 goes to the next one, Ctrl+F4 closes it, Alt+- "
    "opens "
    "the menu of its window, Ctrl+P its own menu.\n"
    "Ctrl+M shows the messages, Ctrl+S saves the settings.\n\n"
    "In a graph: left and right move a marker, P and N go to peaks, D makes a delta marker.";

}  // namespace

// --- Commands

struct Workbench::Command {
  UINT id;
  void (Workbench::*run)();
  // Whether the menu offers it now, and shows a check mark.
  bool (*offered)(const Workbench& self);
  bool (*checked)(const Workbench& self);
};

// Those of a row of the menu that stand for one number each, from 0.
struct Workbench::Numbered {
  UINT first;
  UINT last;
  void (Workbench::*run)(int number);
  bool (*offered)(const Workbench& self, int number);
  bool (*checked)(const Workbench& self, int number);
};

namespace {

constexpr auto kAlways = [](const auto&) { return true; };
constexpr auto kNever = [](const auto&) { return false; };
constexpr auto kAnyNumber = [](const auto&, int) { return true; };
constexpr auto kNoNumber = [](const auto&, int) { return false; };

}  // namespace

const Workbench::Command Workbench::kCommands[] = {
    {IDM_FILE_OPEN, &Workbench::askForRecording, kAlways, kNever},
    {IDM_FILE_SIMULATE, &Workbench::simulateAgain, kAlways,
     [](const Workbench& self) { return self.simulator_ != nullptr; }},
    {IDM_FILE_SIMULATE_OTHER, &Workbench::simulateOther, kAlways, kNever},
    {IDM_FILE_RECORD, &Workbench::toggleRecording,
     [](const Workbench& self) { return self.player_.state() != FramePlayer::State::Empty; },
     [](const Workbench& self) { return self.capture_.has_value(); }},
    {IDM_EXPORT_PICTURE, &Workbench::exportPicture,
     [](const Workbench& self) { return self.activePanel() != nullptr; }, kNever},
    {IDM_EXPORT_WINDOW, &Workbench::exportWindow, kAlways, kNever},
    {IDM_EXPORT_VALUES, &Workbench::exportValues,
     [](const Workbench& self) { return self.activePanel() != nullptr; }, kNever},
    {IDM_EXPORT_REPORT, &Workbench::exportReport, [](const Workbench& self) { return !self.panels_.empty(); },
     kNever},
    {IDM_FILE_EXIT, &Workbench::quit, kAlways, kNever},
    {IDM_PANELS_SIDE_BY_SIDE, &Workbench::sideBySide, kAlways,
     [](const Workbench& self) { return self.window_.arrangement() == Arrangement::SideBySide; }},
    {IDM_PANELS_STACKED, &Workbench::stacked, kAlways,
     [](const Workbench& self) { return self.window_.arrangement() == Arrangement::Stacked; }},
    {IDM_PANELS_NEXT, &Workbench::nextPanel, [](const Workbench& self) { return self.panels_.size() > 1; },
     kNever},
    {IDM_PANELS_CLOSE, &Workbench::closeActive,
     [](const Workbench& self) { return self.activePanel() != nullptr; }, kNever},
    {IDM_PANELS_POP_UP, &Workbench::popUpOfActive,
     [](const Workbench& self) { return self.activePanel() != nullptr; }, kNever},
    {IDM_PANELS_PLAYBACK, &Workbench::playbackOnly,
     [](const Workbench& self) {
       const Panel* const active = self.activePanel();
       return active != nullptr && !active->isPlayback();
     },
     [](const Workbench& self) {
       const Panel* const active = self.activePanel();
       return active != nullptr && active->isPlayback();
     }},
    {IDM_PANELS_MESSAGES, &Workbench::toggleMessages, kAlways,
     [](const Workbench& self) { return self.window_.messagesShown(); }},
    {IDM_PANELS_CLEAR_MESSAGES, &Workbench::clearMessages, kAlways, kNever},
    {IDM_SOURCE_PLAY, &Workbench::play,
     [](const Workbench& self) {
       return self.player_.state() == FramePlayer::State::Paused ||
              self.player_.state() == FramePlayer::State::Ended;
     },
     kNever},
    {IDM_SOURCE_PAUSE, &Workbench::pause,
     [](const Workbench& self) { return self.player_.state() == FramePlayer::State::Playing; }, kNever},
    {IDM_SOURCE_STEP, &Workbench::step,
     [](const Workbench& self) {
       return self.player_.state() == FramePlayer::State::Paused ||
              self.player_.state() == FramePlayer::State::Playing;
     },
     kNever},
    {IDM_SOURCE_STEP_BACK, &Workbench::stepBack,
     [](const Workbench& self) { return self.player_.frameNumber() > 1; }, kNever},
    {IDM_SOURCE_RESTART, &Workbench::restart,
     [](const Workbench& self) { return self.player_.state() != FramePlayer::State::Empty; }, kNever},
    {IDM_SOURCE_LOOP, &Workbench::toggleLoop, kAlways,
     [](const Workbench& self) { return self.player_.loop(); }},
    {IDM_SOURCE_GO_TO, &Workbench::goTo,
     [](const Workbench& self) { return self.player_.frameCount().has_value(); }, kNever},
    {IDM_SETTINGS_SAVE, &Workbench::saveSettingsNow, kAlways, kNever},
    {IDM_SETTINGS_RESTORE, &Workbench::restoreSettings,
     [](const Workbench& self) { return !self.panels_.empty(); }, kNever},
    {IDM_IMPORT_CELLS, &Workbench::importCells,
     [](const Workbench& self) { return self.panel(PanelKind::Pilots) != nullptr; }, kNever},
    {IDM_HELP_KEYS, &Workbench::keys, kAlways, kNever},
    {IDM_HELP_ABOUT, &Workbench::about, kAlways, kNever},
    {IDM_LATER, &Workbench::doLater, kAlways, kNever},
};

const Workbench::Numbered Workbench::kNumbered[] = {
    {IDM_PANELS_FIRST, IDM_PANELS_LAST, &Workbench::togglePanel, kAnyNumber,
     [](const Workbench& self, int number) {
       return self.panel(kPanelKinds[static_cast<std::size_t>(number)].kind) != nullptr;
     }},
    {IDM_RATE_FIRST, IDM_RATE_LAST, &Workbench::rate, kAnyNumber,
     [](const Workbench& self, int number) { return self.rate_ == static_cast<std::size_t>(number); }},
    {IDM_SAVE_SET_UP_FIRST, IDM_SAVE_SET_UP_LAST, &Workbench::saveSetUp,
     [](const Workbench& self, int) { return !self.panels_.empty(); },
     [](const Workbench& self, int number) { return self.hasSetUp(number); }},
    {IDM_RESTORE_SET_UP_FIRST, IDM_RESTORE_SET_UP_LAST, &Workbench::restoreSetUp,
     [](const Workbench& self, int number) { return self.hasSetUp(number) && !self.panels_.empty(); },
     kNoNumber},
    {IDM_POP_UP_FIRST, IDM_POP_UP_LAST, &Workbench::popUpClick, kAnyNumber, kNoNumber},
};

void Workbench::command(UINT id) {
  if (id == IDM_CANCEL) {
    cancelled_ = true;
    return;
  }
  // While a recording is read the window lives, but what it is asked for comes after that; ending ends both.
  if (reading_ && id != IDM_LATER) {
    cancelled_ = cancelled_ || id == IDM_FILE_EXIT;
    if (id == IDM_FILE_EXIT) later([this] { quit(); });
    return;
  }
  for (const Command& row : kCommands)
    if (row.id == id && row.offered(*this)) (this->*row.run)();
  for (const Numbered& row : kNumbered) {
    const int number = static_cast<int>(id) - static_cast<int>(row.first);
    if (id >= row.first && id <= row.last && row.offered(*this, number)) (this->*row.run)(number);
  }
  if (!reading_) showMessages();
}

void Workbench::menuOpening(HMENU menu) {
  const auto show = [menu](UINT id, bool offered, bool checked) {
    EnableMenuItem(menu, id, MF_BYCOMMAND | (offered ? MF_ENABLED : MF_GRAYED));
    CheckMenuItem(menu, id, MF_BYCOMMAND | (checked ? MF_CHECKED : MF_UNCHECKED));
  };
  for (const Command& row : kCommands) show(row.id, !reading_ && row.offered(*this), row.checked(*this));
  for (const Numbered& row : kNumbered) {
    if (row.first == IDM_POP_UP_FIRST) continue;
    for (UINT id = row.first; id <= row.last; ++id) {
      const int number = static_cast<int>(id - row.first);
      show(id, !reading_ && row.offered(*this, number), row.checked(*this, number));
    }
  }
}

// --- Beginning and ending

Workbench::Workbench(Options options, TextFiles& files)
    : options_(std::move(options)), files_(files), window_(*this) {}

// The panels go before the window that they live in.
Workbench::~Workbench() { panels_.clear(); }

ExitCode Workbench::run(int showCommand) {
  loadSettings();
  placeWindow();
  window_.show(showMaximised_ && showCommand != SW_SHOWMINNOACTIVE ? SW_SHOWMAXIMIZED : showCommand);
  showStatus();
  const bool started = start();
  if (options_.exit && !started) return exitCode_;
  return static_cast<ExitCode>(window_.runMessageLoop());
}

void Workbench::attempt(const std::function<void()>& body) {
  try {
    body();
  } catch (const NotRegistered&) {
    exitCode_ = ExitCode::NotRegistered;
    report(currentFailure());
  } catch (...) {
    if (exitCode_ == ExitCode::Done) exitCode_ = ExitCode::Failed;
    report(currentFailure());
  }
}

// Each step by itself: without a panel a recording can still be opened, and the other way round.
bool Workbench::start() {
  attempt([this] { openFirstSource(); });
  for (const PanelKind kind : firstPanels())
    if (exitCode_ != ExitCode::NotRegistered) attempt([this, kind] { openPanel(kind); });
  if (!options_.record.empty()) attempt([this] { record(options_.record); });
  const bool whole = exitCode_ == ExitCode::Done;
  if (whole) attempt([this] { play(); });
  return whole;
}

std::vector<PanelKind> Workbench::firstPanels() const {
  if (options_.panels) return *options_.panels;
  std::vector<PanelKind> panels;
  const bool asBefore =
      options_.recording.empty() && !options_.simulate && settings_.find("window") != nullptr;
  for (const PanelKindRow& row : kPanelKinds) {
    const SettingsSection* const kept = settings_.find(panelWord(row.kind));
    const FrameSource* const source = player_.source();
    const bool wanted = row.kind == PanelKind::Spectrum ? source == nullptr || source->hasSweeps()
                                                        : source != nullptr && source->hasPilots();
    if (asBefore ? kept != nullptr && kept->get<bool>("open").value_or(false) : wanted)
      panels.push_back(row.kind);
  }
  return panels;
}

// What is remembered may be gone: there is always the recording that the program carries.
void Workbench::openFirstSource() {
  if (options_.simulate) return simulate(*options_.simulate);
  if (!options_.recording.empty()) return static_cast<void>(openRecording(options_.recording));
  if (const SettingsSection* const source = settings_.find("source")) {
    const auto seed = exactNumber<std::uint64_t>(source->get<std::string>("simulated drive").value_or(""));
    // Unattended, a drive without an end would be one.
    if (seed && (!options_.exit || options_.sweeps)) return simulate(*seed);
    const auto recording = source->get<std::string>("recording");
    bool opened = false;
    if (recording) attempt([&] { opened = openRecording(*recording); });
    if (opened) return;
  }
  openRecording(carriedRecording());
}

// Whatever cannot be saved is named; the program ends all the same.
void Workbench::quit() {
  stopRecording();
  attempt([this] { saveSettings(); });
  end(exitCode_);
}

void Workbench::finishUnattended() {
  if (framesTaken_ == 0) {
    report(player_.source()->name() + ": there is no sweep in it");
    exitCode_ = ExitCode::Failed;
  }
  quit();
}

void Workbench::end(ExitCode code) noexcept { PostQuitMessage(static_cast<int>(code)); }

// --- Panels

Panel* Workbench::panel(PanelKind kind) const {
  const auto found = std::find_if(panels_.begin(), panels_.end(),
                                  [kind](const auto& panel) { return panel->kind() == kind; });
  return found == panels_.end() ? nullptr : found->get();
}

Panel* Workbench::activePanel() const {
  const PanelWindow* const active = window_.activePanel();
  const auto found = std::find_if(panels_.begin(), panels_.end(),
                                  [active](const auto& panel) { return &panel->window() == active; });
  return found == panels_.end() ? nullptr : found->get();
}

void Workbench::togglePanel(int number) {
  const PanelKind kind = kPanelKinds[static_cast<std::size_t>(number)].kind;
  panel(kind) != nullptr ? closePanel(kind) : openPanel(kind);
}

void Workbench::openPanel(PanelKind kind) {
  if (panel(kind) != nullptr) return;
  // Asked first: of the library's classes the panel is the one that the user knows.
  registeredClass(panelKind(kind).progId);
  if (!messages_) messages_.emplace();
  const std::optional<StoredPanel> stored = storedPanel(kind);
  Panel& opened =
      *panels_.emplace_back(workbench::openPanel(kind, window_, *this, stored ? &*stored : nullptr));
  window_.panelsChanged();
  opened.meet(simulator_);
  // Where another source was tuned to says nothing of this one.
  if (!stored || !sourceIsKept()) opened.forgetTuning();
  if (capture_) opened.logging(true);
  receiveAnew();
  showMessages();
}

// One that cannot say what is to be kept goes all the same.
void Workbench::closePanel(PanelKind kind) {
  const auto found = std::find_if(panels_.begin(), panels_.end(),
                                  [kind](const auto& panel) { return panel->kind() == kind; });
  if (found == panels_.end()) return;
  attempt([&] { keepPanel(**found); });
  settings_.section(panelWord(kind)).set("open", false);
  // Nobody finds it among the others while it goes.
  const std::unique_ptr<Panel> closed = std::move(*found);
  panels_.erase(found);
  window_.panelsChanged();
}

void Workbench::closeActive() {
  if (const Panel* const active = activePanel()) closePanel(active->kind());
}

void Workbench::playbackOnly() {
  if (Panel* const active = activePanel()) active->playback();
}

void Workbench::toggleMessages() {
  const bool shown = !window_.messagesShown();
  window_.showMessages(shown);
  if (shown) window_.messages().focus();
}

void Workbench::clearMessages() {
  window_.messages().clear();
  window_.status(StatusPart::Message, "");
}

// --- What the panels ask for. They may still be inside an event: all but stopping is done after it.

void Workbench::later(std::function<void()> work) {
  later_.push_back(std::move(work));
  if (!PostMessageW(window_.handle(), WM_COMMAND, IDM_LATER, 0))
    raiseLastError("Putting off what a panel asked for");
}

// Each by itself: a failure of one is no reason for the others to be lost.
void Workbench::doLater() {
  const std::vector<std::function<void()>> works = std::exchange(later_, {});
  for (const auto& work : works) attempt(work);
}

void Workbench::closeAsked(PanelKind kind) {
  later([this, kind] { closePanel(kind); });
}

void Workbench::answerWanted(PanelKind kind) {
  later([this, kind] { answer(kind); });
}

bool Workbench::operationAsked(PanelKind kind, std::int16_t operation) {
  const bool empty = player_.state() == FramePlayer::State::Empty;
  switch (operation) {
    case kSingleSweepOperation:
      if (!empty) later([this] { single(); });
      return !empty;
    case kContinuousSweepOperation:
      if (!empty) later([this] { play(); });
      return !empty;
    case kStopSweepOperation:
      pause();
      // What was asked for before it and has not begun is stopped as well.
      later([this] { pause(); });
      return true;
    case QUILL_VFP_SAVE:
      later([this, kind] {
        if (Panel* const saved = panel(kind)) saved->save();
        saveSettingsNow();
      });
      return true;
    default:
      return false;
  }
}

// As a receiver does once it is set: tells the panel, and shows what it receives now. Where nothing was taken
// yet the next frame will.
void Workbench::answer(PanelKind kind) {
  Panel* const asking = panel(kind);
  if (asking == nullptr || !asking->answer()) return;
  receiveAnew();
  showMessages();
  takeScreenshots();
}

void Workbench::popUpAsked(PanelKind kind, POINT onScreen) {
  Panel* const asked = panel(kind);
  if (asked == nullptr) return;
  struct DestroyMenuOf {
    void operator()(HMENU menu) const noexcept { DestroyMenu(menu); }
  };
  const std::unique_ptr<std::remove_pointer_t<HMENU>, DestroyMenuOf> menu(CreatePopupMenu());
  if (!menu) raiseLastError("Making the panel's menu");
  for (const PopUpItem& item : asked->popUpItems()) {
    const UINT state = (item.checked ? MF_CHECKED : 0U) | (item.enabled ? 0U : MF_GRAYED);
    AppendMenuW(menu.get(), MF_STRING | state, IDM_POP_UP_FIRST + static_cast<UINT>(item.id),
                toUtf16(item.caption).c_str());
  }
  const auto chosen =
      static_cast<UINT>(TrackPopupMenu(menu.get(), TPM_RETURNCMD | TPM_NONOTIFY | TPM_RIGHTBUTTON, onScreen.x,
                                       onScreen.y, 0, window_.handle(), nullptr));
  if (chosen == 0) return;
  later([this, kind, chosen] {
    if (Panel* const clicked = panel(kind))
      clicked->popUpClick(static_cast<std::int16_t>(chosen - IDM_POP_UP_FIRST));
  });
}

void Workbench::popUpOfActive() {
  Panel* const active = activePanel();
  if (active == nullptr) return;
  POINT at{0, 0};
  ClientToScreen(active->window().handle(), &at);
  popUpAsked(active->kind(), at);
}

void Workbench::popUpClick(int item) {
  if (Panel* const active = activePanel()) active->popUpClick(static_cast<std::int16_t>(item));
}

// --- Telling the user

void Workbench::showMessages() {
  if (!messages_) return;
  for (std::string& message : messages_->takeAll()) {
    // What a report goes on with stands on its own line; in the list it is one message.
    std::replace_if(
        message.begin(), message.end(), [](char c) { return c == '\r' || c == '\n'; }, ' ');
    report(message, "Panel");
  }
}

// The list comes up by itself, since what it says may be the reason why nothing is seen; whoever has started
// the program from a console reads it there as well.
void Workbench::report(const std::string& message, const char* source) {
  window_.messages().add(source, message);
  window_.status(StatusPart::Message, message.substr(0, message.find_first_of("\r\n")));
  writeError(message);
  if (!options_.exit && !window_.messagesShown()) window_.showMessages(true);
}

// A play that fails once would fail at every tick; anything else that fails leaves it alone.
void Workbench::failed(const std::string& message) noexcept {
  const bool play = std::exchange(ticking_, false);
  try {
    if (play) {
      player_.pause();
      window_.stopTicking();
    }
    showStatus();
    report(message);
  } catch (...) {
    writeError(message);
  }
  if (options_.exit) end(ExitCode::Failed);
}

void Workbench::keys() { box(kHelp, MB_ICONINFORMATION); }

void Workbench::about() {
  box("Front Panels workbench " FRONTPANELS_VERSION_TEXT
      "\n\nA host for the Front Panels controls: it plays recordings of receivers and a simulated drive into "
      "the spectrum panel and the pilot panel.",
      MB_ICONINFORMATION);
}

void Workbench::box(const std::string& message, UINT icon) {
  MessageBoxW(window_.handle(), toUtf16(message).c_str(), L"Front Panels workbench", MB_OK | icon);
}

}  // namespace frontpanels::workbench

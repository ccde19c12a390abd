#include "workbench/workbench.h"

#include <windows.h>

#include <commdlg.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <filesystem>
#include <iterator>

#include "framework/support/host_codes.h"
#include "platform/win32/utf16.h"
#include "workbench/console.h"
#include "workbench/failure.h"
#include "workbench/resource_ids.h"
#include "workbench/window_picture.h"

namespace frontpanels::workbench {
namespace {

// Operations that panels ask for.
enum Operation : std::int16_t { kClose = 1, kSingleSweep = 2, kContinuousSweeps = 3, kStopSweeps = 4 };
constexpr std::int32_t kDone = 0;
constexpr std::int32_t kUnknownRequest = -1;
constexpr std::int32_t kUnusableValue = -8;
// Unattended there is nobody to watch: as fast as timers go.
constexpr std::chrono::milliseconds kUnattendedPeriod{10};

std::filesystem::path programFolder() {
  std::wstring path(MAX_PATH, L'\0');
  while (true) {
    const DWORD length = GetModuleFileNameW(nullptr, path.data(), static_cast<DWORD>(path.size()));
    if (length == 0) raiseLastError("Looking for the program's folder");
    if (length < path.size()) return std::filesystem::path(path.substr(0, length)).parent_path();
    path.resize(path.size() * 2);
  }
}

std::string carriedRecording() {
  return toUtf8((programFolder() / L"recordings" / L"fm_band.csv").wstring());
}

std::string fileName(const std::string& path) {
  return toUtf8(std::filesystem::path(toUtf16(path)).filename().wstring());
}

const char* stateName(SweepPlayer::State state) {
  switch (state) {
    case SweepPlayer::State::Empty:
      return "no recording";
    case SweepPlayer::State::Paused:
      return "paused";
    case SweepPlayer::State::Playing:
      return "playing";
    case SweepPlayer::State::Ended:
      return "at the end";
  }
  return "";
}

}  // namespace

struct Workbench::Command {
  UINT id;
  void (Workbench::*run)();
  // Whether the menu offers it now.
  bool (*offered)(const Workbench& self);
};

namespace {

constexpr auto kAlways = [](const auto&) { return true; };

}  // namespace

const Workbench::Command Workbench::kCommands[] = {
    {IDM_FILE_OPEN, &Workbench::askForRecording, kAlways},
    {IDM_PANELS_SPECTRUM, &Workbench::togglePanel, kAlways},
    {IDM_PANELS_CLOSE, &Workbench::closePanel, kAlways},
    {IDM_SOURCE_PLAY, &Workbench::play,
     [](const Workbench& self) {
       return self.player_.state() == SweepPlayer::State::Paused ||
              self.player_.state() == SweepPlayer::State::Ended;
     }},
    {IDM_SOURCE_PAUSE, &Workbench::pause,
     [](const Workbench& self) { return self.player_.state() == SweepPlayer::State::Playing; }},
    {IDM_SOURCE_STEP, &Workbench::step,
     [](const Workbench& self) {
       return self.player_.state() == SweepPlayer::State::Paused ||
              self.player_.state() == SweepPlayer::State::Playing;
     }},
    {IDM_SOURCE_RESTART, &Workbench::restart,
     [](const Workbench& self) { return self.player_.state() != SweepPlayer::State::Empty; }},
    {IDM_HELP_ABOUT, &Workbench::about, kAlways},
    {IDM_SINGLE_SWEEP, &Workbench::single, kAlways},
    {IDM_ANSWER_PANEL, &Workbench::answerPanel, kAlways},
};

Workbench::Workbench(Options options, TextFiles& files)
    : options_(std::move(options)), player_(files), window_(*this) {}

// The panel goes before the window that it lives in.
Workbench::~Workbench() { closePanel(); }

ExitCode Workbench::run(int showCommand) {
  window_.show(showCommand);
  showStatus();
  const bool started = start();
  if (options_.exit && !started) return exitCode_;
  return static_cast<ExitCode>(window_.runMessageLoop());
}

// Each step by itself: without a panel a recording can still be opened, and the other way round.
bool Workbench::start() {
  bool whole = true;
  const auto attempt = [&](auto&& step) {
    try {
      step();
    } catch (const NotRegistered&) {
      whole = false;
      exitCode_ = ExitCode::NotRegistered;
      report(currentFailure(), true);
    } catch (...) {
      whole = false;
      exitCode_ = ExitCode::Failed;
      report(currentFailure(), true);
    }
  };
  attempt([this] { openPanel(); });
  if (!options_.exit || whole)
    attempt([this] { openRecording(options_.recording.empty() ? carriedRecording() : options_.recording); });
  return whole;
}

// --- Commands

void Workbench::command(UINT id) {
  if (id == IDM_FILE_EXIT) return end(ExitCode::Done);
  if (id >= IDM_RATE_FIRST && id <= IDM_RATE_LAST) return rate(id - IDM_RATE_FIRST);
  const auto* const found = std::find_if(std::begin(kCommands), std::end(kCommands),
                                         [id](const Command& row) { return row.id == id; });
  if (found != std::end(kCommands)) (this->*found->run)();
}

void Workbench::menuOpening(HMENU menu) {
  for (const Command& row : kCommands)
    EnableMenuItem(menu, row.id, MF_BYCOMMAND | (row.offered(*this) ? MF_ENABLED : MF_GRAYED));
  CheckMenuItem(menu, IDM_PANELS_SPECTRUM, MF_BYCOMMAND | (panel_ ? MF_CHECKED : MF_UNCHECKED));
  CheckMenuRadioItem(menu, IDM_RATE_FIRST, IDM_RATE_LAST, IDM_RATE_FIRST + static_cast<UINT>(rate_),
                     MF_BYCOMMAND);
}

void Workbench::askForRecording() {
  wchar_t path[32768] = L"";
  OPENFILENAMEW dialog{};
  dialog.lStructSize = sizeof dialog;
  dialog.hwndOwner = window_.handle();
  dialog.lpstrFilter = L"Recordings (*.csv; *.txt)\0*.csv;*.txt\0All files (*.*)\0*.*\0";
  dialog.lpstrFile = path;
  dialog.nMaxFile = static_cast<DWORD>(std::size(path));
  dialog.lpstrTitle = L"Open recording";
  dialog.Flags = OFN_FILEMUSTEXIST | OFN_PATHMUSTEXIST | OFN_HIDEREADONLY | OFN_NOCHANGEDIR;
  if (GetOpenFileNameW(&dialog)) openRecording(toUtf8(path));
}

void Workbench::openRecording(const std::string& path) {
  player_.open(path);
  receiver_.showWholeSweeps();
  window_.status(StatusPart::Message, "");
  play();
}

void Workbench::togglePanel() { panel_ ? closePanel() : openPanel(); }

void Workbench::openPanel() {
  // Asked first: of the library's classes the panel is the one that the user knows.
  registeredClass(SpectrumPanel::kProgId);
  if (!messages_) messages_.emplace();
  panel_ = std::make_unique<SpectrumPanel>(window_, static_cast<PanelRequests&>(*this));
  window_.occupy(&panel_->control());
  for (const ReceiverSetting& setting : receiver_.settings()) panel_->set(setting);
  if (player_.sweepNumber() > 0) showSweep();
  showMessages();
}

void Workbench::closePanel() {
  window_.occupy(nullptr);
  panel_.reset();
}

void Workbench::play() {
  player_.play();
  applyState();
}

void Workbench::pause() {
  player_.pause();
  applyState();
}

void Workbench::step() {
  player_.pause();
  applyState();
  takeSweep();
}

// At the end of a recording it begins anew, as playing does.
void Workbench::single() {
  player_.pause();
  applyState();
  if (takeSweep()) return;
  player_.play();
  step();
}

void Workbench::restart() {
  player_.restart();
  receiver_.showWholeSweeps();
  applyState();
}

void Workbench::rate(std::size_t index) {
  rate_ = index;
  applyState();
}

void Workbench::about() {
  box("Front Panels workbench 0.1.0\n\nA host for the Front Panels controls: it plays recordings of "
      "rtl_power and "
      "hackrf_sweep into the spectrum panel.\n\nF5 plays, F6 pauses, F7 takes one sweep, F8 begins anew.",
      MB_ICONINFORMATION);
}

// --- Playing

void Workbench::applyState() {
  if (player_.state() == SweepPlayer::State::Playing) {
    window_.startTicking(options_.exit ? kUnattendedPeriod
                                       : std::chrono::milliseconds(1000 / kSweepsASecond.at(rate_)));
  } else {
    window_.stopTicking();
  }
  showStatus();
}

void Workbench::tick() {
  // A tick may still wait in the queue when the play has been stopped.
  if (player_.state() != SweepPlayer::State::Playing) return;
  const bool more = takeSweep() && sweepsTaken_ != options_.sweeps;
  if (more) return;
  player_.pause();
  applyState();
  if (options_.exit) finishUnattended();
}

bool Workbench::takeSweep() {
  if (!player_.step()) {
    applyState();
    if (const std::string problems = player_.recording()->problemReport(); !problems.empty())
      report(problems, false);
    return false;
  }
  ++sweepsTaken_;
  showSweep();
  showStatus();
  showMessages();
  takeScreenshots();
  return true;
}

void Workbench::showSweep() {
  const DisplaySweep& sweep = receiver_.receive(player_.sweep());
  if (panel_ && sweep.count > 0) panel_->show(sweep);
}

// As a receiver does once it is set: tells the panel, and shows what it receives now. Where nothing was taken
// yet the next sweep will.
void Workbench::answerPanel() {
  bool retuned = false;
  for (const ReceiverSetting& answer : receiver_.takeAnswers()) {
    if (panel_) panel_->set(answer);
    retuned = retuned || answer.code == kCenterFrequencyParameter || answer.code == kSpanParameter;
  }
  if (!retuned) return;
  showSweep();
  showMessages();
  takeScreenshots();
}

void Workbench::showMessages() {
  if (const std::optional<std::string> latest = messages_->takeLatest()) report(*latest, false);
}

void Workbench::takeScreenshots() {
  if (options_.screenshotFolder.empty() || player_.sweepNumber() == 0) return;
  const std::filesystem::path folder = std::filesystem::absolute(toUtf16(options_.screenshotFolder));
  std::filesystem::create_directories(folder);
  wchar_t number[24];
  std::swprintf(number, std::size(number), L"%04llu.png",
                static_cast<unsigned long long>(player_.sweepNumber()));
  saveWindowPicture(window_.handle(), toUtf8((folder / (std::wstring(L"window-") + number)).wstring()));
  if (panel_) panel_->savePicture(toUtf8((folder / (std::wstring(L"spectrum-") + number)).wstring()));
}

// --- Ending, and telling the user

void Workbench::finishUnattended() {
  if (sweepsTaken_ == 0) {
    report(player_.recording()->path() + ": there is no sweep in it", false);
    return end(ExitCode::Failed);
  }
  end(exitCode_);
}

void Workbench::end(ExitCode code) noexcept { PostQuitMessage(static_cast<int>(code)); }

// --- What the panel asks for. It is still inside its own event: all but stopping is done after it.

std::int32_t Workbench::frontPanelOp(std::int32_t, std::int32_t, std::int16_t operation) {
  const bool empty = player_.state() == SweepPlayer::State::Empty;
  const auto afterwards = [this](UINT id) {
    return PostMessageW(window_.handle(), WM_COMMAND, id, 0) ? kDone : kUnknownRequest;
  };
  switch (operation) {
    case kClose:
      return afterwards(IDM_PANELS_CLOSE);
    case kSingleSweep:
      return empty ? kUnknownRequest : afterwards(IDM_SINGLE_SWEEP);
    case kContinuousSweeps:
      return empty ? kUnknownRequest : afterwards(IDM_SOURCE_PLAY);
    case kStopSweeps:
      pause();
      // What was asked for before it and has not begun is stopped as well.
      return afterwards(IDM_SOURCE_PAUSE);
    default:
      return kUnknownRequest;
  }
}

std::int32_t Workbench::frontPanelSet(std::int32_t, std::int32_t, std::int16_t parameterType, std::int16_t,
                                      double value) {
  const bool taken = receiver_.request(parameterType, value);
  const BOOL answered = PostMessageW(window_.handle(), WM_COMMAND, IDM_ANSWER_PANEL, 0);
  return taken && answered ? kDone : kUnusableValue;
}

void Workbench::showStatus() {
  const SweepRecording* const recording = player_.recording();
  if (recording != nullptr)
    window_.status(StatusPart::Source,
                   fileName(recording->path()) + " (" + sweepFormatName(recording->format()) + ")");
  if (player_.sweepNumber() == 0) {
    window_.status(StatusPart::Sweep, "");
  } else {
    window_.status(StatusPart::Sweep,
                   "Sweep " + std::to_string(player_.sweepNumber()) + ", " + player_.sweepTime());
  }
  const std::string rate = options_.exit ? "" : ", " + std::to_string(kSweepsASecond.at(rate_)) + " a second";
  window_.status(StatusPart::Rate, stateName(player_.state()) + rate);
}

// A play that fails once would fail at every tick.
void Workbench::failed(const std::string& message) noexcept {
  try {
    player_.pause();
    window_.stopTicking();
    showStatus();
    report(message, true);
  } catch (...) {
    writeError(message);
  }
  if (options_.exit) end(ExitCode::Failed);
}

void Workbench::report(const std::string& message, bool withBox) {
  window_.status(StatusPart::Message, message.substr(0, message.find('\n')));
  if (options_.exit) {
    writeError(message);
  } else if (withBox) {
    box(message, MB_ICONWARNING);
  }
}

void Workbench::box(const std::string& message, UINT icon) {
  MessageBoxW(window_.handle(), toUtf16(message).c_str(), L"Front Panels workbench", MB_OK | icon);
}

}  // namespace frontpanels::workbench

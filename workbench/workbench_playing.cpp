// Sources, the play, and the recording of it.
#include <windows.h>

#include <chrono>
#include <cstdio>

#include "workbench/console.h"
#include "workbench/failure.h"
#include "workbench/program_files.h"
#include "workbench/questions.h"
#include "workbench/window_picture.h"
#include "workbench/workbench.h"

namespace frontpanels::workbench {
namespace {

// Unattended there is nobody to watch: as fast as timers go.
constexpr std::chrono::milliseconds kUnattendedPeriod{10};
// A long read looks at the keys so often, and shows how far it is.
constexpr ULONGLONG kLookEveryMs = 50;
constexpr ULONGLONG kPatienceMs = 300;  // a read that is over by then is not worth a progress bar

constexpr FileFilter kRecordings =
    L"Recordings (*.csv;*.txt;*.fpcap)\0*.csv;*.txt;*.fpcap\0All files (*.*)\0*.*\0";
constexpr FileFilter kCaptures = L"Captures (*.fpcap)\0*.fpcap\0All files (*.*)\0*.*\0";

const char* stateName(FramePlayer::State state) {
  switch (state) {
    case FramePlayer::State::Empty:
      return "no recording";
    case FramePlayer::State::Paused:
      return "paused";
    case FramePlayer::State::Playing:
      return "playing";
    case FramePlayer::State::Ended:
      return "at the end";
  }
  return "";
}

}  // namespace

// --- Sources

void Workbench::askForRecording() {
  const auto path = askForFileToOpen(window_.handle(), L"Open recording", kRecordings);
  if (!path) return;
  const bool wasPlaying = player_.state() == FramePlayer::State::Playing;
  if (openRecording(*path) || wasPlaying) play();
  showStatus();
}

// The panels live on while a long recording is read, with what was shown last.
bool Workbench::openRecording(const std::string& path) {
  pause();
  reading_ = true;
  cancelled_ = false;
  const ULONGLONG begun = GetTickCount64();
  ULONGLONG looked = begun;
  const Progress progress = [&](int percent) {
    const ULONGLONG now = GetTickCount64();
    if (now - looked < kLookEveryMs) return true;
    looked = now;
    if (now - begun > kPatienceMs) window_.showProgress("Reading " + fileName(path), percent);
    return window_.pumpMessages() && !cancelled_;
  };
  std::unique_ptr<FrameSource> source;
  try {
    source = frontpanels::openRecording(files_, path, progress);
  } catch (...) {
    reading_ = false;
    window_.endProgress();
    throw;
  }
  reading_ = false;
  window_.endProgress();
  if (!source) {
    report(fileName(path) + ": not opened, as reading it was cancelled");
    return false;
  }
  open(std::move(source), nullptr);
  openedPath_ = wholePath(path);
  showStatus();
  reportProblems();
  return true;
}

void Workbench::simulate(std::uint64_t seed) {
  auto drive = std::make_unique<DriveSimulator>(seed);
  DriveSimulator* const simulator = drive.get();
  open(std::move(drive), simulator);
  seed_ = seed;
  openedPath_.clear();
}

void Workbench::open(std::unique_ptr<FrameSource> source, DriveSimulator* simulator) {
  stopRecording();
  simulator_ = nullptr;
  problemsTold_.clear();
  player_.open(std::move(source));
  simulator_ = simulator;
  for (const auto& panel : panels_) {
    panel->forgetTuning();
    panel->meet(simulator_);
  }
  tune();
  applyState();
}

void Workbench::simulateAgain() {
  simulate(seed_);
  play();
}

void Workbench::simulateOther() {
  simulate(seed_ + 1);
  play();
}

// A simulated receiver delivers what the panels have asked for; a recording can only be cut to it.
void Workbench::tune() {
  if (simulator_ == nullptr) return;
  for (const auto& panel : panels_) panel->tune(*simulator_);
}

// The frame that is shown, as it is received with what the panels have asked for since.
void Workbench::receiveAnew() {
  tune();
  if (simulator_ != nullptr && player_.frameNumber() > 0) player_.seek(player_.frameNumber());
  showFrame();
}

// --- Playing

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
  takeFrame();
}

void Workbench::stepBack() {
  player_.pause();
  player_.stepBack();
  applyState();
  showFrame();
  takeScreenshots();
}

// At the end of a recording it begins anew, as playing does.
void Workbench::single() {
  player_.pause();
  applyState();
  if (takeFrame()) return;
  player_.play();
  step();
}

void Workbench::restart() {
  player_.restart();
  for (const auto& panel : panels_) panel->forgetTuning();
  tune();
  applyState();
}

void Workbench::seek(std::uint64_t frame) {
  if (reading_ || frame == player_.frameNumber()) return;
  player_.seek(frame);
  applyState();
  showFrame();
  takeScreenshots();
}

void Workbench::toggleLoop() {
  player_.loop(!player_.loop());
  showStatus();
}

void Workbench::goTo() { window_.focusPlace(); }

void Workbench::rate(int index) {
  rate_ = static_cast<std::size_t>(index);
  applyState();
}

void Workbench::applyState() {
  if (player_.state() == FramePlayer::State::Playing) {
    window_.startTicking(options_.exit ? kUnattendedPeriod
                                       : std::chrono::milliseconds(1000 / kSweepsASecond.at(rate_)));
  } else {
    window_.stopTicking();
  }
  showStatus();
}

void Workbench::tick() {
  ticking_ = true;
  playOn();
  ticking_ = false;
}

void Workbench::playOn() {
  // A tick may still wait in the queue when the play has been stopped.
  if (reading_ || player_.state() != FramePlayer::State::Playing) return;
  const bool more = takeFrame() && framesTaken_ != options_.sweeps;
  if (more) return;
  player_.pause();
  applyState();
  if (options_.exit) finishUnattended();
}

bool Workbench::takeFrame() {
  if (!player_.step()) {
    applyState();
    reportProblems();
    return false;
  }
  ++framesTaken_;
  appendToCapture();
  showFrame();
  showStatus();
  showMessages();
  takeScreenshots();
  return true;
}

// What is wrong with a recording is known once it was read; more may come when it changes meanwhile.
void Workbench::reportProblems() {
  std::string problems = player_.source()->problemReport();
  if (!problems.empty() && problems != problemsTold_) report(problems);
  problemsTold_ = std::move(problems);
}

void Workbench::showFrame() {
  if (player_.frameNumber() == 0) return;
  for (const auto& panel : panels_) panel->receive(player_.frame());
}

// --- Recording what is played

void Workbench::toggleRecording() {
  if (capture_) return stopRecording();
  const std::string proposed = stampForNames() + ".fpcap";
  const auto path = options_.exportFolder.empty()
                        ? askForFileToSave(window_.handle(), L"Record to a new capture, or on to an old one",
                                           kCaptures, L"fpcap", proposed, SavedFile::Continued)
                        : std::optional(fileIn(options_.exportFolder, proposed));
  if (path) record(*path);
}

void Workbench::record(const std::string& path) {
  if (wholePath(path) == openedPath_)
    throw HostFailure(fileName(path) + ": is being played and cannot be recorded to");
  capture_.emplace(path);
  tellLogging(true);
  showStatus();
}

void Workbench::tellLogging(bool on) {
  for (const auto& panel : panels_) attempt([&] { panel->logging(on); });
}

void Workbench::stopRecording() {
  if (!capture_) return;
  const std::string told = fileName(capture_->path()) + ": " + std::to_string(capture_->frames()) +
                           (capture_->frames() == 1 ? " frame recorded" : " frames recorded");
  capture_.reset();
  tellLogging(false);
  showStatus();
  window_.status(StatusPart::Message, told);
  window_.messages().add("Workbench", told);
  writeError(told);
}

// What was recorded until then stays whole; the play goes on.
void Workbench::appendToCapture() {
  if (!capture_) return;
  try {
    capture_->append(player_.frame());
  } catch (...) {
    const std::string failure = currentFailure();
    stopRecording();
    if (options_.exit) exitCode_ = ExitCode::Failed;
    report(failure);
  }
}

// --- What is seen of it

void Workbench::takeScreenshots() {
  if (options_.screenshotFolder.empty() || player_.frameNumber() == 0) return;
  if (IsIconic(window_.handle())) return;  // there is nothing of it to be seen
  char number[32];
  std::snprintf(number, sizeof number, "-%04llu.png", static_cast<unsigned long long>(player_.frameNumber()));
  saveWindowPicture(window_.handle(), fileIn(options_.screenshotFolder, std::string("window") + number));
  for (const auto& panel : panels_)
    panel->savePicture(fileIn(options_.screenshotFolder, std::string(panelWord(panel->kind())) + number));
}

void Workbench::showStatus() {
  const FrameSource* const source = player_.source();
  if (source != nullptr) {
    const bool isFile = simulator_ == nullptr;
    window_.status(StatusPart::Source,
                   isFile ? fileName(source->name()) + " (" + source->formatName() + ")" : source->name());
  }
  window_.status(StatusPart::Sweep,
                 player_.frameNumber() == 0
                     ? ""
                     : "Sweep " + std::to_string(player_.frameNumber()) + ", " + player_.frame().time);
  std::string state = stateName(player_.state());
  if (!options_.exit) state += ", " + std::to_string(kSweepsASecond.at(rate_)) + " a second";
  if (player_.loop()) state += ", in a loop";
  if (capture_) state += ", recording";
  window_.status(StatusPart::Rate, state);
  window_.showPlace(player_.frameNumber(), player_.frameCount());
}

}  // namespace frontpanels::workbench

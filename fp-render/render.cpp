#include "fp-render/render.h"

#include <algorithm>
#include <filesystem>
#include <iomanip>
#include <sstream>
#include <string>

#include "fp-render/console.h"
#include "fp-render/options.h"
#include "fp-render/panel_picture.h"
#include "fp-render/panel_setup.h"
#include "fp-render/picture_file.h"
#include "framework/support/error_handler.h"
#include "framework/support/host_codes.h"
#include "sources/drive_simulator.h"
#include "sources/frame_source.h"

namespace frontpanels {
namespace {

namespace fs = std::filesystem;

std::string counted(std::uint64_t count, const char* thing) {
  return std::to_string(count) + " " + thing + (count == 1 ? "" : "s");
}

bool holds(const Frame& frame, PanelKind panel) {
  return panel == PanelKind::Spectrum ? frame.sweep.has_value() : frame.pilots.has_value();
}

std::string wordsOf(const Sweep& sweep) {
  constexpr double kMega = 1e6;
  const double stopHz = sweep.startHz + sweep.stepHz * static_cast<double>(sweep.levelsDb.size());
  std::ostringstream words;
  words << std::setprecision(10) << sweep.startHz / kMega << " to " << stopHz / kMega << " MHz, "
        << counted(sweep.levelsDb.size(), "bin");
  return words.str();
}

std::string wordsOf(const PilotFrame& frame) {
  std::string words;
  const auto add = [&words](const char* set, const auto& data, auto sizeOf) {
    if (data) words += (words.empty() ? "" : ", ") + std::string(set) + " " + std::to_string(sizeOf(*data));
  };
  const auto levels = [](const PilotLevels& data) { return data.ecIoDb.size(); };
  const auto pilots = [](const PilotBars& data) { return data.pilots.size(); };
  add("all", frame.allPilots, levels);
  add("zoomed", frame.zoomedPilots, levels);
  add("top", frame.topN, pilots);
  add("list", frame.userList, pilots);
  return words;
}

// Markers in the panel's unit; the options are those that problemWith has passed.
WantedMarkers markersOf(const RenderOptions& options, PanelKind panel) {
  const auto placeOf = [panel](const std::string& text) {
    return panel == PanelKind::Spectrum ? frequencyHzOf(text) : pnOffsetOf(text);
  };
  WantedMarkers wanted{{}, options.peak};
  for (const MarkerPlace& marker : options.markers)
    wanted.at.push_back(
        {placeOf(marker.place).value(), marker.delta ? placeOf(*marker.delta) : std::nullopt});
  return wanted;
}

class Renderer {
 public:
  // `frames` is how many the source has, `drive` the source itself where that is a simulated one.
  Renderer(const RenderOptions& options, FrameSource& source, std::uint64_t frames, DriveSimulator* drive,
           Console& console)
      : options_(options),
        source_(source),
        frames_(frames),
        drive_(drive),
        panel_(options.panel.value_or(source.hasSweeps() ? PanelKind::Spectrum : PanelKind::Pilots)),
        console_(console),
        pictures_(options.directory, options.overwrite) {}

  // The number of pictures drawn.
  std::uint64_t run() {
    if (const std::string problem = problemWith(options_, panel_); !problem.empty())
      throw UsageError(problem);
    if (panel_ == PanelKind::Spectrum ? !source_.hasSweeps() : !source_.hasPilots())
      return nothing(std::string("holds no ") + (panel_ == PanelKind::Spectrum ? "sweeps" : "pilots"));
    if (options_.range.first > frames_)
      return nothing("has " + counted(frames_, thing()) + ", no " + thing() + " " +
                     std::to_string(options_.range.first));
    makePicture();
    survey();
    if (!picture_->hasLevels()) return nothing(picture_->missingLevels() + ", there is nothing to draw");
    picture_->fitScale(options_.topDb, options_.dbPerDivision);
    picture_->markers(markersOf(options_, panel_));
    createFolder(options_.directory);
    console_.run([this] { drawAll(); });  // the pictures made before stay and count
    console_.reportsOfPanel();
    return drawn_;
  }

 private:
  [[nodiscard]] const char* thing() const { return panel_ == PanelKind::Spectrum ? "sweep" : "frame"; }

  std::uint64_t nothing(const std::string& why) {
    console_.problem(source_.name() + ": " + why);
    return 0;
  }
  void problem(const Frame& frame, const std::string& what) {
    console_.problem(source_.name() + ": " + thing() + " " + std::to_string(frame.number) + ": " + what);
  }

  template <class Each>
  void forEach(std::uint64_t first, std::uint64_t last, Each each) {
    source_.seek(first);
    for (Frame frame; frame.number < last && source_.next(frame);)
      if (holds(frame, panel_)) each(frame);
  }

  void makePicture() {
    if (!options_.settingsFile.empty())
      fromFile_ = readPanelSetup(options_.settingsFile, panel_, options_.setUp);
    const PictureLook look{options_.sizePx, options_.dpi, options_.fields, options_.caption != ""};
    picture_ =
        panel_ == PanelKind::Spectrum ? makeSpectrumPicture(look) : makePilotPicture(look, setsToShow());
    applyFile();
    if (options_.centerHz) apply({kCenterFrequencyParameter, 0, *options_.centerHz});
    if (options_.spanHz) apply({kSpanParameter, 0, *options_.spanHz});
    for (const StoredSetting& setting : options_.settings) apply(setting);
    if (drive_ != nullptr) picture_->tune(*drive_);
  }

  void apply(const StoredSetting& setting) {
    if (picture_->set(setting)) return;
    console_.reportsOfPanel();
    throw UsageError(cannotUse(setting));
  }

  // One setting that the panel has no use for does not cost the others.
  void applyFile() {
    for (const StoredSetting& setting : fromFile_) {
      if (picture_->set(setting)) continue;
      console_.reportsOfPanel();
      console_.problem(options_.settingsFile + ": " + cannotUse(setting));
    }
  }

  [[nodiscard]] static std::string cannotUse(const StoredSetting& setting) {
    return "the panel cannot use " + settingValueText(setting.value) + " for code " +
           std::to_string(setting.code);
  }

  [[nodiscard]] ShownSets setsToShow() {
    if (options_.sets) return *options_.sets;
    return drive_ == nullptr ? setsHeld() : setsWorthShowing();
  }

  // A drive has whatever set is asked for: a window of the code, a list, once settings say which.
  [[nodiscard]] ShownSets setsWorthShowing() const {
    const auto isSet = [this](std::initializer_list<std::int16_t> codes) {
      const auto listed = [codes](const StoredSetting& setting) {
        return std::find(codes.begin(), codes.end(), setting.code) != codes.end();
      };
      return std::any_of(fromFile_.begin(), fromFile_.end(), listed) ||
             std::any_of(options_.settings.begin(), options_.settings.end(), listed);
    };
    return {true, isSet({kCodeCenterParameter, kCodeStartParameter, kCodeSpanParameter}), true,
            isSet({CDMA_CODE_OFFSET})};
  }

  [[nodiscard]] ShownSets setsHeld() {
    ShownSets held{};
    source_.seek(1);
    for (Frame frame; frame.number < frames_ && source_.next(frame);) {
      if (!frame.pilots) continue;
      const bool inFrame[] = {frame.pilots->allPilots.has_value(), frame.pilots->zoomedPilots.has_value(),
                              frame.pilots->topN.has_value(), frame.pilots->userList.has_value()};
      for (std::size_t set = 0; set < kPilotSets; ++set) held[set] = held[set] || inFrame[set];
      if (std::all_of(held.begin(), held.end(), [](bool set) { return set; })) break;
    }
    return held;
  }

  void survey() {
    forEach(1, frames_, [this](const Frame& frame) { picture_->survey(frame); });
    if (const std::string problems = source_.problemReport(); !problems.empty()) console_.problem(problems);
  }

  void drawAll() {
    const std::uint64_t last = std::min(options_.range.last.value_or(frames_), frames_);
    forEach(options_.range.first, last, [this](const Frame& frame) {
      if ((frame.number - options_.range.first) % options_.every == 0) draw(frame);
    });
    if (seen_ == 0) nothing("none of these frames has anything for this panel");
  }

  void draw(const Frame& frame) {
    ++seen_;
    if (!picture_->show(frame)) return problem(frame, picture_->missingLevels() + ", no picture");
    for (const std::string& place : picture_->markersLeftOut())
      problem(frame, "the marker at " + place + " lies outside of the graph and is left out");
    const PixelView picture = picture_->picture(options_.caption.value_or(captionOf(frame)));
    const std::string path = pictures_.save(nameOf(frame), picture);
    ++drawn_;
    console_.say(path + "  " + frame.time + "  " +
                 (panel_ == PanelKind::Spectrum ? wordsOf(*frame.sweep) : wordsOf(*frame.pilots)));
    for (const std::string& reading : picture_->markerReadings()) console_.say("  " + reading);
  }

  [[nodiscard]] std::string captionOf(const Frame& frame) const {
    return fs::path(source_.name()).filename().string() + "   " + thing() + " " +
           std::to_string(frame.number) + " of " + std::to_string(frames_) + "   " + frame.time;
  }

  [[nodiscard]] std::string nameOf(const Frame& frame) const {
    std::ostringstream name;
    if (!options_.name.empty())
      name << options_.name;
    else if (options_.seed)
      name << "simulation-" << *options_.seed;
    else
      name << fs::path(options_.recording).stem().string();
    name << (panel_ == PanelKind::Spectrum ? "-sweep-" : "-pilots-") << std::setfill('0') << std::setw(4)
         << frame.number << ".png";
    return name.str();
  }

  const RenderOptions& options_;
  FrameSource& source_;
  std::uint64_t frames_;
  DriveSimulator* drive_;
  PanelKind panel_;
  Console& console_;
  PictureFiles pictures_;
  std::vector<StoredSetting> fromFile_;
  std::unique_ptr<PanelPicture> picture_;
  std::uint64_t seen_ = 0;  // frames that have something for the panel
  std::uint64_t drawn_ = 0;
};

int renderFrames(const RenderOptions& options, TextFiles& files, Console& console) {
  std::optional<DriveSimulator> drive;
  std::unique_ptr<FrameSource> recording;
  if (options.seed)
    drive.emplace(*options.seed);
  else
    recording = openRecording(files, options.recording);
  FrameSource& source = drive ? static_cast<FrameSource&>(*drive) : *recording;
  const std::uint64_t drivenFrames = options.frames.value_or(options.range.last.value_or(1));
  const std::uint64_t frames = source.frameCount().value_or(drivenFrames);
  const std::uint64_t drawn = Renderer(options, source, frames, drive ? &*drive : nullptr, console).run();
  if (drawn == 0) return kNothingDrawn;
  console.say(counted(drawn, "picture") + " of " +
              (drive ? source.name() : std::string("a recording of ") + source.formatName()));
  console.finish();
  return console.problems() == 0 ? kDrawn : kDrawnWithProblems;
}

int renderCommand(std::span<const char* const> arguments, TextFiles& files, Console& console) {
  RenderOptions options;
  std::string problem;
  if (!parseOptions(arguments, options, problem)) throw UsageError(problem);
  if (options.help) {
    console.say(renderUsage());
    return kDrawn;
  }
  if (options.version) {
    console.say("fp-render " FRONTPANELS_VERSION);
    return kDrawn;
  }
  return renderFrames(options, files, console);
}

}  // namespace

int render(std::span<const char* const> arguments, TextFiles& files, std::ostream& output,
           std::ostream& errors) noexcept {
  int exitCode = kNothingDrawn;
  guard("fp-render", [&] {
    messageLog().clear();
    Console console(output, errors);
    try {
      console.run([&] { exitCode = renderCommand(arguments, files, console); });
    } catch (const UsageError& error) {
      console.problem("fp-render: " + error.text() + "\n\"fp-render --help\" explains the command line");
      exitCode = kWrongUsage;
    }
  });
  return exitCode;
}

}  // namespace frontpanels

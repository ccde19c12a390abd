#include "fp-render/render.h"

#include <algorithm>
#include <filesystem>
#include <iomanip>
#include <sstream>
#include <string>
#include <system_error>
#include <vector>

#include "fp-render/headless_panel.h"
#include "fp-render/options.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "hosting/whole_file.h"
#include "platform/file_path.h"
#include "platform/raster/png.h"
#include "platform/runtime_error.h"
#include "sources/resample.h"
#include "sources/sweep_recording.h"
#include "sources/vertical_scale.h"

namespace frontpanels {
namespace {

namespace fs = std::filesystem;

constexpr int kPathFileAccessError = 75;

// What a first walk through the recording tells: all pictures have one scale, whichever of them are drawn.
struct Survey {
  std::uint64_t sweeps = 0;
  LevelRange levels;
};

Survey survey(SweepRecording& recording) {
  Survey result;
  DisplaySweep display;
  for (Sweep sweep; recording.next(sweep); ++result.sweeps) {
    resample(sweep, display);
    result.levels.add(display.shown());
  }
  return result;
}

std::string counted(std::uint64_t count, const char* thing) {
  return std::to_string(count) + " " + thing + (count == 1 ? "" : "s");
}

std::string pictureName(const std::string& recording, std::uint64_t number) {
  std::ostringstream name;
  name << fs::path(recording).stem().string() << "-sweep-" << std::setfill('0') << std::setw(4) << number
       << ".png";
  return name.str();
}

std::string captionOf(const std::string& recording, const Sweep& sweep, std::uint64_t sweeps) {
  return fs::path(recording).filename().string() + "   sweep " + std::to_string(sweep.number) + " of " +
         std::to_string(sweeps) + "   " + sweep.time;
}

std::string pictureLine(const fs::path& path, const Sweep& sweep) {
  constexpr double kMega = 1e6;
  const double stopHz = sweep.startHz + sweep.stepHz * static_cast<double>(sweep.levelsDb.size());
  std::ostringstream line;
  line << path.string() << "  " << sweep.time << "  " << std::setprecision(10) << sweep.startHz / kMega
       << " to " << stopHz / kMega << " MHz, " << counted(sweep.levelsDb.size(), "bin");
  return line.str();
}

void createFolder(const std::string& folder) {
  std::error_code error;
  fs::create_directories(folder, error);
  if (!error && !fs::is_directory(folder)) error = std::make_error_code(std::errc::not_a_directory);
  if (error) throw RuntimeError(kPathFileAccessError, folder + ": cannot be created: " + error.message());
}

// Runs `body` and says what ended it, if anything did.
template <class Body>
void sayFailure(std::ostream& errors, const Body& body) noexcept {
  try {
    body();
  } catch (...) {
    errors << "fp-render: " << describeCurrentException() << '\n';
  }
}

// What the panel had to report; its lines end with a carriage return.
void sayMessages(std::ostream& errors) {
  for (std::string message : messageLog().messages()) {
    std::replace(message.begin(), message.end(), '\r', ' ');
    errors << "fp-render: the panel reports: " << message << '\n';
  }
}

class Renderer {
 public:
  Renderer(const RenderOptions& options, SweepRecording& recording, std::ostream& output,
           std::ostream& errors)
      : options_(options), recording_(recording), output_(output), errors_(errors) {}

  // The number of pictures drawn.
  std::uint64_t run() {
    survey_ = survey(recording_);
    const std::string problems = recording_.problemReport();
    if (!problems.empty()) errors_ << problems << '\n';
    if (options_.sweep && *options_.sweep > survey_.sweeps) {
      errors_ << recording_.path() << ": has " << counted(survey_.sweeps, "sweep") << ", no sweep "
              << *options_.sweep << '\n';
      return 0;
    }
    if (survey_.levels.isEmpty()) {
      errors_ << recording_.path() << ": every level is missing, there is nothing to draw\n";
      return 0;
    }
    createFolder(options_.directory);
    sayFailure(errors_, [this] { drawAll(); });  // the pictures made before stay and count
    sayMessages(errors_);
    return drawn_;
  }

 private:
  void drawAll() {
    HeadlessPanel panel(verticalScaleFor(survey_.levels));
    DisplaySweep display;
    recording_.rewind();
    for (Sweep sweep; recording_.next(sweep);) {
      if (options_.sweep && sweep.number < *options_.sweep) continue;
      resample(sweep, display);
      draw(panel, sweep, display);
      if (options_.sweep) return;
    }
  }

  void draw(HeadlessPanel& panel, const Sweep& sweep, const DisplaySweep& display) {
    if (!sweep.hasLevels()) {
      errors_ << recording_.path() << ": sweep " << sweep.number << ": every level is missing, no picture\n";
      return;
    }
    panel.show(display, captionOf(recording_.path(), sweep, survey_.sweeps));
    const fs::path path = fs::path(options_.directory) / pictureName(recording_.path(), sweep.number);
    std::string problem;
    if (!encodePng(panel.picture(), png_, problem))
      throw RuntimeError(kPathFileAccessError, path.string() + ": " + problem);
    saveWhole(utf8FromPath(path), png_);
    ++drawn_;
    output_ << pictureLine(path, sweep) << '\n';
  }

  const RenderOptions& options_;
  SweepRecording& recording_;
  std::ostream& output_;
  std::ostream& errors_;
  Survey survey_;
  std::vector<std::uint8_t> png_;
  std::uint64_t drawn_ = 0;
};

int renderRecording(const RenderOptions& options, TextFiles& files, std::ostream& output,
                    std::ostream& errors) {
  const auto recording = SweepRecording::open(files, options.recording);
  Renderer renderer(options, *recording, output, errors);
  const std::uint64_t drawn = renderer.run();
  if (drawn == 0) return kNothingDrawn;
  output << counted(drawn, "picture") << " of a recording of " << sweepFormatName(recording->format())
         << '\n';
  return kDrawn;
}

int renderCommand(std::span<const char* const> arguments, TextFiles& files, std::ostream& output,
                  std::ostream& errors) {
  RenderOptions options;
  std::string problem;
  if (!parseOptions(arguments, options, problem)) {
    errors << "fp-render: " << problem << "\n\n" << kRenderUsage;
    return kWrongUsage;
  }
  if (options.help) {
    output << kRenderUsage;
    return kDrawn;
  }
  if (options.version) {
    output << "fp-render " << FRONTPANELS_VERSION << '\n';
    return kDrawn;
  }
  return renderRecording(options, files, output, errors);
}

}  // namespace

int render(std::span<const char* const> arguments, TextFiles& files, std::ostream& output,
           std::ostream& errors) noexcept {
  messageLog().clear();
  int exitCode = kNothingDrawn;
  sayFailure(errors, [&] { exitCode = renderCommand(arguments, files, output, errors); });
  return exitCode;
}

}  // namespace frontpanels

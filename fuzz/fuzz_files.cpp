#include "fuzz/fuzz_files.h"

#include <bit>
#include <vector>

namespace frontpanels::fuzz {
namespace {

void add(std::string& text, float value) {
  text += std::to_string(std::bit_cast<std::uint32_t>(value)) + " ";
}

void add(std::string& text, const std::optional<PilotLevels>& levels) {
  text += levels ? "levels " : "none ";
  if (!levels) return;
  add(text, levels->ioDbm);
  for (const float level : levels->ecIoDb) add(text, level);
}

void add(std::string& text, const std::optional<PilotBars>& bars) {
  text += bars ? "bars " : "none ";
  if (!bars) return;
  for (const PilotRecord& pilot : bars->pilots) {
    add(text, pilot.pnOffset);
    add(text, pilot.aggregateMinusPeakDb);
  }
}

std::unique_ptr<FrameSource> opened(TextFiles& files, std::size_t maxBookmarks) {
  constexpr int kInvalidFileFormat = 321;
  try {
    return openRecording(files, "fuzz", {}, maxBookmarks);
  } catch (const RuntimeError& error) {
    require(error.number() == kInvalidFileFormat, "what is no recording is refused as that");
    require(error.description().starts_with("fuzz: "), "an error names the file");
    return nullptr;
  }
}

void requirePlausible(const Frame& frame) {
  if (!frame.sweep) return;
  require(frame.sweep->number == frame.number, "a sweep has the number of its frame");
  require(frame.sweep->levelsDb.size() <= kMaxSweepBins, "a sweep is bounded");
  require(frame.sweep->levelsDb.empty() || frame.sweep->stepHz > 0, "bins have frequencies");
}

}  // namespace

std::string textOf(const Frame& frame) {
  std::string text = std::to_string(frame.number) + " " + frame.time + " ";
  if (frame.sweep) {
    text += std::to_string(frame.sweep->startHz) + " " + std::to_string(frame.sweep->stepHz) + " ";
    for (const float level : frame.sweep->levelsDb) add(text, level);
  }
  if (!frame.pilots) return text;
  add(text, frame.pilots->allPilots);
  add(text, frame.pilots->zoomedPilots);
  add(text, frame.pilots->topN);
  add(text, frame.pilots->userList);
  return text + (frame.pilots->carrier ? "carrier" : "none");
}

std::unique_ptr<FrameSource> playEverything(TextFiles& files) {
  constexpr std::size_t kFewBookmarks = 2;
  constexpr std::uint64_t kFramesSought = 8;
  std::unique_ptr<FrameSource> source = opened(files, kFewBookmarks);
  if (!source) return nullptr;
  std::vector<std::string> texts;
  Frame frame;
  for (; source->next(frame); texts.push_back(textOf(frame))) {
    requirePlausible(frame);
    require(frame.number == texts.size() + 1, "frames are numbered");
  }
  require(source->frameCount() == texts.size(), "all frames play that were counted");
  const std::string report = source->problemReport();
  for (std::uint64_t number = texts.size(); number > 0 && texts.size() - number < kFramesSought; --number) {
    source->seek(number);
    require(source->next(frame) && textOf(frame) == texts[number - 1], "seeking gives the frame that plays");
  }
  require(source->problemReport() == report, "reading again reports nothing more");
  return source;
}

}  // namespace frontpanels::fuzz

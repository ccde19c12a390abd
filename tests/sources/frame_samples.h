// Frames as tests capture and compare them.
#pragma once

#include <cmath>
#include <cstdio>
#include <string>

#include "sources/frame.h"
#include "sources/frame_source.h"

namespace frontpanels::testing {

// A short text of all that a frame holds; gaps read "gap".
class FrameText {
 public:
  static std::string of(const Frame& frame) {
    FrameText text;
    text.result_ = std::to_string(frame.number) + " " + frame.time;
    if (frame.sweep) text.add(*frame.sweep, frame);
    if (frame.pilots) text.add(*frame.pilots);
    return text.result_;
  }

 private:
  void add(const Sweep& sweep, const Frame& frame) {
    result_ += sweep.number == frame.number && sweep.time == frame.time ? " sweep" : " ANOTHER sweep";
    number(sweep.startHz);
    number(sweep.stepHz);
    number(static_cast<double>(sweep.rows));
    for (const float level : sweep.levelsDb) number(static_cast<double>(level));
  }
  void add(const PilotFrame& pilots) {
    result_ += " pilots";
    add(" all", pilots.allPilots);
    add(" zoomed", pilots.zoomedPilots);
    add(" top", pilots.topN);
    add(" user", pilots.userList);
    if (!pilots.carrier) return;
    result_ += " carrier";
    number(pilots.carrier->frequencyErrorHz);
    number(pilots.carrier->frequencyState);
    number(pilots.carrier->onePps);
  }
  void add(const char* name, const std::optional<PilotLevels>& levels) {
    if (!levels) return;
    result_ += name;
    number(static_cast<double>(levels->ioDbm));
    for (const float level : levels->ecIoDb) number(static_cast<double>(level));
  }
  void add(const char* name, const std::optional<PilotBars>& bars) {
    if (!bars) return;
    result_ += name;
    number(static_cast<double>(bars->ioDbm));
    for (const PilotRecord& pilot : bars->pilots)
      for (const float value : {pilot.pnOffset, pilot.peakEcIoDb, pilot.delayChips, pilot.aggregateEcIoDb,
                                pilot.delaySpreadChips, pilot.aggregateMinusPeakDb})
        number(static_cast<double>(value));
  }
  void number(double value) {
    char text[32];
    std::snprintf(text, sizeof text, std::isnan(value) ? " gap" : " %g", value);
    result_ += text;
  }

  std::string result_;
};

// All frames from where the source stands, a line each.
inline std::string textOfAll(FrameSource& source) {
  std::string all;
  for (Frame frame; source.next(frame);) all += FrameText::of(frame) + "\n";
  return all;
}

inline Frame sweepFrame(const char* time, std::vector<float> levelsDb) {
  Frame frame;
  frame.time = time;
  frame.sweep.emplace();
  frame.sweep->startHz = 100;
  frame.sweep->stepHz = 10;
  frame.sweep->rows = 1;
  frame.sweep->levelsDb = std::move(levelsDb);
  return frame;
}

// With all that there can be.
inline Frame fullFrame(const char* time) {
  Frame frame = sweepFrame(time, {-1.5F, kGap});
  PilotFrame& pilots = frame.pilots.emplace();
  pilots.allPilots = {-60.5F, {-3, kGap, -5}};
  pilots.zoomedPilots = {-61, {}};
  pilots.topN = {-62, {{12, -3, 1.5F, -2.5F, 0.5F, 0.25F}, {8, -9, 0, -8, 1, 1}}};
  pilots.userList = {-63, {}};
  pilots.carrier = {-12.5, 2, 1};
  return frame;
}
inline constexpr const char* kFullFrameText =
    " sweep 100 10 1 -1.5 gap pilots all -60.5 -3 gap -5 zoomed -61"
    " top -62 12 -3 1.5 -2.5 0.5 0.25 8 -9 0 -8 1 1 user -63 carrier -12.5 2 1";

}  // namespace frontpanels::testing

#include "sources/sweep_recording.h"

#include <algorithm>
#include <cmath>
#include <string_view>
#include <utility>

#include "platform/runtime_error.h"
#include "sources/named_files.h"

namespace frontpanels {
namespace {

// How far into a file its first row is looked for.
constexpr std::uint64_t kHeadLines = 1000;
constexpr std::uint64_t kHeadBytes = std::uint64_t{4} << 20;

// A shell of Windows that redirects a program's output writes UTF-16.
bool isUtf16(std::string_view text) { return text.starts_with("\xff\xfe") || text.starts_with("\xfe\xff"); }

// hackrf_sweep samples at 20 MHz and hands out a quarter of that a row; its samples are those of one
// transform. Its newer versions print fractions of a second, which rtl_power never does.
SweepFormat formatOf(const SweepRow& row) {
  constexpr double kRowHz = 5e6;
  constexpr double kSampleRateHz = 20e6;
  const bool hackrfRow = std::abs(row.highHz - row.lowHz - kRowHz) < 1.0 &&
                         std::abs(row.samples * row.stepHz - kSampleRateHz) < kSampleRateHz / 100;
  return hackrfRow || row.time.find('.') != std::string::npos ? SweepFormat::HackrfSweep
                                                              : SweepFormat::RtlPower;
}

std::string lineText(const RowProblem& problem) {
  return "\n  line " + std::to_string(problem.line) + ": " + problem.text;
}

std::string rowsText(std::uint64_t count) { return std::to_string(count) + (count == 1 ? " row" : " rows"); }

}  // namespace

const char* sweepFormatName(SweepFormat format) noexcept {
  return format == SweepFormat::RtlPower ? "rtl_power" : "hackrf_sweep";
}

std::unique_ptr<SweepRecording> SweepRecording::open(TextFiles& files, const std::string& path) {
  std::unique_ptr<SweepRecording> recording(new SweepRecording(files, path));
  recording->rewind();
  return recording;
}

void SweepRecording::rewind() {
  openAnew();
  cutShort_ = false;
  mixed_ = false;
  unreadableRows_ = 0;
  rowsOutOfOrder_ = 0;
  problems_.clear();
  recognise();
}

void SweepRecording::openAnew() {
  reader_ = namingFile(path_, [this] { return files_.open(path_, kMaxLineBytes); });
  readFailed_ = false;
  rowPending_ = false;
  startSweep();
  sweepNumber_ = 0;
}

FramePlace SweepRecording::place() const {
  return rowPending_ ? rowPlace_ : FramePlace{reader_->positionBytes(), line_.number};
}

void SweepRecording::goTo(const FramePlace& place) {
  openAnew();
  namingFile(path_, [&] { reader_->goTo(place.bytes, place.linesBefore); });
  line_.number = place.linesBefore;
}

void SweepRecording::recognise() {
  line_.number = 0;
  while (line_.number < kHeadLines && reader_->positionBytes() < kHeadBytes && readLine()) {
    if (line_.number == 1 && isUtf16(line_.text))
      refuseFile(path_, "UTF-16 text; save it as UTF-8 or plain text");
    if (line_.text.empty()) continue;
    if (parseSweepRow(line_.text, row_, problem_)) {
      rowPending_ = true;
      rowLine_ = line_.number;
      rowPlace_ = linePlace_;
      format_ = formatOf(row_);
      lastBinTwice_ = row_.rangeBins != 0 && row_.writtenValues == row_.rangeBins + 1;
      return;
    }
    noteUnreadable(line_.number, problem_);
  }
  if (problems_.empty()) refuseFile(path_, "the file is empty");
  std::string reason = "not a recording of rtl_power or hackrf_sweep";
  for (const RowProblem& problem : problems_) reason += lineText(problem);
  refuseFile(path_, reason);
}

bool SweepRecording::next(Sweep& sweep) {
  startSweep();
  while (rowPending_ || readRow()) {
    rowPending_ = true;
    const Fit fit = rows_.empty() ? Fit::SameSweep : fitOfRow();
    if (fit == Fit::NextSweep) break;
    rowPending_ = false;
    if (fit == Fit::Repeated) {
      noteUnreadable(rowLine_, "the same frequencies as the row before");
    } else {
      placeRow();
    }
  }
  if (rows_.empty()) return false;
  if (!rowPending_) distrustLastValue();
  finishSweep(sweep);
  return true;
}

// A file that cannot be read further ends here; what came before is kept.
bool SweepRecording::readLine() {
  if (readFailed_) return false;
  linePlace_ = {reader_->positionBytes(), line_.number};
  try {
    if (!reader_->readLine(line_)) return false;
  } catch (const RuntimeError& error) {
    readFailed_ = true;
    cutShort_ = true;
    keepProblem(line_.number + 1, "the file cannot be read further: " + error.description());
    return false;
  }
  constexpr std::string_view kUtf8Mark = "\xef\xbb\xbf";
  if (line_.number == 1 && line_.text.starts_with(kUtf8Mark)) line_.text.erase(0, kUtf8Mark.size());
  return true;
}

bool SweepRecording::readRow() {
  while (readLine()) {
    if (line_.text.find_first_not_of(" \t\r") == std::string::npos) continue;
    rowLine_ = line_.number;
    rowPlace_ = linePlace_;
    if (line_.cut) {
      noteUnreadable(rowLine_, "longer than " + std::to_string(kMaxLineBytes) + " bytes");
    } else if (parseSweepRow(line_.text, row_, problem_)) {
      return true;
    } else {
      noteUnreadable(rowLine_, problem_);
    }
  }
  return false;
}

// A sweep ends where a frequency comes again, normally the lowest one. The other signs are for what else is
// found in files: a recording that begins in the middle of a sweep, one that was stopped and continued, two
// put together.
SweepRecording::Fit SweepRecording::fitOfRow() const {
  const double lowestHz = rows_.begin()->first;
  const bool otherStep = std::abs(row_.stepHz - stepHz_) > std::max(0.02, stepHz_ * 1e-3);
  if (otherStep) return Fit::NextSweep;
  if (rowIsPlaced()) {
    const bool rowTwice = row_.lowHz == previousLowHz_ && row_.lowHz > lowestHz && row_.time == previousTime_;
    return rowTwice ? Fit::Repeated : Fit::NextSweep;
  }
  // rtl_power's hops rise and carry one time; hackrf_sweep's go forth and back above the lowest.
  const double floorHz = sweepFormat_ == SweepFormat::RtlPower ? previousLowHz_ : lowestHz;
  return row_.lowHz < floorHz && row_.time != previousTime_ ? Fit::NextSweep : Fit::SameSweep;
}

// Rows less than half a bin apart are the same row.
bool SweepRecording::rowIsPlaced() const {
  const auto above = rows_.lower_bound(row_.lowHz - stepHz_ / 2);
  return above != rows_.end() && above->first < row_.lowHz + stepHz_ / 2;
}

bool SweepRecording::hasRoomForRow() const {
  const double rowEndHz = row_.lowHz + stepHz_ * static_cast<double>(row_.levelsDb.size());
  const double lowHz = std::min(rows_.begin()->first, row_.lowHz);
  return (std::max(endHz_, rowEndHz) - lowHz) / stepHz_ <= static_cast<double>(kMaxSweepBins) &&
         levels_.size() + row_.levelsDb.size() <= kMaxSweepBins && rows_.size() < kMaxRows;
}

void SweepRecording::placeRow() {
  if (!rows_.empty() && !hasRoomForRow()) {
    constexpr const char* kTooFar = "too far from the other rows for one sweep";
    // Of two rows the first is the one to doubt: what follows shows the second right or wrong.
    noteUnreadable(rows_.size() == 1 ? rows_.begin()->second.line : rowLine_, kTooFar);
    if (rows_.size() > 1) return;
    startSweep();
  }
  if (rows_.empty()) {
    if (sweepNumber_ > 0 && row_.time < sweepTime_) noteOutOfOrder("its sweep is older than the one before");
    noteFormat();
    stepHz_ = row_.stepHz;
    sweepTime_ = row_.time;
    endHz_ = row_.lowHz;
  } else if (sweepFormat_ == SweepFormat::RtlPower && row_.lowHz < previousLowHz_) {
    noteOutOfOrder("out of order: its frequency is below that of the row before");
  }
  rows_.emplace_hint(rows_.end(), row_.lowHz, Placed{levels_.size(), row_.levelsDb.size(), rowLine_});
  levels_.insert(levels_.end(), row_.levelsDb.begin(), row_.levelsDb.end());
  endHz_ = std::max(endHz_, row_.lowHz + stepHz_ * static_cast<double>(row_.levelsDb.size()));
  previousLowHz_ = row_.lowHz;
  previousTime_ = row_.time;
}

// Files put together may hold both.
void SweepRecording::noteFormat() {
  sweepFormat_ = formatOf(row_);
  if (sweepFormat_ == format_ || mixed_) return;
  mixed_ = true;
  keepProblem(rowLine_, std::string("from here on also ") + sweepFormatName(sweepFormat_));
}

void SweepRecording::startSweep() {
  rows_.clear();
  levels_.clear();
}

// Where a file breaks off, "-65.79" may read as "-6", which would stand out as a carrier. A last row without
// its line end is believed when it has all of its values and the last one has no fewer decimals than the
// first.
void SweepRecording::distrustLastValue() {
  const bool rowIsLast = rowLine_ == rows_.at(previousLowHz_).line;
  const std::size_t expected = row_.rangeBins + (lastBinTwice_ ? 1 : 0);
  const bool whole = line_.ended || (row_.writtenValues >= expected && !row_.lastValueShorter);
  if (!rowIsLast || whole) return;
  const bool lastDropped = row_.writtenValues == row_.rangeBins + 1;
  if (!lastDropped) levels_.back() = kGap;
  cutShort_ = true;
  keepProblem(rowLine_, "the file ends within this row; its last value is left out");
}

void SweepRecording::finishSweep(Sweep& sweep) {
  sweep.number = ++sweepNumber_;
  sweep.time = sweepTime_;
  sweep.startHz = rows_.begin()->first;
  sweep.stepHz = stepHz_;
  sweep.rows = rows_.size();
  sweep.levelsDb.clear();
  for (const auto& [lowHz, placed] : rows_) {
    const auto firstBin = static_cast<std::size_t>(std::llround((lowHz - sweep.startHz) / stepHz_));
    const std::size_t bins = std::max(sweep.levelsDb.size(), firstBin + placed.bins);
    sweep.levelsDb.resize(bins, kGap);
    for (std::size_t i = 0; i < placed.bins; ++i) {
      float& level = sweep.levelsDb[firstBin + i];
      level = largerLevel(level, levels_[placed.firstLevel + i]);
    }
  }
}

void SweepRecording::noteUnreadable(std::uint64_t line, std::string text) {
  ++unreadableRows_;
  keepProblem(line, std::move(text));
}

void SweepRecording::noteOutOfOrder(std::string text) {
  ++rowsOutOfOrder_;
  keepProblem(rowLine_, std::move(text));
}

void SweepRecording::keepProblem(std::uint64_t line, std::string text) {
  if (problems_.size() < kKeptProblems) problems_.push_back({line, std::move(text)});
}

std::string SweepRecording::problemReport() const {
  if (problems_.empty()) return {};
  std::string report = path_ + ":";
  const auto add = [&report](const std::string& text) {
    report += (report.ends_with(':') ? " " : ", ") + text;
  };
  if (unreadableRows_ != 0) add(rowsText(unreadableRows_) + " could not be read");
  if (rowsOutOfOrder_ != 0) add(rowsText(rowsOutOfOrder_) + " out of order");
  if (mixed_) add("of two formats");
  if (cutShort_) add("cut short");
  for (const RowProblem& problem : problems_) report += lineText(problem);
  if (unreadableRows_ + rowsOutOfOrder_ > problems_.size()) report += "\n  ...";
  return report;
}

}  // namespace frontpanels

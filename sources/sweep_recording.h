// Recordings of rtl_power and hackrf_sweep, read one sweep at a time: however long the file is, what is held
// is one sweep and one row of it.
#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "platform/textfile.h"
#include "sources/frame_reader.h"
#include "sources/sweep.h"
#include "sources/sweep_row.h"

namespace frontpanels {

enum class SweepFormat { RtlPower, HackrfSweep };
[[nodiscard]] const char* sweepFormatName(SweepFormat format) noexcept;

// What was wrong with a line.
struct RowProblem {
  std::uint64_t line = 0;
  std::string text;  // reads on from "line 12: "
  friend bool operator==(const RowProblem&, const RowProblem&) = default;
};

class SweepRecording {
 public:
  static constexpr std::size_t kMaxRows = std::size_t{1} << 18;  // of one sweep
  static constexpr std::size_t kMaxLineBytes = std::size_t{32}
                                               << 20;  // eight bytes a bin of the finest sweep
  static constexpr std::size_t kKeptProblems = 5;

  // The format is recognised from the content. Raises a run-time error whose description names the file: when
  // it cannot be opened, is empty, or has no row of either format among its first lines. `files` must outlive
  // the recording.
  [[nodiscard]] static std::unique_ptr<SweepRecording> open(TextFiles& files, const std::string& path);

  // False at the end of the recording; `sweep` is then unspecified. Capacity of `sweep` is reused. Raises
  // nothing for rows that cannot be read: they are counted, and the first ones kept by line number.
  bool next(Sweep& sweep);
  // Back to before the first sweep; the counts begin anew. Raises as `open` does.
  void rewind();

  // Where the sweep to come begins, and back to there; sweeps are then counted from 1 again, the problems go
  // on being counted. Raises as `open` does.
  [[nodiscard]] FramePlace place() const;
  void goTo(const FramePlace& place);

  [[nodiscard]] const std::string& path() const noexcept { return path_; }
  [[nodiscard]] SweepFormat format() const noexcept { return format_; }
  [[nodiscard]] std::uint64_t positionBytes() const { return reader_->positionBytes(); }
  [[nodiscard]] std::uint64_t sizeBytes() const { return reader_->sizeBytes(); }

  [[nodiscard]] std::uint64_t unreadableRows() const noexcept { return unreadableRows_; }
  // Rows and sweeps that were read but are not where they belong.
  [[nodiscard]] std::uint64_t rowsOutOfOrder() const noexcept { return rowsOutOfOrder_; }
  // The first ones.
  [[nodiscard]] const std::vector<RowProblem>& problems() const noexcept { return problems_; }
  // For the user: what was wrong, and the first of it by line number, a line each; empty when nothing was.
  [[nodiscard]] std::string problemReport() const;

 private:
  struct Placed {
    std::size_t firstLevel = 0;  // in levels_
    std::size_t bins = 0;
    std::uint64_t line = 0;
  };
  enum class Fit { SameSweep, NextSweep, Repeated };

  SweepRecording(TextFiles& files, std::string path) : files_(files), path_(std::move(path)) {}

  void recognise();
  void openAnew();
  bool readLine();
  bool readRow();
  [[nodiscard]] Fit fitOfRow() const;
  [[nodiscard]] bool rowIsPlaced() const;
  [[nodiscard]] bool hasRoomForRow() const;
  void placeRow();
  void noteFormat();
  void startSweep();
  void distrustLastValue();
  void finishSweep(Sweep& sweep);
  void noteUnreadable(std::uint64_t line, std::string text);
  void noteOutOfOrder(std::string text);
  void keepProblem(std::uint64_t line, std::string text);

  TextFiles& files_;
  std::string path_;
  std::unique_ptr<TextReader> reader_;
  bool readFailed_ = false;
  bool cutShort_ = false;
  SweepFormat format_ = SweepFormat::RtlPower;
  bool lastBinTwice_ = false;
  bool mixed_ = false;  // with rows of the other format

  TextLine line_;
  FramePlace linePlace_;
  SweepRow row_;
  std::uint64_t rowLine_ = 0;
  FramePlace rowPlace_;
  bool rowPending_ = false;  // row_ is read and belongs to the sweep to come
  std::string problem_;

  // The sweep that is being put together. Rows come in any order, so they are placed on the grid at its end.
  std::map<double, Placed> rows_;  // by low frequency
  std::vector<float> levels_;
  std::string sweepTime_;
  SweepFormat sweepFormat_ = SweepFormat::RtlPower;
  double stepHz_ = 0;
  double endHz_ = 0;
  double previousLowHz_ = 0;
  std::string previousTime_;
  std::uint64_t sweepNumber_ = 0;

  std::uint64_t unreadableRows_ = 0;
  std::uint64_t rowsOutOfOrder_ = 0;
  std::vector<RowProblem> problems_;
};

}  // namespace frontpanels

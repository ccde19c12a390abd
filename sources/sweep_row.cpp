#include "sources/sweep_row.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <limits>
#include <optional>

#include "sources/sweep.h"

namespace frontpanels {
namespace {

constexpr double kMaxFrequencyHz = 1e13;
// Half a unit of the second decimal, to which both receivers print the step, and some more for the
// subtraction.
constexpr double kPrintedStepTolerance = 0.0051;

std::string_view trimmed(std::string_view text) {
  constexpr std::string_view kBlanks = " \t\r\v\f";
  const auto first = text.find_first_not_of(kBlanks);
  if (first == std::string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

// Walks the fields of a line, blanks around them left out.
class Fields {
 public:
  explicit Fields(std::string_view line) : rest_(line) {}

  bool next(std::string_view& field) {
    if (atEnd_) return false;
    const auto comma = rest_.find(',');
    field = trimmed(rest_.substr(0, comma));
    atEnd_ = comma == std::string_view::npos;
    if (!atEnd_) rest_.remove_prefix(comma + 1);
    return true;
  }

 private:
  std::string_view rest_;
  bool atEnd_ = false;
};

// Does `text` look like `pattern`, where '0' stands for any digit?
bool matches(std::string_view text, std::string_view pattern) {
  const auto same = [](char c, char p) { return p == '0' ? c >= '0' && c <= '9' : c == p; };
  return text.size() == pattern.size() && std::equal(text.begin(), text.end(), pattern.begin(), same);
}

bool isTimeOfDay(std::string_view text) {
  if (!matches(text.substr(0, 8), "00:00:00")) return false;
  const std::string_view fraction = text.substr(8);
  return fraction.empty() ||
         (fraction.front() == '.' && fraction.find_first_not_of("0123456789", 1) == std::string_view::npos);
}

std::optional<double> number(std::string_view text) {
  if (text.starts_with('+')) text.remove_prefix(1);
  double value = 0;
  const char* const end = text.data() + text.size();
  const auto [stop, error] = std::from_chars(text.data(), end, value);
  if (error != std::errc{} || stop != end) return std::nullopt;
  return value;
}

bool isFrequency(std::optional<double> hz) { return hz && *hz >= 0 && *hz <= kMaxFrequencyHz; }

// Old Microsoft libraries print what is not a number as 1.#J, 1.#IND, 1.#INF, 1.#QNAN, with or without a
// sign.
bool isMicrosoftNotANumber(std::string_view text) {
  if (text.starts_with('-') || text.starts_with('+')) text.remove_prefix(1);
  return text.starts_with("1.#");
}

// A level, a gap for a missing one; nothing when the text is neither.
std::optional<float> level(std::string_view text) {
  if (text.empty() || isMicrosoftNotANumber(text)) return kGap;
  const std::optional<double> value = number(text);
  if (!value) return std::nullopt;
  const bool finite = std::abs(*value) <= static_cast<double>(std::numeric_limits<float>::max());
  return finite ? static_cast<float>(*value) : kGap;
}

std::size_t decimals(std::string_view text) {
  const auto point = text.find('.');
  return point == std::string_view::npos ? 0 : text.size() - point - 1;
}

std::string excerpt(std::string_view text) {
  constexpr std::size_t kShownChars = 40;
  std::string shown = "\"";
  for (const char c : text.substr(0, kShownChars)) shown += c >= ' ' && c <= '~' ? c : '?';
  return shown + (text.size() > kShownChars ? "...\"" : "\"");
}

bool isText(std::string_view line) {
  return std::none_of(line.begin(), line.end(), [](char c) { return c >= 0 && c < ' ' && c != '\t'; });
}

bool parseTime(Fields& fields, SweepRow& row) {
  std::string_view date;
  std::string_view time;
  if (!fields.next(date) || !matches(date, "0000-00-00")) return false;
  if (!fields.next(time) || time.size() < 8 || !isTimeOfDay(time)) return false;
  row.time.assign(date).append(1, ' ').append(time);
  return true;
}

bool parseRange(Fields& fields, SweepRow& row, std::string& problem) {
  struct Column {
    const char* name;
    double SweepRow::*target;
  };
  constexpr Column kColumns[] = {{"low frequency", &SweepRow::lowHz},
                                 {"high frequency", &SweepRow::highHz},
                                 {"step", &SweepRow::stepHz},
                                 {"number of samples", &SweepRow::samples}};
  for (const Column& column : kColumns) {
    std::string_view field;
    if (!fields.next(field)) {
      problem = std::string("ends before its ") + column.name;
      return false;
    }
    const std::optional<double> value = number(field);
    if (!isFrequency(value)) {
      problem = std::string("its ") + column.name + " is " + excerpt(field);
      return false;
    }
    row.*column.target = *value;
  }
  if (row.stepHz > 0) return true;
  problem = "its step is 0";
  return false;
}

bool parseLevels(Fields& fields, SweepRow& row, std::string& problem) {
  row.levelsDb.clear();
  std::string_view field;
  std::string_view first;
  std::string_view last;
  std::size_t values = 0;  // up to the last field that is not empty
  for (std::size_t read = 1; fields.next(field); ++read) {
    if (field.empty()) continue;  // a gap when something follows it, otherwise a trailing separator
    if (read > kMaxSweepBins) {
      problem = "has more than " + std::to_string(kMaxSweepBins) + " values";
      return false;
    }
    const std::optional<float> value = level(field);
    if (!value) {
      problem = "its value " + std::to_string(read) + " is " + excerpt(field);
      return false;
    }
    row.levelsDb.resize(read - 1, kGap);
    row.levelsDb.push_back(*value);
    if (values == 0) first = field;
    last = field;
    values = read;
  }
  row.writtenValues = values;
  row.lastValueShorter = decimals(last) < decimals(first);
  return true;
}

// Sets the number of bins that the range holds and drops the value that is written twice.
void settleCount(SweepRow& row) {
  const double bins = std::round((row.highHz - row.lowHz) / row.stepHz);
  row.rangeBins =
      bins >= 1 && bins <= static_cast<double>(kMaxSweepBins) ? static_cast<std::size_t>(bins) : 0;
  if (row.rangeBins == 0) return;
  if (row.writtenValues == row.rangeBins + 1) row.levelsDb.pop_back();
  // The printed step is rounded; over thousands of bins that adds up to whole bins.
  const double exactStepHz = (row.highHz - row.lowHz) / static_cast<double>(row.rangeBins);
  if (std::abs(exactStepHz - row.stepHz) <= kPrintedStepTolerance) row.stepHz = exactStepHz;
}

}  // namespace

bool parseSweepRow(std::string_view text, SweepRow& row, std::string& problem) {
  Fields fields(text);
  if (!parseTime(fields, row)) {
    problem = isText(text) ? "does not begin with a date and a time: " + excerpt(text)
                           : std::string("holds bytes that are not text");
    return false;
  }
  if (!parseRange(fields, row, problem) || !parseLevels(fields, row, problem)) return false;
  if (row.writtenValues == 0) {
    problem = "has no values";
    return false;
  }
  settleCount(row);
  return true;
}

}  // namespace frontpanels

#include "pilot/import_list_parser.h"

#include <utility>

#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

// Written by editors at the very beginning of a file in UTF-8; no part of the first argument.
constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";

// Takes the text in front of the separator off the rest of a line, and the separator with it.
std::string_view takeToken(std::string_view& rest, std::string_view separator) {
  const std::size_t end = rest.find(separator);
  const std::string_view token = rest.substr(0, end);
  rest = end == std::string_view::npos ? std::string_view() : rest.substr(end + separator.size());
  return token;
}

std::string_view withoutBlanks(std::string_view text) {
  const std::size_t first = text.find_first_not_of(' ');
  if (first == std::string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(' ') - first + 1);
}

}  // namespace

void ImportListParser::FileOpen(const std::string& path) { file_ = files_.open(path, kLongestLineBytes); }

// Empty at the end of the file. A file without line ends or with zero bytes is no list: its pieces would only
// fill the user's list with rubbish.
std::string_view ImportListParser::nextLine() {
  if (file_ == nullptr) raiseObjectVariableNotSet();
  if (!file_->readLine(line_)) return {};
  std::string_view text = line_.text;
  if (line_.cut || text.find('\0') != std::string_view::npos) raiseInvalidFileFormat();
  if (line_.number == 1 && text.starts_with(kByteOrderMark)) text.remove_prefix(kByteOrderMark.size());
  return text;
}

bool ImportListParser::ParseEntry() {
  for (std::string& argument : arguments_) argument.clear();
  std::string_view rest = nextLine();
  const std::string& separator = separators_.listSeparator();
  std::size_t count = 0;
  while (!rest.empty()) {
    const std::string_view token = withoutBlanks(takeToken(rest, separator));
    if (count == kMostArguments) raiseSubscriptOutOfRange();
    arguments_[count++] = token;
  }
  return count != 0;
}

const std::string& ImportListParser::GetArg(std::int32_t index) const {
  if (index < 0 || std::cmp_greater_equal(index, kMostArguments)) raiseSubscriptOutOfRange();
  return arguments_[static_cast<std::size_t>(index)];
}

}  // namespace frontpanels

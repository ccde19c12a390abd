// Reads a list from a text file: a line an entry, split into arguments at the user's list separator.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

#include "framework/support/utility.h"
#include "platform/textfile.h"

namespace frontpanels {

class ImportListParser {
 public:
  static constexpr std::size_t kMostArguments = 9;
  static constexpr std::size_t kLongestLineBytes = 65536;

  // Both must outlive this.
  ImportListParser(TextFiles& files, RegionalSeparators& separators)
      : files_(files), separators_(separators) {}

  // `path` is UTF-8. Raises what TextFiles::open raises; the file that was open then stays so.
  void FileOpen(const std::string& path);

  // Takes the next line apart. False for an empty line and at the end of the file. Raises "Object variable or
  // With block variable not set" before the first FileOpen, "Subscript out of range" for a tenth argument,
  // "Invalid file format" for what is no line of text and "Device I/O error".
  [[nodiscard]] bool ParseEntry();

  // From 0 to 8, of the line that was parsed last, without the blanks round it; empty where the line has no
  // such argument. Raises "Subscript out of range".
  [[nodiscard]] const std::string& GetArg(std::int32_t index) const;

 private:
  [[nodiscard]] std::string_view nextLine();

  TextFiles& files_;
  RegionalSeparators& separators_;
  std::unique_ptr<TextReader> file_;
  TextLine line_;
  std::array<std::string, kMostArguments> arguments_;
};

}  // namespace frontpanels

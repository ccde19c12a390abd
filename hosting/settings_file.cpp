#include "hosting/settings_file.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <set>

#include "framework/support/utf8.h"
#include "hosting/file_text.h"
#include "hosting/number_text.h"
#include "hosting/setting_names.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

constexpr int kInvalidFileFormat = 321;
constexpr std::int32_t kFormat = 1;
constexpr std::string_view kFirstLine = "# Front Panels settings, format ";
constexpr std::string_view kAbout =
    "# Written when the program ends: change it while the program does not run. A value may be followed by "
    "a\n"
    "# comment; % and two hexadecimal digits stand for a byte (%25 is a percent sign, %23 a number sign). "
    "Below\n"
    "# [spectrum] and [pilots] a number is the code of a setting of the panel. The last line must stay.\n";
constexpr std::string_view kEndBegins = "# checksum ";
constexpr std::string_view kEndCloses = ", end of the settings";
constexpr std::size_t kChecksumDigits = 8;
constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";
// What a name must not hold as it is.
constexpr std::string_view kNameMarks = "=[]";

// The usual 32-bit cyclic redundancy check: of zip files and of the command crc32.
std::uint32_t checksum(std::string_view text) noexcept {
  constexpr std::uint32_t kPolynomial = 0xEDB88320U;
  std::uint32_t sum = ~0U;
  for (const char c : text) {
    sum ^= static_cast<unsigned char>(c);
    for (int bit = 0; bit < 8; ++bit) sum = (sum >> 1U) ^ ((sum & 1U) != 0 ? kPolynomial : 0U);
  }
  return ~sum;
}

std::string hexText(std::uint32_t number) {
  std::array<char, kChecksumDigits> digits{};
  const auto end = std::to_chars(digits.data(), digits.data() + digits.size(), number, 16);
  const std::string text(digits.data(), end.ptr);
  return std::string(kChecksumDigits - text.size(), '0') + text;
}

// The checksum that an end line states; nothing when it is none.
std::optional<std::uint32_t> endLine(std::string_view line) noexcept {
  if (!line.starts_with(kEndBegins) || !line.ends_with(kEndCloses) ||
      line.size() != kEndBegins.size() + kChecksumDigits + kEndCloses.size())
    return std::nullopt;
  const char* const digits = line.data() + kEndBegins.size();
  std::uint32_t sum = 0;
  const auto [end, error] = std::from_chars(digits, digits + kChecksumDigits, sum, 16);
  if (error != std::errc{} || end != digits + kChecksumDigits) return std::nullopt;
  return sum;
}

void requireName(std::string_view name) {
  if (name.empty()) raiseInvalidProcedureCall();
}

// A number at the front of a line is the code of a setting.
bool beginsANumber(std::string_view text) noexcept {
  return !text.empty() && (text.front() == '-' || (text.front() >= '0' && text.front() <= '9'));
}

std::string escapedName(std::string_view name) {
  if (!beginsANumber(name)) return escapedForLine(name, kNameMarks);
  return escapedForLine(name.substr(0, 1), name.substr(0, 1)) + escapedForLine(name.substr(1), kNameMarks);
}

template <class Container>
auto findByName(Container& sections, std::string_view name) noexcept {
  return std::find_if(sections.begin(), sections.end(),
                      [name](const SettingsSection& section) { return section.name() == name; });
}

template <class Values>
auto valueOf(Values& values, std::string_view name) noexcept {
  return std::find_if(values.begin(), values.end(),
                      [name](const SettingsSection::Value& value) { return value.first == name; });
}

}  // namespace

// --- Reading

class SettingsParser {
 public:
  // Whether the checksum holds.
  bool run(std::string_view text, SettingsFile& file) {
    if (text.starts_with(kByteOrderMark)) text.remove_prefix(kByteOrderMark.size());
    if (text.empty()) throw RuntimeError(kInvalidFileFormat, "the file is empty");
    const std::string_view whole = text;
    std::optional<std::uint32_t> stated;
    bool same = false;
    while (!text.empty()) {
      const std::size_t before = whole.size() - text.size();
      const std::string_view line = nextLine(text);
      if (stated && !line.empty()) fail("something follows the end of the settings");
      if (number_ == 1)
        readFirst(line);
      else if (const auto sum = endLine(line))
        same = checksum(whole.substr(0, before)) == *(stated = sum);
      else
        readLine(line, file);
    }
    if (!stated) fail("the end of the settings is missing: the file was cut");
    return same;
  }

 private:
  [[noreturn]] void fail(const std::string& reason) const {
    throw RuntimeError(kInvalidFileFormat, "line " + std::to_string(number_) + ": " + reason);
  }

  std::string_view nextLine(std::string_view& text) {
    ++number_;
    const std::size_t feed = std::min(text.find('\n'), text.size());
    std::string_view line = text.substr(0, feed);
    text.remove_prefix(std::min(feed + 1, text.size()));
    if (line.ends_with('\r')) line.remove_suffix(1);
    for (std::size_t at = 0; at < line.size();) {
      const std::size_t bytes = utf8CharacterBytes(line.substr(at));
      if (bytes == 0) fail("this is no UTF-8");
      const auto c = static_cast<unsigned char>(line[at]);
      if ((c < ' ' && c != '\t') || c == 0x7F) fail("a control character (" + std::to_string(c) + ")");
      at += bytes;
    }
    return trimmedLine(line);
  }

  void readFirst(std::string_view line) const {
    if (!line.starts_with(kFirstLine)) fail("these are no settings of Front Panels");
    const std::string_view format = line.substr(kFirstLine.size());
    const std::optional<std::int32_t> number = exactNumber<std::int32_t>(format);
    if (!number) fail("these are no settings of Front Panels");
    if (*number != kFormat)
      fail("settings of format " + std::to_string(*number) + ", and this program reads format " +
           std::to_string(kFormat));
  }

  void readLine(std::string_view line, SettingsFile& file) {
    line = trimmedLine(line.substr(0, line.find('#')));
    if (line.empty()) return;
    if (line.front() == '[') return readSection(line, file);
    if (section_ == nullptr) fail("a value before the first section");
    const std::size_t equals = line.find('=');
    if (equals == std::string_view::npos) fail("no = between name and value");
    const std::string_view name = trimmedLine(line.substr(0, equals));
    const std::string value = unescaped(trimmedLine(line.substr(equals + 1)));
    if (name.empty()) fail("no name before the =");
    if (beginsANumber(name)) return readSetting(name, value);
    const std::string plainName = unescaped(name);
    if (!names_.insert(plainName).second) fail("\"" + plainName + "\" comes twice in this section");
    section_->values_.emplace_back(plainName, value);
  }

  void readSection(std::string_view line, SettingsFile& file) {
    if (!line.ends_with(']')) fail("no ] behind the name of the section");
    const std::string name = unescaped(trimmedLine(line.substr(1, line.size() - 2)));
    if (name.empty()) fail("a section without a name");
    if (!sectionNames_.insert(name).second) fail("the section [" + name + "] comes twice");
    section_ = &file.sections_.emplace_back(name);
    names_.clear();
  }

  // CODE or CODE,INDEX
  void readSetting(std::string_view name, const std::string& value) {
    const std::size_t comma = std::min(name.find(','), name.size());
    const auto code = exactNumber<std::int16_t>(trimmedLine(name.substr(0, comma)));
    const auto index = comma == name.size() ? std::int16_t{0}
                                            : exactNumber<std::int16_t>(trimmedLine(name.substr(comma + 1)));
    if (!code || !index) fail("\"" + std::string(name) + "\" is no code of a setting");
    std::optional<Variant> parsed = parseSettingValue(value);
    if (!parsed) fail("\"" + value + "\" is no value of a setting");
    section_->settings_.push_back({*code, *index, std::move(*parsed)});
  }

  [[nodiscard]] std::string unescaped(std::string_view text) const {
    std::optional<std::string> plain = unescapedFromLine(text);
    if (!plain) fail("% without two hexadecimal digits");
    return std::move(*plain);
  }

  std::size_t number_ = 0;
  SettingsSection* section_ = nullptr;
  std::set<std::string> names_;  // in that section
  std::set<std::string> sectionNames_;
};

// --- Writing

namespace {

std::string settingLine(const StoredSetting& setting, std::optional<PanelKind> panel) {
  std::string line = exactText(setting.code);
  if (setting.index != 0) line += "," + exactText(setting.index);
  line += " = " + escapedForLine(settingValueText(setting.value));
  const std::string_view name = panel ? settingName(*panel, setting.code) : std::string_view();
  if (!name.empty()) line.append("  # ").append(name);
  return line + "\n";
}

std::string sectionText(const SettingsSection& section) {
  std::string text = "\n[" + escapedForLine(section.name(), kNameMarks) + "]\n";
  for (const auto& [name, value] : section.values())
    text += escapedName(name) + " = " + escapedForLine(value) + "\n";
  const std::optional<PanelKind> panel = panelOfWord(section.name());
  for (const StoredSetting& setting : section.settings()) text += settingLine(setting, panel);
  return text;
}

}  // namespace

SettingsSection::SettingsSection(std::string name) : name_(std::move(name)) { requireName(name_); }

void SettingsSection::set(std::string_view name, std::string_view text) {
  requireName(name);
  const auto found = valueOf(values_, name);
  if (found == values_.end())
    values_.emplace_back(name, text);
  else
    found->second = text;
}

void SettingsSection::set(std::string_view name, bool value) { set(name, value ? "true" : "false"); }
void SettingsSection::set(std::string_view name, std::int32_t value) {
  set(name, std::string_view(exactText(value)));
}
void SettingsSection::set(std::string_view name, double value) {
  set(name, std::string_view(exactText(value)));
}

bool SettingsSection::erase(std::string_view name) {
  const auto found = valueOf(values_, name);
  if (found == values_.end()) return false;
  values_.erase(found);
  return true;
}

template <>
std::optional<std::string> SettingsSection::get(std::string_view name) const {
  const auto found = valueOf(values_, name);
  if (found == values_.end()) return std::nullopt;
  return found->second;
}

template <>
std::optional<bool> SettingsSection::get(std::string_view name) const {
  const auto text = get<std::string>(name);
  if (text == "true") return true;
  if (text == "false") return false;
  return std::nullopt;
}

template <>
std::optional<std::int32_t> SettingsSection::get(std::string_view name) const {
  return exactNumber<std::int32_t>(get<std::string>(name).value_or(""));
}

template <>
std::optional<double> SettingsSection::get(std::string_view name) const {
  return exactNumber<double>(get<std::string>(name).value_or(""));
}

void SettingsSection::settings(std::vector<StoredSetting> settings) {
  for (const StoredSetting& setting : settings) static_cast<void>(settingValueText(setting.value));
  settings_ = std::move(settings);
}

SettingsFile SettingsFile::parse(std::string_view text) {
  SettingsFile file;
  file.changedByHand_ = !SettingsParser().run(text, file);
  return file;
}

std::string SettingsFile::text() const {
  std::string text = std::string(kFirstLine) + exactText(kFormat) + "\n" + std::string(kAbout);
  for (const SettingsSection& section : sections_) text += sectionText(section);
  text += "\n";
  const std::string sum = hexText(checksum(text));
  return text.append(kEndBegins).append(sum).append(kEndCloses).append("\n");
}

SettingsSection& SettingsFile::section(std::string_view name) {
  if (SettingsSection* const found = find(name)) return *found;
  return sections_.emplace_back(std::string(name));
}

const SettingsSection* SettingsFile::find(std::string_view name) const noexcept {
  const auto found = findByName(sections_, name);
  return found == sections_.end() ? nullptr : &*found;
}

SettingsSection* SettingsFile::find(std::string_view name) noexcept {
  const auto found = findByName(sections_, name);
  return found == sections_.end() ? nullptr : &*found;
}

bool SettingsFile::erase(std::string_view name) {
  const auto found = findByName(sections_, name);
  if (found == sections_.end()) return false;
  sections_.erase(found);
  return true;
}

}  // namespace frontpanels

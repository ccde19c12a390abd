// What a host keeps from one run to the next, in one text file that people can read and change: sections of
// named values and of settings that panels have handed over. docs/settings-file.md shows one.
#pragma once

#include <cstdint>
#include <list>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "hosting/stored_setting.h"

namespace frontpanels {

// Names and texts may hold any bytes; only an empty name raises "Invalid procedure call or argument".
class SettingsSection {
 public:
  using Value = std::pair<std::string, std::string>;  // name, text

  explicit SettingsSection(std::string name);

  [[nodiscard]] const std::string& name() const noexcept { return name_; }

  // Replaces a value of that name where it stands, else adds one behind the others.
  void set(std::string_view name, std::string_view text);
  void set(std::string_view name, const char* text) { set(name, std::string_view(text)); }
  void set(std::string_view name, bool value);
  void set(std::string_view name, std::int32_t value);
  void set(std::string_view name, double value);
  // False when there was none.
  bool erase(std::string_view name);

  // T is std::string, bool, std::int32_t or double. Nothing when there is no such value or, changed by hand,
  // it does not read as a T.
  template <class T>
  [[nodiscard]] std::optional<T> get(std::string_view name) const;
  [[nodiscard]] const std::vector<Value>& values() const noexcept { return values_; }

  // In the order in which they go back to the panel; a code may come several times. Raises "Type mismatch"
  // and changes nothing for a value that no text holds (an object, an array of variants).
  void settings(std::vector<StoredSetting> settings);
  [[nodiscard]] const std::vector<StoredSetting>& settings() const noexcept { return settings_; }

  friend bool operator==(const SettingsSection&, const SettingsSection&) = default;

 private:
  friend class SettingsParser;

  std::string name_;
  std::vector<Value> values_;
  std::vector<StoredSetting> settings_;
};

template <>
[[nodiscard]] std::optional<std::string> SettingsSection::get(std::string_view name) const;
template <>
[[nodiscard]] std::optional<bool> SettingsSection::get(std::string_view name) const;
template <>
[[nodiscard]] std::optional<std::int32_t> SettingsSection::get(std::string_view name) const;
template <>
[[nodiscard]] std::optional<double> SettingsSection::get(std::string_view name) const;

class SettingsFile {
 public:
  // Raises a run-time error with the line and the reason for what is no whole file of this format. A file
  // changed by hand is one; see `changedByHand`.
  [[nodiscard]] static SettingsFile parse(std::string_view text);
  // Where the first word of a section's name is that of a panel ("spectrum", "pilots"), its settings carry
  // their names as comments.
  [[nodiscard]] std::string text() const;

  // The section of that name, added behind the others where there is none. It stays where it is until it is
  // erased.
  SettingsSection& section(std::string_view name);
  [[nodiscard]] const SettingsSection* find(std::string_view name) const noexcept;
  [[nodiscard]] SettingsSection* find(std::string_view name) noexcept;
  bool erase(std::string_view name);
  [[nodiscard]] const std::list<SettingsSection>& sections() const noexcept { return sections_; }

  // Whether the text that was parsed is not the one that `text` once made, by its checksum.
  [[nodiscard]] bool changedByHand() const noexcept { return changedByHand_; }

  friend bool operator==(const SettingsFile& a, const SettingsFile& b) { return a.sections_ == b.sections_; }

 private:
  friend class SettingsParser;

  std::list<SettingsSection> sections_;
  bool changedByHand_ = false;
};

struct LoadedSettings {
  SettingsFile settings;
  std::string problem;        // for the user; empty when all is well
  bool mayBeReplaced = true;  // false: a file that could not be used could not be put aside either
};

// Without a file there are no settings and no problem. A file that cannot be read, is damaged or of another
// version stays under another name beside it ("NAME.damaged-1", the next number that is free).
[[nodiscard]] LoadedSettings loadSettings(const std::string& pathUtf8);

// Whole or not at all (`saveWhole`); a missing folder is made. Raises a run-time error that names the path.
void saveSettings(const std::string& pathUtf8, const SettingsFile& settings);

}  // namespace frontpanels

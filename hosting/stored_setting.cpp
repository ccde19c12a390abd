#include "hosting/stored_setting.h"

#include <algorithm>
#include <iterator>
#include <type_traits>

#include "hosting/number_text.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

using MaybeVariant = std::optional<Variant>;

template <class T>
MaybeVariant readNumber(std::string_view text) {
  if (const std::optional<T> number = exactNumber<T>(text)) return Variant(*number);
  return std::nullopt;
}

template <class T>
MaybeVariant readArray(std::string_view text) {
  std::vector<T> numbers;
  while (!text.empty()) {
    const std::size_t blank = std::min(text.find(' '), text.size());
    const std::optional<T> number = exactNumber<T>(text.substr(0, blank));
    if (!number) return std::nullopt;
    numbers.push_back(*number);
    text.remove_prefix(std::min(blank + 1, text.size()));
  }
  return Variant(std::move(numbers));
}

MaybeVariant readDate(std::string_view text) {
  if (const auto days = exactNumber<double>(text)) return Variant(DateValue{*days});
  return std::nullopt;
}

MaybeVariant readError(std::string_view text) {
  if (const auto code = exactNumber<std::int32_t>(text)) return Variant(ErrorValue{*code});
  return std::nullopt;
}

// Words that say the type of what follows them.
template <class T>
inline constexpr std::string_view kTypeWord = {};
template <>
inline constexpr std::string_view kTypeWord<std::uint8_t> = "byte";
template <>
inline constexpr std::string_view kTypeWord<std::int16_t> = "integer";
template <>
inline constexpr std::string_view kTypeWord<std::int32_t> = "long";
template <>
inline constexpr std::string_view kTypeWord<std::int64_t> = "longlong";
template <>
inline constexpr std::string_view kTypeWord<float> = "single";
template <>
inline constexpr std::string_view kTypeWord<double> = "double";
constexpr std::string_view kDateWord = "date";
constexpr std::string_view kErrorWord = "error";
constexpr std::string_view kArrayMark = "()";

struct TypeRow {
  std::string_view word;
  MaybeVariant (*read)(std::string_view);
  MaybeVariant (*readArray)(std::string_view) = nullptr;
};
template <class T>
constexpr TypeRow kRow = {kTypeWord<T>, readNumber<T>, readArray<T>};
constexpr TypeRow kTypes[] = {
    kRow<std::uint8_t>,    kRow<std::int16_t>,
    kRow<std::int32_t>,    kRow<float>,
    kRow<double>,          {kTypeWord<std::int64_t>, readNumber<std::int64_t>},
    {kDateWord, readDate}, {kErrorWord, readError},
};

struct WordRow {
  std::string_view word;
  Variant::Value value;
};
const WordRow kWords[] = {
    {"true", true}, {"false", false}, {"empty", Variant::Empty{}}, {"null", Variant::Null{}}};

std::string after(std::string_view word, const std::string& value) { return std::string(word) + " " + value; }

struct ValueWriter {
  std::string operator()(bool value) const { return value ? "true" : "false"; }
  std::string operator()(const Variant::Empty&) const { return "empty"; }
  std::string operator()(const Variant::Null&) const { return "null"; }
  std::string operator()(double value) const { return exactText(value); }
  std::string operator()(const DateValue& date) const { return after(kDateWord, exactText(date.days)); }
  std::string operator()(const ErrorValue& error) const { return after(kErrorWord, exactText(error.code)); }
  std::string operator()(const std::string& text) const { return '"' + text + '"'; }
  std::string operator()(const ObjectReference&) const { raiseTypeMismatch(); }
  std::string operator()(const Variant::Variants&) const { raiseTypeMismatch(); }
  template <class T>
  std::string operator()(const T& value) const {
    return after(kTypeWord<T>, exactText(value));
  }
  template <class T>
  std::string operator()(const std::vector<T>& values) const {
    std::string text(kTypeWord<T>);
    text += kArrayMark;
    for (const T value : values) text += " " + exactText(value);
    return text;
  }
};

}  // namespace

std::string settingValueText(const Variant& value) { return std::visit(ValueWriter(), value.value()); }

std::optional<Variant> parseSettingValue(std::string_view text) {
  if (text.size() >= 2 && text.starts_with('"') && text.ends_with('"'))
    return Variant(std::string(text.substr(1, text.size() - 2)));
  for (const WordRow& row : kWords)
    if (text == row.word) return Variant(row.value);
  const std::size_t blank = std::min(text.find(' '), text.size());
  const std::string_view rest = text.substr(std::min(blank + 1, text.size()));
  std::string_view word = text.substr(0, blank);
  const bool array = word.ends_with(kArrayMark);
  if (array) word.remove_suffix(kArrayMark.size());
  for (const TypeRow& row : kTypes) {
    if (word != row.word) continue;
    const auto read = array ? row.readArray : row.read;
    return read == nullptr ? std::nullopt : read(rest);
  }
  return readNumber<double>(text);
}

}  // namespace frontpanels

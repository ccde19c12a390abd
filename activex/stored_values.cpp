#include "activex/stored_values.h"

#include <oleauto.h>

#include <algorithm>
#include <cstddef>

#include "activex/barrier.h"
#include "activex/variants.h"
#include "platform/win32/utf16.h"

namespace frontpanels::activex {
namespace {

constexpr std::uint32_t kMagic = 0x4C505046;     // "FPPL"
constexpr std::uint16_t kVersionOfBooleans = 1;  // a byte a property, any but 0 is true
constexpr std::uint16_t kVersion = 2;  // a kind a property, behind that of a text its length and bytes
constexpr std::uint16_t kMostProperties = 64;

enum class ValueKind : std::uint8_t { False, True, Text };

#pragma pack(push, 1)
struct StreamHeader {
  std::uint32_t magic = kMagic;
  std::uint16_t version = kVersion;
  std::uint16_t properties = 0;
  std::int32_t widthHimetric = 0;
  std::int32_t heightHimetric = 0;
};
#pragma pack(pop)

[[noreturn]] void refuse() { throw ComFailure(STG_E_DOCFILECORRUPT); }

void readWhole(IStream& stream, void* data, std::size_t bytes) {
  ULONG read = 0;
  check(stream.Read(data, static_cast<ULONG>(bytes), &read));
  if (read != bytes) throw ComFailure(STG_E_READFAULT);
}

template <class T>
T readPlain(IStream& stream) {
  T value{};
  readWhole(stream, &value, sizeof value);
  return value;
}

// Piece by piece: a length that promises more than the stream has must not cost the memory for it.
std::string readText(IStream& stream) {
  constexpr std::size_t kPieceBytes = 65536;
  std::string text;
  for (std::size_t left = readPlain<std::uint32_t>(stream); left > 0;) {
    const std::size_t piece = std::min(left, kPieceBytes);
    text.resize(text.size() + piece);
    readWhole(stream, text.data() + text.size() - piece, piece);
    left -= piece;
  }
  if (toUtf8(toUtf16(text)) != text) refuse();
  return text;
}

Variant readValue(IStream& stream, std::uint16_t version) {
  const auto kind = readPlain<std::uint8_t>(stream);
  if (version == kVersionOfBooleans || kind <= static_cast<std::uint8_t>(ValueKind::True)) return kind != 0;
  if (kind != static_cast<std::uint8_t>(ValueKind::Text)) refuse();
  return readText(stream);
}

bool sameKind(const Variant& a, const Variant& b) { return a.value().index() == b.value().index(); }

template <class T>
void append(std::string& bytes, const T& plain) {
  bytes.append(reinterpret_cast<const char*>(&plain), sizeof plain);
}

class OwnVariant {
 public:
  explicit OwnVariant(const VARIANT& owned) noexcept : value_(owned) {}
  ~OwnVariant() { VariantClear(&value_); }
  OwnVariant(const OwnVariant&) = delete;
  OwnVariant& operator=(const OwnVariant&) = delete;
  [[nodiscard]] VARIANT* get() noexcept { return &value_; }

 private:
  VARIANT value_;
};

// The wanted type goes in as a hint, and the value with it zeroed; whatever comes back is converted, text
// too.
Variant readValue(IPropertyBag& bag, IErrorLog* log, const StoredProperty& property) {
  const Variant usual = defaultOf(property);
  const VARTYPE wanted = std::holds_alternative<bool>(property.defaultValue) ? VT_BOOL : VT_BSTR;
  OwnVariant value(VARIANT{});
  V_VT(value.get()) = wanted;
  if (FAILED(bag.Read(property.name, value.get(), log))) return usual;
  if (SUCCEEDED(VariantChangeTypeEx(value.get(), value.get(), LOCALE_INVARIANT, 0, wanted)))
    return fromAutomation(*value.get());
  if (log != nullptr) {
    EXCEPINFO info{};
    info.scode = DISP_E_TYPEMISMATCH;
    log->AddError(property.name, &info);
  }
  return usual;
}

}  // namespace

Variant defaultOf(const StoredProperty& property) {
  if (const auto* const text = std::get_if<std::string_view>(&property.defaultValue))
    return std::string(*text);
  return std::get<bool>(property.defaultValue);
}

StoredState readStored(IStream& stream, std::span<const StoredProperty> properties) {
  const auto header = readPlain<StreamHeader>(stream);
  const bool known = header.version == kVersionOfBooleans || header.version == kVersion;
  if (header.magic != kMagic || !known || header.properties > kMostProperties || header.widthHimetric < 0 ||
      header.heightHimetric < 0)
    refuse();
  StoredState state{{header.widthHimetric, header.heightHimetric}, {}};
  for (const StoredProperty& property : properties) state.values.push_back(defaultOf(property));
  for (std::size_t i = 0; i < header.properties; ++i) {
    Variant value = readValue(stream, header.version);
    if (i >= state.values.size()) continue;
    if (!sameKind(value, state.values[i])) refuse();
    state.values[i] = std::move(value);
  }
  return state;
}

std::string storedBytes(const StoredState& state) {
  StreamHeader header;
  header.properties = static_cast<std::uint16_t>(state.values.size());
  header.widthHimetric = static_cast<std::int32_t>(state.extentHimetric.cx);
  header.heightHimetric = static_cast<std::int32_t>(state.extentHimetric.cy);
  std::string bytes;
  append(bytes, header);
  for (const Variant& value : state.values) {
    if (const auto* const text = std::get_if<std::string>(&value.value())) {
      append(bytes, ValueKind::Text);
      append(bytes, static_cast<std::uint32_t>(text->size()));
      bytes += *text;
    } else {
      append(bytes, value.toBoolean() ? ValueKind::True : ValueKind::False);
    }
  }
  return bytes;
}

StoredValues readStored(IPropertyBag& bag, IErrorLog* log, std::span<const StoredProperty> properties) {
  StoredValues values;
  for (const StoredProperty& property : properties) values.push_back(readValue(bag, log, property));
  return values;
}

void writeStored(IPropertyBag& bag, std::span<const StoredProperty> properties, const StoredValues& values,
                 bool all) {
  for (std::size_t i = 0; i < properties.size(); ++i) {
    if (!all && values[i] == defaultOf(properties[i])) continue;
    OwnVariant value(toAutomation(values[i]));
    check(bag.Write(properties[i].name, value.get()));
  }
}

}  // namespace frontpanels::activex

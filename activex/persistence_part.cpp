#include "activex/persistence_part.h"

#include <oleauto.h>

#include <algorithm>
#include <vector>

#include "activex/barrier.h"
#include "framework/support/error_handler.h"

namespace frontpanels::activex {
namespace {

constexpr std::uint32_t kMagic = 0x4C505046;  // "FPPL"
constexpr std::uint16_t kVersion = 1;
constexpr std::uint16_t kMostProperties = 64;
constexpr wchar_t kStreamName[] = L"FrontPanels";

#pragma pack(push, 1)
struct StreamHeader {
  std::uint32_t magic = kMagic;
  std::uint16_t version = kVersion;
  std::uint16_t properties = 0;
  std::int32_t widthHimetric = 0;
  std::int32_t heightHimetric = 0;
};
#pragma pack(pop)

void readWhole(IStream& stream, void* data, ULONG bytes) {
  ULONG read = 0;
  check(stream.Read(data, bytes, &read));
  if (read != bytes) throw ComFailure(STG_E_READFAULT);
}

void writeWhole(IStream& stream, const void* data, ULONG bytes) {
  ULONG written = 0;
  check(stream.Write(data, bytes, &written));
  if (written != bytes) throw ComFailure(STG_E_WRITEFAULT);
}

// What fails is reported as well: containers load and save forms without a word.
template <class Body>
HRESULT reported(const char* routine, Body body) {
  const HRESULT result = barrier(body);
  if (FAILED(result)) errorHandler().Assert(routine);
  return result;
}

constexpr const char* kReading = "UserControl_ReadProperties()";
constexpr const char* kWriting = "UserControl_WriteProperties()";

// The wanted type goes in as a hint, and the value with it zeroed; whatever comes back is converted, text
// too. The default where the bag has no such property.
bool readFlag(IPropertyBag& bag, IErrorLog* log, const StoredProperty& property) {
  VARIANT value;
  VariantInit(&value);
  V_VT(&value) = VT_BOOL;
  V_BOOL(&value) = VARIANT_FALSE;
  bool flag = property.defaultValue;
  if (SUCCEEDED(bag.Read(property.name, &value, log))) {
    if (SUCCEEDED(VariantChangeTypeEx(&value, &value, LOCALE_INVARIANT, 0, VT_BOOL))) {
      flag = V_BOOL(&value) != VARIANT_FALSE;
    } else if (log != nullptr) {
      EXCEPINFO info{};
      info.scode = DISP_E_TYPEMISMATCH;
      log->AddError(property.name, &info);
    }
  }
  VariantClear(&value);
  return flag;
}

void writeFlag(IPropertyBag& bag, const StoredProperty& property, bool flag) {
  VARIANT value;
  VariantInit(&value);
  V_VT(&value) = VT_BOOL;
  V_BOOL(&value) = flag ? VARIANT_TRUE : VARIANT_FALSE;
  check(bag.Write(property.name, &value));
}

}  // namespace

HRESULT PersistencePart::GetClassID(CLSID* id) {
  if (id == nullptr) return E_POINTER;
  *id = *core().controlClass().id;
  return S_OK;
}

HRESULT PersistencePart::IsDirty() { return core().dirty() ? S_OK : S_FALSE; }

void PersistencePart::setDefaults() {
  const auto properties = core().storedProperties();
  for (std::size_t i = 0; i < properties.size(); ++i) core().storedValue(i, properties[i].defaultValue);
  core().dirty(false);
}

HRESULT PersistencePart::InitNew() {
  return barrier([&] { setDefaults(); });
}

void PersistencePart::readStream(IStream& stream) {
  StreamHeader header;
  readWhole(stream, &header, sizeof header);
  if (header.magic != kMagic || header.version != kVersion || header.properties > kMostProperties ||
      header.widthHimetric < 0 || header.heightHimetric < 0)
    throw ComFailure(STG_E_DOCFILECORRUPT);
  std::vector<std::uint8_t> flags(header.properties);
  if (!flags.empty()) readWhole(stream, flags.data(), static_cast<ULONG>(flags.size()));
  setDefaults();
  const std::size_t known = std::min(flags.size(), core().storedProperties().size());
  for (std::size_t i = 0; i < known; ++i) core().storedValue(i, flags[i] != 0);
  core().extent({header.widthHimetric, header.heightHimetric});
  core().dirty(false);
}

void PersistencePart::writeStream(IStream& stream) const {
  const std::size_t count = core().storedProperties().size();
  StreamHeader header;
  header.properties = static_cast<std::uint16_t>(count);
  header.widthHimetric = static_cast<std::int32_t>(core().extent().cx);
  header.heightHimetric = static_cast<std::int32_t>(core().extent().cy);
  writeWhole(stream, &header, sizeof header);
  for (std::size_t i = 0; i < count; ++i) {
    const std::uint8_t flag = core().storedValue(i) ? 1 : 0;
    writeWhole(stream, &flag, sizeof flag);
  }
}

HRESULT PersistencePart::Load(IStream* stream) {
  if (stream == nullptr) return E_POINTER;
  return reported(kReading, [&] { readStream(*stream); });
}

HRESULT PersistencePart::Save(IStream* stream, BOOL clearDirty) {
  if (stream == nullptr) return E_POINTER;
  return reported(kWriting, [&] {
    writeStream(*stream);
    if (clearDirty) core().dirty(false);
  });
}

HRESULT PersistencePart::GetSizeMax(ULARGE_INTEGER* size) {
  if (size == nullptr) return E_POINTER;
  size->QuadPart = sizeof(StreamHeader) + core().storedProperties().size();
  return S_OK;
}

HRESULT PersistencePart::Load(IPropertyBag* bag, IErrorLog* log) {
  if (bag == nullptr) return E_POINTER;
  return reported(kReading, [&] {
    const auto properties = core().storedProperties();
    for (std::size_t i = 0; i < properties.size(); ++i)
      core().storedValue(i, readFlag(*bag, log, properties[i]));
    core().dirty(false);
  });
}

HRESULT PersistencePart::Save(IPropertyBag* bag, BOOL clearDirty, BOOL saveAll) {
  if (bag == nullptr) return E_POINTER;
  return reported(kWriting, [&] {
    const auto properties = core().storedProperties();
    for (std::size_t i = 0; i < properties.size(); ++i) {
      const bool flag = core().storedValue(i);
      if (saveAll || flag != properties[i].defaultValue) writeFlag(*bag, properties[i], flag);
    }
    if (clearDirty) core().dirty(false);
  });
}

HRESULT PersistencePart::InitNew(IStorage*) { return InitNew(); }

HRESULT PersistencePart::Load(IStorage* storage) {
  if (storage == nullptr) return E_POINTER;
  return reported(kReading, [&] {
    ComPointer<IStream> stream;
    check(storage->OpenStream(kStreamName, nullptr, STGM_READ | STGM_SHARE_EXCLUSIVE, 0, stream.receive()));
    readStream(*stream.get());
  });
}

// Stays dirty until the container says that the save is complete.
HRESULT PersistencePart::Save(IStorage* storage, BOOL) {
  if (storage == nullptr) return E_POINTER;
  return reported(kWriting, [&] {
    ComPointer<IStream> stream;
    check(storage->CreateStream(kStreamName, STGM_CREATE | STGM_WRITE | STGM_SHARE_EXCLUSIVE, 0, 0,
                                stream.receive()));
    writeStream(*stream.get());
  });
}

HRESULT PersistencePart::SaveCompleted(IStorage*) {
  core().dirty(false);
  return S_OK;
}

}  // namespace frontpanels::activex

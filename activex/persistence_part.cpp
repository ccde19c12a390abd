#include "activex/persistence_part.h"

#include <utility>

#include "activex/barrier.h"
#include "activex/stored_values.h"
#include "framework/support/error_handler.h"

namespace frontpanels::activex {
namespace {

constexpr wchar_t kStreamName[] = L"FrontPanels";

constexpr const char* kReading = "UserControl_ReadProperties()";
constexpr const char* kWriting = "UserControl_WriteProperties()";

// What fails is reported as well: containers load and save forms without a word.
HRESULT reported(const char* routine, HRESULT result) {
  if (FAILED(result)) errorHandler().Assert(routine);
  return result;
}

}  // namespace

template <class Body>
HRESULT PersistencePart::loading(Body body) {
  return reported(kReading, entry(body));
}

template <class Body>
HRESULT PersistencePart::saving(Body body) {
  return reported(kWriting, entry([&] {
                    const ControlCore::Saving quiet(core());
                    return body();
                  }));
}

HRESULT PersistencePart::GetClassID(CLSID* id) {
  if (id == nullptr) return E_POINTER;
  *id = *core().controlClass().id;
  return S_OK;
}

HRESULT PersistencePart::IsDirty() { return core().dirty() ? S_OK : S_FALSE; }

void PersistencePart::apply(const StoredValues& values) {
  for (std::size_t i = 0; i < values.size(); ++i) core().storedValue(i, values[i]);
  core().dirty(false);
}

StoredState PersistencePart::state() const {
  StoredState state{core().extent(), {}};
  for (std::size_t i = 0; i < core().storedProperties().size(); ++i)
    state.values.push_back(core().storedValue(i));
  return state;
}

HRESULT PersistencePart::InitNew() {
  return entry([&] {
    StoredValues values;
    for (const StoredProperty& property : core().storedProperties()) values.push_back(defaultOf(property));
    apply(values);
  });
}

// Nothing changes before all of it is read.
void PersistencePart::readStream(IStream& stream) {
  const StoredState stored = readStored(stream, core().storedProperties());
  apply(stored.values);
  core().extent(stored.extentHimetric);
  core().dirty(false);
}

void PersistencePart::writeStream(IStream& stream) const {
  const std::string bytes = storedBytes(state());
  ULONG written = 0;
  check(stream.Write(bytes.data(), static_cast<ULONG>(bytes.size()), &written));
  if (written != bytes.size()) throw ComFailure(STG_E_WRITEFAULT);
}

HRESULT PersistencePart::Load(IStream* stream) {
  if (stream == nullptr) return E_POINTER;
  return loading([&] { readStream(*stream); });
}

HRESULT PersistencePart::Save(IStream* stream, BOOL clearDirty) {
  if (stream == nullptr) return E_POINTER;
  return saving([&] {
    writeStream(*stream);
    if (clearDirty) core().dirty(false);
  });
}

HRESULT PersistencePart::GetSizeMax(ULARGE_INTEGER* size) {
  if (size == nullptr) return E_POINTER;
  size->QuadPart = 0;
  return entry([&] { size->QuadPart = storedBytes(state()).size(); });
}

HRESULT PersistencePart::Load(IPropertyBag* bag, IErrorLog* log) {
  if (bag == nullptr) return E_POINTER;
  return loading([&] { apply(readStored(*bag, log, core().storedProperties())); });
}

HRESULT PersistencePart::Save(IPropertyBag* bag, BOOL clearDirty, BOOL saveAll) {
  if (bag == nullptr) return E_POINTER;
  return saving([&] {
    writeStored(*bag, core().storedProperties(), state().values, saveAll != FALSE);
    if (clearDirty) core().dirty(false);
  });
}

HRESULT PersistencePart::InitNew(IStorage*) { return InitNew(); }

HRESULT PersistencePart::Load(IStorage* storage) {
  if (storage == nullptr) return E_POINTER;
  return loading([&] {
    ComPointer<IStream> stream;
    check(storage->OpenStream(kStreamName, nullptr, STGM_READ | STGM_SHARE_EXCLUSIVE, 0, stream.receive()));
    readStream(*stream.get());
  });
}

// Stays dirty until the container says that the save is complete.
HRESULT PersistencePart::Save(IStorage* storage, BOOL sameAsLoad) {
  if (storage == nullptr) return E_POINTER;
  saved_ = Saved::Nothing;
  return saving([&] {
    ComPointer<IStream> stream;
    check(storage->CreateStream(kStreamName, STGM_CREATE | STGM_WRITE | STGM_SHARE_EXCLUSIVE, 0, 0,
                                stream.receive()));
    writeStream(*stream.get());
    saved_ = sameAsLoad ? Saved::Original : Saved::Copy;
    savedChanges_ = core().changes();
  });
}

// A copy leaves the original unsaved, unless the container goes on with the copy's storage. After a save that
// failed a storage comes back as well: the control is as dirty as it was then.
HRESULT PersistencePart::SaveCompleted(IStorage* storage) {
  const Saved saved = std::exchange(saved_, Saved::Nothing);
  const bool whole = saved == Saved::Original || (saved == Saved::Copy && storage != nullptr);
  if (whole && savedChanges_ == core().changes()) core().dirty(false);
  return S_OK;
}

}  // namespace frontpanels::activex

// IPersistStreamInit, IPersistPropertyBag and IPersistStorage: what a container keeps of the control with its
// form.
#pragma once

#include <ocidl.h>

#include "activex/control_core.h"

namespace frontpanels::activex {

class PersistencePart final : public ControlPart<IPersistStreamInit, IPersistPropertyBag, IPersistStorage> {
 public:
  using ControlPart::ControlPart;

  // IPersist
  HRESULT STDMETHODCALLTYPE GetClassID(CLSID* id) override;
  // The same for all three ways.
  HRESULT STDMETHODCALLTYPE IsDirty() override;
  HRESULT STDMETHODCALLTYPE InitNew() override;
  // IPersistStreamInit: magic, version, extent, properties. A stream that is cut or another's changes
  // nothing.
  HRESULT STDMETHODCALLTYPE Load(IStream* stream) override;
  HRESULT STDMETHODCALLTYPE Save(IStream* stream, BOOL clearDirty) override;
  HRESULT STDMETHODCALLTYPE GetSizeMax(ULARGE_INTEGER* size) override;
  // IPersistPropertyBag
  HRESULT STDMETHODCALLTYPE Load(IPropertyBag* bag, IErrorLog* log) override;
  HRESULT STDMETHODCALLTYPE Save(IPropertyBag* bag, BOOL clearDirty, BOOL saveAll) override;
  // IPersistStorage: one stream in the storage.
  HRESULT STDMETHODCALLTYPE InitNew(IStorage* storage) override;
  HRESULT STDMETHODCALLTYPE Load(IStorage* storage) override;
  HRESULT STDMETHODCALLTYPE Save(IStorage* storage, BOOL sameAsLoad) override;
  HRESULT STDMETHODCALLTYPE SaveCompleted(IStorage* storage) override;
  HRESULT STDMETHODCALLTYPE HandsOffStorage() override { return S_OK; }

 private:
  // What a storage got since the container last said that a save is complete.
  enum class Saved { Nothing, Original, Copy };

  template <class Body>
  HRESULT loading(Body body);
  template <class Body>
  HRESULT saving(Body body);
  void apply(const StoredValues& values);
  [[nodiscard]] StoredState state() const;
  void readStream(IStream& stream);
  void writeStream(IStream& stream) const;

  Saved saved_ = Saved::Nothing;
  unsigned savedChanges_ = 0;  // as many as the control had when it was saved
};

}  // namespace frontpanels::activex

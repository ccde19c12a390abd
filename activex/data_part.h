// IDataObject: the control's picture for containers that keep one with their document, as a metafile of
// either kind.
#pragma once

#include "activex/control_core.h"

namespace frontpanels::activex {

class DataPart final : public ControlPart<IDataObject> {
 public:
  using ControlPart::ControlPart;

  // Tells whoever keeps the picture that it has changed.
  void changed();
  // The same when the control goes away: connections that wait for it get it now.
  void closed();

  HRESULT STDMETHODCALLTYPE GetData(FORMATETC* format, STGMEDIUM* medium) override;
  HRESULT STDMETHODCALLTYPE GetDataHere(FORMATETC*, STGMEDIUM*) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE QueryGetData(FORMATETC* format) override;
  HRESULT STDMETHODCALLTYPE GetCanonicalFormatEtc(FORMATETC* format, FORMATETC* canonical) override;
  HRESULT STDMETHODCALLTYPE SetData(FORMATETC*, STGMEDIUM*, WINBOOL) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE EnumFormatEtc(DWORD direction, IEnumFORMATETC** formats) override;
  HRESULT STDMETHODCALLTYPE DAdvise(FORMATETC* format, DWORD flags, IAdviseSink* sink,
                                    DWORD* connection) override;
  HRESULT STDMETHODCALLTYPE DUnadvise(DWORD connection) override;
  HRESULT STDMETHODCALLTYPE EnumDAdvise(IEnumSTATDATA** advises) override;

 private:
  ComPointer<IDataAdviseHolder> advises_;
};

}  // namespace frontpanels::activex

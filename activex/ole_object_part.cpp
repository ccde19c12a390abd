#include "activex/ole_object_part.h"

#include <olectl.h>

#include <cwchar>

#include "activex/data_part.h"
#include "activex/in_place_part.h"

namespace frontpanels::activex {

HRESULT OleObjectPart::SetClientSite(IOleClientSite* site) {
  return entry([&] { core().site(site); });
}

HRESULT OleObjectPart::GetClientSite(IOleClientSite** site) {
  if (site == nullptr) return E_POINTER;
  *site = core().site().get();
  if (*site != nullptr) (*site)->AddRef();
  return S_OK;
}

HRESULT OleObjectPart::Close(DWORD saveOption) {
  return entry([&] {
    const ComPointer<IOleClientSite> site = core().site();
    if (saveOption != OLECLOSE_NOSAVE && core().dirty() && site) site->SaveObject();
    core().inPlace().deactivate();
    core().dataObject().closed();
    const ComPointer<IOleAdviseHolder> advises = advises_;
    if (advises) advises->SendOnClose();
  });
}

HRESULT OleObjectPart::GetMoniker(DWORD, DWORD, IMoniker** moniker) {
  if (moniker == nullptr) return E_POINTER;
  *moniker = nullptr;
  return E_NOTIMPL;
}

// That one would be a picture of this moment; the control itself gives the picture that it has now.
HRESULT OleObjectPart::GetClipboardData(DWORD, IDataObject** data) {
  if (data == nullptr) return E_POINTER;
  *data = nullptr;
  return E_NOTIMPL;
}

HRESULT OleObjectPart::DoVerb(LONG verb, LPMSG, IOleClientSite*, LONG, HWND parent, LPCRECT place) {
  return entry([&]() -> HRESULT {
    // Some hosts hand a verb over as a 16-bit number.
    switch (static_cast<std::int16_t>(verb & 0xFFFF)) {
      case OLEIVERB_PRIMARY:
      case OLEIVERB_UIACTIVATE:
        core().inPlace().activate(parent, place);
        core().inPlace().activateUi();
        return S_OK;
      case OLEIVERB_SHOW:
      case OLEIVERB_INPLACEACTIVATE:
        core().inPlace().activate(parent, place);
        return S_OK;
      case OLEIVERB_HIDE:
        core().inPlace().hide();
        return S_OK;
      case OLEIVERB_DISCARDUNDOSTATE:
        return S_OK;
      default:
        break;
    }
    if (static_cast<std::int16_t>(verb & 0xFFFF) < 0) return E_NOTIMPL;
    core().inPlace().activate(parent, place);
    core().inPlace().activateUi();
    return OLEOBJ_S_INVALIDVERB;
  });
}

HRESULT OleObjectPart::EnumVerbs(IEnumOLEVERB** verbs) {
  if (verbs == nullptr) return E_POINTER;
  *verbs = nullptr;
  return OLE_S_USEREG;
}

HRESULT OleObjectPart::GetUserClassID(CLSID* id) {
  if (id == nullptr) return E_POINTER;
  *id = *core().controlClass().id;
  return S_OK;
}

HRESULT OleObjectPart::GetUserType(DWORD, LPOLESTR* name) {
  if (name == nullptr) return E_POINTER;
  const wchar_t* const text = core().controlClass().userTypeName;
  const std::size_t bytes = (std::wcslen(text) + 1) * sizeof(wchar_t);
  *name = static_cast<LPOLESTR>(CoTaskMemAlloc(bytes));
  if (*name == nullptr) return E_OUTOFMEMORY;
  std::wmemcpy(*name, text, bytes / sizeof(wchar_t));
  return S_OK;
}

HRESULT OleObjectPart::SetExtent(DWORD aspect, SIZEL* himetric) {
  if (himetric == nullptr) return E_POINTER;
  if (aspect != DVASPECT_CONTENT) return DV_E_DVASPECT;
  if (himetric->cx < 0 || himetric->cy < 0) return E_INVALIDARG;
  return entry([&] { core().extent(*himetric); });
}

HRESULT OleObjectPart::GetExtent(DWORD aspect, SIZEL* himetric) {
  if (himetric == nullptr) return E_POINTER;
  if (aspect != DVASPECT_CONTENT) return DV_E_DVASPECT;
  *himetric = core().extent();
  return S_OK;
}

HRESULT OleObjectPart::Advise(IAdviseSink* sink, DWORD* connection) {
  if (connection == nullptr) return E_POINTER;
  return entry([&] {
    if (!advises_) check(CreateOleAdviseHolder(advises_.receive()));
    return advises_->Advise(sink, connection);
  });
}

HRESULT OleObjectPart::Unadvise(DWORD connection) {
  return entry([&] { return advises_ ? advises_->Unadvise(connection) : OLE_E_NOCONNECTION; });
}

HRESULT OleObjectPart::EnumAdvise(IEnumSTATDATA** advises) {
  if (advises == nullptr) return E_POINTER;
  *advises = nullptr;
  return advises_ ? advises_->EnumAdvise(advises) : S_OK;
}

HRESULT OleObjectPart::GetMiscStatus(DWORD aspect, DWORD* status) {
  if (status == nullptr) return E_POINTER;
  *status = aspect == DVASPECT_CONTENT ? kMiscStatus : 0;
  return S_OK;
}

HRESULT OleObjectPart::GetControlInfo(CONTROLINFO* info) {
  if (info == nullptr) return E_POINTER;
  info->cb = sizeof *info;
  info->hAccel = nullptr;
  info->cAccel = 0;
  info->dwFlags = core().window().hasFields() ? CTRLINFO_EATS_RETURN : 0;
  return entry([&] { accessKeys_.give(core().window().accessKeys(), *info); });
}

bool OleObjectPart::accessKeysOutdated() { return accessKeys_.outdated(core().window().accessKeys()); }

// As the key in the panel: the focus goes to the labelled field, a button is clicked.
HRESULT OleObjectPart::OnMnemonic(MSG* message) {
  if (message == nullptr) return E_POINTER;
  return entry([&] { core().window().accessKey(message->wParam); });
}

HRESULT OleObjectPart::OnAmbientPropertyChange(DISPID property) {
  return entry([&] {
    if (property == DISPID_UNKNOWN || property == DISPID_AMBIENT_USERMODE || property == DISPID_AMBIENT_FONT)
      core().readAmbients();
  });
}

HRESULT OleObjectPart::FreezeEvents(BOOL freeze) {
  core().freezeEvents(freeze != FALSE);
  return S_OK;
}

}  // namespace frontpanels::activex

#include "activex/view_part.h"

#include <utility>

#include "activex/services.h"

namespace frontpanels::activex {

void ViewPart::changed() {
  if (!sink_ || (aspects_ & DVASPECT_CONTENT) == 0) return;
  const ComPointer<IAdviseSink> told = sink_;
  if ((flags_ & ADVF_ONLYONCE) != 0) sink_.reset();
  told->OnViewChange(DVASPECT_CONTENT, -1);
}

HRESULT ViewPart::Draw(DWORD aspect, LONG, void*, DVTARGETDEVICE*, HDC, HDC dc, LPCRECTL bounds, LPCRECTL,
                       WINBOOL(CALLBACK*)(ULONG_PTR), ULONG_PTR) {
  if (aspect != DVASPECT_CONTENT) return DV_E_DVASPECT;
  if (dc == nullptr || bounds == nullptr) return E_INVALIDARG;
  if (bounds->left == bounds->right || bounds->top == bounds->bottom) return S_OK;  // nothing to be seen
  return entry([&] {
    services().gdi.settingsChanged();  // of which only windows are told
    core().window().draw(services().gdi, dc, *bounds);
  });
}

HRESULT ViewPart::GetColorSet(DWORD, LONG, void*, DVTARGETDEVICE*, HDC, LOGPALETTE** palette) {
  if (palette == nullptr) return E_POINTER;
  *palette = nullptr;
  return S_FALSE;
}

HRESULT ViewPart::SetAdvise(DWORD aspects, DWORD flags, IAdviseSink* sink) {
  return entry([&] {
    aspects_ = aspects;
    flags_ = flags;
    const ComPointer<IAdviseSink> before = std::exchange(sink_, ComPointer<IAdviseSink>(sink));
    if ((flags & ADVF_PRIMEFIRST) != 0) changed();
  });
}

HRESULT ViewPart::GetAdvise(DWORD* aspects, DWORD* flags, IAdviseSink** sink) {
  if (aspects != nullptr) *aspects = aspects_;
  if (flags != nullptr) *flags = flags_;
  if (sink != nullptr) *sink = ComPointer<IAdviseSink>(sink_).detach();
  return S_OK;
}

HRESULT ViewPart::GetExtent(DWORD aspect, LONG, DVTARGETDEVICE*, LPSIZEL himetric) {
  if (himetric == nullptr) return E_POINTER;
  if (aspect != DVASPECT_CONTENT) return DV_E_DVASPECT;
  *himetric = core().extent();
  return S_OK;
}

}  // namespace frontpanels::activex

#include "workbench/control_site.h"

#include <windows.h>

#include "workbench/ambient_properties.h"
#include "workbench/failure.h"
#include "workbench/screen_scale.h"

namespace frontpanels::workbench {
namespace {

struct Answer {
  const IID& id;
  void* (*find)(ControlSite& site);
};

template <class Interface>
void* as(ControlSite& site) {
  return static_cast<Interface*>(&site);
}

const Answer kAnswers[] = {
    {IID_IUnknown, as<IOleClientSite>},         {IID_IOleClientSite, as<IOleClientSite>},
    {IID_IOleWindow, as<IOleInPlaceSite>},      {IID_IOleInPlaceSite, as<IOleInPlaceSite>},
    {IID_IOleControlSite, as<IOleControlSite>}, {IID_IDispatch, as<IDispatch>},
};

}  // namespace

ControlSite::ControlSite(ControlOwner& owner, const std::wstring& name)
    : owner_(&owner),
      name_(name),
      frame_(makeComObject<ControlFrame>(owner)),
      extender_(makeComObject<Extender>(owner, name)) {}

void ControlSite::detach() noexcept {
  owner_ = nullptr;
  frame_->detach();
  extender_->detach();
}

void* ControlSite::findInterface(REFIID id) noexcept {
  for (const Answer& answer : kAnswers)
    if (answer.id == id) return answer.find(*this);
  return nullptr;
}

// --- IOleClientSite

HRESULT ControlSite::GetMoniker(DWORD, DWORD, IMoniker** moniker) {
  if (moniker != nullptr) *moniker = nullptr;
  return E_NOTIMPL;
}

HRESULT ControlSite::GetContainer(IOleContainer** container) {
  if (container != nullptr) *container = nullptr;
  return E_NOINTERFACE;
}

// --- IOleInPlaceSite

HRESULT ControlSite::GetWindow(HWND* window) {
  return comBarrier([&]() -> HRESULT {
    if (window == nullptr) return E_POINTER;
    if (owner_ == nullptr) return E_UNEXPECTED;
    *window = owner_->place().parentWindow();
    return S_OK;
  });
}

HRESULT ControlSite::GetWindowContext(IOleInPlaceFrame** frame, IOleInPlaceUIWindow** document, LPRECT place,
                                      LPRECT clip, LPOLEINPLACEFRAMEINFO info) {
  return comBarrier([&]() -> HRESULT {
    if (frame == nullptr || document == nullptr || place == nullptr || clip == nullptr || info == nullptr)
      return E_POINTER;
    *frame = nullptr;
    *document = nullptr;
    if (owner_ == nullptr) return E_UNEXPECTED;
    *place = *clip = owner_->place().panelRect();
    const HACCEL accelerators = owner_->place().acceleratorTable();
    info->fMDIApp = TRUE;
    info->hwndFrame = owner_->place().frameWindow();
    info->haccel = accelerators;
    info->cAccelEntries = static_cast<UINT>(CopyAcceleratorTableW(accelerators, nullptr, 0));
    // No tool bars are shared out, so there is no document window to ask for room.
    *frame = frame_.get();
    frame_->AddRef();
    return S_OK;
  });
}

HRESULT ControlSite::OnPosRectChange(LPCRECT wanted) {
  return comBarrier([&]() -> HRESULT {
    if (wanted == nullptr) return E_POINTER;
    if (owner_ == nullptr) return E_UNEXPECTED;
    // The panel fills the window, whose size is the user's.
    owner_->layOut();
    return S_OK;
  });
}

// --- IOleControlSite

HRESULT ControlSite::GetExtendedControl(IDispatch** extender) {
  if (extender == nullptr) return E_POINTER;
  *extender = extender_.get();
  extender_->AddRef();
  return S_OK;
}

HRESULT ControlSite::TransformCoords(POINTL* himetric, POINTF* container, DWORD flags) {
  if (himetric == nullptr || container == nullptr) return E_POINTER;
  constexpr float kTwipsAnHimetric = 1440.0F / 2540.0F;
  if ((flags & XFORMCOORDS_HIMETRICTOCONTAINER) != 0) {
    container->x = static_cast<float>(himetric->x) * kTwipsAnHimetric;
    container->y = static_cast<float>(himetric->y) * kTwipsAnHimetric;
    return S_OK;
  }
  if ((flags & XFORMCOORDS_CONTAINERTOHIMETRIC) == 0) return E_INVALIDARG;
  himetric->x = static_cast<LONG>(container->x / kTwipsAnHimetric);
  himetric->y = static_cast<LONG>(container->y / kTwipsAnHimetric);
  return S_OK;
}

HRESULT ControlSite::TranslateAccelerator(MSG* message, DWORD) {
  return comBarrier([&]() -> HRESULT {
    if (message == nullptr) return E_POINTER;
    if (owner_ == nullptr) return S_FALSE;
    return owner_->place().translateAccelerator(*message) ? S_OK : S_FALSE;
  });
}

// --- Ambient properties

HRESULT ControlSite::GetTypeInfoCount(UINT* count) {
  if (count == nullptr) return E_POINTER;
  *count = 0;
  return S_OK;
}

HRESULT ControlSite::GetTypeInfo(UINT, LCID, ITypeInfo** info) {
  if (info != nullptr) *info = nullptr;
  return E_NOTIMPL;
}

HRESULT ControlSite::Invoke(DISPID member, REFIID, LCID, WORD flags, DISPPARAMS*, VARIANT* result, EXCEPINFO*,
                            UINT*) {
  return comBarrier([&]() -> HRESULT {
    if ((flags & DISPATCH_PROPERTYGET) == 0) return DISP_E_MEMBERNOTFOUND;
    if (result == nullptr) return E_POINTER;
    return ambientProperty(member, name_, *result);
  });
}

}  // namespace frontpanels::workbench

#include "tests/wine/full_container.h"

#include <algorithm>

namespace frontpanels::testing {
namespace {

constexpr const wchar_t* kPlaceNames[] = {L"Caption", L"Visible", L"ViewState", L"Left",
                                          L"Top",     L"Width",   L"Height"};

}  // namespace

HRESULT PlaceProperties::GetIDsOfNames(REFIID, LPOLESTR* names, UINT, LCID, DISPID* ids) {
  for (DISPID i = 0; i < 7; ++i)
    if (std::wstring(names[0]) == kPlaceNames[i]) return ids[0] = i, S_OK;
  return DISP_E_UNKNOWNNAME;
}

HRESULT PlaceProperties::Invoke(DISPID member, REFIID, LCID, WORD flags, DISPPARAMS* parameters, VARIANT*,
                                EXCEPINFO*, UINT*) {
  if (flags != DISPATCH_PROPERTYPUT || parameters->cNamedArgs != 1) return DISP_E_MEMBERNOTFOUND;
  Value text;
  VariantChangeType(text.get(), &parameters->rgvarg[0], VARIANT_ALPHABOOL, VT_BSTR);
  told.push_back(std::wstring(kPlaceNames[member]) + L"=" + text.text());
  return S_OK;
}

int FullContainer::count(const std::string& what) const {
  return static_cast<int>(std::count(told.begin(), told.end(), what));
}

HRESULT FullContainer::GetWindowContext(IOleInPlaceFrame** frame, IOleInPlaceUIWindow** document, LPRECT area,
                                        LPRECT clip, LPOLEINPLACEFRAMEINFO info) {
  *frame = this;
  AddRef();
  *document = nullptr;
  *area = *clip = place;
  info->fMDIApp = FALSE;
  info->hwndFrame = window_;
  info->haccel = nullptr;
  info->cAccelEntries = 0;
  return S_OK;
}

HRESULT FullContainer::GetExtendedControl(IDispatch** extended) {
  *extended = extender;
  if (extender == nullptr) return E_NOTIMPL;
  extender->AddRef();
  return S_OK;
}

HRESULT FullContainer::Invoke(DISPID member, REFIID, LCID, WORD, DISPPARAMS*, VARIANT* result, EXCEPINFO*,
                              UINT*) {
  if (member == DISPID_AMBIENT_FONT && font != nullptr) {
    V_VT(result) = VT_DISPATCH;
    V_DISPATCH(result) = font;
    return font->AddRef(), S_OK;
  }
  if (member != DISPID_AMBIENT_USERMODE) return DISP_E_MEMBERNOTFOUND;
  V_VT(result) = VT_BOOL;
  V_BOOL(result) = userMode ? VARIANT_TRUE : VARIANT_FALSE;
  return S_OK;
}

void* FullContainer::find(REFIID id) {
  if (id == IID_IUnknown || id == IID_IOleClientSite) return static_cast<IOleClientSite*>(this);
  if (id == IID_IOleWindow || id == IID_IOleInPlaceSite) return static_cast<IOleInPlaceSite*>(this);
  if (id == IID_IOleControlSite) return static_cast<IOleControlSite*>(this);
  if (id == IID_IOleInPlaceUIWindow || id == IID_IOleInPlaceFrame)
    return static_cast<IOleInPlaceFrame*>(this);
  if (id == IID_IDispatch) return static_cast<IDispatch*>(this);
  return nullptr;
}

Hosted::Hosted(const std::wstring& progId)
    : object(create<IOleObject>(progId.c_str())),
      members(object.query<IDispatch>()),
      inPlace(object.query<IOleInPlaceObject>()) {}

HRESULT Hosted::verb(LONG verb) { return object->DoVerb(verb, nullptr, nullptr, 0, nullptr, nullptr); }

void Hosted::advise(IUnknown& sink) const {
  DWORD cookie = 0;
  pointOf(*members.get(), eventsOf(*members.get()))->Advise(&sink, &cookie);
}

HWND Hosted::window() const {
  HWND window = nullptr;
  inPlace->GetWindow(&window);
  return window;
}

void Hosted::release() {
  members.reset();
  inPlace.reset();
  object.reset();
}

void Hosted::close() {
  if (!object) return;
  object->Close(OLECLOSE_NOSAVE);
  object->SetClientSite(nullptr);
  release();
}

ComPointer<IConnectionPoint> pointOf(IDispatch& control, const IID& id) {
  ComPointer<IConnectionPoint> point;
  if (const auto points = ComPointer<IDispatch>(&control).query<IConnectionPointContainer>())
    points->FindConnectionPoint(id, point.receive());
  return point;
}

IID eventsOf(IDispatch& control) {
  IID id{};
  if (const auto info = ComPointer<IDispatch>(&control).query<IProvideClassInfo2>())
    info->GetGUID(GUIDKIND_DEFAULT_SOURCE_DISP_IID, &id);
  return id;
}

}  // namespace frontpanels::testing

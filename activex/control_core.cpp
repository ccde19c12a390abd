#include "activex/control_core.h"

#include <olectl.h>

#include "activex/barrier.h"
#include "activex/class_info_part.h"
#include "activex/connections_part.h"
#include "activex/data_part.h"
#include "activex/in_place_part.h"
#include "activex/late_notices.h"
#include "activex/ole_object_part.h"
#include "activex/persistence_part.h"
#include "activex/variants.h"
#include "activex/view_part.h"
#include "platform/win32/win32_windowing.h"

namespace frontpanels::activex {
namespace {

constexpr Size kDefaultSizePx{640, 480};
constexpr int kHimetricPerInch = 2540;
constexpr int kUsualDpi = 96;

// A screen without a driver answers 0, by which nothing can be divided.
int screenDpi(int axis) noexcept {
  const HDC screen = GetDC(nullptr);
  const int dpi = GetDeviceCaps(screen, axis);
  ReleaseDC(nullptr, screen);
  return dpi > 0 ? dpi : kUsualDpi;
}

}  // namespace

SIZEL himetricOf(Size sizePx) noexcept {
  return {MulDiv(sizePx.width, kHimetricPerInch, screenDpi(LOGPIXELSX)),
          MulDiv(sizePx.height, kHimetricPerInch, screenDpi(LOGPIXELSY))};
}

Size pixelsOf(SIZEL himetric) noexcept {
  return {MulDiv(himetric.cx, screenDpi(LOGPIXELSX), kHimetricPerInch),
          MulDiv(himetric.cy, screenDpi(LOGPIXELSY), kHimetricPerInch)};
}

ControlCore::ControlCore(IUnknown* outer, const ControlClass& controlClass)
    : Aggregable(outer),
      class_(controlClass),
      extent_(himetricOf(kDefaultSizePx)),
      window_(*this, readScreenMetrics(), kDefaultSizePx),
      oleObject_(std::make_unique<OleObjectPart>(*this)),
      inPlace_(std::make_unique<InPlacePart>(*this)),
      view_(std::make_unique<ViewPart>(*this)),
      persistence_(std::make_unique<PersistencePart>(*this)),
      connections_(std::make_unique<ConnectionsPart>(*this)),
      classInfo_(std::make_unique<ClassInfoPart>(*this)),
      dataObject_(std::make_unique<DataPart>(*this)) {}

ControlCore::~ControlCore() = default;

// A container that lets go without closing first gets its window back all the same.
void ControlCore::lastRelease() noexcept {
  ending_ = true;
  inPlace_->deactivate();
  connections_->disconnectAll();
  site_.reset();
}

void* ControlCore::findPart(REFIID id) noexcept {
  struct Row {
    const IID& id;
    void* part;
  };
  const Row rows[] = {
      {IID_IOleObject, static_cast<IOleObject*>(oleObject_.get())},
      {IID_IOleControl, static_cast<IOleControl*>(oleObject_.get())},
      {IID_IOleWindow, static_cast<IOleWindow*>(static_cast<IOleInPlaceObject*>(inPlace_.get()))},
      {IID_IOleInPlaceObject, static_cast<IOleInPlaceObject*>(inPlace_.get())},
      {IID_IOleInPlaceActiveObject, static_cast<IOleInPlaceActiveObject*>(inPlace_.get())},
      {IID_IViewObject, static_cast<IViewObject*>(view_.get())},
      {IID_IViewObject2, static_cast<IViewObject2*>(view_.get())},
      {IID_IPersist, static_cast<IPersist*>(static_cast<IPersistStreamInit*>(persistence_.get()))},
      {IID_IPersistStreamInit, static_cast<IPersistStreamInit*>(persistence_.get())},
      {IID_IPersistPropertyBag, static_cast<IPersistPropertyBag*>(persistence_.get())},
      {IID_IPersistStorage, static_cast<IPersistStorage*>(persistence_.get())},
      {IID_IConnectionPointContainer, static_cast<IConnectionPointContainer*>(connections_.get())},
      {IID_IProvideClassInfo, static_cast<IProvideClassInfo*>(classInfo_.get())},
      {IID_IProvideClassInfo2, static_cast<IProvideClassInfo2*>(classInfo_.get())},
      {IID_ISupportErrorInfo, static_cast<ISupportErrorInfo*>(classInfo_.get())},
      {IID_IDataObject, static_cast<IDataObject*>(dataObject_.get())},
  };
  for (const Row& row : rows)
    if (row.id == id) return row.part;
  return nullptr;
}

void ControlCore::site(IOleClientSite* site) {
  if (site != site_.get()) inPlace_->deactivate();
  site_ = ComPointer<IOleClientSite>(site);
  readAmbients();
}

// A container that does not say is running, and has no font.
void ControlCore::readAmbients() {
  userMode_ = true;
  ComPointer<IFont> font;
  VARIANT value;
  VariantInit(&value);
  if (readAmbient(DISPID_AMBIENT_USERMODE, value) && SUCCEEDED(VariantChangeType(&value, &value, 0, VT_BOOL)))
    userMode_ = V_BOOL(&value) != VARIANT_FALSE;
  VariantClear(&value);
  if (readAmbient(DISPID_AMBIENT_FONT, value) && (V_VT(&value) == VT_DISPATCH || V_VT(&value) == VT_UNKNOWN))
    font = ComPointer<IUnknown>(V_UNKNOWN(&value)).query<IFont>();
  VariantClear(&value);
  HFONT handle = nullptr;
  if (font && FAILED(font->get_hFont(&handle))) handle = nullptr;
  window_.font(handle);
  font_ = font;
}

bool ControlCore::readAmbient(DISPID property, VARIANT& value) const {
  const auto ambients = site_.query<IDispatch>();
  DISPPARAMS none{};
  return ambients && SUCCEEDED(ambients->Invoke(property, IID_NULL, LOCALE_USER_DEFAULT, DISPATCH_PROPERTYGET,
                                                &none, &value, nullptr, nullptr));
}

// Some containers answer the control itself: asking it would call us back for ever.
ComPointer<IDispatch> ControlCore::extender() const {
  ComPointer<IDispatch> extended;
  const auto controlSite = site_.query<IOleControlSite>();
  if (!controlSite || FAILED(controlSite->GetExtendedControl(extended.receive()))) return {};
  const ComPointer<IUnknown> own = ComPointer<IUnknown>(outer()).query<IUnknown>();
  if (extended.query<IUnknown>().get() == own.get()) return {};
  return extended;
}

bool ControlCore::putExtended(const wchar_t* name, const Variant& value) noexcept {
  const ComPointer<IUnknown> alive(outer());
  return barrier([&]() -> HRESULT {
           const ComPointer<IDispatch> extended = extender();
           if (!extended) return E_NOTIMPL;
           std::wstring text = name;
           LPOLESTR pointer = text.data();
           DISPID id = DISPID_UNKNOWN;
           check(extended->GetIDsOfNames(IID_NULL, &pointer, 1, LOCALE_USER_DEFAULT, &id));
           VARIANT argument = toAutomation(value);
           DISPID put = DISPID_PROPERTYPUT;
           DISPPARAMS parameters{&argument, &put, 1, 1};
           const HRESULT done = extended->Invoke(id, IID_NULL, LOCALE_USER_DEFAULT, DISPATCH_PROPERTYPUT,
                                                 &parameters, nullptr, nullptr, nullptr);
           VariantClear(&argument);
           return done;
         }) == S_OK;
}

void ControlCore::extent(SIZEL himetric) {
  if (himetric.cx == extent_.cx && himetric.cy == extent_.cy) return;
  extent_ = himetric;
  dirty(true);
  window_.resizeMemory(pixelsOf(himetric));
  viewChanged();
}

void ControlCore::requestPlace(const RECT& place) {
  if (inPlace_->active()) return inPlace_->requestPlace(place);
  placePx_ = place;
  if (!adoptSize({place.right - place.left, place.bottom - place.top})) return;
  viewChanged();
  if (const ComPointer<IOleClientSite> site = site_) site->RequestNewObjectLayout();
}

// A window shows by itself what it has got. Of a control that is going nobody may keep hold any more.
void ControlCore::viewChanged() {
  if (ending_ || inPlace_->active()) return;
  if (savings_ == 0) return LateNotices::tell(*this);
  changedMeanwhile_ = true;
}

void ControlCore::tellOnlookers() {
  view_->changed();
  dataObject_->changed();
}

bool ControlCore::adoptSize(Size sizePx) {
  window_.resizeMemory(sizePx);  // for the time after the window
  if (sizePx.width <= 0 || sizePx.height <= 0 || pixelsOf(extent_) == sizePx) return false;
  extent_ = himetricOf(sizePx);
  dirty(true);
  return true;
}

void ControlCore::pressed() { inPlace_->activateUi(); }

// Focus that comes by the Tab key makes the control active like a click. A designer has the focus itself.
void ControlCore::focusChanged(bool focused) {
  if (!userMode_) return;
  if (const auto controlSite = site_.query<IOleControlSite>()) controlSite->OnFocus(focused);
  if (focused) inPlace_->activateUi();
}

void ControlCore::accessKeysChanged() {
  const auto controlSite = site_.query<IOleControlSite>();
  if (controlSite && oleObject_->accessKeysOutdated()) controlSite->OnControlInfoChanged();
}

void ControlCore::windowDestroyed() noexcept { inPlace_->windowLost(); }

}  // namespace frontpanels::activex

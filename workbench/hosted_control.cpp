#include "workbench/hosted_control.h"

#include <windows.h>

#include "workbench/failure.h"
#include "workbench/screen_scale.h"

namespace frontpanels::workbench {

HostedControl::HostedControl(const std::string& progId, const std::wstring& name, PanelPlace& place,
                             PanelRequests& requests, const Properties* stored)
    : place_(place), site_(makeComObject<ControlSite>(static_cast<ControlOwner&>(*this), name)) {
  const ComPointer<IUnknown> control = createObject(progId);
  object_ = control.query<IOleObject>();
  if (!object_) throw HostFailure(progId + " is not a control");
  try {
    siteAndInitialise(name, stored);
    events_.emplace(*control.get(), requests);
    activate();
  } catch (...) {
    close();
    throw;
  }
}

HostedControl::~HostedControl() { close(); }

void HostedControl::siteAndInitialise(const std::wstring& name, const Properties* stored) {
  DWORD status = 0;
  object_->GetMiscStatus(DVASPECT_CONTENT, &status);
  const bool siteFirst = (status & OLEMISC_SETCLIENTSITEFIRST) != 0;
  if (siteFirst) check(object_->SetClientSite(site_.get()), "Giving the panel its site");
  initialise(stored);
  if (!siteFirst) check(object_->SetClientSite(site_.get()), "Giving the panel its site");
  object_->SetHostNames(L"Front Panels workbench", name.c_str());
}

void HostedControl::initialise(const Properties* stored) {
  const auto bag = object_.query<IPersistPropertyBag>();
  if (stored != nullptr && bag)
    return check(bag->Load(makeComObject<PropertyBag>(*stored).get(), nullptr), "Restoring the panel");
  if (const auto persist = object_.query<IPersistStreamInit>())
    check(persist->InitNew(), "Initialising the panel");
}

Properties HostedControl::properties() const {
  const auto persist = object_.query<IPersistPropertyBag>();
  if (!persist) return {};
  const auto bag = makeComObject<PropertyBag>(Properties{});
  check(persist->Save(bag.get(), TRUE, TRUE), "Asking the panel for what it keeps");
  return bag->properties();
}

void HostedControl::activate() {
  const RECT rect = place_.panelRect();
  SIZEL extent{himetricFromPixels(rect.right - rect.left), himetricFromPixels(rect.bottom - rect.top)};
  object_->SetExtent(DVASPECT_CONTENT, &extent);
  check(doVerb(OLEIVERB_INPLACEACTIVATE), "Activating the panel");
  inPlace_ = object_.query<IOleInPlaceObject>();
  if (!inPlace_) throw HostFailure("The panel cannot be active in a window");
  layOut();
}

HRESULT HostedControl::doVerb(LONG verb) {
  const RECT rect = place_.panelRect();
  return object_->DoVerb(verb, nullptr, site_.get(), 0, place_.parentWindow(), &rect);
}

Automation HostedControl::automation() const {
  ComPointer<IDispatch> members = object_.query<IDispatch>();
  if (!members) throw HostFailure("The panel cannot be called by name");
  return Automation(std::move(members));
}

void HostedControl::layOut() {
  if (!inPlace_) return;
  const RECT rect = place_.panelRect();
  inPlace_->SetObjectRects(&rect, &rect);
}

// A control that does not want the keyboard leaves it where it is.
void HostedControl::focus() { static_cast<void>(doVerb(OLEIVERB_UIACTIVATE)); }

void HostedControl::frameActivated(bool active) {
  if (activeObject_) activeObject_->OnFrameWindowActivate(active);
}

bool HostedControl::translateAccelerator(MSG& message) {
  // The control may let go of its activity while it deals with the key.
  const ComPointer<IOleInPlaceActiveObject> alive = activeObject_;
  return alive && alive->TranslateAccelerator(&message) == S_OK;
}

// Beside another panel it has no keys, no border and no focus.
void HostedControl::documentActivated(bool active) {
  if (activeObject_) activeObject_->OnDocWindowActivate(active);
  if (!active && inPlace_) inPlace_->UIDeactivate();
}

void HostedControl::close() noexcept {
  events_.reset();
  activeObject_.reset();
  if (inPlace_) inPlace_->InPlaceDeactivate();
  inPlace_.reset();
  if (object_) {
    object_->Close(OLECLOSE_NOSAVE);
    object_->SetClientSite(nullptr);
  }
  object_.reset();
  site_->detach();
}

}  // namespace frontpanels::workbench

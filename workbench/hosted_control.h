// A control in its place: created, sited, activated, laid out, and closed again.
#pragma once

#include <ocidl.h>
#include <oleidl.h>

#include <optional>
#include <string>

#include "platform/win32/com_pointer.h"
#include "workbench/automation.h"
#include "workbench/control_owner.h"
#include "workbench/control_site.h"
#include "workbench/event_sink.h"
#include "workbench/property_bag.h"

namespace frontpanels::workbench {

class HostedControl final : private ControlOwner {
 public:
  // `name` is what the container calls the control, `stored` what it kept with its form; without that it
  // begins anew. Raises `NotRegistered`, or a failure that names the step; what was set up until then is
  // undone.
  HostedControl(const std::string& progId, const std::wstring& name, PanelPlace& place,
                PanelRequests& requests, const Properties* stored);
  HostedControl(const HostedControl&) = delete;
  HostedControl& operator=(const HostedControl&) = delete;
  ~HostedControl();

  [[nodiscard]] Automation automation() const;

  void layOut() override;
  // Gives it the keyboard.
  void focus();
  // The program's window has become active, or no longer is; the same for the panel's own in it.
  void frameActivated(bool active);
  void documentActivated(bool active);
  // What is to be kept with the form.
  [[nodiscard]] Properties properties() const;
  // True when the control has dealt with the key.
  [[nodiscard]] bool translateAccelerator(MSG& message);

 private:
  [[nodiscard]] PanelPlace& place() override { return place_; }
  void activeObject(IOleInPlaceActiveObject* object) override {
    activeObject_ = ComPointer<IOleInPlaceActiveObject>(object);
  }

  void siteAndInitialise(const std::wstring& name, const Properties* stored);
  void initialise(const Properties* stored);
  void activate();
  [[nodiscard]] HRESULT doVerb(LONG verb);
  void close() noexcept;

  PanelPlace& place_;
  ComPointer<ControlSite> site_;
  ComPointer<IOleObject> object_;
  ComPointer<IOleInPlaceObject> inPlace_;
  ComPointer<IOleInPlaceActiveObject> activeObject_;
  std::optional<EventConnection> events_;
};

}  // namespace frontpanels::workbench

// What site, frame and extender ask of the hosted control that they belong to. They are counted objects and
// may outlive it: it detaches them when it goes, and they then answer E_UNEXPECTED.
#pragma once

#include <oleidl.h>

#include "workbench/panel_place.h"

namespace frontpanels::workbench {

class ControlOwner {
 public:
  [[nodiscard]] virtual PanelPlace& place() = 0;
  // The object that gets the keys first; null when there is none.
  virtual void activeObject(IOleInPlaceActiveObject* object) = 0;
  // Puts the control's window where the place says.
  virtual void layOut() = 0;

 protected:
  ~ControlOwner() = default;
};

}  // namespace frontpanels::workbench

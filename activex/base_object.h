// A panel's base as an object for late binding: the state that its panels share with their host, each
// property by its name. Its identity is its own, its life the control's.
#pragma once

#include "activex/named_members.h"
#include "framework/panel/base_vfp.h"

namespace frontpanels::activex {

class BaseObject : public NamedObject<clsBaseVFP> {
 public:
  BaseObject();
};

}  // namespace frontpanels::activex

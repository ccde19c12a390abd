// IProvideClassInfo2 and ISupportErrorInfo: what the control is and which of its interfaces explain their
// errors.
#pragma once

#include <ocidl.h>

#include "activex/control_core.h"

namespace frontpanels::activex {

class ClassInfoPart final : public ControlPart<IProvideClassInfo2, ISupportErrorInfo> {
 public:
  using ControlPart::ControlPart;

  HRESULT STDMETHODCALLTYPE GetClassInfo(ITypeInfo** info) override;
  HRESULT STDMETHODCALLTYPE GetGUID(DWORD kind, GUID* id) override;
  HRESULT STDMETHODCALLTYPE InterfaceSupportsErrorInfo(REFIID id) override;
};

}  // namespace frontpanels::activex

// What a container tells all of its controls: user mode, colours, font, language.
#pragma once

#include <oaidl.h>

#include <string>

namespace frontpanels::workbench {

// DISP_E_MEMBERNOTFOUND for a property that is not offered. `result` is overwritten.
[[nodiscard]] HRESULT ambientProperty(DISPID id, const std::wstring& displayName, VARIANT& result);

}  // namespace frontpanels::workbench

#include "activex/classes.h"

#include "activex/cell_name_object.h"
#include "activex/data_hub_object.h"
#include "activex/diagnostics_object.h"
#include "activex/result_buffer_object.h"
#include "activex/spectrum_control.h"
#include "frontpanels_h.h"

namespace frontpanels::activex {
namespace {

template <class Object>
Aggregable* create(IUnknown* outer) {
  return new Object(outer);
}

const ClassRow kClasses[] = {
    {&CLSID_SpectrumView, L"SpectrumView", L"Front Panels SpectrumView", true, create<SpectrumControl>},
    {&CLSID_DataHub, L"DataHub", L"Front Panels DataHub", false, create<DataHubObject>},
    {&CLSID_Diagnostics, L"Diagnostics", L"Front Panels Diagnostics", false, create<DiagnosticsObject>},
    {&CLSID_ResultBuffer, L"ResultBuffer", L"Front Panels ResultBuffer", false, create<ResultBufferObject>},
    {&CLSID_clsCellNameInfo, L"clsCellNameInfo", L"Front Panels clsCellNameInfo", false,
     create<CellNameObject>},
};

}  // namespace

std::span<const ClassRow> classes() noexcept { return kClasses; }

}  // namespace frontpanels::activex

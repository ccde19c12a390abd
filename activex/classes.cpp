#include "activex/classes.h"

#include "activex/cell_name_object.h"
#include "activex/data_hub_object.h"
#include "activex/diagnostics_object.h"
#include "activex/result_buffer_object.h"
#include "activex/spectrum_control.h"
#include "activex/tarvex_control.h"
#include "activex/toolbox_bitmaps.h"
#include "frontpanels_h.h"

namespace frontpanels::activex {
namespace {

template <class Object>
Aggregable* create(IUnknown* outer) {
  return new Object(outer);
}

const ClassRow kClasses[] = {
    {&CLSID_SpectrumView, L"SpectrumView", L"Front Panels SpectrumView", SPECTRUM_TOOLBOX_BITMAP,
     create<SpectrumControl>},
    {&CLSID_DataHub, L"DataHub", L"Front Panels DataHub", 0, create<DataHubObject>},
    {&CLSID_Diagnostics, L"Diagnostics", L"Front Panels Diagnostics", 0, create<DiagnosticsObject>},
    {&CLSID_ResultBuffer, L"ResultBuffer", L"Front Panels ResultBuffer", 0, create<ResultBufferObject>},
    {&CLSID_clsCellNameInfo, L"clsCellNameInfo", L"Front Panels clsCellNameInfo", 0, create<CellNameObject>},
    {&CLSID_Tarvex, L"Tarvex", L"Front Panels Tarvex", PILOT_TOOLBOX_BITMAP, create<TarvexControl>},
};

}  // namespace

std::span<const ClassRow> classes() noexcept { return kClasses; }

}  // namespace frontpanels::activex

#include "activex/spectrum_control.h"

#include "activex/services.h"

namespace frontpanels::activex {
namespace {

constexpr ControlClass kClass{&CLSID_SpectrumView, &IID_ISpectrumView, &DIID__ISpectrumViewEvents,
                              L"Front Panels SpectrumView"};

}  // namespace

SpectrumControl::SpectrumControl(IUnknown* outer) : FrontPanelControl(outer, kClass) {
  Services& shared = services();
  panel_.emplace(PanelEnvironment{shared.gdi, shared.windowing, window(), shared.hub, readScreenMetrics(),
                                  toUtf8(GetCommandLineW())},
                 requests(), *this);
  window().events(this);
  panel_->Form_Resize();
}

SpectrumControl::~SpectrumControl() { window().events(nullptr); }

void* SpectrumControl::findInterface(REFIID id) noexcept {
  if (id == IID_ISpectrumView || id == IID_IDispatch) return static_cast<ISpectrumView*>(this);
  return findPart(id);
}

HRESULT SpectrumControl::addMarker() {
  return perform([&] { panel_->addMarker(); });
}

HRESULT SpectrumControl::markerToMax() {
  return perform([&] { panel_->markerToMax(); });
}

HRESULT SpectrumControl::markerToMin() {
  return perform([&] { panel_->markerToMin(); });
}

}  // namespace frontpanels::activex

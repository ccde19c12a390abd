// FrontPanels.SpectrumView: the spectrum panel as a control.
#pragma once

#include <optional>

#include "activex/front_panel_control.h"
#include "frontpanels_h.h"
#include "spectrum/spectrum_view.h"

namespace frontpanels::activex {

class SpectrumControl final : public FrontPanelControl<ISpectrumView> {
 public:
  explicit SpectrumControl(IUnknown* outer);
  ~SpectrumControl() override;

  HRESULT STDMETHODCALLTYPE addMarker() override;
  HRESULT STDMETHODCALLTYPE markerToMax() override;
  HRESULT STDMETHODCALLTYPE markerToMin() override;

 private:
  [[nodiscard]] void* findInterface(REFIID id) noexcept override;
  [[nodiscard]] HostedPanel& panel() override { return *panel_; }
  [[nodiscard]] clsBaseVFP& base() override { return panel_->base(); }

  std::optional<SpectrumView> panel_;
};

}  // namespace frontpanels::activex

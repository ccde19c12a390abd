// FrontPanels.SpectrumView: the spectrum panel as a control.
#pragma once

#include "activex/front_panel_control.h"
#include "frontpanels_h.h"
#include "spectrum/spectrum_view.h"

namespace frontpanels::activex {

class SpectrumControl final : public FrontPanelControl<ISpectrumView, SpectrumView> {
 public:
  explicit SpectrumControl(IUnknown* outer);

  HRESULT STDMETHODCALLTYPE markerToCenter() override;
  HRESULT STDMETHODCALLTYPE updateMarkerButtons() override;
  HRESULT STDMETHODCALLTYPE evaluateEnablingMarkerToCenter() override;
  HRESULT STDMETHODCALLTYPE deltaMarkerButtonEnabled(VARIANT_BOOL enable) override;
  HRESULT STDMETHODCALLTYPE Limits(short parameterType, VARIANT ranges, LONG* status) override;
  HRESULT STDMETHODCALLTYPE ChannelZero(short order, double frequencyHz) override;
  HRESULT STDMETHODCALLTYPE ChannelSpacing(short order, double spacingHz) override;
  HRESULT STDMETHODCALLTYPE ChannelDiscontinuity(short order, double channel, double lowest,
                                                 double highest) override;
  HRESULT STDMETHODCALLTYPE ChannelLookup(short channelization, short lowestOrder,
                                          short highestOrder) override;
  HRESULT STDMETHODCALLTYPE ClearChannels() override;
};

}  // namespace frontpanels::activex

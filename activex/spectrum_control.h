// FrontPanels.SpectrumView: the spectrum panel as a control.
#pragma once

#include <optional>

#include "activex/control_core.h"
#include "activex/dispatch.h"
#include "activex/panel_events.h"
#include "framework/panel/panel_host.h"
#include "frontpanels_h.h"
#include "spectrum/spectrum_view.h"

namespace frontpanels::activex {

// A control with its automation interface.
class SpectrumControlBase : public ControlCore, public ISpectrumView {
 public:
  using ControlCore::ControlCore;
  HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override {
    return outer()->QueryInterface(id, object);
  }
  ULONG STDMETHODCALLTYPE AddRef() override { return outer()->AddRef(); }
  ULONG STDMETHODCALLTYPE Release() override { return outer()->Release(); }
};

class SpectrumControl final : public Dispatching<SpectrumControlBase, ISpectrumView>,
                              public PanelEvents,
                              public PanelHost,
                              public PanelContainer {
 public:
  explicit SpectrumControl(IUnknown* outer);
  ~SpectrumControl() override;

  // ISpectrumView
  HRESULT STDMETHODCALLTYPE vfpOp(LONG hardwareId, short operation, VARIANT parameter, LONG* status) override;
  HRESULT STDMETHODCALLTYPE vfpSet(LONG hardwareId, short parameterType, short index, VARIANT value,
                                   LONG* status) override;
  HRESULT STDMETHODCALLTYPE get_Caption(BSTR* text) override;
  HRESULT STDMETHODCALLTYPE addMarker() override;
  HRESULT STDMETHODCALLTYPE markerToMax() override;
  HRESULT STDMETHODCALLTYPE markerToMin() override;
  HRESULT STDMETHODCALLTYPE SavePicture(BSTR path) override;
  HRESULT STDMETHODCALLTYPE get_ViewScaleWidth(float* twips) override;
  HRESULT STDMETHODCALLTYPE get_ViewScaleHeight(float* twips) override;
  HRESULT STDMETHODCALLTYPE get_ViewScaleMode(short* mode) override;
  HRESULT STDMETHODCALLTYPE get_ViewHWnd(LONG* window) override;
  HRESULT STDMETHODCALLTYPE get_ViewVisible(VARIANT_BOOL* visible) override;
  HRESULT STDMETHODCALLTYPE Refresh() override;
  HRESULT STDMETHODCALLTYPE put_Caption(BSTR text) override;
  HRESULT STDMETHODCALLTYPE put_ViewVisible(VARIANT_BOOL visible) override;
  HRESULT STDMETHODCALLTYPE get_ViewHDC(LONG* dc) override;
  HRESULT STDMETHODCALLTYPE get_ViewScaleLeft(float* twips) override;
  HRESULT STDMETHODCALLTYPE get_ViewScaleTop(float* twips) override;
  HRESULT STDMETHODCALLTYPE get_ViewUsableScaleWidth(float* twips) override;
  HRESULT STDMETHODCALLTYPE get_ViewUsableScaleHeight(float* twips) override;
  HRESULT STDMETHODCALLTYPE get_ViewDrawMode(short* mode) override;
  HRESULT STDMETHODCALLTYPE put_ViewDrawMode(short mode) override;
  HRESULT STDMETHODCALLTYPE get_ViewDrawStyle(short* style) override;
  HRESULT STDMETHODCALLTYPE put_ViewDrawStyle(short style) override;
  HRESULT STDMETHODCALLTYPE get_ViewDrawWidth(short* widthPx) override;
  HRESULT STDMETHODCALLTYPE get_ViewMousePointer(short* pointer) override;
  HRESULT STDMETHODCALLTYPE put_ViewMousePointer(short pointer) override;
  HRESULT STDMETHODCALLTYPE get_ViewState(short* state) override;
  HRESULT STDMETHODCALLTYPE put_ViewState(short state) override;
  HRESULT STDMETHODCALLTYPE ViewRefresh() override;
  HRESULT STDMETHODCALLTYPE get_DisplayPanelVisible(VARIANT_BOOL* visible) override;
  HRESULT STDMETHODCALLTYPE put_DisplayPanelVisible(VARIANT_BOOL visible) override;
  HRESULT STDMETHODCALLTYPE get_MeasurementPanelVisible(VARIANT_BOOL* visible) override;
  HRESULT STDMETHODCALLTYPE put_MeasurementPanelVisible(VARIANT_BOOL visible) override;
  HRESULT STDMETHODCALLTYPE closeVfp() override;
  HRESULT STDMETHODCALLTYPE refreshControls() override;
  HRESULT STDMETHODCALLTYPE get_hWnd(LONG* window) override { return get_ViewHWnd(window); }

  // PanelEvents
  void paint() override { panel_->Paint(); }
  Rect paintedAreaPx() override;
  void resized() override { panel_->Form_Resize(); }
  void mouseDown(const MouseEvent& e) override { panel_->MouseDown(e.button, e.shift, e.xTwips, e.yTwips); }
  void mouseMove(const MouseEvent& e) override { panel_->MouseMove(e.button, e.shift, e.xTwips, e.yTwips); }
  void mouseUp(const MouseEvent& e) override { panel_->MouseUp(e.button, e.shift, e.xTwips, e.yTwips); }
  void keyDown(std::int16_t keyCode, std::int16_t shift) override { panel_->KeyDown(keyCode, shift); }

  // PanelHost
  std::int32_t frontPanelOp(std::int32_t hwId, std::int32_t vfpId, std::int16_t operation,
                            const Variant& argument) override;
  // PanelContainer: a container that keeps no such property goes without.
  void caption(std::string_view text) override { putExtended(L"Caption", std::string(text)); }
  void visible(bool visible) override { putExtended(L"Visible", visible); }
  void viewState(std::int16_t state) override { putExtended(L"ViewState", state); }

  // Stored properties
  std::span<const StoredProperty> storedProperties() const override;
  bool storedValue(std::size_t property) const override;
  void storedValue(std::size_t property, bool value) override;

 private:
  [[nodiscard]] void* findInterface(REFIID id) noexcept override;
  HRESULT change(std::size_t property, VARIANT_BOOL value);

  std::optional<SpectrumView> panel_;
};

}  // namespace frontpanels::activex

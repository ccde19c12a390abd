#include "activex/spectrum_control.h"

#include "activex/connections_part.h"
#include "activex/picture_file.h"
#include "activex/services.h"
#include "activex/variants.h"
#include "activex/view_part.h"
#include "framework/panel/base_vfp.h"
#include "framework/support/numeric.h"
#include "platform/win32/utf16.h"

namespace frontpanels::activex {
namespace {

constexpr ControlClass kClass{&CLSID_SpectrumView, &IID_ISpectrumView, &DIID__ISpectrumViewEvents,
                              L"Front Panels SpectrumView"};
constexpr DISPID kFrontPanelOpEvent = 1;

enum Stored : std::size_t { kDisplayPanelVisible, kMeasurementPanelVisible };
constexpr StoredProperty kStored[] = {{L"DisplayPanelVisible", true}, {L"MeasurementPanelVisible", true}};

constexpr DISPID kStoredIds[] = {26, 27};

VARIANT_BOOL variantBool(bool value) noexcept { return value ? VARIANT_TRUE : VARIANT_FALSE; }

// Handles of the system have 32 significant bits in either width.
template <class Tag>
LONG numberOf(Handle<Tag> handle) noexcept {
  return static_cast<LONG>(static_cast<LONG_PTR>(handle.value));
}

std::string commandLine() { return toUtf8(GetCommandLineW()); }

// Hands a value out through a pointer that a caller may have left null.
template <class T, class Body>
HRESULT give(T* result, Body body) {
  if (result == nullptr) return E_POINTER;
  *result = T{};
  return barrier(IID_ISpectrumView, [&] { *result = body(); });
}

}  // namespace

SpectrumControl::SpectrumControl(IUnknown* outer) : Dispatching(outer, kClass) {
  Services& shared = services();
  panel_.emplace(PanelEnvironment{shared.gdi, shared.windowing, window(), shared.hub, readScreenMetrics(),
                                  commandLine()},
                 *this, *this);
  window().events(this);
  panel_->Form_Resize();
}

SpectrumControl::~SpectrumControl() { window().events(nullptr); }

void* SpectrumControl::findInterface(REFIID id) noexcept {
  if (id == IID_ISpectrumView || id == IID_IDispatch) return static_cast<ISpectrumView*>(this);
  return findPart(id);
}

// --- ISpectrumView

HRESULT SpectrumControl::vfpOp(LONG hardwareId, short operation, VARIANT parameter, LONG* status) {
  const ComPointer<IUnknown> alive(outer());
  return give(status, [&] {
    return static_cast<LONG>(panel_->vfpOp(hardwareId, operation, fromAutomation(parameter)));
  });
}

HRESULT SpectrumControl::vfpSet(LONG hardwareId, short parameterType, short index, VARIANT value,
                                LONG* status) {
  const ComPointer<IUnknown> alive(outer());
  return give(status, [&] {
    return static_cast<LONG>(panel_->vfpSet(hardwareId, parameterType, index, fromAutomation(value)));
  });
}

HRESULT SpectrumControl::get_Caption(BSTR* text) {
  return give(text, [&] { return toBstr(panel_->Caption()); });
}

HRESULT SpectrumControl::addMarker() {
  return barrier(IID_ISpectrumView, [&] { panel_->addMarker(); });
}

HRESULT SpectrumControl::markerToMax() {
  return barrier(IID_ISpectrumView, [&] { panel_->markerToMax(); });
}

HRESULT SpectrumControl::markerToMin() {
  return barrier(IID_ISpectrumView, [&] { panel_->markerToMin(); });
}

HRESULT SpectrumControl::SavePicture(BSTR path) {
  return barrier(IID_ISpectrumView, [&] {
    MemoryPicture picture;
    window().render(picture);
    writePng(std::wstring(path, SysStringLen(path)), picture);
  });
}

HRESULT SpectrumControl::put_Caption(BSTR text) {
  return barrier(IID_ISpectrumView, [&] { panel_->base().Caption(fromBstr(text)); });
}

HRESULT SpectrumControl::get_DisplayPanelVisible(VARIANT_BOOL* visible) {
  return give(visible, [&] { return variantBool(storedValue(kDisplayPanelVisible)); });
}

HRESULT SpectrumControl::put_DisplayPanelVisible(VARIANT_BOOL visible) {
  return change(kDisplayPanelVisible, visible);
}

HRESULT SpectrumControl::get_MeasurementPanelVisible(VARIANT_BOOL* visible) {
  return give(visible, [&] { return variantBool(storedValue(kMeasurementPanelVisible)); });
}

HRESULT SpectrumControl::put_MeasurementPanelVisible(VARIANT_BOOL visible) {
  return change(kMeasurementPanelVisible, visible);
}

HRESULT SpectrumControl::change(std::size_t property, VARIANT_BOOL value) {
  const ComPointer<IUnknown> alive(outer());
  return barrier(IID_ISpectrumView, [&] {
    storedValue(property, value != VARIANT_FALSE);
    dirty(true);
    view().changed();
    connections().notifyChanged(kStoredIds[property]);
  });
}

HRESULT SpectrumControl::closeVfp() {
  const ComPointer<IUnknown> alive(outer());
  return barrier(IID_ISpectrumView, [&] { panel_->base().closeVfp(); });
}

HRESULT SpectrumControl::refreshControls() {
  return barrier(IID_ISpectrumView, [&] { panel_->control().refreshControls(); });
}

// --- The surface that the graph is drawn on

HRESULT SpectrumControl::get_ViewScaleLeft(float* twips) {
  return give(twips, [&] { return panel_->control().ViewScaleLeft(); });
}

HRESULT SpectrumControl::get_ViewScaleTop(float* twips) {
  return give(twips, [&] { return panel_->control().ViewScaleTop(); });
}

HRESULT SpectrumControl::get_ViewScaleWidth(float* twips) {
  return give(twips, [&] { return panel_->control().ViewScaleWidth(); });
}

HRESULT SpectrumControl::get_ViewScaleHeight(float* twips) {
  return give(twips, [&] { return panel_->control().ViewScaleHeight(); });
}

HRESULT SpectrumControl::get_ViewUsableScaleWidth(float* twips) {
  return give(twips, [&] { return panel_->control().ViewUseableScaleWidth(); });
}

HRESULT SpectrumControl::get_ViewUsableScaleHeight(float* twips) {
  return give(twips, [&] { return panel_->control().ViewUseableScaleHeight(); });
}

HRESULT SpectrumControl::get_ViewScaleMode(short* mode) {
  return give(mode, [&] { return static_cast<short>(panel_->control().ViewScaleMode()); });
}

HRESULT SpectrumControl::get_ViewHWnd(LONG* windowHandle) {
  return give(windowHandle, [&] { return numberOf(panel_->control().ViewHWnd()); });
}

HRESULT SpectrumControl::get_ViewHDC(LONG* dc) {
  return give(dc, [&] { return numberOf(panel_->control().ViewHDC()); });
}

HRESULT SpectrumControl::get_ViewDrawMode(short* mode) {
  return give(mode, [&] { return static_cast<short>(panel_->control().ViewDrawMode()); });
}

HRESULT SpectrumControl::put_ViewDrawMode(short mode) {
  return barrier(IID_ISpectrumView, [&] { panel_->control().ViewDrawMode(static_cast<DrawMode>(mode)); });
}

HRESULT SpectrumControl::get_ViewDrawStyle(short* style) {
  return give(style, [&] { return static_cast<short>(panel_->control().ViewDrawStyle()); });
}

HRESULT SpectrumControl::put_ViewDrawStyle(short style) {
  return barrier(IID_ISpectrumView, [&] { panel_->control().ViewDrawStyle(static_cast<PenStyle>(style)); });
}

HRESULT SpectrumControl::get_ViewDrawWidth(short* widthPx) {
  return give(widthPx, [&] { return panel_->control().ViewDrawWidth(); });
}

HRESULT SpectrumControl::get_ViewMousePointer(short* pointer) {
  return give(pointer, [&] { return static_cast<short>(panel_->control().ViewMousePointer()); });
}

HRESULT SpectrumControl::put_ViewMousePointer(short pointer) {
  return barrier(IID_ISpectrumView,
                 [&] { panel_->control().ViewMousePointer(static_cast<MousePointer>(pointer)); });
}

HRESULT SpectrumControl::get_ViewState(short* state) {
  return give(state, [&] { return panel_->control().winState(); });
}

HRESULT SpectrumControl::put_ViewState(short state) {
  return barrier(IID_ISpectrumView, [&] { panel_->control().ViewState(state); });
}

HRESULT SpectrumControl::get_ViewVisible(VARIANT_BOOL* visible) {
  return give(visible, [&] { return variantBool(window().visible()); });
}

HRESULT SpectrumControl::put_ViewVisible(VARIANT_BOOL visible) {
  return barrier(IID_ISpectrumView, [&] { panel_->control().ViewVisible(visible != VARIANT_FALSE); });
}

HRESULT SpectrumControl::ViewRefresh() {
  return barrier(IID_ISpectrumView, [&] { panel_->control().ViewRefresh(); });
}

HRESULT SpectrumControl::Refresh() {
  return barrier(IID_ISpectrumView, [&] {
    panel_->Paint();
    window().refresh();
  });
}

// --- Requests to the host

std::int32_t SpectrumControl::frontPanelOp(std::int32_t hwId, std::int32_t vfpId, std::int16_t operation,
                                           const Variant& argument) {
  VARIANT arguments[4] = {};
  V_VT(&arguments[0]) = VT_I4;
  V_I4(&arguments[0]) = hwId;
  V_VT(&arguments[1]) = VT_I4;
  V_I4(&arguments[1]) = vfpId;
  V_VT(&arguments[2]) = VT_I2;
  V_I2(&arguments[2]) = operation;
  arguments[3] = toAutomation(argument);
  const LONG status = connections().raiseForStatus(kFrontPanelOpEvent, arguments);
  VariantClear(&arguments[3]);
  return static_cast<std::int32_t>(status);
}

Rect SpectrumControl::paintedAreaPx() {
  const PanelArea& area = panel_->base().traceManager().drawingAreaPx();
  const std::int32_t left = toInt32(area.left);
  const std::int32_t top = toInt32(area.top);
  return {left, top, left + toInt32(area.width), top + toInt32(area.height)};
}

// --- Stored properties

std::span<const StoredProperty> SpectrumControl::storedProperties() const { return kStored; }

bool SpectrumControl::storedValue(std::size_t property) const {
  const clsBaseVFP& base = const_cast<SpectrumView&>(*panel_).base();
  return property == kDisplayPanelVisible ? base.rightPanelVisible() : base.bottomPanelVisible();
}

void SpectrumControl::storedValue(std::size_t property, bool value) {
  if (property == kDisplayPanelVisible)
    panel_->base().rightPanelVisible(value);
  else
    panel_->base().bottomPanelVisible(value);
}

}  // namespace frontpanels::activex

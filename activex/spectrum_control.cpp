#include "activex/spectrum_control.h"

#include "activex/connections_part.h"
#include "activex/picture_file.h"
#include "activex/services.h"
#include "activex/variants.h"
#include "framework/panel/base_vfp.h"
#include "framework/support/numeric.h"
#include "platform/win32/utf16.h"

namespace frontpanels::activex {
namespace {

constexpr ControlClass kClass{&CLSID_SpectrumView, &IID_ISpectrumView, &DIID__ISpectrumViewEvents,
                              L"Front Panels SpectrumView"};
constexpr DISPID kFrontPanelOpEvent = 1;
constexpr short kTwipsScale = 1;

enum Stored : std::size_t { kDisplayPanelVisible, kMeasurementPanelVisible };
constexpr StoredProperty kStored[] = {{L"DisplayPanelVisible", true}, {L"MeasurementPanelVisible", true}};

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

HRESULT SpectrumControl::get_ViewScaleWidth(float* twips) {
  return give(twips, [&] {
    return static_cast<float>(window().clientSizePx().width) * readScreenMetrics().twipsPerPixelX;
  });
}

HRESULT SpectrumControl::get_ViewScaleHeight(float* twips) {
  return give(twips, [&] {
    return static_cast<float>(window().clientSizePx().height) * readScreenMetrics().twipsPerPixelY;
  });
}

HRESULT SpectrumControl::get_ViewScaleMode(short* mode) {
  return give(mode, [] { return kTwipsScale; });
}

// A window handle has 32 significant bits in either width.
HRESULT SpectrumControl::get_ViewHWnd(LONG* windowHandle) {
  return give(windowHandle, [&] { return static_cast<LONG>(reinterpret_cast<LONG_PTR>(window().window())); });
}

HRESULT SpectrumControl::get_ViewVisible(VARIANT_BOOL* visible) {
  return give(visible,
              [&] { return static_cast<VARIANT_BOOL>(window().visible() ? VARIANT_TRUE : VARIANT_FALSE); });
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

// What is alike in all panel controls: the panel in its window, and the host's contract as automation
// members. `Dual` is a panel's dual interface, with these members and its own; `Panel` is the panel, a
// FieldPanel with marker commands.
#pragma once

#include <algorithm>
#include <cstring>
#include <iterator>
#include <string>
#include <utility>

#include "activex/base_object.h"
#include "activex/connections_part.h"
#include "activex/constituent_object.h"
#include "activex/control_core.h"
#include "activex/dispatch.h"
#include "activex/panel_events.h"
#include "activex/panel_requests.h"
#include "activex/picture_file.h"
#include "activex/services.h"
#include "activex/variants.h"
#include "activex/view_part.h"
#include "framework/panel/field_panel.h"
#include "framework/support/guard.h"
#include "framework/support/host_codes.h"
#include "framework/support/numeric.h"
#include "platform/win32/utf16.h"

namespace frontpanels::activex {

[[nodiscard]] inline VARIANT_BOOL variantBool(bool value) noexcept {
  return value ? VARIANT_TRUE : VARIANT_FALSE;
}

// Handles of the system have 32 significant bits in either width.
template <class Tag>
[[nodiscard]] LONG numberOf(Handle<Tag> handle) noexcept {
  return static_cast<LONG>(static_cast<LONG_PTR>(handle.value));
}

// A control with its automation interface.
template <class Dual>
class DualControl : public ControlCore, public Dual {
 public:
  using ControlCore::ControlCore;
  HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override {
    return outer()->QueryInterface(id, object);
  }
  ULONG STDMETHODCALLTYPE AddRef() override { return outer()->AddRef(); }
  ULONG STDMETHODCALLTYPE Release() override { return outer()->Release(); }
};

// Shown or hidden areas are kept with the form; the numbers are those of the properties. A panel that keeps
// more lists its own properties behind these and hands these on.
enum class AreaProperty : std::size_t { DisplayPanelVisible, MeasurementPanelVisible };
inline constexpr StoredProperty kStoredAreas[] = {{L"DisplayPanelVisible", true},
                                                  {L"MeasurementPanelVisible", true}};
inline constexpr DISPID kStoredAreaIds[] = {26, 27};

template <class Dual, class Panel>
class FrontPanelControl : public Dispatching<DualControl<Dual>, Dual>,
                          public PanelEvents,
                          public PanelContainer {
 public:
  // `ofPanel` is what the panel needs beyond its environment.
  template <class... PanelServices>
  FrontPanelControl(IUnknown* outer, const ControlClass& controlClass, const PanelServices&... ofPanel)
      : Dispatching<DualControl<Dual>, Dual>(outer, controlClass),
        requests_(*this),
        baseObject_(*this),
        panel_(environment(), ofPanel..., requests_, *this) {
    this->window().events(this);
    this->window().fields(panel_.controls());
    panel_.Form_Resize();
  }
  ~FrontPanelControl() override {
    this->window().fields(nullptr);
    this->window().events(nullptr);
  }

  // --- Entry points
  HRESULT STDMETHODCALLTYPE vfpOp(LONG hardwareId, short operation, VARIANT parameter,
                                  LONG* status) override {
    return give(status, [&] {
      return static_cast<LONG>(panel().vfpOp(hardwareId, operation, hostValue(parameter), nullptr));
    });
  }
  HRESULT STDMETHODCALLTYPE vfpSet(LONG hardwareId, short parameterType, short index, VARIANT value,
                                   LONG* status) override {
    return give(status, [&] {
      return static_cast<LONG>(panel().vfpSet(hardwareId, parameterType, index, hostValue(value), nullptr));
    });
  }
  HRESULT STDMETHODCALLTYPE displayData(VARIANT vParameter, VARIANT resultData, LONG* dataPointer,
                                        LONG* dataCount, LONG resultTypeId, LONG resultLength,
                                        LONG* status) override {
    if (dataPointer == nullptr || dataCount == nullptr) return E_POINTER;
    return give(status, [&] {
      const auto decode = [&](std::span<const std::uint8_t> bytes) {
        auto cursor = static_cast<std::int32_t>(*dataPointer);
        auto left = static_cast<std::int32_t>(*dataCount);
        const std::int32_t answer =
            base().displayData(hostValue(vParameter), bytes, cursor, left, resultTypeId, resultLength);
        *dataPointer = cursor;
        *dataCount = left;
        return static_cast<LONG>(answer);
      };
      if (base().closing()) return static_cast<LONG>(kStatusDone);
      return guarded("clsBaseVFP::displayData() ... ", static_cast<LONG>(kStatusUnusableParameter),
                     [&] { return withBytes(resultData, decode); });
    });
  }
  HRESULT STDMETHODCALLTYPE displayParameter(short order, VARIANT newValue, LONG* status) override {
    return give(status,
                [&] { return static_cast<LONG>(base().displayParameter(order, hostValue(newValue))); });
  }
  HRESULT STDMETHODCALLTYPE PopUp_Click(LONG subjectId, LONG buttonId) override {
    return perform([&] { base().PopUp_Click(subjectId, buttonId); });
  }
  HRESULT STDMETHODCALLTYPE closeVfp() override {
    return perform([&] { panel().closeVfp(); });
  }
  HRESULT STDMETHODCALLTYPE refreshControls() override {
    return perform([&] { panel().refreshControls(); });
  }
  HRESULT STDMETHODCALLTYPE refreshMenuItems() override {
    return perform([&] { panel().refreshMenuItems(); });
  }
  HRESULT STDMETHODCALLTYPE activeInContext(LONG /*nContext*/, VARIANT_BOOL* active) override {
    return give(active, [&] {
      return guarded([&] { return panel().typeName() + "::activeInContext()"; }, VARIANT_FALSE,
                     [&] { return variantBool(!base().closing() && panel().ViewVisible()); });
    });
  }
  HRESULT STDMETHODCALLTYPE actionEnabled(short action, VARIANT_BOOL* enabled) override {
    return give(enabled, [&] { return variantBool(base().actionEnabled(action)); });
  }
  HRESULT STDMETHODCALLTYPE measurementInfo(VARIANT* measurementTypes, LONG* status) override {
    if (measurementTypes == nullptr) return E_POINTER;
    return give(status, [&] {
      Variant types;
      const auto answer = static_cast<LONG>(base().measurementInfo(types));
      replaceVariable(*measurementTypes, types);
      return answer;
    });
  }
  HRESULT STDMETHODCALLTYPE activeControlLink(BSTR* name) override {
    return give(name, [&] { return toBstr(base().activeControlLink()); });
  }
  HRESULT STDMETHODCALLTYPE initializeLinkValue(short linkType, LONG genericId, VARIANT* value) override {
    return give(value, [&] { return toAutomation(base().initializeLinkValue(linkType, genericId)); });
  }
  HRESULT STDMETHODCALLTYPE frontPanelLink(short linkType, LONG genericId, VARIANT_BOOL Bold,
                                           VARIANT_BOOL Italic, VARIANT_BOOL enable) override {
    return perform([&] {
      base().frontPanelLink({linkType, static_cast<std::int32_t>(genericId), Bold != VARIANT_FALSE,
                             Italic != VARIANT_FALSE, enable != VARIANT_FALSE});
    });
  }
  HRESULT STDMETHODCALLTYPE reportHtml(BSTR* html) override {
    return give(html, [&] { return toBstr(base().reportHtml()); });
  }
  HRESULT STDMETHODCALLTYPE linkSourceName(BSTR* name) override {
    return give(name, [&] { return toBstr(base().linkSourceName()); });
  }

  // --- What the host reads and writes on the panel
  HRESULT STDMETHODCALLTYPE get_baseInstance(IDispatch** base) override {
    return give(base, [&] {
      baseObject_.AddRef();
      return static_cast<IDispatch*>(&baseObject_);
    });
  }
  HRESULT STDMETHODCALLTYPE Constituent(BSTR name, IDispatch** field) override {
    return give(field, [&] { return constituent(fromBstr(name)); });
  }
  HRESULT STDMETHODCALLTYPE get_displayPanel(IDispatch** field) override {
    return give(field, [&] { return constituent("displayPanel"); });
  }
  HRESULT STDMETHODCALLTYPE get_controlPanel(IDispatch** field) override {
    return give(field, [&] { return constituent("controlPanel"); });
  }
  HRESULT STDMETHODCALLTYPE setDrawingArea() override {
    return perform([&] { base().setDrawingArea(); });
  }
  HRESULT STDMETHODCALLTYPE get_hSplitter(float* position) override {
    return give(position, [&] { return base().hSplitter; });
  }
  HRESULT STDMETHODCALLTYPE put_hSplitter(float position) override {
    return perform([&] { base().hSplitter = position; });
  }
  HRESULT STDMETHODCALLTYPE get_vSplitter(float* position) override {
    return give(position, [&] { return base().vSplitter; });
  }
  HRESULT STDMETHODCALLTYPE put_vSplitter(float position) override {
    return perform([&] { base().vSplitter = position; });
  }
  HRESULT STDMETHODCALLTYPE get_winState(short* state) override { return get_ViewState(state); }
  HRESULT STDMETHODCALLTYPE get_Settings(VARIANT* settings) override {
    return give(settings, [&] { return toAutomation(listOf(base().settings())); });
  }
  HRESULT STDMETHODCALLTYPE get_virtualFrontPanelId(LONG* id) override {
    return give(id, [&] { return static_cast<LONG>(base().virtualFrontPanelId); });
  }
  HRESULT STDMETHODCALLTYPE put_virtualFrontPanelId(LONG id) override {
    return perform([&] { base().virtualFrontPanelId = static_cast<std::int32_t>(id); });
  }
  HRESULT STDMETHODCALLTYPE get_MenuItemChecked(short buttonId, VARIANT_BOOL* itemChecked) override {
    return give(itemChecked, [&] { return variantBool(base().menuItem(buttonId).checked); });
  }
  HRESULT STDMETHODCALLTYPE get_MenuItemEnabled(short buttonId, VARIANT_BOOL* itemEnabled) override {
    return give(itemEnabled, [&] { return variantBool(base().menuItem(buttonId).enabled); });
  }
  HRESULT STDMETHODCALLTYPE get_Caption(BSTR* text) override {
    return give(text, [&] { return toBstr(base().Caption()); });
  }
  HRESULT STDMETHODCALLTYPE put_Caption(BSTR text) override {
    return perform([&] { base().Caption(fromBstr(text)); });
  }
  HRESULT STDMETHODCALLTYPE get_DisplayPanelVisible(VARIANT_BOOL* visible) override {
    return give(visible, [&] { return variantBool(base().rightPanelVisible()); });
  }
  HRESULT STDMETHODCALLTYPE put_DisplayPanelVisible(VARIANT_BOOL visible) override {
    return change(AreaProperty::DisplayPanelVisible, visible);
  }
  HRESULT STDMETHODCALLTYPE get_MeasurementPanelVisible(VARIANT_BOOL* visible) override {
    return give(visible, [&] { return variantBool(base().bottomPanelVisible()); });
  }
  HRESULT STDMETHODCALLTYPE put_MeasurementPanelVisible(VARIANT_BOOL visible) override {
    return change(AreaProperty::MeasurementPanelVisible, visible);
  }
  HRESULT STDMETHODCALLTYPE SavePicture(BSTR path) override {
    return perform([&] {
      MemoryPicture picture;
      this->window().renderGraph(picture);
      writePng(std::wstring(path, SysStringLen(path)), picture);
    });
  }
  HRESULT STDMETHODCALLTYPE Refresh() override {
    return perform([&] {
      paint();
      this->window().refresh();
    });
  }

  // --- Markers
  HRESULT STDMETHODCALLTYPE addMarker() override {
    return perform([&] { panel().addMarker(); });
  }
  HRESULT STDMETHODCALLTYPE addDeltaMarker() override {
    return perform([&] { panel().addDeltaMarker(); });
  }
  HRESULT STDMETHODCALLTYPE deleteMarker() override {
    return perform([&] { panel().deleteMarker(); });
  }
  HRESULT STDMETHODCALLTYPE markerToMax() override {
    return perform([&] { panel().markerToMax(); });
  }
  HRESULT STDMETHODCALLTYPE markerToMin() override {
    return perform([&] { panel().markerToMin(); });
  }

  // --- The surface that the graph is drawn on. The names are the panel's own.
  HRESULT STDMETHODCALLTYPE get_ViewScaleLeft(float* value) override {
    return give(value, [&] { return panel().ViewScaleLeft(); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewScaleTop(float* value) override {
    return give(value, [&] { return panel().ViewScaleTop(); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewScaleWidth(float* value) override {
    return give(value, [&] { return panel().ViewScaleWidth(); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewScaleHeight(float* value) override {
    return give(value, [&] { return panel().ViewScaleHeight(); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewUsableScaleWidth(float* value) override {
    return give(value, [&] { return panel().ViewUseableScaleWidth(); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewUsableScaleHeight(float* value) override {
    return give(value, [&] { return panel().ViewUseableScaleHeight(); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewScaleMode(short* value) override {
    return give(value, [&] { return static_cast<short>(panel().ViewScaleMode()); });
  }
  HRESULT STDMETHODCALLTYPE put_ViewScaleMode(short value) override {
    return perform([&] { panel().ViewScaleMode(value); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewHWnd(LONG* value) override {
    return give(value, [&] { return numberOf(panel().ViewHWnd()); });
  }
  HRESULT STDMETHODCALLTYPE get_hWnd(LONG* value) override { return get_ViewHWnd(value); }
  HRESULT STDMETHODCALLTYPE get_ViewHDC(LONG* value) override {
    return give(value, [&] { return numberOf(panel().ViewHDC()); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewDrawMode(short* value) override {
    return give(value, [&] { return static_cast<short>(panel().ViewDrawMode()); });
  }
  HRESULT STDMETHODCALLTYPE put_ViewDrawMode(short value) override {
    return perform([&] { panel().ViewDrawMode(static_cast<DrawMode>(value)); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewDrawStyle(short* value) override {
    return give(value, [&] { return static_cast<short>(panel().ViewDrawStyle()); });
  }
  HRESULT STDMETHODCALLTYPE put_ViewDrawStyle(short value) override {
    return perform([&] { panel().ViewDrawStyle(static_cast<PenStyle>(value)); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewDrawWidth(short* value) override {
    return give(value, [&] { return panel().ViewDrawWidth(); });
  }
  HRESULT STDMETHODCALLTYPE put_ViewDrawWidth(short value) override {
    return perform([&] { panel().ViewDrawWidth(value); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewFillStyle(short* value) override {
    return give(value, [&] { return panel().ViewFillStyle(); });
  }
  HRESULT STDMETHODCALLTYPE put_ViewFillStyle(short value) override {
    return perform([&] { panel().ViewFillStyle(value); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewFontTransparent(VARIANT_BOOL* value) override {
    return give(value, [&] { return variantBool(panel().ViewFontTransparent()); });
  }
  HRESULT STDMETHODCALLTYPE put_ViewFontTransparent(VARIANT_BOOL value) override {
    return perform([&] { panel().ViewFontTransparent(value != VARIANT_FALSE); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewForeColor(LONG* value) override {
    return give(value, [&] { return static_cast<LONG>(panel().ViewForeColor().bgr); });
  }
  HRESULT STDMETHODCALLTYPE put_ViewForeColor(LONG value) override {
    return perform([&] { panel().ViewForeColor(colorOf(value)); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewCurrentX(float* value) override {
    return give(value, [&] { return panel().ViewCurrentX(); });
  }
  HRESULT STDMETHODCALLTYPE put_ViewCurrentX(float value) override {
    return perform([&] { panel().ViewCurrentX(value); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewCurrentY(float* value) override {
    return give(value, [&] { return panel().ViewCurrentY(); });
  }
  HRESULT STDMETHODCALLTYPE put_ViewCurrentY(float value) override {
    return perform([&] { panel().ViewCurrentY(value); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewWidth(float* value) override {
    return give(value, [&] { return panel().ViewWidth(); });
  }
  HRESULT STDMETHODCALLTYPE put_ViewWidth(float value) override {
    return perform([&] { panel().ViewWidth(value); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewHeight(float* value) override {
    return give(value, [&] { return panel().ViewHeight(); });
  }
  HRESULT STDMETHODCALLTYPE put_ViewHeight(float value) override {
    return perform([&] { panel().ViewHeight(value); });
  }
  HRESULT STDMETHODCALLTYPE get_InvisibleWidthMarkX1(float* value) override {
    return give(value, [&] { return panel().InvisibleWidthMarkX1(); });
  }
  HRESULT STDMETHODCALLTYPE put_InvisibleWidthMarkX1(float value) override {
    return perform([&] { panel().InvisibleWidthMarkX1(value); });
  }
  HRESULT STDMETHODCALLTYPE get_InvisibleHeightMarkY1(float* value) override {
    return give(value, [&] { return panel().InvisibleHeightMarkY1(); });
  }
  HRESULT STDMETHODCALLTYPE put_InvisibleHeightMarkY1(float value) override {
    return perform([&] { panel().InvisibleHeightMarkY1(value); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewMousePointer(short* value) override {
    return give(value, [&] { return static_cast<short>(panel().ViewMousePointer()); });
  }
  HRESULT STDMETHODCALLTYPE put_ViewMousePointer(short value) override {
    return perform([&] { panel().ViewMousePointer(static_cast<MousePointer>(value)); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewState(short* value) override {
    return give(value, [&] { return panel().winState(); });
  }
  HRESULT STDMETHODCALLTYPE put_ViewState(short value) override {
    return perform([&] { panel().ViewState(value); });
  }
  HRESULT STDMETHODCALLTYPE get_ViewVisible(VARIANT_BOOL* value) override {
    return give(value, [&] { return variantBool(panel().ViewVisible()); });
  }
  HRESULT STDMETHODCALLTYPE put_ViewVisible(VARIANT_BOOL value) override {
    return perform([&] { panel().ViewVisible(value != VARIANT_FALSE); });
  }
  HRESULT STDMETHODCALLTYPE ViewRefresh() override {
    return perform([&] { panel().ViewRefresh(); });
  }

  // --- PanelEvents
  void paint() override { base().Paint(); }
  Rect paintedAreaPx() override {
    const PanelArea& area = base().traceManager().drawingAreaPx();
    const std::int32_t left = toInt32(area.left);
    const std::int32_t top = toInt32(area.top);
    return {left, top, left + toInt32(area.width), top + toInt32(area.height)};
  }
  DcHandle surface() override { return base().traceManager().shadowDC(); }
  Size graphSizePx() override {
    const Size view = this->window().clientSizePx();
    return {graphLengthPx(panel().InvisibleWidthMarkX1(), panel().ViewScaleWidth(), view.width),
            graphLengthPx(panel().InvisibleHeightMarkY1(), panel().ViewScaleHeight(), view.height)};
  }
  void resized() override { panel().Form_Resize(); }
  void rescaled(ScreenMetrics metrics) override { panel().rescale(metrics); }
  void mouseDown(const MouseEvent& e) override { base().MouseDown(e.button, e.shift, e.xTwips, e.yTwips); }
  void mouseMove(const MouseEvent& e) override { base().MouseMove(e.button, e.shift, e.xTwips, e.yTwips); }
  void mouseUp(const MouseEvent& e) override { base().MouseUp(e.button, e.shift, e.xTwips, e.yTwips); }
  bool usesKey(std::int16_t keyCode, std::int16_t shift) override { return base().usesKey(keyCode, shift); }
  bool keyDown(std::int16_t keyCode, std::int16_t shift) override { return base().KeyDown(keyCode, shift); }
  std::vector<PanelMenuItem> contextMenu() override { return panel().contextMenu(); }
  void contextMenuClick(std::int16_t id) override { panel().contextMenuClick(id); }

  GraphItems graphItems() override { return base().traceManager().graphItems(); }
  GraphState graphState() override { return base().traceManager().graphState(); }
  std::string title() override {
    return base().Caption().empty() ? toUtf8(this->controlClass().userTypeName) : base().Caption();
  }

  // Whoever has shown or hidden an area: host, menu or user.
  void settled() override {
    const bool now[] = {base().rightPanelVisible(), base().bottomPanelVisible()};
    for (std::size_t area = 0; area < std::size(now); ++area)
      if (std::exchange(storedAreas_[area], now[area]) != now[area]) propertyChanged(kStoredAreaIds[area]);
  }

  void focusChanged(bool focused) override {
    Dispatching<DualControl<Dual>, Dual>::focusChanged(focused);
    if (focused) base().Activate();
  }

  // --- PanelContainer: a container that keeps no such property is asked for another place; of what no
  // container keeps, the panel's own state remains.
  void caption(std::string_view text) override {
    this->window().caption(toUtf16(text));
    this->putExtended(L"Caption", std::string(text));
    this->window().voice().captioned();
  }
  void visible(bool visible) override { this->putExtended(L"Visible", visible); }
  void viewState(std::int16_t state) override { this->putExtended(L"ViewState", state); }
  void left(float twips) override {
    const LONG px = lengthPx(twips, panel().metrics().twipsPerPixelX);
    place(L"Left", twips, [px](RECT& place) { OffsetRect(&place, px - place.left, 0); });
  }
  void top(float twips) override {
    const LONG px = lengthPx(twips, panel().metrics().twipsPerPixelY);
    place(L"Top", twips, [px](RECT& place) { OffsetRect(&place, 0, px - place.top); });
  }
  void width(float twips) override {
    const LONG px = lengthPx(twips, panel().metrics().twipsPerPixelX);
    place(L"Width", twips, [px](RECT& place) { place.right = place.left + px; });
  }
  void height(float twips) override {
    const LONG px = lengthPx(twips, panel().metrics().twipsPerPixelY);
    place(L"Height", twips, [px](RECT& place) { place.bottom = place.top + px; });
  }
  std::vector<std::uint8_t> picturePng() override {
    MemoryPicture picture;
    this->window().renderGraph(picture);
    return encodePng(picture);
  }

  // --- Stored properties
  std::span<const StoredProperty> storedProperties() const override { return kStoredAreas; }
  Variant storedValue(std::size_t property) const override {
    const clsBaseVFP& common = const_cast<FrontPanelControl&>(*this).base();
    return static_cast<AreaProperty>(property) == AreaProperty::DisplayPanelVisible
               ? common.rightPanelVisible()
               : common.bottomPanelVisible();
  }
  void storedValue(std::size_t property, const Variant& value) override {
    storedAreas_[property] = value.toBoolean();
    if (static_cast<AreaProperty>(property) == AreaProperty::DisplayPanelVisible)
      base().rightPanelVisible(value.toBoolean());
    else
      base().bottomPanelVisible(value.toBoolean());
  }

 protected:
  [[nodiscard]] Panel& panel() noexcept { return panel_; }
  [[nodiscard]] const Panel& panel() const noexcept { return panel_; }
  [[nodiscard]] clsBaseVFP& base() { return panel_.base(); }

  // A call that hands a value out, through a pointer that a caller may have left null. The host may let go of
  // the control inside.
  template <class T, class Body>
  HRESULT give(T* result, Body body) {
    if (result == nullptr) return E_POINTER;
    std::memset(result, 0, sizeof(T));
    return perform([&] { *result = body(); });
  }
  template <class Body>
  HRESULT perform(Body body) {
    const ComPointer<IUnknown> alive(this->outer());
    const HRESULT done = barrier(__uuidof(Dual), body);
    barrier([&] { settled(); });
    return done;
  }
  // A stored property has another value: the form is to be saved, and whoever watches the property is told.
  void propertyChanged(DISPID id) {
    this->dirty(true);
    this->connections().notifyChanged(id);
  }

 private:
  [[nodiscard]] void* findInterface(REFIID id) noexcept override {
    if (id == __uuidof(Dual) || id == IID_IDispatch) return static_cast<Dual*>(this);
    return this->findPart(id);
  }

  [[nodiscard]] PanelEnvironment environment() {
    Services& shared = services();
    return {shared.gdi, shared.windowing,    this->window(),
            shared.hub, readScreenMetrics(), toUtf8(GetCommandLineW())};
  }

  // The base as an object that lives with the control.
  class BaseInstance final : public BaseObject {
   public:
    explicit BaseInstance(FrontPanelControl& control) noexcept : control_(control) {}
    ULONG STDMETHODCALLTYPE AddRef() override { return control_.outer()->AddRef(); }
    ULONG STDMETHODCALLTYPE Release() override { return control_.outer()->Release(); }

   private:
    clsBaseVFP& self() override { return control_.base(); }
    FrontPanelControl& control_;
  };

  // From the surface's scale to pixels of the view; at least one, as there is no picture without a pixel.
  static std::int32_t graphLengthPx(float mark, float scaleLength, std::int32_t viewPx) {
    const float share = scaleLength > 0 ? mark / scaleLength : 1.0F;
    return std::clamp(toInt32(share * static_cast<float>(viewPx)), 1, viewPx);
  }

  static LONG lengthPx(float twips, float twipsPerPixel) { return toInt32(twips / twipsPerPixel); }

  // Where the container has no such property of the control's place, it may take a wish for the whole place.
  template <class Change>
  void place(const wchar_t* name, float twips, Change change) {
    if (this->putExtended(name, twips)) return;
    RECT wanted = this->placePx();
    const Size size = this->window().clientSizePx();
    wanted.right = wanted.left + size.width;
    wanted.bottom = wanted.top + size.height;
    change(wanted);
    this->requestPlace(wanted);
  }

  // With the sign bit set, the low bits name a colour of the system.
  static Color colorOf(LONG value) noexcept {
    if (value < 0) return {static_cast<std::uint32_t>(GetSysColor(static_cast<int>(value & 0xFF)))};
    return {static_cast<std::uint32_t>(value) & 0xFFFFFFU};
  }

  IDispatch* constituent(std::string_view name) {
    return new ConstituentObject(this->outer(), panel().controls()->control(name));
  }

  HRESULT change(AreaProperty property, VARIANT_BOOL value) {
    return perform([&] {
      if (property == AreaProperty::DisplayPanelVisible)
        base().rightPanelVisible(value != VARIANT_FALSE);
      else
        base().bottomPanelVisible(value != VARIANT_FALSE);
    });
  }

  PanelRequests requests_;
  BaseInstance baseObject_;
  Panel panel_;
  bool storedAreas_[2] = {true, true};  // as the container knows them
};

}  // namespace frontpanels::activex

// IOleInPlaceObject and IOleInPlaceActiveObject: the control as a live window in the container.
#pragma once

#include "activex/control_core.h"
#include "activex/message_boxes.h"

namespace frontpanels::activex {

class InPlacePart final : public ControlPart<IOleInPlaceObject, IOleInPlaceActiveObject>, private BoxOwner {
 public:
  using ControlPart::ControlPart;
  ~InPlacePart() override { removeBoxOwner(*this); }

  // Makes the control a child window of the container; takes neither focus nor frame. Does nothing when it is
  // one, but shows it again. Raises ComFailure.
  void activate(HWND parent, const RECT* place);
  // Takes the focus and tells frame and document that this is the active object. Needs to be active.
  void activateUi();
  void hide();
  // Twice does no harm.
  void deactivate();
  // The window went away by itself, with the container's.
  void windowLost() noexcept;
  [[nodiscard]] bool active() const noexcept { return active_; }
  // The container is asked; it answers with SetObjectRects, or not at all.
  void requestPlace(const RECT& place);

  // IOleWindow
  HRESULT STDMETHODCALLTYPE GetWindow(HWND* window) override;
  HRESULT STDMETHODCALLTYPE ContextSensitiveHelp(BOOL) override { return E_NOTIMPL; }
  // IOleInPlaceObject
  HRESULT STDMETHODCALLTYPE InPlaceDeactivate() override;
  HRESULT STDMETHODCALLTYPE UIDeactivate() override;
  HRESULT STDMETHODCALLTYPE SetObjectRects(LPCRECT place, LPCRECT clip) override;
  HRESULT STDMETHODCALLTYPE ReactivateAndUndo() override { return E_NOTIMPL; }
  // IOleInPlaceActiveObject
  HRESULT STDMETHODCALLTYPE TranslateAccelerator(LPMSG message) override;
  HRESULT STDMETHODCALLTYPE OnFrameWindowActivate(BOOL) override { return S_OK; }
  HRESULT STDMETHODCALLTYPE OnDocWindowActivate(BOOL) override { return S_OK; }
  HRESULT STDMETHODCALLTYPE ResizeBorder(LPCRECT, IOleInPlaceUIWindow*, BOOL) override { return S_OK; }
  HRESULT STDMETHODCALLTYPE EnableModeless(BOOL) override { return S_OK; }

 private:
  void enterSite(HWND parent, const RECT* place);
  void takePlace(const RECT& place, const RECT* clip);
  void deactivateUi();
  void nameActiveObject(IOleInPlaceActiveObject* object);
  void enableHost(bool enable) noexcept override;

  ComPointer<IOleInPlaceSite> inPlaceSite_;
  ComPointer<IOleInPlaceFrame> frame_;
  ComPointer<IOleInPlaceUIWindow> document_;
  bool active_ = false;
  bool uiActive_ = false;
};

}  // namespace frontpanels::activex

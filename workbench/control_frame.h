// The in-place frame: the program's window as an active control sees it. Panels bring no menus and no tool
// bars, so the window of their own in it need not be known as a document's.
#pragma once

#include <oleidl.h>

#include "workbench/com_object.h"
#include "workbench/control_owner.h"

namespace frontpanels::workbench {

class ControlFrame final : public ComObject<IOleInPlaceFrame> {
 public:
  explicit ControlFrame(ControlOwner& owner) : owner_(&owner) {}
  void detach() noexcept { owner_ = nullptr; }

  // IOleWindow
  HRESULT STDMETHODCALLTYPE GetWindow(HWND* window) override;
  HRESULT STDMETHODCALLTYPE ContextSensitiveHelp(BOOL) override { return E_NOTIMPL; }
  // IOleInPlaceUIWindow
  HRESULT STDMETHODCALLTYPE GetBorder(LPRECT) override { return INPLACE_E_NOTOOLSPACE; }
  HRESULT STDMETHODCALLTYPE RequestBorderSpace(LPCBORDERWIDTHS) override { return INPLACE_E_NOTOOLSPACE; }
  HRESULT STDMETHODCALLTYPE SetBorderSpace(LPCBORDERWIDTHS widths) override;
  HRESULT STDMETHODCALLTYPE SetActiveObject(IOleInPlaceActiveObject* object, LPCOLESTR name) override;
  // IOleInPlaceFrame
  HRESULT STDMETHODCALLTYPE InsertMenus(HMENU, LPOLEMENUGROUPWIDTHS) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE SetMenu(HMENU, HOLEMENU, HWND) override { return S_OK; }
  HRESULT STDMETHODCALLTYPE RemoveMenus(HMENU) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE SetStatusText(LPCOLESTR text) override;
  HRESULT STDMETHODCALLTYPE EnableModeless(BOOL enable) override;
  HRESULT STDMETHODCALLTYPE TranslateAccelerator(LPMSG message, WORD command) override;

 private:
  ~ControlFrame() override = default;
  [[nodiscard]] void* findInterface(REFIID id) noexcept override;

  ControlOwner* owner_;
};

}  // namespace frontpanels::workbench

#include "workbench/control_frame.h"

#include "workbench/failure.h"

namespace frontpanels::workbench {

void* ControlFrame::findInterface(REFIID id) noexcept {
  const bool known = id == IID_IUnknown || id == IID_IOleWindow || id == IID_IOleInPlaceUIWindow ||
                     id == IID_IOleInPlaceFrame;
  return known ? static_cast<IOleInPlaceFrame*>(this) : nullptr;
}

HRESULT ControlFrame::GetWindow(HWND* window) {
  return comBarrier([&]() -> HRESULT {
    if (window == nullptr) return E_POINTER;
    if (owner_ == nullptr) return E_UNEXPECTED;
    *window = owner_->place().frameWindow();
    return S_OK;
  });
}

HRESULT ControlFrame::SetBorderSpace(LPCBORDERWIDTHS widths) {
  // No widths: the control wants no room beside the program's own bars.
  return widths == nullptr ? S_OK : INPLACE_E_NOTOOLSPACE;
}

HRESULT ControlFrame::SetActiveObject(IOleInPlaceActiveObject* object, LPCOLESTR) {
  return comBarrier([&]() -> HRESULT {
    if (owner_ == nullptr) return E_UNEXPECTED;
    owner_->activeObject(object);
    return S_OK;
  });
}

HRESULT ControlFrame::SetStatusText(LPCOLESTR text) {
  return comBarrier([&]() -> HRESULT {
    if (owner_ == nullptr) return E_UNEXPECTED;
    owner_->place().statusText(text == nullptr ? L"" : text);
    return S_OK;
  });
}

HRESULT ControlFrame::EnableModeless(BOOL) {
  // The only modeless window is the one that the control's box disables by itself.
  return S_OK;
}

HRESULT ControlFrame::TranslateAccelerator(LPMSG message, WORD) {
  return comBarrier([&]() -> HRESULT {
    if (message == nullptr) return E_POINTER;
    if (owner_ == nullptr) return S_FALSE;
    return owner_->place().translateAccelerator(*message) ? S_OK : S_FALSE;
  });
}

}  // namespace frontpanels::workbench

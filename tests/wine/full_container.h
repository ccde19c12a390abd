// A container that has all that containers may have: ambient properties, an extender, a frame that hears
// about the active object, sinks that answer. It keeps a list of what it is told.
#pragma once

#include <windows.h>

#include <ocidl.h>
#include <olectl.h>

#include <functional>
#include <map>
#include <string>
#include <vector>

#include "tests/wine/com_client.h"

namespace frontpanels::testing {

// Objects of the container live as locals of a check: what remains of their count is looked at.
template <class... Interfaces>
class Counted : public Interfaces... {
 public:
  HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override {
    *object = find(id);
    if (*object == nullptr) return E_NOINTERFACE;
    AddRef();
    return S_OK;
  }
  ULONG STDMETHODCALLTYPE AddRef() override { return ++references; }
  ULONG STDMETHODCALLTYPE Release() override { return --references; }
  ULONG references = 1;

 protected:
  [[nodiscard]] virtual void* find(REFIID id) = 0;
};

// Calls by number that arrive here.
class Listener : public Counted<IDispatch> {
 public:
  HRESULT STDMETHODCALLTYPE GetTypeInfoCount(UINT*) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE GetTypeInfo(UINT, LCID, ITypeInfo**) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE GetIDsOfNames(REFIID, LPOLESTR*, UINT, LCID, DISPID*) override {
    return DISP_E_UNKNOWNNAME;
  }

 protected:
  void* find(REFIID id) override { return id == IID_IUnknown || id == IID_IDispatch ? this : nullptr; }
};

class ChangeSink final : public Counted<IPropertyNotifySink> {
 public:
  std::vector<DISPID> changed;
  HRESULT STDMETHODCALLTYPE OnChanged(DISPID property) override { return changed.push_back(property), S_OK; }
  HRESULT STDMETHODCALLTYPE OnRequestEdit(DISPID) override { return S_OK; }

 protected:
  void* find(REFIID id) override {
    return id == IID_IUnknown || id == IID_IPropertyNotifySink ? this : nullptr;
  }
};

using Lines = std::vector<std::wstring>;

// Notes any event: its number, then the arguments as texts, none for an empty one, the status as it came in.
class EventSink final : public Listener {
 public:
  Lines received;
  std::function<void()> during = [] {};  // in the middle of the event
  HRESULT answer = S_OK;                 // DISP_E_MEMBERNOTFOUND: no handler
  LONG status = 0;                       // what is written into the status

  HRESULT STDMETHODCALLTYPE Invoke(DISPID member, REFIID, LCID, WORD, DISPPARAMS* parameters, VARIANT*,
                                   EXCEPINFO*, UINT*) override {
    if (answer != S_OK) return answer;
    VARIANT* const arguments = parameters->rgvarg;  // the last comes first
    if (V_VT(&arguments[0]) != (VT_BYREF | VT_I4)) return DISP_E_TYPEMISMATCH;
    std::wstring line = std::to_wstring(member);
    for (UINT i = parameters->cArgs; i > 0; --i) {
      Value text;
      const bool plain = SUCCEEDED(VariantChangeType(text.get(), &arguments[i - 1], 0, VT_BSTR));
      line += L" " + (plain ? text.text() : std::wstring(L"?"));
    }
    received.push_back(line);
    *V_I4REF(&arguments[0]) = status;
    during();
    return S_OK;
  }
};

// Knows texts only, as a page does.
class TextBag final : public Counted<IPropertyBag> {
 public:
  std::map<std::wstring, std::wstring> texts;
  HRESULT STDMETHODCALLTYPE Read(LPCOLESTR name, VARIANT* value, IErrorLog*) override {
    if (texts.count(name) == 0) return E_INVALIDARG;
    V_VT(value) = VT_BSTR;
    V_BSTR(value) = SysAllocString(texts[name].c_str());
    return S_OK;
  }
  HRESULT STDMETHODCALLTYPE Write(LPCOLESTR name, VARIANT* value) override {
    Value text;
    VariantChangeType(text.get(), value, VARIANT_ALPHABOOL, VT_BSTR);
    texts[name] = text.text();
    return S_OK;
  }

 protected:
  void* find(REFIID id) override { return id == IID_IUnknown || id == IID_IPropertyBag ? this : nullptr; }
};

class ErrorLog final : public Counted<IErrorLog> {
 public:
  Lines names;
  HRESULT STDMETHODCALLTYPE AddError(LPCOLESTR name, EXCEPINFO*) override {
    return names.push_back(name), S_OK;
  }

 protected:
  void* find(REFIID id) override { return id == IID_IUnknown || id == IID_IErrorLog ? this : nullptr; }
};

// Caption, Visible and ViewState of the place that a control stands on.
class PlaceProperties final : public Listener {
 public:
  std::vector<std::wstring> told;  // "Caption=text"
  HRESULT STDMETHODCALLTYPE GetIDsOfNames(REFIID, LPOLESTR* names, UINT, LCID, DISPID* ids) override;
  HRESULT STDMETHODCALLTYPE Invoke(DISPID member, REFIID, LCID, WORD flags, DISPPARAMS* parameters, VARIANT*,
                                   EXCEPINFO*, UINT*) override;
};

class FullContainer
    : public Counted<IOleClientSite, IOleInPlaceSite, IOleControlSite, IOleInPlaceFrame, IDispatch> {
 public:
  explicit FullContainer(HWND window) : window_(window) {}
  void stand(HWND window) { window_ = window; }

  std::vector<std::string> told;
  bool userMode = true;
  IDispatch* font = nullptr;  // ambient
  IDispatch* extender = nullptr;
  RECT place{10, 20, 410, 320};
  RECT wanted{};  // the place that the control last asked for
  [[nodiscard]] int count(const std::string& what) const;

  // IOleClientSite
  HRESULT STDMETHODCALLTYPE SaveObject() override { return hear("SaveObject"); }
  HRESULT STDMETHODCALLTYPE GetMoniker(DWORD, DWORD, IMoniker**) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE GetContainer(IOleContainer** container) override {
    return *container = nullptr, E_NOTIMPL;
  }
  HRESULT STDMETHODCALLTYPE ShowObject() override { return hear("ShowObject"); }
  HRESULT STDMETHODCALLTYPE OnShowWindow(BOOL) override { return S_OK; }
  HRESULT STDMETHODCALLTYPE RequestNewObjectLayout() override { return E_NOTIMPL; }
  // IOleWindow, IOleInPlaceSite
  HRESULT STDMETHODCALLTYPE GetWindow(HWND* window) override { return *window = window_, S_OK; }
  HRESULT STDMETHODCALLTYPE ContextSensitiveHelp(BOOL) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE CanInPlaceActivate() override { return S_OK; }
  HRESULT STDMETHODCALLTYPE OnInPlaceActivate() override { return hear("OnInPlaceActivate"); }
  HRESULT STDMETHODCALLTYPE OnUIActivate() override { return hear("OnUIActivate"); }
  HRESULT STDMETHODCALLTYPE GetWindowContext(IOleInPlaceFrame** frame, IOleInPlaceUIWindow** document,
                                             LPRECT area, LPRECT clip, LPOLEINPLACEFRAMEINFO info) override;
  HRESULT STDMETHODCALLTYPE Scroll(SIZE) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE OnUIDeactivate(BOOL) override { return hear("OnUIDeactivate"); }
  HRESULT STDMETHODCALLTYPE OnInPlaceDeactivate() override { return hear("OnInPlaceDeactivate"); }
  HRESULT STDMETHODCALLTYPE DiscardUndoState() override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE DeactivateAndUndo() override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE OnPosRectChange(LPCRECT rect) override {
    return wanted = *rect, hear("OnPosRectChange");
  }
  // IOleControlSite
  HRESULT STDMETHODCALLTYPE OnControlInfoChanged() override { return hear("OnControlInfoChanged"); }
  HRESULT STDMETHODCALLTYPE LockInPlaceActive(BOOL) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE GetExtendedControl(IDispatch** extended) override;
  HRESULT STDMETHODCALLTYPE TransformCoords(POINTL*, POINTF*, DWORD) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE TranslateAccelerator(MSG*, DWORD) override {
    return hear("TranslateAccelerator");
  }
  HRESULT STDMETHODCALLTYPE OnFocus(BOOL focus) override { return hear(focus ? "OnFocus" : "OnFocus(off)"); }
  HRESULT STDMETHODCALLTYPE ShowPropertyFrame() override { return E_NOTIMPL; }
  // IOleInPlaceFrame
  HRESULT STDMETHODCALLTYPE GetBorder(LPRECT) override { return INPLACE_E_NOTOOLSPACE; }
  HRESULT STDMETHODCALLTYPE RequestBorderSpace(LPCBORDERWIDTHS) override { return INPLACE_E_NOTOOLSPACE; }
  HRESULT STDMETHODCALLTYPE SetBorderSpace(LPCBORDERWIDTHS widths) override {
    return hear(widths == nullptr ? "SetBorderSpace(none)" : "SetBorderSpace");
  }
  HRESULT STDMETHODCALLTYPE SetActiveObject(IOleInPlaceActiveObject* object, LPCOLESTR) override {
    return hear(object != nullptr ? "SetActiveObject" : "SetActiveObject(none)");
  }
  HRESULT STDMETHODCALLTYPE InsertMenus(HMENU, LPOLEMENUGROUPWIDTHS) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE SetMenu(HMENU, HOLEMENU, HWND) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE RemoveMenus(HMENU) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE SetStatusText(LPCOLESTR) override { return S_OK; }
  HRESULT STDMETHODCALLTYPE EnableModeless(BOOL enable) override {
    return hear(enable ? "EnableModeless" : "EnableModeless(off)");
  }
  HRESULT STDMETHODCALLTYPE TranslateAccelerator(LPMSG, WORD) override { return E_NOTIMPL; }
  // IDispatch: ambient properties
  HRESULT STDMETHODCALLTYPE GetTypeInfoCount(UINT*) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE GetTypeInfo(UINT, LCID, ITypeInfo**) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE GetIDsOfNames(REFIID, LPOLESTR*, UINT, LCID, DISPID*) override {
    return E_NOTIMPL;
  }
  HRESULT STDMETHODCALLTYPE Invoke(DISPID member, REFIID, LCID, WORD, DISPPARAMS*, VARIANT* result,
                                   EXCEPINFO*, UINT*) override;

 protected:
  void* find(REFIID id) override;

 private:
  HRESULT hear(const char* what) { return told.emplace_back(what), S_OK; }

  HWND window_;
};

// A control and its host's side. Closed at the end at the latest.
struct Hosted {
  ComPointer<IOleObject> object;
  ComPointer<IDispatch> members;
  ComPointer<IOleInPlaceObject> inPlace;

  explicit Hosted(const std::wstring& progId = panelClass());
  ~Hosted() { close(); }
  Hosted(const Hosted&) = delete;
  Hosted& operator=(const Hosted&) = delete;

  HRESULT verb(LONG verb);
  Value call(const wchar_t* name, std::initializer_list<Value> arguments = {}) const {
    return testing::call(*members.get(), name, arguments);
  }
  // To its events, for the rest of its life: the sink must live longer.
  void advise(IUnknown& sink) const;
  [[nodiscard]] HWND window() const;
  void release();
  void close();
};

struct Site {
  FullContainer container;
};

// A control and its container.
struct Sited : Site, Hosted {
  explicit Sited(HWND window) : Site{FullContainer(window)} { object->SetClientSite(&container); }
  Sited(HWND window, LONG firstVerb) : Sited(window) { verb(firstVerb); }
};

// A connection to one of a control's outgoing interfaces.
[[nodiscard]] ComPointer<IConnectionPoint> pointOf(IDispatch& control, const IID& id);
[[nodiscard]] IID eventsOf(IDispatch& control);

}  // namespace frontpanels::testing

// A whole host in one file: a window with a SpectrumView in it, a receiver that is made up, and the answers
// that a panel wants. Build:  x86_64-w64-mingw32-g++ -std=c++20 -municode -static container.cpp -o
// container.exe -lole32 -loleaut32 -luuid
//         or: cl /std:c++20 /EHsc container.cpp ole32.lib oleaut32.lib user32.lib
// Start:  regsvr32 frontpanels.ocx, then  container.exe  (with a number: that many sweeps, then it ends by
// itself)
#ifndef UNICODE
#define UNICODE
#endif
#include <windows.h>

#include <ocidl.h>
#include <olectl.h>

#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cwchar>
#include <initializer_list>
#include <vector>

namespace {

constexpr wchar_t kSpectrumPath[] = L"Brantor Scanner/Spectrum/Spectrum Trace";
constexpr SHORT kCenterHz = 13;
constexpr SHORT kSpanHz = 14;
constexpr SHORT kClose = 1;
constexpr UINT_PTR kSweepTimer = 1;

// --- Late binding, as every host has it

DISPID idOf(IDispatch& object, const wchar_t* name) {
  DISPID id = DISPID_UNKNOWN;
  auto* text = const_cast<LPOLESTR>(name);
  object.GetIDsOfNames(IID_NULL, &text, 1, LOCALE_USER_DEFAULT, &id);
  return id;
}

// Arguments in the order of the declaration; they stay the caller's.
HRESULT invoke(IDispatch& object, const wchar_t* name, std::initializer_list<VARIANT> arguments) {
  std::vector<VARIANT> reversed(std::rbegin(arguments), std::rend(arguments));
  DISPPARAMS parameters{reversed.data(), nullptr, static_cast<UINT>(reversed.size()), 0};
  return object.Invoke(idOf(object, name), IID_NULL, LOCALE_USER_DEFAULT, DISPATCH_METHOD, &parameters,
                       nullptr, nullptr, nullptr);
}

VARIANT number(double value) {
  VARIANT variant{};
  variant.vt = VT_R8;
  variant.dblVal = value;
  return variant;
}

// --- The receiver: noise, and a carrier at 881.52 MHz

struct Receiver {
  double centerHz = 881.52e6;
  double spanHz = 5e6;
  IDispatch* hub = nullptr;

  void sweep() const {
    constexpr ULONG kPoints = 513;
    SAFEARRAY* const levels = SafeArrayCreateVector(VT_R4, 0, kPoints);
    float* dbm = nullptr;
    SafeArrayAccessData(levels, reinterpret_cast<void**>(&dbm));
    for (ULONG i = 0; i < kPoints; ++i) {
      const double hz = centerHz + spanHz * (static_cast<double>(i) / (kPoints - 1) - 0.5);
      const double offset = (hz - 881.52e6) / 60e3;
      dbm[i] = static_cast<float>(-105 + 2.0 * std::rand() / RAND_MAX + 50 * std::exp(-offset * offset));
    }
    SafeArrayUnaccessData(levels);
    VARIANT path{};
    path.vt = VT_BSTR;
    path.bstrVal = SysAllocString(kSpectrumPath);
    VARIANT values{};
    values.vt = VT_ARRAY | VT_R4;
    values.parray = levels;
    invoke(*hub, L"Publish", {path, values});
    VariantClear(&path);
    VariantClear(&values);
  }
};

// --- The container: a site, the frame round it, and a sink for the panel's requests

class Host final : public IOleClientSite, public IOleInPlaceSite, public IOleInPlaceFrame, public IDispatch {
 public:
  Host(HWND window, Receiver& receiver) : window_(window), receiver_(receiver) {}

  bool open(const CLSID& panelClass) {
    if (FAILED(CoCreateInstance(panelClass, nullptr, CLSCTX_INPROC_SERVER, IID_IOleObject,
                                reinterpret_cast<void**>(&object_))))
      return false;
    object_->QueryInterface(IID_IDispatch, reinterpret_cast<void**>(&panel_));
    object_->SetClientSite(this);
    connect(true);
    object_->DoVerb(OLEIVERB_INPLACEACTIVATE, nullptr, this, 0, window_, nullptr);
    tell(kCenterHz, receiver_.centerHz);
    tell(kSpanHz, receiver_.spanHz);
    return true;
  }

  void close() {
    if (object_ == nullptr) return;
    connect(false);
    object_->Close(OLECLOSE_NOSAVE);
    object_->SetClientSite(nullptr);
    panel_->Release();
    object_->Release();
    object_ = nullptr;
    panel_ = nullptr;
  }

  void resized() {
    IOleInPlaceObject* inPlace = nullptr;
    if (object_ == nullptr ||
        FAILED(object_->QueryInterface(IID_IOleInPlaceObject, reinterpret_cast<void**>(&inPlace))))
      return;
    const RECT all = area();
    inPlace->SetObjectRects(&all, &all);
    inPlace->Release();
  }

  // Keys go to the active panel first.
  bool translated(MSG& message) {
    return active_ != nullptr && active_->TranslateAccelerator(&message) == S_OK;
  }

  // IUnknown; the host lives as long as main does.
  HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override {
    *object = nullptr;
    if (id == IID_IUnknown || id == IID_IOleClientSite) *object = static_cast<IOleClientSite*>(this);
    if (id == IID_IOleWindow || id == IID_IOleInPlaceSite) *object = static_cast<IOleInPlaceSite*>(this);
    if (id == IID_IOleInPlaceUIWindow || id == IID_IOleInPlaceFrame)
      *object = static_cast<IOleInPlaceFrame*>(this);
    if (id == IID_IDispatch || id == events_) *object = static_cast<IDispatch*>(this);
    return *object != nullptr ? S_OK : E_NOINTERFACE;
  }
  ULONG STDMETHODCALLTYPE AddRef() override { return 1; }
  ULONG STDMETHODCALLTYPE Release() override { return 1; }

  // IOleClientSite
  HRESULT STDMETHODCALLTYPE SaveObject() override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE GetMoniker(DWORD, DWORD, IMoniker**) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE GetContainer(IOleContainer** container) override {
    return *container = nullptr, E_NOINTERFACE;
  }
  HRESULT STDMETHODCALLTYPE ShowObject() override { return S_OK; }
  HRESULT STDMETHODCALLTYPE OnShowWindow(BOOL) override { return S_OK; }
  HRESULT STDMETHODCALLTYPE RequestNewObjectLayout() override { return E_NOTIMPL; }

  // IOleWindow, of site and frame alike
  HRESULT STDMETHODCALLTYPE GetWindow(HWND* window) override { return *window = window_, S_OK; }
  HRESULT STDMETHODCALLTYPE ContextSensitiveHelp(BOOL) override { return E_NOTIMPL; }

  // IOleInPlaceSite
  HRESULT STDMETHODCALLTYPE CanInPlaceActivate() override { return S_OK; }
  HRESULT STDMETHODCALLTYPE OnInPlaceActivate() override { return S_OK; }
  HRESULT STDMETHODCALLTYPE OnUIActivate() override { return S_OK; }
  HRESULT STDMETHODCALLTYPE GetWindowContext(IOleInPlaceFrame** frame, IOleInPlaceUIWindow** document,
                                             LPRECT place, LPRECT clip, LPOLEINPLACEFRAMEINFO info) override {
    *frame = this;
    *document = nullptr;
    *place = *clip = area();
    info->fMDIApp = FALSE;
    info->hwndFrame = window_;
    info->haccel = nullptr;
    info->cAccelEntries = 0;
    return S_OK;
  }
  HRESULT STDMETHODCALLTYPE Scroll(SIZE) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE OnUIDeactivate(BOOL) override { return S_OK; }
  HRESULT STDMETHODCALLTYPE OnInPlaceDeactivate() override { return S_OK; }
  HRESULT STDMETHODCALLTYPE DiscardUndoState() override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE DeactivateAndUndo() override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE OnPosRectChange(LPCRECT) override {
    return E_NOTIMPL;
  }  // the panel fills the window

  // IOleInPlaceFrame
  HRESULT STDMETHODCALLTYPE GetBorder(LPRECT) override { return INPLACE_E_NOTOOLSPACE; }
  HRESULT STDMETHODCALLTYPE RequestBorderSpace(LPCBORDERWIDTHS) override { return INPLACE_E_NOTOOLSPACE; }
  HRESULT STDMETHODCALLTYPE SetBorderSpace(LPCBORDERWIDTHS) override { return S_OK; }
  HRESULT STDMETHODCALLTYPE SetActiveObject(IOleInPlaceActiveObject* active, LPCOLESTR) override {
    if (active != nullptr) active->AddRef();
    if (active_ != nullptr) active_->Release();
    active_ = active;
    return S_OK;
  }
  HRESULT STDMETHODCALLTYPE InsertMenus(HMENU, LPOLEMENUGROUPWIDTHS) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE SetMenu(HMENU, HOLEMENU, HWND) override { return S_OK; }
  HRESULT STDMETHODCALLTYPE RemoveMenus(HMENU) override { return S_OK; }
  HRESULT STDMETHODCALLTYPE SetStatusText(LPCOLESTR) override { return S_OK; }
  HRESULT STDMETHODCALLTYPE EnableModeless(BOOL enable) override {
    return EnableWindow(window_, enable), S_OK;
  }
  HRESULT STDMETHODCALLTYPE TranslateAccelerator(LPMSG, WORD) override { return S_FALSE; }

  // IDispatch: the panel's requests. The last argument comes first: a status by reference, 0 unless it is
  // set.
  HRESULT STDMETHODCALLTYPE GetTypeInfoCount(UINT* count) override { return *count = 0, S_OK; }
  HRESULT STDMETHODCALLTYPE GetTypeInfo(UINT, LCID, ITypeInfo**) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE GetIDsOfNames(REFIID, LPOLESTR*, UINT, LCID, DISPID*) override {
    return DISP_E_UNKNOWNNAME;
  }
  HRESULT STDMETHODCALLTYPE Invoke(DISPID event, REFIID, LCID, WORD, DISPPARAMS* parameters, VARIANT*,
                                   EXCEPINFO*, UINT*) override {
    constexpr DISPID kFrontPanelOp = 1;
    constexpr DISPID kFrontPanelSet = 2;
    VARIANT* const last = parameters->rgvarg;
    if (event == kFrontPanelOp && last[2].iVal == kClose) PostMessageW(window_, WM_CLOSE, 0, 0);
    if (event == kFrontPanelSet) change(last[3].iVal, last[1]);
    return S_OK;
  }

 private:
  [[nodiscard]] RECT area() const {
    RECT client{};
    GetClientRect(window_, &client);
    return client;
  }

  // The receiver takes the setting, then the panel hears what it has now.
  void change(SHORT parameter, VARIANT& value) {
    VARIANT hz{};
    if (FAILED(VariantChangeType(&hz, &value, 0, VT_R8))) return;
    if (parameter == kCenterHz) receiver_.centerHz = hz.dblVal;
    if (parameter == kSpanHz) receiver_.spanHz = hz.dblVal;
    if (parameter == kCenterHz || parameter == kSpanHz) tell(parameter, hz.dblVal);
  }

  void tell(SHORT parameter, double value) {
    invoke(*panel_, L"vfpSet", {number(0), number(parameter), number(0), number(value)});
  }

  void connect(bool on) {
    IConnectionPointContainer* points = nullptr;
    IProvideClassInfo2* info = nullptr;
    IConnectionPoint* point = nullptr;
    object_->QueryInterface(IID_IConnectionPointContainer, reinterpret_cast<void**>(&points));
    object_->QueryInterface(IID_IProvideClassInfo2, reinterpret_cast<void**>(&info));
    info->GetGUID(GUIDKIND_DEFAULT_SOURCE_DISP_IID, &events_);
    if (SUCCEEDED(points->FindConnectionPoint(events_, &point))) {
      on ? point->Advise(static_cast<IDispatch*>(this), &connection_) : point->Unadvise(connection_);
      point->Release();
    }
    info->Release();
    points->Release();
  }

  HWND window_;
  Receiver& receiver_;
  IOleObject* object_ = nullptr;
  IDispatch* panel_ = nullptr;
  IOleInPlaceActiveObject* active_ = nullptr;
  IID events_{};
  DWORD connection_ = 0;
};

LRESULT CALLBACK windowProcedure(HWND window, UINT message, WPARAM wide, LPARAM extra) {
  auto* const host = reinterpret_cast<Host*>(GetWindowLongPtrW(window, GWLP_USERDATA));
  if (message == WM_SIZE && host != nullptr) host->resized();
  if (message == WM_DESTROY) {
    if (host != nullptr) host->close();  // while its window is still there
    PostQuitMessage(0);
  }
  return DefWindowProcW(window, message, wide, extra);
}

HWND makeWindow() {
  WNDCLASSEXW description{};
  description.cbSize = sizeof description;
  description.lpfnWndProc = windowProcedure;
  description.hCursor = LoadCursorW(nullptr, IDC_ARROW);
  description.lpszClassName = L"FrontPanels.Example";
  RegisterClassExW(&description);
  return CreateWindowExW(0, description.lpszClassName, L"A receiver", WS_OVERLAPPEDWINDOW | WS_CLIPCHILDREN,
                         CW_USEDEFAULT, CW_USEDEFAULT, 1000, 740, nullptr, nullptr, nullptr, nullptr);
}

// Ends after so many sweeps, or with the window.
int run(Host& host, const Receiver& receiver, HWND window, int sweeps) {
  SetTimer(window, kSweepTimer, 100, nullptr);
  int swept = 0;
  for (MSG message; GetMessageW(&message, nullptr, 0, 0) > 0;) {
    if (host.translated(message)) continue;
    if (message.message == WM_TIMER && message.wParam == kSweepTimer) {
      receiver.sweep();
      if (++swept == sweeps) DestroyWindow(window);
    }
    TranslateMessage(&message);
    DispatchMessageW(&message);
  }
  std::printf("%d sweeps shown\n", swept);
  return swept > 0 ? 0 : 1;
}

int show(const CLSID& panelClass, const CLSID& hubClass, int sweeps) {
  Receiver receiver;
  const HWND window = makeWindow();
  Host host(window, receiver);
  CoCreateInstance(hubClass, nullptr, CLSCTX_INPROC_SERVER, IID_IDispatch,
                   reinterpret_cast<void**>(&receiver.hub));
  if (receiver.hub == nullptr || !host.open(panelClass)) {
    std::fputs("The panel could not be made\n", stderr);
    return 1;
  }
  SetWindowLongPtrW(window, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(&host));
  ShowWindow(window, SW_SHOW);
  const int result = run(host, receiver, window, sweeps);
  receiver.hub->Release();
  return result;
}

}  // namespace

int wmain(int count, wchar_t** arguments) {
  OleInitialize(nullptr);
  CLSID panelClass{};
  CLSID hubClass{};
  int result = 1;
  if (FAILED(CLSIDFromProgID(L"FrontPanels.SpectrumView", &panelClass)) ||
      FAILED(CLSIDFromProgID(L"FrontPanels.DataHub", &hubClass)))
    std::fputs("The controls are not registered: regsvr32 frontpanels.ocx\n", stderr);
  else
    result =
        show(panelClass, hubClass, count > 1 ? static_cast<int>(std::wcstol(arguments[1], nullptr, 10)) : 0);
  OleUninitialize();
  return result;
}

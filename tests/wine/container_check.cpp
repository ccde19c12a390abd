// A container that knows nothing but the published interfaces: it creates the registered control, sites it,
// feeds it, looks at what is on the screen, and lets go of it again. Prints a line a check, at the end "N
// passed, N failed".
#include <windows.h>

#include <ocidl.h>
#include <olectl.h>

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

#include "platform/win32/com_pointer.h"

using frontpanels::ComPointer;

namespace {

int passed = 0;
int failed = 0;

void expect(bool good, const char* what) {
  std::printf("%s container: %s\n", good ? "ok" : "not ok", what);
  ++(good ? passed : failed);
}

constexpr SIZE kSizePx{640, 480};
const wchar_t kSpectrumPath[] = L"Brantor Scanner/Spectrum/Spectrum Trace";

// --- The container's side

class Site final : public IOleClientSite, public IOleInPlaceSite {
 public:
  explicit Site(HWND window) : window_(window) {}
  int activations = 0;
  int deactivations = 0;

  HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override {
    *object = nullptr;
    if (id == IID_IUnknown || id == IID_IOleClientSite) *object = static_cast<IOleClientSite*>(this);
    if (id == IID_IOleWindow || id == IID_IOleInPlaceSite) *object = static_cast<IOleInPlaceSite*>(this);
    if (*object == nullptr) return E_NOINTERFACE;
    AddRef();
    return S_OK;
  }
  ULONG STDMETHODCALLTYPE AddRef() override { return ++references; }
  ULONG STDMETHODCALLTYPE Release() override { return --references; }  // lives on the stack
  ULONG references = 1;

  HRESULT STDMETHODCALLTYPE SaveObject() override { return S_OK; }
  HRESULT STDMETHODCALLTYPE GetMoniker(DWORD, DWORD, IMoniker**) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE GetContainer(IOleContainer** container) override {
    *container = nullptr;
    return E_NOINTERFACE;
  }
  HRESULT STDMETHODCALLTYPE ShowObject() override { return S_OK; }
  HRESULT STDMETHODCALLTYPE OnShowWindow(WINBOOL) override { return S_OK; }
  HRESULT STDMETHODCALLTYPE RequestNewObjectLayout() override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE GetWindow(HWND* window) override {
    *window = window_;
    return S_OK;
  }
  HRESULT STDMETHODCALLTYPE ContextSensitiveHelp(WINBOOL) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE CanInPlaceActivate() override { return S_OK; }
  HRESULT STDMETHODCALLTYPE OnInPlaceActivate() override { return ++activations, S_OK; }
  HRESULT STDMETHODCALLTYPE OnUIActivate() override { return S_OK; }
  HRESULT STDMETHODCALLTYPE GetWindowContext(IOleInPlaceFrame** frame, IOleInPlaceUIWindow** document,
                                             LPRECT place, LPRECT clip, LPOLEINPLACEFRAMEINFO info) override {
    *frame = nullptr;
    *document = nullptr;
    *place = *clip = {0, 0, kSizePx.cx, kSizePx.cy};
    info->fMDIApp = FALSE;
    info->hwndFrame = window_;
    info->haccel = nullptr;
    info->cAccelEntries = 0;
    return S_OK;
  }
  HRESULT STDMETHODCALLTYPE Scroll(SIZE) override { return S_FALSE; }
  HRESULT STDMETHODCALLTYPE OnUIDeactivate(WINBOOL) override { return S_OK; }
  HRESULT STDMETHODCALLTYPE OnInPlaceDeactivate() override { return ++deactivations, S_OK; }
  HRESULT STDMETHODCALLTYPE DiscardUndoState() override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE DeactivateAndUndo() override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE OnPosRectChange(LPCRECT) override { return S_OK; }

 private:
  HWND window_;
};

class Sink final : public IDispatch {
 public:
  ULONG references = 1;
  HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override {
    *object = id == IID_IUnknown || id == IID_IDispatch ? this : nullptr;
    if (*object == nullptr) return E_NOINTERFACE;
    AddRef();
    return S_OK;
  }
  ULONG STDMETHODCALLTYPE AddRef() override { return ++references; }
  ULONG STDMETHODCALLTYPE Release() override { return --references; }
  HRESULT STDMETHODCALLTYPE GetTypeInfoCount(UINT*) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE GetTypeInfo(UINT, LCID, ITypeInfo**) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE GetIDsOfNames(REFIID, LPOLESTR*, UINT, LCID, DISPID*) override {
    return E_NOTIMPL;
  }
  HRESULT STDMETHODCALLTYPE Invoke(DISPID, REFIID, LCID, WORD, DISPPARAMS*, VARIANT*, EXCEPINFO*,
                                   UINT*) override {
    return DISP_E_MEMBERNOTFOUND;
  }
};

CLSID classOf(const wchar_t* progId) {
  CLSID id{};
  CLSIDFromProgID(progId, &id);
  return id;
}

template <class Interface>
ComPointer<Interface> create(const wchar_t* progId) {
  ComPointer<Interface> object;
  CoCreateInstance(classOf(progId), nullptr, CLSCTX_INPROC_SERVER, __uuidof(Interface),
                   reinterpret_cast<void**>(object.receive()));
  return object;
}

// Calls a member by name; arguments in the order of the declaration.
VARIANT call(IDispatch& object, const wchar_t* name, std::vector<VARIANT> arguments) {
  LPOLESTR names[] = {const_cast<LPOLESTR>(name)};
  DISPID member = DISPID_UNKNOWN;
  VARIANT result;
  VariantInit(&result);
  if (FAILED(object.GetIDsOfNames(IID_NULL, names, 1, LOCALE_USER_DEFAULT, &member))) return result;
  std::vector<VARIANT> reversed(arguments.rbegin(), arguments.rend());
  DISPPARAMS parameters{reversed.data(), nullptr, static_cast<UINT>(reversed.size()), 0};
  object.Invoke(member, IID_NULL, LOCALE_USER_DEFAULT, DISPATCH_METHOD | DISPATCH_PROPERTYGET, &parameters,
                &result, nullptr, nullptr);
  return result;
}

VARIANT number(double value) {
  VARIANT result;
  VariantInit(&result);
  V_VT(&result) = VT_R8;
  V_R8(&result) = value;
  return result;
}

void publishSweep() {
  const auto hub = create<IDispatch>(L"FrontPanels.DataHub");
  SAFEARRAY* const levels = SafeArrayCreateVector(VT_R4, 0, 513);
  float* data = nullptr;
  SafeArrayAccessData(levels, reinterpret_cast<void**>(&data));
  for (int i = 0; i < 513; ++i) data[i] = i == 256 ? -30.0F : -100.0F;
  SafeArrayUnaccessData(levels);
  VARIANT path;
  V_VT(&path) = VT_BSTR;
  V_BSTR(&path) = SysAllocString(kSpectrumPath);
  VARIANT values;
  V_VT(&values) = VT_ARRAY | VT_R4;
  V_ARRAY(&values) = levels;
  call(*hub.get(), L"Publish", {path, values});
  VariantClear(&path);
  VariantClear(&values);
}

void pumpMessages() {
  MSG message;
  while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) DispatchMessageW(&message);
}

// Pixels of a colour in what a window shows.
int pixelsOf(HWND window, COLORREF color) {
  const HDC dc = GetDC(window);
  int count = 0;
  for (int y = 0; y < kSizePx.cy; ++y)
    for (int x = 0; x < kSizePx.cx; ++x) count += GetPixel(dc, x, y) == color;
  ReleaseDC(window, dc);
  return count;
}
constexpr COLORREF kTraceColor = RGB(50, 156, 50);

struct Hosted {
  ComPointer<IOleObject> object;
  ComPointer<IDispatch> panel;
};

Hosted activate(Site& site, HWND window) {
  Hosted hosted{create<IOleObject>(L"FrontPanels.SpectrumView"), {}};
  if (!hosted.object) return hosted;
  hosted.object->SetClientSite(&site);
  hosted.object.query<IPersistStreamInit>()->InitNew();
  SIZEL extent{1000, 1000};
  hosted.object->SetExtent(DVASPECT_CONTENT, &extent);
  const RECT place{0, 0, kSizePx.cx, kSizePx.cy};
  hosted.object->DoVerb(OLEIVERB_INPLACEACTIVATE, nullptr, &site, 0, window, &place);
  hosted.panel = hosted.object.query<IDispatch>();
  return hosted;
}

void close(Hosted& hosted) {
  hosted.object->Close(OLECLOSE_NOSAVE);
  hosted.object->SetClientSite(nullptr);
  hosted.panel.reset();
  hosted.object.reset();
}

// --- The checks

void showsASweep(HWND window) {
  Site site(window);
  Hosted hosted = activate(site, window);
  expect(static_cast<bool>(hosted.object), "the registered control is created");
  if (!hosted.object) return;
  DWORD status = 0;
  hosted.object->GetMiscStatus(DVASPECT_CONTENT, &status);
  expect(status == 131473, "its status bits are those of an inside-out control");
  HWND view = nullptr;
  hosted.object.query<IOleInPlaceObject>()->GetWindow(&view);
  expect(site.activations == 1 && view != nullptr && GetParent(view) == window,
         "it is a child of the container");
  SIZEL extent{};
  hosted.object->GetExtent(DVASPECT_CONTENT, &extent);
  const int dpi = 96;
  expect(MulDiv(extent.cx, dpi, 2540) == kSizePx.cx,
         "its extent follows the place it was given, not a stale one");
  pumpMessages();
  expect(pixelsOf(view, kTraceColor) == 0, "no trace before a sweep");
  publishSweep();
  pumpMessages();
  expect(pixelsOf(view, kTraceColor) > kSizePx.cx / 2, "a published sweep is on the screen at once");
  InvalidateRect(view, nullptr, TRUE);
  pumpMessages();
  expect(pixelsOf(view, kTraceColor) > kSizePx.cx / 2, "and again after the window system asked for a paint");
  const RECT larger{0, 0, kSizePx.cx, kSizePx.cy + 100};
  hosted.object.query<IOleInPlaceObject>()->SetObjectRects(&larger, &larger);
  pumpMessages();
  RECT client{};
  GetClientRect(view, &client);
  expect(client.bottom == kSizePx.cy + 100 && pixelsOf(view, kTraceColor) > 0, "it fills a larger place");
  close(hosted);
  expect(site.deactivations == 1 && !IsWindow(view), "closing takes its window away");
  expect(site.references == 1, "no reference to the site is left");
}

void drawsWithoutAWindow() {
  const auto panel = create<IDispatch>(L"FrontPanels.SpectrumView");
  publishSweep();
  const ComPointer<IViewObject2> view = panel.query<IViewObject2>();
  const HDC screen = GetDC(nullptr);
  const HDC dc = CreateCompatibleDC(screen);
  const HBITMAP bitmap = CreateCompatibleBitmap(screen, kSizePx.cx, kSizePx.cy);
  HGDIOBJ const previous = SelectObject(dc, bitmap);
  const RECTL bounds{0, 0, kSizePx.cx, kSizePx.cy};
  expect(
      view->Draw(DVASPECT_CONTENT, -1, nullptr, nullptr, nullptr, dc, &bounds, nullptr, nullptr, 0) == S_OK,
      "an inactive control draws itself");
  int trace = 0;
  for (int x = 0; x < kSizePx.cx; ++x)
    for (int y = 0; y < kSizePx.cy; ++y) trace += GetPixel(dc, x, y) == kTraceColor;
  expect(trace > kSizePx.cx / 2, "with its trace");
  expect(view->Draw(DVASPECT_ICON, -1, nullptr, nullptr, nullptr, dc, &bounds, nullptr, nullptr, 0) ==
             DV_E_DVASPECT,
         "but no other aspect of it");
  SelectObject(dc, previous);
  DeleteObject(bitmap);
  DeleteDC(dc);
  ReleaseDC(nullptr, screen);
}

void keepsItsProperties() {
  const auto stored = create<IPersistStreamInit>(L"FrontPanels.SpectrumView");
  const auto object = stored.query<IOleObject>();
  SIZEL extent{5000, 4000};
  object->SetExtent(DVASPECT_CONTENT, &extent);
  expect(stored->IsDirty() == S_OK, "a new extent makes it dirty");
  ComPointer<IStream> stream;
  CreateStreamOnHGlobal(nullptr, TRUE, stream.receive());
  expect(stored->Save(stream.get(), TRUE) == S_OK && stored->IsDirty() == S_FALSE, "saving makes it clean");
  const auto loaded = create<IPersistStreamInit>(L"FrontPanels.SpectrumView");
  stream->Seek({}, STREAM_SEEK_SET, nullptr);
  SIZEL back{};
  expect(loaded->Load(stream.get()) == S_OK, "what was saved loads");
  loaded.query<IOleObject>()->GetExtent(DVASPECT_CONTENT, &back);
  expect(back.cx == 5000 && back.cy == 4000, "with the extent to the unit");
  expect(FAILED(loaded->Load(stream.get())), "a stream that ends early is refused");
}

void aggregates() {
  struct Outer final : IUnknown {
    ULONG references = 1;
    HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override {
      *object = id == IID_IUnknown ? this : nullptr;
      if (*object == nullptr) return E_NOINTERFACE;
      AddRef();
      return S_OK;
    }
    ULONG STDMETHODCALLTYPE AddRef() override { return ++references; }
    ULONG STDMETHODCALLTYPE Release() override { return --references; }
  } outer;
  ComPointer<IUnknown> inner;
  const CLSID id = classOf(L"FrontPanels.SpectrumView");
  expect(
      CoCreateInstance(id, &outer, CLSCTX_INPROC_SERVER, IID_IDispatch,
                       reinterpret_cast<void**>(ComPointer<IDispatch>().receive())) == CLASS_E_NOAGGREGATION,
      "an outer object may ask for the inner identity only");
  CoCreateInstance(id, &outer, CLSCTX_INPROC_SERVER, IID_IUnknown, reinterpret_cast<void**>(inner.receive()));
  const auto part = inner.query<IOleObject>();
  ComPointer<IUnknown> identity;
  if (part) part->QueryInterface(IID_IUnknown, reinterpret_cast<void**>(identity.receive()));
  expect(identity.get() == &outer, "its parts show the outer identity");
}

void connectsSinks() {
  const auto panel = create<IDispatch>(L"FrontPanels.SpectrumView");
  const auto container = panel.query<IConnectionPointContainer>();
  GUID source{};
  panel.query<IProvideClassInfo2>()->GetGUID(GUIDKIND_DEFAULT_SOURCE_DISP_IID, &source);
  ComPointer<IConnectionPoint> point;
  expect(container->FindConnectionPoint(source, point.receive()) == S_OK,
         "its events have a connection point");
  Sink sink;
  DWORD first = 0;
  DWORD second = 0;
  point->Advise(&sink, &first);
  point->Unadvise(first);
  point->Advise(&sink, &second);
  expect(first != 0 && second != first, "a cookie is never used twice");
  expect(point->Unadvise(first) == CONNECT_E_NOCONNECTION && point->Unadvise(second) == S_OK &&
             sink.references == 1,
         "leaving gives the sink back");
}

// Handles and graphics objects of the process, by a cycle that is repeated.
void leavesNothingBehind(HWND window) {
  constexpr int kCycles = 50;
  const auto cycle = [window] {
    Site site(window);
    Hosted hosted = activate(site, window);
    publishSweep();
    pumpMessages();
    close(hosted);
    return site.references == 1 && site.activations == 1 && site.deactivations == 1;
  };
  bool clean = cycle();
  const DWORD gdiBefore = GetGuiResources(GetCurrentProcess(), GR_GDIOBJECTS);
  const DWORD userBefore = GetGuiResources(GetCurrentProcess(), GR_USEROBJECTS);
  // The highest handle that the graphics interface hands out grows with every object that is left.
  const auto probe = [] {
    std::vector<HGDIOBJ> pens;
    for (int i = 0; i < 64; ++i) pens.push_back(CreatePen(PS_SOLID, 1, RGB(i, 0, 0)));
    std::uintptr_t highest = 0;
    for (HGDIOBJ const pen : pens) {
      highest = std::max(highest, reinterpret_cast<std::uintptr_t>(pen) & 0xFFFF);
      DeleteObject(pen);
    }
    return highest;
  };
  const std::uintptr_t before = probe();
  for (int i = 0; i < kCycles; ++i) clean = cycle() && clean;
  expect(clean, "fifty cycles of create, activate, feed, close leave no reference to the site");
  expect(probe() <= before + 8, "and no graphics object");
  expect(GetGuiResources(GetCurrentProcess(), GR_GDIOBJECTS) <= gdiBefore + 2 &&
             GetGuiResources(GetCurrentProcess(), GR_USEROBJECTS) <= userBefore + 2,
         "nor any that the system counts");
}

void unloads() {
  CoFreeUnusedLibrariesEx(0, 0);
  HMODULE const library = GetModuleHandleW(L"frontpanels.ocx");
  if (library == nullptr) return expect(true, "the library is unloaded once nothing of it is in use");
  const auto canUnload = reinterpret_cast<HRESULT(WINAPI*)()>(
      reinterpret_cast<void*>(GetProcAddress(library, "DllCanUnloadNow")));
  expect(canUnload() == S_OK, "the library may be unloaded once nothing of it is in use");
}

}  // namespace

int main() {
  OleInitialize(nullptr);
  {
    const auto diagnostics = create<IDispatch>(L"FrontPanels.Diagnostics");
    if (diagnostics) {
      VARIANT no;
      V_VT(&no) = VT_BOOL;
      V_BOOL(&no) = VARIANT_FALSE;
      LPOLESTR names[] = {const_cast<LPOLESTR>(L"ShowMessages")};
      DISPID member = DISPID_UNKNOWN;
      DISPID put = DISPID_PROPERTYPUT;
      diagnostics->GetIDsOfNames(IID_NULL, names, 1, LOCALE_USER_DEFAULT, &member);
      DISPPARAMS parameters{&no, &put, 1, 1};
      diagnostics->Invoke(member, IID_NULL, LOCALE_USER_DEFAULT, DISPATCH_PROPERTYPUT, &parameters, nullptr,
                          nullptr, nullptr);
    }
    HWND const window = CreateWindowExW(0, L"STATIC", L"container", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 0, 0,
                                        800, 700, nullptr, nullptr, nullptr, nullptr);
    pumpMessages();
    showsASweep(window);
    drawsWithoutAWindow();
    keepsItsProperties();
    aggregates();
    connectsSinks();
    leavesNothingBehind(window);
    const VARIANT count = diagnostics ? call(*diagnostics.get(), L"Count", {}) : number(-1);
    expect(V_VT(&count) == VT_I4 && V_I4(&count) == 0, "nothing was reported on the way");
    DestroyWindow(window);
  }
  unloads();
  OleUninitialize();
  std::printf("%d passed, %d failed\n", passed, failed);
  return failed == 0 ? 0 : 1;
}

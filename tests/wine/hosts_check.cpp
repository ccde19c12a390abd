// Four families of hosts, each with its own order of calls: form designers, window toolkits, office programs
// and pages. Every step has its answer and what the host is told meanwhile. Then hosts that let go of a panel
// inside its own events. Prints a line a check, at the end "N passed, N failed".
#include <windows.h>

#include <objbase.h>
#include <ocidl.h>
#include <olectl.h>

#include <algorithm>
#include <functional>
#include <iterator>
#include <map>
#include <span>
#include <string>
#include <vector>

#include "tests/wine/com_client.h"
#include "tests/wine/full_container.h"
#include "tests/wine/panel_user.h"

namespace frontpanels::testing {
namespace {

constexpr DISPID kSecurityContext = -513;
constexpr int kHimetricPerInch = 2540;
constexpr int kDotsPerInch = 96;

LONG himetric(LONG px) { return MulDiv(px, kHimetricPerInch, kDotsPerInch); }

// The answer of a step that looks at something.
HRESULT yes(bool good) { return good ? S_OK : E_UNEXPECTED; }

int tracePixelsOf(HWND window) {
  pumpMessages();
  RECT area{};
  GetClientRect(window, &area);
  const HDC dc = GetDC(window);
  const int pixels = pixelsOf(dc, area, kTraceColor);
  ReleaseDC(window, dc);
  return pixels;
}

// --- What hosts bring along

// The object that a designer makes the control part of: its own identity, the control's interfaces.
class Outer final : public Counted<IUnknown> {
 public:
  ComPointer<IUnknown> inner;
  HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override {
    return id == IID_IUnknown || !inner ? Counted::QueryInterface(id, object)
                                        : inner->QueryInterface(id, object);
  }

 protected:
  void* find(REFIID id) override { return id == IID_IUnknown ? this : nullptr; }
};

// The place that a designer keeps for a control, in twips.
class Extender final : public Listener {
 public:
  std::map<std::wstring, int> values{
      {L"Left", 0}, {L"Top", 0}, {L"Width", 0}, {L"Height", 0}, {L"Visible", -1}};
  HRESULT STDMETHODCALLTYPE GetIDsOfNames(REFIID, LPOLESTR* names, UINT, LCID, DISPID* ids) override {
    const auto found = values.find(names[0]);
    if (found == values.end() && names[0] != std::wstring(L"Name")) return DISP_E_UNKNOWNNAME;
    return ids[0] = static_cast<DISPID>(std::distance(values.begin(), found)), S_OK;
  }
  HRESULT STDMETHODCALLTYPE Invoke(DISPID member, REFIID, LCID, WORD flags, DISPPARAMS* parameters,
                                   VARIANT* result, EXCEPINFO*, UINT*) override {
    const bool name = member == static_cast<DISPID>(values.size());
    const auto place = name ? values.end() : std::next(values.begin(), member);
    if (flags == DISPATCH_PROPERTYPUT) {
      Value number;
      if (name || FAILED(VariantChangeType(number.get(), &parameters->rgvarg[0], 0, VT_I4)))
        return DISP_E_TYPEMISMATCH;
      return place->second = static_cast<int>(V_I4(&number.variant())), S_OK;
    }
    if (result == nullptr) return E_POINTER;
    return VariantCopy(result, (name ? Value(L"Panel1") : Value(place->second)).get());
  }
};

// Values of the kind that they are asked for, as designers keep them.
class TypedBag final : public Counted<IPropertyBag> {
 public:
  std::map<std::wstring, Value> values;
  int reads = 0;
  int unhinted = 0;  // reads that say no kind, or bring a value along
  HRESULT STDMETHODCALLTYPE Read(LPCOLESTR name, VARIANT* value, IErrorLog*) override {
    ++reads;
    unhinted += (V_VT(value) != VT_BOOL && V_VT(value) != VT_BSTR) || V_I8(value) != 0;
    const auto found = values.find(name);
    return found == values.end() ? E_INVALIDARG
                                 : VariantChangeType(value, found->second.get(), 0, V_VT(value));
  }
  HRESULT STDMETHODCALLTYPE Write(LPCOLESTR name, VARIANT* value) override {
    return VariantCopy(values[name].get(), value);
  }

 protected:
  void* find(REFIID id) override { return id == IID_IUnknown || id == IID_IPropertyBag ? this : nullptr; }
};

// Hears of the picture and of the end.
class Viewer final : public Counted<IAdviseSink> {
 public:
  int views = 0;
  int closes = 0;
  std::function<void()> during = [] {};
  void STDMETHODCALLTYPE OnDataChange(FORMATETC*, STGMEDIUM*) override {}
  void STDMETHODCALLTYPE OnViewChange(DWORD, LONG) override {
    ++views;
    during();
  }
  void STDMETHODCALLTYPE OnRename(IMoniker*) override {}
  void STDMETHODCALLTYPE OnSave() override {}
  void STDMETHODCALLTYPE OnClose() override { ++closes; }

 protected:
  void* find(REFIID id) override { return id == IID_IUnknown || id == IID_IAdviseSink ? this : nullptr; }
};

enum class Ambients { All, Missing, Unanswered };

class StrictSite final : public FullContainer {
 public:
  using FullContainer::FullContainer;
  Ambients ambients = Ambients::All;
  bool emptyClip = false;
  std::function<void()> saves = [] {};

  HRESULT STDMETHODCALLTYPE SaveObject() override {
    saves();
    return FullContainer::SaveObject();
  }
  HRESULT STDMETHODCALLTYPE GetWindowContext(IOleInPlaceFrame** frame, IOleInPlaceUIWindow** document,
                                             LPRECT area, LPRECT clip, LPOLEINPLACEFRAMEINFO info) override {
    const HRESULT answer = FullContainer::GetWindowContext(frame, document, area, clip, info);
    if (emptyClip) *clip = {};
    return answer;
  }
  HRESULT STDMETHODCALLTYPE Invoke(DISPID member, REFIID id, LCID locale, WORD flags, DISPPARAMS* parameters,
                                   VARIANT* result, EXCEPINFO* exception, UINT* bad) override {
    return ambients == Ambients::Unanswered
               ? E_NOTIMPL
               : FullContainer::Invoke(member, id, locale, flags, parameters, result, exception, bad);
  }

 protected:
  void* find(REFIID id) override {
    return ambients == Ambients::Missing && id == IID_IDispatch ? nullptr : FullContainer::find(id);
  }
};

// --- A host and its control, and the steps that it takes

struct Stage {
  explicit Stage(HWND window) : container(window), form(window) {}
  ~Stage() {
    control.reset();
    outer.inner.reset();
  }

  template <class Interface>
  [[nodiscard]] ComPointer<Interface> as() const {
    return control.query<Interface>();
  }
  Value call(const wchar_t* name, std::initializer_list<Value> arguments = {}) const {
    return testing::call(*as<IDispatch>().get(), name, arguments);
  }
  HRESULT create(IUnknown* partOf) {
    ComPointer<IUnknown>& made = partOf == nullptr ? control : outer.inner;
    const HRESULT answer = CoCreateInstance(classOf(panelClass().c_str()), partOf, CLSCTX_INPROC_SERVER,
                                            IID_IUnknown, reinterpret_cast<void**>(made.receive()));
    if (partOf != nullptr) control = ComPointer<IUnknown>(partOf);
    return answer;
  }
  HRESULT verb(LONG number, const RECT* place = nullptr) const {
    return as<IOleObject>()->DoVerb(number, nullptr, nullptr, 0, form, place);
  }
  HRESULT site(IOleClientSite* given) const { return as<IOleObject>()->SetClientSite(given); }
  HRESULT freeze(BOOL freeze) const { return as<IOleControl>()->FreezeEvents(freeze); }
  HRESULT advise() {
    DWORD cookie = 0;
    const auto members = as<IDispatch>();
    return pointOf(*members.get(), eventsOf(*members.get()))->Advise(&sink, &cookie);
  }
  HRESULT extent(LONG widthPx, LONG heightPx) const {
    SIZEL size{himetric(widthPx), himetric(heightPx)};
    return as<IOleObject>()->SetExtent(DVASPECT_CONTENT, &size);
  }
  [[nodiscard]] bool measures(LONG widthPx, LONG heightPx) const {
    SIZEL size{};
    as<IOleObject>()->GetExtent(DVASPECT_CONTENT, &size);
    return size.cx == himetric(widthPx) && size.cy == himetric(heightPx);
  }
  HRESULT place(RECT rect) const { return as<IOleInPlaceObject>()->SetObjectRects(&rect, &rect); }
  [[nodiscard]] HWND window() const {
    HWND found = nullptr;
    as<IOleInPlaceObject>()->GetWindow(&found);
    return found;
  }
  [[nodiscard]] bool shown() const { return (GetWindowLongW(window(), GWL_STYLE) & WS_VISIBLE) != 0; }
  [[nodiscard]] bool stands(RECT rect) const {
    const RECT at = placeIn(form, window());
    return EqualRect(&at, &rect) != FALSE;
  }
  // Whether a request now reaches the host.
  [[nodiscard]] bool heardByHost() {
    sink.received.clear();
    call(L"closeVfp");
    return sink.received.size() == 1;
  }
  HRESULT save(BOOL sameAsLoad) const { return as<IPersistStorage>()->Save(storage.get(), sameAsLoad); }
  [[nodiscard]] bool dirty() const { return as<IPersistStorage>()->IsDirty() == S_OK; }

  // Before the control, which may go with them.
  StrictSite container;
  Outer outer;
  Extender extender;
  TypedBag typedBag;
  TextBag textBag;
  ErrorLog log;
  EventSink sink;
  Viewer viewer;
  HWND form;
  HWND lastWindow = nullptr;
  int views = 0;
  ComPointer<IStream> stream;
  ComPointer<IStorage> storage;
  ComPointer<IUnknown> control;
};

struct Step {
  const char* what;
  HRESULT (*take)(Stage& s);
  HRESULT answer = S_OK;
  const char* heard = "";  // by the container meanwhile
};

void play(const char* family, std::span<const Step> steps, Stage& stage) {
  chapter(family);
  for (const Step& step : steps) {
    stage.container.told.clear();
    const HRESULT answer = step.take(stage);
    std::string heard;
    for (const std::string& one : stage.container.told) heard += (heard.empty() ? "" : " ") + one;
    const bool good = answer == step.answer && heard == step.heard;
    char found[32];
    wsprintfA(found, " -> %08lx ", static_cast<unsigned long>(answer));
    expect(good, good ? step.what : step.what + (found + heard));
  }
}

void leavesNothing(Stage& stage) {
  stage.control.reset();
  stage.outer.inner.reset();
  expect(stage.container.references == 1 && stage.sink.references == 1 && stage.viewer.references == 1 &&
             stage.extender.references == 1 && stage.outer.references == 1 &&
             stage.typedBag.references == 1 && stage.log.references == 1,
         "no reference to anything of the host's is left");
}

constexpr RECT kPlace{10, 20, 410, 320};
constexpr RECT kLarger{5, 5, 605, 405};

// --- Form designers

const Step kDesigned[] = {
    {"makes the control part of another object", [](Stage& s) { return s.create(&s.outer); }},
    {"holds events back before there is a site", [](Stage& s) { return s.freeze(TRUE); }},
    {"gives it a site", [](Stage& s) { return s.site(&s.container); }},
    {"loads typed values",
     [](Stage& s) {
       s.typedBag.values[L"DisplayPanelVisible"] = Value(false);
       return s.as<IPersistPropertyBag>()->Load(&s.typedBag, &s.log);
     }},
    {"which were asked for by their kind, with nothing in them",
     [](Stage& s) { return yes(s.typedBag.reads >= 2 && s.typedBag.unhinted == 0 && s.log.names.empty()); }},
    {"is clean then", [](Stage& s) { return yes(!s.dirty()); }},
    {"connects its events", [](Stage& s) { return s.advise(); }},
    {"sizes it", [](Stage& s) { return s.extent(400, 300); }},
    {"shows it", [](Stage& s) { return s.verb(OLEIVERB_INPLACEACTIVATE); }, S_OK,
     "OnInPlaceActivate ShowObject"},
    {"sees its background",
     [](Stage& s) {
       pumpMessages();
       const HDC dc = GetDC(s.window());
       const COLORREF corner = GetPixel(dc, 0, 0);
       ReleaseDC(s.window(), dc);
       return yes(s.stands(kPlace) && corner == GetSysColor(COLOR_BTNFACE));
     }},
    {"presses on it in vain",
     [](Stage& s) {
       SendMessageW(s.window(), WM_LBUTTONDOWN, MK_LBUTTON, MAKELPARAM(50, 50));
       return yes(GetCapture() == nullptr && GetFocus() != s.window());
     }},
    {"lets events go", [](Stage& s) { return s.freeze(FALSE); }},
    {"hears none while it designs", [](Stage& s) { return yes(!s.heardByHost()); }},
    {"changes a property",
     [](Stage& s) { return put(*s.as<IDispatch>().get(), L"MeasurementPanelVisible", false); }},
    {"has to save it", [](Stage& s) { return yes(s.dirty()); }},
    {"saves what is not as usual",
     [](Stage& s) {
       s.typedBag.values.clear();
       return s.as<IPersistPropertyBag>()->Save(&s.typedBag, TRUE, FALSE);
     }},
    {"and that alone",
     [](Stage& s) {
       return yes(!s.dirty() && s.typedBag.values.size() == 2 &&
                  s.typedBag.values[L"DisplayPanelVisible"].number() == 0 &&
                  s.typedBag.values[L"MeasurementPanelVisible"].number() == 0);
     }},
    {"saves a stream",
     [](Stage& s) {
       CreateStreamOnHGlobal(nullptr, TRUE, s.stream.receive());
       return s.as<IPersistStreamInit>()->Save(s.stream.get(), TRUE);
     }},
    {"closes it", [](Stage& s) { return s.as<IOleObject>()->Close(OLECLOSE_SAVEIFDIRTY); }, S_OK,
     "OnInPlaceDeactivate"},
    {"takes its site away", [](Stage& s) { return s.site(nullptr); }},
};

const Step kRun[] = {
    {"makes the control part of another object", [](Stage& s) { return s.create(&s.outer); }},
    {"holds events back", [](Stage& s) { return s.freeze(TRUE); }},
    {"gives it a site", [](Stage& s) { return s.site(&s.container); }},
    {"loads the stream",
     [](Stage& s) {
       s.stream->Seek({}, STREAM_SEEK_SET, nullptr);
       return s.as<IPersistStreamInit>()->Load(s.stream.get());
     }},
    {"with the size and the properties that were designed",
     [](Stage& s) { return yes(s.measures(400, 300) && s.call(L"MeasurementPanelVisible").number() == 0); }},
    {"connects its events", [](Stage& s) { return s.advise(); }},
    {"shows it", [](Stage& s) { return s.verb(OLEIVERB_INPLACEACTIVATE); }, S_OK,
     "OnInPlaceActivate ShowObject"},
    {"hears nothing yet", [](Stage& s) { return yes(!s.heardByHost()); }},
    {"lets events go", [](Stage& s) { return s.freeze(FALSE); }},
    {"hears a request", [](Stage& s) { return yes(s.heardByHost()); }},
    {"finds the place where the panel was told to be, in twips",
     [](Stage& s) {
       const int wanted[] = {1500, 750, 7500, 4500};
       for (int code = 700; code < 704; ++code) s.call(L"vfpSet", {0, code, 0, wanted[code - 700]});
       const auto& at = s.extender.values;
       return yes(at.at(L"Left") == 1500 && at.at(L"Top") == 750 && at.at(L"Width") == 7500 &&
                  at.at(L"Height") == 4500);
     }},
    {"is asked for no state that it does not keep",
     [](Stage& s) {
       return yes(s.call(L"vfpSet", {0, 704, 0, 2}).number() == 0 && s.call(L"ViewState").number() == 2);
     }},
    {"hides it",
     [](Stage& s) {
       s.call(L"vfpSet", {0, 727, 0, L"FALSE"});
       return yes(s.extender.values.at(L"Visible") == 0 && !s.shown());
     }},
    {"shows it again",
     [](Stage& s) {
       s.call(L"vfpSet", {0, 727, 0, L"TRUE"});
       return yes(s.extender.values.at(L"Visible") == -1 && s.shown());
     }},
    {"sees a sweep",
     [](Stage& s) {
       publish(carrier());
       return yes(tracePixelsOf(s.window()) > 200);
     }},
    {"closes it", [](Stage& s) { return s.as<IOleObject>()->Close(OLECLOSE_NOSAVE); }, S_OK,
     "OnInPlaceDeactivate"},
    {"takes its site away", [](Stage& s) { return s.site(nullptr); }},
};

void formDesigner(const Desk& desk) {
  Stage stage(desk.window);
  stage.container.extender = &stage.extender;
  stage.container.userMode = false;
  play("designer", kDesigned, stage);
  leavesNothing(stage);
  stage.container.userMode = true;
  play("designed form at run time", kRun, stage);
  leavesNothing(stage);
}

// --- Window toolkits

const Step kToolkit[] = {
    {"creates it", [](Stage& s) { return s.create(nullptr); }},
    {"reads its status",
     [](Stage& s) {
       DWORD status = 0;
       s.as<IOleObject>()->GetMiscStatus(DVASPECT_CONTENT, &status);
       return yes(status == 131473);
     }},
    {"gives the site first", [](Stage& s) { return s.site(&s.container); }},
    {"holds events back", [](Stage& s) { return s.freeze(TRUE); }},
    {"has it start anew", [](Stage& s) { return s.as<IPersistStreamInit>()->InitNew(); }},
    {"connects its events", [](Stage& s) { return s.advise(); }},
    {"places it before there is a window", [](Stage& s) { return s.place(kPlace); }},
    {"sizes it", [](Stage& s) { return s.extent(400, 300); }},
    {"trusts what it answers", [](Stage& s) { return yes(s.measures(400, 300)); }},
    {"sizes it once more to what is not its place", [](Stage& s) { return s.extent(111, 99); }},
    {"activates it", [](Stage& s) { return s.verb(OLEIVERB_INPLACEACTIVATE); }, S_OK,
     "OnInPlaceActivate ShowObject"},
    {"finds a window right after",
     [](Stage& s) {
       s.lastWindow = s.window();
       return yes(IsWindow(s.lastWindow) && GetParent(s.lastWindow) == s.form);
     }},
    {"still has the focus", [](Stage& s) { return yes(GetFocus() == s.form); }},
    {"is not told to grow to the size of before",
     [](Stage& s) { return yes(s.measures(400, 300) && s.stands(kPlace)); }},
    {"moves it", [](Stage& s) { return s.place(kLarger); }},
    {"and its size follows", [](Stage& s) { return yes(s.measures(600, 400) && s.stands(kLarger)); }},
    {"hides it", [](Stage& s) { return s.verb(OLEIVERB_HIDE); }},
    {"whose window stays", [](Stage& s) { return yes(s.window() == s.lastWindow && !s.shown()); }},
    {"shows it", [](Stage& s) { return s.verb(OLEIVERB_SHOW); }},
    {"as it was", [](Stage& s) { return yes(s.window() == s.lastWindow && s.shown() && s.stands(kLarger)); }},
    {"gives it the user", [](Stage& s) { return s.verb(OLEIVERB_UIACTIVATE); }, S_OK,
     "OnUIActivate OnFocus SetActiveObject SetBorderSpace(none)"},
    {"hears nothing before it thaws", [](Stage& s) { return yes(!s.heardByHost()); }},
    {"lets events go", [](Stage& s) { return s.freeze(FALSE); }},
    {"hears a request", [](Stage& s) { return yes(s.heardByHost()); }},
    {"sees a sweep",
     [](Stage& s) {
       publish(carrier());
       return yes(tracePixelsOf(s.window()) > 200);
     }},
    {"hides what the user is at", [](Stage& s) { return s.verb(OLEIVERB_HIDE); }, S_OK,
     "SetActiveObject(none) OnUIDeactivate OnFocus(off)"},
    {"deactivates it", [](Stage& s) { return s.as<IOleInPlaceObject>()->InPlaceDeactivate(); }, S_OK,
     "OnInPlaceDeactivate"},
    {"finds no window then", [](Stage& s) { return yes(!IsWindow(s.lastWindow) && s.window() == nullptr); }},
    {"closes it", [](Stage& s) { return s.as<IOleObject>()->Close(OLECLOSE_NOSAVE); }},
    {"takes its site away", [](Stage& s) { return s.site(nullptr); }},
};

void windowToolkit(const Desk& desk) {
  Stage stage(desk.window);
  SetFocus(desk.window);
  play("toolkit", kToolkit, stage);
  leavesNothing(stage);
}

// --- Office programs

// A number of 16 bits, as these hosts pass them.
constexpr LONG shortVerb(LONG verb) { return verb & 0xFFFF; }

HRESULT drawsIntoAMetafile(Stage& s) {
  const HDC recording = CreateEnhMetaFileW(nullptr, nullptr, nullptr, nullptr);
  const RECTL bounds{0, 0, 400, 300};
  const HRESULT answer = s.as<IViewObject>()->Draw(DVASPECT_CONTENT, -1, nullptr, nullptr, nullptr, recording,
                                                   &bounds, nullptr, nullptr, 0);
  const HENHMETAFILE file = CloseEnhMetaFile(recording);
  const HDC screen = GetDC(nullptr);
  const HDC dc = CreateCompatibleDC(screen);
  const HBITMAP bitmap = CreateCompatibleBitmap(screen, 400, 300);
  HGDIOBJ const before = SelectObject(dc, bitmap);
  ENHMETAHEADER header{};
  GetEnhMetaFileHeader(file, sizeof header, &header);
  const RECT drawn{header.rclBounds.left, header.rclBounds.top, header.rclBounds.right + 1,
                   header.rclBounds.bottom + 1};
  PlayEnhMetaFile(dc, file, &drawn);
  const int pixels = pixelsOf(dc, {0, 0, 400, 300}, kTraceColor);
  SelectObject(dc, before);
  DeleteObject(bitmap);
  DeleteDC(dc);
  ReleaseDC(nullptr, screen);
  DeleteEnhMetaFile(file);
  return FAILED(answer) ? answer : yes(pixels > 100);
}

HRESULT givesData(Stage& s) {
  const auto data = s.as<IDataObject>();
  if (!data) return E_NOINTERFACE;
  for (FORMATETC format : {FORMATETC{CF_ENHMETAFILE, nullptr, DVASPECT_CONTENT, -1, TYMED_ENHMF},
                           FORMATETC{CF_METAFILEPICT, nullptr, DVASPECT_CONTENT, -1, TYMED_MFPICT}}) {
    STGMEDIUM medium{};
    const HRESULT answer = data->GetData(&format, &medium);
    if (FAILED(answer)) return answer;
    ReleaseStgMedium(&medium);
  }
  FORMATETC strange{CF_WAVE, nullptr, DVASPECT_CONTENT, -1, TYMED_HGLOBAL};
  return yes(FAILED(data->QueryGetData(&strange)));
}

const Step kOffice[] = {
    {"creates it", [](Stage& s) { return s.create(nullptr); }},
    {"gives it a storage", [](Stage& s) { return s.as<IPersistStorage>()->InitNew(s.storage.get()); }},
    {"gives it a site", [](Stage& s) { return s.site(&s.container); }},
    {"names itself", [](Stage& s) { return s.as<IOleObject>()->SetHostNames(L"Office", L"Document 1"); }},
    {"asks for its name",
     [](Stage& s) {
       LPOLESTR name = nullptr;
       s.as<IOleObject>()->GetUserType(USERCLASSTYPE_FULL, &name);
       const bool good = name != nullptr && name == std::wstring(L"Front Panels ") + panelKind().name;
       CoTaskMemFree(name);
       return yes(good);
     }},
    {"watches its picture",
     [](Stage& s) { return s.as<IViewObject>()->SetAdvise(DVASPECT_CONTENT, 0, &s.viewer); }},
    {"watches its end",
     [](Stage& s) {
       DWORD cookie = 0;
       return s.as<IOleObject>()->Advise(&s.viewer, &cookie);
     }},
    {"sizes it", [](Stage& s) { return s.extent(400, 300); }},
    {"is told of another picture", [](Stage& s) { return yes(s.viewer.views > 0 && s.dirty()); }},
    {"feeds it",
     [](Stage& s) {
       publish(carrier());
       s.views = s.viewer.views;
       return S_OK;
     }},
    {"has it draw into a metafile", drawsIntoAMetafile},
    {"asks for its picture as data", givesData},
    {"saves it where it came from", [](Stage& s) { return s.save(TRUE); }},
    {"which is not for good yet", [](Stage& s) { return yes(s.dirty()); }},
    {"takes the storage", [](Stage& s) { return s.as<IPersistStorage>()->HandsOffStorage(); }},
    {"gives another", [](Stage& s) { return s.as<IPersistStorage>()->SaveCompleted(s.storage.get()); }},
    {"has it clean", [](Stage& s) { return yes(!s.dirty()); }},
    {"was not told of another picture while it saved",
     [](Stage& s) { return yes(s.viewer.views == s.views); }},
    {"resizes it", [](Stage& s) { return s.extent(500, 300); }},
    {"saves a copy", [](Stage& s) { return s.save(FALSE); }},
    {"which is all", [](Stage& s) { return s.as<IPersistStorage>()->SaveCompleted(nullptr); }},
    {"has the original unsaved still", [](Stage& s) { return yes(s.dirty()); }},
    {"activates it by a short number", [](Stage& s) { return s.verb(shortVerb(OLEIVERB_INPLACEACTIVATE)); },
     S_OK, "OnInPlaceActivate ShowObject"},
    {"does not know a short number of the system's", [](Stage& s) { return s.verb(shortVerb(-16)); },
     E_NOTIMPL},
    {"tries a number of its own", [](Stage& s) { return s.verb(7); }, OLEOBJ_S_INVALIDVERB,
     "OnUIActivate OnFocus SetActiveObject SetBorderSpace(none)"},
    {"discards what could be undone", [](Stage& s) { return s.verb(shortVerb(OLEIVERB_DISCARDUNDOSTATE)); }},
    {"closes it", [](Stage& s) { return s.as<IOleObject>()->Close(OLECLOSE_SAVEIFDIRTY); }, S_OK,
     "SaveObject SetActiveObject(none) OnUIDeactivate OnFocus(off) OnInPlaceDeactivate"},
    {"and once more", [](Stage& s) { return s.as<IOleObject>()->Close(OLECLOSE_SAVEIFDIRTY); }},
    {"hears of the end", [](Stage& s) { return yes(s.viewer.closes > 0); }},
    {"takes its site away", [](Stage& s) { return s.site(nullptr); }},
};

const Step kOfficeAgain[] = {
    {"creates it", [](Stage& s) { return s.create(nullptr); }},
    {"loads it", [](Stage& s) { return s.as<IPersistStorage>()->Load(s.storage.get()); }},
    {"with the size of its place", [](Stage& s) { return yes(s.measures(400, 300) && !s.dirty()); }},
};

void officeProgram(const Desk& desk) {
  Stage stage(desk.window);
  StgCreateDocfile(nullptr, STGM_CREATE | STGM_READWRITE | STGM_SHARE_EXCLUSIVE | STGM_DELETEONRELEASE, 0,
                   stage.storage.receive());
  stage.container.saves = [&stage] {
    stage.save(TRUE);
    stage.as<IPersistStorage>()->SaveCompleted(nullptr);
  };
  SetFocus(desk.window);
  play("office", kOffice, stage);
  leavesNothing(stage);
  play("office, the document again", kOfficeAgain, stage);
}

// --- Pages

// Quietly: no report, no text of an error.
HRESULT isProbed(Stage& s) {
  for (const DISPID probe :
       {static_cast<DISPID>(DISPID_READYSTATE), static_cast<DISPID>(DISPID_ENABLED), kSecurityContext}) {
    DISPPARAMS none{};
    Value result;
    EXCEPINFO exception{};
    const HRESULT answer = s.as<IDispatch>()->Invoke(
        probe, IID_NULL, LOCALE_USER_DEFAULT, DISPATCH_PROPERTYGET, &none, result.get(), &exception, nullptr);
    if (answer != DISP_E_MEMBERNOTFOUND || exception.bstrDescription != nullptr) return answer;
  }
  return S_OK;
}

const Step kPage[] = {
    {"creates it", [](Stage& s) { return s.create(nullptr); }},
    {"has no rights to ask for it by what it is not", isProbed},
    {"gives it a site", [](Stage& s) { return s.site(&s.container); }},
    {"loads texts",
     [](Stage& s) {
       s.textBag.texts = {{L"DisplayPanelVisible", L"0"}, {L"MeasurementPanelVisible", L"rubbish"}};
       return s.as<IPersistPropertyBag>()->Load(&s.textBag, &s.log);
     }},
    {"is told of the one that says nothing",
     [](Stage& s) { return yes(s.log.names == Lines{L"MeasurementPanelVisible"}); }},
    {"which is as usual",
     [](Stage& s) {
       return yes(s.call(L"DisplayPanelVisible").number() == 0 &&
                  s.call(L"MeasurementPanelVisible").number() == -1);
     }},
    {"loads a text that says yes",
     [](Stage& s) {
       s.textBag.texts = {{L"DisplayPanelVisible", L"True"}};
       return s.as<IPersistPropertyBag>()->Load(&s.textBag, nullptr);
     }},
    {"and has it", [](Stage& s) { return yes(s.call(L"DisplayPanelVisible").number() == -1); }},
    {"listens by numbers alone", [](Stage& s) { return s.advise(); }},
    {"activates it in a rectangle", [](Stage& s) { return s.verb(OLEIVERB_INPLACEACTIVATE, &kPlace); }, S_OK,
     "OnInPlaceActivate ShowObject"},
    {"moves it before anything was pumped, with an empty clip",
     [](Stage& s) {
       const RECT none{};
       return s.as<IOleInPlaceObject>()->SetObjectRects(&kLarger, &none);
     }},
    {"and sees all of it",
     [](Stage& s) {
       const HRGN region = CreateRectRgn(0, 0, 0, 0);
       const bool whole = GetWindowRgn(s.window(), region) == ERROR;
       DeleteObject(region);
       return yes(whole && s.stands(kLarger));
     }},
    {"hears a request", [](Stage& s) { return yes(s.heardByHost()); }},
    {"sees a sweep",
     [](Stage& s) {
       publish(carrier());
       return yes(tracePixelsOf(s.window()) > 200);
     }},
    {"probes it again", isProbed},
    {"takes its site away while it is active",
     [](Stage& s) {
       s.lastWindow = s.window();
       return s.site(nullptr);
     },
     S_OK, "OnInPlaceDeactivate"},
    {"with its window", [](Stage& s) { return yes(!IsWindow(s.lastWindow) && s.container.references == 1); }},
    {"closes it without a site", [](Stage& s) { return s.as<IOleObject>()->Close(OLECLOSE_SAVEIFDIRTY); }},
};

void page(const Desk& desk) {
  for (const Ambients ambients : {Ambients::Missing, Ambients::Unanswered}) {
    Stage stage(desk.window);
    stage.container.ambients = ambients;
    stage.container.emptyClip = true;
    play(ambients == Ambients::Missing ? "page without ambients" : "page that answers none", kPage, stage);
    leavesNothing(stage);
  }
}

// --- The end in the middle

// Messages of a panel that was closed in the middle of a request are not looked at.
void forget(const Desk& desk) { call(desk.diagnostics, L"Clear"); }

void asksTheHost(IDispatch& panel) { call(panel, L"closeVfp"); }

// A field that the user has changed: the new value goes to the host.
void setsSomething(IDispatch& panel) {
  const bool spectrum = panelKind().text == nullptr;
  const Value field =
      call(panel, L"Constituent", {spectrum ? L"CenterFrequencyTextBox" : L"CodeStartTextBox"});
  put(*V_DISPATCH(&field.variant()), L"Text", spectrum ? L"881 MHz" : L"64");
  call(*V_DISPATCH(&field.variant()), L"KeyPress", {13});
}

// How a host may end a panel: let go of it in any order.
void ends(const Desk& desk) {
  struct Way {
    const char* name;
    const wchar_t* event;  // its number, as the sink notes it
    void (*raise)(IDispatch& panel);
    bool publishes;  // from within the event, before and after the end
  };
  constexpr Way kWays[] = {{"in the middle of an operation", L"1 ", asksTheHost, false},
                           {"in the middle of a setting", L"2 ", setsSomething, false},
                           {"in the middle of an operation with a sweep", L"1 ", asksTheHost, true},
                           {"in the middle of a setting with a sweep", L"2 ", setsSomething, true}};
  for (const Way& way : kWays) {
    EventSink sink;
    Sited other(desk.window, OLEIVERB_INPLACEACTIVATE);
    Sited hosted(desk.window, OLEIVERB_UIACTIVATE);
    const HWND view = hosted.window();
    hosted.advise(sink);
    sink.during = [&] {
      if (way.publishes) publish(carrier());
      hosted.close();
      if (way.publishes) publish(carrier());
    };
    way.raise(*ComPointer<IDispatch>(hosted.members.get()).get());
    expect(!sink.received.empty() && sink.received[0].rfind(way.event, 0) == 0 && !hosted.object &&
               !IsWindow(view) && hosted.container.count("OnInPlaceDeactivate") == 1 &&
               hosted.container.references == 1 && sink.references == 1,
           std::string("it goes ") + way.name);
    publish(carrier());
    expect(tracePixelsOf(other.window()) > 200, "and the panel beside it goes on");
  }
  forget(desk);
}

// Whoever watches a picture may let go of the panel when it hears of another one.
void endsWithItsPicture(const Desk& desk) {
  for (const bool sweep : {false, true}) {
    Viewer viewer;
    Sited hosted(desk.window);
    hosted.object.query<IViewObject>()->SetAdvise(DVASPECT_CONTENT, 0, &viewer);
    viewer.during = [&] { hosted.close(); };
    if (sweep) publish(carrier());
    const auto members = ComPointer<IDispatch>(hosted.members.get());
    if (members) put(*members.get(), L"DisplayPanelVisible", false);
    expect(viewer.views == 1 && hosted.container.references == 1, "it goes when its picture changes");
    viewer.during = [] {};
  }
  forget(desk);
}

void joinAndLeave(const Desk& desk) {
  Sited hosted(desk.window, OLEIVERB_INPLACEACTIVATE);
  const auto point = pointOf(*hosted.members.get(), eventsOf(*hosted.members.get()));
  EventSink first;
  EventSink second;
  std::vector<DWORD> cookies(1);
  point->Advise(&first, cookies.data());
  first.during = [&] { point->Advise(&second, &cookies.emplace_back()); };
  asksTheHost(*hosted.members.get());
  expect(first.received.size() == 1 && second.received.empty(),
         "who joins inside an event hears the next one");
  first.during = [&] { point->Unadvise(cookies[0]); };
  second.status = -8;
  asksTheHost(*hosted.members.get());
  expect(first.received.size() == 2 && second.received.size() == 1 && first.references == 1,
         "who leaves inside its own is let go of, and the others hear it");
  asksTheHost(*hosted.members.get());
  expect(first.received.size() == 2 && second.received.size() == 2, "and the next one alone");
  for (int i = 0; i < 3; ++i) {
    const DWORD last = cookies.back();
    expect(point->Unadvise(last) == S_OK && point->Unadvise(last) == CONNECT_E_NOCONNECTION,
           "a cookie is good for one leave");
    point->Advise(&second, &cookies.emplace_back());
  }
  std::sort(cookies.begin(), cookies.end());
  expect(std::adjacent_find(cookies.begin(), cookies.end()) == cookies.end() && cookies[0] != 0,
         "no cookie comes twice");
  forget(desk);
}

constexpr struct {
  const char* name;
  void (*check)(const Desk& desk);
} kChapters[] = {{"designer", formDesigner},
                 {"toolkit", windowToolkit},
                 {"office", officeProgram},
                 {"page", page},
                 {"ends", ends},
                 {"ends with its picture", endsWithItsPicture},
                 {"sinks", joinAndLeave}};

}  // namespace

int check() {
  return runChecks({800, 700}, [](const Desk& desk) {
    onEachPanel([&desk] {
      for (const auto& [name, check] : kChapters) {
        chapter(name);
        check(desk);
      }
    });
    chapter("all hosts");
  });
}

}  // namespace frontpanels::testing

int main() { return frontpanels::testing::check(); }

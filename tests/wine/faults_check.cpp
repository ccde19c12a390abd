// Every call into the library while an allocation fails, and every barrier of it while its body fails. Works
// with the build in which both can be asked for, loaded from its file without a registration. Prints a line a
// check, at the end "N passed, N failed".
#include <windows.h>

#include <ocidl.h>
#include <ole2.h>
#include <olectl.h>

#include <cstdio>
#include <deque>
#include <functional>
#include <iterator>
#include <map>
#include <memory>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "tests/wine/com_client.h"
#include "tests/wine/full_container.h"
#include "tests/wine/panel_user.h"

namespace frontpanels::testing {
namespace {

constexpr HRESULT kOutOfMemoryError = static_cast<HRESULT>(0x800A0007);
constexpr const wchar_t kFaultText[] = L"A fault for the barrier";

// --- The library and what is asked of it

struct Library {
  HRESULT(WINAPI* classObject)(REFCLSID, REFIID, void**) = nullptr;
  HRESULT(WINAPI* canUnload)() = nullptr;
  long(WINAPI* liveBlocks)() = nullptr;
  long(WINAPI* failAllocation)(long n, int andOn) = nullptr;
  long(WINAPI* failBarrier)(int kind, long after) = nullptr;
  std::map<std::wstring, ComPointer<ITypeInfo>> classes;
};
Library library;

template <class Function>
void find(Function& function, HMODULE module, const char* name) {
  function = reinterpret_cast<Function>(reinterpret_cast<void*>(GetProcAddress(module, name)));
}

struct Attributes {
  explicit Attributes(ITypeInfo& info) : info_(info) { info.GetTypeAttr(&value); }
  ~Attributes() { info_.ReleaseTypeAttr(value); }
  TYPEATTR* value = nullptr;

 private:
  ITypeInfo& info_;
};

bool load(const wchar_t* file) {
  const HMODULE module = LoadLibraryW(file);
  find(library.classObject, module, "DllGetClassObject");
  find(library.canUnload, module, "DllCanUnloadNow");
  find(library.liveBlocks, module, "FaultsLiveBlocks");
  find(library.failAllocation, module, "FaultsFailAllocation");
  find(library.failBarrier, module, "FaultsFailBarrier");
  ComPointer<ITypeLib> types;
  if (module == nullptr || FAILED(LoadTypeLibEx(file, REGKIND_NONE, types.receive()))) return false;
  for (UINT i = 0; i < types->GetTypeInfoCount(); ++i) {
    ComPointer<ITypeInfo> info;
    types->GetTypeInfo(i, info.receive());
    BSTR name = nullptr;
    if (Attributes(*info.get()).value->typekind != TKIND_COCLASS) continue;
    info->GetDocumentation(MEMBERID_NIL, &name, nullptr, nullptr, nullptr);
    library.classes[name] = info;
    SysFreeString(name);
  }
  return library.failBarrier != nullptr && library.classes.size() == 6;
}

bool isPanel(const std::wstring& name) { return name == L"SpectrumView" || name == L"Tarvex"; }

CLSID idOf(const std::wstring& name) { return Attributes(*library.classes.at(name).get()).value->guid; }

HRESULT make(const std::wstring& name, ComPointer<IUnknown>& object) {
  ComPointer<IClassFactory> factory;
  const HRESULT found =
      library.classObject(idOf(name), IID_IClassFactory, reinterpret_cast<void**>(factory.receive()));
  if (FAILED(found)) return found;
  return factory->CreateInstance(nullptr, IID_IUnknown, reinterpret_cast<void**>(object.receive()));
}

// An object and its host's side.
struct Subject {
  Subject(const std::wstring& className, HWND form) : name(className), container(form) {
    container.place = {0, 0, 300, 200};
    library.classObject(idOf(name), IID_IClassFactory, reinterpret_cast<void**>(factory.receive()));
    factory->CreateInstance(nullptr, IID_IUnknown, reinterpret_cast<void**>(object.receive()));
    CreateStreamOnHGlobal(nullptr, TRUE, stream.receive());
    StgCreateDocfile(nullptr, STGM_CREATE | STGM_READWRITE | STGM_SHARE_EXCLUSIVE | STGM_DELETEONRELEASE, 0,
                     storage.receive());
    if (!isPanel(name)) return;
    at<IOleObject>()->SetClientSite(&container);
    at<IPersistStreamInit>()->Save(stream.get(), FALSE);
    at<IPersistStorage>()->Save(storage.get(), TRUE);
    point()->EnumConnections(connections.receive());
    const auto members = at<IDispatch>();
    const Value named = call(*members.get(), L"Constituent", {L"MarkerDeltaButton"});
    const Value shared = call(*members.get(), L"baseInstance");
    field = ComPointer<IDispatch>(V_DISPATCH(&named.variant()));
    base = ComPointer<IDispatch>(V_DISPATCH(&shared.variant()));
  }
  ~Subject() {
    if (!isPanel(name)) return;
    at<IOleObject>()->Close(OLECLOSE_NOSAVE);
    at<IOleObject>()->SetClientSite(nullptr);
  }

  template <class Interface>
  [[nodiscard]] ComPointer<Interface> at() const {
    return object.query<Interface>();
  }
  [[nodiscard]] ComPointer<IConnectionPoint> point(const IID& id = IID_IPropertyNotifySink) const {
    ComPointer<IConnectionPoint> found;
    at<IConnectionPointContainer>()->FindConnectionPoint(id, found.receive());
    return found;
  }
  [[nodiscard]] IStream* fromBegin() const {
    stream->Seek({}, STREAM_SEEK_SET, nullptr);
    return stream.get();
  }
  HRESULT activate() const {
    return at<IOleObject>()->DoVerb(OLEIVERB_INPLACEACTIVATE, nullptr, nullptr, 0, nullptr, nullptr);
  }
  [[nodiscard]] HWND window() const {
    HWND found = nullptr;
    at<IOleInPlaceObject>()->GetWindow(&found);
    return found;
  }

  std::wstring name;
  FullContainer container;
  EventSink sink;
  ChangeSink changes;
  TextBag bag;
  ErrorLog log;
  ComPointer<IStream> stream;
  ComPointer<IStorage> storage;
  ComPointer<IClassFactory> factory;
  ComPointer<IUnknown> object;
  ComPointer<IEnumConnections> connections;
  ComPointer<IDispatch> field;
  ComPointer<IDispatch> base;
};

// Gives back what a call has handed out.
template <class Interface>
HRESULT released(HRESULT answer, Interface* handed) {
  if (handed != nullptr) handed->Release();
  return answer;
}

// A call by name, which first looks the name up; the answer is its own where there is an exception.
HRESULT byName(IDispatch& object, const wchar_t* name, std::vector<Value> arguments, WORD flags) {
  LPOLESTR names[] = {const_cast<LPOLESTR>(name)};
  DISPID id = DISPID_UNKNOWN;
  const HRESULT known = object.GetIDsOfNames(IID_NULL, names, 1, LOCALE_USER_DEFAULT, &id);
  if (FAILED(known)) return known;
  std::vector<VARIANT> raw;
  for (auto one = arguments.rbegin(); one != arguments.rend(); ++one) raw.push_back(one->variant());
  DISPID put = DISPID_PROPERTYPUT;
  const bool puts = flags == DISPATCH_PROPERTYPUT;
  DISPPARAMS parameters{raw.data(), puts ? &put : nullptr, static_cast<UINT>(raw.size()), puts ? 1U : 0U};
  Value result;
  EXCEPINFO exception{};
  const HRESULT answer = object.Invoke(id, IID_NULL, LOCALE_USER_DEFAULT, flags, &parameters,
                                       puts ? nullptr : result.get(), &exception, nullptr);
  SysFreeString(exception.bstrDescription);
  SysFreeString(exception.bstrSource);
  SysFreeString(exception.bstrHelpFile);
  return answer == DISP_E_EXCEPTION ? exception.scode : answer;
}

constexpr WORD kCall = DISPATCH_METHOD | DISPATCH_PROPERTYGET;

// --- The members of a class by their places, as its type library lists them

// Arguments of any kind that a member takes: small numbers, a text, room for what it hands out.
class PlainArguments {
 public:
  explicit PlainArguments(const FUNCDESC& function) {
    for (SHORT i = 0; i < function.cParams; ++i) add(function.lprgelemdescParam[i].tdesc);
    for (VARIANT& value : values_) {
      pointers_.push_back(&value);
      types_.push_back(V_VT(&value));
    }
  }
  ~PlainArguments() {
    for (VARIANT& value : values_)
      if ((V_VT(&value) & VT_BYREF) == 0) VariantClear(&value);
    for (const auto& [type, cell] : cells_) {
      if (type == VT_VARIANT) VariantClear(cell.get());
      if (type == VT_BSTR) SysFreeString(*reinterpret_cast<BSTR*>(cell.get()));
      if (type == VT_DISPATCH)
        if (auto* const object = *reinterpret_cast<IDispatch**>(cell.get())) object->Release();
    }
  }
  PlainArguments(const PlainArguments&) = delete;
  PlainArguments& operator=(const PlainArguments&) = delete;

  HRESULT call(void* object, const FUNCDESC& function) {
    Value answer;
    const HRESULT called =
        DispCallFunc(object, static_cast<ULONG_PTR>(function.oVft), CC_STDCALL, VT_I4,
                     static_cast<UINT>(values_.size()), types_.data(), pointers_.data(), answer.get());
    return FAILED(called) ? called : static_cast<HRESULT>(V_I4(&answer.variant()));
  }

 private:
  void add(const TYPEDESC& type) {
    VARIANT& value = values_.emplace_back();
    VariantInit(&value);
    if (type.vt == VT_PTR) {
      cells_.emplace_back(type.lptdesc->vt, std::make_unique<VARIANT>());
      V_VT(&value) = static_cast<VARTYPE>(VT_BYREF | type.lptdesc->vt);
      V_BYREF(&value) = cells_.back().second.get();
      return;
    }
    V_VT(&value) = type.vt;
    if (type.vt == VT_BSTR) V_BSTR(&value) = SysAllocString(L"C:\\windows\\temp\\a rather long text");
    if (type.vt == VT_R4) V_R4(&value) = 1;
    if (type.vt == VT_R8) V_R8(&value) = 1;
    if (type.vt == VT_I2 || type.vt == VT_I4 || type.vt == VT_BOOL) V_I4(&value) = 1;
  }

  std::deque<VARIANT> values_;
  std::vector<VARTYPE> types_;
  std::vector<VARIANT*> pointers_;
  std::vector<std::pair<VARTYPE, std::unique_ptr<VARIANT>>> cells_;
};

using MemberCheck = std::function<void(const std::wstring& member, const std::function<HRESULT()>& call)>;

void onEachMember(const Subject& subject, const MemberCheck& check) {
  const auto followed = [](ITypeInfo& info, UINT index) {
    HREFTYPE reference = 0;
    ComPointer<ITypeInfo> found;
    info.GetRefTypeOfImplType(index, &reference);
    info.GetRefTypeInfo(reference, found.receive());
    return found;
  };
  const auto dual = followed(*library.classes.at(subject.name).get(), 0);
  const auto table =
      followed(*dual.get(), static_cast<UINT>(-1));  // the places lie behind the dual interface
  const Attributes attributes(*table.get());
  void* members = nullptr;
  subject.object->QueryInterface(attributes.value->guid, &members);
  const auto held = ComPointer<IUnknown>::adopt(static_cast<IUnknown*>(members));
  for (UINT i = 0; i < attributes.value->cFuncs; ++i) {
    FUNCDESC* function = nullptr;
    BSTR name = nullptr;
    table->GetFuncDesc(i, &function);
    table->GetDocumentation(function->memid, &name, nullptr, nullptr, nullptr);
    const wchar_t* const kind = function->invkind == INVOKE_FUNC          ? L""
                                : function->invkind == INVOKE_PROPERTYGET ? L" (get)"
                                                                          : L" (put)";
    check(subject.name + L"." + name + kind,
          [&] { return PlainArguments(*function).call(members, *function); });
    SysFreeString(name);
    table->ReleaseFuncDesc(function);
  }
}

// --- Allocations that fail

// What goes on in the library without a call that a type library knows. `back` undoes it.
struct Scenario {
  const char* name;
  HRESULT (*act)(Subject& s);
  void (*back)(Subject& s) = [](Subject&) {};
};

HRESULT member(Subject& s, const wchar_t* name, std::vector<Value> arguments = {}) {
  return byName(*s.at<IDispatch>().get(), name, std::move(arguments), kCall);
}

HRESULT sweeps(Subject& s) {
  ComPointer<IUnknown> hub;
  const HRESULT made = make(L"DataHub", hub);
  if (FAILED(made)) return made;
  const bool spectrum = s.name == L"SpectrumView";
  return byName(*hub.query<IDispatch>().get(), L"Publish",
                {spectrum ? L"Brantor Scanner/Spectrum/Spectrum Trace"
                          : L"Brantor Scanner/CDMA All Pilots/AllPilotsTrace",
                 Value(std::vector<float>(513, -30.0F))},
                kCall);
}

void deactivate(Subject& s) { s.at<IOleInPlaceObject>()->InPlaceDeactivate(); }

HRESULT paints(Subject& s) {
  const HDC screen = GetDC(nullptr);
  const HDC dc = CreateCompatibleDC(screen);
  const HBITMAP bitmap = CreateCompatibleBitmap(screen, 300, 200);
  HGDIOBJ const before = SelectObject(dc, bitmap);
  const RECTL bounds{0, 0, 300, 200};
  const HRESULT answer = s.at<IViewObject>()->Draw(DVASPECT_CONTENT, -1, nullptr, nullptr, nullptr, dc,
                                                   &bounds, nullptr, nullptr, 0);
  SelectObject(dc, before);
  DeleteObject(bitmap);
  DeleteDC(dc);
  ReleaseDC(nullptr, screen);
  return answer;
}

FORMATETC metafile{CF_ENHMETAFILE, nullptr, DVASPECT_CONTENT, -1, TYMED_ENHMF};

HRESULT givesItsPicture(Subject& s) {
  STGMEDIUM medium{};
  const HRESULT answer = s.at<IDataObject>()->GetData(&metafile, &medium);
  if (medium.tymed != TYMED_NULL) ReleaseStgMedium(&medium);
  return answer;
}

HRESULT makesAnother(Subject& s) {
  ComPointer<IUnknown> another;
  return make(s.name, another);
}

HRESULT connects(Subject& s) {
  const auto point = s.point();
  DWORD cookie = 0;
  const HRESULT joined = point->Advise(&s.changes, &cookie);
  IEnumConnections* connections = nullptr;
  const HRESULT listed = point->EnumConnections(&connections);
  IEnumConnections* copy = nullptr;
  const HRESULT copied = connections != nullptr ? connections->Clone(&copy) : listed;
  released(released(S_OK, copy), connections);
  point->Unadvise(cookie);
  return FAILED(joined) ? joined : FAILED(listed) ? listed : copied;
}

HRESULT asksTheHost(Subject& s) {
  const IID events = eventsOf(*s.at<IDispatch>().get());
  const auto point = s.point(events);
  DWORD cookie = 0;
  const HRESULT joined = point->Advise(&s.sink, &cookie);
  const HRESULT asked = member(s, L"closeVfp");
  const HRESULT kept = member(s, L"vfpOp", {0, 9});
  point->Unadvise(cookie);
  return FAILED(joined) ? joined : FAILED(asked) ? asked : kept;
}

HRESULT composes(Subject& s) {
  const struct {
    const wchar_t* name;
    std::vector<Value> arguments;
  } kSteps[] = {{L"HardwareId", {7}},
                {L"BeginMeasurement", {1}},
                {L"BeginSubMeasurement", {1}},
                {L"BeginRecord", {10}},
                {L"Int16", {5}},
                {L"Float32Array", {Value(std::vector<float>(40, 1.0F))}},
                {L"Text", {L"a text that does not fit in the string itself"}},
                {L"EndRecord", {}},
                {L"EndSubMeasurement", {}},
                {L"EndMeasurement", {}},
                {L"Length", {}},
                {L"Bytes", {}}};
  for (const auto& step : kSteps)
    if (const HRESULT done = member(s, step.name, step.arguments); FAILED(done)) return done;
  return S_OK;
}

const Scenario kScenarios[] = {
    {"creation", makesAnother},
    {"sweep", sweeps},
    {"picture", paints},
    {"picture as data", givesItsPicture},
    {"connection", connects},
    {"request", asksTheHost},
    {"class",
     [](Subject& s) {
       ITypeInfo* info = nullptr;
       const HRESULT answer = s.at<IProvideClassInfo>()->GetClassInfo(&info);
       return released(answer, info);
     }},
    {"stream saved", [](Subject& s) { return s.at<IPersistStreamInit>()->Save(s.fromBegin(), TRUE); }},
    {"stream loaded", [](Subject& s) { return s.at<IPersistStreamInit>()->Load(s.fromBegin()); }},
    {"bag saved", [](Subject& s) { return s.at<IPersistPropertyBag>()->Save(&s.bag, TRUE, TRUE); }},
    {"bag loaded", [](Subject& s) { return s.at<IPersistPropertyBag>()->Load(&s.bag, &s.log); }},
    {"storage saved", [](Subject& s) { return s.at<IPersistStorage>()->Save(s.storage.get(), TRUE); }},
    {"storage loaded", [](Subject& s) { return s.at<IPersistStorage>()->Load(s.storage.get()); }},
    {"trace added",
     [](Subject& s) {
       return member(s, L"vfpOp", {0, 10, s.name == L"Tarvex" ? 14 : 10});
     },
     [](Subject& s) {
       member(s, L"vfpOp", {0, 11, s.name == L"Tarvex" ? 14 : 10});
     }},
    {"text set",
     [](Subject& s) {
       return member(s, L"vfpSet", {0, 314, 0, L"A caption with some length"});
     }},
    {"frequency set",
     [](Subject& s) {
       return member(s, L"vfpSet", {0, 13, 0, 881520000.0});
     }},
    {"average set",
     [](Subject& s) {
       return member(s, L"vfpSet", {0, 500, 0, 1});
     }},
    {"unknown code set",
     [](Subject& s) {
       return member(s, L"vfpSet", {0, 4000, 0, L"rubbish of some length"});
     }},
    {"shown",
     [](Subject& s) {
       return member(s, L"vfpOp", {0, 12});
     }},
    {"menu",
     [](Subject& s) {
       return member(s, L"PopUp_Click", {0, 900});
     }},
    {"marker", [](Subject& s) { return member(s, L"addMarker"); },
     [](Subject& s) { member(s, L"deleteMarker"); }},
    {"link",
     [](Subject& s) {
       return member(s, L"frontPanelLink", {3, 13, true, false, true});
     }},
    {"field",
     [](Subject& s) {
       Value field = call(*s.at<IDispatch>().get(), L"Constituent", {L"MarkerDeltaButton"});
       if (V_DISPATCH(&field.variant()) == nullptr) return E_OUTOFMEMORY;
       return byName(*V_DISPATCH(&field.variant()), L"Caption", {}, kCall);
     }},
    {"base",
     [](Subject& s) {
       Value base = call(*s.at<IDispatch>().get(), L"baseInstance");
       if (V_DISPATCH(&base.variant()) == nullptr) return E_OUTOFMEMORY;
       return byName(*V_DISPATCH(&base.variant()), L"Caption", {L"A text of the base"}, DISPATCH_PROPERTYPUT);
     }},
};
const Scenario kActiveScenarios[] = {
    {"deactivation", [](Subject& s) { return s.at<IOleInPlaceObject>()->InPlaceDeactivate(); },
     [](Subject& s) { s.activate(); }},
    {"close", [](Subject& s) { return s.at<IOleObject>()->Close(OLECLOSE_SAVEIFDIRTY); },
     [](Subject& s) { s.activate(); }},
    {"sweep on the screen", sweeps},
    {"paint",
     [](Subject& s) {
       InvalidateRect(s.window(), nullptr, TRUE);
       UpdateWindow(s.window());
       return IsWindow(s.window()) ? S_OK : E_UNEXPECTED;
     }},
    {"size",
     [](Subject& s) {
       static LONG widthPx = 300;
       const RECT place{0, 0, widthPx = 600 - widthPx, 250};
       return s.at<IOleInPlaceObject>()->SetObjectRects(&place, &place);
     }},
};

// Fails each allocation of a call in turn, once and from there on, until none is left that could fail.
class Failing {
 public:
  void run(
      const std::string& name, const std::function<HRESULT()>& act,
      const std::function<void()>& back = [] {}) {
    std::printf("# %s\n", name.c_str());  // where the program ends if something gets out
    std::fflush(stdout);
    const HRESULT usual = act();
    back();
    for (const int andOn : {0, 1}) {
      long n = 1;
      while (n > 0) n = failAt(name, n, andOn, usual, act, back);
    }
    ++calls_;
  }
  void judge(const std::string& what) const {
    expect(
        wrong_.empty() && calls_ > 0 && faults_ > 0,
        what + ": " + std::to_string(faults_) + " failures in " + std::to_string(calls_) + " calls" + wrong_);
  }

 private:
  // The next one to fail; 0 when all have.
  long failAt(const std::string& name, long n, int andOn, HRESULT usual, const std::function<HRESULT()>& act,
              const std::function<void()>& back) {
    library.failAllocation(n, andOn);
    const HRESULT answer = act();
    const bool failed = library.failAllocation(0, 0) > 0;
    back();
    const HRESULT again = act();
    back();
    faults_ += failed;
    if (answer != usual && answer != E_OUTOFMEMORY && answer != kOutOfMemoryError) note(name, n, answer);
    if (again != usual) note(name + ", afterwards", n, again);
    // Each of the first, then ever fewer: what comes late has the same kinds of neighbours.
    return failed ? n + 1 + n / 16 : 0;
  }
  void note(const std::string& name, long n, HRESULT answer) {
    char line[40];
    std::snprintf(line, sizeof line, " at %ld -> %08lx", n, static_cast<unsigned long>(answer));
    if (wrong_.size() < 2000) wrong_ += "; " + name + line;
  }

  int calls_ = 0;
  int faults_ = 0;
  std::string wrong_;
};

std::string narrow(const std::wstring& text) { return {text.begin(), text.end()}; }

void clearMessages() {
  ComPointer<IUnknown> diagnostics;
  make(L"Diagnostics", diagnostics);
  byName(*diagnostics.query<IDispatch>().get(), L"Clear", {}, kCall);
}

void allocationsOf(const std::wstring& name, HWND form) {
  Failing failing;
  Subject subject(name, form);
  const auto anew = [&] {
    if (name == L"ResultBuffer") member(subject, L"Clear");
  };
  onEachMember(subject, [&](const std::wstring& one, const std::function<HRESULT()>& call) {
    failing.run(narrow(one), call, anew);
  });
  if (name == L"ResultBuffer")
    failing.run(
        "buffer", [&] { return composes(subject); }, anew);
  if (!isPanel(name)) {
    failing.run(narrow(name) + ", creation", [&] { return makesAnother(subject); });
    return failing.judge("every member");
  }
  for (const Scenario& one : kScenarios)
    failing.run(
        one.name, [&] { return one.act(subject); }, [&] { one.back(subject); });
  failing.judge("every member and event");
  Failing active;
  active.run(
      "activation", [&] { return subject.activate(); }, [&] { deactivate(subject); });
  subject.activate();
  for (const Scenario& one : kActiveScenarios)
    active.run(
        one.name, [&] { return one.act(subject); }, [&] { one.back(subject); });
  active.judge("in its window");
}

// What a later one finds ready, the first one has to do without: a panel for each failure.
void goesWithoutMemory(const std::wstring& name, HWND form) {
  bool gone = true;
  long n = 0;
  for (bool failed = true; failed;) {
    Subject subject(name, form);
    subject.activate();
    const HWND window = subject.window();
    library.failAllocation(++n, 1);
    deactivate(subject);
    failed = library.failAllocation(0, 0) > 0;
    gone = gone && !IsWindow(window);
  }
  expect(gone, "its window goes: " + std::to_string(n - 1) + " failures");
}

// Once to warm up: what is made once for all stays.
void failAllocations(HWND form) {
  chapter("allocations");
  for (const auto& [name, info] : library.classes) {
    chapter(narrow(name) + ", allocations");
    for (const bool measured : {false, true}) {
      clearMessages();
      const long before = library.liveBlocks();
      if (measured) {
        allocationsOf(name, form);
        if (isPanel(name)) goesWithoutMemory(name, form);
      } else {
        Subject subject(name, form);
        for (const Scenario& one : kScenarios)
          if (isPanel(name)) one.act(subject), one.back(subject);
      }
      clearMessages();
      if (measured)
        expect(library.liveBlocks() == before,
               "nothing is kept: " + std::to_string(library.liveBlocks() - before) + " blocks");
    }
  }
}

// --- Barriers that fail

constexpr const char* kTells = "tells what is there";
constexpr const char* kDeclines = "is not offered";
constexpr const char* kSystems = "the system's own object does it";

// A method of an interface; `plain` is why one has no barrier.
struct Method {
  const char* name;
  HRESULT (*call)(Subject& s);
  const char* plain = nullptr;
};

template <class Interface, class... Parameters, class... Arguments>
HRESULT ask(Subject& s, HRESULT (STDMETHODCALLTYPE Interface::*method)(Parameters...),
            Arguments... arguments) {
  return (s.at<Interface>().get()->*method)(arguments...);
}

// A method without arguments, one that fills in a value, one that hands out an object.
template <auto Called>
HRESULT asks(Subject& s) {
  return ask(s, Called);
}
template <auto Called, class Value>
HRESULT tells(Subject& s) {
  Value value{};
  return ask(s, Called, &value);
}
template <auto Called, class Interface>
HRESULT hands(Subject& s) {
  Interface* object = nullptr;
  const HRESULT answer = ask(s, Called, &object);
  return released(answer, object);
}

// The first member of an object that is known by names alone.
HRESULT invokes(IDispatch& object) {
  DISPPARAMS none{};
  Value result;
  return object.Invoke(1, IID_NULL, LOCALE_USER_DEFAULT, kCall, &none, result.get(), nullptr, nullptr);
}

const Method kPanelMethods[] = {
    {"IOleObject::SetClientSite",
     [](Subject& s) { return ask(s, &IOleObject::SetClientSite, &s.container); }},
    {"IOleObject::GetClientSite", hands<&IOleObject::GetClientSite, IOleClientSite>, kTells},
    {"IOleObject::SetHostNames", [](Subject& s) { return ask(s, &IOleObject::SetHostNames, L"a", L"b"); },
     kTells},
    {"IOleObject::Close", [](Subject& s) { return ask(s, &IOleObject::Close, OLECLOSE_NOSAVE); }},
    {"IOleObject::SetMoniker", [](Subject& s) { return ask(s, &IOleObject::SetMoniker, 0, nullptr); },
     kDeclines},
    {"IOleObject::GetMoniker",
     [](Subject& s) {
       IMoniker* none = nullptr;
       return ask(s, &IOleObject::GetMoniker, 1, 1, &none);
     },
     kDeclines},
    {"IOleObject::InitFromData",
     [](Subject& s) { return ask(s, &IOleObject::InitFromData, nullptr, FALSE, 0); }, kDeclines},
    {"IOleObject::GetClipboardData",
     [](Subject& s) {
       IDataObject* data = nullptr;
       const HRESULT answer = ask(s, &IOleObject::GetClipboardData, 0, &data);
       return released(answer, data);
     },
     kDeclines},
    {"IOleObject::EnumVerbs", hands<&IOleObject::EnumVerbs, IEnumOLEVERB>, kTells},
    {"IOleObject::DoVerb", [](Subject& s) { return s.activate(); }},
    {"IOleObject::Update", asks<&IOleObject::Update>, kTells},
    {"IOleObject::IsUpToDate", asks<&IOleObject::IsUpToDate>, kTells},
    {"IOleObject::GetUserClassID", tells<&IOleObject::GetUserClassID, CLSID>, kTells},
    {"IOleObject::GetUserType",
     [](Subject& s) {
       LPOLESTR name = nullptr;
       const HRESULT answer = ask(s, &IOleObject::GetUserType, USERCLASSTYPE_FULL, &name);
       CoTaskMemFree(name);
       return answer;
     },
     kTells},
    {"IOleObject::SetExtent",
     [](Subject& s) {
       SIZEL size{5000, 4000};
       return ask(s, &IOleObject::SetExtent, DVASPECT_CONTENT, &size);
     }},
    {"IOleObject::GetExtent",
     [](Subject& s) {
       SIZEL size;
       return ask(s, &IOleObject::GetExtent, DVASPECT_CONTENT, &size);
     },
     kTells},
    {"IOleObject::Advise",
     [](Subject& s) {
       DWORD cookie = 0;
       return ask(s, &IOleObject::Advise, nullptr, &cookie);
     }},
    {"IOleObject::Unadvise", [](Subject& s) { return ask(s, &IOleObject::Unadvise, 9); }},
    {"IOleObject::EnumAdvise", hands<&IOleObject::EnumAdvise, IEnumSTATDATA>, kSystems},
    {"IOleObject::GetMiscStatus",
     [](Subject& s) {
       DWORD status;
       return ask(s, &IOleObject::GetMiscStatus, DVASPECT_CONTENT, &status);
     },
     kTells},
    {"IOleObject::SetColorScheme", [](Subject& s) { return ask(s, &IOleObject::SetColorScheme, nullptr); },
     kDeclines},
    {"IOleControl::GetControlInfo", tells<&IOleControl::GetControlInfo, CONTROLINFO>},
    {"IOleControl::OnMnemonic",
     [](Subject& s) {
       MSG key{nullptr, WM_SYSCHAR, 'x', 0, 0, {}};
       return ask(s, &IOleControl::OnMnemonic, &key);
     }},
    {"IOleControl::OnAmbientPropertyChange",
     [](Subject& s) { return ask(s, &IOleControl::OnAmbientPropertyChange, DISPID_UNKNOWN); }},
    {"IOleControl::FreezeEvents", [](Subject& s) { return ask(s, &IOleControl::FreezeEvents, FALSE); },
     kTells},
    {"IOleWindow::ContextSensitiveHelp",
     [](Subject& s) { return ask(s, &IOleWindow::ContextSensitiveHelp, FALSE); }, kDeclines},
    {"IOleInPlaceObject::GetWindow", [](Subject& s) { return s.window() != nullptr ? S_OK : S_FALSE; },
     kTells},
    {"IOleInPlaceObject::InPlaceDeactivate", asks<&IOleInPlaceObject::InPlaceDeactivate>},
    {"IOleInPlaceObject::UIDeactivate", asks<&IOleInPlaceObject::UIDeactivate>},
    {"IOleInPlaceObject::SetObjectRects",
     [](Subject& s) {
       const RECT place{0, 0, 310, 210};
       return ask(s, &IOleInPlaceObject::SetObjectRects, &place, &place);
     }},
    {"IOleInPlaceObject::ReactivateAndUndo", asks<&IOleInPlaceObject::ReactivateAndUndo>, kDeclines},
    {"IOleInPlaceActiveObject::TranslateAccelerator",
     [](Subject& s) {
       MSG key{s.window(), WM_KEYDOWN, VK_LEFT, 0, 0, {}};
       return s.at<IOleInPlaceActiveObject>()->TranslateAccelerator(&key);
     }},
    {"IOleInPlaceActiveObject::OnFrameWindowActivate",
     [](Subject& s) { return ask(s, &IOleInPlaceActiveObject::OnFrameWindowActivate, TRUE); }, kTells},
    {"IOleInPlaceActiveObject::OnDocWindowActivate",
     [](Subject& s) { return ask(s, &IOleInPlaceActiveObject::OnDocWindowActivate, TRUE); }, kTells},
    {"IOleInPlaceActiveObject::ResizeBorder",
     [](Subject& s) { return s.at<IOleInPlaceActiveObject>()->ResizeBorder(nullptr, nullptr, TRUE); },
     kTells},
    {"IOleInPlaceActiveObject::EnableModeless",
     [](Subject& s) { return ask(s, &IOleInPlaceActiveObject::EnableModeless, TRUE); }, kTells},
    {"IViewObject::Draw", paints},
    {"IViewObject::SetAdvise",
     [](Subject& s) { return ask(s, &IViewObject::SetAdvise, DVASPECT_CONTENT, 0, nullptr); }},
    {"IViewObject::GetColorSet",
     [](Subject& s) {
       LOGPALETTE* none = nullptr;
       return s.at<IViewObject>()->GetColorSet(DVASPECT_CONTENT, -1, nullptr, nullptr, nullptr, &none);
     },
     kDeclines},
    {"IViewObject::Freeze",
     [](Subject& s) { return s.at<IViewObject>()->Freeze(DVASPECT_CONTENT, -1, nullptr, nullptr); },
     kDeclines},
    {"IViewObject::Unfreeze", [](Subject& s) { return ask(s, &IViewObject::Unfreeze, 0); }, kDeclines},
    {"IViewObject::GetAdvise",
     [](Subject& s) { return ask(s, &IViewObject::GetAdvise, nullptr, nullptr, nullptr); }, kTells},
    {"IViewObject2::GetExtent",
     [](Subject& s) {
       SIZEL size;
       return ask(s, &IViewObject2::GetExtent, DVASPECT_CONTENT, -1, nullptr, &size);
     },
     kTells},
    {"IDataObject::GetData", givesItsPicture},
    {"IDataObject::GetDataHere",
     [](Subject& s) { return ask(s, &IDataObject::GetDataHere, nullptr, nullptr); }, kDeclines},
    {"IDataObject::QueryGetData", [](Subject& s) { return ask(s, &IDataObject::QueryGetData, &metafile); },
     kTells},
    {"IDataObject::GetCanonicalFormatEtc",
     [](Subject& s) {
       FORMATETC canonical;
       return ask(s, &IDataObject::GetCanonicalFormatEtc, &metafile, &canonical);
     },
     kTells},
    {"IDataObject::SetData",
     [](Subject& s) { return ask(s, &IDataObject::SetData, nullptr, nullptr, FALSE); }, kDeclines},
    {"IDataObject::EnumFormatEtc",
     [](Subject& s) {
       IEnumFORMATETC* formats = nullptr;
       const HRESULT answer = ask(s, &IDataObject::EnumFormatEtc, DATADIR_GET, &formats);
       return released(answer, formats);
     }},
    {"IDataObject::DAdvise",
     [](Subject& s) {
       DWORD cookie = 0;
       return ask(s, &IDataObject::DAdvise, &metafile, 0, nullptr, &cookie);
     }},
    {"IDataObject::DUnadvise", [](Subject& s) { return ask(s, &IDataObject::DUnadvise, 9); }},
    {"IDataObject::EnumDAdvise", hands<&IDataObject::EnumDAdvise, IEnumSTATDATA>, kSystems},
    {"IPersist::GetClassID", tells<&IPersist::GetClassID, CLSID>, kTells},
    {"IPersistStreamInit::IsDirty", asks<&IPersistStreamInit::IsDirty>, kTells},
    {"IPersistStreamInit::InitNew", asks<&IPersistStreamInit::InitNew>},
    {"IPersistStreamInit::Save",
     [](Subject& s) { return ask(s, &IPersistStreamInit::Save, s.fromBegin(), TRUE); }},
    {"IPersistStreamInit::Load", [](Subject& s) { return ask(s, &IPersistStreamInit::Load, s.fromBegin()); }},
    {"IPersistStreamInit::GetSizeMax", tells<&IPersistStreamInit::GetSizeMax, ULARGE_INTEGER>},
    {"IPersistPropertyBag::InitNew", asks<&IPersistPropertyBag::InitNew>},
    {"IPersistPropertyBag::Save",
     [](Subject& s) { return ask(s, &IPersistPropertyBag::Save, &s.bag, TRUE, TRUE); }},
    {"IPersistPropertyBag::Load",
     [](Subject& s) { return ask(s, &IPersistPropertyBag::Load, &s.bag, &s.log); }},
    {"IPersistStorage::InitNew",
     [](Subject& s) { return ask(s, &IPersistStorage::InitNew, s.storage.get()); }},
    {"IPersistStorage::Save",
     [](Subject& s) { return ask(s, &IPersistStorage::Save, s.storage.get(), TRUE); }},
    {"IPersistStorage::SaveCompleted",
     [](Subject& s) { return ask(s, &IPersistStorage::SaveCompleted, nullptr); }, kTells},
    {"IPersistStorage::HandsOffStorage", asks<&IPersistStorage::HandsOffStorage>, kTells},
    {"IPersistStorage::Load", [](Subject& s) { return ask(s, &IPersistStorage::Load, s.storage.get()); }},
    {"IConnectionPointContainer::EnumConnectionPoints",
     hands<&IConnectionPointContainer::EnumConnectionPoints, IEnumConnectionPoints>},
    {"IConnectionPointContainer::FindConnectionPoint", [](Subject& s) { return s.point() ? S_OK : E_FAIL; },
     kTells},
    {"IConnectionPoint::GetConnectionInterface",
     [](Subject& s) {
       IID id;
       return s.point()->GetConnectionInterface(&id);
     },
     kTells},
    {"IConnectionPoint::Advise",
     [](Subject& s) {
       DWORD cookie = 0;
       const HRESULT answer = s.point()->Advise(&s.changes, &cookie);
       s.point()->Unadvise(cookie);
       return answer;
     }},
    {"IConnectionPoint::Unadvise", [](Subject& s) { return s.point()->Unadvise(99); }, kTells},
    {"IConnectionPoint::EnumConnections",
     [](Subject& s) {
       IEnumConnections* all = nullptr;
       const HRESULT answer = s.point()->EnumConnections(&all);
       return released(answer, all);
     }},
    {"IConnectionPoint::GetConnectionPointContainer",
     [](Subject& s) {
       IConnectionPointContainer* container = nullptr;
       const HRESULT answer = s.point()->GetConnectionPointContainer(&container);
       return released(answer, container);
     },
     kTells},
    {"IEnumConnections::Next",
     [](Subject& s) {
       CONNECTDATA none{};
       return s.connections->Next(1, &none, nullptr);
     },
     kTells},
    {"IEnumConnections::Skip", [](Subject& s) { return s.connections->Skip(1); }, kTells},
    {"IEnumConnections::Reset", [](Subject& s) { return s.connections->Reset(); }, kTells},
    {"a field, IDispatch::Invoke", [](Subject& s) { return invokes(*s.field.get()); }},
    {"a field, IDispatch::GetIDsOfNames",
     [](Subject& s) { return memberOf(*s.field.get(), L"Text") > 0 ? S_OK : E_FAIL; }, kTells},
    {"the base, IDispatch::Invoke", [](Subject& s) { return invokes(*s.base.get()); }},
    {"IEnumConnections::Clone",
     [](Subject& s) {
       IEnumConnections* copy = nullptr;
       const HRESULT answer = s.connections->Clone(&copy);
       return released(answer, copy);
     }},
    {"IProvideClassInfo::GetClassInfo", hands<&IProvideClassInfo::GetClassInfo, ITypeInfo>},
    {"IProvideClassInfo2::GetGUID",
     [](Subject& s) {
       GUID id;
       return ask(s, &IProvideClassInfo2::GetGUID, GUIDKIND_DEFAULT_SOURCE_DISP_IID, &id);
     },
     kTells},
};

// Of every class.
const Method kMethods[] = {
    {"IDispatch::GetTypeInfoCount",
     [](Subject& s) {
       UINT count;
       return ask(s, &IDispatch::GetTypeInfoCount, &count);
     },
     kTells},
    {"IDispatch::GetTypeInfo",
     [](Subject& s) {
       ITypeInfo* info = nullptr;
       const HRESULT answer = s.at<IDispatch>()->GetTypeInfo(0, LOCALE_USER_DEFAULT, &info);
       return released(answer, info);
     }},
    {"IDispatch::GetIDsOfNames",
     [](Subject& s) {
       wchar_t name[] = L"Clear";
       LPOLESTR names[] = {name};
       DISPID id;
       return s.at<IDispatch>()->GetIDsOfNames(IID_NULL, names, 1, LOCALE_USER_DEFAULT, &id);
     }},
    {"IDispatch::Invoke",
     [](Subject& s) {
       DISPPARAMS none{};
       Value result;
       return s.at<IDispatch>()->Invoke(DISPID_CAPTION, IID_NULL, LOCALE_USER_DEFAULT, kCall, &none,
                                        result.get(), nullptr, nullptr);
     }},
    {"ISupportErrorInfo::InterfaceSupportsErrorInfo",
     [](Subject& s) { return s.at<ISupportErrorInfo>()->InterfaceSupportsErrorInfo(IID_IDispatch); }, kTells},
    {"IClassFactory::CreateInstance",
     [](Subject& s) {
       ComPointer<IUnknown> another;
       return s.factory->CreateInstance(nullptr, IID_IUnknown, reinterpret_cast<void**>(another.receive()));
     }},
    {"IClassFactory::LockServer",
     [](Subject& s) { return s.factory->LockServer(TRUE), s.factory->LockServer(FALSE); }, kTells},
    {"DllGetClassObject",
     [](Subject& s) {
       ComPointer<IClassFactory> factory;
       return library.classObject(idOf(s.name), IID_IClassFactory,
                                  reinterpret_cast<void**>(factory.receive()));
     }},
};

// Numbers that are read or written, and nothing else; what cannot fail.
const std::set<std::wstring> kPlainMembers = {L"Diagnostics.SilenceAssert (get)",
                                              L"Diagnostics.SilenceAssert (put)",
                                              L"Diagnostics.ShowMessages (get)",
                                              L"Diagnostics.ShowMessages (put)",
                                              L"Diagnostics.Count (get)",
                                              L"Diagnostics.Clear",
                                              L"clsCellNameInfo.maxCellNameLength (get)",
                                              L"clsCellNameInfo.maxCellNameLength (put)",
                                              L"clsCellNameInfo.Initialize"};

std::wstring errorText() {
  ComPointer<IErrorInfo> info;
  BSTR text = nullptr;
  if (GetErrorInfo(0, info.receive()) != S_OK) return L"";
  info->GetDescription(&text);
  Value owned;
  V_VT(owned.get()) = VT_BSTR;
  V_BSTR(owned.get()) = text;
  return owned.text();
}

// What a barrier makes of each kind of fault, from 1 on.
constexpr HRESULT kAnswers[] = {S_OK, static_cast<HRESULT>(0x800A0005), E_OUTOFMEMORY, E_FAIL};
constexpr int kKinds[] = {1, 2, 3};
constexpr long kDeepest = 12;  // barriers within each other, or one after the other

class Barriers {
 public:
  void run(const std::string& name, bool plain, const std::function<HRESULT()>& act) {
    std::printf("# %s\n", name.c_str());
    std::fflush(stdout);
    ++calls_;
    for (const int kind : kKinds) {
      for (long after = 0; after < kDeepest; ++after) {
        SetErrorInfo(0, nullptr);
        library.failBarrier(kind, after);
        const HRESULT answer = act();
        const bool failed = library.failBarrier(0, 0) > 0;
        const bool told = kind != 1 || errorText() == kFaultText;
        if (after == 0 && (plain ? failed : !failed || answer != kAnswers[kind] || !told))
          note(name, kind, answer);
        if (!failed) break;
      }
    }
  }
  void judge(const std::string& what) const {
    expect(wrong_.empty() && calls_ > 0, what + ": " + std::to_string(calls_) + " calls" + wrong_);
  }

 private:
  void note(const std::string& name, int kind, HRESULT answer) {
    char line[40];
    std::snprintf(line, sizeof line, " (%d) -> %08lx", kind, static_cast<unsigned long>(answer));
    wrong_ += "; " + name + line;
  }

  int calls_ = 0;
  std::string wrong_;
};

void failMethods(HWND form) {
  for (const auto& [name, info] : library.classes) {
    chapter(narrow(name) + ", barriers");
    Barriers barriers;
    Subject subject(name, form);
    const auto run = [&](const Method& one) {
      barriers.run(one.name, one.plain != nullptr, [&] { return one.call(subject); });
    };
    for (const Method& one : kMethods) run(one);
    if (isPanel(name))
      for (const Method& one : kPanelMethods) run(one);
    barriers.judge("every interface");
    Barriers members;
    onEachMember(subject, [&](const std::wstring& one, const std::function<HRESULT()>& call) {
      members.run(narrow(one), kPlainMembers.count(one) != 0, call);
    });
    members.judge("every member");
  }
  clearMessages();
}

struct Message {
  UINT message;
  WPARAM wide = 0;
  LPARAM extra = 0;
};
constexpr Message kMessages[] = {{WM_PAINT},
                                 {WM_SIZE, SIZE_RESTORED, MAKELPARAM(280, 180)},
                                 {WM_KEYDOWN, VK_LEFT},
                                 {WM_KEYDOWN, VK_TAB},
                                 {WM_KEYDOWN, VK_RETURN},
                                 {WM_CHAR, L'7'},
                                 {WM_SYSCHAR, L'x'},
                                 {WM_SETFOCUS},
                                 {WM_KILLFOCUS},
                                 {WM_LBUTTONDOWN, MK_LBUTTON, MAKELPARAM(40, 40)},
                                 {WM_MOUSEMOVE, MK_LBUTTON, MAKELPARAM(60, 50)},
                                 {WM_LBUTTONUP, 0, MAKELPARAM(60, 50)},
                                 {WM_MOUSEACTIVATE, 0, MAKELPARAM(HTCLIENT, WM_LBUTTONDOWN)},
                                 {WM_SETCURSOR, 0, HTCLIENT},
                                 {WM_GETDLGCODE}};

// The window itself and a field of each kind that a user types into.
std::vector<HWND> windowsToFail(HWND panel) {
  std::vector<HWND> windows{panel};
  for (const wchar_t* const kind : {L"EDIT", L"COMBOBOX", L"BUTTON"})
    for (const HWND one : windowsOf(panel, kind)) {
      windows.push_back(one);
      break;
    }
  return windows;
}

void failMessages(HWND form) {
  for (const wchar_t* const name : {L"SpectrumView", L"Tarvex"}) {
    chapter(narrow(name) + ", window procedure");
    Subject subject(name, form);
    subject.activate();
    const HDC screen = GetDC(nullptr);
    const HDC dc = CreateCompatibleDC(screen);
    int failed = 0;
    bool valid = true;
    const auto send = [&](HWND window, const Message& one, int kind, long after) {
      if (one.message == WM_PAINT) InvalidateRect(window, nullptr, TRUE);
      library.failBarrier(kind, after);
      SendMessageW(window, one.message,
                   one.message == WM_PRINTCLIENT ? reinterpret_cast<WPARAM>(dc) : one.wide, one.extra);
      const bool reached = library.failBarrier(0, 0) > 0;
      failed += reached;
      valid = valid && IsWindow(window) && IsWindow(subject.window());
      return reached;
    };
    std::vector<Message> all(std::begin(kMessages), std::end(kMessages));
    all.push_back({WM_PRINTCLIENT, 0, PRF_CLIENT});
    for (const HWND window : windowsToFail(subject.window()))
      for (const Message& one : all)
        for (const int kind : kKinds)
          for (long after = 0; after < kDeepest && send(window, one, kind, after);) ++after;
    DeleteDC(dc);
    ReleaseDC(nullptr, screen);
    ReleaseCapture();
    expect(valid && failed > 100,
           "nothing gets out, and the windows stay: " + std::to_string(failed) + " failures");
    sweeps(subject);
    InvalidateRect(subject.window(), nullptr, TRUE);
    pumpMessages();
    const HDC shown = GetDC(subject.window());
    RECT area{};
    GetClientRect(subject.window(), &area);
    expect(pixelsOf(shown, area, kTraceColor) > 0, "and show a sweep afterwards");
    ReleaseDC(subject.window(), shown);
  }
  clearMessages();
}

}  // namespace

int check(const wchar_t* file) {
  OleInitialize(nullptr);
  chapter("faults");
  if (load(file)) {
    ComPointer<IUnknown> diagnostics;
    make(L"Diagnostics", diagnostics);
    put(*diagnostics.query<IDispatch>().get(), L"ShowMessages", false);
    const HWND form = CreateWindowExW(0, L"STATIC", L"", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 0, 0, 400, 300,
                                      nullptr, nullptr, nullptr, nullptr);
    failMethods(form);
    failMessages(form);
    failAllocations(form);
    DestroyWindow(form);
    diagnostics.reset();
    chapter("faults");
    expect(library.canUnload() == S_OK, "the library may go");
  } else {
    expect(false, "the library loads");
  }
  return verdict();
}

}  // namespace frontpanels::testing

int wmain(int count, wchar_t** arguments) {
  return count == 2 ? frontpanels::testing::check(arguments[1]) : 2;
}

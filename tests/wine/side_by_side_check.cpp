// A host with the library beside it as a side-by-side assembly, on a machine where nothing is registered.
// Prints a line a check, at the end "N passed, N failed".
#include <windows.h>

#include <ocidl.h>

#include <atomic>
#include <string>
#include <thread>

#include "frontpanels_h.h"
#include "tests/wine/com_client.h"
#include "tests/wine/full_container.h"

namespace frontpanels::testing {
namespace {

constexpr DWORD kInsideOutControl = 131473;

struct ClassRow {
  const char* name;
  CLSID id;
  IID members;
  bool control = false;
};
const ClassRow kClasses[] = {{"SpectrumView", __uuidof(SpectrumView), __uuidof(ISpectrumView), true},
                             {"DataHub", __uuidof(DataHub), __uuidof(IDataHub)},
                             {"Diagnostics", __uuidof(Diagnostics), __uuidof(IDiagnostics)},
                             {"ResultBuffer", __uuidof(ResultBuffer), __uuidof(IResultBuffer)},
                             {"clsCellNameInfo", __uuidof(clsCellNameInfo), __uuidof(IclsCellNameInfo)},
                             {"Tarvex", __uuidof(Tarvex), __uuidof(ITarvex), true}};

void isNotRegistered(const ClassRow& row) {
  HKEY key = nullptr;
  const std::string progId = std::string("FrontPanels.") + row.name;
  expect(RegOpenKeyA(HKEY_CLASSES_ROOT, progId.c_str(), &key) == ERROR_FILE_NOT_FOUND, "is not registered");
}

// The interface that an object answers late-bound calls with.
IID membersOf(const ComPointer<IDispatch>& object) {
  ComPointer<ITypeInfo> members;
  TYPEATTR* attributes = nullptr;
  if (!object || FAILED(object->GetTypeInfo(0, 0, members.receive())) ||
      FAILED(members->GetTypeAttr(&attributes)))
    return IID_NULL;
  const IID id = attributes->guid;
  members->ReleaseTypeAttr(attributes);
  return id;
}

// A ProgID of an assembly gives a CLSID of the system's making, so what is created tells whether it is the
// right one.
void isFound(const ClassRow& row) {
  const std::string name = row.name;
  const std::wstring progId = L"FrontPanels." + std::wstring(name.begin(), name.end());
  ComPointer<IDispatch> object;
  CoCreateInstance(row.id, nullptr, CLSCTX_INPROC_SERVER, IID_IDispatch,
                   reinterpret_cast<void**>(object.receive()));
  expect(membersOf(object) == row.members, "is created by its CLSID");
  expect(membersOf(create<IDispatch>(progId.c_str())) == row.members, "by its ProgID");
  expect(membersOf(create<IDispatch>((progId + L".1").c_str())) == row.members,
         "and by that with its version");
  DWORD status = 0;
  OleRegGetMiscStatus(row.id, DVASPECT_CONTENT, &status);
  expect(status == (row.control ? kInsideOutControl : 0), "has the status bits of its kind");
}

void worksOnAForm(HWND window) {
  Sited hosted(window);
  expect(hosted.call(L"vfpOp", {0, 12}).number() == 0, "answers a member by its name");
  hosted.container.place = {0, 0, 640, 480};
  expect(hosted.verb(OLEIVERB_INPLACEACTIVATE) == S_OK, "is activated on a form");
  hosted.call(L"vfpOp", {0, 10, panelKind().resultType});
  publish(carrier());
  pumpMessages();
  const HWND view = hosted.window();
  const HDC dc = GetDC(view);
  expect(view != nullptr && pixelsOf(dc, {0, 0, 640, 480}, kTraceColor) > 320, "and shows what is published");
  ReleaseDC(view, dc);
}

// A call from another apartment goes through what the assembly says of the interface.
void isCalledFromAnotherApartment() {
  publish(carrier());
  const auto hub = create<IDataHub>(L"FrontPanels.DataHub");
  ComPointer<IStream> parcel;
  CoMarshalInterThreadInterfaceInStream(__uuidof(IDataHub), hub.get(), parcel.receive());
  LONG items = 0;
  std::atomic<bool> done = false;
  std::thread other([&] {
    CoInitializeEx(nullptr, COINIT_MULTITHREADED);
    ComPointer<IDataHub> remote;
    if (parcel)
      CoUnmarshalInterface(parcel.get(), __uuidof(IDataHub), reinterpret_cast<void**>(remote.receive()));
    const BSTR path = SysAllocString(panelKind().path);
    if (remote) remote->ItemCount(path, &items);
    SysFreeString(path);
    remote.reset();
    CoUninitialize();
    done = true;
  });
  while (!done) pumpMessages();
  other.join();
  expect(items == 513, "a hub is called from another apartment");
}

}  // namespace

int check() {
  return runChecks({800, 700}, [](const Desk& desk) {
    for (const ClassRow& row : kClasses) {
      chapter(std::string("side by side, ") + row.name);
      isNotRegistered(row);
      isFound(row);
    }
    onEachPanel([&desk] {
      chapter("side by side");
      worksOnAForm(desk.window);
    });
    chapter("side by side");
    isCalledFromAnotherApartment();
  });
}

}  // namespace frontpanels::testing

int main() { return frontpanels::testing::check(); }

// A thousand lives of the panels: what one of them leaves behind, however little, shows in a thousand. Prints
// a line a check, at the end "N passed, N failed".
#include <windows.h>

#include <ocidl.h>
#include <olectl.h>

#include <cstdio>
#include <iterator>
#include <string>
#include <vector>

#include "tests/wine/com_client.h"
#include "tests/wine/full_container.h"
#include "tests/wine/holdings.h"

namespace frontpanels::testing {
namespace {

constexpr int kWarmUp = 200;  // lives until everything has found its place
constexpr int kLives = 1000;

std::string text(const Holdings& held) {
  char line[120];
  std::snprintf(line, sizeof line, "%d windows, %d graphics objects, %lld blocks, %lld bytes", held.windows,
                held.graphicsObjects, static_cast<long long>(held.heapBlocks),
                static_cast<long long>(held.heapBytes));
  return line;
}

// How a life ends, and in the middle of what.
enum class End { Closed, Released, InAnEvent, InASweep };
constexpr End kEnds[] = {End::Closed, End::Closed, End::InAnEvent, End::Closed, End::Released, End::InASweep};

// False when the host's side is still held after it.
bool live(HWND form, const std::vector<float>& sweep, End end) {
  EventSink sink;
  ChangeSink changes;
  FullContainer container(form);
  container.place = {0, 0, 300, 200};
  {
    Hosted hosted;
    hosted.object->SetClientSite(&container);
    hosted.advise(sink);
    DWORD cookie = 0;
    pointOf(*hosted.members.get(), IID_IPropertyNotifySink)->Advise(&changes, &cookie);
    hosted.verb(OLEIVERB_UIACTIVATE);
    publish(sweep);
    put(*hosted.members.get(), L"DisplayPanelVisible", false);
    pumpMessages();
    sink.during = [&] {
      if (end == End::InASweep) publish(sweep);
      if (end == End::InASweep || end == End::InAnEvent) hosted.close();
    };
    const ComPointer<IDispatch> members = hosted.members;
    call(*members.get(), L"closeVfp");
    if (end == End::Released) hosted.release();
    if (end == End::Closed) hosted.inPlace->InPlaceDeactivate();
  }
  return container.references == 1 && sink.references == 1 && changes.references == 1 &&
         changes.changed.size() == 1 && container.count("OnInPlaceDeactivate") == 1;
}

// Each kind of thing that could be left is seen when it is.
void seesWhatIsLeft(HWND form) {
  chapter("measure");
  const Holdings before = holdings();
  const HPEN pen = CreatePen(PS_SOLID, 1, RGB(1, 2, 3));
  expect((holdings() - before).graphicsObjects == 1, "sees a pen");
  DeleteObject(pen);
  const HWND window =
      CreateWindowExW(0, L"STATIC", L"", WS_CHILD, 0, 0, 9, 9, form, nullptr, nullptr, nullptr);
  expect((holdings() - before).windows == 1, "sees a window within a window");
  DestroyWindow(window);
  void* const block = HeapAlloc(GetProcessHeap(), 0, 5);
  const Holdings held = holdings() - before;
  expect(held.heapBlocks >= 1 && held.heapBytes >= 5, "sees a byte");
  HeapFree(GetProcessHeap(), 0, block);
}

void livesAThousandTimes(const Desk& desk) {
  const std::vector<float> sweep = carrier();
  Holdings warm;
  bool clean = true;
  for (int i = 0; i < kLives / 2; ++i) {  // one of each panel
    if (i == kWarmUp / 2) warm = holdings();
    onEachPanel([&] { clean = live(desk.window, sweep, kEnds[i % std::size(kEnds)]) && clean; });
    call(desk.diagnostics, L"Clear");  // what closing in the middle reports
  }
  const Holdings grown = holdings() - warm;
  chapter("lives");
  expect(clean, "no life keeps its site or its sinks");
  expect(GetWindow(desk.window, GW_CHILD) == nullptr && grown.windows == 0, "nor a window: " + text(grown));
  expect(grown.graphicsObjects == 0, "nor a graphics object");
  expect(grown.heapBlocks <= 0 && grown.heapBytes <= 0, "nor a byte");
}

using CanUnload = HRESULT(WINAPI*)();

void isUnloaded() {
  const HMODULE library = GetModuleHandleW(L"frontpanels.ocx");
  const auto canUnload =
      reinterpret_cast<CanUnload>(reinterpret_cast<void*>(GetProcAddress(library, "DllCanUnloadNow")));
  expect(canUnload != nullptr && canUnload() == S_OK, "the library may go");
  CoFreeUnusedLibrariesEx(0, 0);
  expect(GetModuleHandleW(L"frontpanels.ocx") == nullptr, "and goes");
}

}  // namespace

int check() {
  const auto checks = [](const Desk& desk) {
    seesWhatIsLeft(desk.window);
    livesAThousandTimes(desk);
  };
  return runChecks({400, 300}, checks, isUnloaded);
}

}  // namespace frontpanels::testing

int main() { return frontpanels::testing::check(); }

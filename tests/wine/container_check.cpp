// The life of the registered control on a form: created, sited, fed, looked at on the screen, stored, let go
// of. Prints a line a check, at the end "N passed, N failed".
#include <windows.h>

#include <ocidl.h>
#include <olectl.h>

#include <algorithm>
#include <cstdint>
#include <vector>

#include "tests/wine/com_client.h"
#include "tests/wine/full_container.h"

namespace frontpanels::testing {
namespace {

constexpr SIZE kSizePx{640, 480};
constexpr int kDotsPerInch = 96;

void activate(Sited& hosted) {
  hosted.container.place = {0, 0, kSizePx.cx, kSizePx.cy};
  hosted.object.query<IPersistStreamInit>()->InitNew();
  SIZEL extent{1000, 1000};
  hosted.object->SetExtent(DVASPECT_CONTENT, &extent);
  hosted.verb(OLEIVERB_INPLACEACTIVATE);
}

int tracePixelsOf(HWND window) {
  const HDC dc = GetDC(window);
  const int pixels = pixelsOf(dc, {0, 0, kSizePx.cx, kSizePx.cy}, kTraceColor);
  ReleaseDC(window, dc);
  return pixels;
}

void showsASweep(HWND window) {
  Sited hosted(window);
  FullContainer& container = hosted.container;
  activate(hosted);
  DWORD status = 0;
  hosted.object->GetMiscStatus(DVASPECT_CONTENT, &status);
  expect(status == 131473, "its status bits are those of an inside-out control");
  const HWND view = hosted.window();
  expect(container.count("OnInPlaceActivate") == 1 && view != nullptr && GetParent(view) == window,
         "it is a child of the container");
  SIZEL extent{};
  hosted.object->GetExtent(DVASPECT_CONTENT, &extent);
  expect(MulDiv(extent.cx, kDotsPerInch, 2540) == kSizePx.cx,
         "its extent follows the place it was given, not a stale one");
  pumpMessages();
  expect(tracePixelsOf(view) == 0, "no trace before a sweep");
  publish(carrier());
  pumpMessages();
  expect(tracePixelsOf(view) > kSizePx.cx / 2, "a published sweep is on the screen at once");
  InvalidateRect(view, nullptr, TRUE);
  pumpMessages();
  expect(tracePixelsOf(view) > kSizePx.cx / 2, "and again after the window system asked for a paint");
  const RECT larger{0, 0, kSizePx.cx, kSizePx.cy + 100};
  hosted.inPlace->SetObjectRects(&larger, &larger);
  pumpMessages();
  RECT client{};
  GetClientRect(view, &client);
  expect(client.bottom == kSizePx.cy + 100 && tracePixelsOf(view) > 0, "it fills a larger place");
  hosted.close();
  expect(container.count("OnInPlaceDeactivate") == 1 && !IsWindow(view), "closing takes its window away");
  expect(container.references == 1, "no reference to the site is left");
}

void drawsWithoutAWindow() {
  Hosted hosted;
  publish(carrier());
  const auto view = hosted.object.query<IViewObject2>();
  const HDC screen = GetDC(nullptr);
  const HDC dc = CreateCompatibleDC(screen);
  const HBITMAP bitmap = CreateCompatibleBitmap(screen, kSizePx.cx, kSizePx.cy);
  HGDIOBJ const previous = SelectObject(dc, bitmap);
  const RECTL bounds{0, 0, kSizePx.cx, kSizePx.cy};
  const auto draw = [&](DWORD aspect) {
    return view->Draw(aspect, -1, nullptr, nullptr, nullptr, dc, &bounds, nullptr, nullptr, 0);
  };
  expect(draw(DVASPECT_CONTENT) == S_OK, "an inactive control draws itself");
  expect(pixelsOf(dc, {0, 0, kSizePx.cx, kSizePx.cy}, kTraceColor) > kSizePx.cx / 2, "with its trace");
  expect(draw(DVASPECT_ICON) == DV_E_DVASPECT, "but no other aspect of it");
  SelectObject(dc, previous);
  DeleteObject(bitmap);
  DeleteDC(dc);
  ReleaseDC(nullptr, screen);
}

void keepsItsPropertiesInAStream() {
  Hosted stored;
  const auto saving = stored.object.query<IPersistStreamInit>();
  SIZEL extent{5000, 4000};
  stored.object->SetExtent(DVASPECT_CONTENT, &extent);
  expect(saving->IsDirty() == S_OK, "a new extent makes it dirty");
  ComPointer<IStream> stream;
  CreateStreamOnHGlobal(nullptr, TRUE, stream.receive());
  expect(saving->Save(stream.get(), TRUE) == S_OK && saving->IsDirty() == S_FALSE, "saving makes it clean");
  Hosted other;
  const auto loading = other.object.query<IPersistStreamInit>();
  stream->Seek({}, STREAM_SEEK_SET, nullptr);
  SIZEL back{};
  expect(loading->Load(stream.get()) == S_OK, "what was saved loads");
  other.object->GetExtent(DVASPECT_CONTENT, &back);
  expect(back.cx == 5000 && back.cy == 4000, "with the extent to the unit");
  stream->Seek({}, STREAM_SEEK_SET, nullptr);
  stream->SetSize({{17, 0}});
  put(*other.members.get(), L"DisplayPanelVisible", false);
  expect(FAILED(loading->Load(stream.get())), "a stream that ends early is refused");
  expect(call(*other.members.get(), L"DisplayPanelVisible").number() == 0, "and changes nothing");
  const auto diagnostics = create<IDispatch>(L"FrontPanels.Diagnostics");
  expect(call(*diagnostics.get(), L"Message", {0}).text() == L"UserControl_ReadProperties()\r",
         "and reported");
  call(*diagnostics.get(), L"Clear");
}

void isPartOfAnAggregate() {
  struct Outer final : Counted<IUnknown> {
    void* find(REFIID id) override { return id == IID_IUnknown ? this : nullptr; }
  } outer;
  const CLSID id = classOf(panelClass().c_str());
  ComPointer<IDispatch> refused;
  expect(CoCreateInstance(id, &outer, CLSCTX_INPROC_SERVER, IID_IDispatch,
                          reinterpret_cast<void**>(refused.receive())) == CLASS_E_NOAGGREGATION,
         "an outer object may ask for the inner identity only");
  ComPointer<IUnknown> inner;
  CoCreateInstance(id, &outer, CLSCTX_INPROC_SERVER, IID_IUnknown, reinterpret_cast<void**>(inner.receive()));
  const auto identity = inner.query<IOleObject>().query<IUnknown>();
  expect(identity.get() == &outer, "its parts show the outer identity");
}

// The registry names the library and the number of a picture in it, as designers show controls.
void isPicturedInToolboxes() {
  LPOLESTR id = nullptr;
  StringFromCLSID(classOf(panelClass().c_str()), &id);
  const std::wstring key = std::wstring(L"CLSID\\") + id + L"\\ToolboxBitmap32";
  CoTaskMemFree(id);
  wchar_t text[MAX_PATH] = L"";
  LONG bytes = sizeof text;
  RegQueryValueW(HKEY_CLASSES_ROOT, key.c_str(), text, &bytes);
  const std::wstring place = text;
  const std::size_t comma = place.rfind(L',');
  const HMODULE library = GetModuleHandleW(place.substr(0, comma).c_str());
  BITMAP size{};
  if (comma != std::wstring::npos && library != nullptr) {
    HGDIOBJ const picture = LoadBitmapW(library, MAKEINTRESOURCEW(std::stoi(place.substr(comma + 1))));
    GetObjectW(picture, sizeof size, &size);
    DeleteObject(picture);
  }
  expect(size.bmWidth == 16 && size.bmHeight == 15, "it has its picture for the toolboxes of designers");
}

// The graphics interface gives out the lowest free handle: the highest of many new pens grows with what is
// left.
std::uintptr_t highestHandle() {
  std::vector<HGDIOBJ> pens;
  for (int i = 0; i < 64; ++i) pens.push_back(CreatePen(PS_SOLID, 1, RGB(i, 0, 0)));
  std::uintptr_t highest = 0;
  for (HGDIOBJ const pen : pens) {
    highest = std::max(highest, reinterpret_cast<std::uintptr_t>(pen) & 0xFFFF);
    DeleteObject(pen);
  }
  return highest;
}

void leavesNothingBehind(HWND window) {
  constexpr int kCycles = 50;
  const auto cycle = [window] {
    Sited hosted(window);
    activate(hosted);
    publish(carrier());
    pumpMessages();
    hosted.close();
    return hosted.container.references == 1 && hosted.container.count("OnInPlaceDeactivate") == 1;
  };
  bool clean = cycle();
  const DWORD gdiBefore = GetGuiResources(GetCurrentProcess(), GR_GDIOBJECTS);
  const DWORD userBefore = GetGuiResources(GetCurrentProcess(), GR_USEROBJECTS);
  const std::uintptr_t before = highestHandle();
  for (int i = 0; i < kCycles; ++i) clean = cycle() && clean;
  expect(clean, "fifty cycles of create, activate, feed, close leave no reference to the site");
  expect(highestHandle() <= before + 8, "and no graphics object");
  expect(GetGuiResources(GetCurrentProcess(), GR_GDIOBJECTS) <= gdiBefore + 2 &&
             GetGuiResources(GetCurrentProcess(), GR_USEROBJECTS) <= userBefore + 2,
         "nor any that the system counts");
}

}  // namespace

int check() {
  chapter("container");
  const auto checks = [](const Desk& desk) {
    onEachPanel([&desk] {
      chapter("container");
      showsASweep(desk.window);
      drawsWithoutAWindow();
      keepsItsPropertiesInAStream();
      isPartOfAnAggregate();
      isPicturedInToolboxes();
      leavesNothingBehind(desk.window);
    });
  };
  return runChecks({800, 700}, checks, [] {
    CoFreeUnusedLibrariesEx(0, 0);
    expect(GetModuleHandleW(L"frontpanels.ocx") == nullptr,
           "the library is unloaded once nothing of it is in use");
  });
}

}  // namespace frontpanels::testing

int main() { return frontpanels::testing::check(); }

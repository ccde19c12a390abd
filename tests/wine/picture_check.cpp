// The pictures of the registered controls: on screens, in metafiles of both kinds and at other scales, for
// containers that draw them by themselves; and the places that a panel asks its container for. Prints a line
// a check, at the end "N passed, N failed". Leaves pictures in the folder that it is given.
#include <windows.h>

#include <ocidl.h>
#include <olectl.h>

#include <functional>
#include <map>
#include <string>
#include <vector>

#include "tests/wine/com_client.h"
#include "tests/wine/full_container.h"
#include "workbench/window_picture.h"

namespace frontpanels::testing {
namespace {

constexpr SIZE kViewPx{1000, 700};  // room for all the fields
std::string pictures;               // the folder

// A context in memory, white at first.
class Canvas {
 public:
  explicit Canvas(SIZE size) : size_(size), dc_(CreateCompatibleDC(nullptr)) {
    const HDC screen = GetDC(nullptr);
    bitmap_ = CreateCompatibleBitmap(screen, size.cx, size.cy);
    ReleaseDC(nullptr, screen);
    previous_ = SelectObject(dc_, bitmap_);
    PatBlt(dc_, 0, 0, size.cx, size.cy, WHITENESS);
  }
  ~Canvas() {
    SelectObject(dc_, previous_);
    DeleteObject(bitmap_);
    DeleteDC(dc_);
  }
  Canvas(const Canvas&) = delete;
  Canvas& operator=(const Canvas&) = delete;

  [[nodiscard]] HDC dc() const { return dc_; }
  [[nodiscard]] RECT area() const { return {0, 0, size_.cx, size_.cy}; }
  [[nodiscard]] int pixels(COLORREF color, RECT area) const { return pixelsOf(dc_, area, color); }
  [[nodiscard]] int pixels(COLORREF color) const { return pixels(color, area()); }
  void keep(const char* name) const {
    const std::wstring panel = panelKind().name;
    workbench::saveContextPicture(
        dc_, size_, pictures + "\\drawn_" + std::string(panel.begin(), panel.end()) + "_" + name + ".png");
  }

 private:
  SIZE size_;
  HDC dc_;
  HBITMAP bitmap_;
  HGDIOBJ previous_;
};

HRESULT draw(Hosted& panel, HDC dc, RECTL bounds) {
  return panel.object.query<IViewObject2>()->Draw(DVASPECT_CONTENT, -1, nullptr, nullptr, nullptr, dc,
                                                  &bounds, nullptr, nullptr, 0);
}

// A panel that stands nowhere, with a sweep to show.
struct Shown : Hosted {
  Shown() {
    SIZEL extent{MulDiv(kViewPx.cx, 2540, dpi()), MulDiv(kViewPx.cy, 2540, dpi())};
    object->SetExtent(DVASPECT_CONTENT, &extent);
    publish(carrier());
  }
  static int dpi() {
    const HDC screen = GetDC(nullptr);
    const int dots = GetDeviceCaps(screen, LOGPIXELSX);
    ReleaseDC(nullptr, screen);
    return dots;
  }
};

void drawsAtItsOwnScale() {
  Shown panel;
  const Canvas canvas(kViewPx);
  expect(draw(panel, canvas.dc(), {0, 0, kViewPx.cx, kViewPx.cy}) == S_OK, "an inactive panel draws itself");
  canvas.keep("inactive");
  expect(canvas.pixels(kTraceColor) > kViewPx.cx / 4, "with its trace");
  const COLORREF face = GetSysColor(COLOR_BTNFACE);
  expect(canvas.pixels(GetSysColor(COLOR_WINDOW), {kViewPx.cx * 3 / 4, 0, kViewPx.cx, kViewPx.cy}) > 2000,
         "and its fields, which have no windows");
  expect(canvas.pixels(face) > kViewPx.cx * 50, "on the colour of dialogs");
  RECT clip{};
  expect(
      GetClipBox(canvas.dc(), &clip) == SIMPLEREGION && clip.right == kViewPx.cx && clip.bottom == kViewPx.cy,
      "it leaves no clip behind");
}

// Where and how large does not change what there is to be seen: twice the scale has the trace twice as long.
void drawsAtOtherScales() {
  Shown panel;
  const Canvas once(kViewPx);
  draw(panel, once.dc(), {0, 0, kViewPx.cx, kViewPx.cy});
  const SIZE twicePx{kViewPx.cx * 2, kViewPx.cy * 2};
  const Canvas twice(twicePx);
  draw(panel, twice.dc(), {0, 0, twicePx.cx, twicePx.cy});
  twice.keep("twice");
  const int single = once.pixels(kTraceColor);
  const int larger = twice.pixels(kTraceColor);
  expect(larger > single * 3 && larger < single * 5,
         "at twice the scale its lines are twice as long and wide");
  const Canvas part(kViewPx);
  draw(panel, part.dc(), {500, 350, kViewPx.cx, kViewPx.cy});
  expect(part.pixels(RGB(255, 255, 255), {0, 0, 500, 350}) == 500 * 350, "it keeps to its bounds");
  expect(part.pixels(kTraceColor, {500, 350, kViewPx.cx, kViewPx.cy}) > 100, "and is there");
  const Canvas mapped(kViewPx);
  SetMapMode(mapped.dc(), MM_ANISOTROPIC);
  SetWindowExtEx(mapped.dc(), 10000, -7000, nullptr);
  SetViewportExtEx(mapped.dc(), kViewPx.cx, kViewPx.cy, nullptr);
  draw(panel, mapped.dc(), {0, 0, 10000, -7000});
  SetMapMode(mapped.dc(), MM_TEXT);
  mapped.keep("logical");
  const int logical = mapped.pixels(kTraceColor);
  expect(logical > single * 3 / 4 && logical < single * 3 / 2,
         "in units of another size, with the axis upwards, it is the same picture");
}

int CALLBACK countRecord(HDC, HANDLETABLE*, const ENHMETARECORD* record, int, LPARAM counts) {
  ++(*reinterpret_cast<std::map<DWORD, int>*>(counts))[record->iType];
  return 1;
}

STGMEDIUM dataOf(Hosted& panel, CLIPFORMAT kind, DWORD medium) {
  FORMATETC format{kind, nullptr, DVASPECT_CONTENT, -1, medium};
  STGMEDIUM data{};
  const HRESULT given = panel.object.query<IDataObject>()->GetData(&format, &data);
  expect(given == S_OK && data.tymed == medium, "the picture is given as data");
  return data;
}

void recordsIntoMetafiles() {
  Shown panel;
  STGMEDIUM enhanced = dataOf(panel, CF_ENHMETAFILE, TYMED_ENHMF);
  std::map<DWORD, int> records;
  EnumEnhMetaFile(nullptr, enhanced.hEnhMetaFile, reinterpret_cast<ENHMFENUMPROC>(countRecord), &records,
                  nullptr);
  expect(records[EMR_STRETCHDIBITS] + records[EMR_STRETCHBLT] + records[EMR_SETDIBITSTODEVICE] == 0,
         "a metafile of it has no bitmap");
  expect(records[EMR_POLYLINE16] + records[EMR_POLYLINE] > 20 && records[EMR_EXTTEXTOUTW] > 10,
         "but lines and texts");
  const Canvas replayed(kViewPx);
  const RECT all = replayed.area();
  PlayEnhMetaFile(replayed.dc(), enhanced.hEnhMetaFile, &all);
  replayed.keep("enhanced");
  expect(replayed.pixels(kTraceColor) > kViewPx.cx / 4, "which replays");
  ENHMETAHEADER header{};
  GetEnhMetaFileHeader(enhanced.hEnhMetaFile, sizeof header, &header);
  const LONG rightMm100 =
      MulDiv(static_cast<int>(header.rclBounds.right), 100 * static_cast<int>(header.szlMillimeters.cx),
             static_cast<int>(header.szlDevice.cx));
  expect(rightMm100 > header.rclFrame.right - 60, "and fills its frame, whatever the screen's size in mm");
  const Canvas part(kViewPx);
  const RECT bounds{200, 100, 700, 450};
  PlayEnhMetaFile(part.dc(), enhanced.hEnhMetaFile, &bounds);
  const int outside = kViewPx.cx * kViewPx.cy - 501 * 351;  // its edges are drawn in part
  expect(part.pixels(RGB(255, 255, 255), {0, 0, kViewPx.cx, 100}) == kViewPx.cx * 100 &&
             part.pixels(RGB(255, 255, 255)) >= outside,
         "inside its bounds, however much of the fields a view cuts off");
  ReleaseStgMedium(&enhanced);

  STGMEDIUM plain = dataOf(panel, CF_METAFILEPICT, TYMED_MFPICT);
  const auto* const picture = static_cast<const METAFILEPICT*>(GlobalLock(plain.hMetaFilePict));
  SIZEL extent{};
  panel.object->GetExtent(DVASPECT_CONTENT, &extent);
  expect(picture->mm == MM_ANISOTROPIC && picture->xExt == extent.cx && picture->yExt == extent.cy,
         "the older kind says its size in himetric");
  const Canvas older(kViewPx);
  SaveDC(older.dc());
  SetMapMode(older.dc(), MM_ANISOTROPIC);
  SetViewportExtEx(older.dc(), kViewPx.cx, kViewPx.cy, nullptr);
  PlayMetaFile(older.dc(), picture->hMF);
  RestoreDC(older.dc(), -1);
  older.keep("plain");
  expect(older.pixels(kTraceColor) > kViewPx.cx / 4, "and replays as well");
  GlobalUnlock(plain.hMetaFilePict);
  ReleaseStgMedium(&plain);
}

// 40,000 himetric do not fit into the 16 bits of the older kind.
void recordsLargePictures() {
  Hosted panel;
  SIZEL extent{40000, 20000};
  panel.object->SetExtent(DVASPECT_CONTENT, &extent);
  publish(carrier());
  STGMEDIUM plain = dataOf(panel, CF_METAFILEPICT, TYMED_MFPICT);
  const auto* const picture = static_cast<const METAFILEPICT*>(GlobalLock(plain.hMetaFilePict));
  const Canvas canvas(kViewPx);
  SetMapMode(canvas.dc(), MM_ANISOTROPIC);
  SetViewportExtEx(canvas.dc(), kViewPx.cx, kViewPx.cy, nullptr);
  PlayMetaFile(canvas.dc(), picture->hMF);
  SetMapMode(canvas.dc(), MM_TEXT);
  SetWindowOrgEx(canvas.dc(), 0, 0, nullptr);
  SetViewportOrgEx(canvas.dc(), 0, 0, nullptr);
  expect(picture->xExt == 40000, "a large picture says how large it is");
  expect(canvas.pixels(GetSysColor(COLOR_WINDOW), {kViewPx.cx * 3 / 4, 0, kViewPx.cx, kViewPx.cy}) > 500,
         "and has its fields at its right edge");
  GlobalUnlock(plain.hMetaFilePict);
  ReleaseStgMedium(&plain);
}

void saysWhatDataItHas() {
  Hosted panel;
  const auto data = panel.object.query<IDataObject>();
  const struct {
    FORMATETC format;
    HRESULT answer;
    const char* what;
  } questions[] = {
      {{CF_ENHMETAFILE, nullptr, DVASPECT_CONTENT, -1, TYMED_ENHMF}, S_OK, "an enhanced metafile"},
      {{CF_METAFILEPICT, nullptr, DVASPECT_CONTENT, -1, TYMED_MFPICT | TYMED_FILE}, S_OK, "a plain one"},
      {{CF_METAFILEPICT, nullptr, DVASPECT_CONTENT, -1, TYMED_ENHMF}, DV_E_TYMED, "in another medium"},
      {{CF_ENHMETAFILE, nullptr, DVASPECT_ICON, -1, TYMED_ENHMF}, DV_E_DVASPECT, "as an icon"},
      {{CF_ENHMETAFILE, nullptr, DVASPECT_CONTENT, 0, TYMED_ENHMF}, DV_E_LINDEX, "a page of it"},
      {{CF_TEXT, nullptr, DVASPECT_CONTENT, -1, TYMED_HGLOBAL}, DV_E_FORMATETC, "text"},
  };
  for (const auto& question : questions) {
    FORMATETC format = question.format;
    STGMEDIUM medium{};
    expect(data->QueryGetData(&format) == question.answer, std::string("data asked for: ") + question.what);
    if (question.answer != S_OK)
      expect(data->GetData(&format, &medium) == question.answer && medium.tymed == TYMED_NULL,
             "and given so");
  }
  ComPointer<IEnumFORMATETC> formats;
  data->EnumFormatEtc(DATADIR_GET, formats.receive());
  FORMATETC listed[3]{};
  ULONG count = 0;
  expect(formats && formats->Next(3, listed, &count) == S_FALSE && count == 2, "it lists two kinds");
}

// Hears that a picture has changed.
class Onlooker final : public Counted<IAdviseSink> {
 public:
  int views = 0;
  int data = 0;
  int closed = 0;
  void STDMETHODCALLTYPE OnDataChange(FORMATETC*, STGMEDIUM*) override { ++data; }
  void STDMETHODCALLTYPE OnViewChange(DWORD, LONG) override { ++views; }
  void STDMETHODCALLTYPE OnRename(IMoniker*) override {}
  void STDMETHODCALLTYPE OnSave() override {}
  void STDMETHODCALLTYPE OnClose() override { ++closed; }

 protected:
  void* find(REFIID id) override { return id == IID_IUnknown || id == IID_IAdviseSink ? this : nullptr; }
};

// Does something else while it is written into.
class InterruptingBag final : public Counted<IPropertyBag> {
 public:
  std::function<void()> during;
  HRESULT STDMETHODCALLTYPE Read(LPCOLESTR, VARIANT*, IErrorLog*) override { return E_INVALIDARG; }
  HRESULT STDMETHODCALLTYPE Write(LPCOLESTR, VARIANT*) override { return during(), S_OK; }

 protected:
  void* find(REFIID id) override { return id == IID_IUnknown || id == IID_IPropertyBag ? this : nullptr; }
};

void tellsOnlookers(HWND window) {
  Onlooker onlooker;
  {
    Sited panel(window);
    const auto view = panel.object.query<IViewObject2>();
    view->SetAdvise(DVASPECT_CONTENT, ADVF_PRIMEFIRST, &onlooker);
    expect(onlooker.views == 1, "who looks on is told at once when he asks for it");
    FORMATETC format{CF_ENHMETAFILE, nullptr, DVASPECT_CONTENT, -1, TYMED_ENHMF};
    DWORD connection = 0;
    panel.object.query<IDataObject>()->DAdvise(&format, ADVF_NODATA, &onlooker, &connection);
    publish(carrier());
    expect(onlooker.views > 1 && onlooker.data > 0, "and that an inactive panel has got a sweep");
    const int swept = onlooker.views;
    panel.call(L"addMarker");
    expect(onlooker.views > swept, "and a marker");
    const auto stored = panel.object.query<IPersistStreamInit>();
    panel.call(L"PopUp_Click", {0, 900});
    expect(stored->IsDirty() == S_OK && panel.call(L"DisplayPanelVisible").number() == 0,
           "an area that the menu hides is to be stored");
    const int before = onlooker.views;
    int within = -1;
    InterruptingBag bag;
    bag.during = [&] {
      publish(carrier());
      within = onlooker.views;
    };
    panel.object.query<IPersistPropertyBag>()->Save(&bag, TRUE, TRUE);
    expect(within == before && onlooker.views == before + 1,
           "a sweep that comes during a save is told after it");
    panel.verb(OLEIVERB_INPLACEACTIVATE);
    const int active = onlooker.views;
    publish(carrier());
    pumpMessages();
    expect(onlooker.views == active, "a panel with a window shows by itself");
    view->SetAdvise(DVASPECT_CONTENT, 0, nullptr);
    panel.object.query<IDataObject>()->DUnadvise(connection);
  }
  expect(onlooker.references == 1, "no reference to who looked on is left");
}

// --- Places

void takesItsClip(HWND window) {
  Sited panel(window, OLEIVERB_INPLACEACTIVATE);
  const RECT place{0, 0, 400, 300};
  const struct {
    RECT clip;
    RECT shown;
    const char* what;
  } clips[] = {
      {{0, 0, 800, 600}, {0, 0, 400, 300}, "all of it"},
      {{100, 50, 800, 600}, {100, 50, 400, 300}, "a part of it"},
      {{500, 0, 800, 600}, {0, 0, 0, 0}, "nothing of it, scrolled away"},
      {{0, 0, 0, 0}, {0, 0, 400, 300}, "all of it, without a clip"},
  };
  for (const auto& row : clips) {
    panel.inPlace->SetObjectRects(&place, &row.clip);
    const HRGN region = CreateRectRgn(0, 0, 0, 0);
    RECT shown{0, 0, 400, 300};
    if (GetWindowRgn(panel.window(), region) != ERROR) GetRgnBox(region, &shown);
    DeleteObject(region);
    expect(EqualRect(&shown, &row.shown), std::string("the container shows ") + row.what);
  }
}

// Window parameters 700 to 703 in twips, for a container that keeps no properties of the panel's place.
void asksForItsPlace(HWND window) {
  Sited panel(window, OLEIVERB_INPLACEACTIVATE);
  FullContainer& container = panel.container;
  const float twipsPerPx = 1440.0F / static_cast<float>(Shown::dpi());
  const struct {
    int parameter;
    int px;
    RECT wanted;
  } wishes[] = {
      {700, 40, {40, 20, 440, 320}},
      {701, 60, {40, 60, 440, 360}},
      {702, 500, {40, 60, 540, 360}},
      {703, 200, {40, 60, 540, 260}},
  };
  for (const auto& wish : wishes) {
    const double twips = wish.px * static_cast<double>(twipsPerPx);
    expect(panel.call(L"vfpSet", {0, wish.parameter, 0, twips}).number() == 0 &&
               EqualRect(&container.wanted, &wish.wanted),
           "parameter " + std::to_string(wish.parameter) + " asks for a place");
    panel.inPlace->SetObjectRects(&container.wanted, nullptr);
  }
  expect(panel.call(L"vfpSet", {0, 727, 0, false}).number() == 0 && !IsWindowVisible(panel.window()),
         "parameter 727 hides its window");
  panel.call(L"vfpSet", {0, 727, 0, true});
  expect((GetWindowLongW(panel.window(), GWL_STYLE) & WS_VISIBLE) != 0, "and shows it");
  panel.call(L"vfpSet", {0, 314, 0, L"Drive 7"});
  wchar_t title[32] = L"";
  GetWindowTextW(panel.window(), title, 32);
  expect(std::wstring(title).rfind(L"Drive 7", 0) == 0, "its window has the panel's caption");
}

// A script has the panel without any container.
void takesItsSize() {
  Hosted panel;
  put(*panel.members.get(), L"ViewWidth", 7200.0);
  put(*panel.members.get(), L"ViewHeight", 5760.0);
  expect(panel.call(L"ViewWidth").number() == 7200 && panel.call(L"ViewHeight").number() == 5760,
         "without a container a panel has the size that it is given");
}

// --- Scales of screens

// A program tells one screen from another; its window says which scale is wanted.
void followsItsWindowsScale() {
  using SetAwareness = HANDLE(WINAPI*)(HANDLE);
  const auto setAwareness = reinterpret_cast<SetAwareness>(reinterpret_cast<void*>(
      GetProcAddress(GetModuleHandleW(L"user32.dll"), "SetThreadDpiAwarenessContext")));
  if (setAwareness == nullptr || Shown::dpi() == 96) return;
  const auto unaware = reinterpret_cast<HANDLE>(-1);
  Hosted plain;
  const int atScreenScale = plain.call(L"ViewScaleWidth").number();
  const HANDLE before = setAwareness(unaware);
  const HWND parent = CreateWindowExW(0, L"STATIC", L"", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 0, 0, 700, 500,
                                      nullptr, nullptr, nullptr, nullptr);
  {
    Sited panel(parent, OLEIVERB_INPLACEACTIVATE);
    RECT client{};
    GetClientRect(panel.window(), &client);
    expect(panel.call(L"ViewScaleWidth").number() == client.right * 15,
           "on a window of 96 dots an inch a pixel is 15 twips, whatever the screen's own scale");
    SendMessageW(panel.window(), 0x02E3, 0, 0);
    expect(panel.call(L"ViewScaleWidth").number() == client.right * 15, "also when it is told to look again");
  }
  DestroyWindow(parent);
  setAwareness(before);
  expect(plain.call(L"ViewScaleWidth").number() == atScreenScale, "and the others keep theirs");
}

}  // namespace

int check() {
  return runChecks({800, 700}, [](const Desk& desk) {
    onEachPanel([&desk] {
      chapter("pictures");
      drawsAtItsOwnScale();
      drawsAtOtherScales();
      recordsIntoMetafiles();
      recordsLargePictures();
      saysWhatDataItHas();
      tellsOnlookers(desk.window);
      chapter("places");
      takesItsClip(desk.window);
      asksForItsPlace(desk.window);
      takesItsSize();
      followsItsWindowsScale();
    });
  });
}

}  // namespace frontpanels::testing

int main(int count, char** arguments) {
  frontpanels::testing::pictures = count > 1 ? arguments[1] : ".";
  return frontpanels::testing::check();
}

// The pilot panel on a form, as an operator has it before him: every field whole and for itself, the four
// displays divided by bars that can be dragged. Leaves pictures in the given folder. Prints a line a check,
// at the end "N passed, N failed".
#include <windows.h>

#include <algorithm>
#include <iterator>
#include <span>
#include <string>
#include <vector>

#include "platform/win32/utf16.h"
#include "tests/wine/com_client.h"
#include "tests/wine/full_container.h"
#include "tests/wine/panel_user.h"
#include "workbench/window_picture.h"

namespace frontpanels::testing {
namespace {

constexpr int kPilots = 12;
constexpr int kColumns = 6;

// --- A frame of pilots

float valueOf(int column, int pilot) {
  const float peak = -4.5F - static_cast<float>(pilot * 13 % 29) / 2;
  const float above = static_cast<float>(pilot % 4) / 4;
  const float values[kColumns] = {static_cast<float>(4 + 41 * pilot),          peak,
                                  static_cast<float>(37 * pilot % 200),        peak + above,
                                  static_cast<float>(pilot % 5) * 1.5F + 0.5F, above};
  return values[column];
}

std::vector<float> levels(int count) {
  std::vector<float> all;
  for (int code = 0; code < count; ++code) {
    float level = -24 - static_cast<float>(code * code * 7919 % 97) / 20;
    for (int pilot = 0; pilot < kPilots; ++pilot)
      if (code == static_cast<int>(valueOf(0, pilot))) level = valueOf(1, pilot);
    all.push_back(level);
  }
  return all;
}

std::vector<std::wstring> pathsOf(const Hosted& panel, const wchar_t* server) {
  std::vector<std::wstring> paths(1);
  for (const wchar_t letter : panel.call(server).text())
    letter == L'\x1b' ? paths.emplace_back() : paths.back() += letter;
  return paths;
}

struct SetRow {
  int resultType;
  const wchar_t* server;
  int codes;  // of a trace; 0 for bars
};
constexpr SetRow kSets[] = {{14, L"DfiAllPilots", 512},
                            {18, L"DfiZoomedPilots", 128},
                            {201, L"DfiPilotTopNMultipath", 0},
                            {200, L"DfiPilotListMultipath", 0}};

void publish(const std::wstring& path, const Value& value) {
  call(*create<IDispatch>(L"FrontPanels.DataHub").get(), L"Publish", {path.c_str(), value});
}

void publishFrame(const Hosted& panel, const SetRow& set) {
  const auto paths = pathsOf(panel, set.server);
  publish(paths[0], -61.5);
  if (set.codes > 0) return publish(paths[1], Value(levels(set.codes)));
  for (int column = 0; column < kColumns; ++column) {
    std::vector<float> values;
    for (int pilot = 0; pilot < kPilots; ++pilot) values.push_back(valueOf(column, pilot));
    publish(paths[static_cast<std::size_t>(column) + 1], Value(values));
  }
}

void publishCarrier(const Hosted& panel) {
  const auto paths = pathsOf(panel, L"DfiCarrier");
  publish(paths[0], -132.75);
  publish(paths[1], L"Locked");
  publish(paths[2], 17.0);
}

// --- The form

struct Form {
  HWND window;
  Sited panel;

  explicit Form(SIZE twips) : window(makeWindow(twips)), panel(window) {
    GetClientRect(window, &panel.container.place);
    panel.verb(OLEIVERB_INPLACEACTIVATE);
    pumpMessages();
  }
  ~Form() {
    panel.close();
    DestroyWindow(window);
  }
  Form(const Form&) = delete;
  Form& operator=(const Form&) = delete;

  static HWND makeWindow(SIZE twips) {
    return CreateWindowExW(WS_EX_CONTROLPARENT, L"STATIC", L"", WS_POPUP | WS_CLIPCHILDREN | WS_VISIBLE, 0, 0,
                           inPixels(static_cast<double>(twips.cx)), inPixels(static_cast<double>(twips.cy)),
                           nullptr, nullptr, nullptr, nullptr);
  }
  void set(int code, const Value& value) const { panel.call(L"vfpSet", {0, code, 0, value}); }
};

void nameCells(const Form& form) {
  constexpr const wchar_t* kNames[] = {L"Harbour East", L"Town Hall", L"Mill",   L"Airport 2", L"St. Mary",
                                       L"Depot",        L"Stadium",   L"Quarry", L"Ferry",     L"Hill Farm"};
  const auto cells = create<IDispatch>(L"FrontPanels.clsCellNameInfo");
  for (int pilot = 0; pilot < static_cast<int>(std::size(kNames)); ++pilot)
    call(*cells.get(), L"SetCellName", {static_cast<double>(valueOf(0, pilot)), -1.0, kNames[pilot]});
  form.set(799, true);
  Value object;
  V_VT(object.get()) = VT_DISPATCH;
  V_DISPATCH(object.get()) = cells.get();
  cells->AddRef();
  put(*form.panel.members.get(), L"CellNameInfo", object);
  form.set(776, 1);
}

// --- Fields

bool isFrame(HWND window) {
  return isOf(window, L"Button") && (GetWindowLongW(window, GWL_STYLE) & BS_TYPEMASK) == BS_GROUPBOX;
}

int textWidth(HWND window, std::wstring text) {
  std::erase(text, L'&');
  const HDC dc = GetDC(window);
  HGDIOBJ const previous = SelectObject(dc, reinterpret_cast<HFONT>(SendMessageW(window, WM_GETFONT, 0, 0)));
  SIZE size{};
  GetTextExtentPoint32W(dc, text.c_str(), static_cast<int>(text.size()), &size);
  SelectObject(dc, previous);
  ReleaseDC(window, dc);
  return static_cast<int>(size.cx);
}

// The longest text that a field of a fixed choice has to show; none for what a user types.
std::wstring longestText(HWND window) {
  std::wstring longest = isOf(window, L"Edit") ? L"" : textOf(window);
  const auto count = static_cast<int>(SendMessageW(window, CB_GETCOUNT, 0, 0));
  for (int item = 0; isOf(window, L"ComboBox") && item < count; ++item) {
    wchar_t text[200] = L"";
    SendMessageW(window, CB_GETLBTEXT, item, reinterpret_cast<LPARAM>(text));
    if (textWidth(window, text) > textWidth(window, longest)) longest = text;
  }
  return longest;
}

// What a field shows beside its text, in twips: the arrow of a list, the mark of a box, the edges of a
// button.
int besideTextTwips(HWND window) {
  if (isOf(window, L"ComboBox")) return 360;
  if (!isOf(window, L"Button")) return 0;
  const LONG type = GetWindowLongW(window, GWL_STYLE) & BS_TYPEMASK;
  return type == BS_PUSHBUTTON || type == BS_DEFPUSHBUTTON ? 90 : type == BS_GROUPBOX ? 210 : 270;
}

void captionsAreWhole(HWND view) {
  std::wstring cut;
  for (const wchar_t* const kind : {L"STATIC", L"BUTTON", L"COMBOBOX"}) {
    for (const HWND field : windowsOf(view, kind)) {
      const std::wstring text = longestText(field);
      const RECT place = placeIn(view, field);
      if (!text.empty() &&
          textWidth(field, text) + inPixels(besideTextTwips(field)) > place.right - place.left)
        cut += L" [" + text + L": " + std::to_wstring(textWidth(field, text)) + L" in " +
               std::to_wstring(place.right - place.left) + L"]";
    }
  }
  expect(cut.empty(), "every caption and every item of a list is whole" + toUtf8(cut));
}

void fieldsStandApart(HWND view) {
  std::vector<HWND> fields;
  for (const wchar_t* const kind : {L"STATIC", L"BUTTON", L"COMBOBOX", L"EDIT", L"LISTBOX"})
    for (const HWND field : windowsOf(view, kind))
      if (!isFrame(field) && !textOf(field).empty() && IsWindowVisible(field)) fields.push_back(field);
  std::wstring overlaps;
  for (std::size_t i = 0; i < fields.size(); ++i) {
    for (std::size_t k = i + 1; k < fields.size(); ++k) {
      const RECT one = placeIn(view, fields[i]);
      const RECT other = placeIn(view, fields[k]);
      RECT both{};
      if (!IsChild(fields[i], fields[k]) && !IsChild(fields[k], fields[i]) &&
          IntersectRect(&both, &one, &other))
        overlaps += L" [" + textOf(fields[i]) + L" / " + textOf(fields[k]) + L"]";
    }
  }
  expect(fields.size() > 30 && overlaps.empty(), "no field lies over another" + toUtf8(overlaps));
}

// --- Pictures

struct Scene {
  const char* name;
  std::span<const SetRow> sets;
  void (*prepare)(const Form& form);
};

const Scene kScenes[] = {
    {"four", kSets, [](const Form& form) { form.set(730, 2); }},
    {"names", std::span(kSets).subspan(2, 1), nameCells},
    {"aggregate", std::span(kSets).subspan(2, 1),
     [](const Form& form) { form.set(775, 1), form.set(731, 6); }},
};

void isPictured(const std::string& folder, const Scene& scene, SIZE twips) {
  const Form form(twips);
  for (const SetRow& set : scene.sets) form.panel.call(L"vfpOp", {0, 10, set.resultType});
  scene.prepare(form);
  for (const SetRow& set : scene.sets) publishFrame(form.panel, set);
  publishCarrier(form.panel);
  pumpMessages();
  captionsAreWhole(form.panel.window());
  fieldsStandApart(form.panel.window());
  const std::string stem = folder + "\\pilots_" + scene.name + "_" + std::to_string(twips.cx / 15) + "_";
  workbench::saveWindowPicture(form.panel.window(), stem + std::to_string(screenDpi()) + ".png");
}

}  // namespace

int check(const std::string& folder) {
  return runChecks({100, 100}, [&folder](const Desk&) {
    onEachPanel([&folder] {
      if (std::wstring(panelKind().name) != L"Tarvex") return;
      for (const Scene& scene : kScenes) {
        for (const SIZE twips : {SIZE{12000, 9000}, SIZE{18000, 13500}}) {
          chapter(scene.name);
          isPictured(folder, scene, twips);
        }
      }
    });
  });
}

}  // namespace frontpanels::testing

int main(int count, char** arguments) {
  SetProcessDPIAware();
  return frontpanels::testing::check(count > 1 ? arguments[1] : ".");
}

// The fields of the sited control, used as an operator does: walked through, typed into, collapsed. Leaves
// pictures of the control in the given folder. Prints a line a check, at the end "N passed, N failed".
#include <windows.h>

#include <objbase.h>
#include <olectl.h>

#include <algorithm>
#include <cstdio>
#include <functional>
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

constexpr const wchar_t* kMenuClass = L"#32768";

// Every stop of the Tab key, in order; of options the first stands for its frame.
constexpr const wchar_t* kStops[] = {
    L"CenterFrequencyTextBox", L"FrequencySpanTextBox", L"FrequencyRbwTextBox",
    L"StartFrequencyTextBox",  L"StopFrequencyTextBox", L"SingleSweepButton",
    L"ContinuousSweepButton",  L"StopSweepButton",      L"FrequencyOption",
    L"ChannelizationCombo",    L"IntervalTimeOption",   L"SweepRateTextBox",
    L"DownlinkOption",         L"WidebandOption",       L"AverageCountTextBox",
    L"AverageTypeCombo",       L"DisplayLengthTextBox", L"LogPwrOption",
    L"VerticalScaleTextBox",   L"AutoScaleBox",         L"VerticalOffsetTextBox",
    L"MarkerAddButton",        L"MarkerDeleteButton",   L"MarkerToMaxButton",
    L"MarkerDeltaButton",      L"MarkerToCenterButton", L"CloseButton"};

// The control in use on a form, which has a button before and one after it.
class Form {
 public:
  enum class Loop { Container, Dialog };

  explicit Form(Loop loop, SIZE twips = {12000, 9000}, bool userMode = true);
  ~Form();
  Form(const Form&) = delete;
  Form& operator=(const Form&) = delete;

  [[nodiscard]] IDispatch& members() const { return *hosted.members.get(); }
  // What a member of a field answers.
  [[nodiscard]] Value of(const wchar_t* field, const wchar_t* member) const;
  // The window that has the focus shows the field, whatever shows its name to nobody.
  [[nodiscard]] bool isFocused(const wchar_t* name) const;
  void press(WORD key, WORD held = 0) {
    testing::press(key, held, [this] { pump(); });
  }
  void type(const wchar_t* text);
  void click(HWND window);
  void pump();

  HWND window = nullptr;
  HWND before = nullptr;
  HWND after = nullptr;
  FullContainer container;
  Hosted hosted;

 private:
  static HWND makeForm(SIZE sizePx);

  Loop loop_;
  ComPointer<IOleInPlaceActiveObject> active_;
};

HWND makeButton(HWND form) {
  return CreateWindowExW(0, L"BUTTON", L"", WS_CHILD | WS_VISIBLE | WS_TABSTOP, 0, 0, 1, 1, form, nullptr,
                         nullptr, nullptr);
}

HWND Form::makeForm(SIZE sizePx) {
  const HWND form =
      CreateWindowExW(WS_EX_CONTROLPARENT, L"STATIC", L"", WS_POPUP | WS_CLIPCHILDREN | WS_VISIBLE, 0, 0,
                      sizePx.cx, sizePx.cy, nullptr, nullptr, nullptr, nullptr);
  SetForegroundWindow(form);
  return form;
}

Form::Form(Loop loop, SIZE twips, bool userMode)
    : window(makeForm({inPixels(static_cast<int>(twips.cx)), inPixels(static_cast<int>(twips.cy))})),
      after(makeButton(window)),
      container(window),
      loop_(loop) {
  GetClientRect(window, &container.place);
  container.userMode = userMode;
  hosted.object->SetClientSite(&container);
  hosted.verb(OLEIVERB_INPLACEACTIVATE);
  before = makeButton(window);
  SetWindowPos(before, HWND_TOP, 0, 0, 0, 0, SWP_NOMOVE | SWP_NOSIZE | SWP_NOACTIVATE);
  SetWindowPos(after, HWND_BOTTOM, 0, 0, 0, 0, SWP_NOMOVE | SWP_NOSIZE | SWP_NOACTIVATE);
  active_ = hosted.object.query<IOleInPlaceActiveObject>();
  pump();
}

Form::~Form() {
  active_.reset();
  hosted.close();
  DestroyWindow(window);
}

Value Form::of(const wchar_t* field, const wchar_t* member) const {
  const Value found = hosted.call(L"Constituent", {field});
  return V_VT(&found.variant()) == VT_DISPATCH ? call(*V_DISPATCH(&found.variant()), member) : Value();
}

void Form::pump() {
  MSG message{};
  while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) {
    const bool ours = message.message >= WM_KEYFIRST && message.message <= WM_KEYLAST &&
                      message.message != WM_KEYUP && message.message != WM_SYSKEYUP;
    if (ours && loop_ == Loop::Container && active_->TranslateAccelerator(&message) == S_OK) continue;
    if (ours && loop_ == Loop::Dialog && IsDialogMessageW(window, &message)) continue;
    TranslateMessage(&message);
    DispatchMessageW(&message);
  }
}

void Form::type(const wchar_t* text) {
  for (; *text != L'\0'; ++text) PostMessageW(GetFocus(), WM_CHAR, *text, 1);
  pump();
}

void Form::click(HWND target) {
  SendMessageW(target, WM_MOUSEACTIVATE, reinterpret_cast<WPARAM>(window),
               MAKELPARAM(HTCLIENT, WM_LBUTTONDOWN));
  testing::click(target);
  pump();
}

// A letter that is typed into the window arrives in the field; a caption is the same on both.
bool Form::isFocused(const wchar_t* name) const {
  const HWND focus = GetFocus();
  if (!IsChild(hosted.window(), focus)) return false;
  if (std::wstring(name).ends_with(L"Combo")) return isOf(focus, L"ComboBox");
  if (isOf(focus, L"Edit")) {
    SendMessageW(focus, EM_SETSEL, 0, -1);
    SendMessageW(focus, EM_REPLACESEL, TRUE, reinterpret_cast<LPARAM>(L"8"));
    const bool arrived = of(name, L"Text").text() == L"8";
    return SendMessageW(focus, EM_UNDO, 0, 0), arrived;
  }
  std::wstring caption = textOf(focus);
  std::erase(caption, L'&');
  return caption == of(name, L"Caption").text();
}

// --- Keyboard

void isWalkedThrough(Form& form, const std::string& how, const std::function<bool()>& left) {
  std::vector<const wchar_t*> stops(std::begin(kStops), std::end(kStops));
  std::erase_if(stops, [&form](const wchar_t* name) { return form.of(name, L"Enabled").number() != -1; });
  std::wstring strayed;
  std::size_t reached = 0;
  for (; reached < stops.size() && strayed.empty(); ++reached) {
    form.press(VK_TAB);
    if (!form.isFocused(stops[reached])) strayed = stops[reached];
  }
  expect(strayed.empty() && reached > 20, how + ": Tab goes through the fields in their order" +
                                              (strayed.empty() ? "" : ", but not to " + toUtf8(strayed)));
  form.press(VK_TAB);
  expect(left(), how + ": and leads out behind the last");
}

void tabInAContainer() {
  Form form(Form::Loop::Container);
  SetFocus(form.hosted.window());
  expect(form.container.count("OnFocus") == 1 && form.container.count("OnUIActivate") == 1,
         "the graph can have the focus");
  isWalkedThrough(form, "container", [&] {
    return form.container.count("TranslateAccelerator") == 1 && form.isFocused(L"CloseButton");
  });
  expect(form.container.count("OnFocus") == 1 && form.container.count("OnFocus(off)") == 0,
         "from field to field the control keeps the focus");
  SetFocus(form.window);
  expect(form.container.count("OnFocus(off)") == 1, "and gives it up once");
}

void tabInADialog() {
  Form form(Form::Loop::Dialog);
  SetFocus(form.before);
  isWalkedThrough(form, "dialog", [&] { return GetFocus() == form.after; });
  form.press(VK_TAB, VK_SHIFT);
  expect(form.isFocused(L"CloseButton"), "dialog: Shift+Tab enters by the last field");
  SetFocus(form.before);
  form.press(VK_TAB);
  form.press(VK_TAB, VK_SHIFT);
  expect(GetFocus() == form.before, "dialog: and leaves before the first");
}

// --- Mouse

HWND centerBox(const Form& form) { return boxBeside(form.hosted.window(), L"<Center>"); }

void isClickedAndTypedInto() {
  Form form(Form::Loop::Container);
  SetFocus(form.before);
  form.click(centerBox(form));
  expect(form.container.count("OnUIActivate") == 1 && form.container.count("OnFocus") == 1 &&
             form.isFocused(L"CenterFrequencyTextBox"),
         "a click on a field makes the control active, and the field has the focus");
  form.type(L"881.52");
  const auto typed = [&form] { return form.of(L"CenterFrequencyTextBox", L"Text").text(); };
  expect(typed() == L"881.52", "what is typed arrives in it");
  form.press(VK_HOME);
  form.type(L"1");
  expect(typed() == L"1881.52" && form.container.count("TranslateAccelerator") == 0,
         "Home is the field's own");
  CONTROLINFO info{};
  info.cb = sizeof info;
  form.hosted.object.query<IOleControl>()->GetControlInfo(&info);
  MSG enter{GetFocus(), WM_KEYDOWN, VK_RETURN, 0, 0, {}};
  expect(info.dwFlags == CTRLINFO_EATS_RETURN &&
             form.hosted.object.query<IOleInPlaceActiveObject>()->TranslateAccelerator(&enter) == S_OK &&
             form.container.count("TranslateAccelerator") == 0,
         "Enter too");
  form.click(form.hosted.window());
  expect(GetFocus() == form.hosted.window() && form.container.count("OnFocus") == 1,
         "a click on the graph brings it the focus");
}

void isPartOfTheControl() {
  Form form(Form::Loop::Container);
  const HWND center = centerBox(form);
  expect(IsWindowVisible(center) != FALSE, "a field is in sight");
  form.hosted.verb(OLEIVERB_HIDE);
  expect(IsWindowVisible(center) == FALSE, "and hidden with the control");
  form.hosted.verb(OLEIVERB_SHOW);
  form.hosted.inPlace->InPlaceDeactivate();
  expect(!IsWindow(center), "and goes with its window");
  form.hosted.verb(OLEIVERB_INPLACEACTIVATE);
  expect(IsWindowVisible(centerBox(form)) != FALSE, "and comes back with it");

  Form designer(Form::Loop::Container, {12000, 9000}, false);
  POINT inBox{3, 3};
  ClientToScreen(centerBox(designer), &inBox);
  expect(WindowFromPoint(inBox) == designer.hosted.window(), "in a designer the mouse passes through it");
  SendMessageW(designer.hosted.window(), WM_RBUTTONUP, 0, MAKELPARAM(50, 50));
  expect(FindWindowW(kMenuClass, nullptr) == nullptr, "and there is no menu");
}

void areasCollapse() {
  Form form(Form::Loop::Container);
  struct Row {
    const wchar_t* area;
    bool upright;
  };
  for (const Row& row : {Row{L"DisplayPanelVisible", true}, Row{L"MeasurementPanelVisible", false}}) {
    const auto strip = [&] {
      for (const HWND button : windowsOf(form.hosted.window(), L"BUTTON")) {
        RECT client{};
        GetClientRect(button, &client);
        const bool slim = std::min(client.right, client.bottom) == inPixels(90);
        if (slim && (client.bottom > client.right) == row.upright) return button;
      }
      return HWND{nullptr};
    };
    const auto toggled = [&](int state) {
      form.click(strip());
      return call(form.members(), row.area).number() == state && GetFocus() == form.hosted.window();
    };
    SendMessageW(strip(), WM_SETCURSOR, reinterpret_cast<WPARAM>(strip()),
                 MAKELPARAM(HTCLIENT, WM_MOUSEMOVE));
    expect(GetCursor() == LoadCursorW(nullptr, IDC_HAND),
           toUtf8(row.area) + ": the pointer says: to be pressed");
    expect(toggled(0) && toggled(-1), toUtf8(row.area) + ": goes and comes with a click on its strip");
  }
}

// --- Menu

HWND menuOwner = nullptr;

void CALLBACK chooseTheFirstItem(HWND, UINT, UINT_PTR timer, DWORD) {
  if (FindWindowW(kMenuClass, nullptr) == nullptr) return;
  KillTimer(nullptr, timer);
  PostMessageW(menuOwner, WM_KEYDOWN, VK_DOWN, 0);
  PostMessageW(menuOwner, WM_KEYDOWN, VK_RETURN, 0);
}

// The first item shows and hides the display area.
void menuOpens() {
  Form form(Form::Loop::Dialog);
  // A pointer over the form would take the keys' choice in the menu back.
  SetCursorPos(GetSystemMetrics(SM_CXSCREEN) - 1, GetSystemMetrics(SM_CYSCREEN) - 1);
  form.pump();
  menuOwner = form.hosted.window();
  SetFocus(menuOwner);
  int shown = -1;
  const auto chosen = [&](const char* how, const std::function<void()>& open) {
    SetTimer(nullptr, 0, 10, chooseTheFirstItem);
    open();
    shown = -1 - shown;
    expect(call(form.members(), L"DisplayPanelVisible").number() == shown,
           std::string("the graph's menu opens by ") + how + ", and its first item is chosen");
  };
  chosen("a right click", [&] {
    SendMessageW(menuOwner, WM_RBUTTONDOWN, MK_RBUTTON, MAKELPARAM(50, 50));
    SendMessageW(menuOwner, WM_RBUTTONUP, 0, MAKELPARAM(50, 50));
  });
  chosen("Shift+F10", [&] { form.press(VK_F10, VK_SHIFT); });
  chosen("the menu key", [&] { form.press(VK_APPS); });
}

// --- Looks

// A field's inside is there where it has its window.
bool showsTheCenterBox(const Form& form, HDC dc) {
  const RECT box = placeIn(form.hosted.window(), centerBox(form));
  const LONG area = (box.right - box.left) * (box.bottom - box.top);
  return pixelsOf(dc, box, GetSysColor(COLOR_WINDOW)) > area / 2;
}

void isWholeInPictures() {
  Form form(Form::Loop::Container);
  publish(carrier());
  form.pump();
  const SIZE size{form.container.place.right, form.container.place.bottom};
  const HDC screen = GetDC(nullptr);
  const HDC dc = CreateCompatibleDC(screen);
  const HBITMAP bitmap = CreateCompatibleBitmap(screen, size.cx, size.cy);
  HGDIOBJ const previous = SelectObject(dc, bitmap);
  const RECT all{0, 0, size.cx, size.cy};
  const RECT graph{0, 0, inPixels(9270), inPixels(7470)};
  const RECTL bounds{0, 0, size.cx, size.cy};
  FillRect(dc, &all, static_cast<HBRUSH>(GetStockObject(BLACK_BRUSH)));
  form.hosted.object.query<IViewObject2>()->Draw(DVASPECT_CONTENT, -1, nullptr, nullptr, nullptr, dc, &bounds,
                                                 nullptr, nullptr, 0);
  expect(showsTheCenterBox(form, dc) && pixelsOf(dc, graph, kTraceColor) > 200,
         "drawn by the container, graph and fields are there");
  for (const UINT message : {WM_PRINT, WM_PRINTCLIENT}) {
    FillRect(dc, &all, static_cast<HBRUSH>(GetStockObject(BLACK_BRUSH)));
    SendMessageW(form.hosted.window(), message, reinterpret_cast<WPARAM>(dc), PRF_CLIENT | PRF_CHILDREN);
    expect(showsTheCenterBox(form, dc) && pixelsOf(dc, graph, kTraceColor) > 200, "printed as well");
  }
  const RECT right{inPixels(9270), 0, size.cx, inPixels(7470)};
  expect(pixelsOf(dc, right, kTraceColor) > 20, "the markers' frame has the trace's colour");
  SelectObject(dc, previous);
  DeleteObject(bitmap);
  DeleteDC(dc);
  ReleaseDC(nullptr, screen);
}

// Width and height as the head of a PNG file has them.
SIZE sizeOfPng(const std::string& path) {
  unsigned char head[24] = {};
  if (FILE* const file = std::fopen(path.c_str(), "rb")) {
    if (std::fread(head, 1, sizeof head, file) != sizeof head) head[0] = 0;
    std::fclose(file);
  }
  const auto number = [&head](int at) { return head[at + 2] * 256 + head[at + 3]; };
  return {number(16), number(20)};
}

void graphIsSavedAlone(const std::string& folder) {
  Form form(Form::Loop::Container);
  const std::string path = folder + "\\graph_alone.png";
  call(form.members(), L"SavePicture", {toUtf16(path).c_str()});
  const SIZE size = sizeOfPng(path);
  DeleteFileA(path.c_str());
  expect(size.cx == inPixels(9270) && size.cy == inPixels(7470),
         "a saved picture ends where the areas begin");
}

ComPointer<IDispatch> makeFont(int points) {
  wchar_t name[] = L"Tahoma";
  FONTDESC description{sizeof description, name, {}, FW_NORMAL, DEFAULT_CHARSET, FALSE, FALSE, FALSE};
  description.cySize.int64 = points * 10000LL;
  ComPointer<IDispatch> font;
  OleCreateFontIndirect(&description, IID_IDispatch, reinterpret_cast<void**>(font.receive()));
  return font;
}

void containersFontIsTaken() {
  Form form(Form::Loop::Container);
  const auto inFont = [&form](int points) {
    return fontOf(centerBox(form)).lfHeight == -MulDiv(points, screenDpi(), 72);
  };
  expect(inFont(8), "without a font of the container's the fields have that of dialogs");
  const auto larger = makeFont(10);
  form.container.font = larger.get();
  form.hosted.object.query<IOleControl>()->OnAmbientPropertyChange(DISPID_AMBIENT_FONT);
  expect(inFont(10), "with one they have it");
  form.container.font = nullptr;
  form.hosted.object.query<IOleControl>()->OnAmbientPropertyChange(DISPID_UNKNOWN);
  expect(inFont(8), "as long as it is the container's");
}

// --- Pictures

// Long numbers, a noisy band and a pair of markers: what an operator has before him.
void showWorkingPanel(Form& form) {
  call(form.members(), L"vfpSet", {0, 13, 0, 2412123456.78});
  call(form.members(), L"vfpSet", {0, 14, 0, 19980468.75});
  call(form.members(), L"vfpSet", {0, 500, 0, 1});
  std::vector<float> levels(512);
  for (std::size_t i = 0; i < levels.size(); ++i) {
    levels[i] = -95 + static_cast<float>(i * i * 7919 % 97) / 12;
    for (const std::size_t peak : {80U, 200U, 333U, 460U}) {
      const auto away = static_cast<float>(i > peak ? i - peak : peak - i);
      levels[i] = std::max(levels[i], -30 - static_cast<float>(peak) / 16 - away * 4);
    }
  }
  publish(levels);
  for (const wchar_t* const member : {L"addMarker", L"markerToMax", L"addDeltaMarker"})
    call(form.members(), member);
  form.pump();
}

void isPictured(const std::string& folder) {
  struct Shot {
    const char* name;
    SIZE twips;
    bool right;
    bool bottom;
  };
  const Shot shots[] = {{"whole", {12000, 9000}, true, true},
                        {"small", {6000, 4500}, true, true},
                        {"right", {12000, 9000}, true, false},
                        {"bottom", {12000, 9000}, false, true},
                        {"graph", {12000, 9000}, false, false}};
  for (const Shot& shot : shots) {
    Form form(Form::Loop::Container, shot.twips);
    put(form.members(), L"DisplayPanelVisible", shot.right);
    put(form.members(), L"MeasurementPanelVisible", shot.bottom);
    showWorkingPanel(form);
    const std::string stem = folder + "\\panel_" + shot.name + "_" + std::to_string(screenDpi());
    workbench::saveWindowPicture(form.hosted.window(), stem + ".png");
  }
}

}  // namespace

int check(const std::string& folder) {
  chapter("fields of the control");
  return runChecks({100, 100}, [&folder](const Desk&) {
    tabInAContainer();
    tabInADialog();
    isClickedAndTypedInto();
    isPartOfTheControl();
    areasCollapse();
    menuOpens();
    isWholeInPictures();
    graphIsSavedAlone(folder);
    containersFontIsTaken();
    isPictured(folder);
  });
}

}  // namespace frontpanels::testing

int main(int count, char** arguments) {
  SetProcessDPIAware();
  return frontpanels::testing::check(count > 1 ? arguments[1] : ".");
}

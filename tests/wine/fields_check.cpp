// The fields of the sited control, used as an operator does: walked through, typed into, collapsed. Leaves
// pictures of the control in the given folder. Prints a line a check, at the end "N passed, N failed".
#include <windows.h>

#include <objbase.h>

#include <algorithm>
#include <functional>
#include <span>
#include <string>
#include <vector>

#include "platform/win32/utf16.h"
#include "tests/wine/com_client.h"
#include "tests/wine/full_container.h"
#include "workbench/window_picture.h"

namespace frontpanels::testing {
namespace {

int screenDpi() {
  const HDC screen = GetDC(nullptr);
  const int dpi = GetDeviceCaps(screen, LOGPIXELSX);
  ReleaseDC(nullptr, screen);
  return dpi;
}

int inPixels(int twips) { return MulDiv(twips, screenDpi(), 1440); }

// Every stop of the Tab key, in order; of options the first stands for its frame.
constexpr const wchar_t* kStops[] = {
    L"CenterFrequencyTextBox", L"FrequencySpanTextBox", L"FrequencyRbwTextBox",
    L"StartFrequencyTextBox",  L"StopFrequencyTextBox", L"SingleSweepButton",
    L"ContinuousSweepButton",  L"StopSweepButton",      L"AverageCountTextBox",
    L"AverageTypeCombo",       L"DisplayLengthTextBox", L"LogPwrOption",
    L"FrequencyOption",        L"ChannelizationCombo",  L"DownlinkOption",
    L"IntervalTimeOption",     L"SweepRateTextBox",     L"WidebandOption",
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
  [[nodiscard]] ComPointer<IDispatch> field(const wchar_t* name) const;
  // The window that has the focus shows the field, whatever shows its name to nobody.
  [[nodiscard]] bool isFocused(const wchar_t* name) const;
  void press(WORD key, WORD held = 0);
  void type(const wchar_t* text);
  static void click(HWND window);
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

ComPointer<IDispatch> Form::field(const wchar_t* name) const {
  const Value found = call(members(), L"Constituent", {name});
  return V_VT(&found.variant()) == VT_DISPATCH ? ComPointer<IDispatch>(V_DISPATCH(&found.variant()))
                                               : ComPointer<IDispatch>();
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

void sendKey(WORD key, bool down) {
  INPUT input{};
  input.type = INPUT_KEYBOARD;
  input.ki.wVk = key;
  input.ki.wScan = static_cast<WORD>(MapVirtualKeyW(key, MAPVK_VK_TO_VSC));
  input.ki.dwFlags = down ? 0 : KEYEVENTF_KEYUP;
  SendInput(1, &input, sizeof input);
}

void Form::press(WORD key, WORD held) {
  if (held != 0) sendKey(held, true);
  sendKey(key, true);
  pump();  // whoever looks at the key's state sees it down
  sendKey(key, false);
  if (held != 0) sendKey(held, false);
  pump();
}

void Form::type(const wchar_t* text) {
  for (; *text != L'\0'; ++text) PostMessageW(GetFocus(), WM_CHAR, *text, 1);
  pump();
}

void Form::click(HWND window) {
  SendMessageW(window, WM_MOUSEACTIVATE, reinterpret_cast<WPARAM>(GetAncestor(window, GA_ROOT)),
               MAKELPARAM(HTCLIENT, WM_LBUTTONDOWN));
  PostMessageW(window, WM_LBUTTONDOWN, MK_LBUTTON, MAKELPARAM(2, 2));
  PostMessageW(window, WM_LBUTTONUP, 0, MAKELPARAM(2, 2));
}

std::wstring classOf(HWND window) {
  wchar_t name[64] = L"";
  GetClassNameW(window, name, 64);
  return name;
}

std::wstring textOf(HWND window) {
  wchar_t text[256] = L"";
  GetWindowTextW(window, text, 256);
  return text;
}

// A letter that is typed into the window arrives in the field; a caption is the same on both.
bool Form::isFocused(const wchar_t* name) const {
  const HWND focus = GetFocus();
  const auto constituent = field(name);
  if (!constituent || !IsChild(hosted.window(), focus)) return false;
  if (std::wstring(name).ends_with(L"Combo")) return classOf(focus) == L"ComboBox";
  if (classOf(focus) == L"Edit") {
    SendMessageW(focus, EM_SETSEL, 0, -1);
    SendMessageW(focus, EM_REPLACESEL, TRUE, reinterpret_cast<LPARAM>(L"8"));
    const bool arrived = call(*constituent.get(), L"Text").text() == L"8";
    return SendMessageW(focus, EM_UNDO, 0, 0), arrived;
  }
  std::wstring caption = textOf(focus);
  std::erase(caption, L'&');
  return caption == call(*constituent.get(), L"Caption").text();
}

// --- Keyboard

std::vector<const wchar_t*> stopsInUse(const Form& form) {
  std::vector<const wchar_t*> stops;
  for (const wchar_t* const name : kStops)
    if (const auto field = form.field(name); field && call(*field.get(), L"Enabled").number() != 0)
      stops.push_back(name);
  return stops;
}

// What a loop does with Tab and with Shift+Tab past the ends is told by `left`.
void isWalkedThrough(Form& form, const char* how, const std::function<bool(bool forward)>& left) {
  const std::vector<const wchar_t*> stops = stopsInUse(form);
  std::wstring strayed;
  std::size_t reached = 0;
  for (; reached < stops.size() && strayed.empty(); ++reached) {
    form.press(VK_TAB);
    if (!form.isFocused(stops[reached])) strayed = stops[reached];
  }
  expect(strayed.empty() && reached > 20, std::string(how) + ": Tab goes through the fields in their order" +
                                              (strayed.empty() ? "" : ", but not to " + toUtf8(strayed)));
  form.press(VK_TAB);
  expect(left(true), std::string(how) + ": and leads out behind the last");
}

void tabInAContainer() {
  Form form(Form::Loop::Container);
  SetFocus(form.hosted.window());
  expect(form.container.count("OnFocus") == 1 && form.container.count("OnUIActivate") == 1,
         "the graph can have the focus");
  isWalkedThrough(form, "container", [&](bool) {
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
  isWalkedThrough(form, "dialog", [&](bool) { return GetFocus() == form.after; });
  form.press(VK_TAB, VK_SHIFT);
  expect(form.isFocused(L"CloseButton"), "dialog: Shift+Tab enters by the last field");
  SetFocus(form.before);
  form.press(VK_TAB);
  form.press(VK_TAB, VK_SHIFT);
  expect(GetFocus() == form.before, "dialog: and leaves before the first");
}

// --- Mouse

// The windows of a class inside the control, from the topmost on.
std::vector<HWND> windowsOf(HWND parent, const wchar_t* className) {
  std::vector<HWND> found;
  for (HWND child = GetWindow(parent, GW_CHILD); child != nullptr; child = GetWindow(child, GW_HWNDNEXT)) {
    if (classOf(child) == className) found.push_back(child);
    const std::vector<HWND> inside = windowsOf(child, className);
    found.insert(found.end(), inside.begin(), inside.end());
  }
  return found;
}

// The first text box of the area at the bottom.
HWND centerBox(const Form& form) {
  const std::vector<HWND> boxes = windowsOf(form.hosted.window(), L"Edit");
  const auto lowest = std::max_element(boxes.begin(), boxes.end(), [](HWND a, HWND b) {
    RECT first{};
    RECT second{};
    GetWindowRect(GetParent(a), &first);
    GetWindowRect(GetParent(b), &second);
    return first.top < second.top;
  });
  return lowest == boxes.end() ? nullptr : *lowest;
}

void isClickedAndTypedInto() {
  Form form(Form::Loop::Container);
  SetFocus(form.before);
  Form::click(centerBox(form));
  form.pump();
  expect(form.container.count("OnUIActivate") == 1 && form.container.count("OnFocus") == 1 &&
             form.isFocused(L"CenterFrequencyTextBox"),
         "a click on a field makes the control active, and the field has the focus");
  form.type(L"881.52");
  const auto center = form.field(L"CenterFrequencyTextBox");
  expect(center && call(*center.get(), L"Text").text() == L"881.52", "what is typed arrives in it");
  form.press(VK_HOME);
  form.type(L"1");
  expect(center && call(*center.get(), L"Text").text() == L"1881.52" &&
             form.container.count("TranslateAccelerator") == 0,
         "Home is the field's own");
  CONTROLINFO info{};
  info.cb = sizeof info;
  form.hosted.object.query<IOleControl>()->GetControlInfo(&info);
  MSG enter{GetFocus(), WM_KEYDOWN, VK_RETURN, 0, 0, {}};
  expect(info.dwFlags == CTRLINFO_EATS_RETURN &&
             form.hosted.object.query<IOleInPlaceActiveObject>()->TranslateAccelerator(&enter) == S_OK &&
             form.container.count("TranslateAccelerator") == 0,
         "Enter too");
  Form::click(form.hosted.window());
  form.pump();
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
}

// --- Pictures

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
    publish(carrier());
    form.pump();
    const std::string stem = folder + "\\panel_" + shot.name + "_" + std::to_string(screenDpi());
    workbench::saveWindowPicture(form.hosted.window(), stem + ".png");
  }
}

}  // namespace

int check(const std::string& folder) {
  OleInitialize(nullptr);
  const auto diagnostics = create<IDispatch>(L"FrontPanels.Diagnostics");
  put(*diagnostics.get(), L"ShowMessages", false);
  chapter("fields of the control");
  tabInAContainer();
  tabInADialog();
  isClickedAndTypedInto();
  isPartOfTheControl();
  isPictured(folder);
  OleUninitialize();
  return verdict();
}

}  // namespace frontpanels::testing

int main(int count, char** arguments) {
  SetProcessDPIAware();
  return frontpanels::testing::check(count > 1 ? arguments[1] : ".");
}

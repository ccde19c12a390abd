// The fields of a panel as real windows, used as a user does: by keyboard, mouse and wheel. Leaves a picture
// of the panel in the given folder. Prints a line a check, at the end "N passed, N failed".
#include <windows.h>

#include <commctrl.h>
#include <objbase.h>

#include <optional>
#include <string>
#include <vector>

#include "platform/runtime_error.h"
#include "platform/win32/utf16.h"
#include "platform/win32/win32_controls.h"
#include "tests/wine/com_client.h"
#include "workbench/window_picture.h"

namespace frontpanels::testing {
namespace {

using Kind = ControlKind;
using Texts = std::vector<std::string>;

constexpr int kPanelWidthTwips = 7200;
constexpr int kPanelHeightTwips = 4350;

constexpr ControlRow kRows[] = {
    {"SideArea", Kind::Picture, "", "", {0, 0, 7200, 3600}},
    {"FrequencyFrame", Kind::Frame, "SideArea", "Frequency", {120, 60, 3420, 1980}},
    {"CenterLabel", Kind::Label, "FrequencyFrame", "&Center", {120, 360, 900, 240}, 0},
    {"CenterTextBox", Kind::TextBox, "FrequencyFrame", "", {1080, 330, 1800, 285}, 1},
    {"CenterSpinButton", Kind::SpinButton, "FrequencyFrame", "", {2880, 330, 270, 285}},
    {"SpanLabel", Kind::Label, "FrequencyFrame", "S&pan", {120, 765, 900, 240}, 2},
    {"SpanTextBox", Kind::TextBox, "FrequencyFrame", "", {1080, 735, 1800, 285}, 3},
    {"SpanSpinButton", Kind::SpinButton, "FrequencyFrame", "", {2880, 735, 270, 285}},
    {"RbwLabel", Kind::Label, "FrequencyFrame", "RBW", {120, 1170, 900, 240}, 4},
    {"RbwTextBox", Kind::TextBox, "FrequencyFrame", "", {1080, 1140, 1800, 285}, 5},
    {"RbwSpinButton", Kind::SpinButton, "FrequencyFrame", "", {2880, 1140, 270, 285}},
    {"NameLabel", Kind::Label, "FrequencyFrame", "&Name", {120, 1575, 900, 240}, 6},
    {"NameTextBox", Kind::TextBox, "FrequencyFrame", "", {1080, 1545, 2070, 285}, 7},
    {"TraceFrame", Kind::Frame, "SideArea", "Trace", {3660, 60, 3420, 1980}},
    {"TypeLabel", Kind::Label, "TraceFrame", "A&veraging", {120, 375, 1020, 240}, 8},
    {"TypeCombo", Kind::ComboBox, "TraceFrame", "", {1200, 330, 2100, 315}, 9},
    {"PnListBox", Kind::ListBox, "TraceFrame", "", {1200, 750, 2100, 840}, 10},
    {"AutoScaleBox", Kind::CheckBox, "TraceFrame", "A&utoScale", {1200, 1650, 2100, 255}, 11},
    {"UnitsFrame", Kind::Frame, "SideArea", "Units", {120, 2130, 3420, 1260}},
    {"FrequencyOption", Kind::OptionButton, "UnitsFrame", "F&requency", {240, 330, 2700, 255}, 12},
    {"ChannelOption", Kind::OptionButton, "UnitsFrame", "C&hannel", {240, 660, 2700, 255}, 13},
    {"IntervalFrame", Kind::Frame, "SideArea", "Meas. Interval", {3660, 2130, 3420, 1260}},
    {"TimeOption", Kind::OptionButton, "IntervalFrame", "&Time", {240, 330, 2700, 255}, 14},
    {"DistanceOption", Kind::OptionButton, "IntervalFrame", "&Distance", {240, 660, 2700, 255}, 15},
    {"SingleButton", Kind::PushButton, "", "&Single", {120, 3780, 1200, 375}, 16},
    {"StopButton", Kind::PushButton, "", "St&op", {1440, 3780, 1200, 375}, 17},
    {"HiddenButton", Kind::PushButton, "", "&Hidden", {2760, 3780, 1200, 375}, 18, false},
    {"CloseButton", Kind::PushButton, "", "C&lose", {5880, 3780, 1200, 375}, 19},
};

int screenDpi() {
  const HDC screen = GetDC(nullptr);
  const int dpi = GetDeviceCaps(screen, LOGPIXELSX);
  ReleaseDC(nullptr, screen);
  return dpi;
}

int inPixels(int twips) { return MulDiv(twips, screenDpi(), 1440); }

// One for all panels, as the window system takes its time to show one.
HWND frameWindow() {
  static const HWND frame = [] {
    const HWND made = CreateWindowExW(0, L"STATIC", L"", WS_POPUP | WS_CLIPCHILDREN | WS_VISIBLE, 0, 0,
                                      inPixels(kPanelWidthTwips), inPixels(kPanelHeightTwips), nullptr,
                                      nullptr, nullptr, nullptr);
    SetForegroundWindow(made);
    return made;
  }();
  return frame;
}

// A window that holds the panel as a control's window would.
class SamplePanel {
 public:
  SamplePanel();
  ~SamplePanel() {
    controls.reset();
    DestroyWindow(window);
  }
  SamplePanel(const SamplePanel&) = delete;
  SamplePanel& operator=(const SamplePanel&) = delete;

  [[nodiscard]] HWND of(const char* name) const { return controls->window(set.control(name)); }
  [[nodiscard]] std::string focus() const { return set.focused() == nullptr ? "" : set.focused()->name(); }
  [[nodiscard]] bool focusIs(const char* name) const { return focus() == name && GetFocus() == of(name); }
  [[nodiscard]] std::string windowText(const char* name) const {
    wchar_t text[100] = {};
    GetWindowTextW(of(name), text, 100);
    return toUtf8(text);
  }
  [[nodiscard]] Texts taken() { return std::exchange(events, {}); }
  void pump();

  ControlSet set{kRows};
  Texts events;
  int failures = 0;
  HWND window = nullptr;
  std::optional<Win32Controls> controls;

 private:
  static LRESULT CALLBACK procedure(HWND window, UINT message, WPARAM wide, LPARAM extra) noexcept;
  void fill();
};

void SamplePanel::fill() {
  for (const auto& control : set.controls()) {
    const auto log = [this, name = control->name()](const char* what) {
      return [this, name, what] { events.push_back(name + " " + what); };
    };
    control->GotFocus = log("got");
    control->LostFocus = log("lost");
    control->Click = log("click");
    if (auto* const spin = dynamic_cast<SpinButton*>(control.get())) {
      spin->SpinUp = log("up");
      spin->SpinDown = log("down");
    }
  }
  set.textBox("CenterTextBox").Text("98.1 MHz");
  set.textBox("SpanTextBox").Text("20 MHz");
  set.textBox("RbwTextBox").Text("100 kHz");
  set.textBox("NameTextBox").Text("Gr\xC3\xBC\xC3\x9F Gott & more");
  set.control("RbwLabel").Enabled(false);
  set.control("RbwTextBox").Enabled(false);
  set.control("RbwSpinButton").Enabled(false);
  int data = 0;
  for (const char* const text : {"Off", "Linear", "Exponential", "Max Hold", "Min Hold"})
    set.list("TypeCombo").AddItem(text, data++);
  set.list("TypeCombo").ListIndex(1);
  for (const char* const text : {"PN 12", "PN 84", "PN 128", "PN 508"})
    set.list("PnListBox").AddItem(text, 0);
  set.list("PnListBox").ListIndex(2);
  set.checkBox("AutoScaleBox").Value(1);
  set.optionButton("FrequencyOption").Value(true);
  set.optionButton("DistanceOption").Value(true);
  set.control("DistanceOption").Bold(true);
  set.control("StopButton").Enabled(false);
  events.clear();
}

SamplePanel::SamplePanel() {
  fill();
  WNDCLASSEXW description{};
  description.cbSize = sizeof description;
  description.lpfnWndProc = procedure;
  description.hInstance = GetModuleHandleW(nullptr);
  description.hbrBackground = GetSysColorBrush(COLOR_BTNFACE);
  description.lpszClassName = L"SamplePanel";
  RegisterClassExW(&description);
  window = CreateWindowExW(0, L"SamplePanel", L"", WS_CHILD | WS_VISIBLE | WS_CLIPCHILDREN, 0, 0,
                           inPixels(kPanelWidthTwips), inPixels(kPanelHeightTwips), frameWindow(), nullptr,
                           GetModuleHandleW(nullptr), this);
  controls.emplace(set, [this](const std::function<void()>& body) {
    try {
      body();
    } catch (const RuntimeError&) {
      ++failures;
    }
  });
  controls->create(window);
  pump();
}

LRESULT CALLBACK SamplePanel::procedure(HWND window, UINT message, WPARAM wide, LPARAM extra) noexcept {
  if (message == WM_NCCREATE)
    SetWindowLongPtrW(
        window, GWLP_USERDATA,
        reinterpret_cast<LONG_PTR>(reinterpret_cast<const CREATESTRUCTW*>(extra)->lpCreateParams));
  auto* const self = reinterpret_cast<SamplePanel*>(GetWindowLongPtrW(window, GWLP_USERDATA));
  LRESULT result = 0;
  if (self != nullptr && self->controls && self->controls->parentMessage(message, wide, extra, result))
    return result;
  return DefWindowProcW(window, message, wide, extra);
}

void SamplePanel::pump() {
  MSG message{};
  while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) {
    if (controls && controls->translateKey(message)) continue;
    TranslateMessage(&message);
    DispatchMessageW(&message);
  }
}

// --- What a user does

void sendKey(WORD key, bool down) {
  INPUT input{};
  input.type = INPUT_KEYBOARD;
  input.ki.wVk = key;
  input.ki.wScan = static_cast<WORD>(MapVirtualKeyW(key, MAPVK_VK_TO_VSC));
  input.ki.dwFlags = down ? 0 : KEYEVENTF_KEYUP;
  SendInput(1, &input, sizeof input);
}

void press(SamplePanel& panel, WORD key, WORD held = 0) {
  if (held != 0) sendKey(held, true);
  sendKey(key, true);
  sendKey(key, false);
  if (held != 0) sendKey(held, false);
  panel.pump();
}

void type(SamplePanel& panel, const wchar_t* text) {
  for (; *text != 0; ++text) PostMessageW(GetFocus(), WM_CHAR, *text, 1);
  panel.pump();
}

// In a window, in hundredths of its width and height.
void clickAt(SamplePanel& panel, HWND window, int x, int y) {
  RECT client{};
  GetClientRect(window, &client);
  const LPARAM at = MAKELPARAM(client.right * x / 100, client.bottom * y / 100);
  PostMessageW(window, WM_LBUTTONDOWN, MK_LBUTTON, at);
  PostMessageW(window, WM_LBUTTONUP, 0, at);
  panel.pump();
}

void turnWheel(SamplePanel& panel, HWND window, int delta) {
  PostMessageW(window, WM_MOUSEWHEEL, MAKEWPARAM(0, static_cast<WORD>(delta)), 0);
  panel.pump();
}

std::string joined(const Texts& texts) {
  std::string all;
  for (const std::string& text : texts) all += (all.empty() ? "" : ", ") + text;
  return all;
}

void expectEvents(SamplePanel& panel, const Texts& wanted, const std::string& what) {
  const Texts events = panel.taken();
  expect(events == wanted, what + (events == wanted ? "" : ": " + joined(events)));
}

// --- Checks

void tabWalksThroughAllFields() {
  SamplePanel panel;
  panel.set.control("CenterTextBox").SetFocus();
  const Texts order = {"CenterTextBox", "SpanTextBox",     "NameTextBox",    "TypeCombo",    "PnListBox",
                       "AutoScaleBox",  "FrequencyOption", "DistanceOption", "SingleButton", "CloseButton"};
  const auto walk = [&](WORD held) {
    Texts names = {panel.focus()};
    for (std::size_t step = 1; step < order.size(); ++step) {
      press(panel, VK_TAB, held);
      if (!panel.focusIs(panel.focus().c_str())) names.emplace_back("the window of another");
      names.push_back(panel.focus());
    }
    return names;
  };
  const Texts forth = walk(0);
  expect(forth == order, "Tab leads through all fields: " + joined(forth));
  press(panel, VK_TAB);
  expect(panel.focusIs("CloseButton"), "and on the last field is left to the container");
  const Texts back = walk(VK_SHIFT);
  expect(back == Texts(order.rbegin(), order.rend()), "Shift+Tab leads back: " + joined(back));
  panel.events.clear();
  press(panel, VK_TAB);
  expectEvents(panel, {"CenterTextBox lost", "SpanTextBox got"},
               "a field is left before the next is entered");
  DWORD begin = 0;
  DWORD end = 0;
  SendMessageW(panel.of("SpanTextBox"), EM_GETSEL, reinterpret_cast<WPARAM>(&begin),
               reinterpret_cast<LPARAM>(&end));
  expect(begin == 0 && end == 6, "which selects its text");
}

void keysReachOptionsAndLabels() {
  SamplePanel panel;
  panel.set.control("FrequencyOption").SetFocus();
  panel.events.clear();
  press(panel, VK_DOWN);
  expect(panel.focusIs("ChannelOption") && panel.set.optionButton("ChannelOption").Value() &&
             SendMessageW(panel.of("ChannelOption"), BM_GETCHECK, 0, 0) == BST_CHECKED &&
             SendMessageW(panel.of("FrequencyOption"), BM_GETCHECK, 0, 0) == BST_UNCHECKED,
         "an arrow chooses the next option");
  expectEvents(panel, {"FrequencyOption lost", "ChannelOption got", "ChannelOption click"}, "and clicks it");
  panel.set.control("TimeOption").SetFocus();
  panel.pump();
  expect(!panel.set.optionButton("TimeOption").Value(), "the focus alone chooses no option");
  press(panel, VK_SPACE);
  expect(panel.set.optionButton("TimeOption").Value(), "the space bar does");
  panel.events.clear();
  press(panel, 'P', VK_MENU);
  expect(panel.focusIs("SpanTextBox"), "a label's access key leads to its field");
  press(panel, 'U', VK_MENU);
  expect(panel.focusIs("AutoScaleBox") && panel.set.checkBox("AutoScaleBox").Value() == 0 &&
             SendMessageW(panel.of("AutoScaleBox"), BM_GETCHECK, 0, 0) == BST_UNCHECKED,
         "that of a check box turns it");
  const auto cues = SendMessageW(panel.of("AutoScaleBox"), WM_QUERYUISTATE, 0, 0);
  expect((cues & (UISF_HIDEACCEL | UISF_HIDEFOCUS)) == 0, "from the first key on the cues are in sight");
  panel.events.clear();
  press(panel, 'S', VK_MENU);
  press(panel, VK_RETURN);
  press(panel, VK_SPACE);
  clickAt(panel, panel.of("SingleButton"), 50, 50);
  expectEvents(panel,
               {"AutoScaleBox lost", "SingleButton got", "SingleButton click", "SingleButton click",
                "SingleButton click", "SingleButton click"},
               "a button is clicked by its key, Enter, the space bar and the mouse");
}

void textGoesBothWays() {
  SamplePanel panel;
  TextBox& box = panel.set.textBox("CenterTextBox");
  clickAt(panel, panel.of("CenterTextBox"), 50, 50);
  type(panel, L"107,7");
  expect(box.Text() == "107,7" && panel.windowText("CenterTextBox") == "107,7",
         "what is typed into a field that was clicked replaces its text");
  type(panel, L"\x1A");
  expect(box.Text() == "98.1 MHz" && panel.windowText("CenterTextBox") == "98.1 MHz", "Ctrl+Z takes it back");
  type(panel, L"\x01\x20AC");
  expect(box.Text() == "\xE2\x82\xAC", "Ctrl+A selects all; a character is kept as UTF-8");
  box.KeyPress = [&](std::int16_t& character) {
    if (character == 'x') character = 0;
    if (character == 'k') box.Text("900 kHz");
    if (character == 'k') character = 0;
  };
  type(panel, L"xy");
  expect(box.Text() == "\xE2\x82\xACy", "a character that was used up does not arrive");
  type(panel, L"k\r");
  expect(panel.windowText("CenterTextBox") == "900 kHz", "a text set while a key is handled shows at once");
  SendMessageW(panel.of("NameTextBox"), WM_SETTEXT, 0, reinterpret_cast<LPARAM>(L"from outside"));
  expect(panel.set.textBox("NameTextBox").Text() == "from outside",
         "a text set from outside reaches the model");
  const std::wstring pasted(65536, L'9');
  SendMessageW(panel.of("NameTextBox"), EM_SETSEL, 0, -1);
  SendMessageW(panel.of("NameTextBox"), EM_REPLACESEL, TRUE, reinterpret_cast<LPARAM>(pasted.c_str()));
  expect(panel.set.textBox("NameTextBox").Text().size() ==
             static_cast<std::size_t>(GetWindowTextLengthW(panel.of("NameTextBox"))),
         "64 KB pasted are taken as far as the window takes them");
}

void valuesStep() {
  SamplePanel panel;
  panel.set.control("NameTextBox").SetFocus();
  panel.events.clear();
  clickAt(panel, panel.of("CenterSpinButton"), 50, 25);
  clickAt(panel, panel.of("CenterSpinButton"), 50, 75);
  expectEvents(panel,
               {"NameTextBox lost", "CenterTextBox got", "CenterSpinButton up", "CenterSpinButton down"},
               "a spin button enters its field and steps");
  press(panel, VK_UP);
  press(panel, VK_DOWN);
  expectEvents(panel, {"CenterSpinButton up", "CenterSpinButton down"}, "the arrow keys step");
  const HWND box = panel.of("CenterTextBox");
  turnWheel(panel, box, 240);
  turnWheel(panel, box, -80);
  turnWheel(panel, box, -80);
  expectEvents(panel, {"CenterSpinButton up", "CenterSpinButton up", "CenterSpinButton down"},
               "the wheel steps once a notch, fine turns added up");
  turnWheel(panel, panel.of("SpanTextBox"), 120);
  turnWheel(panel, panel.of("TypeCombo"), -120);
  expectEvents(panel, {}, "but only the field that has the focus");
  clickAt(panel, panel.of("RbwSpinButton"), 50, 25);
  expectEvents(panel, {}, "a disabled spin button does nothing");
}

void listsDropDownByKeyboard() {
  SamplePanel panel;
  ItemList& list = panel.set.list("TypeCombo");
  const HWND combo = panel.of("TypeCombo");
  const auto dropped = [combo] { return SendMessageW(combo, CB_GETDROPPEDSTATE, 0, 0) != 0; };
  const auto shown = [combo] { return SendMessageW(combo, CB_GETCURSEL, 0, 0); };
  list.SetFocus();
  panel.events.clear();
  press(panel, VK_F4);
  expect(dropped(), "F4 drops the list down");
  press(panel, VK_DOWN);
  press(panel, VK_DOWN);
  expectEvents(panel, {}, "looking through it chooses nothing");
  press(panel, VK_RETURN);
  expect(!dropped() && list.ListIndex() == 3, "Enter chooses");
  expectEvents(panel, {"TypeCombo click"}, "and clicks once");
  press(panel, VK_DOWN, VK_MENU);
  expect(dropped(), "Alt+Down drops it down, too");
  press(panel, VK_UP);
  press(panel, VK_ESCAPE);
  expect(!dropped() && list.ListIndex() == 3 && shown() == 3, "Esc leaves the choice as it was");
  press(panel, VK_DOWN);
  expect(list.ListIndex() == 4, "an arrow chooses in a closed list");
  turnWheel(panel, combo, 120);
  turnWheel(panel, combo, -240);
  expect(list.ListIndex() == 4 && shown() == 4, "and so does the wheel, to the end and no further");
  list.ListIndex(0);
  list.AddItem("Peak", 9, 0);
  panel.pump();
  expect(shown() == 1 && SendMessageW(combo, CB_GETCOUNT, 0, 0) == 6, "what the program changes is shown");
  clickAt(panel, panel.of("PnListBox"), 50, 10);
  expect(panel.set.list("PnListBox").ListIndex() == 0 && panel.focusIs("PnListBox"),
         "a list box is chosen from by the mouse");
}

void statesAreShown() {
  SamplePanel panel;
  expect(!IsWindowEnabled(panel.of("RbwTextBox")) && !IsWindowVisible(panel.of("HiddenButton")),
         "states set before are those of the windows");
  panel.set.control("SpanTextBox").SetFocus();
  panel.events.clear();
  panel.set.frame("FrequencyFrame").Enabled(false);
  expect(!IsWindowEnabled(panel.of("SpanTextBox")) && !IsWindowEnabled(panel.of("CenterSpinButton")),
         "a frame disables what lies in it");
  expect(panel.focusIs("TypeCombo"), "and passes the focus on");
  panel.set.frame("TraceFrame").Visible(false);
  expect(!IsWindowVisible(panel.of("TypeCombo")) && panel.focusIs("FrequencyOption"), "so does a hidden one");
  expectEvents(panel, {"SpanTextBox lost", "TypeCombo got", "TypeCombo lost", "FrequencyOption got"},
               "step by step");
  panel.set.control("SingleButton").Caption("Stop && go");
  expect(panel.windowText("SingleButton") == "Stop && go", "a caption is shown");
}

void eventsMayFailAndTakeTheWindowsAway() {
  {
    SamplePanel panel;
    panel.set.control("SingleButton").Click = [] { raiseOverflow(); };
    clickAt(panel, panel.of("SingleButton"), 50, 50);
    expect(panel.failures == 1 && panel.focusIs("SingleButton"), "what an event raises stops at the window");
  }
  struct Ending {
    const char* what;
    void (*prepare)(SamplePanel&);
    void (*cause)(SamplePanel&);
  };
  const Ending endings[] = {
      {"a click",
       [](SamplePanel& panel) { panel.set.control("CloseButton").Click = [&] { panel.controls.reset(); }; },
       [](SamplePanel& panel) { clickAt(panel, panel.of("CloseButton"), 50, 50); }},
      {"a step",
       [](SamplePanel& panel) {
         panel.set.spinButton("CenterSpinButton").SpinUp = [&] { panel.controls.reset(); };
       },
       [](SamplePanel& panel) { clickAt(panel, panel.of("CenterSpinButton"), 50, 25); }},
      {"a choice",
       [](SamplePanel& panel) { panel.set.control("TypeCombo").Click = [&] { panel.controls.reset(); }; },
       [](SamplePanel& panel) {
         panel.set.control("TypeCombo").SetFocus();
         press(panel, VK_DOWN);
       }},
      {"a key",
       [](SamplePanel& panel) {
         panel.set.control("SpanTextBox").KeyPress = [&](std::int16_t&) { panel.controls.reset(); };
       },
       [](SamplePanel& panel) {
         panel.set.control("SpanTextBox").SetFocus();
         type(panel, L"9");
       }},
      {"leaving a field",
       [](SamplePanel& panel) {
         panel.set.control("SpanTextBox").LostFocus = [&] { DestroyWindow(panel.window); };
       },
       [](SamplePanel& panel) {
         panel.set.control("SpanTextBox").SetFocus();
         press(panel, VK_TAB);
       }},
  };
  for (const Ending& ending : endings) {
    SamplePanel panel;
    const HWND button = panel.of("CloseButton");
    ending.prepare(panel);
    ending.cause(panel);
    expect(!IsWindow(button) && panel.set.control("CloseButton").peer() == nullptr && panel.failures == 0,
           std::string(ending.what) + " may take the windows away");
  }
}

void isScaledAndPictured(const std::string& folder) {
  SamplePanel panel;
  RECT box{};
  GetWindowRect(panel.of("CenterTextBox"), &box);
  MapWindowPoints(nullptr, panel.window, reinterpret_cast<POINT*>(&box), 2);
  const RECT wanted = {inPixels(1200), inPixels(390), inPixels(3000), inPixels(675)};  // in frame and area
  expect(EqualRect(&box, &wanted) != 0,
         "twips become pixels at " + std::to_string(screenDpi()) + " dots an inch");
  expect((GetWindowLongW(panel.of("CenterTextBox"), GWL_STYLE) & ES_RIGHT) != 0 &&
             (GetWindowLongW(panel.of("NameTextBox"), GWL_STYLE) & ES_RIGHT) == 0,
         "numbers stand at the right, names at the left");
  panel.set.control("FrequencyOption").SetFocus();
  press(panel, VK_TAB);
  press(panel, VK_TAB, VK_SHIFT);
  const std::string path = folder + "\\controls_" + std::to_string(screenDpi()) + ".png";
  workbench::saveWindowPicture(panel.window, path);
  expect(GetFileAttributesW(toUtf16(path).c_str()) != INVALID_FILE_ATTRIBUTES, "leaves " + path);

  LOGFONTW larger{};
  GetObjectW(reinterpret_cast<HFONT>(SendMessageW(panel.of("SingleButton"), WM_GETFONT, 0, 0)), sizeof larger,
             &larger);
  larger.lfHeight = larger.lfHeight * 3 / 2;
  const HFONT font = CreateFontIndirectW(&larger);
  panel.controls->rescale(font);
  LOGFONTW bold{};
  GetObjectW(reinterpret_cast<HFONT>(SendMessageW(panel.of("DistanceOption"), WM_GETFONT, 0, 0)), sizeof bold,
             &bold);
  expect(SendMessageW(panel.of("SingleButton"), WM_GETFONT, 0, 0) == reinterpret_cast<LRESULT>(font) &&
             bold.lfHeight == larger.lfHeight && bold.lfWeight == FW_BOLD,
         "a container's font is taken over, also in bold");
  panel.controls.reset();
  DeleteObject(font);
}

void run(const std::string& folder) {
  struct Part {
    const char* name;
    void (*check)();
  };
  const Part parts[] = {{"tab", tabWalksThroughAllFields},
                        {"keys", keysReachOptionsAndLabels},
                        {"text", textGoesBothWays},
                        {"steps", valuesStep},
                        {"lists", listsDropDownByKeyboard},
                        {"states", statesAreShown},
                        {"endings", eventsMayFailAndTakeTheWindowsAway}};
  for (const Part& part : parts) {
    chapter(part.name);
    part.check();
  }
  chapter("scale");
  isScaledAndPictured(folder);
}

}  // namespace
}  // namespace frontpanels::testing

int main(int count, char** arguments) {
  SetProcessDPIAware();
  CoInitializeEx(nullptr, COINIT_APARTMENTTHREADED);
  frontpanels::testing::run(count > 1 ? arguments[1] : ".");
  CoUninitialize();
  return frontpanels::testing::verdict();
}

// The fields of a panel as real windows, used as a user does: by keyboard, mouse and wheel. Leaves a picture
// of the panel in the given folder. Prints a line a check, at the end "N passed, N failed".
#include <windows.h>

#include <objbase.h>

#include <map>
#include <optional>
#include <random>
#include <span>
#include <string>

#include "platform/runtime_error.h"
#include "platform/win32/utf16.h"
#include "platform/win32/win32_controls.h"
#include "tests/support/sample_panel.h"
#include "tests/wine/com_client.h"
#include "tests/wine/panel_user.h"
#include "workbench/window_picture.h"

namespace frontpanels::testing {
namespace {

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

// The panel in a window that holds it as a control's window would.
class WindowPanel final : public SamplePanel, public FieldsOwner {
 public:
  WindowPanel();
  ~WindowPanel() override {
    controls.reset();
    DestroyWindow(window);
  }

  [[nodiscard]] HWND of(const char* name) const { return controls->window(set.control(name)); }
  void take(std::span<const Step> steps);
  void key(const std::string& name) override;
  void type(const std::string& text) override;
  void click(Control& control, int downPercent) override;

  void pump();

  int failures = 0;
  HWND window = nullptr;
  std::optional<Win32Controls> controls;

 protected:
  void wheel(Control& control, int delta) override;
  [[nodiscard]] std::string value(Control& control) override;

 private:
  void run(const std::function<void()>& body) noexcept override;
  static LRESULT CALLBACK procedure(HWND window, UINT message, WPARAM wide, LPARAM extra) noexcept;
};

WindowPanel::WindowPanel() {
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
  controls.emplace(set, *this);
  controls->create(window);
  pump();
}

void WindowPanel::run(const std::function<void()>& body) noexcept {
  try {
    body();
  } catch (const RuntimeError&) {
    ++failures;
  }
}

LRESULT CALLBACK WindowPanel::procedure(HWND window, UINT message, WPARAM wide, LPARAM extra) noexcept {
  if (message == WM_NCCREATE)
    SetWindowLongPtrW(
        window, GWLP_USERDATA,
        reinterpret_cast<LONG_PTR>(reinterpret_cast<const CREATESTRUCTW*>(extra)->lpCreateParams));
  auto* const self = reinterpret_cast<WindowPanel*>(GetWindowLongPtrW(window, GWLP_USERDATA));
  LRESULT result = 0;
  if (self != nullptr && self->controls && self->controls->parentMessage(message, wide, extra, result))
    return result;
  return DefWindowProcW(window, message, wide, extra);
}

void WindowPanel::pump() {
  MSG message{};
  while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) {
    if (controls && controls->translateKey(message)) continue;
    TranslateMessage(&message);
    DispatchMessageW(&message);
  }
}

void WindowPanel::take(std::span<const Step> steps) {
  for (const Step& step : steps) {
    const auto [raised, held] = play(step);
    const bool elsewhere = set.focused() != nullptr && GetFocus() != controls->window(*set.focused());
    const bool good = raised == step.events && held == step.value && !elsewhere;
    expect(good, step.actions + (good ? std::string() : ": [" + raised + "] " + held) +
                     (elsewhere ? ", and the focus is elsewhere" : ""));
  }
}

// --- What a user does

void WindowPanel::key(const std::string& name) {
  static const std::map<std::string, WORD> keys = {{"Tab", VK_TAB}, {"Enter", VK_RETURN}, {"Space", VK_SPACE},
                                                   {"Up", VK_UP},   {"Down", VK_DOWN},    {"Esc", VK_ESCAPE},
                                                   {"F4", VK_F4}};
  const std::size_t plus = name.find('+');
  const std::string last = name.substr(plus + 1);
  const WORD held = plus == std::string::npos ? WORD{0}
                    : name[0] == 'A'          ? WORD{VK_MENU}
                    : name[0] == 'C'          ? WORD{VK_CONTROL}
                                              : WORD{VK_SHIFT};
  press(keys.contains(last) ? keys.at(last) : static_cast<WORD>(last[0]), held, [this] { pump(); });
}

void WindowPanel::type(const std::string& text) {
  for (const wchar_t character : toUtf16(text)) PostMessageW(GetFocus(), WM_CHAR, character, 1);
  pump();
}

void WindowPanel::click(Control& control, int downPercent) {
  const HWND target = controls->window(control);
  RECT client{};
  GetClientRect(target, &client);
  const LPARAM at = MAKELPARAM(client.right / 2, client.bottom * downPercent / 100);
  PostMessageW(target, WM_LBUTTONDOWN, MK_LBUTTON, at);
  PostMessageW(target, WM_LBUTTONUP, 0, at);
  pump();
}

void WindowPanel::wheel(Control& control, int delta) {
  PostMessageW(controls->window(control), WM_MOUSEWHEEL, MAKEWPARAM(0, static_cast<WORD>(delta)), 0);
  pump();
}

// What the window shows; the model's as well where that is something else.
std::string WindowPanel::value(Control& control) {
  pump();
  const HWND shown = controls->window(control);
  const auto ask = [shown](UINT message) { return std::to_string(SendMessageW(shown, message, 0, 0)); };
  std::string seen = toUtf8(textOf(shown));
  const ControlKind kind = control.kind();
  if (kind == ControlKind::ComboBox) seen = ask(CB_GETCURSEL);
  if (kind == ControlKind::ListBox) seen = ask(LB_GETCURSEL);
  if (kind == ControlKind::CheckBox || kind == ControlKind::OptionButton) seen = ask(BM_GETCHECK);
  if (kind == ControlKind::ComboBox && SendMessageW(shown, CB_GETDROPPEDSTATE, 0, 0) != 0) return "down";
  seen += std::string(IsWindowEnabled(shown) ? "" : " disabled") + (IsWindowVisible(shown) ? "" : " hidden");
  const std::string held = SamplePanel::value(control);
  return seen == held ? seen : seen + " for " + held;
}

// --- Checks

constexpr Step kWindowScript[] = {
    {"click Name, type 107", "+Name !Name", "Name 107"},
    {"Ctrl+Z", "", "Name Gr\xC3\xBC\xC3\x9F"},
    {"Ctrl+Z, Ctrl+A, type x", "", "Name x"},
    {"focus Span, Up, Down, wheel Span 240, wheel Span -80",
     "-Name +Span ^SpanSpin vSpanSpin ^SpanSpin ^SpanSpin"},
    {"wheel Span -80, wheel Center 120, wheel Type -120", "vSpanSpin",
     "Type 1"},  // by whole notches, here alone
    {"focus Type, F4", "-Span +Type", "Type down"},
    {"Down, Down", "", "Type down"},  // to look through a list chooses nothing
    {"Enter", "!Type", "Type 3"},
    {"Alt+Down, Up", "", "Type down"},
    {"Esc", "", "Type 3"},
    {"Down", "!Type", "Type 4"},
    {"wheel Type 120, wheel Type -240", "!Type !Type", "Type 4"},  // to the end and no further
    {"click Pn 10", "-Type +Pn !Pn", "Pn 0"},
};

void isUsedAsItsModels() {
  WindowPanel().take(kScript);
  WindowPanel panel;
  panel.take(kWindowScript);
  const auto cues = SendMessageW(panel.of("Auto"), WM_QUERYUISTATE, 0, 0);
  expect((cues & (UISF_HIDEACCEL | UISF_HIDEFOCUS)) == 0, "from the first Alt on the cues are in sight");
  SetWindowTextW(panel.of("Name"), L"from outside");
  panel.set.control("Close").Caption("Stop && go");
  panel.set.list("Type").AddItem("Peak", 0, 0);
  panel.take({{Step{"focus Name", "-Pn +Name", "Name from outside"},
               Step{"focus Name", "", "Close Stop && go"}, Step{"focus Name", "", "Type 5"}}});
  panel.set.control("Span").KeyPress = [](std::int16_t& character) {
    character = character == 'x' ? 0 : 'Y';
  };
  panel.take({{Step{"focus Span, Ctrl+A, type xy", "-Name +Span", "Span Y"}}});
  const std::wstring pasted(65536, L'9');
  SendMessageW(panel.of("Name"), EM_REPLACESEL, TRUE, reinterpret_cast<LPARAM>(pasted.c_str()));
  expect(panel.set.textBox("Name").Text().size() ==
             static_cast<std::size_t>(GetWindowTextLengthW(panel.of("Name"))),
         "64 KB pasted are taken as far as the window takes them");
  panel.set.control("Single").Click = [] { raiseOverflow(); };
  panel.take({{Step{"click Single", "-Span +Single"}}});
  expect(panel.failures == 1, "what an event raises stops at the window, and is told to the owner");
}

void eventsMayTakeTheWindowsAway() {
  struct Ending {
    const char* actions;
    const char* control;
    std::function<void()> Control::*event;
  };
  const Ending endings[] = {
      {"click Close", "Close", &Control::Click},        {"focus Type, Down", "Type", &Control::Click},
      {"focus Name, Tab", "Name", &Control::LostFocus}, {"focus Freq, Tab", "Dist", &Control::GotFocus},
      {"click SpanSpin 25", "SpanSpin", nullptr},       {"focus Span, type 9", "Span", nullptr}};
  for (const bool parentToo : {false, true})
    for (const Ending& ending : endings) {
      WindowPanel panel;
      const HWND button = panel.of("Close");
      const auto end = [&] {
        parentToo ? static_cast<void>(DestroyWindow(panel.window)) : panel.controls.reset();
      };
      Control& control = panel.set.control(ending.control);
      if (ending.event != nullptr) control.*ending.event = end;
      panel.set.spinButton("SpanSpin").SpinUp = end;
      panel.set.control("Span").KeyPress = [end](std::int16_t&) { end(); };
      static_cast<void>(panel.play({ending.actions, ""}));
      expect(!IsWindow(button) && panel.set.control("Close").peer() == nullptr && panel.failures == 0,
             std::string(ending.actions) +
                 (parentToo ? " may destroy the parent" : " may let go of the fields"));
    }
}

// One step of a program that fills a list and changes it, with whatever the window does in between.
void step(WindowPanel& panel, ItemList& list, std::mt19937& random) {
  const std::int32_t count = list.ListCount();
  const auto anywhere = [&] { return static_cast<std::int32_t>(random() % static_cast<unsigned>(count)); };
  const unsigned kind = random() % 100;
  if (kind < 50 || count == 0) return list.AddItem("item " + std::to_string(random() % 1000), 0);
  if (kind < 60) return list.AddItem("early " + std::to_string(random() % 1000), 0, anywhere());
  if (kind < 75) return list.RemoveItem(anywhere());
  if (kind < 85) return list.ListIndex(anywhere());
  if (kind == 85) return list.Clear();
  if (kind < 95) panel.pump();
}

std::string contentsOf(HWND list, bool combo) {
  const auto ask = [&](UINT ofCombo, UINT ofList, int index, void* into) {
    return SendMessageW(list, combo ? ofCombo : ofList, static_cast<WPARAM>(index),
                        reinterpret_cast<LPARAM>(into));
  };
  std::string all = std::to_string(ask(CB_GETCURSEL, LB_GETCURSEL, 0, nullptr));
  for (int index = 0; index < ask(CB_GETCOUNT, LB_GETCOUNT, 0, nullptr); ++index) {
    wchar_t text[100] = {};
    ask(CB_GETLBTEXT, LB_GETTEXT, index, text);
    all += "|" + toUtf8(text);
  }
  return all;
}

void listsFollowTheirModels() {
  WindowPanel panel;
  std::mt19937 random(11);
  for (const char* const name : {"Type", "Pn"}) {
    ItemList& list = panel.set.list(name);
    int strange = 0;
    for (int round = 0; round < 40; ++round) {
      for (int i = 0; i < 50; ++i) step(panel, list, random);
      panel.pump();
      std::string wanted = std::to_string(list.ListIndex());
      for (std::int32_t index = 0; index < list.ListCount(); ++index) wanted += "|" + list.item(index).text;
      strange += contentsOf(panel.of(name), list.kind() == ControlKind::ComboBox) != wanted;
    }
    expect(strange == 0, std::string(name) + " shows its items and its choice, however they came and went");
  }
}

void isScaledAndPictured(const std::string& folder) {
  WindowPanel panel;
  const RECT box = placeIn(panel.window, panel.of("Center"));
  const RECT wanted = {inPixels(1200), inPixels(390), inPixels(3000), inPixels(675)};  // in frame and area
  expect(EqualRect(&box, &wanted) != 0,
         "twips become pixels at " + std::to_string(screenDpi()) + " dots an inch");
  panel.set.textBox("Span").Text("20 MHz");
  panel.set.textBox("Rbw").Text("100 kHz");
  static_cast<void>(panel.play({"focus Freq, Tab, Shift+Tab", ""}));
  workbench::saveWindowPicture(panel.window, folder + "\\controls_" + std::to_string(screenDpi()) + ".png");

  LOGFONTW larger = fontOf(panel.of("Single"));
  larger.lfHeight = larger.lfHeight * 3 / 2;
  const HFONT font = CreateFontIndirectW(&larger);
  panel.controls->rescale(font);
  const LOGFONTW bold = fontOf(panel.of("Dist"));
  expect(fontOf(panel.of("Single")).lfHeight == larger.lfHeight && bold.lfHeight == larger.lfHeight &&
             bold.lfWeight == FW_BOLD,
         "a container's font is taken over, also in bold");
  panel.controls.reset();
  DeleteObject(font);
}

}  // namespace
}  // namespace frontpanels::testing

int main(int count, char** arguments) {
  using namespace frontpanels::testing;
  SetProcessDPIAware();
  CoInitializeEx(nullptr, COINIT_APARTMENTTHREADED);
  chapter("fields");
  isUsedAsItsModels();
  eventsMayTakeTheWindowsAway();
  listsFollowTheirModels();
  isScaledAndPictured(count > 1 ? arguments[1] : ".");
  CoUninitialize();
  return verdict();
}

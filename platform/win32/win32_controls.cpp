#include "platform/win32/win32_controls.h"

#include <commctrl.h>

#include <algorithm>
#include <array>
#include <iterator>
#include <map>
#include <type_traits>
#include <utility>
#include <vector>

#include "platform/runtime_error.h"
#include "platform/win32/field_window.h"

namespace frontpanels {
namespace {

constexpr int kTwipsPerInch = 1440;
constexpr int kUsualDpi = 96;

struct DeleteFont {
  void operator()(HFONT font) const noexcept { DeleteObject(font); }
};
using OwnFont = std::unique_ptr<std::remove_pointer_t<HFONT>, DeleteFont>;

int screenDpi() {
  const HDC screen = GetDC(nullptr);
  const int dpi = screen == nullptr ? 0 : GetDeviceCaps(screen, LOGPIXELSX);
  if (screen != nullptr) ReleaseDC(nullptr, screen);
  return dpi > 0 ? dpi : kUsualDpi;
}

// Windows before 10 have one scale for all screens.
int dpiOf(HWND window) {
  using Ask = UINT(WINAPI*)(HWND);
  static const auto kAsk = reinterpret_cast<Ask>(
      reinterpret_cast<void*>(GetProcAddress(GetModuleHandleW(L"user32.dll"), "GetDpiForWindow")));
  const int dpi = kAsk == nullptr ? 0 : static_cast<int>(kAsk(window));
  return dpi > 0 ? dpi : screenDpi();
}

int pixels(float twips, int dpi) { return MulDiv(static_cast<int>(twips), dpi, kTwipsPerInch); }

LOGFONTW dialogFont(int dpi) {
  NONCLIENTMETRICSW metrics{};
  metrics.cbSize = sizeof metrics;
  LOGFONTW font{};
  if (SystemParametersInfoW(SPI_GETNONCLIENTMETRICS, sizeof metrics, &metrics, 0) != 0)
    font = metrics.lfMessageFont;
  font.lfHeight = MulDiv(font.lfHeight, dpi, screenDpi());
  return font;
}

// The font's variants, by bold + 2 x italic. The first is the given one itself, if there is one.
class FieldFonts {
 public:
  FieldFonts() = default;
  FieldFonts(HFONT given, int dpi) : given_(given) {
    LOGFONTW plain{};
    if (given == nullptr || GetObjectW(given, sizeof plain, &plain) == 0) plain = dialogFont(dpi);
    for (std::size_t variant = given == nullptr ? 0 : 1; variant < made_.size(); ++variant) {
      LOGFONTW font = plain;
      if ((variant & 1U) != 0) font.lfWeight = FW_BOLD;
      if ((variant & 2U) != 0) font.lfItalic = TRUE;
      made_[variant].reset(CreateFontIndirectW(&font));
    }
  }

  [[nodiscard]] HFONT of(const Control& control) const {
    const std::size_t variant = (control.Bold() ? 1U : 0U) + (control.Italic() ? 2U : 0U);
    return variant == 0 && given_ != nullptr ? given_ : made_[variant].get();
  }

 private:
  HFONT given_ = nullptr;
  std::array<OwnFont, 4> made_;
};

// Windows stand in the nearest picture; frames are drawn round their controls and hold no windows.
const Control* areaOf(const Control& control) {
  const Control* area = control.parent();
  while (area != nullptr && area->kind() != ControlKind::Picture) area = area->parent();
  return area;
}

}  // namespace

class FieldWindows final : public FieldSite {
 public:
  FieldWindows(ControlSet& set, Win32Controls::Barrier barrier) : set_(set), barrier_(std::move(barrier)) {}

  void create(HWND parent, HFONT font);
  void destroy() noexcept;
  void rescale(HFONT font);
  bool translateKey(const MSG& message);
  [[nodiscard]] FieldWindow* fieldOf(const Control& control) const noexcept;

  // FieldSite
  void run(const std::function<void()>& body) noexcept override;
  void arrange() override;
  void showUsability() override;
  [[nodiscard]] HFONT fontOf(const Control& control) const override { return fonts_.of(control); }
  [[nodiscard]] SpinButton* spinOf(const Control& control) const override;
  bool childMessage(UINT message, WPARAM wide, LPARAM extra, LRESULT& result) override;

 protected:
  void allLeft() noexcept override { retired_.clear(); }

 private:
  using Fields = std::vector<std::unique_ptr<FieldWindow>>;

  void makeWindows();
  void orderWindows();
  [[nodiscard]] DWORD tabStyle(const Control& control) const;
  [[nodiscard]] RECT placeOf(const Control& control) const;
  [[nodiscard]] FieldWindow* fieldOf(HWND window) const noexcept;
  bool pressed(const MSG& message);
  void showCues(WORD hidden) const;

  ControlSet& set_;
  Win32Controls::Barrier barrier_;
  HWND parent_ = nullptr;
  FieldFonts fonts_;
  Fields fields_;
  Fields retired_;
};

// --- Making and placing

void FieldWindows::create(HWND parent, HFONT font) {
  destroy();
  parent_ = parent;
  fonts_ = FieldFonts(font, dpiOf(parent));
  try {
    makeWindows();
  } catch (...) {
    destroy();
    throw;
  }
  arrange();
  orderWindows();
}

void FieldWindows::makeWindows() {
  for (const std::unique_ptr<Control>& control : set_.controls()) {
    const Control* const area = areaOf(*control);
    fields_.push_back(makeFieldWindow(*control, *this));
    fields_.back()->create(area == nullptr ? parent_ : fieldOf(*area)->window(), placeOf(*control),
                           tabStyle(*control));
  }
}

// What reads a panel aloud takes a field's name from the window before it, so the labels go before the
// fields.
void FieldWindows::orderWindows() {
  const auto behind = [this](const Control& control, HWND before) {
    const HWND window = fieldOf(control)->window();
    SetWindowPos(window, before, 0, 0, 0, 0, SWP_NOMOVE | SWP_NOSIZE | SWP_NOACTIVATE);
    return window;
  };
  std::map<const Control*, HWND> last;  // by area
  for (Control* const control : set_.tabOrder()) {
    HWND& before = last.try_emplace(areaOf(*control), HWND_TOP).first->second;
    before = behind(*control, before);
    if (SpinButton* const spin = spinOf(*control)) before = behind(*spin, before);
  }
}

// For containers that walk through their dialogs' windows by themselves.
DWORD FieldWindows::tabStyle(const Control& control) const {
  const auto order = set_.tabOrder();
  if (!facetsOf(control.kind()).takesFocus || std::find(order.begin(), order.end(), &control) == order.end())
    return 0;
  const auto* const option = dynamic_cast<const OptionButton*>(&control);
  const bool follows = option != nullptr && option->group()->front() != option;
  return follows ? 0 : WS_TABSTOP | WS_GROUP;
}

void FieldWindows::destroy() noexcept {
  Fields gone;
  gone.swap(fields_);
  for (const auto& field : gone) field->destroy();
  // The procedure of one of them may be what has led here.
  if (visited()) std::move(gone.begin(), gone.end(), std::back_inserter(retired_));
}

void FieldWindows::rescale(HFONT font) {
  if (parent_ == nullptr) return;
  const FieldFonts before = std::exchange(fonts_, FieldFonts(font, dpiOf(parent_)));
  for (const auto& field : fields_) field->showFont();
  arrange();
}

RECT FieldWindows::placeOf(const Control& control) const {
  ControlPlace place = control.place();
  const Control* const area = areaOf(control);
  for (const Control* frame = control.parent(); frame != area; frame = frame->parent()) {
    place.leftTwips += frame->place().leftTwips;
    place.topTwips += frame->place().topTwips;
  }
  const int dpi = dpiOf(parent_);
  return {pixels(place.leftTwips, dpi), pixels(place.topTwips, dpi),
          pixels(place.leftTwips + place.widthTwips, dpi), pixels(place.topTwips + place.heightTwips, dpi)};
}

void FieldWindows::arrange() {
  for (const auto& field : fields_)
    if (field->window() != nullptr) field->place(placeOf(field->control()));
}

// By index: a field that is disabled loses the focus, and what then happens may take the fields away.
void FieldWindows::showUsability() {
  for (std::size_t index = 0; index < fields_.size(); ++index)
    if (fields_[index]->window() != nullptr) fields_[index]->showUsability();
}

// --- Looking up

FieldWindow* FieldWindows::fieldOf(const Control& control) const noexcept {
  const auto found = std::find_if(fields_.begin(), fields_.end(),
                                  [&](const auto& field) { return &field->control() == &control; });
  return found == fields_.end() ? nullptr : found->get();
}

FieldWindow* FieldWindows::fieldOf(HWND window) const noexcept {
  const auto found = std::find_if(fields_.begin(), fields_.end(),
                                  [&](const auto& field) { return field->window() == window; });
  return window == nullptr || found == fields_.end() ? nullptr : found->get();
}

SpinButton* FieldWindows::spinOf(const Control& control) const {
  for (const std::unique_ptr<Control>& other : set_.controls())
    if (auto* const spin = dynamic_cast<SpinButton*>(other.get());
        spin != nullptr && spin->buddy() == &control)
      return spin;
  return nullptr;
}

// --- Messages

void FieldWindows::run(const std::function<void()>& body) noexcept {
  try {
    if (barrier_)
      barrier_(body);
    else
      body();
  } catch (...) {
    // Nobody was named who would want to know.
  }
}

bool FieldWindows::childMessage(UINT message, WPARAM wide, LPARAM extra, LRESULT& result) {
  result = 0;
  if (message == WM_COMMAND) {
    FieldWindow* const field = fieldOf(reinterpret_cast<HWND>(extra));
    if (field != nullptr) field->notified(HIWORD(wide));
    return field != nullptr;
  }
  if (message != WM_NOTIFY) return false;
  const auto& header = *reinterpret_cast<const NMHDR*>(extra);
  FieldWindow* const field = fieldOf(header.hwndFrom);
  if (field == nullptr || header.code != static_cast<UINT>(UDN_DELTAPOS)) return false;
  field->stepped(reinterpret_cast<const NMUPDOWN*>(extra)->iDelta > 0);
  result = TRUE;  // the position stays, so there is always a next step
  return true;
}

bool FieldWindows::translateKey(const MSG& message) {
  bool used = false;
  const auto body = [&] { used = pressed(message); };
  if (parent_ != nullptr && (message.hwnd == parent_ || IsChild(parent_, message.hwnd))) run(std::cref(body));
  return used;
}

bool FieldWindows::pressed(const MSG& message) {
  if (message.message == WM_SYSKEYDOWN && message.wParam == VK_MENU)
    showCues(UISF_HIDEACCEL | UISF_HIDEFOCUS);
  bool moved = false;
  if (message.message == WM_SYSCHAR) {
    moved = set_.accessKey(static_cast<char32_t>(message.wParam));
  } else if (message.message == WM_KEYDOWN && set_.focused() != nullptr && GetKeyState(VK_CONTROL) >= 0) {
    const WPARAM key = message.wParam;
    if (key == VK_TAB)
      moved = set_.tab(GetKeyState(VK_SHIFT) >= 0);
    else if (key == VK_UP || key == VK_LEFT || key == VK_DOWN || key == VK_RIGHT)
      moved = set_.arrow(key == VK_DOWN || key == VK_RIGHT);
  }
  if (!moved) return false;
  showCues(UISF_HIDEFOCUS);
  if (auto* const box = dynamic_cast<TextBox*>(set_.focused())) box->selectAll();
  return true;
}

// Underlined keys and focus rectangles come into sight with the first key that needs them.
void FieldWindows::showCues(WORD hidden) const {
  SendMessageW(parent_, WM_CHANGEUISTATE, MAKEWPARAM(UIS_CLEAR, hidden), 0);
}

// --- The owner's side

Win32Controls::Win32Controls(ControlSet& set, Barrier barrier)
    : windows_(std::make_shared<FieldWindows>(set, std::move(barrier))) {}

Win32Controls::~Win32Controls() { destroy(); }

void Win32Controls::create(HWND parent, HFONT font) { windows_->create(parent, font); }

void Win32Controls::destroy() noexcept {
  const FieldSite::Visit visit(*windows_);
  windows_->destroy();
}

void Win32Controls::rescale(HFONT font) { windows_->rescale(font); }

bool Win32Controls::parentMessage(UINT message, WPARAM wide, LPARAM extra, LRESULT& result) {
  const FieldSite::Visit visit(*windows_);
  FieldWindows& windows = *windows_;  // this may go with an event
  bool used = false;
  const auto body = [&] { used = windows.childMessage(message, wide, extra, result); };
  windows.run(std::cref(body));
  return used;
}

bool Win32Controls::translateKey(const MSG& message) {
  const FieldSite::Visit visit(*windows_);
  return windows_->translateKey(message);
}

HWND Win32Controls::window(const Control& control) const noexcept {
  const FieldWindow* const field = windows_->fieldOf(control);
  return field == nullptr ? nullptr : field->window();
}

}  // namespace frontpanels

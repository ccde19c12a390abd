#include "platform/win32/win32_controls.h"

#include <commctrl.h>

#include <algorithm>
#include <iterator>
#include <map>
#include <utility>
#include <vector>

#include "platform/runtime_error.h"
#include "platform/win32/field_fonts.h"
#include "platform/win32/field_window.h"
#include "platform/win32/win32_windowing.h"

namespace frontpanels {
namespace {

constexpr int kUsualDpi = 96;

// Windows stand in the nearest picture; frames are drawn round their controls and hold no windows.
const Control* areaOf(const Control& control) {
  const Control* area = control.parent();
  while (area != nullptr && area->kind() != ControlKind::Picture) area = area->parent();
  return area;
}

}  // namespace

class FieldWindows final : public FieldSite {
 public:
  FieldWindows(ControlSet& set, FieldsOwner& owner) noexcept : set_(set), owner_(&owner) {}

  void create(HWND parent, HFONT font, int dpi);
  void destroy() noexcept;
  void rescale(HFONT font, int dpi);
  // The owner goes; a message of a field may still be under way.
  void disown() noexcept { owner_ = nullptr; }
  bool translateKey(const MSG& message);
  bool enter(bool forward);
  [[nodiscard]] FieldWindow* fieldOf(const Control& control) const noexcept;

  // FieldSite
  void run(const std::function<void()>& body) noexcept override;
  void arrange(const Control& moved) override;
  void showUsability() override;
  [[nodiscard]] HFONT fontOf(const Control& control) const override { return fonts_.of(control); }
  [[nodiscard]] SpinButton* spinOf(const Control& control) const override;
  bool childMessage(UINT message, WPARAM wide, LPARAM extra, LRESULT& result) override;
  bool untranslatedKey(UINT message, WPARAM key) override;
  void focusMoved(HWND to) override {
    if (owner_ != nullptr) owner_->focusMoved(to);
  }
  [[nodiscard]] bool inUse() const override { return owner_ == nullptr || owner_->inUse(); }
  bool readAloud(const Control& control, WPARAM flags, LRESULT& result) override {
    return owner_ != nullptr && owner_->readAloud(control, fieldOf(control)->window(), flags, result);
  }
  void captionsChanged() override {
    if (owner_ != nullptr) owner_->accessKeysChanged();
  }

 protected:
  void allLeft() noexcept override { retired_.clear(); }

 private:
  using Fields = std::vector<std::unique_ptr<FieldWindow>>;

  void makeWindows();
  void arrange();
  void orderWindows();
  [[nodiscard]] DWORD tabStyle(const Control& control) const;
  [[nodiscard]] RECT placeOf(const Control& control) const;
  [[nodiscard]] FieldWindow* fieldOf(HWND window) const noexcept;
  bool notified(LPARAM extra, LRESULT& result);
  bool pressed(UINT message, WPARAM key);
  void showFocus() const;
  void goOn(bool forward) const;
  void showCues(WORD hidden) const;

  ControlSet& set_;
  FieldsOwner* owner_;
  HWND parent_ = nullptr;
  int dpi_ = kUsualDpi;
  FieldFonts fonts_;
  Fields fields_;
  Fields retired_;
};

// --- Making and placing

void FieldWindows::create(HWND parent, HFONT font, int dpi) {
  destroy();
  retired_.reserve(retired_.size() + set_.controls().size());  // letting go of them must not need memory
  parent_ = parent;
  dpi_ = dpi > 0 ? dpi : dotsPerInch(metricsOf(parent));
  fonts_ = FieldFonts(font, dpi_);
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
  parent_ = nullptr;
  for (const auto& field : gone) field->destroy();
  // The procedure of one of them may be what has led here.
  if (visited()) std::move(gone.begin(), gone.end(), std::back_inserter(retired_));
}

void FieldWindows::rescale(HFONT font, int dpi) {
  if (parent_ == nullptr) return;
  dpi_ = dpi > 0 ? dpi : dotsPerInch(metricsOf(parent_));
  const FieldFonts before = std::exchange(fonts_, FieldFonts(font, dpi_));
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
  return {pixelsOfTwips(place.leftTwips, dpi_), pixelsOfTwips(place.topTwips, dpi_),
          pixelsOfTwips(place.leftTwips + place.widthTwips, dpi_),
          pixelsOfTwips(place.topTwips + place.heightTwips, dpi_)};
}

void FieldWindows::arrange() {
  for (const auto& field : fields_)
    if (field->window() != nullptr) field->place(placeOf(field->control()));
}

// What lies in an area goes with the area's window; a frame holds no windows.
void FieldWindows::arrange(const Control& moved) {
  for (const auto& field : fields_) {
    const Control& control = field->control();
    const bool goesAlong = areaOf(control) == areaOf(moved) && control.liesIn(moved);
    if (field->window() != nullptr && (&control == &moved || goesAlong)) field->place(placeOf(control));
  }
}

// By index: a field that is disabled loses the focus, and what then happens may take the fields away.
void FieldWindows::showUsability() {
  for (std::size_t index = 0; index < fields_.size(); ++index)
    if (fields_[index]->window() != nullptr) fields_[index]->showUsability();
  captionsChanged();
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
  if (owner_ != nullptr) return owner_->run(body);
  try {
    body();
  } catch (...) {
    // Nobody is left who would want to know.
  }
}

bool FieldWindows::childMessage(UINT message, WPARAM wide, LPARAM extra, LRESULT& result) {
  result = 0;
  FieldWindow* field = nullptr;
  switch (message) {
    case WM_COMMAND:
      field = fieldOf(reinterpret_cast<HWND>(extra));
      if (field != nullptr) field->notified(HIWORD(wide));
      return field != nullptr;
    case WM_CTLCOLORSTATIC:
      field = fieldOf(reinterpret_cast<HWND>(extra));
      return field != nullptr && field->colored(reinterpret_cast<HDC>(wide), result);
    case WM_DRAWITEM:
      field = fieldOf(reinterpret_cast<const DRAWITEMSTRUCT*>(extra)->hwndItem);
      if (field != nullptr) field->draw(*reinterpret_cast<const DRAWITEMSTRUCT*>(extra));
      result = TRUE;
      return field != nullptr;
    case WM_NOTIFY:
      return notified(extra, result);
    default:
      return false;
  }
}

bool FieldWindows::notified(LPARAM extra, LRESULT& result) {
  const auto& header = *reinterpret_cast<const NMHDR*>(extra);
  FieldWindow* const field = fieldOf(header.hwndFrom);
  if (field == nullptr || header.code != static_cast<UINT>(UDN_DELTAPOS)) return false;
  field->stepped(reinterpret_cast<const NMUPDOWN*>(extra)->iDelta > 0);
  result = TRUE;  // the position stays, so there is always a next step
  return true;
}

bool FieldWindows::translateKey(const MSG& message) {
  bool used = false;
  const auto body = [&] { used = pressed(message.message, message.wParam); };
  if (parent_ != nullptr && (message.hwnd == parent_ || IsChild(parent_, message.hwnd))) run(std::cref(body));
  return used;
}

bool FieldWindows::pressed(UINT message, WPARAM key) {
  if (message == WM_SYSKEYDOWN && (key == VK_MENU || key == VK_F10))
    showCues(UISF_HIDEACCEL | UISF_HIDEFOCUS);
  bool moved = false;
  if (message == WM_SYSCHAR) {
    moved = set_.accessKey(static_cast<char32_t>(key));
  } else if (message == WM_KEYDOWN && set_.focused() != nullptr && GetKeyState(VK_CONTROL) >= 0) {
    if (key == VK_TAB)
      moved = set_.tab(GetKeyState(VK_SHIFT) >= 0);
    else if (key == VK_UP || key == VK_LEFT || key == VK_DOWN || key == VK_RIGHT)
      moved = set_.arrow(key == VK_DOWN || key == VK_RIGHT);
  }
  if (moved) showFocus();
  return moved;
}

// A text box that is entered by a key is selected, so that what is typed next replaces it.
void FieldWindows::showFocus() const {
  showCues(UISF_HIDEFOCUS);
  if (auto* const box = dynamic_cast<TextBox*>(set_.focused())) box->selectAll();
}

bool FieldWindows::enter(bool forward) {
  bool entered = false;
  const auto body = [&] {
    Control* const first = parent_ == nullptr ? nullptr : set_.nextStop(nullptr, forward);
    if (first == nullptr) return;
    first->SetFocus();
    showFocus();
    entered = true;
  };
  run(std::cref(body));
  return entered;
}

bool FieldWindows::untranslatedKey(UINT message, WPARAM key) {
  if (pressed(message, key)) return true;
  const bool leaves = message == WM_KEYDOWN && key == VK_TAB && GetKeyState(VK_CONTROL) >= 0;
  if (leaves) goOn(GetKeyState(VK_SHIFT) >= 0);
  return leaves;
}

void FieldWindows::goOn(bool forward) const {
  const HWND next = GetNextDlgTabItem(GetAncestor(parent_, GA_ROOT), parent_, static_cast<BOOL>(!forward));
  if (next != nullptr && next != parent_ && !IsChild(parent_, next)) SetFocus(next);
}

// Underlined keys and focus rectangles come into sight with the first key that needs them.
void FieldWindows::showCues(WORD hidden) const {
  SendMessageW(parent_, WM_CHANGEUISTATE, MAKEWPARAM(UIS_CLEAR, hidden), 0);
}

// --- The owner's side

Win32Controls::Win32Controls(ControlSet& set, FieldsOwner& owner)
    : windows_(std::make_shared<FieldWindows>(set, owner)) {}

Win32Controls::~Win32Controls() {
  destroy();
  windows_->disown();
}

void Win32Controls::create(HWND parent, HFONT font, int dpi) { windows_->create(parent, font, dpi); }

void Win32Controls::destroy() noexcept {
  const FieldSite::Visit visit(*windows_);
  windows_->destroy();
}

void Win32Controls::rescale(HFONT font, int dpi) { windows_->rescale(font, dpi); }

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

bool Win32Controls::enter(bool forward) {
  const FieldSite::Visit visit(*windows_);
  return windows_->enter(forward);
}

bool Win32Controls::untranslatedKey(UINT message, WPARAM key) {
  const FieldSite::Visit visit(*windows_);
  FieldWindows& windows = *windows_;
  bool used = false;
  const auto body = [&] { used = windows.untranslatedKey(message, key); };
  windows.run(std::cref(body));
  return used;
}

HWND Win32Controls::window(const Control& control) const noexcept {
  const FieldWindow* const field = windows_->fieldOf(control);
  return field == nullptr ? nullptr : field->window();
}

}  // namespace frontpanels

#include "platform/win32/field_window.h"

#include <commctrl.h>

#include <algorithm>
#include <cstdlib>
#include <cwchar>
#include <iterator>
#include <string>
#include <utility>

#include "platform/runtime_error.h"
#include "platform/win32/utf16.h"
#include "platform/win32/win32_windowing.h"

namespace frontpanels {
namespace {

// The window class of pictures, under a name for each address that this module is loaded at: a class outlives
// its module and would then point into nothing.
const wchar_t* areaClass();

struct NativeKind {
  const wchar_t* className;
  DWORD style;
  DWORD extendedStyle;
};

// In the order of ControlKind. Group boxes leave their inside to the window below; the clipping of children
// must not keep that from painting it.
constexpr NativeKind kNativeKinds[] = {
    {L"BUTTON", BS_GROUPBOX, WS_EX_TRANSPARENT},
    {L"STATIC", SS_LEFT, 0},
    {L"EDIT", ES_AUTOHSCROLL, WS_EX_CLIENTEDGE},
    {UPDOWN_CLASSW, 0, 0},
    {L"COMBOBOX", WS_VSCROLL, 0},
    {L"LISTBOX", LBS_NOTIFY | LBS_NOINTEGRALHEIGHT | WS_VSCROLL, WS_EX_CLIENTEDGE},
    {L"BUTTON", BS_CHECKBOX, 0},
    {L"BUTTON", BS_RADIOBUTTON, 0},
    {L"BUTTON", BS_PUSHBUTTON, 0},
    {nullptr, WS_CLIPCHILDREN, WS_EX_CONTROLPARENT},  // of a class of our own
};

HINSTANCE thisModule() {
  HMODULE module = nullptr;
  GetModuleHandleExW(GET_MODULE_HANDLE_EX_FLAG_FROM_ADDRESS | GET_MODULE_HANDLE_EX_FLAG_UNCHANGED_REFCOUNT,
                     reinterpret_cast<const wchar_t*>(&thisModule), &module);
  return module;
}

const wchar_t* areaClass() {
  static wchar_t name[64];
  static const bool registered = [] {
    std::swprintf(name, std::size(name), L"FrontPanels.Area.%p", reinterpret_cast<void*>(&areaClass));
    WNDCLASSEXW description{};
    description.cbSize = sizeof description;
    description.lpfnWndProc = DefWindowProcW;
    description.hInstance = thisModule();
    description.hCursor = LoadCursorW(nullptr, IDC_ARROW);
    description.hbrBackground = GetSysColorBrush(COLOR_BTNFACE);
    description.lpszClassName = name;
    return RegisterClassExW(&description) != 0 || GetLastError() == ERROR_CLASS_ALREADY_EXISTS;
  }();
  if (!registered) raiseOutOfMemory();
  return name;
}

// The class of spin buttons is there once the library that has it was asked for it. Asked for by name, as a
// control must not need a certain version of it.
void provideSpinButtons() {
  static const bool provided = [] {
    const HMODULE library = LoadLibraryW(L"comctl32.dll");
    if (library == nullptr) return false;
    const auto initialize = reinterpret_cast<BOOL(WINAPI*)(const INITCOMMONCONTROLSEX*)>(
        reinterpret_cast<void*>(GetProcAddress(library, "InitCommonControlsEx")));
    const INITCOMMONCONTROLSEX wanted{sizeof wanted, ICC_UPDOWN_CLASS};
    return initialize != nullptr && initialize(&wanted) != 0;
  }();
  if (!provided) raiseOutOfMemory();
}

std::int16_t shiftState() {
  const auto down = [](int key) { return GetKeyState(key) < 0; };
  return static_cast<std::int16_t>((down(VK_SHIFT) ? 1 : 0) | (down(VK_CONTROL) ? 2 : 0) |
                                   (down(VK_MENU) ? 4 : 0));
}

std::wstring textOf(HWND window) {
  std::wstring text(static_cast<std::size_t>(GetWindowTextLengthW(window)), L'\0');
  const int length = GetWindowTextW(window, text.data(), static_cast<int>(text.size()) + 1);
  text.resize(static_cast<std::size_t>(length));
  return text;
}

// --- Text boxes

class TextField final : public FieldWindow {
 public:
  TextField(TextBox& box, FieldSite& site) noexcept : FieldWindow(box, site), box_(box) {}

  void notified(WORD code) override {
    if (code == EN_CHANGE && !writing_) box_.userText(toUtf8(textOf(window())));
  }

  void changed(ControlChange what) override {
    if (what == ControlChange::Text)
      showContents();
    else if (what == ControlChange::Selection)
      SendMessageW(window(), EM_SETSEL, 0, -1);
    else
      FieldWindow::changed(what);
  }

 protected:
  // Only texts that differ come here: to set one clears what could be undone.
  void showContents() override {
    const std::wstring text = toUtf16(box_.Text());
    writing_ = true;
    SetWindowTextW(window(), text.c_str());
    writing_ = false;
    // Elsewhere the caret would only scroll the beginning of a long text out of sight.
    if (GetFocus() == window())
      SendMessageW(window(), EM_SETSEL, text.size(), static_cast<LPARAM>(text.size()));
  }

  LRESULT handle(UINT message, WPARAM wide, LPARAM extra) override {
    switch (message) {
      case WM_CHAR:
        return character(wide, extra);
      case WM_LBUTTONDOWN:
        // Entering a field selects it, by the mouse as by the keyboard; the next press places the caret.
        if (GetFocus() == window()) break;
        box_.SetFocus();
        if (!gone()) box_.selectAll();
        return 0;
      case WM_LBUTTONUP:
        box_.userClick();
        break;
      default:
        break;
    }
    return FieldWindow::handle(message, wide, extra);
  }

  // A field that hears its keys steps by itself.
  bool keyDown(WPARAM key) override {
    const bool heard = box_.KeyDown != nullptr;
    if (FieldWindow::keyDown(key)) return true;
    if ((key != VK_UP && key != VK_DOWN) || site().spinOf(box_) == nullptr) return false;
    return heard || turned(key == VK_UP);
  }

  LRESULT wantedKeys(WPARAM key) const override {
    return FieldWindow::wantedKeys(key) | (key == VK_RETURN ? DLGC_WANTMESSAGE : 0);
  }

  bool turned(bool up) override {
    SpinButton* const spin = site().spinOf(box_);
    if (spin != nullptr) spin->press(up);
    return spin != nullptr;
  }

 private:
  LRESULT character(WPARAM wide, LPARAM extra) {
    constexpr WPARAM kSelectAll = 1;  // Ctrl+A
    if (wide == kSelectAll) return box_.selectAll(), 0;
    const auto kept = static_cast<std::uint16_t>(typed(wide));
    // One line has no use for these; its class would beep.
    const bool unused = kept == VK_RETURN || kept == VK_ESCAPE;
    return kept == 0 || unused ? 0 : original(WM_CHAR, kept, extra);
  }

  TextBox& box_;
  bool writing_ = false;
};

// --- Combo and list boxes

struct ListMessages {
  UINT reset;
  UINT add;
  UINT insert;
  UINT remove;
  UINT getSelection;
  UINT setSelection;
};
constexpr ListMessages kComboMessages{CB_RESETCONTENT, CB_ADDSTRING, CB_INSERTSTRING,
                                      CB_DELETESTRING, CB_GETCURSEL, CB_SETCURSEL};
constexpr ListMessages kListMessages{LB_RESETCONTENT, LB_ADDSTRING, LB_INSERTSTRING,
                                     LB_DELETESTRING, LB_GETCURSEL, LB_SETCURSEL};

// The window always has the first items of its model, all of them once it has taken in the latest: those that
// are added at the end wait for each other, what changes before that end changes in the window at once.

class ListField final : public FieldWindow {
 public:
  ListField(ItemList& list, FieldSite& site) noexcept
      : FieldWindow(list, site),
        list_(list),
        combo_(list.kind() == ControlKind::ComboBox),
        messages_(combo_ ? kComboMessages : kListMessages) {}

  // A combo box is as high as what stands in it; its window's height is that of the list when it drops down.
  void place(const RECT& px) override {
    if (!combo_) return FieldWindow::place(px);
    constexpr LONG kItemsInSight = 10;
    constexpr WPARAM kField = static_cast<WPARAM>(-1);  // in place of an item's number
    RECT closed{};
    GetWindowRect(window(), &closed);
    const auto fieldPx = static_cast<LONG>(SendMessageW(window(), CB_GETITEMHEIGHT, kField, 0));
    const LONG framePx = closed.bottom - closed.top - fieldPx;
    if (!dropped() && px.bottom - px.top > framePx)
      SendMessageW(window(), CB_SETITEMHEIGHT, kField, px.bottom - px.top - framePx);
    const auto itemPx = static_cast<LONG>(SendMessageW(window(), CB_GETITEMHEIGHT, 0, 0));
    FieldWindow::place({px.left, px.top, px.right, px.bottom + kItemsInSight * itemPx});
  }

  void notified(WORD code) override {
    const bool chosen = combo_ ? code == CBN_SELCHANGE || code == CBN_CLOSEUP : code == LBN_SELCHANGE;
    if (combo_ && code == CBN_DROPDOWN) cancelled_ = false;
    if (combo_ && code == CBN_SELENDCANCEL) cancelled_ = dropped();
    if (chosen) defer(kChoice);
  }

  void changed(ControlChange what) override {
    if (what == ControlChange::Items) {
      empty();
      awaitItems();
    } else if (what == ControlChange::ListIndex) {
      showSelection();
    } else {
      FieldWindow::changed(what);
    }
  }

  void itemAdded(std::int32_t index) override {
    if (index >= shown_) return awaitItems();
    send(messages_.insert, index);
    ++shown_;
    showSelection();
  }

  void itemRemoved(std::int32_t index) override {
    if (index >= shown_) return;
    SendMessageW(window(), messages_.remove, static_cast<WPARAM>(index), 0);
    --shown_;
    showSelection();
  }

 protected:
  void showContents() override {
    empty();
    showNewItems();
    showSelection();
  }

  void deferred(WPARAM work) override {
    if (work == kItems) return showNewItems();
    if (dropped()) return;  // while the list is down, the user is still looking
    if (std::exchange(cancelled_, false)) return showSelection();
    const auto index = static_cast<std::int32_t>(SendMessageW(window(), messages_.getSelection, 0, 0));
    if (index != list_.ListIndex() && index >= 0) list_.userChoice(index);
  }

  bool turned(bool up) override {
    if (!combo_) return false;
    const std::int32_t index = list_.ListIndex() + (up ? -1 : 1);
    if (index >= 0 && index < list_.ListCount()) list_.userChoice(index);
    return true;
  }

  LRESULT handle(UINT message, WPARAM wide, LPARAM extra) override {
    if (message == WM_MOUSEWHEEL && dropped()) return original(message, wide, extra);
    return FieldWindow::handle(message, wide, extra);
  }

 private:
  static constexpr WPARAM kItems = 1;
  static constexpr WPARAM kChoice = 2;

  [[nodiscard]] bool dropped() const {
    return combo_ && SendMessageW(window(), CB_GETDROPPEDSTATE, 0, 0) != 0;
  }
  // Once for many items that come one after the other.
  void awaitItems() {
    if (!std::exchange(awaiting_, true)) defer(kItems);
  }
  void empty() {
    SendMessageW(window(), messages_.reset, 0, 0);
    shown_ = 0;
  }
  void send(UINT message, std::int32_t index) {
    SendMessageW(window(), message, static_cast<WPARAM>(index),
                 reinterpret_cast<LPARAM>(toUtf16(list_.item(index).text).c_str()));
  }
  void showNewItems() {
    awaiting_ = false;
    const std::int32_t first = shown_;
    SendMessageW(window(), WM_SETREDRAW, FALSE, 0);
    for (; shown_ < list_.ListCount(); ++shown_) send(messages_.add, shown_);
    SendMessageW(window(), WM_SETREDRAW, TRUE, 0);
    if (list_.ListIndex() >= first) showSelection();
    InvalidateRect(window(), nullptr, TRUE);
  }
  // An item that has not come into the window yet is selected with its coming.
  void showSelection() {
    if (list_.ListIndex() >= shown_) return;
    SendMessageW(window(), messages_.setSelection, static_cast<WPARAM>(list_.ListIndex()), 0);
  }

  ItemList& list_;
  bool combo_;
  const ListMessages& messages_;
  std::int32_t shown_ = 0;
  bool awaiting_ = false;
  bool cancelled_ = false;
};

// --- Buttons

class ButtonField final : public FieldWindow {
 public:
  using FieldWindow::FieldWindow;

  void notified(WORD code) override {
    if (code == BN_CLICKED) control().userClick();
  }

  void changed(ControlChange what) override {
    if (what == ControlChange::Value)
      showContents();
    else
      FieldWindow::changed(what);
  }

 protected:
  void showContents() override {
    bool set = false;
    if (const auto* const box = dynamic_cast<const CheckBox*>(&control())) set = box->Value() != 0;
    if (const auto* const option = dynamic_cast<const OptionButton*>(&control())) set = option->Value();
    if (control().kind() == ControlKind::PushButton) return;
    // Or an option that the focus comes to would say that it was clicked: to look at options chooses none.
    SendMessageW(window(), BM_SETDONTCLICK, TRUE, 0);
    SendMessageW(window(), BM_SETCHECK, set ? BST_CHECKED : BST_UNCHECKED, 0);
  }

  bool keyDown(WPARAM key) override {
    if (FieldWindow::keyDown(key)) return true;
    if (key != VK_RETURN || control().kind() != ControlKind::PushButton) return false;
    control().userClick();
    return true;
  }

  LRESULT wantedKeys(WPARAM key) const override {
    const bool enter = key == VK_RETURN && control().kind() == ControlKind::PushButton;
    const bool arrows = control().kind() == ControlKind::OptionButton;
    return FieldWindow::wantedKeys(key) | (enter ? DLGC_WANTMESSAGE : 0) | (arrows ? DLGC_WANTARROWS : 0);
  }
};

// A push button without a caption: a slim strip along an edge, for the mouse alone.
class StripField final : public FieldWindow {
 public:
  using FieldWindow::FieldWindow;

  // The focus goes to what lies round the strip, which would show it nowhere.
  void notified(WORD code) override {
    if (code != BN_CLICKED) return;
    control().userClick();
    if (!gone() && GetFocus() == window()) SetFocus(GetParent(window()));
  }

  void draw(const DRAWITEMSTRUCT& item) override;

 protected:
  DWORD ownStyle() const override { return BS_OWNERDRAW; }

  LRESULT handle(UINT message, WPARAM wide, LPARAM extra) override {
    if (message != WM_SETCURSOR || !site().inUse()) return FieldWindow::handle(message, wide, extra);
    SetCursor(LoadCursorW(nullptr, IDC_HAND));
    return TRUE;
  }
};

// Flat, with a grip in the middle: notches across the strip.
void StripField::draw(const DRAWITEMSTRUCT& item) {
  const bool pressed = (item.itemState & ODS_SELECTED) != 0;
  const RECT& all = item.rcItem;
  FillRect(item.hDC, &all, GetSysColorBrush(pressed ? COLOR_BTNSHADOW : COLOR_3DLIGHT));
  const bool upright = all.bottom - all.top > all.right - all.left;
  const LONG thicknessPx = upright ? all.right - all.left : all.bottom - all.top;
  const LONG unitPx = std::max<LONG>(thicknessPx / 6, 1);
  const LONG middlePx = (upright ? all.top + all.bottom : all.left + all.right) / 2;
  constexpr LONG kNotches = 9;
  for (LONG notch = -(kNotches / 2); notch <= kNotches / 2; ++notch) {
    const LONG atPx = middlePx + notch * 4 * unitPx;
    const RECT line = upright ? RECT{all.left + unitPx, atPx, all.right - unitPx, atPx + unitPx}
                              : RECT{atPx, all.top + unitPx, atPx + unitPx, all.bottom - unitPx};
    FillRect(item.hDC, &line, GetSysColorBrush(pressed ? COLOR_BTNHIGHLIGHT : COLOR_BTNSHADOW));
  }
}

// --- Spin buttons

class SpinField final : public FieldWindow {
 public:
  SpinField(SpinButton& spin, FieldSite& site) noexcept : FieldWindow(spin, site), spin_(spin) {}

  void stepped(bool up) override { defer(up ? 1 : 0); }

 protected:
  // Both arrows always have somewhere to go: the position itself is never taken over.
  void showContents() override { SendMessageW(window(), UDM_SETRANGE32, static_cast<WPARAM>(-1), 1); }

  void deferred(WPARAM up) override {
    if (spin_.usable() && spin_.buddy() != nullptr) spin_.buddy()->SetFocus();
    if (!gone()) spin_.press(up != 0);
  }

 private:
  SpinButton& spin_;
};

}  // namespace

std::unique_ptr<FieldWindow> makeFieldWindow(Control& control, FieldSite& site) {
  if (auto* const box = dynamic_cast<TextBox*>(&control)) return std::make_unique<TextField>(*box, site);
  if (auto* const list = dynamic_cast<ItemList*>(&control)) return std::make_unique<ListField>(*list, site);
  if (auto* const spin = dynamic_cast<SpinButton*>(&control)) return std::make_unique<SpinField>(*spin, site);
  if (control.kind() == ControlKind::PushButton && control.Caption().empty())
    return std::make_unique<StripField>(control, site);
  if (facetsOf(control.kind()).takesFocus) return std::make_unique<ButtonField>(control, site);
  return std::make_unique<FieldWindow>(control, site);
}

// --- All kinds

namespace {

DWORD listStyle(const Control& control) {
  const auto* const list = dynamic_cast<const ItemList*>(&control);
  if (list == nullptr || list->kind() != ControlKind::ComboBox) return 0;
  if (list->Style() == ListStyle::DropDownList) return CBS_DROPDOWNLIST;
  return CBS_AUTOHSCROLL | (list->Style() == ListStyle::SimpleCombo ? CBS_SIMPLE : CBS_DROPDOWN);
}

// A themed frame paints its caption in the theme's colour, whatever it is told.
void theme(HWND window, bool themed) {
  const HMODULE library = GetModuleHandleW(L"uxtheme.dll");
  if (library == nullptr) return;
  const auto set = reinterpret_cast<HRESULT(WINAPI*)(HWND, LPCWSTR, LPCWSTR)>(
      reinterpret_cast<void*>(GetProcAddress(library, "SetWindowTheme")));
  if (set != nullptr) set(window, themed ? nullptr : L"", themed ? nullptr : L"");
}

}  // namespace

void FieldWindow::create(HWND parent, const RECT& px, DWORD moreStyle) {
  const NativeKind& kind = kNativeKinds[static_cast<std::size_t>(control_.kind())];
  if (control_.kind() == ControlKind::SpinButton) provideSpinButtons();
  // A number is read from its last digit.
  const DWORD alignment = site_.spinOf(control_) != nullptr ? ES_RIGHT : 0;
  const DWORD state =
      (control_.reallyVisible() ? WS_VISIBLE : 0) | (control_.reallyEnabled() ? 0 : WS_DISABLED);
  const bool captioned = facetsOf(control_.kind()).hasCaption;
  const HWND window = CreateWindowExW(
      kind.extendedStyle, kind.className == nullptr ? areaClass() : kind.className,
      captioned ? toUtf16(control_.Caption()).c_str() : L"",
      WS_CHILD | kind.style | ownStyle() | listStyle(control_) | alignment | state | moreStyle, px.left,
      px.top, px.right - px.left, px.bottom - px.top, parent, nullptr, thisModule(), nullptr);
  if (window == nullptr) raiseOutOfMemory();
  window_ = window;
  SetWindowLongPtrW(window, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(this));
  original_ = reinterpret_cast<WNDPROC>(
      SetWindowLongPtrW(window, GWLP_WNDPROC, reinterpret_cast<LONG_PTR>(procedure)));
  control_.peer(this);
  showFont();
  if (control_.ForeColor()) showForeColor();
  showContents();
}

void FieldWindow::destroy() noexcept {
  if (control_.peer() == this) control_.peer(nullptr);
  if (window_ != nullptr) DestroyWindow(window_);
}

void FieldWindow::place(const RECT& px) {
  SetWindowPos(window_, nullptr, px.left, px.top, px.right - px.left, px.bottom - px.top,
               SWP_NOZORDER | SWP_NOACTIVATE);
}

void FieldWindow::showUsability() {
  const auto style = static_cast<DWORD>(GetWindowLongW(window_, GWL_STYLE));
  if (((style & WS_DISABLED) == 0) != control_.reallyEnabled())
    EnableWindow(window_, static_cast<BOOL>(control_.reallyEnabled()));
  if (((style & WS_VISIBLE) != 0) != control_.reallyVisible())
    ShowWindow(window_, control_.reallyVisible() ? SW_SHOWNA : SW_HIDE);
}

void FieldWindow::showFont() {
  SendMessageW(window_, WM_SETFONT, reinterpret_cast<WPARAM>(site_.fontOf(control_)), TRUE);
}

void FieldWindow::showForeColor() {
  if (control_.kind() == ControlKind::Frame) theme(window_, !control_.ForeColor());
  InvalidateRect(window_, nullptr, TRUE);
}

bool FieldWindow::colored(HDC dc, LRESULT& brush) const {
  if (!control_.ForeColor() || isHighContrast()) return false;
  SetTextColor(dc, control_.ForeColor()->bgr);
  SetBkColor(dc, GetSysColor(COLOR_BTNFACE));
  brush = reinterpret_cast<LRESULT>(GetSysColorBrush(COLOR_BTNFACE));
  return true;
}

void FieldWindow::changed(ControlChange what) {
  switch (what) {
    case ControlChange::Caption:
      if (facetsOf(control_.kind()).hasCaption) SetWindowTextW(window_, toUtf16(control_.Caption()).c_str());
      return site_.captionsChanged();
    case ControlChange::Enabled:
    case ControlChange::Visible:
      return site_.showUsability();
    case ControlChange::Font:
      return showFont();
    case ControlChange::ForeColor:
      return showForeColor();
    case ControlChange::Place:
      return site_.arrange(control_);
    default:
      return;
  }
}

void FieldWindow::takeFocus() { SetFocus(window_); }

void FieldWindow::beep() { MessageBeep(MB_OK); }

// --- Messages

LRESULT CALLBACK FieldWindow::procedure(HWND window, UINT message, WPARAM wide, LPARAM extra) noexcept {
  auto* const self = reinterpret_cast<FieldWindow*>(GetWindowLongPtrW(window, GWLP_USERDATA));
  if (self == nullptr) return DefWindowProcW(window, message, wide, extra);
  const FieldSite::Visit visit(self->site_);
  LRESULT result = 0;
  const auto body = [&] { result = self->handle(message, wide, extra); };
  self->site_.run(std::cref(body));
  if (message == WM_NCDESTROY) {
    const auto farewell = [self] { self->windowGone(); };
    self->site_.run(std::cref(farewell));
  }
  return result;
}

void FieldWindow::windowGone() {
  SetWindowLongPtrW(window_, GWLP_USERDATA, 0);
  window_ = nullptr;
  if (control_.peer() != this) return;
  control_.peer(nullptr);
  control_.focusChanged(false);
}

LRESULT FieldWindow::original(UINT message, WPARAM wide, LPARAM extra) {
  return gone() ? 0 : CallWindowProcW(original_, window_, message, wide, extra);
}

LRESULT FieldWindow::handle(UINT message, WPARAM wide, LPARAM extra) {
  LRESULT result = 0;
  switch (message) {
    case WM_SETFOCUS:
    case WM_KILLFOCUS:
      return focus(message == WM_SETFOCUS, wide, extra);
    case WM_GETDLGCODE:
      return original(message, wide, extra) | wantedKeys(wide);
    case WM_KEYDOWN:
      if (site_.untranslatedKey(message, wide) || gone() || keyDown(wide)) return 0;
      break;
    case WM_SYSCHAR:
      if (site_.untranslatedKey(message, wide) || gone()) return 0;
      break;
    case WM_CHAR:
      wide = static_cast<std::uint16_t>(typed(wide));
      if (wide == 0) return 0;
      break;
    case WM_NCHITTEST:
      if (!site_.inUse()) return HTTRANSPARENT;
      break;
    case WM_MOUSEWHEEL:
      return wheel(wide, extra);
    case WM_COMMAND:
    case WM_NOTIFY:
    case WM_CTLCOLORSTATIC:
    case WM_DRAWITEM:
      if (site_.childMessage(message, wide, extra, result)) return result;
      break;
    case WM_GETOBJECT:
      if (static_cast<DWORD>(extra) == static_cast<DWORD>(OBJID_CLIENT) &&
          site_.readAloud(control_, wide, result))
        return result;
      break;
    case WM_SYSKEYDOWN:
      site_.untranslatedKey(message, wide);
      break;
    case kDeferred:
      return deferred(wide), 0;
    default:
      break;
  }
  return original(message, wide, extra);
}

// The panel has the focus before its field, and loses it after.
LRESULT FieldWindow::focus(bool gained, WPARAM wide, LPARAM extra) {
  const LRESULT result = original(gained ? WM_SETFOCUS : WM_KILLFOCUS, wide, extra);
  wheelRest_ = 0;
  if (gained) site_.focusMoved(window_);
  if (facetsOf(control_.kind()).takesFocus && !gone()) control_.focusChanged(gained);
  if (!gained) site_.focusMoved(reinterpret_cast<HWND>(wide));
  return result;
}

// Tab moves the focus within the panel first, so a dialog must not take it.
LRESULT FieldWindow::wantedKeys(WPARAM /*key*/) const {
  return facetsOf(control_.kind()).takesFocus ? DLGC_WANTTAB : 0;
}

bool FieldWindow::keyDown(WPARAM key) {
  if (control_.KeyDown) control_.KeyDown(static_cast<std::int16_t>(key), shiftState());
  return gone();
}

// Tab is what the focus has come here by, or leaves by: nothing is typed.
std::int16_t FieldWindow::typed(WPARAM character) {
  if (character == VK_TAB) return 0;
  auto kept = static_cast<std::int16_t>(character);
  if (control_.KeyPress) control_.KeyPress(kept);
  return gone() ? std::int16_t{0} : kept;
}

// Only whole notches count; what fine wheels send is added up. A field without the focus leaves the wheel to
// whoever is round it: a pointer that rests on a field by chance must not change it.
LRESULT FieldWindow::wheel(WPARAM wide, LPARAM extra) {
  if (GetFocus() != window_ || (LOWORD(wide) & (MK_CONTROL | MK_SHIFT)) != 0)
    return DefWindowProcW(window_, WM_MOUSEWHEEL, wide, extra);
  wheelRest_ += GET_WHEEL_DELTA_WPARAM(wide);
  const int notches = wheelRest_ / WHEEL_DELTA;
  wheelRest_ -= notches * WHEEL_DELTA;
  for (int notch = 0; notch < std::abs(notches) && !gone(); ++notch)
    if (!turned(notches > 0)) return original(WM_MOUSEWHEEL, wide, extra);
  return 0;
}

}  // namespace frontpanels

// The constituent controls of a panel as plain models: what a field holds, and the events that a user's
// action raises. A model works without a window, so that a test types, clicks and steps exactly as a user
// would; a native child window, where there is one, is bound to its model in both directions through
// ControlPeer. Places are twips relative to the parent's client area.
#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "platform/gdi.h"

namespace frontpanels {

enum class ControlKind : std::uint8_t {
  Frame,
  Label,
  TextBox,
  SpinButton,
  ComboBox,
  ListBox,
  CheckBox,
  OptionButton,
  PushButton,
  Picture
};

struct ControlPlace {
  float leftTwips = 0;
  float topTwips = 0;
  float widthTwips = 0;
  float heightTwips = 0;
  friend bool operator==(const ControlPlace&, const ControlPlace&) = default;
};
// Whole twips to pixels at a scale in dots per inch, rounded half away from zero.
[[nodiscard]] constexpr std::int32_t pixelsOfTwips(float twips, std::int32_t dpi) noexcept {
  constexpr std::int64_t kTwipsPerInch = 1440;
  const std::int64_t dots = static_cast<std::int64_t>(twips) * dpi;
  return static_cast<std::int32_t>((dots + (dots < 0 ? -kTwipsPerInch : kTwipsPerInch) / 2) / kTwipsPerInch);
}

// Whether the keyboard focus may rest on a kind, whether it shows a caption, and whether others lie in it.
struct ControlFacets {
  bool takesFocus = false;
  bool hasCaption = false;
  bool contains = false;
};
[[nodiscard]] ControlFacets facetsOf(ControlKind kind) noexcept;

// Which part of a model has changed; its window reads the new state from the model.
enum class ControlChange : std::uint8_t {
  Caption,
  Enabled,
  Visible,
  Font,
  ForeColor,
  Place,
  Text,
  Selection,
  Items,
  ListIndex,
  Value
};

// The native window behind a model.
class ControlPeer {
 public:
  virtual ~ControlPeer() = default;

  virtual void changed(ControlChange what) = 0;
  // A list has a new item at `index`, or has the one at `index` no more: a window that knows which can follow
  // a long list at little cost.
  virtual void itemAdded(std::int32_t /*index*/) { changed(ControlChange::Items); }
  virtual void itemRemoved(std::int32_t /*index*/) { changed(ControlChange::Items); }
  // Moves the keyboard focus to the window.
  virtual void takeFocus() = 0;
  // A refused entry: a soft sound.
  virtual void beep() = 0;
};

class Control;

// What a control asks of the set that it belongs to.
class ControlScope {
 public:
  virtual ~ControlScope() = default;

  [[nodiscard]] virtual Control* focused() const noexcept = 0;
  // Moves the keyboard focus where there is no window to do it.
  virtual void moveFocus(Control& to) = 0;
  // Moves the focus on from a control that had it and was disabled or hidden.
  virtual void leave(Control& unusable) = 0;
};

// What all kinds have. The owner (a panel's set of controls) keeps models and peers alive together, and for
// as long as one of their events lasts.
class Control {
 public:
  Control(ControlKind kind, std::string name) : kind_(kind), name_(std::move(name)) {}
  virtual ~Control() = default;
  Control(const Control&) = delete;
  Control& operator=(const Control&) = delete;

  [[nodiscard]] ControlKind kind() const noexcept { return kind_; }
  [[nodiscard]] const std::string& name() const noexcept { return name_; }
  // What it is called where it is read aloud, if its captions do not say it (see platform/control_names.h).
  [[nodiscard]] const std::string& spokenName() const noexcept { return spokenName_; }
  void spokenName(std::string name) { spokenName_ = std::move(name); }
  // "&" marks the access key.
  [[nodiscard]] const std::string& Caption() const noexcept { return caption_; }
  void Caption(std::string caption) { set(caption_, std::move(caption), ControlChange::Caption); }
  [[nodiscard]] bool Enabled() const noexcept { return enabled_; }
  void Enabled(bool enabled) { setUsability(enabled_, enabled, ControlChange::Enabled); }
  [[nodiscard]] bool Visible() const noexcept { return visible_; }
  void Visible(bool visible) { setUsability(visible_, visible, ControlChange::Visible); }
  [[nodiscard]] bool Bold() const noexcept { return bold_; }
  void Bold(bool bold) { set(bold_, bold, ControlChange::Font); }
  [[nodiscard]] bool Italic() const noexcept { return italic_; }
  void Italic(bool italic) { set(italic_, italic, ControlChange::Font); }
  // Of the caption; the system's colour for its kind while there is none.
  [[nodiscard]] const std::optional<Color>& ForeColor() const noexcept { return foreColor_; }
  void ForeColor(std::optional<Color> color) { set(foreColor_, color, ControlChange::ForeColor); }
  [[nodiscard]] const ControlPlace& place() const noexcept { return place_; }
  void Move(const ControlPlace& place) { set(place_, place, ControlChange::Place); }

  // The frame or picture that it lies in, null on the panel itself.
  [[nodiscard]] Control* parent() const noexcept { return parent_; }
  // At any depth.
  [[nodiscard]] bool liesIn(const Control& container) const noexcept {
    return parent_ != nullptr && (parent_ == &container || parent_->liesIn(container));
  }
  // Whether a user can reach it: it and all that it lies in are visible, and enabled.
  [[nodiscard]] bool reallyVisible() const noexcept;
  [[nodiscard]] bool reallyEnabled() const noexcept;
  [[nodiscard]] bool usable() const noexcept { return reallyVisible() && reallyEnabled(); }

  [[nodiscard]] bool hasFocus() const noexcept { return focused_; }
  // Asks for the keyboard focus: the window's, or without one the model takes it at once. Nothing where a
  // user could not have it.
  void SetFocus();

  // Tells the user that an entry is refused.
  void beep() {
    if (peer_ != nullptr) peer_->beep();
  }

  // What a user does. Nothing happens to a control that is not usable; the focus is moved by the caller.
  virtual void userClick();
  // One key that types `code`: raises KeyDown and KeyPress, and has its effect unless it was consumed.
  void userKey(std::int16_t code);

  // Events. A key press may be consumed by setting its character to 0.
  std::function<void()> GotFocus;
  std::function<void()> LostFocus;
  std::function<void(std::int16_t& character)> KeyPress;
  std::function<void(std::int16_t keyCode, std::int16_t shift)> KeyDown;
  std::function<void()> Click;

  // The set's side.
  void belongTo(ControlScope* scope, Control* parent) noexcept {
    scope_ = scope;
    parent_ = parent;
  }

  // The window's side: raise what the user did.
  void peer(ControlPeer* peer) noexcept { peer_ = peer; }
  [[nodiscard]] ControlPeer* peer() const noexcept { return peer_; }
  void focusChanged(bool focused) {
    if (focused_ == focused) return;
    focused_ = focused;
    raise(focused ? GotFocus : LostFocus);
  }

 protected:
  template <class T>
  void set(T& field, T value, ControlChange change) {
    if (field == value) return;
    field = std::move(value);
    tell(change);
  }
  void tell(ControlChange change) {
    if (peer_ != nullptr) peer_->changed(change);
  }
  static void raise(const std::function<void()>& event) {
    if (event) event();
  }
  // What a typed character does that nobody has consumed.
  virtual void applyKey(std::int16_t /*character*/) {}

 private:
  void setUsability(bool& field, bool value, ControlChange change);

  ControlKind kind_;
  std::string name_;
  std::string caption_;
  std::string spokenName_;
  bool enabled_ = true;
  bool visible_ = true;
  bool bold_ = false;
  bool italic_ = false;
  bool focused_ = false;
  std::optional<Color> foreColor_;
  ControlPlace place_;
  ControlPeer* peer_ = nullptr;
  ControlScope* scope_ = nullptr;
  Control* parent_ = nullptr;
};

class Label final : public Control {
 public:
  explicit Label(std::string name) : Control(ControlKind::Label, std::move(name)) {}
};

class FieldFrame final : public Control {
 public:
  explicit FieldFrame(std::string name) : Control(ControlKind::Frame, std::move(name)) {}
};

// An area of its own, which cuts off what lies in it.
class Picture final : public Control {
 public:
  explicit Picture(std::string name) : Control(ControlKind::Picture, std::move(name)) {}
};

// An edit field of one line, UTF-8.
class TextBox : public Control {
 public:
  explicit TextBox(std::string name) : Control(ControlKind::TextBox, std::move(name)) {}

  [[nodiscard]] const std::string& Text() const noexcept { return text_; }
  // Set by the program; raises Change when it differs. The caret stands behind the text.
  void Text(std::string text);
  // Selects the whole text, as on entering a field: what is typed next replaces it.
  void selectAll() {
    allSelected_ = true;
    tell(ControlChange::Selection);
  }
  [[nodiscard]] bool allSelected() const noexcept { return allSelected_; }
  // What the user made of the text, key by key or by pasting.
  void userText(std::string text);

  std::function<void()> Change;

 protected:
  // Without a window to edit in: the caret stands behind the text, or all of it is selected.
  void applyKey(std::int16_t character) override;

 private:
  std::string text_;
  bool allSelected_ = false;
};

class SpinButton : public Control {
 public:
  explicit SpinButton(std::string name) : Control(ControlKind::SpinButton, std::move(name)) {}

  std::function<void()> SpinUp;
  std::function<void()> SpinDown;

  // The text box whose value it steps.
  [[nodiscard]] TextBox* buddy() const noexcept { return buddy_; }
  void buddy(TextBox* box) noexcept { buddy_ = box; }

  // One click of the user on an arrow; nothing while the button cannot be reached.
  void press(bool up) {
    if (usable()) raise(up ? SpinUp : SpinDown);
  }

 private:
  TextBox* buddy_ = nullptr;
};

class CheckBox final : public Control {
 public:
  explicit CheckBox(std::string name) : Control(ControlKind::CheckBox, std::move(name)) {}

  // 0 or 1; any other value raises "Invalid procedure call or argument". A change raises Click, the program's
  // as well as the user's.
  [[nodiscard]] std::int16_t Value() const noexcept { return value_; }
  void Value(std::int16_t value);
  void userClick() override;

 protected:
  void applyKey(std::int16_t character) override;

 private:
  std::int16_t value_ = 0;
};

// One of those in the same frame, of which at most one is chosen.
class OptionButton final : public Control {
 public:
  explicit OptionButton(std::string name) : Control(ControlKind::OptionButton, std::move(name)) {}

  // Choosing one gives up the choice of the others and raises Click of the chosen one alone.
  [[nodiscard]] bool Value() const noexcept { return chosen_; }
  void Value(bool chosen);
  void userClick() override;

  // All options of its frame, in the order of the table.
  using Group = std::vector<OptionButton*>;
  void group(std::shared_ptr<const Group> group) noexcept { group_ = std::move(group); }
  [[nodiscard]] const Group* group() const noexcept { return group_.get(); }

 protected:
  void applyKey(std::int16_t character) override;

 private:
  void show(bool chosen);

  std::shared_ptr<const Group> group_;
  bool chosen_ = false;
};

class PushButton final : public Control {
 public:
  explicit PushButton(std::string name) : Control(ControlKind::PushButton, std::move(name)) {}

 protected:
  void applyKey(std::int16_t character) override;
};

enum class ListStyle : std::uint8_t { DropDownCombo, SimpleCombo, DropDownList };

// A combo or list box: items with a text and 32 bits of data.
class ItemList : public Control {
 public:
  ItemList(ControlKind kind, std::string name, ListStyle style = ListStyle::DropDownList)
      : Control(kind, std::move(name)), style_(style) {}

  struct Item {
    std::string text;
    std::int32_t data = 0;
    friend bool operator==(const Item&, const Item&) = default;
  };

  [[nodiscard]] ListStyle Style() const noexcept { return style_; }
  [[nodiscard]] std::int32_t ListCount() const noexcept { return static_cast<std::int32_t>(items_.size()); }
  // Raises "Subscript out of range", as do the following.
  [[nodiscard]] const Item& item(std::int32_t index) const;
  // Appends, or inserts before `index`.
  void AddItem(std::string text, std::int32_t data);
  void AddItem(std::string text, std::int32_t data, std::int32_t index);
  void RemoveItem(std::int32_t index);
  void Clear();
  // The selected item's text, empty while there is none.
  [[nodiscard]] std::string Text() const { return listIndex_ < 0 ? std::string() : item(listIndex_).text; }
  // -1 while nothing is selected. Setting another index raises Click, as the program's choice is one.
  [[nodiscard]] std::int32_t ListIndex() const noexcept { return listIndex_; }
  void ListIndex(std::int32_t index);
  // The user's choice of an item, also of the one that is chosen already: raises Click.
  void userChoice(std::int32_t index);
  // Chooses what is chosen already.
  void userClick() override;

 private:
  ListStyle style_;
  std::vector<Item> items_;
  std::int32_t listIndex_ = -1;
};

}  // namespace frontpanels

// The constituent controls of a panel as plain models: what a field holds, and the events that a user's
// action raises. A model works without a window, so that a test types, clicks and steps exactly as a user
// would; a native child window, where there is one, is bound to its model in both directions through
// ControlPeer. Places are twips relative to the parent's client area.
#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

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

// Which part of a model has changed; its window reads the new state from the model.
enum class ControlChange : std::uint8_t {
  Caption,
  Enabled,
  Visible,
  Font,
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
  // Moves the keyboard focus to the window.
  virtual void takeFocus() = 0;
  // A refused entry: a soft sound.
  virtual void beep() = 0;
};

// What all kinds have. The owner (a panel's set of controls) keeps models and peers alive together.
class Control {
 public:
  Control(ControlKind kind, std::string name) : kind_(kind), name_(std::move(name)) {}
  virtual ~Control() = default;
  Control(const Control&) = delete;
  Control& operator=(const Control&) = delete;

  [[nodiscard]] ControlKind kind() const noexcept { return kind_; }
  [[nodiscard]] const std::string& name() const noexcept { return name_; }
  // "&" marks the access key.
  [[nodiscard]] const std::string& Caption() const noexcept { return caption_; }
  void Caption(std::string caption) { set(caption_, std::move(caption), ControlChange::Caption); }
  [[nodiscard]] bool Enabled() const noexcept { return enabled_; }
  void Enabled(bool enabled) { set(enabled_, enabled, ControlChange::Enabled); }
  [[nodiscard]] bool Visible() const noexcept { return visible_; }
  void Visible(bool visible) { set(visible_, visible, ControlChange::Visible); }
  [[nodiscard]] bool Bold() const noexcept { return bold_; }
  void Bold(bool bold) { set(bold_, bold, ControlChange::Font); }
  [[nodiscard]] bool Italic() const noexcept { return italic_; }
  void Italic(bool italic) { set(italic_, italic, ControlChange::Font); }
  [[nodiscard]] const ControlPlace& place() const noexcept { return place_; }
  void Move(const ControlPlace& place) { set(place_, place, ControlChange::Place); }

  [[nodiscard]] bool hasFocus() const noexcept { return focused_; }
  // Asks for the keyboard focus: the window's, or without one the model takes it at once.
  void SetFocus() {
    if (peer_ != nullptr)
      peer_->takeFocus();
    else
      focusChanged(true);
  }

  // Events. A key press may be consumed by setting its character to 0.
  std::function<void()> GotFocus;
  std::function<void()> LostFocus;
  std::function<void(std::int16_t& character)> KeyPress;
  std::function<void(std::int16_t keyCode, std::int16_t shift)> KeyDown;
  std::function<void()> Click;

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

 private:
  ControlKind kind_;
  std::string name_;
  std::string caption_;
  bool enabled_ = true;
  bool visible_ = true;
  bool bold_ = false;
  bool italic_ = false;
  bool focused_ = false;
  ControlPlace place_;
  ControlPeer* peer_ = nullptr;
};

// An edit field of one line, UTF-8.
class TextBox : public Control {
 public:
  explicit TextBox(std::string name) : Control(ControlKind::TextBox, std::move(name)) {}

  [[nodiscard]] const std::string& Text() const noexcept { return text_; }
  // Set by the program; raises Change when it differs.
  void Text(std::string text) {
    if (text == text_) return;
    text_ = std::move(text);
    tell(ControlChange::Text);
    raise(Change);
  }
  // Selects the whole text, as on entering a field.
  void selectAll() { tell(ControlChange::Selection); }
  // What the user made of the text, key by key or by pasting.
  void userText(std::string text) {
    if (text == text_) return;
    text_ = std::move(text);
    raise(Change);
  }

  std::function<void()> Change;

 private:
  std::string text_;
};

class SpinButton : public Control {
 public:
  explicit SpinButton(std::string name) : Control(ControlKind::SpinButton, std::move(name)) {}

  std::function<void()> SpinUp;
  std::function<void()> SpinDown;

  // One click of the user on an arrow; nothing while the button is disabled.
  void press(bool up) {
    if (Enabled()) raise(up ? SpinUp : SpinDown);
  }
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
  // -1 while nothing is selected. Setting another index raises Click, as the program's choice is one.
  [[nodiscard]] std::int32_t ListIndex() const noexcept { return listIndex_; }
  void ListIndex(std::int32_t index);
  // The user's choice of an item, also of the one that is chosen already: raises Click.
  void userChoice(std::int32_t index);

 private:
  ListStyle style_;
  std::vector<Item> items_;
  std::int32_t listIndex_ = -1;
};

}  // namespace frontpanels

// The controls of one panel, built from one table that is read like a designer file, and what holds among
// them: who lies in whom, the tab order, the access keys, and which one has the keyboard focus.
#pragma once

#include <cstdint>
#include <map>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "platform/controls.h"
#include "platform/runtime_error.h"

namespace frontpanels {

inline constexpr std::int16_t kNoTabIndex = -1;

struct ControlRow {
  const char* name = "";
  ControlKind kind{};
  const char* parent = "";  // a frame or picture further up in the table; none for the panel itself
  const char* caption = "";
  ControlPlace place;  // relative to the parent
  std::int16_t tabIndex = kNoTabIndex;
  bool visible = true;
  ListStyle listStyle = ListStyle::DropDownList;
  const char* spokenName = "";  // where nothing that stands at the control names it
};
// The row with a name to be read aloud.
[[nodiscard]] constexpr ControlRow spoken(ControlRow row, const char* name) {
  row.spokenName = name;
  return row;
}

class ControlSet final : private ControlScope {
 public:
  // A spin button steps the text box last listed before it. Raises error 457 for a name that comes twice,
  // "Invalid procedure call or argument" for a parent that cannot be one and a spin button without a box.
  explicit ControlSet(std::span<const ControlRow> rows);
  ~ControlSet() override = default;
  ControlSet(const ControlSet&) = delete;
  ControlSet& operator=(const ControlSet&) = delete;

  // By name, in any letter case. Raises "Invalid procedure call or argument" for a name that no row has and
  // "Type mismatch" for a control of another kind.
  [[nodiscard]] Control& control(std::string_view name) const;
  // Null for a name that no row has.
  [[nodiscard]] Control* find(std::string_view name) const;
  [[nodiscard]] TextBox& textBox(std::string_view name) const { return typed<TextBox>(name); }
  [[nodiscard]] SpinButton& spinButton(std::string_view name) const { return typed<SpinButton>(name); }
  [[nodiscard]] ItemList& list(std::string_view name) const { return typed<ItemList>(name); }
  [[nodiscard]] CheckBox& checkBox(std::string_view name) const { return typed<CheckBox>(name); }
  [[nodiscard]] OptionButton& optionButton(std::string_view name) const { return typed<OptionButton>(name); }
  [[nodiscard]] PushButton& pushButton(std::string_view name) const { return typed<PushButton>(name); }
  [[nodiscard]] FieldFrame& frame(std::string_view name) const { return typed<FieldFrame>(name); }
  [[nodiscard]] Label& label(std::string_view name) const { return typed<Label>(name); }
  [[nodiscard]] Picture& picture(std::string_view name) const { return typed<Picture>(name); }

  // In the order of the table: a container comes before what lies in it.
  [[nodiscard]] std::span<const std::unique_ptr<Control>> controls() const noexcept { return controls_; }
  // In tab order, labels and frames included.
  [[nodiscard]] std::span<Control* const> tabOrder() const noexcept { return tabOrder_; }

  [[nodiscard]] Control* focused() const noexcept override;
  // The next control in tab order that the focus may rest on, null past the last one; the first (or last) of
  // all without `from`. Options of one frame are one stop: the chosen one, else the first.
  [[nodiscard]] Control* nextStop(const Control* from, bool forward) const;

  // Keys. False when there is nothing that the key could do.
  bool tab(bool forward);
  // From the focused option to its neighbour, round at the ends; the one that is reached is chosen.
  bool arrow(bool forward);
  // The key of a button clicks it, that of a label or frame goes on to what comes next. One that several
  // controls share walks through them and clicks nothing.
  bool accessKey(char32_t key);
  // Those that lead somewhere now, in lower case, each once.
  [[nodiscard]] std::u32string accessKeys() const;
  // A click of the mouse: the focus first, so that a field left behind commits its text before.
  static void click(Control& control);

 private:
  void moveFocus(Control& to) override;
  void leave(Control& unusable) override;
  void add(const ControlRow& row);
  void orderTabs(std::span<const ControlRow> rows);
  void groupOptions();
  template <class T>
  [[nodiscard]] T& typed(std::string_view name) const {
    auto* const found = dynamic_cast<T*>(&control(name));
    if (found == nullptr) raiseTypeMismatch();
    return *found;
  }
  // Where an access key of the control leads.
  [[nodiscard]] Control* keyTarget(Control& control) const;

  std::vector<std::unique_ptr<Control>> controls_;
  std::map<std::string, Control*, std::less<>> byName_;
  std::vector<Control*> tabOrder_;
};

// The access key that a caption names with "&", in lower case; 0 when it names none.
[[nodiscard]] char32_t accessKeyOf(std::string_view caption);

}  // namespace frontpanels

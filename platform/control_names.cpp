#include "platform/control_names.h"

#include <algorithm>

namespace frontpanels {
namespace {

// Without the sign of the access key ("&&" is one "&") and the brackets of a name that the host may change.
std::string spokenCaption(std::string_view caption) {
  const bool bracketed = caption.size() > 2 && caption.front() == '<' && caption.back() == '>';
  if (bracketed) caption = caption.substr(1, caption.size() - 2);
  std::string text;
  for (std::size_t at = 0; at < caption.size(); ++at) {
    if (caption[at] == '&' && ++at == caption.size()) break;
    text += caption[at];
  }
  return text;
}

// The label that leads to the control: right before it in tab order, in the same frame.
const Control* labelOf(const ControlSet& set, const Control& control) {
  const auto order = set.tabOrder();
  const auto found = std::find(order.begin(), order.end(), &control);
  if (found == order.end() || found == order.begin()) return nullptr;
  const Control* const before = *(found - 1);
  return before->kind() == ControlKind::Label && before->parent() == control.parent() ? before : nullptr;
}

// Empty outside frames.
std::string frameOf(const Control& control) {
  const Control* const parent = control.parent();
  return parent == nullptr || parent->kind() != ControlKind::Frame ? "" : spokenCaption(parent->Caption());
}

std::string inFrame(const std::string& name, const Control& control) {
  const std::string frame = frameOf(control);
  return frame.empty() || frame == name ? name : name + ", " + frame;
}

// Whatever other controls are called.
std::string plainName(const ControlSet& set, const Control& control) {
  if (!control.spokenName().empty()) return control.spokenName();
  if (!control.Caption().empty()) {
    const bool oneOfMany =
        control.kind() == ControlKind::OptionButton || control.kind() == ControlKind::PushButton;
    return oneOfMany ? inFrame(spokenCaption(control.Caption()), control) : spokenCaption(control.Caption());
  }
  if (const Control* const label = labelOf(set, control)) return spokenCaption(label->Caption());
  return frameOf(control);
}

bool isShared(const ControlSet& set, const Control& control, const std::string& name) {
  return std::any_of(set.controls().begin(), set.controls().end(), [&](const auto& other) {
    return other.get() != &control && facetsOf(other->kind()).takesFocus && plainName(set, *other) == name;
  });
}

}  // namespace

std::string spokenName(const ControlSet& set, const Control& control) {
  if (const auto* const spin = dynamic_cast<const SpinButton*>(&control);
      spin != nullptr && spin->buddy() != nullptr)
    return spokenName(set, *spin->buddy());
  std::string name = plainName(set, control);
  if (name.empty()) return control.name();
  return facetsOf(control.kind()).takesFocus && isShared(set, control, name) ? inFrame(name, control) : name;
}

std::string spokenShortcut(const ControlSet& set, const Control& control) {
  char32_t key = accessKeyOf(control.Caption());
  if (const Control* const label = labelOf(set, control); key == 0 && label != nullptr)
    key = accessKeyOf(label->Caption());
  if (key == 0 || key > U'~') return {};
  const bool letter = key >= U'a' && key <= U'z';
  return std::string("Alt+") + static_cast<char>(letter ? key - U'a' + U'A' : key);
}

}  // namespace frontpanels

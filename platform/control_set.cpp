#include "platform/control_set.h"

#include <algorithm>
#include <numeric>
#include <utility>

#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

char32_t lowerCased(char32_t key) { return key >= U'A' && key <= U'Z' ? key - U'A' + U'a' : key; }

std::string keyOf(std::string_view name) {
  std::string key(name);
  std::transform(key.begin(), key.end(), key.begin(),
                 [](char c) { return static_cast<char>(lowerCased(static_cast<unsigned char>(c))); });
  return key;
}

template <class T>
std::unique_ptr<Control> make(const ControlRow& row) {
  if constexpr (std::is_same_v<T, ItemList>)
    return std::make_unique<T>(row.kind, row.name, row.listStyle);
  else
    return std::make_unique<T>(row.name);
}

// In the order of ControlKind.
using Maker = std::unique_ptr<Control> (*)(const ControlRow&);
constexpr Maker kMakers[] = {make<FieldFrame>, make<Label>,    make<TextBox>,  make<SpinButton>,
                             make<ItemList>,   make<ItemList>, make<CheckBox>, make<OptionButton>,
                             make<PushButton>, make<Picture>};

const OptionButton::Group* groupOf(const Control* control) {
  const auto* const option = dynamic_cast<const OptionButton*>(control);
  return option == nullptr ? nullptr : option->group();
}

// The option of a group that the focus enters by: the chosen one, else the first that can be reached.
const Control* entryOf(const OptionButton::Group& group) {
  const Control* entry = nullptr;
  for (const OptionButton* const option : group) {
    if (!option->usable()) continue;
    if (option->Value()) return option;
    if (entry == nullptr) entry = option;
  }
  return entry;
}

bool isStop(const Control& control) {
  if (!facetsOf(control.kind()).takesFocus || !control.usable()) return false;
  const OptionButton::Group* const group = groupOf(&control);
  return group == nullptr || entryOf(*group) == &control;
}

}  // namespace

char32_t accessKeyOf(std::string_view caption) {
  for (std::size_t at = caption.find('&'); at != std::string_view::npos && at + 1 < caption.size();
       at = caption.find('&', at + 2))
    if (caption[at + 1] != '&') return lowerCased(static_cast<unsigned char>(caption[at + 1]));
  return 0;
}

// --- Building

ControlSet::ControlSet(std::span<const ControlRow> rows) {
  for (const ControlRow& row : rows) add(row);
  orderTabs(rows);
  groupOptions();
}

void ControlSet::add(const ControlRow& row) {
  Control* const parent = *row.parent == '\0' ? nullptr : &control(row.parent);
  if (parent != nullptr && !facetsOf(parent->kind()).contains) raiseInvalidProcedureCall();
  std::unique_ptr<Control> made = kMakers[static_cast<std::size_t>(row.kind)](row);
  if (auto* const spin = dynamic_cast<SpinButton*>(made.get())) {
    const auto box = std::find_if(controls_.rbegin(), controls_.rend(), [](const auto& control) {
      return control->kind() == ControlKind::TextBox;
    });
    if (box == controls_.rend()) raiseInvalidProcedureCall();
    spin->buddy(static_cast<TextBox*>(box->get()));
  }
  if (!byName_.emplace(keyOf(row.name), made.get()).second) raiseDuplicateKey();
  made->Caption(row.caption);
  made->Move(row.place);
  made->Visible(row.visible);
  made->spokenName(row.spokenName);
  made->belongTo(this, parent);
  controls_.push_back(std::move(made));
}

void ControlSet::orderTabs(std::span<const ControlRow> rows) {
  std::vector<std::size_t> order(rows.size());
  std::iota(order.begin(), order.end(), std::size_t{0});
  std::stable_sort(order.begin(), order.end(),
                   [rows](std::size_t a, std::size_t b) { return rows[a].tabIndex < rows[b].tabIndex; });
  for (const std::size_t index : order)
    if (rows[index].tabIndex != kNoTabIndex) tabOrder_.push_back(controls_[index].get());
}

void ControlSet::groupOptions() {
  std::map<const Control*, std::shared_ptr<OptionButton::Group>> groups;
  for (const std::unique_ptr<Control>& control : controls_)
    if (auto* const option = dynamic_cast<OptionButton*>(control.get())) {
      std::shared_ptr<OptionButton::Group>& group = groups[option->parent()];
      if (group == nullptr) group = std::make_shared<OptionButton::Group>();
      group->push_back(option);
      option->group(group);
    }
}

Control* ControlSet::find(std::string_view name) const {
  const auto found = byName_.find(keyOf(name));
  return found == byName_.end() ? nullptr : found->second;
}

Control& ControlSet::control(std::string_view name) const {
  Control* const found = find(name);
  if (found == nullptr) raiseInvalidProcedureCall();
  return *found;
}

// --- Focus

Control* ControlSet::focused() const noexcept {
  const auto found = std::find_if(controls_.begin(), controls_.end(),
                                  [](const auto& control) { return control->hasFocus(); });
  return found == controls_.end() ? nullptr : found->get();
}

void ControlSet::moveFocus(Control& to) {
  Control* const from = focused();
  if (from == &to) return;
  if (from != nullptr) from->focusChanged(false);
  // What was left may have sent the focus elsewhere, or closed the way.
  if (focused() == nullptr && to.usable()) to.focusChanged(true);
}

void ControlSet::leave(Control& unusable) {
  Control* to = nextStop(&unusable, true);
  if (to == nullptr) to = nextStop(nullptr, true);
  if (to != nullptr)
    to->SetFocus();
  else if (unusable.peer() == nullptr)
    unusable.focusChanged(false);
}

Control* ControlSet::nextStop(const Control* from, bool forward) const {
  const auto count = static_cast<std::ptrdiff_t>(tabOrder_.size());
  std::ptrdiff_t at = forward ? -1 : count;
  if (from != nullptr) {
    const auto found = std::find(tabOrder_.begin(), tabOrder_.end(), from);
    if (found != tabOrder_.end()) at = found - tabOrder_.begin();
  }
  const OptionButton::Group* const left = groupOf(from);
  for (at += forward ? 1 : -1; at >= 0 && at < count; at += forward ? 1 : -1) {
    Control* const candidate = tabOrder_[static_cast<std::size_t>(at)];
    if (isStop(*candidate) && (left == nullptr || groupOf(candidate) != left)) return candidate;
  }
  return nullptr;
}

// --- Keys and clicks

bool ControlSet::tab(bool forward) {
  Control* const to = nextStop(focused(), forward);
  if (to == nullptr) return false;
  to->SetFocus();
  return true;
}

bool ControlSet::arrow(bool forward) {
  auto* const from = dynamic_cast<OptionButton*>(focused());
  if (from == nullptr || from->group() == nullptr) return false;
  const OptionButton::Group& group = *from->group();
  const auto count = group.size();
  auto at = static_cast<std::size_t>(std::find(group.begin(), group.end(), from) - group.begin());
  for (std::size_t steps = 1; steps < count; ++steps) {
    at = (at + (forward ? 1 : count - 1)) % count;
    if (!group[at]->usable()) continue;
    click(*group[at]);
    return true;
  }
  return false;
}

Control* ControlSet::keyTarget(Control& control) const {
  if (!control.usable()) return nullptr;
  return facetsOf(control.kind()).takesFocus ? &control : nextStop(&control, true);
}

bool ControlSet::accessKey(char32_t key) {
  struct Match {
    Control* control;
    Control* target;
  };
  std::vector<Match> matches;
  for (Control* const control : tabOrder_)
    if (accessKeyOf(control->Caption()) == lowerCased(key) && key != 0)
      if (Control* const target = keyTarget(*control); target != nullptr)
        matches.push_back({control, target});
  if (matches.empty()) return false;
  const auto current = std::find_if(matches.begin(), matches.end(),
                                    [](const Match& match) { return match.target->hasFocus(); });
  const bool shared = matches.size() > 1;
  const bool goesOn = shared && current != matches.end() && current + 1 != matches.end();
  const Match match = goesOn ? *(current + 1) : matches.front();
  if (match.control == match.target && !shared)
    click(*match.target);
  else
    match.target->SetFocus();
  return true;
}

std::u32string ControlSet::accessKeys() const {
  std::u32string keys;
  for (Control* const control : tabOrder_) {
    const char32_t key = accessKeyOf(control->Caption());
    if (key != 0 && keys.find(key) == std::u32string::npos && keyTarget(*control) != nullptr) keys += key;
  }
  return keys;
}

void ControlSet::click(Control& control) {
  control.SetFocus();
  control.userClick();
}

}  // namespace frontpanels

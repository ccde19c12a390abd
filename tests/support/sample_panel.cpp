#include "tests/support/sample_panel.h"

namespace frontpanels::testing {

SamplePanel::SamplePanel() {
  set.textBox("Name").Text("Gr\xC3\xBC\xC3\x9F");
  for (const char* const name : {"RbwLabel", "Rbw", "RbwSpin", "Stop"}) set.control(name).Enabled(false);
  for (const char* const text : {"Off", "Linear", "Exponential", "Max Hold", "Min Hold"})
    set.list("Type").AddItem(text, 0);
  set.list("Type").ListIndex(1);
  for (const char* const text : {"PN 12", "PN 84", "PN 128", "PN 508"}) set.list("Pn").AddItem(text, 0);
  set.list("Pn").ListIndex(2);
  set.checkBox("Auto").Value(1);
  set.optionButton("Freq").Value(true);
  set.optionButton("Dist").Value(true);
  set.control("Dist").Bold(true);

  center.frequencySuffix();
  center.MAXIMUM(6e9);
  center.Arbitrary(true);
  center.step(100e3);
  center.value(98.1e6);
  bindEntry(center, &set.textBox("Center"), &set.spinButton("CenterSpin"),
            [this] { log("=" + numberToText(center.value())); });
  for (const auto& control : set.controls()) {
    const auto logged = [this, name = control->name()](const char* what, std::function<void()> then = {}) {
      return [this, event = what + name, then = std::move(then)] {
        log(event);
        if (then) then();
      };
    };
    control->GotFocus = logged("+", control->GotFocus);
    control->LostFocus = logged("-", control->LostFocus);
    control->Click = logged("!");
    auto* const spin = dynamic_cast<SpinButton*>(control.get());
    if (spin == nullptr || spin->SpinUp) continue;
    spin->SpinUp = logged("^");
    spin->SpinDown = logged("v");
  }
}

std::pair<std::string, std::string> SamplePanel::play(const Step& step) {
  events.clear();
  std::istringstream actions(step.actions);
  for (std::string action; std::getline(actions >> std::ws, action, ',');) act(action);
  const std::string field = std::string(step.value).substr(0, std::string(step.value).find(' '));
  return {events, field.empty() ? "" : field + " " + value(set.control(field))};
}

void SamplePanel::act(const std::string& action) {
  std::istringstream words(action);
  std::string verb;
  std::string name;
  int number = 50;
  words >> verb >> name >> number;
  if (name.empty()) return key(verb);
  if (verb == "type") return type(name);
  Control& control = set.control(name);
  if (verb == "focus") control.SetFocus();
  if (verb == "click") click(control, words ? number : 50);
  if (verb == "wheel") wheel(control, number);
  if (verb == "disable") control.Enabled(false);
  if (verb == "hide") control.Visible(false);
}

void SamplePanel::key(const std::string& name) {
  Control& focused = *set.focused();
  const bool up = name == "Up";
  if (name == "Tab" || name == "Shift+Tab")
    set.tab(name == "Tab");
  else if (name.substr(0, 4) == "Alt+")
    set.accessKey(static_cast<unsigned char>(name.back()));
  else if (name == "Enter" || name == "Space")
    focused.userKey(name == "Enter" ? 13 : 32);
  else if (!set.arrow(!up) && focused.KeyDown)
    focused.KeyDown(up ? 38 : 40, 0);
}

void SamplePanel::type(const std::string& text) {
  for (const char character : text) set.focused()->userKey(character);
}

void SamplePanel::click(Control& control, int downPercent) {
  auto* const spin = dynamic_cast<SpinButton*>(&control);
  if (spin == nullptr) return ControlSet::click(control);
  spin->buddy()->SetFocus();
  spin->press(downPercent < 50);
}

std::string SamplePanel::value(Control& control) {
  std::string held = control.Caption();
  if (const auto* const list = dynamic_cast<const ItemList*>(&control))
    held = std::to_string(list->ListIndex());
  if (const auto* const box = dynamic_cast<const TextBox*>(&control)) held = box->Text();
  if (const auto* const check = dynamic_cast<const CheckBox*>(&control))
    held = std::to_string(check->Value());
  if (const auto* const option = dynamic_cast<const OptionButton*>(&control))
    held = option->Value() ? "1" : "0";
  return held + (control.reallyEnabled() ? "" : " disabled") + (control.reallyVisible() ? "" : " hidden");
}

}  // namespace frontpanels::testing

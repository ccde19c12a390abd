// The text box, spin button and label of a numeric entry, and what a user does with them.
#include <cmath>

#include "entry/entry_text.h"
#include "entry/number_format.h"
#include "entry/numeric_entry.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

constexpr std::int16_t kEnter = 13;
// The numbers of the keys up and down, and, where a typed character is compared with them, "&" and "(".
constexpr std::int16_t kUp = 38;
constexpr std::int16_t kDown = 40;

}  // namespace

// --- The bound controls

void clsNumericEntry::textBox(TextBox* box) noexcept {
  guard("clsNumericEntry::textBox() failed. ", [&] {
    textBox_ = box;
    if (box == nullptr) return;
    // What the box is by itself is left alone.
    if (bold_) box->Bold(true);
    if (italic_) box->Italic(true);
    if (!controlEnable_ || !linkEnable_) enable();
    reformat();
  });
}

void clsNumericEntry::Enabled(bool enabled) noexcept {
  if (textBox_ == nullptr)
    errorHandler().Assert("clsNumericEntry::Enable() ... TextBox not defined");
  else
    controlEnable(enabled);
}

void clsNumericEntry::controlEnable(bool enable) noexcept {
  controlEnable_ = enable;
  this->enable();
}

void clsNumericEntry::linkEnable(bool enable) noexcept {
  linkEnable_ = enable;
  this->enable();
}

void clsNumericEntry::enable() noexcept {
  guard("clsNumericEntry::Enable() failed. ", [&] {
    const bool enabled = controlEnable_ && linkEnable_;
    if (textBox_ != nullptr) textBox_->Enabled(enabled);
    if (spinButton_ != nullptr) spinButton_->Enabled(enabled);
    if (label_ != nullptr) label_->Enabled(enabled);
    if (clearIfDisabled_) reformat();
  });
}

void clsNumericEntry::clearIfDisabled(bool clear) noexcept {
  clearIfDisabled_ = clear;
  if (textBox_ != nullptr && !textBox_->Enabled()) reformat();
}

void clsNumericEntry::Visible(bool visible) noexcept {
  guard("clsNumericEntry::Visible() failed. ", [&] {
    if (textBox_ == nullptr) {
      errorHandler().Assert("clsNumericEntry::Visible() ... TextBox object not defined");
      return;
    }
    textBox_->Visible(visible);
    if (spinButton_ != nullptr) spinButton_->Visible(visible);
    if (label_ != nullptr) label_->Visible(visible);
  });
}

void clsNumericEntry::Bold(bool bold) noexcept {
  guard("clsNumericEntry::Bold() failed. ", [&] {
    bold_ = bold;
    if (textBox_ != nullptr) textBox_->Bold(bold);
  });
}

void clsNumericEntry::Italic(bool italic) noexcept {
  guard("clsNumericEntry::Italic() failed. ", [&] {
    italic_ = italic;
    if (textBox_ != nullptr) textBox_->Italic(italic);
  });
}

// --- The text

const std::string& clsNumericEntry::text() const noexcept {
  return textBox_ == nullptr ? lastText_ : textBox_->Text();
}

void clsNumericEntry::text(std::string_view text) noexcept {
  onEvent("clsNumericEntry::LetText() failed. ", [&](bool& changed) {
    validNumeric_ = accepts(text);
    if (!validNumeric_) raiseTypeMismatch();
    changed = commit(std::string(text)) == Entered::Changed;
  });
}

std::optional<double> clsNumericEntry::textToNumeric() const noexcept {
  return guarded("clsNumericEntry::textToNumeric() failed. ", std::optional<double>(),
                 [&] { return parsed(text()); });
}

std::optional<double> clsNumericEntry::parsed(std::string_view text) const {
  const SuffixRecord* const unit = shownUnit(value_);
  const double unitScale = unit == nullptr ? 1 : unit->scale;
  const std::optional<double> number = parseEntryText(text, shownSuffixes(), unitScale, decimalSeparator_);
  if (number && channelChoose()) return frequencyOfChannel(*number);
  const auto [offset, scale] = display();
  if (!number || scale == 0) return std::nullopt;
  if (scale == 1 && offset == 0) return number;
  const double value = toSignificantDigits(*number * scale + offset);
  if (!std::isfinite(value)) return std::nullopt;
  return value;
}

std::optional<double> clsNumericEntry::shownValue() const {
  const bool asWritten = text() == lastText_ && (blank_ || !lastText_.empty());
  if (textBox_ == nullptr || asWritten) return value_;
  return textToNumeric();
}

void clsNumericEntry::reformat() noexcept {
  guard("clsNumericEntry::reformat() failed. ", [&] {
    redisplay_ = false;
    const bool cleared = clearIfDisabled_ && textBox_ != nullptr && !textBox_->Enabled();
    if (!preserveBlankEntry_) blank_ = false;
    if (cleared || blank_)
      lastText_.clear();
    else
      formatter(value_, lastText_);
    if (textBox_ != nullptr) textBox_->Text(lastText_);
  });
}

void clsNumericEntry::blank() noexcept {
  guard("clsNumericEntry::blank() failed. ", [&] {
    blank_ = true;
    lastText_.clear();
    redisplay_ = !preserveBlankEntry_;
    if (textBox_ != nullptr) textBox_->Text({});
  });
}

void clsNumericEntry::Clear() noexcept {
  guard("clsNumericEntry::Clear() failed. ", [&] {
    suffixes_ = {};
    ranges_ = {};
    range_ = 0;
    choose(range_);
    discontinuities_.clear();
    UpdateDiscontinuities();
    channelUnits_ = false;
    channelChoose_.reset();
    sequence_ = {};
    power_ = 0;
    step_.reset();
    resolution_.reset();
  });
}

clsNumericEntry::Entered clsNumericEntry::commit(const std::string& typed) {
  if (preserveBlankEntry_ && isBlankText(typed)) {
    const bool news = !std::exchange(blank_, true);
    reformat();
    return news ? Entered::Changed : Entered::Same;
  }
  const std::optional<double> number = parsed(typed);
  if (!number) return Entered::Refused;
  return setValue(*number, autoChoose_);
}

// --- Events

template <class Body>
void clsNumericEntry::onEvent(const char* message, Body body) noexcept {
  newValue_ = false;
  validNumeric_ = true;
  bool changed = false;
  guard(message, [&] { body(changed); });
  // Not before: a text that is written and a focus that moves raise events as well.
  newValue_ = changed;
}

void clsNumericEntry::upClick() noexcept { click("clsNumericEntry::upClick() failed. ", StepDirection::Up); }

void clsNumericEntry::downClick() noexcept {
  click("clsNumericEntry::downClick() failed. ", StepDirection::Down);
}

void clsNumericEntry::click(const char* message, StepDirection direction) noexcept {
  onEvent(message, [&](bool& changed) {
    unspelt_.clear();
    const std::optional<double> from = shownValue();
    if (!from) {
      errorHandler().Assert(message);
      return;
    }
    changed = setValue(stepped(*from, direction), autoChoose_) == Entered::Changed;
    if (textBox_ != nullptr) textBox_->SetFocus();
    selectText();
  });
}

// Whoever types a unit to its end must not type over the text that its first letter has completed.
bool clsNumericEntry::spellsOn(std::int16_t character) {
  const std::string unspelt = std::exchange(unspelt_, {});
  const auto letter = static_cast<char>(character);
  if (unspelt.empty() || text() != lastText_ || character > '~') return false;
  if (!beginsWith(unspelt, std::string_view(&letter, 1))) return false;
  unspelt_ = unspelt.substr(1);
  return true;
}

void clsNumericEntry::KeyPress(std::int16_t& character) noexcept {
  onEvent("clsNumericEntry::KeyPress() failed. ", [&](bool& changed) {
    const std::int16_t typed = character;
    if (spellsOn(typed)) {
      character = 0;
    } else if (typed == kUp || typed == kDown) {
      character = 0;
      typed == kUp ? upClick() : downClick();
      changed = newValue_;
    } else if (const SuffixRecord* const unit = suffixBegunBy(shownSuffixes(), typed);
               textBox_ != nullptr && (typed == kEnter || unit != nullptr)) {
      character = 0;
      takeOver(typed == kEnter ? text() : text() + static_cast<char>(typed), changed);
      if (unit != nullptr) unspelt_ = unit->name.substr(1);
    }
  });
}

void clsNumericEntry::takeOver(const std::string& typed, bool& changed) {
  // As it was written, a text stands for the exact value.
  const bool asWritten = typed == lastText_;
  if (asWritten) textBox_->Text(typed);
  const Entered entered = asWritten ? Entered::Same : commit(typed);
  changed = entered == Entered::Changed;
  if (entered == Entered::Refused) textBox_->beep();
  selectText();
}

void clsNumericEntry::KeyDown(std::int16_t keyCode, std::int16_t shift) noexcept {
  newValue_ = false;
  if (shift != 0) return;
  if (keyCode == kUp) upClick();
  if (keyCode == kDown) downClick();
}

void clsNumericEntry::GotFocus() noexcept {
  onEvent("clsNumericEntry::GotFocus() failed. ", [&](bool&) {
    unspelt_.clear();
    selectText();
  });
}

void clsNumericEntry::LostFocus() noexcept {
  onEvent("clsNumericEntry::LostFocus() failed. ", [&](bool& changed) {
    if (textBox_ == nullptr || text() == lastText_) return;
    const Entered entered = commit(std::string(text()));
    changed = entered == Entered::Changed;
    if (entered != Entered::Refused) return;
    textBox_->Text(lastText_);
    textBox_->beep();
    validNumeric_ = false;
  });
}

void clsNumericEntry::selectText() const {
  if (textBox_ != nullptr) textBox_->selectAll();
}

}  // namespace frontpanels

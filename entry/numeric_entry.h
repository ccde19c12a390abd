// clsNumericEntry: a numeric setting of a panel, the text it is shown as, and the text box and spin button
// that a user changes it with. Axes use it only to turn their values into text.
#pragma once

#include <array>
#include <initializer_list>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "entry/channel_map.h"
#include "entry/entry_ranges.h"
#include "entry/entry_steps.h"
#include "entry/suffix_table.h"
#include "platform/controls.h"
#include "platform/variant.h"

namespace frontpanels {

class clsNumericEntry {
 public:
  static constexpr std::string_view kTypeName = "clsNumericEntry";

  // --- The field. Each control may be absent, is told of by its owner, and must outlive the binding
  // (entry/entry_binding.h connects the events).

  // Shows the value in the box.
  void textBox(TextBox* box) noexcept;
  [[nodiscard]] SpinButton* spinButton() const noexcept { return spinButton_; }
  void spinButton(SpinButton* button) noexcept { spinButton_ = button; }
  [[nodiscard]] Control* Label() const noexcept { return label_; }
  void Label(Control* label) noexcept { label_ = label; }

  // Of the text box; false without one. Set on text box, spin button and label; without a text box reported.
  // A field is enabled while both the panel, by `controlEnable` or `Enabled`, and the host's link allow it.
  [[nodiscard]] bool Enabled() const noexcept { return textBox_ != nullptr && textBox_->Enabled(); }
  void Enabled(bool enabled) noexcept;
  [[nodiscard]] bool controlEnable() const noexcept { return controlEnable_; }
  void controlEnable(bool enable) noexcept;
  [[nodiscard]] bool linkEnable() const noexcept { return linkEnable_; }
  void linkEnable(bool enable) noexcept;
  // Whether a field that is not enabled shows no text.
  [[nodiscard]] bool clearIfDisabled() const noexcept { return clearIfDisabled_; }
  void clearIfDisabled(bool clear) noexcept;
  [[nodiscard]] bool Visible() const noexcept { return textBox_ != nullptr && textBox_->Visible(); }
  void Visible(bool visible) noexcept;
  // The text's font; kept for a text box to come.
  [[nodiscard]] bool Bold() const noexcept { return bold_; }
  void Bold(bool bold) noexcept;
  [[nodiscard]] bool Italic() const noexcept { return italic_; }
  void Italic(bool italic) noexcept;

  // --- The value

  // Set: snapped (see below), moved into the limits or, with `autoChoose`, into another range, rounded to the
  // resolution, and shown. A value that cannot be (no finite number, limits that hold nothing) is reported
  // and nothing changes.
  [[nodiscard]] double value() const noexcept { return value_; }
  void value(double value) noexcept;
  // The same as the host's doing, which is no news; the second one chooses a range whatever `autoChoose` is.
  void valueNoUpdate(double value) noexcept;
  void valueNoUpdateAutoChoose(double value) noexcept;
  // The value before the latest one.
  [[nodiscard]] double previousValue() const noexcept { return previousValue_; }
  // Whether the latest event, or the latest setting of `value` or `text`, has changed the value.
  [[nodiscard]] bool newValue() const noexcept { return newValue_; }

  // --- Limits and ranges

  [[nodiscard]] double MINIMUM() const noexcept { return limits_.minimum; }
  void MINIMUM(double minimum) noexcept;
  [[nodiscard]] double MAXIMUM() const noexcept { return limits_.maximum; }
  void MAXIMUM(double maximum) noexcept;
  // Whether a value outside the limits selects the first range that holds it.
  [[nodiscard]] bool autoChoose() const noexcept { return autoChoose_; }
  void autoChoose(bool choose) noexcept { autoChoose_ = choose; }
  // The chosen range. Choosing one takes over its limits and how it is shown; the value stays.
  [[nodiscard]] std::int32_t range() const noexcept { return range_; }
  void range(std::int32_t index) noexcept;

  // Whether a range has limits of its own.
  [[nodiscard]] bool rangeDefined(std::int32_t index) const noexcept;

  // The fields of one range, 0 to 6, whether or not it is the chosen one: what is in force stays until a
  // range is chosen. A limit that is written defines the range.
  [[nodiscard]] double MinimumForRange(std::int32_t index) const noexcept;
  void MinimumForRange(std::int32_t index, double minimum) noexcept;
  [[nodiscard]] double MaximumForRange(std::int32_t index) const noexcept;
  void MaximumForRange(std::int32_t index, double maximum) noexcept;
  [[nodiscard]] double FormatOffsetForRange(std::int32_t index) const noexcept;
  void FormatOffsetForRange(std::int32_t index, double offset) noexcept;
  [[nodiscard]] double FormatScaleForRange(std::int32_t index) const noexcept;
  void FormatScaleForRange(std::int32_t index, double scale) noexcept;

  // The limits of a host parameter: a record gives those of the range that its order names, other ranges are
  // no longer defined. The chosen range stays if it can, and its limits come in force. Unusable ones are
  // reported, change nothing and answer false.
  bool Limits(const HostRecordSet& records) noexcept;
  // The limits of another entry, its ranges' and its choice among them; how values are shown stays this
  // one's.
  void CopyLimits(const clsNumericEntry& source) noexcept;

  // --- Snapping and stepping

  // Whether any value within the limits will do: no snapping to sequence, power or step.
  [[nodiscard]] bool Arbitrary() const noexcept { return arbitrary_; }
  void Arbitrary(bool arbitrary) noexcept { arbitrary_ = arbitrary; }
  // Up to ten mantissas of a decade; the last numeric one ends the sequence, without any there is none. One
  // that is not numeric leaves the mantissa that stood in its place.
  void sequence(std::initializer_list<Variant> mantissas) noexcept;
  // Without a sequence: values are whole powers of this number. Below 2, as 0 at first: no powers.
  [[nodiscard]] double power() const noexcept { return power_; }
  void power(const Variant& power) noexcept;
  // Empty, or a number above 0: values are its multiples, a click moves by it.
  [[nodiscard]] Variant step() const { return step_ ? Variant(*step_) : Variant(); }
  void step(const Variant& step) noexcept;
  // Whether a click leads to a multiple of the step from an arbitrary value, too.
  [[nodiscard]] bool NormalizeAsStep() const noexcept { return normalizeAsStep_; }
  void NormalizeAsStep(bool normalize) noexcept { normalizeAsStep_ = normalize; }
  // Empty, or a number above 0: what values are rounded to when all else is done, unless channels are shown.
  [[nodiscard]] Variant resolution() const { return resolution_ ? Variant(*resolution_) : Variant(); }
  void resolution(const Variant& resolution) noexcept;

  // --- Unit suffixes

  // At most 10; one more is reported and refused. Without a numeric scale the scale is the lower limit, or 1
  // where that is 0; a scale that is given and not numeric is reported as well.
  void suffix(std::string_view name, double lowerLimit, double upperLimit, const Variant& scale = {});
  [[nodiscard]] const SuffixTable& suffixes() const noexcept { return suffixes_; }

  // Suffix sets: each adds its records.
  void noSuffix() {}
  void chipSuffix();
  void offsetSuffix();
  void byteSuffix();
  void dBSuffix();
  void dBmSuffix();
  void degreeSuffix();
  void frequencySuffix();
  void meterSuffix();
  void percentSuffix();
  void timeSuffix();
  void longTimeSuffix();
  void voltSuffix();
  void meterPerSecSuffix();
  void milePerHourSuffix();
  void kmPerHourSuffix();
  void feetSuffix();

  // --- The text

  // How a value is shown: (value - formatOffset) / formatScale, in the unit whose limits hold it, by the
  // number format (see entry/number_format.h), or in the general form when that is empty. A text box shows a
  // change with the next value, the same one included, or by `reformat`.
  [[nodiscard]] const std::string& formatString() const noexcept { return formatString_; }
  void formatString(std::string_view format);
  [[nodiscard]] double formatScale() const noexcept { return formatScale_; }
  void formatScale(double scale) noexcept;
  // Another name of formatScale.
  [[nodiscard]] double scaling() const noexcept { return formatScale_; }
  void scaling(double scale) noexcept { formatScale(scale); }
  [[nodiscard]] double formatOffset() const noexcept { return formatOffset_; }
  void formatOffset(double offset) noexcept;
  [[nodiscard]] bool suppressSuffix() const noexcept { return suppressSuffix_; }
  void suppressSuffix(bool suppress) noexcept;
  // The user's, in texts shown and typed; "." at first, and where it is empty.
  [[nodiscard]] const std::string& decimalSeparator() const noexcept { return decimalSeparator_; }
  void decimalSeparator(std::string_view separator);
  // Whether a user may leave the field empty. The value stays; that the field has become empty, or holds a
  // value again, is a change.
  [[nodiscard]] bool preserveBlankEntry() const noexcept { return preserveBlankEntry_; }
  void preserveBlankEntry(bool preserve) noexcept { preserveBlankEntry_ = preserve; }

  // The text of a value. A failure (a scale of 0, an unusable number format) is reported and the text is
  // empty.
  [[nodiscard]] std::string formatter(double value) const;
  // The same into a text whose storage is used again.
  void formatter(double value, std::string& text) const;

  // Appends the text of a value by a number format of the caller's. Raises "Division by zero" for a scale of
  // 0 and what appendNumber raises; `text` is then as it was.
  void append(std::string& text, double value, std::string_view format, bool withUnit) const;
  // The same of the difference of two values: the display offset cancels out of it, and between channels it
  // is a number of channels.
  void appendDifference(std::string& text, double difference, std::string_view format, bool withUnit) const;
  // How many units of the value make one of what is shown: the scale times that of the unit chosen for
  // `value`.
  [[nodiscard]] double shownScale(double value) const noexcept;

  // The text box's text, or without one the text written last. Set, it is taken as typed; one that is refused
  // is reported.
  [[nodiscard]] const std::string& text() const noexcept;
  void text(std::string_view text) noexcept;
  // The value that the text means (see entry/entry_text.h), if it means one.
  [[nodiscard]] std::optional<double> textToNumeric() const noexcept;
  // Writes the value's text anew.
  void reformat() noexcept;
  // Shows no text until a value is set.
  void blank() noexcept;
  [[nodiscard]] bool isBlank() const noexcept { return blank_; }
  // Takes back units, ranges, limits, sequence, power, step and resolution, so that the entry can be set up
  // for another quantity; value, text, flags and the bound controls stay.
  void Clear() noexcept;

  // --- Channels: (value - channel zero) / channel spacing of the chosen range, through its discontinuities
  // (see entry/channel_map.h) and without a unit. The step is then one channel, whatever `step` says.

  // The display offset, and the display scale, of the range that the record's order names; without a record,
  // or from a host whose data have no orders, of range 0 and in force. The entry then has channel units.
  void ChannelZero(double value, const HostRecordSet* records = nullptr) noexcept;
  void ChannelSpacing(double value, const HostRecordSet* records = nullptr) noexcept;
  // Whether the ranges' offsets and scales are channel zeros and spacings.
  [[nodiscard]] bool channelUnits() const noexcept { return channelUnits_; }
  void channelUnits(bool channels) noexcept;
  // Whether channels are shown, or else frequencies: as soon as there are channel units, until it is set.
  [[nodiscard]] bool channelChoose() const noexcept { return channelChoose_.value_or(channelUnits_); }
  void channelChoose(bool channels) noexcept;

  // Of one range, or without one of every range. One that is no block of channels, or overlaps another, is
  // reported and not added.
  void AddChannelDiscontinuity(double channel, double minimum, double maximum,
                               std::optional<std::int32_t> range = {}) noexcept;
  // The same from a host's record, whose default is the channel, or the value where it has none. 0 without a
  // record takes all discontinuities back.
  void ChannelDiscontinuity(double value, const HostRecordSet* records = nullptr) noexcept;
  // Gives every range its discontinuities. One whose range has no limits is reported, and waits for them.
  void UpdateDiscontinuities() noexcept;

  // Whether the text in the box, or one that the latest event has refused, stands for a value: a number, and
  // where channels are shown that of a channel within the limits. Set by a panel that refuses a text itself.
  [[nodiscard]] bool validNumeric() const noexcept;
  void validNumeric(bool valid) noexcept { validNumeric_ = valid; }

  // --- Events, forwarded by the panel. Each says by `newValue` whether it has changed the value. A refused
  // text changes nothing and stays to be corrected while the box keeps the focus; when the focus leaves, the
  // last good one is back.

  // A text that is no number is reported.
  void upClick() noexcept;
  void downClick() noexcept;
  // Enter and the first letter of a unit take the text over, "&" and "(" step. What has an effect is
  // consumed, and so are the unit's other letters when they follow.
  void KeyPress(std::int16_t& character) noexcept;
  // The arrow keys up and down step.
  void KeyDown(std::int16_t keyCode, std::int16_t shift) noexcept;
  void GotFocus() noexcept;
  void LostFocus() noexcept;
  void change() noexcept { newValue_ = false; }
  void Click() noexcept { newValue_ = false; }
  void DblClick() noexcept { newValue_ = false; }
  void DragDrop() noexcept { newValue_ = false; }
  void DragOver() noexcept { newValue_ = false; }
  void KeyUp(std::int16_t /*keyCode*/, std::int16_t /*shift*/) noexcept { newValue_ = false; }
  void LinkClose() noexcept { newValue_ = false; }
  void LinkError() noexcept { newValue_ = false; }
  void LinkNotify() noexcept { newValue_ = false; }
  void LinkOpen() noexcept { newValue_ = false; }
  void MouseDown() noexcept { newValue_ = false; }
  void MouseMove() noexcept { newValue_ = false; }
  void MouseUp() noexcept { newValue_ = false; }

 private:
  enum class Entered : std::uint8_t { Refused, Same, Changed };

  // What setting a value comes to, and the range that it selects.
  struct Settled {
    double value = 0;
    std::optional<std::int32_t> range;
  };

  struct Display {
    double offset = 0;
    double scale = 1;
  };

  struct ChannelField {
    std::string_view failure;
    std::string_view badOrder;
    double EntryRange::*member;
  };

  struct RangedDiscontinuity {
    frontpanels::ChannelDiscontinuity block;
    std::optional<std::int32_t> range;
    [[nodiscard]] bool countsFor(std::int32_t index) const noexcept { return range.value_or(index) == index; }
  };

  [[nodiscard]] Entered setValue(double wanted, bool chooseRange) noexcept;
  // Empty after a failure that was reported by its own message.
  [[nodiscard]] std::optional<double> snapped(double value) const;
  [[nodiscard]] std::optional<double> chooseSequence(double value) const noexcept;
  [[nodiscard]] std::optional<double> choosePower(double value) const noexcept;
  [[nodiscard]] StepSequence powers() const noexcept;
  [[nodiscard]] Settled settled(double value, bool chooseRange) const;
  [[nodiscard]] double stepped(double value, StepDirection direction) const;
  [[nodiscard]] double shownStep(double value, StepDirection direction) const;

  void choose(std::int32_t index) noexcept;
  // The range whose field is read or written; null after a report in the routine's name.
  [[nodiscard]] const EntryRange* rangeFor(std::string_view routine, std::int32_t index) const noexcept;
  void setRangeField(std::string_view routine, std::int32_t index, double value,
                     void (*set)(EntryRange& range, double value)) noexcept;

  static void setGrid(std::string_view routine, const Variant& value, std::optional<double>& grid) noexcept;

  void setChannelField(const ChannelField& field, double value, const HostRecordSet* records,
                       double& inForce) noexcept;
  void addDiscontinuity(const RangedDiscontinuity& added);
  [[nodiscard]] bool hasLimits(std::int32_t index) const noexcept;
  [[nodiscard]] ChannelPlan channelPlan(std::int32_t index) const noexcept;
  // In the chosen range, or with `autoChoose` in the first that has the channel.
  [[nodiscard]] std::optional<double> frequencyOfChannel(double channel) const noexcept;
  [[nodiscard]] double nearestChannel(double value) const;
  [[nodiscard]] double nextChannel(double value, StepDirection direction) const;

  // What turns a value into the number that is shown, before its unit.
  [[nodiscard]] Display display() const noexcept;
  [[nodiscard]] double shownNumber(double value) const;
  [[nodiscard]] const SuffixTable& shownSuffixes() const noexcept;
  // Null without units.
  [[nodiscard]] const SuffixRecord* shownUnit(double value) const noexcept;
  [[nodiscard]] std::optional<double> parsed(std::string_view text) const;
  [[nodiscard]] bool accepts(std::string_view text) const;
  // The value that the field stands for: the exact one while its text is as it was written.
  [[nodiscard]] std::optional<double> shownValue() const;
  // Takes a typed text over as the value.
  Entered commit(const std::string& typed);
  void enable() noexcept;

  template <class Body>
  void onEvent(const char* message, Body body) noexcept;
  void appendShown(std::string& text, double shown, std::string_view format, bool withUnit) const;
  void click(const char* message, StepDirection direction) noexcept;
  // Commits a text while the box keeps the focus.
  void takeOver(const std::string& typed, bool& changed);
  [[nodiscard]] bool spellsOn(std::int16_t character);
  void selectText() const;

  TextBox* textBox_ = nullptr;
  SpinButton* spinButton_ = nullptr;
  Control* label_ = nullptr;

  double value_ = 0;
  double previousValue_ = 0;
  EntryLimits limits_;
  EntryRanges ranges_;
  std::int32_t range_ = 0;
  StepSequence sequence_;
  double power_ = 0;
  std::optional<double> step_;
  std::optional<double> resolution_;

  SuffixTable suffixes_;
  std::string formatString_;
  std::string decimalSeparator_ = ".";
  double formatScale_ = 1;
  double formatOffset_ = 0;
  std::string lastText_;  // as written to the box
  std::string unspelt_;   // what is left of a unit whose first letter has taken the text over

  std::vector<RangedDiscontinuity> discontinuities_;  // as added
  std::array<std::vector<frontpanels::ChannelDiscontinuity>, EntryRanges::kCount> rangeDiscontinuities_;
  std::optional<bool> channelChoose_;
  bool channelUnits_ = false;
  bool validNumeric_ = true;

  bool newValue_ = false;
  bool autoChoose_ = false;
  bool arbitrary_ = false;
  bool normalizeAsStep_ = false;
  bool suppressSuffix_ = false;
  bool preserveBlankEntry_ = false;
  bool clearIfDisabled_ = false;
  bool controlEnable_ = true;
  bool linkEnable_ = true;
  bool bold_ = false;
  bool italic_ = false;
  bool blank_ = false;
  bool redisplay_ = false;  // the text is out of date whatever the value
};

}  // namespace frontpanels

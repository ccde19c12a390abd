// Any settings of a numeric entry and anything typed into its field: a byte a step, and what the step takes.
#include <algorithm>
#include <cmath>
#include <iterator>
#include <string>

#include "entry/entry_binding.h"
#include "framework/support/error_handler.h"
#include "fuzz/fuzz_input.h"
#include "fuzz/fuzz_variant.h"

namespace frontpanels::fuzz {
namespace {

constexpr int kMaxSteps = 96;

// An entry in its field, with a window that counts what is refused.
class Field final : public ControlPeer {
 public:
  Field() {
    messageLog().clear();
    bindEntry(entry, &box, &spin, {});
    box.peer(this);
  }
  ~Field() override { box.peer(nullptr); }
  Field(const Field&) = delete;
  Field& operator=(const Field&) = delete;

  void type(std::string text) {
    box.focusChanged(true);
    box.userText(std::move(text));
  }

  TextBox box{"TextBox"};
  SpinButton spin{"SpinButton"};
  clsNumericEntry entry;
  int refused = 0;

 private:
  void changed(ControlChange) override {}
  void takeFocus() override { box.focusChanged(true); }
  void beep() override { ++refused; }
};

using Step = void (*)(Field& field, FuzzInput& input);
using Entry = clsNumericEntry;

double takeDouble(FuzzInput& input) { return input.number<double>(); }

std::string takeText(FuzzInput& input) {
  const auto bytes = input.bytes(input.number<std::uint8_t>());
  return {bytes.begin(), bytes.end()};
}

template <void (Entry::*set)(double) noexcept>
void number(Field& field, FuzzInput& input) {
  (field.entry.*set)(takeDouble(input));
}
template <void (Entry::*set)(const Variant&) noexcept>
void variant(Field& field, FuzzInput& input) {
  (field.entry.*set)(takeVariant(input));
}
template <void (Entry::*call)()>
void units(Field& field, FuzzInput&) {
  (field.entry.*call)();
}
template <void (Entry::*call)() noexcept>
void event(Field& field, FuzzInput&) {
  (field.entry.*call)();
}

void suffix(Field& field, FuzzInput& input) {
  const std::string name = takeText(input);
  const double lower = takeDouble(input);
  const double upper = takeDouble(input);
  field.entry.suffix(name, lower, upper, takeVariant(input));
}

void sequence(Field& field, FuzzInput& input) {
  const double first = takeDouble(input);
  const double second = takeDouble(input);
  field.entry.sequence({first, second, takeVariant(input)});
}

void range(Field& field, FuzzInput& input) {
  const auto index = input.number<std::int8_t>();
  field.entry.MinimumForRange(index, takeDouble(input));
  field.entry.MaximumForRange(index, takeDouble(input));
  field.entry.FormatOffsetForRange(index, takeDouble(input));
  field.entry.FormatScaleForRange(index, takeDouble(input));
}

void chooseRange(Field& field, FuzzInput& input) { field.entry.range(input.number<std::int8_t>()); }

void format(Field& field, FuzzInput& input) {
  field.entry.formatString(takeText(input));
  field.entry.decimalSeparator(takeText(input));
}

void flags(Field& field, FuzzInput& input) {
  const auto bits = input.number<std::uint8_t>();
  field.entry.autoChoose((bits & 1) != 0);
  field.entry.Arbitrary((bits & 2) != 0);
  field.entry.NormalizeAsStep((bits & 4) != 0);
  field.entry.preserveBlankEntry((bits & 8) != 0);
  field.entry.suppressSuffix((bits & 16) != 0);
  field.entry.clearIfDisabled((bits & 32) != 0);
  field.entry.Enabled((bits & 64) == 0);
}

void leave(Field& field, FuzzInput& input) {
  field.type(takeText(input));
  field.box.focusChanged(false);
}

void key(Field& field, FuzzInput& input) {
  field.type(takeText(input));
  auto character = input.number<std::int16_t>();
  field.entry.KeyPress(character);
}

void text(Field& field, FuzzInput& input) { field.entry.text(takeText(input)); }

// Places in this table are what make_seeds.cpp names its steps by.
constexpr Step kSteps[] = {leave,
                           key,
                           text,
                           number<&Entry::value>,
                           number<&Entry::valueNoUpdate>,
                           number<&Entry::valueNoUpdateAutoChoose>,
                           number<&Entry::MINIMUM>,
                           number<&Entry::MAXIMUM>,
                           number<&Entry::formatScale>,
                           number<&Entry::formatOffset>,
                           variant<&Entry::step>,
                           variant<&Entry::resolution>,
                           variant<&Entry::power>,
                           sequence,
                           range,
                           chooseRange,
                           suffix,
                           format,
                           flags,
                           event<&Entry::upClick>,
                           event<&Entry::downClick>,
                           event<&Entry::blank>,
                           event<&Entry::reformat>,
                           event<&Entry::Clear>,
                           units<&Entry::frequencySuffix>,
                           units<&Entry::timeSuffix>,
                           units<&Entry::meterSuffix>,
                           units<&Entry::byteSuffix>,
                           units<&Entry::dBmSuffix>};

struct State {
  double value;
  double minimum;
  double maximum;
  std::int32_t range;
  friend bool operator==(const State&, const State&) = default;
};
State stateOf(const Entry& entry) { return {entry.value(), entry.MINIMUM(), entry.MAXIMUM(), entry.range()}; }

// The resolution rounds last, by half of it at most.
bool withinLimits(const Entry& entry) {
  const double value = entry.value();
  const double room = entry.resolution().toDouble() * 0.5 + std::fabs(value) * 1e-15;
  return value >= entry.MINIMUM() - room && value <= entry.MAXIMUM() + room;
}

void run(FuzzInput input) {
  Field field;
  const Entry& entry = field.entry;
  for (int steps = 0; steps < kMaxSteps && !input.empty(); ++steps) {
    const State before = stateOf(entry);
    field.refused = 0;
    kSteps[input.number<std::uint8_t>() % std::size(kSteps)](field, input);
    require(std::isfinite(entry.value()), "a value is a finite number");
    require(entry.value() == before.value || withinLimits(entry), "a new value lies within the limits");
    require(field.refused == 0 || (stateOf(entry) == before && !entry.newValue()),
            "a refused text changes nothing");
  }
  const auto& messages = messageLog().messages();
  require(std::ranges::none_of(messages,
                               [](const std::string& said) { return said.ends_with("Internal error"); }),
          "every failure is one that the run-time knows");
}

}  // namespace
}  // namespace frontpanels::fuzz

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  frontpanels::fuzz::run(frontpanels::fuzz::FuzzInput({data, size}));
  return 0;
}

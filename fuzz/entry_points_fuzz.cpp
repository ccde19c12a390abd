// Any sequence of what a host, its container and its user can do to a panel: a byte a call, and what the call
// takes.
#include <cstdint>
#include <iterator>

#include "framework/panel/base_vfp.h"
#include "framework/panel/host_codes.h"
#include "fuzz/fuzz_input.h"
#include "fuzz/fuzz_variant.h"
#include "fuzz/panel_under_test.h"

namespace frontpanels::fuzz {
namespace {

constexpr int kMaxCalls = 64;

using Call = void (*)(PanelUnderTest& test, FuzzInput& input);

void requireStatus(PanelUnderTest& test, bool closed, std::int32_t status) {
  require(status == kStatusDone || status == kStatusUnknownOperation || status == kStatusUnusableParameter,
          "a status is one of three");
  require(!closed || status == kStatusDone, "a closed panel answers 0");
  require(!closed || test.panel().base().closing(), "a closed panel stays closed");
}

void vfpOp(PanelUnderTest& test, FuzzInput& input) {
  const bool closed = test.panel().base().closing();
  const auto hardwareId = input.number<std::int32_t>();
  const auto operation = input.number<std::int16_t>();
  requireStatus(test, closed, test.panel().vfpOp(hardwareId, operation, takeVariant(input)));
}

void vfpSet(PanelUnderTest& test, FuzzInput& input) {
  const bool closed = test.panel().base().closing();
  const auto hardwareId = input.number<std::int32_t>();
  const auto parameterType = input.number<std::int16_t>();
  const auto index = input.number<std::int16_t>();
  requireStatus(test, closed, test.panel().vfpSet(hardwareId, parameterType, index, takeVariant(input)));
}

void publish(PanelUnderTest& test, FuzzInput& input) {
  test.hub.publish(SpectrumView::kSpectrumPath, takeVariant(input));
}

void resize(PanelUnderTest& test, FuzzInput& input) {
  const auto width = input.number<std::int16_t>();
  const auto height = input.number<std::int16_t>();
  test.view.sizePx = {width % 512, height % 512};
  test.panel().Form_Resize();
}

// Positions are whole twips, or any number that a single can hold.
template <auto event, class Position>
void mouse(PanelUnderTest& test, FuzzInput& input) {
  const auto button = input.number<std::int8_t>();
  const auto shift = input.number<std::int8_t>();
  const auto x = static_cast<float>(input.number<Position>());
  const auto y = static_cast<float>(input.number<Position>());
  (test.panel().*event)(button, shift, x, y);
}

void KeyDown(PanelUnderTest& test, FuzzInput& input) {
  const auto keyCode = input.number<std::int16_t>();
  test.panel().KeyDown(keyCode, input.number<std::int8_t>());
}

template <auto member>
void call(PanelUnderTest& test, FuzzInput&) {
  (test.panel().*member)();
}

using V = SpectrumView;

// make_seeds writes the places of these rows.
constexpr Call kCalls[] = {
    vfpOp,
    vfpSet,
    publish,
    resize,
    call<&V::Paint>,
    mouse<&V::MouseDown, std::int16_t>,
    mouse<&V::MouseMove, std::int16_t>,
    mouse<&V::MouseUp, std::int16_t>,
    mouse<&V::MouseDown, float>,
    mouse<&V::MouseMove, float>,
    mouse<&V::MouseUp, float>,
    KeyDown,
    call<&V::addMarker>,
    call<&V::markerToMax>,
    call<&V::markerToMin>,
    [](PanelUnderTest& test, FuzzInput& input) { test.owner.status = input.number<std::int32_t>(); },
    [](PanelUnderTest& test, FuzzInput& input) { test.view.shown = (input.number<std::uint8_t>() & 1) != 0; },
    [](PanelUnderTest& test, FuzzInput& input) {
      test.windowing.captured = WindowHandle{input.number<std::uint8_t>()};
    },
    [](PanelUnderTest& test, FuzzInput&) { test.panel().base().closeVfp(); },
    [](PanelUnderTest& test, FuzzInput& input) {
      test.panel().base().rightPanelVisible((input.number<std::uint8_t>() & 1) != 0);
    },
    [](PanelUnderTest& test, FuzzInput& input) {
      test.panel().base().bottomPanelVisible((input.number<std::uint8_t>() & 1) != 0);
    },
};

void run(FuzzInput input) {
  PanelUnderTest test;
  for (int i = 0; i < kMaxCalls && !input.empty(); ++i)
    kCalls[input.number<std::uint8_t>() % std::size(kCalls)](test, input);
}

}  // namespace
}  // namespace frontpanels::fuzz

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  frontpanels::fuzz::run(frontpanels::fuzz::FuzzInput({data, size}));
  return 0;
}

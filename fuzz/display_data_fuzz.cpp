// Any bytes as a result buffer for a panel, from any cursor and count, its view hidden. The input is how the
// panel is set up, how often it gets the buffer, how the cursor stands, and the buffer.
#include <cstdint>
#include <vector>

#include "framework/panel/base_vfp.h"
#include "framework/support/host_codes.h"
#include "fuzz/fuzz_input.h"
#include "fuzz/panel_under_test.h"

namespace frontpanels::fuzz {
namespace {

// The ids that make_seeds writes.
constexpr std::int32_t kHardwareId = 7;
constexpr std::int32_t kMeasurementId = 100;

// The bits of the first byte.
enum SetUp : std::uint8_t { kResourceKnown = 1, kTraceAdded = 2, kCursorGiven = 4, kTwice = 8 };

// As a host that has, or has not, named its resource and added the trace; once it is there, it stays.
void setUp(SpectrumView& panel, std::uint8_t bits) {
  panel.vfpSet(kHardwareId, PARM_MEASUREMENT_ID, 0, kMeasurementId);
  panel.vfpSet(kHardwareId, PARM_RESOURCE_ID, 0, kHardwareId);
  panel.base().resourceIdValid((bits & kResourceKnown) != 0);
  if ((bits & kTraceAdded) == 0) return;
  if (panel.base().traceManager().find(SpectrumView::kSpectrumResultType) == nullptr)
    panel.vfpOp(kHardwareId, kAddTraceOperation, kAddTraceOperation);
}

// Making a panel costs a hundred times what decoding does: one serves many inputs, until its life ends with
// the checks of its destructor. The last one is left alone: the graphics below it go first.
SpectrumView& servingPanel() {
  constexpr int kInputsPerPanel = 1000;
  static PanelUnderTest* test = nullptr;
  static int inputsLeft = 0;
  if (inputsLeft-- == 0) {
    delete test;
    test = new PanelUnderTest;
    inputsLeft = kInputsPerPanel - 1;
  }
  return *test->spectrum();
}

void display(SpectrumView& panel, const std::vector<std::uint8_t>& buffer, std::int32_t cursor,
             std::int32_t count) {
  const std::int32_t cursorBefore = cursor;
  const std::int32_t countBefore = count;
  const auto size = static_cast<std::int64_t>(buffer.size());
  const bool inside = cursor >= 0 && count >= 0 && std::int64_t{cursor} + count <= size;
  const std::int32_t status = panel.displayData(Variant(), buffer, cursor, count, 0, 0);
  require(status == kStatusDone || status == kStatusUnusableParameter, "a status is done or unusable");
  if (!inside) {
    require(status == kStatusUnusableParameter, "a cursor outside the buffer is refused");
    require(cursor == cursorBefore && count == countBefore, "and stays as it was");
    return;
  }
  require(cursor >= cursorBefore && count >= 0, "the cursor never goes back nor the count below 0");
  require(std::int64_t{cursor} + count == std::int64_t{cursorBefore} + countBefore,
          "cursor and count stay inside the buffer");
}

void run(FuzzInput input) {
  const auto bits = input.number<std::uint8_t>();
  std::int32_t cursor = 0;
  std::int32_t count = 0;
  if ((bits & kCursorGiven) != 0) {
    cursor = input.number<std::int32_t>();
    count = input.number<std::int32_t>();
  }
  const auto rest = input.rest();
  const std::vector<std::uint8_t> buffer(rest.begin(), rest.end());  // of exactly this size
  if ((bits & kCursorGiven) == 0) count = static_cast<std::int32_t>(buffer.size());
  SpectrumView& panel = servingPanel();
  setUp(panel, bits);
  display(panel, buffer, cursor, count);
  if ((bits & kTwice) != 0) display(panel, buffer, cursor, count);
}

}  // namespace
}  // namespace frontpanels::fuzz

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  frontpanels::fuzz::run(frontpanels::fuzz::FuzzInput({data, size}));
  return 0;
}

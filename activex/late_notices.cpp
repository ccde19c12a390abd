#include "activex/late_notices.h"

#include <algorithm>
#include <utility>
#include <vector>

namespace frontpanels::activex {
namespace {

struct Waiting {
  ControlCore* control;
  ComPointer<IUnknown> alive;
};

int open = 0;
std::vector<Waiting> waiting;

}  // namespace

LateNotices::LateNotices() noexcept { ++open; }

LateNotices::~LateNotices() {
  if (--open > 0) return;
  const std::vector<Waiting> told = std::exchange(waiting, {});
  for (const Waiting& one : told) barrier([&one] { one.control->tellOnlookers(); });
}

void LateNotices::tell(ControlCore& control) noexcept {
  barrier([&control] {
    if (open == 0) return control.tellOnlookers();
    const bool known = std::any_of(waiting.begin(), waiting.end(),
                                   [&control](const Waiting& one) { return one.control == &control; });
    if (!known) waiting.push_back({&control, ComPointer<IUnknown>(control.outer())});
  });
}

}  // namespace frontpanels::activex

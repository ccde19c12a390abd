// Pictures that change while values are being published: who looks on is told when all panels have them, as
// he may let go of a control on hearing it, also of one in the middle of its work.
#pragma once

#include "activex/control_core.h"

namespace frontpanels::activex {

class LateNotices {
 public:
  LateNotices() noexcept;
  ~LateNotices();  // tells, when it is the outermost one
  LateNotices(const LateNotices&) = delete;
  LateNotices& operator=(const LateNotices&) = delete;

  // At the end of the outermost one that lives, else at once. A notice that there is no memory for is lost:
  // the next change brings another.
  static void tell(ControlCore& control) noexcept;
};

}  // namespace frontpanels::activex

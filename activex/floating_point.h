// The floating-point settings that the library's arithmetic relies on. Some hosts let a division by zero or a
// comparison with a not-a-number raise an exception of the processor; inside the library both are ordinary
// values.
#pragma once

#include <xmmintrin.h>

namespace frontpanels::activex {

class MaskedFloatingPoint {
 public:
  MaskedFloatingPoint() noexcept : sse_(_mm_getcsr()), x87_(x87Control()) {
    if (differs()) set(kDefaultSse, kDefaultX87);
  }
  // Puts the host's settings back, without what the arithmetic in between has flagged.
  ~MaskedFloatingPoint() {
    if (differs()) set(sse_, x87_);
  }
  MaskedFloatingPoint(const MaskedFloatingPoint&) = delete;
  MaskedFloatingPoint& operator=(const MaskedFloatingPoint&) = delete;

 private:
  static constexpr unsigned kDefaultSse = 0x1F80;  // all exceptions masked, to nearest
  static constexpr unsigned short kDefaultX87 = 0x037F;
  static constexpr unsigned kSseFlags = 0x3F;

  static unsigned short x87Control() noexcept {
    unsigned short control = 0;
    __asm__ __volatile__("fnstcw %0" : "=m"(control));
    return control;
  }
  static void set(unsigned sse, unsigned short x87) noexcept {
    _mm_setcsr(sse);
    __asm__ __volatile__("fnclex\n\tfldcw %0" : : "m"(x87));
  }
  [[nodiscard]] bool differs() const noexcept {
    return (sse_ & ~kSseFlags) != kDefaultSse || x87_ != kDefaultX87;
  }

  unsigned sse_;
  unsigned short x87_;
};

}  // namespace frontpanels::activex

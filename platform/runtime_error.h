// What anything outside raises when it fails, and what the defined arithmetic raises when it overflows: a
// number and a description, as the run-time words them.
#pragma once

#include <string>
#include <utility>

namespace frontpanels {

class RuntimeError {
 public:
  RuntimeError(int number, std::string description) : number_(number), description_(std::move(description)) {}

  [[nodiscard]] int number() const noexcept { return number_; }
  [[nodiscard]] const std::string& description() const noexcept { return description_; }
  friend bool operator==(const RuntimeError&, const RuntimeError&) = default;

 private:
  int number_;
  std::string description_;
};

[[noreturn]] void raiseInvalidProcedureCall();  // 5
[[noreturn]] void raiseOverflow();              // 6
[[noreturn]] void raiseOutOfMemory();           // 7
[[noreturn]] void raiseSubscriptOutOfRange();   // 9
[[noreturn]] void raiseDivisionByZero();        // 11
[[noreturn]] void raiseTypeMismatch();          // 13
[[noreturn]] void raiseFileNotFound();          // 53
[[noreturn]] void raiseDeviceIoError();         // 57
[[noreturn]] void raisePermissionDenied();      // 70
[[noreturn]] void raisePathFileAccessError();   // 75
[[noreturn]] void raiseObjectVariableNotSet();  // 91
[[noreturn]] void raiseInvalidUseOfNull();      // 94
[[noreturn]] void raiseInvalidFileFormat();     // 321
[[noreturn]] void raiseMemberNotSupported();    // 438
[[noreturn]] void raiseDuplicateKey();          // 457

}  // namespace frontpanels

// The one error reporter of the library. It shows messages; it never raises.
#pragma once

#include <cstdint>
#include <deque>
#include <string>
#include <string_view>

#include "platform/dialogs.h"

namespace frontpanels {

class clsErrorHandler {
 public:
  // Shows `message`; `source` and `context` are accepted for the callers' sake and not shown.
  void ModalReportError(std::string_view source, std::string_view message, std::string_view context) noexcept;
  // The same box, for host requests that failed.
  void ReportError(std::string_view message) noexcept;
  // Shows `message`, a carriage return and the description of the run-time error that is current (empty when
  // there is none), unless assertions are silenced. `source` does not change the text.
  void Assert(std::string_view message, std::string_view source = {}) noexcept;

 private:
  void show(std::string_view text) noexcept;
};

// The instance that every class reports through.
[[nodiscard]] clsErrorHandler& errorHandler() noexcept;

// What reporting depends on, set at the edge (the control's module, a test's fixture). Without dialogs a
// message reaches the log alone.
struct Reporting {
  bool silenceAssert = false;
  bool showMessages = true;
  Dialogs* dialogs = nullptr;
};
[[nodiscard]] Reporting& reporting() noexcept;

// The latest messages, for unattended running: a bounded list with a running count.
class MessageLog {
 public:
  static constexpr std::size_t kKept = 1000;

  void add(std::string_view text);
  void clear() noexcept;
  // How many messages came since the last clear, kept or not.
  [[nodiscard]] std::uint64_t count() const noexcept { return count_; }
  // The kept messages, oldest first.
  [[nodiscard]] const std::deque<std::string>& messages() const noexcept { return messages_; }

 private:
  std::deque<std::string> messages_;
  std::uint64_t count_ = 0;
};
[[nodiscard]] MessageLog& messageLog() noexcept;

// Description of the run-time error that is being reported; empty outside a failing guard.
[[nodiscard]] std::string_view currentErrorDescription() noexcept;

}  // namespace frontpanels

// What a run says: results on one stream, problems on the other, which it counts.
#pragma once

#include <cstdint>
#include <ostream>
#include <string>
#include <string_view>

#include "framework/support/guard.h"

namespace frontpanels {

// The command line, or what it asks of the panel, makes no sense.
class UsageError {
 public:
  explicit UsageError(std::string text) : text_(std::move(text)) {}
  [[nodiscard]] const std::string& text() const noexcept { return text_; }

 private:
  std::string text_;
};

class Console {
 public:
  Console(std::ostream& output, std::ostream& errors) : output_(output), errors_(errors) {}

  void say(std::string_view line) { output_ << line << '\n'; }
  void problem(std::string_view line) {
    ++problems_;
    errors_ << line << '\n';
  }
  [[nodiscard]] std::uint64_t problems() const noexcept { return problems_; }

  // What the panel has reported since the last time.
  void reportsOfPanel();
  // Results that nobody received are a problem.
  void finish();

  // Runs `body` and says what ended it, if anything but the usage did.
  template <class Body>
  void run(const Body& body) {
    try {
      body();
    } catch (const UsageError&) {
      throw;
    } catch (...) {
      problem("fp-render: " + describeCurrentException());
    }
  }

 private:
  std::ostream& output_;
  std::ostream& errors_;
  std::uint64_t problems_ = 0;
};

}  // namespace frontpanels

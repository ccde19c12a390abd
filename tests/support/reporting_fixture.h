// A fixture for whatever reports: message boxes are kept instead of shown, and every test starts with the
// global reporting state as a freshly loaded library has it.
#pragma once

#include <gtest/gtest.h>

#include <string>
#include <string_view>
#include <vector>

#include "framework/support/error_handler.h"
#include "platform/dialogs.h"

namespace frontpanels::testing {

class RecordingDialogs : public Dialogs {
 public:
  std::vector<std::string> texts;

  void messageBox(std::string_view text) noexcept override { texts.emplace_back(text); }
};

class ReportingTest : public ::testing::Test {
 protected:
  ReportingTest() {
    reporting() = Reporting{.silenceAssert = false, .showMessages = true, .dialogs = &dialogs_};
    messageLog().clear();
  }
  ~ReportingTest() override {
    reporting() = Reporting{};
    messageLog().clear();
  }

  // The message boxes so far, oldest first, word for word.
  [[nodiscard]] const std::vector<std::string>& messages() const { return dialogs_.texts; }
  void clearMessages() {
    dialogs_.texts.clear();
    messageLog().clear();
  }
  // The message boxes since it was asked last, word for word, a line each.
  [[nodiscard]] std::string said() {
    std::string lines;
    for (const std::string& text : dialogs_.texts) lines += (lines.empty() ? "" : "\n") + text;
    clearMessages();
    return lines;
  }

 private:
  RecordingDialogs dialogs_;
};

}  // namespace frontpanels::testing

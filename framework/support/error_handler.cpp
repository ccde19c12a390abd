#include "framework/support/error_handler.h"

#include <exception>
#include <new>

#include "framework/support/guard.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

std::string& currentDescription() noexcept {
  static std::string description;
  return description;
}

}  // namespace

void clsErrorHandler::ModalReportError(std::string_view /*source*/, std::string_view message,
                                       std::string_view /*context*/) noexcept {
  show(message);
}

void clsErrorHandler::ReportError(std::string_view message) noexcept { show(message); }

void clsErrorHandler::Assert(std::string_view message, std::string_view /*source*/) noexcept {
  if (reporting().silenceAssert) return;
  try {
    std::string text(message);
    text += '\r';
    text += currentErrorDescription();
    show(text);
  } catch (...) {
    show(message);  // no memory for the description: the message alone
  }
}

void clsErrorHandler::show(std::string_view text) noexcept {
  try {
    messageLog().add(text);
  } catch (...) {  // no memory to keep it: the box below still says it
  }
  if (reporting().showMessages && reporting().dialogs != nullptr) reporting().dialogs->messageBox(text);
}

clsErrorHandler& errorHandler() noexcept {
  static clsErrorHandler handler;
  return handler;
}

Reporting& reporting() noexcept {
  static Reporting state;
  return state;
}

MessageLog& messageLog() noexcept {
  static MessageLog log;
  return log;
}

void MessageLog::add(std::string_view text) {
  ++count_;
  messages_.emplace_back(text);
  if (messages_.size() > kKept) messages_.pop_front();
}

void MessageLog::clear() noexcept {
  messages_.clear();
  count_ = 0;
}

std::string_view currentErrorDescription() noexcept { return currentDescription(); }

std::string describeCurrentException() {
  try {
    throw;
  } catch (const RuntimeError& error) {
    return error.description();
  } catch (const std::bad_alloc&) {
    return "Out of memory";
  } catch (...) {
    return "Internal error";
  }
}

void reportCurrentException(std::string_view message) noexcept {
  try {
    currentDescription() = describeCurrentException();
  } catch (...) {
    currentDescription().clear();
  }
  errorHandler().Assert(message);
  currentDescription().clear();
}

}  // namespace frontpanels

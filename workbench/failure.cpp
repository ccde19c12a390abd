#include "workbench/failure.h"

#include <cstdio>
#include <new>

#include "platform/runtime_error.h"
#include "platform/win32/utf16.h"

namespace frontpanels::workbench {
namespace {

std::string systemText(DWORD code) {
  wchar_t text[512];
  const DWORD length = FormatMessageW(FORMAT_MESSAGE_FROM_SYSTEM | FORMAT_MESSAGE_IGNORE_INSERTS, nullptr,
                                      code, 0, text, static_cast<DWORD>(std::size(text)), nullptr);
  std::wstring_view words(text, length);
  const auto last = words.find_last_not_of(L"\r\n .");
  return toUtf8(words.substr(0, last == std::wstring_view::npos ? 0 : last + 1));
}

}  // namespace

NotRegistered::NotRegistered(std::string_view progId)
    : HostFailure(std::string(progId) + " is not registered. Run: regsvr32 frontpanels.ocx") {}

std::string describe(HRESULT result) {
  char code[16];
  std::snprintf(code, sizeof code, "0x%08lX", static_cast<unsigned long>(result));
  const std::string words = systemText(static_cast<DWORD>(result));
  return words.empty() ? code : std::string(code) + " (" + words + ")";
}

void check(HRESULT result, std::string_view attempt) {
  if (FAILED(result)) throw HostFailure(std::string(attempt) + ": " + describe(result));
}

void raiseLastError(std::string_view attempt) {
  const DWORD code = GetLastError();
  throw HostFailure(std::string(attempt) + ": " + describe(HRESULT_FROM_WIN32(code)));
}

std::string currentFailure() noexcept try {
  try {
    throw;
  } catch (const RuntimeError& error) {
    return error.description();
  } catch (const std::bad_alloc&) {
    return "Out of memory";
  } catch (const std::exception& error) {
    return error.what();
  } catch (...) {
    return "Internal error";
  }
} catch (...) {
  return {};
}

}  // namespace frontpanels::workbench

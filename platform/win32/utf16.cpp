#include "platform/win32/utf16.h"

#include <windows.h>

#include <limits>

#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

int checkedLength(std::size_t length) {
  if (length > static_cast<std::size_t>(std::numeric_limits<int>::max())) raiseOutOfMemory();
  return static_cast<int>(length);
}

}  // namespace

std::wstring toUtf16(std::string_view utf8) {
  const int bytes = checkedLength(utf8.size());
  if (bytes == 0) return {};  // a length of 0 is an error to the system
  const int units = MultiByteToWideChar(CP_UTF8, 0, utf8.data(), bytes, nullptr, 0);
  std::wstring text(static_cast<std::size_t>(units), L'\0');
  MultiByteToWideChar(CP_UTF8, 0, utf8.data(), bytes, text.data(), units);
  return text;
}

std::string toUtf8(std::wstring_view utf16) {
  const int units = checkedLength(utf16.size());
  if (units == 0) return {};
  const int bytes = WideCharToMultiByte(CP_UTF8, 0, utf16.data(), units, nullptr, 0, nullptr, nullptr);
  std::string text(static_cast<std::size_t>(bytes), '\0');
  WideCharToMultiByte(CP_UTF8, 0, utf16.data(), units, text.data(), bytes, nullptr, nullptr);
  return text;
}

}  // namespace frontpanels

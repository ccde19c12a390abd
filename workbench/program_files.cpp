#include "workbench/program_files.h"

#include <windows.h>

#include <shlobj.h>

#include <algorithm>
#include <cstdio>

#include "platform/win32/utf16.h"
#include "workbench/failure.h"

namespace frontpanels::workbench {
namespace {

std::filesystem::path programFolder() {
  std::wstring path(MAX_PATH, L'\0');
  while (true) {
    const DWORD length = GetModuleFileNameW(nullptr, path.data(), static_cast<DWORD>(path.size()));
    if (length == 0) raiseLastError("Looking for the program's folder");
    if (length < path.size()) return std::filesystem::path(path.substr(0, length)).parent_path();
    path.resize(path.size() * 2);
  }
}

std::string utf8(const std::filesystem::path& path) { return toUtf8(path.wstring()); }

}  // namespace

std::string carriedRecording() { return utf8(programFolder() / L"recordings" / L"fm_band.csv"); }

std::string usersSettingsFile() {
  wchar_t folder[MAX_PATH] = L"";
  check(SHGetFolderPathW(nullptr, CSIDL_APPDATA | CSIDL_FLAG_CREATE, nullptr, SHGFP_TYPE_CURRENT, folder),
        "Looking for the folder of the settings");
  return utf8(std::filesystem::path(folder) / L"Front Panels" / L"workbench.settings");
}

std::string fileName(const std::string& path) {
  return utf8(std::filesystem::path(toUtf16(path)).filename());
}

std::string wholePath(const std::string& path) {
  std::error_code error;
  const std::filesystem::path whole = std::filesystem::absolute(toUtf16(path), error);
  return error ? path : utf8(whole.lexically_normal());
}

std::string fileIn(const std::string& folder, const std::string& name) {
  const std::filesystem::path place = std::filesystem::absolute(toUtf16(folder));
  std::error_code error;
  std::filesystem::create_directories(place, error);
  if (!std::filesystem::is_directory(place, error))
    throw HostFailure(folder + ": the folder cannot be made" + (error ? ": " + error.message() : ""));
  return utf8(place / toUtf16(name));
}

std::string stamp() {
  SYSTEMTIME now{};
  GetLocalTime(&now);
  char text[32];
  std::snprintf(text, sizeof text, "%04u-%02u-%02u %02u:%02u:%02u", now.wYear, now.wMonth, now.wDay,
                now.wHour, now.wMinute, now.wSecond);
  return text;
}

std::string stampForNames() {
  std::string text = stamp();
  std::replace(text.begin(), text.end(), ':', '-');
  return text;
}

}  // namespace frontpanels::workbench

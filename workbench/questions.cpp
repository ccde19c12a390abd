#include "workbench/questions.h"

#include <commdlg.h>

#include "platform/win32/utf16.h"
#include "workbench/failure.h"

namespace frontpanels::workbench {
namespace {

constexpr DWORD kLongestPath = 32768;

OPENFILENAMEW questionFor(HWND owner, const wchar_t* title, FileFilter filter, std::wstring& path) {
  path.resize(kLongestPath);
  OPENFILENAMEW question{};
  question.lStructSize = sizeof question;
  question.hwndOwner = owner;
  question.lpstrFilter = filter;
  question.lpstrFile = path.data();
  question.nMaxFile = kLongestPath;
  question.lpstrTitle = title;
  question.Flags = OFN_HIDEREADONLY | OFN_NOCHANGEDIR;
  return question;
}

std::optional<std::string> answerOf(bool given, const std::wstring& path, const char* attempt) {
  if (given) return toUtf8(path.c_str());
  if (const DWORD error = CommDlgExtendedError(); error != 0)
    throw HostFailure(std::string(attempt) + ": the dialog failed with " + std::to_string(error));
  return std::nullopt;
}

}  // namespace

std::optional<std::string> askForFileToOpen(HWND owner, const wchar_t* title, FileFilter filter) {
  std::wstring path;
  OPENFILENAMEW question = questionFor(owner, title, filter, path);
  question.Flags |= OFN_FILEMUSTEXIST;
  return answerOf(GetOpenFileNameW(&question), path, "Asking for a file to open");
}

std::optional<std::string> askForFileToSave(HWND owner, const wchar_t* title, FileFilter filter,
                                            const wchar_t* extension, const std::string& proposed,
                                            SavedFile file) {
  std::wstring path;
  OPENFILENAMEW question = questionFor(owner, title, filter, path);
  toUtf16(proposed).copy(path.data(), kLongestPath - 1);
  question.lpstrDefExt = extension;
  question.Flags |= OFN_PATHMUSTEXIST;
  if (file == SavedFile::Replaced) question.Flags |= OFN_OVERWRITEPROMPT;
  return answerOf(GetSaveFileNameW(&question), path, "Asking for a file to save to");
}

}  // namespace frontpanels::workbench

#include "activex/registration.h"

#include <oleauto.h>

#include <iterator>

#include <string>
#include <vector>

#include "activex/barrier.h"
#include "activex/classes.h"
#include "activex/control_core.h"
#include "activex/dispatch.h"
#include "activex/module.h"
#include "frontpanels_h.h"

// Exported by the system's Automation library; the cross-compiler's headers do not declare them.
extern "C" {
HRESULT WINAPI RegisterTypeLibForUser(ITypeLib* library, OLECHAR* path, OLECHAR* helpFolder);
HRESULT WINAPI UnRegisterTypeLibForUser(REFGUID id, WORD major, WORD minor, LCID locale, SYSKIND kind);
}

namespace frontpanels::activex {
namespace {

constexpr WORD kMajorVersion = 1;
constexpr WORD kMinorVersion = 0;
constexpr wchar_t kVersion[] = L"1.0";
// What containers list as controls.
constexpr wchar_t kControlCategory[] = L"{40FC6ED4-2438-11CF-A3DB-080036F12502}";

#ifdef _WIN64
constexpr SYSKIND kSystemKind = SYS_WIN64;
#else
constexpr SYSKIND kSystemKind = SYS_WIN32;
#endif

std::wstring textOf(const GUID& id) {
  wchar_t text[40];
  return StringFromGUID2(id, text, static_cast<int>(std::size(text))) > 0 ? text : L"";
}

HKEY rootOf(Scope scope) noexcept { return scope == Scope::Machine ? HKEY_LOCAL_MACHINE : HKEY_CURRENT_USER; }

void setValue(Scope scope, const std::wstring& key, const wchar_t* name, const std::wstring& value) {
  const std::wstring path = L"Software\\Classes\\" + key;
  const LSTATUS status = RegSetKeyValueW(rootOf(scope), path.c_str(), name, REG_SZ, value.c_str(),
                                         static_cast<DWORD>((value.size() + 1) * sizeof(wchar_t)));
  if (status != ERROR_SUCCESS) throw ComFailure(HRESULT_FROM_WIN32(static_cast<DWORD>(status)));
}

void removeTree(Scope scope, const std::wstring& key) {
  const std::wstring path = L"Software\\Classes\\" + key;
  const LSTATUS status = RegDeleteTreeW(rootOf(scope), path.c_str());
  if (status != ERROR_SUCCESS && status != ERROR_FILE_NOT_FOUND)
    throw ComFailure(HRESULT_FROM_WIN32(static_cast<DWORD>(status)));
}

bool exists(Scope scope, const std::wstring& key) {
  HKEY opened = nullptr;
  const std::wstring path = L"Software\\Classes\\" + key;
  if (RegOpenKeyExW(rootOf(scope), path.c_str(), 0, KEY_READ, &opened) != ERROR_SUCCESS) return false;
  RegCloseKey(opened);
  return true;
}

std::wstring progIdOf(const ClassRow& row) { return std::wstring(L"FrontPanels.") + row.name; }

struct Entry {
  std::wstring key;
  const wchar_t* name;  // null for the key's own value
  std::wstring value;
};

std::vector<Entry> entriesOf(const ClassRow& row, const std::wstring& path) {
  const std::wstring id = textOf(*row.id);
  const std::wstring progId = progIdOf(row);
  const std::wstring versioned = progId + L".1";
  const std::wstring key = L"CLSID\\" + id;
  std::vector<Entry> entries = {
      {progId, nullptr, row.title},
      {progId + L"\\CLSID", nullptr, id},
      {progId + L"\\CurVer", nullptr, versioned},
      {versioned, nullptr, row.title},
      {versioned + L"\\CLSID", nullptr, id},
      {key, nullptr, row.title},
      {key + L"\\InprocServer32", nullptr, path},
      {key + L"\\InprocServer32", L"ThreadingModel", L"Apartment"},
      {key + L"\\ProgID", nullptr, versioned},
      {key + L"\\VersionIndependentProgID", nullptr, progId},
      {key + L"\\TypeLib", nullptr, textOf(LIBID_FrontPanels)},
      {key + L"\\Version", nullptr, kVersion},
      {key + L"\\Programmable", nullptr, L""},
  };
  if (row.toolboxBitmap == 0) return entries;
  const std::vector<Entry> ofControls = {
      {key + L"\\Control", nullptr, L""},
      {key + L"\\MiscStatus", nullptr, L"0"},
      {key + L"\\MiscStatus\\1", nullptr, std::to_wstring(kMiscStatus)},
      {key + L"\\ToolboxBitmap32", nullptr, path + L", " + std::to_wstring(row.toolboxBitmap)},
      {key + L"\\Implemented Categories\\" + kControlCategory, nullptr, L""},
  };
  entries.insert(entries.end(), ofControls.begin(), ofControls.end());
  return entries;
}

void writeAll(Scope scope) {
  std::wstring path = modulePath();
  for (const ClassRow& row : classes())
    for (const Entry& entry : entriesOf(row, path)) setValue(scope, entry.key, entry.name, entry.value);
  const ComPointer<ITypeLib> library = ownTypeLibrary();
  check(scope == Scope::Machine ? RegisterTypeLib(library.get(), path.data(), nullptr)
                                : RegisterTypeLibForUser(library.get(), path.data(), nullptr));
}

}  // namespace

void registerLibrary(Scope scope) {
  try {
    writeAll(scope);
  } catch (...) {
    barrier([scope] { unregisterLibrary(scope); });
    throw;
  }
}

void unregisterLibrary(Scope scope) {
  for (const ClassRow& row : classes()) {
    removeTree(scope, L"CLSID\\" + textOf(*row.id));
    removeTree(scope, progIdOf(row) + L".1");
    removeTree(scope, progIdOf(row));
  }
  if (!exists(scope, L"TypeLib\\" + textOf(LIBID_FrontPanels))) return;
  check(scope == Scope::Machine
            ? UnRegisterTypeLib(LIBID_FrontPanels, kMajorVersion, kMinorVersion, LOCALE_NEUTRAL, kSystemKind)
            : UnRegisterTypeLibForUser(LIBID_FrontPanels, kMajorVersion, kMinorVersion, LOCALE_NEUTRAL,
                                       kSystemKind));
}

}  // namespace frontpanels::activex

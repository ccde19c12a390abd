// The library as a module: its handle, its locks, and where its file lies.
#pragma once

#include <windows.h>

#include <string>

namespace frontpanels::activex {

[[nodiscard]] HINSTANCE moduleHandle() noexcept;
// Full path of the library's file. Raises std::system_error.
[[nodiscard]] std::wstring modulePath();

// While any lock is held the library stays loaded: objects, factories and servers' locks count.
class ModuleLock {
 public:
  ModuleLock() noexcept;
  ~ModuleLock();
  ModuleLock(const ModuleLock&) = delete;
  ModuleLock& operator=(const ModuleLock&) = delete;
};
void lockModule() noexcept;
void unlockModule() noexcept;
[[nodiscard]] long moduleLocks() noexcept;
// The library's state is kept without locks: while anything of it is in use, all calls belong to the thread
// that took the first lock.
[[nodiscard]] bool onModuleThread() noexcept;

// Called by DllMain alone.
void attachModule(HINSTANCE instance) noexcept;

}  // namespace frontpanels::activex

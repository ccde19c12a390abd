#include "activex/module.h"

#include <atomic>
#include <system_error>

namespace frontpanels::activex {
namespace {

HINSTANCE instance = nullptr;
std::atomic<long> locks = 0;
std::atomic<DWORD> ownThread = 0;

}  // namespace

void attachModule(HINSTANCE moduleInstance) noexcept { instance = moduleInstance; }
HINSTANCE moduleHandle() noexcept { return instance; }

// A user's profile may have any length and any characters: the buffer grows until the path fits.
std::wstring modulePath() {
  for (std::wstring path(MAX_PATH, L'\0');; path.resize(path.size() * 2)) {
    const DWORD written = GetModuleFileNameW(instance, path.data(), static_cast<DWORD>(path.size()));
    if (written == 0) throw std::system_error(static_cast<int>(GetLastError()), std::system_category());
    if (written < path.size()) return path.substr(0, written);
  }
}

void lockModule() noexcept {
  if (++locks == 1) ownThread = GetCurrentThreadId();
}
void unlockModule() noexcept { --locks; }
long moduleLocks() noexcept { return locks; }
bool onModuleThread() noexcept { return locks == 0 || ownThread == GetCurrentThreadId(); }

ModuleLock::ModuleLock() noexcept { lockModule(); }
ModuleLock::~ModuleLock() { unlockModule(); }

}  // namespace frontpanels::activex

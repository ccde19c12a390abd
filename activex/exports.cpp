// The functions that the system calls in the library.
#include <windows.h>

#include <cwchar>

#include "activex/barrier.h"
#include "activex/class_factory.h"
#include "activex/module.h"
#include "activex/registration.h"
#include "platform/win32/com_pointer.h"

using namespace frontpanels;
using namespace frontpanels::activex;

// Nothing but the handle is kept: under the loader's lock nothing else may be done.
extern "C" BOOL WINAPI DllMain(HINSTANCE instance, DWORD reason, void*) {
  if (reason == DLL_PROCESS_ATTACH) {
    attachModule(instance);
    DisableThreadLibraryCalls(instance);
  }
  return TRUE;
}

extern "C" HRESULT WINAPI DllGetClassObject(REFCLSID classId, REFIID id, void** object) {
  if (object == nullptr) return E_POINTER;
  *object = nullptr;
  if (!onModuleThread()) return RPC_E_WRONG_THREAD;
  return barrier([&]() -> HRESULT {
    for (const ClassRow& row : classes()) {
      if (*row.id != classId) continue;
      const auto factory = ComPointer<ClassFactory>::adopt(new ClassFactory(row));
      return factory->QueryInterface(id, object);
    }
    return CLASS_E_CLASSNOTAVAILABLE;
  });
}

extern "C" HRESULT WINAPI DllCanUnloadNow() { return moduleLocks() == 0 ? S_OK : S_FALSE; }

extern "C" HRESULT WINAPI DllRegisterServer() {
  return barrier([] { registerLibrary(Scope::Machine); });
}

extern "C" HRESULT WINAPI DllUnregisterServer() {
  return barrier([] { unregisterLibrary(Scope::Machine); });
}

// "user" registers for the current user alone.
extern "C" HRESULT WINAPI DllInstall(WINBOOL install, LPCWSTR argument) {
  const bool user = argument != nullptr && _wcsicmp(argument, L"user") == 0;
  if (!user && argument != nullptr && *argument != L'\0') return E_INVALIDARG;
  const Scope scope = user ? Scope::User : Scope::Machine;
  return barrier([&] { install ? registerLibrary(scope) : unregisterLibrary(scope); });
}

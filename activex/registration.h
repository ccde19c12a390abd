// The library's keys in the registry and its type library.
#pragma once

#include <windows.h>

namespace frontpanels::activex {

// Per-user registration serves hosts that may not write the machine's part; elevated hosts do not see it.
enum class Scope { Machine, User };

// Both raise ComFailure. A registration that fails takes back what it wrote; removing what is not there
// succeeds.
void registerLibrary(Scope scope);
void unregisterLibrary(Scope scope);

}  // namespace frontpanels::activex

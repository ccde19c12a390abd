// What axbase.idl names, from the system's headers.
#pragma once

#include <oaidl.h>
#include <ocidl.h>

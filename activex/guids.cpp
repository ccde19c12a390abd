// The identifiers' definitions, in this one file.
#define INITGUID
#include <windows.h>

#include <cguid.h>

#include "frontpanels_h.h"

#include "tests/wine/holdings.h"

namespace frontpanels::testing {
namespace {

BOOL CALLBACK countWindow(HWND window, LPARAM count) {
  ++*reinterpret_cast<int*>(count);
  if (GetAncestor(window, GA_PARENT) == GetDesktopWindow()) EnumChildWindows(window, countWindow, count);
  return TRUE;
}

// Each process sees the table of its graphics objects; an entry that is free has no type. Some systems count
// nothing where they are asked for a number.
int graphicsObjects() {
  if (const DWORD counted = GetGuiResources(GetCurrentProcess(), GR_GDIOBJECTS))
    return static_cast<int>(counted);
  constexpr int kEntries = 0x4000;
  constexpr int kEntryBytes = 24;
  constexpr int kTypeAt = 14;
  constexpr int kTableAt = sizeof(void*) == 8 ? 0xF8 : 0x94;  // in the process environment block
  const auto environment = reinterpret_cast<const char*(WINAPI*)()>(
      reinterpret_cast<void*>(GetProcAddress(GetModuleHandleW(L"ntdll.dll"), "RtlGetCurrentPeb")));
  const char* const table = *reinterpret_cast<const char* const*>(environment() + kTableAt);
  int used = 0;
  for (int i = 0; table != nullptr && i < kEntries; ++i) used += table[i * kEntryBytes + kTypeAt] != 0;
  return used;
}

void countHeaps(Holdings& held) {
  HANDLE heaps[64] = {};
  const DWORD count = GetProcessHeaps(64, heaps);
  for (DWORD i = 0; i < count && i < 64; ++i) {
    HeapLock(heaps[i]);
    for (PROCESS_HEAP_ENTRY entry{}; HeapWalk(heaps[i], &entry);) {
      if ((entry.wFlags & PROCESS_HEAP_ENTRY_BUSY) == 0) continue;
      ++held.heapBlocks;
      held.heapBytes += entry.cbData;
    }
    HeapUnlock(heaps[i]);
  }
}

}  // namespace

Holdings holdings() {
  Holdings held;
  EnumThreadWindows(GetCurrentThreadId(), countWindow, reinterpret_cast<LPARAM>(&held.windows));
  held.graphicsObjects = graphicsObjects();
  countHeaps(held);
  return held;
}

Holdings operator-(const Holdings& a, const Holdings& b) {
  return {a.windows - b.windows, a.graphicsObjects - b.graphicsObjects, a.heapBlocks - b.heapBlocks,
          a.heapBytes - b.heapBytes};
}

}  // namespace frontpanels::testing

// Plays the user of a window of another program:
//
//   tell_window CLASS WORD...
//
// Waits for a window of that class and puts into its queue, in order, for each word: "key:118" a key pressed
// and let go (a virtual key's number), "command:1101" a menu's command, "close" its closing. Ends with 1 when
// no such window came.
#include <windows.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>

namespace {

constexpr ULONGLONG kPatienceMs = 30000;
constexpr DWORD kGlanceMs = 50;

HWND waitForWindow(const char* className) {
  const ULONGLONG started = GetTickCount64();
  while (GetTickCount64() - started < kPatienceMs) {
    const HWND window = FindWindowA(className, nullptr);
    if (window != nullptr && IsWindowVisible(window)) return window;
    Sleep(kGlanceMs);
  }
  return nullptr;
}

bool tell(HWND window, const char* word) {
  if (std::strncmp(word, "key:", 4) == 0) {
    const auto key = static_cast<WPARAM>(std::atoi(word + 4));
    return PostMessageA(window, WM_KEYDOWN, key, 1) && PostMessageA(window, WM_KEYUP, key, 0xC0000001);
  }
  if (std::strncmp(word, "command:", 8) == 0)
    return PostMessageA(window, WM_COMMAND, static_cast<WPARAM>(std::atoi(word + 8)), 0);
  if (std::strcmp(word, "close") == 0) return PostMessageA(window, WM_CLOSE, 0, 0);
  return false;
}

}  // namespace

int main(int count, char** words) {
  if (count < 2) return 2;
  const HWND window = waitForWindow(words[1]);
  if (window == nullptr) {
    std::fprintf(stderr, "no window of the class %s\n", words[1]);
    return 1;
  }
  for (int i = 2; i < count; ++i) {
    if (!tell(window, words[i])) {
      std::fprintf(stderr, "the window cannot be told %s\n", words[i]);
      return 2;
    }
  }
  return 0;
}

// What the platform's services do on a real window system.
#include <windows.h>

#include <gtest/gtest.h>

#include <dlgs.h>

#include <filesystem>
#include <fstream>

#include "platform/win32/utf16.h"
#include "platform/win32/win32_dialogs.h"
#include "platform/win32/win32_locale.h"
#include "platform/win32/win32_windowing.h"
#include "tests/support/raised.h"

namespace frontpanels {
namespace {

class WindowsServices : public ::testing::Test {
 protected:
  ~WindowsServices() override { DestroyWindow(native); }

  HWND native = CreateWindowExW(0, L"STATIC", L"panel", WS_POPUP | WS_VISIBLE, 0, 0, 50, 50, nullptr, nullptr,
                                nullptr, nullptr);
  WindowHandle window{reinterpret_cast<std::uintptr_t>(native)};
};

TEST_F(WindowsServices, TextGoesThereAndBackAndReplacesWhatIsNoText) {
  EXPECT_EQ(toUtf16("Gr\xC3\xB6\xC3\x9F"), L"Gr\u00F6\u00DF");
  EXPECT_EQ(toUtf8(L"\u00F6\u20AC"), "\xC3\xB6\xE2\x82\xAC");
  EXPECT_EQ(toUtf16("a\xFFz"), L"a\uFFFDz");
  EXPECT_EQ(toUtf16(""), L"");
}

TEST_F(WindowsServices, LocaleAnswersTheUsersSettingWithinTheSize) {
  wchar_t decimal[8] = {};
  GetLocaleInfoW(1024, 14, decimal, 8);
  EXPECT_EQ(Win32Locale().info(LocaleItem::DecimalSeparator, 99), toUtf8(decimal));
  EXPECT_FALSE(Win32Locale().info(LocaleItem::ListSeparator, 99).empty());
  EXPECT_EQ(Win32Locale().info(LocaleItem::ListSeparator, 1), "");  // no room beside the terminating zero
}

TEST_F(WindowsServices, CaptureAnswersWhoHeldItBefore) {
  Win32Windowing windowing;
  EXPECT_EQ(windowing.setCapture(window), WindowHandle{});
  EXPECT_EQ(windowing.getCapture(), window);
  EXPECT_EQ(windowing.setCapture(window), window);
  windowing.releaseCapture();
  EXPECT_EQ(windowing.getCapture(), WindowHandle{});
}

TEST_F(WindowsServices, TopmostStateIsSetAndClearedAndARefusalIsToldApart) {
  Win32Windowing windowing;
  EXPECT_TRUE(windowing.setTopmost(window, true));
  EXPECT_NE(GetWindowLongW(native, GWL_EXSTYLE) & WS_EX_TOPMOST, 0);
  EXPECT_TRUE(windowing.setTopmost(window, false));
  EXPECT_EQ(GetWindowLongW(native, GWL_EXSTYLE) & WS_EX_TOPMOST, 0);
  EXPECT_FALSE(windowing.setTopmost(WindowHandle{12345}, true));
}

// What the box looked like while it was up.
struct Seen {
  std::wstring title;
  std::wstring text;
  bool ownerEnabled = true;
} seen;

void CALLBACK lookAndAnswer(HWND, UINT, UINT_PTR timer, DWORD) {
  const HWND box = FindWindowW(L"#32770", nullptr);
  if (box == nullptr) return;
  wchar_t text[100] = {};
  GetWindowTextW(box, text, 100);
  seen.title = text;
  GetDlgItemTextW(box, 0xFFFF, text, 100);
  seen.text = text;
  seen.ownerEnabled = IsWindowEnabled(GetWindow(box, GW_OWNER)) != 0;
  KillTimer(nullptr, timer);
  PostMessageW(box, WM_COMMAND, IDOK, 0);
}

TEST_F(WindowsServices, MessageBoxIsModalToTheActiveWindow) {
  SetActiveWindow(native);
  SetTimer(nullptr, 0, 100, lookAndAnswer);
  Win32Dialogs().messageBox("clsBaseVFP::vfpSet() ... \rGr\xC3\xB6\xC3\x9F");
  EXPECT_EQ(seen.text, L"clsBaseVFP::vfpSet() ... \rGr\u00F6\u00DF");
  EXPECT_EQ(seen.title, L"Error");  // the system's default
  EXPECT_FALSE(seen.ownerEnabled);
}

// What the file dialog is answered with; empty to cancel it.
std::wstring choice;

void CALLBACK choose(HWND, UINT, UINT_PTR timer, DWORD) {
  const HWND dialog = FindWindowW(L"#32770", nullptr);
  if (dialog == nullptr || !IsWindowVisible(dialog)) return;
  KillTimer(nullptr, timer);
  wchar_t text[100] = {};
  SendMessageW(GetDlgItem(dialog, cmb1), CB_GETLBTEXT, 0, reinterpret_cast<LPARAM>(text));
  seen.text = text;
  seen.ownerEnabled = IsWindowEnabled(GetWindow(dialog, GW_OWNER)) != 0;
  SendMessageW(GetDlgItem(dialog, cmb13), WM_SETTEXT, 0, reinterpret_cast<LPARAM>(choice.c_str()));
  SetDlgItemTextW(dialog, edt1, choice.c_str());
  PostMessageW(dialog, WM_COMMAND, choice.empty() ? IDCANCEL : IDOK, 0);
}

TEST_F(WindowsServices, FileDialogAnswersAPathOrNone) {
  const std::filesystem::path file = std::filesystem::temp_directory_path() / L"list \u00F6\u20AC.txt";
  std::ofstream(file) << "12";
  const auto folder = std::filesystem::current_path();
  SetActiveWindow(native);
  SetTimer(nullptr, 0, 100, choose);
  choice = file.wstring();
  EXPECT_EQ(Win32FileDialogs().openFile("Text Files (*.txt)|*.txt"), toUtf8(file.wstring()));
  EXPECT_EQ(seen.text, L"Text Files (*.txt)");
  EXPECT_FALSE(seen.ownerEnabled);
  SetTimer(nullptr, 0, 100, choose);
  choice.clear();
  EXPECT_EQ(Win32FileDialogs().openFile(""), std::nullopt);
  EXPECT_EQ(std::filesystem::current_path(), folder);
  std::filesystem::remove(file);
  for (const std::string& filter : {std::string("Text Files"), std::string("a|b|c"), std::string("a|\0", 3)})
    EXPECT_EQ(testing::raised([&] { return Win32FileDialogs().openFile(filter); }),
              "Invalid procedure call or argument");
}

TEST_F(WindowsServices, EscapeIsTakenOutOfTheQueueAndNothingElse) {
  Win32FileDialogs dialogs;
  EXPECT_FALSE(dialogs.cancelPressed());
  PostMessageW(native, WM_APP, 1, 0);
  PostMessageW(native, WM_KEYDOWN, VK_ESCAPE, 1);
  PostMessageW(native, WM_KEYDOWN, 'A', 1);
  PostMessageW(native, WM_KEYDOWN, VK_ESCAPE, 1);
  EXPECT_TRUE(dialogs.cancelPressed());
  EXPECT_FALSE(dialogs.cancelPressed());  // behind what was typed before it
  std::wstring left;
  MSG message{};
  while (PeekMessageW(&message, native, WM_KEYDOWN, WM_APP, PM_REMOVE) != 0)
    left += std::to_wstring(message.message) + L":" + std::to_wstring(message.wParam) + L" ";
  EXPECT_EQ(left, L"32768:1 256:65 256:27 ");
}

}  // namespace
}  // namespace frontpanels

#include "workbench/message_list.h"

#include <commctrl.h>

#include <algorithm>
#include <array>
#include <cstring>

#include "platform/win32/utf16.h"
#include "workbench/failure.h"
#include "workbench/resource_ids.h"
#include "workbench/screen_scale.h"

namespace frontpanels::workbench {
namespace {

constexpr int kHeight = 130;  // at 96 dots an inch
constexpr int kNarrowest = 200;

struct Column {
  const wchar_t* title;
  int width;  // at 96 dots an inch; the last one has what is left
};
constexpr std::array<Column, 3> kColumns = {{{L"Time", 80}, {L"From", 110}, {L"Message", 0}}};

std::wstring timeOfDay() {
  SYSTEMTIME now{};
  GetLocalTime(&now);
  wchar_t text[16];
  std::swprintf(text, std::size(text), L"%02u:%02u:%02u", now.wHour, now.wMinute, now.wSecond);
  return text;
}

std::wstring cell(HWND list, int row, int column) {
  wchar_t text[1024] = L"";
  LVITEMW item{};
  item.iSubItem = column;
  item.pszText = text;
  item.cchTextMax = static_cast<int>(std::size(text));
  SendMessageW(list, LVM_GETITEMTEXTW, static_cast<WPARAM>(row), reinterpret_cast<LPARAM>(&item));
  return text;
}

bool isDown(int key) { return GetKeyState(key) < 0; }

void putOnClipboard(HWND owner, const std::wstring& text) {
  const std::size_t bytes = (text.size() + 1) * sizeof(wchar_t);
  const HGLOBAL memory = GlobalAlloc(GMEM_MOVEABLE, bytes);
  if (memory == nullptr) throw std::bad_alloc();
  std::memcpy(GlobalLock(memory), text.c_str(), bytes);
  GlobalUnlock(memory);
  const bool open = OpenClipboard(owner);
  const bool taken = open && EmptyClipboard() && SetClipboardData(CF_UNICODETEXT, memory) != nullptr;
  if (open) CloseClipboard();
  if (!taken) GlobalFree(memory);
}

}  // namespace

MessageList::MessageList(HWND parent)
    : list_(CreateWindowExW(WS_EX_CLIENTEDGE, WC_LISTVIEWW, L"Messages",
                            WS_CHILD | WS_TABSTOP | LVS_REPORT | LVS_SHOWSELALWAYS | LVS_NOSORTHEADER, 0, 0,
                            0, 0, parent, reinterpret_cast<HMENU>(static_cast<UINT_PTR>(IDC_MESSAGES)),
                            GetModuleHandleW(nullptr), nullptr)) {
  if (list_ == nullptr) raiseLastError("Creating the list of messages");
  SendMessageW(list_, LVM_SETEXTENDEDLISTVIEWSTYLE, 0, LVS_EX_FULLROWSELECT | LVS_EX_LABELTIP);
  for (std::size_t i = 0; i < kColumns.size(); ++i) {
    LVCOLUMNW column{};
    column.mask = LVCF_TEXT | LVCF_WIDTH;
    column.cx = scaled(kColumns[i].width);
    column.pszText = const_cast<LPWSTR>(kColumns[i].title);
    SendMessageW(list_, LVM_INSERTCOLUMNW, i, reinterpret_cast<LPARAM>(&column));
  }
}

void MessageList::add(const std::string& source, const std::string& text) {
  const std::wstring time = timeOfDay();
  const std::wstring from = toUtf16(source);
  for (std::size_t begin = 0; begin < text.size();) {
    const std::size_t end = std::min(text.find_first_of("\r\n", begin), text.size());
    if (end > begin) addLine(time, from, toUtf16(text.substr(begin, end - begin)));
    begin = end + 1;
  }
}

void MessageList::addLine(const std::wstring& time, const std::wstring& source, const std::wstring& text) {
  if (count() >= kMostMessages) SendMessageW(list_, LVM_DELETEITEM, 0, 0);
  LVITEMW item{};
  item.mask = LVIF_TEXT;
  item.iItem = count();
  item.pszText = const_cast<LPWSTR>(time.c_str());
  const LRESULT row = SendMessageW(list_, LVM_INSERTITEMW, 0, reinterpret_cast<LPARAM>(&item));
  for (const auto& [column, words] : {std::pair(1, &source), std::pair(2, &text)}) {
    item.iSubItem = column;
    item.pszText = const_cast<LPWSTR>(words->c_str());
    SendMessageW(list_, LVM_SETITEMTEXTW, static_cast<WPARAM>(row), reinterpret_cast<LPARAM>(&item));
  }
  SendMessageW(list_, LVM_ENSUREVISIBLE, static_cast<WPARAM>(row), FALSE);
}

void MessageList::clear() { SendMessageW(list_, LVM_DELETEALLITEMS, 0, 0); }

int MessageList::count() const { return static_cast<int>(SendMessageW(list_, LVM_GETITEMCOUNT, 0, 0)); }

void MessageList::show(bool shown) {
  shown_ = shown;
  ShowWindow(list_, shown ? SW_SHOWNA : SW_HIDE);
}

LONG MessageList::heightPx() const noexcept { return shown_ ? scaled(kHeight) : 0; }

void MessageList::layOut(const RECT& place) {
  const int width = static_cast<int>(place.right - place.left);
  MoveWindow(list_, place.left, place.top, width, place.bottom - place.top, TRUE);
  int rest = width - GetSystemMetrics(SM_CXVSCROLL) - 2 * GetSystemMetrics(SM_CXEDGE);
  for (const Column& column : kColumns) rest -= scaled(column.width);
  SendMessageW(list_, LVM_SETCOLUMNWIDTH, kColumns.size() - 1, std::max(rest, scaled(kNarrowest)));
}

void MessageList::notified(const NMHDR& notice) {
  if (notice.hwndFrom != list_ || notice.code != static_cast<UINT>(LVN_KEYDOWN) || !isDown(VK_CONTROL))
    return;
  switch (reinterpret_cast<const NMLVKEYDOWN&>(notice).wVKey) {
    case 'C':
      return copySelected();
    case 'A': {
      LVITEMW all{};
      all.stateMask = all.state = LVIS_SELECTED;
      SendMessageW(list_, LVM_SETITEMSTATE, static_cast<WPARAM>(-1), reinterpret_cast<LPARAM>(&all));
      return;
    }
    default:
      return;
  }
}

void MessageList::copySelected() const {
  std::wstring text;
  LRESULT row = -1;
  while ((row = SendMessageW(list_, LVM_GETNEXTITEM, static_cast<WPARAM>(row), LVNI_SELECTED)) >= 0) {
    for (int column = 0; column < static_cast<int>(kColumns.size()); ++column)
      text += (column == 0 ? L"" : L"\t") + cell(list_, static_cast<int>(row), column);
    text += L"\r\n";
  }
  if (!text.empty()) putOnClipboard(list_, text);
}

}  // namespace frontpanels::workbench

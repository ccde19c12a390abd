// What panels and program have to say, with the time, instead of boxes that would stop the play.
#pragma once

#include <windows.h>

#include <string>

namespace frontpanels::workbench {

class MessageList {
 public:
  static constexpr int kMostMessages = 1000;  // the oldest go

  explicit MessageList(HWND parent);
  MessageList(const MessageList&) = delete;
  MessageList& operator=(const MessageList&) = delete;
  ~MessageList() = default;  // the parent takes its children with it

  // Each line of the text becomes one of the list.
  void add(const std::string& source, const std::string& text);
  void clear();
  [[nodiscard]] int count() const;

  [[nodiscard]] bool shown() const noexcept { return shown_; }
  void show(bool shown);
  // In pixels; 0 while it is hidden.
  [[nodiscard]] LONG heightPx() const noexcept;
  void layOut(const RECT& place);
  void focus() const { SetFocus(list_); }
  [[nodiscard]] bool hasFocus() const { return GetFocus() == list_; }
  // Deals with the list's own notices: Ctrl+C copies what is selected, Ctrl+A selects all.
  void notified(const NMHDR& notice);

 private:
  void addLine(const std::wstring& time, const std::wstring& source, const std::wstring& text);
  void copySelected() const;

  HWND list_ = nullptr;
  bool shown_ = false;
};

}  // namespace frontpanels::workbench

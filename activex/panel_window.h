// The window of a panel: its graph, and round it its fields as child windows. Before the control is active
// there is none, and the graph is drawn into a bitmap in memory instead, so that a panel that a script
// created works like one on a form.
#pragma once

#include <windows.h>

#include <optional>
#include <string>

#include "activex/panel_events.h"
#include "activex/panel_voice.h"
#include "platform/win32/picture_gdi.h"
#include "platform/win32/win32_controls.h"
#include "platform/windowing.h"

namespace frontpanels::activex {

// The control as its window sees it.
class WindowOwner {
 public:
  virtual ~WindowOwner() = default;

  // Keeps the control alive while one of its messages is being handled.
  virtual void holdControl() noexcept = 0;
  virtual void releaseControl() noexcept = 0;
  virtual void pressed() = 0;  // with the mouse: the control becomes the active one
  // The keyboard focus has come to the graph or a field, or has left both.
  virtual void focusChanged(bool focused) = 0;
  virtual void windowDestroyed() noexcept = 0;
  // Fields have come into reach of their access keys, or out of it.
  virtual void accessKeysChanged() = 0;
  // False while a form is being designed: the panel is a picture then, without input.
  [[nodiscard]] virtual bool inUse() const = 0;
  // What it shows while there is no window is another picture now.
  virtual void viewChanged() = 0;
};

// A device context in memory with a bitmap of 32-bit pixels, rows from the top.
class MemoryPicture {
 public:
  MemoryPicture() = default;
  ~MemoryPicture() { release(); }
  MemoryPicture(const MemoryPicture&) = delete;
  MemoryPicture& operator=(const MemoryPicture&) = delete;

  // Filled with the face colour. Raises std::bad_alloc.
  void create(Size sizePx);
  void release() noexcept;
  [[nodiscard]] HDC dc() const noexcept { return dc_; }
  [[nodiscard]] Size sizePx() const noexcept { return sizePx_; }
  [[nodiscard]] const std::uint32_t* pixels() const noexcept { return pixels_; }

 private:
  HDC dc_ = nullptr;
  HBITMAP bitmap_ = nullptr;
  HGDIOBJ previous_ = nullptr;
  std::uint32_t* pixels_ = nullptr;
  Size sizePx_{};
};

class PanelWindow final : public GraphView, private FieldsOwner {
 public:
  PanelWindow(WindowOwner& owner, ScreenMetrics metrics, Size initialSizePx);
  ~PanelWindow() override;
  // What is told about paints and input from now on; null for nobody.
  void events(PanelEvents* events) noexcept { events_ = events; }
  [[nodiscard]] PanelEvents* events() const noexcept { return events_; }
  // What is shown as child windows, null for nothing. Not while there is a window.
  void fields(ControlSet* fields);
  [[nodiscard]] bool hasFields() const noexcept { return fields_.has_value(); }
  // Of the fields, at the scale of the window; it stays the caller's. Null for that of dialogs.
  void font(HFONT font);

  // Makes the child window, not shown yet. Raises ComFailure.
  void create(HWND parent, const RECT& place);
  void destroy() noexcept;
  [[nodiscard]] HWND window() const noexcept { return window_; }
  // Moves the window and clips it where the container shows only a part.
  void place(const RECT& rect, const RECT* clip);
  // What those read who look at windows rather than into them.
  void caption(const std::wstring& text);
  // The size of the view while it has no window.
  void resizeMemory(Size sizePx);
  // Whether the graph or a field has the keyboard focus.
  [[nodiscard]] bool hasFocus() const noexcept { return holds(GetFocus()); }
  // For the container's message loop: the keys that move the focus among the fields. False for others.
  bool translateKey(const MSG& message);
  // The access keys that lead to a field now, and the effect of one, wherever the focus is; false for others.
  [[nodiscard]] std::u32string accessKeys() const;
  bool accessKey(WPARAM key);
  [[nodiscard]] PanelVoice& voice() noexcept { return voice_; }
  // Draws the whole panel, with its fields whether they have windows or not, into the bounds, which are
  // logical coordinates of the context: as lines, areas and texts at its own resolution.
  void draw(PictureGdi& gdi, HDC dc, const RECTL& bounds);
  // Composes the picture of the graph anew.
  void renderGraph(MemoryPicture& picture);

  // GraphView
  DcHandle hdc() override;
  WindowHandle hwnd() override { return {reinterpret_cast<std::uintptr_t>(window_)}; }
  Size clientSizePx() override;
  MousePointer mousePointer() override { return pointer_; }
  void mousePointer(MousePointer pointer) override;
  bool visible() override { return visible_; }
  void visible(bool visible) override;
  void refresh() override;
  void painted() override;

 private:
  static LRESULT CALLBACK windowProcedure(HWND window, UINT message, WPARAM wParam, LPARAM lParam) noexcept;
  [[nodiscard]] LRESULT handle(UINT message, WPARAM wParam, LPARAM lParam);
  // The rest of the messages, of mouse, keyboard and menu.
  [[nodiscard]] LRESULT handleInput(UINT message, WPARAM wParam, LPARAM lParam);
  void paint();
  void paintInto(HDC dc);
  void print(HDC dc);
  void fillMargins(HDC dc);
  [[nodiscard]] LRESULT dialogCode(const MSG* message);
  [[nodiscard]] bool untranslatedKey(UINT message, WPARAM key);
  void takeFocus();
  [[nodiscard]] bool holds(HWND window) const noexcept;
  bool showMenu(LPARAM position);
  void press(std::int16_t button, LPARAM position);
  void release(std::int16_t button, WPARAM keys, LPARAM position);
  [[nodiscard]] MouseEvent mouseEvent(std::int16_t button, LPARAM position) const;
  void showPointer() const;
  // Takes over the scale of the screen that the window is on.
  void followScale();

  // FieldsOwner
  void run(const std::function<void()>& body) noexcept override;
  void focusMoved(HWND to) override;
  bool inUse() const override { return owner_.inUse(); }
  bool readAloud(const Control& control, HWND window, WPARAM flags, LRESULT& result) override;
  void accessKeysChanged() override { owner_.accessKeysChanged(); }

  WindowOwner& owner_;
  PanelVoice voice_;
  ScreenMetrics metrics_;
  PanelEvents* events_ = nullptr;
  ControlSet* controls_ = nullptr;
  std::optional<Win32Controls> fields_;  // the windows of the controls
  HFONT font_ = nullptr;
  std::wstring caption_;
  bool focused_ = false;
  HWND window_ = nullptr;
  HDC windowDC_ = nullptr;
  Size memorySizePx_;
  MemoryPicture memory_;     // made when it is drawn on, so a panel that is always in a window has none
  HDC rendering_ = nullptr;  // stands in for the view while a picture is made
  bool drawing_ = false;     // for somebody else, who knows
  MousePointer pointer_ = MousePointer::Default;
  bool visible_ = true;
};

}  // namespace frontpanels::activex

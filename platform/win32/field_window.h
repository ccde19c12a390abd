// The native window of one control: it shows what the model holds, and what the user does to it reaches the
// model. A model's event may take all windows away: a window looks after each event whether it still exists.
#pragma once

#include <windows.h>

#include <functional>
#include <memory>

#include "platform/controls.h"

namespace frontpanels {

// All fields of a panel, as one of their windows sees them.
class FieldSite : public std::enable_shared_from_this<FieldSite> {
 public:
  virtual ~FieldSite() = default;

  // Runs what a message causes. Nothing that it throws gets out.
  virtual void run(const std::function<void()>& body) noexcept = 0;
  // Moves the window of a control, and the others that go with it, to their places.
  virtual void arrange(const Control& moved) = 0;
  // Shows and enables every window as far as its control's frames are.
  virtual void showUsability() = 0;
  // Valid until the site's fonts change.
  [[nodiscard]] virtual HFONT fontOf(const Control& control) const = 0;
  [[nodiscard]] virtual SpinButton* spinOf(const Control& control) const = 0;
  // What a child tells its parent's window procedure; false for what does not concern a field.
  virtual bool childMessage(UINT message, WPARAM wide, LPARAM extra, LRESULT& result) = 0;
  // A key that reaches a field without having been translated; false for what does not move the focus.
  virtual bool untranslatedKey(UINT message, WPARAM key) = 0;
  virtual void focusMoved(HWND to) = 0;
  [[nodiscard]] virtual bool inUse() const = 0;
  // The answer to who reads a field's window aloud; false for the system's.
  virtual bool readAloud(const Control& control, WPARAM flags, LRESULT& result) = 0;
  // What access keys lead to may have changed.
  virtual void captionsChanged() = 0;

  // Keeps the fields, also those that are let go of, until the message at hand is through.
  class Visit {
   public:
    explicit Visit(FieldSite& site) : site_(site.shared_from_this()) { ++site_->visits_; }
    ~Visit() {
      if (--site_->visits_ == 0) site_->allLeft();
    }
    Visit(const Visit&) = delete;
    Visit& operator=(const Visit&) = delete;

   private:
    std::shared_ptr<FieldSite> site_;
  };

 protected:
  [[nodiscard]] bool visited() const noexcept { return visits_ != 0; }
  virtual void allLeft() noexcept = 0;

 private:
  int visits_ = 0;
};

class FieldWindow : public ControlPeer {
 public:
  FieldWindow(Control& control, FieldSite& site) noexcept : control_(control), site_(site) {}
  FieldWindow(const FieldWindow&) = delete;
  FieldWindow& operator=(const FieldWindow&) = delete;

  // Raises "Out of memory" when the window system refuses.
  void create(HWND parent, const RECT& px, DWORD moreStyle);
  // The window goes; the model has no peer from now on.
  void destroy() noexcept;
  [[nodiscard]] HWND window() const noexcept { return window_; }
  [[nodiscard]] Control& control() const noexcept { return control_; }

  virtual void place(const RECT& px);
  void showUsability();
  void showFont();
  // A notification of the window to its parent (EN_CHANGE and the like).
  virtual void notified(WORD /*code*/) {}
  // An arrow of a spin button was pressed.
  virtual void stepped(bool /*up*/) {}
  // Colours of a caption; false for those of the system. The brush is the result.
  [[nodiscard]] bool colored(HDC dc, LRESULT& brush) const;
  // For windows that leave their painting to their parent.
  virtual void draw(const DRAWITEMSTRUCT& /*item*/) {}

  // ControlPeer
  void changed(ControlChange what) override;
  void takeFocus() override;
  void beep() override;

 protected:
  // One message, with the meaning that the window's class gives to it unless a kind knows better.
  [[nodiscard]] virtual LRESULT handle(UINT message, WPARAM wide, LPARAM extra);
  [[nodiscard]] LRESULT original(UINT message, WPARAM wide, LPARAM extra);
  // Styles beyond those of its kind.
  [[nodiscard]] virtual DWORD ownStyle() const { return 0; }
  // Everything of the model that its kind shows beyond the caption.
  virtual void showContents() {}
  // The keys that a dialog is to leave to the window, beyond those that its class asks for.
  [[nodiscard]] virtual LRESULT wantedKeys(WPARAM key) const;
  // Work that must wait until the window's own procedure has returned, as it cannot bear to be destroyed.
  void defer(WPARAM work) const { PostMessageW(window_, kDeferred, work, 0); }
  virtual void deferred(WPARAM /*work*/) {}
  // One notch of the wheel while the window has the focus; false when the kind has no use for it.
  virtual bool turned(bool /*up*/) { return false; }
  // What the panel makes of a key before the window has it; 0 for a character that was used up.
  virtual bool keyDown(WPARAM key);
  [[nodiscard]] std::int16_t typed(WPARAM character);

  [[nodiscard]] FieldSite& site() const noexcept { return site_; }
  [[nodiscard]] bool gone() const noexcept { return window_ == nullptr; }

 private:
  static constexpr UINT kDeferred = WM_APP + 70;

  static LRESULT CALLBACK procedure(HWND window, UINT message, WPARAM wide, LPARAM extra) noexcept;
  [[nodiscard]] LRESULT focus(bool gained, WPARAM wide, LPARAM extra);
  void showForeColor();
  [[nodiscard]] LRESULT wheel(WPARAM wide, LPARAM extra);
  void windowGone();

  Control& control_;
  FieldSite& site_;
  HWND window_ = nullptr;
  WNDPROC original_ = nullptr;
  int wheelRest_ = 0;
};

[[nodiscard]] std::unique_ptr<FieldWindow> makeFieldWindow(Control& control, FieldSite& site);

}  // namespace frontpanels

// What a panel's window tells those who read it aloud: its accessible object, made when somebody first asks
// for it, and the events that they follow it by. A new sweep is no event, and costs nothing.
#pragma once

#include <windows.h>

#include <optional>
#include <string>
#include <vector>

#include "activex/accessible_graph.h"
#include "platform/win32/com_pointer.h"
#include "traces/graph_items.h"

namespace frontpanels::activex {

class PanelEvents;
class PanelWindow;
class WindowOwner;

class PanelVoice final : private GraphTeller {
 public:
  // Both must outlive the voice.
  PanelVoice(PanelWindow& panel, WindowOwner& owner) noexcept : panel_(panel), owner_(owner) {}
  ~PanelVoice() override { windowGone(); }
  PanelVoice(const PanelVoice&) = delete;
  PanelVoice& operator=(const PanelVoice&) = delete;

  // The answer to WM_GETOBJECT for the window's client. Raises std::bad_alloc.
  [[nodiscard]] LRESULT answer(WPARAM flags);
  // The graph has been painted: tells of markers that have moved or were chosen, and of items that have come
  // or gone.
  void painted() noexcept;
  // The caption is set; tells when it is another one.
  void captioned() noexcept;
  void windowGone() noexcept;

 private:
  // GraphTeller
  HWND window() override;
  std::string title() override;
  const std::vector<GraphItem>& items() override;
  void hold() noexcept override;
  void letGo() noexcept override;

  void tell(const GraphState& before, const GraphState& now);

  PanelWindow& panel_;
  WindowOwner& owner_;
  ComPointer<AccessibleGraph> graph_;
  GraphState state_;
  std::string title_;
  GraphItems items_;
  std::optional<GraphState> itemsOf_;  // none when they are to be asked for anew
};

}  // namespace frontpanels::activex

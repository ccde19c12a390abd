#include "activex/panel_voice.h"

#include <utility>

#include "activex/barrier.h"
#include "activex/panel_window.h"

namespace frontpanels::activex {

LRESULT PanelVoice::answer(WPARAM flags) {
  if (!graph_) graph_ = ComPointer<AccessibleGraph>::adopt(new AccessibleGraph(*this));
  return handedOut(*graph_.get(), flags);
}

void PanelVoice::windowGone() noexcept {
  if (graph_) graph_->disconnect();
  graph_.reset();
}

void PanelVoice::painted() noexcept {
  itemsOf_.reset();
  if (window() == nullptr || panel_.events() == nullptr) return;
  barrier([&] {
    const GraphState now = panel_.events()->graphState();
    const GraphState before = std::exchange(state_, now);
    if (now != before) tell(before, now);
  });
}

// Whoever listens may ask back at once: the state is the new one already.
void PanelVoice::tell(const GraphState& before, const GraphState& now) {
  const HWND graph = window();
  if (now.items != before.items) NotifyWinEvent(EVENT_OBJECT_REORDER, graph, OBJID_CLIENT, CHILDID_SELF);
  const bool chosen = now.activeTrace != before.activeTrace || now.activeMarker != before.activeMarker;
  if (!chosen && now.point == before.point) return;
  const LONG followed = followedItem(items());
  if (followed == CHILDID_SELF) return;
  if (!chosen) return NotifyWinEvent(EVENT_OBJECT_VALUECHANGE, graph, OBJID_CLIENT, followed);
  NotifyWinEvent(EVENT_OBJECT_SELECTION, graph, OBJID_CLIENT, followed);
  if (GetFocus() == graph) NotifyWinEvent(EVENT_OBJECT_FOCUS, graph, OBJID_CLIENT, followed);
}

void PanelVoice::captioned() noexcept {
  if (window() == nullptr || panel_.events() == nullptr) return;
  barrier([&] {
    std::string now = title();
    if (std::exchange(title_, now) != now)
      NotifyWinEvent(EVENT_OBJECT_NAMECHANGE, window(), OBJID_CLIENT, CHILDID_SELF);
  });
}

HWND PanelVoice::window() { return panel_.window(); }

std::string PanelVoice::title() {
  return panel_.events() == nullptr ? std::string() : panel_.events()->title();
}

// What goes is gone before the next paint.
const std::vector<GraphItem>& PanelVoice::items() {
  PanelEvents* const panel = panel_.events();
  const GraphState now = panel == nullptr ? GraphState() : panel->graphState();
  if (itemsOf_ != now) items_ = panel == nullptr ? GraphItems() : panel->graphItems();
  itemsOf_ = now;
  return items_.all();
}

void PanelVoice::hold() noexcept { owner_.holdControl(); }
void PanelVoice::letGo() noexcept { owner_.releaseControl(); }

}  // namespace frontpanels::activex

#include "activex/printed_window.h"

namespace frontpanels::activex {
namespace {

// Edge first, then what the window and its children show inside it. Not all systems that run the control
// print edges or children by themselves.
void printWindow(HWND window, HDC dc, const RECT& place) {
  const int saved = SaveDC(dc);
  IntersectClipRect(dc, place.left, place.top, place.right, place.bottom);
  if ((GetWindowLongW(window, GWL_EXSTYLE) & WS_EX_CLIENTEDGE) != 0) {
    RECT edge = place;
    DrawEdge(dc, &edge, EDGE_SUNKEN, BF_RECT);
  }
  RECT client{};
  GetClientRect(window, &client);
  MapWindowPoints(window, GetParent(window), reinterpret_cast<POINT*>(&client), 2);
  IntersectClipRect(dc, client.left, client.top, client.right, client.bottom);
  OffsetViewportOrgEx(dc, client.left, client.top, nullptr);
  const auto context = reinterpret_cast<WPARAM>(dc);
  SendMessageW(window, WM_ERASEBKGND, context, 0);
  SendMessageW(window, WM_PRINTCLIENT, context, PRF_CLIENT);
  printChildren(window, dc);
  RestoreDC(dc, saved);
}

}  // namespace

// From the lowest to the topmost.
void printChildren(HWND window, HDC dc) {
  HWND child = GetWindow(window, GW_CHILD);
  if (child != nullptr) child = GetWindow(child, GW_HWNDLAST);
  for (; child != nullptr; child = GetWindow(child, GW_HWNDPREV)) {
    if ((GetWindowLongW(child, GWL_STYLE) & WS_VISIBLE) == 0) continue;
    RECT place{};
    GetWindowRect(child, &place);
    MapWindowPoints(nullptr, window, reinterpret_cast<POINT*>(&place), 2);
    printWindow(child, dc, place);
  }
}

}  // namespace frontpanels::activex

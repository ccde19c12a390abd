#include "activex/printed_window.h"

#include "activex/panel_window.h"

namespace frontpanels::activex {
namespace {

// Each into memory of its own: some systems that run the control clip a window's picture as if it began at
// the context's corner, and print neither edges nor children by themselves.
void printWindow(HWND window, HDC dc, const RECT& place) {
  if ((GetWindowLongW(window, GWL_EXSTYLE) & WS_EX_CLIENTEDGE) != 0) {
    RECT edge = place;
    DrawEdge(dc, &edge, EDGE_SUNKEN, BF_RECT);
  }
  RECT client{};
  GetClientRect(window, &client);
  MapWindowPoints(window, GetParent(window), reinterpret_cast<POINT*>(&client), 2);
  const Size size{client.right - client.left, client.bottom - client.top};
  if (size.width <= 0 || size.height <= 0) return;
  MemoryPicture picture;
  picture.create(size);
  // What lies below shines through a frame.
  BitBlt(picture.dc(), 0, 0, size.width, size.height, dc, client.left, client.top, SRCCOPY);
  const auto context = reinterpret_cast<WPARAM>(picture.dc());
  SendMessageW(window, WM_ERASEBKGND, context, 0);
  SendMessageW(window, WM_PRINTCLIENT, context, PRF_CLIENT);
  printChildren(window, picture.dc());
  BitBlt(dc, client.left, client.top, size.width, size.height, picture.dc(), 0, 0, SRCCOPY);
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

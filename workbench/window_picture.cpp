#include "workbench/window_picture.h"

#include <wincodec.h>

#include <algorithm>
#include <cstdint>
#include <memory>
#include <type_traits>
#include <vector>

#include "hosting/whole_file.h"
#include "platform/win32/com_pointer.h"
#include "platform/win32/utf16.h"
#include "workbench/failure.h"

namespace frontpanels::workbench {
namespace {

struct DeleteDcOf {
  void operator()(HDC dc) const noexcept { DeleteDC(dc); }
};
struct DeleteBitmapOf {
  void operator()(HBITMAP bitmap) const noexcept { DeleteObject(bitmap); }
};
using MemoryDc = std::unique_ptr<std::remove_pointer_t<HDC>, DeleteDcOf>;
using Bitmap = std::unique_ptr<std::remove_pointer_t<HBITMAP>, DeleteBitmapOf>;

class WindowDc {
 public:
  explicit WindowDc(HWND window) : window_(window), dc_(GetWindowDC(window)) {}
  WindowDc(const WindowDc&) = delete;
  WindowDc& operator=(const WindowDc&) = delete;
  ~WindowDc() { ReleaseDC(window_, dc_); }
  [[nodiscard]] HDC get() const noexcept { return dc_; }

 private:
  HWND window_;
  HDC dc_;
};

// Rows from the top, three bytes a pixel, each row filled up to a multiple of four bytes.
struct Picture {
  Bitmap bitmap;
  BYTE* bytes = nullptr;
  UINT width = 0;
  UINT height = 0;

  [[nodiscard]] UINT stride() const noexcept { return (width * 3 + 3) & ~3U; }
};

Picture makePicture(LONG width, LONG height) {
  BITMAPINFO info{};
  info.bmiHeader.biSize = sizeof info.bmiHeader;
  info.bmiHeader.biWidth = width;
  info.bmiHeader.biHeight = -height;
  info.bmiHeader.biPlanes = 1;
  info.bmiHeader.biBitCount = 24;
  Picture picture;
  void* bits = nullptr;
  picture.bitmap.reset(CreateDIBSection(nullptr, &info, DIB_RGB_COLORS, &bits, nullptr, 0));
  if (!picture.bitmap) raiseLastError("Making room for a screenshot");
  picture.bytes = static_cast<BYTE*>(bits);
  picture.width = static_cast<UINT>(width);
  picture.height = static_cast<UINT>(height);
  return picture;
}

// In screen coordinates.
RECT menuAndClientArea(HWND window) {
  RECT area{};
  GetClientRect(window, &area);
  MapWindowPoints(window, nullptr, reinterpret_cast<POINT*>(&area), 2);
  MENUBARINFO menu{};
  menu.cbSize = sizeof menu;
  if (GetMenuBarInfo(window, OBJID_MENU, 0, &menu)) area.top = std::min(area.top, menu.rcBar.top);
  return area;
}

Picture copyOf(HDC source, const RECT& area) {
  Picture picture = makePicture(area.right - area.left, area.bottom - area.top);
  const MemoryDc target(CreateCompatibleDC(source));
  const HGDIOBJ previous = SelectObject(target.get(), picture.bitmap.get());
  const bool copied = BitBlt(target.get(), 0, 0, static_cast<int>(picture.width),
                             static_cast<int>(picture.height), source, area.left, area.top, SRCCOPY);
  SelectObject(target.get(), previous);
  GdiFlush();
  if (!copied) raiseLastError("Copying the picture");
  return picture;
}

Picture captureWindow(HWND window) {
  RedrawWindow(window, nullptr, nullptr, RDW_UPDATENOW | RDW_ALLCHILDREN);
  RECT whole{};
  GetWindowRect(window, &whole);
  RECT area = menuAndClientArea(window);
  OffsetRect(&area, -whole.left, -whole.top);
  return copyOf(WindowDc(window).get(), area);
}

std::vector<std::uint8_t> contentOf(IStream& stream, const std::string& attempt) {
  STATSTG state{};
  check(stream.Stat(&state, STATFLAG_NONAME), attempt);
  std::vector<std::uint8_t> content(static_cast<std::size_t>(state.cbSize.QuadPart));
  check(stream.Seek({}, STREAM_SEEK_SET, nullptr), attempt);
  ULONG read = 0;
  check(stream.Read(content.data(), static_cast<ULONG>(content.size()), &read), attempt);
  content.resize(read);
  return content;
}

// Through memory: a picture that cannot be written whole leaves the one that was there.
void writePng(const Picture& picture, const std::string& path) {
  const std::string attempt = "Writing " + path;
  ComPointer<IWICImagingFactory> factory;
  check(CoCreateInstance(CLSID_WICImagingFactory, nullptr, CLSCTX_INPROC_SERVER, __uuidof(IWICImagingFactory),
                         reinterpret_cast<void**>(factory.receive())),
        attempt);
  ComPointer<IStream> bytes;
  check(CreateStreamOnHGlobal(nullptr, TRUE, bytes.receive()), attempt);
  ComPointer<IWICBitmapEncoder> encoder;
  check(factory->CreateEncoder(GUID_ContainerFormatPng, nullptr, encoder.receive()), attempt);
  check(encoder->Initialize(bytes.get(), WICBitmapEncoderNoCache), attempt);
  ComPointer<IWICBitmapFrameEncode> frame;
  check(encoder->CreateNewFrame(frame.receive(), nullptr), attempt);
  check(frame->Initialize(nullptr), attempt);
  check(frame->SetSize(picture.width, picture.height), attempt);
  WICPixelFormatGUID format = GUID_WICPixelFormat24bppBGR;
  check(frame->SetPixelFormat(&format), attempt);
  if (format != GUID_WICPixelFormat24bppBGR) throw HostFailure(attempt + ": the encoder wants other pixels");
  check(
      frame->WritePixels(picture.height, picture.stride(), picture.stride() * picture.height, picture.bytes),
      attempt);
  check(frame->Commit(), attempt);
  check(encoder->Commit(), attempt);
  saveWhole(path, contentOf(*bytes.get(), attempt));
}

}  // namespace

void saveWindowPicture(HWND window, const std::string& path) { writePng(captureWindow(window), path); }

void saveContextPicture(HDC dc, SIZE sizePx, const std::string& path) {
  writePng(copyOf(dc, {0, 0, sizePx.cx, sizePx.cy}), path);
}

}  // namespace frontpanels::workbench

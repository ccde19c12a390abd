#include "activex/picture_file.h"

#include <wincodec.h>

#include "activex/barrier.h"
#include "platform/runtime_error.h"
#include "platform/win32/com_pointer.h"

namespace frontpanels::activex {
namespace {

ComPointer<IWICImagingFactory> imaging() {
  ComPointer<IWICImagingFactory> factory;
  check(CoCreateInstance(CLSID_WICImagingFactory, nullptr, CLSCTX_INPROC_SERVER, IID_IWICImagingFactory,
                         reinterpret_cast<void**>(factory.receive())));
  return factory;
}

void encode(IWICImagingFactory& factory, IStream* stream, const MemoryPicture& picture) {
  ComPointer<IWICBitmapEncoder> encoder;
  check(factory.CreateEncoder(GUID_ContainerFormatPng, nullptr, encoder.receive()));
  check(encoder->Initialize(stream, WICBitmapEncoderNoCache));
  ComPointer<IWICBitmapFrameEncode> frame;
  check(encoder->CreateNewFrame(frame.receive(), nullptr));
  check(frame->Initialize(nullptr));
  const auto width = static_cast<UINT>(picture.sizePx().width);
  const auto height = static_cast<UINT>(picture.sizePx().height);
  check(frame->SetSize(width, height));
  ComPointer<IWICBitmap> bitmap;
  check(factory.CreateBitmapFromMemory(
      width, height, GUID_WICPixelFormat32bppBGR, width * 4, width * height * 4,
      reinterpret_cast<BYTE*>(const_cast<std::uint32_t*>(picture.pixels())), bitmap.receive()));
  WICPixelFormatGUID format = GUID_WICPixelFormat24bppBGR;
  check(frame->SetPixelFormat(&format));
  ComPointer<IWICFormatConverter> converter;
  check(factory.CreateFormatConverter(converter.receive()));
  check(converter->Initialize(bitmap.get(), format, WICBitmapDitherTypeNone, nullptr, 0,
                              WICBitmapPaletteTypeCustom));
  check(frame->WriteSource(converter.get(), nullptr));
  check(frame->Commit());
  check(encoder->Commit());
}

void encodeFile(const std::wstring& path, const MemoryPicture& picture) {
  const ComPointer<IWICImagingFactory> factory = imaging();
  ComPointer<IWICStream> stream;
  check(factory->CreateStream(stream.receive()));
  if (FAILED(stream->InitializeFromFilename(path.c_str(), GENERIC_WRITE))) raisePathFileAccessError();
  encode(*factory.get(), stream.get(), picture);
}

}  // namespace

std::vector<std::uint8_t> encodePng(const MemoryPicture& picture) {
  GdiFlush();
  ComPointer<IStream> stream;
  check(CreateStreamOnHGlobal(nullptr, TRUE, stream.receive()));
  encode(*imaging().get(), stream.get(), picture);
  STATSTG facts{};
  check(stream->Stat(&facts, STATFLAG_NONAME));
  std::vector<std::uint8_t> png(static_cast<std::size_t>(facts.cbSize.QuadPart));
  check(stream->Seek({}, STREAM_SEEK_SET, nullptr));
  ULONG read = 0;
  check(stream->Read(png.data(), static_cast<ULONG>(png.size()), &read));
  png.resize(read);
  return png;
}

// Written aside and renamed, so that a full disk leaves no half picture.
void writePng(const std::wstring& path, const MemoryPicture& picture) {
  const std::wstring aside = path + L".part";
  GdiFlush();
  try {
    encodeFile(aside, picture);
  } catch (...) {
    DeleteFileW(aside.c_str());
    throw;
  }
  if (MoveFileExW(aside.c_str(), path.c_str(), MOVEFILE_REPLACE_EXISTING)) return;
  DeleteFileW(aside.c_str());
  raisePathFileAccessError();
}

}  // namespace frontpanels::activex

#include "activex/data_part.h"

#include <algorithm>

#include "activex/enumerators.h"
#include "activex/services.h"

namespace frontpanels::activex {
namespace {

constexpr FORMATETC kEnhanced{CF_ENHMETAFILE, nullptr, DVASPECT_CONTENT, -1, TYMED_ENHMF};
constexpr FORMATETC kPlain{CF_METAFILEPICT, nullptr, DVASPECT_CONTENT, -1, TYMED_MFPICT};

HRESULT judge(const FORMATETC* format) {
  if (format == nullptr) return E_POINTER;
  const bool enhanced = format->cfFormat == CF_ENHMETAFILE;
  if (!enhanced && format->cfFormat != CF_METAFILEPICT) return DV_E_FORMATETC;
  if (format->dwAspect != DVASPECT_CONTENT) return DV_E_DVASPECT;
  if (format->lindex != -1) return DV_E_LINDEX;
  return (format->tymed & (enhanced ? TYMED_ENHMF : TYMED_MFPICT)) != 0 ? S_OK : DV_E_TYMED;
}

struct FormatTraits {
  using Item = FORMATETC;
  using Handed = FORMATETC;
  static Handed hand(const Item& item) { return item; }
};
using FormatEnumerator = Enumerator<IEnumFORMATETC, FormatTraits>;

// What was recorded, when all of it was drawn. Raises ComFailure.
template <class Metafile>
Metafile whole(HRESULT drawn, Metafile recorded, WINBOOL(WINAPI* discard)(Metafile)) {
  if (SUCCEEDED(drawn) && recorded != nullptr) return recorded;
  if (recorded != nullptr) discard(recorded);
  throw ComFailure(FAILED(drawn) ? drawn : E_OUTOFMEMORY);
}

// The kinds of metafile have the size in himetric. What is drawn into an enhanced one is counted in pixels of
// the screen by its size in millimetres, which need not be those of its dots an inch.
HENHMETAFILE recordEnhanced(ControlCore& control) {
  const SIZEL extent = control.extent();
  const RECT frame{0, 0, static_cast<LONG>(extent.cx), static_cast<LONG>(extent.cy)};
  const HDC dc = CreateEnhMetaFileW(nullptr, nullptr, &frame, nullptr);
  if (dc == nullptr) throw ComFailure(E_OUTOFMEMORY);
  const auto lengthPx = [dc](LONG himetric, int resolution, int millimetres) {
    return MulDiv(static_cast<int>(himetric), GetDeviceCaps(dc, resolution),
                  100 * GetDeviceCaps(dc, millimetres));
  };
  const RECTL bounds{0, 0, lengthPx(extent.cx, HORZRES, HORZSIZE), lengthPx(extent.cy, VERTRES, VERTSIZE)};
  const HRESULT drawn = barrier([&] { control.window().draw(services().gdi, dc, bounds); });
  return whole(drawn, CloseEnhMetaFile(dc), DeleteEnhMetaFile);
}

HMETAFILE recordPlain(ControlCore& control) {
  const HDC dc = CreateMetaFileW(nullptr);
  if (dc == nullptr) throw ComFailure(E_OUTOFMEMORY);
  const SIZEL extent = control.extent();
  // Its coordinates have 16 bits.
  constexpr LONG kLargest = 16000;
  const LONG unit = std::max(extent.cx, extent.cy) / kLargest + 1;
  const RECTL bounds{0, 0, extent.cx / unit, extent.cy / unit};
  SetMapMode(dc, MM_ANISOTROPIC);
  SetWindowOrgEx(dc, 0, 0, nullptr);
  SetWindowExtEx(dc, static_cast<int>(bounds.right), static_cast<int>(bounds.bottom), nullptr);
  const HRESULT drawn = barrier([&] { control.window().draw(services().gdi, dc, bounds); });
  return whole(drawn, CloseMetaFile(dc), DeleteMetaFile);
}

HGLOBAL metafilePicture(ControlCore& control) {
  const HMETAFILE recorded = recordPlain(control);
  const HGLOBAL memory = GlobalAlloc(GMEM_MOVEABLE, sizeof(METAFILEPICT));
  auto* const picture = memory == nullptr ? nullptr : static_cast<METAFILEPICT*>(GlobalLock(memory));
  if (picture == nullptr) {
    DeleteMetaFile(recorded);
    GlobalFree(memory);
    throw ComFailure(E_OUTOFMEMORY);
  }
  const SIZEL extent = control.extent();
  *picture = {MM_ANISOTROPIC, static_cast<LONG>(extent.cx), static_cast<LONG>(extent.cy), recorded};
  GlobalUnlock(memory);
  return memory;
}

}  // namespace

void DataPart::changed() {
  if (const ComPointer<IDataAdviseHolder> advises = advises_) advises->SendOnDataChange(this, 0, 0);
}

void DataPart::closed() {
  if (const ComPointer<IDataAdviseHolder> advises = advises_)
    advises->SendOnDataChange(this, 0, ADVF_DATAONSTOP);
}

HRESULT DataPart::GetData(FORMATETC* format, STGMEDIUM* medium) {
  if (medium == nullptr) return E_POINTER;
  *medium = {};
  const HRESULT offered = judge(format);
  if (offered != S_OK) return offered;
  return entry([&] {
    if (format->cfFormat == CF_ENHMETAFILE) {
      medium->hEnhMetaFile = recordEnhanced(core());
      medium->tymed = TYMED_ENHMF;
    } else {
      medium->hMetaFilePict = metafilePicture(core());
      medium->tymed = TYMED_MFPICT;
    }
  });
}

HRESULT DataPart::QueryGetData(FORMATETC* format) { return judge(format); }

HRESULT DataPart::GetCanonicalFormatEtc(FORMATETC* format, FORMATETC* canonical) {
  if (format == nullptr || canonical == nullptr) return E_POINTER;
  *canonical = *format;
  canonical->ptd = nullptr;  // pictures are the same for all devices
  return format->ptd == nullptr ? DATA_S_SAMEFORMATETC : S_OK;
}

HRESULT DataPart::EnumFormatEtc(DWORD direction, IEnumFORMATETC** formats) {
  if (formats == nullptr) return E_POINTER;
  *formats = nullptr;
  if (direction != DATADIR_GET) return E_NOTIMPL;
  return entry([&] { *formats = new FormatEnumerator({kEnhanced, kPlain}); });
}

HRESULT DataPart::DAdvise(FORMATETC* format, DWORD flags, IAdviseSink* sink, DWORD* connection) {
  if (connection == nullptr) return E_POINTER;
  *connection = 0;
  // Everything at once may be asked for as well.
  const HRESULT offered = format != nullptr && format->cfFormat == 0 ? S_OK : judge(format);
  if (offered != S_OK) return offered;
  return entry([&]() -> HRESULT {
    if (!advises_) check(CreateDataAdviseHolder(advises_.receive()));
    return advises_->Advise(this, format, flags, sink, connection);
  });
}

HRESULT DataPart::DUnadvise(DWORD connection) {
  return entry([&] { return advises_ ? advises_->Unadvise(connection) : OLE_E_NOCONNECTION; });
}

HRESULT DataPart::EnumDAdvise(IEnumSTATDATA** advises) {
  if (advises == nullptr) return E_POINTER;
  *advises = nullptr;
  return advises_ ? advises_->EnumAdvise(advises) : S_OK;
}

}  // namespace frontpanels::activex

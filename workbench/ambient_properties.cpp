#include "workbench/ambient_properties.h"

#include <windows.h>

#include <olectl.h>

#include <algorithm>
#include <iterator>
#include <new>

#include "workbench/failure.h"

namespace frontpanels::workbench {
namespace {

void answerFlag(VARIANT& result, bool flag) {
  result.vt = VT_BOOL;
  result.boolVal = flag ? VARIANT_TRUE : VARIANT_FALSE;
}

void answerColor(VARIANT& result, int systemColor) {
  result.vt = VT_I4;
  result.lVal = static_cast<LONG>(GetSysColor(systemColor));
}

void answerText(VARIANT& result, const std::wstring& text) {
  result.bstrVal = SysAllocStringLen(text.data(), static_cast<UINT>(text.size()));
  if (result.bstrVal == nullptr) throw std::bad_alloc();
  result.vt = VT_BSTR;
}

// The font of message boxes, which follows the user's settings.
void answerFont(VARIANT& result) {
  NONCLIENTMETRICSW metrics{};
  metrics.cbSize = sizeof metrics;
  if (!SystemParametersInfoW(SPI_GETNONCLIENTMETRICS, metrics.cbSize, &metrics, 0))
    raiseLastError("Asking for the font");
  const LOGFONTW& font = metrics.lfMessageFont;
  const HDC screen = GetDC(nullptr);
  const int dpi = std::max(1, GetDeviceCaps(screen, LOGPIXELSY));
  ReleaseDC(nullptr, screen);
  FONTDESC description{};
  description.cbSizeofstruct = sizeof description;
  description.lpstrName = const_cast<LPOLESTR>(font.lfFaceName);
  // Ten-thousandths of a point.
  description.cySize.int64 = static_cast<LONGLONG>(MulDiv(std::abs(font.lfHeight), 72, dpi)) * 10000;
  description.sWeight = static_cast<SHORT>(font.lfWeight);
  description.sCharset = font.lfCharSet;
  description.fItalic = font.lfItalic;
  check(OleCreateFontIndirect(&description, IID_IDispatch, reinterpret_cast<void**>(&result.pdispVal)),
        "Making the ambient font");
  result.vt = VT_DISPATCH;
}

struct Ambient {
  DISPID id;
  void (*answer)(VARIANT& result, const std::wstring& displayName);
};

template <bool flag>
void flagIs(VARIANT& result, const std::wstring&) {
  answerFlag(result, flag);
}

template <int systemColor>
void colorIs(VARIANT& result, const std::wstring&) {
  answerColor(result, systemColor);
}

constexpr Ambient kAmbients[] = {
    {DISPID_AMBIENT_USERMODE, flagIs<true>},
    {DISPID_AMBIENT_UIDEAD, flagIs<false>},
    {DISPID_AMBIENT_SHOWHATCHING, flagIs<false>},
    {DISPID_AMBIENT_SHOWGRABHANDLES, flagIs<false>},
    {DISPID_AMBIENT_DISPLAYASDEFAULT, flagIs<false>},
    {DISPID_AMBIENT_MESSAGEREFLECT, flagIs<false>},
    {DISPID_AMBIENT_SUPPORTSMNEMONICS, flagIs<false>},
    {DISPID_AMBIENT_AUTOCLIP, flagIs<true>},
    {DISPID_AMBIENT_RIGHTTOLEFT, flagIs<false>},
    {DISPID_AMBIENT_BACKCOLOR, colorIs<COLOR_BTNFACE>},
    {DISPID_AMBIENT_FORECOLOR, colorIs<COLOR_BTNTEXT>},
    {DISPID_AMBIENT_FONT, [](VARIANT& result, const std::wstring&) { answerFont(result); }},
    {DISPID_AMBIENT_LOCALEID,
     [](VARIANT& result, const std::wstring&) {
       result.vt = VT_I4;
       result.lVal = static_cast<LONG>(GetUserDefaultLCID());
     }},
    {DISPID_AMBIENT_DISPLAYNAME,
     [](VARIANT& result, const std::wstring& displayName) { answerText(result, displayName); }},
    {DISPID_AMBIENT_SCALEUNITS, [](VARIANT& result, const std::wstring&) { answerText(result, L"Twip"); }},
};

}  // namespace

HRESULT ambientProperty(DISPID id, const std::wstring& displayName, VARIANT& result) {
  const auto* const ambient = std::find_if(std::begin(kAmbients), std::end(kAmbients),
                                           [id](const Ambient& candidate) { return candidate.id == id; });
  if (ambient == std::end(kAmbients)) return DISP_E_MEMBERNOTFOUND;
  VariantInit(&result);
  ambient->answer(result, displayName);
  return S_OK;
}

}  // namespace frontpanels::workbench

#include "workbench/extender.h"

#include <windows.h>

#include <algorithm>

#include "workbench/failure.h"
#include "workbench/screen_scale.h"

namespace frontpanels::workbench {
namespace {

void answer(VARIANT& result, LONG number) {
  result.vt = VT_I4;
  result.lVal = number;
}

void answer(VARIANT& result, bool flag) {
  result.vt = VT_BOOL;
  result.boolVal = flag ? VARIANT_TRUE : VARIANT_FALSE;
}

void answer(VARIANT& result, const std::wstring& text) {
  result.bstrVal = SysAllocStringLen(text.data(), static_cast<UINT>(text.size()));
  if (result.bstrVal == nullptr) throw std::bad_alloc();
  result.vt = VT_BSTR;
}

// Converts what a panel puts to the type that the property has.
class Converted {
 public:
  Converted(VARIANT& from, VARTYPE type) {
    VariantInit(&value_);
    check(VariantChangeType(&value_, &from, 0, type), "Setting a property of the container");
  }
  Converted(const Converted&) = delete;
  Converted& operator=(const Converted&) = delete;
  ~Converted() { VariantClear(&value_); }
  [[nodiscard]] const VARIANT& value() const noexcept { return value_; }

 private:
  VARIANT value_;
};

}  // namespace

struct Extender::Property {
  const wchar_t* name;
  DISPID id;
  void (*get)(Extender& self, VARIANT& result);
  void (*put)(Extender& self, VARIANT& value);  // null for a property that can only be read
};

namespace {

// A side, or the extent from one side to the other, that a panel asks for.
template <LONG RECT::*low, LONG RECT::*high, bool isExtent>
void putTwips(PanelPlace& place, VARIANT& value) {
  const LONG pixels = pixelsFromTwips(Converted(value, VT_R8).value().dblVal);
  RECT wanted = place.bounds();
  const LONG extent = wanted.*high - wanted.*low;
  if (!isExtent) wanted.*low = pixels;
  wanted.*high = wanted.*low + (isExtent ? pixels : extent);
  place.bounds(wanted);
}

}  // namespace

// Places are counted in the program's window, extents are those of the panel's own window in it.
const Extender::Property Extender::kProperties[] = {
    {L"Name", 1, [](Extender& self, VARIANT& result) { answer(result, self.name_); }, nullptr},
    {L"Left", 2, [](Extender& self, VARIANT& result) { answer(result, self.edgeTwips(&RECT::left)); },
     [](Extender& self, VARIANT& value) {
       putTwips<&RECT::left, &RECT::right, false>(self.owner_->place(), value);
     }},
    {L"Top", 3, [](Extender& self, VARIANT& result) { answer(result, self.edgeTwips(&RECT::top)); },
     [](Extender& self, VARIANT& value) {
       putTwips<&RECT::top, &RECT::bottom, false>(self.owner_->place(), value);
     }},
    {L"Width", 4,
     [](Extender& self, VARIANT& result) { answer(result, self.extentTwips(&RECT::left, &RECT::right)); },
     [](Extender& self, VARIANT& value) {
       putTwips<&RECT::left, &RECT::right, true>(self.owner_->place(), value);
     }},
    {L"Height", 5,
     [](Extender& self, VARIANT& result) { answer(result, self.extentTwips(&RECT::top, &RECT::bottom)); },
     [](Extender& self, VARIANT& value) {
       putTwips<&RECT::top, &RECT::bottom, true>(self.owner_->place(), value);
     }},
    {L"Visible", 6, [](Extender& self, VARIANT& result) { answer(result, self.owner_->place().visible()); },
     [](Extender& self, VARIANT& value) {
       self.owner_->place().visible(Converted(value, VT_BOOL).value().boolVal != VARIANT_FALSE);
     }},
    {L"Caption", 7, [](Extender& self, VARIANT& result) { answer(result, self.caption_); },
     [](Extender& self, VARIANT& value) {
       const Converted text(value, VT_BSTR);
       self.caption_.assign(text.value().bstrVal, SysStringLen(text.value().bstrVal));
       self.owner_->place().panelCaption(self.caption_);
     }},
    {L"ViewState", 8,
     [](Extender& self, VARIANT& result) { answer(result, self.owner_->place().viewState()); },
     [](Extender& self, VARIANT& value) {
       self.owner_->place().viewState(Converted(value, VT_I4).value().lVal);
     }},
};

LONG Extender::edgeTwips(LONG RECT::*edge) {
  const RECT rect = owner_->place().bounds();
  return twipsFromPixels(rect.*edge);
}

LONG Extender::extentTwips(LONG RECT::*low, LONG RECT::*high) {
  const RECT rect = owner_->place().bounds();
  return twipsFromPixels(rect.*high - rect.*low);
}

void* Extender::findInterface(REFIID id) noexcept {
  return id == IID_IUnknown || id == IID_IDispatch ? static_cast<IDispatch*>(this) : nullptr;
}

HRESULT Extender::GetTypeInfoCount(UINT* count) {
  if (count == nullptr) return E_POINTER;
  *count = 0;
  return S_OK;
}

HRESULT Extender::GetTypeInfo(UINT, LCID, ITypeInfo** info) {
  if (info != nullptr) *info = nullptr;
  return E_NOTIMPL;
}

HRESULT Extender::GetIDsOfNames(REFIID, LPOLESTR* names, UINT count, LCID, DISPID* ids) {
  return comBarrier([&]() -> HRESULT {
    if (names == nullptr || ids == nullptr || count == 0) return E_POINTER;
    std::fill_n(ids, count, DISPID_UNKNOWN);
    for (const Property& property : kProperties)
      if (lstrcmpiW(names[0], property.name) == 0) ids[0] = property.id;
    // Names beyond the first are those of arguments, and properties have none.
    return count == 1 && ids[0] != DISPID_UNKNOWN ? S_OK : DISP_E_UNKNOWNNAME;
  });
}

HRESULT Extender::Invoke(DISPID member, REFIID, LCID, WORD flags, DISPPARAMS* parameters, VARIANT* result,
                         EXCEPINFO*, UINT*) {
  return comBarrier([&]() -> HRESULT {
    const ComPointer<Extender> alive(this);
    if (owner_ == nullptr) return E_UNEXPECTED;
    for (const Property& property : kProperties) {
      if (property.id != member) continue;
      if ((flags & (DISPATCH_PROPERTYPUT | DISPATCH_PROPERTYPUTREF)) != 0) {
        if (property.put == nullptr) return DISP_E_MEMBERNOTFOUND;
        if (parameters == nullptr || parameters->cArgs != 1) return DISP_E_BADPARAMCOUNT;
        property.put(*this, parameters->rgvarg[0]);
        return S_OK;
      }
      if (result == nullptr) return E_POINTER;
      VariantInit(result);
      property.get(*this, *result);
      return S_OK;
    }
    return DISP_E_MEMBERNOTFOUND;
  });
}

}  // namespace frontpanels::workbench

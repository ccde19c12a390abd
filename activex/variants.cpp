#include "activex/variants.h"

#include <oleauto.h>

#include <algorithm>
#include <new>
#include <utility>
#include <vector>

#include "activex/barrier.h"
#include "platform/runtime_error.h"
#include "platform/win32/utf16.h"

namespace frontpanels::activex {
namespace {

// A variant that clears itself.
struct OwnedVariant {
  VARIANT value{};
  OwnedVariant() { VariantInit(&value); }
  ~OwnedVariant() { VariantClear(&value); }
  OwnedVariant(const OwnedVariant&) = delete;
  OwnedVariant& operator=(const OwnedVariant&) = delete;
};

// An array's data, held in place.
class LockedArray {
 public:
  explicit LockedArray(SAFEARRAY* array) : array_(array) {
    if (array_ == nullptr || SafeArrayGetDim(array_) != 1) raiseTypeMismatch();
    if (FAILED(SafeArrayAccessData(array_, &data_))) raiseTypeMismatch();
  }
  ~LockedArray() { SafeArrayUnaccessData(array_); }
  LockedArray(const LockedArray&) = delete;
  LockedArray& operator=(const LockedArray&) = delete;

  [[nodiscard]] std::size_t count() const noexcept { return array_->rgsabound[0].cElements; }
  template <class T>
  [[nodiscard]] std::vector<T> copy() const {
    const auto* const first = static_cast<const T*>(data_);
    return std::vector<T>(first, first + count());
  }
  template <class T>
  [[nodiscard]] const T& at(std::size_t index) const noexcept {
    return static_cast<const T*>(data_)[index];
  }

 private:
  SAFEARRAY* array_;
  void* data_ = nullptr;
};

// Element by element, through a variant of the array's type.
Variant::Variants elementsOf(const LockedArray& array, SAFEARRAY* source, VARTYPE type) {
  Variant::Variants elements;
  elements.reserve(array.count());
  const auto size = SafeArrayGetElemsize(source);
  for (std::size_t i = 0; i < array.count(); ++i) {
    VARIANT element;
    VariantInit(&element);
    V_VT(&element) = static_cast<VARTYPE>(VT_BYREF | type);
    V_BYREF(&element) = const_cast<char*>(&array.at<char>(i * size));
    elements.push_back(fromAutomation(element));
  }
  return elements;
}

bool isReferenceToVariant(const VARIANT& value) noexcept { return V_VT(&value) == (VT_BYREF | VT_VARIANT); }

Variant fromArray(SAFEARRAY* source, VARTYPE type) {
  const LockedArray array(source);
  switch (type) {
    case VT_UI1:
      return array.copy<std::uint8_t>();
    case VT_I2:
      return array.copy<std::int16_t>();
    case VT_I4:
      return array.copy<std::int32_t>();
    case VT_R4:
      return array.copy<float>();
    case VT_R8:
      return array.copy<double>();
    default:
      return elementsOf(array, source, type);
  }
}

Variant fromObject(IUnknown* object) {
  if (object != nullptr) object->AddRef();
  return ObjectReference(object, [](IUnknown* held) {
    if (held != nullptr) held->Release();
  });
}

// Types without a counterpart of the same width become doubles where they are numbers.
Variant fromOtherNumber(const VARIANT& value) {
  OwnedVariant number;
  if (FAILED(VariantChangeType(&number.value, const_cast<VARIANT*>(&value), 0, VT_R8))) raiseTypeMismatch();
  return V_R8(&number.value);
}

template <class Element>
VARIANT arrayOf(VARTYPE type, const std::vector<Element>& values) {
  SAFEARRAY* const array = SafeArrayCreateVector(type, 0, static_cast<ULONG>(values.size()));
  if (array == nullptr) throw std::bad_alloc();
  std::copy(values.begin(), values.end(), static_cast<Element*>(array->pvData));
  VARIANT result;
  VariantInit(&result);
  V_VT(&result) = static_cast<VARTYPE>(VT_ARRAY | type);
  V_ARRAY(&result) = array;
  return result;
}

struct ToAutomation {
  OwnedVariant owned;  // until all of it is made
  VARIANT& result = owned.value;

  void operator()(Variant::Empty) {}
  void operator()(Variant::Null) { V_VT(&result) = VT_NULL; }
  void operator()(bool value) {
    V_VT(&result) = VT_BOOL, V_BOOL(&result) = value ? VARIANT_TRUE : VARIANT_FALSE;
  }
  void operator()(std::uint8_t value) { V_VT(&result) = VT_UI1, V_UI1(&result) = value; }
  void operator()(std::int16_t value) { V_VT(&result) = VT_I2, V_I2(&result) = value; }
  void operator()(std::int32_t value) { V_VT(&result) = VT_I4, V_I4(&result) = value; }
  void operator()(std::int64_t value) { V_VT(&result) = VT_I8, V_I8(&result) = value; }
  void operator()(float value) { V_VT(&result) = VT_R4, V_R4(&result) = value; }
  void operator()(double value) { V_VT(&result) = VT_R8, V_R8(&result) = value; }
  void operator()(DateValue value) { V_VT(&result) = VT_DATE, V_DATE(&result) = value.days; }
  void operator()(ErrorValue value) { V_VT(&result) = VT_ERROR, V_ERROR(&result) = value.code; }
  void operator()(const std::string& value) {
    V_BSTR(&result) = toBstr(value);
    V_VT(&result) = VT_BSTR;
  }
  void operator()(const ObjectReference& value) {
    V_VT(&result) = VT_UNKNOWN;
    V_UNKNOWN(&result) = static_cast<IUnknown*>(value.get());
    if (V_UNKNOWN(&result) != nullptr) V_UNKNOWN(&result)->AddRef();
  }
  void operator()(const Variant::Bytes& values) { result = arrayOf(VT_UI1, values); }
  void operator()(const Variant::Int16s& values) { result = arrayOf(VT_I2, values); }
  void operator()(const Variant::Int32s& values) { result = arrayOf(VT_I4, values); }
  void operator()(const Variant::Singles& values) { result = arrayOf(VT_R4, values); }
  void operator()(const Variant::Doubles& values) { result = arrayOf(VT_R8, values); }
  void operator()(const Variant::Variants& values) {
    result = arrayOf(VT_VARIANT, std::vector<VARIANT>(values.size()));
    auto* element = static_cast<VARIANT*>(V_ARRAY(&result)->pvData);
    for (const Variant& value : values) *element++ = toAutomation(value);
  }
};

}  // namespace

Variant fromAutomation(const VARIANT& value) {
  if (isReferenceToVariant(value)) return fromAutomation(*V_VARIANTREF(&value));
  if (V_VT(&value) == (VT_BYREF | VT_ARRAY | (V_VT(&value) & VT_TYPEMASK)))
    return fromArray(*V_ARRAYREF(&value), static_cast<VARTYPE>(V_VT(&value) & VT_TYPEMASK));
  if ((V_VT(&value) & VT_BYREF) != 0) {
    OwnedVariant followed;
    if (FAILED(VariantCopyInd(&followed.value, const_cast<VARIANT*>(&value)))) raiseTypeMismatch();
    return fromAutomation(followed.value);
  }
  if ((V_VT(&value) & VT_ARRAY) != 0)
    return fromArray(V_ARRAY(&value), static_cast<VARTYPE>(V_VT(&value) & ~VT_ARRAY));
  switch (V_VT(&value)) {
    case VT_EMPTY:
      return {};
    case VT_NULL:
      return Variant::null();
    case VT_ERROR:
      // An argument that was left out arrives as this code.
      return V_ERROR(&value) == DISP_E_PARAMNOTFOUND ? Variant() : Variant(ErrorValue{V_ERROR(&value)});
    case VT_BOOL:
      return V_BOOL(&value) != VARIANT_FALSE;
    case VT_UI1:
      return V_UI1(&value);
    case VT_I2:
      return V_I2(&value);
    case VT_I4:
      return static_cast<std::int32_t>(V_I4(&value));
    case VT_R4:
      return V_R4(&value);
    case VT_R8:
      return V_R8(&value);
    case VT_DATE:
      return DateValue{V_DATE(&value)};
    case VT_BSTR:
      return fromBstr(V_BSTR(&value));
    case VT_DISPATCH:
    case VT_UNKNOWN:
      return fromObject(V_UNKNOWN(&value));
    default:
      return fromOtherNumber(value);
  }
}

bool withSingles(const VARIANT& value, const std::function<void(std::span<const float>)>& body) {
  if (isReferenceToVariant(value)) return withSingles(*V_VARIANTREF(&value), body);
  if ((V_VT(&value) & ~VT_BYREF) != (VT_ARRAY | VT_R4)) return false;
  const LockedArray array((V_VT(&value) & VT_BYREF) != 0 ? *V_ARRAYREF(&value) : V_ARRAY(&value));
  body({&array.at<float>(0), array.count()});
  return true;
}

LONG withBytes(const VARIANT& value, const std::function<LONG(std::span<const std::uint8_t>)>& body) {
  if (isReferenceToVariant(value)) return withBytes(*V_VARIANTREF(&value), body);
  if ((V_VT(&value) & ~VT_BYREF) == (VT_ARRAY | VT_UI1)) {
    const LockedArray array((V_VT(&value) & VT_BYREF) != 0 ? *V_ARRAYREF(&value) : V_ARRAY(&value));
    return body({&array.at<std::uint8_t>(0), array.count()});
  }
  const Variant list = fromAutomation(value);
  std::vector<std::uint8_t> bytes;
  bytes.reserve(list.elementCount());
  for (std::size_t i = 0; i < list.elementCount(); ++i) {
    const std::int16_t number = list.element(i).toInt16();
    if (number < 0 || number > 255) raiseOverflow();
    bytes.push_back(static_cast<std::uint8_t>(number));
  }
  return body(bytes);
}

Variant hostValue(const VARIANT& value) {
  try {
    return fromAutomation(value);
  } catch (const RuntimeError&) {
    return ErrorValue{DISP_E_TYPEMISMATCH};
  }
}

void replaceVariable(VARIANT& variable, const Variant& value) {
  if (isReferenceToVariant(variable)) return replaceVariable(*V_VARIANTREF(&variable), value);
  VARIANT fresh = toAutomation(value);
  const HRESULT cleared = VariantClear(&variable);
  if (FAILED(cleared)) {
    VariantClear(&fresh);
    check(cleared);
  }
  variable = fresh;
}

VARIANT toAutomation(const Variant& value) {
  ToAutomation conversion;
  std::visit(conversion, value.value());
  return std::exchange(conversion.result, VARIANT{});
}

std::string fromBstr(BSTR text) { return toUtf8(std::wstring_view(text, SysStringLen(text))); }

BSTR toBstr(std::string_view utf8) {
  const std::wstring text = toUtf16(utf8);
  BSTR const copy = SysAllocStringLen(text.data(), static_cast<UINT>(text.size()));
  if (copy == nullptr) throw std::bad_alloc();
  return copy;
}

}  // namespace frontpanels::activex

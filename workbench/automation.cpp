#include "workbench/automation.h"

#include <windows.h>

#include <algorithm>
#include <cstring>
#include <vector>

#include "platform/win32/utf16.h"
#include "workbench/failure.h"

namespace frontpanels::workbench {
namespace {

// The texts of an exception belong to the caller.
class ExceptionInfo {
 public:
  ExceptionInfo() = default;
  ExceptionInfo(const ExceptionInfo&) = delete;
  ExceptionInfo& operator=(const ExceptionInfo&) = delete;
  ~ExceptionInfo() {
    SysFreeString(info_.bstrSource);
    SysFreeString(info_.bstrDescription);
    SysFreeString(info_.bstrHelpFile);
  }

  [[nodiscard]] EXCEPINFO* receive() noexcept { return &info_; }
  [[nodiscard]] std::string description() {
    if (info_.pfnDeferredFillIn != nullptr) info_.pfnDeferredFillIn(&info_);
    if (info_.bstrDescription != nullptr) return toUtf8(info_.bstrDescription);
    return describe(info_.scode != 0 ? info_.scode : E_FAIL);
  }

 private:
  EXCEPINFO info_{};
};

// Functions that only read a variant are declared without saying so.
VARIANT* withoutConst(const VARIANT& variant) noexcept { return const_cast<VARIANT*>(&variant); }

BSTR makeBstr(std::wstring_view text) {
  const BSTR copy = SysAllocStringLen(text.data(), static_cast<UINT>(text.size()));
  if (copy == nullptr) throw std::bad_alloc();
  return copy;
}

template <class T>
void fillArray(VARIANT& target, VARTYPE type, std::span<const T> values) {
  SAFEARRAY* const array = SafeArrayCreateVector(type, 0, static_cast<ULONG>(values.size()));
  if (array == nullptr) throw std::bad_alloc();
  target.vt = static_cast<VARTYPE>(VT_ARRAY | type);
  target.parray = array;
  void* data = nullptr;
  check(SafeArrayAccessData(array, &data), "Filling an array");
  if (!values.empty()) std::memcpy(data, values.data(), values.size_bytes());
  SafeArrayUnaccessData(array);
}

struct Filling {
  VARIANT& target;

  void operator()(const Variant::Empty&) const {}
  void operator()(bool value) const {
    target.vt = VT_BOOL, target.boolVal = value ? VARIANT_TRUE : VARIANT_FALSE;
  }
  void operator()(std::uint8_t value) const { target.vt = VT_UI1, target.bVal = value; }
  void operator()(std::int16_t value) const { target.vt = VT_I2, target.iVal = value; }
  void operator()(std::int32_t value) const { target.vt = VT_I4, target.lVal = value; }
  void operator()(float value) const { target.vt = VT_R4, target.fltVal = value; }
  void operator()(double value) const { target.vt = VT_R8, target.dblVal = value; }
  void operator()(const std::string& value) const {
    target.bstrVal = makeBstr(toUtf16(value));
    target.vt = VT_BSTR;
  }
  template <class Other>
  void operator()(const Other&) const {
    throw HostFailure("A value is neither a number nor a text");
  }
};

}  // namespace

Value::Value(bool value) noexcept : Value() {
  variant_.vt = VT_BOOL;
  variant_.boolVal = value ? VARIANT_TRUE : VARIANT_FALSE;
}

Value::Value(std::int16_t value) noexcept : Value() {
  variant_.vt = VT_I2;
  variant_.iVal = value;
}

Value::Value(std::int32_t value) noexcept : Value() {
  variant_.vt = VT_I4;
  variant_.lVal = value;
}

Value::Value(double value) noexcept : Value() {
  variant_.vt = VT_R8;
  variant_.dblVal = value;
}

Value::Value(std::string_view utf8) : Value() {
  variant_.bstrVal = makeBstr(toUtf16(utf8));
  variant_.vt = VT_BSTR;
}

Value::Value(std::span<const float> singles) : Value() { fillArray(variant_, VT_R4, singles); }

Value::Value(std::span<const double> doubles) : Value() { fillArray(variant_, VT_R8, doubles); }

Value Value::of(const Variant& plain) {
  Value value;
  std::visit(Filling{value.variant_}, plain.value());
  return value;
}

Value::Value(ComPointer<IDispatch> object) noexcept : Value() {
  variant_.vt = VT_DISPATCH;
  variant_.pdispVal = object.detach();
}

Variant variantOf(const VARIANT& value) {
  switch (value.vt) {
    case VT_EMPTY:
      return {};
    case VT_BOOL:
      return value.boolVal != VARIANT_FALSE;
    case VT_UI1:
      return value.bVal;
    case VT_I2:
      return static_cast<std::int16_t>(value.iVal);
    case VT_I4:
      return static_cast<std::int32_t>(value.lVal);
    case VT_R4:
      return value.fltVal;
    case VT_R8:
      return value.dblVal;
    case VT_BSTR:
      return toUtf8({value.bstrVal, SysStringLen(value.bstrVal)});
    default:
      throw HostFailure("A value is neither a number nor a text");
  }
}

std::vector<Variant> elementsOf(const VARIANT& array) {
  const bool byReference = (array.vt & VT_BYREF) != 0;
  if (byReference && (array.vt & VT_TYPEMASK) == VT_VARIANT && (array.vt & VT_ARRAY) == 0)
    return elementsOf(*array.pvarVal);
  if ((array.vt & ~VT_BYREF) != (VT_ARRAY | VT_VARIANT)) throw HostFailure("A list is no array of values");
  SAFEARRAY* const elements = byReference ? *array.pparray : array.parray;
  LONG low = 0;
  LONG high = -1;
  if (elements == nullptr || SafeArrayGetDim(elements) != 1 ||
      FAILED(SafeArrayGetLBound(elements, 1, &low)) || FAILED(SafeArrayGetUBound(elements, 1, &high)))
    throw HostFailure("A list is no array of values");
  std::vector<Variant> values;
  for (LONG i = low; i <= high; ++i) {
    Value element;
    check(SafeArrayGetElement(elements, &i, element.receive()), "Reading a list");
    values.push_back(variantOf(element.variant()));
  }
  return values;
}

Value::Value(const Value& other) : Value() {
  check(VariantCopy(&variant_, withoutConst(other.variant_)), "Copying a value");
}

VARIANT* Value::receive() noexcept {
  VariantClear(&variant_);
  return &variant_;
}

std::int32_t Value::toInt32() const {
  Value converted;
  check(VariantChangeType(&converted.variant_, withoutConst(variant_), 0, VT_I4), "Reading a whole number");
  return converted.variant_.lVal;
}

std::string Value::toText() const {
  Value converted;
  check(VariantChangeType(&converted.variant_, withoutConst(variant_), 0, VT_BSTR), "Reading a text");
  return toUtf8({converted.variant_.bstrVal, SysStringLen(converted.variant_.bstrVal)});
}

CLSID registeredClass(const std::string& progId) {
  CLSID id{};
  if (FAILED(CLSIDFromProgID(toUtf16(progId).c_str(), &id))) throw NotRegistered(progId);
  return id;
}

ComPointer<IUnknown> createObject(const std::string& progId) {
  ComPointer<IUnknown> object;
  const HRESULT result = CoCreateInstance(registeredClass(progId), nullptr, CLSCTX_INPROC_SERVER,
                                          __uuidof(IUnknown), reinterpret_cast<void**>(object.receive()));
  // The entry is left behind when the library's file was moved or registered for the other width only.
  if (result == REGDB_E_CLASSNOTREG || result == HRESULT_FROM_WIN32(ERROR_MOD_NOT_FOUND))
    throw NotRegistered(progId);
  check(result, "Creating " + progId);
  return object;
}

Automation Automation::create(const std::string& progId) {
  ComPointer<IDispatch> object = createObject(progId).query<IDispatch>();
  if (!object) throw HostFailure(progId + " cannot be called by name");
  return Automation(std::move(object));
}

void Automation::call(const std::string& member, Arguments arguments) {
  Value result;
  invoke(DISPATCH_METHOD, member, arguments, result);
}

std::int32_t Automation::number(const std::string& member, Arguments arguments) {
  Value result;
  invoke(DISPATCH_METHOD | DISPATCH_PROPERTYGET, member, arguments, result);
  return result.toInt32();
}

std::string Automation::text(const std::string& member, Arguments arguments) {
  Value result;
  invoke(DISPATCH_METHOD | DISPATCH_PROPERTYGET, member, arguments, result);
  return result.toText();
}

bool Automation::flag(const std::string& member, Arguments arguments) {
  return variantOf(value(member, arguments).variant()).toBoolean();
}

Value Automation::value(const std::string& member, Arguments arguments) {
  Value result;
  invoke(DISPATCH_METHOD | DISPATCH_PROPERTYGET, member, arguments, result);
  return result;
}

Automation Automation::object(const std::string& property) {
  const Value result = value(property);
  if (result.variant().vt != VT_DISPATCH || result.variant().pdispVal == nullptr)
    throw HostFailure(property + " is no object");
  return Automation(ComPointer<IDispatch>(result.variant().pdispVal));
}

void Automation::put(const std::string& property, const Value& value) {
  VARIANT argument = value.variant();
  DISPID named = DISPID_PROPERTYPUT;
  DISPPARAMS parameters{&argument, &named, 1, 1};
  ExceptionInfo exception;
  const HRESULT result =
      object_->Invoke(member(property), IID_NULL, LOCALE_USER_DEFAULT, DISPATCH_PROPERTYPUT, &parameters,
                      nullptr, exception.receive(), nullptr);
  if (result == DISP_E_EXCEPTION) throw HostFailure(property + ": " + exception.description());
  check(result, "Setting " + property);
}

void Automation::invoke(WORD flags, const std::string& name, Arguments arguments, Value& result) {
  const DISPID id = member(name);
  // The last argument comes first. The copies borrow what the arguments own.
  std::vector<VARIANT> reversed;
  for (const Value& argument : arguments) reversed.push_back(argument.variant());
  std::reverse(reversed.begin(), reversed.end());
  DISPPARAMS parameters{reversed.data(), nullptr, static_cast<UINT>(reversed.size()), 0};
  ExceptionInfo exception;
  const HRESULT outcome = object_->Invoke(id, IID_NULL, LOCALE_USER_DEFAULT, flags, &parameters,
                                          result.receive(), exception.receive(), nullptr);
  if (outcome == DISP_E_EXCEPTION) throw HostFailure(name + ": " + exception.description());
  check(outcome, "Calling " + name);
}

DISPID Automation::member(const std::string& name) {
  if (const auto known = members_.find(name); known != members_.end()) return known->second;
  std::wstring wideName = toUtf16(name);
  LPOLESTR pointer = wideName.data();
  DISPID id = DISPID_UNKNOWN;
  check(object_->GetIDsOfNames(IID_NULL, &pointer, 1, LOCALE_USER_DEFAULT, &id), "Looking up " + name);
  return members_.emplace(name, id).first->second;
}

}  // namespace frontpanels::workbench

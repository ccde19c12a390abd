// Late binding, as a script or a form does it: members are called by name.
#pragma once

#include <oaidl.h>

#include <cstdint>
#include <functional>
#include <initializer_list>
#include <map>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "platform/variant.h"
#include "platform/win32/com_pointer.h"

namespace frontpanels::workbench {

// An owning VARIANT; made implicitly, so that a call's arguments read as a list of plain values.
class Value {
 public:
  Value() noexcept { VariantInit(&variant_); }
  Value(bool value) noexcept;
  Value(std::int16_t value) noexcept;
  Value(std::int32_t value) noexcept;
  Value(double value) noexcept;
  Value(std::string_view utf8);
  Value(const std::string& utf8) : Value(std::string_view(utf8)) {}
  Value(const char* utf8) : Value(std::string_view(utf8)) {}
  // Arrays counted from 0.
  Value(std::span<const float> singles);
  Value(std::span<const double> doubles);
  Value(ComPointer<IDispatch> object) noexcept;
  Value(const Value& other);
  Value& operator=(const Value&) = delete;
  ~Value() { VariantClear(&variant_); }

  // Of a boolean, a number or a text; raises a failure for anything else.
  [[nodiscard]] static Value of(const Variant& plain);

  [[nodiscard]] const VARIANT& variant() const noexcept { return variant_; }
  // For functions that only read, and are declared without saying so.
  [[nodiscard]] VARIANT* inPlace() noexcept { return &variant_; }
  // Gives up what is held; for functions that hand a value out.
  [[nodiscard]] VARIANT* receive() noexcept;
  // Raise a failure when it cannot be read so.
  [[nodiscard]] std::int32_t toInt32() const;
  [[nodiscard]] std::string toText() const;

 private:
  VARIANT variant_;
};

// A boolean, a number or a text of the system's kind; raises a failure for anything else.
[[nodiscard]] Variant variantOf(const VARIANT& value);
// The elements of an array of variants, by themselves as well as by reference; raises a failure for anything
// else.
[[nodiscard]] std::vector<Variant> elementsOf(const VARIANT& array);

using Arguments = std::initializer_list<Value>;

class Automation {
 public:
  explicit Automation(ComPointer<IDispatch> object) : object_(std::move(object)) {}
  // Raises `NotRegistered` when there is no such class.
  [[nodiscard]] static Automation create(const std::string& progId);

  // Arguments in the order of the declaration. All raise a failure in the object's own words.
  void call(const std::string& member, Arguments arguments);
  [[nodiscard]] std::int32_t number(const std::string& member, Arguments arguments = {});
  [[nodiscard]] std::string text(const std::string& member, Arguments arguments = {});
  [[nodiscard]] bool flag(const std::string& member, Arguments arguments = {});
  [[nodiscard]] Value value(const std::string& member, Arguments arguments = {});
  // The object that a property gives.
  [[nodiscard]] Automation object(const std::string& property);
  [[nodiscard]] const ComPointer<IDispatch>& dispatch() const noexcept { return object_; }
  void put(const std::string& property, const Value& value);

 private:
  void invoke(WORD flags, const std::string& member, Arguments arguments, Value& result);
  [[nodiscard]] DISPID member(const std::string& name);

  ComPointer<IDispatch> object_;
  std::map<std::string, DISPID, std::less<>> members_;
};

// The class of a ProgID; raises `NotRegistered` when there is none.
CLSID registeredClass(const std::string& progId);
// Creates an object of it in this process; `progId` is for the failure's text.
[[nodiscard]] ComPointer<IUnknown> createObject(const std::string& progId);

}  // namespace frontpanels::workbench

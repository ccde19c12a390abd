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
  // An array of singles, counted from 0.
  Value(std::span<const float> singles);
  Value(const Value& other);
  Value& operator=(const Value&) = delete;
  ~Value() { VariantClear(&variant_); }

  [[nodiscard]] const VARIANT& variant() const noexcept { return variant_; }
  // Gives up what is held; for functions that hand a value out.
  [[nodiscard]] VARIANT* receive() noexcept;
  // Raise a failure when it cannot be read so.
  [[nodiscard]] std::int32_t toInt32() const;
  [[nodiscard]] std::string toText() const;

 private:
  VARIANT variant_;
};

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

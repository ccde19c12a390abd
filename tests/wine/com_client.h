// A client of registered classes: calls by name, and a line for each check.
#pragma once

#include <windows.h>

#include <oleauto.h>

#include <cstdint>
#include <functional>
#include <initializer_list>
#include <string>
#include <utility>
#include <vector>

#include "platform/win32/com_pointer.h"

namespace frontpanels::testing {

// Prints "ok NAME: WHAT" or "not ok NAME: WHAT" and counts it.
void expect(bool good, const std::string& what);
// What the checks that follow are about.
void chapter(const std::string& name);
// Prints "N passed, N failed"; 0 when all passed.
[[nodiscard]] int verdict();

class Value {
 public:
  Value() { VariantInit(&variant_); }
  Value(int number) : Value() { V_VT(&variant_) = VT_I4, V_I4(&variant_) = number; }
  Value(double number) : Value() { V_VT(&variant_) = VT_R8, V_R8(&variant_) = number; }
  Value(bool flag) : Value() {
    V_VT(&variant_) = VT_BOOL, V_BOOL(&variant_) = flag ? VARIANT_TRUE : VARIANT_FALSE;
  }
  Value(const wchar_t* text) : Value() {
    V_VT(&variant_) = VT_BSTR, V_BSTR(&variant_) = SysAllocString(text);
  }
  explicit Value(const std::vector<float>& singles);
  Value(const Value& other) : Value() { VariantCopy(&variant_, const_cast<VARIANT*>(&other.variant_)); }
  Value(Value&& other) noexcept : variant_(std::exchange(other.variant_, VARIANT{})) {}
  Value& operator=(Value other) noexcept {
    std::swap(variant_, other.variant_);
    return *this;
  }
  ~Value() { VariantClear(&variant_); }

  [[nodiscard]] VARIANT* get() noexcept { return &variant_; }
  [[nodiscard]] const VARIANT& variant() const noexcept { return variant_; }
  // -12345 for what is no whole number.
  [[nodiscard]] int number() const;
  [[nodiscard]] std::wstring text() const;

 private:
  VARIANT variant_;
};

// What all checks of a program share: the reports, and a window of the foreground to site controls on.
struct Desk {
  IDispatch& diagnostics;
  HWND window;
};
// Runs checks, then demands that nothing was reported nor asked of the user on the way; `after` follows when
// nothing of the library is held any more. Answers as verdict() does.
[[nodiscard]] int runChecks(
    SIZE windowPx, const std::function<void(const Desk&)>& checks,
    const std::function<void()>& after = [] {});

[[nodiscard]] CLSID classOf(const wchar_t* progId);

template <class Interface>
[[nodiscard]] ComPointer<Interface> create(const wchar_t* progId) {
  ComPointer<Interface> object;
  CoCreateInstance(classOf(progId), nullptr, CLSCTX_INPROC_SERVER, __uuidof(Interface),
                   reinterpret_cast<void**>(object.receive()));
  return object;
}

[[nodiscard]] DISPID memberOf(IDispatch& object, const wchar_t* name);
// A method or a property; arguments in the order of the declaration.
Value call(IDispatch& object, const wchar_t* name, std::initializer_list<Value> arguments = {});
// The same with values as they are, nobody's to be copied or freed.
Value callRaw(IDispatch& object, const wchar_t* name, std::vector<VARIANT> arguments);
HRESULT put(IDispatch& object, const wchar_t* name, Value value);

void pumpMessages();

// The panels that checks are made on.
struct PanelKind {
  const wchar_t* name;  // of the class, after "FrontPanels."
  int resultType;       // whose trace operation 10 adds
  const wchar_t* path;  // of that trace
  float floorDb;        // a level at the foot of its graph, as it is at first
  const wchar_t* text;  // a stored property that is a text; null where there is none
};
// The one that checks are made on now.
[[nodiscard]] const PanelKind& panelKind();
[[nodiscard]] std::wstring panelClass();  // its ProgID
void onEachPanel(const std::function<void()>& checks);

// A sweep with one carrier in its middle, and its way to the panels.
[[nodiscard]] std::vector<float> carrier();
void publish(const std::vector<float>& sweep);

inline constexpr COLORREF kTraceColor = RGB(50, 156, 50);
// How many pixels of an area have a colour.
[[nodiscard]] int pixelsOf(HDC dc, const RECT& area, COLORREF color);

}  // namespace frontpanels::testing

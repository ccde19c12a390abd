#include "tests/wine/com_client.h"

#include <ole2.h>

#include <algorithm>
#include <cstdio>
#include <cstring>

namespace frontpanels::testing {
namespace {

int passed = 0;
int failed = 0;
std::string about;

constexpr PanelKind kPanels[] = {
    {L"SpectrumView", 10, L"Brantor Scanner/Spectrum/Spectrum Trace", -100, nullptr},
    {L"Tarvex", 14, L"Brantor Scanner/CDMA All Pilots/AllPilotsTrace", -45, L"DfiCarrier"}};
const PanelKind* kind = &kPanels[0];
std::string prefix;  // of the chapters

}  // namespace

const PanelKind& panelKind() { return *kind; }

std::wstring panelClass() { return std::wstring(L"FrontPanels.") + kind->name; }

void onEachPanel(const std::function<void()>& checks) {
  for (const PanelKind& one : kPanels) {
    kind = &one;
    const std::wstring name = one.name;
    prefix = std::string(name.begin(), name.end()) + ", ";
    checks();
  }
  prefix.clear();
  kind = &kPanels[0];
}

void expect(bool good, const std::string& what) {
  std::printf("%s %s: %s\n", good ? "ok" : "not ok", about.c_str(), what.c_str());
  std::fflush(stdout);
  ++(good ? passed : failed);
}

void chapter(const std::string& name) { about = prefix + name; }

int verdict() {
  std::printf("%d passed, %d failed\n", passed, failed);
  return failed == 0 && passed > 0 ? 0 : 1;
}

int runChecks(SIZE windowPx, const std::function<void(const Desk&)>& checks,
              const std::function<void()>& after) {
  OleInitialize(nullptr);
  if (const auto diagnostics = create<IDispatch>(L"FrontPanels.Diagnostics")) {
    put(*diagnostics.get(), L"ShowMessages", false);
    call(*diagnostics.get(), L"Clear");
    const HWND window = CreateWindowExW(0, L"STATIC", L"container", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 0, 0,
                                        windowPx.cx, windowPx.cy, nullptr, nullptr, nullptr, nullptr);
    SetForegroundWindow(window);
    pumpMessages();
    checks({*diagnostics.get(), window});
    expect(call(*diagnostics.get(), L"Count").number() == 0 && FindWindowW(L"#32770", nullptr) == nullptr,
           "nothing was reported on the way, and no box is open");
    DestroyWindow(window);
  } else {
    expect(false, "the classes can be created");
  }
  after();
  OleUninitialize();
  return verdict();
}

Value::Value(const std::vector<float>& singles) : Value() {
  SAFEARRAY* const array = SafeArrayCreateVector(VT_R4, 0, static_cast<ULONG>(singles.size()));
  void* data = nullptr;
  SafeArrayAccessData(array, &data);
  std::memcpy(data, singles.data(), singles.size() * sizeof(float));
  SafeArrayUnaccessData(array);
  V_VT(&variant_) = VT_ARRAY | VT_R4;
  V_ARRAY(&variant_) = array;
}

int Value::number() const {
  Value converted;
  const HRESULT result = VariantChangeType(&converted.variant_, const_cast<VARIANT*>(&variant_), 0, VT_I4);
  return SUCCEEDED(result) && V_VT(&variant_) != VT_EMPTY ? static_cast<int>(V_I4(&converted.variant_))
                                                          : -12345;
}

std::wstring Value::text() const {
  return V_VT(&variant_) == VT_BSTR ? std::wstring(V_BSTR(&variant_), SysStringLen(V_BSTR(&variant_)))
                                    : L"(no text)";
}

CLSID classOf(const wchar_t* progId) {
  CLSID id{};
  CLSIDFromProgID(progId, &id);
  return id;
}

DISPID memberOf(IDispatch& object, const wchar_t* name) {
  LPOLESTR names[] = {const_cast<LPOLESTR>(name)};
  DISPID member = DISPID_UNKNOWN;
  object.GetIDsOfNames(IID_NULL, names, 1, LOCALE_USER_DEFAULT, &member);
  return member;
}

Value call(IDispatch& object, const wchar_t* name, std::initializer_list<Value> arguments) {
  std::vector<VARIANT> raw;
  for (const Value& argument : arguments) raw.push_back(argument.variant());
  return callRaw(object, name, std::move(raw));
}

Value callRaw(IDispatch& object, const wchar_t* name, std::vector<VARIANT> arguments) {
  std::reverse(arguments.begin(), arguments.end());
  DISPPARAMS parameters{arguments.data(), nullptr, static_cast<UINT>(arguments.size()), 0};
  Value result;
  object.Invoke(memberOf(object, name), IID_NULL, LOCALE_USER_DEFAULT, DISPATCH_METHOD | DISPATCH_PROPERTYGET,
                &parameters, result.get(), nullptr, nullptr);
  return result;
}

HRESULT put(IDispatch& object, const wchar_t* name, Value value) {
  DISPID named = DISPID_PROPERTYPUT;
  DISPPARAMS parameters{value.get(), &named, 1, 1};
  return object.Invoke(memberOf(object, name), IID_NULL, LOCALE_USER_DEFAULT, DISPATCH_PROPERTYPUT,
                       &parameters, nullptr, nullptr, nullptr);
}

std::vector<float> carrier() {
  std::vector<float> sweep(513, kind->floorDb);
  sweep[256] = kind->floorDb + 40;
  return sweep;
}

void publish(const std::vector<float>& sweep) {
  const auto hub = create<IDispatch>(L"FrontPanels.DataHub");
  call(*hub.get(), L"Publish", {kind->path, Value(sweep)});
}

int pixelsOf(HDC dc, const RECT& area, COLORREF color) {
  int pixels = 0;
  for (int y = area.top; y < area.bottom; ++y)
    for (int x = area.left; x < area.right; ++x) pixels += GetPixel(dc, x, y) == color;
  return pixels;
}

void pumpMessages() {
  MSG message;
  while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) DispatchMessageW(&message);
}

}  // namespace frontpanels::testing

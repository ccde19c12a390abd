#include "activex/barrier.h"

#include <oleauto.h>

#include <new>

#include "framework/support/guard.h"
#include "platform/win32/com_pointer.h"
#include "platform/win32/utf16.h"

namespace frontpanels::activex {
namespace {

constexpr int kOutOfMemory = 7;

// Run-time errors travel as the codes that their numbers have in every Automation host.
HRESULT codeOf(const RuntimeError& error) noexcept {
  if (error.number() == kOutOfMemory) return E_OUTOFMEMORY;
  return static_cast<HRESULT>(0x800A0000U | static_cast<unsigned>(error.number()));
}

void describe(const IID& source, const std::string& text) {
  ComPointer<ICreateErrorInfo> info;
  if (FAILED(CreateErrorInfo(info.receive()))) return;
  info->SetGUID(source);
  std::wstring description = toUtf16(text);
  info->SetDescription(description.data());
  wchar_t name[] = L"FrontPanels";
  info->SetSource(name);
  if (const auto error = info.query<IErrorInfo>()) SetErrorInfo(0, error.get());
}

}  // namespace

HRESULT currentFailure(const IID& source) noexcept {
  try {
    try {
      throw;
    } catch (const ComFailure& failure) {
      return failure.code();
    } catch (const RuntimeError& error) {
      describe(source, error.description());
      return codeOf(error);
    } catch (const std::bad_alloc&) {
      return E_OUTOFMEMORY;
    } catch (...) {
      describe(source, describeCurrentException());
      return E_FAIL;
    }
  } catch (...) {  // describing it failed too
    return E_OUTOFMEMORY;
  }
}

}  // namespace frontpanels::activex

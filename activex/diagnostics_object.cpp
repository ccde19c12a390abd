#include "activex/diagnostics_object.h"

#include "activex/variants.h"
#include "framework/support/error_handler.h"

namespace frontpanels::activex {
namespace {

HRESULT answer(bool flag, VARIANT_BOOL* result) {
  if (result == nullptr) return E_POINTER;
  *result = flag ? VARIANT_TRUE : VARIANT_FALSE;
  return S_OK;
}

}  // namespace

HRESULT DiagnosticsObject::get_SilenceAssert(VARIANT_BOOL* silent) {
  return answer(reporting().silenceAssert, silent);
}

HRESULT DiagnosticsObject::put_SilenceAssert(VARIANT_BOOL silent) {
  reporting().silenceAssert = silent != VARIANT_FALSE;
  return S_OK;
}

HRESULT DiagnosticsObject::get_ShowMessages(VARIANT_BOOL* show) {
  return answer(reporting().showMessages, show);
}

HRESULT DiagnosticsObject::put_ShowMessages(VARIANT_BOOL show) {
  reporting().showMessages = show != VARIANT_FALSE;
  return S_OK;
}

HRESULT DiagnosticsObject::get_Count(LONG* count) {
  if (count == nullptr) return E_POINTER;
  *count = static_cast<LONG>(messageLog().count());
  return S_OK;
}

// Counted over all that came: of many, only the last ones are still there.
HRESULT DiagnosticsObject::Message(LONG index, BSTR* text) {
  if (text == nullptr) return E_POINTER;
  *text = nullptr;
  return barrier(IID_IDiagnostics, [&] {
    const auto& kept = messageLog().messages();
    const auto forgotten = static_cast<LONG>(messageLog().count() - kept.size());
    if (index < forgotten || index - forgotten >= static_cast<LONG>(kept.size())) raiseSubscriptOutOfRange();
    *text = toBstr(kept[static_cast<std::size_t>(index - forgotten)]);
  });
}

HRESULT DiagnosticsObject::Clear() {
  messageLog().clear();
  return S_OK;
}

void* DiagnosticsObject::findInterface(REFIID id) noexcept {
  if (id == IID_IDiagnostics || id == IID_IDispatch) return static_cast<IDiagnostics*>(this);
  if (id == IID_ISupportErrorInfo) return static_cast<ISupportErrorInfo*>(this);
  return nullptr;
}

}  // namespace frontpanels::activex

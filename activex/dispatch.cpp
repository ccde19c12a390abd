#include "activex/dispatch.h"

#include <oleauto.h>

#include "activex/module.h"
#include "activex/typed_arguments.h"

namespace frontpanels::activex {
namespace {

constexpr WORD kPropertyPuts = DISPATCH_PROPERTYPUT | DISPATCH_PROPERTYPUTREF;

}  // namespace

ComPointer<ITypeLib> ownTypeLibrary() {
  ComPointer<ITypeLib> library;
  check(LoadTypeLibEx(modulePath().c_str(), REGKIND_NONE, library.receive()));
  return library;
}

ComPointer<ITypeInfo> typeInfoOf(const GUID& id) {
  ComPointer<ITypeInfo> info;
  check(ownTypeLibrary()->GetTypeInfoOfGuid(id, info.receive()));
  return info;
}

HRESULT invokeByTypeInfo(ITypeInfo& info, void* object, DISPID member, WORD flags, DISPPARAMS* parameters,
                         VARIANT* result, EXCEPINFO* exception, UINT* badArgument) {
  if (parameters == nullptr) return E_POINTER;
  // Some hosts put by value and by reference in one call: the members have plain puts only.
  if ((flags & kPropertyPuts) == kPropertyPuts) flags = static_cast<WORD>(flags & ~DISPATCH_PROPERTYPUTREF);
  SetErrorInfo(0, nullptr);  // what an earlier failure left must not stand for this call's
  TypedArguments arguments(info, member, flags, *parameters, badArgument);
  const HRESULT called = info.Invoke(object, member, flags, arguments.get(), result, exception, badArgument);
  if (SUCCEEDED(called)) arguments.copyBack();
  return called;
}

}  // namespace frontpanels::activex

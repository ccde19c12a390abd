// Prints a type library as text, a line a member: describe_library FILE. The compiler that writes the library
// leaves out what it cannot encode, so the finished library is compared with a text that somebody has read.
#include <windows.h>

#include <oleauto.h>

#include <cstdio>
#include <map>
#include <string>

#include "platform/win32/com_pointer.h"

namespace frontpanels::testing {
namespace {

constexpr LONG kSlotBytes64 = 8;
constexpr LONG kSlotBytes32 = 4;

std::wstring take(BSTR text) {
  std::wstring copy(text != nullptr ? text : L"");
  SysFreeString(text);
  return copy;
}

std::wstring nameOf(ITypeInfo& info, MEMBERID member) {
  BSTR name = nullptr;
  info.GetDocumentation(member, &name, nullptr, nullptr, nullptr);
  return take(name);
}

std::wstring textOf(const GUID& id) {
  wchar_t text[40] = {};
  StringFromGUID2(id, text, 40);
  return text;
}

std::wstring typeOf(const TYPEDESC& type) {
  static const std::map<VARTYPE, const wchar_t*> kNames = {
      {VT_I2, L"short"},        {VT_I4, L"long"},         {VT_R4, L"float"},
      {VT_R8, L"double"},       {VT_BSTR, L"BSTR"},       {VT_BOOL, L"boolean"},
      {VT_VARIANT, L"VARIANT"}, {VT_HRESULT, L"HRESULT"}, {VT_VOID, L"void"}};
  if (type.vt == VT_PTR) return typeOf(*type.lptdesc) + L"*";
  const auto known = kNames.find(type.vt);
  return known != kNames.end() ? known->second : L"type " + std::to_wstring(type.vt);
}

std::wstring flagsOf(USHORT flags) {
  std::wstring text;
  if ((flags & PARAMFLAG_FOPT) != 0) text += L"optional ";
  if ((flags & PARAMFLAG_FIN) != 0) text += L"in ";
  if ((flags & PARAMFLAG_FOUT) != 0) text += L"out ";
  if ((flags & PARAMFLAG_FRETVAL) != 0) text += L"retval ";
  return text;
}

void printFunction(ITypeInfo& info, const FUNCDESC& function, LONG slotBytes) {
  static const std::map<INVOKEKIND, const char*> kKinds = {{INVOKE_FUNC, "method"},
                                                           {INVOKE_PROPERTYGET, "get"},
                                                           {INVOKE_PROPERTYPUT, "put"},
                                                           {INVOKE_PROPERTYPUTREF, "putref"}};
  BSTR names[20] = {};
  UINT named = 0;
  info.GetNames(function.memid, names, 20, &named);
  std::printf("  %ld %s %ls(", function.memid, kKinds.at(function.invkind), names[0]);
  for (SHORT i = 0; i < function.cParams; ++i) {
    const ELEMDESC& parameter = function.lprgelemdescParam[i];
    std::printf("%s%ls%ls", i > 0 ? ", " : "", flagsOf(parameter.paramdesc.wParamFlags).c_str(),
                typeOf(parameter.tdesc).c_str());
    if (static_cast<UINT>(i) + 1 < named) std::printf(" %ls", names[i + 1]);
  }
  std::printf(") %ls", typeOf(function.elemdescFunc.tdesc).c_str());
  if (function.funckind != FUNC_DISPATCH) std::printf(", slot %ld", function.oVft / slotBytes);
  if ((function.wFuncFlags & FUNCFLAG_FBINDABLE) != 0) std::printf(", bindable");
  std::printf("\n");
  for (UINT i = 0; i < named; ++i) SysFreeString(names[i]);
}

void printFunctions(ITypeInfo& info, const TYPEATTR& attributes, LONG slotBytes) {
  for (UINT i = 0; i < attributes.cFuncs; ++i) {
    FUNCDESC* function = nullptr;
    if (FAILED(info.GetFuncDesc(i, &function))) return;
    printFunction(info, *function, slotBytes);
    info.ReleaseFuncDesc(function);
  }
}

void printImplemented(ITypeInfo& info, const TYPEATTR& attributes) {
  for (UINT i = 0; i < attributes.cImplTypes; ++i) {
    HREFTYPE reference = 0;
    int flags = 0;
    ComPointer<ITypeInfo> implemented;
    info.GetRefTypeOfImplType(i, &reference);
    info.GetImplTypeFlags(i, &flags);
    if (SUCCEEDED(info.GetRefTypeInfo(reference, implemented.receive())))
      std::printf("  %s%s%ls\n", (flags & IMPLTYPEFLAG_FDEFAULT) != 0 ? "default " : "",
                  (flags & IMPLTYPEFLAG_FSOURCE) != 0 ? "source " : "",
                  nameOf(*implemented.get(), MEMBERID_NIL).c_str());
  }
}

void printType(ITypeInfo& info, LONG slotBytes) {
  static const std::map<TYPEKIND, const char*> kKinds = {
      {TKIND_DISPATCH, "dispatch"}, {TKIND_INTERFACE, "interface"}, {TKIND_COCLASS, "class"}};
  TYPEATTR* attributes = nullptr;
  info.GetTypeAttr(&attributes);
  const WORD flags = attributes->wTypeFlags;
  std::printf("%s %ls %ls%s%s%s\n", kKinds.at(attributes->typekind), nameOf(info, MEMBERID_NIL).c_str(),
              textOf(attributes->guid).c_str(), (flags & TYPEFLAG_FDUAL) != 0 ? " dual" : "",
              (flags & TYPEFLAG_FOLEAUTOMATION) != 0 ? " oleautomation" : "",
              (flags & TYPEFLAG_FCONTROL) != 0 ? " control" : "");
  // Behind a dual interface lies the one with the places of its methods.
  HREFTYPE reference = 0;
  ComPointer<ITypeInfo> behind;
  if (attributes->typekind == TKIND_COCLASS) {
    printImplemented(info, *attributes);
  } else if ((flags & TYPEFLAG_FDUAL) != 0 &&
             SUCCEEDED(info.GetRefTypeOfImplType(static_cast<UINT>(-1), &reference)) &&
             SUCCEEDED(info.GetRefTypeInfo(reference, behind.receive()))) {
    TYPEATTR* inner = nullptr;
    behind->GetTypeAttr(&inner);
    printFunctions(*behind.get(), *inner, slotBytes);
    behind->ReleaseTypeAttr(inner);
  } else {
    printFunctions(info, *attributes, slotBytes);
  }
  info.ReleaseTypeAttr(attributes);
}

int print(const wchar_t* file) {
  ComPointer<ITypeLib> library;
  if (FAILED(LoadTypeLibEx(file, REGKIND_NONE, library.receive()))) return 1;
  TLIBATTR* attributes = nullptr;
  library->GetLibAttr(&attributes);
  BSTR name = nullptr;
  library->GetDocumentation(-1, &name, nullptr, nullptr, nullptr);
  std::printf("library %ls %ls %u.%u%s\n", take(name).c_str(), textOf(attributes->guid).c_str(),
              attributes->wMajorVerNum, attributes->wMinorVerNum,
              (attributes->wLibFlags & LIBFLAG_FCONTROL) != 0 ? " control" : "");
  const LONG slotBytes = sizeof(void*) == 8 ? kSlotBytes64 : kSlotBytes32;
  library->ReleaseTLibAttr(attributes);
  for (UINT i = 0; i < library->GetTypeInfoCount(); ++i) {
    ComPointer<ITypeInfo> info;
    library->GetTypeInfo(i, info.receive());
    printType(*info.get(), slotBytes);
  }
  return 0;
}

}  // namespace
}  // namespace frontpanels::testing

int wmain(int count, wchar_t** arguments) {
  CoInitialize(nullptr);
  return count == 2 ? frontpanels::testing::print(arguments[1]) : 2;
}

#include "activex/result_buffer_object.h"

#include <vector>

#include "activex/variants.h"

namespace frontpanels::activex {
namespace {

// The numbers of an array of any element type. Raises "Type mismatch".
template <class T>
std::vector<T> numbersOf(const VARIANT& values, T (Variant::*convert)() const) {
  const Variant list = fromAutomation(values);
  std::vector<T> numbers;
  numbers.reserve(list.elementCount());
  for (std::size_t i = 0; i < list.elementCount(); ++i) numbers.push_back((list.element(i).*convert)());
  return numbers;
}

}  // namespace

HRESULT ResultBufferObject::HardwareId(LONG id) {
  return barrier(IID_IResultBuffer, [&] { writer_.HardwareId(static_cast<std::int32_t>(id)); });
}

HRESULT ResultBufferObject::BeginMeasurement(LONG id) {
  return barrier(IID_IResultBuffer, [&] { writer_.BeginMeasurement(static_cast<std::int32_t>(id)); });
}

HRESULT ResultBufferObject::BeginSubMeasurement(LONG id) {
  return barrier(IID_IResultBuffer, [&] { writer_.BeginSubMeasurement(static_cast<std::int32_t>(id)); });
}

HRESULT ResultBufferObject::BeginRecord(LONG resultType) {
  return barrier(IID_IResultBuffer, [&] { writer_.BeginRecord(static_cast<std::int32_t>(resultType)); });
}

HRESULT ResultBufferObject::UInt8(unsigned char number) {
  return barrier(IID_IResultBuffer, [&] { writer_.UInt8(number); });
}

HRESULT ResultBufferObject::Int16(short number) {
  return barrier(IID_IResultBuffer, [&] { writer_.Int16(number); });
}

HRESULT ResultBufferObject::Int32(LONG number) {
  return barrier(IID_IResultBuffer, [&] { writer_.Int32(static_cast<std::int32_t>(number)); });
}

HRESULT ResultBufferObject::Float32(float number) {
  return barrier(IID_IResultBuffer, [&] { writer_.Float32(number); });
}

HRESULT ResultBufferObject::Float64(double number) {
  return barrier(IID_IResultBuffer, [&] { writer_.Float64(number); });
}

HRESULT ResultBufferObject::Text(BSTR content) {
  return barrier(IID_IResultBuffer, [&] { writer_.Text(fromBstr(content)); });
}

HRESULT ResultBufferObject::EndRecord() {
  return barrier(IID_IResultBuffer, [&] { writer_.EndRecord(); });
}

HRESULT ResultBufferObject::EndSubMeasurement() {
  return barrier(IID_IResultBuffer, [&] { writer_.EndSubMeasurement(); });
}

HRESULT ResultBufferObject::EndMeasurement() {
  return barrier(IID_IResultBuffer, [&] { writer_.EndMeasurement(); });
}

HRESULT ResultBufferObject::Clear() {
  return barrier(IID_IResultBuffer, [&] { writer_.Clear(); });
}

HRESULT ResultBufferObject::Float32Array(VARIANT values) {
  return barrier(IID_IResultBuffer, [&] { writer_.Float32Array(numbersOf(values, &Variant::toSingle)); });
}

HRESULT ResultBufferObject::Float64Array(VARIANT values) {
  return barrier(IID_IResultBuffer, [&] { writer_.Float64Array(numbersOf(values, &Variant::toDouble)); });
}

HRESULT ResultBufferObject::Bytes(VARIANT* buffer) {
  if (buffer == nullptr) return E_POINTER;
  VariantInit(buffer);
  return barrier(IID_IResultBuffer, [&] { *buffer = toAutomation(writer_.Bytes()); });
}

// For scripts, some of which cannot count the elements of an array of bytes.
HRESULT ResultBufferObject::get_Length(LONG* byteCount) {
  if (byteCount == nullptr) return E_POINTER;
  *byteCount = 0;
  return barrier(IID_IResultBuffer, [&] { *byteCount = static_cast<LONG>(writer_.Bytes().size()); });
}

void* ResultBufferObject::findInterface(REFIID id) noexcept {
  if (id == IID_IResultBuffer || id == IID_IDispatch) return static_cast<IResultBuffer*>(this);
  if (id == IID_ISupportErrorInfo) return static_cast<ISupportErrorInfo*>(this);
  return nullptr;
}

}  // namespace frontpanels::activex

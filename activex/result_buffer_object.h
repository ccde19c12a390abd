// FrontPanels.ResultBuffer: how a host without a composer of its own makes the buffers for `displayData`.
#pragma once

#include "activex/aggregable.h"
#include "activex/dispatch.h"
#include "frontpanels_h.h"
#include "platform/result_writer.h"

namespace frontpanels::activex {

class ResultBufferObject final
    : public Dispatching<Delegating<IResultBuffer, ISupportErrorInfo>, IResultBuffer> {
 public:
  using Dispatching::Dispatching;

  HRESULT STDMETHODCALLTYPE HardwareId(LONG id) override;
  HRESULT STDMETHODCALLTYPE BeginMeasurement(LONG id) override;
  HRESULT STDMETHODCALLTYPE BeginSubMeasurement(LONG id) override;
  HRESULT STDMETHODCALLTYPE BeginRecord(LONG resultType) override;
  HRESULT STDMETHODCALLTYPE UInt8(unsigned char number) override;
  HRESULT STDMETHODCALLTYPE Int16(short number) override;
  HRESULT STDMETHODCALLTYPE Int32(LONG number) override;
  HRESULT STDMETHODCALLTYPE Float32(float number) override;
  HRESULT STDMETHODCALLTYPE Float64(double number) override;
  HRESULT STDMETHODCALLTYPE Float32Array(VARIANT values) override;
  HRESULT STDMETHODCALLTYPE Float64Array(VARIANT values) override;
  HRESULT STDMETHODCALLTYPE Text(BSTR content) override;
  HRESULT STDMETHODCALLTYPE EndRecord() override;
  HRESULT STDMETHODCALLTYPE EndSubMeasurement() override;
  HRESULT STDMETHODCALLTYPE EndMeasurement() override;
  HRESULT STDMETHODCALLTYPE Bytes(VARIANT* buffer) override;
  HRESULT STDMETHODCALLTYPE Clear() override;
  HRESULT STDMETHODCALLTYPE get_Length(LONG* byteCount) override;
  HRESULT STDMETHODCALLTYPE InterfaceSupportsErrorInfo(REFIID id) override {
    return id == IID_IResultBuffer ? S_OK : S_FALSE;
  }

 private:
  [[nodiscard]] void* findInterface(REFIID id) noexcept override;

  ResultWriter writer_;
};

}  // namespace frontpanels::activex

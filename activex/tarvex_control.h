// FrontPanels.Tarvex: the pilot panel as a control.
#pragma once

#include <cstddef>
#include <span>

#include "activex/front_panel_control.h"
#include "frontpanels_h.h"
#include "pilot/tarvex.h"

namespace frontpanels::activex {

class TarvexControl final : public FrontPanelControl<ITarvex, Tarvex> {
 public:
  explicit TarvexControl(IUnknown* outer);

  HRESULT STDMETHODCALLTYPE get_AllPilotsData(VARIANT* levels) override;
  HRESULT STDMETHODCALLTYPE get_ZoomedPilotsData(VARIANT* levels) override;
  HRESULT STDMETHODCALLTYPE get_TopNData(VARIANT* records) override;
  HRESULT STDMETHODCALLTYPE get_UserListData(VARIANT* records) override;
  HRESULT STDMETHODCALLTYPE get_UpdateCount(short* updates) override;

  // "Type mismatch" for an object that holds no names of this library.
  HRESULT STDMETHODCALLTYPE get_CellNameInfo(IDispatch** cells) override;
  HRESULT STDMETHODCALLTYPE put_CellNameInfo(IDispatch* cells) override;
  HRESULT STDMETHODCALLTYPE putref_CellNameInfo(IDispatch* cells) override;

  HRESULT STDMETHODCALLTYPE get_DfiAllPilots(BSTR* paths) override;
  HRESULT STDMETHODCALLTYPE put_DfiAllPilots(BSTR paths) override;
  HRESULT STDMETHODCALLTYPE get_DfiZoomedPilots(BSTR* paths) override;
  HRESULT STDMETHODCALLTYPE put_DfiZoomedPilots(BSTR paths) override;
  HRESULT STDMETHODCALLTYPE get_DfiPilotTopNMultipath(BSTR* paths) override;
  HRESULT STDMETHODCALLTYPE put_DfiPilotTopNMultipath(BSTR paths) override;
  HRESULT STDMETHODCALLTYPE get_DfiPilotListMultipath(BSTR* paths) override;
  HRESULT STDMETHODCALLTYPE put_DfiPilotListMultipath(BSTR paths) override;
  HRESULT STDMETHODCALLTYPE get_DfiCarrier(BSTR* paths) override;
  HRESULT STDMETHODCALLTYPE put_DfiCarrier(BSTR paths) override;

  std::span<const StoredProperty> storedProperties() const override;
  Variant storedValue(std::size_t property) const override;
  void storedValue(std::size_t property, const Variant& value) override;

 private:
  HRESULT giveSingles(VARIANT* array, std::span<const float> (Tarvex::*data)() const);
  HRESULT givePaths(BSTR* paths, PilotServer server);
  HRESULT takePaths(BSTR paths, PilotServer server);

  ComPointer<IDispatch> cells_;  // the object whose names the panel shows
};

}  // namespace frontpanels::activex

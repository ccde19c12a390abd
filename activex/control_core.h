// What every control of the library is: an object that a container can site, activate in place, persist and
// draw. The OLE interfaces are parts with a file each; they share the state that this class keeps.
#pragma once

#include <ocidl.h>
#include <oleidl.h>

#include <memory>
#include <span>
#include <string>
#include <utility>

#include "activex/aggregable.h"
#include "activex/barrier.h"
#include "activex/panel_window.h"
#include "activex/stored_values.h"
#include "platform/variant.h"
#include "platform/win32/com_pointer.h"

namespace frontpanels::activex {

// The facts of a control's class.
struct ControlClass {
  const CLSID* id;
  const IID* defaultInterface;
  const IID* eventInterface;
  const wchar_t* userTypeName;
};

// RECOMPOSEONRESIZE | CANTLINKINSIDE | INSIDEOUT | ACTIVATEWHENVISIBLE | SETCLIENTSITEFIRST, in the registry
// and as answered.
inline constexpr DWORD kMiscStatus = OLEMISC_RECOMPOSEONRESIZE | OLEMISC_CANTLINKINSIDE | OLEMISC_INSIDEOUT |
                                     OLEMISC_ACTIVATEWHENVISIBLE | OLEMISC_SETCLIENTSITEFIRST;

class OleObjectPart;
class InPlacePart;
class ViewPart;
class PersistencePart;
class ConnectionsPart;
class ClassInfoPart;
class DataPart;

class ControlCore : public Aggregable, public WindowOwner {
 public:
  ControlCore(IUnknown* outer, const ControlClass& controlClass);
  ~ControlCore() override;

  [[nodiscard]] const ControlClass& controlClass() const noexcept { return class_; }
  [[nodiscard]] PanelWindow& window() noexcept { return window_; }
  [[nodiscard]] OleObjectPart& oleObject() noexcept { return *oleObject_; }
  [[nodiscard]] InPlacePart& inPlace() noexcept { return *inPlace_; }
  [[nodiscard]] DataPart& dataObject() noexcept { return *dataObject_; }
  [[nodiscard]] ConnectionsPart& connections() noexcept { return *connections_; }
  [[nodiscard]] const ComPointer<IOleClientSite>& site() const noexcept { return site_; }
  // Reads the ambient properties anew; leaving a site ends the activity in it.
  void site(IOleClientSite* site);
  void readAmbients();
  // Sets a property of the place that the container keeps for the control: Caption, Visible and the like.
  // False when the container keeps none, or not this one.
  bool putExtended(const wchar_t* name, const Variant& value) noexcept;

  // Himetric; what the container set is kept as it is.
  [[nodiscard]] SIZEL extent() const noexcept { return extent_; }
  void extent(SIZEL himetric);
  // Takes over a size in pixels when the kept extent means another one; answers whether it did.
  bool adoptSize(Size sizePx);

  [[nodiscard]] bool dirty() const noexcept { return dirty_; }
  void dirty(bool dirty) noexcept {
    dirty_ = dirty;
    if (dirty) ++changes_;
  }
  // How often it became so, or more so: what has changed since a save is not in it.
  [[nodiscard]] unsigned changes() const noexcept { return changes_; }
  // The control's place as the container last gave it, pixels of the container's window.
  [[nodiscard]] const RECT& placePx() const noexcept { return placePx_; }
  void placePx(const RECT& place) noexcept { placePx_ = place; }
  // Asks the container for another place. Without a window only the size changes, as far as the container
  // lets it. A container that refuses keeps the control where it is.
  void requestPlace(const RECT& place);
  // Nobody hears that the picture has changed while one lives: some containers lay the control out anew in
  // the middle of their saving.
  class Saving {
   public:
    explicit Saving(ControlCore& core) noexcept : core_(core) { ++core_.savings_; }
    ~Saving() {
      if (--core_.savings_ == 0 && std::exchange(core_.changedMeanwhile_, false)) core_.viewChanged();
    }
    Saving(const Saving&) = delete;
    Saving& operator=(const Saving&) = delete;

   private:
    ControlCore& core_;
  };
  // A count: containers nest their freezes.
  void freezeEvents(bool freeze) noexcept { freezes_ += freeze ? 1 : freezes_ > 0 ? -1 : 0; }
  // Neither while the container holds events back nor in a designer.
  [[nodiscard]] bool raisesEvents() const noexcept { return freezes_ == 0 && userMode_; }

  // What the control stores through the container. A value is of its property's kind, whatever it says: a
  // text that the control has no use for is its to pass over, as the form would be lost with it.
  [[nodiscard]] virtual std::span<const StoredProperty> storedProperties() const = 0;
  [[nodiscard]] virtual Variant storedValue(std::size_t property) const = 0;
  virtual void storedValue(std::size_t property, const Variant& value) = 0;

  // WindowOwner
  void holdControl() noexcept override { outer()->AddRef(); }
  void releaseControl() noexcept override { outer()->Release(); }
  void pressed() override;
  void focusChanged(bool focused) override;
  void windowDestroyed() noexcept override;
  void accessKeysChanged() override;
  bool inUse() const override { return userMode_; }
  // Tells who looks on, unless the window shows it by itself.
  void viewChanged() override;
  // The same at once.
  void tellOnlookers();

 protected:
  // The interfaces that all controls have.
  [[nodiscard]] void* findPart(REFIID id) noexcept;

 private:
  void lastRelease() noexcept final;
  [[nodiscard]] ComPointer<IDispatch> extender() const;
  [[nodiscard]] bool readAmbient(DISPID property, VARIANT& value) const;

  const ControlClass& class_;
  SIZEL extent_{};
  PanelWindow window_;
  ComPointer<IOleClientSite> site_;
  ComPointer<IFont> font_;  // of the container, as long as the fields show it
  bool userMode_ = true;
  bool dirty_ = false;
  unsigned changes_ = 0;
  int freezes_ = 0;
  int savings_ = 0;
  bool changedMeanwhile_ = false;
  bool ending_ = false;
  RECT placePx_{};

  std::unique_ptr<OleObjectPart> oleObject_;
  std::unique_ptr<InPlacePart> inPlace_;
  std::unique_ptr<ViewPart> view_;
  std::unique_ptr<PersistencePart> persistence_;
  std::unique_ptr<ConnectionsPart> connections_;
  std::unique_ptr<ClassInfoPart> classInfo_;
  std::unique_ptr<DataPart> dataObject_;
};

// An OLE duty of a control: interfaces whose identity and life are the control's.
template <class... Interfaces>
class ControlPart : public Interfaces... {
 public:
  explicit ControlPart(ControlCore& core) noexcept : core_(core) {}
  virtual ~ControlPart() = default;
  ControlPart(const ControlPart&) = delete;
  ControlPart& operator=(const ControlPart&) = delete;

  HRESULT STDMETHODCALLTYPE QueryInterface(REFIID id, void** object) override {
    return core_.outer()->QueryInterface(id, object);
  }
  ULONG STDMETHODCALLTYPE AddRef() override { return core_.outer()->AddRef(); }
  ULONG STDMETHODCALLTYPE Release() override { return core_.outer()->Release(); }

 protected:
  [[nodiscard]] ControlCore& core() const noexcept { return core_; }
  // A call that runs panel's or container's code: nothing thrown leaves it, and the control outlives it.
  template <class Body>
  HRESULT entry(Body body) const {
    const ComPointer<IUnknown> alive(core_.outer());
    return barrier(body);
  }

 private:
  ControlCore& core_;
};

// Pixels and himetric of the screen; symmetric rounding.
[[nodiscard]] SIZEL himetricOf(Size sizePx) noexcept;
[[nodiscard]] Size pixelsOf(SIZEL himetric) noexcept;

}  // namespace frontpanels::activex

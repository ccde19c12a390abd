// One control of a panel as an object for late binding: what it shows, and what a user could do to it.
#pragma once

#include <atomic>

#include "activex/named_members.h"
#include "platform/constituent.h"
#include "platform/win32/com_pointer.h"

namespace frontpanels::activex {

class ConstituentObject final : public NamedObject<const Constituent> {
 public:
  // Keeps the panel that the control belongs to.
  ConstituentObject(IUnknown* panel, Control& control);

  ULONG STDMETHODCALLTYPE AddRef() override { return ++references_; }
  ULONG STDMETHODCALLTYPE Release() override {
    const ULONG left = --references_;
    if (left == 0) delete this;
    return left;
  }

 private:
  ~ConstituentObject() override = default;
  const Constituent& self() override { return constituent_; }

  ComPointer<IUnknown> panel_;
  const Constituent constituent_;
  std::atomic<ULONG> references_ = 1;
};

}  // namespace frontpanels::activex

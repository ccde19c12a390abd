// The access keys of a panel for its container: an accelerator table of those that lead to a field now, by
// which the container knows that a key is the control's although the focus is elsewhere.
#pragma once

#include <ocidl.h>

#include <optional>
#include <string>

namespace frontpanels::activex {

class AccessKeys {
 public:
  AccessKeys() = default;
  ~AccessKeys() { release(); }
  AccessKeys(const AccessKeys&) = delete;
  AccessKeys& operator=(const AccessKeys&) = delete;

  // Writes a table of the keys, in lower case, into the answer; it is valid until the next one. Raises
  // std::bad_alloc.
  void give(const std::u32string& keys, CONTROLINFO& info);
  // Whether the container has asked, and was given others.
  [[nodiscard]] bool outdated(const std::u32string& keys) const { return given_ && *given_ != keys; }

 private:
  void release() noexcept;

  HACCEL table_ = nullptr;
  std::optional<std::u32string> given_;
};

}  // namespace frontpanels::activex

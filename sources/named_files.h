// Opening files so that what goes wrong says which file it was.
#pragma once

#include <memory>
#include <string>

#include "platform/runtime_error.h"
#include "platform/textfile.h"

namespace frontpanels {

inline constexpr int kInvalidFileFormat = 321;

[[noreturn]] inline void refuseFile(const std::string& path, const std::string& reason) {
  throw RuntimeError(kInvalidFileFormat, path + ": " + reason);
}

// What `call` answers; what it raises, with the name of the file before it.
template <class Call>
auto namingFile(const std::string& path, Call&& call) {
  try {
    return call();
  } catch (const RuntimeError& error) {
    throw RuntimeError(error.number(), path + ": " + error.description());
  }
}

}  // namespace frontpanels

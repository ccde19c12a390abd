#include "hosting/taken_file.h"

namespace frontpanels {

bool isTaken(const std::error_code& error) noexcept {
#ifdef _WIN32
  // The library's renaming answers an input/output error for whatever is not plainly denied.
  return error == std::errc::permission_denied || error == std::errc::io_error;
#else
  return error == std::errc::operation_would_block;
#endif
}

}  // namespace frontpanels

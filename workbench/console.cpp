#include "workbench/console.h"

#include <windows.h>

namespace frontpanels::workbench {

void writeError(std::string_view line) noexcept {
  const HANDLE output = GetStdHandle(STD_ERROR_HANDLE);
  if (output == nullptr || output == INVALID_HANDLE_VALUE) return;
  DWORD written = 0;
  WriteFile(output, line.data(), static_cast<DWORD>(line.size()), &written, nullptr);
  WriteFile(output, "\n", 1, &written, nullptr);
}

}  // namespace frontpanels::workbench

#include "platform/file_path.h"

#include <system_error>

#include "platform/runtime_error.h"

namespace frontpanels {

std::filesystem::path pathFromUtf8(std::string_view path) {
  if (path.find('\0') != std::string_view::npos) raisePathFileAccessError();
  try {
    return {std::u8string(path.begin(), path.end())};
  } catch (const std::system_error&) {
    raisePathFileAccessError();
  }
}

std::string utf8FromPath(const std::filesystem::path& path) {
  const std::u8string text = path.u8string();
  return {text.begin(), text.end()};
}

}  // namespace frontpanels

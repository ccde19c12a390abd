// Paths as the project carries them, UTF-8, and as the operating system takes them.
#pragma once

#include <filesystem>
#include <string>
#include <string_view>

namespace frontpanels {

// Raises "Path/File access error" for a text that can name no file: it holds a zero byte or, where the
// system's names are UTF-16, is no UTF-8.
[[nodiscard]] std::filesystem::path pathFromUtf8(std::string_view path);
[[nodiscard]] std::string utf8FromPath(const std::filesystem::path& path);

}  // namespace frontpanels

#include "core/paths.h"

namespace kavu {

std::filesystem::path PathFromUtf8(std::string_view text) {
  // char8_t text is taken as UTF-8 by std::filesystem on every system; plain
  // char text would be taken in the ANSI code page on Windows.
  const std::u8string utf8(text.begin(), text.end());
  return std::filesystem::path(utf8);
}

std::string Utf8FromPath(const std::filesystem::path& path) {
  const std::u8string utf8 = path.u8string();
  return std::string(utf8.begin(), utf8.end());
}

}  // namespace kavu

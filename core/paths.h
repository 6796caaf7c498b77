// Paths are kept as UTF-8 text everywhere in the program; these two turn such
// a text into a file-system path and back. On Linux the bytes pass unchanged;
// on Windows they go through the wide-character API, so a folder with
// Vietnamese letters works whatever the ANSI code page of the machine.
#pragma once

#include <filesystem>
#include <string>
#include <string_view>

namespace kavu {

std::filesystem::path PathFromUtf8(std::string_view text);
std::string Utf8FromPath(const std::filesystem::path& path);

}  // namespace kavu

#include "core/lines.h"

#include <ios>
#include <iterator>
#include <system_error>

#include "core/paths.h"

namespace kavu {

std::vector<std::string> SplitLines(std::string_view content) {
  std::vector<std::string> lines;
  std::size_t start = 0;
  std::size_t i = 0;
  while (i < content.size()) {
    const char c = content[i];
    if (c == '\r' || c == '\n') {
      lines.emplace_back(content.substr(start, i - start));
      ++i;
      if (c == '\r' && i < content.size() && content[i] == '\n') ++i;
      start = i;
    } else {
      ++i;
    }
  }
  if (start < content.size()) lines.emplace_back(content.substr(start));
  return lines;
}

std::optional<std::string> ReadFileBytes(const std::filesystem::path& path) {
  std::error_code ec;
  if (std::filesystem::is_directory(path, ec)) return std::nullopt;
  std::ifstream in(path, std::ios::binary);
  if (!in) return std::nullopt;
  std::string bytes((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
  if (in.bad()) return std::nullopt;
  return bytes;
}

std::optional<std::string> ReadFileBytes(const std::string& utf8Path) {
  return ReadFileBytes(PathFromUtf8(utf8Path));
}

std::optional<std::vector<std::string>> ReadLines(const std::filesystem::path& path) {
  auto bytes = ReadFileBytes(path);
  if (!bytes) return std::nullopt;
  return SplitLines(*bytes);
}

std::optional<std::vector<std::string>> ReadLines(const std::string& utf8Path) {
  return ReadLines(PathFromUtf8(utf8Path));
}

TextOut::TextOut(const std::filesystem::path& path) { open(path); }

TextOut::TextOut(const std::string& utf8Path) { open(PathFromUtf8(utf8Path)); }

bool TextOut::open(const std::string& utf8Path) { return open(PathFromUtf8(utf8Path)); }

bool TextOut::open(const std::filesystem::path& path) {
  if (out_.is_open()) close();
  path_ = path;
  out_.clear();
  out_.open(path, std::ios::binary | std::ios::out | std::ios::trunc);
  failed_ = !out_.is_open();
  return !failed_;
}

bool TextOut::ok() const { return out_.is_open() && !failed_; }

void TextOut::Write(std::string_view text) {
  if (!ok()) return;
  out_.write(text.data(), static_cast<std::streamsize>(text.size()));
  if (!out_) failed_ = true;
}

void TextOut::Line(std::string_view text) {
  Write(text);
  Write("\r\n");
}

bool TextOut::close() {
  if (out_.is_open()) {
    out_.flush();
    if (!out_) failed_ = true;
    out_.close();
    if (out_.fail()) failed_ = true;
  }
  return !failed_;
}

}  // namespace kavu

// Reading and writing text files line by line. A path given as a std::string
// is UTF-8 text (see core/paths.h). CR LF, a lone CR and a lone LF
// each end a line; a last line without a line end counts; there is no empty
// line after the final line end. Lines are always written with CR LF.
#pragma once

#include <filesystem>
#include <fstream>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kavu {

// Splits a file's bytes into its lines.
std::vector<std::string> SplitLines(std::string_view content);

// The whole file as bytes, or nothing when it cannot be opened or read.
std::optional<std::string> ReadFileBytes(const std::filesystem::path& path);
std::optional<std::string> ReadFileBytes(const std::string& utf8Path);

// The file's lines, or nothing when it cannot be read.
std::optional<std::vector<std::string>> ReadLines(const std::filesystem::path& path);
std::optional<std::vector<std::string>> ReadLines(const std::string& utf8Path);

// An output text file; a file that cannot be created swallows its lines and
// reports !ok(), so the run goes on and names it in the summary.
class TextOut {
 public:
  TextOut() = default;
  explicit TextOut(const std::filesystem::path& path);
  explicit TextOut(const std::string& utf8Path);
  bool open(const std::filesystem::path& path);
  bool open(const std::string& utf8Path);
  bool is_open() const { return out_.is_open(); }
  bool ok() const;
  void Line(std::string_view text);   // text + CR LF
  void Write(std::string_view text);  // text as it stands
  bool close();                       // false when a write failed
  const std::filesystem::path& path() const { return path_; }

 private:
  std::ofstream out_;
  std::filesystem::path path_;
  bool failed_ = false;
};

}  // namespace kavu

// Reading and writing text files line by line. A path given as a std::string
// is UTF-8 text (see core/paths.h). CR LF, a lone CR and a lone LF
// each end a line; a last line without a line end counts; there is no empty
// line after the final line end. Lines are always written with CR LF.
#pragma once

#include <cstdio>
#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <system_error>
#include <vector>

namespace kavu {

// The lines of a file's bytes, one at a time, as views into them.
class LineReader {
 public:
  explicit LineReader(std::string_view content) : content_(content) {}
  // The next line; false after the last.
  bool Next(std::string_view& line);

 private:
  std::string_view content_;
  std::size_t next_ = 0;
};

// Splits a file's bytes into its lines.
std::vector<std::string> SplitLines(std::string_view content);

// A file that may be read: a regular file, or a link to one. Folders, FIFOs
// and devices are not (a FIFO would block the run, a device never ends).
bool IsDataFile(const std::filesystem::path& path);
bool IsDataFile(const std::string& utf8Path);

// The whole file as bytes, or nothing when it is no data file or cannot be
// read.
std::optional<std::string> ReadFileBytes(const std::filesystem::path& path);
std::optional<std::string> ReadFileBytes(const std::string& utf8Path);

// The file's lines, or nothing when it cannot be read.
std::optional<std::vector<std::string>> ReadLines(const std::filesystem::path& path);
std::optional<std::vector<std::string>> ReadLines(const std::string& utf8Path);

// True when writing `product` would replace the file `input` that a run reads:
// the same path (./ and .. included) or the same file under another name (a
// hard link, or a symbolic link to it, given as the input). A product that is
// itself a symbolic link is never the same: writing replaces the link only.
bool WouldReplace(const std::filesystem::path& product, const std::filesystem::path& input);
bool WouldReplace(const std::string& utf8Product, const std::string& utf8Input);

// The suffix of the temporary file beside a product while it is written.
inline constexpr std::string_view kTempSuffix = ".kavu-tmp";
std::filesystem::path TempPathOf(const std::filesystem::path& path);

// An output text file, written whole or not at all: the lines go to a
// temporary file beside it (path + ".kavu-tmp"), which commit() flushes to
// the disk and renames over the file; the previous file stays untouched until
// then, and for good when the writing fails or the output is abandoned.
// A file that cannot be created swallows its lines and reports !ok(), so the
// run goes on and names it in the summary. An output neither committed nor
// abandoned is abandoned when it is destroyed.
class TextOut {
 public:
  TextOut() = default;
  explicit TextOut(const std::filesystem::path& path);
  explicit TextOut(const std::string& utf8Path);
  TextOut(TextOut&& other) noexcept;
  TextOut& operator=(TextOut&& other) noexcept;
  ~TextOut();

  bool open(const std::filesystem::path& path);
  bool open(const std::string& utf8Path);
  bool is_open() const { return file_ != nullptr; }
  bool ok() const;
  void Line(std::string_view text);   // text + CR LF
  void Write(std::string_view text);  // text as it stands
  // The text waiting to be written, for a line to be put together in place;
  // EndLine ends it with CR LF.
  std::string& Buffer() { return buffer_; }
  void EndLine();
  // Writes the text waiting once it fills a block.
  void WriteFull() {
    if (buffer_.size() >= kBlock) Drain();
  }
  // Writes what waits, flushes the file to the disk and closes it; false when
  // that failed. The file is put in place by commit.
  bool finish();
  // Puts the file in place (finishing it first); false (and the previous
  // file kept) when a write, the flush to the disk or the rename failed.
  bool commit();
  bool close() { return commit(); }
  // Drops what was written; the previous file stays as it was.
  void abandon();
  const std::filesystem::path& path() const { return path_; }
  // Why the file could not be written (the first failure), or none.
  std::error_code error() const { return error_; }

 private:
  // The first failure kept: later ones follow from it.
  void Fail(std::error_code ec);
  struct Closer {
    void operator()(std::FILE* file) const { std::fclose(file); }
  };
  std::unique_ptr<std::FILE, Closer> file_;
  // Written to the file a block at a time.
  static constexpr std::size_t kBlock = 1 << 20;
  bool Drain();
  std::string buffer_;
  std::filesystem::path path_;
  bool failed_ = false;
  bool finished_ = false;  // closed, not yet put in place
  std::error_code error_;
};

// A product that could not be written, as the summary names it: the path and
// the reason in a few words ("Không ghi được File: " comes before it).
std::string UnwritableEntry(const std::string& path, std::error_code reason);

// An exclusive lock on a file, held by the operating system for this process
// (released when the process ends, however it ends). The lock file is removed
// when the lock is released.
class FileLock {
 public:
  enum class Result { Taken, Busy, Unavailable };
  FileLock() = default;
  FileLock(const FileLock&) = delete;
  FileLock& operator=(const FileLock&) = delete;
  ~FileLock() { Release(); }
  // Busy when another process holds it; Unavailable when the lock file cannot
  // be made (a read-only folder).
  Result Acquire(const std::filesystem::path& path);
  void Release();

 private:
  std::filesystem::path path_;
#ifdef _WIN32
  void* handle_ = nullptr;
#else
  int fd_ = -1;
#endif
};

}  // namespace kavu

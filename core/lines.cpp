#include "core/lines.h"

#include <cerrno>
#include <cstring>
#include <fstream>
#include <ios>
#include <iterator>
#include <system_error>
#include <utility>

#ifdef _WIN32
#ifndef NOMINMAX
#define NOMINMAX
#endif
#ifndef WIN32_LEAN_AND_MEAN
#define WIN32_LEAN_AND_MEAN
#endif
#include <io.h>
#include <windows.h>
// windows.h names a drawing call TextOut; ours is the text file.
#undef TextOut
#else
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>
#endif

#include "core/messages.h"
#include "core/paths.h"

namespace kavu {

bool LineReader::Next(std::string_view& line) {
  if (next_ >= content_.size()) return false;
  const std::size_t start = next_;
  // The line ends at the first CR or LF: the LF found first, then a CR
  // before it.
  const char* const from = content_.data() + start;
  const std::size_t left = content_.size() - start;
  const void* const lf = std::memchr(from, '\n', left);
  const std::size_t toLf =
      lf != nullptr ? static_cast<std::size_t>(static_cast<const char*>(lf) - from) : left;
  const void* const cr = std::memchr(from, '\r', toLf);
  const std::size_t end =
      start +
      (cr != nullptr ? static_cast<std::size_t>(static_cast<const char*>(cr) - from) : toLf);
  if (end == content_.size()) {
    line = content_.substr(start);
    next_ = content_.size();
    return true;
  }
  line = content_.substr(start, end - start);
  next_ = end + 1;
  if (content_[end] == '\r' && next_ < content_.size() && content_[next_] == '\n') ++next_;
  return true;
}

std::vector<std::string> SplitLines(std::string_view content) {
  std::vector<std::string> lines;
  LineReader reader(content);
  for (std::string_view line; reader.Next(line);) lines.emplace_back(line);
  return lines;
}

bool IsDataFile(const std::filesystem::path& path) {
  std::error_code ec;
  return std::filesystem::is_regular_file(path, ec);
}

bool IsDataFile(const std::string& utf8Path) { return IsDataFile(PathFromUtf8(utf8Path)); }

std::optional<std::string> ReadFileBytes(const std::filesystem::path& path) {
  if (!IsDataFile(path)) return std::nullopt;
  std::ifstream in(path, std::ios::binary);
  if (!in) return std::nullopt;
  // Read in blocks into a text as large as the file, so that a large field
  // book is held once, not in a copy twice its size.
  std::error_code ec;
  const std::uintmax_t size = std::filesystem::file_size(path, ec);
  std::string bytes;
  if (!ec) bytes.reserve(static_cast<std::size_t>(size));
  char block[1 << 16];
  while (in.read(block, sizeof block) || in.gcount() > 0) {
    bytes.append(block, static_cast<std::size_t>(in.gcount()));
  }
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

namespace {

// The path with its folder resolved (./, .., links of folders) and its last
// name kept as written.
std::filesystem::path Resolved(const std::filesystem::path& path) {
  std::error_code ec;
  const std::filesystem::path absolute = std::filesystem::absolute(path, ec);
  const std::filesystem::path folder =
      std::filesystem::weakly_canonical(absolute.parent_path(), ec);
  return ec ? absolute.lexically_normal() : folder / absolute.filename();
}

}  // namespace

bool WouldReplace(const std::filesystem::path& product, const std::filesystem::path& input) {
  if (Resolved(product) == Resolved(input)) return true;
  std::error_code ec;
  if (std::filesystem::is_symlink(std::filesystem::symlink_status(product, ec))) return false;
  return std::filesystem::equivalent(product, input, ec) && !ec;
}

bool WouldReplace(const std::string& utf8Product, const std::string& utf8Input) {
  return WouldReplace(PathFromUtf8(utf8Product), PathFromUtf8(utf8Input));
}

std::filesystem::path TempPathOf(const std::filesystem::path& path) {
  std::filesystem::path temp = path;
  temp += kTempSuffix;
  return temp;
}

namespace {

std::error_code LastError() { return {errno, std::generic_category()}; }

}  // namespace

std::string UnwritableEntry(const std::string& path, std::error_code reason) {
  const std::error_condition condition = reason.default_error_condition();
  std::string_view why = msg::kWriteFailed;
  if (condition == std::errc::permission_denied || condition == std::errc::operation_not_permitted)
    why = msg::kNoWritePermission;
  else if (condition == std::errc::read_only_file_system)
    why = msg::kReadOnlyDisk;
  else if (condition == std::errc::no_space_on_device || condition == std::errc::file_too_large)
    why = msg::kDiskFull;
  else if (condition == std::errc::no_such_file_or_directory || condition == std::errc::not_a_directory)
    why = msg::kNoSuchFolder;
  else if (condition == std::errc::is_a_directory)
    why = msg::kIsAFolder;
  return path + " (" + std::string(why) + ")";
}

TextOut::TextOut(const std::filesystem::path& path) { open(path); }

TextOut::TextOut(const std::string& utf8Path) { open(PathFromUtf8(utf8Path)); }

bool TextOut::open(const std::string& utf8Path) { return open(PathFromUtf8(utf8Path)); }

TextOut::TextOut(TextOut&& other) noexcept
    : file_(std::move(other.file_)),
      buffer_(std::move(other.buffer_)),
      path_(std::move(other.path_)),
      failed_(other.failed_),
      finished_(std::exchange(other.finished_, false)),
      error_(other.error_) {}

TextOut& TextOut::operator=(TextOut&& other) noexcept {
  if (this != &other) {
    abandon();
    file_ = std::move(other.file_);
    buffer_ = std::move(other.buffer_);
    path_ = std::move(other.path_);
    failed_ = other.failed_;
    finished_ = std::exchange(other.finished_, false);
    error_ = other.error_;
  }
  return *this;
}

TextOut::~TextOut() { abandon(); }

bool TextOut::open(const std::filesystem::path& path) {
  abandon();
  path_ = path;
  const std::filesystem::path temp = TempPathOf(path);
  // A temporary file left behind (or a link planted in its place) is
  // replaced, never written through.
  std::error_code ec;
  std::filesystem::remove(temp, ec);
#ifdef _WIN32
  file_.reset(_wfopen(temp.c_str(), L"wb"));
#else
  file_.reset(std::fopen(temp.c_str(), "wb"));
#endif
  failed_ = false;
  error_.clear();
  if (file_ == nullptr) Fail(LastError());
  // Room for a block and the line that fills it, so that it never grows.
  buffer_.reserve(kBlock + (1 << 16));
  return !failed_;
}

bool TextOut::ok() const { return file_ != nullptr && !failed_; }

void TextOut::Fail(std::error_code ec) {
  if (!failed_ || !error_) error_ = ec ? ec : std::make_error_code(std::errc::io_error);
  failed_ = true;
}

bool TextOut::Drain() {
  if (!buffer_.empty() && ok() &&
      std::fwrite(buffer_.data(), 1, buffer_.size(), file_.get()) != buffer_.size()) {
    Fail(LastError());
  }
  buffer_.clear();
  return ok();
}

void TextOut::Write(std::string_view text) {
  if (!ok() || text.empty()) return;
  if (text.size() >= kBlock) {
    // A large text goes straight to the file, after what is waiting.
    if (Drain() && std::fwrite(text.data(), 1, text.size(), file_.get()) != text.size()) {
      Fail(LastError());
    }
    return;
  }
  buffer_.append(text);
  if (buffer_.size() >= kBlock) Drain();
}

void TextOut::Line(std::string_view text) {
  buffer_.append(text);
  EndLine();
}

void TextOut::EndLine() {
  buffer_.append("\r\n");
  if (buffer_.size() >= kBlock) Drain();
}

namespace {

// Flushes the file's buffers and the system's to the disk.
bool FlushToDisk(std::FILE* file) {
  if (std::fflush(file) != 0) return false;
#ifdef _WIN32
  return _commit(_fileno(file)) == 0;
#else
  return fsync(fileno(file)) == 0;
#endif
}

}  // namespace

bool TextOut::finish() {
  if (!file_) return !failed_;
  bool written = Drain();
  if (written && !FlushToDisk(file_.get())) {
    Fail(LastError());
    written = false;
  }
  std::string().swap(buffer_);  // the block's memory goes back at once
  if (std::fclose(file_.release()) != 0) {
    Fail(LastError());
    written = false;
  }
  finished_ = true;
  return written;
}

bool TextOut::commit() {
  if (!file_ && !finished_) return !failed_;
  bool written = finish();
  finished_ = false;
  const std::filesystem::path temp = TempPathOf(path_);
  std::error_code ec;
  if (written) {
    // Renaming replaces a link of that name itself, not the file it names.
    std::filesystem::rename(temp, path_, ec);
    written = !ec;
    if (ec) Fail(ec);
  }
  if (!written) {
    failed_ = true;
    std::filesystem::remove(temp, ec);
  }
  return written;
}

void TextOut::abandon() {
  std::string().swap(buffer_);
  if (!file_ && !finished_) return;
  finished_ = false;
  if (file_) std::fclose(file_.release());
  std::error_code ec;
  std::filesystem::remove(TempPathOf(path_), ec);
}

#ifdef _WIN32

FileLock::Result FileLock::Acquire(const std::filesystem::path& path) {
  Release();
  // The system deletes the lock file when its last handle closes, also when
  // the process dies.
  HANDLE handle =
      CreateFileW(path.c_str(), GENERIC_READ | GENERIC_WRITE,
                  FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE, nullptr, OPEN_ALWAYS,
                  FILE_ATTRIBUTE_NORMAL | FILE_FLAG_DELETE_ON_CLOSE, nullptr);
  if (handle == INVALID_HANDLE_VALUE) {
    return GetLastError() == ERROR_SHARING_VIOLATION ? Result::Busy : Result::Unavailable;
  }
  OVERLAPPED whole{};
  if (!LockFileEx(handle, LOCKFILE_EXCLUSIVE_LOCK | LOCKFILE_FAIL_IMMEDIATELY, 0, 1, 0, &whole)) {
    const DWORD error = GetLastError();
    CloseHandle(handle);
    return error == ERROR_LOCK_VIOLATION ? Result::Busy : Result::Unavailable;
  }
  handle_ = handle;
  path_ = path;
  return Result::Taken;
}

void FileLock::Release() {
  if (handle_ == nullptr) return;
  CloseHandle(static_cast<HANDLE>(handle_));
  handle_ = nullptr;
}

#else

FileLock::Result FileLock::Acquire(const std::filesystem::path& path) {
  Release();
  // A holder removes the lock file when it ends; a lock taken on a file that
  // was removed meanwhile is taken again on the new one.
  for (int attempt = 0; attempt < 8; ++attempt) {
    const int fd = ::open(path.c_str(), O_RDWR | O_CREAT | O_NOFOLLOW | O_CLOEXEC, 0666);
    if (fd < 0) return Result::Unavailable;
    if (flock(fd, LOCK_EX | LOCK_NB) != 0) {
      const int error = errno;
      ::close(fd);
      return error == EWOULDBLOCK ? Result::Busy : Result::Unavailable;
    }
    struct stat held {};
    struct stat named {};
    if (fstat(fd, &held) == 0 && stat(path.c_str(), &named) == 0 && held.st_dev == named.st_dev &&
        held.st_ino == named.st_ino) {
      fd_ = fd;
      path_ = path;
      return Result::Taken;
    }
    ::close(fd);
  }
  return Result::Busy;
}

void FileLock::Release() {
  if (fd_ < 0) return;
  ::unlink(path_.c_str());
  ::close(fd_);
  fd_ = -1;
}

#endif

}  // namespace kavu

#include "import/dispatch.h"

#include <array>
#include <filesystem>
#include <system_error>

#include "core/messages.h"
#include "core/paths.h"
#include "core/text.h"
#include "import/converters.h"
#include "import/formats.h"

namespace kavu {
namespace fs = std::filesystem;

namespace {


std::string WithSeparator(const fs::path& folder) {
  std::string text = Utf8FromPath(folder);
  if (text.empty() || text.back() != fs::path::preferred_separator) {
    text += static_cast<char>(fs::path::preferred_separator);
  }
  return text;
}

void RefuseFile(RunState& st, Host& host, std::string_view message) {
  host.MessageBox(message, MsgIcon::Critical, MsgButtons::Ok);
  st.txtfile.clear();
  host.SetFileBox("");
  host.FocusFileBox();
}

std::string NotFoundMessage(const std::string& path) {
  return std::string(msg::kFileNotFound) + path + "\r" + std::string(msg::kEnterNewFile);
}

// A file to read: it must exist and be a data file (a FIFO would block the
// run, a device never ends). Refused otherwise, with txtfile emptied.
bool ReadableFile(RunState& st, Host& host, const std::string& path) {
  std::error_code ec;
  if (!fs::exists(PathFromUtf8(path), ec)) {
    RefuseFile(st, host, NotFoundMessage(path));
    return false;
  }
  if (!IsDataFile(path)) {
    RefuseFile(st, host, std::string(msg::kNotDataFile) + path);
    return false;
  }
  return true;
}

// The temporary files that a killed run of this job left beside its products.
void RemoveLeftovers(const RunState& st) {
  std::vector<std::string> products{st.filesl1};
  for (const char* extension :
       {".asc", ".err", ".cpv", ".sdo", ".cp", ".kc", ".td1", ".txt", ".dxf"}) {
    products.push_back(st.daufile + extension);
  }
  for (const std::string& product : products) {
    const std::string temp = product + std::string(kTempSuffix);
    bool read = false;
    for (const std::string& input : st.inputs) read = read || WouldReplace(temp, input);
    std::error_code ec;
    if (!read) fs::remove(PathFromUtf8(temp), ec);
  }
}

}  // namespace

void DeriveFileSelection(FileSelection& sel, std::string_view path) {
  sel.filesl = std::string(path);
  const fs::path file = PathFromUtf8(sel.filesl);
  const std::string name = Utf8FromPath(file.filename());
  const std::string folderText = sel.filesl.substr(0, sel.filesl.size() - name.size());
  sel.tentm = folderText;
  // Only the dots of the file name count: a dot in a folder name must not
  // rename the products.
  const std::size_t firstDot = name.find('.');
  if (firstDot == std::string::npos) {
    sel.daufile = sel.filesl;
    sel.duoifile.clear();
  } else {
    sel.daufile = folderText + name.substr(0, firstDot);
    const std::size_t secondDot = name.find('.', firstDot + 1);
    sel.duoifile =
        name.substr(firstDot + 1,
                    secondDot == std::string::npos ? std::string::npos : secondDot - firstDot - 1);
  }
  // The regenerated field book goes to TRIDO beside the file's folder.
  std::error_code ec;
  fs::path folder = fs::absolute(file, ec).make_preferred().parent_path();
  fs::path parent = folder.parent_path();
  if (parent.empty() || parent == folder) parent = folder;
  sel.tentmbd = WithSeparator(parent / "TRIDO");
  sel.filesl1 = sel.tentmbd + name.substr(0, firstDot) + ".asc";
}

std::optional<std::string> CheckAndConvert(RunState& st, Host& host, FileLock* jobLock) {
  // The chosen file.
  if (st.txtfile.empty()) {
    st.filesl.clear();
    RefuseFile(st, host, msg::kNoFileChosen);
    return std::nullopt;
  }
  if (!ReadableFile(st, host, st.txtfile)) return std::nullopt;
  DeriveFileSelection(st, st.txtfile);
  const int kind = FormatAt(st.kindOverride) != nullptr ? st.kindOverride
                       : KindOfExtension(Upper(st.duoifile));
  st.cbkieu = kind;
  host.ShowFolder(st.tentm, PatternOfKind(kind));
  host.SelectKind(kind);
  // The sketch's writer cuts each header text to its field.
  if (Ticked(st.fsdo)) st.nhap = st.nhapsdo;
  std::error_code ec;
  if (fs::file_size(PathFromUtf8(st.filesl), ec) == 0 && !ec) {
    RefuseFile(st, host,
               std::string(msg::kFileSizeZero) + "\r" + std::string(msg::kCheckFileAgain));
    return std::nullopt;
  }

  // The field book to compute: the chosen file itself, a converted one, or
  // the one of the same base name for kinds without a converter. A converted
  // one never replaces a file that the run reads.
  const std::string fieldBook = kind == 0 ? st.filesl : st.daufile + ".asc";
  const auto convert = FormatAt(kind)->convert;
  st.inputs = {st.filesl};
  if (Ticked(st.ckKC) && !Trim(st.txtFKC).empty()) st.inputs.push_back(Trim(st.txtFKC));
  if (convert) {
    for (const std::string& input : st.inputs) {
      if (WouldReplace(fieldBook, input)) {
        host.MessageBox(std::string(msg::kConversionOverInput) + fieldBook, MsgIcon::Critical,
                        MsgButtons::Ok);
        return std::nullopt;
      }
    }
  } else if (fieldBook != st.filesl) {
    if (!ReadableFile(st, host, fieldBook)) return std::nullopt;
    st.inputs.push_back(fieldBook);
  }

  // One run of a job at a time; what a killed run left is removed.
  if (jobLock != nullptr) {
    switch (jobLock->Acquire(PathFromUtf8(st.daufile + ".lock"))) {
      case FileLock::Result::Busy:
        host.MessageBox(std::string(msg::kBeingComputed) + st.filesl, MsgIcon::Critical,
                        MsgButtons::Ok);
        return std::nullopt;
      case FileLock::Result::Taken:
        RemoveLeftovers(st);
        break;
      case FileLock::Result::Unavailable:  // a read-only folder: no lock, nothing to remove
        break;
    }
  }

  std::optional<std::string> content;
  if (convert) {
    const auto raw = ReadFileBytes(st.filesl);
    if (!raw) {
      host.MessageBox(std::string(msg::kCannotOpen) + st.filesl, MsgIcon::Critical, MsgButtons::Ok);
      return std::nullopt;
    }
    Conversion conversion = convert(*raw, kind);
    content = std::move(conversion.book);
    st.conversionReport = std::move(conversion.report);
    TextOut out(fieldBook);
    out.Write(*content);
    if (out.commit()) {
      st.written.push_back(fieldBook);
    } else {
      // The run computes the conversion all the same; the window stays on
      // the instrument file, since no field book stands beside it.
      st.unwritable.push_back(UnwritableEntry(fieldBook, out.error()));
      return content;
    }
  } else {
    content = ReadFileBytes(fieldBook);
  }
  if (!content) {
    host.MessageBox(std::string(msg::kCannotOpen) + fieldBook, MsgIcon::Critical, MsgButtons::Ok);
    return std::nullopt;
  }

  // The run and the window switch to the field book.
  st.filesl = fieldBook;
  st.txtfile = fieldBook;
  host.SetFileBox(fieldBook);
  st.cbkieu = 0;
  host.ShowFolder(st.tentm, PatternOfKind(0));
  host.SelectKind(0);
  return content;
}

}  // namespace kavu

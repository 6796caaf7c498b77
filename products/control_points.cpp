#include "products/control_points.h"

#include <filesystem>
#include <system_error>

#include "core/messages.h"
#include "core/paths.h"
#include "core/station.h"
#include "core/tcvn3.h"
#include "core/text.h"
#include "products/pegs.h"

namespace kavu {
namespace {

// One line as both passes read it: surrounding spaces removed, blank lines
// skipped, the rest normalised and split. False for a blank line.
bool ReadRecord(std::string_view raw, std::string& line, std::vector<std::string>& fields) {
  line = Trim(raw);
  if (line.empty()) return false;
  fields = SplitFields(line);
  return true;
}

bool IsControlRecord(const std::vector<std::string>& fields) {
  return fields.size() >= 4 && fields[0] == "TR";
}

void AddControlPoint(RunState& st, const std::vector<std::string>& fields) {
  ReportLongName(st, fields[1]);
  const bool withHeight = Ticked(st.fdc) && fields.size() >= 5;
  st.MangKhongChe.push_back({fields[1], fields[2], fields[3], withHeight ? fields[4] : ""});
}

}  // namespace

bool DocFileKhongChe(RunState& st, Host& host, const std::vector<std::string>& fieldBook) {
  const bool commonFile = Ticked(st.ckKC);
  std::string line;
  std::vector<std::string> fields;
  st.MangKhongChe.clear();
  st.tamsl.clear();
  if (commonFile) {
    const std::string path = Trim(st.txtFKC);
    if (path.empty()) {
      host.MessageBox(msg::kNoControlFile, MsgIcon::None, MsgButtons::Ok);
      return false;
    }
    // Only a data file is read: a FIFO would block the run, a device never ends.
    std::error_code ec;
    if (std::filesystem::exists(PathFromUtf8(path), ec) && !IsDataFile(path)) {
      host.MessageBox(std::string(msg::kNotDataFile) + path, MsgIcon::Critical, MsgButtons::Ok);
      return false;
    }
    const auto lines = ReadLines(path);
    if (!lines) {
      host.MessageBox(std::string(msg::kCannotOpen) + path, MsgIcon::Critical, MsgButtons::Ok);
      return false;
    }
    host.SetTitle(msg::kReadingControlFile);
    for (const std::string& raw : *lines) {
      if (ReadRecord(raw, line, fields) && IsControlRecord(fields)) AddControlPoint(st, fields);
    }
    host.SetTitle(msg::kReadingData);
  }
  host.SetTitle(msg::kFindingControlPoints);
  for (const std::string& raw : fieldBook) {
    if (!ReadRecord(raw, line, fields)) continue;
    if (IsControlRecord(fields)) {
      // With a common file the field book's own control points are ignored.
      if (!commonFile) AddControlPoint(st, fields);
    } else {
      st.tamsl.push_back(line);
    }
  }
  WritePegFileHead(st);
  return true;
}

}  // namespace kavu

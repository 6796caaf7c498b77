#include "core/control_points.h"

#include <filesystem>
#include <system_error>

#include "core/messages.h"
#include "core/paths.h"
#include "core/station.h"
#include "core/tcvn3.h"
#include "core/text.h"

namespace kavu {
namespace {

// One line as both passes read it: surrounding spaces removed, blank lines
// skipped, the rest normalised and split. False for a blank line.
bool ReadRecord(std::string_view raw, std::string& line, std::vector<std::string>& fields) {
  line.assign(TrimView(raw));
  if (line.empty()) return false;
  SplitFields(line, fields);
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

// A record the station loop starts a station at.
bool IsStationRecord(std::string_view line) {
  return line.starts_with("TR") && line.find(' ') != std::string_view::npos;
}

}  // namespace

bool DocFileKhongChe(RunState& st, Host& host, std::string_view fieldBook) {
  const bool commonFile = Ticked(st.ckKC);
  std::string line;
  std::vector<std::string> fields;
  st.MangKhongChe.clear();
  st.tamsl.clear();
  st.tamslLine.clear();
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
    const auto bytes = ReadFileBytes(path);
    if (!bytes) {
      host.MessageBox(std::string(msg::kCannotOpen) + path, MsgIcon::Critical, MsgButtons::Ok);
      return false;
    }
    host.SetTitle(msg::kReadingControlFile);
    st.line = 0;
    LineReader reader(*bytes);
    for (std::string_view raw; reader.Next(raw);) {
      if (ReadRecord(raw, line, fields) && IsControlRecord(fields)) AddControlPoint(st, fields);
    }
    host.SetTitle(msg::kReadingData);
  }
  host.SetTitle(msg::kFindingControlPoints);
  // First the control points, and whether a station record stands on any line
  // of the working copy but its last: a book without one is not kept.
  bool stationSeen = false;
  bool reachable = false;
  std::size_t number = 0;
  LineReader reader(fieldBook);
  for (std::string_view raw; reader.Next(raw);) {
    ++number;
    if (!ReadRecord(raw, line, fields)) continue;
    st.line = number;
    if (IsControlRecord(fields)) {
      // With a common file the field book's own control points are ignored.
      if (!commonFile) AddControlPoint(st, fields);
    } else {
      reachable = reachable || stationSeen;
      stationSeen = stationSeen || IsStationRecord(line);
    }
  }
  st.line = 0;
  if (!reachable) return true;
  number = 0;
  reader = LineReader(fieldBook);
  for (std::string_view raw; reader.Next(raw);) {
    ++number;
    if (!ReadRecord(raw, line, fields) || IsControlRecord(fields)) continue;
    st.tamsl.push_back(line);
    st.tamslLine.push_back(number);
  }
  return true;
}

}  // namespace kavu

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
bool ReadRecord(std::string_view raw, std::string& line, std::vector<std::string_view>& fields) {
  line.assign(TrimView(raw));
  if (line.empty()) return false;
  SplitFields(line, fields);
  return true;
}

bool IsControlRecord(const std::vector<std::string_view>& fields) {
  return fields.size() >= 4 && fields[0] == "TR";
}

void AddControlPoint(RunState& st, const std::vector<std::string_view>& fields) {
  ReportLongName(st, fields[1]);
  const bool withHeight = Ticked(st.fdc) && fields.size() >= 5;
  st.MangKhongChe.push_back({std::string(fields[1]), std::string(fields[2]), std::string(fields[3]),
                             withHeight ? std::string(fields[4]) : std::string()});
}

}  // namespace

bool WorkingLine(std::string_view raw, std::string& line, std::vector<std::string_view>& fields) {
  return ReadRecord(raw, line, fields) && !IsControlRecord(fields);
}

namespace {

// A record the station loop starts a station at.
bool IsStationRecord(std::string_view line) {
  return line.starts_with("TR") && line.find(' ') != std::string_view::npos;
}

}  // namespace

bool DocFileKhongChe(RunState& st, Host& host, std::string_view fieldBook) {
  const bool commonFile = Ticked(st.ckKC);
  std::string line;
  std::vector<std::string_view> fields;
  st.MangKhongChe.clear();
  st.workingLines = 0;
  st.stationRecords = 0;
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
  std::size_t working = 0;
  LineReader reader(fieldBook);
  for (std::string_view raw; reader.Next(raw);) {
    ++number;
    // Only a record that begins with TR can be a control or station record.
    const std::string_view trimmed = TrimView(raw);
    if (!trimmed.empty() && !trimmed.starts_with("TR")) {
      ++working;
      reachable = reachable || stationSeen;
      continue;
    }
    if (!ReadRecord(raw, line, fields)) continue;
    st.line = number;
    if (IsControlRecord(fields)) {
      // With a common file the field book's own control points are ignored.
      if (!commonFile) AddControlPoint(st, fields);
    } else {
      ++working;
      reachable = reachable || stationSeen;
      const bool station = IsStationRecord(line);
      st.stationRecords += station ? 1 : 0;
      stationSeen = stationSeen || station;
    }
  }
  st.line = 0;
  if (reachable) st.workingLines = working;
  return true;
}

}  // namespace kavu

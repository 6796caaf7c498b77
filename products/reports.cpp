#include "products/reports.h"

#include <algorithm>
#include <filesystem>
#include <string>

#include "core/messages.h"
#include "core/numbers.h"
#include "core/paths.h"
#include "core/station.h"
#include "core/text.h"

namespace kavu {

void WriteErrorReport(TextOut& out, const std::vector<ReportEntry>& report) {
  out.Line(msg::kErrHeader1);
  out.Line(msg::kErrHeader2);
  for (const ReportEntry& entry : report) {
    if (entry.counted) out.Line("");
    out.Line(entry.text);
  }
}

void WriteStationListingHeader(TextOut& out) {
  for (std::string_view line : msg::kCpvHeader) out.Line(line);
}

std::string CoordinateTextLine(const ComputedPoint& p, int decimals) {
  const std::string height =
      NumberColumn(NumberText(RoundEven(Val(HeightText(p.z)), decimals)), 10);
  return FixedWidth(p.name, 5) + " " + NumberWidth(NorthingText(p.x), 11) + " " +
         NumberWidth(EastingText(p.y), 10) + " " + height + " " + p.code + " " + p.note;
}

bool ProductOverInput(RunState& st, const std::string& path) {
  for (const std::string& input : st.inputs) {
    if (WouldReplace(path, input)) {
      st.unwritable.push_back(path + std::string(msg::kProductIsInput));
      return true;
    }
  }
  return false;
}

namespace {

// Writes one product whole or not at all; a product that cannot be written, or
// would replace a file the run reads, is named for the summary and the run
// goes on with the next.
template <typename Body>
void WriteProduct(RunState& st, const std::string& path, Body body) {
  if (ProductOverInput(st, path)) return;
  TextOut out(path);
  body(out);
  if (!out.commit()) st.unwritable.push_back(path);
}

int HeightDecimals(const std::string& text) {
  const double d = RoundEvenWhole(Val(text));
  return static_cast<int>(std::clamp(d, 0.0, 10.0));
}

}  // namespace

void WriteTextProducts(RunState& st) {
  if (Ticked(st.fkc)) {
    WriteProduct(st, st.daufile + ".kc", [&](TextOut& out) { out.Line(st.ChuoiKC); });
  }
  if (Ticked(st.fasc)) {
    std::error_code ignored;
    std::filesystem::create_directories(PathFromUtf8(st.tentmbd), ignored);
    WriteProduct(st, st.filesl1, [&](TextOut& out) {
      out.Line(st.ChuoiKC);
      for (const std::string& line : st.MangSoLieuASC) out.Line(line);
    });
    WriteProduct(st, st.daufile + ".td1", [&](TextOut& out) {
      out.Line(st.ChuoiKC);
      for (const std::string& line : st.MangSoLieuToaDo) {
        if (!Trim(line).empty()) out.Line(line);
      }
    });
  }
  if (Ticked(st.ftd)) {
    const int decimals = HeightDecimals(st.txtSoleDC);
    WriteProduct(st, st.daufile + ".txt", [&](TextOut& out) {
      for (const ComputedPoint& point : st.survey.points) {
        if (point.kind == PointKind::Detail) out.Line(CoordinateTextLine(point, decimals));
      }
    });
  }
}

}  // namespace kavu

#include "core/reports.h"

#include <algorithm>
#include <filesystem>
#include <string>

#include "core/messages.h"
#include "core/numbers.h"
#include "core/paths.h"
#include "core/text.h"

namespace kavu {

void WriteErrorReportHeader(TextOut& out) {
  out.Line(msg::kErrHeader1);
  out.Line(msg::kErrHeader2);
}

void WriteStationListingHeader(TextOut& out) {
  for (std::string_view line : msg::kCpvHeader) out.Line(line);
}

std::string CoordinateTextLine(const RunState& st, int k, int decimals) {
  const DetailPoint& p = st.MangToaDoChiTiet[static_cast<std::size_t>(k)];
  const std::string height = NumberColumn(NumberText(RoundEven(Val(p[3]), decimals)), 10);
  return FixedWidth(p[0].substr(0, 5), 5) + " " + NumberWidth(p[1], 11) + " " +
         NumberWidth(p[2], 10) + " " + height + " " + p[4] + " " + p[5];
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
      for (int k = 0; k < st.sdtd(); ++k) out.Line(CoordinateTextLine(st, k, decimals));
    });
  }
}

}  // namespace kavu

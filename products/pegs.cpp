#include "products/pegs.h"

#include <string>

#include "core/messages.h"
#include "core/text.h"

namespace kavu {

namespace {

// A packed angle of more than 7 characters cannot be a DDDMMSS reading.
constexpr std::size_t kLongestReading = 7;
// The observation columns of a peg line are 8 characters wide; a value never
// runs into the one before it, so the line can still be read back as a field
// book.
constexpr int kColumn = 8;

}  // namespace

void WritePegFileHead(RunState& st) {
  if (!Ticked(st.fcp)) return;
  for (const KnownPoint& point : st.MangKhongChe) {
    st.TenKC = point[0];
    st.StX = point[1];
    st.StY = point[2];
    st.StZ = point[3];
    std::string line = "TR " + st.TenKC.str() + " " + st.StX.str() + " " + st.StY.str();
    if (Ticked(st.fdc)) line += " " + st.StZ.str();
    st.cpFile.Line(line);
  }
}

void incocphu(RunState& st) {
  if (!Ticked(st.fcp) || st.MangCocPhu.empty()) return;

  TextOut& out = st.cpFile;
  out.Line("TR " + st.TenTram.str());
  out.Line("DKD1 " + st.TenDinhHuong.str());
  if (!st.DongDinhHuong2.empty()) out.Line(st.DongDinhHuong2);

  for (const PegEntry& peg : st.MangCocPhu) {
    st.TenDiem = peg[1];
    const std::string reading = Trim(peg[2]);
    if (reading.size() > kLongestReading) {
      // An impossible reading ends the station's block; the lines already
      // written stay.
      ReportError(st, "Diem " + st.TenDiem.str() + std::string(msg::kWrongDegrees),
                  st.TenDiem.str());
      return;
    }
    out.Line(Trim(peg[0]) + " " + st.TenDiem.str() + RString(reading, kColumn) +
             NumberColumn(peg[3], kColumn) + NumberColumn(peg[4], kColumn) + " " + Trim(peg[5]) +
             " " + Trim(peg[6]));
  }
}

}  // namespace kavu

#include "products/sketch.h"

#include <string>
#include <string_view>

#include "core/numbers.h"
#include "core/station.h"
#include "core/tcvn3.h"
#include "core/text.h"
#include "products/reports.h"

namespace kavu {

namespace {

// The printed form's own words (UTF-8 here, TCVN3 in the file).
constexpr std::string_view kSketchNumber = "Lược đồ số:";
constexpr std::string_view kSketchTitle = "               SO DO CHI TIET";
constexpr std::string_view kStation = "Điểm trạm đo: ";
constexpr std::string_view kArea = "    Khu đo: ";
constexpr std::string_view kInstrument = "1. Máy đo: ";
constexpr std::string_view kInstrumentNumber = "Số máy: ";
constexpr std::string_view kSurveyor = "2. Người đo: ";
constexpr std::string_view kRecorder = "Người ghi: ";
constexpr std::string_view kDate = "Ngày đo:";
constexpr std::string_view kStationCoordinates = "3. Tọa độ điểm trạm đo:       X= ";
constexpr std::string_view kOrientation1 = "4. Định hướng 1: ";
constexpr std::string_view kOrientation2 = "5. Định hướng 2: ";
constexpr std::string_view kColumnHeads1 =
    "| Điểm |  Khoảng  |   Góc bằng   |   Góc đứng  |  Chiều cao  |    Ghi chú   |";
constexpr std::string_view kColumnHeads2 =
    "| mia  |  cách (m)|   o  ,  ,,   |   o  ,  ,,  |    gương    |              |";

// Every ruled line of the form is 77 characters wide.
constexpr std::size_t kFormWidth = 77;

std::string T(std::string_view utf8) { return Utf8ToTcvn3(utf8); }

// One detail row: point, distance, horizontal angle, vertical angle, prism
// height, note between the bars of columns 1, 8, 19, 34, 48, 62 and 77. A name
// of six characters or more pushes the rest of its row to the right.
std::string DetailRow(const SketchRow& row) {
  return "|" + LString(Trim(row[0]), 5) + " |" + RString(Trim(row[2]), 9) + " |  " + row[1] +
         "  |  " + NumberWidth(row[3], 11) + "| " + NumberWidth(row[4], 10) + "  | " +
         FixedWidth(row[5], 12) + " |";
}

}  // namespace

void insodo(RunState& st) {
  if (!Ticked(st.fsdo)) return;

  // The reading on the orientation point is shown as 0 00 and a few seconds
  // drawn at random, as the printed form has always shown it.
  st.goc = st.rng.Next() * 0.025;
  GocString(st);
  const std::string reading = "    0 00 " + Mask(st.giay, "00") + " ";

  const auto& nhap = st.nhap;
  TextOut& out = st.sdoFile;
  out.Line("");
  out.Line(T(kSketchNumber) + FixedWidth(nhap[1], 6) + std::string(kSketchTitle));
  out.Line("");
  out.Line(T(kStation) + st.TenTram.str() + T(kArea) + FixedWidth(nhap[0], 39));
  out.Line(T(kInstrument) + FixedWidth(nhap[2], 19) + T(kInstrumentNumber) +
           FixedWidth(nhap[3], 20));
  out.Line(T(kSurveyor) + FixedWidth(nhap[4], 17) + T(kRecorder) + FixedWidth(nhap[5], 18) +
           T(kDate) + FixedWidth(nhap[6], 10));
  out.Line(T(kStationCoordinates) + NumberWidth(st.StXTram, 11) +
           "    Y= " + NumberWidth(st.StYTram, 10) + "    Z= " + NumberWidth(st.StZTram, 10));
  out.Line(T(kOrientation1) + st.TenDinhHuong.str() + " X= " + NumberWidth(st.StXDinhHuong, 11) +
           "    Y= " + NumberWidth(st.StYDinhHuong, 10) +
           "    Z= " + NumberWidth(st.StZDinhHuong, 10));
  out.Line(T(kOrientation2) + st.TenDinhHuong2.str() + " X= " + NumberWidth(st.StXDinhHuong2, 11) +
           "    Y= " + NumberWidth(st.StYDinhHuong2, 10));
  out.Line(std::string(kFormWidth, '='));
  out.Line(T(kColumnHeads1));
  out.Line(T(kColumnHeads2));
  out.Line(std::string(kFormWidth, '-'));

  for (const SketchRow& row : st.MangSoLieuSoDo) out.Line(DetailRow(row));

  // The closing row: orientation distance, reading and the orientation point.
  out.Line("|      | " + OrientationDistanceText(st.cdhdau) + " | " + reading + " | " +
           "            |  " + "           | " + st.TenDinhHuong.str() + " |");
  out.Line(std::string(kFormWidth, '='));
}

}  // namespace kavu

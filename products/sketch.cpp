#include "products/sketch.h"

#include <algorithm>
#include <cmath>
#include <span>
#include <string>
#include <string_view>

#include "core/angles.h"
#include "core/numbers.h"
#include "core/results.h"
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
void AppendDetailRow(std::string& out, const Survey& survey, const ComputedPoint& point) {
  const std::string_view record = survey.Record(point);
  const double reading = PackedDegrees(Val(RecordField(record, 1)));
  const double distance = RoundEven(std::fabs(Val(RecordField(record, 2))), 3);
  const double zenith = PackedDegrees(Val(RecordField(record, 3)));
  const auto fields = std::count(record.begin(), record.end(), ' ') + 1;
  out.push_back('|');
  std::size_t from = out.size();
  out.append(survey.Name(point));
  PadBehind(out, from, 5);
  out.append(" |");
  from = out.size();
  AppendMask(out, distance, kDistanceMask);
  PadInFront(out, from, 9);
  out.append(" |  ");
  AppendAngle(out, reading, " ", 10);
  out.append("  |  ");
  from = out.size();
  AppendAngle(out, zenith, " ", 9);
  PadBehind(out, from, 11);
  out.append("| ");
  from = out.size();
  AppendMask(out, survey.Prism(point), kPrismMask);
  PadInFront(out, from, 10);
  out.append("  | ");
  // The note: the words of a record with them, or of a reading of 0.
  from = out.size();
  if (fields == 5) {
    out.append(12, ' ');
  } else if (reading == 0 || point.words) {
    out.append(RecordField(record, 5));
    if (fields == 7) out.append(" ").append(RecordField(record, 6));
  }
  out.resize(std::min(out.size(), from + 12));
  PadBehind(out, from, 12);
  out.append(" |");
}

void WriteStation(TextOut& out, const Survey& survey, const StationResult& station,
                  std::span<const ComputedPoint> points, const std::array<std::string, 7>& nhap) {
  const SketchTexts& t = station.sketch;
  const std::string orientation = FixedWidth(station.orientation.name, 12);
  out.Line("");
  out.Line(T(kSketchNumber) + FixedWidth(nhap[1], 6) + std::string(kSketchTitle));
  out.Line("");
  out.Line(T(kStation) + FixedWidth(station.station.name, 12) + T(kArea) + FixedWidth(nhap[0], 39));
  out.Line(T(kInstrument) + FixedWidth(nhap[2], 19) + T(kInstrumentNumber) +
           FixedWidth(nhap[3], 20));
  out.Line(T(kSurveyor) + FixedWidth(nhap[4], 17) + T(kRecorder) + FixedWidth(nhap[5], 18) +
           T(kDate) + FixedWidth(nhap[6], 10));
  out.Line(T(kStationCoordinates) + NumberWidth(t.stationX, 11) +
           "    Y= " + NumberWidth(t.stationY, 10) + "    Z= " + NumberWidth(t.stationZ, 10));
  out.Line(T(kOrientation1) + orientation + " X= " + NumberWidth(t.orientationX, 11) + "    Y= " +
           NumberWidth(t.orientationY, 10) + "    Z= " + NumberWidth(t.orientationZ, 10));
  out.Line(T(kOrientation2) + FixedWidth(t.checkName, 12) + " X= " + NumberWidth(t.checkX, 11) +
           "    Y= " + NumberWidth(t.checkY, 10));
  out.Line(std::string(kFormWidth, '='));
  out.Line(T(kColumnHeads1));
  out.Line(T(kColumnHeads2));
  out.Line(std::string(kFormWidth, '-'));

  for (const ComputedPoint& point : points) {
    if (point.kind != PointKind::Detail) continue;
    AppendDetailRow(out.Buffer(), survey, point);
    out.EndLine();
  }

  // The closing row: orientation distance, reading and the orientation point.
  const std::string reading =
      "    0 00 " + Mask(DecomposeAngle(t.orientationReading).giay, "00") + " ";
  out.Line("|      | " + OrientationDistanceText(station.orientationDistance) + " | " + reading +
           " | " + "            |  " + "           | " + orientation + " |");
  out.Line(std::string(kFormWidth, '='));
}

}  // namespace

void WriteSketch(TextOut& out, const Survey& survey, const std::array<std::string, 7>& header) {
  std::size_t first = 0;
  for (std::size_t i = 0; i < survey.stations.size(); ++i) {
    std::size_t end = first;
    while (end < survey.points.size() && survey.points[end].station == i) ++end;
    WriteStation(out, survey, survey.stations[i],
                 std::span<const ComputedPoint>(survey.points).subspan(first, end - first), header);
    first = end;
  }
}

}  // namespace kavu

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

// The form's words in TCVN3, converted once.
struct FormWords {
  std::string sketchNumber = Utf8ToTcvn3(kSketchNumber), station = Utf8ToTcvn3(kStation),
              area = Utf8ToTcvn3(kArea), instrument = Utf8ToTcvn3(kInstrument),
              instrumentNumber = Utf8ToTcvn3(kInstrumentNumber), surveyor = Utf8ToTcvn3(kSurveyor),
              recorder = Utf8ToTcvn3(kRecorder), date = Utf8ToTcvn3(kDate),
              stationCoordinates = Utf8ToTcvn3(kStationCoordinates),
              orientation1 = Utf8ToTcvn3(kOrientation1), orientation2 = Utf8ToTcvn3(kOrientation2),
              columnHeads1 = Utf8ToTcvn3(kColumnHeads1), columnHeads2 = Utf8ToTcvn3(kColumnHeads2);
};

// One detail row: point, distance, horizontal angle, vertical angle, prism
// height, note between the bars of columns 1, 8, 19, 34, 48, 62 and 77. A name
// of six characters or more pushes the rest of its row to the right.
void AppendDetailRow(std::string& out, const Survey& survey, const ComputedPoint& point) {
  std::array<std::string_view, 7> f;
  const std::size_t fields = RecordFields(survey.Record(point), f);
  const double reading = PackedDegrees(Val(f[1]));
  const double distance = RoundEven(std::fabs(Val(f[2])), 3);
  const double zenith = PackedDegrees(Val(f[3]));
  out.push_back('|');
  std::size_t from = out.size();
  out.append(f[0].substr(0, kNameWidth));
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
  AppendMask(out, Val(f[4]), kPrismMask);
  PadInFront(out, from, 10);
  out.append("  | ");
  // The note: the words of a record with them, or of a reading of 0.
  from = out.size();
  if (fields == 5) {
    out.append(kNameWidth, ' ');
  } else if (reading == 0 || point.words) {
    out.append(f[5]);
    if (fields == 7) out.append(" ").append(f[6]);
  }
  out.resize(std::min(out.size(), from + kNameWidth));
  PadBehind(out, from, kNameWidth);
  out.append(" |");
}

void WriteStation(TextOut& out, const FormWords& w, const Survey& survey,
                  const StationResult& station, std::span<const ComputedPoint> points,
                  const std::array<std::string, 7>& nhap) {
  const SketchTexts& t = station.sketch;
  const std::string orientation = FixedWidth(station.orientation.name, kNameWidth);
  out.Line("");
  // Header text i cut to its width and set in its column.
  const auto field = [&nhap](std::size_t i) {
    return FixedWidth(std::string_view(nhap[i]).substr(0, kSketchHeaderWidths[i]),
                      kSketchHeaderColumns[i]);
  };
  out.Line(w.sketchNumber + field(1) + std::string(kSketchTitle));
  out.Line("");
  out.Line(w.station + FixedWidth(station.station.name, kNameWidth) + w.area + field(0));
  out.Line(w.instrument + field(2) + w.instrumentNumber + field(3));
  out.Line(w.surveyor + field(4) + w.recorder + field(5) + w.date + field(6));
  out.Line(w.stationCoordinates + NumberWidth(t.stationX, 11) +
           "    Y= " + NumberWidth(t.stationY, 10) + "    Z= " + NumberWidth(t.stationZ, 10));
  out.Line(w.orientation1 + orientation + " X= " + NumberWidth(t.orientationX, 11) + "    Y= " +
           NumberWidth(t.orientationY, 10) + "    Z= " + NumberWidth(t.orientationZ, 10));
  out.Line(w.orientation2 + FixedWidth(t.checkName, kNameWidth) + " X= " + NumberWidth(t.checkX, 11) +
           "    Y= " + NumberWidth(t.checkY, 10));
  out.Line(std::string(kFormWidth, '='));
  out.Line(w.columnHeads1);
  out.Line(w.columnHeads2);
  out.Line(std::string(kFormWidth, '-'));

  for (const ComputedPoint& point : points) {
    if (point.kind() != PointKind::Detail) continue;
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
  const FormWords words;
  std::size_t first = 0;
  for (std::size_t i = 0; i < survey.stations.size(); ++i) {
    std::size_t end = first;
    while (end < survey.points.size() && survey.points[end].station == i) ++end;
    WriteStation(out, words, survey, survey.stations[i],
                 std::span<const ComputedPoint>(survey.points).subspan(first, end - first), header);
    first = end;
  }
}

}  // namespace kavu

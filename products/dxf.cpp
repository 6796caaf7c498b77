#include "products/dxf.h"

#include <cmath>
#include <string>
#include <string_view>

#include "core/numbers.h"
#include "core/station.h"
#include "core/text.h"

namespace kavu {

namespace {

// A planar position as drawn: x the northing, y the easting, both to the mm.
struct Position {
  double x = 0, y = 0;
};

Position RoundedPosition(const std::string& textX, const std::string& textY) {
  return {RoundEven(Val(textX), 3), RoundEven(Val(textY), 3)};
}

// A computed point drawn where the coordinate text file puts it.
Position RoundedPosition(const ComputedPoint& point) {
  return {RoundEven(MillimetreValue(point.x), 3), RoundEven(MillimetreValue(point.y), 3)};
}

// The ASCII drawing file is written as pairs of lines: a group code, then its
// value. Group 10 is the drawing's x, which carries the easting Y; group 20
// carries the northing X. No entity carries a handle (group 5): readers give
// each entity its own, whereas one handle repeated on every control point
// makes a reader keep only the last of them.
class EntityWriter {
 public:
  explicit EntityWriter(TextOut& out) : out_(out), text_(out.Buffer()) {}

  void Pair(std::string_view code, std::string_view value) {
    text_.append(code).append("\r\n").append(value).append("\r\n");
    out_.WriteFull();
  }
  void Pair(std::string_view code, double value) {
    text_.append(code).append("\r\n");
    AppendReportNumber(text_, value);
    text_.append("\r\n");
    out_.WriteFull();
  }

  void Point(std::string_view layer, const Position& p, bool controlPoint) {
    Pair("  0", "POINT");
    Pair("  8", layer);
    if (controlPoint) Pair(" 62", "     1");
    Pair(" 10", p.y);
    Pair(" 20", p.x);
  }

  // The label sits half a label height north and east of its point.
  void Label(const Position& p, double offset, std::string_view height, std::string_view name,
             bool controlPoint) {
    const double lx = RoundEven(p.x + offset, 3);
    const double ly = RoundEven(p.y + offset, 3);
    Pair("  0", "TEXT");
    if (controlPoint) {
      Pair("  8", "KC-ID");
      Pair(" 62", "     1");
    } else {
      Pair("  8", "DIEM_ID");
      Pair(" 62", "    3");
    }
    Pair(" 10", ly);
    Pair(" 20", lx);
    Pair(" 30", "0.0");
    Pair(" 40", height);
    Pair("  1", name);
    Pair(" 41", "0.8");
  }

 private:
  TextOut& out_;
  std::string& text_;
};

}  // namespace

void WriteDrawing(TextOut& out, const Survey& survey, double labelHeight) {
  double h = labelHeight;
  if (!std::isfinite(h) || !std::isfinite(1.5 * h)) h = 0;
  const std::string controlHeight = ReportNumber(1.5 * h);
  const std::string detailHeight = ReportNumber(h);

  EntityWriter dxf(out);
  dxf.Pair(" 0", "SECTION");
  dxf.Pair("  2", "ENTITIES");

  for (const KnownPoint& point : survey.known) {
    dxf.Point("KC", RoundedPosition(point[1], point[2]), true);
  }
  for (const KnownPoint& point : survey.known) {
    const Position p = RoundedPosition(point[1], point[2]);
    dxf.Label(p, h / 2, controlHeight, TrimView(point[0]), true);
  }
  for (const ComputedPoint& point : survey.points) {
    if (point.kind() != PointKind::Detail) continue;
    const Position p = RoundedPosition(point);
    dxf.Label(p, h / 2, detailHeight, survey.Name(point), false);
    dxf.Point("DIEM", p, false);
  }

  out.Line(" 0");
  out.Line("ENDSEC");
  out.Line(" 0");
  out.Line("EOF");
}

}  // namespace kavu

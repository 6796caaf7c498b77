#include "products/dxf.h"

#include <gtest/gtest.h>

#include "tests/products/product_files.h"

namespace kavu {
namespace {

using testing::Expected;
using testing::FileBytes;
using testing::FreshFolder;

void AddPoint(Survey& survey, const std::string& name, double x, double y,
              PointKind kind = PointKind::Detail) {
  survey.AddPoint(kind == PointKind::Peg ? "1 0 1 900000 1 " + name : name + " 0 1 900000 1", kind,
                  x, y);
}

// The drawing of a state at a scale and a label height, as its bytes.
std::string Drawing(RunState& st, const std::string& tyle, const std::string& htext) {
  st.Tyle = tyle;
  st.Htext = htext;
  const auto path = FreshFolder() / "JOB1.dxf";
  TextOut out(path);
  WriteDrawing(out, st);
  EXPECT_TRUE(out.commit());
  return FileBytes(path);
}

// Scale 1000, 2 mm: detail labels 2 m high, control labels 3 m, both 1 m north
// and east of their point; drawing x is the easting. The control table holds a
// TCVN3 name, a point looked up twice (drawn twice), a 12-character name,
// small numbers written without their leading zero and coordinates that are
// not numbers (drawn at 0); the details an empty name and exponent forms; a
// peg is drawn among the control points, never as a detail point. Without
// points, the section and the end only. A height or scale that is not a
// number, or out of range, makes labels of height 0 on their point.
TEST(Dxf, ControlAndDetailPointsWithTheirLabels) {
  RunState st;
  EXPECT_EQ(Drawing(st, "1000", "2.0"), Expected("dxf/no_points.dxf"));
  st.MangKhongChe = {{"P1", "2345678.123", "567890.456", "12.5"},
                     {"\xa7\xd3i1", "2345600", "567800.5", ""},
                     {"P1", "2345678.123", "567890.456", "12.5"},
                     {"ABCDEFGHIJKL", "0.5", "-0.25", ""},
                     {"BAD", "abc", "", ""}};
  AddPoint(st.survey, "15", 2345678.123, 567890.456);
  AddPoint(st.survey, "", 2345700.001, 567900.999);
  AddPoint(st.survey, "C\xacng", -12.5, 7);
  AddPoint(st.survey, "ABCDEFGHIJKL", 1E3, 2E2);
  AddPoint(st.survey, "CP", 1, 2, PointKind::Peg);
  EXPECT_EQ(Drawing(st, "1000", "2.0"), Expected("dxf/control_and_detail.dxf"));

  RunState one;
  AddPoint(one.survey, "7", 100.25, 200.75);
  for (const auto& [tyle, htext] :
       {std::pair{"500", "mm"}, std::pair{"", "2.0"}, std::pair{"1D300", "1D300"}}) {
    EXPECT_EQ(Drawing(one, tyle, htext), Expected("dxf/height_not_a_number.dxf")) << tyle;
  }
}

}  // namespace
}  // namespace kavu

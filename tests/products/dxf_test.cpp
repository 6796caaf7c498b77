#include "products/dxf.h"

#include <gtest/gtest.h>

#include <limits>

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

// The drawing of a survey at a label height, as its bytes.
std::string Drawing(const Survey& survey, double labelHeight) {
  const auto path = FreshFolder() / "JOB1.dxf";
  TextOut out(path);
  WriteDrawing(out, survey, labelHeight);
  EXPECT_TRUE(out.commit());
  return FileBytes(path);
}

// Scale 1000, 2 mm: detail labels 2 m high, control labels 3 m, both 1 m north
// and east of their point; drawing x is the easting. The control table holds a
// TCVN3 name, a point looked up twice (drawn twice), a 12-character name,
// small numbers written without their leading zero and coordinates that are
// not numbers (drawn at 0); the details an empty name and exponent forms; a
// peg is drawn among the control points, never as a detail point. Without
// points, the section and the end only. A label height out of range makes
// labels of height 0 on their point.
TEST(Dxf, ControlAndDetailPointsWithTheirLabels) {
  Survey survey;
  EXPECT_EQ(Drawing(survey, 2), Expected("dxf/no_points.dxf"));
  survey.known = {{"P1", "2345678.123", "567890.456", "12.5"},
                  {"\xa7\xd3i1", "2345600", "567800.5", ""},
                  {"P1", "2345678.123", "567890.456", "12.5"},
                  {"ABCDEFGHIJKL", "0.5", "-0.25", ""},
                  {"BAD", "abc", "", ""}};
  AddPoint(survey, "15", 2345678.123, 567890.456);
  AddPoint(survey, "", 2345700.001, 567900.999);
  AddPoint(survey, "C\xacng", -12.5, 7);
  AddPoint(survey, "ABCDEFGHIJKL", 1E3, 2E2);
  AddPoint(survey, "CP", 1, 2, PointKind::Peg);
  EXPECT_EQ(Drawing(survey, 2), Expected("dxf/control_and_detail.dxf"));

  Survey one;
  AddPoint(one, "7", 100.25, 200.75);
  for (const double height : {0.0, std::numeric_limits<double>::infinity(), 1.5e308}) {
    EXPECT_EQ(Drawing(one, height), Expected("dxf/height_not_a_number.dxf")) << height;
  }
}

}  // namespace
}  // namespace kavu

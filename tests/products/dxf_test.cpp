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

// Labels 2 m high for details and 3 m for control points, 1 m north and east
// of them, x the easting; control points named in TCVN3, twice, in 12
// characters, with small or no numbers; pegs among the control points; no
// points; a label height out of range gives labels of height 0.
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

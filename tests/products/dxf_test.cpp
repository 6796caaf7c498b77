#include "products/dxf.h"

#include <gtest/gtest.h>

#include "tests/products/product_files.h"

namespace kavu {
namespace {

using testing::Expected;
using testing::FileBytes;
using testing::FreshFolder;

void AddDetail(Survey& survey, const std::string& name, double x, double y,
               PointKind kind = PointKind::Detail) {
  survey.AddPoint(kind == PointKind::Peg ? "1 0 1 900000 1 " + name : name + " 0 1 900000 1", kind,
                  x, y);
}

RunState DrawingState(const std::string& tyle, const std::string& htext) {
  RunState st;
  st.daufile = (FreshFolder() / "JOB1").string();
  st.Tyle = tyle;
  st.Htext = htext;
  return st;
}

// Scale 1000, 2 mm: detail labels 2 m high, control labels 3 m, both 1 m north
// and east of their point; drawing x is the easting. The control table holds a
// TCVN3 name, a point looked up twice (drawn twice), a 12-character name,
// small numbers written without their leading zero and coordinates that are
// not numbers (drawn at 0); the details an empty name and exponent forms.
TEST(Dxf, ControlAndDetailPointsWithTheirLabels) {
  RunState st = DrawingState("1000", "2.0");
  st.MangKhongChe = {{"P1", "2345678.123", "567890.456", "12.5"},
                     {"\xa7\xd3i1", "2345600", "567800.5", ""},
                     {"P1", "2345678.123", "567890.456", "12.5"},
                     {"ABCDEFGHIJKL", "0.5", "-0.25", ""},
                     {"BAD", "abc", "", ""}};
  AddDetail(st.survey, "15", 2345678.123, 567890.456);
  AddDetail(st.survey, "", 2345700.001, 567900.999);
  AddDetail(st.survey, "C\xacng", -12.5, 7);
  AddDetail(st.survey, "ABCDEFGHIJKL", 1E3, 2E2);
  // A peg is drawn among the control points, never as a detail point.
  AddDetail(st.survey, "CP", 1, 2, PointKind::Peg);
  ASSERT_TRUE(indxf(st));
  EXPECT_EQ(FileBytes(st.daufile + ".dxf"), Expected("dxf/control_and_detail.dxf"));
}

TEST(Dxf, NoPointsGivesSectionAndEndOnly) {
  RunState st = DrawingState("1000", "2.0");
  ASSERT_TRUE(indxf(st));
  EXPECT_EQ(FileBytes(st.daufile + ".dxf"), Expected("dxf/no_points.dxf"));
}

// A height that is not a number makes h = 0: labels of height 0 on the point.
TEST(Dxf, HeightNotANumberPutsLabelsOnThePoint) {
  RunState st = DrawingState("500", "mm");
  AddDetail(st.survey, "7", 100.25, 200.75);
  ASSERT_TRUE(indxf(st));
  EXPECT_EQ(FileBytes(st.daufile + ".dxf"), Expected("dxf/height_not_a_number.dxf"));
}

TEST(Dxf, ScaleNotANumberOrOutOfRangeGivesHeightZero) {
  for (const auto& [tyle, htext] : {std::pair{"", "2.0"}, std::pair{"1D300", "1D300"}}) {
    RunState st = DrawingState(tyle, htext);
    AddDetail(st.survey, "7", 100.25, 200.75);
    ASSERT_TRUE(indxf(st));
    EXPECT_EQ(FileBytes(st.daufile + ".dxf"), Expected("dxf/height_not_a_number.dxf")) << tyle;
  }
}

TEST(Dxf, UnwritableFileIsReported) {
  RunState st = DrawingState("1000", "2.0");
  st.daufile = (FreshFolder() / "no such folder" / "JOB1").string();
  EXPECT_FALSE(indxf(st));
}

}  // namespace
}  // namespace kavu

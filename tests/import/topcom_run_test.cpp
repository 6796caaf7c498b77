// The Topcom example jobs through a whole run: converted, computed, and a few
// coordinates checked against an azimuth and distance worked out here from
// the control points.
#include <cmath>
#include <string>

#include "import/converters.h"
#include "tests/import/instrument_test_util.h"

namespace kavu::testing {
namespace {

const Xy kGps01{2341520.412, 585310.227};
const Xy kGps02{2341688.905, 585402.618};
const Xy kGps03{2341605.330, 585561.774};
const Xy kGps04{2341432.118, 585498.501};

class TopcomRun : public InstrumentRunTest {
 protected:
  int RunWithControl(const std::string& job) {
    return Run({kExamples / job, kExamples / "job-idx-tcm-control.txt"},
               {"--txt", "--control-file", (dir_ / "job-idx-tcm-control.txt").string()});
  }
};

TEST_F(TopcomRun, KeywordExampleComputes) {
  EXPECT_EQ(RunWithControl("job-idx.idx"), kExitOk);
  const auto points = Coordinates("job-idx.txt");
  EXPECT_EQ(points.size(), 16u);  // 14 points and the two orientation points
  // 101 from GPS01 on GPS02: Hz 187.633516, slope 84.578 at Vz 89.199928.
  ExpectNear(
      points, "101",
      Polar(kGps01, kGps02, 187.633516, 84.578 * std::sin(89.199928 * std::acos(-1.0) / 180)));
  // 113 from GPS04 on GPS03: 215 57 52 (whole seconds), 89.659 reduced.
  ExpectNear(points, "113", Polar(kGps04, kGps03, 215 + 57 / 60.0 + 52 / 3600.0, 89.659));
}

TEST_F(TopcomRun, Topcom226ExampleComputes) {
  EXPECT_EQ(RunWithControl("job-tcm.tcm"), kExitOk);
  const auto points = Coordinates("job-tcm.txt");
  EXPECT_EQ(points.size(), 9u);  // the peg and the orientation sights are not detail points
  // 202 from GPS03 on GPS04 (circle 0 there): 160 00 37, 87.580.
  ExpectNear(points, "202", Polar(kGps03, kGps04, 160 + 37 / 3600.0, 87.580));
  // 205 from GPS01, circle 0 00 02 on GPS04: 293 25 37 - 2" = 293 25 35.
  ExpectNear(points, "205", Polar(kGps01, kGps04, 293 + 25 / 60.0 + 35 / 3600.0, 42.866));
  // 210 from GPS02 on GPS01: 6 37 17, 99.812.
  ExpectNear(points, "210", Polar(kGps02, kGps01, 6 + 37 / 60.0 + 17 / 3600.0, 99.812));
}

}  // namespace
}  // namespace kavu::testing

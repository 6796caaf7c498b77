// The example jobs of every instrument kind through a whole run: converted by
// the batch command, computed, and a few coordinates checked against an
// azimuth and a reduced distance worked out here from the raw values.
#include <cmath>
#include <string>
#include <vector>

#include "tests/import/instrument_test_util.h"

namespace kavu::testing {
namespace {

const Xy kKc01{5000, 3000}, kKc02{5100, 3050}, kKc03{4950, 3120};
const Xy kGps01{2341520.412, 585310.227}, kGps02{2341688.905, 585402.618},
    kGps03{2341605.330, 585561.774}, kGps04{2341432.118, 585498.501};

double Degrees(double d, double m, double s) { return d + m / 60 + s / 3600; }

// A point shot with the circle reading `circle` when the orientation point
// was read at `circle0`; slope distance and zenith angle as recorded.
Xy Shot(Xy station, Xy orientation, double circle0, double circle, double slope, double zenith) {
  return Polar(station, orientation, circle - circle0,
               slope * std::sin(zenith * std::acos(-1.0) / 180));
}

struct Point {
  const char* name;
  Xy expected;
};
struct Job {
  const char* file;
  bool control;        // the Topcom jobs take their control points from a common file
  std::size_t points;  // lines of the coordinate text file's names
  std::vector<Point> checked;
};

class InstrumentRun : public InstrumentRunTest {};

TEST_F(InstrumentRun, ExampleJobsComputeToTheirShots) {
  const Job jobs[] = {
      // 101 is shot before the backsight KC02 (read at 349.315051): turned;
      // 104 after a prism-height change; 106 from KC03 on KC01.
      {"job-sdr.sdr",
       false,
       6,
       {{"101", Shot(kKc01, kKc02, 349.315051, 15.880102, 50.0025, 89.427061)},
        {"104", Shot(kKc01, kKc02, 349.315051, 47.039407, 100.5072, 89.258893)},
        {"106", Shot(kKc03, kKc01, 351.119865, 272.190068, 36.0614, 91.032802)}}},
      // The backsight shots KC02 and KC01 are points too.
      {"job-obs.obs",
       false,
       8,
       {{"101", Shot(kKc01, kKc02, 349.31505118, 15.88010235, 50.00249994, 89.42706130)},
        {"105", Shot(kKc03, kKc01, 351.11986495, 95.36989765, 50.00022500, 89.82811318)}}},
      // 103 twice (the second from KC02 on KC01, read at 194.56505118).
      {"job-set.set",
       false,
       8,
       {{"102", Shot(kKc01, kKc02, 349.31505118, 71.18494882, 63.24586943, 89.81881544)},
        {"103", Shot(kKc02, kKc01, 194.56505118, 224.30993247, 72.11369079, 90.49260855)}}},
      // 101 from GPS01 on GPS02; 113 from GPS04 on GPS03 in whole seconds.
      {"job-idx.idx",
       true,
       16,
       {{"101", Shot(kGps01, kGps02, 0, 187.633516, 84.578, 89.199928)},
        {"113", Polar(kGps04, kGps03, Degrees(215, 57, 52), 89.659)}}},
      // 205 from GPS01, circle 0 00 02 on GPS04: 293 25 37 - 2"; the peg and
      // the orientation sights are no detail points.
      {"job-tcm.tcm",
       true,
       9,
       {{"202", Polar(kGps03, kGps04, Degrees(160, 0, 37), 87.580)},
        {"205", Polar(kGps01, kGps04, Degrees(293, 25, 35), 42.866)}}},
  };
  tolerance_ = 0.002;  // readings through whole seconds, distances through millimetres
  for (const Job& job : jobs) {
    SCOPED_TRACE(job.file);
    std::vector<std::string> args{"--txt", "--seed", "1"};
    if (job.control) {
      args.push_back("--control-file");
      args.push_back((kExamples / "job-idx-tcm-control.txt").string());
    }
    EXPECT_EQ(Run({kExamples / job.file}, args), kExitOk);
    const std::string txt = std::filesystem::path(job.file).stem().string() + ".txt";
    const auto points = Coordinates(txt);
    EXPECT_EQ(points.size(), job.points);
    for (const Point& p : job.checked) ExpectNear(points, p.name, p.expected);
  }
}

}  // namespace
}  // namespace kavu::testing
